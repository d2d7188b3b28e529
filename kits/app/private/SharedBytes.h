// SharedBytes: a block of bytes that several messages refer to.
#pragma once

#include <atomic>
#include <cstdlib>
#include <new>

#include <SupportDefs.h>

namespace BPrivate {


// Never changes once it is shared. Starts with one reference; the last one frees it. Any thread.
class SharedBytes {
public:
	typedef void (*release_func)(void* cookie);

	// Room for the caller to fill in before sharing; NULL without memory.
	static SharedBytes* Create(size_t size)
	{
		void* block = malloc(sizeof(SharedBytes) + size);
		if (block == nullptr)
			return nullptr;
		return new (block) SharedBytes(static_cast<uint8*>(block) + sizeof(SharedBytes), size);
	}

	// Takes the bytes as they are; the function is called when nobody refers to them any more.
	static SharedBytes* Adopt(const void* bytes, size_t size, release_func release, void* cookie)
	{
		void* block = malloc(sizeof(SharedBytes));
		if (block == nullptr)
			return nullptr;
		auto* shared =
			new (block) SharedBytes(const_cast<uint8*>(static_cast<const uint8*>(bytes)), size);
		shared->fRelease = release;
		shared->fCookie = cookie;
		return shared;
	}

	void Acquire() { fReferences.fetch_add(1, std::memory_order_relaxed); }

	void Release()
	{
		if (fReferences.fetch_sub(1, std::memory_order_acq_rel) != 1)
			return;
		if (fRelease != nullptr)
			fRelease(fCookie);
		free(this);
	}

	uint8* Bytes() const { return fBytes; }
	size_t Size() const { return fSize; }

private:
	SharedBytes(uint8* bytes, size_t size) : fBytes(bytes), fSize(size) {}

	std::atomic<int32> fReferences { 1 };
	uint8* fBytes;
	size_t fSize;
	release_func fRelease = nullptr;
	void* fCookie = nullptr;
};


} // namespace BPrivate
