#include "support/AllocationMeter.h"

#include <atomic>
#include <cerrno>
#include <cstdint>
#include <malloc.h>

#if defined(__SANITIZE_ADDRESS__) || defined(__SANITIZE_THREAD__)
#define COUNTS_ALLOCATIONS 0
#else
#define COUNTS_ALLOCATIONS 1
#endif

namespace {

std::atomic<size_t> sLive { 0 };
std::atomic<size_t> sPeak { 0 };
std::atomic<size_t> sLargest { 0 };
std::atomic<size_t> sCount { 0 };
std::atomic<size_t> sTotal { 0 };


void
raise_to(std::atomic<size_t>& mark, size_t value)
{
	size_t old = mark.load(std::memory_order_relaxed);
	while (old < value && !mark.compare_exchange_weak(old, value)) {
	}
}


[[maybe_unused]] void*
took(void* block, size_t asked)
{
	if (block == nullptr)
		return nullptr;
	sCount.fetch_add(1, std::memory_order_relaxed);
	sTotal.fetch_add(asked, std::memory_order_relaxed);
	const size_t size = malloc_usable_size(block);
	raise_to(sPeak, sLive.fetch_add(size) + size);
	raise_to(sLargest, asked);
	return block;
}


[[maybe_unused]] void
gave(void* block)
{
	if (block != nullptr)
		sLive.fetch_sub(malloc_usable_size(block));
}

} // namespace


#if COUNTS_ALLOCATIONS

extern "C" {

void* __libc_malloc(size_t size);
void* __libc_calloc(size_t count, size_t size);
void* __libc_realloc(void* block, size_t size);
void* __libc_memalign(size_t alignment, size_t size);
void __libc_free(void* block);


void*
malloc(size_t size)
{
	return took(__libc_malloc(size), size);
}


void*
calloc(size_t count, size_t size)
{
	return took(__libc_calloc(count, size), count * size);
}


void*
realloc(void* block, size_t size)
{
	const size_t before = block != nullptr ? malloc_usable_size(block) : 0;
	void* moved = __libc_realloc(block, size);
	if (moved != nullptr || size == 0)
		sLive.fetch_sub(before);
	return took(moved, size);
}


void*
memalign(size_t alignment, size_t size)
{
	return took(__libc_memalign(alignment, size), size);
}


void*
aligned_alloc(size_t alignment, size_t size)
{
	return memalign(alignment, size);
}


int
posix_memalign(void** _block, size_t alignment, size_t size)
{
	*_block = memalign(alignment, size);
	return *_block != nullptr ? 0 : ENOMEM;
}


void
free(void* block)
{
	gave(block);
	__libc_free(block);
}

} // extern "C"

#endif


AllocationMeter::AllocationMeter() :
	fLiveBefore(sLive.load()), fCountBefore(sCount.load()), fTotalBefore(sTotal.load())
{
	sPeak.store(fLiveBefore);
	sLargest.store(0);
}


bool
AllocationMeter::IsCounting()
{
	return COUNTS_ALLOCATIONS != 0;
}


size_t
AllocationMeter::Peak() const
{
	return sPeak.load() - fLiveBefore;
}


size_t
AllocationMeter::Largest() const
{
	return sLargest.load();
}


size_t
AllocationMeter::Count() const
{
	return sCount.load() - fCountBefore;
}


size_t
AllocationMeter::Total() const
{
	return sTotal.load() - fTotalBefore;
}
