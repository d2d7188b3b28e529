#include "addon/PalettePresence.h"

#include <algorithm>
#include <mutex>

#include <Messenger.h>
#include <Screen.h>

#include "palette/WidgetWindow.h"

namespace {


// Editors live in windows with threads of their own. The palette's thread never takes this.
std::mutex sMutex;
BMessenger sPalette; // invalid once the palette is gone, as when the program ends all its windows

const BPoint kPaletteLeftTop(800, 400); // on the screen, if it is large enough
constexpr float kFrameWidth = 6; // of the desktop's frames, at most
constexpr float kTitleHeight = 26;


// A small screen shows all of the palette, its title before all.
void
MoveOntoScreen(BWindow* window)
{
	const BRect screen = BScreen().Frame();
	const BRect frame = window->Frame();
	const float left = std::min(frame.left, screen.right - kFrameWidth - frame.Width());
	const float top = std::min(frame.top, screen.bottom - kFrameWidth - frame.Height());
	window->MoveTo(
		std::max(screen.left + kFrameWidth, left), std::max(screen.top + kTitleHeight, top));
}


} // namespace


void
EnterPalette()
{
	std::lock_guard<std::mutex> guard(sMutex);

	if (widgetWindow == nullptr || !sPalette.IsValid()) {
		widgetWindow = new WidgetWindow(kPaletteLeftTop);
		sPalette = BMessenger(widgetWindow);
		widgetWindow->Lock();
		MoveOntoScreen(widgetWindow);
		widgetWindow->Show();
		widgetWindow->Unlock();
	}
	widgetWindowCount++;
}


void
LeavePalette()
{
	std::lock_guard<std::mutex> guard(sMutex);

	if (--widgetWindowCount > 0 || widgetWindow == nullptr)
		return;

	if (sPalette.LockTarget())
		widgetWindow->Quit();
	widgetWindow = nullptr;
}
