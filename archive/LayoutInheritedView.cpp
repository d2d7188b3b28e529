#include "archive/LayoutInheritedView.h"

#include <cmath>

#include <Font.h>
#include <Message.h>
#include <Region.h>

namespace {


constexpr const char* kClassField = "class";
constexpr const char* kPlaceholderClass = "LayoutInheritedView";
constexpr const char* kNewClassName = "MyBView";
constexpr float kLabelMargin = 4;


const char*
ArchivedClassName(BMessage* archive)
{
	const char* name;
	return archive->FindString(kClassField, 1, &name) == B_OK ? name : "";
}


// The view's bounds without its children's frames.
BRegion
FreeRegion(BView* view)
{
	BRegion region(view->Bounds());
	for (BView* child = view->ChildAt(0); child != nullptr; child = child->NextSibling())
		region.Exclude(child->Frame());
	return region;
}


bool
Fits(BRect label, const BRegion& free)
{
	BRegion covered(label);
	covered.Exclude(&free);
	return !covered.Frame().IsValid();
}


BRect
LabelAt(float left, float top, float width, float height)
{
	return BRect(left, top, left + width, top + height);
}


BRect
CenteredLabel(float x, float y, float width, float height)
{
	return BRect(x - width / 2, y - height / 2, x + width / 2, y + height / 2);
}


// Centred in the first free rectangle that is large enough, else in the middle of the view.
BRect
LabelInFreeRectangle(BRegion& free, BRect middle, float width, float height)
{
	for (int32 i = 0; i < free.CountRects(); i++) {
		const BRect rect = free.RectAt(i);
		// Strictly greater in height, but not in width: this difference is wanted.
		if (rect.Height() > height + 2 && rect.Width() >= width + 2) {
			return CenteredLabel(
				(rect.left + rect.right) / 2, (rect.top + rect.bottom) / 2, width, height);
		}
	}
	return middle;
}


} // namespace


LayoutInherited::LayoutInherited(const char* className) :
	fClassName(className), fLabelFrame(0, 0, -1, -1)
{
}


const char*
LayoutInherited::ClassName() const
{
	return fClassName.String();
}


void
LayoutInherited::SetClassName(const char* name)
{
	fClassName = name != nullptr ? name : "";
}


void
LayoutInherited::SpecialDraw(BView* view)
{
	font_height metrics;
	view->GetFontHeight(&metrics);
	const float width = std::ceil(view->StringWidth(fClassName.String()));
	const float height = std::ceil(metrics.ascent + metrics.descent);

	fLabelFrame = _PlaceLabel(view, width, height);
	view->MovePenTo(fLabelFrame.left, fLabelFrame.top + metrics.ascent);
	view->DrawString(fClassName.String());
}


BRect
LayoutInherited::_PlaceLabel(BView* view, float width, float height) const
{
	BRegion free = FreeRegion(view);

	// The label does not jump when nothing that matters changed.
	if (fLabelFrame.Width() == width && fLabelFrame.Height() == height && Fits(fLabelFrame, free))
		return fLabelFrame;

	const BRect bounds = view->Bounds();
	const float right = bounds.right - kLabelMargin - width;
	const float bottom = bounds.bottom - kLabelMargin - height;
	const BRect topLeft = LabelAt(kLabelMargin, kLabelMargin, width, height);
	const BRect middle = CenteredLabel(bounds.Width() / 2, bounds.Height() / 2, width, height);

	const BRect candidates[] = { topLeft, LabelAt(right, kLabelMargin, width, height),
		LabelAt(kLabelMargin, bottom, width, height), LabelAt(right, bottom, width, height), middle,
		LabelInFreeRectangle(free, middle, width, height) };
	for (const BRect& candidate : candidates) {
		if (Fits(candidate, free))
			return candidate;
	}
	return topLeft;
}


// #pragma mark - LayoutInheritedView


LayoutInheritedView::LayoutInheritedView(
	BRect frame, const char* name, uint32 resizingMode, uint32 flags) :
	LayoutInherited(kNewClassName),
	BView(frame, name, resizingMode, flags)
{
}


LayoutInheritedView::LayoutInheritedView(BMessage* archive) :
	LayoutInherited(ArchivedClassName(archive)), BView(archive)
{
	const char* name;
	for (int32 i = 2; archive->FindString(kClassField, i, &name) == B_OK; i++)
		fBaseClasses.AddString(kClassField, name);
}


BArchivable*
LayoutInheritedView::Instantiate(BMessage* archive)
{
	if (!validate_instantiation(archive, kPlaceholderClass))
		return nullptr;
	return new LayoutInheritedView(archive);
}


status_t
LayoutInheritedView::Archive(BMessage* archive, bool deep) const
{
	BView::Archive(archive, deep);
	archive->RemoveName(kClassField);
	archive->AddString(kClassField, kPlaceholderClass);
	archive->AddString(kClassField, ClassName());
	const char* name;
	for (int32 i = 0; fBaseClasses.FindString(kClassField, i, &name) == B_OK; i++)
		archive->AddString(kClassField, name);
	return B_OK;
}


void
LayoutInheritedView::Draw(BRect updateRect)
{
	SpecialDraw(this);
}
