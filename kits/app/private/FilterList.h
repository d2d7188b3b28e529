// FilterList: what a handler and a looper do with a list of filters.
#pragma once

#include <List.h>
#include <MessageFilter.h>

namespace BPrivate {


class FilterPrivate {
public:
	static bool IsInstalled(const BMessageFilter* filter) { return filter->fOwner != nullptr; }
	static void SetOwner(BMessageFilter* filter, const BHandler* owner) { filter->fOwner = owner; }
	static bool Accepts(const BMessageFilter& filter, const BMessage& message);
	static filter_result Run(BMessageFilter& filter, BMessage* message, BHandler** target);
};


// Each refuses, through debugger(), a filter that is in a list already. The list is made when the
// first filter comes.
bool add_filter(BList*& list, BMessageFilter* filter, const BHandler* owner);
bool remove_filter(BList* list, BMessageFilter* filter);
// Deletes the filters of the old list and the list itself.
void replace_filters(BList*& list, BList* newList, const BHandler* owner);
// False when a filter skips the message. A filter may change the list meanwhile.
bool run_filters(BList* const& list, BMessage* message, BHandler** target);


} // namespace BPrivate
