// The tree of views: order, hooks, frames, following the parent.
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include <View.h>
#include <Window.h>

#include "support/DebuggerCatcher.h"
#include "support/TestWindow.h"

namespace {

using Log = std::vector<std::string>;

class LogView : public BView {
public:
	LogView(const char* name, Log& log, BRect frame = BRect(0, 0, 99, 99)) :
		BView(frame, name, B_FOLLOW_NONE, B_WILL_DRAW | B_FRAME_EVENTS), fLog(log)
	{
	}

	void AttachedToWindow() override { _Note("attached"); }
	void AllAttached() override { _Note("allAttached"); }
	void DetachedFromWindow() override { _Note("detached"); }
	void AllDetached() override { _Note("allDetached"); }
	void FrameMoved(BPoint where) override
	{
		fLog.push_back("moved " + std::to_string(int(where.x)));
	}
	void FrameResized(float width, float height) override
	{
		fLog.push_back("resized " + std::to_string(int(width)));
	}

private:
	void _Note(const char* what)
	{
		fLog.push_back(std::string(Name()) + " " + what + (Window() != NULL ? "" : " alone"));
	}

	Log& fLog;
};


BView*
plain(const char* name, BRect frame = BRect(0, 0, 9, 9), uint32 mode = B_FOLLOW_NONE)
{
	return new BView(frame, name, mode, 0);
}

} // namespace


TEST(ViewTree, ChildrenKeepTheOrderInWhichTheyWereAdded)
{
	BView parent(BRect(0, 0, 99, 99), "parent", B_FOLLOW_NONE, 0);
	BView* a = plain("a");
	BView* b = plain("b");
	BView* c = plain("c");
	parent.AddChild(a);
	parent.AddChild(c);
	parent.AddChild(b, c);

	ASSERT_EQ(3, parent.CountChildren());
	EXPECT_EQ(a, parent.ChildAt(0));
	EXPECT_EQ(b, parent.ChildAt(1));
	EXPECT_EQ(c, parent.ChildAt(2));
	EXPECT_EQ(NULL, parent.ChildAt(3));
	EXPECT_EQ(NULL, parent.ChildAt(-1));
	EXPECT_EQ(b, a->NextSibling());
	EXPECT_EQ(b, c->PreviousSibling());
	EXPECT_EQ(NULL, a->PreviousSibling());
	EXPECT_EQ(&parent, b->Parent());
	EXPECT_EQ(&parent, b->NextHandler());

	EXPECT_TRUE(parent.RemoveChild(b));
	EXPECT_EQ(NULL, b->Parent());
	EXPECT_EQ(c, a->NextSibling());
	EXPECT_EQ(c, parent.ChildAt(1));
	EXPECT_FALSE(b->RemoveSelf());
	EXPECT_FALSE(parent.RemoveChild(b));
	delete b;
}


TEST(ViewTree, FindViewIncludesTheViewItselfAndTakesTheFirstMatch)
{
	BView parent(BRect(0, 0, 99, 99), "x", B_FOLLOW_NONE, 0);
	BView* a = plain("a");
	BView* deep = plain("same");
	parent.AddChild(a);
	a->AddChild(deep);
	parent.AddChild(plain("same"));

	EXPECT_EQ(&parent, parent.FindView("x"));
	EXPECT_EQ(deep, parent.FindView("same"));
	EXPECT_EQ(NULL, parent.FindView("none"));
}


TEST(ViewTree, AddingAViewTwiceIsRefused)
{
	DebuggerCatcher catcher;
	BView parent(BRect(0, 0, 99, 99), "parent", B_FOLLOW_NONE, 0);
	BView* child = plain("child");
	parent.AddChild(child);
	parent.AddChild(child);
	EXPECT_EQ(1u, catcher.Take().size());
	EXPECT_EQ(1, parent.CountChildren());

	child->AddChild(plain("grandchild"));
	child->ChildAt(0)->AddChild(&parent);
	EXPECT_EQ(1u, catcher.Take().size());
}


TEST(ViewTree, FlagsAndModeShareOneWord)
{
	BView view(BRect(), "v", B_WILL_DRAW | 0x00010000, B_FOLLOW_ALL | B_NAVIGABLE);
	EXPECT_EQ(B_WILL_DRAW | B_NAVIGABLE | 0x00010000, view.Flags());
	EXPECT_EQ(B_FOLLOW_ALL, view.ResizingMode());
	view.SetFlags(B_PULSE_NEEDED);
	EXPECT_EQ(B_PULSE_NEEDED, view.Flags());
	EXPECT_EQ(B_FOLLOW_ALL, view.ResizingMode());
}


TEST(ViewTree, HooksOfAttachingComeParentsFirstThenChildrenFirst)
{
	Log log;
	TestWindow window;
	BView* parent = new LogView("p", log);
	BView* child = new LogView("c", log);
	BView* grandchild = new LogView("g", log);
	parent->AddChild(child);
	child->AddChild(grandchild);
	parent->AddChild(new LogView("d", log));
	window.Add(parent);
	EXPECT_EQ((Log { "p attached", "c attached", "g attached", "d attached", "g allAttached",
				  "c allAttached", "d allAttached", "p allAttached" }),
		log);

	EXPECT_EQ(window.Window(), grandchild->Window());
	EXPECT_EQ(NULL, parent->Parent());
	EXPECT_EQ(window.Window(), parent->NextHandler());
	EXPECT_EQ(parent, child->NextHandler());

	log.clear();
	window.Locked([&] { EXPECT_TRUE(parent->RemoveSelf()); });
	EXPECT_EQ((Log { "p detached", "c detached", "g detached", "d detached", "g allDetached",
				  "c allDetached", "d allDetached", "p allDetached" }),
		log);
	EXPECT_EQ(NULL, grandchild->Window());
	EXPECT_EQ(NULL, grandchild->Looper());
	delete parent;
}


TEST(ViewTree, AViewAddedByAHookIsAttachedCompletelyAtOnce)
{
	class Adder : public LogView {
	public:
		Adder(Log& log) : LogView("a", log), fOther(log) {}
		void AttachedToWindow() override
		{
			LogView::AttachedToWindow();
			AddChild(new LogView("new", fOther));
		}
		Log& fOther;
	};

	Log log;
	TestWindow window;
	BView* adder = new Adder(log);
	adder->AddChild(new LogView("old", log));
	window.Add(adder);
	EXPECT_EQ((Log { "a attached", "new attached", "new allAttached", "old attached",
				  "old allAttached", "a allAttached" }),
		log);
}


TEST(ViewTree, AHookMayTakeViewsOut)
{
	class Remover : public LogView {
	public:
		Remover(Log& log) : LogView("r", log) {}
		void AttachedToWindow() override
		{
			LogView::AttachedToWindow();
			BView* next = NextSibling();
			next->RemoveSelf();
			delete next;
		}
	};

	Log log;
	TestWindow window;
	BView* parent = new LogView("p", log);
	parent->AddChild(new Remover(log));
	parent->AddChild(new LogView("gone", log));
	parent->AddChild(new LogView("last", log));
	window.Add(parent);
	EXPECT_EQ((Log { "p attached", "r attached", "gone detached", "gone allDetached",
				  "last attached", "r allAttached", "last allAttached", "p allAttached" }),
		log);
}


TEST(ViewTree, AnUnattachedViewIsMovedAloneAndItsChildrenStay)
{
	BView parent(BRect(0, 0, 99, 99), "parent", B_FOLLOW_NONE, 0);
	BView* child = plain("child", BRect(0, 0, 99, 99), B_FOLLOW_ALL);
	parent.AddChild(child);
	parent.ResizeTo(199, 199);
	EXPECT_EQ(BRect(0, 0, 199, 199), parent.Frame());
	EXPECT_EQ(BRect(0, 0, 99, 99), child->Frame());
}


struct FollowCase {
	uint32 mode;
	BRect expected; // of (10, 20, 30, 40) after the parent grew by (7, 9)
};

class ViewFollow : public testing::TestWithParam<FollowCase> {};


TEST_P(ViewFollow, EdgesFollowTheParentByTheirDigits)
{
	TestWindow window;
	BView* parent = plain("parent", BRect(0, 0, 99, 99));
	BView* child = plain("child", BRect(10, 20, 30, 40), GetParam().mode);
	parent->AddChild(child);
	window.Add(parent);
	window.Locked([&] { parent->ResizeBy(7, 9); });
	EXPECT_EQ(GetParam().expected, child->Frame());
}

INSTANTIATE_TEST_SUITE_P(Modes, ViewFollow,
	testing::Values(FollowCase { B_FOLLOW_NONE, BRect(10, 20, 30, 40) },
		FollowCase { B_FOLLOW_LEFT | B_FOLLOW_TOP, BRect(10, 20, 30, 40) },
		FollowCase { B_FOLLOW_RIGHT | B_FOLLOW_TOP, BRect(17, 20, 37, 40) },
		FollowCase { B_FOLLOW_LEFT_RIGHT | B_FOLLOW_BOTTOM, BRect(10, 29, 37, 49) },
		FollowCase { B_FOLLOW_ALL, BRect(10, 20, 37, 49) },
		FollowCase { B_FOLLOW_H_CENTER | B_FOLLOW_V_CENTER, BRect(13, 24, 33, 44) },
		FollowCase { 0x0004, BRect(10, 20, 37, 40) }));


TEST(ViewTree, CentredViewsDriftBecauseHalvesAreCutOffTowardsZero)
{
	TestWindow window;
	BView* parent = plain("parent", BRect(0, 0, 99, 99));
	BView* child = plain("child", BRect(10, 10, 20, 20), B_FOLLOW_H_CENTER | B_FOLLOW_TOP);
	parent->AddChild(child);
	window.Add(parent);
	window.Locked([&] {
		parent->ResizeBy(1, 0);
		parent->ResizeBy(1, 0);
		EXPECT_EQ(10, child->Frame().left);
		parent->ResizeBy(-3, 0);
		EXPECT_EQ(9, child->Frame().left);
	});
}


TEST(ViewTree, TheWindowsViewsFollowItsSize)
{
	TestWindow window(BRect(50, 50, 249, 149));
	BView* view = window.Add(plain("all", BRect(0, 0, 199, 99), B_FOLLOW_ALL));
	window.driver.ResizeWindow(window.Window(), 299, 149);
	EXPECT_EQ(BRect(0, 0, 299, 149), view->Frame());
	window.Locked([&] { window.Window()->ResizeTo(99, 79); });
	EXPECT_EQ(BRect(0, 0, 99, 79), view->Frame());
	EXPECT_EQ(BRect(0, 0, 99, 79), window.Window()->Bounds());
}


TEST(ViewTree, FrameHooksComeLaterMovedBeforeResized)
{
	Log log;
	TestWindow window;
	BView* view = window.Add(new LogView("v", log));
	log.clear();
	window.Window()->Lock();
	view->ResizeTo(49, 49);
	view->MoveTo(5, 0);
	view->MoveTo(7, 0);
	EXPECT_TRUE(log.empty());
	window.Window()->Unlock();
	Driver::WaitUntilIdle();
	EXPECT_EQ((Log { "resized 49", "moved 5", "moved 7" }), log);
}


TEST(ViewTree, ConversionsGoThroughScrolledParents)
{
	TestWindow window(BRect(50, 60, 449, 359));
	BView* parent = plain("parent", BRect(10, 20, 109, 119));
	BView* child = plain("child", BRect(30, 40, 60, 70));
	parent->AddChild(child);
	EXPECT_EQ(BPoint(1, 2), child->ConvertToScreen(BPoint(1, 2)));
	window.Add(parent);
	window.Locked([&] {
		parent->ScrollTo(5, 6);
		EXPECT_EQ(BRect(30, 40, 60, 70), child->Frame());
		EXPECT_EQ(BPoint(31, 42), child->ConvertToParent(BPoint(1, 2)));
		EXPECT_EQ(BPoint(1, 2), child->ConvertFromParent(BPoint(31, 42)));
		EXPECT_EQ(BPoint(50 + 10 + 30 - 5, 60 + 20 + 40 - 6), child->ConvertToScreen(BPoint(0, 0)));
		EXPECT_EQ(BPoint(0, 0), child->ConvertFromScreen(BPoint(85, 114)));
		EXPECT_EQ(BRect(0, 0, 5, 5), child->ConvertFromScreen(BRect(85, 114, 90, 119)));
	});
}


TEST(ViewTree, HiddenIsWhoHasAHiddenAncestor)
{
	TestWindow window;
	BView* parent = plain("parent");
	BView* child = plain("child");
	parent->AddChild(child);
	EXPECT_FALSE(child->IsHidden());
	window.Add(parent);
	window.Locked([&] {
		parent->Hide();
		parent->Hide();
		EXPECT_TRUE(child->IsHidden());
		EXPECT_FALSE(child->IsHidden(child));
		EXPECT_FALSE(child->IsHidden(parent));
		parent->Show();
		EXPECT_TRUE(child->IsHidden());
		parent->Show();
		EXPECT_FALSE(child->IsHidden());
		window.Window()->Hide();
		EXPECT_TRUE(child->IsHidden());
		window.Window()->Show();
	});
}


TEST(ViewTree, AViewIsUsedUnderItsWindowsLock)
{
	TestWindow window;
	BView* view = window.Add(plain("v"));
	DebuggerCatcher catcher;
	view->MoveTo(3, 3);
	EXPECT_GE(catcher.Take().size(), 1u);
}


// Building, finding by number, and taking apart take linear time; a quadratic step at this size
// takes minutes.
TEST(ViewTree, LargeTreesTakeLinearTime)
{
	constexpr int32 kViews = 100000;
	TestWindow window;
	BView* parent = plain("parent", BRect(0, 0, 99, 99));
	for (int32 i = 0; i < kViews; i++)
		parent->AddChild(plain("child"));
	for (int32 i = 0; i < kViews; i++)
		ASSERT_NE(nullptr, parent->ChildAt(i));
	for (int32 i = kViews; i-- > 0;)
		ASSERT_NE(nullptr, parent->ChildAt(i));
	window.Add(parent);
	window.Locked([&] {
		parent->MoveTo(1, 1);
		for (int32 i = 0; i < kViews / 2; i++) {
			BView* child = parent->ChildAt(0);
			child->RemoveSelf();
			delete child;
		}
		parent->RemoveSelf();
	});
	delete parent;
}


TEST(ViewTree, DeepTreesTakeLinearTime)
{
	constexpr int32 kViews = 1000;
	TestWindow window;
	BView* top = plain("top", BRect(0, 0, 2000, 2000), B_FOLLOW_ALL);
	BView* last = top;
	for (int32 i = 0; i < kViews; i++) {
		BView* child = plain("child", BRect(0, 0, 2000, 2000), B_FOLLOW_ALL);
		last->AddChild(child);
		last = child;
	}
	window.Add(top);
	window.Locked([&] { top->ResizeBy(5, 5); });
	EXPECT_EQ(BRect(0, 0, 2005, 2005), last->Frame());
	window.Locked([&] { EXPECT_EQ(last, window.Window()->FindView(BPoint(10, 10))); });
}
