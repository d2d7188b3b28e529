// Windows as scripts see them: title, frame and kind, their views and their menu bar.
#include <Window.h>

#include <cstring>

#include <AppDefs.h>
#include <MenuBar.h>
#include <Message.h>
#include <PropertyInfo.h>

#include "interface/private/ViewScripting.h"

using namespace BPrivate;

namespace {

enum {
	kFeel = 0,
	kFlags,
	kFrame,
	kHidden,
	kLook,
	kMinimize,
	kTitle,
	kWorkspaces,
	kViewCount,
};

constexpr property_info
property_of(const char* name, type_code type)
{
	return { name, { B_GET_PROPERTY, B_SET_PROPERTY }, { B_DIRECT_SPECIFIER }, NULL, 0, { type },
		{}, {} };
}

property_info sProperties[] = {
	property_of("Feel", B_INT32_TYPE),
	property_of("Flags", B_INT32_TYPE),
	property_of("Frame", B_RECT_TYPE),
	property_of("Hidden", B_BOOL_TYPE),
	property_of("Look", B_INT32_TYPE),
	property_of("Minimize", B_BOOL_TYPE),
	property_of("Title", B_STRING_TYPE),
	property_of("Workspaces", B_INT32_TYPE),
	{ "View", { B_COUNT_PROPERTIES }, { B_DIRECT_SPECIFIER }, NULL, 0, { B_INT32_TYPE }, {}, {} },
	{ NULL, {}, {}, NULL, 0, {}, {}, {} },
};


status_t
get_property(const BWindow* window, int32 property, BMessage* reply)
{
	switch (property) {
		case kFeel:
			return reply->AddInt32("result", window->Feel());
		case kFlags:
			return reply->AddInt32("result", window->Flags());
		case kFrame:
			return reply->AddRect("result", window->Frame());
		case kHidden:
			return reply->AddBool("result", window->IsHidden());
		case kLook:
			return reply->AddInt32("result", window->Look());
		case kMinimize:
			return reply->AddBool("result", window->IsMinimized());
		case kTitle:
			return reply->AddString("result", window->Title());
		case kWorkspaces:
			return reply->AddInt32("result", window->Workspaces());
		default:
			return reply->AddInt32("result", window->CountChildren());
	}
}


status_t
set_number(BWindow* window, int32 property, int32 number)
{
	switch (property) {
		case kFeel:
			return window->SetFeel(static_cast<window_feel>(number));
		case kFlags:
			return window->SetFlags(number);
		case kLook:
			return window->SetLook(static_cast<window_look>(number));
		default:
			window->SetWorkspaces(number);
			return B_OK;
	}
}


status_t
set_flag(BWindow* window, int32 property, bool on)
{
	if (property == kMinimize)
		window->Minimize(on);
	else if (on && !window->IsHidden())
		window->Hide();
	else if (!on && window->IsHidden())
		window->Show();
	return B_OK;
}


status_t
set_property(BWindow* window, int32 property, BMessage* message)
{
	BRect frame;
	bool on;
	const char* title;
	int32 number;
	switch (property) {
		case kFrame:
			if (message->FindRect("data", &frame) != B_OK || !frame.IsValid())
				return B_BAD_VALUE;
			window->MoveTo(frame.LeftTop());
			window->ResizeTo(frame.Width(), frame.Height());
			return B_OK;

		case kHidden:
		case kMinimize:
			return message->FindBool("data", &on) == B_OK ? set_flag(window, property, on)
														  : B_BAD_VALUE;

		case kTitle:
			if (message->FindString("data", &title) != B_OK)
				return B_BAD_VALUE;
			window->SetTitle(title);
			return B_OK;

		default:
			return message->FindInt32("data", &number) == B_OK
				? set_number(window, property, number)
				: B_BAD_VALUE;
	}
}

} // namespace


bool
BPrivate::handle_window_property(BWindow* window, BMessage* message)
{
	const int32 match = match_property(sProperties, message);
	if (match < 0)
		return false;
	BMessage reply(B_REPLY);
	const status_t status = message->what == B_SET_PROPERTY ? set_property(window, match, message)
															: get_property(window, match, &reply);
	reply.AddInt32("error", status);
	message->SendReply(&reply);
	return true;
}


BView*
BPrivate::find_child(const BWindow* parent, BMessage* specifier, int32 form)
{
	int32 index;
	const char* name;
	if (form == B_NAME_SPECIFIER)
		return specifier->FindString("name", &name) == B_OK ? parent->FindView(name) : NULL;
	if (specifier->FindInt32("index", &index) != B_OK || index < 0)
		return NULL;
	if (form == B_REVERSE_INDEX_SPECIFIER && index <= parent->CountChildren())
		index = parent->CountChildren() - index;
	else if (form != B_INDEX_SPECIFIER)
		return NULL;
	return parent->ChildAt(index);
}


BHandler*
BWindow::ResolveSpecifier(
	BMessage* message, int32 index, BMessage* specifier, int32 form, const char* property)
{
	if (BPropertyInfo(sProperties).FindMatch(message, index, specifier, form, property) >= 0)
		return this;
	BHandler* target = nullptr;
	if (property != nullptr && std::strcmp(property, "View") == 0)
		target = find_child(this, specifier, form);
	else if (property != nullptr && std::strcmp(property, "MenuBar") == 0)
		target = form == B_DIRECT_SPECIFIER ? KeyMenuBar() : nullptr;
	if (target == nullptr)
		return BLooper::ResolveSpecifier(message, index, specifier, form, property);
	message->PopSpecifier();
	return target;
}


status_t
BWindow::GetSupportedSuites(BMessage* data)
{
	if (data == nullptr)
		return B_BAD_VALUE;
	const status_t status = data->AddString("suites", "suite/vnd.Be-window");
	return status == B_OK ? BLooper::GetSupportedSuites(data) : status;
}
