// What controls ask of classes made from them, and calls that need no user.
#include <string>

#include <Button.h>
#include <CheckBox.h>
#include <ColorControl.h>
#include <MenuBar.h>
#include <MenuField.h>
#include <MenuItem.h>
#include <PictureButton.h>
#include <PopUpMenu.h>
#include <RadioButton.h>
#include <TextControl.h>
#include <TextView.h>

#include "ControlFixture.h"

namespace {

constexpr uint32 kInvoked = 'invk';
const BRect kFrame(20, 20, 169, 49);


// Notes the values that it is set to, and its invocations.
template<class Control> class Noting : public Control {
public:
	using Control::Control;

	void SetValue(int32 value) override
	{
		calls += "value " + std::to_string(value) + " ";
		Control::SetValue(value);
	}

	status_t Invoke(BMessage* message = NULL) override
	{
		calls += "invoke ";
		return Control::Invoke(message);
	}

	std::string calls;
};


template<class Control> class PlainMark : public Control {
public:
	using Control::Control;

	void DrawMark(BPoint leftTop, rgb_color base, uint32 state) override
	{
		marks++;
		if (this->Value() != B_CONTROL_ON)
			return;
		this->SetHighColor(255, 0, 0);
		this->FillRect(BRect(leftTop, leftTop + BPoint(5, 5)));
	}

	int marks = 0;
};


int
CountRed(ControlFixture& fixture, BView* view)
{
	int count = 0;
	for (float y = 0; y <= view->Bounds().bottom; y++) {
		for (float x = 0; x < 20; x++)
			count += fixture.driver.PixelAt(view, BPoint(x, y)) == rgb_color { 255, 0, 0, 255 };
	}
	return count;
}

} // namespace


TEST(ControlHooks, AClickSetsTheValueOfABButtonAndInvokesIt)
{
	ControlFixture fixture;
	auto button =
		fixture.Add(new Noting<BButton>(kFrame, "button", "Label", new BMessage(kInvoked)));
	fixture.driver.Click(button);
	EXPECT_EQ("value 1 value 0 invoke ", button->calls) << "SetValue() and Invoke()";
	EXPECT_EQ(1, fixture.CountReceived(kInvoked));

	button->calls.clear();
	fixture.driver.MoveTo(button);
	fixture.driver.Press();
	EXPECT_EQ("value 1 ", button->calls);
	fixture.driver.MoveTo(fixture.ground, BPoint(300, 200));
	EXPECT_EQ("value 1 value 0 ", button->calls);
	fixture.driver.Release();
	EXPECT_EQ(std::string::npos, button->calls.find("invoke"));
	EXPECT_EQ(1, fixture.CountReceived(kInvoked));
}


TEST(ControlHooks, ABCheckBoxDrawsTheMarkOfItsClass)
{
	ControlFixture fixture;
	auto check = fixture.Add(new PlainMark<BCheckBox>(kFrame, "check", "Label", nullptr));
	EXPECT_GT(check->marks, 0) << "DrawMark()";
	EXPECT_EQ(0, CountRed(fixture, check));
	fixture.driver.Click(check);
	EXPECT_EQ(36, CountRed(fixture, check));
}


TEST(ControlHooks, ABRadioButtonDrawsTheMarkOfItsClass)
{
	ControlFixture fixture;
	auto radio = fixture.Add(new PlainMark<BRadioButton>(kFrame, "radio", "Label", nullptr));
	EXPECT_GT(radio->marks, 0) << "DrawMark()";
	EXPECT_EQ(0, CountRed(fixture, radio));
	fixture.driver.Click(radio);
	EXPECT_EQ(36, CountRed(fixture, radio));
}


TEST(ControlHooks, ABTextControlInvokesForAChangedText)
{
	ControlFixture fixture;
	auto field = fixture.Add(
		new Noting<BTextControl>(kFrame, "field", "Label", "abc", new BMessage(kInvoked)));
	fixture.Focus(field);
	fixture.driver.Key("Return");
	EXPECT_EQ("", field->calls);
	fixture.driver.Type("x\n");
	EXPECT_EQ("invoke ", field->calls) << "Invoke()";
	ASSERT_EQ(1, fixture.CountReceived(kInvoked));
	ExpectInvocationFields(fixture.Received(kInvoked)[0], field, 0);
	fixture.Locked([&] { static_cast<BControl*>(field)->SetValue(5); });
	EXPECT_EQ(0, field->Value()) << "SetValue(): its value is its text";
	EXPECT_STREQ("x", field->Text());
}


TEST(ControlHooks, ABTextControlHandsNavigationToItsField)
{
	ControlFixture fixture;
	BTextControl* field = fixture.Add(new BTextControl(kFrame, "field", "Label", "", NULL));
	fixture.Locked([&] {
		field->SetFlags(B_WILL_DRAW);
		EXPECT_EQ(0u, field->TextView()->Flags() & B_NAVIGABLE);
		field->SetFlags(B_WILL_DRAW | B_NAVIGABLE);
		EXPECT_NE(0u, field->TextView()->Flags() & B_NAVIGABLE);
		EXPECT_EQ(0u, field->Flags() & B_NAVIGABLE);
	});
	fixture.driver.Key("Tab");
	EXPECT_TRUE(fixture.Locked([&] { return field->TextView()->IsFocus(); }));
}


TEST(ControlHooks, ABTextControlPrefersRoomForLabelAndField)
{
	ControlFixture fixture;
	BTextControl* field = fixture.Add(new BTextControl(kFrame, "field", "Label", "", NULL));
	fixture.Locked([&] {
		float shortWidth, width, height;
		field->SetDivider(0);
		field->GetPreferredSize(&shortWidth, &height);
		field->SetLabel("A label that is much longer");
		field->GetPreferredSize(&width, &height);
		EXPECT_NEAR(field->StringWidth("A label that is much longer") - field->StringWidth("Label"),
			width - shortWidth, 1);
		field->ResizeToPreferred();
		EXPECT_EQ(width, field->Frame().Width());
		EXPECT_EQ(height, field->Frame().Height());
	});
}


TEST(ControlHooks, ABColorControlKeepsItsPreferredSizeAndInvokes)
{
	ControlFixture fixture;
	BColorControl* color = fixture.Add(
		new BColorControl(BPoint(10, 10), B_CELLS_32x8, 8, "color", new BMessage(kInvoked)));
	fixture.Locked([&] {
		float width, height;
		color->GetPreferredSize(&width, &height);
		EXPECT_EQ(color->Frame().Width(), width);
		EXPECT_EQ(color->Frame().Height(), height);
		color->ResizeTo(10, 10);
		color->ResizeToPreferred();
		EXPECT_EQ(width, color->Frame().Width());
		EXPECT_EQ(height, color->Frame().Height());
		color->SetValue(rgb_color { 1, 2, 3, 255 });
		EXPECT_EQ(B_OK, color->Invoke());
	});
	ASSERT_EQ(1, fixture.CountReceived(kInvoked));
	ExpectInvocationFields(fixture.Received(kInvoked)[0], color, 0x01020300);
}


TEST(ControlHooks, ABControlHasItsOwnSizeAndTracksWhenItIsTold)
{
	class Tracking : public BControl {
	public:
		Tracking() : BControl(kFrame, "control", "Label", NULL, B_FOLLOW_NONE, B_WILL_DRAW) {}
		void MouseDown(BPoint) override
		{
			SetTracking(true);
			SetMouseEventMask(B_POINTER_EVENTS);
		}
		void MouseUp(BPoint) override { SetTracking(false); }
		bool Tracks() const { return IsTracking(); }
	};
	ControlFixture fixture;
	Tracking* control = fixture.Add(new Tracking);
	EXPECT_FALSE(control->Tracks());
	fixture.driver.MoveTo(control);
	fixture.driver.Press();
	EXPECT_TRUE(control->Tracks()) << "SetTracking()";
	fixture.driver.Release();
	EXPECT_FALSE(control->Tracks());
	fixture.Locked([&] {
		float width, height;
		control->GetPreferredSize(&width, &height);
		control->ResizeToPreferred();
		EXPECT_EQ(width, control->Frame().Width());
		EXPECT_EQ(height, control->Frame().Height());
	});
}


TEST(ControlHooks, ABPictureButtonKeepsItsBehavior)
{
	ControlFixture fixture;
	BPictureButton* button =
		fixture.Add(new BPictureButton(kFrame, "picture", new BMessage(kInvoked)));
	fixture.driver.Click(button);
	EXPECT_EQ(0, button->Value());
	fixture.Locked([&] { button->SetBehavior(B_TWO_STATE_BUTTON); });
	EXPECT_EQ(static_cast<uint32>(B_TWO_STATE_BUTTON), button->Behavior());
	fixture.driver.Click(button);
	EXPECT_EQ(1, button->Value());
	fixture.driver.Click(button);
	EXPECT_EQ(0, button->Value());
	EXPECT_EQ(3, fixture.CountReceived(kInvoked));
	fixture.Locked([&] {
		float width, height;
		button->GetPreferredSize(&width, &height);
		button->ResizeToPreferred();
		EXPECT_EQ(BRect(20, 20, 20 + width, 20 + height), button->Frame());
	});
}


TEST(ControlHooks, ABMenuFieldHidesAndShowsItsMark)
{
	ControlFixture fixture;
	BPopUpMenu* menu = new BPopUpMenu("menu");
	menu->AddItem(new BMenuItem("Item", NULL));
	BMenuField* field = fixture.Add(new BMenuField(kFrame, "field", "Label", menu));
	const auto dark = [&] {
		int count = 0;
		const BRect bar = field->MenuBar()->Bounds();
		for (float y = 2; y <= bar.bottom - 2; y++) {
			for (float x = bar.right - 13; x <= bar.right - 2; x++)
				count += fixture.driver.PixelAt(field->MenuBar(), BPoint(x, y)).red < 100;
		}
		return count;
	};
	const int shown = dark();
	EXPECT_GT(shown, 0);
	fixture.Locked([&] { field->HidePopUpMarker(); });
	EXPECT_EQ(0, dark());
	fixture.Locked([&] { field->ShowPopUpMarker(); });
	EXPECT_EQ(shown, dark());
}


TEST(ControlHooks, ABPictureButtonIsChosenByAClickAndAKey)
{
	class Noting : public BPictureButton {
	public:
		using BPictureButton::BPictureButton;
		void Choose() override
		{
			chosen++;
			if (!refuse)
				BPictureButton::Choose();
		}
		int chosen = 0;
		bool refuse = false;
	};
	ControlFixture fixture;
	Noting* button = fixture.Add(new Noting(kFrame, "picture", new BMessage(kInvoked)));
	fixture.driver.Click(button);
	EXPECT_EQ(1, button->chosen) << "Choose()";
	EXPECT_EQ(1, fixture.CountReceived(kInvoked));
	fixture.Focus(button);
	fixture.driver.Key("Space");
	EXPECT_EQ(2, button->chosen);
	EXPECT_EQ(2, fixture.CountReceived(kInvoked));
	fixture.Locked([&] { button->refuse = true; });
	fixture.driver.Click(button);
	EXPECT_EQ(3, button->chosen);
	EXPECT_EQ(2, fixture.CountReceived(kInvoked));
}
