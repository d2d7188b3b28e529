// The panels of sliders, status bars, scroll views, tab views, text views and menu bars.

#include "editors/EditMenuBar.h"
#include "editors/EditScrollView.h"
#include "editors/EditSlider.h"
#include "editors/EditStatusBar.h"
#include "editors/EditTabView.h"
#include "editors/EditTextView.h"

#include <MenuBar.h>
#include <OutlineListView.h>
#include <ScrollBar.h>
#include <ScrollView.h>
#include <Slider.h>
#include <StatusBar.h>
#include <TabView.h>

#include "PanelFixture.h"

namespace {


const BRect kFrame(20, 20, 220, 120);


bool
IsColor(rgb_color color, uint8 red, uint8 green, uint8 blue)
{
	return color.red == red && color.green == green && color.blue == blue;
}


} // namespace


class EditSliderTest : public PanelFixture<EditSlider> {};


TEST_F(EditSliderTest, ShowsAndChangesWhatASliderCanChange)
{
	BSlider* slider = Use(new BSlider(kFrame, "s", "Toast:", new BMessage('sldr'), -5, 50));
	EXPECT_EQ("-5", Shown("Min Value:"));
	EXPECT_EQ("50", Shown("Max Value:"));
	EXPECT_EQ("20000", Shown("Snooze:"));
	EXPECT_EQ("none", Chosen("Hash marks:"));
	EXPECT_EQ("block", Chosen("Thumb:"));

	TypeOver("Snooze:", "30000");
	EXPECT_EQ(30000, slider->SnoozeAmount());
	TypeOver("Key Increment:", "4");
	EXPECT_EQ(4, slider->KeyIncrementValue());
	TypeOver("Num Hash Marks:", "7");
	EXPECT_EQ(7, slider->HashMarkCount());
	Choose("Hash marks:", "top & bottom");
	EXPECT_EQ(B_HASH_MARKS_BOTH, slider->HashMarks());
	Choose("Thumb:", "triangle");
	EXPECT_EQ(B_TRIANGLE_THUMB, slider->Style());
	ExpectDeclined();
}


TEST_F(EditSliderTest, OneEmptyLimitLabelStaysALabel)
{
	BSlider* slider = new BSlider(kFrame, "s", "Toast:", NULL, 0, 99);
	slider->SetLimitLabels("light", "dark");
	Use(slider);
	EXPECT_EQ("light", Shown("Min Label:"));
	TypeOver("Min Label:", "");
	EXPECT_STREQ("", slider->MinLimitLabel());
	EXPECT_STREQ("dark", slider->MaxLimitLabel());
}


TEST_F(EditSliderTest, ARebuildNeedsAnEditor)
{
	BSlider* slider = Use(new BSlider(kFrame, "s", "Toast:", NULL, 0, 99));
	TypeOver("Min Value:", "10");
	EXPECT_EQ(slider, ground->ChildAt(0));
	int32 minimum, maximum;
	slider->GetLimits(&minimum, &maximum);
	EXPECT_EQ(0, minimum);
}


TEST_F(EditSliderTest, UsesTheDefaultColor)
{
	BSlider* slider = Use(new BSlider(kFrame, "s", "Toast:", NULL, 0, 99));
	Press("Use Default");
	EXPECT_TRUE(IsColor(slider->BarColor(), 80, 80, 80));
}


TEST_F(EditSliderTest, LoadingDoesNotTouchTheColor)
{
	BSlider* slider = new BSlider(kFrame, "s", "Toast:", NULL, 0, 99);
	slider->SetBarColor(rgb_color { 1, 2, 3, 77 });
	Use(slider);
	EXPECT_EQ(77, slider->BarColor().alpha);
}


class EditStatusBarTest : public PanelFixture<EditStatusBar> {};


TEST_F(EditStatusBarTest, OneTextKeepsTheOthersAndTheValue)
{
	BStatusBar* bar = new BStatusBar(kFrame, "s", "Copying:", "left");
	Use(bar);
	window.Locked([&] { bar->Update(40, "file", "12"); });
	Reload(bar);
	EXPECT_EQ("40", Shown("Value:"));
	TypeOver("Trailing label:", "remaining");
	EXPECT_STREQ("Copying:", bar->Label());
	EXPECT_STREQ("remaining", bar->TrailingLabel());
	EXPECT_STREQ("file", bar->Text());
	EXPECT_STREQ("12", bar->TrailingText());
	EXPECT_EQ(40, bar->CurrentValue());
	ExpectDeclined();
}


TEST_F(EditStatusBarTest, ALowerMaximumLimitsTheValue)
{
	BStatusBar* bar = new BStatusBar(kFrame, "s");
	Use(bar);
	TypeOver("Value:", "80");
	EXPECT_EQ(80, bar->CurrentValue());
	TypeOver("Max:", "50");
	EXPECT_EQ(50, bar->MaxValue());
	EXPECT_EQ("50", Shown("Value:"));
	EXPECT_EQ(50, bar->CurrentValue());
}


TEST_F(EditStatusBarTest, ChangesHeightAndColor)
{
	BStatusBar* bar = new BStatusBar(kFrame, "s");
	bar->SetBarColor(rgb_color { 9, 9, 9, 255 });
	Use(bar);
	TypeOver("Bar height:", "20");
	EXPECT_EQ(20, bar->BarHeight());
	Press("Use Default");
	EXPECT_TRUE(IsColor(bar->BarColor(), 50, 150, 255));
}


class EditScrollViewTest : public PanelFixture<EditScrollView> {
protected:
	BScrollView* MakeScrollView(bool horizontal, bool vertical)
	{
		target = new BView(BRect(20, 20, 120, 100), "target", B_FOLLOW_ALL_SIDES, B_WILL_DRAW);
		return new BScrollView("scroll", target, B_FOLLOW_LEFT | B_FOLLOW_TOP, 0, horizontal,
			vertical, B_FANCY_BORDER);
	}

	BView* target;
};


TEST_F(EditScrollViewTest, DisablesTheControlsOfAMissingBar)
{
	Use(MakeScrollView(false, true));
	EXPECT_FALSE(IsTicked("Horizontal"));
	EXPECT_TRUE(IsTicked("Vertical"));
	EXPECT_EQ("0", Shown("Total width:"));
	EXPECT_EQ("1", Shown("Small step:", 0));
	EXPECT_EQ("10", Shown("Big step:", 0));
	EXPECT_FALSE(Find<BTextControl>("Total width:")->IsEnabled());
	EXPECT_TRUE(Find<BTextControl>("Total height:")->IsEnabled());
	ExpectDeclined();
}


TEST_F(EditScrollViewTest, TheTotalIsNotLessThanTheTarget)
{
	BScrollView* scroll = Use(MakeScrollView(true, true));
	TypeOver("Total width:", "300");
	float minimum, maximum;
	scroll->ScrollBar(B_HORIZONTAL)->GetRange(&minimum, &maximum);
	EXPECT_EQ(200, maximum);
	TypeOver("Total width:", "5");
	EXPECT_EQ("100", Shown("Total width:"));
	TypeOver("Small step:", "3", 1);
	float small, big;
	scroll->ScrollBar(B_VERTICAL)->GetSteps(&small, &big);
	EXPECT_EQ(3, small);
}


TEST_F(EditScrollViewTest, ChangesTheBorder)
{
	BScrollView* scroll = Use(MakeScrollView(true, true));
	EXPECT_EQ("B_FANCY_BORDER", Chosen("Border style:"));
	Choose("Border style:", "B_PLAIN_BORDER");
	EXPECT_EQ(B_PLAIN_BORDER, scroll->Border());
}


TEST_F(EditScrollViewTest, TogglingABarKeepsTheOther)
{
	BScrollView* scroll = Use(MakeScrollView(true, true));
	window.Locked([&] {
		scroll->ScrollBar(B_HORIZONTAL)->SetRange(0, 70);
		scroll->ScrollBar(B_HORIZONTAL)->SetSteps(4, 40);
	});
	Tick("Vertical");
	ASSERT_EQ(1, ground->CountChildren());
	BScrollView* rebuilt = dynamic_cast<BScrollView*>(ground->ChildAt(0));
	ASSERT_NE(nullptr, rebuilt);
	EXPECT_EQ(target, rebuilt->Target());
	EXPECT_EQ(NULL, rebuilt->ScrollBar(B_VERTICAL));
	ASSERT_NE(nullptr, rebuilt->ScrollBar(B_HORIZONTAL));
	float minimum, maximum, small, big;
	rebuilt->ScrollBar(B_HORIZONTAL)->GetRange(&minimum, &maximum);
	rebuilt->ScrollBar(B_HORIZONTAL)->GetSteps(&small, &big);
	EXPECT_EQ(70, maximum);
	EXPECT_EQ(4, small);
	EXPECT_EQ(40, big);

	Tick("Vertical");
	rebuilt = dynamic_cast<BScrollView*>(ground->ChildAt(0));
	ASSERT_NE(nullptr, rebuilt);
	EXPECT_NE(nullptr, rebuilt->ScrollBar(B_VERTICAL));
}


class EditTabViewTest : public PanelFixture<EditTabView> {
protected:
	BTabView* MakeTabs(std::initializer_list<const char*> names)
	{
		BTabView* tabs = new BTabView(BRect(20, 20, 320, 220), "tabs");
		for (const char* name : names) {
			tabs->AddTab(new BView(BRect(0, 0, 100, 80), name, B_FOLLOW_ALL_SIDES, B_WILL_DRAW));
		}
		return Use(tabs);
	}

	std::string Order(const BTabView* tabs)
	{
		std::string order;
		for (int32 i = 0; i < tabs->CountTabs(); i++)
			order += tabs->TabAt(i)->Label();
		return order;
	}

	void Select(BTabView* tabs, int32 index)
	{
		const BRect frame = tabs->TabFrame(index);
		window.driver.Click(tabs, BPoint(frame.left + 8, frame.top + 8));
		ASSERT_EQ(index, tabs->Selection());
	}
};


TEST_F(EditTabViewTest, MovesTheSelectedTab)
{
	BTabView* tabs = MakeTabs({ "A", "B", "C", "D", "E" });
	Select(tabs, 2);
	Press("forward");
	EXPECT_EQ("ACBDE", Order(tabs));
	Select(tabs, 1);
	Press("backward");
	EXPECT_EQ("ABCDE", Order(tabs));
	EXPECT_EQ(2, tabs->Selection());
	ExpectDeclined();
}


TEST_F(EditTabViewTest, TheEndsStay)
{
	BTabView* tabs = MakeTabs({ "A", "B", "C" });
	Select(tabs, 0);
	Press("forward");
	EXPECT_EQ("ABC", Order(tabs));
	Press("backward");
	EXPECT_EQ("BAC", Order(tabs));
	EXPECT_EQ(1, tabs->Selection());
	Select(tabs, 2);
	Press("backward");
	EXPECT_EQ("BAC", Order(tabs));
	Press("forward");
	EXPECT_EQ("BCA", Order(tabs));
}


TEST_F(EditTabViewTest, ASingleTabStays)
{
	BTabView* tabs = MakeTabs({ "A" });
	Press("forward");
	Press("backward");
	EXPECT_EQ("A", Order(tabs));
}


TEST_F(EditTabViewTest, DeletesAndInserts)
{
	BTabView* tabs = MakeTabs({ "A", "B", "C" });
	Select(tabs, 1);
	Press("delete");
	EXPECT_EQ("AC", Order(tabs));
	Press("insert");
	EXPECT_EQ("ACTab", Order(tabs));
	const BRect bounds = tabs->Bounds();
	EXPECT_EQ(BRect(3, 2, bounds.right - 4, bounds.bottom - 5 - tabs->TabHeight()),
		tabs->ViewForTab(2)->Frame());
}


TEST_F(EditTabViewTest, ChangesHeightAndWidth)
{
	BTabView* tabs = MakeTabs({ "A", "B" });
	TypeOver("Tab height:", "31");
	EXPECT_EQ(31, tabs->TabHeight());
	Choose("Tab widgh:", "B_WIDTH_FROM_LABEL");
	EXPECT_EQ(B_WIDTH_FROM_LABEL, tabs->TabWidth());
}


class EditTextViewTest : public PanelFixture<EditTextView> {
protected:
	BTextView* UseText()
	{
		return Use(new BTextView(kFrame, "t", BRect(2, 2, 198, 98), B_FOLLOW_NONE, B_WILL_DRAW));
	}
};


TEST_F(EditTextViewTest, ChangesTheSwitches)
{
	BTextView* text = UseText();
	EXPECT_TRUE(IsTicked("Editable"));
	Tick("Editable");
	EXPECT_FALSE(text->IsEditable());
	Tick("Selectable");
	EXPECT_FALSE(text->IsSelectable());
	Tick("Auto Indent");
	EXPECT_TRUE(text->DoesAutoindent());
	Tick("Stylable");
	EXPECT_TRUE(text->IsStylable());
	Tick("Word Wrap");
	EXPECT_FALSE(text->DoesWordWrap());
	ExpectDeclined();
}


TEST_F(EditTextViewTest, ResizableClearsWordWrap)
{
	BTextView* text = UseText();
	EXPECT_TRUE(IsTicked("Word Wrap"));
	Tick("Resizable");
	EXPECT_TRUE(text->IsResizable());
	EXPECT_FALSE(IsTicked("Word Wrap"));
	Tick("Resizable");
	EXPECT_FALSE(IsTicked("Word Wrap"));
}


TEST_F(EditTextViewTest, ChangesNumbersAndMenus)
{
	BTextView* text = UseText();
	TypeOver("Max bytes:", "50");
	EXPECT_EQ(50, text->MaxBytes());
	TypeOver("Tab width:", "0");
	EXPECT_EQ(0, text->TabWidth());
	Choose("Text:", "B_ALIGN_CENTER");
	EXPECT_EQ(B_ALIGN_CENTER, text->Alignment());
	Choose("Offscreen:", "B_RGB32");
	EXPECT_EQ(1, text->ColorSpace());
	window.Locked([&] { text->SetColorSpace(B_RGBA32); });
	Reload(text);
	EXPECT_EQ("", Chosen("Offscreen:"));
}


TEST_F(EditTextViewTest, TheTextRectangleFollowsTheFrame)
{
	BTextView* text = UseText();
	window.Locked([&] {
		text->ResizeTo(150, 60);
		panel->FrameChanged();
	});
	const BRect rect = text->TextRect();
	EXPECT_EQ(2, rect.left);
	EXPECT_EQ(2, rect.top);
	EXPECT_EQ(148, rect.right);
}


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
