// BListView: the mouse and keys.
#include "ListView.h"

#include <algorithm>
#include <cmath>
#include <cstring>
#include <strings.h>

#include <AppDefs.h>
#include <Message.h>
#include <Messenger.h>
#include <Window.h>

#include "interface/private/EventModifiers.h"
#include "interface/private/ListViewPrivate.h"

using namespace BPrivate;

namespace {

constexpr float kDragDistance = 5; // pixels
constexpr bigtime_t kScrollInterval = 50000;
constexpr bigtime_t kTypeAheadTime = 1000000; // a longer pause begins a new word

} // namespace


bool
BListView::InitiateDrag(BPoint, int32, bool)
{
	return false;
}


void
BListView::MouseDown(BPoint where)
{
	if (!IsFocus())
		MakeFocus(true);
	const BMessage* message = Window() != NULL ? Window()->CurrentMessage() : NULL;
	int32 clicks;
	if (message == NULL || message->FindInt32("clicks", &clicks) != B_OK)
		clicks = 1;
	const uint32 held = event_modifiers(*this);
	const int32 index = IndexOf(where);

	if (index < 0) {
		fTracking.reset();
		if ((held & (B_SHIFT_KEY | B_COMMAND_KEY | B_CONTROL_KEY)) == 0)
			DeselectAll();
		return;
	}
	if (clicks % 2 == 0 && index == fFocusItem && fItems[index]->fSelected
		&& (held & (B_SHIFT_KEY | B_COMMAND_KEY | B_CONTROL_KEY)) == 0) {
		fTracking.reset();
		Invoke();
		return;
	}

	fTracking = std::make_unique<Tracking>();
	fTracking->press = where;
	fTracking->index = index;
	fTracking->wasSelected = fItems[index]->fSelected;
	fTracking->mayDrag = true;
	fTracking->reduces = false;
	SetMouseEventMask(B_POINTER_EVENTS, B_LOCK_WINDOW_FOCUS | B_NO_POINTER_HISTORY);
	_Press(index, held);
}


// A press on one of several selected items leaves them selected, for they may be dragged.
void
BListView::_Press(int32 index, uint32 held)
{
	fFocusItem = index;
	if (fType == B_MULTIPLE_SELECTION_LIST) {
		if ((held & B_SHIFT_KEY) != 0 && fAnchor >= 0) {
			_SelectionDone(_SelectRange(std::min(fAnchor, index), std::max(fAnchor, index), false));
			return;
		}
		fAnchor = index;
		if ((held & (B_COMMAND_KEY | B_CONTROL_KEY)) != 0) {
			const bool changed = _SetSelected(index, !fItems[index]->fSelected);
			_RescanSelection();
			_SelectionDone(changed);
			return;
		}
		if (fItems[index]->fSelected) {
			fTracking->reduces = true;
			return;
		}
	} else if ((held & (B_COMMAND_KEY | B_CONTROL_KEY)) != 0 && fItems[index]->fSelected) {
		Deselect(index);
		return;
	}
	fAnchor = index;
	if (fItems[index]->fEnabled)
		_SelectionDone(_SelectRange(index, index, false));
}


void
BListView::MouseMoved(BPoint where, uint32 code, const BMessage* message)
{
	if (fTracking == nullptr || message != NULL) {
		BView::MouseMoved(where, code, message);
		return;
	}
	if (fTracking->mayDrag) {
		const BPoint press = fTracking->press;
		if (std::max(std::fabs(where.x - press.x), std::fabs(where.y - press.y)) < kDragDistance)
			return;
		fTracking->mayDrag = false;
		const bool wasSelected = fTracking->wasSelected;
		if (InitiateDrag(press, fTracking->index, wasSelected)) {
			fTracking.reset();
			return;
		}
		if (fTracking == nullptr)
			return;
	}
	_TrackTo(where);
}


void
BListView::MouseUp(BPoint where)
{
	if (fTracking == nullptr) {
		BView::MouseUp(where);
		return;
	}
	const bool reduces = fTracking->reduces && fTracking->mayDrag;
	const int32 index = fTracking->index;
	fTracking.reset();
	if (reduces && index < CountItems())
		_SelectionDone(_SelectRange(index, index, false));
}


// A drag that nobody wants selects what it passes.
void
BListView::_TrackTo(BPoint where)
{
	const bool outside = where.y < Bounds().top || where.y > Bounds().bottom;
	if (!outside) {
		fTracking->scroller.reset();
	} else if (fTracking->scroller == nullptr) {
		const BMessage scroll(kListScroll);
		fTracking->scroller =
			std::make_unique<BMessageRunner>(BMessenger(this), &scroll, kScrollInterval);
	}
	const int32 index = std::clamp<int32>(_IndexAt(where.y), 0, CountItems() - 1);
	const int32 press = fTracking->index;
	if (index == fFocusItem || press >= CountItems())
		return;
	fFocusItem = index;
	if (fType == B_MULTIPLE_SELECTION_LIST)
		_SelectionDone(_SelectRange(std::min(press, index), std::max(press, index), false));
	else if (fItems[index]->fEnabled)
		_SelectionDone(_SelectRange(index, index, false));
}


void
BListView::_AutoScroll()
{
	if (fTracking == nullptr || CountItems() == 0)
		return;
	BPoint where;
	uint32 buttons;
	GetMouse(&where, &buttons, false);
	const BRect bounds = Bounds();
	float y = bounds.top;
	if (where.y < bounds.top)
		y = std::max(0.0f, where.y);
	else if (where.y > bounds.bottom)
		y = std::min(std::max(bounds.top, _Bottom() - bounds.Height()),
			bounds.top + where.y - bounds.bottom);
	y = std::floor(y);
	if (y == bounds.top)
		return;
	ScrollTo(BPoint(bounds.left, y));
	_TrackTo(where + BPoint(0, y - bounds.top));
}


// #pragma mark - keys


void
BListView::KeyDown(const char* bytes, int32 numBytes)
{
	const bool extend =
		(event_modifiers(*this) & B_SHIFT_KEY) != 0 && fType == B_MULTIPLE_SELECTION_LIST;
	// Where nothing is selected, the keys begin with the first item.
	const bool moved = fFirstSelected >= 0 && fFocusItem >= 0 && fFocusItem < CountItems();
	const int32 at = moved ? fFocusItem : fFirstSelected;
	const bool typing = fTypeAhead != nullptr && system_time() - fTypeAhead->when < kTypeAheadTime;
	switch (numBytes > 0 ? bytes[0] : '\0') {
		case B_UP_ARROW:
			_MoveByKey(at < 0 ? _NextEnabled(-1, 1) : _NextEnabled(at, -1), extend);
			break;

		case B_DOWN_ARROW:
			_MoveByKey(_NextEnabled(at, 1), extend);
			break;

		case B_HOME:
			_MoveByKey(_NextEnabled(-1, 1), extend);
			break;

		case B_END:
			_MoveByKey(_NextEnabled(CountItems(), -1), extend);
			break;

		case B_PAGE_UP:
			_MoveByKey(_PageStep(at, false), extend);
			break;

		case B_PAGE_DOWN:
			_MoveByKey(_PageStep(at, true), extend);
			break;

		case B_SPACE:
			if (typing && _HandleTypeAhead(bytes, numBytes))
				break;
			[[fallthrough]];

		case B_ENTER:
			if (fFirstSelected >= 0)
				Invoke();
			break;

		default:
			if (!_HandleTypeAhead(bytes, numBytes))
				BView::KeyDown(bytes, numBytes);
			break;
	}
}


void
BListView::_MoveByKey(int32 to, bool extend)
{
	if (to < 0)
		return;
	fFocusItem = to;
	if (extend && fAnchor >= 0) {
		_SelectionDone(_SelectRange(std::min(fAnchor, to), std::max(fAnchor, to), false));
	} else {
		fAnchor = to;
		_SelectionDone(_SelectRange(to, to, false));
	}
	_ScrollToItem(to);
}


// Beginning beside `from`; -1 when there is none that way.
int32
BListView::_NextEnabled(int32 from, int32 step) const
{
	for (int32 i = from + step; i >= 0 && i < CountItems(); i += step) {
		if (fItems[i]->fEnabled)
			return i;
	}
	return -1;
}


int32
BListView::_PageStep(int32 from, bool down) const
{
	if (CountItems() == 0)
		return -1;
	from = std::max<int32>(from, 0);
	_EnsurePlaces();
	const float height = Bounds().Height();
	const int32 target = std::clamp<int32>(
		_IndexAt(fItems[from]->fTop + (down ? height : -height)), 0, CountItems() - 1);
	if (fItems[target]->fEnabled)
		return target;
	const int32 next = _NextEnabled(target, down ? 1 : -1);
	return next >= 0 ? next : _NextEnabled(target, down ? -1 : 1);
}


// Selects the next string item that begins like what is being typed. The same letter again and
// again goes through all that begin with it.
bool
BListView::_HandleTypeAhead(const char* bytes, int32 numBytes)
{
	if (numBytes <= 0 || static_cast<uchar>(bytes[0]) < ' ' || bytes[0] == B_DELETE
		|| CountItems() == 0)
		return false;
	const bigtime_t now = system_time();
	if (fTypeAhead == nullptr)
		fTypeAhead = std::make_unique<TypeAhead>();
	if (now - fTypeAhead->when >= kTypeAheadTime)
		fTypeAhead->text.clear();
	fTypeAhead->when = now;
	const std::string typed(bytes, numBytes);
	const bool repeated = fTypeAhead->text == typed;
	if (!repeated)
		fTypeAhead->text += typed;

	const std::string& text = fTypeAhead->text;
	const int32 count = CountItems();
	const int32 at = std::max<int32>(fFirstSelected, 0);
	const int32 start = text.size() == typed.size() && fFirstSelected >= 0 ? at + 1 : at;
	for (int32 i = 0; i < count; i++) {
		const int32 index = (start + i) % count;
		const BStringItem* item = dynamic_cast<const BStringItem*>(fItems[index]);
		if (item != NULL && item->Text() != NULL && fItems[index]->fEnabled
			&& strncasecmp(item->Text(), text.c_str(), text.size()) == 0) {
			_MoveByKey(index, false);
			return true;
		}
	}
	return true;
}
