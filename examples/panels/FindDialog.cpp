// A dialog with a menu bar, nested groups and a list.

#include "Panels.h"

#include <Box.h>
#include <Button.h>
#include <CheckBox.h>
#include <ListView.h>
#include <Menu.h>
#include <MenuBar.h>
#include <MenuItem.h>
#include <Message.h>
#include <RadioButton.h>
#include <ScrollView.h>
#include <StringItem.h>
#include <TextControl.h>

namespace {


BView*
MakeMenuBar()
{
	BMenuBar* bar = new BMenuBar(BRect(0, 0, 359, 18), "menu bar");
	BMenu* menu = new BMenu("File");
	menu->AddItem(new BMenuItem("Save Search", new BMessage('save'), 'S'));
	menu->AddSeparatorItem();
	menu->AddItem(new BMenuItem("Close", new BMessage(B_QUIT_REQUESTED), 'W'));
	bar->AddItem(menu);
	menu = new BMenu("Edit");
	for (const char* label : { "Cut", "Copy", "Paste" })
		menu->AddItem(new BMenuItem(label, new BMessage('edit')));
	bar->AddItem(menu);
	return bar;
}


BView*
MakeOptions()
{
	BBox* options = new BBox(BRect(12, 60, 203, 154), "options");
	options->SetLabel("Options");
	const char* labels[][2] = { { "case", "Match upper case" }, { "word", "Whole words only" },
		{ "wrap", "Start again at the top" } };
	float top = 18;
	for (const auto& [name, label] : labels) {
		options->AddChild(
			new BCheckBox(BRect(12, top, 180, top + 17), name, label, new BMessage('optn')));
		top += 23;
	}
	return options;
}


BView*
MakeDirection()
{
	BBox* direction =
		new BBox(BRect(213, 60, 347, 154), "direction", B_FOLLOW_LEFT_RIGHT | B_FOLLOW_TOP);
	direction->SetLabel("Direction");
	BRadioButton* forward =
		new BRadioButton(BRect(12, 18, 120, 35), "forward", "Forward", new BMessage('dirn'));
	direction->AddChild(forward);
	forward->SetValue(B_CONTROL_ON);
	direction->AddChild(
		new BRadioButton(BRect(12, 41, 120, 58), "backward", "Backward", new BMessage('dirn')));
	return direction;
}


BView*
MakeHistory()
{
	BListView* list = new BListView(
		BRect(14, 166, 331, 236), "history", B_SINGLE_SELECTION_LIST, B_FOLLOW_ALL_SIDES);
	for (const char* text : { "view", "archive", "message", "button" })
		list->AddItem(new BStringItem(text));
	list->Select(1);
	return new BScrollView("history frame", list, B_FOLLOW_ALL_SIDES, 0, false, true);
}


} // namespace


BView*
MakeFindDialog()
{
	BView* panel = MakePanel(BRect(0, 0, 359, 285), "find dialog");
	panel->AddChild(MakeMenuBar());
	BTextControl* what = new BTextControl(BRect(12, 30, 347, 49), "what", "Find:", "archive",
		new BMessage('what'), B_FOLLOW_LEFT_RIGHT | B_FOLLOW_TOP);
	what->SetDivider(40);
	panel->AddChild(what);
	panel->AddChild(MakeOptions());
	panel->AddChild(MakeDirection());
	panel->AddChild(MakeHistory());
	constexpr uint32 kFollow = B_FOLLOW_RIGHT | B_FOLLOW_BOTTOM;
	panel->AddChild(new BButton(
		BRect(172, 250, 251, 273), "cancel", "Cancel", new BMessage(B_QUIT_REQUESTED), kFollow));
	BButton* find =
		new BButton(BRect(266, 250, 345, 273), "find", "Find", new BMessage('find'), kFollow);
	find->MakeDefault(true);
	panel->AddChild(find);
	return panel;
}
