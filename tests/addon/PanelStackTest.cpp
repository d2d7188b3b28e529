// The stack of panels for every kind of view: which are shown and where, and the keyboard's way
// through them.

#include "EditorFixture.h"

#include <algorithm>

#include <Box.h>
#include <Control.h>
#include <MenuField.h>
#include <OutlineListView.h>
#include <TextView.h>

#include "palette/WidgetCatalogue.h"

namespace {


struct Case {
	const char* entry; // of the palette
	std::vector<std::string> panels; // below the view panel
};


void
PrintTo(const Case& each, std::ostream* out)
{
	*out << each.entry;
}


const Case kCases[] = {
	{ "BView", {} },
	{ "BView (custom)", { "EditInherited" } },
	{ "BBox", { "EditBox" } },
	{ "BStringView", { "EditStringView" } },
	{ "BButton", { "EditControl", "EditButton" } },
	{ "BCheckBox", { "EditControl", "EditCheckBox" } },
	{ "BRadioButton", { "EditControl", "EditRadioButton" } },
	{ "BTextControl", { "EditControl", "EditTextControl" } },
	{ "BSlider", { "EditControl", "EditSlider" } },
	{ "BColorControl", { "EditControl", "EditColorControl" } },
	{ "BMenuField", { "EditMenuField" } },
	{ "BStatusBar", { "EditStatusBar" } },
	{ "BTextView", { "EditTextView" } },
	{ "BScrollView with BView", { "EditScrollView" } },
	{ "BTabView", { "EditTabView" } },
	{ "BListView", { "EditListView" } },
	{ "BOutlineListView", { "EditListView", "EditOutlineListView" } },
	{ "BMenuBar", { "EditMenuBar" } },
};


class PanelStackTest : public EditorFixture, public testing::WithParamInterface<Case> {
protected:
	PanelStackTest() : EditorFixture(BRect(10, 10, 1509, 909))
	{
		BView* root =
			new BView(BRect(0, 0, 799, 699), "root", B_FOLLOW_LEFT | B_FOLLOW_TOP, B_WILL_DRAW);
		sample = MakeSample(GetParam().entry);
		sample->MoveTo(40, 40);
		root->AddChild(sample);
		Open(Add(1, root));
		Select(Root()->ChildAt(0));
	}

	std::vector<EditorInterface*> Shown()
	{
		std::vector<EditorInterface*> panels;
		for (BView* child = Column()->ChildAt(0); child != nullptr; child = child->NextSibling())
			panels.push_back(dynamic_cast<EditorInterface*>(child));
		return panels;
	}

	static bool IsUsable(const BView* view)
	{
		if ((view->Flags() & B_NAVIGABLE) == 0)
			return false;
		if (auto control = dynamic_cast<const BControl*>(view))
			return control->IsEnabled();
		auto field = dynamic_cast<const BMenuField*>(view);
		return field == nullptr || field->IsEnabled();
	}

	static void Collect(BView* view, std::vector<BView*>& usable)
	{
		if (IsUsable(view))
			usable.push_back(view);
		for (BView* child = view->ChildAt(0); child != nullptr; child = child->NextSibling())
			Collect(child, usable);
	}

	BView* TabFrom(BView* view)
	{
		EXPECT_EQ(view, window.Window()->CurrentFocus());
		driver.Key("Tab");
		return window.Window()->CurrentFocus();
	}

	BRect OnScreen(BView* view)
	{
		BRect frame;
		window.Locked([&] { frame = view->ConvertToScreen(view->Bounds()); });
		return frame;
	}

	BView* sample;
};


} // namespace


TEST_P(PanelStackTest, ShowsThePanelsOfTheClassChainTwelvePixelsApart)
{
	const std::vector<EditorInterface*> panels = Shown();
	ASSERT_EQ(GetParam().panels.size() + 1, panels.size());
	EXPECT_STREQ("EditView", panels[0]->Name());
	EXPECT_EQ(BPoint(4, 4), panels[0]->Frame().LeftTop());
	for (size_t i = 1; i < panels.size(); i++) {
		EXPECT_EQ(GetParam().panels[i - 1], panels[i]->Name());
		EXPECT_EQ(4, panels[i]->Frame().left);
		EXPECT_EQ(panels[i - 1]->Frame().bottom + 12, panels[i]->Frame().top);
		EXPECT_EQ(panels[i - 1]->Frame().right, panels[i]->Frame().right);
	}

	Select(Root());
	EXPECT_EQ(1u, Shown().size());
}


TEST_P(PanelStackTest, TabReachesEveryControlInReadingOrder)
{
	// With an entry selected, what is about it can be used.
	if (BView* panel = Panel("EditMenuBar"))
		driver.Click(ControlUser::All<BOutlineListView>(panel)[0], BPoint(100, 6));
	std::vector<BView*> usable;
	Collect(Column(), usable);
	ASSERT_FALSE(usable.empty());

	driver.Click(usable[0]);
	for (size_t i = 1; i < usable.size(); i++) {
		BView* next = TabFrom(usable[i - 1]);
		ASSERT_EQ(usable[i], next);
		if (LiveViewAttached(usable[i - 1], next) != nullptr)
			continue; // a colour control's own fields
		// The next one is in a lower row, or further right in the row or in the next column.
		const BRect before = OnScreen(usable[i - 1]);
		const BRect frame = OnScreen(next);
		EXPECT_TRUE(frame.top >= before.bottom || frame.left > before.right)
			<< "control " << i << " at " << frame.left << ", " << frame.top;
	}
	for (size_t i = usable.size() - 1; i > 0; i--) {
		driver.Key("Tab", B_SHIFT_KEY);
		EXPECT_EQ(usable[i - 1], window.Window()->CurrentFocus());
	}
}


INSTANTIATE_TEST_SUITE_P(Catalogue, PanelStackTest, testing::ValuesIn(kCases));
