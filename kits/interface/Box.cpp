#include <Box.h>

#include <algorithm>
#include <cmath>

#include <Message.h>

#include "interface/private/ControlArchive.h"
#include "interface/private/Label.h"
#include "interface/private/Look.h"
#include "interface/private/ViewArchive.h"

namespace Look = BPrivate::Look;

using BPrivate::is_revived;
using BPrivate::LabelMetrics;

namespace {

constexpr float kLabelLeft = 10;
constexpr float kGapMargin = 4; // between the label and the broken border

constexpr float
BorderWidth(border_style border)
{
	return border == B_FANCY_BORDER ? 2 : border == B_PLAIN_BORDER ? 1 : 0;
}


// The border of an archive. A bool is true for anything but fancy; which one is not recorded.
border_style
ReadBorder(const BMessage* archive)
{
	int32 border;
	if (archive->FindInt32("_style", &border) == B_OK)
		return static_cast<border_style>(border);
	bool other;
	if (archive->FindBool("_style", &other) == B_OK && other)
		return B_PLAIN_BORDER;
	return B_FANCY_BORDER;
}

} // namespace


BBox::BBox(BRect frame, const char* name, uint32 resizingMode, uint32 flags, border_style border) :
	BView(frame, name, resizingMode, flags | B_WILL_DRAW | B_FRAME_EVENTS), fLabelView(NULL),
	fOldBounds(Bounds()), fBorder(border)
{
	SetFont(be_bold_font);
}


BBox::BBox(BMessage* archive) :
	BView(archive), fLabel(BPrivate::read_text(archive, "_label")), fLabelView(NULL),
	fOldBounds(Bounds()), fBorder(ReadBorder(archive))
{
	bool labelIsView;
	if (archive->FindBool("_lblview", &labelIsView) == B_OK)
		fLabelView = ChildAt(0);
}


BBox::~BBox()
{
}


BArchivable*
BBox::Instantiate(BMessage* archive)
{
	return validate_instantiation(archive, "BBox") ? new BBox(archive) : NULL;
}


status_t
BBox::Archive(BMessage* archive, bool deep) const
{
	const status_t status = BView::Archive(archive, deep);
	if (status != B_OK)
		return status;

	BPrivate::ArchiveWriter writer(archive);
	BPrivate::write_text(writer, archive, "_label", fLabel);
	const bool hasLabelView = LabelView() != NULL;
	if (!writer.Keep("_lblview", writer.Source().HasBool("_lblview") == hasLabelView)
		&& hasLabelView) {
		archive->AddBool("_lblview", true);
	}
	if (!writer.Keep("_style", ReadBorder(&writer.Source()) == fBorder)
		&& fBorder != B_FANCY_BORDER) {
		archive->AddInt32("_style", fBorder);
	}
	return writer.Status();
}


// #pragma mark - border and label


void
BBox::SetBorder(border_style border)
{
	if (border == fBorder)
		return;
	fBorder = border;
	Invalidate();
}


border_style
BBox::Border() const
{
	return fBorder;
}


BRect
BBox::InnerFrame()
{
	BRect frame = Bounds();
	const float width = BorderWidth(fBorder);
	frame.InsetBy(width, width);
	const BRect gap = _LabelGap();
	if (gap.IsValid())
		frame.top = std::max(frame.top, gap.bottom + 1);
	return frame;
}


void
BBox::SetLabel(const char* label)
{
	if (label == NULL)
		label = "";
	if (LabelView() == NULL && fLabel == label)
		return;
	_ClearLabel();
	fLabel = label;
	Invalidate();
}


status_t
BBox::SetLabel(BView* viewLabel)
{
	if (viewLabel != NULL && viewLabel == LabelView())
		return B_OK;
	_ClearLabel();
	if (viewLabel != NULL) {
		fLabelView = viewLabel;
		viewLabel->MoveTo(kLabelLeft, 0);
		AddChild(viewLabel, ChildAt(0));
	}
	Invalidate();
	return B_OK;
}


const char*
BBox::Label() const
{
	return fLabel.empty() ? NULL : fLabel.c_str();
}


BView*
BBox::LabelView() const
{
	return fLabelView != NULL && ChildAt(0) == fLabelView ? fLabelView : NULL;
}


bool
BBox::_HasLabel() const
{
	return !fLabel.empty() || LabelView() != NULL;
}


void
BBox::_ClearLabel()
{
	fLabel.clear();
	BView* view = LabelView();
	fLabelView = NULL;
	if (view != NULL) {
		view->RemoveSelf();
		delete view;
	}
}


BRect
BBox::_LabelGap() const
{
	if (const BView* view = LabelView()) {
		BRect gap = view->Frame();
		gap.InsetBy(-kGapMargin, 0);
		return gap;
	}
	if (fLabel.empty())
		return BRect();
	const float width = BPrivate::label_width(this, fLabel.c_str());
	return BRect(kLabelLeft - kGapMargin, 0, kLabelLeft + width + kGapMargin - 1,
		LabelMetrics(this).textHeight);
}


float
BBox::_BorderTop() const
{
	return _HasLabel() ? std::round(_LabelGap().bottom / 2) : 0;
}


// #pragma mark - drawing


void
BBox::Draw(BRect updateRect)
{
	BRect frame = Bounds();
	const rgb_color base = Look::BaseColor(this);
	if (fBorder != B_NO_BORDER && (frame.Width() <= 1 || frame.Height() <= 1)) {
		Look::DrawSeparator(this, frame, base);
		return;
	}

	frame.top += _BorderTop();
	const BRect gap = _LabelGap();
	if (fBorder == B_FANCY_BORDER)
		Look::DrawGroove(this, frame, base, gap);
	else if (fBorder == B_PLAIN_BORDER)
		Look::DrawPlainFrame(this, frame, base, gap);

	if (!fLabel.empty()) {
		BFont font;
		GetFont(&font);
		font_height height;
		font.GetHeight(&height);
		const float baseline = std::ceil(height.ascent - height.descent) + 1;
		DrawString(fLabel.c_str(), BPoint(kLabelLeft, baseline));
	}
}


void
BBox::FrameResized(float newWidth, float newHeight)
{
	const BRect bounds = Bounds();
	if ((Flags() & B_FULL_UPDATE_ON_RESIZE) == 0)
		_InvalidateStrips(fOldBounds, bounds);
	fOldBounds = bounds;
	BView::FrameResized(newWidth, newHeight);
}


// The right and bottom border of before lie inside of a box that has grown; those of one that has
// shrunk were cut off.
void
BBox::_InvalidateStrips(BRect oldBounds, BRect newBounds)
{
	const float width = std::max(BorderWidth(fBorder), 1.0f);
	if (oldBounds.Width() != newBounds.Width()) {
		for (const BRect& bounds : { oldBounds, newBounds })
			Invalidate(BRect(bounds.right - width, bounds.top, bounds.right, bounds.bottom));
	}
	if (oldBounds.Height() != newBounds.Height()) {
		for (const BRect& bounds : { oldBounds, newBounds })
			Invalidate(BRect(bounds.left, bounds.bottom - width, bounds.right, bounds.bottom));
	}
}


// #pragma mark - hooks


void
BBox::AttachedToWindow()
{
	if (!is_revived(this)) {
		const rgb_color color = Look::ColorOfParent(this);
		SetViewColor(color);
		SetLowColor(color);
	}
	fOldBounds = Bounds();
	BView::AttachedToWindow();
}


void
BBox::DetachedFromWindow()
{
	BView::DetachedFromWindow();
}


void
BBox::AllAttached()
{
	BView::AllAttached();
}


void
BBox::AllDetached()
{
	BView::AllDetached();
}


void
BBox::FrameMoved(BPoint newPosition)
{
	BView::FrameMoved(newPosition);
}


void
BBox::MessageReceived(BMessage* message)
{
	BView::MessageReceived(message);
}


void
BBox::MouseDown(BPoint where)
{
	BView::MouseDown(where);
}


void
BBox::MouseUp(BPoint where)
{
	BView::MouseUp(where);
}


void
BBox::MouseMoved(BPoint where, uint32 transit, const BMessage* dragMessage)
{
	BView::MouseMoved(where, transit, dragMessage);
}


void
BBox::WindowActivated(bool active)
{
	BView::WindowActivated(active);
}


void
BBox::MakeFocus(bool focused)
{
	BView::MakeFocus(focused);
}


void
BBox::GetPreferredSize(float* _width, float* _height)
{
	const BRect bounds = Bounds();
	const float border = 2 * BorderWidth(fBorder);
	const BRect gap = _LabelGap();
	if (_width != NULL) {
		const float needed = gap.IsValid() ? gap.right + kLabelLeft : border;
		*_width = std::max(bounds.Width(), needed);
	}
	if (_height != NULL) {
		const float needed = gap.IsValid() ? gap.bottom + border : border;
		*_height = std::max(bounds.Height(), needed);
	}
}


void
BBox::ResizeToPreferred()
{
	BView::ResizeToPreferred();
}


BHandler*
BBox::ResolveSpecifier(
	BMessage* message, int32 index, BMessage* specifier, int32 what, const char* property)
{
	return BView::ResolveSpecifier(message, index, specifier, what, property);
}


status_t
BBox::GetSupportedSuites(BMessage* message)
{
	return BView::GetSupportedSuites(message);
}


status_t
BBox::Perform(perform_code code, void* data)
{
	return BView::Perform(code, data);
}
