#include <CheckBox.h>

#include <algorithm>
#include <cmath>

#include <Font.h>

#include "ControlFixture.h"

namespace {

constexpr uint32 kInvoked = 'invk';

BCheckBox*
NewCheckBox()
{
	return new BCheckBox(BRect(20, 20, 169, 39), "check", "Check me", new BMessage(kInvoked));
}

} // namespace


TEST(CheckBox, HasTheDefaultsOfItsClass)
{
	BApplication app("application/x-vnd.Archway-test");
	BCheckBox box(BRect(0, 0, 50, 20), "b", "Label", NULL);
	EXPECT_EQ(static_cast<uint32>(B_WILL_DRAW | B_NAVIGABLE), box.Flags());
	EXPECT_EQ(static_cast<uint32>(B_FOLLOW_LEFT | B_FOLLOW_TOP), box.ResizingMode());
	EXPECT_EQ(B_CONTROL_OFF, box.Value());
}


TEST(CheckBox, PrefersRoomForBoxAndLabel)
{
	BApplication app("application/x-vnd.Archway-test");
	BCheckBox box(BRect(0, 0, 5, 5), "b", "Label", NULL);
	font_height height;
	be_plain_font->GetHeight(&height);
	float preferredWidth;
	float preferredHeight;
	box.GetPreferredSize(&preferredWidth, &preferredHeight);
	EXPECT_EQ(22 + std::ceil(be_plain_font->StringWidth("Label")), preferredWidth);
	EXPECT_EQ(std::ceil(height.ascent + height.descent + height.leading) + 6, preferredHeight);
}


TEST(CheckBox, IsAsHighAsItsMarkAtLeast)
{
	constexpr float kMarkBottom = 16;
	BApplication app("application/x-vnd.Archway-test");
	for (const float height : { -10.f, 12.f, kMarkBottom, 30.f }) {
		BCheckBox box(BRect(7, 9, 107, 9 + height), "b", "Multiply", NULL);
		EXPECT_EQ(BPoint(7, 9), box.Frame().LeftTop());
		EXPECT_EQ(100, box.Bounds().Width());
		EXPECT_EQ(std::max(height, kMarkBottom), box.Bounds().Height());
	}
}


// A label that has no room at its usual place stands closer to the mark.
TEST(CheckBox, ALongLabelMovesTowardsTheMark)
{
	ControlFixture fixture;
	const float label = std::ceil(be_plain_font->StringWidth("Horizontal"));
	BCheckBox* box = fixture.Add(new BCheckBox(
		BRect(20, 20, 20 + 16 + label - 1, 39), "check", "Horizontal", new BMessage(kInvoked)));
	const auto isInked = [&](float x) {
		for (float y = 0; y <= box->Bounds().bottom; y++) {
			if (fixture.driver.PixelAt(box, BPoint(x, y)).red < 100)
				return true;
		}
		return false;
	};
	EXPECT_TRUE(isInked(17) || isInked(18));
	EXPECT_TRUE(isInked(box->Bounds().right - 1) || isInked(box->Bounds().right - 2));
}


TEST(CheckBox, AClickSwitchesItAndInvokes)
{
	ControlFixture fixture;
	BCheckBox* box = fixture.Add(NewCheckBox());
	fixture.driver.MoveTo(box, BPoint(5, 8));
	fixture.driver.Press();
	fixture.Locked([&] { EXPECT_EQ(0, box->Value()); });
	fixture.driver.Release();
	fixture.driver.Click(box);

	const std::vector<BMessage> sent = fixture.Received(kInvoked);
	ASSERT_EQ(2u, sent.size());
	ExpectInvocationFields(sent[0], box, 1);
	ExpectInvocationFields(sent[1], box, 0);
}


TEST(CheckBox, AReleaseOutsideChangesNothing)
{
	ControlFixture fixture;
	BCheckBox* box = fixture.Add(NewCheckBox());
	fixture.driver.MoveTo(box);
	fixture.driver.Press();
	fixture.driver.MoveTo(box, BPoint(250, 200));
	fixture.driver.Release();
	fixture.Locked([&] { EXPECT_EQ(0, box->Value()); });
	EXPECT_EQ(0, fixture.CountReceived(kInvoked));
}


TEST(CheckBox, SpaceAndEnterSwitchIt)
{
	ControlFixture fixture;
	BCheckBox* box = fixture.Add(NewCheckBox());
	fixture.Focus(box);
	fixture.driver.Type(" ");
	fixture.Locked([&] { EXPECT_EQ(1, box->Value()); });
	fixture.driver.Type("\n");
	fixture.Locked([&] { EXPECT_EQ(0, box->Value()); });
	EXPECT_EQ(2, fixture.CountReceived(kInvoked));
}


TEST(CheckBox, APartlyOnOneIsSwitchedOn)
{
	ControlFixture fixture;
	BCheckBox* box = fixture.Add(NewCheckBox());
	fixture.Locked([&] { box->SetValue(B_CONTROL_PARTIALLY_ON); });
	fixture.driver.Click(box);
	fixture.Locked([&] { EXPECT_EQ(B_CONTROL_ON, box->Value()); });
}


TEST(CheckBox, ADisabledOneDoesNothing)
{
	ControlFixture fixture;
	BCheckBox* box = fixture.Add(NewCheckBox());
	fixture.Locked([&] { box->SetEnabled(false); });
	fixture.driver.Click(box);
	fixture.Locked([&] { EXPECT_EQ(0, box->Value()); });
	EXPECT_EQ(0, fixture.CountReceived(kInvoked));
}


TEST(CheckBox, ShowsItsMarkInTheMiddleOfTheBox)
{
	ControlFixture fixture;
	BCheckBox* box = fixture.Add(NewCheckBox());
	const BPoint middle(7, 9);
	EXPECT_EQ((rgb_color { 255, 255, 255, 255 }), fixture.driver.PixelAt(box, middle));
	fixture.Locked([&] { box->SetValue(B_CONTROL_ON); });
	EXPECT_EQ((rgb_color { 0, 0, 229, 255 }), fixture.driver.PixelAt(box, middle));
}


TEST(CheckBox, RevivesWhatItWrote)
{
	ControlFixture fixture;
	BCheckBox box(BRect(1, 2, 103, 44), "b", "Label", new BMessage(kInvoked));
	ExpectRoundTrip(fixture, box);
	box.SetValue(B_CONTROL_ON);
	box.SetEnabled(false);
	EXPECT_EQ("_msg _label _val _disable be:wants_nav", OwnFieldNames(ArchiveOf(box)));
	ExpectRoundTrip(fixture, box);
}
