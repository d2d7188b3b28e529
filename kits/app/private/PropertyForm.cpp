#include "app/private/PropertyForm.h"

#include <cstring>

#include <ByteOrder.h>

namespace BPrivate {

namespace {

// Numbers are little-endian. A text is its length and its bytes; a missing one has kNoText for its
// length.
constexpr uint32 kVersion = 1;
constexpr uint32 kNoText = 0xffffffff;


void
PutNumber(std::string& bytes, uint32 number)
{
	const uint32 swapped = B_HOST_TO_LENDIAN_INT32(number);
	bytes.append(reinterpret_cast<const char*>(&swapped), sizeof(swapped));
}


void
PutText(std::string& bytes, const char* text)
{
	if (text == nullptr) {
		PutNumber(bytes, kNoText);
		return;
	}
	PutNumber(bytes, static_cast<uint32>(strlen(text)));
	bytes += text;
}


void
PutNumbers(std::string& bytes, const uint32 (&numbers)[10])
{
	for (uint32 number : numbers)
		PutNumber(bytes, number);
}


// Reads from the front; after the first piece that is not there everything fails.
class Reader {
public:
	Reader(std::string_view bytes, std::deque<std::string>& texts) : fBytes(bytes), fTexts(texts) {}

	bool Failed() const { return fFailed; }

	uint32 Number()
	{
		uint32 number = 0;
		if (fBytes.size() < sizeof(number)) {
			fFailed = true;
			fBytes = {};
			return 0;
		}
		memcpy(&number, fBytes.data(), sizeof(number));
		fBytes.remove_prefix(sizeof(number));
		return B_LENDIAN_TO_HOST_INT32(number);
	}

	void Numbers(uint32 (&numbers)[10])
	{
		for (uint32& number : numbers)
			number = Number();
	}

	char* Text()
	{
		const uint32 length = Number();
		if (length == kNoText)
			return nullptr;
		if (length > fBytes.size()) {
			fFailed = true;
			return nullptr;
		}
		fTexts.emplace_back(fBytes.substr(0, length));
		fBytes.remove_prefix(length);
		return fTexts.back().data();
	}

private:
	std::string_view fBytes;
	std::deque<std::string>& fTexts;
	bool fFailed = false;
};


void
PutProperty(std::string& bytes, const property_info& property)
{
	PutText(bytes, property.name);
	PutText(bytes, property.usage);
	PutNumber(bytes, property.extra_data);
	PutNumbers(bytes, property.commands);
	PutNumbers(bytes, property.specifiers);
	PutNumbers(bytes, property.types);
	for (const compound_type& compound : property.ctypes) {
		for (const compound_type::field_pair& pair : compound.pairs) {
			PutText(bytes, pair.name);
			PutNumber(bytes, pair.type);
		}
	}
}


property_info
ReadProperty(Reader& reader)
{
	property_info property {};
	property.name = reader.Text();
	property.usage = reader.Text();
	property.extra_data = reader.Number();
	reader.Numbers(property.commands);
	reader.Numbers(property.specifiers);
	reader.Numbers(property.types);
	for (compound_type& compound : property.ctypes) {
		for (compound_type::field_pair& pair : compound.pairs) {
			pair.name = reader.Text();
			pair.type = reader.Number();
		}
	}
	return property;
}


value_info
ReadValue(Reader& reader)
{
	value_info value {};
	value.name = reader.Text();
	value.value = reader.Number();
	value.kind = reader.Number() == B_TYPE_CODE_KIND ? B_TYPE_CODE_KIND : B_COMMAND_KIND;
	value.usage = reader.Text();
	value.extra_data = reader.Number();
	return value;
}


// Each entry follows a 1; a 0 ends the list.
template<typename Entry>
bool
ReadList(Reader& reader, std::vector<Entry>& list, Entry (*read)(Reader&))
{
	while (reader.Number() != 0) {
		const Entry entry = read(reader);
		if (entry.name == nullptr || reader.Failed())
			return false;
		list.push_back(entry);
	}
	list.push_back(Entry {});
	return !reader.Failed();
}

} // namespace


std::string
FlattenProperties(const property_info* properties, const value_info* values)
{
	std::string bytes;
	PutNumber(bytes, kVersion);
	for (; properties != nullptr && properties->name != nullptr; properties++) {
		PutNumber(bytes, 1);
		PutProperty(bytes, *properties);
	}
	PutNumber(bytes, 0);
	for (; values != nullptr && values->name != nullptr; values++) {
		PutNumber(bytes, 1);
		PutText(bytes, values->name);
		PutNumber(bytes, values->value);
		PutNumber(bytes, values->kind);
		PutText(bytes, values->usage);
		PutNumber(bytes, values->extra_data);
	}
	PutNumber(bytes, 0);
	return bytes;
}


std::unique_ptr<PropertyTables>
UnflattenProperties(std::string_view bytes)
{
	auto tables = std::make_unique<PropertyTables>();
	Reader reader(bytes, tables->texts);
	if (reader.Number() != kVersion || !ReadList(reader, tables->properties, ReadProperty)
		|| !ReadList(reader, tables->values, ReadValue))
		return nullptr;
	return tables;
}

} // namespace BPrivate
