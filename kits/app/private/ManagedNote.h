// ManagedNote: where an archive that came from a managed one was found in it.
#pragma once

#include <atomic>
#include <cstdint>

#include <Message.h>

namespace BPrivate {


// What the root of a managed archive carried. Never changes; shared by the notes of all archives
// that came from it.
struct ManagedOrigin {
	std::atomic<int32> references { 1 };
	BMessage root; // as it was read, with its lists
	int32 objectCount = 0; // entries of the list
	bool hasForeignObjects = false; // some are no children of a view

	void Acquire() { references.fetch_add(1, std::memory_order_relaxed); }
	void Release()
	{
		if (references.fetch_sub(1, std::memory_order_acq_rel) == 1)
			delete this;
	}
};


// One archive's place. Never changes; shared by copies of the archive.
class ManagedNote {
public:
	ManagedNote(ManagedOrigin* origin, int32 token) : fOrigin(origin), fToken(token)
	{
		origin->Acquire();
	}

	void Acquire() { fReferences.fetch_add(1, std::memory_order_relaxed); }
	void Release()
	{
		if (fReferences.fetch_sub(1, std::memory_order_acq_rel) == 1)
			delete this;
	}

	ManagedOrigin* Origin() const { return fOrigin; }
	int32 Token() const { return fToken; } // 0 is the root

private:
	~ManagedNote() { fOrigin->Release(); }

	std::atomic<int32> fReferences { 1 };
	ManagedOrigin* fOrigin; // a reference
	int32 fToken;
};


} // namespace BPrivate
