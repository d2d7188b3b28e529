#include <string>

#include <gtest/gtest.h>

#include <List.h>

namespace {

void*
item(intptr_t number)
{
	return reinterpret_cast<void*>(number);
}


std::string
text_of(const BList& list)
{
	std::string text;
	for (int32 i = 0; i < list.CountItems(); i++)
		text += std::to_string(reinterpret_cast<intptr_t>(list.ItemAt(i)));
	return text;
}


BList
numbers(int count)
{
	BList list;
	for (int i = 1; i <= count; i++)
		list.AddItem(item(i));
	return list;
}

} // namespace


TEST(List, AddsAnywhere)
{
	BList list = numbers(3);
	EXPECT_TRUE(list.AddItem(item(9), 0));
	EXPECT_TRUE(list.AddItem(item(8), 2));
	EXPECT_FALSE(list.AddItem(item(7), 6));
	EXPECT_FALSE(list.AddItem(item(7), -1));
	EXPECT_EQ("91823", text_of(list));
	const BList more = numbers(2);
	EXPECT_TRUE(list.AddList(&more, 1));
	EXPECT_EQ("9121823", text_of(list));
	EXPECT_TRUE(list.AddList(&list, 3));
	EXPECT_EQ("91291218231823", text_of(list));
	EXPECT_FALSE(list.AddList(nullptr));
}


TEST(List, RemovesAndReplaces)
{
	BList list = numbers(6);
	EXPECT_EQ(item(2), list.RemoveItem(int32(1)));
	EXPECT_TRUE(list.RemoveItem(item(5)));
	EXPECT_FALSE(list.RemoveItem(item(5)));
	EXPECT_EQ(nullptr, list.RemoveItem(int32(9)));
	EXPECT_EQ("1346", text_of(list));
	EXPECT_TRUE(list.RemoveItems(2, 10));
	EXPECT_FALSE(list.RemoveItems(2, 1));
	EXPECT_EQ("13", text_of(list));
	EXPECT_TRUE(list.ReplaceItem(0, item(7)));
	EXPECT_FALSE(list.ReplaceItem(2, item(7)));
	EXPECT_EQ("73", text_of(list));
	list.MakeEmpty();
	EXPECT_TRUE(list.IsEmpty());
	EXPECT_EQ(nullptr, list.FirstItem());
	EXPECT_EQ(nullptr, list.LastItem());
}


TEST(List, MovesSwapsAndSorts)
{
	BList list = numbers(5);
	EXPECT_TRUE(list.MoveItem(0, 3));
	EXPECT_EQ("23415", text_of(list));
	EXPECT_TRUE(list.MoveItem(4, 1));
	EXPECT_EQ("25341", text_of(list));
	EXPECT_FALSE(list.MoveItem(0, 5));
	EXPECT_TRUE(list.SwapItems(0, 4));
	EXPECT_FALSE(list.SwapItems(0, 5));
	EXPECT_EQ("15342", text_of(list));
	list.SortItems([](const void* a, const void* b) {
		const auto left = *static_cast<const intptr_t*>(a);
		const auto right = *static_cast<const intptr_t*>(b);
		return left < right ? 1 : (left > right ? -1 : 0);
	});
	EXPECT_EQ("54321", text_of(list));
}


TEST(List, FindsAndCompares)
{
	BList list = numbers(4);
	EXPECT_EQ(2, list.IndexOf(item(3)));
	EXPECT_EQ(-1, list.IndexOf(item(9)));
	EXPECT_TRUE(list.HasItem(item(1)));
	BList copy(list);
	EXPECT_TRUE(copy == list);
	copy.SwapItems(0, 1);
	EXPECT_TRUE(copy != list);
	copy = list;
	EXPECT_TRUE(copy == list);
	EXPECT_EQ(item(4), list.LastItem());

	static int sVisits;
	sVisits = 0;
	list.DoForEach([](void* visited) {
		sVisits++;
		return visited == item(2);
	});
	EXPECT_EQ(2, sVisits);
}
