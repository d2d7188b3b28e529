#include <PictureButton.h>

#include "ControlFixture.h"

namespace {

constexpr uint32 kInvoked = 'invk';

BPictureButton*
NewPictureButton(uint32 behavior)
{
	return new BPictureButton(BRect(20, 20, 69, 69), "picture", new BMessage(kInvoked), behavior);
}

} // namespace


TEST(PictureButton, HasTheDefaultsOfItsClass)
{
	BApplication app("application/x-vnd.Archway-test");
	BPictureButton button(BRect(0, 0, 50, 20), "b", NULL);
	EXPECT_EQ(static_cast<uint32>(B_WILL_DRAW | B_NAVIGABLE), button.Flags());
	EXPECT_EQ(static_cast<uint32>(B_ONE_STATE_BUTTON), button.Behavior());
	EXPECT_EQ(0, button.Value());
	float width;
	float height;
	button.GetPreferredSize(&width, &height);
	EXPECT_EQ(50, width);
	EXPECT_EQ(20, height);
}


TEST(PictureButton, OneWithASingleStateIsOnWhileItInvokes)
{
	ControlFixture fixture;
	BPictureButton* button = fixture.Add(NewPictureButton(B_ONE_STATE_BUTTON));
	fixture.driver.Click(button);
	const std::vector<BMessage> sent = fixture.Received(kInvoked);
	ASSERT_EQ(1u, sent.size());
	ExpectInvocationFields(sent[0], button, 1);
	fixture.Locked([&] { EXPECT_EQ(0, button->Value()); });
}


TEST(PictureButton, OneWithTwoStatesSwitches)
{
	ControlFixture fixture;
	BPictureButton* button = fixture.Add(NewPictureButton(B_TWO_STATE_BUTTON));
	fixture.driver.Click(button);
	fixture.Locked([&] { EXPECT_EQ(1, button->Value()); });
	fixture.Focus(button);
	fixture.driver.Type(" ");
	fixture.Locked([&] { EXPECT_EQ(0, button->Value()); });
	EXPECT_EQ(2, fixture.CountReceived(kInvoked));
}


TEST(PictureButton, AReleaseOutsideDoesNothing)
{
	ControlFixture fixture;
	BPictureButton* button = fixture.Add(NewPictureButton(B_TWO_STATE_BUTTON));
	fixture.driver.MoveTo(button);
	fixture.driver.Press();
	fixture.driver.MoveTo(button, BPoint(200, 200));
	fixture.driver.Release();
	fixture.Locked([&] { EXPECT_EQ(0, button->Value()); });
	EXPECT_EQ(0, fixture.CountReceived(kInvoked));
}


TEST(PictureButton, KeepsThePicturesOfItsArchive)
{
	ControlFixture fixture;
	BPictureButton button(BRect(1, 2, 30, 40), "b", new BMessage(kInvoked), B_TWO_STATE_BUTTON);
	BMessage archive = ArchiveOf(button);
	EXPECT_EQ("_msg _behave", OwnFieldNames(archive));
	BMessage picture;
	picture.AddString("class", "BPicture");
	picture.AddInt32("_ver", 1);
	archive.AddMessage("_e_on", &picture);
	archive.AddMessage("_e_off", &picture);
	ExpectArchiveRoundTrip<BPictureButton>(fixture, archive);
}
