#include "scenarios/Differences.h"

#include <algorithm>

#include <gtest/gtest.h>

#include "scenarios/Program.h"
#include "tools/arcv/JsonValue.h"

namespace {


using Differences = std::map<std::string, std::string>;


JsonValue
Dump(const std::string& path)
{
	const ProgramResult result = Run({ ARCHWAY_BINARIES "/arcv", "dump", "--json", path });
	JsonValue value;
	EXPECT_EQ(0, result.status) << result.errors;
	EXPECT_TRUE(ParseJson(result.output, &value)) << path;
	return value;
}


std::string
TextOf(const JsonValue& value)
{
	std::string text;
	for (size_t i = 0; i < value.items.size(); i++) {
		text += text.empty() ? "" : ",";
		if (value.kind == JsonValue::Kind::kObject)
			text += value.names[i] + ':';
		text += TextOf(value.items[i]);
	}
	switch (value.kind) {
		case JsonValue::Kind::kArray:
			return '[' + text + ']';
		case JsonValue::Kind::kObject:
			return '{' + text + '}';
		case JsonValue::Kind::kNull:
			return "null";
		default:
			return value.text;
	}
}


void CompareMessages(const JsonValue& before, const JsonValue& after, const std::string& path,
	Differences& differences);


void
CompareValues(const JsonValue& before, const JsonValue& after, const std::string& path,
	Differences& differences)
{
	if (before.Find("fields") != nullptr && after.Find("fields") != nullptr)
		CompareMessages(before, after, path, differences);
	else if (TextOf(before) != TextOf(after))
		differences[path] = TextOf(after);
}


void
CompareFields(const JsonValue& before, const JsonValue& after, const std::string& path,
	Differences& differences)
{
	const JsonValue& from = before["values"];
	const JsonValue& to = after["values"];
	if (before["type"].text != after["type"].text || from.items.size() != to.items.size()) {
		differences[path] = after["type"].text + TextOf(to);
		return;
	}
	const bool isSingle = from.items.size() == 1 && from.items[0].Find("fields") == nullptr;
	for (size_t i = 0; i < from.items.size(); i++) {
		const std::string index = isSingle ? "" : '[' + std::to_string(i) + ']';
		CompareValues(from.items[i], to.items[i], path + index, differences);
	}
}


const JsonValue*
FieldNamed(const JsonValue& fields, const std::string& name)
{
	const auto found = std::find_if(fields.items.begin(), fields.items.end(),
		[&](const JsonValue& field) { return field["name"].text == name; });
	return found != fields.items.end() ? &*found : nullptr;
}


std::string
NamesOf(const JsonValue& fields, const JsonValue& others)
{
	std::string names;
	for (const JsonValue& field : fields.items) {
		if (FieldNamed(others, field["name"].text) != nullptr)
			names += field["name"].text + ' ';
	}
	return names;
}


// The fields that both have must also be in the same order.
void
CompareMessages(const JsonValue& before, const JsonValue& after, const std::string& path,
	Differences& differences)
{
	if (before["what"].text != after["what"].text)
		differences[path + "/what"] = after["what"].text;
	const JsonValue& from = before["fields"];
	const JsonValue& to = after["fields"];
	for (const JsonValue& field : from.items) {
		const std::string name = path + '/' + field["name"].text;
		if (const JsonValue* other = FieldNamed(to, field["name"].text))
			CompareFields(field, *other, name, differences);
		else
			differences[name] = "gone";
	}
	for (const JsonValue& field : to.items) {
		if (FieldNamed(from, field["name"].text) == nullptr)
			differences[path + '/' + field["name"].text] = "new";
	}
	if (NamesOf(from, to) != NamesOf(to, from))
		differences[path + "/order"] = NamesOf(to, from);
}


} // namespace


Differences
DifferencesBetween(const std::string& before, const std::string& after)
{
	const JsonValue from = Dump(before);
	const JsonValue to = Dump(after);
	const std::vector<JsonValue>& fromItems = from["resources"].items;
	const std::vector<JsonValue>& toItems = to["resources"].items;
	Differences differences;
	if (fromItems.size() != toItems.size())
		differences["items"] = std::to_string(toItems.size());
	for (size_t i = 0; i < std::min(fromItems.size(), toItems.size()); i++) {
		const JsonValue& item = fromItems[i];
		const std::string path = item["type"].text + ':' + item["id"].text;
		for (const char* member : { "type", "id", "name", "data" }) {
			if (TextOf(item[member]) != TextOf(toItems[i][member]))
				differences[path + ' ' + member] = TextOf(toItems[i][member]);
		}
		CompareValues(item["message"], toItems[i]["message"], path, differences);
	}
	return differences;
}
