// BTextView: what scripts may do to it.
#include "TextView.h"

#include <cstring>

#include <AppDefs.h>
#include <Message.h>
#include <PropertyInfo.h>

#include "interface/private/TextLayout.h"

namespace {

constexpr const char* kSuite = "suite/vnd.Be-text-view";

property_info sProperties[] = {
	{ "Selection", { B_GET_PROPERTY, B_SET_PROPERTY, 0 }, { B_DIRECT_SPECIFIER, 0 },
		"Where the selection starts and ends.", 0, {}, {}, {} },
	{ "Text", { B_COUNT_PROPERTIES, 0 }, { B_DIRECT_SPECIFIER, 0 }, "How long the text is.", 0, {},
		{}, {} },
	{ "Text", { B_GET_PROPERTY, 0 }, { B_DIRECT_SPECIFIER, B_RANGE_SPECIFIER, 0 },
		"The text, or a part of it.", 0, {}, {}, {} },
	{ "Text", { B_SET_PROPERTY, 0 }, { B_DIRECT_SPECIFIER, B_RANGE_SPECIFIER, 0 },
		"Replaces the text, or a part of it; without data removes it.", 0, {}, {}, {} },
	{},
};


} // namespace


BHandler*
BTextView::ResolveSpecifier(
	BMessage* message, int32 index, BMessage* specifier, int32 form, const char* property)
{
	BPropertyInfo info(sProperties);
	if (info.FindMatch(message, index, specifier, form, property) >= 0)
		return this;
	return BView::ResolveSpecifier(message, index, specifier, form, property);
}


status_t
BTextView::GetSupportedSuites(BMessage* data)
{
	if (data == NULL)
		return B_BAD_VALUE;
	data->AddString("suites", kSuite);
	return BView::GetSupportedSuites(data);
}


bool
BTextView::_HandleProperty(BMessage* message)
{
	int32 index, form;
	BMessage specifier;
	const char* property;
	if (message->GetCurrentSpecifier(&index, &specifier, &form, &property) != B_OK)
		return false;
	BPropertyInfo info(sProperties);
	if (info.FindMatch(message, index, &specifier, form, property) < 0)
		return false;

	BMessage reply(B_REPLY);
	status_t status = B_OK;
	if (strcmp(property, "Selection") == 0)
		status = _HandleSelectionProperty(message, &reply);
	else
		status = _HandleTextProperty(message, specifier, form, &reply);
	reply.AddInt32("error", status);
	message->SendReply(&reply);
	return true;
}


status_t
BTextView::_HandleSelectionProperty(BMessage* message, BMessage* reply)
{
	if (message->what == B_GET_PROPERTY) {
		reply->AddInt32("result", _Start());
		reply->AddInt32("result", _End());
		return B_OK;
	}
	int32 start, end;
	if (message->FindInt32("data", 0, &start) != B_OK
		|| message->FindInt32("data", 1, &end) != B_OK)
		return B_BAD_VALUE;
	Select(start, end);
	return B_OK;
}


status_t
BTextView::_HandleTextProperty(
	BMessage* message, const BMessage& specifier, int32 form, BMessage* reply)
{
	if (message->what == B_COUNT_PROPERTIES)
		return reply->AddInt32("result", TextLength());

	int32 from = 0;
	int32 length = TextLength();
	if (form == B_RANGE_SPECIFIER
		&& (specifier.FindInt32("index", &from) != B_OK
			|| specifier.FindInt32("range", &length) != B_OK))
		return B_BAD_VALUE;
	if (from < 0 || length < 0 || from > TextLength() || length > TextLength() - from)
		return B_BAD_INDEX;

	if (message->what == B_GET_PROPERTY) {
		std::string text(length + 1, '\0');
		GetText(from, length, text.data());
		return reply->AddString("result", text.c_str());
	}
	const char* text;
	if (message->FindString("data", &text) != B_OK) {
		Delete(from, from + length);
	} else if (form == B_RANGE_SPECIFIER) {
		Delete(from, from + length);
		Insert(from, text, static_cast<int32>(strlen(text)));
	} else {
		SetText(text);
	}
	return B_OK;
}
