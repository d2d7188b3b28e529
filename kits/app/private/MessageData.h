// MessageData: the fields of a message, shared by its copies.
#pragma once

#include <atomic>
#include <cstdlib>
#include <cstring>

#include <MessageForm.h>
#include <SupportDefs.h>

#include "app/private/SharedBytes.h"

namespace BPrivate {

class ManagedNote;
class MessageData;


// A field's items lie in the message's own store, or in the bytes that the message was read from.
// Fields that were added one after another lie in the store just as the R5 form wants them, and so
// do those that were read from that form; then writing the message is copying bytes.
struct MessageField {
	enum : uint16 {
		kFixed = 0x01, // items of one size, one after another without sizes
		kInSource = 0x02, // offsets count in the bytes that were read, else in the store
		kNameInSource = 0x04,
		kPacked = 0x08, // variable items without padding between them, as the Haiku form has them
		kCompact =
			0x10, // what lies in front of the name is the field's head in the compact R5 form
		kWide = 0x20, // the same for the wide R5 form
		kScattered = 0x40, // only the table tells where the items are
		kCarried = 0x80, // put in by a WriteBack; the first item that is added replaces it
		kTwin = 0x100, // put in by a WriteBack, which knows it by its place only
	};

	uint32 name; // offset
	uint32 data; // offset of the first item (of its size, if variable)
	uint32 size; // bytes of all items; scattered items count as padded
	uint32 count;
	uint32 capacity; // bytes that the data may take where they are, in the store
	type_code type;
	uint32 key; // of the name, see name_key()
	uint64* table; // where each variable item is, see ItemPlace; NULL when they are few
	uint16 nameLength;
	uint16 flags;
	uint32 place; // of a kTwin field, its number in the source

	bool Has(uint16 flag) const { return (flags & flag) != 0; }
	uint32 ItemSize() const { return size / count; } // of a fixed field
	uint32 Start() const; // offset of the encoded field, if it is compact; the data ends it
};


// Where a variable item is: its size word in one of the two stores, or a message that was added
// and is kept as it is.
class ItemPlace {
public:
	static ItemPlace InStore(uint32 offset) { return ItemPlace(uint64(offset) << 2); }
	static ItemPlace InSource(uint32 offset) { return ItemPlace(uint64(offset) << 2 | 2); }
	static ItemPlace Nested(MessageData* data)
	{
		return ItemPlace(reinterpret_cast<uint64>(data) | 1);
	}
	explicit ItemPlace(uint64 word) : fWord(word) {}

	bool IsNested() const { return (fWord & 1) != 0; }
	bool IsInSource() const { return (fWord & 3) == 2; }
	uint32 Offset() const { return uint32(fWord >> 2); }
	MessageData* Message() const { return reinterpret_cast<MessageData*>(fWord & ~uint64(3)); }
	uint64 Word() const { return fWord; }

private:
	uint64 fWord;
};


// What an item is made of: bytes, or a message that is to be written as bytes.
struct ItemContents {
	const void* data;
	size_t size;
	const MessageData* message = nullptr;
};


// The owner of the only reference may change it; all others only read, from any thread.
class MessageData {
public:
	// Up to here a walk over the fields is as good as a table.
	static constexpr uint32 kFewFields = 16;

	static MessageData* Create(); // NULL without memory
	// Takes over a reference to the source and the tables of the fields. When all fields lie one
	// after another in the compact form, bodySize is the sum of their bytes, else 0.
	static MessageData* CreateFrom(SharedBytes* source, const uint8* base,
		const MessageField* fields, uint32 count, int32 level, uint32 bodySize);
	// The same for an array from malloc(), which is taken over too.
	static MessageData* CreateAround(SharedBytes* source, const uint8* base, MessageField* fields,
		uint32 count, int32 level, uint32 bodySize);
	MessageData* Clone() const;

	void Acquire() { fReferences.fetch_add(1, std::memory_order_relaxed); }
	void Release();
	bool IsShared() const { return fReferences.load(std::memory_order_acquire) != 1; }

	// The code is the message's business; this one counts for a message inside another.
	uint32 What() const { return fWhat; }
	void SetWhat(uint32 what) { fWhat = what; }

	uint32 CountFields() const { return fCount; }
	const MessageField& FieldAt(uint32 index) const { return fFields[index]; }
	int32 Find(const char* name) const; // -1; the first of several with one name
	int32 Find(const char* name, size_t length) const;
	const char* NameBytes(const MessageField& field) const; // without a NUL
	const char* NameAt(uint32 index) const; // with one; valid until a change; NULL without memory

	// Items. The index must be in range.
	status_t GetItem(uint32 field, uint32 index, const void** _data, size_t* _size) const;
	size_t ItemSizeAt(uint32 field, uint32 index) const;
	// A new reference, or NULL when the item is no message, or is nested too deep: B_BAD_DATA.
	MessageData* GetMessage(uint32 field, uint32 index, status_t* _status = nullptr) const;
	// The message that was added as such, without a reference, or NULL when there are bytes.
	MessageData* MessageAt(uint32 field, uint32 index) const;

	// Changes, by the only owner. Sizes are not 0, types have been checked.
	status_t AddField(
		const char* name, size_t length, type_code type, bool fixed, const ItemContents& item);
	status_t AddItem(uint32 field, const ItemContents& item);
	status_t AddMessageField(const char* name, size_t length, type_code type, MessageData* data);
	status_t AddMessageItem(uint32 field, MessageData* data);
	status_t ReplaceItem(uint32 field, uint32 index, const ItemContents& item);
	status_t ReplaceMessage(uint32 field, uint32 index, MessageData* data);
	status_t RemoveItem(uint32 field, uint32 index);
	void RemoveField(uint32 field);
	status_t RenameField(uint32 field, const char* name, size_t length);
	// Copies a field of another message to the end, or in the place of one.
	status_t CopyField(const MessageData& from, uint32 field);
	status_t CopyFieldOver(uint32 target, const MessageData& from, uint32 field);
	// Whether the other's field of the same number has the same name, type and bytes. Fields that
	// share their bytes are not read.
	bool HasSameField(uint32 field, const MessageData& other) const;
	// Brings a field to an earlier place.
	void MoveField(uint32 from, uint32 to);
	void SetCarried(uint32 field, bool carried);
	void SetTwin(uint32 field, int32 place); // -1: it is none

	// How deep it lies in the message that was read, and how deep messages lie in it.
	int32 Level() const { return fLevel; }
	int32 Height() const { return fHeight; }

	// The compact R5 form. Both go through the plan of MessageWriter when an item that is a
	// message of another form lies somewhere in it.
	size_t FlatSize() const;
	bool IsPlain() const; // no such item
	// Whether it should go into another message as bytes. Small messages do, so that a tree is
	// written in few pieces; but no byte is copied more than a few times on its way to the root.
	bool IsBetterCopied() const;
	uint8* WritePlain(uint32 what, uint8* to) const;

	ManagedNote* Note() const { return fNote; }
	void SetNote(ManagedNote* note); // takes a reference of its own

	const uint8* Base(const MessageField& field) const
	{
		return field.Has(MessageField::kInSource) ? fSourceBase : fStore;
	}
	ItemPlace PlaceAt(const MessageField& field, uint32 index) const;
	const uint8* BytesAt(ItemPlace place) const // at the size word
	{
		return (place.IsInSource() ? fSourceBase : fStore) + place.Offset();
	}

private:
	MessageData() = default;
	~MessageData();
	void operator delete(void* block) { free(block); }

	static MessageData* _CreateWithRoom(uint32 fields, uint32 store = 0);
	const SharedBytes* _Flat() const;
	uint8* _WriteField(const MessageField& field, uint8* to) const;
	SharedBytes* _SourceOf(uint32 field, uint32 index, const void** _bytes, size_t size) const;
	void _CopyStore(const MessageData& from);
	static bool _CopyPlaces(const MessageField& from, MessageField* copy);
	status_t _ShareField(const MessageField& original);
	status_t _CopyItems(const MessageData& from, uint32 number);
	bool _InitFrom(SharedBytes* source, const uint8* base, int32 level, uint32 bodySize);
	// What was derived from the fields no longer holds.
	void _Changed()
	{
		if (fHasDerived.load(std::memory_order_relaxed))
			_ForgetDerived();
	}
	void _ForgetDerived();
	bool _ReserveFields(uint32 count) { return fCount + count <= fFieldRoom || _GrowFields(count); }
	bool _ReserveStore(size_t size) { return size <= fStoreRoom - fStoreSize || _GrowStore(size); }
	bool _GrowFields(uint32 count);
	bool _GrowStore(size_t size);
	void _AddToIndex(uint32 field);
	bool _BuildIndex();
	bool _IsNamed(const MessageField& field, const char* name, size_t length, uint32 key) const
	{
		return field.key == key && field.nameLength == length
			&& (length == 0 || memcmp(NameBytes(field), name, length) == 0);
	}
	bool _IsAtEnd(const MessageField& field) const;
	status_t _AppendFixed(MessageField& field, const ItemContents& item);
	status_t _AppendVariable(MessageField& field, const ItemContents& item);
	status_t _Lengthen(MessageField& field, uint32 bytes);
	bool _OwnFixed(MessageField& field, size_t capacity);
	bool _MakeTable(MessageField& field, uint32 room);
	bool _Scatter(MessageField& field, uint32 room);
	bool _PutItem(const ItemContents& item, uint32* _offset);
	void _NoteNested(type_code type, const ItemContents& item);
	void _CompactStore();
	void _ReleaseTable(MessageField& field);
	const uint8* _Body(size_t* _size) const;

	std::atomic<int32> fReferences { 1 };
	uint32 fWhat = 0;
	MessageField* fFields = nullptr; // at first behind this object, in the same block
	uint32 fCount = 0;
	uint32 fFieldRoom = 0;
	uint32* fIndex = nullptr; // slots of field numbers + 1; NULL while there are few fields
	uint32 fIndexMask = 0;
	uint64 fNameBits = 0; // a bit for each name that is or was there; most absent names lack theirs
	uint32 fBodySize = 0; // of the source's fields, when they are all there is, as they are
	SharedBytes* fSource = nullptr;
	const uint8* fSourceBase = nullptr;
	uint8* fStore = nullptr; // at first in the same block too, if it is there from the start
	uint32 fStoreSize = 0;
	uint32 fStoreRoom = 0;
	uint32 fWaste = 0; // bytes of the store that no field uses any more
	int16 fLevel = 0;
	int16 fHeight = 0;
	bool fStoreIsInside = false;
	bool fStoreIsBody = true; // the store holds all fields one after another in the compact form
	uint8 fCopies = 0; // how often the bytes of messages in it have been copied
	mutable std::atomic<int8> fPlain { 1 }; // -1: not known
	mutable std::atomic<bool> fHasDerived { false }; // one of the following is set
	mutable std::atomic<uint32> fFlatSize { 0 }; // 0: not known
	mutable std::atomic<SharedBytes*> fFlat { nullptr }; // for those who want the bytes of an item
	mutable std::atomic<char*> fNames { nullptr }; // all names with their NULs
	ManagedNote* fNote = nullptr;
};


// Bytes of an item with its size and padding.
inline size_t
padded_item_size(size_t size)
{
	return (size + 4 + 7) & ~size_t(7);
}


inline uint32
read_uint32(const void* from)
{
	uint32 value;
	memcpy(&value, from, sizeof(value));
	return value;
}


inline void
write_uint32(void* to, uint32 value)
{
	memcpy(to, &value, sizeof(value));
}


inline uint32
r5_field_header_length(uint32 count, size_t size, message_form form)
{
	const bool mini = form == B_R5_FORM && count <= 255 && size <= 255;
	return 1 + 4 + (count == 1 ? 0 : (mini ? 1 : 4)) + (mini ? 1 : 4) + 1;
}


inline uint32
MessageField::Start() const
{
	return name - r5_field_header_length(count, size, B_R5_FORM);
}


// Tells most names apart at a glance.
inline uint32
name_key(const char* name, size_t length)
{
	if (length == 0)
		return 0;
	return uint32(length) << 24 | uint32(uint8(name[0])) << 16
		| uint32(uint8(name[length / 2])) << 8 | uint8(name[length - 1]);
}


inline uint64
name_bit(uint32 key)
{
	return uint64(1) << (key * 0x9e3779b1u >> 26);
}


} // namespace BPrivate
