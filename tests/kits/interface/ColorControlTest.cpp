#include <ColorControl.h>

#include <Messenger.h>
#include <TextControl.h>
#include <TextView.h>

#include "ControlFixture.h"

namespace {

constexpr uint32 kInvoked = 'invk';

BColorControl*
NewColorControl()
{
	return new BColorControl(BPoint(20, 20), B_CELLS_32x8, 8, "color", new BMessage(kInvoked));
}


BTextControl*
Field(BView* control, const char* name)
{
	return dynamic_cast<BTextControl*>(control->FindView(name));
}


// A place in the ramp (0 grey, 1 red, ...) whose component has the amount.
BPoint
PlaceIn(int32 ramp, int32 amount)
{
	return BPoint(2 + amount * 256 / 255.0f + 0.1f, 2 + 16 * ramp + 8);
}

} // namespace


TEST(ColorControl, HasTheDefaultsOfItsClass)
{
	BApplication app("application/x-vnd.Archway-test");
	BColorControl control(BPoint(3, 4), B_CELLS_16x16, 8, "c");
	EXPECT_EQ(static_cast<uint32>(B_WILL_DRAW | B_NAVIGABLE), control.Flags());
	EXPECT_EQ(static_cast<uint32>(B_FOLLOW_LEFT | B_FOLLOW_TOP), control.ResizingMode());
	EXPECT_EQ(BPoint(3, 4), control.Frame().LeftTop());
	EXPECT_EQ(0, control.Value());
	EXPECT_EQ(B_CELLS_16x16, control.Layout());
	EXPECT_EQ(8, control.CellSize());
	const char* const labels[] = { "Red:", "Green:", "Blue:" };
	const char* const names[] = { "_red", "_green", "_blue" };
	for (int32 i = 0; i < 3; i++) {
		BTextControl* field = Field(&control, names[i]);
		ASSERT_NE(nullptr, field);
		EXPECT_EQ(field, control.ChildAt(i));
		EXPECT_STREQ(labels[i], field->Label());
		EXPECT_STREQ("0", field->Text());
		EXPECT_EQ(static_cast<uint32>('ccol'), field->Command());
		EXPECT_EQ(3, field->TextView()->MaxBytes());
	}
}


TEST(ColorControl, ASmallCellIsRaisedToSix)
{
	BApplication app("application/x-vnd.Archway-test");
	BColorControl control(BPoint(3, 4), B_CELLS_32x8, 1, "c");
	EXPECT_EQ(6, control.CellSize());
	control.SetCellSize(10);
	EXPECT_EQ(10, control.CellSize());
}


TEST(ColorControl, ItsSizeFollowsFromTheCells)
{
	BApplication app("application/x-vnd.Archway-test");
	for (const color_control_layout layout :
		{ B_CELLS_4x64, B_CELLS_8x32, B_CELLS_16x16, B_CELLS_32x8, B_CELLS_64x4 }) {
		BColorControl control(BPoint(0, 0), layout, 8, "c");
		const BRect bounds = control.Bounds();
		const float bevelRight = layout * 8 + 4;
		EXPECT_GE(bounds.Height(), 256 / layout * 8 + 3);
		BRect fields;
		for (const char* name : { "_red", "_green", "_blue" }) {
			const BRect frame = control.FindView(name)->Frame();
			EXPECT_EQ(bevelRight + 6, frame.left);
			EXPECT_TRUE(bounds.Contains(frame));
			EXPECT_FALSE(fields.IsValid() && fields.Intersects(frame));
			fields = fields.IsValid() ? fields | frame : frame;
		}
		EXPECT_EQ(fields.right, bounds.right);
	}
}


TEST(ColorControl, TheValueIsTheColourAndTheFieldsShowIt)
{
	BApplication app("application/x-vnd.Archway-test");
	BColorControl control(BPoint(0, 0), B_CELLS_32x8, 8, "c");
	control.SetValue({ 17, 34, 255, 128 });
	EXPECT_EQ(0x1122ff00, control.Value());
	EXPECT_EQ((rgb_color { 17, 34, 255, 255 }), control.ValueAsColor());
	EXPECT_STREQ("17", Field(&control, "_red")->Text());
	EXPECT_STREQ("34", Field(&control, "_green")->Text());
	EXPECT_STREQ("255", Field(&control, "_blue")->Text());
	control.SetValue(static_cast<int32>(0x010203ff));
	EXPECT_EQ(0x01020300, control.Value());
}


TEST(ColorControl, APressInARampSetsItsComponentAndInvokesAtEveryMove)
{
	ControlFixture fixture;
	BColorControl* control = fixture.Add(NewColorControl());
	fixture.driver.MoveTo(control, PlaceIn(1, 100));
	fixture.driver.Press();
	fixture.Locked([&] { EXPECT_EQ(0x64000000, control->Value()); });
	fixture.driver.MoveTo(control, PlaceIn(1, 120));
	fixture.driver.MoveTo(control, BPoint(900, 150));
	fixture.driver.Release();
	fixture.driver.Click(control, PlaceIn(3, 51));

	const std::vector<BMessage> sent = fixture.Received(kInvoked);
	ASSERT_EQ(4u, sent.size());
	ExpectInvocationFields(sent[1], control, 0x78000000);
	ExpectInvocationFields(sent[3], control, static_cast<int32>(0xff003300));
	fixture.Locked([&] { EXPECT_STREQ("51", Field(control, "_blue")->Text()); });

	fixture.driver.Click(control, PlaceIn(0, 51));
	fixture.Locked([&] { EXPECT_EQ(0x33333300, control->Value()); });
}


TEST(ColorControl, TypingInAFieldChangesItsComponentWithOneInvocation)
{
	ControlFixture fixture;
	BColorControl* control = fixture.Add(NewColorControl());
	fixture.Locked([&] { control->SetValue({ 10, 20, 30, 255 }); });
	fixture.Focus(Field(control, "_green"));
	fixture.driver.Type("x77\n");
	fixture.Locked([&] { EXPECT_EQ(0x0a4d1e00, control->Value()); });
	const std::vector<BMessage> sent = fixture.Received(kInvoked);
	ASSERT_EQ(1u, sent.size());
	ExpectInvocationFields(sent[0], control, 0x0a4d1e00);

	fixture.driver.Type("999\n");
	fixture.Locked([&] {
		EXPECT_EQ(0x0aff1e00, control->Value());
		EXPECT_STREQ("255", Field(control, "_green")->Text());
	});
}


TEST(ColorControl, KeysChooseARampAndChangeIt)
{
	ControlFixture fixture;
	BColorControl* control = fixture.Add(NewColorControl());
	fixture.Focus(control);
	fixture.driver.Key("Down");
	fixture.driver.Key("Right");
	fixture.driver.Key("Right");
	fixture.driver.Key("Down");
	fixture.driver.Key("Right");
	fixture.driver.Key("Up");
	fixture.driver.Key("Left");
	fixture.Locked([&] { EXPECT_EQ(0x01010000, control->Value()); });
	EXPECT_EQ(4, fixture.CountReceived(kInvoked));
}


TEST(ColorControl, ADisabledOneDoesNothing)
{
	ControlFixture fixture;
	BColorControl* control = fixture.Add(NewColorControl());
	fixture.Locked([&] {
		control->SetEnabled(false);
		EXPECT_FALSE(Field(control, "_red")->IsEnabled());
	});
	fixture.driver.Click(control, PlaceIn(1, 100));
	fixture.Locked([&] { EXPECT_EQ(0, control->Value()); });
	fixture.Locked([&] {
		control->SetEnabled(true);
		EXPECT_TRUE(Field(control, "_red")->IsEnabled());
	});
}


TEST(ColorControl, ShowsTheRamps)
{
	ControlFixture fixture;
	BColorControl* control = fixture.Add(NewColorControl());
	const BPoint right(2 + 250, 2 + 8);
	const rgb_color grey = fixture.driver.PixelAt(control, right);
	EXPECT_GT(grey.red, 240);
	EXPECT_EQ(grey.red, grey.green);
	const rgb_color green = fixture.driver.PixelAt(control, right + BPoint(0, 32));
	EXPECT_EQ(0, green.red);
	EXPECT_GT(green.green, 240);
}


TEST(ColorControl, RevivesWhatItWrote)
{
	ControlFixture fixture;
	BColorControl control(BPoint(3, 4), B_CELLS_16x16, 8, "c", new BMessage(kInvoked));
	EXPECT_EQ("_msg _layout _csize _use_off", OwnFieldNames(ArchiveOf(control)));
	ExpectRoundTrip(fixture, control);
	control.SetValue({ 1, 2, 3, 255 });
	ExpectRoundTrip(fixture, control);

	std::unique_ptr<BColorControl> revived = Revive<BColorControl>(ArchiveOf(control));
	EXPECT_EQ(3, revived->CountChildren());
	EXPECT_STREQ("3", Field(revived.get(), "_blue")->Text());
}


TEST(ColorControl, AShallowArchiveGetsItsFieldsBack)
{
	BApplication app("application/x-vnd.Archway-test");
	BColorControl control(BPoint(3, 4), B_CELLS_16x16, 8, "c");
	control.SetValue({ 1, 2, 3, 255 });
	std::unique_ptr<BColorControl> revived = Revive<BColorControl>(ArchiveOf(control, false));
	ASSERT_NE(nullptr, Field(revived.get(), "_blue"));
	EXPECT_STREQ("3", Field(revived.get(), "_blue")->Text());
}


TEST(ColorControl, AnOddLayoutIsReadAsTheSmallest)
{
	BApplication app("application/x-vnd.Archway-test");
	BColorControl control(BPoint(3, 4), B_CELLS_16x16, 8, "c");
	BMessage archive = ArchiveOf(control);
	archive.ReplaceInt32("_layout", 0);
	archive.ReplaceFloat("_csize", -1);
	std::unique_ptr<BColorControl> revived = Revive<BColorControl>(archive);
	EXPECT_EQ(B_CELLS_4x64, revived->Layout());
	EXPECT_EQ(6, revived->CellSize());
	EXPECT_TRUE(archive.HasSameData(ArchiveOf(*revived), false, true));
}


TEST(ColorControl, CellsOfAnySizeAreShownAtOnce)
{
	ControlFixture fixture;
	BColorControl* control = fixture.Add(NewColorControl());
	for (const float size : { 1000.0f, 2147483647.0f, 1e30f }) {
		fixture.Locked([&] { control->SetCellSize(size); });
		EXPECT_EQ(size, control->CellSize());
	}
	fixture.Locked([&] { control->SetCellSize(8); });
	EXPECT_GT(fixture.driver.PixelAt(control, BPoint(252, 10)).red, 240);
}
