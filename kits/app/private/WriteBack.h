// WriteBack: lets the fields of an archive take the places that they had in an older one.
#pragma once

#include "app/private/MessageData.h"

namespace BPrivate {


// Belongs to the message that is being written and goes with it; copies have none. Fields that are
// carried along give way to the first item that is added under their name, at their place. Twins of
// other fields (see TwinFields.h) are carried along whatever happens to the first of their name; no
// look-up in the message that is being written finds them, even while the first is not there.
class WriteBack {
public:
	explicit WriteBack(MessageData* source) : fSource(source) { fSource->Acquire(); }
	~WriteBack() { fSource->Release(); }
	WriteBack(const WriteBack&) = delete;
	WriteBack& operator=(const WriteBack&) = delete;

	MessageData* Source() const { return fSource; }

	// The target's field of that name, or -1: none of the twins.
	static int32 Find(const MessageData& target, const char* name, size_t length);
	// An item is about to be added to the field of that name: returns its number, or -1 if there is
	// none or it had to go. Of a field that is carried from its second item on, the first one stays.
	int32 MakeRoom(MessageData& target, const char* name, size_t length);
	// The last field is a new one: brings it to its old place.
	void PlaceLast(MessageData& target) const;
	// Puts the source's field in as it was read, in place of the one that may be there.
	status_t Restore(MessageData& target, uint32 sourceField, bool carried) const;
	// Tells the twins of that name in a target that was written before and read again.
	void MarkTwins(MessageData& target, const char* name) const;
	// Puts a twin in.
	status_t RestoreTwin(MessageData& target, uint32 sourceField) const;
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
