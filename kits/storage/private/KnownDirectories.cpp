#include "storage/private/KnownDirectories.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <map>
#include <mutex>
#include <string>
#include <utility>

#include "storage/private/Descriptor.h"

namespace BPrivate {

namespace {

using Number = std::pair<dev_t, ino_t>;

struct Known {
	std::mutex lock;
	std::map<Number, std::string> paths;
};


Known&
TheKnown()
{
	static Known* known = new Known; // never deleted: threads may outlive the statics
	return *known;
}

} // namespace


void
RememberDirectory(int fd)
{
	struct stat stat;
	if (fstat(fd, &stat) < 0)
		return;
	std::string path = PathOf(fd);
	if (path.empty())
		return;

	Known& known = TheKnown();
	std::lock_guard<std::mutex> guard(known.lock);
	known.paths[Number(stat.st_dev, stat.st_ino)] = std::move(path);
}


int
OpenKnownDirectory(dev_t device, ino_t node)
{
	std::string path;
	{
		Known& known = TheKnown();
		std::lock_guard<std::mutex> guard(known.lock);
		const auto found = known.paths.find(Number(device, node));
		if (found == known.paths.end())
			return -1;
		path = found->second;
	}

	const int fd = OpenAt(AT_FDCWD, path.c_str(), O_PATH | O_DIRECTORY);
	if (fd < 0)
		return -1;
	struct stat stat;
	if (fstat(fd, &stat) == 0 && stat.st_dev == device && stat.st_ino == node)
		return fd;
	close(fd);
	return -1;
}

} // namespace BPrivate
