#include "archive/BitmapView.h"

#include <Bitmap.h>
#include <Message.h>

namespace {


constexpr const char* kClassName = "BitmapView";
constexpr const char* kBitmapField = "bitmap";


} // namespace


BitmapView::BitmapView(BRect frame, const char* name, uint32 resizingMode, uint32 flags) :
	BView(frame, name, resizingMode, flags), fBitmap(nullptr)
{
}


BitmapView::BitmapView(BMessage* archive) : BView(archive), fBitmap(nullptr)
{
	auto source = std::make_unique<BMessage>();
	if (archive->FindMessage(kBitmapField, source.get()) == B_OK) {
		AdoptBitmap(std::make_unique<BBitmap>(source.get()));
		fSource = std::move(source);
	}
}


BitmapView::~BitmapView()
{
}


BArchivable*
BitmapView::Instantiate(BMessage* archive)
{
	if (!validate_instantiation(archive, kClassName))
		return nullptr;
	return new BitmapView(archive);
}


status_t
BitmapView::Archive(BMessage* archive, bool deep) const
{
	BView::Archive(archive, deep);
	if (!deep || fBitmap == nullptr)
		return B_OK;

	if (fSource != nullptr) {
		archive->AddMessage(kBitmapField, fSource.get());
		return B_OK;
	}

	BMessage bitmapArchive;
	if (fBitmap->Archive(&bitmapArchive, deep) == B_OK)
		archive->AddMessage(kBitmapField, &bitmapArchive);
	return B_OK;
}


void
BitmapView::AttachedToWindow()
{
	BView::AttachedToWindow();
	if (fBitmap != nullptr && fBitmap->IsValid())
		SetViewBitmap(fBitmap, B_FOLLOW_ALL_SIDES, B_TILE_BITMAP);
}


BBitmap*
BitmapView::Bitmap() const
{
	return fBitmap;
}


void
BitmapView::SetBitmap(BBitmap* bitmap)
{
	if (bitmap == fBitmap)
		return;

	fBitmap = bitmap;
	fOwnBitmap.reset();
	fSource.reset();
}


void
BitmapView::AdoptBitmap(std::unique_ptr<BBitmap> bitmap)
{
	SetBitmap(bitmap.get());
	fOwnBitmap = std::move(bitmap);
}
