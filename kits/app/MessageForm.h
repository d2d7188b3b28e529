// The forms in which a message can be written as bytes: a small extension of BMessage.
#pragma once

#include <vector>

#include <Message.h>

enum message_form {
	B_NO_MESSAGE_FORM, // not a flattened message
	B_R5_FORM,
	B_R5_WIDE_FORM, // as R5, all counts and sizes of four bytes, as later systems write it
	B_HAIKU_FORM,
	B_DANO_FORM, // is only read
};

// What is known of flattened bytes from their start.
struct message_form_info {
	message_form form;
	bool big_endian;
	size_t size; // of the whole message as its header gives it; may be wrong
	bool checksum_matches; // true for the forms that have none
};

// Why bytes were refused, for a person who looks at a damaged file.
struct message_damage {
	size_t offset; // of the first byte that does not fit, from the start of the message
	const char* reason; // a sentence's end: "the field's data pass the end of the message"
};

// Looks at the first bytes only. B_NOT_A_MESSAGE when the magic is unknown or the header is cut.
// For the R5 form, tells wide from compact by the fields; a message without any counts as compact.
status_t get_message_form(const void* data, size_t size, message_form_info* _info);

// Reads exactly this buffer; nothing behind its end is touched. On an error the message is empty
// and *_damage says where; it may be NULL. *_used gets the bytes that the message takes up.
status_t unflatten_message(BMessage* message, const void* data, size_t size,
	message_damage* _damage = NULL, size_t* _used = NULL);

// Reads what can be read of a damaged message: a list's items before the damage, the fields in front
// of it and, where the form tells their places, behind it; of messages inside it the same. An error
// when nothing can be read. *_damages gets all that was left out; it may be NULL. A message inside
// that was put together from its remains may have its fields in part.
status_t salvage_message(
	BMessage* message, const void* data, size_t size, std::vector<message_damage>* _damages = NULL);

// Keeps the buffer instead of copying it: free it with the message's last copy only. The keeper is
// called once, from any thread, when nothing refers to the bytes any more.
status_t unflatten_message_shared(BMessage* message, const void* data, size_t size,
	void (*release)(void* cookie), void* cookie, message_damage* _damage = NULL);

// Nested messages are written in the same form. B_BAD_VALUE for a form that is only read.
ssize_t flattened_message_size(const BMessage& message, message_form form);
status_t flatten_message(const BMessage& message, message_form form, void* buffer, ssize_t size);

// A message that was read can hold several fields of one name. GetInfo() counts them all; whatever
// takes a name finds the first only. These take a field's number, as GetInfo(B_ANY_TYPE) has it.
// B_BAD_INDEX for a field or an item that is not there; B_BAD_TYPE for a field of no messages.
bool is_first_of_its_name(const BMessage& message, int32 field);
status_t find_field_data(
	const BMessage& message, int32 field, int32 index, const void** _data, ssize_t* _size);
status_t find_field_message(const BMessage& message, int32 field, int32 index, BMessage* _nested);

// Levels of messages inside messages that are read; a deeper one stays raw bytes, which
// FindMessage() answers with B_BAD_DATA.
enum { B_MAX_MESSAGE_NESTING = 256 };
