#include "tools/arcv/Output.h"

#include <errno.h>
#include <fcntl.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <sys/stat.h>
#include <unistd.h>

#include <Errors.h>

#include "tools/arcv/Input.h"

namespace Arcv {

void
Print(std::string_view text)
{
	fwrite(text.data(), 1, text.size(), stdout);
}


bool
FinishOutput()
{
	if (fflush(stdout) == 0 && ferror(stdout) == 0)
		return true;
	fprintf(stderr, "arcv: the output cannot be written: %s\n", strerror(errno));
	return false;
}


void
Complain(const std::string& file, const std::string& text, off_t offset)
{
	if (offset >= 0)
		fprintf(stderr, "arcv: %s: %s (offset %lld)\n", file.c_str(), text.c_str(),
			static_cast<long long>(offset));
	else
		fprintf(stderr, "arcv: %s: %s\n", file.c_str(), text.c_str());
}


std::string
StatusText(status_t status)
{
	switch (status) {
		case B_ENTRY_NOT_FOUND:
			return "there is no such file";
		case B_PERMISSION_DENIED:
			return "permission denied";
		case B_NOT_ALLOWED:
			return "the file is read-only, or its owner and group could not be kept";
		case B_NOT_SUPPORTED:
			return "the file's attributes could not be kept";
		case B_IS_A_DIRECTORY:
			return "this is a directory";
		case B_NOT_A_DIRECTORY:
			return "a part of the path is no directory";
		case B_DEVICE_FULL:
			return "no space is left";
		case B_READ_ONLY_DEVICE:
			return "the file system is read-only";
		case B_NO_MEMORY:
			return "not enough memory";
		case B_IO_ERROR:
			return "it cannot be read or written";
		case B_BUSY:
			return "the file is in use";
		default: {
			char text[32];
			snprintf(text, sizeof(text), "error 0x%08x", static_cast<unsigned>(status));
			return text;
		}
	}
}


bool
Exists(const std::string& path)
{
	struct stat stat;
	return lstat(path.c_str(), &stat) == 0;
}


namespace {

bool
WriteTemporary(const std::string& path, std::string_view bytes, mode_t mode)
{
	const int fd = open(path.c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, mode);
	if (fd < 0)
		return false;
	bool fine = true;
	while (fine && !bytes.empty()) {
		const ssize_t step = write(fd, bytes.data(), bytes.size());
		if (step > 0)
			bytes.remove_prefix(step);
		else
			fine = step < 0 && errno == EINTR;
	}
	fine = fine && fsync(fd) == 0;
	const int error = errno;
	fine = close(fd) == 0 && fine;
	if (!fine) {
		unlink(path.c_str());
		errno = error;
	}
	return fine;
}

} // namespace


bool
WriteWholeFile(const std::string& path, std::string_view bytes)
{
	if (path == "-") {
		Print(bytes);
		return true;
	}
	// Beside the real file, when the path is a link to it.
	char* real = realpath(path.c_str(), NULL);
	const std::string target = real != NULL ? real : path;
	free(real);
	struct stat stat;
	const bool there = ::stat(target.c_str(), &stat) == 0;
	if (there && !S_ISREG(stat.st_mode)) {
		Complain(path, "this is no regular file");
		return false;
	}

	const std::string temporary = target + "." + std::to_string(getpid()) + ".tmp";
	bool fine = WriteTemporary(temporary, bytes, there ? stat.st_mode & 0777 : 0666);
	if (fine && rename(temporary.c_str(), target.c_str()) < 0) {
		fine = false;
		unlink(temporary.c_str());
	}
	if (!fine)
		Complain(path, strerror(errno));
	return fine;
}


bool
CopyFile(const std::string& from, const std::string& to)
{
	std::string bytes;
	return ReadWholeFile(from, &bytes) && WriteWholeFile(to, bytes);
}

} // namespace Arcv
