#include "server/play/PlayRunner.h"

#include <cstdio>
#include <fstream>
#include <unistd.h>
#include <vector>

#include "server/DesktopThread.h"
#include "server/play/Player.h"

namespace BPrivate {

namespace {

constexpr int kFailed = 4;
constexpr std::chrono::seconds kQuitPatience(30);


bool
HasCommand(const std::string& line)
{
	const size_t first = line.find_first_not_of(" \t\r");
	return first != std::string::npos && line[first] != '#';
}

} // namespace


PlayRunner::PlayRunner(DesktopThread& desktop, const char* path) : fDesktop(desktop), fPath(path)
{
}


PlayRunner::~PlayRunner()
{
	ProgramEnds();
}


void
PlayRunner::Start()
{
	fThread = std::thread([this] { _Run(); });
}


void
PlayRunner::ProgramEnds()
{
	{
		std::lock_guard lock(fLock);
		fEnding = true;
	}
	fChanged.notify_all();
	if (fThread.joinable())
		fThread.join();
}


bool
PlayRunner::_IsEnding()
{
	std::lock_guard lock(fLock);
	return fEnding;
}


void
PlayRunner::_Fail(const std::string& expected, const std::string& found)
{
	std::fprintf(
		stderr, "play: %d: %s, %s\n", static_cast<int>(fLine), expected.c_str(), found.c_str());
	std::fflush(nullptr);
	_exit(kFailed);
}


void
PlayRunner::_Run()
{
	try {
		_Play();
	} catch (const PlayError& error) {
		_Fail(error.expected, error.found);
	} catch (const std::exception& error) {
		_Fail("memory for the script", error.what());
	}
}


void
PlayRunner::_Play()
{
	std::vector<std::string> lines;
	std::ifstream file(fPath);
	if (!file)
		throw PlayError { "a script " + fPath, "it cannot be read" };
	for (std::string line; std::getline(file, line);)
		lines.push_back(line);

	Player player(fDesktop, [this] { return _IsEnding(); });
	player.OpenOutput();
	player.WaitForFirstWindow();
	for (const std::string& line : lines) {
		fLine++;
		if (HasCommand(line))
			_PlayLine(player, line);
	}
	_AwaitEnd(player);
}


void
PlayRunner::_PlayLine(Player& player, const std::string& line)
{
	player.WaitUntilIdle();
	if (_IsEnding())
		_Fail("a program that goes on", "it has ended");
	PlayTokenReader reader(play_tokens(line));
	player.Perform(reader);
}


void
PlayRunner::_AwaitEnd(Player& player)
{
	player.WaitUntilIdle();
	if (_IsEnding())
		return;
	player.Quit();
	std::unique_lock lock(fLock);
	if (!fChanged.wait_for(lock, kQuitPatience, [this] { return fEnding; }))
		_Fail("a program that quits at the end of the script", "it still runs");
}


} // namespace BPrivate
