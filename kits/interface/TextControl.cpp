#include "TextControl.h"

#include <algorithm>
#include <cmath>

#include <Message.h>
#include <TextView.h>
#include <Window.h>

#include "interface/private/InnerChild.h"
#include "interface/private/Look.h"
#include "interface/private/TextControlParts.h"
#include "interface/private/TextInput.h"
#include "interface/private/ViewArchive.h"

using namespace BPrivate;

namespace {

constexpr const char* kInputName = "_input_";

constexpr rgb_color kWhite = { 255, 255, 255, 255 };

} // namespace


BTextControl::BTextControl(BRect frame, const char* name, const char* label, const char* text,
	BMessage* message, uint32 resizingMode, uint32 flags) :
	BControl(frame, name, label, message, resizingMode, flags | B_FRAME_EVENTS)
{
	_Init();
	SetFont(be_plain_font);
	fDivider = label != NULL ? std::floor(frame.Width() / 2) : 0;
	_RaiseHeight();
	_CreateInput(flags & B_NAVIGABLE);
	BView::SetFlags(Flags() & ~B_NAVIGABLE);
	if (text != NULL && text[0] != '\0')
		fText->SetText(text);
	fCommittedText = fText->Text();
}


BTextControl::BTextControl(BMessage* archive) : BControl(archive)
{
	_Init();
	int32 number;
	fLabelAlignment =
		archive->FindInt32("_a_label", &number) == B_OK ? alignment(number) : B_ALIGN_LEFT;
	const bool hasTextAlignment = archive->FindInt32("_a_text", &number) == B_OK;
	if (archive->FindFloat("_divide", &fDivider) != B_OK)
		fDivider = Label() != NULL ? std::floor(Bounds().Width() / 2) : 0;
	BMessage modification;
	if (archive->FindMessage("_mod_msg", &modification) == B_OK)
		fModificationMessage = new BMessage(modification);

	BView* input = BPrivate::inner_child(this, kInputName);
	if (input == NULL) {
		_CreateInput(Flags() & B_NAVIGABLE);
		_ShowEnabled();
	} else {
		fText = dynamic_cast<BTextView*>(input);
	}
	if (fText != NULL) {
		if (hasTextAlignment)
			fText->SetAlignment(alignment(number));
		fCommittedText = fText->Text();
	}
}


BTextControl::~BTextControl()
{
	delete fModificationMessage;
}


void
BTextControl::_Init()
{
	fText = NULL;
	fModificationMessage = NULL;
	fLabelAlignment = B_ALIGN_LEFT;
	fDivider = 0;
	fInputWasNavigable = true;
}


BArchivable*
BTextControl::Instantiate(BMessage* archive)
{
	return validate_instantiation(archive, "BTextControl") ? new BTextControl(archive) : NULL;
}


status_t
BTextControl::Archive(BMessage* archive, bool deep) const
{
	const status_t status = BControl::Archive(archive, deep);
	if (status != B_OK)
		return status;

	ArchiveWriter writer(archive);
	writer.Int32("_a_label", fLabelAlignment, B_ALIGN_LEFT);
	writer.Int32("_a_text", fText != NULL ? fText->Alignment() : B_ALIGN_LEFT, B_ALIGN_LEFT);
	const float absent = Label() != NULL ? std::floor(Bounds().Width() / 2) : 0;
	writer.Float("_divide", fDivider, absent);
	writer.Message("_mod_msg", fModificationMessage);
	return writer.Status();
}


void
BTextControl::_CreateInput(uint32 flags)
{
	const BRect frame = _InputFrame();
	_BTextInput_* input = new _BTextInput_(
		frame, frame.OffsetToCopy(B_ORIGIN), B_FOLLOW_ALL, B_WILL_DRAW | B_FRAME_EVENTS | flags);
	fText = input;
	AddChild(input);
	input->AlignTextRect();
}


// #pragma mark - text


void
BTextControl::SetText(const char* text)
{
	if (InvokeKind() != B_CONTROL_INVOKED || fText == NULL)
		return;
	fText->SetText(text != NULL ? text : "");
	fCommittedText = fText->Text();
	if (fText->IsFocus())
		fText->SelectAll();
}


const char*
BTextControl::Text() const
{
	return fText != NULL ? fText->Text() : "";
}


void
BTextControl::SetValue(int32)
{
}


status_t
BTextControl::Invoke(BMessage* message)
{
	return BControl::Invoke(message);
}


BTextView*
BTextControl::TextView() const
{
	return fText;
}


void
BTextControl::SetModificationMessage(BMessage* message)
{
	if (message == fModificationMessage)
		return;
	delete fModificationMessage;
	fModificationMessage = message;
}


BMessage*
BTextControl::ModificationMessage() const
{
	return fModificationMessage;
}


// Invokes if the text is not what it was; remembers it first, as the target may set it again.
void
BTextControl::_CommitText()
{
	const std::string text = Text();
	if (text == fCommittedText)
		return;
	fCommittedText = text;
	Invoke();
}


void
BTextControl::_SendModification()
{
	if (fModificationMessage != NULL)
		InvokeNotify(fModificationMessage, B_CONTROL_MODIFIED);
}


// #pragma mark - hooks


void
BTextControl::Draw(BRect updateRect)
{
	if (fText == NULL)
		return;
	const bool enabled = IsEnabled();
	const bool focused = fText->IsFocus() && Window()->IsActive();
	uint32 state = enabled ? Look::kNormal : Look::kDisabled;
	if (focused)
		state |= Look::kFocused;
	const BRect field = fText->Frame();
	Look::DrawFieldFrame(this, field.InsetByCopy(-kTextControlFrame, -kTextControlFrame),
		Look::BaseColor(this), state);

	if (Label() == NULL)
		return;
	// On the baseline of the text.
	BFont font;
	fText->GetFontAndColor(0, &font);
	font_height height;
	font.GetHeight(&height);
	const float baseline = field.top + fText->TextRect().top + std::ceil(height.ascent);
	const float width = StringWidth(Label());
	float x = 0;
	if (fLabelAlignment == B_ALIGN_RIGHT)
		x = fDivider - width - kTextControlLabelGap;
	else if (fLabelAlignment == B_ALIGN_CENTER)
		x = (fDivider - width) / 2;
	PushState();
	SetDrawingMode(B_OP_OVER);
	SetHighColor(Look::TextColor(state));
	DrawString(Label(), BPoint(std::max(0.0f, std::floor(x)), baseline));
	PopState();
}


void
BTextControl::AttachedToWindow()
{
	BControl::AttachedToWindow();
	if (is_revived(this))
		return;
	const float height = Bounds().Height();
	_RaiseHeight();
	if (Bounds().Height() != height)
		_LayOutInput();
}


void
BTextControl::MakeFocus(bool focus)
{
	if (fText == NULL) {
		BControl::MakeFocus(focus);
		return;
	}
	if (focus == fText->IsFocus())
		return;
	fText->MakeFocus(focus);
}


void
BTextControl::_InputFocusChanged()
{
	if (fText != NULL)
		Invalidate(fText->Frame().InsetByCopy(-kTextControlFrame, -kTextControlFrame));
}


void
BTextControl::SetEnabled(bool enabled)
{
	if (IsEnabled() == enabled)
		return;
	if (!enabled && fText != NULL)
		fInputWasNavigable = (fText->Flags() & B_NAVIGABLE) != 0;
	BControl::SetEnabled(enabled);
	if (fText != NULL && enabled && fInputWasNavigable)
		fText->SetFlags(fText->Flags() | B_NAVIGABLE);
	else if (fText != NULL)
		fText->SetFlags(fText->Flags() & ~B_NAVIGABLE);
	_ShowEnabled();
	if (fText != NULL)
		fText->MakeEditable(enabled);
}


void
BTextControl::_ShowEnabled()
{
	if (fText == NULL)
		return;
	const rgb_color color = IsEnabled() ? kWhite : tint_color(Look::PanelColor(), B_LIGHTEN_2_TINT);
	fText->SetViewColor(color);
	fText->SetLowColor(color);
	if (_BTextInput_* input = dynamic_cast<_BTextInput_*>(fText))
		input->SetFaded(!IsEnabled());
	fText->Invalidate();
}


// The field takes part in the keyboard's navigation, the control itself does not.
void
BTextControl::SetFlags(uint32 flags)
{
	if (fText != NULL) {
		const uint32 others = fText->Flags() & ~B_NAVIGABLE;
		fText->SetFlags(others | (flags & B_NAVIGABLE));
		flags &= ~B_NAVIGABLE;
	}
	BControl::SetFlags(flags);
}


// A press beside the field, as on the label, is meant for it.
void
BTextControl::MouseDown(BPoint where)
{
	if (fText != NULL && IsEnabled() && !fText->IsFocus())
		fText->MakeFocus(true);
	else
		BControl::MouseDown(where);
}


void
BTextControl::MouseUp(BPoint where)
{
	BControl::MouseUp(where);
}


void
BTextControl::MouseMoved(BPoint where, uint32 transit, const BMessage* message)
{
	BControl::MouseMoved(where, transit, message);
}


void
BTextControl::WindowActivated(bool active)
{
	BControl::WindowActivated(active);
}


void
BTextControl::DetachedFromWindow()
{
	BControl::DetachedFromWindow();
}


void
BTextControl::AllAttached()
{
	BControl::AllAttached();
}


void
BTextControl::AllDetached()
{
	BControl::AllDetached();
}


void
BTextControl::MessageReceived(BMessage* message)
{
	BControl::MessageReceived(message);
}


BHandler*
BTextControl::ResolveSpecifier(
	BMessage* message, int32 index, BMessage* specifier, int32 form, const char* property)
{
	return BControl::ResolveSpecifier(message, index, specifier, form, property);
}


status_t
BTextControl::GetSupportedSuites(BMessage* data)
{
	return BControl::GetSupportedSuites(data);
}


status_t
BTextControl::Perform(perform_code code, void* data)
{
	return BControl::Perform(code, data);
}
