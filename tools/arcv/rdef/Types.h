// The types of resource definition text, and values of them.
#pragma once

#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include <Message.h>
#include <SupportDefs.h>

namespace Arcv {

struct RdefType;

// A value while it is compiled. Numbers stay numbers until their size is known.
struct Value {
	enum class Kind { kInteger, kReal, kBytes, kMessage };

	Kind kind = Kind::kBytes;
	type_code type = 0; // 0 for a number that was given no type yet
	uint64 integer = 0;
	bool negative = false; // the integer was given with a minus sign
	double real = 0;
	std::string bytes;
	std::shared_ptr<BMessage> message;
	const RdefType* origin = nullptr; // gives id and name to a resource without them
};

struct RdefField {
	std::string name;
	const RdefType* type;
	size_t size = 0; // cut or filled with zeros to this; 0 for the type's own
	std::optional<Value> defaultValue;
};

struct RdefType {
	std::string name;
	type_code code;
	Value::Kind kind = Value::Kind::kBytes;
	size_t size = 0; // of a number, 0 for what has no fixed size
	std::vector<RdefField> fields; // of a compound
	std::optional<int32> id; // of a resource that has none
	std::string resourceName;
};

// The types that the language has from the start. Valid for ever.
const RdefType* FindBuiltInType(std::string_view name);
// A number type by its code; NULL for other types.
const RdefType* FindNumberType(type_code code);

// The value of a known constant.
bool FindConstant(std::string_view name, uint64* _value);

// The bytes of a number of that size, in the host's order.
std::string NumberBytes(uint64 number, size_t size);

} // namespace Arcv
