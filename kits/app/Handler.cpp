#include <Handler.h>

#include <algorithm>
#include <string.h>
#include <vector>

#include <AppDefs.h>
#include <List.h>
#include <Looper.h>
#include <Message.h>
#include <MessageFilter.h>
#include <PropertyInfo.h>

#include "app/private/FilterList.h"
#include "app/private/HandlerPrivate.h"
#include "app/private/HandlerTokens.h"
#include "app/private/ObserverList.h"

using BPrivate::HandlerTokens;

const char* B_OBSERVE_WHAT_CHANGE = "be:observe_change_what";
const char* B_OBSERVE_ORIGINAL_WHAT = "be:observe_orig_what";

namespace {

constexpr uint32 kStartWatching = '_OBS';
constexpr uint32 kStopWatching = '_OBP';
constexpr const char* kObserver = "be:observer";

property_info sHandlerProperties[] = {
	{ "Suites", { B_GET_PROPERTY }, { B_DIRECT_SPECIFIER }, NULL, 0, {}, {}, {} },
	{ "Messenger", { B_GET_PROPERTY }, { B_DIRECT_SPECIFIER }, NULL, 0, { B_MESSENGER_TYPE }, {},
		{} },
	{ "InternalName", { B_GET_PROPERTY }, { B_DIRECT_SPECIFIER }, NULL, 0, { B_STRING_TYPE }, {},
		{} },
	{},
};

} // namespace


BHandler::BHandler(const char* name)
{
	SetName(name);
}


BHandler::BHandler(BMessage* data) : BArchivable(data)
{
	const char* name = NULL;
	if (data != nullptr && data->FindString("_name", &name) == B_OK)
		SetName(name);
}


BHandler::~BHandler()
{
	// A looper has taken itself off already.
	if (LockLooper()) {
		BLooper* looper = Looper();
		looper->RemoveHandler(this);
		looper->Unlock();
	}
	if (const int32 token = fToken.load(); token >= 0)
		HandlerTokens::Remove(token);

	BPrivate::replace_filters(fFilters, nullptr, this);
	delete fObservers;
	free(fName);
}


BArchivable*
BHandler::Instantiate(BMessage* data)
{
	return validate_instantiation(data, "BHandler") ? new BHandler(data) : nullptr;
}


status_t
BHandler::Archive(BMessage* data, bool deep) const
{
	const status_t status = BArchivable::Archive(data, deep);
	if (status != B_OK || fName == nullptr)
		return status;
	return data->AddString("_name", fName);
}


void
BHandler::MessageReceived(BMessage* message)
{
	if (_HandleRequest(message))
		return;

	if (BHandler* next = fNextHandler) {
		// The message enters the next handler by its filters, like any other.
		BLooper* looper = Looper();
		if (looper != nullptr && !looper->_FilterByHandler(message, &next))
			return;
		if (next != nullptr)
			next->MessageReceived(message);
		return;
	}

	const bool expectsAnswer =
		message->WasDropped() || message->HasSpecifiers() || message->IsSourceWaiting();
	if (!expectsAnswer || message->what == B_MESSAGE_NOT_UNDERSTOOD)
		return;

	BMessage reply(B_MESSAGE_NOT_UNDERSTOOD);
	if (message->HasSpecifiers()) {
		reply.AddInt32("error", B_BAD_SCRIPT_SYNTAX);
		reply.AddString("message", "Didn't understand the specifier(s)");
	}
	message->SendReply(&reply);
}


BLooper*
BHandler::Looper() const
{
	return fLooper.load();
}


void
BHandler::SetName(const char* name)
{
	char* copy = name != nullptr ? strdup(name) : nullptr;
	free(fName);
	fName = copy;
}


const char*
BHandler::Name() const
{
	return fName;
}


void
BHandler::SetNextHandler(BHandler* handler)
{
	BLooper* looper = Looper();
	if (looper == nullptr) {
		debugger("handler must belong to looper before setting NextHandler");
		return;
	}
	if (!_CheckLooperLocked("SetNextHandler"))
		return;
	if (handler != nullptr && handler->Looper() != looper) {
		debugger("The handler and its NextHandler must have the same looper");
		return;
	}
	fNextHandler = handler;
}


BHandler*
BHandler::NextHandler() const
{
	return fNextHandler;
}


// #pragma mark - filters


void
BHandler::AddFilter(BMessageFilter* filter)
{
	if (_CheckLooperLocked("AddFilter"))
		BPrivate::add_filter(fFilters, filter, this);
}


bool
BHandler::RemoveFilter(BMessageFilter* filter)
{
	return _CheckLooperLocked("RemoveFilter") && BPrivate::remove_filter(fFilters, filter);
}


void
BHandler::SetFilterList(BList* filters)
{
	if (_CheckLooperLocked("SetFilterList"))
		BPrivate::replace_filters(fFilters, filters, this);
}


BList*
BHandler::FilterList()
{
	return fFilters;
}


// #pragma mark - lock


bool
BHandler::LockLooper()
{
	return LockLooperWithTimeout(B_INFINITE_TIMEOUT) == B_OK;
}


status_t
BHandler::LockLooperWithTimeout(bigtime_t timeout)
{
	BLooper* looper = Looper();
	if (looper == nullptr)
		return B_BAD_VALUE;
	if (const status_t status = looper->LockWithTimeout(timeout); status != B_OK)
		return status == B_BAD_PORT_ID && Looper() != looper ? B_MISMATCHED_VALUES : status;

	if (Looper() == looper)
		return B_OK;
	looper->Unlock();
	return B_MISMATCHED_VALUES;
}


void
BHandler::UnlockLooper()
{
	if (BLooper* looper = Looper())
		looper->Unlock();
}


// #pragma mark - scripting


BHandler*
BHandler::ResolveSpecifier(
	BMessage* message, int32 index, BMessage* specifier, int32 form, const char* property)
{
	const BPropertyInfo properties(sHandlerProperties);
	if (properties.FindMatch(message, index, specifier, form, property) >= 0)
		return this;

	BMessage reply(B_MESSAGE_NOT_UNDERSTOOD);
	reply.AddInt32("error", B_BAD_SCRIPT_SYNTAX);
	reply.AddString("message", "Didn't understand the specifier(s)");
	message->SendReply(&reply);
	return nullptr;
}


status_t
BHandler::GetSupportedSuites(BMessage* data)
{
	if (data == nullptr)
		return B_BAD_VALUE;
	const status_t status = data->AddString("suites", "suite/vnd.Be-handler");
	const BPropertyInfo properties(sHandlerProperties);
	return status == B_OK ? data->AddFlat("messages", &properties) : status;
}


// Returns whether the message was meant for every handler, and is done.
bool
BHandler::_HandleRequest(BMessage* message)
{
	switch (message->what) {
		case kStartWatching:
		case kStopWatching:
			return _HandleWatchRequest(*message);

		case B_GET_SUPPORTED_SUITES: {
			BMessage reply(B_REPLY);
			reply.AddInt32("error", GetSupportedSuites(&reply));
			message->SendReply(&reply);
			return true;
		}

		case B_GET_PROPERTY:
			return _ReplyToScript(message) == B_OK;

		default:
			return false;
	}
}


status_t
BHandler::_ReplyToScript(BMessage* message)
{
	BMessage specifier;
	int32 form = 0;
	const char* property = NULL;
	if (message->GetCurrentSpecifier(NULL, &specifier, &form, &property) != B_OK
		|| property == nullptr)
		return B_BAD_SCRIPT_SYNTAX;

	BMessage reply(B_REPLY);
	if (strcmp(property, "Suites") == 0)
		GetSupportedSuites(&reply);
	else if (strcmp(property, "Messenger") == 0)
		reply.AddMessenger("result", BMessenger(this));
	else if (strcmp(property, "InternalName") == 0)
		reply.AddString("result", Name() != nullptr ? Name() : "");
	else
		return B_BAD_SCRIPT_SYNTAX;

	reply.AddInt32("error", B_OK);
	return message->SendReply(&reply);
}


// #pragma mark - observers


status_t
BHandler::StartWatching(BMessenger target, uint32 what)
{
	return _AskToWatch(target, kStartWatching, what);
}


status_t
BHandler::StartWatchingAll(BMessenger target)
{
	return _AskToWatch(target, kStartWatching, B_OBSERVER_OBSERVE_ALL);
}


status_t
BHandler::StopWatching(BMessenger target, uint32 what)
{
	return _AskToWatch(target, kStopWatching, what);
}


status_t
BHandler::StopWatchingAll(BMessenger target)
{
	return _AskToWatch(target, kStopWatching, B_OBSERVER_OBSERVE_ALL);
}


status_t
BHandler::StartWatching(BHandler* observer, uint32 what)
{
	if (observer == nullptr)
		return B_BAD_HANDLER;
	if (fObservers == nullptr)
		fObservers = new BPrivate::ObserverList;
	return fObservers->Add(observer, what);
}


status_t
BHandler::StartWatchingAll(BHandler* observer)
{
	return StartWatching(observer, B_OBSERVER_OBSERVE_ALL);
}


status_t
BHandler::StopWatching(BHandler* observer, uint32 what)
{
	if (observer == nullptr)
		return B_BAD_HANDLER;
	return fObservers != nullptr ? fObservers->Remove(observer, what) : B_BAD_VALUE;
}


status_t
BHandler::StopWatchingAll(BHandler* observer)
{
	return StopWatching(observer, B_OBSERVER_OBSERVE_ALL);
}


void
BHandler::SendNotices(uint32 what, const BMessage* message)
{
	if (fObservers == nullptr)
		return;

	BMessage notice = message != nullptr ? *message : BMessage();
	notice.AddInt32(B_OBSERVE_ORIGINAL_WHAT, int32(notice.what));
	notice.AddInt32(B_OBSERVE_WHAT_CHANGE, int32(what));
	notice.what = B_OBSERVER_NOTICE_CHANGE;
	fObservers->Send(what, &notice);
}


bool
BHandler::IsWatched() const
{
	return fObservers != nullptr && !fObservers->IsEmpty();
}


status_t
BHandler::_AskToWatch(const BMessenger& observed, uint32 request, uint32 what)
{
	BMessage message(request);
	message.AddMessenger(kObserver, BMessenger(this));
	message.AddInt32(B_OBSERVE_WHAT_CHANGE, int32(what));
	return observed.SendMessage(&message);
}


bool
BHandler::_HandleWatchRequest(const BMessage& message)
{
	BMessenger observer;
	int32 what = 0;
	if (message.FindMessenger(kObserver, &observer) != B_OK
		|| message.FindInt32(B_OBSERVE_WHAT_CHANGE, &what) != B_OK)
		return false;

	if (message.what == kStartWatching) {
		if (fObservers == nullptr)
			fObservers = new BPrivate::ObserverList;
		fObservers->Add(observer, uint32(what));
	} else if (fObservers != nullptr)
		fObservers->Remove(observer, uint32(what));
	return true;
}


// Handlers without a looper belong to whoever has them; the others to the looper's lock.
bool
BHandler::_CheckLooperLocked(const char* function) const
{
	const BLooper* looper = Looper();
	if (looper == nullptr || looper->IsLocked())
		return true;

	char text[96];
	snprintf(text, sizeof(text), "Owning Looper must be locked before calling %s", function);
	debugger(text);
	return false;
}


// #pragma mark - private access


namespace BPrivate {


int32
HandlerPrivate::Token() const
{
	if (const int32 token = fHandler->fToken.load(); token >= 0)
		return token;

	const int32 made = HandlerTokens::Add(fHandler, fHandler->fLooper);
	int32 known = -1;
	if (!fHandler->fToken.compare_exchange_strong(known, made)) {
		HandlerTokens::Remove(made);
		return known;
	}
	// Who changed the looper before the token was visible did not know to update the table.
	HandlerTokens::Update(made, fHandler->fLooper);
	return made;
}


void
HandlerPrivate::SetLooper(BLooper* looper)
{
	fHandler->fLooper.store(looper);
	if (const int32 token = fHandler->fToken.load(); token >= 0)
		HandlerTokens::Update(token, fHandler->fLooper);
}


} // namespace BPrivate
