// What the buttons and lists of the panels change, saved and opened again: the items of a menu bar,
// the tabs of a tab view, colours of whole trees, frames.

#include "CatalogueFixture.h"

#include <algorithm>
#include <iterator>

#include <Button.h>
#include <CheckBox.h>
#include <MenuField.h>
#include <MenuItem.h>
#include <RadioButton.h>
#include <TabView.h>

#include "editors/LiveColorControl.h"

namespace {


std::string
ColorsOf(const BView* view)
{
	std::string text;
	for (const rgb_color color : { view->ViewColor(), view->HighColor(), view->LowColor() }) {
		char hex[16];
		snprintf(hex, sizeof(hex), "%02x%02x%02x ", color.red, color.green, color.blue);
		text += hex;
	}
	return text;
}


// All descendants, each in a line.
std::string
ColorsBelow(const BView* view)
{
	std::string text;
	for (const BView* child = view->ChildAt(0); child != nullptr; child = child->NextSibling()) {
		text += ColorsOf(child) + "\n" + ColorsBelow(child);
	}
	return text;
}


class CatalogueTrees : public CatalogueFixture {
protected:
	void Press(const char* panel, const char* label)
	{
		driver.Click(InPanel<BButton>(panel, label));
	}

	// With the view selected anew, what is shown comes from the view.
	void SelectAgain()
	{
		Select(Root());
		Select(Sample());
	}

	// #pragma mark - menu bars

	BOutlineListView* Entries()
	{
		return ControlUser::All<BOutlineListView>(Panel("EditMenuBar"))[0];
	}

	static std::string TextOf(BListItem* entry) { return static_cast<BStringItem*>(entry)->Text(); }

	void ClickEntry(int32 index)
	{
		person.ClickEntry(Entries(), TextOf(Entries()->FullListItemAt(index)).c_str());
	}

	BMenuField* KindField() { return InPanel<BMenuField>("EditMenuBar", "", 1); }

	// Each entry gets a label that no other has.
	void ChangeEveryItem()
	{
		for (int32 i = 0; i < Entries()->FullListCountItems(); i++) {
			SCOPED_TRACE(i);
			ClickEntry(i);
			driver.Click(InPanel<BCheckBox>("EditMenuBar", "Enabled"));
			char code[8];
			snprintf(code, sizeof(code), "c%03d", static_cast<int>(i));
			person.TypeOver(Field("EditMenuBar", "Message: "), code);
			if (KindField()->Menu()->IsEnabled())
				person.Choose(KindField(), KindField()->Menu()->ItemAt(1 + i % 2)->Label());
			person.TypeOver(Field("EditMenuBar", "Label: "), "item " + std::to_string(i));
		}
	}

	// What the panel shows of each item; labels that are alike cannot be told from each other.
	std::vector<std::string> ShownItems()
	{
		std::vector<std::string> items;
		for (int32 i = 0; i < Entries()->FullListCountItems(); i++) {
			ClickEntry(i);
			BListItem* entry = Entries()->FullListItemAt(i);
			std::string text = std::to_string(entry->OutlineLevel()) + " " + TextOf(entry);
			text += std::string(" ") + Field("EditMenuBar", "Label: ")->Text();
			text += std::string(" ") + Field("EditMenuBar", "Message: ")->Text();
			BCheckBox* enabled = InPanel<BCheckBox>("EditMenuBar", "Enabled");
			text += enabled->Value() == B_CONTROL_OFF ? " off" : " on";
			if (KindField()->Menu()->IsEnabled())
				text += std::string(" ") + KindField()->Menu()->FindMarked()->Label();
			items.push_back(text);
		}
		return items;
	}

	// #pragma mark - tab views

	BTabView* Tabs() { return dynamic_cast<BTabView*>(Sample()); }

	void SelectTab(int32 index)
	{
		window.Locked([&] { Tabs()->Select(index); });
	}

	// A page can be told by its name.
	void NamePage(int32 index, const char* name)
	{
		SelectTab(index);
		Select(Tabs()->ViewForTab(index));
		person.TypeOver(Field("EditView", "Name: "), name);
		Select(Tabs());
	}

	std::string Pages()
	{
		std::string text;
		for (int32 i = 0; i < Tabs()->CountTabs(); i++) {
			text +=
				std::string(Tabs()->ViewForTab(i)->Name()) + "(" + Tabs()->TabAt(i)->Label() + ") ";
		}
		return text + std::to_string(Tabs()->Selection());
	}

	// #pragma mark - colours

	// Along the n-th of a colour control's ramps: grey, red, green, blue.
	void DragInRamp(const char* panel, int ramp, float to)
	{
		LiveColorControl* control = ControlUser::All<LiveColorControl>(Panel(panel))[0];
		const float y = 8 + 12 * static_cast<float>(ramp);
		driver.Drag(control, BPoint(20, y), control, BPoint(to, y));
	}

	void ChooseRole(const char* role) { driver.Click(InPanel<BRadioButton>("EditView", role)); }

	std::vector<std::string> ShownSwatches()
	{
		std::vector<std::string> colors;
		const BView* group = InPanel<BRadioButton>("EditView", "View")->Parent();
		for (BBox* swatch : ControlUser::All<BBox>(const_cast<BView*>(group)))
			colors.push_back(ColorsOf(swatch).substr(0, 6));
		return colors;
	}
};


} // namespace


TEST_F(CatalogueTrees, EveryItemOfAMenuBar)
{
	DragIn("BMenuBar");
	Select(Sample());
	const int32 before = Entries()->FullListCountItems();
	ClickEntry(0);
	Press("EditMenuBar", "Add Before");
	Press("EditMenuBar", "Add After");
	Press("EditMenuBar", "Add After");
	Press("EditMenuBar", "Add Submenu");
	Press("EditMenuBar", "Add After");
	Press("EditMenuBar", "Add Submenu");
	Press("EditMenuBar", "Add Before");
	Press("EditMenuBar", "Delete");
	SelectAgain();
	EXPECT_EQ(before + 6, Entries()->FullListCountItems());
	ChangeEveryItem();
	SelectAgain();
	const std::vector<std::string> changed = ShownItems();
	for (size_t i = 0; i < changed.size(); i++)
		EXPECT_NE(std::string::npos, changed[i].find("item " + std::to_string(i) + " ")) << i;

	SaveAndReopen();
	Select(Sample());
	EXPECT_EQ(changed, ShownItems());
}


TEST_F(CatalogueTrees, TheOrderOfTabs)
{
	DragIn("BTabView");
	Select(Tabs());
	while (Tabs()->CountTabs() < 5)
		Press("EditTabView", "insert");
	const char* kNames[] = { "A", "B", "C", "D", "E" };
	for (int32 i = 0; i < 5; i++)
		NamePage(i, kNames[i]);
	SelectTab(3);
	Press("EditTabView", "forward");
	EXPECT_EQ("A", Pages().substr(0, 1));
	SelectTab(0);
	Press("EditTabView", "backward");
	SelectTab(4);
	Press("EditTabView", "delete");
	std::string order;
	for (int32 i = 0; i < Tabs()->CountTabs(); i++)
		order += Tabs()->ViewForTab(i)->Name();
	EXPECT_EQ("BADC", order);
	const std::string changed = Pages();

	SaveAndReopen();
	EXPECT_EQ(changed, Pages());
}


TEST_F(CatalogueTrees, ColorsThatWereDraggedAndHandedDown)
{
	DragIn("BBox");
	Select(Sample());
	person.TypeOver(Field("EditView", "R:"), "600");
	person.TypeOver(Field("EditView", "B:"), "500");
	DragTo("BTextView", Sample()->Frame().LeftTop() + BPoint(20, 20));
	ASSERT_EQ(1, Sample()->CountChildren());
	Select(Sample());
	int ramp = 1;
	for (const char* role : { "View", "High", "Low" }) {
		ChooseRole(role);
		DragInRamp("EditView", ramp++, 150);
		Press("EditView", "Set Children");
	}
	const std::string own = ColorsOf(Sample());
	const std::string below = ColorsBelow(Sample());
	EXPECT_EQ(0u, below.find(own)); // the first child's
	ASSERT_EQ(21u, own.length());
	EXPECT_NE(own.substr(0, 7), own.substr(7, 7));
	EXPECT_NE(own.substr(7, 7), own.substr(14));
	SelectAgain();
	const std::vector<std::string> swatches = ShownSwatches();
	ASSERT_EQ(3u, swatches.size());

	SaveAndReopen();
	EXPECT_EQ(own, ColorsOf(Sample()));
	EXPECT_EQ(below, ColorsBelow(Sample()));
	Select(Sample());
	EXPECT_EQ(swatches, ShownSwatches());
}


TEST_F(CatalogueTrees, ColorsOfTheParentAndDefaults)
{
	DragIn("BView");
	Select(Sample());
	for (const char* role : { "View", "High", "Low" }) {
		ChooseRole(role);
		DragInRamp("EditView", 3, 120);
		Press("EditView", "Use Parent");
	}
	EXPECT_EQ(ColorsOf(Root()), ColorsOf(Sample()));
	ChooseRole("High");
	DragInRamp("EditView", 2, 90);
	ChooseRole("View");
	Press("EditView", "216 Gray");
	const std::string own = ColorsOf(Sample());
	EXPECT_EQ("d8d8d8 ", own.substr(0, 7));
	EXPECT_NE(ColorsOf(Root()).substr(7, 7), own.substr(7, 7));

	SaveAndReopen();
	EXPECT_EQ(own, ColorsOf(Sample()));
}


class CatalogueBars : public CatalogueTrees,
					  public testing::WithParamInterface<std::pair<const char*, const char*>> {};


TEST_P(CatalogueBars, ColorsThatWereDraggedAndTheDefault)
{
	const auto& [entry, panel] = GetParam();
	DragIn(entry);
	Select(Sample());
	for (const char* action : { "drag", "default" }) {
		SCOPED_TRACE(action);
		if (std::string(action) == "drag")
			DragInRamp(panel, 1, 170);
		else
			Press(panel, "Use Default");
		SelectAgain();
		LiveColorControl* control = ControlUser::All<LiveColorControl>(Panel(panel))[0];
		const rgb_color chosen = control->ValueAsColor();
		SaveAndReopen();
		Select(Sample());
		control = ControlUser::All<LiveColorControl>(Panel(panel))[0];
		const rgb_color again = control->ValueAsColor();
		EXPECT_EQ(chosen.red, again.red);
		EXPECT_EQ(chosen.green, again.green);
		EXPECT_EQ(chosen.blue, again.blue);
	}
}


INSTANTIATE_TEST_SUITE_P(Palette, CatalogueBars,
	testing::Values(
		std::make_pair("BSlider", "EditSlider"), std::make_pair("BStatusBar", "EditStatusBar")));


TEST_F(CatalogueTrees, FramesByTheButtons)
{
	DragIn("BButton");
	for (const char* button : { "preferred", "zoom" }) {
		Select(Sample());
		person.TypeOver(Field("EditView", "R:"), "420");
		const BRect before = Sample()->Frame();
		Press("EditView", button);
		const BRect frame = Sample()->Frame();
		EXPECT_NE(before, frame) << button;
		SaveAndReopen();
		EXPECT_EQ(frame, Sample()->Frame()) << button;
	}
}
