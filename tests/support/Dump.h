// Reads the canonical dumps of resource files that lie beside the samples.
#pragma once

#include <memory>
#include <string>
#include <vector>

#include <Message.h>

namespace test {

struct DumpMessage;

struct DumpItem {
	std::string bytes; // of an item that is no message
	std::unique_ptr<DumpMessage> message;
};

struct DumpField {
	type_code type = 0;
	std::string name;
	std::vector<DumpItem> items;
};

struct DumpMessage {
	uint32 what = 0;
	std::vector<DumpField> fields;
};

struct DumpResource {
	type_code type = 0;
	int32 id = 0;
	std::string name;
	size_t size = 0;
	std::string format; // r5, r5-swapped, haiku or raw
	std::unique_ptr<DumpMessage> message; // NULL for a raw one
	std::string data; // of a raw one, empty when only its sum is given
};


// Reads a dump, also one that was packed with gzip. Throws std::runtime_error with the line that
// cannot be understood; a dump is test data, so this fails the test.
std::vector<DumpResource> read_dump(const std::string& path);

// Empty when the message is what the dump says, else where the two differ.
std::string difference(const BMessage& message, const DumpMessage& dump);

// The first difference of two messages, the order of their fields included, as a path; empty when
// there is none.
std::string first_difference(const BMessage& read, const BMessage& written);

// The sample folder, or an empty text when the environment names none.
std::string samples_folder();
// Paths of all resource files among the samples that have a dump beside them.
std::vector<std::string> sample_files();
// The dump of such a file.
std::string dump_of(const std::string& resourceFile);

} // namespace test
