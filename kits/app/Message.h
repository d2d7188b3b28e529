// BMessage: a code and named fields, each a list of items of one type.
#pragma once

#include <AppDefs.h>
#include <DataIO.h>
#include <Entry.h>
#include <Flattenable.h>
#include <GraphicsDefs.h>
#include <Messenger.h>
#include <OS.h>
#include <Point.h>
#include <Rect.h>
#include <SupportDefs.h>
#include <TypeConstants.h>

class BHandler;
class BString;
struct node_ref;

namespace BPrivate {
class DeliveryState;
class LookUps;
class MessageData;
class MessagePrivate;
class WriteBack;
} // namespace BPrivate

enum {
	B_FIELD_NAME_LENGTH = 255,
	B_PROPERTY_NAME_LENGTH = 255,
};


// Copies share their fields until one of them is changed, so a copy, and a message that is added
// to or found in another, costs next to nothing. Fields keep the order in which their names were
// first added. Look-up of a name and of an item take constant time. Different messages may be used
// by different threads, also when they share fields; one message by one thread at a time.
//
// A pointer into a message (FindData(), FindString(), the names from GetInfo()) is valid until the
// message changes and has no alignment.
class BMessage {
public:
	uint32 what = 0;

	BMessage();
	BMessage(uint32 what);
	BMessage(const BMessage& message);
	BMessage(BMessage&& message);
	virtual ~BMessage();

	BMessage& operator=(const BMessage& message);
	BMessage& operator=(BMessage&& message);

	// Fields. An index counts all fields, or those of the type.
	status_t GetInfo(type_code typeRequested, int32 index, char** nameFound, type_code* typeFound,
		int32* countFound = NULL) const;
	status_t GetInfo(const char* name, type_code* typeFound, int32* countFound = NULL) const;
	status_t GetInfo(const char* name, type_code* typeFound, bool* fixedSize) const;
	status_t GetInfo(
		const char* name, type_code* typeFound, int32* countFound, bool* fixedSize) const;
	int32 CountNames(type_code type) const;
	bool IsEmpty() const;
	bool IsSystem() const;
	bool IsReply() const;
	void PrintToStream() const;
	status_t Rename(const char* oldEntry, const char* newEntry);

	// Delivery: see the looper. All are false or empty for a message that was not delivered.
	bool WasDelivered() const;
	bool IsSourceWaiting() const;
	bool IsSourceRemote() const;
	BMessenger ReturnAddress() const;
	const BMessage* Previous() const; // owned by this message
	bool WasDropped() const;
	BPoint DropPoint(BPoint* offset = NULL) const;

	// The message is copied.
	status_t SendReply(uint32 command, BHandler* replyTo = NULL);
	status_t SendReply(
		BMessage* reply, BHandler* replyTo = NULL, bigtime_t timeout = B_INFINITE_TIMEOUT);
	status_t SendReply(BMessage* reply, BMessenger replyTo, bigtime_t timeout = B_INFINITE_TIMEOUT);
	// Synchronous: waits for the answer to the reply.
	status_t SendReply(uint32 command, BMessage* replyToReply);
	status_t SendReply(BMessage* reply, BMessage* replyToReply,
		bigtime_t sendTimeout = B_INFINITE_TIMEOUT, bigtime_t replyTimeout = B_INFINITE_TIMEOUT);

	// Bytes. Flatten() writes the R5 form in the host's byte order; see MessageForm.h for others.
	// Unflatten() reads every form, and on an error leaves the message empty. The one that takes
	// a buffer without a length trusts the size that its header gives.
	ssize_t FlattenedSize() const;
	status_t Flatten(char* buffer, ssize_t size) const;
	status_t Flatten(BDataIO* stream, ssize_t* size = NULL) const;
	status_t Unflatten(const char* flatBuffer);
	status_t Unflatten(BDataIO* stream);

	// Specifiers of scripting messages
	status_t AddSpecifier(const char* property);
	status_t AddSpecifier(const char* property, int32 index);
	status_t AddSpecifier(const char* property, int32 index, int32 range);
	status_t AddSpecifier(const char* property, const char* name);
	status_t AddSpecifier(const BMessage* specifier);
	status_t SetCurrentSpecifier(int32 index);
	status_t GetCurrentSpecifier(int32* index, BMessage* specifier = NULL, int32* form = NULL,
		const char** property = NULL) const;
	bool HasSpecifiers() const;
	status_t PopSpecifier();

	// Adding. B_BAD_TYPE when the field has another type, B_BAD_VALUE for no data or when the items
	// of a fixed-size field differ in size.
	status_t AddRect(const char* name, BRect value);
	status_t AddPoint(const char* name, BPoint value);
	status_t AddInt8(const char* name, int8 value);
	status_t AddUInt8(const char* name, uint8 value);
	status_t AddInt16(const char* name, int16 value);
	status_t AddUInt16(const char* name, uint16 value);
	status_t AddInt32(const char* name, int32 value);
	status_t AddUInt32(const char* name, uint32 value);
	status_t AddInt64(const char* name, int64 value);
	status_t AddUInt64(const char* name, uint64 value);
	status_t AddBool(const char* name, bool value);
	status_t AddFloat(const char* name, float value);
	status_t AddDouble(const char* name, double value);
	status_t AddColor(const char* name, rgb_color value);
	status_t AddString(const char* name, const char* string);
	status_t AddString(const char* name, const BString& string);
	status_t AddPointer(const char* name, const void* pointer);
	status_t AddMessenger(const char* name, BMessenger messenger);
	status_t AddRef(const char* name, const entry_ref* ref);
	status_t AddNodeRef(const char* name, const node_ref* ref);
	status_t AddMessage(const char* name, const BMessage* message);
	status_t AddFlat(const char* name, BFlattenable* object, int32 count = 1);
	status_t AddFlat(const char* name, const BFlattenable* object, int32 count = 1);
	status_t AddData(const char* name, type_code type, const void* data, ssize_t numBytes,
		bool isFixedSize = true, int32 count = 1);
	// Every item of the other message, in its order; stops at the first error.
	status_t Append(const BMessage& message);

	// Removing. The field goes with its last item.
	status_t RemoveData(const char* name, int32 index = 0);
	status_t RemoveName(const char* name);
	status_t MakeEmpty(); // the code stays

	// Finding. On an error the number functions give zero, the others their default object.
	status_t FindRect(const char* name, BRect* value) const;
	status_t FindRect(const char* name, int32 index, BRect* value) const;
	status_t FindPoint(const char* name, BPoint* value) const;
	status_t FindPoint(const char* name, int32 index, BPoint* value) const;
	status_t FindInt8(const char* name, int8* value) const;
	status_t FindInt8(const char* name, int32 index, int8* value) const;
	status_t FindUInt8(const char* name, uint8* value) const;
	status_t FindUInt8(const char* name, int32 index, uint8* value) const;
	status_t FindInt16(const char* name, int16* value) const;
	status_t FindInt16(const char* name, int32 index, int16* value) const;
	status_t FindUInt16(const char* name, uint16* value) const;
	status_t FindUInt16(const char* name, int32 index, uint16* value) const;
	status_t FindInt32(const char* name, int32* value) const;
	status_t FindInt32(const char* name, int32 index, int32* value) const;
	status_t FindUInt32(const char* name, uint32* value) const;
	status_t FindUInt32(const char* name, int32 index, uint32* value) const;
	status_t FindInt64(const char* name, int64* value) const;
	status_t FindInt64(const char* name, int32 index, int64* value) const;
	status_t FindUInt64(const char* name, uint64* value) const;
	status_t FindUInt64(const char* name, int32 index, uint64* value) const;
	status_t FindBool(const char* name, bool* value) const;
	status_t FindBool(const char* name, int32 index, bool* value) const;
	status_t FindFloat(const char* name, float* value) const;
	status_t FindFloat(const char* name, int32 index, float* value) const;
	status_t FindDouble(const char* name, double* value) const;
	status_t FindDouble(const char* name, int32 index, double* value) const;
	status_t FindColor(const char* name, rgb_color* value) const;
	status_t FindColor(const char* name, int32 index, rgb_color* value) const;
	status_t FindString(const char* name, const char** string) const;
	status_t FindString(const char* name, int32 index, const char** string) const;
	status_t FindString(const char* name, BString* string) const;
	status_t FindString(const char* name, int32 index, BString* string) const;
	status_t FindPointer(const char* name, void** pointer) const;
	status_t FindPointer(const char* name, int32 index, void** pointer) const;
	status_t FindMessenger(const char* name, BMessenger* messenger) const;
	status_t FindMessenger(const char* name, int32 index, BMessenger* messenger) const;
	status_t FindRef(const char* name, entry_ref* ref) const;
	status_t FindRef(const char* name, int32 index, entry_ref* ref) const;
	status_t FindNodeRef(const char* name, node_ref* ref) const;
	status_t FindNodeRef(const char* name, int32 index, node_ref* ref) const;
	status_t FindMessage(const char* name, BMessage* message) const;
	status_t FindMessage(const char* name, int32 index, BMessage* message) const;
	status_t FindFlat(const char* name, BFlattenable* object) const;
	status_t FindFlat(const char* name, int32 index, BFlattenable* object) const;
	status_t FindData(const char* name, type_code type, const void** data, ssize_t* numBytes) const;
	status_t FindData(
		const char* name, type_code type, int32 index, const void** data, ssize_t* numBytes) const;

	// Replacing an item in its place; never adds.
	status_t ReplaceRect(const char* name, BRect value);
	status_t ReplaceRect(const char* name, int32 index, BRect value);
	status_t ReplacePoint(const char* name, BPoint value);
	status_t ReplacePoint(const char* name, int32 index, BPoint value);
	status_t ReplaceInt8(const char* name, int8 value);
	status_t ReplaceInt8(const char* name, int32 index, int8 value);
	status_t ReplaceUInt8(const char* name, uint8 value);
	status_t ReplaceUInt8(const char* name, int32 index, uint8 value);
	status_t ReplaceInt16(const char* name, int16 value);
	status_t ReplaceInt16(const char* name, int32 index, int16 value);
	status_t ReplaceUInt16(const char* name, uint16 value);
	status_t ReplaceUInt16(const char* name, int32 index, uint16 value);
	status_t ReplaceInt32(const char* name, int32 value);
	status_t ReplaceInt32(const char* name, int32 index, int32 value);
	status_t ReplaceUInt32(const char* name, uint32 value);
	status_t ReplaceUInt32(const char* name, int32 index, uint32 value);
	status_t ReplaceInt64(const char* name, int64 value);
	status_t ReplaceInt64(const char* name, int32 index, int64 value);
	status_t ReplaceUInt64(const char* name, uint64 value);
	status_t ReplaceUInt64(const char* name, int32 index, uint64 value);
	status_t ReplaceBool(const char* name, bool value);
	status_t ReplaceBool(const char* name, int32 index, bool value);
	status_t ReplaceFloat(const char* name, float value);
	status_t ReplaceFloat(const char* name, int32 index, float value);
	status_t ReplaceDouble(const char* name, double value);
	status_t ReplaceDouble(const char* name, int32 index, double value);
	status_t ReplaceColor(const char* name, rgb_color value);
	status_t ReplaceColor(const char* name, int32 index, rgb_color value);
	status_t ReplaceString(const char* name, const char* string);
	status_t ReplaceString(const char* name, int32 index, const char* string);
	status_t ReplaceString(const char* name, const BString& string);
	status_t ReplaceString(const char* name, int32 index, const BString& string);
	status_t ReplacePointer(const char* name, const void* pointer);
	status_t ReplacePointer(const char* name, int32 index, const void* pointer);
	status_t ReplaceMessenger(const char* name, BMessenger messenger);
	status_t ReplaceMessenger(const char* name, int32 index, BMessenger messenger);
	status_t ReplaceRef(const char* name, const entry_ref* ref);
	status_t ReplaceRef(const char* name, int32 index, const entry_ref* ref);
	status_t ReplaceNodeRef(const char* name, const node_ref* ref);
	status_t ReplaceNodeRef(const char* name, int32 index, const node_ref* ref);
	status_t ReplaceMessage(const char* name, const BMessage* message);
	status_t ReplaceMessage(const char* name, int32 index, const BMessage* message);
	status_t ReplaceFlat(const char* name, BFlattenable* object);
	status_t ReplaceFlat(const char* name, int32 index, BFlattenable* object);
	status_t ReplaceData(const char* name, type_code type, const void* data, ssize_t numBytes);
	status_t ReplaceData(
		const char* name, type_code type, int32 index, const void* data, ssize_t numBytes);

	// Asking
	bool HasRect(const char* name, int32 index = 0) const;
	bool HasPoint(const char* name, int32 index = 0) const;
	bool HasInt8(const char* name, int32 index = 0) const;
	bool HasUInt8(const char* name, int32 index = 0) const;
	bool HasInt16(const char* name, int32 index = 0) const;
	bool HasUInt16(const char* name, int32 index = 0) const;
	bool HasInt32(const char* name, int32 index = 0) const;
	bool HasUInt32(const char* name, int32 index = 0) const;
	bool HasInt64(const char* name, int32 index = 0) const;
	bool HasUInt64(const char* name, int32 index = 0) const;
	bool HasBool(const char* name, int32 index = 0) const;
	bool HasFloat(const char* name, int32 index = 0) const;
	bool HasDouble(const char* name, int32 index = 0) const;
	bool HasColor(const char* name, int32 index = 0) const;
	bool HasString(const char* name, int32 index = 0) const;
	bool HasPointer(const char* name, int32 index = 0) const;
	bool HasMessenger(const char* name, int32 index = 0) const;
	bool HasRef(const char* name, int32 index = 0) const;
	bool HasNodeRef(const char* name, int32 index = 0) const;
	bool HasMessage(const char* name, int32 index = 0) const;
	bool HasFlat(const char* name, const BFlattenable* object) const;
	bool HasFlat(const char* name, int32 index, const BFlattenable* object) const;
	bool HasData(const char* name, type_code type, int32 index = 0) const;
	// The same fields, types and bytes, whatever the code; nested messages by value when deep.
	bool HasSameData(const BMessage& other, bool ignoreFieldOrder = true, bool deep = false) const;

	// Old style: the value itself, a default on any error
	BRect FindRect(const char* name, int32 index = 0) const;
	BPoint FindPoint(const char* name, int32 index = 0) const;
	const char* FindString(const char* name, int32 index = 0) const;
	int8 FindInt8(const char* name, int32 index = 0) const;
	int16 FindInt16(const char* name, int32 index = 0) const;
	int32 FindInt32(const char* name, int32 index = 0) const;
	int64 FindInt64(const char* name, int32 index = 0) const;
	bool FindBool(const char* name, int32 index = 0) const;
	float FindFloat(const char* name, int32 index = 0) const;
	double FindDouble(const char* name, int32 index = 0) const;

	// Later conveniences: the value or the given default; replacing the first item, or adding it
	BRect GetRect(const char* name, const BRect& defaultValue) const;
	BRect GetRect(const char* name, int32 index, const BRect& defaultValue) const;
	BPoint GetPoint(const char* name, const BPoint& defaultValue) const;
	BPoint GetPoint(const char* name, int32 index, const BPoint& defaultValue) const;
	int8 GetInt8(const char* name, int8 defaultValue) const;
	int8 GetInt8(const char* name, int32 index, int8 defaultValue) const;
	uint8 GetUInt8(const char* name, uint8 defaultValue) const;
	uint8 GetUInt8(const char* name, int32 index, uint8 defaultValue) const;
	int16 GetInt16(const char* name, int16 defaultValue) const;
	int16 GetInt16(const char* name, int32 index, int16 defaultValue) const;
	uint16 GetUInt16(const char* name, uint16 defaultValue) const;
	uint16 GetUInt16(const char* name, int32 index, uint16 defaultValue) const;
	int32 GetInt32(const char* name, int32 defaultValue) const;
	int32 GetInt32(const char* name, int32 index, int32 defaultValue) const;
	uint32 GetUInt32(const char* name, uint32 defaultValue) const;
	uint32 GetUInt32(const char* name, int32 index, uint32 defaultValue) const;
	int64 GetInt64(const char* name, int64 defaultValue) const;
	int64 GetInt64(const char* name, int32 index, int64 defaultValue) const;
	uint64 GetUInt64(const char* name, uint64 defaultValue) const;
	uint64 GetUInt64(const char* name, int32 index, uint64 defaultValue) const;
	bool GetBool(const char* name, bool defaultValue) const;
	bool GetBool(const char* name, int32 index, bool defaultValue) const;
	float GetFloat(const char* name, float defaultValue) const;
	float GetFloat(const char* name, int32 index, float defaultValue) const;
	double GetDouble(const char* name, double defaultValue) const;
	double GetDouble(const char* name, int32 index, double defaultValue) const;
	rgb_color GetColor(const char* name, rgb_color defaultValue) const;
	rgb_color GetColor(const char* name, int32 index, rgb_color defaultValue) const;
	const char* GetString(const char* name, const char* defaultValue = NULL) const;
	const char* GetString(const char* name, int32 index, const char* defaultValue) const;
	void* GetPointer(const char* name, int32 index, const void* defaultValue) const;
	void* GetPointer(const char* name, const void* defaultValue = NULL) const;
	status_t SetRect(const char* name, const BRect& value);
	status_t SetPoint(const char* name, const BPoint& value);
	status_t SetInt8(const char* name, int8 value);
	status_t SetUInt8(const char* name, uint8 value);
	status_t SetInt16(const char* name, int16 value);
	status_t SetUInt16(const char* name, uint16 value);
	status_t SetInt32(const char* name, int32 value);
	status_t SetUInt32(const char* name, uint32 value);
	status_t SetInt64(const char* name, int64 value);
	status_t SetUInt64(const char* name, uint64 value);
	status_t SetBool(const char* name, bool value);
	status_t SetFloat(const char* name, float value);
	status_t SetDouble(const char* name, double value);
	status_t SetColor(const char* name, rgb_color value);
	status_t SetString(const char* name, const char* string);
	status_t SetString(const char* name, const BString& string);
	status_t SetPointer(const char* name, const void* value);
	status_t SetData(const char* name, type_code type, const void* data, ssize_t numBytes,
		bool fixedSize = true, int32 count = 1);

private:
	friend class BPrivate::MessagePrivate;

	int32 _Find(const char* name) const;
	status_t _FindItem(const char* name, type_code type, int32 index, uint32* _number) const;
	status_t _FindFixed(
		const char* name, type_code type, int32 index, void* value, size_t size) const;
	BPrivate::MessageData* _Own(); // ours alone, made when there is none; NULL without memory
	static BPrivate::MessageData* _Nested(const BMessage& message);
	status_t _AddNested(const char* name, BPrivate::MessageData* nested);
	status_t _AppendItem(
		const BPrivate::MessageData& from, uint32 number, uint32 index, const char* name);
	bool _SameField(uint32 number, const BPrivate::MessageData& other, uint32 otherNumber,
		bool ignoreFieldOrder, bool deep) const;
	int8 _SameMessages(uint32 number, const BPrivate::MessageData& other, uint32 otherNumber,
		uint32 index, bool ignoreFieldOrder) const;
	status_t _ReadRest(BDataIO* stream, const uint8* header, size_t have, size_t size);
	void _Clear();
	void _Release();

	BPrivate::MessageData* fData = nullptr; // shared; NULL when there are no fields
	BPrivate::DeliveryState* fDelivery = nullptr; // owned
	BPrivate::LookUps* fLookUps = nullptr; // shared; see ArchiveSource
	BPrivate::WriteBack* fWriteBack = nullptr; // owned; while an archive is written again
	int32 fCurrentSpecifier = -1;
};
