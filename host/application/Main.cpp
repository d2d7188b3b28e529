// archway: the resource editor's command line.

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <string>

#include <sys/mman.h>

#include <CLI/CLI.hpp>

#include "host/application/AddonRoster.h"
#include "host/application/EditorApplication.h"
#include "host/application/FourCharacters.h"

namespace {


struct CommandLine {
	EditorApplication::Options application;
	std::string playScript;
	std::string screenshot;
	std::string scale;
	std::string item;
	bool offscreen = false;
};


// TYPE:ID, as in ARCV:1.
bool
ParseItem(const std::string& text, EditorApplication::Options& options)
{
	const size_t colon = text.rfind(':');
	if (colon == std::string::npos
		|| !ParseFourCharacters(text.substr(0, colon), &options.itemType))
		return false;

	const std::string number = text.substr(colon + 1);
	char* end;
	options.itemID = static_cast<int32>(strtol(number.c_str(), &end, 10));
	options.openItem = !number.empty() && *end == '\0';
	return options.openItem;
}


// A screenshot is taken by the shortest of all play scripts, in a file that no folder shows.
std::string
WriteScreenshotScript(const std::string& picture)
{
	const int file = memfd_create("play", 0);
	const std::string path = "/proc/self/fd/" + std::to_string(file);
	std::ofstream(path) << "picture " << std::filesystem::absolute(picture).string() << "\nquit!\n";
	return path;
}


// The platform takes its settings from the environment, so that any program has them.
void
SetEnvironment(const CommandLine& line, const std::string& playScript)
{
	if (line.offscreen || !line.screenshot.empty())
		setenv("ARCHWAY_BACKEND", "headless", 1);
	if (!line.scale.empty())
		setenv("ARCHWAY_SCALE", line.scale.c_str(), 1);
	if (!playScript.empty())
		setenv("ARCHWAY_PLAY", playScript.c_str(), 1);
}


// Beside the programs of a build, and of an installation.
std::string
AddonFolder(const char* program)
{
	namespace fs = std::filesystem;
	std::error_code error;
	fs::path self = fs::read_symlink("/proc/self/exe", error);
	if (error)
		self = fs::absolute(program);
	const fs::path root = self.parent_path().parent_path();
	const fs::path built = root / "add-ons";
	return fs::exists(built) ? built.string() : (root / "lib/archway/add-ons").string();
}


} // namespace


int
main(int argc, char** argv)
{
	CommandLine line;
	CLI::App options("archway edits resource files and the views archived in them.", "archway");
	options.add_option("FILE", line.application.files, "Resource files to open");
	options.add_option("--open", line.item, "Open this item of the first file, as ARCV:1")
		->type_name("TYPE:ID");
	options.add_option("--play", line.playScript, "Carry out a play script, then quit")
		->type_name("SCRIPT")
		->check(CLI::ExistingFile);
	options.add_option("--scale", line.scale, "Device pixels per pixel: 1, 1.25, 1.5, 2, ...")
		->check(CLI::Range(0.5, 8.0));
	options
		.add_option("--screenshot", line.screenshot,
			"Write what the screen would show into this file, then quit")
		->type_name("OUT.png");
	options.add_flag("--offscreen", line.offscreen, "Use a screen in memory");

	try {
		options.parse(argc, argv);
	} catch (const CLI::ParseError& error) {
		const int status = options.exit(error);
		return status == 0 ? 0 : 2;
	}
	if (!line.item.empty() && !ParseItem(line.item, line.application)) {
		fprintf(stderr, "archway: --open wants TYPE:ID, as in ARCV:1\n");
		return 2;
	}

	std::string playScript = line.playScript;
	if (!line.screenshot.empty()) {
		line.application.openFirstArchive = true;
		playScript = WriteScreenshotScript(line.screenshot);
	}
	SetEnvironment(line, playScript);

	AddonRoster::Load(AddonFolder(argv[0]));
	EditorApplication application(line.application);
	application.Run();
	return 0;
}
