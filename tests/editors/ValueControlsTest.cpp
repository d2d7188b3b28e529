#include <cmath>
#include <string>

#include <gtest/gtest.h>

#include <Message.h>
#include <TextView.h>

#include "editors/FloatControl.h"
#include "editors/IntControl.h"
#include "editors/LiveColorControl.h"
#include "support/ControlUser.h"
#include "support/TestWindow.h"

namespace {


// Receives a control's messages and notes its text at that moment.
class Receiver : public BView {
public:
	Receiver() : BView(BRect(0, 0, 399, 299), "receiver", B_FOLLOW_NONE, B_WILL_DRAW) {}

	void MessageReceived(BMessage* message) override
	{
		if (message->what != 'vlue') {
			BView::MessageReceived(message);
			return;
		}
		messages++;
		if (control != nullptr)
			text = control->Text();
	}

	BTextControl* control = nullptr;
	int messages = 0;
	std::string text;
};


struct Fixture {
	Fixture() : receiver(window.Add(new Receiver)) {}

	template<class Control> Control* Add(Control* control)
	{
		window.Locked([&] {
			receiver->AddChild(control);
			control->SetTarget(receiver);
		});
		return control;
	}

	void TypeOver(BTextControl* control, const char* text) { user.TypeOver(control, text); }

	TestWindow window;
	ControlUser user { window.driver };
	Receiver* receiver;
};


IntControl*
MakeInt(int value, int min, int max)
{
	return new IntControl(BRect(10, 10, 150, 30), NULL, "Value:", new BMessage('vlue'), value, min,
		max, B_FOLLOW_LEFT | B_FOLLOW_TOP, B_WILL_DRAW | B_NAVIGABLE);
}


FloatControl*
MakeFloat(float value, float min, float max)
{
	return new FloatControl(BRect(10, 10, 150, 30), NULL, "Value:", new BMessage('vlue'), value,
		min, max, B_FOLLOW_LEFT | B_FOLLOW_TOP, B_WILL_DRAW | B_NAVIGABLE);
}


} // namespace


TEST(IntControl, ShowsTheClampedNumberBeforeItSends)
{
	Fixture fixture;
	IntControl* control = fixture.Add(MakeInt(7, 0, 100));
	fixture.receiver->control = control;
	EXPECT_STREQ("7", control->Text());

	fixture.TypeOver(control, "250");
	EXPECT_EQ(1, fixture.receiver->messages);
	EXPECT_EQ("100", fixture.receiver->text);
	EXPECT_EQ(100, control->Value());

	fixture.TypeOver(control, "abc");
	EXPECT_EQ("0", fixture.receiver->text);
}


TEST(IntControl, ShowsTheMinimumForATextWhenZeroLiesBelow)
{
	Fixture fixture;
	IntControl* control = fixture.Add(MakeInt(7, 5, 100));
	fixture.TypeOver(control, "abc");
	EXPECT_STREQ("5", control->Text());
}


TEST(IntControl, ReadsANumberAtTheStartOfItsText)
{
	Fixture fixture;
	IntControl* control = fixture.Add(MakeInt(0, -1000, 1000));
	fixture.window.Locked([&] {
		control->SetText("  -12xyz");
		EXPECT_EQ(-12, control->Value());
		control->SetText("99999999999999999999");
		EXPECT_EQ(2147483647, control->Value());
	});
}


TEST(IntControl, LimitsDoNotPassEachOther)
{
	Fixture fixture;
	IntControl* control = fixture.Add(MakeInt(50, 10, 100));
	fixture.window.Locked([&] {
		control->SetMax(5);
		EXPECT_STREQ("10", control->Text());
		control->SetValue(50);
		EXPECT_STREQ("10", control->Text());
		control->SetMax(20);
		control->SetMin(30);
		EXPECT_STREQ("20", control->Text());
	});
}


TEST(IntControl, TheMaximumWinsWhenTheRangeIsUpsideDown)
{
	Fixture fixture;
	EXPECT_STREQ("10", fixture.Add(MakeInt(50, 100, 10))->Text());
}


TEST(FloatControl, ShowsShortNumbers)
{
	Fixture fixture;
	FloatControl* control = fixture.Add(MakeFloat(12, -100, 100));
	fixture.window.Locked([&] {
		EXPECT_STREQ("12", control->Text());
		control->SetFloatValue(0.5f);
		EXPECT_STREQ("0.5", control->Text());
		control->SetFloatValue(1000);
		EXPECT_STREQ("100", control->Text());
		control->SetFloatValue(NAN);
		EXPECT_STREQ("-100", control->Text());
	});
}


TEST(FloatControl, NormalisesWhatIsTyped)
{
	Fixture fixture;
	FloatControl* control = fixture.Add(MakeFloat(1, -100, 100));
	fixture.receiver->control = control;
	fixture.TypeOver(control, "2.50");
	EXPECT_EQ("2.5", fixture.receiver->text);
	fixture.TypeOver(control, "1e999");
	EXPECT_EQ("100", fixture.receiver->text);
	fixture.TypeOver(control, "word");
	EXPECT_EQ("0", fixture.receiver->text);
}


TEST(FloatControl, LimitsDoNotPassEachOther)
{
	Fixture fixture;
	FloatControl* control = fixture.Add(MakeFloat(50, 10, 100));
	fixture.window.Locked([&] {
		control->SetMax(NAN);
		EXPECT_STREQ("10", control->Text());
		control->SetMax(40);
		control->SetMin(60);
		EXPECT_STREQ("40", control->Text());
	});
}


TEST(LiveColorControl, SendsForEveryValue)
{
	Fixture fixture;
	LiveColorControl* control = fixture.Add(
		new LiveColorControl(BPoint(10, 40), B_CELLS_32x8, 1, "color", new BMessage('vlue'), true));
	fixture.window.Locked([&] { control->SetValue(rgb_color { 1, 2, 3, 200 }); });
	EXPECT_EQ(0x01020300, control->Value());
	EXPECT_EQ(1, fixture.receiver->messages);
	fixture.window.Locked([&] { control->SetValue(0x0a0b0c00); });
	EXPECT_EQ(2, fixture.receiver->messages);
}


TEST(LiveColorControl, CutsComponentsToEightBits)
{
	Fixture fixture;
	LiveColorControl* control = fixture.Add(
		new LiveColorControl(BPoint(10, 40), B_CELLS_32x8, 1, "color", new BMessage('vlue'), true));
	fixture.window.Locked([&] {
		auto set = [control](const char* name, const char* text) {
			dynamic_cast<BTextControl*>(control->FindView(name))->SetText(text);
		};
		set("_red", "300");
		set("_green", "-1");
		set("_blue", "0");
		control->SetValueFromComponents();
	});
	EXPECT_EQ(44, control->ValueAsColor().red);
	EXPECT_EQ(255, control->ValueAsColor().green);
	EXPECT_EQ(0, control->ValueAsColor().blue);
}


TEST(LiveColorControl, NeedsAllThreeFields)
{
	Fixture fixture;
	LiveColorControl* control = fixture.Add(
		new LiveColorControl(BPoint(10, 40), B_CELLS_32x8, 1, "color", new BMessage('vlue'), true));
	fixture.window.Locked([&] {
		BView* green = control->FindView("_green");
		control->RemoveChild(green);
		control->SetValueFromComponents();
		control->AddChild(green);
	});
	EXPECT_EQ(0, fixture.receiver->messages);
}
