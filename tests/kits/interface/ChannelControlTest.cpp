#include <ChannelControl.h>

#include <string>
#include <vector>

#include "ControlFixture.h"

namespace {

constexpr uint32 kInvoked = 'invk';

// Four channels at most, and nothing to see.
class PlainChannels : public BChannelControl {
public:
	explicit PlainChannels(int32 count = 3) :
		BChannelControl(BRect(10, 10, 99, 39), "channels", "Label", new BMessage(kInvoked), count)
	{
	}
	explicit PlainChannels(BMessage* archive) : BChannelControl(archive) {}

	void Draw(BRect) override {}
	void MouseDown(BPoint) override {}
	void KeyDown(const char*, int32) override {}
	void GetPreferredSize(float* _width, float* _height) override { *_width = *_height = 50; }
	int32 MaxChannelCount() const override { return 4; }
	bool SupportsIndividualLimits() const override { return true; }

	status_t StuffValues(int32 from, int32 count, const int32* values) override
	{
		fStuffed++;
		return BChannelControl::StuffValues(from, count, values);
	}

	using BChannelControl::MaxLimitList;
	using BChannelControl::MinLimitList;
	using BChannelControl::ValueList;

	int fStuffed = 0;
};


std::string
ValuesOf(const BChannelControl& control)
{
	std::string text;
	for (int32 i = 0; i < control.CountChannels(); i++)
		text += (i > 0 ? " " : "") + std::to_string(control.ValueFor(i));
	return text;
}


template<class Value>
BMessage
Asked(BChannelControl* control, uint32 what, const char* property, Value add)
{
	BMessage message(what);
	message.AddSpecifier(property);
	add(message);
	BMessage reply;
	EXPECT_EQ(B_OK, BMessenger(control).SendMessage(&message, &reply));
	return reply;
}

} // namespace


TEST(ChannelControl, HasTheDefaultsOfItsClass)
{
	BApplication app("application/x-vnd.Archway-test");
	PlainChannels control;
	EXPECT_EQ(static_cast<uint32>(B_WILL_DRAW), control.Flags());
	EXPECT_EQ(3, control.CountChannels());
	EXPECT_EQ(0, control.CurrentChannel());
	EXPECT_EQ("0 0 0", ValuesOf(control));
	int32 min = -1;
	int32 max = -1;
	EXPECT_EQ(B_OK, control.GetLimits(&min, &max));
	EXPECT_EQ(0, min);
	EXPECT_EQ(100, max);
	EXPECT_STREQ("", control.MinLimitLabel());
	EXPECT_STREQ("", control.MaxLimitLabel());
	EXPECT_EQ(nullptr, control.ModificationMessage());
	EXPECT_EQ(0, PlainChannels(-5).CountChannels());
}


TEST(ChannelControl, TheCurrentChannelIsTheValue)
{
	BApplication app("application/x-vnd.Archway-test");
	PlainChannels control;
	control.SetValue(10);
	EXPECT_EQ(B_OK, control.SetCurrentChannel(2));
	EXPECT_EQ(2, control.CurrentChannel());
	EXPECT_EQ(0, control.Value());
	control.SetValue(30);
	EXPECT_EQ("10 0 30", ValuesOf(control));
	EXPECT_EQ(B_OK, control.SetCurrentChannel(0));
	EXPECT_EQ(10, control.Value());
	EXPECT_EQ(B_OK, control.SetValueFor(0, 11));
	EXPECT_EQ(11, control.Value());
	EXPECT_EQ(B_BAD_INDEX, control.SetCurrentChannel(3));
	EXPECT_EQ(B_BAD_INDEX, control.SetCurrentChannel(-1));
	EXPECT_EQ(0, control.CurrentChannel());
}


TEST(ChannelControl, ManyValuesAreSetAndGotAtOnce)
{
	BApplication app("application/x-vnd.Archway-test");
	PlainChannels control;
	const int32 values[] = { 5, 600 };
	EXPECT_EQ(B_OK, control.SetValue(1, 2, values));
	EXPECT_EQ("0 5 100", ValuesOf(control)) << "kept within the limits";
	EXPECT_EQ(1, control.fStuffed);
	EXPECT_EQ(B_BAD_INDEX, control.SetValue(2, 2, values));
	EXPECT_EQ(B_BAD_INDEX, control.SetValue(-1, 2, values));
	EXPECT_EQ(B_BAD_INDEX, control.SetValue(0, 0x7fffffff, values));
	EXPECT_EQ(B_BAD_VALUE, control.SetValue(0, 2, NULL));
	EXPECT_EQ("0 5 100", ValuesOf(control));

	int32 got[5] = { 7, 7, 7, 7, 7 };
	EXPECT_EQ(2, control.GetValue(got, 1, 5));
	EXPECT_EQ(5, got[0]);
	EXPECT_EQ(100, got[1]);
	EXPECT_EQ(7, got[2]);
	EXPECT_EQ(0, control.GetValue(got, 3, 1));
	EXPECT_EQ(-1, control.ValueFor(3));
	EXPECT_EQ(B_OK, control.SetAllValue(44));
	EXPECT_EQ("44 44 44", ValuesOf(control));
	EXPECT_EQ(44, control.Value());
	EXPECT_EQ(44, control.ValueList()[2]);
}


TEST(ChannelControl, LimitsAreThoseOfEachChannel)
{
	BApplication app("application/x-vnd.Archway-test");
	PlainChannels control;
	EXPECT_EQ(B_OK, control.SetLimitsFor(1, 10, 20));
	EXPECT_EQ("0 10 0", ValuesOf(control));
	EXPECT_EQ(B_OK, control.SetAllValue(50));
	EXPECT_EQ("50 20 50", ValuesOf(control));
	const int32 minimums[] = { -5, -6 };
	const int32 maximums[] = { 5, 6 };
	EXPECT_EQ(B_OK, control.SetLimitsFor(1, 2, minimums, maximums));
	EXPECT_EQ("50 5 6", ValuesOf(control));
	EXPECT_EQ(B_BAD_VALUE, control.SetLimitsFor(1, 2, maximums, minimums));
	EXPECT_EQ(B_BAD_VALUE, control.SetLimitsFor(1, 2, NULL, maximums));
	EXPECT_EQ(B_BAD_INDEX, control.SetLimitsFor(2, 2, minimums, maximums));
	int32 min[3];
	int32 max[3];
	EXPECT_EQ(B_OK, control.GetLimitsFor(0, 3, min, max));
	EXPECT_EQ(-6, min[2]);
	EXPECT_EQ(6, max[2]);
	EXPECT_EQ(-5, control.MinLimitList()[1]);
	EXPECT_EQ(5, control.MaxLimitList()[1]);
	EXPECT_EQ(B_BAD_INDEX, control.GetLimitsFor(3, min, max));

	EXPECT_EQ(B_OK, control.SetLimits(0, 3));
	EXPECT_EQ("3 3 3", ValuesOf(control));
	EXPECT_EQ(3, control.Value());
	EXPECT_EQ(B_BAD_VALUE, control.SetLimits(3, 0));
}


TEST(ChannelControl, ChannelsComeAndGoAtTheEnd)
{
	BApplication app("application/x-vnd.Archway-test");
	PlainChannels control(2);
	control.SetAllValue(9);
	EXPECT_EQ(B_OK, control.SetChannelCount(4));
	EXPECT_EQ("9 9 0 0", ValuesOf(control));
	EXPECT_EQ(B_BAD_VALUE, control.SetChannelCount(5));
	EXPECT_EQ(B_BAD_VALUE, control.SetChannelCount(-1));
	control.SetCurrentChannel(3);
	control.SetValue(33);
	EXPECT_EQ(B_OK, control.SetChannelCount(1));
	EXPECT_EQ(0, control.CurrentChannel());
	EXPECT_EQ(9, control.Value());
	EXPECT_EQ(B_OK, control.SetChannelCount(0));
	control.SetValue(4);
	EXPECT_EQ(4, control.Value());
	EXPECT_EQ(-1, control.ValueFor(0));
}


TEST(ChannelControl, LimitLabelsAreThoseOfAllOrOfOneChannel)
{
	BApplication app("application/x-vnd.Archway-test");
	PlainChannels control;
	EXPECT_EQ(B_OK, control.SetLimitLabels("soft", "loud"));
	EXPECT_STREQ("soft", control.MinLimitLabel());
	EXPECT_STREQ("loud", control.MaxLimitLabel());
	EXPECT_EQ(nullptr, control.MinLimitLabelFor(1));
	EXPECT_EQ(B_OK, control.SetLimitLabelsFor(1, "left", "right"));
	EXPECT_STREQ("left", control.MinLimitLabelFor(1));
	EXPECT_STREQ("right", control.MaxLimitLabelFor(1));
	EXPECT_EQ(nullptr, control.MaxLimitLabelFor(0));
	EXPECT_EQ(nullptr, control.MaxLimitLabelFor(2));
	EXPECT_EQ(B_OK, control.SetLimitLabelsFor(1, 2, "a", NULL));
	EXPECT_STREQ("a", control.MinLimitLabelFor(2));
	EXPECT_STREQ("", control.MaxLimitLabelFor(2));
	EXPECT_EQ(B_BAD_INDEX, control.SetLimitLabelsFor(3, "a", "b"));
	EXPECT_EQ(nullptr, control.MinLimitLabelFor(-1));
	control.SetLimitLabels(NULL, "loud");
	EXPECT_STREQ("", control.MinLimitLabel());
}


TEST(ChannelControl, InvocationsTellTheChannels)
{
	ControlFixture fixture;
	PlainChannels* control = fixture.Add(new PlainChannels);
	fixture.Locked([&] {
		const int32 values[] = { 1, 2, 3 };
		control->SetValue(0, 3, values);
		control->SetCurrentChannel(1);
		EXPECT_EQ(B_OK, control->Invoke());
		EXPECT_EQ(B_OK, control->InvokeChannel());
		const bool mask[] = { false, true };
		EXPECT_EQ(B_OK, control->InvokeChannel(NULL, 1, 2, mask));
		EXPECT_EQ(B_BAD_INDEX, control->InvokeChannel(NULL, 2, 2));
		EXPECT_EQ(B_BAD_INDEX, control->InvokeChannel(NULL, 4));
		control->SetModificationMessage(new BMessage('modi'));
		EXPECT_EQ(static_cast<uint32>('modi'), control->ModificationMessage()->what);
		EXPECT_EQ(B_OK,
			control->InvokeNotifyChannel(control->ModificationMessage(), B_CONTROL_MODIFIED, 2));
	});
	const std::vector<BMessage> sent = fixture.Received(kInvoked);
	ASSERT_EQ(3u, sent.size());
	ExpectInvocationFields(sent[0], control, 2);
	EXPECT_EQ(1, sent[0].GetInt32("be:current_channel", -1));
	EXPECT_FALSE(sent[0].HasInt32("be:channel_value"));

	ExpectInvocationFields(sent[1], control, 2);
	EXPECT_EQ(3, sent[1].GetInt32("be:channel_value", 2, -1));
	EXPECT_TRUE(sent[1].GetBool("be:channel_changed", 2, false));
	EXPECT_EQ(2, sent[2].GetInt32("be:channel_value", 0, -1));
	EXPECT_FALSE(sent[2].GetBool("be:channel_changed", 0, true));
	EXPECT_TRUE(sent[2].GetBool("be:channel_changed", 1, false));
	EXPECT_FALSE(sent[2].HasInt32("be:channel_value", 2));
	const std::vector<BMessage> modified = fixture.Received('modi');
	ASSERT_EQ(1u, modified.size());
	EXPECT_EQ(3, modified[0].GetInt32("be:channel_value", 0, -1));
}


TEST(ChannelControl, AnswersForItsChannelsAndAsAControl)
{
	ControlFixture fixture;
	PlainChannels* control = fixture.Add(new PlainChannels);
	const auto none = [](BMessage&) {};
	const auto number = [](int32 value) {
		return [value](BMessage& message) { message.AddInt32("data", value); };
	};
	const auto text = [](const char* value) {
		return [value](BMessage& message) { message.AddString("data", value); };
	};
	EXPECT_EQ(3, Asked(control, B_GET_PROPERTY, "ChannelCount", none).GetInt32("result", 0));
	BMessage reply = Asked(control, B_SET_PROPERTY, "ChannelCount", number(4));
	EXPECT_EQ(B_OK, reply.GetInt32("error", B_ERROR));
	reply = Asked(control, B_SET_PROPERTY, "ChannelCount", number(40));
	EXPECT_EQ(B_BAD_VALUE, reply.GetInt32("error", B_OK));
	Asked(control, B_SET_PROPERTY, "CurrentChannel", number(3));
	EXPECT_EQ(3, Asked(control, B_GET_PROPERTY, "CurrentChannel", none).GetInt32("result", 0));
	Asked(control, B_SET_PROPERTY, "Value", number(77));
	fixture.Locked([&] { EXPECT_EQ("0 0 0 77", ValuesOf(*control)); });
	Asked(control, B_SET_PROPERTY, "MinLimitLabel", text("low"));
	Asked(control, B_SET_PROPERTY, "MaxLimitLabel", text("high"));
	reply = Asked(control, B_GET_PROPERTY, "MinLimitLabel", none);
	EXPECT_STREQ("low", reply.GetString("result", ""));
	reply = Asked(control, B_GET_PROPERTY, "MaxLimitLabel", none);
	EXPECT_STREQ("high", reply.GetString("result", ""));

	BMessage suites;
	fixture.Locked([&] { EXPECT_EQ(B_OK, control->GetSupportedSuites(&suites)); });
	EXPECT_STREQ("suite/vnd.Be-channel-control", suites.GetString("suites", 0, ""));
	EXPECT_STREQ("suite/vnd.Be-control", suites.GetString("suites", 1, ""));

	fixture.Locked([&] {
		int32 index;
		int32 form;
		BMessage specifier;
		const char* property;
		for (const char* name : { "CurrentChannel", "Enabled" }) {
			BMessage ask(B_GET_PROPERTY);
			ask.AddSpecifier(name);
			ASSERT_EQ(B_OK, ask.GetCurrentSpecifier(&index, &specifier, &form, &property));
			EXPECT_EQ(control, control->ResolveSpecifier(&ask, index, &specifier, form, property));
		}
	});
}


TEST(ChannelControl, ADerivedClassTakesItsPreferredSizeAndFont)
{
	ControlFixture fixture;
	PlainChannels* control = fixture.Add(new PlainChannels);
	fixture.Locked([&] {
		control->ResizeToPreferred();
		EXPECT_EQ(50, control->Bounds().Width());
		BFont font;
		font.SetSize(17);
		control->SetFont(&font);
		control->GetFont(&font);
		EXPECT_EQ(17, font.Size());
		EXPECT_EQ(4, control->MaxChannelCount());
		EXPECT_TRUE(control->SupportsIndividualLimits());
		control->RemoveSelf();
	});
	delete control;
}


TEST(ChannelControl, AnArchiveIsReadBack)
{
	BApplication app("application/x-vnd.Archway-test");
	PlainChannels control(2);
	control.SetLimitsFor(1, -3, 8);
	control.SetValueFor(0, 60);
	control.SetCurrentChannel(1);
	control.SetLimitLabels("low", "");
	BMessage archive = ArchiveOf(control);
	EXPECT_EQ("_msg _label be:_m_channel_count be:_m_value_channel be:_m_min_label "
			  "be:_m_max_label be:_m_channel_min be:_m_channel_max be:_m_channel_val",
		OwnFieldNames(archive));
	PlainChannels revived(&archive);
	EXPECT_EQ("60 0", ValuesOf(revived));
	EXPECT_EQ(1, revived.CurrentChannel());
	EXPECT_EQ(-3, revived.MinLimitList()[1]);
	EXPECT_EQ(8, revived.MaxLimitList()[1]);
	EXPECT_STREQ("low", revived.MinLimitLabel());
	EXPECT_EQ(nullptr, revived.ModificationMessage());

	revived.SetModificationMessage(new BMessage('modi'));
	BMessage more = ArchiveOf(revived);
	EXPECT_TRUE(more.HasMessage("_mod_msg"));
	EXPECT_EQ(static_cast<uint32>('modi'), PlainChannels(&more).ModificationMessage()->what);
}
