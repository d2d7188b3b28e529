// The commands of arcv, and what they exit with.
#pragma once

#include <CLI/CLI.hpp>

namespace Arcv {

enum ExitStatus {
	kFine = 0,
	kFindings = 1, // differences, damages, nothing found
	kUsage = 2,
	kUnreadable = 3, // or a result that cannot be written
};

// Each adds its command; what it did is in *_status after the parsing.
void AddCheckCommand(CLI::App& app, int* _status);
void AddCompileCommand(CLI::App& app, int* _status);
void AddConvertCommand(CLI::App& app, int* _status);
void AddDiffCommand(CLI::App& app, int* _status);
void AddDumpCommand(CLI::App& app, int* _status);
void AddExtractCommand(CLI::App& app, int* _status);
void AddInsertCommand(CLI::App& app, int* _status);
void AddListCommand(CLI::App& app, int* _status);
void AddRdefCommand(CLI::App& app, int* _status);
void AddRemoveCommand(CLI::App& app, int* _status);
void AddRenderCommand(CLI::App& app, int* _status);

// The whole program; what it returns is the exit status.
int RunArcv(int argc, const char* const* argv);

} // namespace Arcv
