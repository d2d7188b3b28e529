// BMenuBar: a menu whose items are always visible.
#pragma once

#include <Menu.h>

namespace BPrivate {
class MenuKeys;
}

enum menu_bar_border : uint32 { B_BORDER_FRAME, B_BORDER_CONTENTS, B_BORDER_EACH_ITEM };


// The bar attached last becomes its window's key menu bar: its items' shortcuts work, and the
// keyboard opens it.
class BMenuBar : public BMenu {
public:
	BMenuBar(BRect frame, const char* name,
		uint32 resizingMode = B_FOLLOW_LEFT_RIGHT | B_FOLLOW_TOP,
		menu_layout layout = B_ITEMS_IN_ROW, bool resizeToFit = true);
	BMenuBar(BMessage* archive);
	virtual ~BMenuBar();

	static BArchivable* Instantiate(BMessage* archive);
	virtual status_t Archive(BMessage* archive, bool deep = true) const;

	// Shown at the next redraw.
	virtual void SetBorder(menu_bar_border border);
	menu_bar_border Border() const;

	virtual void Draw(BRect updateRect);
	virtual void AttachedToWindow();
	virtual void DetachedFromWindow();
	virtual void MessageReceived(BMessage* message);
	virtual void MouseDown(BPoint where);
	virtual void WindowActivated(bool active);
	virtual void MouseUp(BPoint where);
	virtual void FrameMoved(BPoint newPosition);
	virtual void FrameResized(float width, float height);

	virtual void Show();
	virtual void Hide();
	virtual BHandler* ResolveSpecifier(
		BMessage* message, int32 index, BMessage* specifier, int32 form, const char* property);
	virtual status_t GetSupportedSuites(BMessage* data);
	virtual void ResizeToPreferred();
	virtual void GetPreferredSize(float* _width, float* _height);
	virtual void MakeFocus(bool focus = true);
	virtual void AllAttached();
	virtual void AllDetached();
	virtual status_t Perform(perform_code code, void* data);

private:
	friend class BMenuField;
	friend class BPrivate::MenuTracker;

	virtual void _LayoutChanged();
	void _FitToItems();
	// Opens it for the keyboard, as the menu key does.
	void _OpenByKey();
	friend class BPrivate::MenuKeys;

	menu_bar_border fBorder;
};
