#include <Looper.h>

#include <new>
#include <stdio.h>
#include <string.h>
#include <unistd.h>
#include <vector>

#include <AppDefs.h>
#include <Message.h>
#include <MessageFilter.h>
#include <MessageQueue.h>
#include <Messenger.h>

#include "app/private/Delivery.h"
#include "app/private/FilterList.h"
#include "app/private/HandlerPrivate.h"
#include "app/private/HandlerTokens.h"
#include "app/private/LooperCore.h"
#include "app/private/LooperParts.h"

using BPrivate::Delivery;
using BPrivate::HandlerPrivate;
using BPrivate::HandlerTokens;
using BPrivate::LooperCore;
using BPrivate::LooperTable;


BLooper::BLooper(const char* name, int32 priority, int32 portCapacity) : BHandler(name)
{
	_Init(priority, portCapacity);
}


BLooper::BLooper(BMessage* data) : BHandler(data)
{
	int32 capacity = 0;
	if (data == nullptr || data->FindInt32("_port_cap", &capacity) != B_OK || capacity <= 0)
		capacity = B_LOOPER_PORT_DEFAULT_CAPACITY;
	int32 priority = 0;
	if (data == nullptr || data->FindInt32("_prio", &priority) != B_OK)
		priority = B_NORMAL_PRIORITY;
	_Init(priority, capacity);
}


void
BLooper::_Init(int32 priority, int32 portCapacity)
{
	fPriority = priority;
	fHandlers = std::make_unique<HandlerTable>();
	fCore = std::make_shared<LooperCore>(this, portCapacity);
	fCore->SetAddress(BPrivate::PortTable::Add(fCore), HandlerPrivate(this).Token());
	fCore->Lock(B_INFINITE_TIMEOUT);
	LooperTable::Add(this, fCore);
	AddHandler(this);
}


BLooper::~BLooper()
{
	if (fCore->IsLooping() && !fTerminating)
		debugger("You can't call delete on a BLooper object once it is running.");
	if (!IsLocked())
		debugger("The looper must be locked before it is deleted.");

	BPrivate::PortTable::Remove(fCore->PortId());
	for (Dispatch* dispatch = fDispatch; dispatch != nullptr; dispatch = dispatch->outer) {
		delete dispatch->message;
		dispatch->message = nullptr;
	}

	for (BHandler* handler : fHandlers->slots) {
		if (handler == nullptr)
			continue;
		HandlerPrivate access(handler);
		access.SetNextHandler(nullptr);
		access.SetSlot(-1);
		access.SetLooper(nullptr);
	}
	BPrivate::replace_filters(fCommonFilters, nullptr, this);

	LooperTable::Remove(this);
	fCore->Die();
}


BArchivable*
BLooper::Instantiate(BMessage* data)
{
	return validate_instantiation(data, "BLooper") ? new BLooper(data) : nullptr;
}


status_t
BLooper::Archive(BMessage* data, bool deep) const
{
	status_t status = BHandler::Archive(data, deep);
	if (status == B_OK)
		status = data->AddInt32("_port_cap", fCore->Capacity());
	if (status == B_OK)
		status = data->AddInt32("_prio", fPriority);
	return status;
}


// #pragma mark - posting


status_t
BLooper::PostMessage(uint32 command)
{
	return _Post(BMessage(command), fCore->OwnToken(), nullptr);
}


status_t
BLooper::PostMessage(BMessage* message)
{
	if (message == nullptr)
		return B_BAD_VALUE;
	return _Post(*message, fCore->OwnToken(), nullptr);
}


status_t
BLooper::PostMessage(uint32 command, BHandler* handler, BHandler* replyTo)
{
	BMessage message(command);
	return PostMessage(&message, handler, replyTo);
}


status_t
BLooper::PostMessage(BMessage* message, BHandler* handler, BHandler* replyTo)
{
	if (message == nullptr)
		return B_BAD_VALUE;
	if (handler == nullptr)
		return _Post(*message, BPrivate::kPreferredToken, replyTo);
	if (handler->Looper() != this)
		return B_MISMATCHED_VALUES;
	return _Post(*message, HandlerPrivate(handler).Token(), replyTo);
}


status_t
BLooper::_Post(const BMessage& message, int32 token, BHandler* replyTo)
{
	auto copy = std::make_unique<BMessage>(message);
	Delivery& delivery = Delivery::Of(*copy);
	delivery.target = token;
	delivery.delivered = true;
	delivery.replyTo = BPrivate::reply_address(replyTo);
	return fCore->Receive(std::move(copy), 0);
}


// #pragma mark - messages


void
BLooper::DispatchMessage(BMessage* message, BHandler* handler)
{
	if (handler == this && message->what == _QUIT_) {
		fTerminating = true;
		if (!fInCallersThread) {
			delete this;
			exit_thread(B_OK);
		}
		return;
	}
	if (handler == this && message->what == B_QUIT_REQUESTED) {
		_HandleQuitRequest(message);
		return;
	}
	handler->MessageReceived(message);
}


void
BLooper::MessageReceived(BMessage* message)
{
	BHandler::MessageReceived(message);
}


BMessage*
BLooper::CurrentMessage() const
{
	return fDispatch != nullptr && Thread() == find_thread(NULL) ? fDispatch->message : nullptr;
}


BMessage*
BLooper::DetachCurrentMessage()
{
	BMessage* message = CurrentMessage();
	if (message != nullptr)
		fDispatch->message = nullptr;
	return message;
}


BMessageQueue*
BLooper::MessageQueue() const
{
	return &fCore->Queue();
}


bool
BLooper::IsMessageWaiting() const
{
	return !fCore->Queue().IsEmpty();
}


// #pragma mark - handlers


void
BLooper::AddHandler(BHandler* handler)
{
	if (handler == nullptr || !_CheckLocked("AddHandler"))
		return;
	if (handler->Looper() != nullptr) {
		debugger("The handler belongs to a looper already.");
		return;
	}

	HandlerPrivate access(handler);
	access.SetSlot(int32(fHandlers->slots.size()));
	fHandlers->slots.push_back(handler);
	access.SetLooper(this);
	access.SetNextHandler(handler == this ? nullptr : this);
}


bool
BLooper::RemoveHandler(BHandler* handler)
{
	if (handler == nullptr || !_CheckLocked("RemoveHandler"))
		return false;
	if (handler->Looper() != this || handler == this)
		return false;

	if (handler == fPreferredHandler)
		fPreferredHandler = nullptr;

	HandlerPrivate access(handler);
	fHandlers->slots[access.Slot()] = nullptr;
	fHandlers->holes++;
	access.SetNextHandler(nullptr);
	access.SetSlot(-1);
	access.SetLooper(nullptr);
	if (size_t(fHandlers->holes) * 2 > fHandlers->slots.size())
		_CompactHandlers();
	return true;
}


void
BLooper::_CompactHandlers() const
{
	if (fHandlers->holes == 0)
		return;
	std::erase(fHandlers->slots, nullptr);
	fHandlers->holes = 0;
	for (size_t i = 0; i < fHandlers->slots.size(); i++)
		HandlerPrivate(fHandlers->slots[i]).SetSlot(int32(i));
}


int32
BLooper::CountHandlers() const
{
	if (!_CheckLocked("CountHandlers"))
		return 0;
	return int32(fHandlers->slots.size()) - fHandlers->holes;
}


BHandler*
BLooper::HandlerAt(int32 index) const
{
	if (!_CheckLocked("HandlerAt"))
		return nullptr;
	_CompactHandlers();
	return index >= 0 && size_t(index) < fHandlers->slots.size() ? fHandlers->slots[index]
																 : nullptr;
}


int32
BLooper::IndexOf(BHandler* handler) const
{
	if (!_CheckLocked("IndexOf") || handler == nullptr || handler->Looper() != this)
		return -1;
	_CompactHandlers();
	return HandlerPrivate(handler).Slot();
}


BHandler*
BLooper::PreferredHandler() const
{
	return fPreferredHandler;
}


void
BLooper::SetPreferredHandler(BHandler* handler)
{
	if (!_CheckLocked("SetPreferredHandler"))
		return;
	fPreferredHandler = handler != nullptr && handler->Looper() == this ? handler : nullptr;
}


// #pragma mark - lock


bool
BLooper::Lock()
{
	return LockWithTimeout(B_INFINITE_TIMEOUT) == B_OK;
}


void
BLooper::Unlock()
{
	// Who holds the lock of a looper that has just ended in his hands may still let go of it.
	const std::shared_ptr<LooperCore> core = LooperTable::Find(this);
	if (!core)
		return;
	if (!core->IsLockedByCaller()) {
		debugger("looper must be locked before it is unlocked");
		return;
	}
	core->Unlock();
}


bool
BLooper::IsLocked() const
{
	return fCore->IsLockedByCaller();
}


status_t
BLooper::LockWithTimeout(bigtime_t timeout)
{
	// The address alone is looked at: the looper may be gone.
	const std::shared_ptr<LooperCore> core = LooperTable::Find(this);
	return core ? core->Lock(timeout) : B_BAD_PORT_ID;
}


thread_id
BLooper::Thread() const
{
	return fCore->Thread();
}


team_id
BLooper::Team() const
{
	return getpid();
}


BLooper*
BLooper::LooperForThread(thread_id thread)
{
	return LooperTable::FindByThread(thread);
}


thread_id
BLooper::LockingThread() const
{
	return fCore->Owner();
}


int32
BLooper::CountLocks() const
{
	return fCore->CountLocks();
}


int32
BLooper::CountLockRequests() const
{
	return fCore->CountRequests();
}


sem_id
BLooper::Sem() const
{
	return -1;
}


bool
BLooper::_CheckLocked(const char* function) const
{
	if (IsLocked())
		return true;
	char text[96];
	snprintf(text, sizeof(text), "Looper must be locked before calling %s", function);
	debugger(text);
	return false;
}


// #pragma mark - scripting


BHandler*
BLooper::ResolveSpecifier(
	BMessage* message, int32 index, BMessage* specifier, int32 form, const char* property)
{
	if (property == nullptr || specifier == nullptr || strcmp(property, "Handler") != 0)
		return BHandler::ResolveSpecifier(message, index, specifier, form, property);

	BHandler* found = nullptr;
	if (form == B_NAME_SPECIFIER) {
		const char* name = specifier->FindString("name");
		for (BHandler* handler : fHandlers->slots) {
			if (found == nullptr && name != nullptr && handler != nullptr
				&& handler->Name() != nullptr && strcmp(handler->Name(), name) == 0)
				found = handler;
		}
	} else if (form == B_INDEX_SPECIFIER || form == B_REVERSE_INDEX_SPECIFIER) {
		const int32 at = specifier->FindInt32("index");
		found = HandlerAt(form == B_INDEX_SPECIFIER ? at : CountHandlers() - at);
	}
	if (found == nullptr)
		return BHandler::ResolveSpecifier(message, index, specifier, form, property);

	message->PopSpecifier();
	return found;
}


status_t
BLooper::GetSupportedSuites(BMessage* data)
{
	if (data == nullptr)
		return B_BAD_VALUE;
	const status_t status = data->AddString("suites", "suite/vnd.Be-looper");
	return status == B_OK ? BHandler::GetSupportedSuites(data) : status;
}


// #pragma mark - common filters


void
BLooper::AddCommonFilter(BMessageFilter* filter)
{
	if (_CheckLocked("AddCommonFilter"))
		BPrivate::add_filter(fCommonFilters, filter, this);
}


bool
BLooper::RemoveCommonFilter(BMessageFilter* filter)
{
	return _CheckLocked("RemoveCommonFilter") && BPrivate::remove_filter(fCommonFilters, filter);
}


void
BLooper::SetCommonFilterList(BList* filters)
{
	if (_CheckLocked("SetCommonFilterList"))
		BPrivate::replace_filters(fCommonFilters, filters, this);
}


BList*
BLooper::CommonFilterList() const
{
	return fCommonFilters;
}
