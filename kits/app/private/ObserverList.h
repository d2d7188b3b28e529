// ObserverList: who watches a handler, and for what.
#pragma once

#include <vector>

#include <Messenger.h>

class BHandler;
class BMessage;

namespace BPrivate {


// Under the lock of the watched handler's looper, if it has one. A handler that watches directly
// may come into its looper later, and stops watching before it goes.
class ObserverList {
public:
	status_t Add(const BHandler* observer, uint32 what);
	status_t Add(const BMessenger& observer, uint32 what);
	// Watching everything ends with all that was watched.
	status_t Remove(const BHandler* observer, uint32 what);
	status_t Remove(const BMessenger& observer, uint32 what);

	// To everyone who watches this code or all codes, once each. Forgets targets that are gone.
	void Send(uint32 what, BMessage* notice);
	bool IsEmpty() const { return fObservers.empty(); }

private:
	struct Observer {
		const BHandler* handler; // borrowed; NULL for a messenger
		BMessenger messenger;
		uint32 what;

		bool IsSameTarget(const Observer& other) const;
	};

	status_t _Add(const Observer& observer);
	status_t _Remove(const Observer& observer);

	std::vector<Observer> fObservers;
};


} // namespace BPrivate
