// Reads bytes as a flattened message, looks at everything in it, writes it in every form and changes
// it. Whatever is read must come back from its writing.

#include <cstdint>
#include <cstdlib>
#include <cstring>
#include <string>
#include <vector>

#include <DataIO.h>
#include <Message.h>
#include <MessageForm.h>

#include "support/private/ManagedArchive.h"

namespace {

void
require(bool condition)
{
	if (!condition)
		abort();
}


std::string
flatten(const BMessage& message, message_form form)
{
	std::string bytes;
	const ssize_t size = flattened_message_size(message, form);
	require(size > 0);
	bytes.resize(size_t(size));
	require(flatten_message(message, form, bytes.data(), size) == B_OK);
	return bytes;
}


// Returns a sum, so that no look is left out.
uint32
walk(const BMessage& message, int32* budget)
{
	uint32 sum = message.what;
	char* name;
	type_code type;
	int32 count;
	for (int32 i = 0; message.GetInfo(B_ANY_TYPE, i, &name, &type, &count) == B_OK; i++) {
		for (int32 k = 0; k < count && --*budget > 0; k++) {
			const void* data;
			ssize_t size;
			BMessage nested;
			if (type == B_MESSAGE_TYPE && message.FindMessage(name, k, &nested) == B_OK)
				sum += walk(nested, budget);
			if (message.FindData(name, type, k, &data, &size) == B_OK) {
				require(size > 0);
				const auto* bytes = static_cast<const uint8*>(data);
				sum += uint32(bytes[0]) + bytes[size - 1];
			}
			const char* text;
			if (message.FindString(name, k, &text) == B_OK)
				sum += uint32(strlen(text));
		}
	}
	return sum;
}


void
write_and_read(const BMessage& message)
{
	for (message_form form : { B_R5_FORM, B_R5_WIDE_FORM, B_HAIKU_FORM }) {
		const std::string bytes = flatten(message, form);
		BMessage back;
		require(unflatten_message(&back, bytes.data(), bytes.size()) == B_OK);
		require(back.what == message.what);
		require(back.CountNames(B_ANY_TYPE) == message.CountNames(B_ANY_TYPE));
	}
}


// The same, and through the other form, loses nothing. Only the names that R5 must cut may differ.
void
convert(const BMessage& message)
{
	char* name;
	type_code type;
	for (int32 i = 0; message.GetInfo(B_ANY_TYPE, i, &name, &type) == B_OK; i++) {
		if (strlen(name) > B_FIELD_NAME_LENGTH)
			return;
	}
	BMessage there;
	const std::string haiku = flatten(message, B_HAIKU_FORM);
	require(unflatten_message(&there, haiku.data(), haiku.size()) == B_OK);
	BMessage back;
	const std::string r5 = flatten(there, B_R5_FORM);
	require(unflatten_message(&back, r5.data(), r5.size()) == B_OK);
	require(flatten(back, B_R5_FORM) == r5);
	require(flatten(back, B_HAIKU_FORM).size() == haiku.size());
}


void
change(BMessage message)
{
	const BMessage original(message);
	char* name;
	type_code type;
	int32 count;
	for (int32 i = 0; original.GetInfo(B_ANY_TYPE, i, &name, &type, &count) == B_OK && i < 50;
		 i++) {
		const void* data;
		ssize_t size;
		if (original.FindData(name, type, 0, &data, &size) != B_OK)
			continue;
		bool fixed = false;
		message.GetInfo(name, &type, &fixed);
		message.AddData(name, type, data, size);
		if (!fixed)
			message.ReplaceData(name, type, 0, "replaced", 9);
		if (i % 3 == 1)
			message.RemoveData(name, 0);
		if (i % 5 == 2)
			message.Rename(name, "renamed");
	}
	write_and_read(message);
	BMessage appended;
	appended.Append(message);
	write_and_read(appended);
}

} // namespace


extern "C" int
LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
	BMessage message;
	message_form_info info;
	get_message_form(data, size, &info);
	size_t used = 0;
	const status_t status = unflatten_message(&message, data, size, nullptr, &used);
	BMemoryIO stream(data, size);
	BMessage streamed;
	const status_t streamStatus = streamed.Unflatten(&stream);
	require((status == B_OK) == (streamStatus == B_OK));
	if (status != B_OK) {
		require(message.IsEmpty());
		// What can be salvaged is sound.
		std::vector<message_damage> damages;
		if (salvage_message(&message, data, size, &damages) == B_OK)
			write_and_read(message);
		require(!damages.empty());
		return 0;
	}
	require(used <= size && size_t(stream.Position()) == used);

	int32 budget = 2000;
	walk(message, &budget);
	write_and_read(message);
	convert(message);
	change(message);
	if (BPrivate::unmanage_archive(&message) == B_OK) {
		BPrivate::manage_archive(&message);
		write_and_read(message);
	}
	return 0;
}
