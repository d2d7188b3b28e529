#include <Control.h>

#include <Message.h>
#include <Messenger.h>
#include <PropertyInfo.h>
#include <Window.h>

#include "interface/private/ControlArchive.h"
#include "interface/private/Look.h"
#include "interface/private/ViewArchive.h"

using BPrivate::ArchiveWriter;
using BPrivate::is_revived;

namespace {

property_info sProperties[] = {
	{ "Enabled", { B_GET_PROPERTY, B_SET_PROPERTY }, { B_DIRECT_SPECIFIER }, NULL, 0,
		{ B_BOOL_TYPE }, {}, {} },
	{ "Label", { B_GET_PROPERTY, B_SET_PROPERTY }, { B_DIRECT_SPECIFIER }, NULL, 0,
		{ B_STRING_TYPE }, {}, {} },
	{ "Value", { B_GET_PROPERTY, B_SET_PROPERTY }, { B_DIRECT_SPECIFIER }, NULL, 0,
		{ B_INT32_TYPE }, {}, {} },
	{ NULL, {}, {}, NULL, 0, {}, {}, {} },
};

enum { kEnabledProperty = 0, kLabelProperty, kValueProperty };

} // namespace


BControl::BControl(BRect frame, const char* name, const char* label, BMessage* message,
	uint32 resizingMode, uint32 flags) :
	BView(frame, name, resizingMode, flags),
	BInvoker(message, NULL), fLabel(label != NULL ? label : ""), fValue(B_CONTROL_OFF),
	fEnabled(true), fFocusChanging(false), fTracking(false),
	fWantsNavigation((flags & B_NAVIGABLE) != 0)
{
}


BControl::BControl(BMessage* archive) :
	BView(archive), fLabel(BPrivate::read_text(archive, "_label")), fValue(B_CONTROL_OFF),
	fEnabled(true), fFocusChanging(false), fTracking(false),
	fWantsNavigation((Flags() & B_NAVIGABLE) != 0)
{
	BMessage message;
	if (archive->FindMessage("_msg", &message) == B_OK)
		SetMessage(new BMessage(message));

	// Not SetValue(): what a derived class does there is not asked for while reading.
	int32 value;
	if (archive->FindInt32("_val", &value) == B_OK)
		fValue = value;
	bool disabled;
	if (archive->FindBool("_disable", &disabled) == B_OK)
		fEnabled = !disabled;
	bool wantsNavigation;
	if (archive->FindBool("be:wants_nav", &wantsNavigation) == B_OK)
		fWantsNavigation = wantsNavigation;
}


BControl::~BControl()
{
	SetMessage(NULL);
}


BArchivable*
BControl::Instantiate(BMessage* archive)
{
	return validate_instantiation(archive, "BControl") ? new BControl(archive) : NULL;
}


status_t
BControl::Archive(BMessage* archive, bool deep) const
{
	const status_t status = BView::Archive(archive, deep);
	if (status != B_OK)
		return status;

	ArchiveWriter writer(archive);
	writer.Message("_msg", Message());
	BPrivate::write_text(writer, archive, "_label", fLabel);
	writer.Int32("_val", fValue, B_CONTROL_OFF, fValue != B_CONTROL_OFF);
	writer.Bool("_disable", !fEnabled, false, !fEnabled);
	// Without the field the flags answer, which a disabled control has no longer. An enabled one
	// need not say what its flags say.
	const bool navigable = (Flags() & B_NAVIGABLE) != 0;
	bool said;
	if (writer.Source().FindBool("be:wants_nav", &said) != B_OK)
		said = fEnabled ? fWantsNavigation : navigable;
	const bool kept = writer.Keep("be:wants_nav", said == fWantsNavigation);
	if (!kept && !fEnabled && fWantsNavigation != navigable)
		archive->AddBool("be:wants_nav", fWantsNavigation);
	return writer.Status();
}


// #pragma mark - hooks


void
BControl::AttachedToWindow()
{
	if (!is_revived(this)) {
		const rgb_color color = BPrivate::Look::ColorOfParent(this);
		SetViewColor(color);
		SetLowColor(color);
	}

	BView::AttachedToWindow();

	if (!Messenger().IsValid())
		SetTarget(Window());
}


void
BControl::AllAttached()
{
	BView::AllAttached();
}


void
BControl::DetachedFromWindow()
{
	SetTracking(false);
	BView::DetachedFromWindow();
}


void
BControl::AllDetached()
{
	BView::AllDetached();
}


void
BControl::WindowActivated(bool active)
{
	BView::WindowActivated(active);
	// The focus is shown only in the active window.
	if (IsFocus())
		Invalidate();
}


void
BControl::MessageReceived(BMessage* message)
{
	if (message->what == B_GET_PROPERTY || message->what == B_SET_PROPERTY) {
		if (_HandleProperty(message))
			return;
	}
	BView::MessageReceived(message);
}


bool
BControl::_HandleProperty(BMessage* message)
{
	int32 index;
	BMessage specifier;
	int32 form;
	const char* property;
	if (message->GetCurrentSpecifier(&index, &specifier, &form, &property) != B_OK)
		return false;
	const int32 match =
		BPropertyInfo(sProperties).FindMatch(message, index, &specifier, form, property);
	if (match < 0)
		return false;

	BMessage reply(B_REPLY);
	status_t status = B_OK;
	if (message->what == B_GET_PROPERTY) {
		if (match == kEnabledProperty)
			status = reply.AddBool("result", IsEnabled());
		else if (match == kLabelProperty)
			status = reply.AddString("result", fLabel.c_str());
		else
			status = reply.AddInt32("result", Value());
	} else if (match == kEnabledProperty) {
		bool enabled;
		status = message->FindBool("data", &enabled);
		if (status == B_OK)
			SetEnabled(enabled);
	} else if (match == kLabelProperty) {
		const char* label;
		status = message->FindString("data", &label);
		if (status == B_OK)
			SetLabel(label);
	} else if (match == kValueProperty) {
		int32 value;
		status = message->FindInt32("data", &value);
		if (status == B_OK)
			SetValue(value);
	}
	reply.AddInt32("error", status);
	message->SendReply(&reply);
	return true;
}


void
BControl::MakeFocus(bool focused)
{
	if (focused == IsFocus())
		return;

	fFocusChanging = true;
	BView::MakeFocus(focused);
	Invalidate();
	fFocusChanging = false;
}


void
BControl::KeyDown(const char* bytes, int32 numBytes)
{
	if (IsEnabled() && numBytes == 1 && (bytes[0] == B_SPACE || bytes[0] == B_ENTER)) {
		SetValue(Value() != B_CONTROL_OFF ? B_CONTROL_OFF : B_CONTROL_ON);
		Invoke();
		return;
	}
	BView::KeyDown(bytes, numBytes);
}


void
BControl::MouseDown(BPoint where)
{
	BView::MouseDown(where);
}


void
BControl::MouseUp(BPoint where)
{
	BView::MouseUp(where);
}


void
BControl::MouseMoved(BPoint where, uint32 transit, const BMessage* dragMessage)
{
	BView::MouseMoved(where, transit, dragMessage);
}


// #pragma mark - properties


void
BControl::SetLabel(const char* label)
{
	if (label == NULL)
		label = "";
	if (fLabel == label)
		return;
	fLabel = label;
	Invalidate();
}


const char*
BControl::Label() const
{
	return fLabel.empty() ? NULL : fLabel.c_str();
}


void
BControl::SetValue(int32 value)
{
	if (value == fValue)
		return;
	fValue = value;
	Invalidate();
}


void
BControl::SetValueNoUpdate(int32 value)
{
	fValue = value;
}


int32
BControl::Value() const
{
	return fValue;
}


void
BControl::SetEnabled(bool enabled)
{
	if (enabled == fEnabled)
		return;
	fEnabled = enabled;

	if (enabled) {
		if (fWantsNavigation)
			SetFlags(Flags() | B_NAVIGABLE);
	} else {
		fWantsNavigation = (Flags() & B_NAVIGABLE) != 0;
		SetFlags(Flags() & ~B_NAVIGABLE);
	}
	Invalidate();
}


bool
BControl::IsEnabled() const
{
	return fEnabled;
}


void
BControl::GetPreferredSize(float* _width, float* _height)
{
	BView::GetPreferredSize(_width, _height);
}


void
BControl::ResizeToPreferred()
{
	BView::ResizeToPreferred();
}


bool
BControl::IsFocusChanging() const
{
	return fFocusChanging;
}


bool
BControl::IsTracking() const
{
	return fTracking;
}


void
BControl::SetTracking(bool tracking)
{
	fTracking = tracking;
}


// #pragma mark - invocation and scripting


status_t
BControl::Invoke(BMessage* message)
{
	if (message == NULL)
		message = Message();
	if (message == NULL)
		return B_BAD_VALUE;

	BMessage copy(*message);
	copy.AddInt64("when", static_cast<int64>(system_time()));
	copy.AddPointer("source", this);
	copy.AddInt32("be:value", fValue);
	copy.AddMessenger("be:sender", BMessenger(this));
	return BInvoker::Invoke(&copy);
}


BHandler*
BControl::ResolveSpecifier(
	BMessage* message, int32 index, BMessage* specifier, int32 what, const char* property)
{
	const BPropertyInfo info(sProperties);
	if (info.FindMatch(message, index, specifier, what, property) >= 0)
		return this;
	return BView::ResolveSpecifier(message, index, specifier, what, property);
}


status_t
BControl::GetSupportedSuites(BMessage* message)
{
	const status_t status = message->AddString("suites", "suite/vnd.Be-control");
	return status == B_OK ? BView::GetSupportedSuites(message) : status;
}


status_t
BControl::Perform(perform_code code, void* data)
{
	return BView::Perform(code, data);
}
