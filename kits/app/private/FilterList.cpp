#include "app/private/FilterList.h"

#include <Message.h>
#include <OS.h>

namespace BPrivate {


bool
FilterPrivate::Accepts(const BMessageFilter& filter, const BMessage& message)
{
	if (!filter.fFiltersAny && filter.fWhat != message.what)
		return false;
	if (filter.fDelivery != B_ANY_DELIVERY
		&& message.WasDropped() != (filter.fDelivery == B_DROPPED_DELIVERY))
		return false;
	return filter.fSource == B_ANY_SOURCE
		|| message.IsSourceRemote() == (filter.fSource == B_REMOTE_SOURCE);
}


filter_result
FilterPrivate::Run(BMessageFilter& filter, BMessage* message, BHandler** target)
{
	return filter.fHook != nullptr ? filter.fHook(message, target, &filter)
								   : filter.Filter(message, target);
}


bool
add_filter(BList*& list, BMessageFilter* filter, const BHandler* owner)
{
	if (filter == nullptr)
		return false;
	if (FilterPrivate::IsInstalled(filter)) {
		debugger("A BMessageFilter can only be used once.");
		return false;
	}
	if (list == nullptr)
		list = new BList;
	FilterPrivate::SetOwner(filter, owner);
	return list->AddItem(filter);
}


bool
remove_filter(BList* list, BMessageFilter* filter)
{
	if (list == nullptr || !list->RemoveItem(static_cast<void*>(filter)))
		return false;
	FilterPrivate::SetOwner(filter, nullptr);
	return true;
}


void
replace_filters(BList*& list, BList* newList, const BHandler* owner)
{
	if (list == newList)
		return;
	for (int32 i = 0; newList != nullptr && i < newList->CountItems(); i++) {
		auto* filter = static_cast<BMessageFilter*>(newList->ItemAt(i));
		if (FilterPrivate::IsInstalled(filter)) {
			debugger("A BMessageFilter can only be used once.");
			return;
		}
	}

	BList* old = list;
	list = newList;
	for (int32 i = 0; newList != nullptr && i < newList->CountItems(); i++)
		FilterPrivate::SetOwner(static_cast<BMessageFilter*>(newList->ItemAt(i)), owner);
	for (int32 i = 0; old != nullptr && i < old->CountItems(); i++)
		delete static_cast<BMessageFilter*>(old->ItemAt(i));
	delete old;
}


bool
run_filters(BList* const& list, BMessage* message, BHandler** target)
{
	for (int32 i = 0; list != nullptr && i < list->CountItems(); i++) {
		auto* filter = static_cast<BMessageFilter*>(list->ItemAt(i));
		if (FilterPrivate::Accepts(*filter, *message)
			&& FilterPrivate::Run(*filter, message, target) == B_SKIP_MESSAGE)
			return false;
	}
	return true;
}


} // namespace BPrivate
