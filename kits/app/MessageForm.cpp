#include <MessageForm.h>

#include <cstdlib>
#include <cstring>
#include <utility>

#include "app/private/MessageData.h"
#include "app/private/MessagePrivate.h"
#include "app/private/MessageReader.h"
#include "app/private/MessageWriter.h"
#include "app/private/TwinFields.h"

using BPrivate::MessageData;
using BPrivate::MessagePrivate;
using BPrivate::MessageReader;
using BPrivate::MessageWriter;
using BPrivate::SharedBytes;


// Takes over the reference to the source.
static status_t
read_message(BMessage* message, SharedBytes* source, message_damage* _damage, size_t* _used)
{
	MessageReader reader(source, source->Bytes(), source->Size(), 0);
	MessageData* data = reader.Read();
	message->MakeEmpty();
	message->what = 0;
	if (data == nullptr) {
		if (_damage != nullptr)
			*_damage = reader.Damage();
		return reader.Status();
	}

	message->what = data->What();
	MessagePrivate(message).SetData(data);
	data->Release();
	if (_used != nullptr)
		*_used = reader.Used();
	return B_OK;
}


static void
refuse(BMessage* message, message_damage* _damage, const char* reason)
{
	message->MakeEmpty();
	message->what = 0;
	if (_damage != nullptr)
		*_damage = { 0, reason };
}


status_t
get_message_form(const void* data, size_t size, message_form_info* _info)
{
	if (data == nullptr || _info == nullptr)
		return B_BAD_VALUE;
	return BPrivate::read_message_form(static_cast<const uint8*>(data), size, _info);
}


// Only as much is copied as the header says, so that what lies behind costs nothing.
status_t
unflatten_message(
	BMessage* message, const void* data, size_t size, message_damage* _damage, size_t* _used)
{
	if (message == nullptr || data == nullptr)
		return B_BAD_VALUE;
	const size_t stated = BPrivate::read_message_size(static_cast<const uint8*>(data), size);
	const size_t needed = stated == 0 ? min_c(size, size_t(4)) : min_c(size, stated);
	SharedBytes* source = SharedBytes::Create(needed);
	if (source == nullptr) {
		refuse(message, _damage, "there is not enough memory");
		return B_NO_MEMORY;
	}
	memcpy(source->Bytes(), data, needed);
	return read_message(message, source, _damage, _used);
}


status_t
unflatten_message_shared(BMessage* message, const void* data, size_t size,
	void (*release)(void* cookie), void* cookie, message_damage* _damage)
{
	if (message == nullptr || data == nullptr)
		return B_BAD_VALUE;
	SharedBytes* source = SharedBytes::Adopt(data, size, release, cookie);
	if (source == nullptr) {
		refuse(message, _damage, "there is not enough memory");
		if (release != nullptr)
			release(cookie);
		return B_NO_MEMORY;
	}
	return read_message(message, source, _damage, nullptr);
}


ssize_t
flattened_message_size(const BMessage& message, message_form form)
{
	if (form != B_R5_FORM && form != B_R5_WIDE_FORM && form != B_HAIKU_FORM)
		return B_BAD_VALUE;
	return MessageWriter(MessagePrivate(&message).Data(), message.what, form).Size();
}


status_t
flatten_message(const BMessage& message, message_form form, void* buffer, ssize_t size)
{
	if (buffer == nullptr || size < 0
		|| (form != B_R5_FORM && form != B_R5_WIDE_FORM && form != B_HAIKU_FORM))
		return B_BAD_VALUE;
	MessageWriter writer(MessagePrivate(&message).Data(), message.what, form);
	if (writer.Size() < 0)
		return status_t(writer.Size());
	if (size < writer.Size())
		return B_BUFFER_OVERFLOW;
	writer.Write(static_cast<uint8*>(buffer));
	return B_OK;
}


// #pragma mark - fields by number


static bool
has_item(const MessageData* data, int32 field, int32 index)
{
	return data != nullptr && field >= 0 && uint32(field) < data->CountFields() && index >= 0
		&& uint32(index) < data->FieldAt(uint32(field)).count;
}


bool
is_first_of_its_name(const BMessage& message, int32 field)
{
	const MessageData* data = MessagePrivate(&message).Data();
	return has_item(data, field, 0) && !BPrivate::is_twin(*data, uint32(field));
}


status_t
find_field_data(
	const BMessage& message, int32 field, int32 index, const void** _data, ssize_t* _size)
{
	const MessageData* data = MessagePrivate(&message).Data();
	if (_data == nullptr || _size == nullptr)
		return B_BAD_VALUE;
	if (!has_item(data, field, index))
		return B_BAD_INDEX;
	size_t size = 0;
	const status_t status = data->GetItem(uint32(field), uint32(index), _data, &size);
	*_size = ssize_t(size);
	return status;
}


status_t
find_field_message(const BMessage& message, int32 field, int32 index, BMessage* _nested)
{
	const MessageData* data = MessagePrivate(&message).Data();
	if (_nested == nullptr)
		return B_BAD_VALUE;
	if (!has_item(data, field, index))
		return B_BAD_INDEX;
	if (data->FieldAt(uint32(field)).type != B_MESSAGE_TYPE)
		return B_BAD_TYPE;
	status_t status;
	MessageData* nested = data->GetMessage(uint32(field), uint32(index), &status);
	if (nested == nullptr)
		return status;
	BMessage found(nested->What());
	MessagePrivate(&found).SetData(nested);
	nested->Release();
	*_nested = std::move(found);
	return B_OK;
}
