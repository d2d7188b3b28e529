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

#include "support/TestWindow.h"

namespace {

constexpr rgb_color kRed = { 255, 0, 0, 255 };
constexpr rgb_color kGreen = { 0, 255, 0, 255 };
constexpr rgb_color kBlue = { 0, 0, 255, 255 };
constexpr rgb_color kWhite = { 255, 255, 255, 255 };


class PaintView : public BView {
public:
	PaintView(BRect frame, rgb_color color, uint32 flags = 0, uint32 mode = B_FOLLOW_NONE) :
		BView(frame, "paint", mode, B_WILL_DRAW | flags)
	{
		SetViewColor(color);
	}

	void Draw(BRect updateRect) override
	{
		drawn++;
		update = updateRect;
		if (log != nullptr)
			log->push_back(this);
		if (onDraw)
			onDraw();
	}

	void DrawAfterChildren(BRect updateRect) override
	{
		drawnAfter++;
		if (onDrawAfter)
			onDrawAfter();
	}

	int drawn = 0;
	int drawnAfter = 0;
	BRect update;
	std::vector<BView*>* log = nullptr;
	std::function<void()> onDraw;
	std::function<void()> onDrawAfter;
};


class CountUpdates : public BMessageFilter {
public:
	CountUpdates(int* count) : BMessageFilter(_UPDATE_), fCount(count) {}
	filter_result Filter(BMessage* message, BHandler** target) override
	{
		(*fCount)++;
		targets.push_back(*target);
		return B_DISPATCH_MESSAGE;
	}
	std::vector<BHandler*> targets;

private:
	int* fCount;
};


std::string
rects(const BRegion& region)
{
	std::string text;
	for (int32 i = 0; i < region.CountRects(); i++) {
		const clipping_rect rect = region.RectAtInt(i);
		text += "(" + std::to_string(rect.left) + "," + std::to_string(rect.top) + ","
			+ std::to_string(rect.right) + "," + std::to_string(rect.bottom) + ")";
	}
	return text;
}

} // namespace


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


// #pragma mark - clipping


TEST(ViewClipping, LeavesOutChildrenAndWhatAncestorsCut)
{
	TestWindow window(BRect(50, 50, 149, 149));
	PaintView* parent = new PaintView(BRect(0, 0, 49, 49), kWhite);
	PaintView* view = new PaintView(BRect(30, 30, 79, 79), kRed);
	view->AddChild(new PaintView(BRect(5, 5, 9, 9), kBlue));
	parent->AddChild(view);
	window.Add(parent);
	window.Locked([&] {
		BRegion region;
		view->GetClippingRegion(&region);
		BRegion expected(BRect(0, 0, 19, 19));
		expected.Exclude(BRect(5, 5, 9, 9));
		EXPECT_EQ(rects(expected), rects(region));
		view->Hide();
		view->GetClippingRegion(&region);
		EXPECT_EQ("", rects(region));
		view->Show();
	});
}


TEST(ViewClipping, LaterSiblingsCoverUnlessTheyAreTransparent)
{
	TestWindow window;
	PaintView* container = new PaintView(BRect(0, 0, 99, 99), kWhite);
	PaintView* first = new PaintView(BRect(10, 10, 49, 49), kRed);
	PaintView* second = new PaintView(BRect(30, 10, 69, 49), kGreen);
	PaintView* overlay = new PaintView(BRect(0, 0, 99, 99), B_TRANSPARENT_COLOR);
	container->AddChild(first);
	container->AddChild(second);
	window.Add(container);
	window.Add(overlay);
	window.Locked([&] {
		BRegion region;
		first->GetClippingRegion(&region);
		EXPECT_EQ("(0,0,19,39)", rects(region));
		second->GetClippingRegion(&region);
		EXPECT_EQ("(0,0,39,39)", rects(region));
		overlay->GetClippingRegion(&region);
		EXPECT_EQ("(0,0,99,99)", rects(region));
		second->Hide();
		first->GetClippingRegion(&region);
		EXPECT_EQ("(0,0,39,39)", rects(region));
		second->Show();
		// Drawing itself knows no siblings.
		first->SetHighColor(kBlue);
		first->FillRect(first->Bounds());
	});
}


TEST(ViewClipping, ConstraintsReplaceEachOtherAndStackByStates)
{
	TestWindow window;
	PaintView* view = window.Add(new PaintView(BRect(0, 0, 99, 99), kWhite));
	window.Locked([&] {
		BRegion clip;
		BRegion region(BRect(0, 0, 49, 49));
		view->ConstrainClippingRegion(&region);
		region.Set(BRect(10, 10, 59, 59));
		view->ConstrainClippingRegion(&region);
		view->GetClippingRegion(&clip);
		EXPECT_EQ("(10,10,59,59)", rects(clip));
		view->PushState();
		region.Set(BRect(0, 0, 19, 19));
		view->ConstrainClippingRegion(&region);
		view->GetClippingRegion(&clip);
		EXPECT_EQ("(10,10,19,19)", rects(clip));
		view->SetHighColor(kRed);
		view->FillRect(view->Bounds());
		view->PopState();
		view->GetClippingRegion(&clip);
		EXPECT_EQ("(10,10,59,59)", rects(clip));
		view->SetHighColor(kBlue);
		view->FillRect(BRect(55, 55, 80, 80));
		view->ConstrainClippingRegion(NULL);
		view->GetClippingRegion(&clip);
		EXPECT_EQ("(0,0,99,99)", rects(clip));
	});
	EXPECT_EQ(kRed, window.driver.PixelAt(view, BPoint(19, 19)));
	EXPECT_EQ(kWhite, window.driver.PixelAt(view, BPoint(20, 20)));
	EXPECT_EQ(kBlue, window.driver.PixelAt(view, BPoint(59, 59)));
	EXPECT_EQ(kWhite, window.driver.PixelAt(view, BPoint(60, 60)));
}


// Random overlapping trees against a picture that is painted back to front, view by view.
TEST(ViewClipping, RandomTreesLookLikePaintingBackToFront)
{
	constexpr int kSize = 100;
	std::mt19937 random(20);
	const auto number = [&](int below) { return int(random() % below); };
	TestWindow window(BRect(50, 50, 50 + kSize - 1, 50 + kSize - 1));

	for (int round = 0; round < 30; round++) {
		std::vector<rgb_color> model(kSize * kSize, kWhite);
		std::vector<BView*> views;
		BView* top = new PaintView(BRect(0, 0, kSize - 1, kSize - 1), kWhite);
		views.push_back(top);
		for (int i = 0; i < 12; i++) {
			const int left = number(90) - 10;
			const int upper = number(90) - 10;
			const rgb_color color = { uint8(number(256)), uint8(number(256)), uint8(number(256)),
				255 };
			PaintView* view =
				new PaintView(BRect(left, upper, left + number(60), upper + number(60)), color);
			if (number(8) == 0)
				view->Hide();
			views[number(views.size())]->AddChild(view);
			views.push_back(view);
		}
		window.Add(top);

		std::function<void(BView*, BPoint, BRect)> paint = [&](BView* view, BPoint at, BRect cut) {
			if (view->IsHidden(view))
				return;
			const BRect frame = view->Frame().OffsetByCopy(at) & cut;
			for (int y = frame.top; y <= frame.bottom && frame.IsValid(); y++) {
				for (int x = frame.left; x <= frame.right; x++)
					model[y * kSize + x] = view->ViewColor();
			}
			for (BView* child = view->ChildAt(0); child != NULL; child = child->NextSibling())
				paint(child, view->Frame().LeftTop() + at, frame);
		};
		paint(top, BPoint(0, 0), BRect(0, 0, kSize - 1, kSize - 1));
		for (int i = 0; i < 300; i++) {
			const int x = number(kSize);
			const int y = number(kSize);
			ASSERT_EQ(model[y * kSize + x], window.driver.PixelAt(BPoint(50 + x, 50 + y)))
				<< "round " << round << " at " << x << ", " << y;
		}
		window.Locked([&] {
			top->RemoveSelf();
			delete top;
		});
	}
}


// #pragma mark - scrolling


TEST(ViewScrolling, MovesPixelsAndDrawsOnlyWhatIsNew)
{
	TestWindow window;
	PaintView* view = new PaintView(BRect(0, 0, 99, 99), kWhite);
	view->onDraw = [&] {
		view->SetHighColor(kRed);
		view->FillRect(BRect(0, 0, 300, 49));
		view->SetHighColor(kBlue);
		view->FillRect(BRect(0, 100, 300, 109));
	};
	PaintView* child = new PaintView(BRect(10, 60, 19, 69), kGreen);
	view->AddChild(child);
	window.Add(view);
	const int before = child->drawn;
	window.Locked([&] { view->ScrollTo(0, 20); });
	EXPECT_EQ(BRect(0, 20, 99, 119), view->Bounds());
	EXPECT_EQ(BRect(0, 0, 99, 99), view->Frame());
	EXPECT_EQ(2, view->drawn);
	EXPECT_EQ(BRect(0, 100, 99, 119), view->update);
	EXPECT_EQ(before, child->drawn);
	EXPECT_EQ(kRed, window.driver.PixelAt(BPoint(50 + 5, 50 + 29)));
	EXPECT_EQ(kWhite, window.driver.PixelAt(BPoint(50 + 5, 50 + 30)));
	EXPECT_EQ(kGreen, window.driver.PixelAt(BPoint(50 + 10, 50 + 40)));
	EXPECT_EQ(kBlue, window.driver.PixelAt(BPoint(50 + 5, 50 + 80)));
}


TEST(ViewScrolling, WhatLiesInFrontStaysInItsPlace)
{
	TestWindow window;
	PaintView* view = new PaintView(BRect(0, 0, 99, 99), kWhite);
	view->onDraw = [&] {
		view->SetHighColor(kRed);
		view->FillRect(BRect(0, 50, 99, 300));
	};
	window.Add(view);
	PaintView* front = window.Add(new PaintView(BRect(40, 40, 59, 59), kGreen));
	window.Locked([&] { view->ScrollTo(0, 30); });
	EXPECT_EQ(kGreen, window.driver.PixelAt(front, BPoint(0, 0)));
	EXPECT_EQ(kGreen, window.driver.PixelAt(front, BPoint(19, 19)));
	EXPECT_EQ(kRed, window.driver.PixelAt(BPoint(50 + 50, 50 + 25)));
	EXPECT_EQ(kWhite, window.driver.PixelAt(BPoint(50 + 50, 50 + 10)));
}


// Any mixture of scrolling, moving and invalidating ends with what a fresh painting gives.
TEST(ViewScrolling, RandomChangesEndAsAFreshPaintingDoes)
{
	std::mt19937 random(7);
	const auto number = [&](int below) { return int(random() % below); };
	TestWindow window(BRect(50, 50, 249, 249));
	PaintView* top = new PaintView(BRect(0, 0, 199, 199), kWhite);
	std::vector<PaintView*> views;
	for (int i = 0; i < 10; i++) {
		PaintView* view = new PaintView(
			BRect(0, 0, 30 + number(80), 30 + number(80)), { uint8(i * 20), 100, 150, 255 });
		view->MoveTo(number(150), number(150));
		view->onDraw = [view] {
			const BRect bounds = view->Bounds();
			for (float y = std::floor(bounds.top / 8) * 8; y <= bounds.bottom; y += 8)
				view->StrokeLine(BPoint(bounds.left, y), BPoint(bounds.right, y));
		};
		(i < 4 ? top : views[number(4)])->AddChild(view);
		views.push_back(view);
	}
	window.Add(top);
	for (int round = 0; round < 60; round++) {
		window.Locked([&] {
			for (int i = 0; i < 3; i++) {
				PaintView* view = views[number(views.size())];
				switch (number(4)) {
					case 0:
						view->ScrollBy(number(20) - 10, number(20) - 10);
						break;
					case 1:
						view->MoveTo(number(150), number(150));
						break;
					case 2:
						view->ResizeTo(20 + number(90), 20 + number(90));
						break;
					default:
						view->Invalidate(BRect(0, 0, number(50), number(50)));
						break;
				}
			}
		});
		std::vector<rgb_color> shown;
		std::vector<BPoint> places;
		for (int i = 0; i < 200; i++) {
			places.push_back(BPoint(50 + number(200), 50 + number(200)));
			shown.push_back(window.driver.PixelAt(places.back()));
		}
		window.Locked([&] { top->Invalidate(); });
		for (size_t i = 0; i < places.size(); i++) {
			ASSERT_EQ(window.driver.PixelAt(places[i]), shown[i])
				<< "round " << round << " at " << places[i].x << ", " << places[i].y;
		}
	}
}
