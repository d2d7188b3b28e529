// Messages as JSON.
#pragma once

#include <Message.h>

#include "tools/arcv/Json.h"

namespace Arcv {

// {"what": ..., "code": ..., "fields": [...]}
void WriteMessage(JsonWriter& json, const BMessage& message);

// One item of the field of that number, as GetInfo() counts.
void WriteFieldValue(
	JsonWriter& json, const BMessage& message, int32 field, type_code type, int32 index);

// A value of a message's type by its bytes; nested messages are unflattened.
void WriteValue(JsonWriter& json, type_code type, const void* data, size_t size);

} // namespace Arcv
