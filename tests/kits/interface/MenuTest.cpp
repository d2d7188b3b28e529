#include <Menu.h>

#include <gtest/gtest.h>

#include <MenuBar.h>
#include <MenuItem.h>
#include <Message.h>
#include <PopUpMenu.h>

#include "support/TestWindow.h"

namespace {

struct MenuTest : testing::Test {
	BApplication app { "application/x-vnd.Archway-test" };
};

} // namespace


TEST_F(MenuTest, StartsEnabledEmptyAndInAColumn)
{
	BMenu menu("name");
	EXPECT_EQ(0, menu.CountItems());
	EXPECT_TRUE(menu.IsEnabled());
	EXPECT_FALSE(menu.IsRadioMode());
	EXPECT_FALSE(menu.IsLabelFromMarked());
	EXPECT_TRUE(menu.AreTriggersEnabled());
	EXPECT_EQ(0, menu.MaxContentWidth());
	EXPECT_EQ(nullptr, menu.Superitem());
	EXPECT_EQ(nullptr, menu.Supermenu());
	BPopUpMenu popUp("name");
	EXPECT_TRUE(popUp.IsRadioMode());
	EXPECT_TRUE(popUp.IsLabelFromMarked());
}


TEST_F(MenuTest, AddsFindsAndRemovesItems)
{
	BMenu menu("menu");
	BMenuItem* one = new BMenuItem("one", new BMessage('one_'));
	BMenuItem* two = new BMenuItem("two", new BMessage('two_'));
	EXPECT_TRUE(menu.AddItem(two));
	EXPECT_TRUE(menu.AddItem(one, 0));
	EXPECT_FALSE(menu.AddItem(one));
	EXPECT_TRUE(menu.AddSeparatorItem());
	BMenu* submenu = new BMenu("sub");
	submenu->AddItem(new BMenuItem("inner", new BMessage('innr')));
	EXPECT_TRUE(menu.AddItem(submenu));

	EXPECT_EQ(4, menu.CountItems());
	EXPECT_EQ(0, menu.IndexOf(one));
	EXPECT_EQ(1, menu.IndexOf(two));
	EXPECT_EQ(3, menu.IndexOf(submenu));
	EXPECT_EQ(submenu, menu.SubmenuAt(3));
	EXPECT_EQ(two, menu.FindItem("two"));
	EXPECT_EQ(one, menu.FindItem('one_'));
	EXPECT_EQ(submenu->ItemAt(0), menu.FindItem("inner"));
	EXPECT_EQ(&menu, submenu->Supermenu());
	EXPECT_STREQ("sub", submenu->Superitem()->Label());

	EXPECT_EQ(one, menu.RemoveItem(static_cast<int32>(0)));
	EXPECT_EQ(nullptr, one->Menu());
	EXPECT_FALSE(menu.RemoveItem(one));
	delete one;
	EXPECT_TRUE(menu.RemoveItems(0, 2, true));
	EXPECT_EQ(1, menu.CountItems());
	BMenu* other = new BMenu("other");
	EXPECT_FALSE(menu.AddItem(other, 5));
	EXPECT_EQ(nullptr, other->Superitem());
	delete other;
}


TEST_F(MenuTest, RadioModeKeepsOneItemMarkedAndLabelsTheSuperitem)
{
	BMenu bar("outer");
	BPopUpMenu* menu = new BPopUpMenu("choose");
	BMenuItem* one = new BMenuItem("one", NULL);
	BMenuItem* two = new BMenuItem("two", NULL);
	menu->AddItem(one);
	menu->AddItem(two);
	bar.AddItem(menu);
	EXPECT_STREQ("choose", menu->Superitem()->Label());
	one->SetMarked(true);
	EXPECT_STREQ("one", menu->Superitem()->Label());
	two->SetMarked(true);
	EXPECT_FALSE(one->IsMarked());
	EXPECT_EQ(two, menu->FindMarked());
	EXPECT_STREQ("two", menu->Superitem()->Label());
	two->SetLabel("zwei");
	EXPECT_STREQ("zwei", menu->Superitem()->Label());

	menu->SetRadioMode(false);
	EXPECT_FALSE(menu->IsLabelFromMarked());
	menu->SetLabelFromMarked(true);
	EXPECT_TRUE(menu->IsRadioMode());
}


TEST_F(MenuTest, ItemIsDisabledByEveryMenuAbove)
{
	BMenu outer("outer");
	BMenu* inner = new BMenu("inner");
	BMenuItem* item = new BMenuItem("item", NULL);
	inner->AddItem(item);
	outer.AddItem(inner);
	EXPECT_TRUE(item->IsEnabled());
	outer.SetEnabled(false);
	EXPECT_FALSE(item->IsEnabled());
	outer.SetEnabled(true);
	inner->Superitem()->SetEnabled(false);
	EXPECT_FALSE(inner->IsEnabled());
	EXPECT_FALSE(item->IsEnabled());
}


TEST_F(MenuTest, SeparatorIsAlwaysDisabled)
{
	BSeparatorItem separator;
	EXPECT_FALSE(separator.IsEnabled());
	EXPECT_STREQ("", separator.Label());
	separator.SetEnabled(true);
	EXPECT_FALSE(separator.IsEnabled());
}


TEST_F(MenuTest, ShortcutImpliesCommand)
{
	BMenuItem item("item", NULL, 'K', B_SHIFT_KEY);
	uint32 modifiers;
	EXPECT_EQ('K', item.Shortcut(&modifiers));
	EXPECT_EQ(B_SHIFT_KEY | B_COMMAND_KEY, modifiers);
	item.SetShortcut(0, 0);
	EXPECT_EQ(0, item.Shortcut(&modifiers));
	EXPECT_EQ(0u, modifiers);
}


TEST_F(MenuTest, ColumnIsAsWideAsItsWidestItem)
{
	BMenu menu("menu");
	menu.AddItem(new BMenuItem("i", NULL));
	float narrow, low;
	menu.GetPreferredSize(&narrow, &low);
	menu.AddItem(new BMenuItem("a much longer label", NULL));
	float wide, high;
	menu.GetPreferredSize(&wide, &high);
	EXPECT_EQ(ceilf(menu.StringWidth("a much longer label")) + 34 - 1, wide);
	EXPECT_EQ(2 * (low + 1) - 1, high);
	EXPECT_EQ(menu.ItemAt(0)->Frame().bottom + 1, menu.ItemAt(1)->Frame().top);
	EXPECT_EQ(wide, menu.ItemAt(0)->Frame().right);
	menu.SetMaxContentWidth(40);
	menu.GetPreferredSize(&wide, &high);
	EXPECT_EQ(40 + 34 - 1, wide);
}


TEST_F(MenuTest, MatrixItemsLieWhereTheProgramPutsThem)
{
	BMenu menu("menu", 100, 50);
	BMenuItem* item = new BMenuItem("x", NULL);
	EXPECT_TRUE(menu.AddItem(item, BRect(10, 20, 40, 45)));
	float width, height;
	menu.GetPreferredSize(&width, &height);
	EXPECT_EQ(100, width);
	EXPECT_EQ(50, height);
	EXPECT_EQ(BRect(10, 20, 40, 45), item->Frame());
}


TEST_F(MenuTest, ArchiveRoundTripKeepsEverything)
{
	BMenuBar bar(BRect(0, 0, 100, 20), "bar");
	BMenu* file = new BMenu("File");
	file->AddItem(new BMenuItem("Open", new BMessage('open'), 'O'));
	file->AddSeparatorItem();
	BMenuItem* disabled = new BMenuItem("Save", NULL, 'S', B_SHIFT_KEY);
	disabled->SetEnabled(false);
	disabled->SetTrigger('v');
	file->AddItem(disabled);
	bar.AddItem(file);
	BPopUpMenu* choice = new BPopUpMenu("Choice");
	choice->AddItem(new BMenuItem("first", NULL));
	choice->AddItem(new BMenuItem("second", NULL));
	choice->ItemAt(1)->SetMarked(true);
	choice->SetMaxContentWidth(77);
	choice->SetTriggersEnabled(false);
	bar.AddItem(choice);
	bar.SetBorder(B_BORDER_EACH_ITEM);
	BMessage archive;
	ASSERT_EQ(B_OK, bar.Archive(&archive));

	const std::unique_ptr<BMenuBar> revived(dynamic_cast<BMenuBar*>(instantiate_object(&archive)));
	ASSERT_NE(nullptr, revived);
	EXPECT_EQ(B_BORDER_EACH_ITEM, revived->Border());
	ASSERT_EQ(2, revived->CountItems());
	BMenu* menu = revived->SubmenuAt(0);
	ASSERT_NE(nullptr, menu);
	EXPECT_EQ('O', menu->ItemAt(0)->Shortcut());
	EXPECT_EQ(uint32('open'), menu->ItemAt(0)->Command());
	EXPECT_NE(nullptr, dynamic_cast<BSeparatorItem*>(menu->ItemAt(1)));
	EXPECT_FALSE(menu->ItemAt(2)->IsEnabled());
	EXPECT_EQ('v', menu->ItemAt(2)->Trigger());
	menu = revived->SubmenuAt(1);
	EXPECT_NE(nullptr, dynamic_cast<BPopUpMenu*>(menu));
	EXPECT_EQ(1, menu->FindMarkedIndex());
	EXPECT_TRUE(menu->IsLabelFromMarked());
	EXPECT_FALSE(menu->AreTriggersEnabled());
	EXPECT_EQ(77, menu->MaxContentWidth());
	EXPECT_STREQ("second", menu->Superitem()->Label());

	BMessage again;
	ASSERT_EQ(B_OK, revived->Archive(&again));
	EXPECT_TRUE(again.HasSameData(archive));
}


TEST_F(MenuTest, ItemsOfUnknownClassesAreCarriedAlong)
{
	BMenu menu("menu");
	menu.AddItem(new BMenuItem("known", NULL));
	BMessage archive;
	ASSERT_EQ(B_OK, menu.Archive(&archive));
	BMessage strange;
	strange.AddString("class", "StrangeItem");
	strange.AddString("_label", "strange");
	strange.AddInt32("own", 42);
	archive.AddMessage("_items", &strange);

	const std::unique_ptr<BMenu> revived(dynamic_cast<BMenu*>(instantiate_object(&archive)));
	ASSERT_NE(nullptr, revived);
	ASSERT_EQ(2, revived->CountItems());
	EXPECT_STREQ("strange", revived->ItemAt(1)->Label());
	BMessage again;
	ASSERT_EQ(B_OK, revived->Archive(&again));
	EXPECT_TRUE(again.HasSameData(archive));
}


TEST_F(MenuTest, ASubmenuThatIsDeletedLeavesItsItem)
{
	BMenu menu("menu");
	BMenu* submenu = new BMenu("submenu");
	menu.AddItem(submenu);
	BMenuItem* item = menu.ItemAt(0);
	ASSERT_TRUE(menu.RemoveItem(submenu));
	delete submenu;
	EXPECT_EQ(nullptr, item->Submenu());
	EXPECT_EQ(nullptr, item->Menu());
	EXPECT_STREQ("submenu", item->Label());
	delete item;
}
