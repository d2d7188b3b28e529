#include "tools/arcv/Input.h"

#include <string.h>

#include <algorithm>

#include <File.h>

#include "tools/arcv/Output.h"
#include "tools/arcv/TypeCode.h"

namespace Arcv {

namespace {

constexpr size_t kMessageStart = 128; // enough to know a flattened message

} // namespace


bool
ReadWholeFile(const std::string& path, std::string* _bytes)
{
	BFile file(path.c_str(), B_READ_ONLY);
	off_t size = 0;
	status_t status = file.InitCheck();
	if (status == B_OK)
		status = file.GetSize(&size);
	if (status == B_OK) {
		_bytes->resize(size);
		const ssize_t read = file.ReadAt(0, _bytes->data(), size);
		if (read < 0)
			status = read;
		else
			_bytes->resize(read);
	}
	if (status != B_OK)
		Complain(path, StatusText(status));
	return status == B_OK;
}


bool
IsMessage(const void* data, size_t size, BMessage* _message, message_form* _form)
{
	message_form_info info;
	if (get_message_form(data, size, &info) != B_OK
		|| unflatten_message(_message, data, size) != B_OK)
		return false;
	if (_form != NULL)
		*_form = info.form;
	return true;
}


bool
Input::Open(const std::string& path)
{
	fPath = path;
	BFile file(path.c_str(), B_READ_ONLY);
	if (file.InitCheck() != B_OK) {
		Complain(path, StatusText(file.InitCheck()));
		return false;
	}
	if (file.IsDirectory()) {
		Complain(path, StatusText(B_IS_A_DIRECTORY));
		return false;
	}

	char start[kMessageStart];
	const ssize_t read = file.ReadAt(0, start, sizeof(start));
	message_form_info info;
	if (read > 0 && get_message_form(start, read, &info) == B_OK)
		return _OpenMessage();

	const status_t status = fResources.SetTo(&file);
	if (status != B_OK)
		return _ComplainOfDamage(status);
	Item item;
	const char* name;
	for (int32 i = 0; fResources.GetResourceInfo(i, &item.type, &item.id, &name, &item.size); i++) {
		item.name = name;
		item.index = i;
		fItems.push_back(item);
	}
	return true;
}


const void*
Input::Load(const Item& item)
{
	size_t size;
	const void* data = load_resource(&fResources, item.index, &size);
	if (data == NULL)
		Complain(fPath, "the bytes of " + ItemText(item.type, item.id) + " cannot be read");
	return data;
}


bool
Input::_OpenMessage()
{
	std::string bytes;
	if (!ReadWholeFile(fPath, &bytes))
		return false;
	message_damage damage = {};
	message_form_info info;
	status_t status = get_message_form(bytes.data(), bytes.size(), &info);
	if (status == B_OK)
		status = unflatten_message(&fMessage, bytes.data(), bytes.size(), &damage);
	if (status != B_OK) {
		const char* reason = damage.reason != NULL ? damage.reason : "the message is damaged";
		Complain(fPath, reason, damage.offset);
		return false;
	}
	fIsMessage = true;
	fForm = info.form;
	return true;
}


bool
Input::_ComplainOfDamage(status_t status)
{
	BFile file(fPath.c_str(), B_READ_ONLY);
	std::vector<resource_damage> damages;
	examine_resource_file(&file, NULL, NULL, &damages);
	for (const resource_damage& damage : damages) {
		if (damage.fatal) {
			Complain(fPath, damage.reason, damage.offset);
			return false;
		}
	}
	Complain(fPath, StatusText(status));
	return false;
}

} // namespace Arcv
