// The reference dumps that lie beside the sample files.
#pragma once

#include <stdint.h>

#include <memory>
#include <string>
#include <vector>

struct DumpMessage;

struct DumpEntry {
	std::string bytes;
	std::shared_ptr<DumpMessage> message; // NULL when the entry is bytes
};

struct DumpField {
	std::string type; // four characters, or hexadecimal
	std::string name;
	std::vector<DumpEntry> entries;
};

struct DumpMessage {
	uint32_t what = 0;
	std::vector<DumpField> fields;
};

struct DumpResource {
	std::string type;
	int32_t id = 0;
	std::string name;
	size_t size = 0;
	std::string format;
	std::shared_ptr<DumpMessage> message; // NULL for other data
	std::string data; // empty when only a checksum is given
};

// Of NAME.txt or NAME.txt.gz. False when there is none or it is not understood.
bool ReadCanonicalDump(const std::string& path, std::vector<DumpResource>* _resources);
