// The panel of tab views.

#include "editors/EditTabView.h"

#include <Region.h>
#include <TabView.h>

#include "PanelFixture.h"

namespace {


// Remembers what of it was drawn.
class WatchedTabView : public BTabView {
public:
	using BTabView::BTabView;

	void Draw(BRect updateRect) override
	{
		drawn.Include(updateRect);
		BTabView::Draw(updateRect);
	}

	BRegion drawn;
};


} // namespace


class EditTabViewTest : public PanelFixture<EditTabView> {
protected:
	BTabView* MakeTabs(std::initializer_list<const char*> names)
	{
		BTabView* tabs = new BTabView(BRect(20, 20, 320, 220), "tabs");
		for (const char* name : names) {
			tabs->AddTab(new BView(BRect(0, 0, 100, 80), name, B_FOLLOW_ALL_SIDES, B_WILL_DRAW));
		}
		return Use(tabs);
	}

	std::string Order(const BTabView* tabs)
	{
		std::string order;
		for (int32 i = 0; i < tabs->CountTabs(); i++)
			order += tabs->TabAt(i)->Label();
		return order;
	}

	void Select(BTabView* tabs, int32 index)
	{
		const BRect frame = tabs->TabFrame(index);
		window.driver.Click(tabs, BPoint(frame.left + 8, frame.top + 8));
		ASSERT_EQ(index, tabs->Selection());
	}
};


TEST_F(EditTabViewTest, MovesTheSelectedTab)
{
	BTabView* tabs = MakeTabs({ "A", "B", "C", "D", "E" });
	Select(tabs, 2);
	Press("forward");
	EXPECT_EQ("ACBDE", Order(tabs));
	Select(tabs, 1);
	Press("backward");
	EXPECT_EQ("ABCDE", Order(tabs));
	EXPECT_EQ(2, tabs->Selection());
	ExpectDeclined();
}


TEST_F(EditTabViewTest, TheEndsStay)
{
	BTabView* tabs = MakeTabs({ "A", "B", "C" });
	Select(tabs, 0);
	Press("forward");
	EXPECT_EQ("ABC", Order(tabs));
	Press("backward");
	EXPECT_EQ("BAC", Order(tabs));
	EXPECT_EQ(1, tabs->Selection());
	Select(tabs, 2);
	Press("backward");
	EXPECT_EQ("BAC", Order(tabs));
	Press("forward");
	EXPECT_EQ("BCA", Order(tabs));
}


TEST_F(EditTabViewTest, ASingleTabStays)
{
	BTabView* tabs = MakeTabs({ "A" });
	Press("forward");
	Press("backward");
	EXPECT_EQ("A", Order(tabs));
}


TEST_F(EditTabViewTest, DeletesAndInserts)
{
	BTabView* tabs = MakeTabs({ "A", "B", "C" });
	Select(tabs, 1);
	Press("delete");
	EXPECT_EQ("AC", Order(tabs));
	Press("insert");
	EXPECT_EQ("ACTab", Order(tabs));
	const BRect bounds = tabs->Bounds();
	EXPECT_EQ(BRect(3, 2, bounds.right - 4, bounds.bottom - 5 - tabs->TabHeight()),
		tabs->ViewForTab(2)->Frame());
}


// The tab view draws its tabs anew by itself, and the panel asks for nothing more.
TEST_F(EditTabViewTest, DeletingATabAsksForNoDrawingOfItsOwn)
{
	WatchedTabView* tabs = new WatchedTabView(BRect(0, 0, 200, 100), "tabs");
	for (const char* name : { "A", "B", "C" })
		tabs->AddTab(new BView(BRect(0, 0, 100, 80), name, B_FOLLOW_ALL_SIDES, B_WILL_DRAW));
	Use(tabs);
	Select(tabs, 2);
	tabs->drawn.MakeEmpty();
	Press("delete");
	const BRect byPanel = tabs->drawn.Frame();

	Select(tabs, 1);
	tabs->drawn.MakeEmpty();
	window.Locked([&] { delete tabs->RemoveTab(1); });
	EXPECT_EQ(tabs->drawn.Frame(), byPanel);
	EXPECT_LT(byPanel.bottom, tabs->Bounds().bottom);

	tabs->drawn.MakeEmpty();
	Press("insert");
	EXPECT_EQ(tabs->Bounds().bottom, tabs->drawn.Frame().bottom);
}


TEST_F(EditTabViewTest, ChangesHeightAndWidth)
{
	BTabView* tabs = MakeTabs({ "A", "B" });
	TypeOver("Tab height:", "31");
	EXPECT_EQ(31, tabs->TabHeight());
	Choose("Tab widgh:", "B_WIDTH_FROM_LABEL");
	EXPECT_EQ(B_WIDTH_FROM_LABEL, tabs->TabWidth());
}


TEST_F(EditTabViewTest, ShowsHeightAndWidth)
{
	BTabView* tabs = MakeTabs({ "A" });
	window.Locked([&] {
		tabs->SetTabHeight(27);
		tabs->SetTabWidth(B_WIDTH_FROM_WIDEST);
	});
	Reload(tabs);
	EXPECT_EQ("27", Shown("Tab height:"));
	EXPECT_EQ("B_WIDTH_FROM_WIDEST", Chosen("Tab widgh:"));
}


TEST_F(EditTabViewTest, AnInsertedTabFillsTheTabView)
{
	BTabView* tabs = Use(new BTabView(BRect(0, 0, 200, 100), "tabs"));
	TypeOver("Tab height:", "20");
	Press("insert");
	ASSERT_EQ(1, tabs->CountTabs());
	EXPECT_EQ(BRect(3, 2, 196, 75), tabs->ViewForTab(0)->Frame());
	EXPECT_EQ(216, tabs->ViewForTab(0)->ViewColor().red);
	EXPECT_STREQ("Tab", tabs->TabAt(0)->Label());
}


TEST_F(EditTabViewTest, WithoutTabsTheButtonsDoNothing)
{
	BTabView* tabs = MakeTabs({});
	for (const char* label : { "forward", "backward", "delete" })
		Press(label);
	EXPECT_EQ(0, tabs->CountTabs());
}


TEST_F(EditTabViewTest, MovedTabsKeepTheirContents)
{
	BTabView* tabs = MakeTabs({ "A", "B", "C" });
	BView* second = tabs->ViewForTab(1);
	Select(tabs, 2);
	Press("forward");
	EXPECT_EQ("ACB", Order(tabs));
	EXPECT_EQ(second, tabs->ViewForTab(2));
	EXPECT_EQ(3, tabs->ContainerView()->CountChildren() + 2); // the selected tab's view is shown
}
