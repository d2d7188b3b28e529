// One step of the user's is painted once and shown once, and little more than what it changes.

#include <functional>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include <Box.h>
#include <Button.h>
#include <Slider.h>
#include <StringView.h>

#include "addon/EditorScene.h"
#include "interface/private/WindowInternals.h"
#include "support/PaintCounter.h"

namespace {


constexpr bigtime_t kMinute = 60000000;


// A panel with a slider, which has many panels of its own, between other controls.
BMessage
Design()
{
	BView root(BRect(0, 0, 399, 299), "root", B_FOLLOW_LEFT | B_FOLLOW_TOP, B_WILL_DRAW);
	root.SetViewColor(216, 216, 216);
	BBox* box = new BBox(BRect(10, 10, 389, 199), "box");
	root.AddChild(box);
	box->AddChild(new BButton(BRect(20, 30, 119, 54), "button", "Press", NULL));
	box->AddChild(new BSlider(BRect(20, 80, 249, 120), "slider", "How much", NULL, 0, 99));
	box->AddChild(new BStringView(BRect(150, 30, 300, 50), "text", "Some text"));
	BMessage archive;
	root.Archive(&archive, true);
	return archive;
}


float
AreaOf(BRect rect)
{
	return (rect.Width() + 1) * (rect.Height() + 1);
}


class OneStep : public testing::TestWithParam<const char*> {
protected:
	OneStep()
	{
		BPrivate::WindowInternals::presentDelay = kMinute; // a busy machine counts alike
		scene.Open(Design());
		view = scene.Root()->FindView(GetParam());
		scene.Input().Click(view, BPoint(3, 3));
		EXPECT_EQ(view, scene.Work()->SelectedView());
	}

	// What may change at a step: the view at both places, and the fields that show its frame.
	float MostChanged(BRect before, int32 fields)
	{
		constexpr float kField = 50 * 20;
		return AreaOf(before | view->Frame()) + static_cast<float>(fields) * kField;
	}

	EditorScene scene;
	BView* view;
};


} // namespace


TEST_P(OneStep, OfAnArrowKeyIsShownOnce)
{
	PaintCounter counter(scene.Window());
	for (const char* key : { "Right", "Down", "Left", "Up", "Right" }) {
		const BRect before = view->Frame();
		counter.Reset();
		scene.Input().Key(key);
		EXPECT_NE(before, view->Frame());
		EXPECT_EQ(1, counter.Flushes()) << key;
		EXPECT_LE(counter.FlushedPixels(), 2 * MostChanged(before, 2)) << key;
	}
}


TEST_P(OneStep, OfAResizeIsShownOnce)
{
	const BRect bounds = view->Bounds();
	scene.Input().MoveTo(view, BPoint(bounds.right - 2, bounds.bottom - 2));
	scene.Input().Press();
	const BPoint start = Driver::PointIn(view, BPoint(bounds.right - 2, bounds.bottom - 2));
	PaintCounter counter(scene.Window());
	for (int32 step = 1; step <= 5; step++) {
		const BRect before = view->Frame();
		counter.Reset();
		scene.Input().MoveTo(start + BPoint(static_cast<float>(step), static_cast<float>(step)));
		EXPECT_EQ(before.right + 1, view->Frame().right);
		EXPECT_EQ(1, counter.Flushes()) << step;
		EXPECT_LE(counter.FlushedPixels(), 2 * MostChanged(before, 2)) << step;
	}
	scene.Input().Release();
}


TEST_P(OneStep, OfADragOverAnotherViewIsShownOnce)
{
	scene.Input().MoveTo(view, BPoint(3, 3));
	scene.Input().Press();
	BView* root = scene.Root();
	BView* box = root->FindView("box");
	ASSERT_EQ(box, scene.Work()->SelectedView()); // the view is under way
	scene.Input().MoveTo(root, BPoint(50, 250));
	PaintCounter counter(scene.Window());
	for (float x = 60; x < 100; x += 10) {
		scene.Input().MoveTo(root, BPoint(x, 260));
		EXPECT_EQ(0, counter.Flushes());
	}
	scene.Input().MoveTo(box, BPoint(30, 150));
	EXPECT_EQ(box, scene.Work()->SelectedView());
	EXPECT_EQ(1, counter.Flushes());
	scene.Input().Release();
}


TEST_P(OneStep, OfAClickIsShownOnce)
{
	BView* root = scene.Root();
	PaintCounter counter(scene.Window());
	scene.Input().Click(root, BPoint(50, 250));
	EXPECT_EQ(root, scene.Work()->SelectedView());
	EXPECT_EQ(1, counter.Flushes());
}


INSTANTIATE_TEST_SUITE_P(OfEach, OneStep, testing::Values("button", "slider", "text"),
	[](const auto& info) { return std::string(info.param); });
