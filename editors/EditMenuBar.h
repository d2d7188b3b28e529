// EditMenuBar: the panel for a menu bar's border and its whole tree of items.
#pragma once

#include <memory>
#include <vector>

#include <StringItem.h>

#include "editors/EditorInterface.h"

class BButton;
class BCheckBox;
class BMenu;
class BMenuBar;
class BMenuItem;
class BOutlineListView;
class BTextControl;


// An entry of the outline that mirrors a menu bar.
class ZetkaStringItem : public BStringItem {
public:
	ZetkaStringItem(const char* text, uint32 level, bool expanded, BMenuItem* item);
	~ZetkaStringItem() override;

	BMenuItem* item; // borrowed: the menu's, or the panel's once it has been taken out
};


// The outline has one entry for each item, in pre-order. Items and entries that are taken out stay
// valid, for an entry may still stand for a removed item, until another view becomes the target.
class EditMenuBar : public PanelOf<BMenuBar> {
public:
	EditMenuBar();
	~EditMenuBar() override;

	bool UseView(BView* view) override;

protected:
	bool ApplyEdit(BMessage* message) override;

private:
	void _AddItemList(BRect area);
	void _AddItemRows(BRect area);
	BMenu* _SelectedMenu() const;
	ZetkaStringItem* _NewEntry(const char* text, uint32 level, bool expanded, BMenuItem* item);

	void SynchToTarget();
	void RecursiveAddItem(const BMenu* menu, int level);
	void SetSelectKind(BMenu* submenu);
	void _EnableButtons(bool enabled);
	void _EntrySelected(const BMessage* message);
	void _ForgetRemoved();

	bool _ApplyItemEdit(uint32 code);
	bool _ApplyTreeEdit(uint32 code);
	void _ApplySelectKind();
	void _AddSibling(bool after);
	void _AddSubmenu();
	void _DeleteItem();

	ZetkaStringItem* selectedEntry; // one of fEntries, or NULL
	BMenu* borderMenu;
	BOutlineListView* itemList;
	BTextControl* labelControl;
	BCheckBox* enabledCheckBox;
	BTextControl* messageControl;
	BMenu* selectKindMenu;
	BButton* addBeforeButton;
	BButton* addAfterButton;
	BButton* deleteButton;
	BButton* addSubmenuButton;
	std::vector<std::unique_ptr<ZetkaStringItem>> fEntries; // a list does not own its items
	std::vector<std::unique_ptr<BMenuItem>> fRemovedItems;
};
