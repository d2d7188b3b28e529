// The view panel's font, drawing mode and pen size.

#include "editors/EditView.h"

#include <Font.h>

#include "PanelFixture.h"

namespace {


class EditViewFontTest : public PanelFixture<EditView> {
protected:
	EditViewFontTest()
	{
		view = new BView(BRect(10, 20, 109, 79), "plain", B_FOLLOW_NONE, B_WILL_DRAW);
		Use(view);
	}

	BFont FontOf(BView* of)
	{
		BFont font;
		of->GetFont(&font);
		return font;
	}

	std::string Family(const BFont& font)
	{
		font_family family;
		font_style style;
		font.GetFamilyAndStyle(&family, &style);
		return family;
	}

	std::string Style(const BFont& font)
	{
		font_family family;
		font_style style;
		font.GetFamilyAndStyle(&family, &style);
		return style;
	}

	void Give(const BFont& font)
	{
		window.Locked([&] { view->SetFont(&font); });
		Reload(view);
	}

	BView* view;
};


} // namespace


TEST_F(EditViewFontTest, ChoosesTheStandardFonts)
{
	Choose("Font:", "be_bold_font");
	EXPECT_EQ(*be_bold_font, FontOf(view));
	Choose("Font:", "be_fixed_font");
	EXPECT_EQ(*be_fixed_font, FontOf(view));
	Choose("Font:", "be_plain_font");
	EXPECT_EQ(*be_plain_font, FontOf(view));
}


TEST_F(EditViewFontTest, ShowsTheFamilyOfAStandardFontAndItsStyle)
{
	Give(*be_bold_font);
	EXPECT_EQ(Family(*be_bold_font), Chosen("Font:"));
	EXPECT_EQ(Style(*be_bold_font), Chosen("Font style:"));
	Give(*be_fixed_font);
	EXPECT_EQ(Family(*be_fixed_font), Chosen("Font:"));
}


TEST_F(EditViewFontTest, ChoosesAFamilyAndAStyle)
{
	const std::string family = Family(*be_fixed_font);
	Choose("Font:", family.c_str());
	EXPECT_EQ(family, Family(FontOf(view)));
	EXPECT_EQ(family, Chosen("Font:"));

	Choose("Font style:", "Bold");
	EXPECT_EQ(family, Family(FontOf(view)));
	EXPECT_EQ("Bold", Style(FontOf(view)));
	EXPECT_EQ("Bold", Chosen("Font style:"));

	// The other family has that style too, and keeps it.
	Choose("Font:", Family(*be_plain_font).c_str());
	EXPECT_EQ(Family(*be_plain_font), Family(FontOf(view)));
	EXPECT_EQ("Bold", Style(FontOf(view)));
}


TEST_F(EditViewFontTest, OffersEveryStyleOfTheFamily)
{
	BMenu* styles = Find<BMenuField>("Font style:")->Menu();
	font_family family = {};
	snprintf(family, sizeof(family), "%s", Family(FontOf(view)).c_str());
	ASSERT_GT(count_font_styles(family), 1);
	EXPECT_EQ(count_font_styles(family), styles->CountItems());
}


// A family that was installed after the panel had been made.
TEST_F(EditViewFontTest, AFamilyThatTheMenuDoesNotHaveShowsThePlainFontAndNoStyles)
{
	BMenu* menu = Find<BMenuField>("Font:")->Menu();
	window.Locked([&] {
		delete menu->RemoveItem(menu->IndexOf(menu->FindItem(Family(*be_fixed_font).c_str())));
	});
	TypeOver("Size: ", "17");
	Give(*be_fixed_font);
	EXPECT_EQ("be_plain_font", Chosen("Font:"));
	EXPECT_EQ(0, Find<BMenuField>("Font style:")->Menu()->CountItems());
}


TEST_F(EditViewFontTest, ShowsAndSetsTheSize)
{
	TypeOver("Size: ", "23.5");
	EXPECT_EQ(23.5f, FontOf(view).Size());
	BFont font(*be_plain_font);
	font.SetSize(31);
	Give(font);
	EXPECT_EQ("31", Shown("Size: "));
}


TEST_F(EditViewFontTest, ShearIsKeptBetweenItsLimits)
{
	EXPECT_EQ("90", Shown("Shear: "));
	TypeOver("Shear: ", "10");
	EXPECT_EQ("45", Shown("Shear: "));
	EXPECT_EQ(45, FontOf(view).Shear());
	TypeOver("Shear: ", "200");
	EXPECT_EQ("135", Shown("Shear: "));
	EXPECT_EQ(135, FontOf(view).Shear());
	BFont font(*be_plain_font);
	font.SetShear(70);
	Give(font);
	EXPECT_EQ("70", Shown("Shear: "));
}


TEST_F(EditViewFontTest, ShowsAndSetsTheRotation)
{
	TypeOver("Rotation: ", "-30");
	EXPECT_EQ(-30, FontOf(view).Rotation());
	EXPECT_EQ("-30", Shown("Rotation: "));
	BFont font(*be_plain_font);
	font.SetRotation(45);
	Give(font);
	EXPECT_EQ("45", Shown("Rotation: "));
}


TEST_F(EditViewFontTest, ShowsAndSetsTheDrawingMode)
{
	Choose("Drawing mode:", "B_OP_ALPHA");
	EXPECT_EQ(B_OP_ALPHA, view->DrawingMode());
	window.Locked([&] { view->SetDrawingMode(B_OP_SUBTRACT); });
	Reload(view);
	EXPECT_EQ("B_OP_SUBTRACT", Chosen("Drawing mode:"));
}


TEST_F(EditViewFontTest, ShowsAndSetsThePenSize)
{
	TypeOver("Pen size: ", "3.5");
	EXPECT_EQ(3.5f, view->PenSize());
	TypeOver("Pen size: ", "-1");
	EXPECT_EQ("0", Shown("Pen size: "));
	EXPECT_EQ(0, view->PenSize());
	window.Locked([&] { view->SetPenSize(7); });
	Reload(view);
	EXPECT_EQ("7", Shown("Pen size: "));
}
