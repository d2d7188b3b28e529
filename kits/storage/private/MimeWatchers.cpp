#include "storage/private/MimeWatchers.h"

#include <algorithm>
#include <set>

#include <Message.h>
#include <Mime.h>

#include "storage/private/FolderEvents.h"
#include "storage/private/MimeDatabase.h"
#include "storage/private/MimeSettings.h"

namespace BPrivate {

namespace {

constexpr std::pair<const char*, int32> kChanges[] = {
	{ kMimeShortDescription, B_SHORT_DESCRIPTION_CHANGED },
	{ kMimeLongDescription, B_LONG_DESCRIPTION_CHANGED },
	{ kMimeExtensions, B_FILE_EXTENSIONS_CHANGED },
	{ kMimePreferredApp, B_PREFERRED_APP_CHANGED },
	{ kMimeAttrInfo, B_ATTR_INFO_CHANGED },
	{ kMimeAppHint, B_APP_HINT_CHANGED },
	{ kMimeSnifferRule, B_SNIFFER_RULE_CHANGED },
	{ kMimeSupportedTypes, B_SUPPORTED_TYPES_CHANGED },
	{ kMimeLargeIcon, B_ICON_CHANGED },
	{ kMimeMiniIcon, B_ICON_CHANGED },
};


std::string
BytesOf(const BMessage& settings, const char* field, type_code type)
{
	BMessage message;
	if (type == B_MESSAGE_TYPE && settings.FindMessage(field, &message) == B_OK) {
		std::string bytes(message.FlattenedSize(), '\0');
		message.Flatten(bytes.data(), bytes.size());
		return bytes;
	}
	const void* data;
	ssize_t size;
	if (settings.FindData(field, type, &data, &size) != B_OK)
		return std::string();
	return std::string(static_cast<const char*>(data), size);
}


// False when the type has no settings.
bool
ReadFields(const std::string& type, std::map<std::string, std::string>* _fields)
{
	BMessage settings;
	if (ReadMimeSettings(type, &settings) != B_OK)
		return false;
	char* name;
	type_code code;
	for (int32 i = 0; settings.GetInfo(B_ANY_TYPE, i, &name, &code) == B_OK; i++)
		(*_fields)[name] = BytesOf(settings, name, code);
	return true;
}


BMessage
ChangeOf(const std::string& type, int32 which)
{
	BMessage change(B_META_MIME_CHANGED);
	change.AddString("be:type", type.c_str());
	change.AddInt32("be:which", which);
	return change;
}

} // namespace


// Never destroyed, since something may be set while the program's static objects go. But its
// thread ends before them.
MimeWatchers&
MimeWatchers::Get()
{
	static MimeWatchers* watchers = new MimeWatchers;
	return *watchers;
}


MimeWatchers::~MimeWatchers()
{
}


status_t
MimeWatchers::Start(const BMessenger& target)
{
	struct Ender {
		~Ender() { MimeWatchers::Get().End(); }
	};
	if (!target.IsValid())
		return B_BAD_VALUE;
	std::unique_ptr<FolderEvents> former; // ends without the lock, which its thread may wait for
	std::lock_guard<std::mutex> guard(fLock);
	if (fEvents != nullptr && fEvents->Folder() != MimeSettingsFolder())
		former = std::move(fEvents); // another user's
	const status_t status = fEvents == nullptr ? _Begin() : B_OK;
	if (status != B_OK)
		return status;
	if (std::find(fTargets.begin(), fTargets.end(), target) == fTargets.end())
		fTargets.push_back(target);
	// Made last, so that it ends the thread before anything goes that the thread uses.
	static const Ender ender;
	return B_OK;
}


status_t
MimeWatchers::Stop(const BMessenger& target)
{
	std::unique_ptr<FolderEvents> ended; // like the former one above
	std::lock_guard<std::mutex> guard(fLock);
	const auto found = std::find(fTargets.begin(), fTargets.end(), target);
	if (found == fTargets.end())
		return B_ENTRY_NOT_FOUND;
	fTargets.erase(found);
	if (fTargets.empty())
		ended = std::move(fEvents);
	return B_OK;
}


void
MimeWatchers::End()
{
	std::unique_ptr<FolderEvents> ended;
	std::lock_guard<std::mutex> guard(fLock);
	fTargets.clear();
	ended = std::move(fEvents);
}


void
MimeWatchers::Check(const std::string& type)
{
	std::lock_guard<std::mutex> guard(fLock);
	if (fEvents == nullptr)
		return;
	if (type.empty())
		_CheckAll();
	else
		_CheckOne(type);
}


// #pragma mark - private


// The folder is watched before it is read: so nothing is missed, and what is seen twice is no
// change.
status_t
MimeWatchers::_Begin()
{
	auto events = std::make_unique<FolderEvents>(MimeSettingsFolder(), [](const std::string& name) {
		const std::string type = TypeOfMimeSettings(name);
		if (name.empty() || !type.empty())
			Get().Check(type);
	});
	const status_t status = events->Run();
	if (status != B_OK)
		return status;
	fKnown.clear();
	for (const std::string& type : TypesWithMimeSettings()) {
		Fields fields;
		if (ReadFields(type, &fields))
			fKnown[type] = std::move(fields);
	}
	fEvents = std::move(events);
	return B_OK;
}


void
MimeWatchers::_CheckAll()
{
	std::set<std::string> types = TypesWithMimeSettings();
	for (const auto& [type, fields] : fKnown)
		types.insert(type);
	for (const std::string& type : types)
		_CheckOne(type);
}


void
MimeWatchers::_CheckOne(const std::string& type)
{
	Fields fields;
	const bool there = ReadFields(type, &fields);
	const auto known = fKnown.find(type);
	_Compare(type, known != fKnown.end() ? &known->second : NULL, there ? &fields : NULL);
	if (there)
		fKnown[type] = std::move(fields);
	else if (known != fKnown.end())
		fKnown.erase(known);
}


// A type of the shared database is installed with or without settings.
void
MimeWatchers::_Compare(const std::string& type, const Fields* before, const Fields* after)
{
	const bool shared = MimeDatabase::Get().IsKnown(type);
	if (!shared && before == NULL && after != NULL) {
		BMessage created = ChangeOf(type, B_MIME_TYPE_CREATED);
		_Send(&created);
	}
	if (!shared && before != NULL && after == NULL) {
		BMessage deleted = ChangeOf(type, B_MIME_TYPE_DELETED);
		_Send(&deleted);
		return;
	}
	const Fields none;
	std::set<std::string> names;
	for (const Fields* fields : { before, after }) {
		for (const auto& [name, bytes] : fields != NULL ? *fields : none)
			names.insert(name);
	}
	const auto same = [](const Fields& a, const Fields& b, const std::string& name) {
		const auto first = a.find(name);
		const auto second = b.find(name);
		return first != a.end() && second != b.end() && first->second == second->second;
	};
	for (const std::string& name : names) {
		if (!same(before != NULL ? *before : none, after != NULL ? *after : none, name))
			_TellField(type, name);
	}
}


void
MimeWatchers::_TellField(const std::string& type, const std::string& field)
{
	const size_t colon = std::min(field.find(':'), field.size());
	const std::string name = field.substr(0, colon);
	for (const auto& [known, which] : kChanges) {
		if (name != known)
			continue;
		const bool forType = colon < field.size();
		BMessage change = ChangeOf(type, forType ? B_ICON_FOR_TYPE_CHANGED : which);
		if (forType)
			change.AddString("be:extra_type", field.substr(colon + 1).c_str());
		if (which == B_ICON_CHANGED)
			change.AddBool("be:large_icon", name == kMimeLargeIcon);
		_Send(&change);
	}
}


// Never waits, so a target that has no room misses the change. One that is gone is forgotten.
void
MimeWatchers::_Send(BMessage* change)
{
	std::erase_if(fTargets, [&](const BMessenger& target) {
		return target.SendMessage(change, static_cast<BHandler*>(NULL), 0) == B_BAD_PORT_ID;
	});
}

} // namespace BPrivate
