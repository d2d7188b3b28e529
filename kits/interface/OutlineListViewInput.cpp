// BOutlineListView: drawing, mouse and keys.
#include "OutlineListView.h"

#include <algorithm>
#include <cmath>

#include <Message.h>
#include <Window.h>

#include "interface/private/EventModifiers.h"
#include "interface/private/Look.h"

using namespace BPrivate;

namespace {

constexpr float kLatchWidth = 13; // pixels

} // namespace


float
BOutlineListView::_Indent(int32 level) const
{
	BFont font;
	GetFont(&font);
	return level * std::ceil(font.Size() * 0.85f);
}


BRect
BOutlineListView::LatchRect(BRect itemRect, int32 level) const
{
	const float left = itemRect.left + _Indent(level);
	return BRect(left, itemRect.top, left + kLatchWidth - 1, itemRect.bottom);
}


void
BOutlineListView::DrawLatch(BRect itemRect, int32 level, bool collapsed, bool highlighted, bool)
{
	Look::DrawLatch(this, LatchRect(itemRect, level), !collapsed, highlighted);
}


void
BOutlineListView::DrawItem(BListItem* item, BRect itemFrame, bool complete)
{
	if (item->fHasSubitems) {
		DrawLatch(itemFrame, static_cast<int32>(item->fLevel), !item->fExpanded,
			item == fLatchItem && fLatchInside, item == fLatchItem && !fLatchInside);
	}
	itemFrame.left += _Indent(static_cast<int32>(item->fLevel)) + kLatchWidth;
	BListView::DrawItem(item, itemFrame, complete);
}


bool
BOutlineListView::_HitsLatch(BPoint where, int32 index) const
{
	const BListItem* item = ItemAt(index);
	if (item == NULL || !item->fHasSubitems)
		return false;
	const BRect frame = const_cast<BOutlineListView*>(this)->ItemFrame(index);
	return LatchRect(frame, static_cast<int32>(item->fLevel)).Contains(where);
}


void
BOutlineListView::MouseDown(BPoint where)
{
	const int32 index = IndexOf(where);
	if (!_HitsLatch(where, index)) {
		BListView::MouseDown(where);
		return;
	}
	if (!IsFocus())
		MakeFocus(true);
	fLatchItem = ItemAt(index);
	fLatchInside = true;
	SetMouseEventMask(B_POINTER_EVENTS, B_LOCK_WINDOW_FOCUS);
	InvalidateItem(index);
}


void
BOutlineListView::MouseMoved(BPoint where, uint32 code, const BMessage* message)
{
	if (fLatchItem == NULL) {
		BListView::MouseMoved(where, code, message);
		return;
	}
	const int32 index = IndexOf(fLatchItem);
	const bool inside = _HitsLatch(where, index);
	if (inside != fLatchInside) {
		fLatchInside = inside;
		InvalidateItem(index);
	}
}


void
BOutlineListView::MouseUp(BPoint where)
{
	if (fLatchItem == NULL) {
		BListView::MouseUp(where);
		return;
	}
	BListItem* item = fLatchItem;
	fLatchItem = NULL;
	const int32 index = IndexOf(item);
	InvalidateItem(index);
	if (_HitsLatch(where, index))
		ExpandOrCollapse(item, !item->fExpanded);
}


// Left closes an item, or goes to the one above it; right opens it.
void
BOutlineListView::KeyDown(const char* bytes, int32 numBytes)
{
	const char key = numBytes == 1 ? bytes[0] : '\0';
	const bool asOutline = (event_modifiers(*this) & (B_CONTROL_KEY | B_COMMAND_KEY)) != 0;
	const bool closes = key == B_LEFT_ARROW || (asOutline && key == B_UP_ARROW);
	const bool opens = key == B_RIGHT_ARROW || (asOutline && key == B_DOWN_ARROW);
	BListItem* item = ItemAt(CurrentSelection());
	if (item == NULL || (!closes && !opens)) {
		BListView::KeyDown(bytes, numBytes);
		return;
	}
	if (opens) {
		Expand(item);
	} else if (item->fHasSubitems && item->fExpanded) {
		Collapse(item);
	} else if (BListItem* superitem = Superitem(item)) {
		Select(IndexOf(superitem));
		ScrollToSelection();
	}
}


void
BOutlineListView::FrameMoved(BPoint newPosition)
{
	BListView::FrameMoved(newPosition);
}


void
BOutlineListView::FrameResized(float width, float height)
{
	BListView::FrameResized(width, height);
}


BHandler*
BOutlineListView::ResolveSpecifier(
	BMessage* message, int32 index, BMessage* specifier, int32 form, const char* property)
{
	return BListView::ResolveSpecifier(message, index, specifier, form, property);
}


status_t
BOutlineListView::GetSupportedSuites(BMessage* data)
{
	return BListView::GetSupportedSuites(data);
}


status_t
BOutlineListView::Perform(perform_code code, void* data)
{
	return BListView::Perform(code, data);
}


void
BOutlineListView::ResizeToPreferred()
{
	BListView::ResizeToPreferred();
}


void
BOutlineListView::GetPreferredSize(float* _width, float* _height)
{
	BListView::GetPreferredSize(_width, _height);
	if (_width == NULL || IsEmpty())
		return;
	for (const BListItem* item : fItems) {
		const float left = _Indent(static_cast<int32>(item->fLevel)) + kLatchWidth;
		*_width = std::max(*_width, left + std::ceil(item->fWidth));
	}
}


void
BOutlineListView::MakeFocus(bool focus)
{
	BListView::MakeFocus(focus);
}


void
BOutlineListView::AllAttached()
{
	BListView::AllAttached();
}


void
BOutlineListView::AllDetached()
{
	BListView::AllDetached();
}


void
BOutlineListView::DetachedFromWindow()
{
	fLatchItem = NULL;
	BListView::DetachedFromWindow();
}
