// What lies where in a resource file, damaged ones included: a small extension of BResources.
#pragma once

#include <vector>

#include <String.h>
#include <SupportDefs.h>

class BFile;
class BPositionIO;
class BResources;

enum resource_file_kind {
	B_NO_RESOURCE_FILE,
	B_EMPTY_FILE, // becomes an x86 resource file when it is first written
	B_X86_RESOURCE_FILE,
	B_PPC_RESOURCE_FILE,
	B_PEF_FILE,
	B_ELF_FILE
};

struct resource_file_info {
	resource_file_kind kind;
	bool big_endian; // the section's numbers, and those resources that are numbers
	bool has_section; // an executable may have none yet
	off_t base; // where the section starts, or would start
};

// One resource and where its bytes are.
struct resource_place {
	type_code type;
	int32 id;
	BString name;
	off_t offset; // from the start of the file
	size_t size;
};

// Something that does not fit, for a person who looks at a damaged file.
struct resource_damage {
	off_t offset; // from the start of the file
	const char* reason; // a sentence's end: "the name passes the end of the info table"
	bool fatal; // whether BResources refuses the file because of it
};

// The status that BResources::SetTo() would answer. With B_OK *_places lists all resources in
// their order, and the damages are at most oddities. Otherwise as much as can be read is listed,
// and *_damages says what is wrong; an item whose type was lost is listed as B_RAW_TYPE. All but
// `file` may be NULL. `readable` gets a copy of the listed resources that are wholly there; the
// second of two with one type and id gets the next free id.
status_t examine_resource_file(BPositionIO* file, resource_file_info* _info,
	std::vector<resource_place>* _places, std::vector<resource_damage>* _damages,
	BResources* readable = NULL);

// The bytes of the resource that GetResourceInfo() tells about by this index, also where an earlier
// one has the same type and id. They stay the resources' own, as those of LoadResource().
const void* load_resource(BResources* resources, int32 index, size_t* _size);

// BResources::WriteTo() into a file that may be no resource file, or a damaged one: that is given up
// as by SetTo() with `clobber`, but in one step, so that the file is at every moment what it was or
// holds all resources. An executable's own part stays.
status_t write_resources_over(BResources* resources, BFile* file);
