// Each entry of the palette, dragged into a design, saved, read back, and opened again.

#include <algorithm>

#include <gtest/gtest.h>

#include "scenarios/Archway.h"
#include "scenarios/ScratchFolder.h"
#include "tools/arcv/JsonValue.h"

namespace {


// Flags are those that the sample is made with and those that its class adds. The dropped view's
// middle is at 100, 50.
struct Entry {
	const char* name;
	std::vector<std::string> lines; // in this order, others may lie between
	const char* absent; // no line begins so
};

// Tests are listed by it.
void
PrintTo(const Entry& entry, std::ostream* stream)
{
	*stream << entry.name;
}


const std::string kYellow = "_color -13057"; // 255, 255, 204
const std::string kWhite = "_color -1";
const std::string kLeftTop = "_resize_mode 4626"; // 0x1212
const std::string kAllSides = "_resize_mode 4660"; // 0x1234
const std::string kLeftRightTop = "_resize_mode 4628"; // 0x1214
const std::string kSampleText =
	"Mark \"stylable,\" right-click here, then paste from StyleEdit application.";

const std::vector<Entry> kEntries = {
	{ "BView",
		{ "class BView", "_frame 68 34 132 66", kLeftTop, "_flags 536870912", "_color 255", kYellow,
			kYellow },
		"_name" },
	{ "BView (custom)",
		{ "_frame 68 34 132 66", kLeftTop, "_flags 536870912", kYellow, kYellow, "class MyBView",
			"class LayoutInheritedView" },
		"_name" },
	{ "BButton",
		{ "class BButton", kLeftTop, "_flags 570425344", kYellow, kYellow, "_msg clik",
			"_label button" },
		"_name" },
	{ "BStringView", { "class BStringView", kLeftTop, kYellow, kYellow, "_text String View" },
		"_name" },
	{ "BBox",
		{ "class BBox", "_frame 68 34 132 66", kLeftTop, "_flags 738197504", kYellow, kYellow },
		"_name" },
	{ "BCheckBox",
		{ "class BCheckBox", kLeftTop, "_flags 570425344", kYellow, kYellow, "_msg cbox",
			"_label checkbox" },
		"_name" },
	{ "BRadioButton",
		{ "class BRadioButton", kLeftTop, "_flags 570425344", kYellow, kYellow, "_msg rado",
			"_label radiobutton" },
		"_name" },
	{ "BStatusBar",
		{ "class BStatusBar", kYellow, kYellow, "_val 65", "_text Tolva.jpg", "_ttext 12",
			"_label Copying:", "_tlabel items remaining" },
		"_name" },
	{ "BTextControl",
		{ "class BTextControl", kLeftTop, kYellow, kYellow, "_views/class _BTextInput_",
			"_views/_text Hello!", "_msg tval", "_label Text:" },
		"_name" },
	{ "BSlider",
		{ "class BSlider", "_name ", kLeftTop, "_flags 637534208", kYellow, kYellow, "_msg sldr",
			"_label Toast:", "_minlbl light", "_maxlbl dark", "_min 0", "_max 99", "_hashcount 11",
			"_hashloc 2", "_sstyle 0" },
		"_views" },
	{ "BColorControl",
		{ "class BColorControl", "_name Quib", kYellow, kYellow, "_msg colr", "_layout 32",
			"_use_off false" },
		"_label" },
	{ "BTextView",
		{ "class BTextView", "_name ", kLeftTop, kYellow, kYellow, "_text " + kSampleText },
		"_views" },
	{ "BScrollView with BTextView",
		{ "class BScrollView", "_name ", kLeftTop, kYellow, kYellow, "_views/class BTextView",
			"_views/_name ", "_views/" + kAllSides, "_views/_text " + kSampleText,
			"_views/class BScrollBar", "_views/class BScrollBar" },
		"_label" },
	{ "BScrollView with BView",
		{ "class BScrollView", "_name ", kLeftTop, kYellow, kYellow, "_views/class BView",
			"_views/_frame 2 2 226 130", "_views/" + kAllSides, "_views/_flags 536870912",
			"_views/_color -855640833", "_views/_color -855640833", "_views/class BScrollBar",
			"_views/_range 0", "_views/_range 0", "_views/_steps 10", "_views/_steps 30",
			"_views/_prop 1", "_views/class BScrollBar", "_views/_range 0", "_views/_range 72",
			"_views/_steps 5", "_views/_steps 10", "_views/_prop 0.64" },
		"_label" },
	{ "BTabView",
		{ "class BTabView", "_name ", "_frame -28 -46 228 146", kAllSides, "_flags -1375731712",
			kWhite, kWhite, "_but_width 0", "_l_items/class BTab", "_l_items/class BTab",
			"_view_list/class BView", "_view_list/_name Tab 1", "_view_list/" + kAllSides,
			"_view_list/_flags 536870912", "_view_list/_color -1517313",
			"_view_list/_color -1517313", "_view_list/class BView", "_view_list/_name Tab 2" },
		"_label" },
	{ "BListView",
		{ "class BListView", "_name ", "_frame 36 -46 164 146", kLeftTop, kWhite, kWhite,
			"_lv_type 0" },
		"_l_items" },
	{ "BOutlineListView",
		{ "class BOutlineListView", "_name ", "_frame 36 -46 164 146", kLeftTop, kWhite, kWhite,
			"_lv_type 0" },
		"_l_items" },
	{ "BMenuField",
		{ "class BMenuField", "_name ", kLeftTop, kYellow, kYellow,
			"_views/_items/_label select...", "_views/_items/_submenu/_layout 1",
			"_views/_items/_submenu/_dyn_label true", "_views/_items/_submenu/_items/_label Snap",
			"_views/_items/_submenu/_items/_msg xxxx",
			"_views/_items/_submenu/_items/_label Crackel",
			"_views/_items/_submenu/_items/_msg xxxx", "_views/_items/_submenu/_items/_label Pop!",
			"_views/_items/_submenu/_items/_msg xxxx", "_label Sounds:", "_divide 40",
			"be:fixeds true" },
		"_disable" },
	{ "BMenuBar",
		{ "class BMenuBar", "_name ", "_frame 0 0", kLeftRightTop, kYellow, kYellow,
			"_rsize_to_fit true", "_items/_label File", "_items/_submenu/_layout 1",
			"_items/_submenu/_items/_label New", "_items/_submenu/_items/_msg xxxx",
			"_items/_submenu/_items/_label Open...", "_items/_submenu/_items/_label Save",
			"_items/_submenu/_items/_label Save As..", "_items/_submenu/_items/_label Close",
			"_items/_submenu/_items/_label Quit", "_items/_submenu/_items/_msg xxxx" },
		"_label" },
};


std::string
PlainNumber(std::string digits)
{
	if (digits.ends_with(".0"))
		digits.resize(digits.size() - 2);
	return digits;
}


std::string
TextOf(const JsonValue& value)
{
	if (value.kind == JsonValue::Kind::kNumber)
		return PlainNumber(value.text);
	std::string text = value.text;
	for (const JsonValue& item : value.items)
		text += (text.empty() ? "" : " ") + TextOf(item);
	return text;
}


// One line a value: its path and itself; of a nested message its code.
void
AddLines(const JsonValue& message, const std::string& path, std::vector<std::string>& lines)
{
	for (const JsonValue& field : message["fields"].items) {
		const std::string name = path + field["name"].text;
		for (const JsonValue& value : field["values"].items) {
			if (value.Find("fields") == nullptr) {
				lines.push_back(name + ' ' + TextOf(value));
				continue;
			}
			if (value.Find("code") != nullptr)
				lines.push_back(name + ' ' + value["code"].text);
			AddLines(value, name + '/', lines);
		}
	}
}


class PaletteEntries : public testing::TestWithParam<Entry> {};


} // namespace


TEST_P(PaletteEntries, AreSavedAsTheyWereMade)
{
	const Entry& entry = GetParam();
	const ScratchFolder folder;
	const std::string file = folder.Write("new.rsrc", "");
	const std::string open = "click window \"new.rsrc\" > item \"ARCV:1\" times 2\n"
							 "wait window \"ARCV 1\"\n";
	const ProgramResult made = PlayText("menu \"Resource\" \"New\" \"Archived Object\"\n" + open
			+ "drag window \"Widgets\" > item \"" + entry.name
			+ "\" to WorkView > \"The View\" at 100,50\nmenu \"File\" \"Save\"\n",
		file);
	ASSERT_EQ(0, made.status) << made.errors;

	const ProgramResult dump = ::Run({ ARCHWAY_BINARIES "/arcv", "dump", "--json", file });
	JsonValue json;
	ASSERT_TRUE(ParseJson(dump.output, &json)) << dump.errors;
	const std::string prefix = "_views/";
	std::vector<std::string> lines;
	AddLines(json["resources"].items.at(0)["message"], "", lines);
	auto at = lines.begin();
	for (const std::string& line : entry.lines) {
		const auto found = std::find_if(at, lines.end(),
			[&](const std::string& other) { return other.starts_with(prefix + line); });
		ASSERT_NE(lines.end(), found) << line << "\n" << testing::PrintToString(lines);
		at = found + 1;
	}
	for (const std::string& line : lines)
		EXPECT_FALSE(line.starts_with(prefix + entry.absent + ' ')) << line;

	// It is revived, and nothing of it changes.
	const std::string bytes = BytesOf(file);
	const ProgramResult shown = PlayText(open
			+ "expect WorkView > \"The View\" count 1\n"
			  "click WorkView > \"The View\" at 2,2\n"
			  "key s with Command\n",
		file);
	EXPECT_EQ(0, shown.status) << shown.errors;
	EXPECT_EQ(bytes, BytesOf(file));
}


INSTANTIATE_TEST_SUITE_P(Catalogue, PaletteEntries, testing::ValuesIn(kEntries));
