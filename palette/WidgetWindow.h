// WidgetWindow: the floating palette that all editors share.
#pragma once

#include <Window.h>

class WidgetWindow;

// How many editors are attached, and the one palette, NULL when there is none. Both belong to the
// editors' attach and detach steps, which take a mutex of their own.
extern int32 widgetWindowCount;
extern WidgetWindow* widgetWindow;


class WidgetWindow : public BWindow {
public:
	explicit WidgetWindow(BPoint leftTop); // in screen coordinates

	// Writes the file when a sample was dropped on a file manager.
	void MessageReceived(BMessage* message) override;
};
