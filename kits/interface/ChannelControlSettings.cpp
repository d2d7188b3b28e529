// The values, limits and labels of channels.
#include <ChannelControl.h>

#include <algorithm>

#include <Message.h>


// #pragma mark - values


// Limits that an archive had in the wrong order limit nothing.
int32
BChannelControl::_Within(int32 channel, int32 value) const
{
	if (fMinimums[channel] > fMaximums[channel])
		return value;
	return std::clamp(value, fMinimums[channel], fMaximums[channel]);
}


void
BChannelControl::SetValue(int32 value)
{
	if (fChannelCount > 0)
		StuffValues(fCurrentChannel, 1, &value);
	else
		BControl::SetValue(value);
}


int32
BChannelControl::ValueFor(int32 channel) const
{
	int32 value;
	return GetValue(&value, channel, 1) == 1 ? value : -1;
}


int32
BChannelControl::GetValue(int32* _values, int32 fromChannel, int32 channelCount) const
{
	if (_values == NULL || fromChannel < 0 || fromChannel >= fChannelCount || channelCount < 0)
		return 0;
	const int32 count = std::min(channelCount, fChannelCount - fromChannel);
	std::copy_n(fValues.get() + fromChannel, count, _values);
	return count;
}


status_t
BChannelControl::SetValueFor(int32 channel, int32 value)
{
	return SetValue(channel, 1, &value);
}


status_t
BChannelControl::SetValue(int32 fromChannel, int32 channelCount, const int32* values)
{
	return StuffValues(fromChannel, channelCount, values);
}


status_t
BChannelControl::SetAllValue(int32 value)
{
	const std::vector<int32> values(static_cast<size_t>(fChannelCount), value);
	return StuffValues(0, fChannelCount, values.data());
}


status_t
BChannelControl::StuffValues(int32 fromChannel, int32 channelCount, const int32* values)
{
	if (values == NULL && channelCount != 0)
		return B_BAD_VALUE;
	if (const status_t status = _CheckRange(fromChannel, channelCount); status != B_OK)
		return status;

	for (int32 i = 0; i < channelCount; i++) {
		const int32 channel = fromChannel + i;
		const int32 value = _Within(channel, values[i]);
		if (channel == fCurrentChannel)
			SetValueNoUpdate(value);
		if (fValues[channel] != value) {
			fValues[channel] = value;
			_ChannelChanged(channel);
		}
	}
	return B_OK;
}


// #pragma mark - limits


status_t
BChannelControl::SetLimitsFor(int32 channel, int32 minimum, int32 maximum)
{
	return SetLimitsFor(channel, 1, &minimum, &maximum);
}


status_t
BChannelControl::GetLimitsFor(int32 channel, int32* _minimum, int32* _maximum) const
{
	return GetLimitsFor(channel, 1, _minimum, _maximum);
}


status_t
BChannelControl::SetLimitsFor(
	int32 fromChannel, int32 channelCount, const int32* minimum, const int32* maximum)
{
	if (minimum == NULL || maximum == NULL)
		return B_BAD_VALUE;
	if (const status_t status = _CheckRange(fromChannel, channelCount); status != B_OK)
		return status;
	for (int32 i = 0; i < channelCount; i++) {
		if (minimum[i] > maximum[i])
			return B_BAD_VALUE;
	}

	for (int32 i = 0; i < channelCount; i++) {
		const int32 channel = fromChannel + i;
		fMinimums[channel] = minimum[i];
		fMaximums[channel] = maximum[i];
		_ChannelChanged(channel);
	}
	const std::vector<int32> values(
		fValues.get() + fromChannel, fValues.get() + fromChannel + channelCount);
	return StuffValues(fromChannel, channelCount, values.data());
}


status_t
BChannelControl::GetLimitsFor(
	int32 fromChannel, int32 channelCount, int32* _minimum, int32* _maximum) const
{
	if (_minimum == NULL || _maximum == NULL)
		return B_BAD_VALUE;
	if (const status_t status = _CheckRange(fromChannel, channelCount); status != B_OK)
		return status;
	std::copy_n(fMinimums.get() + fromChannel, channelCount, _minimum);
	std::copy_n(fMaximums.get() + fromChannel, channelCount, _maximum);
	return B_OK;
}


status_t
BChannelControl::SetLimits(int32 minimum, int32 maximum)
{
	const size_t count = static_cast<size_t>(fChannelCount);
	const std::vector<int32> minimums(count + 1, minimum);
	const std::vector<int32> maximums(count + 1, maximum);
	return SetLimitsFor(0, fChannelCount, minimums.data(), maximums.data());
}


status_t
BChannelControl::GetLimits(int32* _minimum, int32* _maximum) const
{
	return GetLimitsFor(0, _minimum, _maximum);
}


// #pragma mark - labels


status_t
BChannelControl::SetLimitLabels(const char* minLabel, const char* maxLabel)
{
	fMinLabel = minLabel != NULL ? minLabel : "";
	fMaxLabel = maxLabel != NULL ? maxLabel : "";
	Invalidate();
	return B_OK;
}


const char*
BChannelControl::MinLimitLabel() const
{
	return fMinLabel.c_str();
}


const char*
BChannelControl::MaxLimitLabel() const
{
	return fMaxLabel.c_str();
}


status_t
BChannelControl::SetLimitLabelsFor(int32 channel, const char* minLabel, const char* maxLabel)
{
	return SetLimitLabelsFor(channel, 1, minLabel, maxLabel);
}


status_t
BChannelControl::SetLimitLabelsFor(
	int32 fromChannel, int32 channelCount, const char* minLabel, const char* maxLabel)
{
	if (const status_t status = _CheckRange(fromChannel, channelCount); status != B_OK)
		return status;
	const size_t end = static_cast<size_t>(fromChannel) + static_cast<size_t>(channelCount);
	if (fChannelLabels.size() < end)
		fChannelLabels.resize(end);
	for (size_t i = static_cast<size_t>(fromChannel); i < end; i++) {
		fChannelLabels[i] = { true, minLabel != NULL ? minLabel : "",
			maxLabel != NULL ? maxLabel : "" };
	}
	Invalidate();
	return B_OK;
}


const char*
BChannelControl::MinLimitLabelFor(int32 channel) const
{
	const size_t i = static_cast<size_t>(channel);
	const bool has = channel >= 0 && i < fChannelLabels.size() && fChannelLabels[i].given;
	return has ? fChannelLabels[i].minimum.c_str() : NULL;
}


const char*
BChannelControl::MaxLimitLabelFor(int32 channel) const
{
	const size_t i = static_cast<size_t>(channel);
	const bool has = channel >= 0 && i < fChannelLabels.size() && fChannelLabels[i].given;
	return has ? fChannelLabels[i].maximum.c_str() : NULL;
}


// #pragma mark - modification message


void
BChannelControl::SetModificationMessage(BMessage* message)
{
	if (message != fModificationMessage.get())
		fModificationMessage.reset(message);
}


BMessage*
BChannelControl::ModificationMessage() const
{
	return fModificationMessage.get();
}
