// HeadlessWindow: a window of the in-memory screen.
#pragma once

#include "backend/Backend.h"

namespace BPrivate {

class HeadlessBackend;


class HeadlessWindow : public BackendWindow {
public:
	HeadlessWindow(HeadlessBackend& screen, FrontImage* image, const WindowTraits& traits);
	~HeadlessWindow() override;

	void SetTraits(const WindowTraits& traits) override;
	void SetOwner(BackendWindow* owner, bool aboveAll) override;
	void SetShown(bool shown) override;
	void SetMinimized(bool minimized) override;
	void Activate() override;
	void Raise() override;
	void PutBehind(BackendWindow* other) override;
	void SetCursor(const CursorShape& shape) override;
	void SetTextSpot(BRect screen) override;
	void Flush(const BRegion& devicePixels) override;

	const WindowTraits& Traits() const { return fTraits; }
	FrontImage& Image() const { return *fImage; }
	bool IsOnScreen() const { return fShown && !fMinimized; }
	bool Contains(BPoint screen) const;
	int32 Layer() const; // higher layers lie in front of lower ones
	// The desktop gives it another frame, within its limits.
	void TakeFrame(BRect frame);

private:
	HeadlessBackend& fScreen;
	FrontImage* fImage; // borrowed
	WindowTraits fTraits;
	bool fShown = false;
	bool fMinimized = false;
};


} // namespace BPrivate
