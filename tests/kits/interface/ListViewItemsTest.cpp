// The less usual calls of lists, and what their items know of themselves.
#include <gtest/gtest.h>

#include <List.h>
#include <ListView.h>
#include <OutlineListView.h>
#include <StringItem.h>

#include "ControlFixture.h"

namespace {

const BRect kFrame(10, 10, 109, 99);


class HookedList : public BListView {
public:
	using BListView::BListView;

	void SelectionChanged() override { changes++; }
	void DrawItem(BListItem* item, BRect frame, bool complete) override
	{
		drawn++;
		BListView::DrawItem(item, frame, complete);
	}

	int32 changes = 0;
	int32 drawn = 0;
};


// A list of "0" to "9", which owns none of them.
struct Ten {
	explicit Ten(BListView* list) : list(list)
	{
		BList added;
		for (int32 i = 0; i < 10; i++) {
			items[i] = new BStringItem(std::to_string(i).c_str());
			added.AddItem(items[i]);
		}
		EXPECT_TRUE(list->AddList(&added));
	}

	~Ten()
	{
		list->MakeEmpty();
		for (BStringItem* item : items)
			delete item;
	}

	BListView* list; // borrowed
	BStringItem* items[10];
};


bool
StopAtThree(BListItem* item, void* visited)
{
	return ++*static_cast<int32*>(visited) == 3;
}

} // namespace


TEST(ListViewItems, AreFoundFromBothEnds)
{
	ControlFixture fixture;
	BListView list(kFrame, "list");
	Ten ten(&list);
	EXPECT_EQ(10, list.CountItems());
	EXPECT_EQ(ten.items[0], list.FirstItem());
	EXPECT_EQ(ten.items[9], list.LastItem());
	EXPECT_TRUE(list.HasItem(ten.items[4]));
	BStringItem stranger("stranger");
	EXPECT_FALSE(list.HasItem(&stranger));
	EXPECT_EQ(ten.items[2], list.Items()[2]);
	int32 visited = 0;
	list.DoForEach(StopAtThree, &visited);
	EXPECT_EQ(3, visited);

	BList more;
	BStringItem a("a"), b("b");
	more.AddItem(&a);
	more.AddItem(&b);
	EXPECT_TRUE(list.AddList(&more, 1));
	EXPECT_EQ(&b, list.ItemAt(2));
	EXPECT_FALSE(list.AddList(&more, 100));
	EXPECT_TRUE(list.RemoveItems(1, 2));
	EXPECT_EQ(ten.items[1], list.ItemAt(1));
}


TEST(ListViewItems, ARangeCanBeKeptOrLeft)
{
	ControlFixture fixture;
	HookedList list(kFrame, "list", B_MULTIPLE_SELECTION_LIST);
	Ten ten(&list);
	list.Select(1, 6);
	EXPECT_EQ(1, list.changes);
	list.DeselectExcept(3, 4);
	EXPECT_EQ(3, list.CurrentSelection(0));
	EXPECT_EQ(4, list.CurrentSelection(1));
	EXPECT_EQ(-1, list.CurrentSelection(2));
	list.Deselect(3);
	EXPECT_EQ(4, list.CurrentSelection(0));
	EXPECT_EQ(3, list.changes);
	list.Select(7, true);
	list.SetListType(B_SINGLE_SELECTION_LIST);
	EXPECT_EQ(B_SINGLE_SELECTION_LIST, list.ListType());
	EXPECT_EQ(4, list.CurrentSelection(0));
	EXPECT_EQ(-1, list.CurrentSelection(1));
}


TEST(ListViewItems, TheSelectionIsScrolledTo)
{
	ControlFixture fixture;
	HookedList list(kFrame, "list");
	Ten ten(&list);
	fixture.Add(&list);
	fixture.Locked([&] {
		list.Select(9);
		list.ScrollToSelection();
		EXPECT_TRUE(list.Bounds().Contains(list.ItemFrame(9)));
		EXPECT_FALSE(list.Bounds().Contains(list.ItemFrame(0)));
	});
	const int32 before = list.drawn;
	fixture.Locked([&] { list.InvalidateItem(9); });
	EXPECT_EQ(before + 1, list.drawn);
	BFont large(be_plain_font);
	large.SetSize(20);
	fixture.Locked([&] {
		list.SetFont(&large);
		EXPECT_GT(ten.items[0]->Height(), 20);
		list.RemoveSelf();
	});
}


TEST(ListViewItems, InvokingSendsEverySelectedIndex)
{
	ControlFixture fixture;
	BListView list(kFrame, "list", B_MULTIPLE_SELECTION_LIST);
	Ten ten(&list);
	fixture.Add(&list);
	fixture.Locked([&] {
		list.SetInvocationMessage(new BMessage('invo'));
		list.Select(2);
		list.Select(5, true);
		EXPECT_EQ(B_OK, list.Invoke());
		list.RemoveSelf();
	});
	const std::vector<BMessage> received = fixture.Received('invo');
	ASSERT_EQ(1u, received.size());
	EXPECT_EQ(2, received[0].GetInt32("index", 0, -1));
	EXPECT_EQ(5, received[0].GetInt32("index", 1, -1));
	EXPECT_TRUE(received[0].HasInt64("when"));
	EXPECT_TRUE(received[0].HasPointer("source"));
	EXPECT_TRUE(received[0].HasMessenger("be:sender"));
}


TEST(ListViewItems, BListItemKeepsItsOwnState)
{
	BStringItem item("text", 2, false);
	EXPECT_EQ(2u, item.OutlineLevel());
	EXPECT_FALSE(item.IsExpanded());
	EXPECT_TRUE(item.IsEnabled());
	EXPECT_FALSE(item.IsSelected());
	item.SetOutlineLevel(1);
	EXPECT_EQ(1u, item.OutlineLevel());
	item.SetExpanded(true);
	EXPECT_TRUE(item.IsExpanded());
	item.SetEnabled(false);
	EXPECT_FALSE(item.IsEnabled());
	item.Select();
	EXPECT_TRUE(item.IsSelected());
	item.Deselect();
	EXPECT_FALSE(item.IsSelected());
	item.SetHeight(30);
	item.SetWidth(70);
	EXPECT_EQ(30, item.Height());
	EXPECT_EQ(70, item.Width());
	item.SetText("other");
	EXPECT_STREQ("other", item.Text());
	EXPECT_FALSE(item.HasSubitems());
}


TEST(ListViewItems, OfAnOutlineAreCountedInFull)
{
	ControlFixture fixture;
	BOutlineListView* list = fixture.Add(new BOutlineListView(kFrame, "outline"));
	BStringItem top("top"), child("child", 1), last("last");
	fixture.Locked([&] {
		BList items;
		items.AddItem(&top);
		items.AddItem(&child);
		items.AddItem(&last);
		EXPECT_TRUE(list->FullListIsEmpty());
		EXPECT_TRUE(list->AddList(&items));
		EXPECT_FALSE(list->FullListIsEmpty());
		EXPECT_EQ(&top, list->FullListFirstItem());
		EXPECT_EQ(&last, list->FullListLastItem());
		EXPECT_TRUE(top.HasSubitems());
		list->Collapse(&top);
		EXPECT_FALSE(child.IsItemVisible());
		EXPECT_TRUE(list->FullListHasItem(&child));
		EXPECT_FALSE(list->HasItem(&child));
		int32 visited = 0;
		list->FullListDoForEach(StopAtThree, &visited);
		EXPECT_EQ(3, visited);
		EXPECT_TRUE(list->RemoveItems(0, 1));
		EXPECT_EQ(1, list->FullListCountItems());
		list->MakeEmpty();
		EXPECT_TRUE(list->FullListIsEmpty());
	});
}
