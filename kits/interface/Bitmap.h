// BBitmap: an image in memory; views may be attached to one to draw in it.
#pragma once

#include <memory>

#include <Archivable.h>
#include <InterfaceDefs.h>
#include <Rect.h>

class BView;
class BWindow;

namespace BPrivate {
class BitmapAccess;
class Surface;
} // namespace BPrivate

enum {
	B_BITMAP_CLEAR_TO_WHITE = 0x00000001,
	B_BITMAP_ACCEPTS_VIEWS = 0x00000002,
	B_BITMAP_IS_AREA = 0x00000004,
	B_BITMAP_IS_LOCKED = 0x00000008 | B_BITMAP_IS_AREA,
	B_BITMAP_IS_CONTIGUOUS = 0x00000010 | B_BITMAP_IS_LOCKED,
	B_BITMAP_IS_OFFSCREEN = 0x00000020,
	B_BITMAP_WILL_OVERLAY = 0x00000040 | B_BITMAP_IS_OFFSCREEN,
	B_BITMAP_RESERVE_OVERLAY_CHANNEL = 0x00000080,
	B_BITMAP_NO_SERVER_LINK = 0x00000100
};

#define B_ANY_BYTES_PER_ROW -1


// Bounds are whole numbers from (0, 0): width + 1 by height + 1 pixels, always at scale 1. A
// bitmap that could not be made (bounds not valid or too large, a space that bitmaps do not
// support, no memory) says so by InitCheck(), has no bits and ignores everything else.
// Its pixels belong to one thread at a time; with views, Lock() says whose turn it is.
class BBitmap : public BArchivable {
public:
	BBitmap(BRect bounds, uint32 flags, color_space colorSpace,
		int32 bytesPerRow = B_ANY_BYTES_PER_ROW, screen_id screenID = B_MAIN_SCREEN_ID);
	BBitmap(BRect bounds, color_space colorSpace, bool acceptsViews = false,
		bool needsContiguous = false);
	BBitmap(const BBitmap& source, uint32 flags);
	BBitmap(const BBitmap& source);
	BBitmap(const BBitmap* source, bool acceptsViews = false, bool needsContiguous = false);
	BBitmap(BMessage* data);
	virtual ~BBitmap();

	static BArchivable* Instantiate(BMessage* data);
	virtual status_t Archive(BMessage* data, bool deep = true) const;

	status_t InitCheck() const { return fInitStatus; }
	bool IsValid() const { return fInitStatus == B_OK; }
	status_t LockBits(uint32* state = NULL);
	void UnlockBits();

	void* Bits() const { return fBits; }
	int32 BitsLength() const; // bytes
	int32 BytesPerRow() const { return fBytesPerRow; }
	color_space ColorSpace() const { return fColorSpace; }
	BRect Bounds() const { return fBounds; }
	uint32 Flags() const { return fFlags; }

	// Converted from rows padded as this class pads them; length and offset are bytes, the offset
	// one of this bitmap's. What would lie beyond the end is cut off.
	void SetBits(const void* data, int32 length, int32 offset, color_space colorSpace);

	// Pixels of any supported space, converted. B_BAD_VALUE: a bad space, offset or rectangle.
	status_t ImportBits(
		const void* data, int32 length, int32 bytesPerRow, int32 offset, color_space colorSpace);
	status_t ImportBits(const void* data, int32 length, int32 bytesPerRow, color_space colorSpace,
		BPoint from, BPoint to, BPoint size);
	status_t ImportBits(const BBitmap* bitmap);
	status_t ImportBits(const BBitmap* bitmap, BPoint from, BPoint to, BPoint size);

	// Views of a bitmap that accepts them; the bitmap deletes those that are left at its end.
	virtual void AddChild(BView* view);
	virtual bool RemoveChild(BView* view);
	int32 CountChildren() const;
	BView* ChildAt(int32 index) const;
	BView* FindView(const char* viewName) const;
	BView* FindView(BPoint point) const;
	bool Lock();
	void Unlock();
	bool IsLocked() const;

	BBitmap& operator=(const BBitmap& source);

private:
	friend class BPrivate::BitmapAccess;

	void _Init(BRect bounds, color_space space, uint32 flags, int32 bytesPerRow);
	void _InitFrom(const BBitmap& source, uint32 flags);
	void _MakeWindow();
	void _LoadSurface();
	void _StoreSurface();
	status_t _Import(const uint8* data, int32 length, int32 bytesPerRow, color_space space,
		int32 fromX, int32 fromY, int32 toX, int32 toY, int32 width, int32 height);
	static uint8 _WhiteIndex();
	void _Clear();

	uint8* fBits; // ours, by malloc()
	BRect fBounds;
	color_space fColorSpace;
	uint32 fFlags;
	int32 fBytesPerRow;
	status_t fInitStatus;
	// What views draw in: it shares our bits where they are 32-bit pixels, else it has its own.
	std::unique_ptr<BPrivate::Surface> fSurface;
	BWindow* fWindow; // ours; NULL unless views are accepted
};
