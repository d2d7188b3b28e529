// arcv against the reference dumps of all sample files.

#include <stdlib.h>
#include <string.h>

#include <filesystem>
#include <map>

#include <gtest/gtest.h>

#include <Resources.h>

#include "CanonicalDump.h"
#include "JsonValue.h"
#include "Program.h"
#include "kits/storage/TemporaryFolder.h"
#include "tools/arcv/TypeCode.h"

namespace {

struct Sample {
	std::string file;
	std::string dump;
};


std::vector<Sample>
Samples()
{
	std::vector<Sample> samples;
	const std::string folder = SamplesFolder();
	for (const char* part : { "/views", "/wild" }) {
		if (folder.empty() || !std::filesystem::exists(folder + part))
			continue;
		for (const auto& entry : std::filesystem::directory_iterator(folder + part)) {
			const std::string path = entry.path().string();
			if (entry.path().extension() == ".rsrc")
				samples.push_back({ path, path.substr(0, path.size() - 5) + ".txt" });
			else if (entry.path().extension() == ".bin")
				samples.push_back({ path, path + ".txt" });
		}
	}
	return samples;
}


type_code
TypeOf(const std::string& text)
{
	type_code type = 0;
	EXPECT_TRUE(Arcv::ParseType(text, &type));
	return type;
}


std::string
BytesOf(BResources& resources, type_code type, int32 id)
{
	size_t size = 0;
	const void* data = resources.LoadResource(type, id, &size);
	return data != NULL ? std::string(static_cast<const char*>(data), size) : "(none)";
}


template<typename Number>
std::string
BytesOf(Number number)
{
	return std::string(reinterpret_cast<const char*>(&number), sizeof(number));
}


double
RealOf(const JsonValue& value)
{
	return strtod(value.text.c_str(), NULL);
}


// The bytes that a JSON value stands for. `size` is that of the reference: some types have two.
std::string
ValueBytes(const std::string& type, const JsonValue& value, size_t size)
{
	if (const JsonValue* hex = value.Find("hex")) {
		std::string bytes;
		for (size_t i = 0; i + 1 < hex->text.size(); i += 2)
			bytes += static_cast<char>(strtoul(hex->text.substr(i, 2).c_str(), NULL, 16));
		return bytes;
	}
	if (type == "CSTR")
		return value.text + '\0';
	if (type == "BOOL")
		return std::string(1, value.text == "true");
	if (type == "DBLE")
		return BytesOf(RealOf(value));
	if (type == "FLOT")
		return BytesOf(static_cast<float>(RealOf(value)));
	std::string bytes;
	if (type == "RECT" || type == "BPNT" || type == "SIZE") {
		for (const JsonValue& item : value.items)
			bytes += BytesOf(static_cast<float>(RealOf(item)));
		return bytes;
	}
	if (type == "RGBC" || type == "RGBB") {
		for (const JsonValue& item : value.items)
			bytes += static_cast<char>(atoi(item.text.c_str()));
		return bytes;
	}
	const bool negative = value.text[0] == '-';
	const uint64_t number =
		negative ? strtoll(value.text.c_str(), NULL, 10) : strtoull(value.text.c_str(), NULL, 10);
	return BytesOf(number).substr(0, size);
}


void
ExpectMessage(const DumpMessage& expected, const JsonValue& json)
{
	EXPECT_EQ(std::to_string(expected.what), json["what"].text);
	const std::vector<JsonValue>& fields = json["fields"].items;
	ASSERT_EQ(expected.fields.size(), fields.size());
	for (size_t i = 0; i < fields.size(); i++) {
		const DumpField& field = expected.fields[i];
		EXPECT_EQ(field.name, fields[i]["name"].text);
		EXPECT_EQ(field.type, fields[i]["type"].text);
		const std::vector<JsonValue>& values = fields[i]["values"].items;
		ASSERT_EQ(field.entries.size(), values.size()) << field.name;
		for (size_t j = 0; j < values.size(); j++) {
			const DumpEntry& entry = field.entries[j];
			if (entry.message != nullptr)
				ExpectMessage(*entry.message, values[j]);
			else
				EXPECT_EQ(entry.bytes, ValueBytes(field.type, values[j], entry.bytes.size()))
					<< field.name << " " << j << " " << values[j].text;
			if (testing::Test::HasFailure())
				return;
		}
	}
}


void
ExpectDump(const std::vector<DumpResource>& expected, const JsonValue& json)
{
	const std::vector<JsonValue>& resources = json["resources"].items;
	ASSERT_EQ(expected.size(), resources.size());
	for (size_t i = 0; i < resources.size(); i++) {
		SCOPED_TRACE(expected[i].type + ":" + std::to_string(expected[i].id));
		EXPECT_EQ(expected[i].type, resources[i]["type"].text);
		EXPECT_EQ(std::to_string(expected[i].id), resources[i]["id"].text);
		EXPECT_EQ(expected[i].name, resources[i]["name"].text);
		EXPECT_EQ(std::to_string(expected[i].size), resources[i]["size"].text);
		const JsonValue* message = resources[i].Find("message");
		ASSERT_EQ(expected[i].message != nullptr, message != nullptr);
		if (message != nullptr)
			ExpectMessage(*expected[i].message, *message);
	}
}

} // namespace


TEST(ArcvSamples, DumpAgreesWithTheReference)
{
	const std::vector<Sample> samples = Samples();
	if (samples.empty())
		GTEST_SKIP() << "ARCHWAY_SAMPLES is not set";
	for (const Sample& sample : samples) {
		SCOPED_TRACE(sample.file);
		std::vector<DumpResource> expected;
		ASSERT_TRUE(ReadCanonicalDump(sample.dump, &expected));
		const ProgramResult result = RunArcv({ "dump", "--json", sample.file });
		EXPECT_EQ(0, result.status) << result.errors;
		JsonValue json;
		ASSERT_TRUE(ParseJson(result.output, &json));
		ExpectDump(expected, json);
		if (HasFailure())
			return;
	}
}


TEST(ArcvSamples, ListAgreesWithTheReference)
{
	const std::vector<Sample> samples = Samples();
	if (samples.empty())
		GTEST_SKIP() << "ARCHWAY_SAMPLES is not set";
	for (const Sample& sample : samples) {
		SCOPED_TRACE(sample.file);
		std::vector<DumpResource> expected;
		ASSERT_TRUE(ReadCanonicalDump(sample.dump, &expected));
		const ProgramResult result = RunArcv({ "list", "--json", sample.file });
		JsonValue json;
		ASSERT_TRUE(ParseJson(result.output, &json));
		const std::vector<JsonValue>& resources = json["resources"].items;
		ASSERT_EQ(expected.size(), resources.size());
		for (size_t i = 0; i < resources.size(); i++) {
			EXPECT_EQ(expected[i].name, resources[i]["name"].text);
			EXPECT_EQ(std::to_string(expected[i].size), resources[i]["size"].text);
			const std::string form = expected[i].format.substr(0, expected[i].format.find('-'));
			EXPECT_EQ(form, resources[i]["form"].text.substr(0, form.size()));
		}
	}
}


TEST(ArcvSamples, NothingIsWrongWithThem)
{
	const std::vector<Sample> samples = Samples();
	if (samples.empty())
		GTEST_SKIP() << "ARCHWAY_SAMPLES is not set";
	for (const Sample& sample : samples) {
		const ProgramResult result = RunArcv({ "check", sample.file });
		EXPECT_EQ(0, result.status) << sample.file << "\n" << result.output << result.errors;
	}
}


TEST(ArcvSamples, CompilingTheTextGivesTheSameItems)
{
	const std::vector<Sample> samples = Samples();
	if (samples.empty())
		GTEST_SKIP() << "ARCHWAY_SAMPLES is not set";
	TemporaryFolder folder;
	for (const Sample& sample : samples) {
		SCOPED_TRACE(sample.file);
		ASSERT_EQ(0, RunArcv({ "rdef", sample.file, "-o", folder / "text" }).status);
		const ProgramResult compiled =
			RunArcv({ "compile", folder / "text", "-o", folder / "file.rsrc" });
		ASSERT_EQ(0, compiled.status) << compiled.errors;

		// The reference knows the fields' order too, which a diff would only mention.
		std::vector<DumpResource> expected;
		ASSERT_TRUE(ReadCanonicalDump(sample.dump, &expected));
		JsonValue json;
		ASSERT_TRUE(ParseJson(RunArcv({ "dump", "--json", folder / "file.rsrc" }).output, &json));
		for (size_t i = 0; i < expected.size(); i++) {
			const std::string size = json["resources"].items[i]["size"].text;
			if (expected[i].message != nullptr)
				expected[i].size = strtoull(size.c_str(), NULL, 10); // the form is another
		}
		ExpectDump(expected, json);
		BResources original(sample.file.c_str());
		BResources copy((folder / "file.rsrc").c_str());
		for (const DumpResource& resource : expected) {
			if (resource.message != nullptr)
				continue;
			const type_code type = TypeOf(resource.type);
			EXPECT_TRUE(BytesOf(original, type, resource.id) == BytesOf(copy, type, resource.id))
				<< resource.type << resource.id;
		}
		if (HasFailure())
			return;
	}
}


TEST(ArcvSamples, TextsOfOtherCompilersGiveWhatTheyMade)
{
	int count = 0;
	TemporaryFolder folder;
	for (const Sample& sample : Samples()) {
		const std::string text = sample.file.substr(0, sample.file.rfind('.')) + ".rdef";
		if (!std::filesystem::exists(text))
			continue;
		SCOPED_TRACE(text);
		const ProgramResult compiled =
			RunArcv({ "compile", text, "-o", folder / "file.rsrc", "--form", "haiku" });
		ASSERT_EQ(0, compiled.status) << compiled.errors;
		std::vector<DumpResource> expected;
		ASSERT_TRUE(ReadCanonicalDump(sample.dump, &expected));
		JsonValue json;
		ASSERT_TRUE(ParseJson(RunArcv({ "dump", "--json", folder / "file.rsrc" }).output, &json));
		for (size_t i = 0; i < expected.size(); i++) {
			if (expected[i].message != nullptr) // fixed sizes take fewer bytes
				expected[i].size =
					strtoull(json["resources"].items[i]["size"].text.c_str(), NULL, 10);
		}
		ExpectDump(expected, json);
		count++;
	}
	if (count == 0)
		GTEST_SKIP() << "ARCHWAY_SAMPLES is not set";
	EXPECT_GE(count, 9);
}


TEST(ArcvSamples, RewritingThemChangesNoItem)
{
	const std::vector<Sample> samples = Samples();
	if (samples.empty())
		GTEST_SKIP() << "ARCHWAY_SAMPLES is not set";
	TemporaryFolder folder;
	WriteFile(folder / "data", "some bytes");
	for (const Sample& sample : samples) {
		SCOPED_TRACE(sample.file);
		const std::string copy = folder / "copy";
		ASSERT_EQ(
			0, RunArcv({ "insert", sample.file, "ZZZZ:77", folder / "data", "-o", copy }).status);
		EXPECT_EQ("+ ZZZZ:77: \"\", 10 bytes\n", RunArcv({ "diff", sample.file, copy }).output);
		ASSERT_EQ(0, RunArcv({ "remove", copy, "ZZZZ:77" }).status);
		const ProgramResult same = RunArcv({ "diff", sample.file, copy });
		EXPECT_EQ(0, same.status) << same.output;
		unlink(copy.c_str());
	}
}


TEST(ArcvSamples, ConvertingThereAndBackLosesNothing)
{
	const std::vector<Sample> samples = Samples();
	if (samples.empty())
		GTEST_SKIP() << "ARCHWAY_SAMPLES is not set";
	TemporaryFolder folder;
	for (const Sample& sample : samples) {
		SCOPED_TRACE(sample.file);
		const std::string r5 = folder / "r5";
		const std::string haiku = folder / "haiku";
		ASSERT_EQ(0, RunArcv({ "convert", "--form", "r5", sample.file, "-o", r5 }).status);
		ASSERT_EQ(0, RunArcv({ "convert", "--form", "haiku", r5, "-o", haiku }).status);
		ASSERT_EQ(0, RunArcv({ "convert", "--form", "r5", haiku }).status);
		std::vector<DumpResource> expected;
		ASSERT_TRUE(ReadCanonicalDump(sample.dump, &expected));
		JsonValue json;
		ASSERT_TRUE(ParseJson(RunArcv({ "dump", "--json", haiku }).output, &json));
		for (size_t i = 0; i < expected.size(); i++) {
			if (expected[i].message != nullptr)
				expected[i].size =
					strtoull(json["resources"].items[i]["size"].text.c_str(), NULL, 10);
		}
		ExpectDump(expected, json);
		unlink(r5.c_str());
		unlink(haiku.c_str());
	}
}
