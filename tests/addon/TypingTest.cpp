// What is typed in a panel and not confirmed is not lost, whatever the user does next.

#include "EditorFixture.h"

#include <Button.h>
#include <CheckBox.h>
#include <MenuBar.h>
#include <MenuField.h>
#include <MenuItem.h>
#include <OutlineListView.h>
#include <RadioButton.h>
#include <ScrollView.h>
#include <Slider.h>
#include <TextView.h>

#include "palette/WidgetWindow.h"

namespace {


class TypingTest : public EditorFixture {
protected:
	TypingTest()
	{
		BView* root =
			new BView(BRect(0, 0, 399, 399), "root", B_FOLLOW_LEFT | B_FOLLOW_TOP, B_WILL_DRAW);
		BView* plain =
			new BView(BRect(20, 20, 139, 119), "plain", B_FOLLOW_LEFT | B_FOLLOW_TOP, B_WILL_DRAW);
		plain->AddChild(
			new BView(BRect(50, 50, 99, 89), "inner", B_FOLLOW_LEFT | B_FOLLOW_TOP, B_WILL_DRAW));
		root->AddChild(plain);
		root->AddChild(new BView(
			BRect(200, 20, 319, 119), "other", B_FOLLOW_LEFT | B_FOLLOW_TOP, B_WILL_DRAW));
		root->AddChild(new BSlider(BRect(20, 150, 219, 190), "slider", "Slide:", NULL, 0, 99));
		root->AddChild(new BScrollView("scroll",
			new BView(BRect(240, 150, 320, 220), "target", B_FOLLOW_ALL_SIDES, B_WILL_DRAW),
			B_FOLLOW_LEFT | B_FOLLOW_TOP, 0, true, true));
		BMenuBar* bar = new BMenuBar(BRect(0, 380, 399, 399), "bar");
		for (const char* label : { "One", "Two" })
			bar->AddItem(new BMenuItem(label, NULL));
		root->AddChild(bar);
		item = Add(1, root);
		Open(item);
	}

	void SelectPlain() { driver.Click(Find("plain"), BPoint(10, 10)); }

	void TypeName(const char* name) { person.Replace(Field("EditView", "Name: "), name); }

	BResEditor::BResourceHandle item;
};


} // namespace


TEST_F(TypingTest, ReturnSendsTheText)
{
	SelectPlain();
	TypeName("fresh");
	EXPECT_EQ(nullptr, Find("fresh"));
	driver.Key("Return");
	EXPECT_NE(nullptr, Find("fresh"));
}


TEST_F(TypingTest, TabSendsTheText)
{
	SelectPlain();
	TypeName("fresh");
	driver.Key("Tab");
	EXPECT_NE(nullptr, Find("fresh"));
}


TEST_F(TypingTest, AnotherFieldSendsTheText)
{
	SelectPlain();
	TypeName("fresh");
	driver.Click(Field("EditView", "L:"));
	EXPECT_NE(nullptr, Find("fresh"));
}


TEST_F(TypingTest, SelectingAnotherViewSendsTheTextToTheFormerOne)
{
	SelectPlain();
	BView* plain = workView->SelectedView();
	TypeName("fresh");
	driver.Click(Find("other"));
	EXPECT_STREQ("fresh", plain->Name());
	EXPECT_STREQ("other", Field("EditView", "Name: ")->Text());
	EXPECT_NE(nullptr, Find("other"));
}


TEST_F(TypingTest, DraggingTheSelectedViewTakesTheTextAlong)
{
	SelectPlain();
	TypeName("fresh");
	driver.Drag(Find("plain"), BPoint(10, 10), Root(), BPoint(50, 250));
	BView* moved = Find("fresh");
	ASSERT_NE(nullptr, moved);
	EXPECT_EQ(BPoint(40, 240), moved->Frame().LeftTop());
	EXPECT_EQ(nullptr, Find("plain"));
}


TEST_F(TypingTest, DraggingACopyCopiesTheText)
{
	SelectPlain();
	TypeName("fresh");
	const BPoint from = Driver::PointIn(Find("plain"), BPoint(10, 10));
	const BPoint to = Driver::PointIn(Root(), BPoint(50, 250));
	driver.Drag(from, to, 10, 1, B_CONTROL_KEY);
	BView* first = Find("fresh");
	ASSERT_NE(nullptr, first);
	EXPECT_EQ(nullptr, Find("plain"));
	int32 count = 0;
	for (BView* child = Root()->ChildAt(0); child != nullptr; child = child->NextSibling()) {
		if (child->Name() != nullptr && std::string(child->Name()) == "fresh")
			count++;
	}
	EXPECT_EQ(2, count);
}


// The press, the drag and the drop are all there before the first of them is looked at.
TEST_F(TypingTest, ADragThatIsOverBeforeItIsNoticedTakesTheTextAlong)
{
	SelectPlain();
	TypeName("fresh");
	const BPoint from = Driver::PointIn(Find("plain"), BPoint(10, 10));
	const BPoint to = Driver::PointIn(Root(), BPoint(50, 250));
	driver.MoveTo(from);
	window.Locked([&] {
		driver.SetWaiting(false);
		driver.Press();
		driver.MoveTo(to);
		driver.Release();
		driver.SetWaiting(true);
	});
	BView* moved = Find("fresh");
	ASSERT_NE(nullptr, moved);
	EXPECT_EQ(BPoint(40, 240), moved->Frame().LeftTop());
}


// The second press takes away the view that holds the one whose name was typed.
TEST_F(TypingTest, TwoQuickPressesOnTheParentLoseNothing)
{
	driver.Click(Find("inner"));
	TypeName("fresh");
	const BPoint from = Driver::PointIn(Find("plain"), BPoint(10, 10));
	driver.MoveTo(from);
	window.Locked([&] {
		driver.SetWaiting(false);
		driver.Press();
		driver.Release();
		driver.Press();
		driver.Release();
		driver.SetWaiting(true);
	});
	BView* inner = Find("fresh");
	ASSERT_NE(nullptr, inner);
	EXPECT_STREQ("plain", inner->Parent()->Name());
}


TEST_F(TypingTest, ResizingByTheCornerKeepsTheText)
{
	SelectPlain();
	TypeName("fresh");
	driver.Drag(Find("plain"), BPoint(116, 96), Root(), BPoint(146, 136));
	BView* resized = Find("fresh");
	ASSERT_NE(nullptr, resized);
	EXPECT_EQ(BRect(20, 20, 149, 139), resized->Frame());
}


// Hovering with a drag selects views without a press.
TEST_F(TypingTest, ADragThatSelectsAnotherViewSendsTheText)
{
	SelectPlain();
	BView* plain = workView->SelectedView();
	TypeName("fresh");
	BView* list = widgetWindow->ChildAt(0);
	driver.MoveTo(list, BPoint(60, 20));
	driver.Press();
	driver.MoveTo(list, BPoint(66, 26));
	driver.MoveTo(Find("other"));
	EXPECT_EQ(Find("other"), workView->SelectedView());
	EXPECT_STREQ("fresh", plain->Name());
	EXPECT_STREQ("other", Field("EditView", "Name: ")->Text());
	driver.MoveTo(BPoint(5, 5));
	driver.Release();
}


TEST_F(TypingTest, AButtonThatLoadsTheFieldsAnewSendsTheTextFirst)
{
	SelectPlain();
	BView* plain = workView->SelectedView();
	person.Replace(Field("EditView", "L:"), "33");
	driver.Click(InPanel<BButton>("EditView", "preferred"));
	EXPECT_EQ(33, plain->Frame().left);

	person.Replace(Field("EditView", "Size: "), "17");
	person.Choose(InPanel<BMenuField>("EditView", "Font:"), "be_bold_font");
	BFont font;
	plain->GetFont(&font);
	EXPECT_EQ(*be_bold_font, font);
	EXPECT_STREQ("10", Field("EditView", "Size: ")->Text());
}


TEST_F(TypingTest, RebuildingTheScrollViewKeepsTheName)
{
	driver.Click(Find("target"));
	driver.Click(Find("scroll"), BPoint(3, 1));
	ASSERT_STREQ("scroll", workView->SelectedView()->Name());
	TypeName("fresh");
	driver.Click(InPanel<BCheckBox>("EditScrollView", "Vertical"));
	BScrollView* rebuilt = Find<BScrollView>("fresh");
	ASSERT_NE(nullptr, rebuilt);
	EXPECT_EQ(nullptr, rebuilt->ScrollBar(B_VERTICAL));
	EXPECT_EQ(nullptr, Find("scroll"));
}


TEST_F(TypingTest, RebuildingTheSliderKeepsTheOtherFields)
{
	driver.Click(Find("slider"));
	person.Replace(Field("EditSlider", "Min Value:"), "7");
	driver.Click(Field("EditSlider", "Max Value:")->TextView());
	driver.Key("a", B_COMMAND_KEY);
	driver.Type("70");
	driver.Click(Field("EditControl", "Label: ")->TextView());
	BSlider* slider = Find<BSlider>("slider");
	int32 minimum, maximum;
	slider->GetLimits(&minimum, &maximum);
	EXPECT_EQ(7, minimum);
	EXPECT_EQ(70, maximum);
}


TEST_F(TypingTest, AnotherItemOfTheMenuBarSendsTheLabelToTheFormerOne)
{
	BMenuBar* bar = Find<BMenuBar>("bar");
	driver.Click(bar, BPoint(300, 8));
	BOutlineListView* list =
		dynamic_cast<BOutlineListView*>(Panel("EditMenuBar")->ChildAt(2)->ChildAt(0));
	ASSERT_NE(nullptr, list);
	person.ClickEntry(list, "One");
	person.Replace(Field("EditMenuBar", "Label: "), "First");
	person.ClickEntry(list, "Two");
	EXPECT_STREQ("First", bar->ItemAt(0)->Label());
	EXPECT_STREQ("Two", bar->ItemAt(1)->Label());

	person.Replace(Field("EditMenuBar", "Label: "), "Second");
	driver.Click(InPanel<BButton>("EditMenuBar", "Add After"));
	ASSERT_EQ(3, bar->CountItems());
	EXPECT_STREQ("Second", bar->ItemAt(1)->Label());
	EXPECT_STREQ("new item", bar->ItemAt(2)->Label());
}


TEST_F(TypingTest, ATypedComponentCountsForTheColorItWasTypedFor)
{
	SelectPlain();
	BView* plain = workView->SelectedView();
	person.Replace(Field("EditView", "Red:"), "17");
	driver.Click(InPanel<BRadioButton>("EditView", "High"));
	EXPECT_EQ(17, plain->ViewColor().red);
	EXPECT_EQ(0, plain->HighColor().red);
	EXPECT_STREQ("0", Field("EditView", "Red:")->Text());
}


TEST_F(TypingTest, AButtonLeavesTheCaretInTheField)
{
	driver.Click(Find("slider"));
	driver.Click(Field("EditView", "Name: ")->TextView());
	driver.Key("End");
	driver.Type("s");
	driver.Click(InPanel<BCheckBox>("EditControl", "Enabled"));
	driver.Type("!\n");
	EXPECT_NE(nullptr, Find("sliders!"));
}
