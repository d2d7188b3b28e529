// arcv check: what is wrong with a file, and what of it can be saved.

#include <sys/stat.h>

#include <memory>

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

struct Report {
	resource_file_info info = {};
	std::vector<resource_place> places;
	std::vector<Finding> findings;
	std::string text; // of the readable items
	bool recognized = false;
};


// A message inside the file has its own damages.
void
CheckMessage(const char* data, size_t size, off_t start, const std::string& prefix, bool expected,
	Report& report)
{
	message_form_info info;
	message_damage damage = {};
	BMessage message;
	if (get_message_form(data, size, &info) != B_OK) {
		if (expected)
			report.findings.push_back({ start, prefix + "this is no flattened message" });
		return;
	}
	size_t used = 0;
	if (unflatten_message(&message, data, size, &damage, &used) != B_OK) {
		const char* reason = damage.reason != NULL ? damage.reason : "the message is damaged";
		report.findings.push_back({ start + static_cast<off_t>(damage.offset), prefix + reason });
		return;
	}
	if (!info.checksum_matches)
		report.findings.push_back({ start, prefix + "the message's checksum does not match" });
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
	if (place.offset + static_cast<off_t>(place.size) > fileSize) {
		report.findings.push_back({ place.offset,
			prefix + "only the first " + std::to_string(std::max<off_t>(fileSize - place.offset, 0))
				+ " of " + std::to_string(place.size) + " bytes are there" });
		return;
	}
	std::string bytes(place.size, '\0');
	if (file.ReadAt(place.offset, bytes.data(), bytes.size())
		!= static_cast<ssize_t>(bytes.size())) {
		report.findings.push_back({ place.offset, prefix + "its bytes cannot be read" });
		return;
	}
	const bool expected = place.type == 'ARCV' || place.type == B_MESSAGE_TYPE;
	CheckMessage(bytes.data(), bytes.size(), place.offset, prefix, expected, report);
}


// A file that is one message has no items.
bool
CheckWholeMessage(BFile& file, Report& report)
{
	char start[64];
	const ssize_t read = file.ReadAt(0, start, sizeof(start));
	message_form_info info;
	if (read <= 0 || get_message_form(start, read, &info) != B_OK)
		return false;
	off_t size = 0;
	file.GetSize(&size);
	std::string bytes(size, '\0');
	if (file.ReadAt(0, bytes.data(), bytes.size()) != size)
		return false;
	CheckMessage(bytes.data(), bytes.size(), 0, "", true, report);
	report.recognized = true;
	return true;
}


bool
WriteRepaired(const std::string& original, const std::string& path, BResources& readable)
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
	if (status == B_OK)
		status = readable.WriteTo(&file);
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
	if (report.findings.empty())
		return;
	Print(std::to_string(report.places.size()) + " items were found\n");
	for (const resource_place& place : report.places)
		Print("  " + ItemText(place.type, place.id) + " \"" + place.name.String() + "\", "
			+ std::to_string(place.size) + " bytes at offset " + std::to_string(place.offset)
			+ "\n");
}


void
PrintJson(const Report& report)
{
	JsonWriter json;
	json.OpenObject();
	json.Name("findings");
	json.OpenArray();
	for (const Finding& finding : report.findings) {
		json.OpenObject(true);
		json.Name("offset");
		json.Integer(finding.offset);
		json.Name("text");
		json.String(finding.text);
		json.CloseObject();
	}
	json.CloseArray();
	json.Name("items");
	json.OpenArray();
	for (const resource_place& place : report.places) {
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
		for (const resource_place& place : report.places)
			CheckItem(file, place, report);
	}

	if (options.json)
		PrintJson(report);
	else
		PrintReport(report, options.file);
	if (!options.repaired.empty() && !WriteRepaired(options.file, options.repaired, readable))
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
