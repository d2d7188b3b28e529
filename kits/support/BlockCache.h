// BBlockCache: blocks of memory of one size, kept for the next use.
#pragma once

#include <Locker.h>
#include <SupportDefs.h>

// How blocks are made: with new[] or with malloc().
enum { B_OBJECT_CACHE = 0, B_MALLOC_CACHE = 1 };

// Any thread. Deleting the cache frees the blocks in it; those outside stay their users', who free
// them in the manner of the cache.
class BBlockCache {
public:
	BBlockCache(uint32 blockCount, size_t blockSize, uint32 allocationType);
	virtual ~BBlockCache();
	BBlockCache(const BBlockCache&) = delete;
	BBlockCache& operator=(const BBlockCache&) = delete;

	// A block of another size than the cache's, or when none is left, is made anew. NULL without
	// memory.
	void* Get(size_t blockSize);
	// Takes back what Get() gave, with the size it was asked for; frees what the cache has no room
	// for.
	void Save(void* pointer, size_t blockSize);

private:
	void* _Allocate(size_t size) const;
	void _Free(void* block) const;

	BLocker fLocker;
	const size_t fBlockSize;
	const uint32 fType;
	const uint32 fRoom; // how many blocks may lie here
	uint32 fCount = 0;
	void** fBlocks; // owned; NULL without memory, then nothing is kept
};
