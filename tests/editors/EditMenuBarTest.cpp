// The panel of menu bars.

#include "editors/EditMenuBar.h"

#include <MenuBar.h>
#include <OutlineListView.h>

#include "PanelFixture.h"


class EditMenuBarTest : public PanelFixture<EditMenuBar> {
protected:
	BMenuBar* UseBar()
	{
		bar = new BMenuBar(BRect(0, 0, 300, 18), "bar");
		file = new BMenu("File");
		file->AddItem(new BMenuItem("New", new BMessage('newf')));
		BMenu* recent = new BMenu("Recent");
		recent->AddItem(new BMenuItem("One", NULL));
		file->AddItem(recent);
		file->AddItem(new BMenuItem("Quit", NULL));
		bar->AddItem(file);
		BMenu* edit = new BMenu("Edit");
		edit->AddItem(new BMenuItem("Undo", NULL));
		bar->AddItem(edit);
		Use(bar);
		list = dynamic_cast<BOutlineListView*>(FindList(panel));
		return bar;
	}

	static BView* FindList(BView* view)
	{
		for (BView* child = view->ChildAt(0); child != nullptr; child = child->NextSibling()) {
			if (dynamic_cast<BOutlineListView*>(child) != nullptr)
				return child;
			if (BView* found = FindList(child))
				return found;
		}
		return nullptr;
	}

	std::string Mirror()
	{
		std::string text;
		for (int32 i = 0; i < list->FullListCountItems(); i++) {
			const BStringItem* item = static_cast<BStringItem*>(list->FullListItemAt(i));
			text += std::to_string(item->OutlineLevel()) + item->Text() + " ";
		}
		return text;
	}

	void Select(const char* text) { user.ClickEntry(list, text); }

	std::string Selected()
	{
		const BStringItem* item = static_cast<BStringItem*>(list->ItemAt(list->CurrentSelection()));
		return item != nullptr ? item->Text() : "";
	}

	BMenuBar* bar;
	BMenu* file;
	BOutlineListView* list;
};


TEST_F(EditMenuBarTest, MirrorsTheItems)
{
	UseBar();
	EXPECT_EQ("0File 1New 1Recent 2One 1Quit 0Edit 1Undo ", Mirror());
	EXPECT_TRUE(list->FullListItemAt(0)->IsExpanded());
	EXPECT_FALSE(list->FullListItemAt(2)->IsExpanded());
	EXPECT_FALSE(Find<BButton>("Delete")->IsEnabled());
	ExpectDeclined();
}


TEST_F(EditMenuBarTest, LoadsAndEditsTheSelectedItem)
{
	UseBar();
	Select("New");
	EXPECT_EQ("New", Shown("Label: "));
	EXPECT_EQ("newf", Shown("Message: "));
	EXPECT_TRUE(Find<BButton>("Delete")->IsEnabled());
	TypeOver("Label: ", "Create");
	EXPECT_STREQ("Create", file->ItemAt(0)->Label());
	EXPECT_EQ("0File 1Create 1Recent 2One 1Quit 0Edit 1Undo ", Mirror());
	TypeOver("Message: ", "abcd");
	EXPECT_EQ(0x61626364u, file->ItemAt(0)->Command());
	Tick("Enabled");
	EXPECT_FALSE(file->ItemAt(0)->IsEnabled());

	Select("Quit");
	EXPECT_EQ("????", Shown("Message: "));
}


TEST_F(EditMenuBarTest, InsertsSiblings)
{
	UseBar();
	Select("Recent");
	Press("Add After");
	EXPECT_EQ("0File 1New 1Recent 2One 1new item 1Quit 0Edit 1Undo ", Mirror());
	EXPECT_EQ("new item", Selected());
	EXPECT_STREQ("new item", file->ItemAt(2)->Label());

	Select("New");
	Press("Add Before");
	EXPECT_EQ("0File 1new item 1New 1Recent 2One 1new item 1Quit 0Edit 1Undo ", Mirror());
	EXPECT_STREQ("new item", file->ItemAt(0)->Label());
}


TEST_F(EditMenuBarTest, DeletesItems)
{
	UseBar();
	Select("Recent");
	Press("Delete");
	EXPECT_EQ("0File 1New 1Quit 0Edit 1Undo ", Mirror());
	EXPECT_EQ(2, file->CountItems());
	EXPECT_EQ("Quit", Selected());

	// A menu is never emptied.
	Select("Undo");
	Press("Delete");
	EXPECT_EQ("0File 1New 1Quit 0Edit 1Undo ", Mirror());

	// The last entry gives the selection to the one before.
	Select("Edit");
	Press("Delete");
	EXPECT_EQ("0File 1New 1Quit ", Mirror());
	EXPECT_EQ(1, bar->CountItems());
}


TEST_F(EditMenuBarTest, TurnsAnItemIntoASubmenu)
{
	UseBar();
	Select("Quit");
	Press("Add Submenu");
	EXPECT_EQ("0File 1New 1Recent 2One 1Quit 2sub item 0Edit 1Undo ", Mirror());
	EXPECT_EQ("sub item", Selected());
	BMenu* submenu = file->ItemAt(2)->Submenu();
	ASSERT_NE(nullptr, submenu);
	EXPECT_STREQ("sub item", submenu->ItemAt(0)->Label());

	// The entry still stands for the item that was taken out.
	Select("Quit");
	TypeOver("Label: ", "Leave");
	EXPECT_STREQ("Quit", file->ItemAt(2)->Label());

	// One that has a submenu gets no second one.
	Select("Recent");
	const std::string before = Mirror();
	Press("Add Submenu");
	EXPECT_EQ(before, Mirror());
}


TEST_F(EditMenuBarTest, ChangesTheKindOfSelection)
{
	UseBar();
	Select("File");
	EXPECT_EQ("Normal Selection", Chosen("", 1));
	Choose("", "Radio & Set Label", 1);
	EXPECT_TRUE(file->IsLabelFromMarked());
	Choose("", "Radio Selection", 1);
	EXPECT_TRUE(file->IsRadioMode());
	EXPECT_FALSE(file->IsLabelFromMarked());
	Choose("", "Normal Selection", 1);
	EXPECT_FALSE(file->IsRadioMode());
}


TEST_F(EditMenuBarTest, ChangesTheBorder)
{
	UseBar();
	Choose("", "B_BORDER_EACH_ITEM");
	EXPECT_EQ(B_BORDER_EACH_ITEM, bar->Border());
}


TEST_F(EditMenuBarTest, ShowsTheBorder)
{
	UseBar();
	window.Locked([&] { bar->SetBorder(B_BORDER_CONTENTS); });
	Reload(bar);
	EXPECT_EQ("B_BORDER_CONTENTS", Chosen(""));
}


TEST_F(EditMenuBarTest, ShowsWhatTheSelectedItemHas)
{
	UseBar();
	window.Locked([&] {
		file->SetRadioMode(true);
		file->ItemAt(0)->SetEnabled(false);
	});
	Select("New");
	EXPECT_FALSE(IsTicked("Enabled"));
	EXPECT_FALSE(Find<BMenuField>("", 1)->Menu()->IsEnabled());
	Select("File");
	EXPECT_TRUE(IsTicked("Enabled"));
	EXPECT_TRUE(Find<BMenuField>("", 1)->Menu()->IsEnabled());
	EXPECT_EQ("Radio Selection", Chosen("", 1));
	window.Locked([&] { file->SetLabelFromMarked(true); });
	Select("New");
	Select("File");
	EXPECT_EQ("Radio & Set Label", Chosen("", 1));
}


TEST_F(EditMenuBarTest, TheLabelOfTheSelectedItemIsReadyToBeTypedOver)
{
	UseBar();
	Select("Quit");
	window.driver.Type("Leave\n");
	EXPECT_STREQ("Leave", file->ItemAt(2)->Label());
}


TEST_F(EditMenuBarTest, EditsWithoutASelectedItemBeep)
{
	UseBar();
	int32 beeps = Driver::CountBeeps();
	TypeOver("Label: ", "nobody");
	EXPECT_EQ(beeps + 1, Driver::CountBeeps());
	Tick("Enabled");
	EXPECT_EQ(beeps + 2, Driver::CountBeeps());
	TypeOver("Message: ", "abcd");
	EXPECT_EQ(beeps + 3, Driver::CountBeeps());
	EXPECT_EQ("0File 1New 1Recent 2One 1Quit 0Edit 1Undo ", Mirror());
}


TEST_F(EditMenuBarTest, RefusedEditsBeep)
{
	UseBar();
	Select("Undo");
	int32 beeps = Driver::CountBeeps();
	Press("Delete"); // the only item of its menu
	EXPECT_EQ(beeps + 1, Driver::CountBeeps());
	Select("Recent");
	Press("Add Submenu"); // has one already
	EXPECT_EQ(beeps + 2, Driver::CountBeeps());
}


TEST_F(EditMenuBarTest, AnItemsMessageIsReplaced)
{
	UseBar();
	window.Locked([&] { file->ItemAt(0)->Message()->AddInt32("dropped", 7); });
	Select("New");
	TypeOver("Message: ", "wxyz");
	EXPECT_EQ(uint32('wxyz'), file->ItemAt(0)->Command());
	EXPECT_TRUE(file->ItemAt(0)->Message()->IsEmpty());
}


TEST_F(EditMenuBarTest, ANewItemHasItsMessage)
{
	UseBar();
	Select("Quit");
	Press("Add After");
	EXPECT_EQ(uint32('menu'), file->ItemAt(3)->Command());
	EXPECT_EQ("menu", Shown("Message: "));
	Press("Add Submenu");
	ASSERT_NE(nullptr, file->ItemAt(3)->Submenu());
	EXPECT_EQ(uint32('xxxx'), file->ItemAt(3)->Submenu()->ItemAt(0)->Command());
}


// Items that were taken out are kept until another view is the target.
TEST_F(EditMenuBarTest, ARemovedItemCanStillBeEdited)
{
	UseBar();
	Select("Quit");
	Press("Add Submenu");
	Select("Quit");
	TypeOver("Message: ", "abcd");
	Tick("Enabled");
	Choose("", "B_BORDER_EACH_ITEM");
	EXPECT_TRUE(file->ItemAt(2)->IsEnabled());
	Reload(bar);
	EXPECT_EQ("0File 1New 1Recent 2One 1Quit 2sub item 0Edit 1Undo ", Mirror());
	Select("Quit");
	EXPECT_EQ("????", Shown("Message: "));
}


TEST_F(EditMenuBarTest, AnotherSelectionClearsTheMirror)
{
	UseBar();
	Select("Recent");
	Press("Delete");
	Reload(bar);
	EXPECT_EQ("0File 1New 1Quit 0Edit 1Undo ", Mirror());
	EXPECT_FALSE(Find<BButton>("Delete")->IsEnabled());
	EXPECT_EQ("", Selected());
}
