#include "addon/PalettePresence.h"

#include <mutex>

#include <Point.h>

#include "palette/WidgetWindow.h"

namespace {


// Editors live in windows with threads of their own. The palette's thread never takes this.
std::mutex sMutex;

const BPoint kPaletteLeftTop(800, 400); // on the screen


} // namespace


void
EnterPalette()
{
	std::lock_guard<std::mutex> guard(sMutex);

	if (widgetWindow == nullptr) {
		widgetWindow = new WidgetWindow(kPaletteLeftTop);
		widgetWindow->Lock();
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

	widgetWindow->Lock();
	widgetWindow->Quit();
	widgetWindow = nullptr;
}
