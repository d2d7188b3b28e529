// BChannelControl: what controls share that have a value for each of several channels.
#pragma once

#include <memory>
#include <string>
#include <vector>

#include <Control.h>


// Channels are counted from 0. Each has a value and limits, 0 and 100 unless they are set; values
// are kept within them. One channel is the current one: its value is the control's. Channels out of
// range give B_BAD_INDEX, missing arrays and limits in the wrong order B_BAD_VALUE, and nothing is
// changed then. Changing a value by a call sends nothing.
class _EXPORT BChannelControl : public BControl {
public:
	BChannelControl(BRect frame, const char* name, const char* label, BMessage* model,
		int32 channelCount = 1, uint32 resizingMode = B_FOLLOW_LEFT | B_FOLLOW_TOP,
		uint32 flags = B_WILL_DRAW);
	BChannelControl(BMessage* archive);
	virtual ~BChannelControl();

	// The labels of single channels are not archived.
	virtual status_t Archive(BMessage* into, bool deep = true) const;

	virtual void Draw(BRect updateRect) = 0;
	virtual void MouseDown(BPoint where) = 0;
	virtual void KeyDown(const char* bytes, int32 numBytes) = 0;

	virtual void FrameResized(float width, float height);
	virtual void SetFont(const BFont* font, uint32 mask = B_FONT_ALL);
	virtual void AttachedToWindow();
	virtual void DetachedFromWindow();
	virtual void ResizeToPreferred();
	virtual void GetPreferredSize(float* _width, float* _height) = 0;
	virtual void MessageReceived(BMessage* message);

	// Of the current channel.
	virtual void SetValue(int32 value);
	virtual status_t SetCurrentChannel(int32 channel);
	int32 CurrentChannel() const;

	virtual int32 CountChannels() const;
	virtual int32 MaxChannelCount() const = 0;
	// B_BAD_VALUE beyond MaxChannelCount(). The channels that remain keep what they have.
	virtual status_t SetChannelCount(int32 channelCount);

	// -1 for a channel out of range.
	int32 ValueFor(int32 channel) const;
	// Returns how many values were stored: as many as there are channels of those.
	virtual int32 GetValue(int32* _values, int32 fromChannel, int32 channelCount) const;
	status_t SetValueFor(int32 channel, int32 value);
	virtual status_t SetValue(int32 fromChannel, int32 channelCount, const int32* values);
	status_t SetAllValue(int32 value);

	// Values beyond new limits are moved to them.
	status_t SetLimitsFor(int32 channel, int32 minimum, int32 maximum);
	status_t GetLimitsFor(int32 channel, int32* _minimum, int32* _maximum) const;
	virtual status_t SetLimitsFor(
		int32 fromChannel, int32 channelCount, const int32* minimum, const int32* maximum);
	virtual status_t GetLimitsFor(
		int32 fromChannel, int32 channelCount, int32* _minimum, int32* _maximum) const;
	// Of all channels; got from the first one.
	status_t SetLimits(int32 minimum, int32 maximum);
	status_t GetLimits(int32* _minimum, int32* _maximum) const;

	virtual BHandler* ResolveSpecifier(
		BMessage* message, int32 index, BMessage* specifier, int32 form, const char* property);
	virtual status_t GetSupportedSuites(BMessage* data);

	// Owned.
	virtual void SetModificationMessage(BMessage* message);
	BMessage* ModificationMessage() const;

	// Adds the int32 "be:current_channel".
	virtual status_t Invoke(BMessage* message = NULL);
	// Adds for each of the channels the int32 "be:channel_value" and the bool "be:channel_changed",
	// which the mask holds, one for each of them; without a mask all have changed. A negative count
	// means all that follow. Without a message the control's own is sent.
	virtual status_t InvokeChannel(BMessage* message = NULL, int32 fromChannel = 0,
		int32 channelCount = -1, const bool* mask = NULL);
	status_t InvokeNotifyChannel(BMessage* message = NULL, uint32 kind = B_CONTROL_INVOKED,
		int32 fromChannel = 0, int32 channelCount = -1, const bool* mask = NULL);

	// Copied. NULL is the same as "", no label.
	virtual status_t SetLimitLabels(const char* minLabel, const char* maxLabel);
	const char* MinLimitLabel() const;
	const char* MaxLimitLabel() const;
	virtual status_t SetLimitLabelsFor(int32 channel, const char* minLabel, const char* maxLabel);
	virtual status_t SetLimitLabelsFor(
		int32 fromChannel, int32 channelCount, const char* minLabel, const char* maxLabel);
	// NULL for a channel that was given none.
	const char* MinLimitLabelFor(int32 channel) const;
	const char* MaxLimitLabelFor(int32 channel) const;
	// Whether the control shows that channels have different limits.
	virtual bool SupportsIndividualLimits() const = 0;

protected:
	// One entry for each channel, valid until the number of channels changes.
	int32* MinLimitList() const { return fMinimums.get(); }
	int32* MaxLimitList() const { return fMaximums.get(); }
	int32* ValueList() const { return fValues.get(); }
	// What every change of values comes to: keeps them within the limits and redraws.
	virtual status_t StuffValues(int32 fromChannel, int32 channelCount, const int32* values);

private:
	friend class BChannelSlider;

	struct LimitLabels {
		bool given = false;
		std::string minimum;
		std::string maximum;
	};

	BChannelControl(const BChannelControl&) = delete;
	BChannelControl& operator=(const BChannelControl&) = delete;

	virtual void _ChannelChanged(int32 channel); // redraws it
	void _SetRoom(int32 channelCount);
	void _ReadArchive(BMessage* archive);
	void _LimitRevived(int32 maximum);
	status_t _CheckRange(int32 fromChannel, int32 channelCount) const;
	int32 _Within(int32 channel, int32 value) const;
	status_t _GetProperty(int32 property, BMessage* reply) const;
	status_t _SetProperty(int32 property, const BMessage* message);

	int32 fChannelCount;
	int32 fCurrentChannel;
	std::unique_ptr<int32[]> fMinimums;
	std::unique_ptr<int32[]> fMaximums;
	std::unique_ptr<int32[]> fValues;
	std::string fMinLabel;
	std::string fMaxLabel;
	std::vector<LimitLabels> fChannelLabels; // no more than there are channels
	std::unique_ptr<BMessage> fModificationMessage;
};
