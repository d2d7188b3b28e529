// arcv remove: takes items out.

#include <memory>
#include <vector>

#include "tools/arcv/Command.h"
#include "tools/arcv/Edit.h"
#include "tools/arcv/Output.h"
#include "tools/arcv/TypeCode.h"

namespace Arcv {

namespace {

struct RemoveOptions {
	std::string file;
	std::vector<std::string> items;
	std::string output;
};


int
RunRemove(const RemoveOptions& options)
{
	std::vector<ItemKey> keys(options.items.size());
	for (size_t i = 0; i < keys.size(); i++) {
		if (!ParseItemKey(options.items[i], &keys[i])) {
			Complain(options.items[i], "an item is named TYPE:ID");
			return kUsage;
		}
	}
	return EditFile(options.file, options.output, false, [&](BResources& resources) {
		// All or none.
		for (const ItemKey& key : keys) {
			if (!resources.HasResource(key.type, key.id)) {
				Complain(options.file, "there is no item " + ItemText(key.type, key.id));
				return static_cast<int>(kFindings);
			}
		}
		for (const ItemKey& key : keys)
			resources.RemoveResource(key.type, key.id);
		return static_cast<int>(kFine);
	});
}

} // namespace


void
AddRemoveCommand(CLI::App& app, int* _status)
{
	const auto options = std::make_shared<RemoveOptions>();
	CLI::App* command = app.add_subcommand("remove", "Take items out");
	command->add_option("file", options->file, "A resource file")->required();
	command->add_option("items", options->items, "The items, as TYPE:ID")->required();
	command->add_option("-o,--output", options->output, "Write a new file instead");
	command->callback([=] { *_status = RunRemove(*options); });
}

} // namespace Arcv
