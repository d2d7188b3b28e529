#include "CanonicalDump.h"

#include <stdio.h>
#include <stdlib.h>
#include <unistd.h>

#include <fstream>
#include <iterator>
#include <sstream>

namespace {

std::string
ReadText(const std::string& path)
{
	if (access(path.c_str(), R_OK) == 0) {
		std::ifstream stream(path, std::ios::binary);
		return std::string(std::istreambuf_iterator<char>(stream), {});
	}
	const std::string packed = path + ".gz";
	if (access(packed.c_str(), R_OK) != 0)
		return std::string();
	std::string text;
	FILE* pipe = popen(("gzip -dc '" + packed + "'").c_str(), "r");
	char buffer[65536];
	for (size_t read; (read = fread(buffer, 1, sizeof(buffer), pipe)) > 0;)
		text.append(buffer, read);
	return pclose(pipe) == 0 ? text : std::string();
}


std::string
FromHex(const std::string& digits)
{
	std::string bytes;
	for (size_t i = 0; i + 1 < digits.size(); i += 2)
		bytes += static_cast<char>(strtoul(digits.substr(i, 2).c_str(), NULL, 16));
	return bytes;
}


class Reader {
public:
	explicit Reader(const std::string& text)
	{
		std::istringstream stream(text);
		for (std::string line; std::getline(stream, line);)
			fLines.push_back(line);
	}

	bool Read(std::vector<DumpResource>* _resources)
	{
		while (fLine < fLines.size()) {
			if (fLines[fLine].empty()) {
				fLine++;
				continue;
			}
			if (!_Resource(&_resources->emplace_back()))
				return false;
		}
		return true;
	}

private:
	size_t _Indent() const
	{
		return fLine < fLines.size() ? fLines[fLine].find_first_not_of(' ') : 0;
	}

	// The parts of the line: words, and what stands in quotes.
	std::vector<std::string> _Parts() const
	{
		std::vector<std::string> parts;
		const std::string& line = fLines[fLine];
		for (size_t i = 0; i < line.size();) {
			if (line[i] == ' ') {
				i++;
			} else if (line[i] == '\'') {
				parts.push_back(line.substr(i + 1, 4));
				i += 6;
			} else if (line[i] == '"') {
				std::string text;
				for (i++; i < line.size() && line[i] != '"'; i++) {
					if (line[i] != '\\')
						text += line[i];
					else if (line[i + 1] == 'x') {
						text += FromHex(line.substr(i + 2, 2));
						i += 3;
					} else
						text += line[++i];
				}
				parts.push_back(text);
				i++;
			} else if (line[i] == ';') {
				break;
			} else {
				const size_t end = std::min(line.find(' ', i), line.size());
				parts.push_back(line.substr(i, end - i));
				i = end;
			}
		}
		return parts;
	}

	bool _Resource(DumpResource* resource)
	{
		const std::vector<std::string> parts = _Parts();
		if (parts.size() != 6 || parts[0] != "resource")
			return false;
		resource->type = parts[1];
		resource->id = static_cast<int32_t>(strtoll(parts[2].c_str(), NULL, 10));
		resource->name = parts[3];
		resource->size = strtoull(parts[4].c_str(), NULL, 10);
		resource->format = parts[5];
		fLine++;
		if (resource->format != "raw") {
			resource->message = std::make_shared<DumpMessage>();
			return _Message(resource->message.get(), 2);
		}
		const std::vector<std::string> data = _Parts();
		if (data.empty() || data[0] != "data")
			return false;
		if (data.size() == 3)
			resource->data = FromHex(data[2]);
		fLine++;
		return true;
	}

	bool _Message(DumpMessage* message, size_t indent)
	{
		std::vector<std::string> parts = _Parts();
		if (parts.size() != 2 || parts[0] != "what")
			return false;
		message->what = static_cast<uint32_t>(strtoul(parts[1].c_str(), NULL, 16));
		fLine++;
		while (fLine < fLines.size() && _Indent() == indent) {
			parts = _Parts();
			if (parts.size() != 4 || parts[0] != "field")
				return false;
			DumpField& field = message->fields.emplace_back();
			field.type = parts[1];
			field.name = parts[3];
			fLine++;
			if (!_Entries(&field, strtoull(parts[2].c_str(), NULL, 10), indent + 2))
				return false;
		}
		return true;
	}

	bool _Entries(DumpField* field, size_t count, size_t indent)
	{
		for (size_t i = 0; i < count; i++) {
			const std::vector<std::string> parts =
				fLine < fLines.size() ? _Parts() : std::vector<std::string>();
			if (parts.size() < 2 || _Indent() != indent)
				return false;
			DumpEntry& entry = field->entries.emplace_back();
			fLine++;
			if (parts[1] == "message") {
				entry.message = std::make_shared<DumpMessage>();
				if (!_Message(entry.message.get(), indent + 2))
					return false;
			} else if (parts.size() > 2)
				entry.bytes = FromHex(parts[2]);
		}
		return true;
	}

	std::vector<std::string> fLines;
	size_t fLine = 0;
};

} // namespace


bool
ReadCanonicalDump(const std::string& path, std::vector<DumpResource>* _resources)
{
	if (access(path.c_str(), R_OK) != 0 && access((path + ".gz").c_str(), R_OK) != 0)
		return false;
	return Reader(ReadText(path)).Read(_resources);
}
