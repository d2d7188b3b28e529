// BApplication: what scripts ask it for.

#include <Application.h>

#include <string.h>

#include <AppDefs.h>
#include <Message.h>
#include <Window.h>

#include "app/private/Delivery.h"
#include "app/private/LooperCore.h"
#include "app/private/LooperPrivate.h"

using BPrivate::LooperTable;


BHandler*
BApplication::ResolveSpecifier(
	BMessage* message, int32 index, BMessage* specifier, int32 form, const char* property)
{
	const bool namesWindow = property != nullptr && specifier != nullptr
		&& strcmp(property, "Window") == 0
		&& (form == B_INDEX_SPECIFIER || form == B_NAME_SPECIFIER);
	if (!namesWindow)
		return BLooper::ResolveSpecifier(message, index, specifier, form, property);

	// The rest of the specifiers is the window's, which answers in its own thread.
	const BMessenger window = _WindowFor(*specifier, form);
	if (window.IsValid()) {
		message->PopSpecifier();
		BPrivate::forward(*message, window);
	} else {
		BMessage reply(B_MESSAGE_NOT_UNDERSTOOD);
		reply.AddInt32("error", B_BAD_INDEX);
		reply.AddString("message", "There is no such window");
		message->SendReply(&reply);
	}
	return nullptr;
}


// The window of an index or title; an invalid messenger when there is none.
BMessenger
BApplication::_WindowFor(const BMessage& specifier, int32 form) const
{
	if (form == B_INDEX_SPECIFIER)
		return LooperTable::WindowMessenger(specifier.FindInt32("index"));

	const char* title = specifier.FindString("name");
	for (int32 i = 0; title != nullptr && i < CountWindows(); i++) {
		const BMessenger candidate = LooperTable::WindowMessenger(i);
		BLooper* looper = nullptr;
		if (!candidate.LockTarget())
			continue;
		candidate.Target(&looper);
		auto* window = dynamic_cast<BWindow*>(looper);
		const bool found = window != nullptr && strcmp(window->Title(), title) == 0;
		looper->Unlock();
		if (found)
			return candidate;
	}
	return BMessenger();
}


status_t
BApplication::GetSupportedSuites(BMessage* data)
{
	if (data == nullptr)
		return B_BAD_VALUE;
	const status_t status = data->AddString("suites", "suite/vnd.Be-application");
	return status == B_OK ? BLooper::GetSupportedSuites(data) : status;
}
