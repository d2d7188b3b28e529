#include <StatusBar.h>

#include <cmath>

#include <AppDefs.h>
#include <Font.h>
#include <Messenger.h>

#include "ControlFixture.h"

namespace {

constexpr rgb_color kFill = { 50, 150, 255, 255 };
constexpr rgb_color kWhite = { 255, 255, 255, 255 };

float
TextHeight()
{
	font_height height;
	be_plain_font->GetHeight(&height);
	return std::ceil(height.ascent + height.descent) + 5;
}

} // namespace


TEST(StatusBar, HasTheDefaultsOfItsClass)
{
	BApplication app("application/x-vnd.Archway-test");
	BStatusBar bar(BRect(0, 0, 199, 10), "s");
	EXPECT_EQ(static_cast<uint32>(B_WILL_DRAW | B_FRAME_EVENTS), bar.Flags());
	EXPECT_EQ(0, bar.CurrentValue());
	EXPECT_EQ(100, bar.MaxValue());
	EXPECT_EQ(16, bar.BarHeight());
	EXPECT_EQ(kFill, bar.BarColor());
	for (const char* text : { bar.Text(), bar.TrailingText(), bar.Label(), bar.TrailingLabel() }) {
		EXPECT_STREQ("", text);
	}
}


TEST(StatusBar, TakesItsHeightWhenAttached)
{
	ControlFixture fixture;
	BStatusBar* bar = fixture.Add(new BStatusBar(BRect(10, 10, 209, 12), "s"));
	fixture.Locked([&] {
		EXPECT_EQ(TextHeight() + 16, bar->Bounds().Height());
		EXPECT_EQ(199, bar->Bounds().Width());
		bar->SetBarHeight(20);
		EXPECT_EQ(TextHeight() + 20, bar->Bounds().Height());
	});
}


TEST(StatusBar, FillsItsBarInProportion)
{
	ControlFixture fixture;
	BStatusBar* bar = fixture.Add(new BStatusBar(BRect(10, 10, 213, 12), "s"));
	const float y = TextHeight() + 8;
	const auto pixel = [&](float x) { return fixture.driver.PixelAt(bar, BPoint(x, y)); };
	EXPECT_EQ(kWhite, pixel(5));
	EXPECT_EQ(kWhite, pixel(100));

	fixture.Locked([&] { bar->Update(50); });
	EXPECT_EQ(kFill, pixel(5));
	EXPECT_EQ(kFill, pixel(99));
	EXPECT_EQ(kWhite, pixel(104));
	fixture.Locked([&] { bar->SetMaxValue(200); });
	EXPECT_EQ(kFill, pixel(45));
	EXPECT_EQ(kWhite, pixel(99));
	fixture.Locked([&] { bar->SetBarColor({ 255, 0, 0, 255 }); });
	EXPECT_EQ((rgb_color { 255, 0, 0, 255 }), pixel(45));
	fixture.Locked([&] { bar->Reset(); });
	EXPECT_EQ(kWhite, pixel(5));
}


TEST(StatusBar, UpdateAddsAndKeepsTextsThatAreNotGiven)
{
	BApplication app("application/x-vnd.Archway-test");
	BStatusBar bar(BRect(0, 0, 199, 10), "s", "Label", "Trailing");
	bar.Update(30, "text", "trailing text");
	bar.Update(20, NULL, "other");
	EXPECT_EQ(50, bar.CurrentValue());
	EXPECT_STREQ("text", bar.Text());
	EXPECT_STREQ("other", bar.TrailingText());
	EXPECT_STREQ("Label", bar.Label());
	bar.Update(1000);
	EXPECT_EQ(100, bar.CurrentValue());
	bar.SetTo(-5);
	EXPECT_EQ(0, bar.CurrentValue());
	bar.SetTo(10);
	bar.SetMaxValue(300);
	bar.Reset("New");
	EXPECT_EQ(0, bar.CurrentValue());
	EXPECT_EQ(100, bar.MaxValue());
	EXPECT_STREQ("New", bar.Label());
	EXPECT_STREQ("", bar.TrailingLabel());
	EXPECT_STREQ("", bar.Text());
}


TEST(StatusBar, IsUpdatedByMessages)
{
	ControlFixture fixture;
	BStatusBar* bar = fixture.Add(new BStatusBar(BRect(10, 10, 209, 12), "s", "Label"));
	BMessage update(B_UPDATE_STATUS_BAR);
	update.AddFloat("delta", 12);
	update.AddString("text", "some");
	update.AddString("trailing_text", "more");
	BMessenger(bar).SendMessage(&update);
	Driver::WaitUntilIdle();
	fixture.Locked([&] {
		EXPECT_EQ(12, bar->CurrentValue());
		EXPECT_STREQ("some", bar->Text());
		EXPECT_STREQ("more", bar->TrailingText());
	});

	BMessage reset(B_RESET_STATUS_BAR);
	reset.AddString("label", "first");
	reset.AddString("trailing_label", "last");
	BMessenger(bar).SendMessage(&reset);
	Driver::WaitUntilIdle();
	fixture.Locked([&] {
		EXPECT_EQ(0, bar->CurrentValue());
		EXPECT_STREQ("", bar->Text());
		EXPECT_STREQ("first", bar->Label());
		EXPECT_STREQ("last", bar->TrailingLabel());
	});
}


TEST(StatusBar, RevivesWhatItWrote)
{
	ControlFixture fixture;
	BStatusBar bar(BRect(10, 10, 209, 12), "s");
	EXPECT_EQ("", OwnFieldNames(ArchiveOf(bar)));
	ExpectRoundTrip(fixture, bar);

	bar.SetBarHeight(20);
	bar.SetBarColor({ 0x11, 0x22, 0x33, 0x44 });
	bar.Reset("label", "tlabel");
	bar.SetMaxValue(50);
	bar.Update(5, "text", "ttext");
	const BMessage archive = ArchiveOf(bar);
	EXPECT_EQ("_high _bcolor _val _max _text _ttext _label _tlabel", OwnFieldNames(archive));
	EXPECT_EQ(0x44332211, archive.GetInt32("_bcolor", 0));
	EXPECT_EQ(5.0f, archive.GetFloat("_val", 0));
	ExpectRoundTrip(fixture, bar);
}


TEST(StatusBar, ResizeToPreferredGivesItItsHeight)
{
	ControlFixture fixture;
	BStatusBar* bar = fixture.Add(new BStatusBar(BRect(10, 10, 209, 40), "bar", "Label"));
	fixture.Locked([&] {
		float width, height;
		bar->GetPreferredSize(&width, &height);
		bar->ResizeTo(199, height + 20);
		bar->ResizeToPreferred();
		EXPECT_EQ(height, bar->Frame().Height());
	});
}
