// Descriptor: one of the host's file descriptors, closed with its last owner.
#pragma once

#include <atomic>
#include <memory>
#include <string>

#include <sys/types.h>

#include <SupportDefs.h>

namespace BPrivate {

class Descriptor {
public:
	explicit Descriptor(int fd);
	~Descriptor();

	int Fd() const { return fFd; }

	// Lets all owners see what `fd` shows, which stays the caller's. The number stays the same.
	status_t Replace(int fd);

	// Keep other descriptors from locking the node: B_BUSY when somebody has done so, be it this
	// one; B_BAD_VALUE for unlocking what was not locked here. Any thread.
	status_t Lock();
	status_t Unlock();

private:
	Descriptor(const Descriptor&);
	Descriptor& operator=(const Descriptor&);

	const int fFd;
	std::atomic<bool> fLocked { false };
};

// A path under which the node can be found now; empty when it was deleted.
std::string PathOf(int fd);

// A path for calls that take no O_PATH descriptor.
std::string ProcPathOf(int fd);

// openat() that goes on after an interruption, and closes on exec.
int OpenAt(int directoryFd, const char* path, int flags, mode_t mode = 0);

// The directory that holds the last part of `path`, and that part. "." and ".." and an empty
// rest are no leaf: *_leaf is then empty and the descriptor is the directory itself. -1 and errno
// when the directory cannot be opened.
int OpenParent(int directoryFd, const char* path, std::string* _leaf);

} // namespace BPrivate
