#include "ClassTable.h"

#include <algorithm>
#include <cstdlib>
#include <fstream>
#include <iterator>

#include <Application.h>
#include <gtest/gtest.h>

namespace {


constexpr const char* kTable = ARCHWAY_SOURCES "/docs/CLASSES.md";

const char* const kClasses[] = { "BView", "BControl", "BButton", "BCheckBox", "BRadioButton",
	"BPictureButton", "BTextControl", "BOptionControl", "BOptionPopUp", "BSlider",
	"BChannelControl", "BChannelSlider", "BColorControl", "BStatusBar", "BStringView", "BBox",
	"BTextView", "BScrollView", "BScrollBar", "BTabView", "BTab", "BListView", "BOutlineListView",
	"BListItem", "BStringItem", "BMenuField", "BMenu", "BMenuBar", "BPopUpMenu", "BMenuItem",
	"BSeparatorItem", "BSeparatorView", "BDragger", "BShelf", "BAlert", "BWindow", "BBitmap" };

const char* const kIntroduction =
	"# The classes of the Interface Kit\n"
	"\n"
	"This page is made by a program from the headers, the sources and the tests: run\n"
	"`ARCHWAY_UPDATE=1 build/bin/tests_house --gtest_filter=ClassTable.*` to make it anew; a test\n"
	"fails when it is out of date.\n"
	"\n"
	"- *Archive fields* are the class's own; those of its bases stand with them. *Read* and "
	"*written*\n"
	"  are taken from the sources. *Shown* is tried: whether a picture of an object changes with "
	"the\n"
	"  field; it is empty where the field has no look by itself (messages, items, lists).\n"
	"- *Calls* are the public and protected functions of the header. A hook counts as covered by "
	"a\n"
	"  test that makes the kit call it.\n"
	"- *Test* names the first test that covers it, the class's own before those of others, and "
	"how\n"
	"  many more there are.\n";


std::string
Shortened(const std::vector<std::string>& tests)
{
	if (tests.empty())
		return "";
	std::string text = tests[0];
	if (tests.size() > 1)
		text += " +" + std::to_string(tests.size() - 1);
	return text;
}


std::string
SectionOf(const KitClass& theClass, const std::vector<TestText>& tests)
{
	std::string text = "\n## " + theClass.name + "\n";
	if (!theClass.fields.empty())
		text += "\n| Archive field | Type | Read | Written | Shown | Test "
				"|\n|---|---|---|---|---|---|\n";
	for (const auto& [name, field] : theClass.fields) {
		text += "| `" + name + "` | " + field.type + " | " + (field.read ? "yes" : "") + " | "
			+ (field.written ? "yes" : "") + " | " + IsShown(theClass.name, name, field.type)
			+ " | " + Shortened(TestsOfField(tests, theClass, name)) + " |\n";
	}
	text += "\n| Call | Test |\n|---|---|\n";
	for (const std::string& call : theClass.calls)
		text += "| `" + call + "` | " + Shortened(TestsOfCall(tests, theClass, call)) + " |\n";
	return text;
}


std::string
MakeTable()
{
	const std::vector<TestText> tests = ReadTests();
	std::string text = kIntroduction;
	for (const char* name : kClasses)
		text += SectionOf(ReadClass(name), tests);
	return text;
}


} // namespace


TEST(ClassTable, IsUpToDate)
{
	BApplication application("application/x-vnd.Archway-test");
	const std::string table = MakeTable();
	if (getenv("ARCHWAY_UPDATE") != nullptr)
		std::ofstream(kTable, std::ios::binary) << table;
	std::ifstream file(kTable, std::ios::binary);
	const std::string committed { std::istreambuf_iterator<char>(file), {} };
	EXPECT_TRUE(committed == table) << "docs/CLASSES.md is out of date: make it anew with\n"
									   "ARCHWAY_UPDATE=1 tests_house --gtest_filter=ClassTable.*";
}


TEST(ClassTable, FindsCallsFieldsAndTests)
{
	const KitClass slider = ReadClass("BSlider");
	EXPECT_NE(slider.calls.end(),
		std::find(slider.calls.begin(), slider.calls.end(), "SetHashMarkCount"));
	EXPECT_EQ(slider.calls.end(), std::find(slider.calls.begin(), slider.calls.end(), "BSlider"));
	ASSERT_EQ(1u, slider.fields.count("_hashcount"));
	EXPECT_TRUE(slider.fields.at("_hashcount").read);
	EXPECT_TRUE(slider.fields.at("_hashcount").written);
	EXPECT_EQ("Int32", slider.fields.at("_hashcount").type);
	const std::vector<TestText> tests = {
		{ "Slider.Counts", "SliderTest", "slider->SetHashMarkCount(3); \"_min _hashcount\"" },
		{ "Other.Counts", "OtherTest", "BSlider x; x.SetHashMarkCount(4);" },
		{ "Other.IsElse", "OtherTest", "thing.SetHashMarkCount(4); _hashcount" },
	};
	EXPECT_EQ((std::vector<std::string> { "Slider.Counts", "Other.Counts" }),
		TestsOfCall(tests, slider, "SetHashMarkCount"));
	EXPECT_EQ(
		std::vector<std::string> { "Slider.Counts" }, TestsOfField(tests, slider, "_hashcount"));
}
