#include "scenarios/Archway.h"

#include "scenarios/ScratchFolder.h"

namespace {


ProgramResult
Play(const std::string& script, const std::string& file, std::vector<std::string> environment)
{
	environment.push_back("FILE=" + file);
	return Run({ ARCHWAY_BINARIES "/archway", "--play", script, file }, environment);
}


} // namespace


ProgramResult
PlayScript(const std::string& name, const std::string& file, std::vector<std::string> environment)
{
	return Play(ARCHWAY_PLAYS "/" + name, file, std::move(environment));
}


ProgramResult
PlayText(
	const std::string& text, const std::string& file, const std::vector<std::string>& environment)
{
	const ScratchFolder folder;
	return Play(folder.Write("script.play", text), file, environment);
}
