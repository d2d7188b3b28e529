// How loopers run, handle their messages, and end.
#include <Looper.h>

#include <new>
#include <string.h>

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


thread_id
BLooper::Run()
{
	if (fCore->IsLooping()) {
		debugger("can't call BLooper::Run twice!");
		return Thread();
	}
	if (!_CheckLocked("Run"))
		return B_ERROR;

	const thread_id thread =
		spawn_thread(&_ThreadEntry, Name() != nullptr ? Name() : "looper", fPriority, this);
	if (thread < B_OK)
		return thread;

	fCore->BeginLoop(thread);
	fCore->Unlock();
	const status_t status = resume_thread(thread);
	return status == B_OK ? thread : status;
}


void
BLooper::Loop()
{
	if (fCore->IsLooping()) {
		debugger("can't call BLooper::Loop on a running looper!");
		return;
	}
	if (!_CheckLocked("Loop"))
		return;

	fInCallersThread = true;
	fCore->BeginLoop(find_thread(NULL));
	fCore->Unlock();
	_RunLoop();
	Lock();
	delete this;
}


status_t
BLooper::_ThreadEntry(void* data)
{
	auto* looper = static_cast<BLooper*>(data);
	looper->fCore->EnterLoop();
	looper->_RunLoop();
	return B_OK;
}


void
BLooper::_RunLoop()
{
	while (!fTerminating)
		_HandleNext();
}


void
BLooper::_HandleNext()
{
	fCore->WaitForMessage();
	fCore->Lock(B_INFINITE_TIMEOUT);
	// What comes first may have changed while the lock was somebody else's.
	if (BMessage* message = fCore->Take()) {
		BHandler* target = _TargetOf(message);
		if (target != nullptr)
			target = _ResolveScripting(message, target);
		_RouteMessage(message, target);
	}
	fCore->Unlock();
	fCore->WorkDone();
}


// NULL when the handler is gone, or belongs to another looper by now.
BHandler*
BLooper::_TargetOf(BMessage* message)
{
	const Delivery* delivery = Delivery::Find(*message);
	const int32 token = delivery != nullptr ? delivery->target : BPrivate::kNoToken;
	if (token >= 0)
		return HandlerTokens::FindIn(token, this);
	return fPreferredHandler != nullptr ? fPreferredHandler : this;
}


// Follows the specifiers of a scripting message; NULL when it was answered or passed on.
BHandler*
BLooper::_ResolveScripting(BMessage* message, BHandler* target)
{
	switch (message->what) {
		case B_SET_PROPERTY:
		case B_GET_PROPERTY:
		case B_CREATE_PROPERTY:
		case B_DELETE_PROPERTY:
		case B_COUNT_PROPERTIES:
		case B_EXECUTE_PROPERTY:
			break;
		default:
			return target;
	}

	int32 index = 0;
	int32 form = 0;
	const char* property = NULL;
	BMessage specifier;
	while (message->HasSpecifiers()
		&& message->GetCurrentSpecifier(&index, &specifier, &form, &property) == B_OK) {
		BHandler* next = target->ResolveSpecifier(message, index, &specifier, form, property);
		if (next == nullptr || next->Looper() != this)
			return nullptr;
		if (next == target)
			return target;
		target = next;
	}
	return target;
}


void
BLooper::_RouteMessage(BMessage* message, BHandler* target)
{
	if (target != nullptr)
		_Deliver(message, target);
	else
		delete message;
}


void
BLooper::_Deliver(BMessage* message, BHandler* target)
{
	Delivery::Of(*message).delivered = true;
	Dispatch dispatch { message, fDispatch };
	fDispatch = &dispatch;

	// A filter that skips everything must not keep the looper from ending.
	if (message->what == _QUIT_
		|| (_FilterCommon(message, &target) && _FilterByHandler(message, &target)))
		DispatchMessage(message, target);

	// Not reached when the message has ended the looper, which then deleted it.
	fDispatch = dispatch.outer;
	delete dispatch.message;
}


bool
BLooper::_FilterCommon(BMessage* message, BHandler** target)
{
	if (!BPrivate::run_filters(fCommonFilters, message, target))
		return false;
	return _CheckTarget(*target);
}


// Goes on to the filters of the new target as long as they name another one.
bool
BLooper::_FilterByHandler(BMessage* message, BHandler** target)
{
	BHandler* current = nullptr;
	while (current != *target) {
		current = *target;
		if (!BPrivate::run_filters(current->fFilters, message, target))
			return false;
		if (current != *target && !_CheckTarget(*target))
			return false;
	}
	return true;
}


bool
BLooper::_CheckTarget(const BHandler* target) const
{
	if (target != nullptr && target->Looper() == this)
		return true;
	debugger("The new handler must be in the same looper as before.");
	return false;
}


void
BLooper::_HandleQuitRequest(BMessage* message)
{
	const bool agreed = QuitRequested();
	if (message->IsSourceWaiting()) {
		BMessage reply(B_REPLY);
		reply.AddBool("result", agreed);
		reply.AddInt32("thread", Thread());
		message->SendReply(&reply);
	}
	if (agreed)
		Quit();
}


void
BLooper::Quit()
{
	if (!IsLocked()) {
		debugger("ERROR - you must Lock a looper before calling Quit()");
		return;
	}

	const thread_id thread = Thread();
	if (!fCore->IsLooping()) {
		fTerminating = true;
		delete this;
	} else if (thread == find_thread(NULL)) {
		fTerminating = true;
		// A loop in somebody's own thread ends, and the looper with it, after this message.
		if (fInCallersThread)
			return;
		delete this;
		exit_thread(B_OK);
	} else {
		// Behind what is queued. Others may quit it meanwhile, so only the core is touched.
		const std::shared_ptr<LooperCore> core = fCore;
		const bool ownThread = !fInCallersThread;
		auto message = std::make_unique<BMessage>(_QUIT_);
		Delivery::Of(*message).target = fCore->OwnToken();
		core->Put(std::move(message), false);
		core->UnlockAll();
		core->WaitUntilDead();
		if (ownThread)
			wait_for_thread(thread, NULL);
	}
}


bool
BLooper::QuitRequested()
{
	return true;
}
