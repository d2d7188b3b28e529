#include <ChannelControl.h>

#include <algorithm>

#include <Message.h>
#include <PropertyInfo.h>

namespace {

property_info sProperties[] = {
	{ "ChannelCount", { B_GET_PROPERTY, B_SET_PROPERTY }, { B_DIRECT_SPECIFIER }, NULL, 0,
		{ B_INT32_TYPE }, {}, {} },
	{ "CurrentChannel", { B_GET_PROPERTY, B_SET_PROPERTY }, { B_DIRECT_SPECIFIER }, NULL, 0,
		{ B_INT32_TYPE }, {}, {} },
	{ "MaxLimitLabel", { B_GET_PROPERTY, B_SET_PROPERTY }, { B_DIRECT_SPECIFIER }, NULL, 0,
		{ B_STRING_TYPE }, {}, {} },
	{ "MinLimitLabel", { B_GET_PROPERTY, B_SET_PROPERTY }, { B_DIRECT_SPECIFIER }, NULL, 0,
		{ B_STRING_TYPE }, {}, {} },
	{ NULL, {}, {}, NULL, 0, {}, {}, {} },
};

enum { kChannelCount = 0, kCurrentChannel, kMaxLimitLabel, kMinLimitLabel };

constexpr int32 kDefaultMinimum = 0;
constexpr int32 kDefaultMaximum = 100;

} // namespace


BChannelControl::BChannelControl(BRect frame, const char* name, const char* label, BMessage* model,
	int32 channelCount, uint32 resizingMode, uint32 flags) :
	BControl(frame, name, label, model, resizingMode, flags),
	fChannelCount(0), fCurrentChannel(0)
{
	_SetRoom(std::max<int32>(0, channelCount));
}


BChannelControl::BChannelControl(BMessage* archive) :
	BControl(archive), fChannelCount(0), fCurrentChannel(0)
{
	_ReadArchive(archive);
}


BChannelControl::~BChannelControl()
{
}


// #pragma mark - hooks


void
BChannelControl::FrameResized(float width, float height)
{
	BControl::FrameResized(width, height);
}


void
BChannelControl::SetFont(const BFont* font, uint32 mask)
{
	BControl::SetFont(font, mask);
}


void
BChannelControl::AttachedToWindow()
{
	BControl::AttachedToWindow();
}


void
BChannelControl::DetachedFromWindow()
{
	BControl::DetachedFromWindow();
}


void
BChannelControl::ResizeToPreferred()
{
	BControl::ResizeToPreferred();
}


// #pragma mark - channels


void
BChannelControl::_SetRoom(int32 channelCount)
{
	const auto resize = [&](std::unique_ptr<int32[]>& list, int32 value) {
		auto longer = std::make_unique<int32[]>(static_cast<size_t>(channelCount));
		const int32 kept = std::min(channelCount, fChannelCount);
		std::copy_n(list.get(), kept, longer.get());
		std::fill(longer.get() + kept, longer.get() + channelCount, value);
		list = std::move(longer);
	};
	resize(fMinimums, kDefaultMinimum);
	resize(fMaximums, kDefaultMaximum);
	resize(fValues, kDefaultMinimum);
	fChannelCount = channelCount;
	if (fChannelLabels.size() > static_cast<size_t>(channelCount))
		fChannelLabels.resize(static_cast<size_t>(channelCount));
}


int32
BChannelControl::CountChannels() const
{
	return fChannelCount;
}


status_t
BChannelControl::SetChannelCount(int32 channelCount)
{
	if (channelCount < 0 || channelCount > MaxChannelCount())
		return B_BAD_VALUE;
	if (channelCount == fChannelCount)
		return B_OK;

	_SetRoom(channelCount);
	if (fCurrentChannel >= channelCount) {
		fCurrentChannel = std::max<int32>(0, channelCount - 1);
		if (channelCount > 0)
			SetValueNoUpdate(fValues[fCurrentChannel]);
	}
	Invalidate();
	return B_OK;
}


status_t
BChannelControl::SetCurrentChannel(int32 channel)
{
	if (channel < 0 || channel >= fChannelCount)
		return B_BAD_INDEX;
	if (channel == fCurrentChannel)
		return B_OK;
	const int32 before = fCurrentChannel;
	fCurrentChannel = channel;
	SetValueNoUpdate(fValues[channel]);
	_ChannelChanged(before);
	_ChannelChanged(channel);
	return B_OK;
}


int32
BChannelControl::CurrentChannel() const
{
	return fCurrentChannel;
}


void
BChannelControl::_ChannelChanged(int32)
{
	Invalidate();
}


status_t
BChannelControl::_CheckRange(int32 fromChannel, int32 channelCount) const
{
	const bool isRange = fromChannel >= 0 && channelCount >= 0 && fromChannel <= fChannelCount
		&& channelCount <= fChannelCount - fromChannel;
	return isRange ? B_OK : B_BAD_INDEX;
}


// #pragma mark - invocation


status_t
BChannelControl::Invoke(BMessage* message)
{
	if (message == NULL)
		message = Message();
	if (message == NULL)
		return B_BAD_VALUE;
	BMessage copy(*message);
	copy.AddInt32("be:current_channel", fCurrentChannel);
	return BControl::Invoke(&copy);
}


status_t
BChannelControl::InvokeChannel(
	BMessage* message, int32 fromChannel, int32 channelCount, const bool* mask)
{
	if (channelCount < 0 && fromChannel >= 0 && fromChannel <= fChannelCount)
		channelCount = fChannelCount - fromChannel;
	if (const status_t status = _CheckRange(fromChannel, channelCount); status != B_OK)
		return status;
	if (message == NULL)
		message = Message();
	if (message == NULL)
		return B_BAD_VALUE;

	BMessage copy(*message);
	copy.AddInt32("be:current_channel", fCurrentChannel);
	for (int32 i = 0; i < channelCount; i++) {
		copy.AddInt32("be:channel_value", fValues[fromChannel + i]);
		copy.AddBool("be:channel_changed", mask == NULL || mask[i]);
	}
	return BControl::Invoke(&copy);
}


status_t
BChannelControl::InvokeNotifyChannel(
	BMessage* message, uint32 kind, int32 fromChannel, int32 channelCount, const bool* mask)
{
	BeginInvokeNotify(kind);
	const status_t status = InvokeChannel(message, fromChannel, channelCount, mask);
	EndInvokeNotify();
	return status;
}


// #pragma mark - scripting


void
BChannelControl::MessageReceived(BMessage* message)
{
	int32 index;
	BMessage specifier;
	int32 form;
	const char* property;
	const bool asks = message->what == B_GET_PROPERTY || message->what == B_SET_PROPERTY;
	int32 match = -1;
	if (asks && message->GetCurrentSpecifier(&index, &specifier, &form, &property) == B_OK)
		match = BPropertyInfo(sProperties).FindMatch(message, index, &specifier, form, property);
	if (match < 0) {
		BControl::MessageReceived(message);
		return;
	}

	BMessage reply(B_REPLY);
	const status_t status = message->what == B_GET_PROPERTY ? _GetProperty(match, &reply)
															: _SetProperty(match, message);
	reply.AddInt32("error", status);
	message->SendReply(&reply);
}


status_t
BChannelControl::_GetProperty(int32 property, BMessage* reply) const
{
	switch (property) {
		case kChannelCount:
			return reply->AddInt32("result", CountChannels());
		case kCurrentChannel:
			return reply->AddInt32("result", CurrentChannel());
		case kMaxLimitLabel:
			return reply->AddString("result", MaxLimitLabel());
		default:
			return reply->AddString("result", MinLimitLabel());
	}
}


status_t
BChannelControl::_SetProperty(int32 property, const BMessage* message)
{
	if (property == kChannelCount || property == kCurrentChannel) {
		int32 number;
		if (const status_t status = message->FindInt32("data", &number); status != B_OK)
			return status;
		return property == kChannelCount ? SetChannelCount(number) : SetCurrentChannel(number);
	}
	const char* label;
	if (const status_t status = message->FindString("data", &label); status != B_OK)
		return status;
	if (property == kMaxLimitLabel)
		return SetLimitLabels(std::string(fMinLabel).c_str(), label);
	return SetLimitLabels(label, std::string(fMaxLabel).c_str());
}


BHandler*
BChannelControl::ResolveSpecifier(
	BMessage* message, int32 index, BMessage* specifier, int32 form, const char* property)
{
	if (BPropertyInfo(sProperties).FindMatch(message, index, specifier, form, property) >= 0)
		return this;
	return BControl::ResolveSpecifier(message, index, specifier, form, property);
}


status_t
BChannelControl::GetSupportedSuites(BMessage* data)
{
	if (data == NULL)
		return B_BAD_VALUE;
	const status_t status = data->AddString("suites", "suite/vnd.Be-channel-control");
	return status == B_OK ? BControl::GetSupportedSuites(data) : status;
}
