#include <StatusBar.h>

#include <algorithm>
#include <cmath>

#include <AppDefs.h>
#include <Message.h>

#include "interface/private/ControlArchive.h"
#include "interface/private/Label.h"
#include "interface/private/Look.h"
#include "interface/private/ViewArchive.h"

namespace Look = BPrivate::Look;

using BPrivate::is_revived;
using BPrivate::LabelMetrics;

namespace {

constexpr float kDefaultMax = 100;
constexpr float kDefaultBarHeight = 16;
constexpr float kTextPadding = 5; // between the text line and the bar, and above
constexpr float kTextInset = 2;
constexpr float kBarBorder = 2; // the two rings round the inside of the bar
constexpr float kTextGap = 4; // between a text and its label

} // namespace


BStatusBar::BStatusBar(
	BRect frame, const char* name, const char* label, const char* trailingLabel) :
	BView(frame, name, B_FOLLOW_LEFT | B_FOLLOW_TOP, B_WILL_DRAW | B_FRAME_EVENTS),
	fLabel(label != NULL ? label : ""), fTrailingLabel(trailingLabel != NULL ? trailingLabel : ""),
	fMax(kDefaultMax), fCurrent(0), fBarHeight(kDefaultBarHeight),
	fBarColor(Look::StatusBarColor()), fCustomBarHeight(false), fCustomBarColor(false)
{
}


BStatusBar::BStatusBar(BMessage* archive) :
	BView(archive), fLabel(BPrivate::read_text(archive, "_label")),
	fTrailingLabel(BPrivate::read_text(archive, "_tlabel")),
	fText(BPrivate::read_text(archive, "_text")),
	fTrailingText(BPrivate::read_text(archive, "_ttext")), fMax(kDefaultMax), fCurrent(0),
	fBarHeight(kDefaultBarHeight), fBarColor(Look::StatusBarColor()), fCustomBarHeight(false),
	fCustomBarColor(false)
{
	float number;
	if (archive->FindFloat("_high", &number) == B_OK) {
		fBarHeight = number;
		fCustomBarHeight = true;
	}
	int32 color;
	if (archive->FindInt32("_bcolor", &color) == B_OK) {
		fBarColor = BPrivate::color_from_bytes(color);
		fCustomBarColor = true;
	}
	if (archive->FindFloat("_val", &number) == B_OK)
		fCurrent = number;
	if (archive->FindFloat("_max", &number) == B_OK)
		fMax = number;
}


BStatusBar::~BStatusBar()
{
}


BArchivable*
BStatusBar::Instantiate(BMessage* archive)
{
	return validate_instantiation(archive, "BStatusBar") ? new BStatusBar(archive) : NULL;
}


status_t
BStatusBar::Archive(BMessage* archive, bool deep) const
{
	const status_t status = BView::Archive(archive, deep);
	if (status != B_OK)
		return status;

	BPrivate::ArchiveWriter writer(archive);
	writer.Float("_high", fBarHeight, kDefaultBarHeight, fCustomBarHeight);
	writer.Int32("_bcolor", BPrivate::color_to_bytes(fBarColor),
		BPrivate::color_to_bytes(Look::StatusBarColor()), fCustomBarColor);
	writer.Float("_val", fCurrent, 0, fCurrent != 0);
	writer.Float("_max", fMax, kDefaultMax, fMax != kDefaultMax);
	BPrivate::write_text(writer, archive, "_text", fText);
	BPrivate::write_text(writer, archive, "_ttext", fTrailingText);
	BPrivate::write_text(writer, archive, "_label", fLabel);
	BPrivate::write_text(writer, archive, "_tlabel", fTrailingLabel);
	return writer.Status();
}


void
BStatusBar::Reset(const char* label, const char* trailingLabel)
{
	_SetText(fLabel, label);
	_SetText(fTrailingLabel, trailingLabel);
	_SetText(fText, NULL);
	_SetText(fTrailingText, NULL);
	_SetValue(0, kDefaultMax);
}


// #pragma mark - hooks


void
BStatusBar::AttachedToWindow()
{
	if (!is_revived(this)) {
		ResizeTo(Bounds().Width(), _TextHeight() + fBarHeight);
		const rgb_color color = Look::ColorOfParent(this);
		SetViewColor(color);
		SetLowColor(color);
	}
	BView::AttachedToWindow();
}


void
BStatusBar::DetachedFromWindow()
{
	BView::DetachedFromWindow();
}


void
BStatusBar::AllAttached()
{
	BView::AllAttached();
}


void
BStatusBar::AllDetached()
{
	BView::AllDetached();
}


void
BStatusBar::MessageReceived(BMessage* message)
{
	switch (message->what) {
		case B_UPDATE_STATUS_BAR: {
			float delta = 0;
			const char* text = NULL;
			const char* trailingText = NULL;
			message->FindFloat("delta", &delta);
			if (message->FindString("text", &text) != B_OK)
				text = NULL;
			if (message->FindString("trailing_text", &trailingText) != B_OK)
				trailingText = NULL;
			Update(delta, text, trailingText);
			break;
		}

		case B_RESET_STATUS_BAR: {
			const char* label = NULL;
			const char* trailingLabel = NULL;
			if (message->FindString("label", &label) != B_OK)
				label = NULL;
			if (message->FindString("trailing_label", &trailingLabel) != B_OK)
				trailingLabel = NULL;
			Reset(label, trailingLabel);
			break;
		}

		default:
			BView::MessageReceived(message);
			break;
	}
}


void
BStatusBar::MouseDown(BPoint where)
{
	BView::MouseDown(where);
}


void
BStatusBar::MouseUp(BPoint where)
{
	BView::MouseUp(where);
}


void
BStatusBar::MouseMoved(BPoint where, uint32 transit, const BMessage* dragMessage)
{
	BView::MouseMoved(where, transit, dragMessage);
}


void
BStatusBar::MakeFocus(bool focused)
{
	BView::MakeFocus(focused);
}


void
BStatusBar::FrameMoved(BPoint newPosition)
{
	BView::FrameMoved(newPosition);
}


void
BStatusBar::FrameResized(float newWidth, float newHeight)
{
	// The filled part and the trailing texts move with the right edge.
	Invalidate();
	BView::FrameResized(newWidth, newHeight);
}


void
BStatusBar::WindowActivated(bool active)
{
	BView::WindowActivated(active);
}


void
BStatusBar::GetPreferredSize(float* _width, float* _height)
{
	if (_width != NULL) {
		float texts = 2 * kTextInset;
		for (const std::string* text : { &fLabel, &fText, &fTrailingText, &fTrailingLabel }) {
			if (!text->empty())
				texts += BPrivate::label_width(this, text->c_str()) + kTextGap;
		}
		*_width = std::max(Bounds().Width(), texts);
	}
	if (_height != NULL)
		*_height = _TextHeight() + fBarHeight;
}


void
BStatusBar::ResizeToPreferred()
{
	BView::ResizeToPreferred();
}


// #pragma mark - drawing


float
BStatusBar::_TextHeight() const
{
	return LabelMetrics(this).textHeight + kTextPadding;
}


// The bar with its border.
BRect
BStatusBar::_BarFrame() const
{
	const BRect bounds = Bounds();
	const float top = _TextHeight();
	return BRect(bounds.left, top, bounds.right, top + fBarHeight);
}


// The last filled column; one before the inside of the bar when nothing is filled.
float
BStatusBar::_FillRight(float value) const
{
	BRect inside = _BarFrame();
	inside.InsetBy(kBarBorder, kBarBorder);
	if (!(fMax > 0) || !(value > 0))
		return inside.left - 1;
	const float part = std::min(value / fMax, 1.0f);
	return inside.left - 1 + std::ceil(part * (inside.Width() + 1));
}


void
BStatusBar::Draw(BRect updateRect)
{
	if (updateRect.top < _TextHeight())
		_DrawTexts();
	_DrawBar();
}


void
BStatusBar::_DrawTexts()
{
	const LabelMetrics metrics(this);
	const float baseline = metrics.ascent + 1;

	float left = kTextInset;
	for (const std::string* text : { &fLabel, &fText }) {
		if (text->empty())
			continue;
		DrawString(text->c_str(), BPoint(left, baseline));
		left += BPrivate::label_width(this, text->c_str()) + kTextGap;
	}

	float right = Bounds().right - kTextInset;
	for (const std::string* text : { &fTrailingLabel, &fTrailingText }) {
		if (text->empty())
			continue;
		right -= BPrivate::label_width(this, text->c_str());
		DrawString(text->c_str(), BPoint(right, baseline));
		right -= kTextGap;
	}
}


void
BStatusBar::_DrawBar()
{
	const BRect frame = _BarFrame();
	const float filled = _FillRight(fCurrent);
	Look::DrawProgressBar(this, frame, Look::BaseColor(this), fBarColor, filled);
}
