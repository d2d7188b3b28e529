#include "support/private/ManagedFields.h"

#include <cstring>

#include "app/private/ManagedNote.h"
#include "app/private/MessageData.h"
#include "app/private/MessagePrivate.h"
#include "app/private/TwinFields.h"

namespace BPrivate {


int32
count_of(const BMessage& message, const char* name, type_code type)
{
	type_code found;
	int32 count = 0;
	return message.GetInfo(name, &found, &count) == B_OK && found == type ? count : 0;
}


bool
holds_objects(const BMessage& message, const char* name)
{
	return strcmp(name, kTabs) != 0 || count_of(message, kTabViews, B_MESSAGE_TYPE) > 0;
}


status_t
put_field(BMessage* message, const char* name, const BMessage& from)
{
	MessageData* data = MessagePrivate(message).OwnData();
	if (data == nullptr)
		return B_NO_MEMORY;
	const MessageData* source = MessagePrivate(&from).Data();
	const int32 field = source->Find(name);
	const int32 place = data->Find(name);
	return place < 0 ? data->CopyField(*source, uint32(field))
					 : data->CopyFieldOver(uint32(place), *source, uint32(field));
}


status_t
put_field_like(BMessage* message, const BMessage& model, const char* name, const BMessage& from)
{
	const MessageData* order = MessagePrivate(&model).Data();
	const MessageData* data = MessagePrivate(message).Data();
	const int32 place = order != nullptr ? order->Find(name) : -1;
	if (place < 0 || data == nullptr || data->Find(name) >= 0)
		return put_field(message, name, from);

	int32 before = -1;
	for (int32 i = place - 1; i >= 0 && before < 0; i--)
		before = corresponding_field(*data, *order, uint32(i));
	MessageData* arranged = MessageData::Create();
	if (arranged == nullptr)
		return B_NO_MEMORY;
	const MessageData* source = MessagePrivate(&from).Data();
	status_t status = B_OK;
	for (int32 i = -1; i < int32(data->CountFields()) && status == B_OK; i++) {
		if (i >= 0)
			status = arranged->CopyField(*data, uint32(i));
		if (i == before && status == B_OK)
			status = arranged->CopyField(*source, uint32(source->Find(name)));
	}
	if (status == B_OK) {
		arranged->SetNote(data->Note());
		MessagePrivate(message).SetData(arranged);
	}
	arranged->Release();
	return status;
}


bool
is_ambiguous(const BMessage& message, const char* name)
{
	const MessageData* data = MessagePrivate(&message).Data();
	const int32 field = data != nullptr ? data->Find(name) : -1;
	return field >= 0 && next_of_name(*data, uint32(field)) >= 0;
}


ManagedNote*
note_of(const BMessage& message)
{
	const MessageData* data = MessagePrivate(&message).Data();
	return data != nullptr ? data->Note() : nullptr;
}


void
set_note(BMessage* message, ManagedNote* note)
{
	// The note is part of the contents, so they must be this message's own.
	if (MessageData* data = MessagePrivate(message).OwnData())
		data->SetNote(note);
}


} // namespace BPrivate
