// WindowInternals: a window's views, its input and its updates.
#pragma once

#include <atomic>
#include <deque>
#include <memory>
#include <string>
#include <vector>

#include <MessageRunner.h>
#include <Window.h>

#include "app/private/ArchiveSource.h"
#include "interface/private/ToolTips.h"
#include "server/ServerWindow.h"
#include "server/ViewTree.h"

namespace BPrivate {

class ViewWalk;

// What a window adds to a mouse message for one view.
constexpr const char* kViewWhere = "be:view_where"; // a point in the view's coordinates
constexpr const char* kTransit = "be:transit";


// Belongs to who holds the window's lock, except for PostInput(), which the display thread calls.
class WindowInternals final : public WindowClient, public ViewTreeClient {
public:
	struct Shortcut {
		uint32 key; // lower case
		uint32 modifiers;
		std::unique_ptr<BMessage> message; // NULL for those of the window itself
		BHandler* target; // borrowed; NULL for the focus
		BView* targetView; // the same, if it is a view
		bool hasTarget; // false: the window
	};

	// Without a bitmap's surface it is a window of the desktop.
	WindowInternals(BWindow& window, BRect frame, Surface* bitmapSurface, BBitmap* bitmap);
	~WindowInternals() override;

	static WindowInternals& Of(const BWindow* window) { return *window->fInternals; }
	static BWindow* NewOffscreen(BBitmap* bitmap, Surface* surface);

	// WindowClient
	void PostInput(BMessage* message) override;
	// ViewTreeClient
	void DrawView(ServerView& view, BRect updateRect, bool afterChildren) override;
	void FrameChanged(ServerView& view, bool moved, bool resized) override;
	void UpdateNeeded() override;

	// Views come and go; the hooks are not this class's affair.
	void ViewsEntered(ServerView& top);
	void ViewsLeave(ServerView& top); // forgets every pointer into the subtree
	void EventMaskChanged(BView* view);
	void ViewHidden(BView* view);
	void NeedPulse();
	void UpdatePulse();
	void Pulse();

	// What was painted is shown when no message waits any more, or after the delay: by a message of
	// its own when another thread draws outside of an update.
	void NoteDrawing();
	void Present();
	void Flush();
	void Update();
	void PrepareSurface();
	void MessageHandled();
	void FollowServerSize();
	void ResizeViews(float width, float height);
	status_t ApplyKind();

	// Input, in WindowInput.cpp and WindowKeys.cpp. Takes ownership of the message.
	void Route(BMessage* message, BHandler* target);
	// For those who poll the mouse: the next waiting movement or release, which then reaches no
	// hook; false when none waits. Then GetPointer() tells the present state.
	bool TakePointer(BPoint* _screen, uint32* _buttons);
	void GetPointer(BPoint* _screen, uint32* _buttons);
	// A drag was asked for: until the desktop has answered, later presses and keys are kept back.
	// If the button is up already, the drop comes before them, as it would have in time.
	void AwaitDrag();
	void SetFocus(BView* view);
	void Navigate(const BView* from, bool backwards, bool byGroups);
	// Whether the key belongs to the window: a shortcut, or a key with Command held.
	bool HandleKeyDown(BMessage* message);
	bool SendShortcut(uint32 key, uint32 modifiers);
	void AddShortcut(
		uint32 key, uint32 modifiers, BMessage* message, BHandler* target, bool hasTarget);
	void RemoveShortcut(uint32 key, uint32 modifiers);
	void ApplyCursor();
	void CallWindowActivated(bool active);

	BWindow& window;
	ViewTree tree;
	std::unique_ptr<ServerWindow> server; // NULL for a bitmap's window
	Surface* bitmapSurface; // borrowed; NULL for a window of the desktop
	BBitmap* bitmap; // borrowed

	std::string title;
	window_type type = B_TITLED_WINDOW;
	window_look look = B_TITLED_WINDOW_LOOK;
	window_feel feel = B_NORMAL_WINDOW_FEEL;
	uint32 flags = 0;
	uint32 workspaces = 0;
	float minWidth = 0, maxWidth = 32768, minHeight = 0, maxHeight = 32768;
	float zoomMaxWidth = 32768, zoomMaxHeight = 32768;
	BRect beforeZoom; // not valid while the window is not zoomed
	int32 hideCount = 1; // a new window is hidden
	bool shownOnce = false;
	bool minimized = false;
	bool active = false; // what the window has been told
	int32 updatesDisabled = 0;
	int32 transactions = 0;
	bool presentPosted = false;
	// Microseconds. Longer for tests that count, which a busy machine must not disturb.
	static inline std::atomic<bigtime_t> presentDelay { 20000 };
	bigtime_t presentDue = 0; // when what is painted is shown though messages wait; 0 for nothing
	float surfaceScale = 0; // of what the tree paints on
	BRegion toPresent; // painted and not yet shown

	BView* focus = nullptr; // borrowed, as are the following
	BView* mouseView = nullptr;
	BView* rectTracker = nullptr; // a rectangle in it follows the pointer
	bool dragOver = false; // the last movement had something dragged
	BButton* defaultButton = nullptr;
	BView* defaultButtonView = nullptr; // the same
	BMenuBar* keyMenuBar = nullptr;
	BView* keyMenuBarView = nullptr; // the same
	std::vector<BView*> eventMaskViews; // with a permanent or temporary mask
	bool pressed = false; // between a press that came in and its release
	BPoint lastScreen; // of the last pointer message
	uint32 lastButtons = 0;
	bool inMouseDown = false;
	bool wantsAllPointer = false;
	BView* pointerTarget = nullptr; // during the handling of one pointer message
	BView* leftView = nullptr;
	BView* enteredView = nullptr;

	ToolTips tips { window };
	int32 awaitedDrags = 0;
	std::deque<std::unique_ptr<BMessage>> keptInput; // from the first press or key on

	std::vector<Shortcut> shortcuts;
	std::unique_ptr<BMessageRunner> pulseRunner;
	bigtime_t pulseRate = 500000;
	bool pulseNeeded = false;
	ViewWalk* walks = nullptr;
	std::unique_ptr<ArchiveSource> source;

private:
	void _PresentSoon();
	bool _KeepBack(BMessage* message);
	void _DragDecided();
	void _RoutePress(BMessage* message);
	void _RouteMove(BMessage* message);
	void _RouteWheel(BMessage* message);
	void _RouteDrop(BMessage* message);
	void _RouteKey(BMessage* message);
	bool _DeliverToMasks(const BMessage& event, BView* under, bool isMove);
	void _DeliverPointer(const BMessage& event, BView* view, int32 transit);
	void _Deliver(BMessage* message, BHandler* target);
	void _NotePointer(const BMessage& message);
	bool _NewerMoveWaits();
	bool _IsStale(const BMessage& event);
	void _EndPress();
	void _UpdatePointerWish();
	bool _HandleCommandKey(uint32 raw, uint32 typed, uint32 held);
};


} // namespace BPrivate
