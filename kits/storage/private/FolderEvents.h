// FolderEvents: tells what comes, changes and goes in one folder.
#pragma once

#include <functional>
#include <set>
#include <string>
#include <thread>

#include <SupportDefs.h>

namespace BPrivate {

// Its thread sleeps until something happens. A folder that does not exist is waited for, through
// the nearest of its parents that does.
class FolderEvents {
public:
	// Called in the object's thread with the name of a file; an empty name stands for any.
	using Callback = std::function<void(const std::string& name)>;

	// What happens from now on is told once Run() was called.
	FolderEvents(const std::string& folder, Callback callback);
	// Waits until the callback has returned, so it must not be the one who calls this.
	~FolderEvents();

	status_t InitCheck() const { return fStatus; }
	status_t Run();
	const std::string& Folder() const { return fFolder; }

private:
	FolderEvents(const FolderEvents&);
	FolderEvents& operator=(const FolderEvents&);

	void _Listen();
	// False when there is nothing more to come.
	bool _ReadEvents();
	// Watches the folder or one of its parents.
	void _Watch();
	bool _WatchNearest();

	const std::string fFolder;
	const Callback fCallback;
	status_t fStatus;
	int fEvents; // where the system tells
	int fEnd; // readable when the thread is to end
	int fWatch; // a number, below 0 for none
	bool fAtFolder; // it is the folder itself that is watched
	std::thread fThread;
};

} // namespace BPrivate
