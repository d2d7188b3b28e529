// A library to preload: one chosen call that touches files fails, or ends the program.
//
// FAILING_CALL is the number of the call, from 1, counted over all that are listed here;
// FAILING_HOW is the error's number, "short" for a transfer of half the bytes, or "kill". The name
// of the call that failed is written to FAILING_REPORT.

#include <dlfcn.h>
#include <errno.h>
#include <fcntl.h>
#include <signal.h>
#include <stdarg.h>
#include <stdlib.h>
#include <string.h>
#include <sys/stat.h>
#include <sys/syscall.h>
#include <sys/xattr.h>
#include <unistd.h>

#include <atomic>

namespace {

std::atomic<int> sCount { 0 };

enum class Verdict { kGoOn, kFail, kShorten };


void
Report(const char* name)
{
	const char* path = getenv("FAILING_REPORT");
	if (path == nullptr)
		return;
	const int fd =
		static_cast<int>(syscall(SYS_openat, AT_FDCWD, path, O_WRONLY | O_CREAT | O_TRUNC, 0600));
	syscall(SYS_write, fd, name, strlen(name));
	syscall(SYS_close, fd);
}


Verdict
Judge(const char* name)
{
	const char* call = getenv("FAILING_CALL");
	const char* how = getenv("FAILING_HOW");
	if (call == nullptr || how == nullptr || ++sCount != atoi(call))
		return Verdict::kGoOn;
	Report(name);
	if (strcmp(how, "kill") == 0)
		raise(SIGKILL);
	if (strcmp(how, "short") == 0)
		return Verdict::kShorten;
	errno = atoi(how);
	return Verdict::kFail;
}


template<typename Function>
Function
Next(const char* name)
{
	return reinterpret_cast<Function>(dlsym(RTLD_NEXT, name));
}


// A call that only fails or not.
template<typename... Arguments>
int
Call(const char* name, Arguments... arguments)
{
	if (Judge(name) == Verdict::kFail)
		return -1;
	return Next<int (*)(Arguments...)>(name)(arguments...);
}

} // namespace


extern "C" {

int
open(const char* path, int flags, ...)
{
	va_list list;
	va_start(list, flags);
	const mode_t mode = va_arg(list, mode_t);
	va_end(list);
	return Call("open", path, flags, mode);
}


int
openat(int directory, const char* path, int flags, ...)
{
	va_list list;
	va_start(list, flags);
	const mode_t mode = va_arg(list, mode_t);
	va_end(list);
	return Call("openat", directory, path, flags, mode);
}


ssize_t
read(int fd, void* buffer, size_t size)
{
	const Verdict verdict = Judge("read");
	if (verdict == Verdict::kFail)
		return -1;
	if (verdict == Verdict::kShorten && size > 1)
		size /= 2;
	return Next<ssize_t (*)(int, void*, size_t)>("read")(fd, buffer, size);
}


ssize_t
pread(int fd, void* buffer, size_t size, off_t offset)
{
	const Verdict verdict = Judge("pread");
	if (verdict == Verdict::kFail)
		return -1;
	if (verdict == Verdict::kShorten && size > 1)
		size /= 2;
	return Next<ssize_t (*)(int, void*, size_t, off_t)>("pread")(fd, buffer, size, offset);
}


ssize_t
write(int fd, const void* buffer, size_t size)
{
	const Verdict verdict = Judge("write");
	if (verdict == Verdict::kFail)
		return -1;
	if (verdict == Verdict::kShorten && size > 1)
		size /= 2;
	return Next<ssize_t (*)(int, const void*, size_t)>("write")(fd, buffer, size);
}


int
fsync(int fd)
{
	return Call("fsync", fd);
}


int
close(int fd)
{
	return Call("close", fd);
}


int
dup3(int fd, int target, int flags) noexcept
{
	return Call("dup3", fd, target, flags);
}


off_t
lseek(int fd, off_t offset, int whence) noexcept
{
	if (Judge("lseek") == Verdict::kFail)
		return -1;
	return Next<off_t (*)(int, off_t, int)>("lseek")(fd, offset, whence);
}


int
rename(const char* from, const char* to) noexcept
{
	return Call("rename", from, to);
}


int
renameat(int fromDirectory, const char* from, int toDirectory, const char* to) noexcept
{
	return Call("renameat", fromDirectory, from, toDirectory, to);
}


int
unlink(const char* path) noexcept
{
	return Call("unlink", path);
}


int
unlinkat(int directory, const char* path, int flags) noexcept
{
	return Call("unlinkat", directory, path, flags);
}


int
fchmod(int fd, mode_t mode) noexcept
{
	return Call("fchmod", fd, mode);
}


int
fchown(int fd, uid_t owner, gid_t group) noexcept
{
	return Call("fchown", fd, owner, group);
}


int
faccessat(int directory, const char* path, int mode, int flags) noexcept
{
	return Call("faccessat", directory, path, mode, flags);
}


int
fstat(int fd, struct stat* stat) noexcept
{
	return Call("fstat", fd, stat);
}


ssize_t
readlink(const char* path, char* buffer, size_t size) noexcept
{
	if (Judge("readlink") == Verdict::kFail)
		return -1;
	return Next<ssize_t (*)(const char*, char*, size_t)>("readlink")(path, buffer, size);
}


ssize_t
listxattr(const char* path, char* list, size_t size) noexcept
{
	if (Judge("listxattr") == Verdict::kFail)
		return -1;
	return Next<ssize_t (*)(const char*, char*, size_t)>("listxattr")(path, list, size);
}


ssize_t
getxattr(const char* path, const char* name, void* value, size_t size) noexcept
{
	if (Judge("getxattr") == Verdict::kFail)
		return -1;
	return Next<ssize_t (*)(const char*, const char*, void*, size_t)>("getxattr")(
		path, name, value, size);
}


int
fsetxattr(int fd, const char* name, const void* value, size_t size, int flags) noexcept
{
	return Call("fsetxattr", fd, name, value, size, flags);
}

} // extern "C"
