// Whatever is entered in a field of a panel: nothing crashes, and the field shows what the view has.

#include "EditorFixture.h"

#include <algorithm>
#include <set>

#include <OutlineListView.h>

#include "palette/WidgetCatalogue.h"

namespace {


const std::string kTexts[] = { "", "0", "-1", "7", "1e999", "-1e999", "nan", "inf", "2147483648",
	"-2147483649", "99999999999999999999999999", "0x10", "1e-40", "--", " 12 ", "12abc",
	std::string(10000, '9'), std::string(10000, 'w'), "\x01\x02\x7f\x1b[2J", "tab\tline\nend",
	"h\xc3\xa9llo \xe2\x82\xac \xf0\x9f\x8e\x88", "\xff\xfe\x80", "%s%n%d", "\"quoted\\\"" };


class HostileTextTest : public EditorFixture, public testing::WithParamInterface<const char*> {
protected:
	HostileTextTest() : EditorFixture(BRect(10, 10, 1509, 909)) { Reopen(); }

	void Reopen()
	{
		Close();
		BView* root =
			new BView(BRect(0, 0, 799, 699), "root", B_FOLLOW_LEFT | B_FOLLOW_TOP, B_WILL_DRAW);
		BView* sample = MakeSample(GetParam());
		sample->MoveTo(40, 40);
		root->AddChild(sample);
		Open(Add(++fItems, root));
		Select(Root()->ChildAt(0));
	}

	std::vector<BTextControl*> Fields() { return ControlUser::All<BTextControl>(Column()); }

	// Text that is no number and no code.
	static bool HoldsText(const BTextControl* field)
	{
		static const std::set<std::string> kLabels = { "Name: ", "Label: ", "Label:", "Text: ",
			"Text:", "Trailing label:", "Trailing text: ", "Min Label:", "Max Label:",
			"Class name: " };
		return kLabels.count(field->Label()) != 0;
	}

	// The first entry of a menu bar's items, which is what its fields are about.
	void ClickEntry()
	{
		if (BView* panel = Panel("EditMenuBar"))
			driver.Click(ControlUser::All<BOutlineListView>(panel)[0], BPoint(100, 6));
	}

	// What is shown after the view was selected anew. It may lie where no mouse gets to it.
	std::string ShownAgain(size_t index)
	{
		window.Locked([&] { workView->SetSelectedView(Root()); });
		window.Locked([&] { workView->SetSelectedView(Root()->ChildAt(0)); });
		ClickEntry();
		return Fields()[index]->Text();
	}

	int32 fItems = 0;
};


// A field is one line.
std::string
OneLine(std::string text)
{
	std::replace(text.begin(), text.end(), '\n', ' ');
	return text;
}


} // namespace


TEST_P(HostileTextTest, AFieldShowsWhatTheViewTook)
{
	// The view panel is the same for all.
	const bool isPlain = std::string(GetParam()) == "BView";
	const size_t viewFields = ControlUser::All<BTextControl>(Panel("EditView")).size();
	for (size_t i = isPlain ? 0 : viewFields; i < Fields().size(); i++) {
		Reopen();
		ClickEntry();
		if (!Fields()[i]->IsEnabled())
			continue;
		for (const std::string& text : kTexts) {
			SCOPED_TRACE(std::string(Fields()[i]->Label()) + " < " + text.substr(0, 40));
			person.Paste(Fields()[i], text);
			driver.Key("Return");
			const std::string shown = Fields()[i]->Text();
			if (HoldsText(Fields()[i])) {
				EXPECT_EQ(OneLine(text), shown);
			}
			if (std::string(Fields()[i]->Label()) == "Cell size:" && std::stof(shown) < 6)
				EXPECT_EQ("6", ShownAgain(i)); // the platform's smallest
			else
				EXPECT_EQ(shown, ShownAgain(i));
		}
	}
}


INSTANTIATE_TEST_SUITE_P(Catalogue, HostileTextTest,
	testing::Values("BView", "BView (custom)", "BBox", "BStringView", "BButton", "BCheckBox",
		"BRadioButton", "BTextControl", "BSlider", "BColorControl", "BMenuField", "BStatusBar",
		"BTextView", "BScrollView with BView", "BTabView", "BListView", "BOutlineListView",
		"BMenuBar"));
