// LookUps: which fields of an archive were asked for.
#pragma once

#include <atomic>
#include <vector>

#include "app/private/MessageData.h"

namespace BPrivate {


// Belongs to the contents that a message had when the recording began. Shared by that message and
// by the object that was made from it; only one thread uses them at a time.
class LookUps {
public:
	explicit LookUps(MessageData* data) :
		// may be NULL
		fData(data)
	{
		if (fData != nullptr)
			fData->Acquire();
	}

	void Acquire() { fReferences.fetch_add(1, std::memory_order_relaxed); }
	void Release()
	{
		if (fReferences.fetch_sub(1, std::memory_order_acq_rel) == 1)
			delete this;
	}

	MessageData* Data() const { return fData; }

	// The field's number in the contents that were asked, which may have been changed meanwhile.
	void Mark(const MessageData* asked, int32 field, const char* name)
	{
		if (asked != fData)
			field = fData != nullptr ? fData->Find(name) : -1;
		if (field < 0)
			return;
		if (field < 64) {
			fFirst |= uint64(1) << field;
			return;
		}
		const size_t word = size_t(field) / 64 - 1;
		if (word >= fMore.size())
			fMore.resize(word + 1);
		fMore[word] |= uint64(1) << (field % 64);
	}

	bool IsMarked(uint32 field) const
	{
		if (field < 64)
			return (fFirst >> field & 1) != 0;
		const size_t word = field / 64 - 1;
		return word < fMore.size() && (fMore[word] >> (field % 64) & 1) != 0;
	}

private:
	~LookUps()
	{
		if (fData != nullptr)
			fData->Release();
	}

	std::atomic<int32> fReferences { 1 };
	MessageData* fData; // a reference
	uint64 fFirst = 0; // a bit for each of the first fields
	std::vector<uint64> fMore;
};


} // namespace BPrivate
