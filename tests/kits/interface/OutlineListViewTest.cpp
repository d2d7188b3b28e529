#include <OutlineListView.h>

#include <gtest/gtest.h>

#include <cstring>
#include <memory>
#include <random>
#include <string>
#include <vector>

#include <Message.h>

#include "support/TestWindow.h"

namespace {

// The visible texts, separated by blanks; the full list with its levels.
std::string
visible(const BOutlineListView& list)
{
	std::string text;
	for (int32 i = 0; i < list.CountItems(); i++)
		text += std::string(i > 0 ? " " : "") + static_cast<BStringItem*>(list.ItemAt(i))->Text();
	return text;
}


std::string
full(const BOutlineListView& list)
{
	std::string text;
	for (int32 i = 0; i < list.FullListCountItems(); i++) {
		const BStringItem* item = static_cast<BStringItem*>(list.FullListItemAt(i));
		text += (i > 0 ? " " : "") + std::string(item->OutlineLevel(), '-') + item->Text();
	}
	return text;
}


int
compare_texts(const BListItem* a, const BListItem* b)
{
	return strcmp(
		static_cast<const BStringItem*>(a)->Text(), static_cast<const BStringItem*>(b)->Text());
}

// a (b (c d) e) f (g)
struct Outline {
	Outline() : list(new BOutlineListView(BRect(10, 10, 209, 209), "outline"))
	{
		for (const auto& [text, level] :
			std::initializer_list<std::pair<const char*, uint32>> { { "a", 0 }, { "b", 1 },
				{ "c", 2 }, { "d", 2 }, { "e", 1 }, { "f", 0 }, { "g", 1 } }) {
			items.push_back(std::make_unique<BStringItem>(text, level));
			list->AddItem(items.back().get());
		}
	}

	BListItem* operator[](char name) { return items[name - 'a'].get(); }

	std::vector<std::unique_ptr<BStringItem>> items;
	BOutlineListView* list;
};

struct OutlineTest : testing::Test {
	~OutlineTest() override { delete outline.list; }

	BApplication app { "application/x-vnd.Archway-test" };
	Outline outline;
	BOutlineListView& list = *outline.list;
};

} // namespace


TEST_F(OutlineTest, CollapsedItemsHideWhatIsUnderThem)
{
	EXPECT_EQ("a b c d e f g", visible(list));
	list.Collapse(outline['b']);
	EXPECT_EQ("a b e f g", visible(list));
	list.Collapse(outline['a']);
	EXPECT_EQ("a f g", visible(list));
	EXPECT_EQ("a -b --c --d -e f -g", full(list));
	list.Expand(outline['a']);
	EXPECT_EQ("a b e f g", visible(list));
	EXPECT_EQ(5, list.CountItems());
	EXPECT_EQ(7, list.FullListCountItems());
	EXPECT_EQ(2, list.FullListIndexOf(outline['c']));
	EXPECT_EQ(-1, list.IndexOf(outline['c']));
	EXPECT_FALSE(list.IsExpanded(1));
}


TEST_F(OutlineTest, KnowsSuperitemsAndCounts)
{
	EXPECT_EQ(outline['b'], list.Superitem(outline['d']));
	EXPECT_EQ(outline['a'], list.Superitem(outline['e']));
	EXPECT_EQ(nullptr, list.Superitem(outline['f']));
	EXPECT_EQ(4, list.CountItemsUnder(outline['a'], false));
	EXPECT_EQ(2, list.CountItemsUnder(outline['a'], true));
	EXPECT_EQ(2, list.CountItemsUnder(NULL, true));
	EXPECT_EQ(outline['e'], list.ItemUnderAt(outline['a'], true, 1));
	EXPECT_EQ(outline['d'], list.ItemUnderAt(outline['a'], false, 2));
	EXPECT_EQ(nullptr, list.ItemUnderAt(outline['c'], true, 0));
	EXPECT_TRUE(outline['a']->HasSubitems());
	EXPECT_FALSE(outline['c']->HasSubitems());
}


TEST_F(OutlineTest, AddUnderPutsTheItemRightBehindItsSuperitem)
{
	BStringItem under("x"), hidden("y");
	EXPECT_TRUE(list.AddUnder(&under, outline['a']));
	EXPECT_EQ(1u, under.OutlineLevel());
	EXPECT_EQ("a x b c d e f g", visible(list));
	list.Collapse(outline['f']);
	EXPECT_TRUE(list.AddUnder(&hidden, outline['f']));
	EXPECT_EQ("a x b c d e f", visible(list));
	list.Expand(outline['f']);
	EXPECT_EQ("a x b c d e f y g", visible(list));
}


TEST_F(OutlineTest, RemovingASuperitemTakesItsSubitemsAlong)
{
	EXPECT_EQ(outline['b'], list.RemoveItem(static_cast<int32>(1)));
	EXPECT_EQ("a -e f -g", full(list));
	EXPECT_EQ("a e f g", visible(list));
	EXPECT_TRUE(list.RemoveItem(outline['f']));
	EXPECT_EQ("a -e", full(list));
	EXPECT_TRUE(list.RemoveItem(outline['e']));
	EXPECT_FALSE(outline['a']->HasSubitems());
}


TEST_F(OutlineTest, SortingMovesItemsWithTheirSubitems)
{
	const auto descending = [](const BListItem* a, const BListItem* b) {
		return compare_texts(b, a);
	};
	list.FullListSortItems(descending);
	EXPECT_EQ("f -g a -e -b --d --c", full(list));
	EXPECT_EQ("f g a e b d c", visible(list));
	list.SortItemsUnder(outline['b'], true, compare_texts);
	EXPECT_EQ("f -g a -e -b --c --d", full(list));
	list.SortItemsUnder(NULL, true, compare_texts);
	EXPECT_EQ("a -e -b --c --d f -g", full(list));
}


TEST_F(OutlineTest, SwapsAndMovesAmongSiblings)
{
	EXPECT_TRUE(list.SwapItems(1, 4));
	EXPECT_EQ("a -e -b --c --d f -g", full(list));
	EXPECT_FALSE(list.SwapItems(0, 1));
	EXPECT_TRUE(list.MoveItem(0, 5));
	EXPECT_EQ("f -g a -e -b --c --d", full(list));
}


TEST_F(OutlineTest, EachItemUnderStopsAtTheItemThatIsReturned)
{
	int32 calls = 0;
	BListItem* found = list.EachItemUnder(
		outline['a'], false,
		[](BListItem* item, void* arg) -> BListItem* {
			(*static_cast<int32*>(arg))++;
			return strcmp(static_cast<BStringItem*>(item)->Text(), "d") == 0 ? item : NULL;
		},
		&calls);
	EXPECT_EQ(outline['d'], found);
	EXPECT_EQ(3, calls);
}


TEST_F(OutlineTest, CollapsingDeselectsWhatDisappears)
{
	list.Select(3);
	EXPECT_EQ(3, list.FullListCurrentSelection());
	list.Collapse(outline['a']);
	EXPECT_EQ(-1, list.CurrentSelection());
	EXPECT_FALSE(outline['d']->IsSelected());
}


TEST_F(OutlineTest, ArchiveRoundTripKeepsTheFullList)
{
	list.Collapse(outline['b']);
	list.SetInvocationMessage(new BMessage('invk'));
	BMessage archive;
	ASSERT_EQ(B_OK, list.Archive(&archive));
	EXPECT_FALSE(archive.HasMessage("_l_items"));
	const std::unique_ptr<BOutlineListView> revived(
		dynamic_cast<BOutlineListView*>(instantiate_object(&archive)));
	ASSERT_NE(nullptr, revived);
	EXPECT_EQ("a -b --c --d -e f -g", full(*revived));
	EXPECT_EQ("a b e f g", visible(*revived));
	EXPECT_EQ(uint32('invk'), revived->InvocationCommand());
	BMessage again;
	ASSERT_EQ(B_OK, revived->Archive(&again));
	EXPECT_TRUE(again.HasSameData(archive));
}


TEST_F(OutlineTest, RandomChangesKeepVisibleAndFullListInStep)
{
	std::mt19937 random(3);
	list.MakeEmpty();
	std::vector<std::unique_ptr<BStringItem>> pool;
	for (int step = 0; step < 2000; step++) {
		const int32 count = list.FullListCountItems();
		const int action = static_cast<int>(random() % 6);
		if (action < 3 || count == 0) {
			pool.push_back(std::make_unique<BStringItem>(
				std::to_string(step).c_str(), random() % 4, random() % 3 != 0));
			list.AddItem(pool.back().get(), static_cast<int32>(random() % (count + 1)));
		} else if (action == 3) {
			list.RemoveItem(static_cast<int32>(random() % count));
		} else if (action == 4) {
			list.Collapse(list.FullListItemAt(static_cast<int32>(random() % count)));
		} else {
			list.Expand(list.FullListItemAt(static_cast<int32>(random() % count)));
		}

		// An item shows if every item that it is under is expanded.
		std::string expected;
		uint32 hiddenBelow = UINT32_MAX;
		for (int32 i = 0; i < list.FullListCountItems(); i++) {
			const BStringItem* item = static_cast<BStringItem*>(list.FullListItemAt(i));
			if (item->OutlineLevel() > hiddenBelow)
				continue;
			hiddenBelow = item->IsExpanded() ? UINT32_MAX : item->OutlineLevel();
			expected += (expected.empty() ? "" : " ") + std::string(item->Text());
		}
		ASSERT_EQ(expected, visible(list)) << "step " << step << ": " << full(list);
	}
}


TEST(OutlineListView, LatchAndKeysOpenAndClose)
{
	TestWindow window;
	Outline outline;
	BOutlineListView* list = window.Add(outline.list);
	BPoint latch, label;
	window.Locked([&] {
		const BRect frame = list->ItemFrame(1);
		// One level to the right, before the label.
		latch = BPoint(15, (frame.top + frame.bottom) / 2);
		label = BPoint(60, latch.y);
		list->MakeFocus();
	});
	window.driver.Click(list, latch);
	EXPECT_EQ("a b e f g", visible(*list));
	EXPECT_EQ(-1, list->CurrentSelection());
	window.driver.Click(list, label);
	EXPECT_EQ(1, list->CurrentSelection());
	EXPECT_EQ("a b e f g", visible(*list));
	window.driver.Key("Right");
	EXPECT_EQ("a b c d e f g", visible(*list));
	window.driver.Key("Left");
	EXPECT_EQ("a b e f g", visible(*list));
	window.driver.Key("Left");
	EXPECT_EQ(0, list->CurrentSelection());
	window.driver.Key("Up", B_CONTROL_KEY);
	EXPECT_EQ("a f g", visible(*list));
	window.Locked([&] { list->MakeEmpty(); });
}
