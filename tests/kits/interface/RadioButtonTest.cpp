#include <RadioButton.h>

#include <Box.h>

#include "ControlFixture.h"

namespace {

constexpr uint32 kInvoked = 'invk';

BRadioButton*
NewRadio(float top, const char* label = "Choice")
{
	return new BRadioButton(BRect(20, top, 169, top + 19), label, label, new BMessage(kInvoked));
}

} // namespace


TEST(RadioButton, AClickChoosesItAndInvokesItAlone)
{
	ControlFixture fixture;
	BRadioButton* first = fixture.Add(NewRadio(20));
	BRadioButton* second = fixture.Add(NewRadio(50));
	fixture.driver.Click(first);
	fixture.driver.Click(second);
	fixture.Locked([&] {
		EXPECT_EQ(0, first->Value());
		EXPECT_EQ(1, second->Value());
	});
	const std::vector<BMessage> sent = fixture.Received(kInvoked);
	ASSERT_EQ(2u, sent.size());
	ExpectInvocationFields(sent[0], first, 1);
	ExpectInvocationFields(sent[1], second, 1);
}


TEST(RadioButton, ChoosingTheChosenOneDoesNothing)
{
	ControlFixture fixture;
	BRadioButton* radio = fixture.Add(NewRadio(20));
	fixture.driver.Click(radio);
	fixture.driver.Click(radio);
	fixture.Focus(radio);
	fixture.driver.Type(" ");
	fixture.Locked([&] { EXPECT_EQ(1, radio->Value()); });
	EXPECT_EQ(1, fixture.CountReceived(kInvoked));
}


TEST(RadioButton, AProgramChoosesWithoutInvoking)
{
	ControlFixture fixture;
	BRadioButton* first = fixture.Add(NewRadio(20));
	BRadioButton* second = fixture.Add(NewRadio(50));
	fixture.Locked([&] {
		first->SetValue(1);
		second->SetValue(1);
		EXPECT_EQ(0, first->Value());
		second->SetValue(0);
		EXPECT_EQ(0, first->Value());
		EXPECT_EQ(0, second->Value());
	});
	EXPECT_EQ(0, fixture.CountReceived(kInvoked));
}


TEST(RadioButton, KeysChooseIt)
{
	ControlFixture fixture;
	BRadioButton* first = fixture.Add(NewRadio(20));
	BRadioButton* second = fixture.Add(NewRadio(50));
	fixture.Focus(first);
	fixture.driver.Type(" ");
	fixture.Focus(second);
	fixture.driver.Type("\n");
	fixture.Locked([&] {
		EXPECT_EQ(0, first->Value());
		EXPECT_EQ(1, second->Value());
	});
	EXPECT_EQ(2, fixture.CountReceived(kInvoked));
}


TEST(RadioButton, EachParentHasAGroupOfItsOwn)
{
	ControlFixture fixture;
	BBox* box = fixture.Add(new BBox(BRect(10, 100, 300, 280), "box"));
	BRadioButton* outside = fixture.Add(NewRadio(20));
	BRadioButton* inside = NewRadio(40);
	fixture.Locked([&] {
		box->AddChild(inside);
		outside->SetValue(1);
		inside->SetValue(1);
		EXPECT_EQ(1, outside->Value());
	});
}


TEST(RadioButton, TheLabelOfABoxBelongsToTheViewsBesideTheBox)
{
	ControlFixture fixture;
	BBox* box = fixture.Add(new BBox(BRect(10, 100, 300, 280), "box"));
	BRadioButton* outside = fixture.Add(NewRadio(20));
	BRadioButton* label = NewRadio(0);
	BRadioButton* inside = NewRadio(40);
	fixture.Locked([&] {
		box->SetLabel(label);
		box->AddChild(inside);
		inside->SetValue(1);
		outside->SetValue(1);
		label->SetValue(1);
		EXPECT_EQ(0, outside->Value());
		EXPECT_EQ(1, inside->Value());
		outside->SetValue(1);
		EXPECT_EQ(0, label->Value());
	});
}


TEST(RadioButton, TopLevelOnesOfAWindowAreAGroup)
{
	ControlFixture fixture;
	BRadioButton* first = NewRadio(20);
	BRadioButton* second = NewRadio(50);
	fixture.Locked([&] {
		fixture.window->AddChild(first);
		fixture.window->AddChild(second);
		first->SetValue(1);
		second->SetValue(1);
		EXPECT_EQ(0, first->Value());
	});
}


TEST(RadioButton, RevivesWhatItWrote)
{
	ControlFixture fixture;
	BRadioButton radio(BRect(1, 2, 103, 44), "b", "Label", new BMessage(kInvoked));
	radio.SetValue(1);
	ExpectRoundTrip(fixture, radio);
}
