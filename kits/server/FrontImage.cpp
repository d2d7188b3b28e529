#include "server/FrontImage.h"

#include "server/paint/Surface.h"

namespace BPrivate {


FrontImage::FrontImage() = default;


FrontImage::~FrontImage() = default;


void
FrontImage::CopyFrom(const Surface& back, const BRegion& damage)
{
	std::lock_guard lock(fLock);
	const bool fits = fSurface != nullptr && fSurface->Width() == back.Width()
		&& fSurface->Height() == back.Height() && fSurface->Scale() == back.Scale();
	if (fits) {
		_Copy(back, damage);
		return;
	}

	auto surface = std::make_unique<Surface>();
	if (surface->SetTo(back.Width(), back.Height(), back.Scale()) != B_OK)
		return;
	fSurface = std::move(surface);
	fPending.MakeEmpty();
	BRegion all;
	all.Set(back.LogicalBounds());
	_Copy(back, all);
}


void
FrontImage::_Copy(const Surface& back, const BRegion& damage)
{
	fSurface->CopyFrom(back, damage);
	if (back.Scale() == 1) {
		fPending.Include(&damage);
		return;
	}
	for (int32 i = 0; i < damage.CountRects(); i++)
		fPending.Include(back.ToDevice(damage.RectAtInt(i)));
}


BRegion
FrontImage::TakePending()
{
	std::lock_guard lock(fLock);
	BRegion pending = std::move(fPending);
	fPending.MakeEmpty();
	return pending;
}


FrontImage::Guard::Guard(FrontImage& image) : fImage(image), fLock(image.fLock)
{
}


} // namespace BPrivate
