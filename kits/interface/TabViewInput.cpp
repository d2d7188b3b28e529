// How tab views are used by mouse and keys.
#include <TabView.h>

#include <algorithm>

#include <Message.h>
#include <Window.h>


int32
BTabView::_TabAt(BPoint where) const
{
	for (int32 i = 0; i < CountTabs(); i++) {
		if (TabFrame(i).Contains(where))
			return i;
	}
	return -1;
}


void
BTabView::MouseDown(BPoint where)
{
	const int32 index = where.y <= fTabHeight ? _TabAt(where) : -1;
	if (index < 0) {
		BView::MouseDown(where);
		return;
	}
	if (fTabs[index]->IsEnabled())
		Select(index);
}


void
BTabView::MouseUp(BPoint where)
{
	BView::MouseUp(where);
}


void
BTabView::MouseMoved(BPoint where, uint32 transit, const BMessage* dragMessage)
{
	BView::MouseMoved(where, transit, dragMessage);
}


void
BTabView::KeyDown(const char* bytes, int32 numBytes)
{
	if (numBytes != 1 || IsHidden() || CountTabs() == 0) {
		BView::KeyDown(bytes, numBytes);
		return;
	}

	switch (bytes[0]) {
		case B_LEFT_ARROW:
		case B_DOWN_ARROW:
			SetFocusTab(fFocus <= 0 ? CountTabs() - 1 : fFocus - 1, true);
			break;
		case B_RIGHT_ARROW:
		case B_UP_ARROW:
			SetFocusTab(fFocus >= CountTabs() - 1 ? 0 : fFocus + 1, true);
			break;
		case B_SPACE:
		case B_ENTER:
			if (fFocus >= 0 && fTabs[fFocus]->IsEnabled())
				Select(fFocus);
			break;
		default:
			BView::KeyDown(bytes, numBytes);
			break;
	}
}


void
BTabView::MakeFocus(bool focused)
{
	BView::MakeFocus(focused);
	SetFocusTab(std::max<int32>(fSelection, 0), focused);
}


void
BTabView::SetFocusTab(int32 tab, bool focused)
{
	const int32 before = fFocus;
	if (before >= 0 && before < CountTabs())
		fTabs[before]->MakeFocus(false);
	fFocus = focused && tab >= 0 && tab < CountTabs() ? tab : -1;
	if (fFocus >= 0)
		fTabs[fFocus]->MakeFocus(true);
	if (fFocus != before)
		_InvalidateTabs();
}


int32
BTabView::FocusTab() const
{
	return fFocus;
}
