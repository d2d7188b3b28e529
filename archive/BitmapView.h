// BitmapView: an archivable view that shows a bitmap, tiled, as its background.
#pragma once

#include <memory>

#include <BeBuild.h>
#include <View.h>

class BBitmap;
class BMessage;


// Exported, so that any program that loads the add-on can revive archives that name it.
class _EXPORT BitmapView : public BView {
public:
	BitmapView(BRect frame, const char* name, uint32 resizingMode, uint32 flags);
	BitmapView(BMessage* archive);
	~BitmapView() override;

	static BArchivable* Instantiate(BMessage* archive);

	// A deep archive holds the bitmap, a shallow one does not.
	status_t Archive(BMessage* archive, bool deep = true) const override;

	void AttachedToWindow() override;

	BBitmap* Bitmap() const; // NULL when there is none

	// The caller keeps the bitmap and its ownership; it must outlive the view. Shown from the next
	// attachment on.
	void SetBitmap(BBitmap* bitmap);

	// The same, but the view owns the bitmap.
	void AdoptBitmap(std::unique_ptr<BBitmap> bitmap);

private:
	BBitmap* fBitmap; // borrowed, or fOwnBitmap
	std::unique_ptr<BBitmap> fOwnBitmap;
	std::unique_ptr<BMessage> fSource; // the archive that the bitmap came from, to be written back
};
