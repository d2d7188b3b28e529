// What the user does to one view takes no more in a design of ten thousand than in one of a hundred.

#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "addon/EditorScene.h"
#include "interface/private/WindowInternals.h"
#include "support/PaintCounter.h"

namespace {


constexpr int32 kInSight = 20;


// Some views in sight, and behind them in the order views that lie far outside of it: either in
// groups of ten or all in the root itself.
BMessage
DesignOf(int32 count, bool inGroups)
{
	BView root(BRect(0, 0, 9000, 9000), "root", B_FOLLOW_LEFT | B_FOLLOW_TOP, B_WILL_DRAW);
	BView* parent = &root;
	for (int32 i = 0; i < count; i++) {
		const std::string name = "view " + std::to_string(i);
		if (inGroups && i >= kInSight && i % 10 == 0) {
			parent = new BView(BRect(5000, 5000, 5399, 5099), "group", B_FOLLOW_NONE, B_WILL_DRAW);
			root.AddChild(parent);
		}
		BPoint at(10 + static_cast<float>(i % 5) * 70, 10 + static_cast<float>(i / 5) * 40);
		if (i >= kInSight)
			at.Set(static_cast<float>(i % 10) * 38, parent == &root ? 6000 : 4);
		parent->AddChild(
			new BView(BRect(at, at + BPoint(59, 29)), name.c_str(), B_FOLLOW_NONE, B_WILL_DRAW));
	}
	BMessage archive;
	root.Archive(&archive, true);
	return archive;
}


// What is painted does not depend on when the display shows it; how often it shows something, and
// how much of it twice, does. Among many views fewer are asked for a point than among a few, and
// children are looked at one by one up to some dozens.
struct Counts {
	int64 drawn, clippings, hitTested, visited;
	int64 flushes, pixels;

	bool operator==(const Counts& other) const
	{
		return drawn == other.drawn && clippings == other.clippings;
	}
};


std::ostream&
operator<<(std::ostream& stream, const Counts& counts)
{
	return stream << counts.drawn << " drawn, " << counts.clippings << " clippings, "
				  << counts.hitTested << " hit-tested, " << counts.visited << " visited, "
				  << counts.flushes << " flushes, " << counts.pixels << " pixels";
}


// Of a click on another view, an arrow key, and the start of a drag.
std::vector<Counts>
CountsOf(int32 views, bool inGroups)
{
	EditorScene scene;
	scene.Open(DesignOf(views, inGroups));
	Driver& input = scene.Input();
	BView* first = scene.Root()->FindView("view 1");
	BView* second = scene.Root()->FindView("view 7");
	input.Click(first, BPoint(20, 15));
	input.Click(second, BPoint(20, 15));
	input.Click(first, BPoint(20, 15));
	input.MoveTo(second, BPoint(20, 15));

	std::vector<Counts> counts;
	PaintCounter counter(scene.Window());
	const auto note = [&] {
		counts.push_back({ counter.Drawn(), counter.Clippings(), counter.HitTested(),
			counter.Visited(), counter.Flushes(), counter.FlushedPixels() });
		counter.Reset();
	};
	input.Press();
	note();
	EXPECT_EQ(second, scene.Work()->SelectedView());
	input.Release();
	counter.Reset();
	input.Key("Right");
	note();
	EXPECT_EQ(151, second->Frame().left);
	input.Press();
	note();
	EXPECT_EQ(scene.Root(), scene.Work()->SelectedView()); // the view is under way
	input.Release();
	return counts;
}


class LargeDesign : public testing::TestWithParam<bool> {};


} // namespace


TEST_P(LargeDesign, TakesNoMoreForOneViewThanASmallOne)
{
	constexpr bigtime_t kMinute = 60000000;
	BPrivate::WindowInternals::presentDelay = kMinute; // a busy machine counts alike
	constexpr int64 kSomeDozens = 160; // of children that are looked at one by one
	constexpr size_t kDragStart = 2;
	const std::vector<Counts> small = CountsOf(100, GetParam());
	ASSERT_EQ(3u, small.size());
	for (const int32 views : { 1000, 10000 }) {
		const std::vector<Counts> large = CountsOf(views, GetParam());
		EXPECT_EQ(small, large) << views;
		for (size_t i = 0; i < small.size(); i++) {
			EXPECT_LE(large[i].hitTested, small[i].hitTested);
			// At the start of a drag the root is selected, and so all of it is clipped.
			if (i < kDragStart) {
				EXPECT_LE(large[i].visited, small[i].visited + kSomeDozens);
			}
			EXPECT_EQ(1, large[i].flushes);
			EXPECT_LE(large[i].pixels, 2 * small[i].pixels + 10000);
		}
	}
}


INSTANTIATE_TEST_SUITE_P(InGroupsOrNot, LargeDesign, testing::Bool());
