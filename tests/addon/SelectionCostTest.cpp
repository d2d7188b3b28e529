// What a selection and an edit do not do again.

#include "EditorFixture.h"

#include <Button.h>
#include <MenuBar.h>
#include <MenuItem.h>
#include <OutlineListView.h>

namespace {


// Stands in a panel and counts what happens to it there.
class Probe : public BView {
public:
	Probe() : BView(BRect(0, 0, 0, 0), "probe", B_FOLLOW_NONE, 0) {}

	void AttachedToWindow() override { attached++; }
	void DetachedFromWindow() override { detached++; }

	int attached = 0;
	int detached = 0;
};


class SelectionCostTest : public EditorFixture {
protected:
	void OpenButtons(int32 count)
	{
		BView* root =
			new BView(BRect(0, 0, 399, 399), "root", B_FOLLOW_LEFT | B_FOLLOW_TOP, B_WILL_DRAW);
		for (int32 i = 0; i < count; i++) {
			const float left = static_cast<float>(i % 4) * 90;
			const float top = static_cast<float>(i / 4) * 30;
			root->AddChild(new BButton(BRect(left, top, left + 80, top + 24), "b", "B", NULL));
		}
		Open(Add(1, root));
	}

	Probe* PutInto(const char* panel)
	{
		Probe* probe = new Probe;
		window.Locked([&] { Panel(panel)->AddChild(probe); });
		EXPECT_EQ(1, probe->attached);
		return probe;
	}
};


} // namespace


TEST_F(SelectionCostTest, ViewsOfOneClassShareTheirPanels)
{
	OpenButtons(12);
	Select(Root()->ChildAt(0));
	const std::vector<BView*> before = ControlUser::All<BView>(Column());
	Probe* probes[] = { PutInto("EditView"), PutInto("EditControl"), PutInto("EditButton") };
	for (int32 i = 1; i < 12; i++)
		Select(Root()->ChildAt(i));
	for (const Probe* probe : probes) {
		EXPECT_EQ(1, probe->attached);
		EXPECT_EQ(0, probe->detached);
	}
	EXPECT_EQ(before.size() + 3, ControlUser::All<BView>(Column()).size());
}


TEST_F(SelectionCostTest, AnotherClassTakesAwayOnlyThePanelsThatItHasNot)
{
	OpenButtons(1);
	Select(Root()->ChildAt(0));
	Probe* own = PutInto("EditButton");
	Probe* common = PutInto("EditView");
	Select(Root());
	EXPECT_EQ(1, own->detached);
	EXPECT_EQ(0, common->detached);
	EXPECT_EQ(1, common->attached);
}


TEST_F(SelectionCostTest, EditsOfAMenuBarKeepTheEntriesOfTheOthers)
{
	BView* root =
		new BView(BRect(0, 0, 399, 399), "root", B_FOLLOW_LEFT | B_FOLLOW_TOP, B_WILL_DRAW);
	BMenuBar* bar = new BMenuBar(BRect(0, 0, 399, 18), "bar");
	for (const char* label : { "One", "Two", "Three" })
		bar->AddItem(new BMenuItem(label, NULL));
	root->AddChild(bar);
	Open(Add(1, root));
	driver.Click(Find("bar"), BPoint(300, 8));
	BOutlineListView* list = ControlUser::All<BOutlineListView>(Panel("EditMenuBar"))[0];
	std::vector<BListItem*> before;
	for (int32 i = 0; i < list->FullListCountItems(); i++)
		before.push_back(list->FullListItemAt(i));

	person.ClickEntry(list, "Two");
	person.TypeOver(Field("EditMenuBar", "Label: "), "Second");
	person.TypeOver(Field("EditMenuBar", "Message: "), "abcd");
	driver.Click(InPanel<BButton>("EditMenuBar", "Add After"));
	ASSERT_EQ(4, list->FullListCountItems());
	EXPECT_EQ(before[0], list->FullListItemAt(0));
	EXPECT_EQ(before[1], list->FullListItemAt(1));
	EXPECT_EQ(before[2], list->FullListItemAt(3));
}
