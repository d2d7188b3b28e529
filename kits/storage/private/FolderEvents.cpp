#include "storage/private/FolderEvents.h"

#include <errno.h>
#include <poll.h>
#include <sys/eventfd.h>
#include <sys/inotify.h>
#include <unistd.h>

#include <system_error>

#include "storage/private/Errno.h"

namespace BPrivate {

namespace {

constexpr uint32 kGone = IN_DELETE_SELF | IN_MOVE_SELF;
constexpr uint32 kFolderMask =
	IN_MOVED_TO | IN_MOVED_FROM | IN_DELETE | IN_CLOSE_WRITE | kGone | IN_ONLYDIR;
constexpr uint32 kParentMask = IN_MOVED_TO | IN_CREATE | kGone | IN_ONLYDIR;


std::string
ParentOf(const std::string& path)
{
	const size_t slash = path.rfind('/');
	return slash == 0 || slash == std::string::npos ? "/" : path.substr(0, slash);
}

} // namespace


FolderEvents::FolderEvents(const std::string& folder, Callback callback) :
	fFolder(folder), fCallback(std::move(callback)), fStatus(B_OK),
	fEvents(inotify_init1(IN_CLOEXEC | IN_NONBLOCK)), fEnd(-1), fWatch(-1), fAtFolder(false)
{
	if (fEvents >= 0)
		fEnd = eventfd(0, EFD_CLOEXEC);
	if (fEvents < 0 || fEnd < 0)
		fStatus = LastStatus();
	else
		_Watch();
}


FolderEvents::~FolderEvents()
{
	if (fThread.joinable()) {
		eventfd_write(fEnd, 1);
		fThread.join();
	}
	if (fEnd >= 0)
		close(fEnd);
	if (fEvents >= 0)
		close(fEvents);
}


status_t
FolderEvents::Run()
{
	if (fStatus != B_OK || fThread.joinable())
		return fStatus;
	try {
		fThread = std::thread([this] { _Listen(); });
	} catch (const std::system_error&) {
		return B_NO_MORE_THREADS;
	}
	return B_OK;
}


// #pragma mark - private


void
FolderEvents::_Listen()
{
	pollfd sources[] = { { fEvents, POLLIN, 0 }, { fEnd, POLLIN, 0 } };
	while (true) {
		const int ready = poll(sources, 2, -1);
		if (ready < 0 && errno == EINTR)
			continue;
		if (ready < 0 || sources[1].revents != 0 || !_ReadEvents())
			return;
	}
}


bool
FolderEvents::_ReadEvents()
{
	alignas(inotify_event) char bytes[4096];
	const ssize_t size = read(fEvents, bytes, sizeof(bytes));
	if (size <= 0)
		return size < 0 && (errno == EINTR || errno == EAGAIN);

	std::set<std::string> names;
	bool lost = false; // the folder, or its place
	const inotify_event* event;
	for (ssize_t at = 0; at < size; at += sizeof(inotify_event) + event->len) {
		event = reinterpret_cast<const inotify_event*>(bytes + at);
		if ((event->mask & IN_Q_OVERFLOW) != 0)
			lost = true;
		if (event->wd != fWatch)
			continue;
		if (!fAtFolder || (event->mask & (kGone | IN_IGNORED | IN_UNMOUNT)) != 0)
			lost = true;
		else if (event->len > 0)
			names.insert(event->name);
	}
	if (lost) {
		const bool wasThere = fAtFolder;
		_Watch();
		if (wasThere || fAtFolder)
			names = { "" };
	}
	for (const std::string& name : names)
		fCallback(name);
	return true;
}


void
FolderEvents::_Watch()
{
	if (fWatch >= 0)
		inotify_rm_watch(fEvents, fWatch);
	while (!_WatchNearest()) {
		// Somebody has just made a folder that is nearer.
		inotify_rm_watch(fEvents, fWatch);
	}
}


bool
FolderEvents::_WatchNearest()
{
	std::string path = fFolder;
	std::string missing; // the child of `path` that did not exist
	while (true) {
		fAtFolder = path == fFolder;
		fWatch = inotify_add_watch(fEvents, path.c_str(), fAtFolder ? kFolderMask : kParentMask);
		if (fWatch >= 0)
			return missing.empty() || access(missing.c_str(), F_OK) != 0;
		// A child that is no folder, or not for us, is not waited for until it is another one.
		missing = errno == ENOENT ? path : "";
		if (path == "/" || path.empty()) {
			fAtFolder = false;
			return true;
		}
		path = ParentOf(path);
	}
}

} // namespace BPrivate
