// QuitSignals: turns the signals that end a program into a request to quit.
#pragma once

#include <signal.h>
#include <thread>

#include <Messenger.h>

namespace BPrivate {


// For the length of its life SIGINT and SIGTERM send B_QUIT_REQUESTED to the target; a second
// signal, while the first is being answered, ends the program at once. One at a time.
class QuitSignals {
public:
	explicit QuitSignals(const BMessenger& target);
	~QuitSignals();
	QuitSignals(const QuitSignals&) = delete;
	QuitSignals& operator=(const QuitSignals&) = delete;

private:
	void _Watch(BMessenger target);

	struct sigaction fOldInterrupt = {};
	struct sigaction fOldTerminate = {};
	int fPipe[2] = { -1, -1 };
	std::thread fWatcher;
};


} // namespace BPrivate
