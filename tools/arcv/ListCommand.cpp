// arcv list: the items of a file, one a line.

#include <stdio.h>

#include <memory>

#include "tools/arcv/Command.h"
#include "tools/arcv/Forms.h"
#include "tools/arcv/Input.h"
#include "tools/arcv/Json.h"
#include "tools/arcv/Output.h"
#include "tools/arcv/TypeCode.h"

namespace Arcv {

namespace {

struct ListOptions {
	std::string file;
	bool json = false;
};


const char*
FormOf(Input& input, const Item& item)
{
	BMessage message;
	message_form form = B_NO_MESSAGE_FORM;
	const void* data = input.Load(item);
	if (data != NULL)
		IsMessage(data, item.size, &message, &form);
	return FormName(form);
}


// A name on a line of its own stays on it.
std::string
Quoted(const std::string& name)
{
	std::string text = "\"";
	for (const char character : name) {
		char escape[8];
		if (character == '"' || character == '\\')
			text += '\\';
		if (static_cast<unsigned char>(character) < 0x20 || character == 0x7f) {
			snprintf(escape, sizeof(escape), "\\x%02x", character);
			text += escape;
		} else
			text += character;
	}
	return text + "\"";
}


void
ListItem(Input& input, const Item& item)
{
	char line[128];
	snprintf(line, sizeof(line), "%-10s %11d %9zu  %-7s  ", TypeText(item.type).c_str(),
		static_cast<int>(item.id), item.size, FormOf(input, item));
	Print(line + Quoted(item.name) + "\n");
}


void
WriteJson(Input& input)
{
	JsonWriter json;
	json.OpenObject();
	json.Name("resources");
	json.OpenArray();
	for (const Item& item : input.Items()) {
		json.OpenObject(true);
		json.Name("type");
		json.String(TypeText(item.type));
		json.Name("id");
		json.Integer(item.id);
		json.Name("name");
		json.Text(item.name);
		json.Name("size");
		json.Unsigned(item.size);
		json.Name("form");
		json.String(FormOf(input, item));
		json.CloseObject();
	}
	json.CloseArray();
	json.CloseObject();
	Print(json.Finish());
}


int
RunList(const ListOptions& options)
{
	Input input;
	if (!input.Open(options.file))
		return kUnreadable;
	if (options.json) {
		WriteJson(input);
		return kFine;
	}
	if (input.IsMessage()) {
		Print(std::string("one flattened message, form ") + FormName(input.Form()) + "\n");
		return kFine;
	}
	for (const Item& item : input.Items())
		ListItem(input, item);
	return kFine;
}

} // namespace


void
AddListCommand(CLI::App& app, int* _status)
{
	const auto options = std::make_shared<ListOptions>();
	CLI::App* command = app.add_subcommand("list", "List type, id, size, form and name of items");
	command->add_option("file", options->file, "A resource file")->required();
	command->add_flag("--json", options->json, "Write JSON");
	command->callback([=] { *_status = RunList(*options); });
}

} // namespace Arcv
