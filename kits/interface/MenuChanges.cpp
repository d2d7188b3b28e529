// BMenu: how it follows its items and its windows.
#include "Menu.h"

#include <algorithm>

#include <Message.h>
#include <Window.h>

#include "interface/private/Look.h"
#include "interface/private/MenuTracker.h"
#include "interface/private/UnknownItem.h"
#include "interface/private/ViewArchive.h"

using namespace BPrivate;

namespace {

constexpr bigtime_t kAddingTime = 20000; // microseconds of dynamic items at a time

} // namespace


void
BMenu::_Install(BWindow* window)
{
	fInstalledWindow = window;
	for (BMenuItem* item : fItems)
		item->_Install(window);
}


void
BMenu::_Uninstall()
{
	fInstalledWindow = NULL;
	for (BMenuItem* item : fItems)
		item->_Uninstall();
}


void
BMenu::_ItemMarked(BMenuItem* marked)
{
	if (fRadioMode) {
		for (BMenuItem* item : fItems) {
			if (item != marked && item->fMarked) {
				item->fMarked = false;
				_ItemChanged(item, false);
			}
		}
	}
	_UpdateSuperitemLabel();
}


void
BMenu::_UpdateSuperitemLabel()
{
	if (!fLabelFromMarked || fSuperitem == NULL)
		return;
	if (BMenuItem* marked = FindMarked())
		fSuperitem->SetLabel(marked->Label());
}


// An open menu is drawn by another thread, which is told; any other one is shown by this one.
void
BMenu::_ItemChanged(BMenuItem* item, bool newSize)
{
	if (newSize) {
		InvalidateLayout();
		return;
	}
	if (fTracker != NULL)
		fTracker->MenuChanged(this);
	if (fTracker != NULL && !fTracker->IsBar(this))
		return;
	if (Window() == NULL)
		return;
	if (item != NULL)
		Invalidate(item->fBounds);
	else
		Invalidate();
}


void
BMenu::_Opened(MenuTracker* tracker, BPoint screenOrigin)
{
	fTracker = tracker;
	fScreenOrigin = screenOrigin;
}


void
BMenu::_Closed()
{
	fTracker = NULL;
	fShowTriggers = false;
	_SelectItem(NULL);
}


// For a while only, so that the menu shows and follows the pointer meanwhile; true: there is more.
bool
BMenu::_AddDynamicItems(bool first)
{
	const bigtime_t start = system_time();
	bool more = AddDynamicItem(first ? B_INITIAL_ADD : B_PROCESSING);
	while (more && system_time() - start < kAddingTime)
		more = AddDynamicItem(B_PROCESSING);
	return more;
}


BHandler*
BMenu::ResolveSpecifier(
	BMessage* message, int32 index, BMessage* specifier, int32 form, const char* property)
{
	return BView::ResolveSpecifier(message, index, specifier, form, property);
}


status_t
BMenu::GetSupportedSuites(BMessage* data)
{
	if (data == NULL)
		return B_BAD_VALUE;
	data->AddString("suites", "suite/vnd.Be-menu");
	return BView::GetSupportedSuites(data);
}
