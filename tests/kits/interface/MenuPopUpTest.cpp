// Menus that pop up, scroll, belong to a field or are filled when they open.
#include <gtest/gtest.h>

#include <atomic>
#include <vector>

#include <Looper.h>
#include <Menu.h>
#include <MenuBar.h>
#include <MenuField.h>
#include <MenuItem.h>
#include <Message.h>
#include <PopUpMenu.h>
#include <Screen.h>

#include "OpenedMenus.h"

namespace {

// Runs a menu in a thread that has no window.
struct PopUpLooper : BLooper {
	void MessageReceived(BMessage*) override { chosen = menu.Go(BPoint(100, 100), false, true); }

	BPopUpMenu menu { "pop", false, false };
	BMenuItem* chosen = NULL;
};

} // namespace


TEST(MenuTracking, SynchronousPopUpReturnsTheChosenItem)
{
	Menus menus;
	PopUpLooper* looper = new PopUpLooper;
	looper->menu.AddItem(new BMenuItem("one", new BMessage('itm7')));
	looper->menu.AddItem(new BMenuItem("two", new BMessage('itm8')));
	looper->menu.SetTargetForItems(menus.window);
	looper->Run();
	looper->PostMessage('open');
	Driver::WaitUntilIdle();
	ASSERT_TRUE(Menus::IsOpen(&looper->menu));
	menus.driver.Click(Menus::Item(&looper->menu, 1));
	ASSERT_TRUE(looper->Lock());
	EXPECT_EQ(looper->menu.ItemAt(1), looper->chosen);
	EXPECT_EQ(Codes(), menus.TakeCodes());
	looper->Quit();
}


TEST(MenuTracking, AsynchronousPopUpDeliversAndReturnsAtOnce)
{
	Menus menus;
	BPopUpMenu* menu = new BPopUpMenu("pop", false, false);
	menu->AddItem(new BMenuItem("one", new BMessage('itm7')));
	menu->SetTargetForItems(menus.window);
	menu->SetAsyncAutoDestruct(true);
	EXPECT_EQ(nullptr, menu->Go(BPoint(100, 100), true, true, true));
	Driver::WaitUntilIdle();
	menus.driver.Click(Menus::Item(menu, 0));
	EXPECT_EQ(Codes { 'itm7' }, menus.TakeCodes());
}


namespace {

// Opens a menu in its MouseDown(), as programs do.
struct PopUpView : BView {
	PopUpView() : BView(BRect(0, 100, 399, 299), "area", B_FOLLOW_NONE, B_WILL_DRAW)
	{
		menu.AddItem(new BMenuItem("one", new BMessage('itm7')));
		menu.AddItem(new BMenuItem("two", new BMessage('itm8')));
	}

	void MouseDown(BPoint where) override
	{
		menu.SetTargetForItems(Window());
		draws = 0;
		Invalidate();
		chosen = menu.Go(ConvertToScreen(where), true, true);
	}

	void Draw(BRect) override { draws++; }

	BPopUpMenu menu { "pop", false, false };
	BMenuItem* chosen = NULL;
	std::atomic<int32> draws { 0 };
};

} // namespace


TEST(MenuTracking, WindowThatWaitsForItsPopUpIsDrawn)
{
	Menus menus;
	PopUpView* view = new PopUpView;
	menus.Locked([&] { menus.window->AddChild(view); });
	menus.driver.Click(view, BPoint(50, 50));
	ASSERT_TRUE(Menus::IsOpen(&view->menu));
	menus.driver.Click(Menus::Item(&view->menu, 1));
	EXPECT_EQ(Codes { 'itm8' }, menus.TakeCodes());
	EXPECT_EQ(view->menu.ItemAt(1), view->chosen);
}


TEST(MenuTracking, MenuHigherThanTheScreenScrolls)
{
	Menus menus;
	menus.Locked([&] {
		for (int32 i = 0; i < 200; i++)
			menus.edit->AddItem(new BMenuItem("item", new BMessage('itm6')));
	});
	menus.driver.Click(menus.BarItem(1));
	ASSERT_TRUE(Menus::IsOpen(menus.edit));
	const BRect screen = BScreen().Frame();
	ASSERT_TRUE(menus.edit->LockLooper());
	EXPECT_LE(menus.edit->Window()->Frame().Height(), screen.Height());
	const float before = menus.edit->Bounds().top;
	menus.edit->UnlockLooper();
	menus.driver.Key("End");
	ASSERT_TRUE(menus.edit->LockLooper());
	EXPECT_GT(menus.edit->Bounds().top, before);
	menus.edit->UnlockLooper();
	EXPECT_TRUE(screen.Contains(Menus::Item(menus.edit, 201)));
	menus.driver.Click(Menus::Item(menus.edit, 201));
	EXPECT_EQ(Codes { 'itm6' }, menus.TakeCodes());
	EXPECT_EQ(201, menus.window->last.GetInt32("index", -1));
}


TEST(MenuTracking, MenuFieldChoosesByMouseAndKeys)
{
	Menus menus;
	BPopUpMenu* menu = new BPopUpMenu("choose");
	for (uint32 i = 0; i < 3; i++) {
		const char* labels[] = { "red", "green", "blue" };
		menu->AddItem(new BMenuItem(labels[i], new BMessage('itm7' + i)));
	}
	menu->ItemAt(0)->SetMarked(true);
	BMenuField* field = new BMenuField(BRect(10, 60, 209, 80), "field", "Colour:", menu);
	menus.Locked([&] { menus.window->AddChild(field); });
	EXPECT_STREQ("red", field->MenuItem()->Label());

	menus.driver.Click(field->MenuBar());
	ASSERT_TRUE(Menus::IsOpen(menu));
	menus.driver.Click(Menus::Item(menu, 2));
	EXPECT_EQ(Codes { 'itm9' }, menus.TakeCodes());
	EXPECT_EQ(2, menu->FindMarkedIndex());
	EXPECT_STREQ("blue", field->MenuItem()->Label());

	menus.Locked([&] { field->MakeFocus(); });
	menus.driver.Key("Down");
	ASSERT_TRUE(Menus::IsOpen(menu));
	menus.driver.Key("g");
	EXPECT_EQ(Codes { 'itm8' }, menus.TakeCodes());
	EXPECT_STREQ("green", field->MenuItem()->Label());

	menus.Locked([&] { field->SetEnabled(false); });
	menus.driver.Click(field->MenuBar());
	EXPECT_FALSE(Menus::IsOpen(menu));
}


namespace {

// Adds items when it opens: some at once, one more with every further call.
struct DynamicMenu : BMenu {
	DynamicMenu(int32 total) : BMenu("Dynamic"), total(total) {}

	bool AddDynamicItem(add_state state) override
	{
		if (state == B_ABORT) {
			aborted = true;
			return false;
		}
		if (state == B_INITIAL_ADD)
			RemoveItems(0, CountItems(), true);
		AddItem(new BMenuItem("dynamic", new BMessage('itm6')));
		return CountItems() < total;
	}

	const int32 total;
	std::atomic<bool> aborted { false };
};

bool
end_when_told(BMenu*, void* state)
{
	return *static_cast<std::atomic<bool>*>(state);
}

struct HookedMenu : BPopUpMenu {
	HookedMenu() : BPopUpMenu("hooked", false, false)
	{
		SetTrackingHook(end_when_told, &end);
		AddItem(new BMenuItem("one", NULL));
	}

	std::atomic<bool> end { false };
};

} // namespace


TEST(MenuTracking, DynamicItemsAreAddedWhenTheMenuOpens)
{
	Menus menus;
	DynamicMenu* menu = new DynamicMenu(5);
	menus.Locked([&] { menus.bar->AddItem(menu); });
	for (int round = 0; round < 2; round++) {
		menus.driver.Click(menus.BarItem(2));
		ASSERT_TRUE(Menus::IsOpen(menu));
		EXPECT_EQ(5, menu->CountItems());
		menus.driver.Click(Menus::Item(menu, 4));
		EXPECT_EQ(Codes { 'itm6' }, menus.TakeCodes());
	}
	EXPECT_FALSE(menu->aborted);
}


TEST(MenuTracking, TheTrackingHookEndsIt)
{
	Menus menus;
	HookedMenu menu;
	menu.Go(BPoint(200, 200), true, true, true);
	Driver::WaitUntilIdle();
	ASSERT_TRUE(Menus::IsOpen(&menu));
	menus.driver.MoveTo(BPoint(300, 300));
	ASSERT_TRUE(Menus::IsOpen(&menu));
	menu.end = true;
	menus.driver.MoveTo(BPoint(310, 310));
	EXPECT_FALSE(Menus::IsOpen(&menu));
}
