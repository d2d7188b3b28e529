// Several fields of one name in one message.
#pragma once

#include <vector>

#include "app/private/MessageData.h"

namespace BPrivate {


// No program adds such fields, but bytes from outside can hold them, and Rename() can make them. A
// look-up by name finds the first, and so do all changes by name; the others, its twins, are only
// reached by number. They are kept, copied, compared, written in every form and carried along from
// an archive to the next like any other field.
//
// Fields of two messages correspond when they have the same name and as many of that name in front
// of them.

// Whether a field of the same name is in front of it.
bool is_twin(const MessageData& data, uint32 field);

// The next field of the same name, or -1.
int32 next_of_name(const MessageData& data, uint32 field);

// The field that corresponds to one of another message, or -1. Walks over all fields for a twin.
int32 corresponding_field(const MessageData& data, const MessageData& other, uint32 otherField);

// For each field the number of the other message's field that corresponds; nothing when all names
// are in the same order. False when a field has no counterpart. Both have as many fields. Costs no
// more than sorting the names.
bool pair_fields(const MessageData& a, const MessageData& b, std::vector<uint32>* _pairs);


} // namespace BPrivate
