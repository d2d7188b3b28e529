// BMenu: items to choose from, in a row, a column or freely placed.
#pragma once

#include <memory>
#include <vector>

#include <InterfaceDefs.h>
#include <List.h>
#include <View.h>

class BList;
class BMenu;
class BMenuBar;
class BMenuItem;
class BMessenger;
class _BMCMenuBar_;

namespace BPrivate {
class MenuAccess;
class MenuTracker;
} // namespace BPrivate

enum menu_layout : uint32 { B_ITEMS_IN_ROW = 0, B_ITEMS_IN_COLUMN, B_ITEMS_IN_MATRIX };

struct menu_info {
	float font_size;
	font_family f_family;
	font_style f_style;
	rgb_color background_color;
	int32 separator;
	bool click_to_open;
	bool triggers_always_shown;
};

status_t get_menu_info(menu_info* info);
status_t set_menu_info(menu_info* info);

// Asked from time to time while a menu is tracked; true ends the tracking.
typedef bool (*menu_tracking_hook)(BMenu* menu, void* state);


// The menu owns its items. A menu that is open lives in a window of its own; its items, marks and
// labels are still read and changed under the lock of the window that owns it: the one of its
// menu bar or field. A pop-up menu without such a window belongs to whoever runs it.
class BMenu : public BView {
public:
	BMenu(const char* name, menu_layout layout = B_ITEMS_IN_COLUMN);
	// A matrix of that size (right - left): each item comes with its own frame.
	BMenu(const char* name, float width, float height);
	BMenu(BMessage* archive);
	virtual ~BMenu();

	static BArchivable* Instantiate(BMessage* archive);
	virtual status_t Archive(BMessage* archive, bool deep = true) const;

	virtual void AttachedToWindow();
	virtual void DetachedFromWindow();

	// Takes the item, or makes one for the submenu. False, and the item stays the caller's, for
	// a bad index or an item that is in a menu already.
	bool AddItem(BMenuItem* item);
	bool AddItem(BMenuItem* item, int32 index);
	bool AddItem(BMenuItem* item, BRect frame);
	bool AddItem(BMenu* submenu);
	bool AddItem(BMenu* submenu, int32 index);
	bool AddItem(BMenu* submenu, BRect frame);
	bool AddList(BList* list, int32 index);
	bool AddSeparatorItem();

	// The item is the caller's again.
	bool RemoveItem(BMenuItem* item);
	BMenuItem* RemoveItem(int32 index);
	bool RemoveItems(int32 index, int32 count, bool deleteItems = false);
	bool RemoveItem(BMenu* submenu);

	BMenuItem* ItemAt(int32 index) const;
	BMenu* SubmenuAt(int32 index) const;
	int32 CountItems() const;
	int32 IndexOf(BMenuItem* item) const;
	int32 IndexOf(BMenu* submenu) const;
	// Both look into the submenus as well.
	BMenuItem* FindItem(uint32 command) const;
	BMenuItem* FindItem(const char* name) const;

	virtual status_t SetTargetForItems(BHandler* target);
	virtual status_t SetTargetForItems(BMessenger messenger);
	virtual void SetEnabled(bool enabled);
	virtual void SetRadioMode(bool on);
	virtual void SetTriggersEnabled(bool on);
	virtual void SetMaxContentWidth(float width);

	void SetLabelFromMarked(bool on);
	bool IsLabelFromMarked();
	bool IsEnabled() const;
	bool IsRadioMode() const;
	bool AreTriggersEnabled() const;
	bool IsRedrawAfterSticky() const;
	float MaxContentWidth() const;

	BMenuItem* FindMarked();
	int32 FindMarkedIndex();

	BMenu* Supermenu() const;
	BMenuItem* Superitem() const;

	virtual void MessageReceived(BMessage* message);
	virtual void KeyDown(const char* bytes, int32 numBytes);
	virtual void MouseDown(BPoint where);
	virtual void MouseUp(BPoint where);
	virtual void MouseMoved(BPoint where, uint32 code, const BMessage* message);
	virtual void Draw(BRect updateRect);
	virtual void GetPreferredSize(float* _width, float* _height);
	virtual void ResizeToPreferred();
	virtual void FrameMoved(BPoint newPosition);
	virtual void FrameResized(float width, float height);
	void InvalidateLayout();

	virtual BHandler* ResolveSpecifier(
		BMessage* message, int32 index, BMessage* specifier, int32 form, const char* property);
	virtual status_t GetSupportedSuites(BMessage* data);
	virtual status_t Perform(perform_code code, void* data);
	virtual void MakeFocus(bool focus = true);
	virtual void AllAttached();
	virtual void AllDetached();

protected:
	BMenu(BRect frame, const char* name, uint32 resizingMode, uint32 flags, menu_layout layout,
		bool resizeToFit);

	// Where the left top goes when the menu opens.
	virtual BPoint ScreenLocation();
	void SetItemMargins(float left, float top, float right, float bottom);
	void GetItemMargins(float* _left, float* _top, float* _right, float* _bottom) const;
	menu_layout Layout() const;

	virtual void Show();
	void Show(bool selectFirstItem);
	void Hide();
	// Opens the menu, follows the user, and returns the chosen item or NULL.
	BMenuItem* Track(bool startOpened = false, BRect* clickToOpenRect = NULL);

	enum add_state { B_INITIAL_ADD, B_PROCESSING, B_ABORT };
	// Called before the menu opens, again and again while it returns true; B_ABORT tells that the
	// menu closed before it was done.
	virtual bool AddDynamicItem(add_state state);
	virtual void DrawBackground(BRect updateRect);
	void SetTrackingHook(menu_tracking_hook hook, void* state);

private:
	friend class BMenuBar;
	friend class BMenuField;
	friend class BMenuItem;
	friend class BPopUpMenu;
	friend class BSeparatorItem;
	friend class _BMCMenuBar_;
	friend class BPrivate::MenuAccess;
	friend class BPrivate::MenuTracker;

	void _Init();
	void _ReadItems(BMessage* archive);
	bool _Insert(BMenuItem* item, int32 index);
	BMenuItem* _Take(int32 index);
	void _Install(BWindow* window);
	void _Uninstall();
	void _ItemMarked(BMenuItem* item);
	void _ItemChanged(BMenuItem* item, bool newSize);
	void _UpdateSuperitemLabel();
	void _Opened(BPrivate::MenuTracker* tracker, BPoint screenOrigin);
	void _Closed();
	void _EndTracking();

	void _ValidateLayout();
	BPoint _LayOut();
	BPoint _LayOutColumn();
	BPoint _LayOutRow();
	BPoint _LayOutMatrix();
	virtual void _LayoutChanged(); // of a menu that is attached and not open
	void _MeasureItem(BMenuItem* item, float* _width, float* _height);
	void _ChooseTriggers();
	bool _AddDynamicItems(bool first);
	void _DrawItems(BRect updateRect);

	BMenuItem* _ItemAtPoint(BPoint where) const;
	BMenuItem* _NextItem(BMenuItem* from, bool forward) const;
	BMenuItem* _ItemWithTrigger(uint32 character) const;
	void _SelectItem(BMenuItem* item);

	std::vector<BMenuItem*> fItems; // owned
	BMenuItem* fSuperitem; // borrowed
	BMenuItem* fSelected; // borrowed
	BPrivate::MenuTracker* fTracker; // while it is open; borrowed
	BWindow* fInstalledWindow; // whose shortcuts and targets its items take part in
	BPoint fScreenOrigin; // of its coordinates, while it is open
	BPoint fContentSize; // right - left and bottom - top of all items
	BPoint fMatrixSize; // as the constructor was told
	float fMarginLeft;
	float fMarginTop;
	float fMarginRight;
	float fMarginBottom;
	float fMaxContentWidth;
	menu_tracking_hook fTrackingHook;
	void* fTrackingState;
	menu_layout fLayout;
	bool fResizeToFit;
	bool fEnabled;
	bool fRadioMode;
	bool fLabelFromMarked;
	bool fTriggersEnabled;
	bool fShowTriggers;
	bool fLayoutValid;
};

#include <MenuItem.h>
