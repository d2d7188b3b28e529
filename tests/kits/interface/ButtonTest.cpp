#include <Button.h>

#include <cmath>

#include <Font.h>

#include "ControlFixture.h"

namespace {

constexpr uint32 kInvoked = 'invk';
const rgb_color kFace = { 240, 240, 240, 255 };

BButton*
NewButton(BRect frame = BRect(20, 20, 119, 44), const char* label = "Press")
{
	return new BButton(frame, "button", label, new BMessage(kInvoked));
}


float
LineHeight()
{
	font_height height;
	be_plain_font->GetHeight(&height);
	return std::ceil(height.ascent + height.descent + height.leading);
}

} // namespace


TEST(Button, HasTheDefaultsOfItsClass)
{
	BApplication app("application/x-vnd.Archway-test");
	BButton button(BRect(0, 0, 50, 20), "b", "Label", NULL);
	EXPECT_EQ(static_cast<uint32>(B_WILL_DRAW | B_NAVIGABLE), button.Flags());
	EXPECT_EQ(static_cast<uint32>(B_FOLLOW_LEFT | B_FOLLOW_TOP), button.ResizingMode());
	EXPECT_FALSE(button.IsDefault());
	EXPECT_EQ(0, button.Value());
}


TEST(Button, PrefersRoomForItsLabel)
{
	BApplication app("application/x-vnd.Archway-test");
	BButton small(BRect(0, 0, 5, 5), "b", "Ok", NULL);
	float width;
	float height;
	small.GetPreferredSize(&width, &height);
	EXPECT_EQ(75, width);
	EXPECT_EQ(LineHeight() + 12, height);

	const char* text = "A label that is wider than usual";
	BButton wide(BRect(0, 0, 5, 5), "b", text, NULL);
	wide.GetPreferredSize(&width, &height);
	EXPECT_EQ(20 + std::ceil(be_plain_font->StringWidth(text)), width);

	wide.MakeDefault(true);
	float defaultWidth;
	float defaultHeight;
	wide.GetPreferredSize(&defaultWidth, &defaultHeight);
	EXPECT_EQ(width + 6, defaultWidth);
	EXPECT_EQ(height + 6, defaultHeight);
}


TEST(Button, BecomesHighEnoughWhenAttached)
{
	ControlFixture fixture;
	BButton* low = fixture.Add(NewButton(BRect(20, 20, 119, 22)));
	BButton* high = fixture.Add(NewButton(BRect(20, 60, 119, 129)));
	fixture.Locked([&] {
		EXPECT_EQ(LineHeight() + 12, low->Bounds().Height());
		EXPECT_EQ(99, low->Bounds().Width());
		EXPECT_EQ(69, high->Bounds().Height());
	});
}


TEST(Button, GrowsRoundItsPlaceAsDefault)
{
	BApplication app("application/x-vnd.Archway-test");
	BButton button(BRect(20, 20, 119, 44), "b", "Label", NULL);
	button.MakeDefault(true);
	EXPECT_EQ(BRect(17, 17, 122, 47), button.Frame());
	EXPECT_TRUE(button.IsDefault());
	button.MakeDefault(true);
	EXPECT_EQ(BRect(17, 17, 122, 47), button.Frame());
	button.MakeDefault(false);
	EXPECT_EQ(BRect(20, 20, 119, 44), button.Frame());
}


TEST(Button, ThereIsOneDefaultButtonInAWindow)
{
	ControlFixture fixture;
	BButton* first = fixture.Add(NewButton());
	BButton* second = NewButton(BRect(20, 100, 119, 130));
	fixture.Locked([&] {
		first->MakeDefault(true);
		EXPECT_EQ(first, fixture.window->DefaultButton());
	});

	second->MakeDefault(true);
	fixture.Add(second);
	fixture.Locked([&] {
		EXPECT_EQ(second, fixture.window->DefaultButton());
		EXPECT_FALSE(first->IsDefault());
		EXPECT_EQ(BRect(20, 20, 119, 44), first->Frame());
		second->MakeDefault(false);
		EXPECT_EQ(nullptr, fixture.window->DefaultButton());
	});
}


TEST(Button, InvokesWhenReleasedInside)
{
	ControlFixture fixture;
	BButton* button = fixture.Add(NewButton());
	fixture.driver.MoveTo(button);
	fixture.driver.Press();
	fixture.Locked([&] { EXPECT_EQ(1, button->Value()); });
	EXPECT_EQ(0, fixture.CountReceived(kInvoked));

	fixture.driver.Release();
	fixture.Locked([&] {
		EXPECT_EQ(0, button->Value());
		EXPECT_FALSE(button->IsFocus());
	});
	const std::vector<BMessage> sent = fixture.Received(kInvoked);
	ASSERT_EQ(1u, sent.size());
	ExpectInvocationFields(sent[0], button, 0);
}


TEST(Button, FollowsThePointerWhileItIsHeld)
{
	ControlFixture fixture;
	BButton* button = fixture.Add(NewButton());
	fixture.driver.MoveTo(button);
	fixture.driver.Press();
	fixture.driver.MoveTo(button, BPoint(300, 200));
	fixture.Locked([&] { EXPECT_EQ(0, button->Value()); });
	fixture.driver.MoveTo(button);
	fixture.Locked([&] { EXPECT_EQ(1, button->Value()); });
	fixture.driver.MoveTo(button, BPoint(300, 200));
	fixture.driver.Release();
	EXPECT_EQ(0, fixture.CountReceived(kInvoked));
}


TEST(Button, ADisabledOneDoesNothing)
{
	ControlFixture fixture;
	BButton* button = fixture.Add(NewButton());
	fixture.Locked([&] { button->SetEnabled(false); });
	fixture.driver.MoveTo(button);
	fixture.driver.Press();
	fixture.Locked([&] { EXPECT_EQ(0, button->Value()); });
	fixture.driver.Release();
	EXPECT_EQ(0, fixture.CountReceived(kInvoked));
}


TEST(Button, SpaceAndEnterInvokeAndLeaveItUp)
{
	ControlFixture fixture;
	BButton* button = fixture.Add(NewButton());
	fixture.Focus(button);
	fixture.driver.Type(" ");
	fixture.driver.Type("\n");
	EXPECT_EQ(2, fixture.CountReceived(kInvoked));
	fixture.Locked([&] { EXPECT_EQ(0, button->Value()); });
}


TEST(Button, TheDefaultOneAnswersEnterForAnotherFocus)
{
	ControlFixture fixture;
	BButton* button = fixture.Add(NewButton());
	BButton* other =
		fixture.Add(new BButton(BRect(20, 100, 119, 130), "other", "Other", new BMessage('othr')));
	fixture.Locked([&] {
		button->MakeDefault(true);
		other->MakeFocus(true);
	});
	fixture.driver.Type("\n");
	EXPECT_EQ(1, fixture.CountReceived(kInvoked));
	EXPECT_EQ(0, fixture.CountReceived('othr'));
	fixture.driver.Type(" ");
	EXPECT_EQ(1, fixture.CountReceived('othr'));
}


TEST(Button, ShowsThatItIsPressed)
{
	ControlFixture fixture;
	BButton* button = fixture.Add(NewButton());
	const BPoint corner(6, 6);
	EXPECT_EQ(kFace, fixture.driver.PixelAt(button, corner));
	fixture.driver.MoveTo(button);
	fixture.driver.Press();
	EXPECT_EQ((rgb_color { 0, 0, 0, 255 }), fixture.driver.PixelAt(button, corner));
	fixture.driver.Release();
	EXPECT_EQ(kFace, fixture.driver.PixelAt(button, corner));
}


TEST(Button, ArchivesThatItIsDefault)
{
	ControlFixture fixture;
	BButton button(BRect(20, 20, 119, 44), "b", "Label", new BMessage(kInvoked));
	EXPECT_EQ("_msg _label", OwnFieldNames(ArchiveOf(button)));
	ExpectRoundTrip(fixture, button);
	button.MakeDefault(true);
	EXPECT_EQ("_msg _label _default", OwnFieldNames(ArchiveOf(button)));
	ExpectRoundTrip(fixture, button);
}


TEST(Button, TwoRevivedDefaultButtonsKeepFlagAndFrame)
{
	ControlFixture fixture;
	BButton model(BRect(20, 20, 119, 25), "b", "Label", NULL);
	model.MakeDefault(true);
	const BRect frame = model.Frame();
	BButton* first = fixture.Add(Revive<BButton>(ArchiveOf(model)).release());
	BButton* second = fixture.Add(Revive<BButton>(ArchiveOf(model)).release());
	fixture.Locked([&] {
		EXPECT_EQ(first, fixture.window->DefaultButton());
		for (BButton* button : { first, second }) {
			EXPECT_TRUE(button->IsDefault());
			EXPECT_EQ(frame, button->Frame());
		}
	});
}
