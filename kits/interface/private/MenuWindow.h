// MenuWindow: the window that an open menu is shown in.
#pragma once

#include <memory>

#include <Window.h>

class BMenu;

namespace BPrivate {

class MenuTracker;


// The frame round the items, with arrows where there are more of them than fit. In the first
// menu's window it hears every pointer event of the program.
class MenuFrame : public BView {
public:
	MenuFrame(BRect frame, MenuTracker& tracker);

	virtual void AttachedToWindow();
	virtual void Draw(BRect updateRect);
	virtual void MouseDown(BPoint where);
	virtual void MouseUp(BPoint where);
	virtual void MouseMoved(BPoint where, uint32 transit, const BMessage* message);
	virtual void KeyDown(const char* bytes, int32 numBytes);

	void SetArrows(bool shown, bool canScrollUp, bool canScrollDown);

private:
	bool _GetScreenPoint(BPoint* _point) const;
	bool _IsFirst() const;

	MenuTracker& fTracker; // lives as long as the window
	bool fHasArrows = false;
	bool fCanScrollUp = false;
	bool fCanScrollDown = false;
};


class MenuWindow : public BWindow {
public:
	static constexpr float kBorder = 1; // pixels round the items
	static constexpr float kArrowHeight = 12; // pixels

	MenuWindow(std::shared_ptr<MenuTracker> tracker, BRect frame);

	virtual bool QuitRequested();
	virtual void MessageReceived(BMessage* message);

	MenuFrame* Frame_() const { return fFrame; }
	// Moves it out of the way while no menu is open in it.
	void Park();
	void AllowQuit() { fMayQuit = true; }

private:
	std::shared_ptr<MenuTracker> fTracker;
	MenuFrame* fFrame; // child
	bool fMayQuit = false;
};


} // namespace BPrivate
