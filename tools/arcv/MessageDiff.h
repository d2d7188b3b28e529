// How two messages differ, field by field.
#pragma once

#include <string>
#include <vector>

#include <Message.h>

namespace Arcv {

struct FieldDifference {
	std::string path; // "_views[2]._label"; empty for the message itself
	std::string what; // "added", "removed", "changed", "moved"
	std::string oldValue; // as JSON on one line; empty where there is none
	std::string newValue;
};

// Nested messages are compared by their fields. Where their number differs, those with the same
// class and name belong together, so that one view more is one difference.
void CompareMessages(const BMessage& oldMessage, const BMessage& newMessage,
	const std::string& path, std::vector<FieldDifference>* _differences);

} // namespace Arcv
