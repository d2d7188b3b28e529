// What a slider asks of classes that change its looks.
#include <Slider.h>

#include <string>

#include <Font.h>

#include "ControlFixture.h"

namespace {


class HookedSlider : public BSlider {
public:
	HookedSlider(const char* label = "Label") :
		BSlider(BRect(20, 20, 236, 40), "slider", label, NULL, 0, 100)
	{
	}

	void DrawSlider() override
	{
		_Note("slider", [this] { BSlider::DrawSlider(); });
	}
	void DrawBar() override
	{
		_Note("bar", [this] { BSlider::DrawBar(); });
	}
	void DrawHashMarks() override
	{
		_Note("marks", [this] { BSlider::DrawHashMarks(); });
	}
	void DrawThumb() override
	{
		_Note("thumb", [this] { BSlider::DrawThumb(); });
	}
	void DrawFocusMark() override
	{
		_Note("focus", [this] { BSlider::DrawFocusMark(); });
	}
	void DrawText() override
	{
		_Note("text", [this] { BSlider::DrawText(); });
	}
	const char* UpdateText() const override { return status.empty() ? NULL : status.c_str(); }

	std::string drawn; // the hooks that came, in their order
	std::string status;
	std::string skipped; // a hook that draws nothing

private:
	template<class Base> void _Note(const char* hook, Base base)
	{
		drawn += (drawn.empty() ? "" : " ") + std::string(hook);
		if (skipped != hook)
			base();
	}
};


// How many pixels of the rectangle are not of the panel's colour.
int
Ink(ControlFixture& fixture, BView* view, BRect area)
{
	const rgb_color panel = { 216, 216, 216, 255 };
	int ink = 0;
	for (float y = area.top; y <= area.bottom; y++) {
		for (float x = area.left; x <= area.right; x++)
			ink += fixture.driver.PixelAt(view, BPoint(x, y)) != panel;
	}
	return ink;
}


BRect
StatusArea(const BSlider* slider)
{
	return BRect(slider->Bounds().Width() / 2, 0, slider->Bounds().right, 12);
}

} // namespace


TEST(SliderHooks, AreCalledInTheirOrderByEachDraw)
{
	ControlFixture fixture;
	HookedSlider* slider = fixture.Add(new HookedSlider);
	fixture.Locked([&] {
		slider->drawn.clear();
		slider->Invalidate();
	});
	EXPECT_EQ("slider bar marks thumb focus text", slider->drawn);
}


TEST(SliderHooks, DrawOnlyTheirPart)
{
	ControlFixture fixture;
	HookedSlider* slider = fixture.Add(new HookedSlider(NULL));
	const int whole = Ink(fixture, slider, slider->Bounds());
	const BRect thumb = slider->ThumbFrame();
	const int thumbInk = Ink(fixture, slider, thumb);
	fixture.Locked([&] {
		slider->skipped = "thumb";
		slider->Invalidate();
	});
	EXPECT_LT(Ink(fixture, slider, thumb), thumbInk) << "DrawThumb() drew it";
	EXPECT_LT(Ink(fixture, slider, slider->Bounds()), whole);
	const BRect bar = slider->BarFrame();
	EXPECT_GT(Ink(fixture, slider, bar), 0);
	fixture.Locked([&] {
		slider->skipped = "bar";
		slider->Invalidate();
	});
	EXPECT_EQ(0, Ink(fixture, slider, BRect(thumb.right + 2, bar.top, bar.right, bar.bottom)))
		<< "DrawBar() drew it";
}


TEST(SliderHooks, HashMarksLieInTheirFrame)
{
	ControlFixture fixture;
	HookedSlider* slider = fixture.Add(new HookedSlider(NULL));
	const BRect bar = slider->BarFrame(), marks = slider->HashMarksFrame();
	EXPECT_EQ(bar.InsetByCopy(0, -6), marks);
	const BRect above(bar.left, marks.top, bar.right, bar.top - 2);
	fixture.Locked([&] { slider->SetPosition(0.5f); });
	const int before = Ink(fixture, slider, above);
	fixture.Locked([&] {
		slider->SetHashMarkCount(5);
		slider->SetHashMarks(B_HASH_MARKS_TOP);
	});
	// DrawHashMarks() has drawn five pairs of lines.
	EXPECT_GE(Ink(fixture, slider, above), before + 4 * 4);
}


TEST(SliderHooks, TheFocusMarkIsForTheFocusInAnActiveWindow)
{
	ControlFixture fixture;
	HookedSlider* slider = fixture.Add(new HookedSlider);
	const auto picture = [&] {
		std::string pixels;
		const BRect bounds = slider->Bounds();
		for (float y = 0; y <= bounds.bottom; y++) {
			for (float x = 0; x <= 40; x++) {
				const rgb_color pixel = fixture.driver.PixelAt(slider, BPoint(x, y));
				pixels += { char(pixel.red), char(pixel.green), char(pixel.blue) };
			}
		}
		return pixels;
	};
	const std::string plain = picture();
	fixture.Focus(slider);
	const std::string focused = picture();
	EXPECT_NE(plain, focused) << "DrawFocusMark()";

	BWindow* other = new BWindow(BRect(600, 50, 700, 150), "Other", B_TITLED_WINDOW, 0);
	other->Show();
	fixture.driver.ActivateWindow(other);
	EXPECT_EQ(plain, picture()) << "WindowActivated(false)";
	fixture.driver.ActivateWindow(fixture.window);
	EXPECT_EQ(focused, picture());
	BMessenger(other).SendMessage(B_QUIT_REQUESTED);
	Driver::WaitUntilIdle();
}


TEST(SliderHooks, TheStatusTextStandsAtTheRight)
{
	ControlFixture fixture;
	HookedSlider* slider = fixture.Add(new HookedSlider);
	EXPECT_EQ(0, Ink(fixture, slider, StatusArea(slider)));
	fixture.Locked([&] {
		slider->status = "0 %";
		slider->UpdateTextChanged();
	});
	const int first = Ink(fixture, slider, StatusArea(slider));
	EXPECT_GT(first, 0) << "what UpdateText() says";

	fixture.Locked([&] { slider->drawn.clear(); });
	fixture.Locked([&] { slider->UpdateTextChanged(); });
	EXPECT_EQ("", slider->drawn) << "it says the same";
	fixture.Locked([&] {
		slider->status = "100 percent";
		slider->UpdateTextChanged();
	});
	EXPECT_GT(Ink(fixture, slider, StatusArea(slider)), first);
}


TEST(SliderHooks, DrawInTheSliderItself)
{
	ControlFixture fixture;
	HookedSlider* slider = fixture.Add(new HookedSlider);
	EXPECT_EQ(slider, slider->OffscreenView());
}


TEST(SliderHooks, SettersKeepWhatTheyAreGiven)
{
	ControlFixture fixture;
	HookedSlider* slider = fixture.Add(new HookedSlider);
	fixture.Locked([&] {
		slider->SetFlags(B_WILL_DRAW);
		EXPECT_EQ(static_cast<uint32>(B_WILL_DRAW), slider->Flags());
		slider->SetResizingMode(B_FOLLOW_RIGHT | B_FOLLOW_BOTTOM);
		EXPECT_EQ(static_cast<uint32>(B_FOLLOW_RIGHT | B_FOLLOW_BOTTOM), slider->ResizingMode());
	});
	const BPoint before = slider->Frame().LeftTop();
	fixture.driver.ResizeWindow(fixture.window, 419, 309);
	EXPECT_EQ(before + BPoint(20, 10), slider->Frame().LeftTop());
}


TEST(SliderHooks, ALargerFontMakesItHigher)
{
	ControlFixture fixture;
	HookedSlider* slider = fixture.Add(new HookedSlider);
	float width, before, after;
	fixture.Locked([&] {
		slider->GetPreferredSize(&width, &before);
		BFont font(be_plain_font);
		font.SetSize(24);
		slider->SetFont(&font);
		slider->GetPreferredSize(&width, &after);
	});
	EXPECT_GT(after, before + 10);
}


TEST(SliderHooks, InvokeSendsTheValue)
{
	ControlFixture fixture;
	HookedSlider* slider = fixture.Add(new HookedSlider);
	fixture.Locked([&] {
		slider->SetMessage(new BMessage('slid'));
		slider->SetValue(7);
		EXPECT_EQ(B_OK, slider->Invoke());
	});
	const std::vector<BMessage> sent = fixture.Received('slid');
	ASSERT_EQ(1u, sent.size());
	ExpectInvocationFields(sent[0], slider, 7);
}
