// BEntryList: an iteration over entries.
#pragma once

#include <dirent.h>

#include <SupportDefs.h>

class BEntry;
struct entry_ref;


class BEntryList {
public:
	BEntryList();
	virtual ~BEntryList();

	// B_ENTRY_NOT_FOUND at the end.
	virtual status_t GetNextEntry(BEntry* entry, bool traverse = false) = 0;
	virtual status_t GetNextRef(entry_ref* ref) = 0;
	// Fills `buffer` with whole records; the number of records, 0 at the end.
	virtual int32 GetNextDirents(struct dirent* buffer, size_t length, int32 count = INT32_MAX) = 0;
	virtual status_t Rewind() = 0;
	virtual int32 CountEntries() = 0;
};
