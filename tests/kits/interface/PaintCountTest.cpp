// What painting and hit testing take, counted, and how it grows with the number of views.
#include <gtest/gtest.h>

#include <vector>

#include <Button.h>
#include <StringView.h>

#include "support/PaintCounter.h"
#include "support/TestWindow.h"

namespace {


const BRect kWindow(0, 0, 999, 999);


// Counts its Draw() calls.
class CountingView : public BView {
public:
	CountingView(BRect frame) : BView(frame, "view", B_FOLLOW_NONE, B_WILL_DRAW)
	{
		SetViewColor(200, 200, 200);
	}
	void Draw(BRect updateRect) override
	{
		FillRect(BRect(2, 2, 4, 4));
		StrokeLine(BPoint(0, 0), BPoint(5, 5));
	}
};


// A window with so many views of 8 × 8 in groups of a hundred.
struct Field : TestWindow {
	explicit Field(int count) : TestWindow(kWindow)
	{
		ground = new BView(kWindow, "ground", B_FOLLOW_NONE, B_WILL_DRAW);
		for (int i = 0; i < count; i++) {
			if (i % 100 == 0) {
				const BPoint at(0, static_cast<float>(i / 100) * 10);
				group = new BView(BRect(at, at + BPoint(999, 8)), "group", B_FOLLOW_NONE, 0);
				ground->AddChild(group);
			}
			const BPoint at(static_cast<float>(i % 100) * 10, 0);
			views.push_back(new CountingView(BRect(at, at + BPoint(7, 7))));
			group->AddChild(views.back());
		}
		Add(ground);
	}

	BView* ground; // child
	BView* group = nullptr; // the last one
	std::vector<CountingView*> views;
};


class PaintCount : public testing::TestWithParam<int> {};


} // namespace


TEST_P(PaintCount, OneStepOfOneViewIsOneFlushOfLittleMoreThanItself)
{
	Field field(GetParam());
	CountingView* view = field.views[field.views.size() / 2 + 50];
	PaintCounter counter(field.Window());
	for (int step = 0; step < 4; step++)
		field.Locked([&] { view->MoveBy(1, 0); });
	EXPECT_EQ(4, counter.Flushes());
	// Both places together are nine columns of eight pixels.
	EXPECT_LE(counter.FlushedPixels(), 4 * 2 * 9 * 8);
	// The view itself, what lies behind it, and the neighbour that it comes to lie on.
	EXPECT_LE(counter.Drawn(), 4 * 4);
	EXPECT_LE(counter.Clippings(), 4 * 4);
}


TEST_P(PaintCount, AChangeOfAllViewsIsPaintedAtOnce)
{
	Field field(GetParam());
	PaintCounter counter(field.Window());
	field.Locked([&] {
		for (CountingView* view : field.views) {
			view->SetViewColor(0, 100, 200);
			view->Invalidate();
			view->Invalidate(BRect(1, 1, 3, 3));
		}
	});
	EXPECT_LE(counter.Flushes(), 2);
	EXPECT_EQ(static_cast<int64>(field.views.size()),
		counter.Drawn() - counter.Drawn() % static_cast<int64>(field.views.size()));
	EXPECT_LE(counter.Clippings(), counter.Drawn());
}


TEST_P(PaintCount, MovingAllViewsMakesNoClippingBeforeTheyArePainted)
{
	Field field(GetParam());
	PaintCounter counter(field.Window());
	int64 during = -1;
	field.Locked([&] {
		for (CountingView* view : field.views) {
			view->MoveBy(1, 0);
			view->Hide();
			view->Show();
		}
		during = counter.Clippings();
	});
	EXPECT_EQ(0, during);
	EXPECT_LE(counter.Clippings(), 2 * static_cast<int64>(field.views.size() + 200));
}


// Down the tree once: the siblings before the view at each level, whatever else the window has.
TEST_P(PaintCount, AMouseMoveAsksOneSiblingAfterTheOther)
{
	Field field(GetParam());
	field.driver.MoveTo(BPoint(3, 3));
	PaintCounter counter(field.Window());
	const int64 groups = GetParam() / 100;
	field.driver.MoveTo(BPoint(504, static_cast<float>(groups - 1) * 10 + 4));
	EXPECT_GE(counter.HitTested(), groups);
	EXPECT_LE(counter.HitTested(), 1 + groups + 51);
}


TEST_P(PaintCount, TakingViewsOutIsPaintedAtOnce)
{
	Field field(GetParam());
	PaintCounter counter(field.Window());
	field.Locked([&] {
		for (CountingView* view : field.views) {
			view->RemoveSelf();
			delete view;
		}
	});
	EXPECT_GE(counter.Flushes(), 1);
	EXPECT_LE(counter.Flushes(), 2);
	EXPECT_LE(counter.Drawn(), GetParam() / 100 + 10);
}


INSTANTIATE_TEST_SUITE_P(Growth, PaintCount, testing::Values(1000, 3000, 10000));


TEST(PaintCounts, MovementsThatComeTogetherAreOneFlush)
{
	Field field(100);
	PaintCounter counter(field.Window());
	field.Locked([&] {
		for (int step = 0; step < 50; step++)
			field.views[55]->MoveBy(1, 0);
	});
	EXPECT_EQ(1, counter.Flushes());
}
