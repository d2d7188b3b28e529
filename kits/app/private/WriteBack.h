// WriteBack: lets the fields of an archive take the places that they had in an older one.
#pragma once

#include "app/private/MessageData.h"

namespace BPrivate {


// Belongs to the message that is being written and goes with it; copies have none. Fields that are
// carried along give way to the first item that is added under their name, at their place.
class WriteBack {
public:
	explicit WriteBack(MessageData* source) : fSource(source) { fSource->Acquire(); }
	~WriteBack() { fSource->Release(); }
	WriteBack(const WriteBack&) = delete;
	WriteBack& operator=(const WriteBack&) = delete;

	MessageData* Source() const { return fSource; }

	// An item is about to be added to the field: returns its number, or -1 if it had to go. Of a
	// field that is carried from its second item on, the first one stays.
	int32 MakeRoom(MessageData& target, int32 field);
	// The last field is a new one: brings it to its old place.
	void PlaceLast(MessageData& target) const;
	// Puts the source's field in as it was read, in place of the one that may be there.
	status_t Restore(MessageData& target, uint32 sourceField, bool carried) const;
	// Whether the fields are those of the source, in their order.
	bool IsUnchanged(const MessageData& target) const;
	// The items after the first one are carried along only.
	void SetFirstItemOwn(uint32 sourceField) { fFirstItemOwn = int32(sourceField); }

private:
	int32 _PlaceOf(const MessageData& target, uint32 field) const;

	MessageData* fSource; // a reference
	int32 fFirstItemOwn = -1; // number in the source
};


} // namespace BPrivate
