// BMenu: where its items lie, and how it is drawn.
#include "Menu.h"

#include <algorithm>
#include <cctype>
#include <cmath>
#include <string>

#include <Window.h>

#include "interface/private/Look.h"
#include "interface/private/MenuTracker.h"
#include "interface/private/ViewArchive.h"

using namespace BPrivate;


void
BMenu::GetPreferredSize(float* _width, float* _height)
{
	_ValidateLayout();
	if (_width != NULL)
		*_width = fContentSize.x;
	if (_height != NULL)
		*_height = fContentSize.y;
}


void
BMenu::ResizeToPreferred()
{
	BView::ResizeToPreferred();
}


// Open menus are laid out by the thread that shows them, all others when they are next needed.
void
BMenu::InvalidateLayout()
{
	fLayoutValid = false;
	for (BMenuItem* item : fItems)
		item->fLabelWidth = -1;
	if (fTracker != NULL)
		fTracker->MenuChanged(this);
	if (fTracker != NULL && !fTracker->IsBar(this))
		return;
	if (Window() != NULL) {
		_ValidateLayout();
		_LayoutChanged();
		Invalidate();
	}
}


void
BMenu::_LayoutChanged()
{
}


void
BMenu::_ValidateLayout()
{
	if (fLayoutValid)
		return;
	fContentSize = _LayOut();
	fLayoutValid = true;
	_ChooseTriggers();
}


// The size of the whole as right - left and bottom - top.
BPoint
BMenu::_LayOut()
{
	switch (fLayout) {
		case B_ITEMS_IN_COLUMN:
			return _LayOutColumn();
		case B_ITEMS_IN_ROW:
			return _LayOutRow();
		default:
			return _LayOutMatrix();
	}
}


void
BMenu::_MeasureItem(BMenuItem* item, float* _width, float* _height)
{
	float width = 0;
	float height = 0;
	item->GetContentSize(&width, &height);
	if (fMaxContentWidth > 0)
		width = std::min(width, fMaxContentWidth);
	item->fContentWidth = std::ceil(width);
	item->fContentHeight = std::ceil(height);
	*_width = item->fContentWidth + fMarginLeft + fMarginRight;
	if (fLayout == B_ITEMS_IN_COLUMN)
		*_width += item->_ShortcutWidth();
	*_height = item->fContentHeight + fMarginTop + fMarginBottom;
}


BPoint
BMenu::_LayOutColumn()
{
	float widest = 0;
	float top = 0;
	for (BMenuItem* item : fItems) {
		float width, height;
		_MeasureItem(item, &width, &height);
		item->fBounds.Set(0, top, 0, top + height - 1);
		widest = std::max(widest, width);
		top += height;
	}
	for (BMenuItem* item : fItems)
		item->fBounds.right = std::max(0.0f, widest - 1);
	return BPoint(std::max(0.0f, widest - 1), std::max(0.0f, top - 1));
}


BPoint
BMenu::_LayOutRow()
{
	float highest = 0;
	float left = 0;
	for (BMenuItem* item : fItems) {
		float width, height;
		_MeasureItem(item, &width, &height);
		item->fBounds.Set(left, 0, left + width - 1, 0);
		highest = std::max(highest, height);
		left += width;
	}
	if (fItems.empty()) {
		font_height height;
		GetFontHeight(&height);
		highest =
			std::ceil(height.ascent + height.descent + height.leading) + fMarginTop + fMarginBottom;
	}
	for (BMenuItem* item : fItems)
		item->fBounds.bottom = highest - 1;
	return BPoint(std::max(0.0f, left - 1), highest - 1);
}


// The items lie where the program put them.
BPoint
BMenu::_LayOutMatrix()
{
	BPoint size = fMatrixSize;
	for (BMenuItem* item : fItems) {
		float width, height;
		_MeasureItem(item, &width, &height);
		size.x = std::max(size.x, item->fBounds.right);
		size.y = std::max(size.y, item->fBounds.bottom);
	}
	return size;
}


// Every item gets the first character of its label that no other one has.
void
BMenu::_ChooseTriggers()
{
	std::string taken;
	for (BMenuItem* item : fItems) {
		item->fTrigger = item->fUserTrigger;
		if (item->fUserTrigger != 0)
			taken += static_cast<char>(tolower(static_cast<uchar>(item->fUserTrigger)));
	}
	if (!fTriggersEnabled)
		return;
	for (BMenuItem* item : fItems) {
		if (item->fTrigger != 0 || item->fLabel == NULL)
			continue;
		for (const char* at = item->fLabel; *at != '\0'; at++) {
			if (!isalnum(static_cast<uchar>(*at)))
				continue;
			const char lower = static_cast<char>(tolower(static_cast<uchar>(*at)));
			if (taken.find(lower) != std::string::npos)
				continue;
			item->fTrigger = *at;
			taken += lower;
			break;
		}
	}
}


// #pragma mark - drawing


void
BMenu::Draw(BRect updateRect)
{
	// An open menu is shown by a thread that does not own the items.
	if (fTracker != NULL && !fTracker->IsBar(this)) {
		MenuTracker::Step step(*fTracker);
		if (step.IsLocked())
			_DrawItems(updateRect);
		return;
	}
	_ValidateLayout();
	_DrawItems(updateRect);
}


void
BMenu::_DrawItems(BRect updateRect)
{
	DrawBackground(updateRect);
	for (BMenuItem* item : fItems) {
		if (item->fBounds.Intersects(updateRect))
			item->Draw();
	}
}


void
BMenu::DrawBackground(BRect updateRect)
{
	PushState();
	SetDrawingMode(B_OP_COPY);
	FillRect(updateRect & Bounds(), B_SOLID_LOW);
	PopState();
}


// #pragma mark - choosing


BMenuItem*
BMenu::_ItemAtPoint(BPoint where) const
{
	for (BMenuItem* item : fItems) {
		if (item->fBounds.Contains(where))
			return item;
	}
	return NULL;
}


// The next item that can be chosen, round the ends; NULL when there is none.
BMenuItem*
BMenu::_NextItem(BMenuItem* from, bool forward) const
{
	const int32 count = CountItems();
	int32 index = IndexOf(from);
	if (index < 0 && !forward)
		index = 0;
	for (int32 i = 0; i < count; i++) {
		index = (index + (forward ? 1 : count - 1)) % count;
		BMenuItem* item = fItems[index];
		if (item->IsEnabled() && dynamic_cast<BSeparatorItem*>(item) == NULL)
			return item;
	}
	return NULL;
}


BMenuItem*
BMenu::_ItemWithTrigger(uint32 character) const
{
	if (!fTriggersEnabled || character >= 0x80)
		return NULL;
	const int wanted = tolower(static_cast<int>(character));
	for (BMenuItem* item : fItems) {
		if (item->fTrigger != 0 && item->IsEnabled()
			&& tolower(static_cast<uchar>(item->fTrigger)) == wanted)
			return item;
	}
	return NULL;
}


// The caller holds the locks of the window that shows the menu and of its owner.
void
BMenu::_SelectItem(BMenuItem* item)
{
	if (fSelected == item)
		return;
	BMenuItem* old = fSelected;
	fSelected = item;
	if (old != NULL)
		old->_Select(false);
	if (item != NULL)
		item->_Select(true);
}
