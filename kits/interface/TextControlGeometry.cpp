// BTextControl: its parts in their places.
#include "TextControl.h"

#include <algorithm>
#include <cmath>

#include <Message.h>
#include <TextView.h>
#include <Window.h>

#include "interface/private/Look.h"
#include "interface/private/TextControlParts.h"
#include "interface/private/TextInput.h"
#include "interface/private/ViewArchive.h"

using namespace BPrivate;

namespace {

constexpr float kHeightPadding = 4;

} // namespace


void
BTextControl::SetAlignment(alignment labelAlignment, alignment textAlignment)
{
	if (fText != NULL)
		fText->SetAlignment(textAlignment);
	if (fLabelAlignment == labelAlignment)
		return;
	fLabelAlignment = labelAlignment;
	Invalidate();
}


void
BTextControl::GetAlignment(alignment* _label, alignment* _text) const
{
	if (_label != NULL)
		*_label = fLabelAlignment;
	if (_text != NULL)
		*_text = fText != NULL ? fText->Alignment() : B_ALIGN_LEFT;
}


void
BTextControl::SetDivider(float position)
{
	fDivider = std::floor(position + 0.5f);
	_LayOutInput();
	Invalidate();
}


float
BTextControl::Divider() const
{
	return fDivider;
}


BRect
BTextControl::_InputFrame() const
{
	BRect frame = Bounds();
	frame.OffsetTo(B_ORIGIN);
	frame.left = fDivider;
	frame.InsetBy(kTextControlFrame, kTextControlFrame);
	return frame;
}


void
BTextControl::_LayOutInput()
{
	if (fText == NULL)
		return;
	const BRect frame = _InputFrame();
	fText->MoveTo(frame.LeftTop());
	fText->ResizeTo(frame.Width(), frame.Height());
	if (_BTextInput_* input = dynamic_cast<_BTextInput_*>(fText))
		input->AlignTextRect();
}


float
BTextControl::_MinimalHeight() const
{
	font_height height;
	GetFontHeight(&height);
	return std::ceil(height.ascent + height.descent + height.leading) + kHeightPadding;
}


void
BTextControl::_RaiseHeight()
{
	const float height = _MinimalHeight();
	if (Bounds().Height() < height)
		ResizeTo(Bounds().Width(), height);
}


float
BTextControl::_LabelWidth() const
{
	return Label() != NULL ? std::ceil(StringWidth(Label())) : 0;
}


void
BTextControl::GetPreferredSize(float* _width, float* _height)
{
	BFont font;
	GetFont(&font);
	font_height height;
	font.GetHeight(&height);
	if (_width != NULL) {
		const float line = std::ceil(height.ascent + height.descent + height.leading + 2);
		const float field = 3 * line + 2 * kTextControlFrame;
		if (Label() != NULL) {
			*_width = std::max(fDivider, _LabelWidth() + std::ceil(font.Size() / 2)) + field;
		} else {
			*_width = std::max(Bounds().Width(), field);
		}
	}
	if (_height != NULL)
		*_height = _MinimalHeight();
}


void
BTextControl::ResizeToPreferred()
{
	BView::ResizeToPreferred();
	SetDivider(Label() != NULL ? _LabelWidth() + kTextControlLabelGap : 0);
}


void
BTextControl::FrameMoved(BPoint newPosition)
{
	BControl::FrameMoved(newPosition);
}


// The field follows by itself; the frame round it and the label are drawn anew.
void
BTextControl::FrameResized(float width, float height)
{
	BControl::FrameResized(width, height);
	BRect dirty = Bounds();
	if (fText != NULL)
		dirty.left = fText->Frame().left - kTextControlFrame;
	Invalidate(dirty);
}
