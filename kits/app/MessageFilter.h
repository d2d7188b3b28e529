// BMessageFilter: looks at the messages of a looper or handler before they are dispatched.
#pragma once

#include <Handler.h>
#include <SupportDefs.h>

class BMessage;
class BMessageFilter;

namespace BPrivate {
class FilterPrivate;
}

enum filter_result { B_SKIP_MESSAGE, B_DISPATCH_MESSAGE };

typedef filter_result (*filter_hook)(BMessage* message, BHandler** target, BMessageFilter* filter);

enum message_delivery { B_ANY_DELIVERY, B_DROPPED_DELIVERY, B_PROGRAMMED_DELIVERY };

enum message_source { B_ANY_SOURCE, B_REMOTE_SOURCE, B_LOCAL_SOURCE };


// A filter is in one list at a time, whose owner deletes it. It runs in the looper's thread with
// the looper locked.
class _EXPORT BMessageFilter {
public:
	BMessageFilter(uint32 command, filter_hook hook = NULL);
	BMessageFilter(message_delivery delivery, message_source source, filter_hook hook = NULL);
	BMessageFilter(
		message_delivery delivery, message_source source, uint32 command, filter_hook hook = NULL);
	// Copies the settings; the copy is installed nowhere.
	BMessageFilter(const BMessageFilter& other);
	BMessageFilter(const BMessageFilter* other);
	virtual ~BMessageFilter();
	BMessageFilter& operator=(const BMessageFilter& other);

	// Not called when there is a hook. May edit the message and name another target.
	virtual filter_result Filter(BMessage* message, BHandler** target);

	message_delivery MessageDelivery() const;
	message_source MessageSource() const;
	uint32 Command() const;
	bool FiltersAnyCommand() const;
	BLooper* Looper() const;

private:
	friend class BPrivate::FilterPrivate;

	bool fFiltersAny;
	uint32 fWhat;
	message_delivery fDelivery;
	message_source fSource;
	filter_hook fHook;
	const BHandler* fOwner = nullptr; // borrowed: whose list it is in
};
