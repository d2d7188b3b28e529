#include "work/HiliteView.h"

#include <cmath>

#include <Message.h>
#include <Region.h>

#include "archive/EditorCodes.h"
#include "archive/ViewTree.h"
#include "work/WorkBackgroundView.h"
#include "work/WorkView.h"

namespace {


constexpr rgb_color kHiliteColor = { 0, 0, 255, 255 };
constexpr float kFrameWidth = 2;


} // namespace


HiliteView::HiliteView(
	BRect frame, const char* name, uint32 resizingMode, uint32 flags, WorkView* owner) :
	BView(frame, name, resizingMode, flags),
	fOwner(owner)
{
	SetViewColor(B_TRANSPARENT_COLOR);
}


void
HiliteView::Draw(BRect updateRect)
{
	DrawHilite();
}


void
HiliteView::MessageReceived(BMessage* message)
{
	if (message->what == kDrawHilite)
		DrawHilite();
	else
		BView::MessageReceived(message);
}


void
HiliteView::DrawHilite()
{
	BView* selection = _Selection();
	if (selection == nullptr)
		return;

	const BPoint offset = ConvertFromScreen(selection->ConvertToScreen(BPoint(0, 0)));
	BRect frame = selection->Bounds().OffsetByCopy(offset);
	frame.right -= 1;
	frame.bottom -= 1;

	BRegion visible;
	selection->GetClippingRegion(&visible);
	visible.OffsetBy(
		static_cast<int32>(std::lround(offset.x)), static_cast<int32>(std::lround(offset.y)));
	ConstrainClippingRegion(&visible);

	SetPenSize(kFrameWidth);
	SetHighColor(kHiliteColor);
	StrokeRect(frame, B_SOLID_HIGH);
	if (!FrameControled(selection)) {
		FillTriangle(BPoint(frame.right - 6, frame.bottom - 1),
			BPoint(frame.right - 1, frame.bottom - 6), BPoint(frame.right - 1, frame.bottom - 1),
			B_SOLID_HIGH);
	}
	SetPenSize(1);
}


void
HiliteView::InvalidateSelection()
{
	BView* selection = _Selection();
	if (selection == nullptr)
		return;

	const BRect bounds = selection->Bounds();
	BRegion region(bounds);
	region.Exclude(bounds.InsetByCopy(kFrameWidth, kFrameWidth));
	region.Include(BRect(bounds.right - 7, bounds.bottom - 7, bounds.right - 2, bounds.bottom - 2));
	selection->Invalidate(&region);
}


// The selected view, if it is still in the edited tree.
BView*
HiliteView::_Selection() const
{
	return LiveViewAttached(fOwner->Container(), fOwner->SelectedView());
}
