// ResourceReader: the one reader of resource sections.
#pragma once

#include <memory>
#include <string>
#include <vector>

#include <ResourceForm.h>
#include <SupportDefs.h>

#include "storage/private/ResourceContainer.h"
#include "storage/private/ResourceItem.h"

class BPositionIO;

namespace BPrivate {

// The words of a section that mean nothing to us but are kept when it is written.
struct ResourceExtras {
	std::string headerPadding; // as in the file; empty when it is all zero
	std::string unknown; // the same for the unknown section, when it is no filler
};

// Reads tables only, never the data. Every number is checked against the file before it is used,
// and memory grows with the tables' real size. Strictly, the first damage ends the reading;
// tolerantly, everything that can still be told is read, and all damages are noted.
class ResourceReader {
public:
	// The file is borrowed.
	ResourceReader(BPositionIO& file, bool tolerant);

	// What a strict reading answers, also when the reading was tolerant.
	status_t Read();

	const resource_file_info& Info() const { return fInfo; }
	off_t FileSize() const { return fFileSize; }
	const ResourceExtras& Extras() const { return fExtras; }
	std::vector<resource_damage>& Damages() { return fReport.damages; }
	// In the order of the index. None has its data in memory.
	std::vector<std::unique_ptr<ResourceItem>>& Items() { return fItems; }

private:
	struct IndexEntry {
		uint32 offset, size;
		off_t place; // of the entry in the file
		bool used;
	};

	// Notes a damage; true when the reading has to end here.
	bool _Stop(bool wrong, off_t offset, const char* reason, status_t status);
	bool _ReadAt(off_t offset, size_t size, std::string* _bytes);
	uint32 _Word(const char* bytes) const;
	uint16 _Half(const char* bytes) const;
	bool _IsFiller(const std::string& bytes, size_t start, uint32 sectionOffset, size_t size) const;

	void _ReadSection();
	bool _FindByteOrder(const char* start);
	bool _ReadHeader();
	void _FindMagic();
	bool _ReadIndex();
	bool _ReadEntries();
	bool _AddEntry(const char* bytes, off_t place);
	void _ReadUnknown();
	bool _ReadInfoTable();
	bool _ReadInfos(const std::string& table, size_t size);
	bool _ReadInfo(const std::string& table, size_t size, size_t* _place, type_code type);
	void _AddItem(size_t index, type_code type, int32 id, const std::string& name, bool named);
	void _KeepLostEntries();
	bool _CheckTotal();

	BPositionIO& fFile;
	const bool fTolerant;
	off_t fFileSize;
	status_t fStatus;
	resource_file_info fInfo;
	ResourceDamageReport fReport;
	ResourceExtras fExtras;
	uint32 fCount; // as the header has it
	uint32 fIndexSize;
	uint32 fInfoOffset;
	uint32 fInfoTableSize;
	bool fLostInfos; // the info table broke off: entries may lack their infos for that reason
	std::vector<IndexEntry> fEntries;
	std::vector<std::unique_ptr<ResourceItem>> fItems; // by index entry, NULL without an info
};

} // namespace BPrivate
