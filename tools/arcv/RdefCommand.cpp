// arcv rdef: a resource file as text.

#include <memory>

#include "tools/arcv/Command.h"
#include "tools/arcv/Input.h"
#include "tools/arcv/Output.h"
#include "tools/arcv/rdef/Decompiler.h"

namespace Arcv {

namespace {

struct RdefOptions {
	std::string file;
	std::string output = "-";
};


int
RunRdef(const RdefOptions& options)
{
	Input input;
	if (!input.Open(options.file))
		return kUnreadable;
	if (input.IsMessage()) {
		Complain(options.file, "this is one flattened message, not a resource file");
		return kUnreadable;
	}
	std::string text;
	for (const Item& item : input.Items()) {
		const void* data = input.Load(item);
		if (data == NULL)
			return kUnreadable;
		text += ResourceText(item.type, item.id, item.name, data, item.size);
	}
	return WriteWholeFile(options.output, text) ? kFine : kUnreadable;
}

} // namespace


void
AddRdefCommand(CLI::App& app, int* _status)
{
	const auto options = std::make_shared<RdefOptions>();
	CLI::App* command =
		app.add_subcommand("rdef", "Write a resource file as resource definition text");
	command->add_option("file", options->file, "A resource file")->required();
	command->add_option("-o,--output", options->output, "The text file; standard output if absent");
	command->callback([=] { *_status = RunRdef(*options); });
}

} // namespace Arcv
