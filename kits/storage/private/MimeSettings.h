// What programs set about types: a message per type, in the user's settings folder.
#pragma once

#include <functional>
#include <set>
#include <string>

#include <Message.h>

namespace BPrivate {

// The fields of a type's settings.
constexpr char kMimeShortDescription[] = "short_description";
constexpr char kMimeLongDescription[] = "long_description";
constexpr char kMimeExtensions[] = "extensions";
constexpr char kMimePreferredApp[] = "preferred_app";
constexpr char kMimeAttrInfo[] = "attr_info";
constexpr char kMimeAppHint[] = "app_hint";
// Of the type itself; with a colon and another type behind it, the icon for that one's files.
constexpr char kMimeLargeIcon[] = "large_icon";
constexpr char kMimeMiniIcon[] = "mini_icon";
constexpr char kMimeSnifferRule[] = "sniffer_rule";
constexpr char kMimeSupportedTypes[] = "supported_types";
// Those that a program supported, and is still listed with.
constexpr char kMimeStrandedTypes[] = "stranded_types";

// Where a file per type is kept; empty when it cannot be told. The folder need not exist.
std::string MimeSettingsFolder();

// Each is a whole read or a whole replacement, so that threads and programs see no half message.
status_t ReadMimeSettings(const std::string& type, BMessage* _settings);
status_t WriteMimeSettings(const std::string& type, const BMessage& settings);
status_t RemoveMimeSettings(const std::string& type);
std::set<std::string> TypesWithMimeSettings();

// The type whose settings are in the file of this name; empty when there is none.
std::string TypeOfMimeSettings(const std::string& leaf);

// Types are the same whatever the case of their letters; settings are kept under the lower one.
std::string LowerCaseType(const char* type);
// The type's settings; an empty message when it has none.
BMessage MimeSettingsOf(const char* type);
// Lets `change` work on the settings and writes them back if that answers B_OK. Other changes, by
// this and by other programs, wait meanwhile.
status_t ChangeMimeSettings(
	const char* type, const std::function<status_t(BMessage& settings)>& change);

} // namespace BPrivate
