// HandlerPrivate: what loopers and views may do to a handler beyond its public calls.
#pragma once

#include <Handler.h>

namespace BPrivate {


class HandlerPrivate {
public:
	explicit HandlerPrivate(const BHandler* handler) : fHandler(const_cast<BHandler*>(handler)) {}

	// The number that messages name the handler by; given at the first call. Any thread.
	int32 Token() const;
	// Sets the links without the checks of SetNextHandler(). The looper is locked.
	void SetNextHandler(BHandler* next) { fHandler->fNextHandler = next; }
	void SetLooper(BLooper* looper);
	int32 Slot() const { return fHandler->fSlot; }
	void SetSlot(int32 slot) { fHandler->fSlot = slot; }
	BList* Filters() const { return fHandler->fFilters; }

private:
	BHandler* fHandler; // borrowed
};


} // namespace BPrivate
