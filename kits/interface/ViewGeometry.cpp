// Frames, coordinates, scrolling and invalidation of views.
#include <View.h>

#include <cmath>

#include <Region.h>
#include <ScrollBar.h>
#include <Window.h>

#include "interface/private/ViewPrivate.h"
#include "interface/private/ViewState.h"
#include "interface/private/WindowInternals.h"
#include "server/ServerView.h"
#include "server/ViewTree.h"

using namespace BPrivate;

namespace {

// The view's point (0, 0) on the screen.
BPoint
screen_origin(const ServerView* node, BWindow* window)
{
	return node->Origin() + window->Frame().LeftTop();
}

} // namespace


BRect
BView::Bounds() const
{
	return fNode->Bounds();
}


BRect
BView::Frame() const
{
	return fNode->Frame();
}


// #pragma mark - conversions


BPoint
BView::ConvertToScreen(BPoint point) const
{
	if (fOwner == nullptr || !_CheckOwnerLock())
		return point;
	return point + screen_origin(fNode, fOwner);
}


BPoint
BView::ConvertFromScreen(BPoint point) const
{
	if (fOwner == nullptr || !_CheckOwnerLock())
		return point;
	return point - screen_origin(fNode, fOwner);
}


BRect
BView::ConvertToScreen(BRect rect) const
{
	return rect.OffsetByCopy(ConvertToScreen(BPoint(0, 0)));
}


BRect
BView::ConvertFromScreen(BRect rect) const
{
	return rect.OffsetByCopy(ConvertFromScreen(BPoint(0, 0)));
}


BPoint
BView::ConvertToParent(BPoint point) const
{
	return point - fNode->Scroll() + fNode->Frame().LeftTop();
}


BPoint
BView::ConvertFromParent(BPoint point) const
{
	return point - fNode->Frame().LeftTop() + fNode->Scroll();
}


BRect
BView::ConvertToParent(BRect rect) const
{
	return rect.OffsetByCopy(ConvertToParent(BPoint(0, 0)));
}


BRect
BView::ConvertFromParent(BRect rect) const
{
	return rect.OffsetByCopy(ConvertFromParent(BPoint(0, 0)));
}


void
BView::ConvertToScreen(BPoint* point) const
{
	*point = ConvertToScreen(*point);
}


void
BView::ConvertFromScreen(BPoint* point) const
{
	*point = ConvertFromScreen(*point);
}


void
BView::ConvertToScreen(BRect* rect) const
{
	*rect = ConvertToScreen(*rect);
}


void
BView::ConvertFromScreen(BRect* rect) const
{
	*rect = ConvertFromScreen(*rect);
}


void
BView::ConvertToParent(BPoint* point) const
{
	*point = ConvertToParent(*point);
}


void
BView::ConvertFromParent(BPoint* point) const
{
	*point = ConvertFromParent(*point);
}


void
BView::ConvertToParent(BRect* rect) const
{
	*rect = ConvertToParent(*rect);
}


void
BView::ConvertFromParent(BRect* rect) const
{
	*rect = ConvertFromParent(*rect);
}


// #pragma mark - moving and sizing


void
BView::MoveBy(float dx, float dy)
{
	MoveTo(Frame().LeftTop() + BPoint(std::round(dx), std::round(dy)));
}


void
BView::MoveTo(float x, float y)
{
	MoveTo(BPoint(x, y));
}


void
BView::MoveTo(BPoint where)
{
	where.Set(std::round(where.x), std::round(where.y));
	if (where == Frame().LeftTop())
		return;
	_CheckLock();
	if (fOwner != nullptr)
		fNode->Tree()->MoveTo(*fNode, where);
	else
		fNode->SetFrame(Frame().OffsetToCopy(where));
}


void
BView::ResizeBy(float dx, float dy)
{
	const BRect frame = Frame();
	ResizeTo(frame.Width() + std::round(dx), frame.Height() + std::round(dy));
}


void
BView::ResizeTo(float width, float height)
{
	width = std::round(width);
	height = std::round(height);
	BRect frame = Frame();
	if (width == frame.Width() && height == frame.Height())
		return;
	_CheckLock();
	if (fOwner != nullptr) {
		fNode->Tree()->ResizeTo(*fNode, width, height);
		return;
	}
	frame.right = frame.left + width;
	frame.bottom = frame.top + height;
	fNode->SetFrame(frame);
}


void
BView::GetPreferredSize(float* width, float* height)
{
	if (width != nullptr)
		*width = Frame().Width();
	if (height != nullptr)
		*height = Frame().Height();
}


void
BView::ResizeToPreferred()
{
	float width, height;
	GetPreferredSize(&width, &height);
	ResizeTo(width, height);
}


// #pragma mark - scrolling


void
BView::ScrollBy(float dx, float dy)
{
	ScrollTo(fNode->Scroll() + BPoint(dx, dy));
}


void
BView::ScrollTo(BPoint where)
{
	_CheckLock();
	where.Set(std::round(where.x), std::round(where.y));
	BScrollBar* horizontal = ScrollBar(B_HORIZONTAL);
	BScrollBar* vertical = ScrollBar(B_VERTICAL);
	// The bars clamp the position and learn of it; they do not scroll in turn.
	if (horizontal != nullptr)
		where.x = horizontal->_Follow(where.x);
	if (vertical != nullptr)
		where.y = vertical->_Follow(where.y);
	if (where == fNode->Scroll())
		return;
	if (fOwner != nullptr)
		fNode->Tree()->ScrollTo(*fNode, where);
	else
		fNode->SetScroll(where);
	if (fOwner != nullptr)
		WindowInternals::Of(fOwner).NoteDrawing();
}


// #pragma mark - invalidation, clipping


void
BView::Invalidate(BRect rect)
{
	if (fOwner == nullptr || !_CheckOwnerLock())
		return;
	fNode->Tree()->Invalidate(*fNode, rect);
}


void
BView::Invalidate(const BRegion* region)
{
	if (region == nullptr || fOwner == nullptr || !_CheckOwnerLock())
		return;
	fNode->Tree()->Invalidate(*fNode, *region);
}


void
BView::Invalidate()
{
	Invalidate(Bounds());
}


void
BView::GetClippingRegion(BRegion* region) const
{
	if (region == nullptr)
		return;
	region->MakeEmpty();
	if (fOwner == nullptr || !_CheckOwnerLock() || !fNode->Tree()->CanPaint())
		return;
	std::optional<BRegion> constraint;
	if (fState != nullptr)
		constraint = fState->Constraint();
	fNode->Tree()->GetClipping(*fNode, constraint ? &*constraint : nullptr, region);
}


void
BView::ConstrainClippingRegion(BRegion* region)
{
	_CheckLock();
	if (region == nullptr && fState == nullptr)
		return;
	DrawState& draw = _State()->draw;
	draw.hasClipping = region != nullptr;
	if (region != nullptr)
		draw.clipping = *region;
	else
		draw.clipping.MakeEmpty();
	if (fOwner != nullptr)
		fNode->Tree()->ConstraintChanged(*fNode);
}


void
BView::Flush() const
{
	if (fOwner != nullptr)
		fOwner->Flush();
}


void
BView::Sync() const
{
	if (fOwner != nullptr)
		fOwner->Sync();
}
