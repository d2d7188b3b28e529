// What the panels do when the selected view is moved or resized in the work area.

#include "EditorFixture.h"

#include <ScrollBar.h>
#include <ScrollView.h>
#include <TextView.h>

namespace {


class FrameFollowTest : public EditorFixture {
protected:
	// In a root that has room for it to grow.
	template<class View> View* OpenWith(View* view)
	{
		view->SetName("sample");
		BView* root =
			new BView(BRect(0, 0, 399, 399), "root", B_FOLLOW_LEFT | B_FOLLOW_TOP, B_WILL_DRAW);
		root->AddChild(view);
		Open(Add(1, root));
		return Find<View>("sample");
	}

	void DragCorner(BView* view, float right, float down)
	{
		const BPoint corner = view->Bounds().RightBottom() - BPoint(3, 3);
		driver.Drag(view, corner, view, corner + BPoint(right, down));
	}

	float ShownNumber(const char* panel, const char* label)
	{
		return std::stof(Field(panel, label)->Text());
	}
};


} // namespace


TEST_F(FrameFollowTest, TheTextOfAResizedTextViewFillsIt)
{
	BTextView* text = OpenWith(new BTextView(BRect(40, 40, 239, 139), "sample",
		BRect(2, 2, 150, 60), B_FOLLOW_LEFT | B_FOLLOW_TOP, B_WILL_DRAW));
	Select(text);
	EXPECT_EQ(150, text->TextRect().right);
	DragCorner(text, 40, 30);
	EXPECT_EQ(BRect(40, 40, 279, 169), text->Frame());
	EXPECT_EQ(text->Bounds().InsetByCopy(2, 2).LeftTop(), text->TextRect().LeftTop());
	EXPECT_EQ(text->Bounds().right - 2, text->TextRect().right);
}


TEST_F(FrameFollowTest, TheFrameIsShownWhereverTheViewGoes)
{
	BView* view = OpenWith(
		new BView(BRect(40, 40, 139, 139), "sample", B_FOLLOW_LEFT | B_FOLLOW_TOP, B_WILL_DRAW));
	Select(view);
	driver.Key("Right");
	driver.Key("Down");
	driver.Key("Down");
	EXPECT_EQ(41, ShownNumber("EditView", "L:"));
	EXPECT_EQ(42, ShownNumber("EditView", "T:"));
	DragCorner(view, 20, 10);
	EXPECT_EQ(view->Frame().right, ShownNumber("EditView", "R:"));
	EXPECT_EQ(view->Frame().bottom, ShownNumber("EditView", "B:"));
	EXPECT_EQ(160, view->Frame().right);
}


TEST_F(FrameFollowTest, TheTotalsOfAScrollViewFollowItsTarget)
{
	BView* target = new BView(BRect(40, 40, 139, 139), "target", B_FOLLOW_ALL_SIDES, B_WILL_DRAW);
	BScrollView* scroll =
		OpenWith(new BScrollView("sample", target, B_FOLLOW_LEFT | B_FOLLOW_TOP, 0, true, true));
	driver.Click(scroll, BPoint(0, 0));
	ASSERT_EQ(scroll, workView->SelectedView());
	const float before = ShownNumber("EditScrollView", "Total width:");
	window.Locked([&] { scroll->ScrollBar(B_HORIZONTAL)->SetRange(0, 30); });
	DragCorner(scroll, 25, 15);
	float minimum, maximum;
	scroll->ScrollBar(B_HORIZONTAL)->GetRange(&minimum, &maximum);
	EXPECT_NE(before, ShownNumber("EditScrollView", "Total width:"));
	EXPECT_EQ(scroll->Target()->Bounds().Width() + maximum,
		ShownNumber("EditScrollView", "Total width:"));
}
