// Every kind of view of the palette: dragged in, changed in every property by mouse and keys, closed,
// saved and opened again.

#include "CatalogueFixture.h"

#include <algorithm>
#include <map>
#include <set>

#include <Box.h>
#include <Button.h>
#include <CheckBox.h>
#include <MenuField.h>
#include <MenuItem.h>
#include <OutlineListView.h>
#include <RadioButton.h>

#include "editors/FloatControl.h"
#include "editors/IntControl.h"
#include "editors/LiveColorControl.h"

namespace {


// What is entered in the field with that label; into the others goes "changed".
const std::map<std::string, std::string> kEntries = { { "L:", "50" }, { "T:", "60" },
	{ "R:", "350" }, { "B:", "300" }, { "Size: ", "13" }, { "Shear: ", "100" },
	{ "Rotation: ", "15" }, { "Pen size: ", "2.5" }, { "Message: ", "qwer" }, { "Value: ", "1" },
	{ "Value:", "40" }, { "Max:", "200" }, { "Bar height:", "23" }, { "Divider:", "45" },
	{ "Invocation message:", "asdf" }, { "Max bytes:", "900" }, { "Tab width:", "55" },
	{ "Snooze:", "25000" }, { "Min Value:", "-2" }, { "Max Value:", "77" },
	{ "Key Increment:", "4" }, { "Num Hash Marks:", "7" }, { "Total width:", "600" },
	{ "Total height:", "500" }, { "Small step:", "3" }, { "Big step:", "33" },
	{ "Cell size:", "9" }, { "Tab height:", "31" }, { "Select Message:", "zxcv" },
	{ "Invoke Message:", "poiu" } };

// Where the next item of the menu would not do.
const std::map<std::string, std::string> kChoices = { { "Flags:", "B_PULSE_NEEDED" },
	{ "Font:", "Liberation Mono" }, { "Cell layout:", "B_CELLS_8x32" }, { "Offscreen:", "B_RGB16" },
	{ "Border style:", "B_PLAIN_BORDER" } };

// A text control has no value, the low byte of a colour is none, and a text view scrolls by lines.
const std::set<std::string> kKeepTheirValue = { "BTextControl EditControl/Value:  0",
	"BColorControl EditControl/Value:  0",
	"BScrollView with BTextView EditScrollView/Small step: 1" };
// That a text view is resizable is not archived.
const std::set<std::string> kAreNotArchived = { "BTextView EditTextView/Resizable 0" };

// A scroll view keeps one bar; without any its steps and totals are not there to be changed. A
// rebuilt one follows nothing, and so the first of the resizing modes is the next.
constexpr const char* kKeptBox = "Vertical";
const std::set<std::string> kKeptByScrollViews = { "EditScrollView/Vertical 0",
	"EditView/Resizing: 0", "EditView/Resizing: 1" };

constexpr const char* kComponents[] = { "Red:", "Green:", "Blue:" };

// What the panels show, by "panel/label number".
typedef std::map<std::string, std::string> State;


class CatalogueTest : public CatalogueFixture, public testing::WithParamInterface<const char*> {
protected:
	// The view, and in a menu bar its first item.
	void SelectSample()
	{
		Select(Sample());
		if (BView* panel = Panel("EditMenuBar"))
			driver.Click(ControlUser::All<BOutlineListView>(panel)[0], BPoint(100, 6));
	}

	std::vector<EditorInterface*> Panels() { return ControlUser::All<EditorInterface>(Column()); }

	// Calls the function with every control of the panels and what names it.
	template<class Control, class Function> void ForEach(const Function& function)
	{
		for (EditorInterface* panel : Panels()) {
			std::map<std::string, int> counts;
			for (Control* control : ControlUser::All<Control>(panel)) {
				const std::string label = control->Label() != nullptr ? control->Label() : "";
				const int n = counts[label]++;
				function(
					std::string(panel->Name()) + "/" + label + " " + std::to_string(n), control);
			}
		}
	}

	State Shown()
	{
		State state;
		ForEach<BTextControl>([&](const std::string& name, BTextControl* field) {
			if (dynamic_cast<LiveColorControl*>(field->Parent()) == nullptr)
				state[name] = field->Text();
		});
		ForEach<BCheckBox>([&](const std::string& name, BCheckBox* box) {
			state[name] = box->Value() != B_CONTROL_OFF ? "on" : "off";
		});
		ForEach<BMenuField>([&](const std::string& name, BMenuField* field) {
			state[name] = field->MenuItem()->Label();
		});
		int swatches = 0;
		ForEach<BBox>([&](const std::string& name, BBox* box) {
			// Swatches stand in a group; a panel's own boxes are lines.
			if (dynamic_cast<EditorInterface*>(box->Parent()) != nullptr)
				return;
			const rgb_color color = box->ViewColor();
			char text[16];
			snprintf(text, sizeof(text), "%02x%02x%02x", color.red, color.green, color.blue);
			state[name + "swatch " + std::to_string(swatches++)] = text;
		});
		return state;
	}

	void ChangeFields(EditorInterface* panel)
	{
		for (BTextControl* field : ControlUser::All<BTextControl>(panel)) {
			if (!field->IsEnabled() || dynamic_cast<LiveColorControl*>(field->Parent()) != nullptr)
				continue;
			const auto entry = kEntries.find(field->Label());
			person.TypeOver(field, entry != kEntries.end() ? entry->second : "changed");
		}
	}

	void ChangeMenus(EditorInterface* panel)
	{
		for (BMenuField* field : ControlUser::All<BMenuField>(panel)) {
			BMenu* menu = field->Menu();
			if (!menu->IsEnabled())
				continue;
			const auto choice = kChoices.find(field->Label());
			const int32 next = (menu->IndexOf(menu->FindMarked()) + 1) % menu->CountItems();
			person.Choose(field,
				choice != kChoices.end() ? choice->second.c_str() : menu->ItemAt(next)->Label());
		}
	}

	void TypeColor(EditorInterface* panel, const char* first)
	{
		for (const char* component : kComponents) {
			if (BTextControl* field = ControlUser::Find<BTextControl>(panel, component))
				person.TypeOver(field, first);
		}
	}

	void ChangeColors(EditorInterface* panel)
	{
		const std::vector<BRadioButton*> roles = ControlUser::All<BRadioButton>(panel);
		if (roles.empty())
			TypeColor(panel, "77");
		for (size_t i = 0; i < roles.size(); i++) {
			driver.Click(roles[i]);
			TypeColor(panel, std::to_string(10 + 20 * i).c_str());
		}
	}

	// The view panel comes last: what the others do to the view may move it.
	void ChangeEverything()
	{
		if (BButton* insert = ControlUser::Find<BButton>(Column(), "insert"))
			driver.Click(insert);
		std::vector<EditorInterface*> panels = Panels();
		std::rotate(panels.begin(), panels.begin() + 1, panels.end());
		for (EditorInterface* panel : panels) {
			ChangeMenus(panel);
			ChangeFields(panel);
			ChangeColors(panel);
			for (BCheckBox* box : ControlUser::All<BCheckBox>(panel)) {
				if (std::string(box->Label()) != kKeptBox)
					driver.Click(box);
			}
		}
	}
};


} // namespace


TEST_P(CatalogueTest, EveryChangeIsSavedAndShownAgain)
{
	DragIn(GetParam());
	SelectSample();
	const State before = Shown();
	ChangeEverything();
	Select(Root());
	SelectSample();
	const State changed = Shown();
	for (const auto& [name, value] : changed) {
		if (kKeepTheirValue.count(GetParam() + (" " + name)) == 0
			&& (Panel("EditScrollView") == nullptr || kKeptByScrollViews.count(name) == 0))
			EXPECT_NE(before.at(name), value) << name;
	}
	Close();

	Open(Saved());
	SelectSample();
	const State again = Shown();
	ASSERT_EQ(changed.size(), again.size());
	for (const auto& [name, value] : changed) {
		if (kAreNotArchived.count(GetParam() + (" " + name)) == 0)
			EXPECT_EQ(value, again.at(name)) << name;
	}
	const std::string saved = Bytes(item);
	Close();
	EXPECT_EQ(saved, Bytes(item));
}


INSTANTIATE_TEST_SUITE_P(Palette, CatalogueTest,
	testing::Values("BView", "BView (custom)", "BBox", "BStringView", "BButton", "BCheckBox",
		"BRadioButton", "BTextControl", "BSlider", "BColorControl", "BMenuField", "BStatusBar",
		"BTextView", "BScrollView with BView", "BScrollView with BTextView", "BTabView",
		"BListView", "BOutlineListView", "BMenuBar"));
