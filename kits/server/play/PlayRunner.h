// PlayRunner: plays a script on a thread of its own.
#pragma once

#include <atomic>
#include <condition_variable>
#include <mutex>
#include <string>
#include <thread>

namespace BPrivate {

class DesktopThread;


// Any thread may call.
class PlayRunner {
public:
	PlayRunner(DesktopThread& desktop, const char* path);
	~PlayRunner();

	void Start();
	// The program is about to end. A script that is not at its end has failed: the process ends
	// with the status that says so.
	void ProgramEnds();
	void Stop();

private:
	void _Run();

	DesktopThread& fDesktop;
	std::string fPath;
	std::thread fThread;
	std::atomic<int> fLine { 0 }; // of the command under way; 0 before the first, -1 at the end
	std::mutex fLock;
	std::condition_variable fChanged;
	bool fEnding = false;
};


} // namespace BPrivate
