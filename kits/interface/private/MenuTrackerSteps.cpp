// MenuTracker: what it does with the pointer, and how menus open and close.
#include "interface/private/MenuTracker.h"

#include <algorithm>
#include <cmath>

#include <MenuBar.h>
#include <MenuItem.h>
#include <Message.h>
#include <Screen.h>

#include "interface/private/MenuCodes.h"
#include "interface/private/MenuWindow.h"

namespace BPrivate {

namespace {

constexpr float kClickDistance = 4; // pixels
constexpr bigtime_t kClickTime = 500000; // a longer press chooses where it is released
constexpr bigtime_t kScrollInterval = 40000;

} // namespace


// #pragma mark - opening and closing


// As the next level. The new window is locked by us until it is shown.
void
MenuTracker::_Open(BMenu* menu, bool selectFirst)
{
	Level level {};
	level.menu = menu;
	level.window = fLevels.empty() ? fFirst : new MenuWindow(shared_from_this(), BRect(0, 0, 9, 9));
	level.savedFrame = menu->Frame();
	{
		Step step(*this);
		if (!step.IsLocked())
			return;
		level.adding = menu->_AddDynamicItems(true);
		menu->fShowTriggers = fRequest.byKey;
		menu->fLayoutValid = false;
		menu->_ValidateLayout();
		const BPoint where =
			fRequest.useWhere && fLevels.empty() ? fRequest.where : menu->ScreenLocation();
		_Place(level, where, menu->fContentSize);
		menu->_Opened(this, BPoint(level.area.left, level.area.top - level.scroll));
		menu->MoveTo(level.area.LeftTop() - level.frame.LeftTop());
		menu->ResizeTo(level.area.Width(), level.area.Height());
		if (selectFirst)
			menu->_SelectItem(menu->_NextItem(NULL, true));
		level.window->MoveTo(level.frame.LeftTop());
		level.window->ResizeTo(level.frame.Width(), level.frame.Height());
		level.window->Frame_()->AddChild(menu);
		menu->BView::ScrollTo(BPoint(0, level.scroll));
	}
	level.window->Frame_()->SetArrows(
		level.maxScroll > 0, level.scroll > 0, level.scroll < level.maxScroll);
	fLevels.push_back(level);
	if (level.window != fFirst)
		level.window->Show();
	if (level.adding)
		fFirstMessenger.SendMessage(kMenuAdd);
}


void
MenuTracker::_AddMoreItems()
{
	bool more = false;
	for (Level& level : fLevels) {
		if (!level.adding)
			continue;
		Step step(*this);
		if (!step.IsLocked())
			return;
		level.adding = level.menu->_AddDynamicItems(false);
		more = more || level.adding;
	}
	if (more)
		fFirstMessenger.SendMessage(kMenuAdd);
}


// On the screen, where it can all be seen if it is not too high; a submenu that has no room at the
// right opens at the left.
void
MenuTracker::_Place(Level& level, BPoint where, BPoint size)
{
	const BRect screen = BScreen().Frame();
	constexpr float border = MenuWindow::kBorder;
	BRect frame(where.x, where.y, where.x + size.x + 2 * border, where.y + size.y + 2 * border);
	const bool isSubmenu = !fLevels.empty();
	if (isSubmenu && frame.right > screen.right) {
		const BRect parent = fLevels.back().frame;
		frame.OffsetTo(std::max(screen.left, parent.left - frame.Width()), frame.top);
	}
	frame.OffsetBy(std::min(0.0f, screen.right - frame.right), 0);
	frame.OffsetBy(std::max(0.0f, screen.left - frame.left), 0);

	const float tooHigh = frame.Height() - screen.Height();
	level.area = frame;
	if (tooHigh <= 0) {
		frame.OffsetBy(0, std::min(0.0f, screen.bottom - frame.bottom));
		frame.OffsetBy(0, std::max(0.0f, screen.top - frame.top));
		level.scroll = level.maxScroll = 0;
		level.area = frame.InsetByCopy(border, border);
	} else {
		// Items keep their places on the screen as far as there are any.
		const float above = std::max(0.0f, screen.top - frame.top);
		frame.top = screen.top;
		frame.bottom = screen.bottom;
		level.area = frame.InsetByCopy(border, border + MenuWindow::kArrowHeight);
		level.maxScroll = std::max(0.0f, size.y - level.area.Height());
		level.scroll = std::min(above, level.maxScroll);
	}
	level.frame = frame;
}


void
MenuTracker::_CloseFrom(size_t first)
{
	_SetArrow(-1, 0);
	while (fLevels.size() > first) {
		Level level = fLevels.back();
		fLevels.pop_back();
		const bool own = level.window == fFirst;
		if (!own && !level.window->Lock())
			continue;
		_Close(level);
		if (own) {
			level.window->Park();
		} else {
			level.window->AllowQuit();
			level.window->Quit();
		}
	}
}


// The menu's window is locked. A closed menu has the frame that it had before.
void
MenuTracker::_Close(Level& level)
{
	Step step(*this);
	// When the owner waits for the end it is not locked, and nobody else uses the menu.
	BMenu* menu = level.menu;
	if (level.adding && step.IsLocked())
		menu->AddDynamicItem(BMenu::B_ABORT);
	menu->BView::ScrollTo(BPoint(0, 0));
	menu->RemoveSelf();
	menu->_Closed();
	menu->MoveTo(level.savedFrame.LeftTop());
	menu->ResizeTo(level.savedFrame.Width(), level.savedFrame.Height());
}


// Items were added, removed or changed while their menu is open.
void
MenuTracker::_Relayout()
{
	for (Level& level : fLevels) {
		const bool own = level.window == fFirst;
		if (!own && !level.window->Lock())
			continue;
		{
			Step step(*this);
			if (step.IsLocked()) {
				BMenu* menu = level.menu;
				menu->_ValidateLayout();
				const float scroll = level.scroll;
				_Place(level, level.frame.LeftTop(), menu->fContentSize);
				level.scroll = std::min(scroll, level.maxScroll);
				menu->fScreenOrigin = BPoint(level.area.left, level.area.top - level.scroll);
				level.window->MoveTo(level.frame.LeftTop());
				level.window->ResizeTo(level.frame.Width(), level.frame.Height());
				menu->MoveTo(level.area.LeftTop() - level.frame.LeftTop());
				menu->ResizeTo(level.area.Width(), level.area.Height());
				menu->BView::ScrollTo(BPoint(0, level.scroll));
				menu->Invalidate();
			}
		}
		level.window->Frame_()->SetArrows(
			level.maxScroll > 0, level.scroll > 0, level.scroll < level.maxScroll);
		if (!own)
			level.window->Unlock();
	}
}


// #pragma mark - pointer


void
MenuTracker::MouseMoved(BPoint screen)
{
	if (fFinished)
		return;
	if (_HookEnds()) {
		_Finish(NULL);
		return;
	}
	if (!fHasOrigin) {
		fHasOrigin = true;
		fOrigin = screen;
	}
	if (std::max(std::fabs(screen.x - fOrigin.x), std::fabs(screen.y - fOrigin.y))
		>= kClickDistance)
		fMoved = true;
	_Follow(_HitTest(screen), false);
}


void
MenuTracker::MouseDown(BPoint screen)
{
	if (fFinished)
		return;
	const Hit hit = _HitTest(screen);
	if (hit.level == -1) {
		_Finish(NULL);
		return;
	}
	if (hit.level == kBarLevel && hit.item != NULL && hit.item == _SelectedInBar()) {
		_Finish(NULL);
		return;
	}
	fPressedInside = true;
	fMoved = true;
	fReleased = false;
	_Follow(hit, false);
}


void
MenuTracker::MouseUp(BPoint screen, bigtime_t when)
{
	if (fFinished)
		return;
	const bool wasFirst = !fReleased && !fPressedInside;
	fReleased = true;
	const bool clicked = wasFirst && !fMoved && when - fStartTime < kClickTime;
	if (clicked) {
		if (fSticky || fRequest.staysOnClick
			|| (fRequest.hasClickToOpen && fRequest.clickToOpen.Contains(screen))) {
			fSticky = true;
			return;
		}
		_Finish(NULL);
		return;
	}
	_Release(screen);
}


void
MenuTracker::_Release(BPoint screen)
{
	const Hit hit = _HitTest(screen);
	_Follow(hit, false);
	fPressedInside = false;
	if (hit.level == -1) {
		if (!fSticky)
			_Finish(NULL);
		return;
	}
	BMenu* submenu;
	if (hit.item != NULL && _CanChoose(hit.item, &submenu) && submenu == NULL) {
		_Finish(hit.item);
		return;
	}
	fSticky = true;
}


BMenuItem*
MenuTracker::_SelectedInBar()
{
	Step step(*this);
	return step.IsLocked() ? fBar->fSelected : NULL;
}


bool
MenuTracker::_CanChoose(BMenuItem* item, BMenu** _submenu)
{
	Step step(*this);
	if (!step.IsLocked() || !_IsInOpenMenu(item))
		return false;
	*_submenu = item->fSubmenu;
	return item->IsEnabled() && dynamic_cast<BSeparatorItem*>(item) == NULL;
}


MenuTracker::Hit
MenuTracker::_HitTest(BPoint screen)
{
	Hit hit;
	for (int32 i = static_cast<int32>(fLevels.size()) - 1; i >= 0; i--) {
		const Level& level = fLevels[i];
		if (!level.frame.Contains(screen))
			continue;
		hit.level = i;
		if (level.area.Contains(screen)) {
			Step step(*this);
			if (step.IsLocked())
				hit.item = level.menu->_ItemAtPoint(screen - level.menu->fScreenOrigin);
		} else if (level.maxScroll > 0) {
			hit.arrow = screen.y < level.area.top ? -1 : screen.y > level.area.bottom ? 1 : 0;
		}
		return hit;
	}
	if (fBar == NULL)
		return hit;
	Step step(*this);
	if (!step.IsLocked())
		return hit;
	fBar->fScreenOrigin = fBar->ConvertToScreen(BPoint(0, 0));
	const BPoint inBar = screen - fBar->fScreenOrigin;
	if (fBar->Bounds().Contains(inBar)) {
		hit.level = kBarLevel;
		hit.item = fBar->_ItemAtPoint(inBar);
	}
	return hit;
}


// The selection goes where the pointer is; submenus open and close along with it.
void
MenuTracker::_Follow(const Hit& hit, bool byKey)
{
	_SetArrow(hit.arrow != 0 ? hit.level : -1, hit.arrow);
	if (hit.level == kBarLevel) {
		BMenu* submenu;
		if (hit.item != NULL && _SelectedInBar() != hit.item && _CanChoose(hit.item, &submenu))
			_OpenBarItem(hit.item, byKey);
		return;
	}
	if (hit.level < 0) {
		// Outside, the last menu loses its selection; the way to it stays open.
		if (!fLevels.empty() && !fSticky)
			_Select(fLevels.size() - 1, NULL);
		return;
	}

	const size_t level = hit.level;
	BMenu* submenu = NULL;
	BMenuItem* item = hit.item != NULL && _CanChoose(hit.item, &submenu) ? hit.item : NULL;
	const bool isOpen =
		submenu != NULL && level + 1 < fLevels.size() && fLevels[level + 1].menu == submenu;
	if (isOpen) {
		if (level + 2 < fLevels.size())
			_CloseFrom(level + 2);
		_Select(level + 1, NULL);
		return;
	}
	if (hit.arrow != 0)
		return;
	_CloseFrom(level + 1);
	_Select(level, item);
	if (submenu != NULL)
		_Open(submenu, byKey);
}


void
MenuTracker::_Select(size_t index, BMenuItem* item)
{
	const Level& level = fLevels[index];
	const bool own = level.window == fFirst;
	if (!own && !level.window->Lock())
		return;
	{
		Step step(*this);
		if (step.IsLocked() && (item == NULL || item->fSuper == level.menu))
			level.menu->_SelectItem(item);
	}
	if (!own)
		level.window->Unlock();
}


void
MenuTracker::_OpenBarItem(BMenuItem* item, bool selectFirst)
{
	_CloseFrom(0);
	BMenu* submenu = NULL;
	{
		Step step(*this);
		if (!step.IsLocked() || !_IsInOpenMenu(item))
			return;
		fBar->_SelectItem(item);
		submenu = item->IsEnabled() ? item->fSubmenu : NULL;
	}
	if (submenu != NULL)
		_Open(submenu, selectFirst);
}


// #pragma mark - scrolling


void
MenuTracker::_SetArrow(int32 level, int32 direction)
{
	if (fArrowLevel == level && fArrow == direction)
		return;
	fArrowLevel = level;
	fArrow = direction;
	fScroller.reset();
	if (level < 0)
		return;
	const BMessage scroll(kMenuScroll);
	fScroller = std::make_unique<BMessageRunner>(fFirstMessenger, &scroll, kScrollInterval);
}


void
MenuTracker::_ScrollLevel(size_t index, float by)
{
	if (index >= fLevels.size())
		return;
	Level& level = fLevels[index];
	const float scroll = std::clamp(std::floor(level.scroll + by), 0.0f, level.maxScroll);
	if (scroll == level.scroll)
		return;
	_CloseFrom(index + 1);
	const bool own = level.window == fFirst;
	if (!own && !level.window->Lock())
		return;
	{
		Step step(*this);
		if (step.IsLocked()) {
			level.scroll = scroll;
			level.menu->fScreenOrigin = BPoint(level.area.left, level.area.top - scroll);
			level.menu->BView::ScrollTo(BPoint(0, scroll));
		}
	}
	level.window->Frame_()->SetArrows(true, scroll > 0, scroll < level.maxScroll);
	if (!own)
		level.window->Unlock();
}


} // namespace BPrivate
