// BCursor: the picture of the pointer.
#pragma once

#include <memory>

#include <AppDefs.h>
#include <Archivable.h>
#include <InterfaceDefs.h>

namespace BPrivate {
class CursorPrivate;
struct CursorPicture;
} // namespace BPrivate

class BBitmap;
class BPoint;

enum BCursorID {
	B_CURSOR_ID_SYSTEM_DEFAULT = 1,
	B_CURSOR_ID_CONTEXT_MENU = 3,
	B_CURSOR_ID_COPY = 4,
	B_CURSOR_ID_CREATE_LINK = 29,
	B_CURSOR_ID_CROSS_HAIR = 5,
	B_CURSOR_ID_FOLLOW_LINK = 6,
	B_CURSOR_ID_GRAB = 7,
	B_CURSOR_ID_GRABBING = 8,
	B_CURSOR_ID_HELP = 9,
	B_CURSOR_ID_I_BEAM = 2,
	B_CURSOR_ID_I_BEAM_HORIZONTAL = 10,
	B_CURSOR_ID_MOVE = 11,
	B_CURSOR_ID_NO_CURSOR = 12,
	B_CURSOR_ID_NOT_ALLOWED = 13,
	B_CURSOR_ID_PROGRESS = 14,
	B_CURSOR_ID_RESIZE_NORTH = 15,
	B_CURSOR_ID_RESIZE_EAST = 16,
	B_CURSOR_ID_RESIZE_SOUTH = 17,
	B_CURSOR_ID_RESIZE_WEST = 18,
	B_CURSOR_ID_RESIZE_NORTH_EAST = 19,
	B_CURSOR_ID_RESIZE_NORTH_WEST = 20,
	B_CURSOR_ID_RESIZE_SOUTH_EAST = 21,
	B_CURSOR_ID_RESIZE_SOUTH_WEST = 22,
	B_CURSOR_ID_RESIZE_NORTH_SOUTH = 23,
	B_CURSOR_ID_RESIZE_EAST_WEST = 24,
	B_CURSOR_ID_RESIZE_NORTH_EAST_SOUTH_WEST = 25,
	B_CURSOR_ID_RESIZE_NORTH_WEST_SOUTH_EAST = 26,
	B_CURSOR_ID_ZOOM_IN = 27,
	B_CURSOR_ID_ZOOM_OUT = 28
};


// A value once made. Cursor data are 68 bytes: size (16), depth (1), hot spot row and column, then
// 16 rows of 2 bytes of colour bits and as many of mask bits.
class _EXPORT BCursor : BArchivable {
public:
	BCursor(const void* cursorData);
	BCursor(const BCursor& other);
	BCursor(BCursorID id);
	BCursor(BMessage* data);
	// Copies the picture, which is 256 pixels wide and high at most. The hot spot lies in it.
	BCursor(const BBitmap* bitmap, const BPoint& hotspot);
	virtual ~BCursor();

	static BArchivable* Instantiate(BMessage* data);
	virtual status_t Archive(BMessage* archive, bool deep = true) const;

	status_t InitCheck() const;
	BCursor& operator=(const BCursor& other);
	bool operator==(const BCursor& other) const;
	bool operator!=(const BCursor& other) const { return !(*this == other); }

private:
	friend class BPrivate::CursorPrivate;

	uint8 fData[68] = {}; // as given; only with an id of 0
	int32 fID = 0; // a BCursorID, or 0 for own data or an own picture
	std::shared_ptr<const BPrivate::CursorPicture> fPicture; // shared by copies
	status_t fStatus = B_OK;
};
