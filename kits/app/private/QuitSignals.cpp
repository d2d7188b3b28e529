#include "app/private/QuitSignals.h"

#include <atomic>
#include <errno.h>
#include <fcntl.h>
#include <unistd.h>

#include <AppDefs.h>

namespace BPrivate {
namespace {

std::atomic<int> sPipe { -1 };

// Runs between any two instructions of the program, so it only writes a byte.
void
HandleSignal(int signal)
{
	const int error = errno;
	const char byte = char(signal);
	[[maybe_unused]] const ssize_t written = write(sPipe.load(), &byte, 1);
	errno = error;
}

} // namespace


QuitSignals::QuitSignals(const BMessenger& target)
{
	if (pipe2(fPipe, O_CLOEXEC) != 0)
		return;
	sPipe = fPipe[1];
	fWatcher = std::thread([this, target] { _Watch(target); });

	struct sigaction action = {};
	action.sa_handler = HandleSignal;
	// The default comes back with the first one.
	action.sa_flags = SA_RESTART | SA_RESETHAND;
	sigaction(SIGINT, &action, &fOldInterrupt);
	sigaction(SIGTERM, &action, &fOldTerminate);
}


QuitSignals::~QuitSignals()
{
	if (fPipe[0] < 0)
		return;
	sigaction(SIGINT, &fOldInterrupt, NULL);
	sigaction(SIGTERM, &fOldTerminate, NULL);
	const char end = 0;
	[[maybe_unused]] const ssize_t written = write(fPipe[1], &end, 1);
	fWatcher.join();
	close(fPipe[0]);
	close(fPipe[1]);
}


void
QuitSignals::_Watch(BMessenger target)
{
	char byte = 0;
	while (true) {
		const ssize_t count = read(fPipe[0], &byte, 1);
		if (count < 0 && errno == EINTR)
			continue;
		if (count != 1 || byte == 0)
			return;
		target.SendMessage(B_QUIT_REQUESTED);
	}
}


} // namespace BPrivate
