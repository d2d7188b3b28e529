// What is painted when: updates, backgrounds, clipping, scrolling.
#include <gtest/gtest.h>

#include <random>
#include <string>
#include <vector>

#include <AppDefs.h>
#include <Bitmap.h>
#include <Message.h>
#include <MessageFilter.h>
#include <Region.h>
#include <View.h>
#include <Window.h>

#include "PaintedViews.h"


TEST(ViewUpdate, ManyInvalidationsAreOneUpdate)
{
	int updates = 0;
	TestWindow window;
	auto filter = new CountUpdates(&updates);
	PaintView* view = window.Add(new PaintView(BRect(0, 0, 199, 199), kRed));
	window.Locked([&] { window.Window()->AddCommonFilter(filter); });
	const int before = view->drawn;
	window.Locked([&] {
		for (int i = 0; i < 100; i++)
			view->Invalidate(BRect(i, i, i + 3, i + 3));
		EXPECT_EQ(before, view->drawn);
	});
	EXPECT_EQ(before + 1, view->drawn);
	EXPECT_EQ(1, updates);
	EXPECT_EQ(window.Window(), filter->targets[0]);
	EXPECT_EQ(BRect(0, 0, 102, 102), view->update);
}


TEST(ViewUpdate, DrawingComesParentsFirstInChildOrderAndOnlyWhereDirty)
{
	std::vector<BView*> log;
	TestWindow window;
	PaintView* parent = new PaintView(BRect(0, 0, 199, 199), kWhite);
	PaintView* a = new PaintView(BRect(0, 0, 49, 49), kRed);
	PaintView* b = new PaintView(BRect(25, 25, 74, 74), kGreen);
	PaintView* far = new PaintView(BRect(100, 100, 149, 149), kBlue);
	for (PaintView* view : { parent, a, b, far })
		view->log = &log;
	parent->AddChild(a);
	parent->AddChild(b);
	parent->AddChild(far);
	window.Add(parent);
	EXPECT_EQ((std::vector<BView*> { parent, a, b, far }), log);
	EXPECT_EQ(kGreen, window.driver.PixelAt(parent, BPoint(30, 30)));

	// A sibling in front is drawn again with what is behind it.
	log.clear();
	window.Locked([&] { a->Invalidate(BRect(30, 30, 40, 40)); });
	EXPECT_EQ((std::vector<BView*> { a, b }), log);
	EXPECT_EQ(BRect(5, 5, 15, 15), b->update);
	EXPECT_EQ(kGreen, window.driver.PixelAt(parent, BPoint(30, 30)));
}


TEST(ViewUpdate, InvalidateMeansTheDescendantsToo)
{
	TestWindow window;
	PaintView* parent = new PaintView(BRect(0, 0, 99, 99), kWhite);
	PaintView* child = new PaintView(BRect(0, 0, 99, 99), kRed);
	parent->AddChild(child);
	window.Add(parent);
	const int before = child->drawn;
	window.Locked([&] { parent->Invalidate(); });
	EXPECT_EQ(before + 1, child->drawn);
}


TEST(ViewUpdate, ATransparentViewInFrontIsDrawnWithWhatIsBehind)
{
	TestWindow window;
	PaintView* behind = window.Add(new PaintView(BRect(0, 0, 99, 99), kRed));
	PaintView* front = new PaintView(BRect(0, 0, 99, 99), B_TRANSPARENT_COLOR);
	front->onDraw = [&] {
		front->SetHighColor(kBlue);
		front->StrokeRect(BRect(10, 10, 20, 20));
	};
	window.Add(front);
	EXPECT_EQ(kBlue, window.driver.PixelAt(front, BPoint(10, 10)));
	EXPECT_EQ(kRed, window.driver.PixelAt(front, BPoint(11, 11)));
	const int before = front->drawn;
	window.Locked([&] { behind->Invalidate(BRect(0, 0, 50, 50)); });
	EXPECT_EQ(before + 1, front->drawn);
	EXPECT_EQ(kBlue, window.driver.PixelAt(front, BPoint(10, 10)));
}


TEST(ViewUpdate, StateThatDrawSetsDoesNotSurvive)
{
	TestWindow window;
	PaintView* view = new PaintView(BRect(0, 0, 99, 99), kWhite);
	view->SetHighColor(kGreen);
	view->SetOrigin(3, 4);
	view->onDraw = [&] {
		EXPECT_EQ(kGreen, view->HighColor());
		EXPECT_EQ(BPoint(3, 4), view->Origin());
		view->SetHighColor(kRed);
		view->SetPenSize(5);
		view->SetOrigin(0, 0);
		view->PushState();
		view->SetLowColor(kBlue);
		BRegion region(BRect(0, 0, 5, 5));
		view->ConstrainClippingRegion(&region);
		view->FillRect(view->Bounds());
	};
	window.Add(view);
	EXPECT_EQ(1, view->drawn);
	EXPECT_EQ(kGreen, view->HighColor());
	EXPECT_EQ(1, view->PenSize());
	EXPECT_EQ(kWhite, view->LowColor());
	EXPECT_EQ(BPoint(3, 4), view->Origin());
	EXPECT_EQ(kRed, window.driver.PixelAt(view, BPoint(5, 5)));
	EXPECT_EQ(kWhite, window.driver.PixelAt(view, BPoint(6, 6)));
	window.Locked([&] {
		BRegion region;
		view->GetClippingRegion(&region);
		EXPECT_EQ("(0,0,99,99)", rects(region));
	});
}


TEST(ViewUpdate, DrawingOutsideOfAnUpdateIsShownAndLeavesItsState)
{
	TestWindow window;
	PaintView* view = window.Add(new PaintView(BRect(0, 0, 99, 99), kWhite));
	window.Locked([&] {
		view->SetHighColor(kBlue);
		view->FillRect(BRect(10, 10, 20, 20));
	});
	EXPECT_EQ(kBlue, view->HighColor());
	EXPECT_EQ(kBlue, window.driver.PixelAt(view, BPoint(15, 15)));
	EXPECT_EQ(1, view->drawn);
}


TEST(ViewUpdate, DrawOnChildrenPaintsOverThem)
{
	TestWindow window;
	PaintView* parent = new PaintView(BRect(0, 0, 99, 99), kWhite, B_DRAW_ON_CHILDREN);
	parent->AddChild(new PaintView(BRect(20, 20, 59, 59), kRed));
	parent->onDraw = [&] {
		parent->SetHighColor(kGreen);
		parent->FillRect(BRect(0, 30, 99, 39));
	};
	parent->onDrawAfter = [&] {
		parent->SetHighColor(kBlue);
		parent->FillRect(BRect(0, 50, 99, 52));
	};
	window.Add(parent);
	EXPECT_EQ(1, parent->drawnAfter);
	EXPECT_EQ(kGreen, window.driver.PixelAt(parent, BPoint(10, 35)));
	EXPECT_EQ(kRed, window.driver.PixelAt(parent, BPoint(30, 35)));
	EXPECT_EQ(kBlue, window.driver.PixelAt(parent, BPoint(30, 51)));
}


TEST(ViewUpdate, GrowingDirtiesTheNewPartAlone)
{
	TestWindow window;
	PaintView* part = window.Add(new PaintView(BRect(0, 0, 99, 99), kRed));
	PaintView* whole =
		window.Add(new PaintView(BRect(150, 0, 249, 99), kRed, B_FULL_UPDATE_ON_RESIZE));
	window.Locked([&] {
		part->ResizeBy(10, 0);
		whole->ResizeBy(10, 0);
	});
	EXPECT_EQ(BRect(100, 0, 109, 99), part->update);
	EXPECT_EQ(BRect(0, 0, 109, 99), whole->update);

	const int before = part->drawn;
	window.Locked([&] { part->ResizeBy(-20, -20); });
	EXPECT_EQ(before, part->drawn);
	EXPECT_EQ(kWhite, window.driver.PixelAt(BPoint(50 + 105, 50 + 10)));
}


TEST(ViewUpdate, MovingRepaintsBothPlaces)
{
	TestWindow window;
	PaintView* view = window.Add(new PaintView(BRect(0, 0, 9, 9), kRed));
	window.Locked([&] { view->MoveBy(20, 0); });
	EXPECT_EQ(kWhite, window.driver.PixelAt(BPoint(55, 55)));
	EXPECT_EQ(kRed, window.driver.PixelAt(BPoint(75, 55)));
	window.Locked([&] { view->Hide(); });
	EXPECT_EQ(kWhite, window.driver.PixelAt(BPoint(75, 55)));
	window.Locked([&] { view->Show(); });
	EXPECT_EQ(kRed, window.driver.PixelAt(BPoint(75, 55)));
	window.Locked([&] {
		view->RemoveSelf();
		delete view;
	});
	EXPECT_EQ(kWhite, window.driver.PixelAt(BPoint(75, 55)));
}


TEST(ViewUpdate, UpdateIfNeededPaintsInTheMiddleOfAHook)
{
	class Asker : public PaintView {
	public:
		Asker() : PaintView(BRect(0, 0, 99, 99), kWhite) {}
		void MessageReceived(BMessage* message) override
		{
			if (message->what != 'test')
				return;
			const int before = drawn;
			Invalidate();
			seen = drawn - before;
			Window()->UpdateIfNeeded();
			seenAfter = drawn - before;
		}
		int seen = -1;
		int seenAfter = -1;
	};
	TestWindow window;
	Asker* view = window.Add(new Asker);
	window.Window()->PostMessage('test', view);
	Driver::WaitUntilIdle();
	EXPECT_EQ(0, view->seen);
	EXPECT_EQ(1, view->seenAfter);
	EXPECT_EQ(2, view->drawn);
}


TEST(ViewUpdate, DisabledUpdatesAreMadeUpFor)
{
	TestWindow window;
	PaintView* view = window.Add(new PaintView(BRect(0, 0, 99, 99), kWhite));
	window.Locked([&] {
		window.Window()->DisableUpdates();
		view->Invalidate();
	});
	EXPECT_EQ(1, view->drawn);
	window.Locked([&] { window.Window()->EnableUpdates(); });
	EXPECT_EQ(2, view->drawn);
}


TEST(ViewUpdate, NothingOfATransactionIsShownBeforeItsEnd)
{
	TestWindow window;
	PaintView* view = window.Add(new PaintView(BRect(0, 0, 99, 99), kWhite));
	window.Locked([&] {
		window.Window()->BeginViewTransaction();
		view->SetHighColor(kRed);
		view->FillRect(BRect(0, 0, 9, 9));
		view->Flush();
	});
	EXPECT_EQ(kWhite, window.driver.PixelAt(view, BPoint(5, 5)));
	window.Locked([&] { window.Window()->EndViewTransaction(); });
	EXPECT_EQ(kRed, window.driver.PixelAt(view, BPoint(5, 5)));
}


TEST(ViewUpdate, OfManyViewsOnlyThoseThatWereTouchedAreDrawn)
{
	constexpr int kViews = 10000;
	std::vector<BView*> log;
	TestWindow window(BRect(0, 0, 999, 999));
	PaintView* parent = new PaintView(BRect(0, 0, 999, 999), kWhite);
	std::vector<PaintView*> views;
	for (int i = 0; i < kViews; i++) {
		const BPoint at(i % 100 * 10, i / 100 * 10);
		views.push_back(new PaintView(BRect(at.x, at.y, at.x + 7, at.y + 7), kRed));
		views.back()->log = &log;
		parent->AddChild(views.back());
	}
	window.Add(parent);
	EXPECT_EQ(size_t(kViews), log.size());
	log.clear();
	window.Locked([&] { views[5050]->MoveBy(1, 0); });
	EXPECT_EQ((std::vector<BView*> { views[5050] }), log);
	log.clear();
	window.Locked([&] {
		for (PaintView* view : views)
			view->MoveBy(0, 1);
	});
	EXPECT_EQ(size_t(kViews), log.size());
}


TEST(ViewUpdate, AViewBitmapLiesOverTheColourAndIsTiled)
{
	TestWindow window;
	PaintView* view = window.Add(new PaintView(BRect(0, 0, 99, 99), kGreen));
	BBitmap bitmap(BRect(0, 0, 1, 1), B_RGB32);
	const uint32 pixels[4] = { 0xffff0000, 0xff0000ff, 0xff0000ff, 0xffff0000 };
	bitmap.SetBits(pixels, sizeof(pixels), 0, B_RGB32);
	window.Locked([&] { view->SetViewBitmap(&bitmap); });
	EXPECT_EQ(kRed, window.driver.PixelAt(view, BPoint(0, 0)));
	EXPECT_EQ(kBlue, window.driver.PixelAt(view, BPoint(51, 50)));
	window.Locked([&] { view->SetViewBitmap(&bitmap, B_FOLLOW_LEFT | B_FOLLOW_TOP, 0); });
	EXPECT_EQ(kRed, window.driver.PixelAt(view, BPoint(1, 1)));
	EXPECT_EQ(kGreen, window.driver.PixelAt(view, BPoint(2, 2)));
	window.Locked([&] { view->ClearViewBitmap(); });
	EXPECT_EQ(kGreen, window.driver.PixelAt(view, BPoint(1, 1)));
}
