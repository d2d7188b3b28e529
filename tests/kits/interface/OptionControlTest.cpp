#include <OptionControl.h>

#include <string>
#include <utility>
#include <vector>

#include "ControlFixture.h"

namespace {

constexpr uint32 kInvoked = 'invk';

// Keeps its options in a list and shows nothing.
class PlainOptions : public BOptionControl {
public:
	PlainOptions() :
		BOptionControl(BRect(10, 10, 99, 39), "options", "Label", new BMessage(kInvoked))
	{
	}

	bool GetOptionAt(int32 index, const char** _name, int32* _value) override
	{
		if (index < 0 || index >= CountOptions())
			return false;
		if (_name != nullptr)
			*_name = fOptions[index].first.c_str();
		if (_value != nullptr)
			*_value = fOptions[index].second;
		return true;
	}

	void RemoveOptionAt(int32 index) override { fOptions.erase(fOptions.begin() + index); }

	int32 CountOptions() const override { return static_cast<int32>(fOptions.size()); }

	status_t AddOptionAt(const char* name, int32 value, int32 index) override
	{
		fOptions.insert(fOptions.begin() + index, { name, value });
		return B_OK;
	}

	int32 SelectedOption(const char** = nullptr, int32* = nullptr) const override
	{
		for (int32 i = 0; i < CountOptions(); i++) {
			if (fOptions[i].second == Value())
				return i;
		}
		return -1;
	}

	using BOptionControl::MakeValueMessage;

private:
	std::vector<std::pair<std::string, int32>> fOptions;
};

} // namespace


TEST(OptionControl, AddOptionGoesBehindTheOthers)
{
	BApplication app("application/x-vnd.Archway-test");
	PlainOptions control;
	EXPECT_EQ(static_cast<uint32>(B_WILL_DRAW), control.Flags());
	EXPECT_EQ(B_OK, control.AddOption("one", 1));
	EXPECT_EQ(B_OK, control.AddOption("three", 3));
	EXPECT_EQ(B_OK, control.AddOptionAt("two", 2, 1));
	ASSERT_EQ(3, control.CountOptions());
	const char* name;
	int32 value;
	ASSERT_TRUE(control.GetOptionAt(2, &name, &value));
	EXPECT_STREQ("three", name);
	EXPECT_EQ(3, value);
	control.RemoveOptionAt(0);
	EXPECT_EQ(2, control.CountOptions());
}


TEST(OptionControl, SelectOptionForFindsValuesAndNames)
{
	ControlFixture fixture;
	PlainOptions* control = fixture.Add(new PlainOptions);
	fixture.Locked([&] {
		control->AddOption("one", 1);
		control->AddOption("two", 2);
		EXPECT_EQ(-1, control->SelectedOption());
		EXPECT_EQ(B_OK, control->SelectOptionFor(2));
		EXPECT_EQ(2, control->Value());
		EXPECT_EQ(1, control->SelectedOption());
		EXPECT_EQ(B_ERROR, control->SelectOptionFor(7));
		EXPECT_EQ(B_OK, control->SelectOptionFor("one"));
		EXPECT_EQ(1, control->Value());
		EXPECT_EQ(B_ERROR, control->SelectOptionFor("One"));
		const char* none = nullptr;
		EXPECT_EQ(B_ERROR, control->SelectOptionFor(none));
		EXPECT_EQ(1, control->Value());
	});
	EXPECT_EQ(0, fixture.CountReceived(kInvoked));
}


TEST(OptionControl, AValueMessageSetsTheValueAndInvokes)
{
	ControlFixture fixture;
	PlainOptions* control = fixture.Add(new PlainOptions);
	const std::unique_ptr<BMessage> message(control->MakeValueMessage(5));
	EXPECT_EQ(static_cast<uint32>('_BMV'), message->what);
	EXPECT_EQ(5, message->GetInt32("be:value", 0));

	BMessenger(control).SendMessage(message.get());
	const std::vector<BMessage> sent = fixture.Received(kInvoked);
	ASSERT_EQ(1u, sent.size());
	ExpectInvocationFields(sent[0], control, 5);
	fixture.Locked([&] { EXPECT_EQ(5, control->Value()); });

	// One that says no value is not the control's.
	BMessenger(control).SendMessage(B_OPTION_VALUE);
	EXPECT_EQ(1, fixture.CountReceived(kInvoked));
}
