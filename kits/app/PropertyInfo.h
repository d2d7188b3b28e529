// BPropertyInfo: which properties a class offers to scripting.
#pragma once

#include <memory>

#include <Flattenable.h>
#include <SupportDefs.h>
#include <TypeConstants.h>

class BMessage;

namespace BPrivate {
struct PropertyTables;
}

struct compound_type {
	struct field_pair {
		char* name;
		type_code type;
	};
	field_pair pairs[5];
};

// Arrays end with a 0. An entry without commands or specifiers stands for all of them.
struct property_info {
	const char* name;
	uint32 commands[10];
	uint32 specifiers[10];
	const char* usage;
	uint32 extra_data;
	uint32 types[10];
	compound_type ctypes[3];
	uint32 _reserved[10];
};

enum value_kind { B_COMMAND_KIND = 0, B_TYPE_CODE_KIND = 1 };

struct value_info {
	const char* name;
	uint32 value;
	value_kind kind;
	const char* usage;
	uint32 extra_data;
	uint32 _reserved[10];
};


// The lists are borrowed, and end with an entry without a name. Flattened it is B_PROPERTY_INFO_TYPE,
// in a form of its own.
class _EXPORT BPropertyInfo : public BFlattenable {
public:
	BPropertyInfo(
		property_info* properties = NULL, value_info* values = NULL, bool freeOnDelete = false);
	virtual ~BPropertyInfo();
	BPropertyInfo(const BPropertyInfo&) = delete;
	BPropertyInfo& operator=(const BPropertyInfo&) = delete;

	// The index of the entry that answers the message, or -1.
	virtual int32 FindMatch(BMessage* message, int32 index, BMessage* specifier, int32 form,
		const char* property, void* data = NULL) const;

	const property_info* Properties() const;
	const value_info* Values() const;
	int32 CountProperties() const;
	int32 CountValues() const;
	void PrintToStream() const;

	bool IsFixedSize() const override;
	type_code TypeCode() const override;
	ssize_t FlattenedSize() const override;
	status_t Flatten(void* buffer, ssize_t size) const override;
	// The lists become its own. B_BAD_TYPE, or B_BAD_DATA and no lists.
	status_t Unflatten(type_code code, const void* buffer, ssize_t size) override;

private:
	void _Release();

	property_info* fProperties; // borrowed unless fFreeOnDelete or fUnflattened
	value_info* fValues; // likewise
	bool fFreeOnDelete;
	std::unique_ptr<BPrivate::PropertyTables> fUnflattened; // owns the lists when they were read
};
