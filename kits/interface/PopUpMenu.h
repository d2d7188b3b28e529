// BPopUpMenu: a menu that opens where the program wants it, by default with one marked item.
#pragma once

#include <Menu.h>


class BPopUpMenu : public BMenu {
public:
	BPopUpMenu(const char* name, bool radioMode = true, bool labelFromMarked = true,
		menu_layout layout = B_ITEMS_IN_COLUMN);
	BPopUpMenu(BMessage* archive);
	virtual ~BPopUpMenu();

	static BArchivable* Instantiate(BMessage* archive);
	virtual status_t Archive(BMessage* archive, bool deep = true) const;

	// Opens at a point of the screen and follows the user. Returns the chosen item, not yet
	// invoked, or NULL. With `deliversMessage` the item has been invoked. With `openAnyway` the
	// menu stays open when the button is released over no item. An asynchronous call returns NULL
	// at once; the item is then invoked if `deliversMessage` says so.
	BMenuItem* Go(
		BPoint where, bool deliversMessage = false, bool openAnyway = false, bool async = false);
	// A click inside the rectangle (screen) leaves the menu open as well.
	BMenuItem* Go(BPoint where, bool deliversMessage, bool openAnyway, BRect clickToOpenRect,
		bool async = false);

	// Whether the menu deletes itself at the end of an asynchronous Go().
	void SetAsyncAutoDestruct(bool on);
	bool AsyncAutoDestruct() const;

	virtual void MessageReceived(BMessage* message);
	virtual void MouseDown(BPoint where);
	virtual void MouseUp(BPoint where);
	virtual void MouseMoved(BPoint where, uint32 code, const BMessage* message);
	virtual void AttachedToWindow();
	virtual void DetachedFromWindow();
	virtual void FrameMoved(BPoint newPosition);
	virtual void FrameResized(float width, float height);
	virtual BHandler* ResolveSpecifier(
		BMessage* message, int32 index, BMessage* specifier, int32 form, const char* property);
	virtual status_t GetSupportedSuites(BMessage* data);
	virtual status_t Perform(perform_code code, void* data);
	virtual void ResizeToPreferred();
	virtual void GetPreferredSize(float* _width, float* _height);
	virtual void MakeFocus(bool focus = true);
	virtual void AllAttached();
	virtual void AllDetached();

protected:
	// Puts the marked item over the label of the field that opens the menu.
	virtual BPoint ScreenLocation();

private:
	friend class BPrivate::MenuTracker;

	BMenuItem* _Go(
		BPoint where, bool deliversMessage, bool openAnyway, BRect* clickToOpenRect, bool async);

	BPoint fWhere;
	bool fUseWhere;
	bool fAutoDestruct;
};
