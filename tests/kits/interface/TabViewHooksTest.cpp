// What a tab view and its tabs ask of classes that change their looks.
#include <TabView.h>

#include <functional>
#include <string>

#include <AppDefs.h>

#include "ControlFixture.h"

namespace {


std::string sDrawn; // the hooks that came, in their order


class HookedTab : public BTab {
public:
	HookedTab(BView* view) : BTab(view) {}

	void DrawTab(BView* owner, BRect frame, tab_position position, bool full) override
	{
		sDrawn += " " + std::string(Label()) + ":"
			+ (position == B_TAB_FRONT ? "front" : (position == B_TAB_FIRST ? "first" : "any"));
		BTab::DrawTab(owner, frame, position, full);
	}

	void DrawLabel(BView* owner, BRect frame) override
	{
		sDrawn += " label";
		BTab::DrawLabel(owner, frame);
	}

	void DrawFocusMark(BView* owner, BRect frame) override
	{
		sDrawn += " mark";
		BTab::DrawFocusMark(owner, frame);
	}

	void Select(BView* owner) override
	{
		history += "s";
		BTab::Select(owner);
	}

	void Deselect() override
	{
		history += "d";
		BTab::Deselect();
	}

	std::string history;
};


class HookedTabView : public BTabView {
public:
	HookedTabView() : BTabView(BRect(10, 10, 309, 209), "tabs") {}

	BRect DrawTabs() override
	{
		sDrawn += " tabs";
		selectedFrame = BTabView::DrawTabs();
		return selectedFrame;
	}

	void DrawBox(BRect selected) override
	{
		sDrawn += " box";
		EXPECT_EQ(selectedFrame, selected);
		BTabView::DrawBox(selected);
	}

	BRect selectedFrame;
};


class TabViewHooks : public testing::Test {
protected:
	void SetUp() override
	{
		tabs = new HookedTabView;
		for (int i = 0; i < 3; i++) {
			const char name[] = { char('A' + i), '\0' };
			BView* page = new BView(BRect(0, 0, 99, 99), name, 0, B_WILL_DRAW);
			page->AddChild(new BView(BRect(5, 5, 20, 20), "inner", 0, B_WILL_DRAW | B_NAVIGABLE));
			tab[i] = new HookedTab(page);
			tabs->AddTab(page, tab[i]);
		}
		fixture.Add(tabs);
	}

	std::string DrawnBy(const std::function<void()>& action)
	{
		fixture.Locked([&] {
			sDrawn.clear();
			action();
		});
		return sDrawn;
	}

	ControlFixture fixture;
	HookedTabView* tabs;
	HookedTab* tab[3];
};

} // namespace


TEST_F(TabViewHooks, DrawTheTabsTheSelectedOneInFront)
{
	const std::string drawn = DrawnBy([this] { tabs->Invalidate(); });
	// DrawTabs() calls DrawTab() for each, that calls DrawLabel(); then comes DrawBox().
	EXPECT_NE(std::string::npos, drawn.find(" tabs")) << drawn;
	EXPECT_NE(std::string::npos, drawn.find("A:front label")) << drawn;
	EXPECT_NE(std::string::npos, drawn.find("B:any label")) << drawn;
	EXPECT_NE(std::string::npos, drawn.find("C:any label")) << drawn;
	EXPECT_NE(std::string::npos, drawn.find(" box")) << drawn;
	EXPECT_EQ(std::string::npos, drawn.find(" mark")) << drawn;
	EXPECT_EQ(tabs->TabFrame(0), tabs->selectedFrame);

	const std::string second = DrawnBy([this] { tabs->Select(1); });
	EXPECT_NE(std::string::npos, second.find("B:front")) << second;
	EXPECT_EQ(tabs->TabFrame(1), tabs->selectedFrame);
}


TEST_F(TabViewHooks, MarkTheFocusTab)
{
	const std::string drawn = DrawnBy([this] { tabs->MakeFocus(); });
	EXPECT_NE(std::string::npos, drawn.find(" mark")) << "DrawFocusMark()" << drawn;
	EXPECT_TRUE(tab[0]->IsFocus());
	fixture.driver.Key("Right");
	EXPECT_FALSE(tab[0]->IsFocus());
	EXPECT_TRUE(tab[1]->IsFocus());
	EXPECT_EQ(1, tabs->FocusTab());

	fixture.Locked([this] { tabs->SetFocusTab(2, true); });
	EXPECT_EQ(2, tabs->FocusTab());
	EXPECT_TRUE(tab[2]->IsFocus());
	fixture.Locked([this] { tabs->SetFocusTab(2, false); });
	EXPECT_EQ(-1, tabs->FocusTab());
	EXPECT_FALSE(tab[2]->IsFocus());
}


TEST_F(TabViewHooks, ShowTheFocusInAnActiveWindowOnly)
{
	fixture.Focus(tabs);
	BWindow* other = new BWindow(BRect(600, 50, 700, 150), "Other", B_TITLED_WINDOW, 0);
	sDrawn.clear();
	other->Show();
	fixture.driver.ActivateWindow(other);
	EXPECT_NE(std::string::npos, sDrawn.find(" tabs")) << "WindowActivated(false) redraws";
	EXPECT_EQ(std::string::npos, sDrawn.find(" mark"));
	sDrawn.clear();
	fixture.driver.ActivateWindow(fixture.window);
	EXPECT_NE(std::string::npos, sDrawn.find(" mark"));
	BMessenger(other).SendMessage(B_QUIT_REQUESTED);
	Driver::WaitUntilIdle();
}


TEST_F(TabViewHooks, SelectingDeselectsTheOther)
{
	for (HookedTab* each : tab)
		each->history.clear();
	const BRect second = tabs->TabFrame(1);
	fixture.driver.Click(tabs, BPoint(second.left + 10, second.top + 8));
	EXPECT_EQ("d", tab[0]->history) << "Deselect()";
	EXPECT_EQ("s", tab[1]->history);
	EXPECT_EQ("", tab[2]->history);
	EXPECT_FALSE(tab[0]->IsSelected());
	EXPECT_TRUE(tab[1]->IsSelected());
	fixture.Locked([this] {
		EXPECT_EQ(nullptr, tab[0]->View()->Window());
		EXPECT_EQ(fixture.window, tab[1]->View()->Window());
	});
}


TEST_F(TabViewHooks, SetViewTakesThePlaceAndTheNameOfTheOther)
{
	BView* page = new BView(BRect(0, 0, 49, 49), "New page", 0, B_WILL_DRAW);
	fixture.Locked([&] {
		tab[1]->SetView(page);
		EXPECT_EQ(page, tab[1]->View());
		EXPECT_STREQ("New page", tab[1]->Label());
		tab[1]->SetView(NULL);
		EXPECT_EQ(page, tab[1]->View());
		tabs->Select(1);
		EXPECT_EQ(tabs->ContainerView(), page->Parent());
	});
}


TEST_F(TabViewHooks, PagesAreDetachedAndAttachedWithTheTabView)
{
	fixture.Locked([this] {
		BView* page = tab[0]->View();
		ASSERT_EQ(fixture.window, page->Window());
		// DetachedFromWindow() and AllDetached() reach the page that is shown.
		tabs->RemoveSelf();
		EXPECT_EQ(nullptr, page->Window());
		EXPECT_EQ(tabs->ContainerView(), page->Parent());
		fixture.ground->AddChild(tabs);
		EXPECT_EQ(fixture.window, page->Window());
		EXPECT_EQ(0, tabs->Selection());
	});
}


TEST_F(TabViewHooks, SettersKeepWhatTheyAreGiven)
{
	fixture.Locked([this] {
		tabs->SetFlags(B_WILL_DRAW | B_FRAME_EVENTS);
		EXPECT_EQ(static_cast<uint32>(B_WILL_DRAW | B_FRAME_EVENTS), tabs->Flags());
		tabs->SetResizingMode(B_FOLLOW_LEFT_RIGHT | B_FOLLOW_TOP);
		EXPECT_EQ(static_cast<uint32>(B_FOLLOW_LEFT_RIGHT | B_FOLLOW_TOP), tabs->ResizingMode());
	});
	const BRect before = tabs->Frame();
	fixture.driver.ResizeWindow(fixture.window, 429, 349);
	EXPECT_EQ(before.Width() + 30, tabs->Frame().Width());
	EXPECT_EQ(before.Height(), tabs->Frame().Height());
	EXPECT_EQ(before.Width() + 30, tabs->ContainerView()->Frame().Width() + 6);
}


TEST_F(TabViewHooks, ItsPreferredSizeIsThatOfItsPages)
{
	fixture.Locked([this] {
		const BRect frame = tabs->Frame();
		float width, height;
		tabs->GetPreferredSize(&width, &height);
		EXPECT_EQ(frame.Width(), width);
		EXPECT_EQ(frame.Height(), height);
		tabs->ResizeToPreferred();
		EXPECT_EQ(frame, tabs->Frame()) << "pages keep their frames";
	});
}
