// PlayRunner: plays a script on a thread of its own.
#pragma once

#include <condition_variable>
#include <mutex>
#include <string>
#include <thread>

#include <SupportDefs.h>

namespace BPrivate {

class DesktopThread;
class Player;


// Started and stopped by the thread that starts and stops the display. A command that fails ends
// the process at once, with status 4.
class PlayRunner {
public:
	PlayRunner(DesktopThread& desktop, const char* path);
	~PlayRunner();

	void Start();
	// The program is about to end. If the script is not at its end it has failed.
	void ProgramEnds();

private:
	void _Run();
	void _Play();
	void _PlayLine(Player& player, const std::string& line);
	void _AwaitEnd(Player& player);
	bool _IsEnding();
	[[noreturn]] void _Fail(const std::string& expected, const std::string& found);

	DesktopThread& fDesktop;
	std::string fPath;
	std::thread fThread;
	int32 fLine = 0; // of the command under way; the player's thread, or under the lock

	std::mutex fLock;
	std::condition_variable fChanged;
	bool fEnding = false;
};


} // namespace BPrivate
