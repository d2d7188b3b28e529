#include "backend/headless/HeadlessWindow.h"

#include <algorithm>

#include "backend/headless/HeadlessBackend.h"

namespace BPrivate {


HeadlessWindow::HeadlessWindow(
	HeadlessBackend& screen, FrontImage* image, const WindowTraits& traits) :
	fScreen(screen),
	fImage(image), fTraits(traits)
{
	fScreen.AddWindow(this);
}


HeadlessWindow::~HeadlessWindow()
{
	fScreen.RemoveWindow(this);
}


void
HeadlessWindow::SetTraits(const WindowTraits& traits)
{
	const bool layerChanged = traits.kind != fTraits.kind;
	const bool frameChanged = traits.frame != fTraits.frame;
	fTraits = traits;
	if (layerChanged)
		fScreen.RaiseWindow(this);
	if (frameChanged)
		fScreen.ReportFrame(this);
}


void
HeadlessWindow::TakeFrame(BRect frame)
{
	const float width = std::clamp(frame.Width(), fTraits.minWidth, fTraits.maxWidth);
	const float height = std::clamp(frame.Height(), fTraits.minHeight, fTraits.maxHeight);
	fTraits.frame.Set(frame.left, frame.top, frame.left + width, frame.top + height);
	fScreen.ReportFrame(this);
}


// Layers keep floating and modal windows above the others here.
void
HeadlessWindow::SetOwner(BackendWindow* owner, bool aboveAll)
{
}


void
HeadlessWindow::SetShown(bool shown)
{
	if (fShown == shown)
		return;
	fShown = shown;
	if (shown)
		fScreen.RaiseWindow(this);
	fScreen.ShownChanged(this);
}


void
HeadlessWindow::SetMinimized(bool minimized)
{
	if (fMinimized == minimized)
		return;
	fMinimized = minimized;
	fScreen.ShownChanged(this);
}


void
HeadlessWindow::Activate()
{
	fMinimized = false;
	fScreen.RaiseWindow(this);
	if (IsOnScreen() && fTraits.takesFocus)
		fScreen.SetActive(this);
}


void
HeadlessWindow::Raise()
{
	fScreen.RaiseWindow(this);
}


void
HeadlessWindow::PutBehind(BackendWindow* other)
{
	fScreen.LowerWindow(this, other);
}


// The picture of the screen has no pointer in it.
void
HeadlessWindow::SetCursor(const CursorShape& shape)
{
}


void
HeadlessWindow::SetTextSpot(BRect screen)
{
}


// Nothing to do: the front image is read when somebody looks.
void
HeadlessWindow::Flush(const BRegion& devicePixels)
{
}


bool
HeadlessWindow::Contains(BPoint screen) const
{
	const BRect& frame = fTraits.frame;
	return screen.x >= frame.left && screen.x < frame.right + 1 && screen.y >= frame.top
		&& screen.y < frame.bottom + 1;
}


int32
HeadlessWindow::Layer() const
{
	return static_cast<int32>(fTraits.kind);
}


} // namespace BPrivate
