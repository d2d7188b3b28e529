// The panel of text views.

#include "editors/EditTextView.h"

#include <TextView.h>

#include "PanelFixture.h"

namespace {

const BRect kFrame(20, 20, 220, 120);

} // namespace


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


TEST_F(EditTextViewTest, ShowsWhatTheTextViewHas)
{
	BTextView* text = UseText();
	window.Locked([&] {
		text->MakeEditable(false);
		text->MakeSelectable(false);
		text->SetAutoindent(true);
		text->SetStylable(true);
		text->SetWordWrap(false);
		text->SetMaxBytes(77);
		text->SetTabWidth(13);
		text->SetAlignment(B_ALIGN_RIGHT);
		text->SetColorSpace(static_cast<color_space>(6));
	});
	Reload(text);
	EXPECT_FALSE(IsTicked("Editable"));
	EXPECT_FALSE(IsTicked("Selectable"));
	EXPECT_TRUE(IsTicked("Auto Indent"));
	EXPECT_TRUE(IsTicked("Stylable"));
	EXPECT_FALSE(IsTicked("Word Wrap"));
	EXPECT_FALSE(IsTicked("Resizable"));
	EXPECT_EQ("77", Shown("Max bytes:"));
	EXPECT_EQ("13", Shown("Tab width:"));
	EXPECT_EQ("B_ALIGN_RIGHT", Chosen("Text:"));
	EXPECT_EQ("B_CMAP8", Chosen("Offscreen:"));
	window.Locked([&] { text->MakeResizable(true, NULL); });
	Reload(text);
	EXPECT_TRUE(IsTicked("Resizable"));
}


TEST_F(EditTextViewTest, OnlyTheLooksDrawTheText)
{
	auto text = Use(new Counting<BTextView>(
		kFrame, "t", BRect(2, 2, 198, 98), uint32(B_FOLLOW_NONE), uint32(B_WILL_DRAW)));
	int draws = text->draws;
	TypeOver("Max bytes:", "50");
	EXPECT_EQ(draws, text->draws);
	Choose("Text:", "B_ALIGN_CENTER");
	EXPECT_GT(text->draws, draws);
	draws = text->draws;
	Tick("Auto Indent");
	EXPECT_GT(text->draws, draws);
	draws = text->draws;
	TypeOver("Tab width:", "60");
	EXPECT_GT(text->draws, draws);
}
