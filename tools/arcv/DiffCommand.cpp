// arcv diff: how two files differ, item by item and field by field.

#include <string.h>

#include <map>
#include <memory>
#include <tuple>

#include "tools/arcv/Command.h"
#include "tools/arcv/Input.h"
#include "tools/arcv/Json.h"
#include "tools/arcv/MessageDiff.h"
#include "tools/arcv/Output.h"
#include "tools/arcv/TypeCode.h"

namespace Arcv {

namespace {

struct DiffOptions {
	std::vector<std::string> files;
	bool json = false;
	bool git = false;
};

struct ItemDifference {
	std::string item; // "ARCV:1", or "message"
	std::string what; // "added", "removed", "changed", "renamed", "moved"
	std::string detail; // for people
	std::vector<FieldDifference> fields;
};


void
CompareBytes(const Item& item, const void* oldData, size_t oldSize, const void* newData,
	size_t newSize, std::vector<ItemDifference>* _differences)
{
	if (oldSize == newSize && memcmp(oldData, newData, oldSize) == 0)
		return;
	ItemDifference difference;
	difference.item = ItemText(item.type, item.id);
	difference.what = "changed";
	BMessage oldMessage;
	BMessage newMessage;
	if (IsMessage(oldData, oldSize, &oldMessage) && IsMessage(newData, newSize, &newMessage)) {
		CompareMessages(oldMessage, newMessage, "", &difference.fields);
		if (difference.fields.empty())
			difference.detail = "the same fields in other bytes";
	} else {
		const char* a = static_cast<const char*>(oldData);
		const char* b = static_cast<const char*>(newData);
		const size_t common = std::min(oldSize, newSize);
		const size_t first = std::mismatch(a, a + common, b).first - a;
		difference.detail = std::to_string(oldSize) + " bytes became " + std::to_string(newSize)
			+ ", different from byte " + std::to_string(first);
	}
	_differences->push_back(std::move(difference));
}


// Type and id, and how many before it have the same: normally 0.
using ItemKey = std::tuple<type_code, int32, int32>;

std::vector<ItemKey>
KeysOf(const std::vector<Item>& items)
{
	std::map<std::pair<type_code, int32>, int32> counts;
	std::vector<ItemKey> keys;
	for (const Item& item : items)
		keys.emplace_back(item.type, item.id, counts[{ item.type, item.id }]++);
	return keys;
}


ItemDifference
WholeItem(const Item& item, const char* what)
{
	return { ItemText(item.type, item.id), what,
		"\"" + item.name + "\", " + std::to_string(item.size) + " bytes", {} };
}


// False after a complaint.
bool
CompareItem(Input& oldInput, const Item& item, Input& newInput, const Item& other,
	std::vector<ItemDifference>* _differences)
{
	if (item.name != other.name)
		_differences->push_back({ ItemText(item.type, item.id), "renamed",
			"\"" + item.name + "\" became \"" + other.name + "\"", {} });
	const void* oldData = oldInput.Load(item);
	const void* newData = newInput.Load(other);
	if (oldData == NULL || newData == NULL)
		return false;
	CompareBytes(item, oldData, item.size, newData, other.size, _differences);
	return true;
}


// False after a complaint.
bool
CompareItems(Input& oldInput, Input& newInput, std::vector<ItemDifference>* _differences)
{
	const std::vector<ItemKey> oldKeys = KeysOf(oldInput.Items());
	const std::vector<ItemKey> newKeys = KeysOf(newInput.Items());
	std::map<ItemKey, const Item*> news;
	for (const Item& item : newInput.Items())
		news.emplace(newKeys[item.index], &item);

	std::vector<ItemKey> oldOrder;
	for (const Item& item : oldInput.Items()) {
		const auto found = news.find(oldKeys[item.index]);
		if (found == news.end()) {
			_differences->push_back(WholeItem(item, "removed"));
			continue;
		}
		oldOrder.push_back(found->first);
		if (!CompareItem(oldInput, item, newInput, *found->second, _differences))
			return false;
		news.erase(found);
	}

	std::vector<ItemKey> newOrder;
	for (const Item& item : newInput.Items()) {
		if (news.count(newKeys[item.index]) == 0)
			newOrder.push_back(newKeys[item.index]);
		else
			_differences->push_back(WholeItem(item, "added"));
	}
	if (oldOrder != newOrder)
		_differences->push_back({ "items", "moved", "the items have another order", {} });
	return true;
}


std::string
FieldText(const FieldDifference& field)
{
	const std::string path = field.path.empty() ? "(message)" : field.path;
	if (field.what == "added")
		return "    + " + path + " = " + field.newValue;
	if (field.what == "removed")
		return "    - " + path + " = " + field.oldValue;
	if (field.what == "moved")
		return "    ~ " + path + ": the fields have another order";
	return "    ~ " + path + ": " + field.oldValue + " -> " + field.newValue;
}


void
PrintText(const std::vector<ItemDifference>& differences)
{
	for (const ItemDifference& difference : differences) {
		const char* sign = difference.what == "added" ? "+ "
			: difference.what == "removed"            ? "- "
													  : "~ ";
		Print(sign + difference.item
			+ (difference.what == "added" || difference.what == "removed"
						|| difference.what == "changed"
					? ""
					: " " + difference.what)
			+ (difference.detail.empty() ? "" : ": " + difference.detail) + "\n");
		for (const FieldDifference& field : difference.fields)
			Print(FieldText(field) + "\n");
	}
}


void
WriteField(JsonWriter& json, const FieldDifference& field)
{
	json.OpenObject();
	json.Name("path");
	json.Text(field.path);
	json.Name("change");
	json.String(field.what);
	if (!field.oldValue.empty()) {
		json.Name("old");
		json.Verbatim(field.oldValue);
	}
	if (!field.newValue.empty()) {
		json.Name("new");
		json.Verbatim(field.newValue);
	}
	json.CloseObject();
}


void
PrintJson(const std::vector<ItemDifference>& differences)
{
	JsonWriter json;
	json.OpenObject();
	json.Name("differences");
	json.OpenArray();
	for (const ItemDifference& difference : differences) {
		json.OpenObject();
		json.Name("item");
		json.String(difference.item);
		json.Name("change");
		json.String(difference.what);
		if (!difference.detail.empty()) {
			json.Name("detail");
			json.Text(difference.detail);
		}
		if (!difference.fields.empty()) {
			json.Name("fields");
			json.OpenArray();
			for (const FieldDifference& field : difference.fields)
				WriteField(json, field);
			json.CloseArray();
		}
		json.CloseObject();
	}
	json.CloseArray();
	json.CloseObject();
	Print(json.Finish());
}


int
RunDiff(const DiffOptions& options)
{
	// git calls: path old-file old-hash old-mode new-file new-hash new-mode. A file that is not
	// there is an empty one for it.
	const size_t count = options.files.size();
	if (options.git ? count < 7 : count != 2) {
		Complain("diff", options.git ? "git gives seven arguments" : "two files are compared");
		return kUsage;
	}
	Input oldInput;
	Input newInput;
	if (!oldInput.Open(options.files[options.git ? 1 : 0])
		|| !newInput.Open(options.files[options.git ? 4 : 1]))
		return kUnreadable;

	std::vector<ItemDifference> differences;
	if (oldInput.IsMessage() && newInput.IsMessage()) {
		ItemDifference difference = { "message", "changed", "", {} };
		CompareMessages(oldInput.Message(), newInput.Message(), "", &difference.fields);
		if (!difference.fields.empty())
			differences.push_back(difference);
	} else if (oldInput.IsMessage() != newInput.IsMessage())
		differences.push_back({ "file", "changed", "one is a message, one a resource file", {} });
	else if (!CompareItems(oldInput, newInput, &differences))
		return kUnreadable;

	if (options.git && !differences.empty())
		Print("arcv diff " + options.files[0] + "\n");
	if (options.json)
		PrintJson(differences);
	else
		PrintText(differences);
	// For git, a difference is no failure.
	return differences.empty() || options.git ? kFine : kFindings;
}

} // namespace


void
AddDiffCommand(CLI::App& app, int* _status)
{
	const auto options = std::make_shared<DiffOptions>();
	CLI::App* command = app.add_subcommand("diff", "Show how two files differ");
	command->add_option("files", options->files, "The old file and the new one")->required();
	command->add_flag("--json", options->json, "Write JSON");
	command->add_flag("--git", options->git, "Take the arguments that git gives a diff driver");
	command->callback([=] { *_status = RunDiff(*options); });
}

} // namespace Arcv
