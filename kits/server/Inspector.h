// Inspector: the views of a window described, for scripts that name and examine them.
#pragma once

#include <string>
#include <vector>

#include <GraphicsDefs.h>
#include <Rect.h>
#include <SupportDefs.h>

namespace BPrivate {


// One view, or one item of a list or a menu (then `isItem` is set). A copy, so it holds no lock and
// outlives its view; only `address` does not.
struct ViewNode {
	const void* address = nullptr; // of the view or item, for comparison alone
	std::string className; // with name spaces
	std::vector<std::string> baseClasses; // nearest first, up to BView
	bool isItem = false;
	int32 level = 0; // of an outline item

	std::string name;
	std::string label; // of a control, box, menu item or tab
	std::string text; // of a text view or control, string view, list item or status bar
	std::string value; // of a control or scroll bar, as a number
	std::string marked; // label of a menu field's marked item, or what the field shows
	std::vector<int32> selection; // of a list
	int32 count = 0; // items of a list or menu, tabs, or children otherwise

	BRect frame; // in the parent
	BRect bounds;
	BRect screen; // the whole view
	BRect visible; // the part that its parents and the window leave, on the screen; may be invalid

	bool enabled = true;
	bool focus = false;
	bool hidden = false; // by itself or by a parent
	bool isMarked = false;
	bool isSelected = false;

	std::string font; // "family/style/size"
	rgb_color viewColor = { 0, 0, 0, 0 }, lowColor = { 0, 0, 0, 0 }, highColor = { 0, 0, 0, 0 };

	std::vector<ViewNode> children; // in child order; items of a list or menu come before views
};


struct WindowNode {
	uint32 id = 0; // of the ServerWindow
	std::string title;
	std::string className;
	bool shown = false;
	bool active = false;
	bool isAlert = false;
	bool isMenu = false; // a window that a menu has opened
	BRect frame;
};


// Implemented by the interface kit. Called by threads that hold no lock, one at a time.
class Inspector {
public:
	virtual ~Inspector() = default;

	// In the order of their making, hidden and menu windows too.
	virtual std::vector<WindowNode> Windows() = 0;

	// The window's top view, whose children are its views. Fails with B_BAD_VALUE when there is no
	// such window, with B_TIMED_OUT when its lock cannot be had for so many microseconds.
	virtual status_t Describe(uint32 window, bigtime_t timeout, ViewNode* _root) = 0;

	// Scrolls an item of a list into view, the only thing that a script does to a view by itself.
	virtual status_t RevealItem(uint32 window, const void* view, const void* item) = 0;
};


} // namespace BPrivate
