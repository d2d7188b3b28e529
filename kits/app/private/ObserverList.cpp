#include "app/private/ObserverList.h"

#include <algorithm>

#include <Handler.h>
#include <Message.h>

namespace BPrivate {


bool
ObserverList::Observer::IsSameTarget(const Observer& other) const
{
	return handler == other.handler && messenger == other.messenger;
}


status_t
ObserverList::Add(const BHandler* observer, uint32 what)
{
	return _Add({ observer, BMessenger(), what });
}


status_t
ObserverList::Add(const BMessenger& observer, uint32 what)
{
	return _Add({ nullptr, observer, what });
}


status_t
ObserverList::Remove(const BHandler* observer, uint32 what)
{
	return _Remove({ observer, BMessenger(), what });
}


status_t
ObserverList::Remove(const BMessenger& observer, uint32 what)
{
	return _Remove({ nullptr, observer, what });
}


void
ObserverList::Send(uint32 what, BMessage* notice)
{
	std::erase_if(fObservers, [](const Observer& observer) {
		return observer.handler == nullptr && !observer.messenger.IsValid();
	});

	std::vector<BMessenger> told;
	for (const Observer& observer : fObservers) {
		if (observer.what != what && observer.what != B_OBSERVER_OBSERVE_ALL)
			continue;
		const BMessenger target =
			observer.handler != nullptr ? BMessenger(observer.handler) : observer.messenger;
		if (std::find(told.begin(), told.end(), target) != told.end())
			continue;
		told.push_back(target);
		target.SendMessage(notice);
	}
}


status_t
ObserverList::_Add(const Observer& observer)
{
	for (const Observer& known : fObservers) {
		if (known.what == observer.what && known.IsSameTarget(observer))
			return B_OK;
	}
	fObservers.push_back(observer);
	return B_OK;
}


status_t
ObserverList::_Remove(const Observer& observer)
{
	const size_t count = std::erase_if(fObservers, [&](const Observer& known) {
		return known.IsSameTarget(observer)
			&& (known.what == observer.what || observer.what == B_OBSERVER_OBSERVE_ALL);
	});
	return count > 0 ? B_OK : B_BAD_VALUE;
}


} // namespace BPrivate
