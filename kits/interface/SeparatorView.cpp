#include <SeparatorView.h>

#include <algorithm>
#include <cmath>

#include <Message.h>

#include "interface/private/Label.h"
#include "interface/private/Look.h"
#include "interface/private/ViewArchive.h"

namespace Look = BPrivate::Look;

using BPrivate::LabelMetrics;

namespace {

constexpr uint32 kFlags = B_WILL_DRAW | B_FULL_UPDATE_ON_RESIZE | B_FRAME_EVENTS;
constexpr float kLabelGap = 5; // pixels between the label and the line
constexpr float kLabelIndent = 10; // of a label at an end of the line

} // namespace


BSeparatorView::BSeparatorView(orientation direction, border_style border) :
	BView(BRect(), NULL, B_FOLLOW_LEFT | B_FOLLOW_TOP, kFlags), fOrientation(direction),
	fHorizontal(B_ALIGN_HORIZONTAL_CENTER), fVertical(B_ALIGN_VERTICAL_CENTER), fBorder(border)
{
	_Init(NULL, NULL);
}


BSeparatorView::BSeparatorView(const char* name, const char* label, orientation direction,
	border_style border, const BAlignment& place) :
	BView(BRect(), name, B_FOLLOW_LEFT | B_FOLLOW_TOP, kFlags),
	fOrientation(direction), fHorizontal(place.horizontal), fVertical(place.vertical),
	fBorder(border)
{
	_Init(label, NULL);
}


BSeparatorView::BSeparatorView(const char* name, BView* labelView, orientation direction,
	border_style border, const BAlignment& place) :
	BView(BRect(), name, B_FOLLOW_LEFT | B_FOLLOW_TOP, kFlags),
	fOrientation(direction), fHorizontal(place.horizontal), fVertical(place.vertical),
	fBorder(border)
{
	_Init(NULL, labelView);
}


BSeparatorView::BSeparatorView(
	const char* label, orientation direction, border_style border, const BAlignment& place) :
	BSeparatorView(static_cast<const char*>(NULL), label, direction, border, place)
{
}


BSeparatorView::BSeparatorView(
	BView* labelView, orientation direction, border_style border, const BAlignment& place) :
	BSeparatorView(static_cast<const char*>(NULL), labelView, direction, border, place)
{
}


BSeparatorView::BSeparatorView(BMessage* archive) :
	BView(archive), fLabelView(NULL), fLabelViewChanged(false), fOrientation(B_HORIZONTAL),
	fHorizontal(B_ALIGN_HORIZONTAL_CENTER), fVertical(B_ALIGN_VERTICAL_CENTER),
	fBorder(B_FANCY_BORDER)
{
	const char* text;
	if (archive->FindString("_label", &text) == B_OK)
		fLabel = text;
	if (archive->FindString("_labelview", &text) == B_OK) {
		for (BView* child = ChildAt(0); child != NULL && fLabelView == NULL;
			 child = child->NextSibling()) {
			if (child->Name() != NULL && std::string(child->Name()) == text)
				fLabelView = child;
		}
	}
	int32 number;
	if (archive->FindInt32("_orientation", &number) == B_OK)
		fOrientation = number;
	if (archive->FindInt32("_halignment", &number) == B_OK)
		fHorizontal = number;
	if (archive->FindInt32("_valignment", &number) == B_OK)
		fVertical = number;
	if (archive->FindInt32("_border", &number) == B_OK)
		fBorder = number;
}


BSeparatorView::~BSeparatorView()
{
}


BArchivable*
BSeparatorView::Instantiate(BMessage* archive)
{
	return validate_instantiation(archive, "BSeparatorView") ? new BSeparatorView(archive) : NULL;
}


status_t
BSeparatorView::Archive(BMessage* archive, bool deep) const
{
	const status_t status = BView::Archive(archive, deep);
	if (status != B_OK)
		return status;

	BPrivate::ArchiveWriter writer(archive);
	const BView* labelView = LabelView();
	writer.String("_label", fLabel.c_str(), "", labelView == NULL);
	// The name of a view that was not found stays.
	if (labelView != NULL || fLabelViewChanged)
		writer.String("_labelview", labelView != NULL ? labelView->Name() : NULL, NULL);
	else
		writer.Keep("_labelview", fLabelView == NULL);
	writer.Int32("_orientation", fOrientation, B_HORIZONTAL);
	writer.Int32("_halignment", fHorizontal, B_ALIGN_HORIZONTAL_CENTER);
	writer.Int32("_valignment", fVertical, B_ALIGN_VERTICAL_CENTER);
	writer.Int32("_border", fBorder, B_FANCY_BORDER);
	return writer.Status();
}


// #pragma mark - hooks


void
BSeparatorView::AttachedToWindow()
{
	if (!BPrivate::is_revived(this)) {
		SetViewColor(Look::ColorOfParent(this));
		SetLowColor(ViewColor());
		_PlaceLabelView();
	}
	BView::AttachedToWindow();
}


void
BSeparatorView::Draw(BRect updateRect)
{
	const BRect bounds = Bounds();
	const bool hasLabel = !fLabel.empty() || LabelView() != NULL;
	BRect label = _LabelFrame();
	const BPoint middle(
		std::floor((label.left + label.right) / 2), std::floor((label.top + label.bottom) / 2));
	const float before = std::floor((_Thickness() - 1) / 2);
	BRect line = bounds;
	if (fOrientation == B_VERTICAL) {
		line.left = middle.x - before;
		line.right = line.left + _Thickness() - 1;
	} else {
		line.top = middle.y - before;
		line.bottom = line.top + _Thickness() - 1;
	}
	if (!hasLabel) {
		_DrawLine(line);
		return;
	}

	label.InsetBy(-kLabelGap, -kLabelGap);
	BRect rest = line;
	if (fOrientation == B_VERTICAL) {
		line.bottom = label.top;
		rest.top = label.bottom;
	} else {
		line.right = label.left;
		rest.left = label.right;
	}
	_DrawLine(line);
	_DrawLine(rest);
	if (!fLabel.empty() && LabelView() == NULL) {
		label.InsetBy(kLabelGap, kLabelGap);
		const float baseline =
			BPrivate::centered_baseline(LabelMetrics(this), label.top, label.bottom);
		BPrivate::draw_label(this, fLabel.c_str(), BPoint(label.left, baseline), true);
	}
}


void
BSeparatorView::FrameResized(float newWidth, float newHeight)
{
	_PlaceLabelView();
	BView::FrameResized(newWidth, newHeight);
}


// A label with a piece of line on both sides.
void
BSeparatorView::GetPreferredSize(float* _width, float* _height)
{
	float width, height;
	_GetLabelSize(&width, &height);
	if (width >= 0)
		(fOrientation == B_VERTICAL ? height : width) += 2 * (kLabelIndent + kLabelGap);
	if (_width != NULL)
		*_width = std::max(width, _Thickness() - 1);
	if (_height != NULL)
		*_height = std::max(height, _Thickness() - 1);
}


status_t
BSeparatorView::Perform(perform_code code, void* argument)
{
	return BView::Perform(code, argument);
}


// #pragma mark - properties


void
BSeparatorView::SetOrientation(orientation direction)
{
	fOrientation = direction;
	_Change();
}


void
BSeparatorView::SetAlignment(const BAlignment& place)
{
	fHorizontal = place.horizontal;
	fVertical = place.vertical;
	_Change();
}


void
BSeparatorView::SetBorderStyle(border_style border)
{
	fBorder = border;
	_Change();
}


void
BSeparatorView::SetLabel(const char* label)
{
	_RemoveLabelView(true);
	fLabel = label != NULL ? label : "";
	_Change();
}


const char*
BSeparatorView::Label() const
{
	return fLabel.empty() || LabelView() != NULL ? NULL : fLabel.c_str();
}


void
BSeparatorView::SetLabel(BView* view, bool deletePrevious)
{
	if (view == LabelView() && view != NULL)
		return;
	_RemoveLabelView(deletePrevious);
	if (view != NULL) {
		if (view->Name() == NULL)
			view->SetName("_labelview_");
		AddChild(view);
		fLabelView = view;
		fLabel.clear();
	}
	_Change();
}


BView*
BSeparatorView::LabelView() const
{
	for (const BView* child = ChildAt(0); fLabelView != NULL && child != NULL;
		 child = child->NextSibling()) {
		if (child == fLabelView)
			return fLabelView;
	}
	return NULL;
}


// #pragma mark - private


void
BSeparatorView::_Init(const char* label, BView* labelView)
{
	fLabelView = NULL;
	fLabelViewChanged = false;
	if (labelView != NULL)
		SetLabel(labelView, true);
	else
		fLabel = label != NULL ? label : "";
}


void
BSeparatorView::_RemoveLabelView(bool deleteIt)
{
	BView* view = LabelView();
	fLabelView = NULL;
	fLabelViewChanged = true;
	if (view == NULL)
		return;
	view->RemoveSelf();
	if (deleteIt)
		delete view;
}


void
BSeparatorView::_Change()
{
	_PlaceLabelView();
	Invalidate();
}


BAlignment
BSeparatorView::_Place() const
{
	return BAlignment(
		static_cast<alignment>(fHorizontal), static_cast<vertical_alignment>(fVertical));
}


// -1 and the line's place, for no label.
void
BSeparatorView::_GetLabelSize(float* _width, float* _height) const
{
	*_width = -1;
	*_height = -1;
	if (const BView* view = LabelView()) {
		*_width = view->Bounds().Width();
		*_height = view->Bounds().Height();
	} else if (!fLabel.empty()) {
		*_width = BPrivate::label_width(this, fLabel.c_str());
		*_height = LabelMetrics(this).textHeight;
	}
}


// Without a label its frame is that of the line's own thickness.
BRect
BSeparatorView::_LabelFrame() const
{
	float width, height;
	_GetLabelSize(&width, &height);
	const bool hasLabel = width >= 0;
	width = std::max(width, _Thickness() - 1);
	height = std::max(height, _Thickness() - 1);
	BRect room = Bounds();
	if (hasLabel && fOrientation == B_VERTICAL)
		room.InsetBy(0, kLabelIndent + kLabelGap);
	else if (hasLabel)
		room.InsetBy(kLabelIndent + kLabelGap, 0);
	const BAlignment place = _Place();
	const float left = std::floor(room.left + (room.Width() - width) * place.RelativeHorizontal());
	const float top = std::floor(room.top + (room.Height() - height) * place.RelativeVertical());
	return BRect(left, top, left + width, top + height);
}


float
BSeparatorView::_Thickness() const
{
	return fBorder == B_NO_BORDER ? 0 : fBorder == B_PLAIN_BORDER ? 1 : 2;
}


void
BSeparatorView::_PlaceLabelView()
{
	if (BView* view = LabelView())
		view->MoveTo(_LabelFrame().LeftTop());
}


void
BSeparatorView::_DrawLine(BRect line)
{
	if (fBorder == B_NO_BORDER || !line.IsValid())
		return;
	const rgb_color base = Look::BaseColor(this);
	if (fBorder != B_PLAIN_BORDER) {
		Look::DrawSeparator(this, line, base);
		return;
	}
	const rgb_color high = HighColor();
	SetHighColor(tint_color(base, B_DARKEN_2_TINT));
	FillRect(line);
	SetHighColor(high);
}
