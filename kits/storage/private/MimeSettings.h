// What programs set about types: a message per type, in the user's settings folder.
#pragma once

#include <set>
#include <string>

#include <Message.h>

namespace BPrivate {

// Each is a whole read or a whole replacement, so that threads and programs see no half message.
status_t ReadMimeSettings(const std::string& type, BMessage* _settings);
status_t WriteMimeSettings(const std::string& type, const BMessage& settings);
status_t RemoveMimeSettings(const std::string& type);
std::set<std::string> TypesWithMimeSettings();

} // namespace BPrivate
