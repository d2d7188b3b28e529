#include <MenuField.h>

#include <gtest/gtest.h>

#include <cmath>

#include <MenuBar.h>
#include <MenuItem.h>
#include <Message.h>
#include <PopUpMenu.h>

#include "support/TestWindow.h"

namespace {

BPopUpMenu*
make_menu(const char* name = "choose")
{
	BPopUpMenu* menu = new BPopUpMenu(name);
	menu->AddItem(new BMenuItem("short", new BMessage('shrt')));
	menu->AddItem(new BMenuItem("a longer label", new BMessage('long')));
	return menu;
}

} // namespace


TEST(MenuField, HoldsItsMenuInABarRightOfTheDivider)
{
	BApplication app("application/x-vnd.Archway-test");
	BPopUpMenu* menu = make_menu();
	const std::unique_ptr<BMenuField> field(
		new BMenuField(BRect(10, 10, 210, 40), "field", "Label:", menu));
	EXPECT_EQ(100, field->Divider());
	EXPECT_EQ(B_ALIGN_LEFT, field->Alignment());
	EXPECT_TRUE(field->IsEnabled());
	EXPECT_STREQ("Label:", field->Label());
	EXPECT_EQ(menu, field->Menu());
	ASSERT_EQ(field->MenuBar(), field->FindView("_mc_mb_"));
	EXPECT_EQ(BPoint(102, 2), field->MenuBar()->Frame().LeftTop());
	EXPECT_EQ(B_BORDER_CONTENTS, field->MenuBar()->Border());
	ASSERT_EQ(1, field->MenuBar()->CountItems());
	EXPECT_EQ(menu, field->MenuItem()->Submenu());
	// Without a marked item the menu's name is shown.
	EXPECT_STREQ("choose", field->MenuItem()->Label());
	field->MenuItem()->SetLabel("shown");
	EXPECT_STREQ("shown", field->MenuItem()->Label());
}


TEST(MenuField, WithoutLabelTheDividerIsAtTheLeft)
{
	BApplication app("application/x-vnd.Archway-test");
	BMenuField field(BRect(0, 0, 100, 30), "field", NULL, make_menu());
	EXPECT_EQ(0, field.Divider());
	EXPECT_EQ(2, field.MenuBar()->Frame().left);
}


TEST(MenuField, TakesTheHeightOfItsBarWhenAttached)
{
	TestWindow window;
	BMenuField* field =
		window.Add(new BMenuField(BRect(10, 10, 210, 90), "field", "Label:", make_menu()));
	window.Locked([&] {
		EXPECT_EQ(field->MenuBar()->Bounds().Height() + 4, field->Bounds().Height());
		EXPECT_EQ(200, field->Bounds().Width());
		EXPECT_EQ(field->MenuBar(), field->ChildAt(0));
		// A field's bar never becomes the window's.
		EXPECT_EQ(nullptr, window.Window()->KeyMenuBar());
	});
}


TEST(MenuField, BarIsAsWideAsItsItemOrAsTheRoom)
{
	TestWindow window;
	BPopUpMenu* menu = make_menu();
	BMenuField* field = window.Add(new BMenuField(BRect(10, 10, 210, 30), "a", "Label:", menu));
	BMenuField* fixed =
		window.Add(new BMenuField(BRect(10, 50, 210, 70), "b", "Label:", make_menu(), true));
	window.Locked([&] {
		menu->ItemAt(0)->SetMarked(true);
		const float narrow = field->MenuBar()->Bounds().Width();
		menu->ItemAt(1)->SetMarked(true);
		const float wide = field->MenuBar()->Bounds().Width();
		EXPECT_NEAR(
			field->StringWidth("a longer label") - field->StringWidth("short"), wide - narrow, 1);
		field->SetDivider(160.3f);
		EXPECT_EQ(160, field->Divider());
		EXPECT_EQ(BPoint(162, 2), field->MenuBar()->Frame().LeftTop());
		EXPECT_EQ(200 - 160 - 4, field->MenuBar()->Bounds().Width());

		EXPECT_EQ(200 - 100 - 4, fixed->MenuBar()->Bounds().Width());
		EXPECT_EQ(B_FOLLOW_LEFT_RIGHT | B_FOLLOW_TOP, fixed->MenuBar()->ResizingMode());
		fixed->ResizeBy(30, 0);
	});
	window.Locked([&] { EXPECT_EQ(230 - 100 - 4, fixed->MenuBar()->Bounds().Width()); });
}


TEST(MenuField, ItemsWithoutTargetGetTheWindow)
{
	TestWindow window;
	BPopUpMenu* menu = make_menu();
	BView handler(BRect(0, 0, 1, 1), "handler", B_FOLLOW_NONE, 0);
	window.Add(&handler);
	window.Locked([&] { menu->ItemAt(0)->SetTarget(&handler); });
	BMenuField* field = window.Add(new BMenuField(BRect(10, 10, 210, 30), "a", "Label:", menu));
	window.Locked([&] {
		EXPECT_EQ(&handler, menu->ItemAt(0)->Target());
		EXPECT_EQ(window.Window(), menu->ItemAt(1)->Target());
		BMenuItem* later = new BMenuItem("later", new BMessage('latr'));
		menu->AddItem(later);
		EXPECT_EQ(window.Window(), later->Target());
		menu->RemoveItem(later);
		EXPECT_EQ(nullptr, later->Target());
		delete later;
		field->RemoveSelf();
		EXPECT_EQ(nullptr, menu->ItemAt(1)->Target());
		handler.RemoveSelf();
	});
	delete field;
}


TEST(MenuField, ArchiveRoundTripKeepsEverything)
{
	BApplication app("application/x-vnd.Archway-test");
	BPopUpMenu* menu = make_menu();
	menu->ItemAt(1)->SetMarked(true);
	BMenuField field(BRect(10, 10, 210, 40), "field", "Label:", menu, true);
	field.SetAlignment(B_ALIGN_RIGHT);
	field.SetDivider(70);
	field.SetEnabled(false);
	field.HidePopUpMarker();
	BMessage archive;
	ASSERT_EQ(B_OK, field.Archive(&archive));

	const std::unique_ptr<BMenuField> revived(
		dynamic_cast<BMenuField*>(instantiate_object(&archive)));
	ASSERT_NE(nullptr, revived);
	EXPECT_EQ(B_ALIGN_RIGHT, revived->Alignment());
	EXPECT_EQ(70, revived->Divider());
	EXPECT_FALSE(revived->IsEnabled());
	ASSERT_NE(nullptr, revived->Menu());
	EXPECT_NE(nullptr, dynamic_cast<BPopUpMenu*>(revived->Menu()));
	EXPECT_EQ(1, revived->Menu()->FindMarkedIndex());
	EXPECT_STREQ("a longer label", revived->MenuItem()->Label());
	BMessage again;
	ASSERT_EQ(B_OK, revived->Archive(&again));
	EXPECT_TRUE(again.HasSameData(archive));
}


TEST(MenuField, ShallowArchiveGetsAnEmptyMenu)
{
	BApplication app("application/x-vnd.Archway-test");
	BMenuField field(BRect(10, 10, 210, 40), "field", "Label:", make_menu());
	BMessage archive;
	ASSERT_EQ(B_OK, field.Archive(&archive, false));
	const std::unique_ptr<BMenuField> revived(
		dynamic_cast<BMenuField*>(instantiate_object(&archive)));
	ASSERT_NE(nullptr, revived);
	ASSERT_NE(nullptr, revived->Menu());
	EXPECT_EQ(0, revived->Menu()->CountItems());
	EXPECT_EQ(BPoint(102, 2), revived->MenuBar()->Frame().LeftTop());
}


TEST(MenuField, RevivedFieldIsNotAdjustedByAttaching)
{
	TestWindow window;
	BMenuField original(BRect(10, 10, 210, 90), "field", "Label:", make_menu());
	BMessage archive;
	ASSERT_EQ(B_OK, original.Archive(&archive));
	archive.ReplaceFloat("_divide", 33.5f);
	BMenuField* revived = dynamic_cast<BMenuField*>(instantiate_object(&archive));
	ASSERT_NE(nullptr, revived);
	window.Add(revived);
	window.Locked([&] {
		EXPECT_EQ(BRect(10, 10, 210, 90), revived->Frame());
		EXPECT_EQ(33.5f, revived->Divider());
		BMessage again;
		EXPECT_EQ(B_OK, revived->Archive(&again));
		EXPECT_TRUE(again.HasSameData(archive));
	});
}


TEST(MenuField, HasABarThoughItBearsThatsName)
{
	BApplication app("application/x-vnd.Archway-test");
	BMessage archive;
	archive.AddString("class", "BMenuField");
	archive.AddString("_name", "_mc_mb_");
	archive.AddRect("_frame", BRect(0, 0, 99, 19));
	const std::unique_ptr<BMenuField> revived(
		dynamic_cast<BMenuField*>(instantiate_object(&archive)));
	ASSERT_NE(nullptr, revived);
	ASSERT_NE(nullptr, revived->MenuBar());
	EXPECT_NE(nullptr, revived->Menu());
}
