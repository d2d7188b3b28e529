// The commands of arcv as a person uses them.

#include <string.h>
#include <sys/stat.h>
#include <unistd.h>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <File.h>
#include <Message.h>
#include <MessageForm.h>
#include <Resources.h>

#include "JsonValue.h"
#include "Program.h"
#include "kits/storage/TemporaryFolder.h"

using testing::HasSubstr;
using testing::Not;

namespace {

const std::string kFolder = ARCHWAY_TEST_DATA "/resources/";
const std::string kDialog = kFolder + "23-dialog.rsrc";
const std::string kTypes = kFolder + "50-many-types.rsrc";


std::string
Flatten(const BMessage& message)
{
	std::string bytes(message.FlattenedSize(), '\0');
	EXPECT_EQ(B_OK, message.Flatten(bytes.data(), bytes.size()));
	return bytes;
}


// Twice two fields of one name, the second of which has that text.
BMessage
WithTwinFields(const char* text)
{
	BMessage inner;
	inner.AddBool("twin", true);
	inner.AddString("other", text);
	EXPECT_EQ(B_OK, inner.Rename("other", "twin"));
	BMessage message('ABCD');
	message.AddInt32("twin", 5);
	message.AddString("other", text);
	EXPECT_EQ(B_OK, message.Rename("other", "twin"));
	message.AddMessage("inner", &inner);
	return message;
}


// A copy of the dialog whose first archive has one field changed.
std::string
ChangedDialog(const TemporaryFolder& folder)
{
	const std::string path = folder / "changed.rsrc";
	WriteFile(path, ReadFile(kDialog));
	BResources resources(path.c_str());
	size_t size = 0;
	const char* name = NULL;
	resources.GetResourceInfo('ARCV', (int32)1, &name, &size);
	const std::string oldName(name);
	const char* data = static_cast<const char*>(resources.LoadResource('ARCV', (int32)1, &size));
	BMessage message;
	EXPECT_EQ(B_OK, message.Unflatten(data));
	BMessage child;
	EXPECT_EQ(B_OK, message.FindMessage("_views", 1, &child));
	child.ReplaceString("_name", "changed");
	child.AddInt32("added", 5);
	message.ReplaceMessage("_views", 1, &child);
	const std::string bytes = Flatten(message);
	resources.AddResource('ARCV', 1, bytes.data(), bytes.size(), oldName.c_str());
	return path;
}

} // namespace


TEST(Arcv, UsageIsExplained)
{
	EXPECT_EQ(2, RunArcv({}).status);
	EXPECT_EQ(2, RunArcv({ "nonsense" }).status);
	EXPECT_EQ(2, RunArcv({ "list" }).status);
	EXPECT_EQ(2, RunArcv({ "extract", kTypes, "nonsense" }).status);
	EXPECT_EQ(2, RunArcv({ "convert", "--form", "other", kTypes }).status);
	const ProgramResult help = RunArcv({ "--help" });
	EXPECT_EQ(0, help.status);
	for (const char* command : { "list", "dump", "check", "diff", "extract", "insert", "remove",
			 "convert", "rdef", "compile", "render" })
		EXPECT_THAT(help.output, HasSubstr(command));
}


TEST(Arcv, UnreadableFilesAreNamedWithTheReason)
{
	TemporaryFolder folder;
	const ProgramResult missing = RunArcv({ "list", folder / "none" });
	EXPECT_EQ(3, missing.status);
	EXPECT_EQ("arcv: " + (folder / "none") + ": there is no such file\n", missing.errors);
	EXPECT_EQ(3, RunArcv({ "list", folder.Path() }).status);
	WriteFile(folder / "text", "this is some text");
	const ProgramResult text = RunArcv({ "dump", folder / "text" });
	EXPECT_EQ(3, text.status);
	EXPECT_THAT(text.errors, HasSubstr("not a kind of file that holds resources (offset 0)"));
	std::string damaged = ReadFile(kDialog);
	damaged[damaged.size() - 7] ^= 1;
	WriteFile(folder / "damaged", damaged);
	const ProgramResult result = RunArcv({ "list", folder / "damaged" });
	EXPECT_EQ(3, result.status);
	EXPECT_THAT(result.errors,
		HasSubstr("checksum of the info table does not match (offset "
			+ std::to_string(damaged.size() - 8) + ")"));
	for (const char* command : { "dump", "rdef" })
		EXPECT_EQ(3, RunArcv({ command, folder / "damaged" }).status);
}


TEST(Arcv, ListShowsOneItemALine)
{
	const ProgramResult result = RunArcv({ "list", kFolder + "51-ids-and-names.rsrc" });
	EXPECT_EQ(0, result.status);
	EXPECT_EQ(8, std::count(result.output.begin(), result.output.end(), '\n'));
	EXPECT_THAT(result.output, HasSubstr("-2147483648"));
	EXPECT_THAT(result.output, HasSubstr("\"same name\""));
	WriteFile("/dev/null", "");
	const ProgramResult empty = RunArcv({ "list", "/dev/null" });
	EXPECT_EQ("", empty.output);
}


TEST(Arcv, AMessageIsDumpedAlone)
{
	TemporaryFolder folder;
	BMessage message('ABCD');
	message.AddString("text", "caf\xc3\xa9 \"x\"\n");
	message.AddData("bad", 'CSTR', "\xff", 2);
	message.AddFloat("f", 0.1f);
	message.AddFloat("f", -0.0f);
	message.AddBool("b", true);
	message.AddUInt64("u", UINT64_MAX);
	WriteFile(folder / "message", Flatten(message));
	const ProgramResult result = RunArcv({ "dump", "--json", folder / "message" });
	EXPECT_EQ(0, result.status);
	JsonValue json;
	ASSERT_TRUE(ParseJson(result.output, &json));
	EXPECT_EQ("1094861636", json["what"].text);
	EXPECT_EQ("ABCD", json["code"].text);
	const auto value = [&](size_t field, size_t index = 0) {
		return json["fields"].items[field]["values"].items[index];
	};
	EXPECT_EQ("caf\xc3\xa9 \"x\"\n", value(0).text);
	EXPECT_EQ("ff00", value(1)["hex"].text);
	EXPECT_EQ("0.1", value(2).text);
	EXPECT_EQ("-0.0", value(2, 1).text);
	EXPECT_EQ("true", value(3).text);
	EXPECT_EQ("18446744073709551615", value(4).text);

	const ProgramResult text = RunArcv({ "dump", folder / "message" });
	EXPECT_THAT(text.output, HasSubstr("FLOT f[1] = -0.0"));
	const std::string cut = Flatten(message).substr(0, 60);
	WriteFile(folder / "message", cut);
	const ProgramResult damaged = RunArcv({ "dump", "--json", folder / "message" });
	EXPECT_EQ(3, damaged.status);
	EXPECT_THAT(damaged.errors, HasSubstr("(offset "));
}


TEST(Arcv, CheckExplainsDamageAndSavesTheRest)
{
	TemporaryFolder folder;
	EXPECT_EQ(0, RunArcv({ "check", kDialog }).status);
	EXPECT_EQ("", RunArcv({ "check", kDialog }).output);

	const std::string whole = ReadFile(kTypes);
	WriteFile(folder / "cut", whole.substr(0, whole.size() - 40));
	const std::string before = ReadFile(folder / "cut");
	const ProgramResult result =
		RunArcv({ "check", folder / "cut", "--repair", folder / "repaired" });
	EXPECT_EQ(1, result.status);
	EXPECT_THAT(result.output, HasSubstr("the info table"));
	EXPECT_TRUE(before == ReadFile(folder / "cut"));
	EXPECT_EQ(0, RunArcv({ "check", folder / "repaired" }).status);
	const ProgramResult items = RunArcv({ "list", folder / "repaired" });
	EXPECT_THAT(items.output, HasSubstr("ARCV"));

	JsonValue json;
	ASSERT_TRUE(ParseJson(RunArcv({ "check", "--json", folder / "cut" }).output, &json));
	EXPECT_FALSE(json["findings"].items.empty());
	EXPECT_FALSE(json["items"].items.empty());

	EXPECT_EQ(3, RunArcv({ "check", folder / "cut", "--repair", folder / "cut" }).status);
	EXPECT_EQ(3, RunArcv({ "check", folder / "cut", "--repair", folder / "repaired" }).status);
	EXPECT_TRUE(before == ReadFile(folder / "cut"));
}


TEST(Arcv, CheckLooksIntoMessages)
{
	TemporaryFolder folder;
	const std::string path = folder / "file";
	WriteFile(path, "");
	BMessage message;
	message.AddString("text", "some text that can be cut");
	const std::string bytes = Flatten(message);
	{
		BResources resources(path.c_str());
		resources.AddResource('ARCV', 1, bytes.data(), bytes.size() - 9);
		resources.AddResource('ARCV', 2, "nonsense", 8);
		resources.AddResource('TEXT', 3, "nonsense", 8);
	}
	const ProgramResult result = RunArcv({ "check", path });
	EXPECT_EQ(1, result.status);
	EXPECT_THAT(result.output, HasSubstr("ARCV:1: "));
	EXPECT_THAT(result.output, HasSubstr("ARCV:2: this is no flattened message"));
	EXPECT_THAT(result.output, Not(HasSubstr("TEXT:3: ")));
}


TEST(Arcv, CheckSavesTheFieldsOfADamagedMessage)
{
	TemporaryFolder folder;
	BMessage message('test');
	message.AddString("text", "a text before the damage");
	message.AddInt32("number", 5);
	message.AddString("late", "a text that will be cut");
	const std::string bytes = Flatten(message);
	WriteFile(folder / "file", "");
	{
		BResources resources((folder / "file").c_str());
		resources.AddResource('ARCV', 1, bytes.data(), bytes.size() - 30, "panel");
		resources.AddResource('TEXT', 3, "some text", 9, "other");
	}
	const ProgramResult result =
		RunArcv({ "check", folder / "file", "--repair", folder / "repaired" });
	EXPECT_EQ(1, result.status) << result.errors;
	EXPECT_THAT(result.output, HasSubstr("ARCV:1: 2 fields can be read: text number\n"));
	EXPECT_EQ(0, RunArcv({ "check", folder / "repaired" }).status);
	BResources repaired((folder / "repaired").c_str());
	size_t size = 0;
	const void* data = repaired.LoadResource('ARCV', 1, &size);
	BMessage saved;
	ASSERT_EQ(B_OK, unflatten_message(&saved, data, size));
	EXPECT_STREQ("a text before the damage", saved.FindString("text"));
	EXPECT_EQ(5, saved.FindInt32("number"));
	EXPECT_TRUE(repaired.HasResource('TEXT', "other"));

	// The same of a file that is one message.
	WriteFile(folder / "message", bytes.substr(0, bytes.size() - 30));
	const ProgramResult alone =
		RunArcv({ "check", folder / "message", "--repair", folder / "message repaired" });
	EXPECT_EQ(1, alone.status) << alone.errors;
	EXPECT_THAT(alone.output, HasSubstr("2 fields can be read: text number\n"));
	EXPECT_EQ(0, RunArcv({ "check", folder / "message repaired" }).status);
	EXPECT_THAT(RunArcv({ "dump", folder / "message repaired" }).output, HasSubstr("number = 5"));
}


TEST(Arcv, OfTwinsBothAreShown)
{
	TemporaryFolder folder;
	const std::string twins = ARCHWAY_SOURCES "/tests/fuzz/seeds/ResourceFuzzer/made-x86-twins";
	const ProgramResult check = RunArcv({ "check", twins, "--repair", folder / "repaired" });
	EXPECT_EQ(1, check.status);
	EXPECT_THAT(check.output, HasSubstr("TWIN:1: there is one of this type and id already"));
	BResources repaired((folder / "repaired").c_str());
	size_t size = 0;
	const void* data = repaired.LoadResource('TWIN', 2, &size);
	ASSERT_NE(nullptr, data);
	EXPECT_EQ("the other", std::string(static_cast<const char*>(data), size));
	EXPECT_EQ(0, RunArcv({ "diff", twins, twins }).status);
	EXPECT_EQ(3, RunArcv({ "convert", "--form", "r5", twins, "-o", folder / "converted" }).status);
}


TEST(Arcv, DiffShowsTheFieldsThatDiffer)
{
	TemporaryFolder folder;
	const std::string changed = ChangedDialog(folder);
	EXPECT_EQ(0, RunArcv({ "diff", kDialog, kDialog }).status);
	const ProgramResult result = RunArcv({ "diff", kDialog, changed });
	EXPECT_EQ(1, result.status);
	EXPECT_THAT(result.output, HasSubstr("~ ARCV:1\n"));
	EXPECT_THAT(result.output, HasSubstr("    ~ _views[1]._name: "));
	EXPECT_THAT(result.output, HasSubstr("-> \"changed\"\n"));
	EXPECT_THAT(result.output, HasSubstr("    + _views[1].added = 5\n"));

	JsonValue json;
	ASSERT_TRUE(ParseJson(RunArcv({ "diff", "--json", kDialog, changed }).output, &json));
	const JsonValue& item = json["differences"].items[0];
	EXPECT_EQ("ARCV:1", item["item"].text);
	ASSERT_EQ(2u, item["fields"].items.size());
	EXPECT_EQ("_views[1]._name", item["fields"].items[0]["path"].text);
	EXPECT_EQ("changed", item["fields"].items[0]["new"].text);

	const ProgramResult git =
		RunArcv({ "diff", "--git", "panel.rsrc", kDialog, "1", "100644", changed, "2", "100644" });
	EXPECT_EQ(0, git.status);
	EXPECT_THAT(git.output, HasSubstr("panel.rsrc"));
	const ProgramResult added =
		RunArcv({ "diff", "--git", "panel.rsrc", "/dev/null", ".", ".", kDialog, "2", "100644" });
	EXPECT_THAT(added.output, HasSubstr("+ ARCV:1"));
}


TEST(Arcv, DiffMatchesViewsThatMoved)
{
	TemporaryFolder folder;
	BMessage panel;
	BMessage shorter;
	for (int i = 0; i < 5; i++) {
		BMessage view;
		view.AddString("class", "BView");
		view.AddString("_name", std::to_string(i).c_str());
		panel.AddMessage("_views", &view);
		if (i != 1)
			shorter.AddMessage("_views", &view);
	}
	WriteFile(folder / "a", Flatten(panel));
	WriteFile(folder / "b", Flatten(shorter));
	const ProgramResult result = RunArcv({ "diff", folder / "a", folder / "b" });
	EXPECT_EQ(1, result.status);
	EXPECT_THAT(result.output, HasSubstr("    - _views[1] = "));
	EXPECT_EQ(2, std::count(result.output.begin(), result.output.end(), '\n'));
}


TEST(Arcv, ItemsAreExtractedInsertedAndRemoved)
{
	TemporaryFolder folder;
	const std::string path = folder / "new.rsrc";
	WriteFile(folder / "data", "first");
	ASSERT_EQ(0, RunArcv({ "insert", path, "TEXT:1", folder / "data", "--name", "one" }).status);
	EXPECT_EQ("first", RunArcv({ "extract", path, "TEXT:1" }).output);
	const ProgramResult again = RunArcv({ "insert", path, "TEXT:1", folder / "data" });
	EXPECT_EQ(1, again.status);
	EXPECT_THAT(again.errors, HasSubstr("there already"));
	WriteFile(folder / "data", "2nd");
	ASSERT_EQ(0, RunArcv({ "insert", path, "0x41424344:-5", folder / "data" }).status);
	ASSERT_EQ(0, RunArcv({ "insert", path, "TEXT:1", folder / "data", "--replace" }).status);
	ASSERT_EQ(0, RunArcv({ "extract", path, "TEXT:1", "-o", folder / "out" }).status);
	EXPECT_EQ("2nd", ReadFile(folder / "out"));
	const std::string list = RunArcv({ "list", path }).output;
	EXPECT_THAT(list, HasSubstr("\"one\""));
	EXPECT_THAT(list, HasSubstr("ABCD"));

	EXPECT_EQ(1, RunArcv({ "extract", path, "TEXT:2" }).status);
	const std::string before = ReadFile(path);
	EXPECT_EQ(1, RunArcv({ "remove", path, "TEXT:1", "TEXT:2" }).status);
	EXPECT_TRUE(before == ReadFile(path));
	ASSERT_EQ(0, RunArcv({ "remove", path, "TEXT:1", "-o", folder / "less.rsrc" }).status);
	EXPECT_TRUE(before == ReadFile(path));
	EXPECT_THAT(RunArcv({ "list", folder / "less.rsrc" }).output, Not(HasSubstr("TEXT")));
	EXPECT_EQ(4u, folder.Count());
}


TEST(Arcv, ConvertChangesTheFormOnly)
{
	TemporaryFolder folder;
	const std::string copy = folder / "copy";
	WriteFile(copy, ReadFile(kTypes));
	ASSERT_EQ(0, RunArcv({ "convert", "--form", "haiku", copy }).status);
	const std::string list = RunArcv({ "list", copy }).output;
	EXPECT_THAT(list, Not(HasSubstr(" r5 ")));
	EXPECT_THAT(list, HasSubstr(" haiku "));
	EXPECT_THAT(RunArcv({ "diff", kTypes, copy }).output, Not(HasSubstr("    ")));
}


TEST(Arcv, FieldsOfOneNameAreKeptApart)
{
	TemporaryFolder folder;
	WriteFile(folder / "message", Flatten(WithTwinFields("second")));
	WriteFile(folder / "other", Flatten(WithTwinFields("changed")));
	EXPECT_EQ("what ABCD\nLONG twin = 5\nCSTR twin = \"second\"\nMSGG inner\n"
			  "  BOOL twin = true\n  CSTR twin = \"second\"\n",
		RunArcv({ "dump", folder / "message" }).output);
	JsonValue json;
	ASSERT_TRUE(ParseJson(RunArcv({ "dump", "--json", folder / "message" }).output, &json));
	EXPECT_EQ("5", json["fields"].items[0]["values"].items[0].text);
	EXPECT_EQ("second", json["fields"].items[1]["values"].items[0].text);

	EXPECT_EQ(0, RunArcv({ "diff", folder / "message", folder / "message" }).status);
	const ProgramResult diff = RunArcv({ "diff", folder / "message", folder / "other" });
	EXPECT_EQ(1, diff.status);
	EXPECT_THAT(diff.output, HasSubstr("twin#2: \"second\" -> \"changed\""));
	EXPECT_THAT(diff.output, HasSubstr("inner.twin#2: \"second\" -> \"changed\""));
	EXPECT_THAT(diff.output, Not(HasSubstr("twin: ")));
	const ProgramResult check = RunArcv({ "check", folder / "message" });
	EXPECT_EQ(1, check.status);
	EXPECT_THAT(check.output, HasSubstr("several fields have the name \"twin\""));
}


TEST(Arcv, FieldsOfOneNameGoThroughEveryForm)
{
	TemporaryFolder folder;
	const std::string bytes = Flatten(WithTwinFields("second"));
	const std::string file = folder / "file.rsrc";
	{
		BFile made(file.c_str(), B_READ_WRITE | B_CREATE_FILE);
		BResources resources(&made, true);
		resources.AddResource('ARCV', 1, bytes.data(), bytes.size(), "twins");
	}
	const std::string text = RunArcv({ "rdef", file }).output;
	WriteFile(folder / "text", text);
	ASSERT_EQ(0, RunArcv({ "compile", folder / "text", "-o", folder / "compiled" }).status);
	EXPECT_EQ(0, RunArcv({ "diff", file, folder / "compiled" }).status);
	const auto item = [](const std::string& path) {
		BResources resources(path.c_str());
		size_t size = 0;
		const void* data = resources.LoadResource('ARCV', 1, &size);
		return std::string(static_cast<const char*>(data), size);
	};
	EXPECT_TRUE(bytes == item(folder / "compiled"));
	ASSERT_EQ(0, RunArcv({ "convert", "--form", "haiku", file }).status);
	EXPECT_FALSE(bytes == item(file));
	ASSERT_EQ(0, RunArcv({ "convert", "--form", "r5", file }).status);
	EXPECT_TRUE(bytes == item(file));
}


TEST(Arcv, CompileReportsWhereTheTextIsWrong)
{
	TemporaryFolder folder;
	WriteFile(folder / "text", "resource(1)\n  nonsense;\n");
	const ProgramResult result = RunArcv({ "compile", folder / "text", "-o", folder / "out" });
	EXPECT_EQ(3, result.status);
	EXPECT_EQ(
		"arcv: " + (folder / "text") + ": line 2: \"nonsense\" is neither a type nor a symbol\n",
		result.errors);
	EXPECT_FALSE(std::filesystem::exists(folder / "out"));

	WriteFile(folder / "text", "resource(1) 5;");
	ASSERT_EQ(0, RunArcv({ "compile", folder / "text", "-o", folder / "out" }).status);
	WriteFile(folder / "text", "resource(2) 6;");
	ASSERT_EQ(0, RunArcv({ "compile", folder / "text", "-o", folder / "out", "--merge" }).status);
	EXPECT_EQ("\nresource(1) 5;\n\nresource(2) 6;\n", RunArcv({ "rdef", folder / "out" }).output);
	ASSERT_EQ(0, RunArcv({ "compile", folder / "text", "-o", folder / "out" }).status);
	EXPECT_EQ("\nresource(2) 6;\n", RunArcv({ "rdef", folder / "out" }).output);
}


TEST(Arcv, AReadOnlyFileIsLeftAlone)
{
	if (geteuid() == 0)
		GTEST_SKIP() << "nothing is read-only for this user";
	TemporaryFolder folder;
	const std::string path = folder / "file";
	WriteFile(path, ReadFile(kDialog));
	chmod(path.c_str(), 0444);
	const ProgramResult result = RunArcv({ "remove", path, "ARCV:1" });
	EXPECT_EQ(3, result.status);
	EXPECT_THAT(result.errors, HasSubstr("permission denied"));
	EXPECT_TRUE(ReadFile(kDialog) == ReadFile(path));
}
