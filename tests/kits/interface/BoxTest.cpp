#include <Box.h>

#include <cmath>

#include <CheckBox.h>
#include <Font.h>

#include "ControlFixture.h"

namespace {

constexpr rgb_color kPanel = { 216, 216, 216, 255 };

} // namespace


TEST(Box, HasTheDefaultsOfItsClass)
{
	BApplication app("application/x-vnd.Archway-test");
	BBox box(BRect(0, 0, 99, 99));
	EXPECT_EQ(static_cast<uint32>(B_WILL_DRAW | B_FRAME_EVENTS | B_NAVIGABLE_JUMP), box.Flags());
	EXPECT_EQ(static_cast<uint32>(B_FOLLOW_LEFT | B_FOLLOW_TOP), box.ResizingMode());
	EXPECT_EQ(B_FANCY_BORDER, box.Border());
	EXPECT_EQ(nullptr, box.Label());
	EXPECT_EQ(nullptr, box.Name());
	BFont font;
	box.GetFont(&font);
	EXPECT_EQ(*be_bold_font, font);
}


TEST(Box, TakesTheColourOfItsParentEvenIfItHadItsOwn)
{
	ControlFixture fixture;
	BBox* box = new BBox(BRect(0, 0, 99, 99));
	box->SetViewColor(1, 2, 3);
	fixture.Add(box);
	fixture.Locked([&] {
		EXPECT_EQ(kPanel, box->ViewColor());
		EXPECT_EQ(kPanel, box->LowColor());
	});
}


TEST(Box, LeavesRoomForBorderAndLabel)
{
	BApplication app("application/x-vnd.Archway-test");
	BBox box(BRect(0, 0, 99, 99));
	EXPECT_EQ(BRect(2, 2, 97, 97), box.InnerFrame());
	box.SetBorder(B_PLAIN_BORDER);
	EXPECT_EQ(BRect(1, 1, 98, 98), box.InnerFrame());
	box.SetBorder(B_NO_BORDER);
	EXPECT_EQ(BRect(0, 0, 99, 99), box.InnerFrame());

	box.SetLabel("Label");
	font_height height;
	be_bold_font->GetHeight(&height);
	EXPECT_EQ(std::ceil(height.ascent + height.descent) + 1, box.InnerFrame().top);
}


TEST(Box, ALabelViewIsItsFirstChild)
{
	BApplication app("application/x-vnd.Archway-test");
	BBox box(BRect(0, 0, 199, 99));
	BView* child = new BView(BRect(20, 40, 50, 50), "child", B_FOLLOW_NONE, 0);
	box.AddChild(child);
	BCheckBox* label = new BCheckBox(BRect(0, 0, 80, 18), "label", "Use it", NULL);
	EXPECT_EQ(B_OK, box.SetLabel(label));
	EXPECT_EQ(label, box.ChildAt(0));
	EXPECT_EQ(label, box.LabelView());
	EXPECT_EQ(nullptr, box.Label());
	EXPECT_EQ(BPoint(10, 0), label->Frame().LeftTop());

	box.SetLabel("text");
	EXPECT_EQ(1, box.CountChildren());
	EXPECT_EQ(nullptr, box.LabelView());
	EXPECT_STREQ("text", box.Label());
	box.SetLabel(static_cast<const char*>(NULL));
	EXPECT_EQ(nullptr, box.Label());
}


TEST(Box, NeverPrefersToBeSmaller)
{
	BApplication app("application/x-vnd.Archway-test");
	BBox box(BRect(0, 0, 199, 99));
	box.SetLabel("A");
	box.ResizeToPreferred();
	EXPECT_EQ(BRect(0, 0, 199, 99), box.Frame());
}


TEST(Box, DrawsAGrooveThatTheLabelBreaks)
{
	ControlFixture fixture;
	BBox* box = fixture.Add(new BBox(BRect(20, 20, 219, 119), "box"));
	EXPECT_EQ(128, fixture.driver.PixelAt(box, BPoint(0, 50)).red & ~1);
	EXPECT_EQ(255, fixture.driver.PixelAt(box, BPoint(1, 50)).red);
	EXPECT_EQ(kPanel, fixture.driver.PixelAt(box, BPoint(2, 50)));
	EXPECT_EQ(255, fixture.driver.PixelAt(box, BPoint(199, 50)).red);

	fixture.Locked([&] { box->SetLabel("Label"); });
	const auto columnIsPlain = [&](float x) {
		for (float y = 0; y < 12; y++) {
			if (fixture.driver.PixelAt(box, BPoint(x, y)) != kPanel)
				return false;
		}
		return true;
	};
	EXPECT_FALSE(columnIsPlain(4));
	EXPECT_TRUE(columnIsPlain(7));
	EXPECT_FALSE(columnIsPlain(150));
}


TEST(Box, LeavesNothingOfItsOldBorderWhenItGrows)
{
	ControlFixture fixture;
	BBox* box = fixture.Add(new BBox(BRect(20, 20, 119, 119), "box"));
	fixture.Locked([&] { box->ResizeTo(150, 150); });
	EXPECT_EQ(kPanel, fixture.driver.PixelAt(box, BPoint(99, 50)));
	EXPECT_EQ(kPanel, fixture.driver.PixelAt(box, BPoint(50, 99)));
	EXPECT_EQ(255, fixture.driver.PixelAt(box, BPoint(150, 50)).red);
	fixture.Locked([&] { box->ResizeTo(80, 80); });
	EXPECT_EQ(255, fixture.driver.PixelAt(box, BPoint(80, 50)).red);
}


TEST(Box, RevivesWhatItWrote)
{
	ControlFixture fixture;
	BBox box(BRect(10, 10, 199, 99), "box");
	EXPECT_EQ("", OwnFieldNames(ArchiveOf(box)));
	ExpectRoundTrip(fixture, box);

	box.SetLabel("Label");
	box.SetBorder(B_PLAIN_BORDER);
	EXPECT_EQ("_label _style", OwnFieldNames(ArchiveOf(box)));
	ExpectRoundTrip(fixture, box);

	box.SetLabel(new BCheckBox(BRect(0, 0, 80, 18), "label", "Use it", NULL));
	EXPECT_EQ("_lblview _style", OwnFieldNames(ArchiveOf(box)));
	ExpectRoundTrip(fixture, box);
	std::unique_ptr<BBox> revived = Revive<BBox>(ArchiveOf(box));
	EXPECT_NE(nullptr, dynamic_cast<BCheckBox*>(revived->LabelView()));
}


TEST(Box, ReadsTheBoolOfOldArchives)
{
	BApplication app("application/x-vnd.Archway-test");
	BBox box(BRect(10, 10, 199, 99), "box");
	BMessage archive = ArchiveOf(box);
	archive.AddBool("_style", true);
	std::unique_ptr<BBox> revived = Revive<BBox>(archive);
	EXPECT_EQ(B_PLAIN_BORDER, revived->Border());
	EXPECT_TRUE(archive.HasSameData(ArchiveOf(*revived), false, true));
}


TEST(Box, KeepsItsBoldLabelWithoutTheFamilyOfItsArchive)
{
	ControlFixture fixture;
	BBox box(BRect(10, 10, 199, 99), "box");
	BMessage archive = ArchiveOf(box);
	archive.ReplaceString("_fname", 0, "A family that is not installed");
	std::unique_ptr<BBox> revived = Revive<BBox>(archive);
	BFont font;
	revived->GetFont(&font);
	EXPECT_EQ(be_bold_font->FamilyAndStyle(), font.FamilyAndStyle());
	ExpectArchiveRoundTrip<BBox>(fixture, archive);
}


TEST(Box, PrefersItsPresentSizeAtLeast)
{
	ControlFixture fixture;
	BBox* box = fixture.Add(new BBox(BRect(10, 10, 209, 109), "box"));
	fixture.Locked([&] {
		float width, height;
		box->GetPreferredSize(&width, &height);
		EXPECT_EQ(199, width);
		EXPECT_EQ(99, height);
		box->ResizeTo(20, 10);
		box->SetLabel("A label that is far wider than the box");
		box->GetPreferredSize(&width, &height);
		EXPECT_GE(width, 20);
		EXPECT_GE(height, 10);
		box->ResizeToPreferred();
		EXPECT_EQ(width, box->Frame().Width());
	});
}
