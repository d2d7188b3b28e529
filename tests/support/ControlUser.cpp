#include "support/ControlUser.h"

#include <cstdio>
#include <cstdlib>

#include <Clipboard.h>
#include <InterfaceDefs.h>
#include <MenuBar.h>
#include <MenuField.h>
#include <MenuItem.h>
#include <Message.h>
#include <OutlineListView.h>
#include <StringItem.h>
#include <TextControl.h>
#include <TextView.h>
#include <Window.h>

namespace {


BPoint
MiddleOf(BRect rect)
{
	return BPoint((int32)((rect.left + rect.right) / 2), (int32)((rect.top + rect.bottom) / 2));
}


[[noreturn]] void
Fail(const char* what, const char* name)
{
	std::fprintf(stderr, "ControlUser: %s \"%s\"\n", what, name);
	std::abort();
}


// The middle of an item of an open menu.
BPoint
PlaceOf(BMenu* menu, BMenuItem* item)
{
	if (!menu->LockLooper())
		Fail("not open: the menu with", item->Label());
	const BPoint point = menu->ConvertToScreen(MiddleOf(item->Frame()));
	menu->UnlockLooper();
	return point;
}


} // namespace


void
ControlUser::_EnterAndClear(BTextControl* field)
{
	fDriver.Click(field->TextView());
	fDriver.Key("Home");
	fDriver.Key("End", B_SHIFT_KEY);
	fDriver.Key("Delete");
}


void
ControlUser::Replace(BTextControl* field, std::string_view text)
{
	_EnterAndClear(field);
	fDriver.Type(text);
}


void
ControlUser::Paste(BTextControl* field, const std::string& text)
{
	if (!be_clipboard->Lock())
		Fail("no clipboard for", field->Label());
	be_clipboard->Clear();
	be_clipboard->Data()->AddData(
		"text/plain", B_MIME_TYPE, text.data(), static_cast<ssize_t>(text.size()));
	be_clipboard->Commit();
	be_clipboard->Unlock();

	_EnterAndClear(field);
	fDriver.Key("v", B_COMMAND_KEY);
}


void
ControlUser::TypeOver(BTextControl* field, std::string_view text)
{
	Replace(field, text);
	fDriver.Key("Return");
}


void
ControlUser::Choose(BMenuField* field, const char* label)
{
	BMenuItem* item = field->Menu()->FindItem(label);
	if (item == nullptr)
		Fail("no item", label);

	fDriver.MoveTo(field->MenuBar());
	fDriver.Press();
	fDriver.MoveTo(PlaceOf(field->Menu(), item));
	fDriver.Release();
	// Where the item opened below the pointer, that was a click, after which menus stay open.
	if (field->Menu()->Window() != nullptr)
		fDriver.Click(PlaceOf(field->Menu(), item));
}


void
ControlUser::ClickEntry(BOutlineListView* list, const char* text)
{
	fDriver.Click(PlaceOfEntry(list, text));
}


BPoint
ControlUser::PlaceOfEntry(BOutlineListView* list, const char* text)
{
	constexpr float kBesideTheLatch = 100;
	while (_Expand(list))
		;
	for (int32 i = 0; i < list->CountItems(); i++) {
		if (std::string_view(static_cast<BStringItem*>(list->ItemAt(i))->Text()) != text)
			continue;
		_ScrollTo(list, i);
		return Driver::PointIn(list, BPoint(kBesideTheLatch, MiddleOf(list->ItemFrame(i)).y));
	}
	Fail("no entry", text);
}


// Clicks on the latch of the first closed entry.
bool
ControlUser::_Expand(BOutlineListView* list)
{
	constexpr float kLatchMiddle = 7;
	constexpr float kIndent = 10;
	for (int32 i = 0; i < list->CountItems(); i++) {
		BListItem* item = list->ItemAt(i);
		if (item->IsExpanded() || list->CountItemsUnder(item, true) == 0)
			continue;
		_ScrollTo(list, i);
		const float x = kLatchMiddle + kIndent * static_cast<float>(item->OutlineLevel());
		fDriver.Click(list, BPoint(x, MiddleOf(list->ItemFrame(i)).y));
		if (!item->IsExpanded())
			Fail("no latch at", static_cast<BStringItem*>(item)->Text());
		return true;
	}
	return false;
}


void
ControlUser::_ScrollTo(BOutlineListView* list, int32 index)
{
	const BRect frame = list->ItemFrame(index);
	while (frame.top < list->Bounds().top)
		fDriver.Wheel(list, 0, -1);
	while (frame.bottom > list->Bounds().bottom)
		fDriver.Wheel(list, 0, 1);
}
