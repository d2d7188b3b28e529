// Views with hundreds of children: painted, clipped and hit like those with a few.
#include <gtest/gtest.h>

#include <algorithm>
#include <optional>
#include <random>
#include <vector>

#include <Region.h>
#include <View.h>

#include "support/PaintCounter.h"
#include "support/TestWindow.h"

namespace {


constexpr int kSize = 300;
constexpr rgb_color kGround = { 255, 255, 255, 255 };


class Crowd {
public:
	Crowd() :
		fWindow(BRect(50, 50, 50 + kSize - 1, 50 + kSize - 1)),
		fParent(fWindow.Add(
			new BView(BRect(0, 0, kSize - 1, kSize - 1), "parent", B_FOLLOW_NONE, B_WILL_DRAW)))
	{
		fWindow.Locked([&] { fParent->SetViewColor(kGround); });
	}

	int Number(int below) { return static_cast<int>(fRandom() % below); }

	// Most are small, some large, and a few lie outside.
	BRect Frame()
	{
		const float size = Number(20) == 0 ? 120.f : 14.f;
		const BPoint at(static_cast<float>(Number(kSize + 40) - 20),
			static_cast<float>(Number(kSize + 40) - 20));
		const BPoint extent(Number(int(size)) - 1.f, Number(int(size)) - 1.f);
		return BRect(at, at + extent);
	}

	void Add()
	{
		BView* view = new BView(Frame(), "child", B_FOLLOW_NONE, B_WILL_DRAW);
		if (Number(6) == 0)
			view->SetViewColor(B_TRANSPARENT_COLOR);
		else
			view->SetViewColor(Number(255), Number(255), Number(255));
		BView* before = Number(3) == 0 ? Any() : nullptr;
		fParent->AddChild(view, before);
		fChildren.insert(std::find(fChildren.begin(), fChildren.end(), before), view);
	}

	void Remove()
	{
		const auto child = fChildren.begin() + Number(static_cast<int>(fChildren.size()));
		fParent->RemoveChild(*child);
		delete *child;
		fChildren.erase(child);
	}

	BView* Any()
	{
		return fChildren.empty() ? nullptr : fChildren[Number(static_cast<int>(fChildren.size()))];
	}

	void Change()
	{
		switch (Number(7)) {
			case 0:
				Add();
				break;
			case 1:
				Remove();
				break;
			case 2:
				Any()->MoveTo(Frame().LeftTop());
				break;
			case 3:
				Any()->ResizeTo(Number(60), Number(60));
				break;
			case 4:
				fParent->ScrollTo(Number(30), Number(30));
				break;
			case 5: {
				BView* view = Any();
				if (view->IsHidden(view))
					view->Show();
				else
					view->Hide();
				break;
			}
			default:
				Any()->Invalidate();
		}
	}

	// Each of them looked at in turn.

	// Nothing below a view without a background, which keeps what was on the screen.
	std::optional<rgb_color> ColorAt(BPoint where) const
	{
		rgb_color color = kGround;
		for (BView* view : fChildren) {
			if (view->IsHidden(view) || !view->Frame().Contains(where))
				continue;
			if (view->ViewColor() == B_TRANSPARENT_COLOR)
				return std::nullopt;
			color = view->ViewColor();
		}
		return color;
	}

	BView* HitAt(BPoint where) const
	{
		for (BView* view : fChildren) {
			if (!view->IsHidden(view) && view->Frame().Contains(where))
				return view;
		}
		return fParent;
	}

	BRegion ClippingOf(BView* view) const
	{
		BRegion region;
		if (!view->IsHidden(view) && (view->Frame() & fParent->Bounds()).IsValid())
			region.Set(view->Frame() & fParent->Bounds());
		const auto own = std::find(fChildren.begin(), fChildren.end(), view);
		for (auto later = own + 1; later != fChildren.end(); later++) {
			if (!(*later)->IsHidden(*later) && (*later)->ViewColor() != B_TRANSPARENT_COLOR)
				region.Exclude((*later)->Frame());
		}
		region.OffsetBy(
			static_cast<int32>(-view->Frame().left), static_cast<int32>(-view->Frame().top));
		return region;
	}

	TestWindow fWindow;
	BView* fParent; // child
	std::vector<BView*> fChildren; // in their order
	std::mt19937 fRandom { 2 };
};


bool
AreEqual(BRegion a, const BRegion& b)
{
	BRegion rest(b);
	rest.Exclude(&a);
	a.Exclude(&b);
	return a.IsEmpty() && rest.IsEmpty();
}


// Children of one parent, beside each other.
struct Rows : TestWindow {
	explicit Rows(int count) : TestWindow(BRect(0, 0, 999, 999))
	{
		parent = new BView(BRect(0, 0, 999, 999), "parent", B_FOLLOW_NONE, B_WILL_DRAW);
		for (int i = 0; i < count; i++) {
			const BPoint at(static_cast<float>(i % 100) * 10, static_cast<float>(i / 100) * 10);
			views.push_back(
				new BView(BRect(at, at + BPoint(7, 7)), "view", B_FOLLOW_NONE, B_WILL_DRAW));
			views.back()->SetViewColor(100, 150, 200);
			parent->AddChild(views.back());
		}
		Add(parent);
	}

	BView* Middle() { return views[views.size() / 2 + 50]; }

	BView* parent; // child
	std::vector<BView*> views;
};


class ManyChildrenCount : public testing::TestWithParam<int> {};
constexpr int kSteps = 20;
constexpr int kNearby = 100; // of views 10 apart: those of a few dozen pixels, asked twice


} // namespace


TEST(ManyChildren, ArePaintedClippedAndHitAsIfLookedAtOneByOne)
{
	Crowd crowd;
	crowd.fWindow.Locked([&] {
		for (int i = 0; i < 500; i++)
			crowd.Add();
	});
	for (int round = 0; round < 60; round++) {
		crowd.fWindow.Locked([&] {
			for (int i = 0; i < 5; i++)
				crowd.Change();
			for (int i = 0; i < 30; i++) {
				BView* view = crowd.Any();
				BRegion region;
				view->GetClippingRegion(&region);
				ASSERT_TRUE(AreEqual(crowd.ClippingOf(view), region)) << "round " << round;
			}
		});
		const BPoint scrolled = crowd.fParent->Bounds().LeftTop();
		for (int i = 0; i < 60; i++) {
			const BPoint at(crowd.Number(kSize), crowd.Number(kSize));
			const auto color = crowd.ColorAt(at + scrolled);
			ASSERT_TRUE(!color || *color == crowd.fWindow.driver.PixelAt(at + BPoint(50, 50)))
				<< "round " << round << " at " << at.x << ", " << at.y;
			crowd.fWindow.Locked([&] {
				ASSERT_EQ(crowd.HitAt(at + scrolled), crowd.fWindow.Window()->FindView(at));
			});
		}
	}
}


TEST_P(ManyChildrenCount, OneChildIsPaintedWithoutALookAtItsSiblings)
{
	Rows rows(GetParam());
	PaintCounter counter(rows.Window());
	rows.Locked([&] { rows.Middle()->Invalidate(); });
	EXPECT_GE(counter.Visited(), 1);
	EXPECT_LE(counter.Visited(), GetParam() + kNearby); // all are looked at once
	counter.Reset();
	for (int step = 0; step < kSteps; step++) {
		rows.Locked([&] {
			rows.views[static_cast<size_t>(step)]->Invalidate();
			rows.Middle()->Invalidate();
		});
	}
	EXPECT_LE(counter.Visited(), kSteps * 2 * kNearby);
}


TEST_P(ManyChildrenCount, OneChildIsMovedWithoutALookAtItsSiblings)
{
	Rows rows(GetParam());
	rows.Locked([&] { rows.Middle()->Invalidate(); });
	PaintCounter counter(rows.Window());
	for (int step = 0; step < kSteps; step++) {
		rows.Locked([&] {
			rows.Middle()->MoveBy(1, 0);
			rows.Middle()->ResizeBy(0, 1);
		});
	}
	EXPECT_LE(counter.Visited(), kSteps * 2 * kNearby);
}


TEST_P(ManyChildrenCount, ClippingAsksTheSiblingsNearby)
{
	Rows rows(GetParam());
	rows.Locked([&] { rows.Middle()->Invalidate(); });
	PaintCounter counter(rows.Window());
	rows.Locked([&] {
		for (int i = 0; i < kSteps; i++) {
			BRegion region;
			rows.views[static_cast<size_t>(i)]->GetClippingRegion(&region);
			EXPECT_EQ(BRect(0, 0, 7, 7), region.Frame());
		}
	});
	EXPECT_LE(counter.Visited(), kSteps * kNearby);
}


TEST_P(ManyChildrenCount, ChildrenComeAndGoWithoutALookAtTheirSiblings)
{
	Rows rows(GetParam());
	rows.Locked([&] { rows.Middle()->Invalidate(); });
	PaintCounter counter(rows.Window());
	BView* view = rows.Middle();
	for (int step = 0; step < kSteps; step++) {
		rows.Locked([&] { view->RemoveSelf(); });
		rows.Locked([&] { rows.parent->AddChild(view); });
	}
	EXPECT_LE(counter.Visited(), kSteps * 2 * kNearby);
}


TEST_P(ManyChildrenCount, APointIsAskedOfTheChildrenNearby)
{
	Rows rows(GetParam());
	rows.driver.MoveTo(BPoint(3, 3));
	PaintCounter counter(rows.Window());
	rows.driver.MoveTo(rows.Middle(), BPoint(3, 3));
	EXPECT_GE(counter.HitTested(), 2);
	EXPECT_LE(counter.HitTested(), 1 + kNearby);
}


INSTANTIATE_TEST_SUITE_P(Growth, ManyChildrenCount, testing::Values(1000, 3000, 10000));
