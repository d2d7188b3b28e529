// arcv dump: everything that a file holds, as text or JSON.

#include <stdio.h>

#include <memory>

#include <MessageForm.h>

#include "tools/arcv/Command.h"
#include "tools/arcv/Input.h"
#include "tools/arcv/MessageJson.h"
#include "tools/arcv/Output.h"
#include "tools/arcv/TypeCode.h"

namespace Arcv {

namespace {

constexpr size_t kHexLine = 32; // bytes
constexpr int32 kDeepestIndent = 40; // levels

struct DumpOptions {
	std::string file;
	bool json = false;
};


std::string
Indent(int32 depth)
{
	return std::string(2 * std::min<int32>(depth, kDeepestIndent), ' ');
}


std::string
ValueText(const BMessage& message, int32 field, type_code type, int32 index)
{
	JsonWriter json;
	json.OpenArray(true);
	WriteFieldValue(json, message, field, type, index);
	json.CloseArray();
	const std::string text = json.Finish();
	return text.substr(1, text.size() - 3);
}


void
PrintMessage(const BMessage& message, int32 depth)
{
	if (message.what != 0)
		Print(Indent(depth) + "what " + TypeText(message.what) + "\n");
	char* name;
	type_code type;
	int32 count;
	for (int32 i = 0; message.GetInfo(B_ANY_TYPE, i, &name, &type, &count) == B_OK; i++) {
		for (int32 j = 0; j < count; j++) {
			const std::string index = count > 1 ? "[" + std::to_string(j) + "]" : "";
			const std::string start = Indent(depth) + TypeText(type) + " " + name + index;
			BMessage nested;
			if (find_field_message(message, i, j, &nested) == B_OK) {
				Print(start + "\n");
				PrintMessage(nested, depth + 1);
			} else
				Print(start + " = " + ValueText(message, i, type, j) + "\n");
		}
	}
}


void
PrintBytes(const char* data, size_t size)
{
	for (size_t start = 0; start < size; start += kHexLine)
		Print(Indent(1) + HexText(data + start, std::min(kHexLine, size - start)) + "\n");
}


int
PrintText(Input& input)
{
	if (input.IsMessage()) {
		PrintMessage(input.Message(), 0);
		return kFine;
	}
	int status = kFine;
	for (const Item& item : input.Items()) {
		Print(ItemText(item.type, item.id) + " " + std::to_string(item.size) + " bytes \""
			+ item.name + "\"\n");
		const void* data = input.Load(item);
		BMessage message;
		if (data == NULL)
			status = kUnreadable;
		else if (IsMessage(data, item.size, &message))
			PrintMessage(message, 1);
		else
			PrintBytes(static_cast<const char*>(data), item.size);
	}
	return status;
}


int
WriteItem(JsonWriter& json, Input& input, const Item& item)
{
	json.OpenObject();
	json.Name("type");
	json.String(TypeText(item.type));
	json.Name("id");
	json.Integer(item.id);
	json.Name("name");
	json.Text(item.name);
	json.Name("size");
	json.Unsigned(item.size);
	const void* data = input.Load(item);
	BMessage message;
	if (data != NULL && IsMessage(data, item.size, &message)) {
		json.Name("message");
		WriteMessage(json, message);
	}
	json.CloseObject();
	return data != NULL ? kFine : kUnreadable;
}


int
WriteJson(Input& input)
{
	JsonWriter json(Print);
	int status = kFine;
	if (input.IsMessage())
		WriteMessage(json, input.Message());
	else {
		json.OpenObject();
		json.Name("resources");
		json.OpenArray();
		for (const Item& item : input.Items())
			status = std::max(status, WriteItem(json, input, item));
		json.CloseArray();
		json.CloseObject();
	}
	json.Finish();
	return status;
}

} // namespace


void
AddDumpCommand(CLI::App& app, int* _status)
{
	const auto options = std::make_shared<DumpOptions>();
	CLI::App* command = app.add_subcommand("dump", "Show everything that a file holds");
	command->add_option("file", options->file, "A resource file, or one flattened message")
		->required();
	command->add_flag("--json", options->json, "Write JSON");
	command->callback([=] {
		Input input;
		if (!input.Open(options->file))
			*_status = kUnreadable;
		else
			*_status = options->json ? WriteJson(input) : PrintText(input);
	});
}

} // namespace Arcv
