// What views may paint on, and what scrolling moves.
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
