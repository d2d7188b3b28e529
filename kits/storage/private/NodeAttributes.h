// The attributes of one node: extended attributes, or a table in memory where there are none.
#pragma once

#include <string>
#include <vector>

#include <SupportDefs.h>

namespace BPrivate {

struct AttributeValue {
	type_code type;
	std::string data;
};

// `fd` may be an O_PATH descriptor. B_ENTRY_NOT_FOUND when there is no such attribute.
status_t ReadAttribute(int fd, const char* name, AttributeValue* _value);
status_t WriteAttribute(int fd, const char* name, const AttributeValue& value);
status_t RemoveAttribute(int fd, const char* name);
status_t ListAttributes(int fd, std::vector<std::string>* _names);

// Whether the node's file system keeps attributes.
bool KeepsAttributes(int fd);

// Carries what is kept in memory for one node over to another that takes its place.
void MoveRememberedAttributes(int fromFd, int toFd);

} // namespace BPrivate
