#include "support/Dump.h"

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <sstream>
#include <stdexcept>

#include <MessageForm.h>

namespace test {

namespace {

std::string
read_file(const std::string& path)
{
	if (!path.ends_with(".gz")) {
		std::ifstream file(path, std::ios::binary);
		std::ostringstream text;
		text << file.rdbuf();
		return text.str();
	}
	FILE* pipe = popen(("gzip -dc '" + path + "'").c_str(), "r");
	if (pipe == nullptr)
		throw std::runtime_error("cannot unpack " + path);
	std::string text;
	char buffer[65536];
	for (size_t size; (size = fread(buffer, 1, sizeof(buffer), pipe)) > 0;)
		text.append(buffer, size);
	if (pclose(pipe) != 0)
		throw std::runtime_error("cannot unpack " + path);
	return text;
}


// One line, taken apart from the left.
class Line {
public:
	explicit Line(std::string text) : fText(std::move(text))
	{
		while (fAt < fText.size() && fText[fAt] == ' ')
			fAt++;
		fIndent = fAt;
	}

	size_t Indent() const { return fIndent; }
	bool IsAtEnd() const { return fAt >= fText.size(); }

	bool Take(const char* word)
	{
		const size_t length = strlen(word);
		if (fText.compare(fAt, length, word) != 0)
			return false;
		fAt += length;
		_Skip();
		return true;
	}

	std::string Word()
	{
		const size_t end = std::min(fText.find(' ', fAt), fText.size());
		const std::string word = fText.substr(fAt, end - fAt);
		fAt = end;
		_Skip();
		return word;
	}

	type_code Type()
	{
		if (fText[fAt] != '\'')
			return type_code(std::stoul(Word(), nullptr, 16));
		type_code type = 0;
		for (size_t i = 1; i <= 4; i++)
			type = type << 8 | uint8(fText.at(fAt + i));
		fAt += 6;
		_Skip();
		return type;
	}

	std::string Quoted()
	{
		if (fText[fAt] != '"')
			Fail();
		std::string text;
		for (fAt++; fText.at(fAt) != '"'; fAt++) {
			if (fText[fAt] != '\\')
				text += fText[fAt];
			else if (fText.at(++fAt) == 'x') {
				text += char(std::stoi(fText.substr(fAt + 1, 2), nullptr, 16));
				fAt += 2;
			} else
				text += fText[fAt];
		}
		fAt++;
		_Skip();
		return text;
	}

	std::string Bytes(size_t size)
	{
		std::string bytes;
		for (size_t i = 0; i < size; i++)
			bytes += char(std::stoi(fText.substr(fAt + 2 * i, 2), nullptr, 16));
		return bytes;
	}

	[[noreturn]] void Fail() const { throw std::runtime_error("cannot read dump line: " + fText); }

private:
	void _Skip()
	{
		while (fAt < fText.size() && fText[fAt] == ' ')
			fAt++;
	}

	std::string fText;
	size_t fAt = 0;
	size_t fIndent = 0;
};


class Reader {
public:
	explicit Reader(const std::string& text)
	{
		std::istringstream stream(text);
		for (std::string line; std::getline(stream, line);) {
			if (!line.empty())
				fLines.emplace_back(line);
		}
	}

	std::vector<DumpResource> Read()
	{
		std::vector<DumpResource> resources;
		while (fNext < fLines.size())
			resources.push_back(_Resource());
		return resources;
	}

private:
	DumpResource _Resource()
	{
		Line& line = fLines[fNext++];
		if (!line.Take("resource"))
			line.Fail();
		DumpResource resource;
		resource.type = line.Type();
		resource.id = int32(std::stol(line.Word()));
		resource.name = line.Quoted();
		resource.size = std::stoul(line.Word());
		resource.format = line.Word();
		const size_t indent = line.Indent();
		if (fNext >= fLines.size() || fLines[fNext].Indent() <= indent)
			return resource;
		if (fLines[fNext].Take("data")) {
			Line& data = fLines[fNext++];
			const size_t size = std::stoul(data.Word());
			if (!data.Take("sha256"))
				resource.data = data.Bytes(size);
		} else
			resource.message = _Message(indent);
		return resource;
	}

	std::unique_ptr<DumpMessage> _Message(size_t indent)
	{
		auto message = std::make_unique<DumpMessage>();
		Line& line = fLines[fNext++];
		if (!line.Take("what"))
			line.Fail();
		message->what = uint32(std::stoul(line.Word(), nullptr, 16));
		while (fNext < fLines.size() && fLines[fNext].Indent() > indent)
			message->fields.push_back(_Field());
		return message;
	}

	DumpField _Field()
	{
		Line& line = fLines[fNext++];
		if (!line.Take("field"))
			line.Fail();
		DumpField field;
		field.type = line.Type();
		const size_t count = std::stoul(line.Word());
		field.name = line.Quoted();
		for (size_t i = 0; i < count; i++)
			field.items.push_back(_Item());
		return field;
	}

	DumpItem _Item()
	{
		Line& line = fLines.at(fNext++);
		line.Word();
		DumpItem item;
		if (line.Take("message"))
			item.message = _Message(line.Indent());
		else {
			const size_t size = std::stoul(line.Word());
			item.bytes = line.Bytes(size);
		}
		return item;
	}

	std::vector<Line> fLines;
	size_t fNext = 0;
};


std::string
item_difference(const BMessage& message, int32 number, const DumpField& field, int32 index)
{
	const DumpItem& item = field.items[size_t(index)];
	const std::string where = field.name + "[" + std::to_string(index) + "]";
	if (item.message != nullptr) {
		BMessage nested;
		if (find_field_message(message, number, index, &nested) != B_OK)
			return where + ": no message";
		const std::string inside = difference(nested, *item.message);
		return inside.empty() ? inside : where + "/" + inside;
	}
	const void* data;
	ssize_t size;
	if (find_field_data(message, number, index, &data, &size) != B_OK)
		return where + ": not found";
	const bool same = size_t(size) == item.bytes.size()
		&& memcmp(data, item.bytes.data(), item.bytes.size()) == 0;
	return same ? std::string() : where + ": other bytes";
}

} // namespace


std::vector<DumpResource>
read_dump(const std::string& path)
{
	return Reader(read_file(path)).Read();
}


std::string
difference(const BMessage& message, const DumpMessage& dump)
{
	if (message.what != dump.what)
		return "what";
	if (size_t(message.CountNames(B_ANY_TYPE)) != dump.fields.size())
		return "number of fields";
	for (size_t i = 0; i < dump.fields.size(); i++) {
		const DumpField& field = dump.fields[i];
		char* name;
		type_code type;
		int32 count;
		if (message.GetInfo(B_ANY_TYPE, int32(i), &name, &type, &count) != B_OK)
			return "field " + std::to_string(i);
		if (field.name != name || field.type != type || field.items.size() != size_t(count))
			return field.name + ": other name, type or count";
		for (int32 k = 0; k < count; k++) {
			const std::string text = item_difference(message, int32(i), field, k);
			if (!text.empty())
				return text;
		}
	}
	return std::string();
}


std::string
first_difference(const BMessage& read, const BMessage& written)
{
	if (read.what != written.what)
		return ": what";
	char* name;
	type_code type;
	int32 count;
	for (int32 i = 0; read.GetInfo(B_ANY_TYPE, i, &name, &type, &count) == B_OK; i++) {
		char* otherName = nullptr;
		type_code otherType;
		int32 otherCount;
		if (written.GetInfo(B_ANY_TYPE, i, &otherName, &otherType, &otherCount) != B_OK)
			return std::string(": no field ") + name;
		if (strcmp(name, otherName) != 0)
			return std::string(": ") + otherName + " in the place of " + name;
		if (type != otherType || count != otherCount)
			return std::string(": type or count of ") + name;
		for (int32 k = 0; k < count; k++) {
			const std::string path = std::string(".") + name + "[" + std::to_string(k) + "]";
			BMessage a, b;
			if (type == B_MESSAGE_TYPE && find_field_message(read, i, k, &a) == B_OK
				&& find_field_message(written, i, k, &b) == B_OK) {
				const std::string nested = first_difference(a, b);
				if (!nested.empty())
					return path + nested;
				continue;
			}
			const void* data = nullptr;
			const void* otherData = nullptr;
			ssize_t size = 0;
			ssize_t otherSize = 0;
			find_field_data(read, i, k, &data, &size);
			find_field_data(written, i, k, &otherData, &otherSize);
			if (size != otherSize || memcmp(data, otherData, size) != 0)
				return path + ": bytes";
		}
	}
	if (written.GetInfo(B_ANY_TYPE, read.CountNames(B_ANY_TYPE), &name, &type, &count) == B_OK)
		return std::string(": new field ") + name;
	return "";
}


std::string
samples_folder()
{
	const char* folder = getenv("ARCHWAY_SAMPLES");
	return folder != nullptr ? folder : "";
}


std::vector<std::string>
sample_files()
{
	std::vector<std::string> files;
	if (samples_folder().empty())
		return files;
	for (const auto& entry : std::filesystem::recursive_directory_iterator(samples_folder())) {
		const std::string path = entry.path();
		if ((path.ends_with(".rsrc") || path.ends_with(".bin")) && !dump_of(path).empty())
			files.push_back(path);
	}
	std::sort(files.begin(), files.end());
	return files;
}


std::string
dump_of(const std::string& resourceFile)
{
	std::string base = resourceFile;
	if (base.ends_with(".rsrc"))
		base.resize(base.size() - strlen(".rsrc"));
	for (const char* end : { ".txt", ".txt.gz" }) {
		if (std::filesystem::exists(base + end))
			return base + end;
	}
	return std::string();
}


} // namespace test
