// BTextView: presses, drags and drops.
#include "TextView.h"

#include <algorithm>
#include <cmath>

#include <AppDefs.h>
#include <Bitmap.h>
#include <Cursor.h>
#include <Message.h>
#include <Region.h>
#include <Window.h>

#include "interface/private/EventModifiers.h"
#include "interface/private/TextHistory.h"
#include "interface/private/TextLayout.h"
#include "interface/private/TextViewPrivate.h"

using namespace BPrivate;

namespace {

constexpr float kDragDistance = 4; // pixels
constexpr bigtime_t kScrollInterval = 50000; // microseconds
constexpr const char* kDragSource = "be:originator";
constexpr const char* kDragStart = "be:originator_start";
constexpr const char* kDragEnd = "be:originator_end";

} // namespace


void
BTextView::MouseDown(BPoint where)
{
	if (!IsFocus())
		MakeFocus(true);
	if (!fEditable && !fSelectable)
		return;
	_EndComposition(true);
	if (fHistory != nullptr)
		fHistory->BreakTyping();
	fCaretX = -1;

	const BMessage* message = Window() != NULL ? Window()->CurrentMessage() : NULL;
	int32 clicks;
	if (message == NULL || message->FindInt32("clicks", &clicks) != B_OK)
		clicks = 1;
	const TextPlace place = _PlaceAt(where);
	const int32 offset = place.offset;
	const bool extend = (event_modifiers(*this) & B_SHIFT_KEY) != 0;

	fTracking = std::make_unique<Tracking>();
	fTracking->press = where;
	fTracking->clicks = (clicks - 1) % 3 + 1;
	fTracking->from = fTracking->to = offset;
	fTracking->mayDrag = false;
	SetMouseEventMask(B_POINTER_EVENTS, B_LOCK_WINDOW_FOCUS | B_NO_POINTER_HISTORY);

	if (extend) {
		fTracking->from = fTracking->to = fAnchor;
		_SetSelection(fAnchor, offset);
		return;
	}
	BRegion selected;
	GetTextRegion(_Start(), _End(), &selected);
	if (clicks == 1 && !fHidesTyping && selected.Contains(where)) {
		fTracking->mayDrag = true;
		return;
	}
	_SelectAround(offset, fTracking->clicks, &fTracking->from, &fTracking->to);
	_SetSelection(fTracking->from, fTracking->to, place.behind);
	_RestartBlinking();
}


void
BTextView::MouseMoved(BPoint where, uint32 code, const BMessage* message)
{
	if (fTracking != nullptr) {
		_TrackTo(where);
		return;
	}
	if (message != NULL && AcceptsDrop(message)) {
		const bool inside = code == B_ENTERED_VIEW || code == B_INSIDE_VIEW;
		_ShowDropPlace(inside ? OffsetAt(where) : -1);
		return;
	}
	_ShowDropPlace(-1);
	_UpdateCursor(where);
	BView::MouseMoved(where, code, message);
}


void
BTextView::MouseUp(BPoint where)
{
	if (fTracking == nullptr) {
		BView::MouseUp(where);
		return;
	}
	const bool clicked = fTracking->mayDrag;
	if (!clicked)
		_TrackTo(where);
	_StopTracking();
	if (clicked) {
		const TextPlace place = _PlaceAt(where);
		_SetSelection(place.offset, place.offset, place.behind);
	}
}


// A click stands for a place, two for a word, three for a line.
void
BTextView::_SelectAround(int32 offset, int32 clicks, int32* _from, int32* _to)
{
	*_from = *_to = offset;
	if (clicks == 2) {
		// Behind the last character of a line its last word is meant.
		int32 at = offset;
		if (at > 0 && (at == TextLength() || ByteAt(at) == '\n') && ByteAt(at - 1) != '\n')
			at = fModel->PreviousCharacter(at);
		if (at < TextLength() && ByteAt(at) != '\n')
			FindWord(at, _from, _to);
	} else if (clicks == 3) {
		while (*_from > 0 && ByteAt(*_from - 1) != '\n')
			(*_from)--;
		const int32 found = fModel->Buffer().Find('\n', offset);
		*_to = found < 0 ? TextLength() : found + 1;
	}
}


void
BTextView::_TrackTo(BPoint where)
{
	Tracking& tracking = *fTracking;
	if (tracking.mayDrag) {
		if (std::max(std::fabs(where.x - tracking.press.x), std::fabs(where.y - tracking.press.y))
			>= kDragDistance)
			_BeginDrag();
		return;
	}

	int32 from, to;
	const TextPlace place = _PlaceAt(where);
	_SelectAround(place.offset, tracking.clicks, &from, &to);
	const int32 limitFrom = std::min(tracking.from, TextLength());
	const int32 limitTo = std::min(tracking.to, TextLength());
	if (from < limitFrom)
		_SetSelection(limitTo, from, place.behind);
	else
		_SetSelection(limitFrom, std::max(limitTo, to), place.behind);

	const bool outside = !Bounds().Contains(where);
	if (!outside) {
		tracking.scroller.reset();
	} else if (tracking.scroller == nullptr) {
		const BMessage scroll(kAutoScroll);
		tracking.scroller =
			std::make_unique<BMessageRunner>(BMessenger(this), &scroll, kScrollInterval);
	}
}


// The pointer rests outside: the text moves below it, the faster the farther it is.
void
BTextView::_AutoScroll()
{
	if (fTracking == nullptr || fTracking->mayDrag)
		return;
	BPoint where;
	uint32 buttons;
	GetMouse(&where, &buttons, false);
	const BRect bounds = Bounds();
	BPoint to = bounds.LeftTop();
	if (where.y < bounds.top)
		to.y = std::max(0.0f, bounds.top - (bounds.top - where.y));
	else if (where.y > bounds.bottom)
		to.y = std::min(std::max(bounds.top, _ContentHeight() - bounds.Height()),
			bounds.top + (where.y - bounds.bottom));
	if (where.x < bounds.left)
		to.x = std::max(0.0f, bounds.left - (bounds.left - where.x));
	else if (where.x > bounds.right && !fWrap)
		to.x = std::min(std::max(bounds.left, _ContentWidth() - bounds.Width()),
			bounds.left + (where.x - bounds.right));
	to = BPoint(std::floor(to.x), std::floor(to.y));
	if (to == bounds.LeftTop())
		return;
	ScrollTo(to);
	_TrackTo(where + (to - bounds.LeftTop()));
}


void
BTextView::_StopTracking()
{
	fTracking.reset();
}


// #pragma mark - drags


void
BTextView::GetDragParameters(BMessage* drag, BBitmap** _bitmap, BPoint* _point, BHandler** _handler)
{
	drag->what = B_MIME_DATA;
	_AddToMessage(drag, _Start(), _End());
	drag->AddPointer(kDragSource, this);
	drag->AddInt32(kDragStart, _Start());
	drag->AddInt32(kDragEnd, _End());
	*_bitmap = NULL;
	*_point = BPoint(0, 0);
	*_handler = NULL;
}


void
BTextView::_BeginDrag()
{
	BMessage drag;
	BBitmap* bitmap = NULL;
	BPoint point;
	BHandler* handler = NULL;
	GetDragParameters(&drag, &bitmap, &point, &handler);
	const BPoint press = fTracking->press;
	_StopTracking();
	if (bitmap != NULL) {
		DragMessage(&drag, bitmap, B_OP_ALPHA, point, handler);
		return;
	}
	BRegion region;
	GetTextRegion(_Start(), _End(), &region);
	BRect rect = region.Frame() & Bounds();
	if (!rect.IsValid())
		rect.Set(press.x - 10, press.y - 10, press.x + 10, press.y + 10);
	DragMessage(&drag, rect, handler);
}


void
BTextView::_ShowDropPlace(int32 offset)
{
	if (fDropPlace == offset)
		return;
	if (fDropPlace >= 0)
		Invalidate(_CaretRect(_Clamp(fDropPlace)));
	fDropPlace = offset;
	if (fDropPlace >= 0)
		Invalidate(_CaretRect(fDropPlace));
}


// A drag from here moves the text, any other copies it. What was dropped is selected.
void
BTextView::_HandleDrop(BMessage* message)
{
	_EndComposition(true);
	_ShowDropPlace(-1);
	int32 offset = OffsetAt(ConvertFromScreen(message->DropPoint()));

	void* source = NULL;
	int32 from = 0, to = 0;
	const bool isMove = message->FindPointer(kDragSource, &source) == B_OK && source == this
		&& message->FindInt32(kDragStart, &from) == B_OK
		&& message->FindInt32(kDragEnd, &to) == B_OK;
	if (isMove) {
		from = _Clamp(from);
		to = _Clamp(to);
		if (offset >= from && offset <= to)
			return;
	}

	if (fDoesUndo && fHistory == nullptr)
		fHistory = std::make_unique<TextHistory>();
	if (fHistory != nullptr)
		fHistory->Begin(B_UNDO_DROP, _Start(), _End());
	if (isMove && from < to) {
		DeleteText(from, to);
		if (offset > from)
			offset -= to - from;
	}
	if (_InsertFrom(message, B_UNDO_DROP, offset)) {
		const int32 end = _Clamp(std::max(offset, _End()));
		_SetSelection(offset, end);
	}
	if (fHistory != nullptr)
		fHistory->End();
	if (!IsFocus())
		MakeFocus(true);
	fCaretX = -1;
}


// An arrow over the selection, which can be dragged.
void
BTextView::_UpdateCursor(BPoint where)
{
	if (!fEditable && !fSelectable)
		return;
	bool overSelection = false;
	if (_ShowsSelection()) {
		BRegion selected;
		GetTextRegion(_Start(), _End(), &selected);
		overSelection = selected.Contains(where);
	}
	SetViewCursor(overSelection ? B_CURSOR_SYSTEM_DEFAULT : B_CURSOR_I_BEAM);
}
