// BWindow: a window on the screen, its thread, and the tree of views in it.
#pragma once

#include <BeBuild.h>
#include <Handler.h>
#include <InterfaceDefs.h>
#include <Looper.h>
#include <Rect.h>
#include <View.h>

enum window_type : uint32 {
	B_UNTYPED_WINDOW = 0,
	B_TITLED_WINDOW = 1,
	B_MODAL_WINDOW = 3,
	B_DOCUMENT_WINDOW = 11,
	B_BORDERED_WINDOW = 20,
	B_FLOATING_WINDOW = 21
};

enum window_look : uint32 {
	B_BORDERED_WINDOW_LOOK = 20,
	B_NO_BORDER_WINDOW_LOOK = 19,
	B_TITLED_WINDOW_LOOK = 1,
	B_DOCUMENT_WINDOW_LOOK = 11,
	B_MODAL_WINDOW_LOOK = 3,
	B_FLOATING_WINDOW_LOOK = 7
};

enum window_feel : uint32 {
	B_NORMAL_WINDOW_FEEL = 0,
	B_MODAL_SUBSET_WINDOW_FEEL = 2,
	B_MODAL_APP_WINDOW_FEEL = 1,
	B_MODAL_ALL_WINDOW_FEEL = 3,
	B_FLOATING_SUBSET_WINDOW_FEEL = 5,
	B_FLOATING_APP_WINDOW_FEEL = 4,
	B_FLOATING_ALL_WINDOW_FEEL = 6
};

enum window_alignment { B_BYTE_ALIGNMENT = 0, B_PIXEL_ALIGNMENT = 1 };

enum {
	B_NOT_MOVABLE = 0x00000001,
	B_NOT_CLOSABLE = 0x00000020,
	B_NOT_ZOOMABLE = 0x00000040,
	B_NOT_MINIMIZABLE = 0x00004000,
	B_NOT_RESIZABLE = 0x00000002,
	B_NOT_H_RESIZABLE = 0x00000004,
	B_NOT_V_RESIZABLE = 0x00000008,
	B_AVOID_FRONT = 0x00000080,
	B_AVOID_FOCUS = 0x00002000,
	B_WILL_ACCEPT_FIRST_CLICK = 0x00000010,
	B_OUTLINE_RESIZE = 0x00001000,
	B_NO_WORKSPACE_ACTIVATION = 0x00000100,
	B_NOT_ANCHORED_ON_ACTIVATE = 0x00020000,
	B_ASYNCHRONOUS_CONTROLS = 0x00080000,
	B_QUIT_ON_WINDOW_CLOSE = 0x00100000,
	B_SAME_POSITION_IN_ALL_WORKSPACES = 0x00200000,
	B_AUTO_UPDATE_SIZE_LIMITS = 0x00400000,
	B_CLOSE_ON_ESCAPE = 0x00800000,
	B_NO_SERVER_SIDE_WINDOW_MODIFIERS = 0x00000200
};

#define B_CURRENT_WORKSPACE 0
#define B_ALL_WORKSPACES 0xffffffff

class BBitmap;
class BButton;
class BMenuBar;
class BMessage;

namespace BPrivate {
class Surface;
class WindowInternals;
} // namespace BPrivate


// A new window is hidden, and locked by its maker until the first Show(), which starts its thread.
// Its views are used under its lock, which every hook holds. Frames are the content's, on the
// screen, without the desktop's border. Quit() ends a window; one never deletes it.
class _EXPORT BWindow : public BLooper {
public:
	BWindow(BRect frame, const char* title, window_type type, uint32 flags,
		uint32 workspaces = B_CURRENT_WORKSPACE);
	BWindow(BRect frame, const char* title, window_look look, window_feel feel, uint32 flags,
		uint32 workspaces = B_CURRENT_WORKSPACE);
	explicit BWindow(BMessage* archive);
	virtual ~BWindow();

	static BArchivable* Instantiate(BMessage* archive);
	virtual status_t Archive(BMessage* archive, bool deep = true) const;

	virtual void Quit();
	void Close() { Quit(); }

	void AddChild(BView* child, BView* before = NULL);
	bool RemoveChild(BView* child);
	int32 CountChildren() const;
	BView* ChildAt(int32 index) const;

	virtual void DispatchMessage(BMessage* message, BHandler* handler);
	virtual void MessageReceived(BMessage* message);
	virtual void FrameMoved(BPoint newPosition);
	virtual void FrameResized(float newWidth, float newHeight);
	virtual void WorkspacesChanged(uint32 oldWorkspaces, uint32 newWorkspaces);
	virtual void WorkspaceActivated(int32 workspace, bool state);
	virtual void Minimize(bool minimize);
	virtual void Zoom(BPoint leftTop, float width, float height);
	void Zoom();
	void SetZoomLimits(float maxWidth, float maxHeight);
	virtual void ScreenChanged(BRect screenSize, color_space format);

	void SetPulseRate(bigtime_t rate);
	bigtime_t PulseRate() const;

	// Command is implied. The window owns the message. Without a handler argument it goes to the
	// window; a NULL handler means the view that has the focus.
	void AddShortcut(uint32 key, uint32 modifiers, BMessage* message);
	void AddShortcut(uint32 key, uint32 modifiers, BMessage* message, BHandler* target);
	void RemoveShortcut(uint32 key, uint32 modifiers);

	void SetDefaultButton(BButton* button);
	BButton* DefaultButton() const;
	virtual void MenusBeginning();
	virtual void MenusEnded();
	bool NeedsUpdate() const;
	// Paints what is dirty now; only from the window's own thread.
	void UpdateIfNeeded();

	BView* FindView(const char* name) const;
	// Window coordinates.
	BView* FindView(BPoint point) const;
	BView* CurrentFocus() const;

	void Activate(bool active = true);
	virtual void WindowActivated(bool active);

	void ConvertToScreen(BPoint* point) const;
	BPoint ConvertToScreen(BPoint point) const;
	void ConvertFromScreen(BPoint* point) const;
	BPoint ConvertFromScreen(BPoint point) const;
	void ConvertToScreen(BRect* rect) const;
	BRect ConvertToScreen(BRect rect) const;
	void ConvertFromScreen(BRect* rect) const;
	BRect ConvertFromScreen(BRect rect) const;

	void MoveBy(float dx, float dy);
	void MoveTo(BPoint where);
	void MoveTo(float x, float y);
	void ResizeBy(float dx, float dy);
	void ResizeTo(float width, float height);
	void CenterIn(const BRect& rect);
	void CenterOnScreen();

	virtual void Show();
	virtual void Hide();
	bool IsHidden() const;
	bool IsMinimized() const;

	void Flush() const;
	void Sync() const;

	status_t SendBehind(const BWindow* window);
	void DisableUpdates();
	void EnableUpdates();
	// Nothing that is drawn in between is shown before the end.
	void BeginViewTransaction();
	void EndViewTransaction();
	bool InViewTransaction() const;
	void OpenViewTransaction() { BeginViewTransaction(); }
	void CommitViewTransaction() { EndViewTransaction(); }

	BRect Bounds() const;
	BRect Frame() const;
	const char* Title() const;
	void SetTitle(const char* title);
	bool IsFront() const;
	bool IsActive() const;

	void SetKeyMenuBar(BMenuBar* bar);
	BMenuBar* KeyMenuBar() const;

	// Limits bind the user, not the program. Widths are right - left.
	void SetSizeLimits(float minWidth, float maxWidth, float minHeight, float maxHeight);
	void GetSizeLimits(float* minWidth, float* maxWidth, float* minHeight, float* maxHeight);

	uint32 Workspaces() const;
	void SetWorkspaces(uint32 workspaces);

	BView* LastMouseMovedView() const;

	virtual BHandler* ResolveSpecifier(
		BMessage* message, int32 index, BMessage* specifier, int32 form, const char* property);
	virtual status_t GetSupportedSuites(BMessage* data);

	status_t AddToSubset(BWindow* window);
	status_t RemoveFromSubset(BWindow* window);

	virtual status_t Perform(perform_code code, void* argument);

	status_t SetType(window_type type);
	window_type Type() const;
	status_t SetLook(window_look look);
	window_look Look() const;
	status_t SetFeel(window_feel feel);
	window_feel Feel() const;
	status_t SetFlags(uint32 flags);
	uint32 Flags() const;
	bool IsModal() const;
	bool IsFloating() const;

	status_t SetWindowAlignment(window_alignment mode, int32 h, int32 hOffset = 0, int32 width = 0,
		int32 widthOffset = 0, int32 v = 0, int32 vOffset = 0, int32 height = 0,
		int32 heightOffset = 0);
	status_t GetWindowAlignment(window_alignment* mode = NULL, int32* h = NULL,
		int32* hOffset = NULL, int32* width = NULL, int32* widthOffset = NULL, int32* v = NULL,
		int32* vOffset = NULL, int32* height = NULL, int32* heightOffset = NULL) const;

	virtual bool QuitRequested();
	virtual thread_id Run();

private:
	friend class BPrivate::WindowInternals;

	// A window that draws into a bitmap.
	BWindow(BRect frame, BBitmap* bitmap, BPrivate::Surface* surface);

	virtual void _RouteMessage(BMessage* message, BHandler* target);
	void _Init(BRect frame, const char* title, window_look look, window_feel feel, uint32 flags,
		uint32 workspaces, window_type type);
	void _DispatchToView(BMessage* message, BView* view);
	void _DeleteViews();

	BPrivate::WindowInternals* fInternals; // owned
};
