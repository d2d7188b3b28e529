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

#include "support/TestWindow.h"

namespace {

struct MenuTestWindow : BWindow {
	MenuTestWindow() :
		BWindow(BRect(50, 50, 449, 349), "menus", B_TITLED_WINDOW, B_ASYNCHRONOUS_CONTROLS)
	{
	}

	void MessageReceived(BMessage* message) override
	{
		if (message->what >= 'itm0' && message->what <= 'itm9') {
			codes.push_back(message->what);
			last = *message;
		} else {
			BWindow::MessageReceived(message);
		}
	}

	void MenusBeginning() override
	{
		beginnings++;
		if (onBeginning)
			onBeginning();
	}

	void MenusEnded() override { ends++; }

	std::vector<uint32> codes;
	BMessage last;
	int32 beginnings = 0;
	int32 ends = 0;
	std::function<void()> onBeginning;
};

typedef std::vector<uint32> Codes;

struct Menus {
	Menus() : app("application/x-vnd.Archway-test"), window(new MenuTestWindow)
	{
		bar = new BMenuBar(BRect(0, 0, 10, 10), "bar");
		file = new BMenu("File");
		file->AddItem(new BMenuItem("Open", new BMessage('itm0'), 'O'));
		file->AddItem(new BMenuItem("Save", new BMessage('itm1'), 'S', B_SHIFT_KEY));
		file->AddSeparatorItem();
		recent = new BMenu("Recent");
		recent->AddItem(new BMenuItem("first", new BMessage('itm2')));
		recent->AddItem(new BMenuItem("second", new BMessage('itm3')));
		file->AddItem(recent);
		edit = new BMenu("Edit");
		edit->AddItem(new BMenuItem("Cut", new BMessage('itm4')));
		edit->AddItem(new BMenuItem("Paste", new BMessage('itm5')));
		bar->AddItem(file);
		bar->AddItem(edit);
		window->AddChild(bar);
		window->Show();
		Driver::WaitUntilIdle();
	}

	~Menus()
	{
		if (window->Lock())
			window->Quit();
	}

	void Locked(const std::function<void()>& function)
	{
		window->Lock();
		function();
		window->Unlock();
		Driver::WaitUntilIdle();
	}

	Codes TakeCodes()
	{
		Codes codes;
		Locked([&] { codes.swap(window->codes); });
		return codes;
	}

	// The middle of a bar's item on the screen.
	BPoint BarItem(int32 index)
	{
		BPoint point;
		Locked([&] {
			const BRect frame = bar->ItemAt(index)->Frame();
			point = bar->ConvertToScreen(
				BPoint((frame.left + frame.right) / 2, (frame.top + frame.bottom) / 2));
		});
		return point;
	}

	// The middle of an open menu's item on the screen.
	static BPoint Item(BMenu* menu, int32 index)
	{
		EXPECT_TRUE(menu->LockLooper()) << "not open";
		const BRect frame = menu->ItemAt(index)->Frame();
		const BPoint point = menu->ConvertToScreen(
			BPoint((frame.left + frame.right) / 2, (frame.top + frame.bottom) / 2));
		menu->UnlockLooper();
		return point;
	}

	static bool IsOpen(BMenu* menu) { return menu->Window() != NULL; }

	BApplication app;
	Driver driver;
	MenuTestWindow* window;
	BMenuBar* bar;
	BMenu* file;
	BMenu* recent;
	BMenu* edit;
};

} // namespace


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
