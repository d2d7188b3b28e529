// FrontImage: the pixels of a window that the display thread may show.
#pragma once

#include <memory>
#include <mutex>

#include <Region.h>

namespace BPrivate {

class Surface;


// A window's thread copies finished rectangles in, the display thread reads; the lock is held for
// the copying alone, so that neither waits for the other's work.
class FrontImage {
public:
	FrontImage();
	~FrontImage();

	// Takes the size of `back` if it has changed, else only the damaged part; logical coordinates.
	void CopyFrom(const Surface& back, const BRegion& damage);

	// What was copied since the last call, in device pixels.
	BRegion TakePending();

	// For as long as the guard lives the pixels stay. The surface is NULL before the first copy.
	class Guard {
	public:
		explicit Guard(FrontImage& image);
		const Surface* Pixels() const { return fImage.fSurface.get(); }

	private:
		FrontImage& fImage; // borrowed
		std::lock_guard<std::mutex> fLock;
	};

private:
	void _Copy(const Surface& back, const BRegion& damage);

	std::mutex fLock;
	std::unique_ptr<Surface> fSurface;
	BRegion fPending; // device pixels
};


} // namespace BPrivate
