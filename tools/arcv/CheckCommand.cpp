// arcv check: what is wrong with a file, and what of it can be saved.

#include <sys/stat.h>

#include <algorithm>
#include <map>
#include <memory>
#include <set>
#include <utility>

#include <File.h>
#include <TypeConstants.h>

#include "tools/arcv/Command.h"
#include "tools/arcv/Input.h"
#include "tools/arcv/Json.h"
#include "tools/arcv/Output.h"
#include "tools/arcv/TypeCode.h"

namespace Arcv {

namespace {

struct CheckOptions {
	std::string file;
	std::string repaired;
	bool json = false;
};

struct Finding {
	off_t offset;
	std::string text;
};

// What could be read of a damaged message, in the form that it had.
struct Remains {
	std::string where; // the item; empty for a file that is one message
	std::vector<std::string> fields;
	std::string bytes;
	std::string name;
};

struct Report {
	resource_file_info info = {};
	std::vector<resource_place> places;
	std::vector<Finding> findings;
	std::map<std::pair<type_code, int32>, Remains> remains;
	std::string text; // of a file that is one message, when it is whole
	bool recognized = false;
	bool isMessage = false;
};


// Notes all that is wrong with a damaged message, and what is left of it.
void
CheckRemains(const char* data, size_t size, off_t start, const std::string& prefix,
	const resource_place& place, Report& report)
{
	BMessage message;
	std::vector<message_damage> damages;
	const status_t status = salvage_message(&message, data, size, &damages);
	for (const message_damage& damage : damages)
		report.findings.push_back(
			{ start + static_cast<off_t>(damage.offset), prefix + damage.reason });
	if (damages.empty())
		report.findings.push_back({ start, prefix + "the message is damaged" });
	if (status != B_OK || message.IsEmpty())
		return;

	Remains remains;
	remains.where = report.isMessage ? "" : ItemText(place.type, place.id);
	remains.name = place.name.String();
	char* name;
	type_code type;
	for (int32 i = 0; message.GetInfo(B_ANY_TYPE, i, &name, &type) == B_OK; i++)
		remains.fields.push_back(name);
	message_form_info info;
	const bool isHaiku = get_message_form(data, size, &info) == B_OK && info.form == B_HAIKU_FORM;
	const message_form form = isHaiku ? B_HAIKU_FORM : B_R5_FORM;
	remains.bytes.resize(std::max<ssize_t>(flattened_message_size(message, form), 0));
	if (flatten_message(message, form, remains.bytes.data(), remains.bytes.size()) == B_OK)
		report.remains.emplace(std::pair(place.type, place.id), std::move(remains));
}


// Programs find the first of several fields with one name, and lose the others when they save.
void
CheckNames(const BMessage& message, off_t start, const std::string& prefix, Report& report)
{
	char* name;
	type_code type;
	int32 count;
	for (int32 i = 0; message.GetInfo(B_ANY_TYPE, i, &name, &type, &count) == B_OK; i++) {
		if (!is_first_of_its_name(message, i))
			report.findings.push_back(
				{ start, prefix + "several fields have the name \"" + name + "\"" });
		BMessage nested;
		for (int32 k = 0; type == B_MESSAGE_TYPE && k < count; k++) {
			if (find_field_message(message, i, k, &nested) == B_OK)
				CheckNames(nested, start, prefix, report);
		}
	}
}


// A message inside the file has its own damages.
void
CheckMessage(const char* data, size_t size, off_t start, const std::string& prefix,
	const resource_place& place, bool expected, Report& report)
{
	message_form_info info;
	BMessage message;
	if (get_message_form(data, size, &info) != B_OK) {
		if (expected)
			report.findings.push_back({ start, prefix + "this is no flattened message" });
		return;
	}
	size_t used = 0;
	if (unflatten_message(&message, data, size, NULL, &used) != B_OK) {
		CheckRemains(data, size, start, prefix, place, report);
		return;
	}
	if (!info.checksum_matches)
		report.findings.push_back({ start, prefix + "the message's checksum does not match" });
	CheckNames(message, start, prefix, report);
	if (used < size)
		report.findings.push_back({ start + static_cast<off_t>(used),
			prefix + std::to_string(size - used) + " bytes follow the message" });
}


void
CheckItem(BFile& file, const resource_place& place, Report& report)
{
	const std::string prefix = ItemText(place.type, place.id) + ": ";
	off_t fileSize = 0;
	file.GetSize(&fileSize);
	const off_t there = std::max<off_t>(fileSize - place.offset, 0);
	const bool isCut = there < static_cast<off_t>(place.size);
	if (isCut)
		report.findings.push_back({ place.offset,
			prefix + "only the first " + std::to_string(there) + " of " + std::to_string(place.size)
				+ " bytes are there" });
	std::string bytes(std::min<off_t>(there, place.size), '\0');
	if (file.ReadAt(place.offset, bytes.data(), bytes.size())
		!= static_cast<ssize_t>(bytes.size())) {
		report.findings.push_back({ place.offset, prefix + "its bytes cannot be read" });
		return;
	}
	const bool expected = !isCut && (place.type == 'ARCV' || place.type == B_MESSAGE_TYPE);
	CheckMessage(bytes.data(), bytes.size(), place.offset, prefix, place, expected, report);
}


// Programs find only the first of two items with one type and id.
void
CheckTwins(Report& report)
{
	std::set<std::pair<type_code, int32>> seen;
	for (const resource_place& place : report.places) {
		if (!seen.emplace(place.type, place.id).second)
			report.findings.push_back({ place.offset,
				ItemText(place.type, place.id) + ": there is one of this type and id already" });
	}
}


// A file that is one message has no items.
bool
CheckWholeMessage(BFile& file, Report& report)
{
	char start[128]; // more than any form needs to be told
	const ssize_t read = file.ReadAt(0, start, sizeof(start));
	message_form_info info;
	if (read <= 0 || get_message_form(start, read, &info) != B_OK)
		return false;
	off_t size = 0;
	file.GetSize(&size);
	std::string bytes(size, '\0');
	if (file.ReadAt(0, bytes.data(), bytes.size()) != size)
		return false;
	report.isMessage = true;
	report.recognized = true;
	CheckMessage(bytes.data(), bytes.size(), 0, "", resource_place(), true, report);
	if (report.remains.empty())
		report.text = std::move(bytes);
	return true;
}


// The readable items, with what is left of damaged messages in the place of those.
status_t
WriteItems(BFile& file, Report& report, BResources& readable)
{
	BResources items;
	type_code type;
	int32 id;
	const char* name;
	size_t size;
	for (int32 i = 0; readable.GetResourceInfo(i, &type, &id, &name, &size); i++) {
		const void* data = readable.LoadResource(type, id, &size);
		const auto remains = report.remains.find({ type, id });
		if (remains == report.remains.end()) {
			items.AddResource(type, id, data, size, name[0] != '\0' ? name : NULL);
			continue;
		}
		const std::string& bytes = remains->second.bytes;
		items.AddResource(type, id, bytes.data(), bytes.size(), name[0] != '\0' ? name : NULL);
	}
	// Items of which the file has only the start.
	for (const auto& [key, remains] : report.remains) {
		if (!items.HasResource(key.first, key.second))
			items.AddResource(key.first, key.second, remains.bytes.data(), remains.bytes.size(),
				remains.name.empty() ? NULL : remains.name.c_str());
	}
	return items.WriteTo(&file);
}


bool
WriteRepaired(
	const std::string& original, const std::string& path, Report& report, BResources& readable)
{
	struct stat first;
	struct stat second;
	if (Exists(path)
		&& (stat(original.c_str(), &first) < 0 || stat(path.c_str(), &second) < 0
			|| (first.st_dev == second.st_dev && first.st_ino == second.st_ino))) {
		Complain(path, "a repaired copy is never written over the original");
		return false;
	}
	BFile file(path.c_str(), B_READ_WRITE | B_CREATE_FILE | B_FAIL_IF_EXISTS);
	status_t status = file.InitCheck();
	if (status == B_OK && !report.isMessage)
		status = WriteItems(file, report, readable);
	else if (status == B_OK) {
		const std::string& bytes =
			report.remains.empty() ? report.text : report.remains.begin()->second.bytes;
		const ssize_t written = file.Write(bytes.data(), bytes.size());
		if (written != static_cast<ssize_t>(bytes.size()))
			status = written < 0 ? static_cast<status_t>(written) : B_DEVICE_FULL;
	}
	if (status == B_FILE_EXISTS)
		Complain(path, "there is a file already");
	else if (status != B_OK)
		Complain(path, StatusText(status));
	return status == B_OK;
}


void
PrintReport(const Report& report, const std::string& file)
{
	for (const Finding& finding : report.findings)
		Print(file + ": offset " + std::to_string(finding.offset) + ": " + finding.text + "\n");
	for (const auto& [key, remains] : report.remains) {
		Print((remains.where.empty() ? "" : remains.where + ": ")
			+ std::to_string(remains.fields.size()) + " fields can be read:");
		for (const std::string& field : remains.fields)
			Print(" " + field);
		Print("\n");
	}
	if (report.findings.empty() || report.isMessage)
		return;
	Print(std::to_string(report.places.size()) + " items were found\n");
	for (const resource_place& place : report.places)
		Print("  " + ItemText(place.type, place.id) + " \"" + place.name.String() + "\", "
			+ std::to_string(place.size) + " bytes at offset " + std::to_string(place.offset)
			+ "\n");
}


void
WriteFindings(JsonWriter& json, const std::vector<Finding>& findings)
{
	json.OpenArray();
	for (const Finding& finding : findings) {
		json.OpenObject(true);
		json.Name("offset");
		json.Integer(finding.offset);
		json.Name("text");
		json.String(finding.text);
		json.CloseObject();
	}
	json.CloseArray();
}


void
WritePlaces(JsonWriter& json, const std::vector<resource_place>& places)
{
	json.OpenArray();
	for (const resource_place& place : places) {
		json.OpenObject(true);
		json.Name("type");
		json.String(TypeText(place.type));
		json.Name("id");
		json.Integer(place.id);
		json.Name("name");
		json.Text(place.name.String());
		json.Name("offset");
		json.Integer(place.offset);
		json.Name("size");
		json.Unsigned(place.size);
		json.CloseObject();
	}
	json.CloseArray();
}


void
PrintJson(const Report& report)
{
	JsonWriter json;
	json.OpenObject();
	json.Name("findings");
	WriteFindings(json, report.findings);
	json.Name("items");
	WritePlaces(json, report.places);
	json.Name("remains");
	json.OpenArray();
	for (const auto& [key, remains] : report.remains) {
		json.OpenObject(true);
		json.Name("item");
		json.String(remains.where);
		json.Name("fields");
		json.OpenArray(true);
		for (const std::string& field : remains.fields)
			json.Text(field);
		json.CloseArray();
		json.CloseObject();
	}
	json.CloseArray();
	json.CloseObject();
	Print(json.Finish());
}


int
RunCheck(const CheckOptions& options)
{
	BFile file(options.file.c_str(), B_READ_ONLY);
	if (file.InitCheck() != B_OK || file.IsDirectory()) {
		Complain(options.file,
			StatusText(file.InitCheck() != B_OK ? file.InitCheck()
												: static_cast<status_t>(B_IS_A_DIRECTORY)));
		return kUnreadable;
	}

	Report report;
	BResources readable;
	if (!CheckWholeMessage(file, report)) {
		std::vector<resource_damage> damages;
		const status_t status =
			examine_resource_file(&file, &report.info, &report.places, &damages, &readable);
		report.recognized = report.info.kind != B_NO_RESOURCE_FILE || !report.places.empty();
		for (const resource_damage& damage : damages)
			report.findings.push_back({ damage.offset, damage.reason });
		if (status != B_OK && damages.empty())
			report.findings.push_back({ 0, StatusText(status) });
		CheckTwins(report);
		for (const resource_place& place : report.places)
			CheckItem(file, place, report);
	}

	if (options.json)
		PrintJson(report);
	else
		PrintReport(report, options.file);
	if (!options.repaired.empty()
		&& !WriteRepaired(options.file, options.repaired, report, readable))
		return kUnreadable;
	if (!report.recognized)
		return kUnreadable;
	return report.findings.empty() ? kFine : kFindings;
}

} // namespace


void
AddCheckCommand(CLI::App& app, int* _status)
{
	const auto options = std::make_shared<CheckOptions>();
	CLI::App* command = app.add_subcommand(
		"check", "Say what is wrong with a file, and save what can be read of it");
	command->add_option("file", options->file, "A resource file, or one flattened message")
		->required();
	command->add_option(
		"-r,--repair", options->repaired, "Write what can be read to a new resource file");
	command->add_flag("--json", options->json, "Write JSON");
	command->callback([=] { *_status = RunCheck(*options); });
}

} // namespace Arcv
