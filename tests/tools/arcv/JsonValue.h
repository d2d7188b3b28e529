// JSON that a test reads.
#pragma once

#include <string>
#include <utility>
#include <vector>

struct JsonValue {
	enum class Kind { kNull, kBoolean, kNumber, kString, kArray, kObject };

	Kind kind = Kind::kNull;
	std::string text; // a number's digits, a string's bytes, "true" or "false"
	std::vector<JsonValue> items; // of an array; the values of an object
	std::vector<std::string> names; // of an object, in order

	// NULL when there is no such member.
	const JsonValue* Find(const std::string& name) const;
	// A value that is not there is null.
	const JsonValue& operator[](const std::string& name) const;
};

// False for anything that is not one JSON value with white space around.
bool ParseJson(const std::string& text, JsonValue* _value);
