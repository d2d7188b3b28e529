// MenuTracker: what it does with keys.
#include "interface/private/MenuTracker.h"

#include <InterfaceDefs.h>
#include <MenuBar.h>
#include <MenuItem.h>
#include <Message.h>

#include "interface/private/MenuWindow.h"
#include "interface/private/TextModel.h"

namespace BPrivate {


// Keys keep the menus open without a button.
void
MenuTracker::KeyDown(const BMessage&, const char* bytes, int32 numBytes)
{
	if (fFinished || numBytes <= 0)
		return;
	fSticky = true;
	const bool inRow = !fLevels.empty() && fLevels.back().menu->fLayout == B_ITEMS_IN_ROW;
	switch (bytes[0]) {
		case B_DOWN_ARROW:
			inRow ? _StepIn() : _MoveSelection(true);
			break;

		case B_UP_ARROW:
			inRow ? _StepOut() : _MoveSelection(false);
			break;

		case B_RIGHT_ARROW:
			inRow ? _MoveSelection(true) : _StepIn();
			break;

		case B_LEFT_ARROW:
			inRow ? _MoveSelection(false) : _StepOut();
			break;

		case B_HOME:
		case B_PAGE_UP:
			_MoveToEnd(false);
			break;

		case B_END:
		case B_PAGE_DOWN:
			_MoveToEnd(true);
			break;

		case B_ENTER:
		case B_SPACE:
			_ChooseSelected();
			break;

		case B_ESCAPE:
			if (fLevels.size() > 1)
				_CloseFrom(fLevels.size() - 1);
			else
				_Finish(NULL);
			break;

		default:
			_ChooseByTrigger(decode_character(bytes, numBytes));
			break;
	}
}


// The selected item of the menu that was opened last.
BMenuItem*
MenuTracker::_Selected()
{
	Step step(*this);
	if (!step.IsLocked())
		return NULL;
	if (fLevels.empty())
		return fBar != NULL ? fBar->fSelected : NULL;
	return fLevels.back().menu->fSelected;
}


void
MenuTracker::_MoveSelection(bool forward)
{
	if (fLevels.empty()) {
		_StepIn();
		return;
	}
	BMenuItem* next;
	{
		Step step(*this);
		if (!step.IsLocked())
			return;
		BMenu* menu = fLevels.back().menu;
		next = menu->_NextItem(menu->fSelected, forward);
	}
	_Select(fLevels.size() - 1, next);
	_RevealSelected();
}


void
MenuTracker::_MoveToEnd(bool last)
{
	if (fLevels.empty())
		return;
	BMenuItem* item;
	{
		Step step(*this);
		if (!step.IsLocked())
			return;
		item = fLevels.back().menu->_NextItem(NULL, !last);
	}
	_Select(fLevels.size() - 1, item);
	_RevealSelected();
}


// Into the submenu of the selected item; without one, to the next menu of the bar.
void
MenuTracker::_StepIn()
{
	BMenuItem* item = _Selected();
	BMenu* submenu = NULL;
	if (item != NULL && _CanChoose(item, &submenu) && submenu != NULL) {
		if (fLevels.empty())
			_OpenBarItem(item, true);
		else
			_Open(submenu, true);
		return;
	}
	if (fBar != NULL)
		_NextInBar(true);
}


void
MenuTracker::_StepOut()
{
	if (fLevels.size() > 1)
		_CloseFrom(fLevels.size() - 1);
	else if (fBar != NULL)
		_NextInBar(false);
}


void
MenuTracker::_NextInBar(bool forward)
{
	BMenuItem* next;
	{
		Step step(*this);
		if (!step.IsLocked())
			return;
		next = fBar->_NextItem(fBar->fSelected, forward);
		if (next == NULL || next == fBar->fSelected)
			return;
	}
	_OpenBarItem(next, true);
}


void
MenuTracker::_ChooseSelected()
{
	BMenuItem* item = _Selected();
	BMenu* submenu;
	if (item == NULL || !_CanChoose(item, &submenu))
		return;
	if (submenu != NULL)
		_StepIn();
	else
		_Finish(item);
}


void
MenuTracker::_ChooseByTrigger(uint32 character)
{
	BMenuItem* item;
	{
		Step step(*this);
		if (!step.IsLocked())
			return;
		BMenu* menu = fLevels.empty() ? fBar : fLevels.back().menu;
		item = menu != NULL ? menu->_ItemWithTrigger(character) : NULL;
	}
	if (item == NULL)
		return;
	if (fLevels.empty()) {
		_OpenBarItem(item, true);
		return;
	}
	_Select(fLevels.size() - 1, item);
	_ChooseSelected();
}


void
MenuTracker::_RevealSelected()
{
	const size_t index = fLevels.size() - 1;
	const Level& level = fLevels[index];
	float by = 0;
	{
		Step step(*this);
		if (!step.IsLocked() || level.menu->fSelected == NULL || level.maxScroll <= 0)
			return;
		const BRect frame = level.menu->fSelected->fBounds;
		if (frame.top < level.scroll)
			by = frame.top - level.scroll;
		else if (frame.bottom > level.scroll + level.area.Height())
			by = frame.bottom - level.scroll - level.area.Height();
	}
	_ScrollLevel(index, by);
}


} // namespace BPrivate
