// BTabView and BTab: pages, one of which is shown, with a row of tabs to choose it.
#pragma once

#include <View.h>

#include <memory>
#include <vector>

enum tab_position { B_TAB_FIRST = 999, B_TAB_FRONT, B_TAB_ANY };

class BTabView;

namespace BPrivate {
class ArchiveSource;
}


// The tab of one page. It owns its contents view, also while that is shown in a tab view.
class _EXPORT BTab : public BArchivable {
public:
	BTab(BView* contentsView = NULL);
	BTab(BMessage* archive);
	virtual ~BTab();

	static BArchivable* Instantiate(BMessage* archive);
	virtual status_t Archive(BMessage* archive, bool deep = true) const;
	virtual status_t Perform(perform_code code, void* data);

	// The label is the name of the contents view; without a view it is ignored.
	const char* Label() const;
	virtual void SetLabel(const char* label);

	bool IsSelected() const;
	virtual void Select(BView* owner);
	virtual void Deselect();

	virtual void SetEnabled(bool enabled);
	bool IsEnabled() const;

	void MakeFocus(bool focused = true);
	bool IsFocus() const;

	// Deletes the view that was there. Nothing happens for NULL or for the same view.
	virtual void SetView(BView* contents);
	BView* View() const;

	virtual void DrawFocusMark(BView* owner, BRect frame);
	virtual void DrawLabel(BView* owner, BRect frame);
	virtual void DrawTab(BView* owner, BRect frame, tab_position position, bool full = true);

private:
	friend class BTabView;

	BTab(const BTab&) = delete;
	BTab& operator=(const BTab&) = delete;

	BView* fView; // owned
	BTabView* fOwner; // borrowed: the tab view that holds this tab
	std::unique_ptr<BPrivate::ArchiveSource> fSource; // what it was made from; NULL if it was not
	bool fEnabled;
	bool fSelected;
	bool fFocus;
};


// Only the selected page is in the view tree, as the child of the container view; the others
// have neither parent nor window. The tab view owns its tabs.
class _EXPORT BTabView : public BView {
public:
	BTabView(BRect frame, const char* name, button_width width = B_WIDTH_AS_USUAL,
		uint32 resizingMode = B_FOLLOW_ALL,
		uint32 flags = B_FULL_UPDATE_ON_RESIZE | B_WILL_DRAW | B_NAVIGABLE_JUMP | B_FRAME_EVENTS
			| B_NAVIGABLE);
	BTabView(BMessage* archive);
	virtual ~BTabView();

	static BArchivable* Instantiate(BMessage* archive);
	virtual status_t Archive(BMessage* archive, bool deep = true) const;
	virtual status_t Perform(perform_code code, void* data);

	virtual void WindowActivated(bool active);
	virtual void AttachedToWindow();
	virtual void AllAttached();
	virtual void AllDetached();
	virtual void DetachedFromWindow();
	virtual void MessageReceived(BMessage* message);
	virtual void FrameMoved(BPoint newPosition);
	virtual void FrameResized(float width, float height);
	virtual void KeyDown(const char* bytes, int32 numBytes);
	virtual void MouseDown(BPoint where);
	virtual void MouseUp(BPoint where);
	virtual void MouseMoved(BPoint where, uint32 transit, const BMessage* dragMessage);
	virtual void Pulse();

	// An index out of range selects the present selection again.
	virtual void Select(int32 index);
	int32 Selection() const;

	virtual void MakeFocus(bool focused = true);
	virtual void SetFocusTab(int32 tab, bool focused);
	int32 FocusTab() const;

	virtual void Draw(BRect updateRect);
	// Draws all tabs and answers the frame of the selected one.
	virtual BRect DrawTabs();
	virtual void DrawBox(BRect selectedTabRect);
	virtual BRect TabFrame(int32 index) const;

	virtual void SetFlags(uint32 flags);
	virtual void SetResizingMode(uint32 mode);
	virtual void GetPreferredSize(float* _width, float* _height);
	virtual void ResizeToPreferred();

	virtual BHandler* ResolveSpecifier(
		BMessage* message, int32 index, BMessage* specifier, int32 what, const char* property);
	virtual status_t GetSupportedSuites(BMessage* message);

	// The view becomes the tab's; without a tab, a plain one is made.
	virtual void AddTab(BView* tabContents, BTab* tab = NULL);
	// The caller owns the tab, and with it its view, which is taken out of the container.
	virtual BTab* RemoveTab(int32 index);
	virtual BTab* TabAt(int32 index) const;
	BView* ViewForTab(int32 index) const;
	int32 CountTabs() const;

	virtual void SetTabWidth(button_width width);
	button_width TabWidth() const;
	virtual void SetTabHeight(float height);
	float TabHeight() const;
	BView* ContainerView() const;

private:
	BTabView(const BTabView&) = delete;
	BTabView& operator=(const BTabView&) = delete;

	// Where an archive has the pages.
	enum class PagePlace { kList, kBesideContainer, kInContainer };

	void _InitContainer();
	void _FindContainer(const BMessage& archive);
	void _ReadTabs(BMessage* archive);
	status_t _ArchiveTabs(BMessage* archive, const BMessage& source) const;
	bool _LeaveOutMadeContainer(BMessage* archive) const;
	status_t _ArchiveContainer(
		BMessage* archive, const BMessage& source, const std::vector<BMessage>& pages) const;
	status_t _LeaveOutShownPage(BMessage* container) const;
	void _Show(int32 index);
	int32 _TabAt(BPoint where) const;
	float _UsualTabHeight() const;
	float _LabelWidth(int32 index) const;
	void _InvalidateTabs();

	std::vector<BTab*> fTabs; // owned
	BView* fContainer; // child
	bool fMadeContainer = false; // since the archive had none
	button_width fWidthSetting;
	float fTabHeight;
	int32 fSelection; // -1: none
	int32 fFocus; // -1: no tab has the focus mark
	PagePlace fPagePlace = PagePlace::kList;
};
