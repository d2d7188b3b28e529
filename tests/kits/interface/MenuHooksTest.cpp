// What menus and their items ask of classes made from them.
#include <MenuBar.h>
#include <MenuField.h>
#include <MenuItem.h>
#include <PopUpMenu.h>
#include <SeparatorItem.h>

#include <cstring>
#include <memory>
#include <string>

#include <List.h>

#include "ControlFixture.h"

namespace {

const rgb_color kRed = { 255, 0, 0, 255 };
const rgb_color kBlue = { 0, 0, 255, 255 };


class HookedItem : public BMenuItem {
public:
	HookedItem(const char* label, uint32 what) : BMenuItem(label, new BMessage(what)) {}

	void GetContentSize(float* width, float* height) override
	{
		BMenuItem::GetContentSize(width, height);
		*width += 40;
		*height += 10;
	}

	void DrawContent() override
	{
		contentAt = ContentLocation();
		pen = Menu()->PenLocation();
		drawn++;
		BMenuItem::DrawContent();
	}

	void Draw() override
	{
		BMenuItem::Draw();
		if (marksSelection && IsSelected()) {
			Menu()->SetHighColor(kRed);
			Menu()->FillRect(BRect(Frame().LeftTop(), Frame().LeftTop() + BPoint(3, 3)));
		}
	}

	void Highlight(bool on) override
	{
		highlights += on ? "+" : "-";
		BMenuItem::Highlight(on);
	}

	void TruncateLabel(float width, char* label) override
	{
		truncatedTo = width;
		BMenuItem::TruncateLabel(width, label);
		truncated = label;
	}

	status_t Invoke(BMessage* message) override
	{
		invocations++;
		return BMenuItem::Invoke(message);
	}

	BPoint contentAt, pen;
	int drawn = 0, invocations = 0;
	bool marksSelection = true;
	std::string highlights, truncated;
	float truncatedTo = -1;
};


class HookedMenu : public BMenu {
public:
	using BMenu::BMenu;

	void DrawBackground(BRect update) override
	{
		SetLowColor(kBlue);
		BMenu::DrawBackground(update);
		SetLowColor(216, 216, 216);
	}

	BPoint ScreenLocation() override
	{
		if (place.x >= 0)
			return place;
		return BMenu::ScreenLocation();
	}

	using BMenu::GetItemMargins;
	using BMenu::Hide;
	using BMenu::SetItemMargins;
	using BMenu::Track;

	BPoint place { -1, -1 };
};


// A bar with one menu of two items; where things are on the screen.
class MenuHooks : public testing::Test {
protected:
	void SetUp() override
	{
		menu = new HookedMenu("Menu");
		for (int i = 0; i < 2; i++)
			menu->AddItem(item[i] = new HookedItem(i == 0 ? "First" : "Second", 'itm0' + i));
		bar = new BMenuBar(BRect(0, 0, 10, 10), "bar");
		bar->AddItem(menu);
		fixture.Add(bar);
	}

	void OpenMenu() { driver.Click(bar, BPoint(15, 8)); }

	BPoint PlaceOf(BMenuItem* which)
	{
		EXPECT_TRUE(menu->LockLooper()) << "not open";
		const BRect frame = which->Frame();
		const BPoint place = menu->ConvertToScreen(frame.LeftTop());
		menu->UnlockLooper();
		return place;
	}

	bool IsOpen() const { return menu->Window() != nullptr; }

	ControlFixture fixture;
	Driver& driver = fixture.driver;
	BMenuBar* bar;
	HookedMenu* menu;
	HookedItem* item[2];
};

} // namespace


TEST_F(MenuHooks, AnItemIsAsLargeAsItsContent)
{
	float left, top, right, bottom;
	menu->GetItemMargins(&left, &top, &right, &bottom);
	EXPECT_EQ(14, left);
	EXPECT_EQ(2, top);
	OpenMenu();
	ASSERT_TRUE(IsOpen());
	menu->LockLooper();
	const float label = menu->StringWidth("Second");
	font_height height;
	menu->GetFontHeight(&height);
	EXPECT_GE(item[1]->Frame().Width() + 1, left + std::ceil(label) + 40 + right)
		<< "GetContentSize()";
	EXPECT_GE(item[1]->Frame().Height() + 1, top + std::ceil(height.ascent) + 10 + bottom);
	menu->UnlockLooper();
	driver.Key("Escape");
}


TEST_F(MenuHooks, ItemsAreDrawnAtTheirContentLocation)
{
	OpenMenu();
	ASSERT_TRUE(IsOpen());
	EXPECT_GT(item[1]->drawn, 0) << "DrawContent()";
	menu->LockLooper();
	EXPECT_EQ(item[1]->Frame().LeftTop() + BPoint(14, 2), item[1]->contentAt);
	EXPECT_EQ(item[1]->contentAt, item[1]->pen);
	menu->UnlockLooper();
	const BPoint second = PlaceOf(item[1]);
	EXPECT_EQ(kBlue, driver.PixelAt(second + BPoint(1, 1))) << "DrawBackground()";
	driver.Key("Escape");
}


TEST_F(MenuHooks, TheSelectedItemIsHighlighted)
{
	OpenMenu();
	ASSERT_TRUE(IsOpen());
	const BPoint first = PlaceOf(item[0]), second = PlaceOf(item[1]);
	driver.MoveTo(first + BPoint(8, 8));
	EXPECT_EQ("+", item[0]->highlights) << "Highlight()";
	EXPECT_EQ(kRed, driver.PixelAt(first + BPoint(1, 1))) << "IsSelected()";
	driver.MoveTo(second + BPoint(8, 8));
	EXPECT_EQ("+-", item[0]->highlights);
	EXPECT_EQ("+", item[1]->highlights);
	EXPECT_NE(kRed, driver.PixelAt(first + BPoint(1, 1)));
	driver.Key("Escape");
}


TEST_F(MenuHooks, AChosenItemIsInvoked)
{
	OpenMenu();
	ASSERT_TRUE(IsOpen());
	driver.Click(PlaceOf(item[1]) + BPoint(8, 8));
	EXPECT_EQ(0, item[0]->invocations);
	EXPECT_EQ(1, item[1]->invocations) << "Invoke()";
	const std::vector<BMessage> sent = fixture.Received('itm1');
	ASSERT_EQ(1u, sent.size());
	EXPECT_EQ(1, sent[0].GetInt32("index", -1));
	EXPECT_TRUE(sent[0].HasInt64("when"));
	void* source;
	EXPECT_EQ(B_OK, sent[0].FindPointer("source", &source));
	EXPECT_EQ(static_cast<BMenuItem*>(item[1]), source);
}


TEST_F(MenuHooks, LabelsThatAreTooLongAreCut)
{
	fixture.Locked([this] {
		item[0]->SetLabel("A label that is far too long for this menu");
		menu->SetMaxContentWidth(80);
	});
	OpenMenu();
	ASSERT_TRUE(IsOpen());
	EXPECT_EQ(80, item[0]->truncatedTo) << "TruncateLabel()";
	EXPECT_LT(item[0]->truncated.size(), strlen(item[0]->Label()));
	EXPECT_LE(be_plain_font->StringWidth(item[0]->truncated.c_str()), 80);
	EXPECT_EQ(-1, item[1]->truncatedTo);
	driver.Key("Escape");
}


TEST_F(MenuHooks, AMenuOpensWhereItsClassSays)
{
	menu->place = BPoint(500, 400);
	OpenMenu();
	ASSERT_TRUE(IsOpen());
	const BPoint first = PlaceOf(item[0]);
	EXPECT_NEAR(500, first.x, 2) << "ScreenLocation()";
	EXPECT_NEAR(400, first.y, 2);
	driver.Key("Escape");
	EXPECT_FALSE(IsOpen());
}


TEST_F(MenuHooks, MarginsAreRoomAroundTheContents)
{
	OpenMenu();
	const float before = PlaceOf(item[1]).y - PlaceOf(item[0]).y;
	driver.Key("Escape");
	fixture.Locked([this] {
		menu->SetItemMargins(20, 5, 6, 7);
		float left, top, right, bottom;
		menu->GetItemMargins(&left, &top, &right, &bottom);
		EXPECT_EQ(20, left);
		EXPECT_EQ(5, top);
		EXPECT_EQ(6, right);
		EXPECT_EQ(7, bottom);
		menu->GetItemMargins(NULL, NULL, NULL, NULL);
	});
	OpenMenu();
	EXPECT_EQ(before + 3 + 7, PlaceOf(item[1]).y - PlaceOf(item[0]).y);
	driver.Key("Escape");
}


TEST_F(MenuHooks, LayoutIsMadeAnewAfterInvalidateLayout)
{
	OpenMenu();
	const float before = PlaceOf(item[1]).y - PlaceOf(item[0]).y;
	driver.Key("Escape");
	fixture.Locked([this] {
		BFont font(be_plain_font);
		font.SetSize(24);
		menu->SetFont(&font);
		menu->InvalidateLayout();
	});
	OpenMenu();
	EXPECT_GT(PlaceOf(item[1]).y - PlaceOf(item[0]).y, before + 5);
	driver.Key("Escape");
}


TEST_F(MenuHooks, AListOfItemsIsAddedInItsOrder)
{
	BList list;
	BMenuItem* added[] = { new BMenuItem("x", NULL), new BMenuItem("y", NULL) };
	for (BMenuItem* each : added)
		list.AddItem(each);
	fixture.Locked([&] {
		EXPECT_FALSE(menu->AddList(NULL, 0));
		EXPECT_TRUE(menu->AddList(&list, 1));
		EXPECT_EQ(4, menu->CountItems());
		EXPECT_EQ(added[0], menu->ItemAt(1));
		EXPECT_EQ(added[1], menu->ItemAt(2));
		EXPECT_EQ(item[1], menu->ItemAt(3));
		EXPECT_FALSE(menu->IsRedrawAfterSticky());
	});
}


TEST_F(MenuHooks, ABMenuItemKnowsItsSubmenu)
{
	fixture.Locked([this] {
		EXPECT_EQ(menu, bar->ItemAt(0)->Submenu());
		EXPECT_EQ(nullptr, item[0]->Submenu());
		EXPECT_EQ(bar->ItemAt(0), menu->Superitem());
	});
}


TEST_F(MenuHooks, ABMenuBarIsHiddenAndShown)
{
	const rgb_color ground = driver.PixelAt(fixture.ground, BPoint(380, 250));
	const auto ink = [&] {
		int count = 0;
		for (float x = 0; x < 60; x++)
			count += driver.PixelAt(fixture.ground, BPoint(x, 8)) != ground;
		return count;
	};
	EXPECT_GT(ink(), 0);
	fixture.Locked([this] { bar->Hide(); });
	EXPECT_TRUE(bar->IsHidden());
	EXPECT_EQ(0, ink());
	fixture.Locked([this] { bar->Show(); });
	EXPECT_GT(ink(), 0);
}


TEST(PopUpMenuHooks, TrackReturnsTheChosenItem)
{
	ControlFixture fixture;
	HookedMenu menu("menu");
	menu.place = BPoint(500, 300);
	BMenuItem* item = new BMenuItem("Item", NULL);
	menu.AddItem(item);
	BMenuItem* chosen = NULL;
	class Tracker : public BLooper {
	public:
		explicit Tracker(std::function<void()> task) : fTask(std::move(task)) {}
		void MessageReceived(BMessage*) override { fTask(); }

	private:
		std::function<void()> fTask;
	};
	Tracker* looper = new Tracker([&] { chosen = menu.Track(true); });
	looper->Run();
	BMessenger(looper).SendMessage('go  ');
	Driver::WaitUntilIdle();
	ASSERT_NE(nullptr, menu.Window()) << "Track() has opened it";
	menu.LockLooper();
	const BPoint place = menu.ConvertToScreen(item->Frame().LeftTop());
	menu.UnlockLooper();
	EXPECT_NEAR(500, place.x, 2) << "ScreenLocation()";
	fixture.driver.Click(place + BPoint(8, 8));
	EXPECT_EQ(item, chosen);
	looper->Lock();
	looper->Quit();
}


TEST(PopUpMenuHooks, ABPopUpMenuMayEndItself)
{
	BApplication app("application/x-vnd.Archway-test");
	BPopUpMenu menu("menu");
	EXPECT_FALSE(menu.AsyncAutoDestruct());
	menu.SetAsyncAutoDestruct(true);
	EXPECT_TRUE(menu.AsyncAutoDestruct());
}


TEST(SeparatorItemHooks, HasASmallContent)
{
	class Measured : public BSeparatorItem {
	public:
		using BSeparatorItem::GetContentSize;
	};
	BApplication app("application/x-vnd.Archway-test");
	BMenu menu("menu");
	Measured* separator = new Measured;
	menu.AddItem(new BMenuItem("Item", NULL));
	menu.AddItem(separator);
	float width = -1, height = -1;
	separator->GetContentSize(&width, &height);
	EXPECT_GT(height, 1);
	EXPECT_LT(height, 10);
	EXPECT_LT(width, menu.StringWidth("Item"));
	EXPECT_FALSE(separator->IsEnabled());
}


TEST(PopUpMenuHooks, ABPopUpMenuOfAFieldOpensOverItsMarkedItemUnlessItsClassSaysWhere)
{
	class Placed : public BPopUpMenu {
	public:
		Placed() : BPopUpMenu("menu") {}
		BPoint ScreenLocation() override
		{
			return place.x >= 0 ? place : BPopUpMenu::ScreenLocation();
		}
		BPoint place { -1, -1 };
	};
	ControlFixture fixture;
	Placed* menu = new Placed;
	for (const char* label : { "One", "Two", "Three" })
		menu->AddItem(new BMenuItem(label, NULL));
	menu->ItemAt(1)->SetMarked(true);
	BMenuField* field =
		fixture.Add(new BMenuField(BRect(100, 100, 299, 125), "field", "Label", menu));
	const auto placeOf = [&](int32 index) {
		EXPECT_TRUE(menu->LockLooper()) << "not open";
		const BPoint place = menu->ConvertToScreen(menu->ItemAt(index)->Frame().LeftTop());
		menu->UnlockLooper();
		return place;
	};
	const BPoint bar = Driver::PointIn(field->MenuBar(), BPoint(0, 0));
	fixture.driver.Click(field->MenuBar());
	EXPECT_NEAR(bar.y, placeOf(1).y, 4);
	fixture.driver.Key("Escape");
	menu->place = BPoint(600, 400);
	fixture.driver.Click(field->MenuBar());
	EXPECT_NEAR(600, placeOf(0).x, 2);
	EXPECT_NEAR(400, placeOf(0).y, 2);
	fixture.driver.Key("Escape");
}
