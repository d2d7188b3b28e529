#include <ChannelSlider.h>

#include <algorithm>
#include <cmath>
#include <limits>

#include <Message.h>
#include <Window.h>

#include "interface/private/EventModifiers.h"
#include "interface/private/ViewArchive.h"

namespace {

constexpr int32 kMaxChannels = 32;

int32
Clamped(int64 value)
{
	typedef std::numeric_limits<int32> Limits;
	return static_cast<int32>(std::clamp<int64>(value, Limits::min(), Limits::max()));
}

} // namespace


BChannelSlider::BChannelSlider(BRect frame, const char* name, const char* label, BMessage* message,
	int32 channelCount, uint32 resizingMode, uint32 flags) :
	BChannelSlider(frame, name, label, message, B_HORIZONTAL, channelCount, resizingMode, flags)
{
}


BChannelSlider::BChannelSlider(BRect frame, const char* name, const char* label, BMessage* message,
	orientation posture, int32 channelCount, uint32 resizingMode, uint32 flags) :
	BChannelControl(frame, name, label, message, std::min(channelCount, kMaxChannels), resizingMode,
		flags | B_FRAME_EVENTS),
	fOrientation(posture), fMovesAll(false), fKeyIsDown(false)
{
}


BChannelSlider::BChannelSlider(BMessage* archive) :
	BChannelControl(archive), fOrientation(B_HORIZONTAL), fMovesAll(false), fKeyIsDown(false)
{
	_LimitRevived(kMaxChannels);
	BPrivate::force_flags(this, B_FRAME_EVENTS);
	int32 number;
	if (archive->FindInt32("_orient", &number) == B_OK)
		fOrientation = number;
}


BChannelSlider::~BChannelSlider()
{
}


BArchivable*
BChannelSlider::Instantiate(BMessage* archive)
{
	return validate_instantiation(archive, "BChannelSlider") ? new BChannelSlider(archive) : NULL;
}


status_t
BChannelSlider::Archive(BMessage* archive, bool deep) const
{
	const status_t status = BChannelControl::Archive(archive, deep);
	if (status != B_OK)
		return status;
	BPrivate::ArchiveWriter writer(archive);
	writer.Int32("_orient", fOrientation, B_HORIZONTAL);
	return writer.Status();
}


// #pragma mark - hooks


void
BChannelSlider::AttachedToWindow()
{
	BChannelControl::AttachedToWindow();
}


void
BChannelSlider::AllAttached()
{
	BChannelControl::AllAttached();
}


void
BChannelSlider::DetachedFromWindow()
{
	fKeyIsDown = false;
	BChannelControl::DetachedFromWindow();
}


void
BChannelSlider::AllDetached()
{
	BChannelControl::AllDetached();
}


void
BChannelSlider::MessageReceived(BMessage* message)
{
	BChannelControl::MessageReceived(message);
}


void
BChannelSlider::WindowActivated(bool active)
{
	BChannelControl::WindowActivated(active);
}


void
BChannelSlider::FrameResized(float width, float height)
{
	Invalidate();
	BChannelControl::FrameResized(width, height);
}


void
BChannelSlider::SetFont(const BFont* font, uint32 mask)
{
	BChannelControl::SetFont(font, mask);
	Invalidate();
}


void
BChannelSlider::MakeFocus(bool focused)
{
	BChannelControl::MakeFocus(focused);
}


void
BChannelSlider::SetEnabled(bool enabled)
{
	BChannelControl::SetEnabled(enabled);
}


BHandler*
BChannelSlider::ResolveSpecifier(
	BMessage* message, int32 index, BMessage* specifier, int32 form, const char* property)
{
	return BChannelControl::ResolveSpecifier(message, index, specifier, form, property);
}


status_t
BChannelSlider::GetSupportedSuites(BMessage* data)
{
	return BChannelControl::GetSupportedSuites(data);
}


int32
BChannelSlider::MaxChannelCount() const
{
	return kMaxChannels;
}


bool
BChannelSlider::SupportsIndividualLimits() const
{
	return false;
}


orientation
BChannelSlider::Orientation() const
{
	return _IsVertical() ? B_VERTICAL : B_HORIZONTAL;
}


void
BChannelSlider::SetOrientation(orientation posture)
{
	if (posture == Orientation())
		return;
	fOrientation = posture;
	Invalidate();
}


// #pragma mark - mouse


void
BChannelSlider::MouseDown(BPoint where)
{
	if (!IsEnabled() || IsTracking() || Window() == NULL)
		return;
	const int32 channel = _ChannelAt(where);
	if (channel < 0)
		return;

	int32 buttons = B_PRIMARY_MOUSE_BUTTON;
	if (const BMessage* message = Window()->CurrentMessage())
		message->FindInt32("buttons", &buttons);
	if (fKeyIsDown)
		_EndChange();
	SetCurrentChannel(channel);
	_BeginChange((buttons & B_SECONDARY_MOUSE_BUTTON) == 0);
	SetTracking(true);
	SetMouseEventMask(B_POINTER_EVENTS, B_LOCK_WINDOW_FOCUS | B_NO_POINTER_HISTORY);
	Invalidate();

	// A thumb stays below the pointer where it was taken; beside it, it comes there.
	BRect thumb = ThumbFrameFor(channel);
	const float delta = ThumbDeltaFor(channel);
	thumb.OffsetBy(_IsVertical() ? 0 : delta, _IsVertical() ? delta : 0);
	const BPoint middle(
		std::floor((thumb.left + thumb.right) / 2), std::floor((thumb.top + thumb.bottom) / 2));
	fGrabbed = thumb.Contains(where) ? where - middle : BPoint(0, 0);
	if (!thumb.Contains(where))
		_ChangeTo(_ValueAt(where, channel));
}


void
BChannelSlider::MouseMoved(BPoint where, uint32 transit, const BMessage* dragMessage)
{
	if (IsTracking() && CountChannels() > 0)
		_ChangeTo(_ValueAt(where, CurrentChannel()));
	else
		BChannelControl::MouseMoved(where, transit, dragMessage);
}


void
BChannelSlider::MouseUp(BPoint where)
{
	if (!IsTracking()) {
		BChannelControl::MouseUp(where);
		return;
	}
	SetTracking(false);
	Invalidate();
	_EndChange();
}


// #pragma mark - keys


void
BChannelSlider::KeyDown(const char* bytes, int32 numBytes)
{
	const bool usable = IsEnabled() && !IsTracking() && numBytes == 1 && CountChannels() > 0;
	const char key = usable ? bytes[0] : '\0';
	const bool vertical = _IsVertical();
	const int32 channel = CurrentChannel();

	int64 value = ValueFor(channel);
	if (key == (vertical ? B_UP_ARROW : B_RIGHT_ARROW))
		value++;
	else if (key == (vertical ? B_DOWN_ARROW : B_LEFT_ARROW))
		value--;
	else if (key == B_HOME)
		value = MinLimitList()[channel];
	else if (key == B_END)
		value = MaxLimitList()[channel];
	else if (key == (vertical ? B_LEFT_ARROW : B_UP_ARROW)) {
		SetCurrentChannel(std::max<int32>(channel - 1, 0));
		return;
	} else if (key == (vertical ? B_RIGHT_ARROW : B_DOWN_ARROW)) {
		SetCurrentChannel(std::min(channel + 1, CountChannels() - 1));
		return;
	} else {
		// Not BControl's: Space and Enter have no other value to switch to.
		BView::KeyDown(bytes, numBytes);
		return;
	}

	const bool all = (BPrivate::event_modifiers(*this) & B_SHIFT_KEY) != 0;
	if (fKeyIsDown && all != fMovesAll)
		_EndChange();
	if (!fKeyIsDown)
		_BeginChange(all);
	fKeyIsDown = true;
	_ChangeTo(value);
}


void
BChannelSlider::KeyUp(const char* bytes, int32 numBytes)
{
	BChannelControl::KeyUp(bytes, numBytes);
	if (fKeyIsDown)
		_EndChange();
}


// #pragma mark - changes by the user


std::vector<int32>
BChannelSlider::_Values() const
{
	return std::vector<int32>(ValueList(), ValueList() + CountChannels());
}


void
BChannelSlider::_BeginChange(bool all)
{
	fMovesAll = all;
	fValuesBefore = _Values();
}


// Of the current channel. Others that move with it keep their distance as far as limits allow.
void
BChannelSlider::_ChangeTo(int64 value)
{
	const int32 channel = CurrentChannel();
	std::vector<int32> values = _Values();
	// The program may have changed the number of channels meanwhile.
	if (fValuesBefore.size() != values.size())
		fValuesBefore = values;
	const std::vector<int32> before = values;

	const int32 minimum = MinLimitList()[channel];
	const int32 maximum = MaxLimitList()[channel];
	if (minimum <= maximum)
		value = std::clamp<int64>(value, minimum, maximum);
	if (fMovesAll) {
		const int64 delta = value - fValuesBefore[static_cast<size_t>(channel)];
		for (size_t i = 0; i < values.size(); i++)
			values[i] = Clamped(fValuesBefore[i] + delta);
		SetValue(0, CountChannels(), values.data());
	} else {
		SetValueFor(channel, Clamped(value));
	}
	if (ModificationMessage() != NULL)
		_Report(ModificationMessage(), B_CONTROL_MODIFIED, before);
}


void
BChannelSlider::_EndChange()
{
	fKeyIsDown = false;
	_Report(NULL, B_CONTROL_INVOKED, fValuesBefore);
}


// Says which channels have changed since; nothing when none has.
void
BChannelSlider::_Report(BMessage* message, uint32 kind, const std::vector<int32>& before)
{
	const std::vector<int32> values = _Values();
	if (values.size() != before.size() || values == before)
		return;
	const auto changed = std::make_unique<bool[]>(values.size());
	for (size_t i = 0; i < values.size(); i++)
		changed[i] = values[i] != before[i];
	InvokeNotifyChannel(message, kind, 0, CountChannels(), changed.get());
}
