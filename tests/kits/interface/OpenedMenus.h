// A window with menus to open.
#pragma once

#include <gtest/gtest.h>

#include <atomic>
#include <functional>
#include <vector>

#include <Looper.h>
#include <Menu.h>
#include <MenuBar.h>
#include <MenuField.h>
#include <MenuItem.h>
#include <Message.h>
#include <PopUpMenu.h>
#include <Screen.h>

#include "support/TestWindow.h"


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
