// MenuTracker: follows the user through open menus until an item is chosen.
#pragma once

#include <atomic>
#include <condition_variable>
#include <memory>
#include <mutex>
#include <vector>

#include <Menu.h>
#include <MessageRunner.h>
#include <Messenger.h>

class BMenuBar;
class BMenuItem;
class BWindow;

namespace BPrivate {

class MenuWindow;
class Worker;


// A state machine that the messages of the first menu's window feed, in that window's thread; the
// windows of submenus only draw. Items are read and changed in steps, each of which takes the lock
// of the window that owns the menus. Locks are taken in the order first menu's window, submenu's
// window, owner; so the owner never waits for a menu's window, except to end the tracking: then the
// steps give up waiting for it.
class MenuTracker : public std::enable_shared_from_this<MenuTracker> {
public:
	struct Request {
		BMenu* menu = nullptr; // opened at `where`; NULL: the submenu of barItem
		BPoint where;
		bool useWhere = false; // else the menu's ScreenLocation()
		BMenuBar* bar = nullptr;
		BMenuItem* barItem = nullptr;
		bool sticky = false; // stays open without a button held
		bool staysOnClick = false; // becomes sticky by a click
		bool byKey = false; // the first item is selected
		bool hasClickToOpen = false;
		BRect clickToOpen; // screen; a click inside makes it sticky
		bool deliver = false; // the chosen item is invoked
		bool autoDestruct = false; // the menu is deleted at the end
	};

	// Waits for the end; a window's own thread keeps the window drawn meanwhile. The chosen item,
	// or NULL.
	static BMenuItem* Track(const Request& request);
	// Returns at once. The caller holds the lock of the window that owns the menus, if there is one.
	static void Start(const Request& request);
	// Ends what the window's menus are doing, since the window is about to go or waits for something
	// else. The caller holds its lock.
	static void EndMenusOf(BWindow* window);

	~MenuTracker();

	// One step: the items belong to the caller while it lives. Not locked: the tracking ends.
	class Step {
	public:
		explicit Step(MenuTracker& tracker);
		~Step();
		Step(const Step&) = delete;
		Step& operator=(const Step&) = delete;
		bool IsLocked() const { return fLocked; }

	private:
		MenuTracker& fTracker;
		bool fLocked = false;
		bool fOwner = false;
	};

	// By the owner's side, under its lock.
	void Abort(); // returns when no menu is open any more
	void MenuChanged(BMenu* menu);
	bool IsBar(const BMenu* menu) const;

	// By the menus' windows.
	void WindowStarted();
	void MessageReceived(BMessage* message);
	void MouseMoved(BPoint screen);
	void MouseDown(BPoint screen);
	void MouseUp(BPoint screen, bigtime_t when);
	void KeyDown(const BMessage& message, const char* bytes, int32 numBytes);
	void Forward(const BMessage& message); // from the window of a submenu to that of the first
	bool IsFirst(const MenuWindow* window) const { return window == fFirst; }
	bool IsDone() const { return fDone; }

private:
	enum class Sharing { kNone, kOwner, kLoan };

	struct Level {
		BMenu* menu;
		MenuWindow* window;
		BRect frame; // of the window, on the screen
		BRect area; // where the items show, on the screen
		BRect savedFrame; // of the menu, as it is while closed
		float scroll; // of the items
		float maxScroll;
		bool adding; // its AddDynamicItem() has more
	};
	struct Hit {
		int32 level = -1; // -1: outside, kBarLevel: in the bar
		BMenuItem* item = nullptr;
		int32 arrow = 0; // -1 upper, 1 lower
	};
	static constexpr int32 kBarLevel = -2;

	MenuTracker(const Request& request, Sharing sharing, BWindow* owner);

	bool _Begin();
	BMenuItem* _Wait(BWindow* window);
	void _UpdateWaiting(BWindow* window);
	void _Finish(BMenuItem* item);
	void _CloseBar();
	bool _IsInOpenMenu(const BMenuItem* item) const;
	bool _HookEnds();

	void _Open(BMenu* menu, bool selectFirst);
	void _Place(Level& level, BPoint where, BPoint size);
	void _CloseFrom(size_t level);
	void _Close(Level& level);
	void _Relayout();
	void _AddMoreItems();
	Hit _HitTest(BPoint screen);
	void _Follow(const Hit& hit, bool byKey);
	void _Select(size_t level, BMenuItem* item);
	void _OpenBarItem(BMenuItem* item, bool selectFirst);
	void _Release(BPoint screen);
	bool _CanChoose(BMenuItem* item, BMenu** _submenu);
	BMenuItem* _SelectedInBar();

	void _MoveSelection(bool forward);
	void _MoveToEnd(bool last);
	void _StepIn();
	void _StepOut();
	void _NextInBar(bool forward);
	void _ChooseSelected();
	void _ChooseByTrigger(uint32 character);
	BMenuItem* _Selected();
	void _RevealSelected();

	void _SetArrow(int32 level, int32 direction);
	void _ScrollLevel(size_t level, float by);
	void _Synchronize();

	const Request fRequest;
	const Sharing fSharing;
	BWindow* const fOwner; // borrowed; NULL if no window owns the menus
	BMenuBar* const fBar; // borrowed
	MenuWindow* fFirst = nullptr; // deletes itself
	BMessenger fFirstMessenger;
	std::vector<Level> fLevels; // of the first window's thread
	std::recursive_mutex fLoan; // what a step takes while the owner's thread waits
	std::atomic<bool> fAborted { false };
	std::atomic<bool> fChangePosted { false };
	std::atomic<thread_id> fThread { -1 };

	bool fSticky = false;
	bool fReleased = false; // the press that opened the menu is over
	bool fMoved = false;
	bool fHasOrigin = false;
	bool fPressedInside = false;
	bool fFinished = false;
	BPoint fOrigin; // where the pointer was at first
	bigtime_t fStartTime = 0;
	int32 fArrowLevel = -1;
	int32 fArrow = 0;
	std::unique_ptr<BMessageRunner> fScroller;
	std::unique_ptr<BMessageRunner> fHookRunner;

	std::mutex fDoneLock;
	std::condition_variable fDoneCondition;
	std::atomic<bool> fDone { false };
	BMenuItem* fResult = nullptr;
	Worker* fWaiter = nullptr; // borrowed; the looper that waits for the end
};


// What tests, scripts and the inspector may know of menus beyond their public calls. The menu's
// window and the owner are locked.
class MenuAccess {
public:
	// Where the item is shown now, in the coordinates of its menu.
	static BRect FrameOf(const BMenuItem* item);
	static MenuTracker* TrackerOf(const BMenu* menu);
	static bool IsSelected(const BMenuItem* item);
};


} // namespace BPrivate
