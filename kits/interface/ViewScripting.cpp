// Views as scripts see them: frame, visibility and children.
#include <View.h>

#include <cstring>

#include <AppDefs.h>
#include <Message.h>
#include <PropertyInfo.h>
#include <Shelf.h>

#include "interface/private/ViewScripting.h"
#include "interface/private/ViewState.h"

using namespace BPrivate;

namespace {

enum { kFrame = 0, kHidden, kChildCount };

property_info sProperties[] = {
	{ "Frame", { B_GET_PROPERTY, B_SET_PROPERTY }, { B_DIRECT_SPECIFIER }, NULL, 0, { B_RECT_TYPE },
		{}, {} },
	{ "Hidden", { B_GET_PROPERTY, B_SET_PROPERTY }, { B_DIRECT_SPECIFIER }, NULL, 0,
		{ B_BOOL_TYPE }, {}, {} },
	{ "View", { B_COUNT_PROPERTIES }, { B_DIRECT_SPECIFIER }, NULL, 0, { B_INT32_TYPE }, {}, {} },
	{ NULL, {}, {}, NULL, 0, {}, {}, {} },
};


status_t
get_property(const BView* view, int32 property, BMessage* reply)
{
	switch (property) {
		case kFrame:
			return reply->AddRect("result", view->Frame());
		case kHidden:
			return reply->AddBool("result", view->IsHidden());
		default:
			return reply->AddInt32("result", view->CountChildren());
	}
}


status_t
set_property(BView* view, int32 property, BMessage* message)
{
	if (property == kFrame) {
		BRect frame;
		if (message->FindRect("data", &frame) != B_OK || !frame.IsValid())
			return B_BAD_VALUE;
		view->MoveTo(frame.LeftTop());
		view->ResizeTo(frame.Width(), frame.Height());
		return B_OK;
	}

	bool hidden;
	const status_t status = message->FindBool("data", &hidden);
	if (status == B_OK && hidden != view->IsHidden(view)) {
		if (hidden)
			view->Hide();
		else
			view->Show();
	}
	return status;
}


// The index of a child, counted from the end for the reverse form; -1 if that is no index.
int32
index_of(BMessage* specifier, int32 form, int32 count)
{
	int32 index;
	if (specifier->FindInt32("index", &index) != B_OK)
		return -1;
	if (form == B_REVERSE_INDEX_SPECIFIER)
		return index >= 0 && index <= count ? count - index : -1;
	return form == B_INDEX_SPECIFIER ? index : -1;
}

} // namespace


BView*
BPrivate::find_child(const BView* parent, BMessage* specifier, int32 form)
{
	if (form != B_NAME_SPECIFIER)
		return parent->ChildAt(index_of(specifier, form, parent->CountChildren()));
	const char* name;
	BView* found = NULL;
	if (specifier->FindString("name", &name) == B_OK) {
		for (BView* child = parent->ChildAt(0); child != NULL && found == NULL;
			 child = child->NextSibling())
			found = child->FindView(name);
	}
	return found;
}


int32
BPrivate::match_property(property_info* properties, BMessage* message)
{
	int32 index;
	BMessage specifier;
	int32 form;
	const char* property;
	if (message->GetCurrentSpecifier(&index, &specifier, &form, &property) != B_OK)
		return -1;
	return BPropertyInfo(properties).FindMatch(message, index, &specifier, form, property);
}


bool
BPrivate::handle_view_property(BView* view, BMessage* message)
{
	const int32 match = match_property(sProperties, message);
	if (match < 0)
		return false;
	BMessage reply(B_REPLY);
	const status_t status = message->what == B_SET_PROPERTY ? set_property(view, match, message)
															: get_property(view, match, &reply);
	reply.AddInt32("error", status);
	message->SendReply(&reply);
	return true;
}


BHandler*
BView::ResolveSpecifier(
	BMessage* message, int32 index, BMessage* specifier, int32 form, const char* property)
{
	if (BPropertyInfo(sProperties).FindMatch(message, index, specifier, form, property) >= 0)
		return this;
	if (property != nullptr && std::strcmp(property, "Shelf") == 0) {
		if (BShelf* shelf = fExtras != nullptr ? fExtras->shelf : nullptr) {
			message->PopSpecifier();
			return shelf;
		}
	}
	if (property != nullptr && std::strcmp(property, "View") == 0) {
		if (BView* child = find_child(this, specifier, form)) {
			message->PopSpecifier();
			return child;
		}
	}
	return BHandler::ResolveSpecifier(message, index, specifier, form, property);
}


status_t
BView::GetSupportedSuites(BMessage* data)
{
	if (data == nullptr)
		return B_BAD_VALUE;
	const status_t status = data->AddString("suites", "suite/vnd.Be-view");
	return status == B_OK ? BHandler::GetSupportedSuites(data) : status;
}
