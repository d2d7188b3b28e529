// Shelves as scripts see them: a list of replicants.
#include <Shelf.h>

#include <cstring>

#include <AppDefs.h>
#include <Entry.h>
#include <Message.h>
#include <PropertyInfo.h>
#include <View.h>

#include "interface/private/Replicants.h"
#include "interface/private/ViewScripting.h"

namespace {

// All are "Replicant": of the shelf as a whole, and one that a specifier tells.
enum { kReplicants = 0, kReplicant };

property_info sProperties[] = {
	{ "Replicant", { B_COUNT_PROPERTIES, B_CREATE_PROPERTY }, { B_DIRECT_SPECIFIER }, NULL, 0, {},
		{}, {} },
	{ "Replicant", { B_GET_PROPERTY, B_DELETE_PROPERTY },
		{ B_INDEX_SPECIFIER, B_REVERSE_INDEX_SPECIFIER, B_NAME_SPECIFIER, B_ID_SPECIFIER }, NULL, 0,
		{ B_MESSAGE_TYPE }, {}, {} },
	{ NULL, {}, {}, NULL, 0, {}, {}, {} },
};

} // namespace


BHandler*
BShelf::ResolveSpecifier(
	BMessage* message, int32 index, BMessage* specifier, int32 form, const char* property)
{
	if (BPropertyInfo(sProperties).FindMatch(message, index, specifier, form, property) >= 0)
		return this;
	return BHandler::ResolveSpecifier(message, index, specifier, form, property);
}


status_t
BShelf::GetSupportedSuites(BMessage* data)
{
	if (data == NULL)
		return B_BAD_VALUE;
	const status_t status = data->AddString("suites", "suite/vnd.Be-shelf");
	if (status != B_OK)
		return status;
	const BPropertyInfo info(sProperties);
	data->AddFlat("messages", &info);
	return BHandler::GetSupportedSuites(data);
}


// A name is that of the replicant's view.
int32
BShelf::_IndexOf(BMessage* specifier, int32 form) const
{
	int32 number = -1;
	if (form == B_NAME_SPECIFIER) {
		const char* name;
		if (specifier->FindString("name", &name) != B_OK)
			return -1;
		for (int32 i = 0; i < CountReplicants(); i++) {
			const BView* view = _ViewOf(*fReplicants[i]);
			if (view != NULL && view->Name() != NULL && std::strcmp(view->Name(), name) == 0)
				return i;
		}
		return -1;
	}
	if (form == B_ID_SPECIFIER)
		return specifier->FindInt32("id", &number) == B_OK ? IndexOf(static_cast<uint32>(number))
														   : -1;
	if (specifier->FindInt32("index", &number) != B_OK)
		return -1;
	return form == B_REVERSE_INDEX_SPECIFIER ? CountReplicants() - number : number;
}


// Whether the message asked for a property of the class, and was answered.
bool
BShelf::_HandleProperty(BMessage* message)
{
	const int32 match = BPrivate::match_property(sProperties, message);
	if (match < 0)
		return false;
	int32 current;
	BMessage specifier;
	int32 form;
	const char* property;
	message->GetCurrentSpecifier(&current, &specifier, &form, &property);

	BMessage reply(B_REPLY);
	status_t status = B_OK;
	BMessage archive;
	if (message->what == B_COUNT_PROPERTIES) {
		reply.AddInt32("result", CountReplicants());
	} else if (message->what == B_CREATE_PROPERTY) {
		BPoint location;
		status = message->FindMessage("data", &archive);
		if (status == B_OK) {
			const bool isPlaced = message->FindPoint("location", &location) == B_OK;
			status = _Add(archive, isPlaced ? &location : NULL, fNextId);
		}
	} else if (message->what == B_DELETE_PROPERTY) {
		status = DeleteReplicant(_IndexOf(&specifier, form));
	} else {
		const BMessage* found = ReplicantAt(_IndexOf(&specifier, form));
		status = found != NULL ? reply.AddMessage("result", found) : B_BAD_INDEX;
	}
	reply.AddInt32("error", status);
	message->SendReply(&reply);
	return true;
}
