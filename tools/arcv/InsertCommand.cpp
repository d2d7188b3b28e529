// arcv insert: adds an item.

#include <memory>
#include <optional>

#include "tools/arcv/Command.h"
#include "tools/arcv/Edit.h"
#include "tools/arcv/Input.h"
#include "tools/arcv/Output.h"
#include "tools/arcv/TypeCode.h"

namespace Arcv {

namespace {

struct InsertOptions {
	std::string file;
	std::string item;
	std::string data;
	std::string output;
	std::optional<std::string> name;
	bool replace = false;
};


int
RunInsert(const InsertOptions& options)
{
	ItemKey key;
	if (!ParseItemKey(options.item, &key)) {
		Complain(options.item, "an item is named TYPE:ID");
		return kUsage;
	}
	std::string bytes;
	if (!ReadWholeFile(options.data, &bytes))
		return kUnreadable;

	return EditFile(options.file, options.output, true, [&](BResources& resources) {
		const bool there = resources.HasResource(key.type, key.id);
		if (there && !options.replace) {
			Complain(options.file, "the item " + options.item + " is there already");
			return static_cast<int>(kFindings);
		}
		if (there) {
			// Its place in the order and, if none is given, its name stay.
			const char* name = NULL;
			size_t size = 0;
			resources.GetResourceInfo(key.type, key.id, &name, &size);
			if (!options.name && size <= bytes.size()) {
				resources.WriteResource(key.type, key.id, bytes.data(), 0, bytes.size());
				return static_cast<int>(kFine);
			}
		}
		std::optional<std::string> name = options.name;
		const char* oldName = NULL;
		if (!name && there && resources.GetResourceInfo(key.type, key.id, &oldName, NULL)
			&& oldName[0] != '\0')
			name = oldName;
		const status_t status = resources.AddResource(
			key.type, key.id, bytes.data(), bytes.size(), name ? name->c_str() : NULL);
		if (status != B_OK)
			Complain(options.file, StatusText(status));
		return static_cast<int>(status == B_OK ? kFine : kUnreadable);
	});
}

} // namespace


void
AddInsertCommand(CLI::App& app, int* _status)
{
	const auto options = std::make_shared<InsertOptions>();
	CLI::App* command =
		app.add_subcommand("insert", "Add an item; a missing resource file is made");
	command->add_option("file", options->file, "A resource file")->required();
	command->add_option("item", options->item, "The item, as TYPE:ID")->required();
	command->add_option("data", options->data, "The file with its bytes")->required();
	command->add_option("-n,--name", options->name, "The item's name");
	command->add_flag("-r,--replace", options->replace, "Replace an item that is there");
	command->add_option("-o,--output", options->output, "Write a new file instead");
	command->callback([=] { *_status = RunInsert(*options); });
}

} // namespace Arcv
