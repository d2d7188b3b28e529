// The size that each class prefers, from the metrics of its font.
#include <gtest/gtest.h>

#include <cmath>

#include <Box.h>
#include <Button.h>
#include <CheckBox.h>
#include <ColorControl.h>
#include <ListView.h>
#include <MenuBar.h>
#include <MenuField.h>
#include <MenuItem.h>
#include <OutlineListView.h>
#include <PictureButton.h>
#include <PopUpMenu.h>
#include <RadioButton.h>
#include <ScrollView.h>
#include <Slider.h>
#include <StatusBar.h>
#include <StringItem.h>
#include <StringView.h>
#include <TabView.h>
#include <TextControl.h>
#include <TextView.h>

#include "ControlFixture.h"

namespace {

const BRect kFrame(10, 10, 209, 109);
constexpr const char* kLabel = "A label of some length";

struct Size {
	float width = 0, height = 0;
};


class PreferredSize : public testing::Test {
protected:
	// As GetPreferredSize() says, after ResizeToPreferred() has been seen to take it.
	template<class View> Size Of(View* view)
	{
		fixture.Add(view);
		Size size;
		fixture.Locked([&] {
			view->GetPreferredSize(&size.width, &size.height);
			view->ResizeToPreferred();
			EXPECT_EQ(size.width, view->Bounds().Width());
			EXPECT_EQ(size.height, view->Bounds().Height());
		});
		return size;
	}

	float Width(const char* text, const BFont* font = be_plain_font)
	{
		return std::ceil(font->StringWidth(text));
	}

	// ceil(ascent + descent + leading)
	float Line(const BFont* font = be_plain_font)
	{
		font_height height;
		font->GetHeight(&height);
		return std::ceil(height.ascent + height.descent + height.leading);
	}

	ControlFixture fixture;
};

} // namespace


TEST_F(PreferredSize, OfAButton)
{
	BButton* button = new BButton(kFrame, "button", kLabel, NULL);
	Size size = Of(button);
	EXPECT_EQ(std::max(75.0f, 20 + Width(kLabel)), size.width);
	EXPECT_EQ(Line() + 12, size.height);
	size = Of(new BButton(kFrame, "short", "OK", NULL));
	EXPECT_EQ(75, size.width);

	fixture.Locked([&] {
		button->SetLabel("Another, longer label than before");
		Size larger;
		button->GetPreferredSize(&larger.width, &larger.height);
		EXPECT_EQ(20 + Width("Another, longer label than before"), larger.width);
		button->MakeDefault(true);
		Size ringed;
		button->GetPreferredSize(&ringed.width, &ringed.height);
		EXPECT_EQ(larger.width + 6, ringed.width);
		EXPECT_EQ(larger.height + 6, ringed.height);
	});
}


TEST_F(PreferredSize, OfCheckBoxesAndRadioButtons)
{
	for (BControl* control : { static_cast<BControl*>(new BCheckBox(kFrame, "b", kLabel, NULL)),
			 static_cast<BControl*>(new BRadioButton(kFrame, "r", kLabel, NULL)) }) {
		const Size size = Of(control);
		EXPECT_EQ(22 + Width(kLabel), size.width);
		EXPECT_EQ(Line() + 6, size.height);
	}
}


TEST_F(PreferredSize, OfATextControl)
{
	BTextControl* control = new BTextControl(kFrame, "control", kLabel, "text", NULL);
	const Size size = Of(control);
	EXPECT_EQ(Line() + 4, size.height); // two pixels of frame above and below
	EXPECT_GT(size.width, Width(kLabel) + 3 * Line());
	// Taking the size moves the divider right behind the label.
	EXPECT_EQ(Width(kLabel) + 2, control->Divider());
}


TEST_F(PreferredSize, OfSliders)
{
	BSlider* slider = new BSlider(kFrame, "slider", "Label", NULL, 0, 10);
	Size size = Of(slider);
	EXPECT_GE(size.width, 199);
	const float plain = size.height;
	fixture.Locked([&] {
		slider->SetLimitLabels("low", "high");
		slider->GetPreferredSize(&size.width, &size.height);
		EXPECT_LT(plain + Line(), size.height);
		slider->SetBarThickness(16);
		float thicker;
		slider->GetPreferredSize(NULL, &thicker);
		EXPECT_EQ(size.height + 10, thicker);
	});

	BSlider* upright = new BSlider(kFrame, "upright", NULL, NULL, 0, 10, B_VERTICAL);
	size = Of(upright);
	EXPECT_EQ(12 + upright->BarThickness(), size.width);
	EXPECT_GE(size.height, 100);
	EXPECT_EQ(B_VERTICAL, upright->Orientation());
	fixture.Locked([&] { upright->SetOrientation(B_HORIZONTAL); });
	EXPECT_EQ(B_HORIZONTAL, upright->Orientation());
}


TEST_F(PreferredSize, OfAColorControl)
{
	BColorControl* control = new BColorControl(BPoint(5, 5), B_CELLS_32x8, 8, "colour");
	const BRect made = control->Frame();
	const Size size = Of(control);
	EXPECT_EQ(made.Width(), size.width);
	EXPECT_EQ(made.Height(), size.height);
	// 32 cells, the bevels and the fields beside them.
	EXPECT_GT(size.width, 32 * 8 + 4 + 6 + Width("999999"));
}


TEST_F(PreferredSize, OfAStatusBar)
{
	BStatusBar* bar = new BStatusBar(kFrame, "bar", "Label", "Trailing");
	const Size size = Of(bar);
	EXPECT_EQ(199, size.width);
	EXPECT_GT(size.height, bar->BarHeight() + Line());
	fixture.Locked([&] {
		bar->SetText("a text that is longer than the whole of the bar by itself");
		bar->SetTrailingText("and more");
		EXPECT_STREQ("and more", bar->TrailingText());
		float wider;
		bar->GetPreferredSize(&wider, NULL);
		EXPECT_GT(wider, Width(bar->Text()) + Width("and more"));
	});
}


TEST_F(PreferredSize, OfAStringView)
{
	BStringView* view = new BStringView(kFrame, "string", kLabel);
	const Size size = Of(view);
	EXPECT_EQ(Width(kLabel), size.width);
	EXPECT_EQ(Line(), size.height);
	fixture.Locked([&] {
		view->SetText("one\ntwo\nthree");
		float height;
		view->GetPreferredSize(NULL, &height);
		EXPECT_EQ(3 * Line(), height);
	});
}


TEST_F(PreferredSize, OfABoxNeverShrinksIt)
{
	BBox* box = new BBox(kFrame, "box");
	Size size = Of(box);
	EXPECT_EQ(199, size.width);
	EXPECT_EQ(99, size.height);
	BBox* narrow = new BBox(BRect(0, 0, 20, 20), "narrow");
	narrow->SetLabel(kLabel);
	size = Of(narrow);
	EXPECT_GT(size.width, Width(kLabel, be_bold_font));
}


TEST_F(PreferredSize, OfListsIsThatOfTheirItems)
{
	BListView* list = new BListView(kFrame, "list");
	BStringItem items[3] = { BStringItem("short"), BStringItem(kLabel), BStringItem("x") };
	for (BStringItem& item : items)
		list->AddItem(&item);
	const Size size = Of(list);
	fixture.Locked([&] {
		EXPECT_EQ(items[1].Width(), size.width);
		EXPECT_EQ(list->ItemFrame(2).bottom, size.height);
		EXPECT_LT(Line(), items[0].Height());
		list->RemoveSelf();
	});
	delete list;

	BOutlineListView* outline = new BOutlineListView(kFrame, "outline");
	BStringItem top("top"), below("below");
	outline->AddItem(&top);
	outline->AddUnder(&below, &top);
	const Size full = Of(outline);
	fixture.Locked([&] {
		outline->Collapse(&top);
		float collapsed;
		outline->GetPreferredSize(NULL, &collapsed);
		EXPECT_LT(collapsed, full.height);
		outline->RemoveSelf();
	});
	delete outline;
}


TEST_F(PreferredSize, OfATextViewIsThatOfItsText)
{
	BTextView* view = new BTextView(kFrame, "text", BRect(2, 2, 190, 90), B_FOLLOW_NONE);
	view->SetText("one\ntwo\nthree");
	const Size size = Of(view);
	EXPECT_EQ(199, size.width);
	EXPECT_GE(size.height, 3 * Line());
	fixture.Locked([&] {
		view->SetWordWrap(false);
		view->SetText(kLabel);
		float width;
		view->GetPreferredSize(&width, NULL);
		EXPECT_GE(width, Width(kLabel));
		EXPECT_LT(width, 199);
	});
}


TEST_F(PreferredSize, OfMenusFieldsAndBars)
{
	BMenuBar* bar = new BMenuBar(kFrame, "bar");
	bar->AddItem(new BMenuItem("One", NULL));
	bar->AddItem(new BMenuItem("Another", NULL));
	Size size;
	bar->GetPreferredSize(&size.width, &size.height);
	const BFont* font = be_plain_font;
	EXPECT_GE(size.width, font->StringWidth("One") + font->StringWidth("Another") + 4 * 8);
	font_height height;
	font->GetHeight(&height);
	EXPECT_GE(size.height, std::ceil(height.ascent + height.descent) + 2);
	delete bar;

	BMenu menu("menu");
	menu.AddItem(new BMenuItem("One", NULL));
	float one, two;
	menu.GetPreferredSize(NULL, &one);
	menu.AddItem(new BMenuItem("Two", NULL));
	menu.GetPreferredSize(NULL, &two);
	EXPECT_GE(two - one, Line());
	menu.ResizeToPreferred();
	EXPECT_EQ(two, menu.Bounds().Height());

	BPopUpMenu* popUp = new BPopUpMenu("pop-up");
	popUp->AddItem(new BMenuItem("Choice", NULL));
	float width;
	popUp->GetPreferredSize(&width, NULL);
	EXPECT_GT(width, Width("Choice"));
	BMenuField* field = new BMenuField(kFrame, "field", kLabel, popUp);
	size = Of(field);
	EXPECT_GT(size.width, field->Divider() + 13);
	EXPECT_EQ(field->MenuBar()->Frame().Height() + 4, size.height);
}


TEST_F(PreferredSize, OfContainersIsTheirPresentSize)
{
	Size size = Of(new BTabView(kFrame, "tabs", B_WIDTH_AS_USUAL, B_FOLLOW_NONE));
	EXPECT_EQ(199, size.width);
	EXPECT_EQ(99, size.height);
	BView* target = new BView(BRect(0, 0, 49, 49), "target", B_FOLLOW_NONE, 0);
	BScrollView* scroller = new BScrollView("scroll", target, B_FOLLOW_NONE, 0, true, true);
	const BRect frame = scroller->Frame();
	size = Of(scroller);
	EXPECT_EQ(frame.Width(), size.width);
	EXPECT_EQ(frame.Height(), size.height);
}


TEST_F(PreferredSize, OfAScrollBarIsItsThickness)
{
	Size size = Of(new BScrollBar(BRect(0, 0, 30, 99), "bar", NULL, 0, 10, B_VERTICAL));
	EXPECT_EQ(14, size.width);
	EXPECT_EQ(99, size.height);
	size = Of(new BScrollBar(BRect(0, 0, 99, 30), "bar", NULL, 0, 10, B_HORIZONTAL));
	EXPECT_EQ(99, size.width);
	EXPECT_EQ(14, size.height);
}
