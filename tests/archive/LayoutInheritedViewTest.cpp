#include "archive/LayoutInheritedView.h"

#include <string>

#include <gtest/gtest.h>

#include <Font.h>
#include <Message.h>

#include "support/TestWindow.h"

namespace {


constexpr rgb_color kWhite = { 255, 255, 255, 255 };


// A placeholder in a window, with children that cover parts of it and leave no ink.
class Placeholder {
public:
	explicit Placeholder(float width = 199, float height = 119) :
		view(window.Add(new LayoutInheritedView(
			BRect(20, 20, 20 + width, 20 + height), "p", B_FOLLOW_NONE, B_WILL_DRAW)))
	{
	}

	void Cover(float left, float top, float right, float bottom)
	{
		window.Locked([&] {
			view->AddChild(new BView(BRect(left, top, right, bottom), NULL, B_FOLLOW_NONE, 0));
			view->Invalidate();
		});
	}

	// The bounds of what is not white.
	BRect Ink()
	{
		BRect ink;
		const BRect bounds = view->Bounds();
		for (float y = 0; y <= bounds.bottom; y++) {
			for (float x = 0; x <= bounds.right; x++) {
				const rgb_color color = window.driver.PixelAt(view, BPoint(x, y));
				if (color.red == kWhite.red && color.green == kWhite.green
					&& color.blue == kWhite.blue)
					continue;
				const BRect pixel(x, y, x, y);
				ink = ink.IsValid() ? ink | pixel : pixel;
			}
		}
		return ink;
	}

	TestWindow window;
	LayoutInheritedView* view;
};


std::string
ClassesOf(const BMessage& archive)
{
	std::string names;
	const char* name;
	for (int32 i = 0; archive.FindString("class", i, &name) == B_OK; i++)
		names += std::string(name) + ";";
	return names;
}


} // namespace


TEST(LayoutInheritedView, DrawsItsClassNameAtTheTopLeft)
{
	Placeholder placeholder;
	const BRect ink = placeholder.Ink();
	EXPECT_GE(ink.left, 4);
	EXPECT_LE(ink.left, 8);
	EXPECT_GE(ink.top, 4);
	EXPECT_LT(ink.bottom, 20);
}


TEST(LayoutInheritedView, AvoidsAChildAtTheTopLeft)
{
	Placeholder placeholder;
	placeholder.Cover(0, 0, 30, 20);
	const BRect ink = placeholder.Ink();
	EXPECT_GT(ink.left, 100);
	EXPECT_GE(ink.right, 185);
	EXPECT_LT(ink.bottom, 20);
}


TEST(LayoutInheritedView, GoesToTheBottomLeftWhenTheTopIsCovered)
{
	Placeholder placeholder;
	placeholder.Cover(0, 0, 199, 59);
	const BRect ink = placeholder.Ink();
	EXPECT_LE(ink.left, 8);
	EXPECT_GT(ink.top, 95);
}


TEST(LayoutInheritedView, KeepsItsPlaceWhenNothingThatMattersChanges)
{
	Placeholder placeholder;
	placeholder.Cover(0, 0, 30, 20);
	const BRect ink = placeholder.Ink();

	// The top left is free again, but the name has no reason to jump back.
	placeholder.window.Locked([&] {
		BView* child = placeholder.view->ChildAt(0);
		placeholder.view->RemoveChild(child);
		delete child;
		placeholder.view->Invalidate();
	});
	EXPECT_EQ(ink, placeholder.Ink());
}


TEST(LayoutInheritedView, PlacesTheNameAnewWhenTheFontChanges)
{
	Placeholder placeholder;
	placeholder.Cover(0, 0, 30, 20);
	placeholder.window.Locked([&] {
		BView* child = placeholder.view->ChildAt(0);
		placeholder.view->RemoveChild(child);
		delete child;
		placeholder.view->SetFontSize(20);
		placeholder.view->Invalidate();
	});
	EXPECT_LT(placeholder.Ink().left, 20);
}


TEST(LayoutInheritedView, FindsAFreeRectangleInsideACrowdedView)
{
	Placeholder placeholder;
	// All corners and the middle are covered; a gap is left at the right of the middle.
	placeholder.Cover(0, 0, 199, 24);
	placeholder.Cover(0, 25, 120, 119);
	placeholder.Cover(121, 60, 199, 119);
	const BRect ink = placeholder.Ink();
	EXPECT_GT(ink.left, 120);
	EXPECT_GT(ink.top, 24);
	EXPECT_LT(ink.bottom, 60);
}


TEST(LayoutInheritedView, DrawsAtTheTopLeftWhenItIsCoveredCompletely)
{
	TestWindow window;
	LayoutInheritedView* view = window.Add(new LayoutInheritedView(
		BRect(20, 20, 119, 79), "p", B_FOLLOW_NONE, B_WILL_DRAW | B_DRAW_ON_CHILDREN));
	window.Locked([&] {
		view->AddChild(new BView(BRect(0, 0, 99, 59), NULL, B_FOLLOW_NONE, 0));
		view->Invalidate();
	});
	// The pen stands behind the name that was drawn last.
	window.Locked([&] {
		view->Draw(view->Bounds());
		font_height height;
		view->GetFontHeight(&height);
		EXPECT_NEAR(4 + height.ascent, view->PenLocation().y, 0.01);
		EXPECT_NEAR(4 + view->StringWidth("MyBView"), view->PenLocation().x, 1);
	});
}


TEST(LayoutInheritedView, ArchivesTwoClassNames)
{
	LayoutInheritedView view(BRect(0, 0, 50, 50), "p", B_FOLLOW_NONE, B_WILL_DRAW);
	BMessage archive;
	EXPECT_EQ(B_OK, view.Archive(&archive, true));
	EXPECT_EQ("LayoutInheritedView;MyBView;", ClassesOf(archive));

	BView* revived = dynamic_cast<BView*>(LayoutInheritedView::Instantiate(&archive));
	ASSERT_NE(nullptr, revived);
	EXPECT_STREQ("MyBView", static_cast<LayoutInheritedView*>(revived)->ClassName());
	delete revived;
}


TEST(LayoutInheritedView, ArchivesAnEmptyNameAndCarriesFurtherOnesAlong)
{
	BMessage archive;
	archive.AddString("class", "LayoutInheritedView");
	LayoutInheritedView nameless(&archive);
	BMessage written;
	nameless.Archive(&written, true);
	EXPECT_EQ("LayoutInheritedView;;", ClassesOf(written));

	archive.AddString("class", "Mine");
	archive.AddString("class", "BView");
	LayoutInheritedView named(&archive);
	written.MakeEmpty();
	named.Archive(&written, true);
	EXPECT_EQ("LayoutInheritedView;Mine;BView;", ClassesOf(written));
}


TEST(LayoutInheritedView, RefusesTheArchiveOfAnotherClass)
{
	BMessage archive;
	archive.AddString("class", "BView");
	EXPECT_EQ(NULL, LayoutInheritedView::Instantiate(&archive));
}
