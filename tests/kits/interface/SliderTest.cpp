#include <Slider.h>

#include <cmath>

#include <Font.h>

#include "ControlFixture.h"

namespace {

constexpr uint32 kInvoked = 'invk';
constexpr uint32 kModified = 'modi';

BSlider*
NewSlider(orientation direction = B_HORIZONTAL)
{
	BSlider* slider =
		new BSlider(direction == B_HORIZONTAL ? BRect(20, 20, 236, 40) : BRect(20, 20, 60, 236),
			"slider", NULL, new BMessage(kInvoked), 0, 100, direction);
	slider->SetModificationMessage(new BMessage(kModified));
	return slider;
}


float
TextLine()
{
	font_height height;
	be_plain_font->GetHeight(&height);
	return std::ceil(height.ascent) + std::ceil(height.descent) + 4;
}

} // namespace


TEST(Slider, HasTheDefaultsOfItsClass)
{
	BApplication app("application/x-vnd.Archway-test");
	BSlider slider(BRect(0, 0, 99, 20), "s", "Label", NULL, 10, 20);
	EXPECT_EQ(static_cast<uint32>(B_NAVIGABLE | B_WILL_DRAW | B_FRAME_EVENTS), slider.Flags());
	EXPECT_EQ(10, slider.Value());
	EXPECT_EQ(20000, slider.SnoozeAmount());
	EXPECT_EQ(1, slider.KeyIncrementValue());
	EXPECT_EQ(0, slider.HashMarkCount());
	EXPECT_EQ(B_HASH_MARKS_NONE, slider.HashMarks());
	EXPECT_EQ(B_BLOCK_THUMB, slider.Style());
	EXPECT_EQ(B_HORIZONTAL, slider.Orientation());
	EXPECT_EQ(6, slider.BarThickness());
	EXPECT_EQ(nullptr, slider.MinLimitLabel());
	EXPECT_FALSE(slider.FillColor(NULL));
	EXPECT_EQ(nullptr, slider.ModificationMessage());
}


TEST(Slider, KeepsItsValuesInTheirRanges)
{
	BApplication app("application/x-vnd.Archway-test");
	BSlider slider(BRect(0, 0, 99, 20), "s", "Label", NULL, 10, 20);
	slider.SetValue(50);
	EXPECT_EQ(20, slider.Value());
	EXPECT_EQ(1, slider.Position());
	slider.SetPosition(0.5f);
	EXPECT_EQ(15, slider.Value());
	slider.SetLimits(0, 12);
	EXPECT_EQ(12, slider.Value());
	slider.SetLimits(9, 3);
	int32 min;
	int32 max;
	slider.GetLimits(&min, &max);
	EXPECT_EQ(0, min);
	EXPECT_EQ(12, max);
	slider.SetSnoozeAmount(1);
	EXPECT_EQ(10000, slider.SnoozeAmount());
	slider.SetSnoozeAmount(2000000);
	EXPECT_EQ(1000000, slider.SnoozeAmount());
}


TEST(Slider, PrefersRoomForItsTexts)
{
	BApplication app("application/x-vnd.Archway-test");
	BSlider slider(BRect(0, 0, 20, 5), "s", NULL, NULL, 0, 100);
	float width;
	float height;
	slider.GetPreferredSize(&width, &height);
	EXPECT_EQ(100, width);
	EXPECT_EQ(18, height);
	slider.SetLabel("Label");
	slider.GetPreferredSize(&width, &height);
	EXPECT_EQ(18 + TextLine(), height);
	slider.SetLimitLabels("low", "high");
	EXPECT_EQ(18 + 2 * TextLine(), slider.Bounds().Height());
	EXPECT_EQ(100, slider.Bounds().Width());

	BSlider upright(BRect(0, 0, 5, 50), "s", NULL, NULL, 0, 100, B_VERTICAL);
	upright.GetPreferredSize(&width, &height);
	EXPECT_EQ(18, width);
	EXPECT_EQ(100, height);
}


TEST(Slider, TakesItsPreferredSizeWhenAttachedButIsNeverNarrower)
{
	ControlFixture fixture;
	BSlider* slider = fixture.Add(NewSlider());
	fixture.Locked([&] { EXPECT_EQ(BRect(20, 20, 236, 38), slider->Frame()); });
}


TEST(Slider, APointMeansAValue)
{
	BApplication app("application/x-vnd.Archway-test");
	BSlider slider(BRect(0, 0, 118, 20), "s", NULL, NULL, 0, 100);
	// The bar goes from 8 to 110, its ends stand for the limits one pixel further in.
	EXPECT_EQ(BRect(8, 6, 110, 12), slider.BarFrame());
	EXPECT_EQ(0, slider.ValueForPoint(BPoint(9, 0)));
	EXPECT_EQ(50, slider.ValueForPoint(BPoint(59, 0)));
	EXPECT_EQ(100, slider.ValueForPoint(BPoint(109, 0)));
	EXPECT_EQ(0, slider.ValueForPoint(BPoint(-50, 0)));
	EXPECT_EQ(100, slider.ValueForPoint(BPoint(500, 0)));

	BSlider upright(BRect(0, 0, 20, 118), "s", NULL, NULL, 0, 100, B_VERTICAL);
	EXPECT_EQ(100, upright.ValueForPoint(BPoint(0, 9)));
	EXPECT_EQ(0, upright.ValueForPoint(BPoint(0, 109)));
}


TEST(Slider, ThePointerMovesItAndReleasingInvokes)
{
	ControlFixture fixture;
	BSlider* slider = fixture.Add(NewSlider());
	const auto xOf = [&](int32 value) { return 9 + 198 * value / 100.0f; };

	fixture.driver.MoveTo(slider, BPoint(xOf(30), 9));
	fixture.driver.Press();
	fixture.driver.MoveTo(slider, BPoint(xOf(60), 9));
	fixture.driver.MoveTo(slider, BPoint(xOf(70), 200));
	EXPECT_EQ(3, fixture.CountReceived(kModified));
	EXPECT_EQ(0, fixture.CountReceived(kInvoked));
	fixture.driver.Release();

	const std::vector<BMessage> modified = fixture.Received(kModified);
	ExpectInvocationFields(modified[0], slider, 30);
	ExpectInvocationFields(modified[1], slider, 60);
	const std::vector<BMessage> invoked = fixture.Received(kInvoked);
	ASSERT_EQ(1u, invoked.size());
	ExpectInvocationFields(invoked[0], slider, 70);
}


TEST(Slider, AClickThatChangesNothingInvokesNothing)
{
	ControlFixture fixture;
	BSlider* slider = fixture.Add(NewSlider());
	fixture.driver.Click(slider, BPoint(9, 9));
	EXPECT_EQ(0, fixture.CountReceived(kModified));
	EXPECT_EQ(0, fixture.CountReceived(kInvoked));
}


TEST(Slider, KeysMoveItByTheIncrement)
{
	ControlFixture fixture;
	BSlider* slider = fixture.Add(NewSlider());
	fixture.Locked([&] { slider->SetKeyIncrementValue(7); });
	fixture.Focus(slider);

	fixture.driver.KeyDown("Right");
	fixture.driver.KeyDown("Right");
	fixture.Locked([&] { EXPECT_EQ(14, slider->Value()); });
	EXPECT_EQ(2, fixture.CountReceived(kModified));
	EXPECT_EQ(0, fixture.CountReceived(kInvoked));
	fixture.driver.KeyUp("Right");
	EXPECT_EQ(1, fixture.CountReceived(kInvoked));

	fixture.driver.Key("Up");
	fixture.driver.Key("Left");
	fixture.driver.Key("Down");
	fixture.Locked([&] { EXPECT_EQ(7, slider->Value()); });
	fixture.driver.Key("End");
	fixture.Locked([&] { EXPECT_EQ(100, slider->Value()); });
	fixture.driver.Key("Home");
	fixture.Locked([&] { EXPECT_EQ(0, slider->Value()); });
	EXPECT_EQ(6, fixture.CountReceived(kInvoked));

	fixture.driver.Key("Left");
	EXPECT_EQ(6, fixture.CountReceived(kInvoked));
}


TEST(Slider, ADisabledOneDoesNothing)
{
	ControlFixture fixture;
	BSlider* slider = fixture.Add(NewSlider());
	fixture.Focus(slider);
	fixture.Locked([&] { slider->SetEnabled(false); });
	fixture.driver.Click(slider, BPoint(100, 9));
	fixture.driver.Key("Right");
	fixture.Locked([&] { EXPECT_EQ(0, slider->Value()); });
	EXPECT_EQ(0, fixture.CountReceived(kModified));
}


TEST(Slider, TheThumbStandsAtTheValue)
{
	ControlFixture fixture;
	for (const orientation direction : { B_HORIZONTAL, B_VERTICAL }) {
		BSlider* slider = fixture.Add(NewSlider(direction));
		fixture.Locked([&] {
			for (const int32 value : { 0, 25, 50, 100 }) {
				slider->SetValue(value);
				const BRect thumb = slider->ThumbFrame();
				EXPECT_EQ(value,
					slider->ValueForPoint(
						BPoint((thumb.left + thumb.right) / 2, (thumb.top + thumb.bottom) / 2)));
				EXPECT_TRUE(slider->Bounds().Contains(thumb));
			}
		});
	}
}


TEST(Slider, RevivesWhatItWrote)
{
	ControlFixture fixture;
	BSlider slider(BRect(10, 10, 209, 60), "s", "Label", new BMessage(kInvoked), -5, 50);
	const std::string always = "_sdelay _bcolor _min _max _incrementvalue _hashcount _hashloc "
							   "_sstyle _orient _bthickness";
	EXPECT_EQ("_msg _label " + always, OwnFieldNames(ArchiveOf(slider)));
	ExpectRoundTrip(fixture, slider);

	slider.SetValue(7);
	slider.SetModificationMessage(new BMessage(kModified));
	slider.SetLimitLabels("low", "");
	slider.SetHashMarks(B_HASH_MARKS_BOTH);
	slider.SetHashMarkCount(5);
	slider.SetStyle(B_TRIANGLE_THUMB);
	slider.SetBarColor({ 80, 80, 80, 0 });
	const rgb_color fill = { 0x11, 0x22, 0x33, 0x44 };
	slider.UseFillColor(true, &fill);
	const BMessage archive = ArchiveOf(slider);
	EXPECT_EQ("_msg _label _val _mod_msg _sdelay _bcolor _fcolor _minlbl _maxlbl _min _max "
			  "_incrementvalue _hashcount _hashloc _sstyle _orient _bthickness",
		OwnFieldNames(archive));
	EXPECT_EQ(0x44332211, archive.GetInt32("_fcolor", 0));
	EXPECT_EQ(1, archive.GetInt16("_sstyle", 0));
	ExpectRoundTrip(fixture, slider);
}


TEST(Slider, ReadsTheFormsOfOldArchives)
{
	BApplication app("application/x-vnd.Archway-test");
	BSlider slider(BRect(10, 10, 209, 60), "s", "Label", NULL, 0, 50);
	BMessage archive = ArchiveOf(slider);
	archive.RemoveName("_sstyle");
	archive.AddInt32("_sstyle", B_TRIANGLE_THUMB);
	const BMessage modification(kModified);
	std::vector<char> flat(modification.FlattenedSize());
	ASSERT_EQ(B_OK, modification.Flatten(flat.data(), flat.size()));
	archive.AddData("_mod_msg", B_RAW_TYPE, flat.data(), flat.size());

	std::unique_ptr<BSlider> revived = Revive<BSlider>(archive);
	EXPECT_EQ(B_TRIANGLE_THUMB, revived->Style());
	ASSERT_NE(nullptr, revived->ModificationMessage());
	EXPECT_EQ(kModified, revived->ModificationMessage()->what);
	EXPECT_TRUE(archive.HasSameData(ArchiveOf(*revived), false, true));
}


TEST(Slider, AbsentFieldsHaveTheirMeaning)
{
	BApplication app("application/x-vnd.Archway-test");
	BMessage archive;
	archive.AddString("class", "BSlider");
	archive.AddRect("_frame", BRect(0, 0, 100, 40));
	std::unique_ptr<BSlider> slider = Revive<BSlider>(archive);
	int32 min;
	int32 max;
	slider->GetLimits(&min, &max);
	EXPECT_EQ(0, min);
	EXPECT_EQ(100, max);
	EXPECT_EQ(11, slider->HashMarkCount());
	EXPECT_EQ(6, slider->BarThickness());
	EXPECT_TRUE(archive.HasSameData(ArchiveOf(*slider), false, true));
}
