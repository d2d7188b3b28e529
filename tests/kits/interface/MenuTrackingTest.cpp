// Menus followed by mouse and keys.
#include <Menu.h>

#include <gtest/gtest.h>

#include <atomic>
#include <vector>

#include <Looper.h>
#include <MenuBar.h>
#include <MenuField.h>
#include <MenuItem.h>
#include <Message.h>
#include <PopUpMenu.h>
#include <Screen.h>

#include "OpenedMenus.h"


TEST(MenuTracking, DraggingToAnItemInvokesIt)
{
	Menus menus;
	menus.driver.MoveTo(menus.BarItem(0));
	menus.driver.Press();
	ASSERT_TRUE(Menus::IsOpen(menus.file));
	menus.driver.MoveTo(Menus::Item(menus.file, 1));
	menus.driver.Release();
	EXPECT_FALSE(Menus::IsOpen(menus.file));
	EXPECT_EQ(Codes { 'itm1' }, menus.TakeCodes());
	EXPECT_EQ(1, menus.window->beginnings);
	EXPECT_EQ(1, menus.window->ends);

	void* source = NULL;
	int32 index = -1;
	EXPECT_EQ(B_OK, menus.window->last.FindPointer("source", &source));
	EXPECT_EQ(menus.file->ItemAt(1), source);
	EXPECT_EQ(B_OK, menus.window->last.FindInt32("index", &index));
	EXPECT_EQ(1, index);
	EXPECT_TRUE(menus.window->last.HasInt64("when"));
}


TEST(MenuTracking, AClickLeavesTheMenuOpenUntilTheNextOne)
{
	Menus menus;
	menus.driver.Click(menus.BarItem(1));
	ASSERT_TRUE(Menus::IsOpen(menus.edit));
	menus.driver.Click(Menus::Item(menus.edit, 0));
	EXPECT_FALSE(Menus::IsOpen(menus.edit));
	EXPECT_EQ(Codes { 'itm4' }, menus.TakeCodes());
}


TEST(MenuTracking, AClickElsewhereClosesWithoutAChoice)
{
	Menus menus;
	menus.driver.Click(menus.BarItem(1));
	ASSERT_TRUE(Menus::IsOpen(menus.edit));
	menus.driver.Click(BPoint(400, 300));
	EXPECT_FALSE(Menus::IsOpen(menus.edit));
	EXPECT_EQ(Codes(), menus.TakeCodes());
	EXPECT_EQ(1, menus.window->ends);
}


TEST(MenuTracking, ThePointerOpensTheNextMenuOfTheBar)
{
	Menus menus;
	menus.driver.MoveTo(menus.BarItem(0));
	menus.driver.Press();
	ASSERT_TRUE(Menus::IsOpen(menus.file));
	menus.driver.MoveTo(menus.BarItem(1));
	EXPECT_FALSE(Menus::IsOpen(menus.file));
	ASSERT_TRUE(Menus::IsOpen(menus.edit));
	menus.driver.MoveTo(Menus::Item(menus.edit, 1));
	menus.driver.Release();
	EXPECT_EQ(Codes { 'itm5' }, menus.TakeCodes());
	EXPECT_EQ(1, menus.window->beginnings);
}


TEST(MenuTracking, SubmenuOpensBesideItsItem)
{
	Menus menus;
	menus.driver.MoveTo(menus.BarItem(0));
	menus.driver.Press();
	menus.driver.MoveTo(Menus::Item(menus.file, 3));
	ASSERT_TRUE(Menus::IsOpen(menus.recent));
	EXPECT_GT(Menus::Item(menus.recent, 0).x, Menus::Item(menus.file, 3).x);
	menus.driver.MoveTo(Menus::Item(menus.recent, 1));
	EXPECT_TRUE(Menus::IsOpen(menus.file));
	menus.driver.Release();
	EXPECT_EQ(Codes { 'itm3' }, menus.TakeCodes());
	EXPECT_FALSE(Menus::IsOpen(menus.file));
	EXPECT_FALSE(Menus::IsOpen(menus.recent));
}


TEST(MenuTracking, KeysMoveChooseAndLeave)
{
	Menus menus;
	menus.driver.Key("Escape", B_COMMAND_KEY);
	ASSERT_TRUE(Menus::IsOpen(menus.file));
	menus.driver.Key("Right");
	ASSERT_TRUE(Menus::IsOpen(menus.edit));
	menus.driver.Key("Down");
	menus.driver.Key("Return");
	EXPECT_EQ(Codes { 'itm5' }, menus.TakeCodes());

	menus.driver.Key("Escape", B_COMMAND_KEY);
	menus.driver.Key("Up"); // round the end, to the submenu
	menus.driver.Key("Right");
	ASSERT_TRUE(Menus::IsOpen(menus.recent));
	menus.driver.Key("Escape");
	EXPECT_FALSE(Menus::IsOpen(menus.recent));
	EXPECT_TRUE(Menus::IsOpen(menus.file));
	menus.driver.Key("Escape");
	EXPECT_FALSE(Menus::IsOpen(menus.file));
	EXPECT_EQ(Codes(), menus.TakeCodes());
}


TEST(MenuTracking, TriggersChooseInAnOpenMenu)
{
	Menus menus;
	menus.driver.Key("Escape", B_COMMAND_KEY);
	menus.driver.Key("s");
	EXPECT_EQ(Codes { 'itm1' }, menus.TakeCodes());
}


TEST(MenuTracking, ShortcutsInvokeTheirItems)
{
	Menus menus;
	menus.driver.Key("o", B_COMMAND_KEY);
	EXPECT_EQ(Codes { 'itm0' }, menus.TakeCodes());
	menus.driver.Key("s", B_COMMAND_KEY);
	EXPECT_EQ(Codes(), menus.TakeCodes());
	menus.driver.Key("s", B_COMMAND_KEY | B_SHIFT_KEY);
	EXPECT_EQ(Codes { 'itm1' }, menus.TakeCodes());
	menus.Locked([&] { menus.file->ItemAt(0)->SetEnabled(false); });
	menus.driver.Key("o", B_COMMAND_KEY);
	EXPECT_EQ(Codes(), menus.TakeCodes());
	menus.Locked([&] { delete menus.file->RemoveItem(static_cast<int32>(1)); });
	menus.driver.Key("s", B_COMMAND_KEY | B_SHIFT_KEY);
	EXPECT_EQ(Codes(), menus.TakeCodes());
}


TEST(MenuTracking, DisabledItemsAndSeparatorsAreNotChosen)
{
	Menus menus;
	menus.Locked([&] { menus.file->ItemAt(1)->SetEnabled(false); });
	menus.driver.Click(menus.BarItem(0));
	menus.driver.Click(Menus::Item(menus.file, 1));
	EXPECT_TRUE(Menus::IsOpen(menus.file));
	menus.driver.Click(Menus::Item(menus.file, 2));
	EXPECT_TRUE(Menus::IsOpen(menus.file));
	menus.driver.Key("Escape");
	EXPECT_EQ(Codes(), menus.TakeCodes());
}


TEST(MenuTracking, SelectedItemIsDrawnDarker)
{
	Menus menus;
	menus.driver.Click(menus.BarItem(1));
	const BPoint first = Menus::Item(menus.edit, 0);
	const BPoint corner(first.x, first.y);
	menus.driver.MoveTo(Menus::Item(menus.edit, 1));
	BRect frame;
	ASSERT_TRUE(menus.edit->LockLooper());
	frame = menus.edit->ConvertToScreen(menus.edit->ItemAt(0)->Frame());
	menus.edit->UnlockLooper();
	const BPoint blank(frame.left + 3, frame.bottom - 2);
	EXPECT_EQ(216, menus.driver.PixelAt(blank).red);
	menus.driver.MoveTo(corner);
	EXPECT_EQ(152, menus.driver.PixelAt(blank).red);
	menus.driver.Key("Escape");
}


TEST(MenuTracking, ClosingTheWindowEndsTheTracking)
{
	Menus menus;
	menus.driver.Click(menus.BarItem(0));
	menus.driver.MoveTo(Menus::Item(menus.file, 3));
	ASSERT_TRUE(Menus::IsOpen(menus.recent));
	ASSERT_TRUE(menus.window->Lock());
	menus.window->Quit();
	Driver::WaitUntilIdle();
	menus.driver.Click(BPoint(200, 200));
	menus.window = new MenuTestWindow;
	menus.window->Show();
}


TEST(MenuTracking, DeletingAnOpenMenuEndsTheTracking)
{
	Menus menus;
	menus.driver.Click(menus.BarItem(0));
	ASSERT_TRUE(Menus::IsOpen(menus.file));
	menus.Locked([&] { delete menus.bar->RemoveItem(static_cast<int32>(0)); });
	EXPECT_EQ(1, menus.bar->CountItems());
	menus.driver.Click(menus.BarItem(0));
	EXPECT_TRUE(Menus::IsOpen(menus.edit));
	menus.driver.Key("Escape");
}


TEST(MenuTracking, MenuThatItsWindowTakesAwayBeforeItOpensStaysClosed)
{
	Menus menus;
	menus.Locked([&] {
		menus.window->onBeginning = [&] { delete menus.bar->RemoveItem(static_cast<int32>(0)); };
	});
	menus.driver.Click(menus.BarItem(0));
	menus.driver.Key("Escape");
	EXPECT_EQ(1, menus.bar->CountItems());
	EXPECT_EQ(1, menus.window->beginnings);
	EXPECT_EQ(1, menus.window->ends);
}


TEST(MenuTracking, ItemsAddedWhileTheMenuIsOpenAppear)
{
	Menus menus;
	menus.driver.Click(menus.BarItem(1));
	ASSERT_TRUE(Menus::IsOpen(menus.edit));
	menus.Locked([&] { menus.edit->AddItem(new BMenuItem("Select All", new BMessage('itm6'))); });
	menus.driver.Click(Menus::Item(menus.edit, 2));
	EXPECT_EQ(Codes { 'itm6' }, menus.TakeCodes());
}


TEST(MenuTracking, OpeningLeavesTheArchiveUntouched)
{
	Menus menus;
	BMessage before, after;
	menus.Locked([&] { menus.file->Archive(&before); });
	menus.driver.Click(menus.BarItem(0));
	menus.driver.Key("Escape");
	menus.Locked([&] { menus.file->Archive(&after); });
	EXPECT_TRUE(after.HasSameData(before));
}
