#include <BlockCache.h>

#include <algorithm>
#include <cstdlib>
#include <new>

#include <Autolock.h>


BBlockCache::BBlockCache(uint32 blockCount, size_t blockSize, uint32 allocationType) :
	fLocker("block cache"), fBlockSize(std::max(blockSize, sizeof(void*))), fType(allocationType),
	fRoom(blockCount), fBlocks(static_cast<void**>(calloc(blockCount, sizeof(void*))))
{
	while (fBlocks != nullptr && fCount < fRoom) {
		void* block = _Allocate(fBlockSize);
		if (block == nullptr)
			break;
		fBlocks[fCount++] = block;
	}
}


BBlockCache::~BBlockCache()
{
	while (fCount > 0)
		_Free(fBlocks[--fCount]);
	free(fBlocks);
}


void*
BBlockCache::Get(size_t blockSize)
{
	if (blockSize == fBlockSize) {
		BAutolock lock(fLocker);
		if (fCount > 0)
			return fBlocks[--fCount];
	}
	return _Allocate(blockSize);
}


void
BBlockCache::Save(void* pointer, size_t blockSize)
{
	if (pointer == nullptr)
		return;
	if (blockSize == fBlockSize && fBlocks != nullptr) {
		BAutolock lock(fLocker);
		if (fCount < fRoom) {
			fBlocks[fCount++] = pointer;
			return;
		}
	}
	_Free(pointer);
}


void*
BBlockCache::_Allocate(size_t size) const
{
	if (fType == B_MALLOC_CACHE)
		return malloc(size);
	return new (std::nothrow) char[size];
}


void
BBlockCache::_Free(void* block) const
{
	if (fType == B_MALLOC_CACHE)
		free(block);
	else
		delete[] static_cast<char*>(block);
}
