// BResourceHandle: names one item of a collection for as long as the collection lives.
#pragma once

#include <BeBuild.h>
#include <SupportDefs.h>

namespace BResEditor {

class BResourceCollection;


// A small value, to be copied freely. It stays the name of its item while the item is renamed,
// renumbered or edited; after the item's removal it names nothing, and its number is not used
// again. The default handle is invalid.
class _EXPORT BResourceHandle {
public:
	BResourceHandle();

	// Whether this ever named an item; whether the item still exists, only the collection knows.
	bool IsValid() const;

	bool operator==(const BResourceHandle& other) const;
	bool operator!=(const BResourceHandle& other) const;

private:
	friend class BResourceCollection;

	explicit BResourceHandle(int32 number);

	int32 fNumber; // from 1, counted up in each collection; 0 for the invalid handle
};


} // namespace BResEditor
