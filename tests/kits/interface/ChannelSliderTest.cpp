#include <ChannelSlider.h>

#include <set>
#include <string>
#include <vector>

#include <Bitmap.h>

#include "ControlFixture.h"
#include "support/Dump.h"

namespace {

constexpr uint32 kInvoked = 'invk';
constexpr uint32 kModified = 'modi';

// Without texts a lane of a thumb's 13 pixels comes every 16, and thumbs go over 200 pixels.
BChannelSlider*
NewSlider(orientation posture = B_HORIZONTAL, int32 channels = 3)
{
	const BRect frame = posture == B_HORIZONTAL ? BRect(20, 20, 236, 64) : BRect(20, 20, 64, 236);
	BChannelSlider* slider = new BChannelSlider(frame, "slider", NULL, new BMessage(kInvoked),
		posture, channels, B_FOLLOW_NONE, B_WILL_DRAW | B_NAVIGABLE);
	slider->SetModificationMessage(new BMessage(kModified));
	return slider;
}


std::string
ValuesOf(const BMessage& message)
{
	std::string text;
	int32 value;
	for (int32 i = 0; message.FindInt32("be:channel_value", i, &value) == B_OK; i++)
		text += (i > 0 ? " " : "") + std::to_string(value)
			+ (message.GetBool("be:channel_changed", i, false) ? "!" : "");
	return text;
}


std::string
ValuesOf(ControlFixture& fixture, const BChannelSlider* slider)
{
	return fixture.Locked([&] {
		std::string text;
		for (int32 i = 0; i < slider->CountChannels(); i++)
			text += (i > 0 ? " " : "") + std::to_string(slider->ValueFor(i));
		return text;
	});
}


// The middle of a horizontal slider's thumb.
BPoint
ThumbPlace(int32 channel, float delta)
{
	return BPoint(8 + delta, 6 + 16.0f * channel);
}


BMessage
ArchiveWith(int32 count, int32 entries)
{
	BMessage archive = ArchiveOf(BChannelSlider(BRect(0, 0, 99, 40), "s", "Label", NULL, 2));
	for (const char* name : { "be:_m_channel_min", "be:_m_channel_max", "be:_m_channel_val" }) {
		archive.RemoveName(name);
		for (int32 i = 0; i < entries; i++)
			archive.AddInt32(name, i * 3);
	}
	archive.ReplaceInt32("be:_m_channel_count", count);
	return archive;
}

} // namespace


TEST(ChannelSlider, HasTheDefaultsOfItsClass)
{
	BApplication app("application/x-vnd.Archway-test");
	BChannelSlider slider(BRect(0, 0, 99, 20), "s", "Label", NULL);
	EXPECT_EQ(static_cast<uint32>(B_WILL_DRAW | B_FRAME_EVENTS), slider.Flags());
	EXPECT_EQ(1, slider.CountChannels());
	EXPECT_EQ(32, slider.MaxChannelCount());
	EXPECT_EQ(B_HORIZONTAL, slider.Orientation());
	EXPECT_FALSE(slider.SupportsIndividualLimits());
	EXPECT_EQ(B_VERTICAL,
		BChannelSlider(BRect(0, 0, 99, 20), "s", NULL, NULL, B_VERTICAL, 2).Orientation());
	EXPECT_EQ(32, BChannelSlider(BRect(), "s", NULL, NULL, 1000000000).CountChannels());
	EXPECT_EQ(B_BAD_VALUE, slider.SetChannelCount(33));
	EXPECT_EQ(B_OK, slider.SetChannelCount(32));
}


TEST(ChannelSlider, ThumbsGoAlongTheirLanes)
{
	BApplication app("application/x-vnd.Archway-test");
	const std::unique_ptr<BChannelSlider> slider(NewSlider());
	EXPECT_EQ(BRect(0, 0, 16, 12), slider->ThumbFor(0, false)->Bounds());
	EXPECT_EQ(BRect(0, 0, 16, 12), slider->ThumbFrameFor(0));
	EXPECT_EQ(BRect(0, 32, 16, 44), slider->ThumbFrameFor(2));
	EXPECT_FALSE(slider->ThumbFrameFor(3).IsValid());
	EXPECT_EQ(200, slider->ThumbRangeFor(0));
	EXPECT_EQ(0, slider->ThumbRangeFor(-1));
	slider->SetValueFor(1, 25);
	EXPECT_EQ(50, slider->ThumbDeltaFor(1));

	const std::unique_ptr<BChannelSlider> upright(NewSlider(B_VERTICAL));
	EXPECT_EQ(BRect(16, 0, 28, 16), upright->ThumbFrameFor(1));
	EXPECT_EQ(200, upright->ThumbRangeFor(0));
	EXPECT_EQ(200, upright->ThumbDeltaFor(0)) << "the minimum is at the bottom";
	upright->SetLimitsFor(0, 50, 50);
	EXPECT_EQ(200, upright->ThumbDeltaFor(0));
	upright->SetOrientation(B_HORIZONTAL);
	EXPECT_EQ(BRect(0, 16, 16, 28), upright->ThumbFrameFor(1));
}


TEST(ChannelSlider, PrefersRoomForItsChannelsAndTexts)
{
	BApplication app("application/x-vnd.Archway-test");
	BChannelSlider slider(BRect(0, 0, 20, 5), "s", NULL, NULL, 3);
	float width;
	float plain;
	slider.GetPreferredSize(&width, &plain);
	EXPECT_EQ(100, width);
	EXPECT_EQ(44, plain);
	slider.SetLabel("Label");
	slider.SetLimitLabels("low", "high");
	slider.ResizeToPreferred();
	const float line = slider.ThumbFrameFor(0).top;
	EXPECT_LT(10, line);
	EXPECT_EQ(plain + 2 * line, slider.Bounds().Height());

	BChannelSlider upright(BRect(0, 0, 5, 50), "s", NULL, NULL, B_VERTICAL, 2);
	upright.ResizeToPreferred();
	EXPECT_EQ(BRect(0, 0, 28, 100), upright.Bounds());
	upright.SetLabel("A label as wide as this");
	float wide;
	upright.GetPreferredSize(&wide, NULL);
	EXPECT_LT(60, wide);

	BFont font;
	font.SetSize(20);
	slider.SetFont(&font);
	EXPECT_LT(line, slider.ThumbFrameFor(0).top);
}


TEST(ChannelSlider, DraggingMovesAllThumbsByTheSameAmount)
{
	ControlFixture fixture;
	BChannelSlider* slider = fixture.Add(NewSlider());
	fixture.Locked([&] {
		const int32 values[] = { 10, 20, 95 };
		slider->SetValue(0, 3, values);
	});
	// Taken beside its middle, a thumb does not jump.
	fixture.driver.MoveTo(slider, ThumbPlace(0, 20) + BPoint(3, 1));
	fixture.driver.Press();
	EXPECT_EQ("10 20 95", ValuesOf(fixture, slider));
	fixture.driver.MoveTo(slider, ThumbPlace(0, 40) + BPoint(3, 50));
	EXPECT_EQ("20 30 100", ValuesOf(fixture, slider));
	fixture.driver.MoveTo(slider, ThumbPlace(0, 30) + BPoint(3, 1));
	EXPECT_EQ("15 25 100", ValuesOf(fixture, slider)) << "distances come back";
	EXPECT_EQ(0, fixture.CountReceived(kInvoked));
	fixture.driver.Release();

	const std::vector<BMessage> modified = fixture.Received(kModified);
	ASSERT_EQ(2u, modified.size());
	EXPECT_EQ("20! 30! 100!", ValuesOf(modified[0]));
	EXPECT_EQ("15! 25! 100", ValuesOf(modified[1]));
	const std::vector<BMessage> sent = fixture.Received(kInvoked);
	ASSERT_EQ(1u, sent.size());
	ExpectInvocationFields(sent[0], slider, 15);
	EXPECT_EQ("15! 25! 100!", ValuesOf(sent[0]));
}


TEST(ChannelSlider, TheSecondaryButtonMovesOneThumb)
{
	ControlFixture fixture;
	BChannelSlider* slider = fixture.Add(NewSlider());
	fixture.driver.MoveTo(slider, ThumbPlace(1, 100));
	fixture.driver.Press(2);
	EXPECT_EQ("0 50 0", ValuesOf(fixture, slider)) << "the thumb comes to the pointer";
	fixture.driver.MoveTo(slider, ThumbPlace(1, 1000));
	fixture.driver.Release(2);
	EXPECT_EQ("0 100 0", ValuesOf(fixture, slider));
	fixture.Locked([&] {
		EXPECT_EQ(1, slider->CurrentChannel());
		EXPECT_EQ(100, slider->Value());
	});
	const std::vector<BMessage> sent = fixture.Received(kInvoked);
	ASSERT_EQ(1u, sent.size());
	EXPECT_EQ("0 100! 0", ValuesOf(sent[0]));
	EXPECT_EQ(1, sent[0].GetInt32("be:current_channel", -1));
}


TEST(ChannelSlider, AnUprightOneIsDraggedUp)
{
	ControlFixture fixture;
	BChannelSlider* slider = fixture.Add(NewSlider(B_VERTICAL));
	fixture.driver.MoveTo(slider, BPoint(22, 208));
	fixture.driver.Press(2);
	fixture.driver.MoveTo(slider, BPoint(22, 58));
	fixture.driver.Release(2);
	EXPECT_EQ("0 75 0", ValuesOf(fixture, slider));
}


TEST(ChannelSlider, AClickThatChangesNothingSendsNothing)
{
	ControlFixture fixture;
	BChannelSlider* slider = fixture.Add(NewSlider());
	fixture.driver.Click(slider, ThumbPlace(2, 0));
	fixture.driver.Click(slider, BPoint(100, 14));
	EXPECT_EQ(0, fixture.CountReceived(kInvoked));
	EXPECT_EQ(0, fixture.CountReceived(kModified));
	EXPECT_EQ("0 0 0", ValuesOf(fixture, slider));

	fixture.Locked([&] { slider->SetEnabled(false); });
	fixture.driver.Click(slider, ThumbPlace(2, 100));
	EXPECT_EQ("0 0 0", ValuesOf(fixture, slider));
}


TEST(ChannelSlider, KeysMoveTheCurrentChannelOrAll)
{
	ControlFixture fixture;
	BChannelSlider* slider = fixture.Add(NewSlider());
	fixture.Focus(slider);
	fixture.driver.Key("Right", 0, 3);
	fixture.driver.Key("Down");
	fixture.driver.Key("End");
	fixture.driver.Key("Left");
	EXPECT_EQ("3 99 0", ValuesOf(fixture, slider));
	EXPECT_EQ(5, fixture.CountReceived(kInvoked));
	fixture.driver.Key("Left", B_SHIFT_KEY, 2);
	EXPECT_EQ("1 97 0", ValuesOf(fixture, slider));
	fixture.driver.Key("Down", 0, 5);
	fixture.Locked([&] { EXPECT_EQ(2, slider->CurrentChannel()); });
	fixture.driver.Key("Up");
	fixture.driver.Key("Home");
	EXPECT_EQ("1 0 0", ValuesOf(fixture, slider));
	// Other keys are not the slider's.
	fixture.driver.Key("Space");
	fixture.driver.Key("Return");
	EXPECT_EQ("1 0 0", ValuesOf(fixture, slider));
}


TEST(ChannelSlider, AHeldKeyInvokesOnceWhenItIsReleased)
{
	ControlFixture fixture;
	BChannelSlider* slider = fixture.Add(NewSlider(B_VERTICAL));
	fixture.Focus(slider);
	fixture.driver.KeyDown("Up");
	fixture.driver.KeyDown("Up");
	EXPECT_EQ(0, fixture.CountReceived(kInvoked));
	EXPECT_EQ(2, fixture.CountReceived(kModified));
	fixture.driver.KeyUp("Up");
	const std::vector<BMessage> sent = fixture.Received(kInvoked);
	ASSERT_EQ(1u, sent.size());
	EXPECT_EQ("2! 0 0", ValuesOf(sent[0]));
	fixture.driver.Key("Right");
	fixture.driver.Key("Up");
	fixture.driver.Key("Down");
	fixture.driver.Key("Left");
	EXPECT_EQ("2 0 0", ValuesOf(fixture, slider));
	fixture.Locked([&] { EXPECT_EQ(0, slider->CurrentChannel()); });
}


TEST(ChannelSlider, FocusAndDisablingAreSeen)
{
	ControlFixture fixture;
	BChannelSlider* slider = fixture.Add(NewSlider());
	// The middle of the second thumb's left edge.
	const BPoint edge = ThumbPlace(1, -8);
	const rgb_color normal = fixture.driver.PixelAt(slider, edge);
	fixture.Focus(slider);
	EXPECT_EQ(normal, fixture.driver.PixelAt(slider, edge)) << "the first channel is current";
	fixture.driver.Key("Down");
	const rgb_color focused = fixture.driver.PixelAt(slider, edge);
	EXPECT_NE(normal, focused);
	EXPECT_LT(focused.red, focused.blue);
	fixture.Locked([&] { slider->SetEnabled(false); });
	const rgb_color disabled = fixture.driver.PixelAt(slider, edge);
	EXPECT_NE(focused, disabled);
	EXPECT_NE(normal, disabled);
	fixture.Locked([&] { slider->MakeFocus(false); });
}


TEST(ChannelSlider, AThumbIsDrawnWhereItsValueIs)
{
	ControlFixture fixture;
	BChannelSlider* slider = fixture.Add(NewSlider());
	const auto at = [&](float delta) {
		return fixture.driver.PixelAt(slider, ThumbPlace(1, delta) + BPoint(3, 0));
	};
	const rgb_color thumb = at(0);
	const rgb_color groove = at(100);
	EXPECT_NE(thumb, groove);
	fixture.Locked([&] { slider->SetValueFor(1, 50); });
	EXPECT_EQ(groove, at(0));
	EXPECT_EQ(thumb, at(100));
	fixture.Locked([&] { slider->ResizeBy(-100, 0); });
	EXPECT_EQ(thumb, at(50));
}


namespace {

// Has thumbs of its own and notes which channels are drawn.
class PictureSlider : public BChannelSlider {
public:
	PictureSlider() :
		BChannelSlider(BRect(20, 20, 139, 70), "pictures", NULL, NULL, B_HORIZONTAL, 2),
		fThumb(BRect(0, 0, 9, 9), B_RGBA32)
	{
		const uint32 red = 0xffff0000;
		for (int32 i = 0; i < fThumb.BitsLength(); i += 4)
			memcpy(static_cast<uint8*>(fThumb.Bits()) + i, &red, 4);
	}

	const BBitmap* ThumbFor(int32, bool) override { return &fThumb; }

	void DrawChannel(BView* into, int32 channel, BRect area, bool pressed) override
	{
		fDrawn.insert(channel);
		BChannelSlider::DrawChannel(into, channel, area, pressed);
	}

	void DrawGroove(BView* into, int32 channel, BPoint from, BPoint to) override
	{
		fGroove = to - from;
		BChannelSlider::DrawGroove(into, channel, from, to);
	}

	void DrawThumb(BView* into, int32 channel, BPoint where, bool pressed) override
	{
		if (pressed)
			fPressed.insert(channel);
		BChannelSlider::DrawThumb(into, channel, where, pressed);
	}

	BBitmap fThumb;
	std::set<int32> fDrawn;
	std::set<int32> fPressed;
	BPoint fGroove;
};

} // namespace


TEST(ChannelSlider, HooksDrawAndMeasureThumbs)
{
	ControlFixture fixture;
	PictureSlider* slider = fixture.Add(new PictureSlider);
	fixture.Locked([&] {
		EXPECT_EQ((std::set<int32> { 0, 1 }), slider->fDrawn);
		EXPECT_EQ(BPoint(110, 0), slider->fGroove);
		EXPECT_EQ(BRect(0, 13, 9, 22), slider->ThumbFrameFor(1));
		slider->fDrawn.clear();
		slider->SetValueFor(1, 100);
	});
	EXPECT_EQ((rgb_color { 255, 0, 0, 255 }), fixture.driver.PixelAt(slider, BPoint(115, 18)));
	fixture.Locked(
		[&] { EXPECT_EQ(std::set<int32> { 1 }, slider->fDrawn) << "only what has changed"; });
	fixture.driver.MoveTo(slider, BPoint(5, 5));
	fixture.driver.Press(2);
	fixture.Locked([&] { EXPECT_EQ(std::set<int32> { 0 }, slider->fPressed); });
	fixture.driver.Release(2);
	fixture.driver.Press();
	fixture.Locked([&] { EXPECT_EQ((std::set<int32> { 0, 1 }), slider->fPressed); });
	fixture.driver.Release();
}


TEST(ChannelSlider, ArchiveRoundTripKeepsEverything)
{
	ControlFixture fixture;
	BChannelSlider slider(
		BRect(10, 10, 209, 90), "s", "Label", new BMessage(kInvoked), B_VERTICAL, 3);
	slider.SetModificationMessage(new BMessage(kModified));
	slider.SetLimitLabels("low", "high");
	slider.SetLimitsFor(1, -20, 20);
	slider.SetValueFor(1, -7);
	slider.SetCurrentChannel(1);
	const BMessage archive = ArchiveOf(slider);
	EXPECT_EQ("_msg _label _val be:_m_channel_count be:_m_value_channel be:_m_min_label "
			  "be:_m_max_label be:_m_channel_min be:_m_channel_max be:_m_channel_val _mod_msg "
			  "_orient",
		OwnFieldNames(archive));
	EXPECT_EQ(-20, archive.GetInt32("be:_m_channel_min", 1, 0));
	EXPECT_EQ(100, archive.GetInt32("be:_m_channel_max", 2, 0));
	EXPECT_EQ(-7, archive.GetInt32("be:_m_channel_val", 1, 0));
	ExpectArchiveRoundTrip<BChannelSlider>(fixture, archive);

	const std::unique_ptr<BChannelSlider> revived = Revive<BChannelSlider>(archive);
	EXPECT_EQ(B_VERTICAL, revived->Orientation());
	EXPECT_EQ(3, revived->CountChannels());
	EXPECT_EQ(1, revived->CurrentChannel());
	EXPECT_EQ(-7, revived->Value());
	EXPECT_STREQ("high", revived->MaxLimitLabel());
	EXPECT_EQ(static_cast<uint32>(kModified), revived->ModificationMessage()->what);
	revived->SetChannelCount(2);
	const BMessage shorter = ArchiveOf(*revived);
	type_code type;
	int32 count = 0;
	EXPECT_EQ(B_OK, shorter.GetInfo("be:_m_channel_val", &type, &count));
	EXPECT_EQ(2, count);
}


TEST(ChannelSlider, StrangeArchivesAreReadAndWrittenBack)
{
	ControlFixture fixture;
	struct {
		int32 count, entries, channels;
	} const cases[] = { { -1, 2, 0 }, { INT32_MIN, 0, 0 }, { 0, 3, 0 }, { 3, 1, 3 }, { 1, 5, 1 },
		{ INT32_MAX, 2, 32 }, { 1000000000, 50, 32 }, { 40, 40, 32 }, { 2, 0, 2 } };
	for (const auto& [count, entries, channels] : cases) {
		SCOPED_TRACE(std::to_string(count) + " channels, " + std::to_string(entries));
		const BMessage archive = ArchiveWith(count, entries);
		EXPECT_EQ(channels, Revive<BChannelSlider>(archive)->CountChannels());
		ExpectArchiveRoundTrip<BChannelSlider>(fixture, archive);
	}
}


TEST(ChannelSlider, FieldsMayBeMissingOrOfAnotherType)
{
	ControlFixture fixture;
	const char* const names[] = { "be:_m_channel_count", "be:_m_value_channel", "be:_m_min_label",
		"be:_m_max_label", "be:_m_channel_min", "be:_m_channel_max", "be:_m_channel_val",
		"_mod_msg", "_orient" };
	BChannelSlider slider(BRect(10, 10, 209, 90), "s", "Label", NULL, B_VERTICAL, 3);
	slider.SetModificationMessage(new BMessage(kModified));
	for (const char* name : names) {
		SCOPED_TRACE(name);
		BMessage archive = ArchiveOf(slider);
		ASSERT_EQ(B_OK, archive.RemoveName(name));
		ExpectArchiveRoundTrip<BChannelSlider>(fixture, archive);
		archive.AddInt8(name, 5);
		ExpectArchiveRoundTrip<BChannelSlider>(fixture, archive);
		archive.RemoveName(name);
		for (int32 value : { 77, -77, INT32_MAX })
			archive.AddInt32(name, value);
		ExpectArchiveRoundTrip<BChannelSlider>(fixture, archive);
	}
}


TEST(ChannelSlider, ARevivedOneWorksAndKeepsLimitsInTheWrongOrder)
{
	ControlFixture fixture;
	BMessage archive = ArchiveOf(*std::unique_ptr<BChannelSlider>(NewSlider()));
	archive.ReplaceInt32("be:_m_channel_min", 2, 50);
	archive.ReplaceInt32("be:_m_channel_max", 2, -50);
	BChannelSlider* slider = fixture.Add(Revive<BChannelSlider>(archive).release());
	fixture.driver.Click(slider, ThumbPlace(0, 100), 1, 2);
	EXPECT_EQ("50 0 0", ValuesOf(fixture, slider));
	fixture.driver.Click(slider, ThumbPlace(2, 100), 1, 2);
	EXPECT_EQ("50 0 0", ValuesOf(fixture, slider));
	fixture.Locked([&] {
		const BMessage again = ArchiveOf(*slider);
		EXPECT_EQ(-50, again.GetInt32("be:_m_channel_max", 2, 0));
		EXPECT_EQ(50, again.GetInt32("be:_m_channel_val", 0, 0));
	});
}


TEST(ChannelSlider, ChannelsThatGoWhileAThumbIsHeldAreNotMissed)
{
	ControlFixture fixture;
	BChannelSlider* slider = fixture.Add(NewSlider());
	fixture.driver.MoveTo(slider, ThumbPlace(2, 50));
	fixture.driver.Press();
	EXPECT_EQ("25 25 25", ValuesOf(fixture, slider));
	fixture.Locked([&] { slider->SetChannelCount(1); });
	fixture.driver.MoveTo(slider, ThumbPlace(2, 100));
	EXPECT_EQ("50", ValuesOf(fixture, slider));
	fixture.Locked([&] { slider->SetChannelCount(0); });
	fixture.driver.MoveTo(slider, ThumbPlace(2, 20));
	fixture.driver.Release();
	EXPECT_EQ("", ValuesOf(fixture, slider));
	fixture.Locked([&] { slider->RemoveSelf(); });
	delete slider;
}
