#include "tools/arcv/Command.h"

#include "tools/arcv/Output.h"

namespace Arcv {

int
RunArcv(int argc, const char* const* argv)
{
	CLI::App app("Lists, shows, compares and changes the items of resource files.", "arcv");
	app.require_subcommand(1);
	app.set_version_flag("--version", "arcv 0.1");

	int status = kFine;
	AddListCommand(app, &status);
	AddDumpCommand(app, &status);
	AddCheckCommand(app, &status);
	AddDiffCommand(app, &status);
	AddRenderCommand(app, &status);
	AddExtractCommand(app, &status);
	AddInsertCommand(app, &status);
	AddRemoveCommand(app, &status);
	AddConvertCommand(app, &status);
	AddRdefCommand(app, &status);
	AddCompileCommand(app, &status);

	try {
		app.parse(argc, argv);
	} catch (const CLI::ParseError& error) {
		// Asking for help is no mistake.
		const bool asked = error.get_exit_code() == 0;
		app.exit(error);
		return asked ? kFine : kUsage;
	}
	return FinishOutput() || status != kFine ? status : static_cast<int>(kUnreadable);
}

} // namespace Arcv
