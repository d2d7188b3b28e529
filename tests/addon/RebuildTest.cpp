// Panels that put a new view in the place of the selected one.

#include "EditorFixture.h"

#include <Button.h>
#include <CheckBox.h>
#include <ScrollBar.h>
#include <ScrollView.h>
#include <Slider.h>

namespace {


class RebuildTest : public EditorFixture {
protected:
	RebuildTest()
	{
		BView* root =
			new BView(BRect(0, 0, 399, 399), "root", B_FOLLOW_LEFT | B_FOLLOW_TOP, B_WILL_DRAW);
		BSlider* slider =
			new BSlider(BRect(20, 20, 219, 60), "slider", "Slide:", new BMessage('slid'), 0, 99);
		slider->SetLimitLabels("low", "high");
		slider->SetViewColor(1, 2, 3);
		root->AddChild(slider);
		root->AddChild(new BScrollView("scroll",
			new BView(BRect(20, 120, 120, 220), "target", B_FOLLOW_ALL_SIDES, B_WILL_DRAW),
			B_FOLLOW_LEFT | B_FOLLOW_TOP, 0, true, true));
		root->AddChild(
			new BView(BRect(300, 20, 380, 60), "last", B_FOLLOW_LEFT | B_FOLLOW_TOP, B_WILL_DRAW));
		item = Add(1, root);
		Open(item);
	}

	BView* LastChild()
	{
		BView* last = Root()->ChildAt(0);
		while (last->NextSibling() != nullptr)
			last = last->NextSibling();
		return last;
	}

	std::string Limits()
	{
		int32 minimum, maximum;
		Find<BSlider>("slider")->GetLimits(&minimum, &maximum);
		return std::to_string(minimum) + ".." + std::to_string(maximum);
	}

	BResEditor::BResourceHandle item;
};


} // namespace


TEST_F(RebuildTest, NewLimitsMakeANewSliderWhichIsSelectedAndLast)
{
	Select(Find("slider"));
	BView* old = Find("slider");
	person.TypeOver(Field("EditSlider", "Min Value:"), "-20");
	BSlider* slider = Find<BSlider>("slider");
	EXPECT_NE(old, slider);
	EXPECT_EQ("-20..99", Limits());
	EXPECT_EQ(slider, workView->SelectedView());
	EXPECT_EQ(slider, LastChild());
	EXPECT_STREQ("low", slider->MinLimitLabel());
	EXPECT_EQ(uint32('slid'), slider->Message()->what);
	EXPECT_EQ(3, slider->ViewColor().blue);

	// The panels are the new slider's.
	person.TypeOver(Field("EditControl", "Label: "), "New:");
	EXPECT_STREQ("New:", slider->Label());
	person.TypeOver(Field("EditSlider", "Max Value:"), "5");
	EXPECT_EQ("-20..5", Limits());
}


TEST_F(RebuildTest, EachLimitWritesBoth)
{
	Select(Find("slider"));
	person.Replace(Field("EditSlider", "Max Value:"), "70");
	person.TypeOver(Field("EditSlider", "Min Value:"), "7");
	EXPECT_EQ("7..70", Limits());
}


TEST_F(RebuildTest, ClearingBothLimitLabelsRemovesThem)
{
	Select(Find("slider"));
	person.TypeOver(Field("EditSlider", "Min Label:"), "");
	EXPECT_STREQ("high", Find<BSlider>("slider")->MaxLimitLabel());
	person.TypeOver(Field("EditSlider", "Max Label:"), "");
	BMessage archive;
	window.Locked([&] { Find("slider")->Archive(&archive); });
	EXPECT_FALSE(archive.HasString("_minlbl"));
	EXPECT_FALSE(archive.HasString("_maxlbl"));
	EXPECT_EQ(Find("slider"), workView->SelectedView());
	EXPECT_EQ(Find("slider"), LastChild());
}


TEST_F(RebuildTest, AMinimumAboveTheMaximumIsPassedOn)
{
	Select(Find("slider"));
	person.TypeOver(Field("EditSlider", "Min Value:"), "200");
	EXPECT_STREQ("200", Field("EditSlider", "Min Value:")->Text());
	EXPECT_EQ(Find("slider"), workView->SelectedView());
	person.TypeOver(Field("EditSlider", "Min Value:"), "5");
	EXPECT_STREQ("5", Field("EditSlider", "Min Value:")->Text());
}


TEST_F(RebuildTest, ARebuiltScrollViewIsSelectedAndTheFormerOneForgotten)
{
	Select(Find("scroll"));
	BView* target = Find("target");
	for (const char* box : { "Vertical", "Horizontal", "Vertical", "Horizontal" }) {
		driver.Click(InPanel<BCheckBox>("EditScrollView", box));
		BScrollView* scroll = Find<BScrollView>("scroll");
		ASSERT_NE(nullptr, scroll);
		EXPECT_EQ(scroll, workView->SelectedView());
		EXPECT_EQ(target, scroll->Target());
		// The panels are the new view's.
		person.TypeOver(Field("EditView", "Name: "), "renamed");
		EXPECT_STREQ("renamed", scroll->Name());
		person.TypeOver(Field("EditView", "Name: "), "scroll");
	}
	EXPECT_NE(nullptr, Find<BScrollView>("scroll")->ScrollBar(B_HORIZONTAL));
	EXPECT_NE(nullptr, Find<BScrollView>("scroll")->ScrollBar(B_VERTICAL));
}


// Its parent is the work area's ground.
TEST_F(RebuildTest, ARootThatIsRebuiltStaysTheRoot)
{
	Close();
	BSlider* slider = new BSlider(BRect(0, 0, 199, 40), "slider", "Slide:", NULL, 0, 99);
	Open(Add(2, slider));
	person.TypeOver(Field("EditSlider", "Min Value:"), "7");
	EXPECT_EQ(Root(), workView->SelectedView());
	EXPECT_EQ("7..99", Limits());
	driver.Click(Root(), BPoint(100, 3));
	person.TypeOver(Field("EditControl", "Label: "), "New:");
	EXPECT_STREQ("New:", dynamic_cast<BSlider*>(Root())->Label());
}


TEST_F(RebuildTest, AScrollViewThatIsTheRootIsRebuiltAndSaved)
{
	Close();
	const BResEditor::BResourceHandle root = Add(2,
		new BScrollView("scroll",
			new BView(BRect(20, 120, 120, 220), "target", B_FOLLOW_ALL_SIDES, B_WILL_DRAW),
			B_FOLLOW_LEFT | B_FOLLOW_TOP, 0, true, true));
	Open(root);
	driver.Click(InPanel<BCheckBox>("EditScrollView", "Vertical"));
	EXPECT_EQ(Root(), workView->SelectedView());
	Close();
	BMessage archive = Archive(root);
	const std::unique_ptr<BArchivable> revived(instantiate_object(&archive));
	BScrollView* scroll = dynamic_cast<BScrollView*>(revived.get());
	ASSERT_NE(nullptr, scroll);
	EXPECT_EQ(nullptr, scroll->ScrollBar(B_VERTICAL));
	EXPECT_NE(nullptr, scroll->ScrollBar(B_HORIZONTAL));
	EXPECT_STREQ("target", scroll->Target()->Name());
}
