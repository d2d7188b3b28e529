// arcv extract: the bytes of one item.

#include <memory>

#include "tools/arcv/Command.h"
#include "tools/arcv/Input.h"
#include "tools/arcv/Output.h"
#include "tools/arcv/TypeCode.h"

namespace Arcv {

namespace {

struct ExtractOptions {
	std::string file;
	std::string item;
	std::string output = "-";
};


int
RunExtract(const ExtractOptions& options)
{
	ItemKey key;
	if (!ParseItemKey(options.item, &key)) {
		Complain(options.item, "an item is named TYPE:ID");
		return kUsage;
	}
	Input input;
	if (!input.Open(options.file))
		return kUnreadable;
	for (const Item& item : input.Items()) {
		if (item.type != key.type || item.id != key.id)
			continue;
		const void* data = input.Load(item);
		if (data == NULL)
			return kUnreadable;
		const std::string_view bytes(static_cast<const char*>(data), item.size);
		return WriteWholeFile(options.output, bytes) ? kFine : kUnreadable;
	}
	Complain(options.file, "there is no item " + options.item);
	return kFindings;
}

} // namespace


void
AddExtractCommand(CLI::App& app, int* _status)
{
	const auto options = std::make_shared<ExtractOptions>();
	CLI::App* command = app.add_subcommand("extract", "Write the bytes of one item");
	command->add_option("file", options->file, "A resource file")->required();
	command->add_option("item", options->item, "The item, as TYPE:ID")->required();
	command->add_option("-o,--output", options->output, "The file; standard output if absent");
	command->callback([=] { *_status = RunExtract(*options); });
}

} // namespace Arcv
