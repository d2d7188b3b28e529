#include <cstring>
#include <string_view>

#include <View.h>

#include "app/private/MessageData.h"
#include "app/private/MessagePrivate.h"
#include "app/private/TwinFields.h"
#include "app/private/WriteBack.h"
#include "interface/private/ViewArchive.h"
#include "support/private/ManagedArchive.h"

namespace BPrivate {

namespace {

// The archive's field, which none of its twins in the source is.
int32
find_own(const MessageData& archive, const char* name)
{
	return WriteBack::Find(archive, name, std::strlen(name));
}


bool
same_string(const char* a, const char* b)
{
	if (a == nullptr || b == nullptr)
		return a == b;
	return std::strcmp(a, b) == 0;
}

// The private classes' names came into a name space at some time; both are meant.
bool
same_class(const char* a, const char* b)
{
	constexpr std::string_view kSpace = "BPrivate::";
	if (a == nullptr || b == nullptr)
		return a == b;
	std::string_view first(a);
	std::string_view second(b);
	for (std::string_view* name : { &first, &second }) {
		if (name->starts_with(kSpace) && name->substr(kSpace.size()).starts_with('_'))
			name->remove_prefix(kSpace.size());
	}
	return first == second;
}

} // namespace


void
begin_archive(const ArchiveSource* source, BMessage* archive)
{
	if (source == nullptr || !source->IsSet() || archive == nullptr)
		return;
	const BMessage read = source->Archive();
	if (archive->what == 0)
		archive->what = read.what;
	copy_managed_note(read, archive);
	MessagePrivate access(archive);
	MessageData* data = source->Data();
	MessageData* own = access.OwnData();
	if (data == nullptr || own == nullptr)
		return;

	auto writeBack = std::make_unique<WriteBack>(data);
	for (uint32 i = 0; i < data->CountFields(); i++) {
		if (source->IsKnownField(i))
			continue;
		const MessageField& field = data->FieldAt(i);
		if (is_twin(*data, i))
			writeBack->RestoreTwin(*own, i);
		else if (WriteBack::Find(*own, data->NameBytes(field), field.nameLength) < 0)
			writeBack->Restore(*own, i, true);
	}
	access.SetWriteBack(std::move(writeBack));
}


bool
is_as_read(const BMessage& archive)
{
	const MessagePrivate access(&archive);
	const WriteBack* writeBack = access.GetWriteBack();
	return writeBack != nullptr && access.Data() != nullptr
		&& writeBack->IsUnchanged(*access.Data());
}


// #pragma mark - ArchiveWriter


ArchiveWriter::ArchiveWriter(BMessage* archive) : fArchive(archive), fHasSource(false)
{
	if (const WriteBack* writeBack = MessagePrivate(archive).GetWriteBack()) {
		fHasSource = true;
		MessagePrivate(&fSource).SetData(writeBack->Source());
	}
}


bool
ArchiveWriter::Keep(const char* name, bool unchanged)
{
	if (!fHasSource || fStatus != B_OK)
		return fStatus != B_OK;
	MessagePrivate access(fArchive);
	WriteBack* writeBack = access.GetWriteBack();
	MessageData* own = access.OwnData();
	if (own == nullptr) {
		_Note(B_NO_MEMORY);
		return true;
	}
	const int32 present = find_own(*own, name);
	if (!unchanged) {
		// It was known after all, so it is not carried along.
		if (present >= 0 && own->FieldAt(present).Has(MessageField::kCarried))
			own->RemoveField(present);
		return false;
	}
	const int32 read = writeBack->Source()->Find(name);
	if (read >= 0)
		_Note(writeBack->Restore(*own, read, false));
	else if (present >= 0)
		own->RemoveField(present);
	return true;
}


void
ArchiveWriter::KeepClass(bool always)
{
	if (!fHasSource)
		return;
	MessagePrivate access(fArchive);
	const char* written = nullptr;
	const char* read = nullptr;
	fArchive->FindString("class", &written);
	fSource.FindString("class", &read);
	const bool same = same_class(written, read);
	if (!Keep("class", always || same) || always)
		return;
	// Further names are carried along until somebody adds names of his own.
	const int32 field = access.GetWriteBack()->Source()->Find("class");
	const int32 own = find_own(*access.OwnData(), "class");
	if (field >= 0 && own >= 0) {
		access.GetWriteBack()->SetFirstItemOwn(field);
		access.OwnData()->SetCarried(own, true);
	}
}


void
ArchiveWriter::KeepName(const char* name)
{
	const char* read = nullptr;
	fSource.FindString("_name", &read);
	Keep("_name", same_string(read, name));
}


void
ArchiveWriter::_Note(status_t status)
{
	if (fStatus == B_OK)
		fStatus = status;
}


template<typename Value, typename Find, typename Add>
void
ArchiveWriter::_Write(const char* name, std::span<const Value> values,
	std::span<const Value> absent, bool wanted, Find find, Add add)
{
	bool unchanged = fHasSource;
	for (size_t i = 0; unchanged && i < values.size(); i++) {
		Value read;
		if ((fSource.*find)(name, static_cast<int32>(i), &read) != B_OK)
			read = absent[i];
		unchanged = same_value(read, values[i]);
	}
	if (Keep(name, unchanged) || !wanted)
		return;
	for (const Value& value : values)
		_Note((fArchive->*add)(name, value));
}


void
ArchiveWriter::Bool(const char* name, bool value, bool absent, bool wanted)
{
	status_t (BMessage::*find)(const char*, int32, bool*) const = &BMessage::FindBool;
	_Write<bool>(name, { &value, 1 }, { &absent, 1 }, wanted, find, &BMessage::AddBool);
}


void
ArchiveWriter::Int8(const char* name, int8 value, int8 absent, bool wanted)
{
	status_t (BMessage::*find)(const char*, int32, int8*) const = &BMessage::FindInt8;
	_Write<int8>(name, { &value, 1 }, { &absent, 1 }, wanted, find, &BMessage::AddInt8);
}


void
ArchiveWriter::Int16(const char* name, int16 value, int16 absent, bool wanted)
{
	Int16s(name, { &value, 1 }, { &absent, 1 }, wanted);
}


void
ArchiveWriter::Int32(const char* name, int32 value, int32 absent, bool wanted)
{
	Int32s(name, { &value, 1 }, { &absent, 1 }, wanted);
}


void
ArchiveWriter::Int64(const char* name, int64 value, int64 absent, bool wanted)
{
	status_t (BMessage::*find)(const char*, int32, int64*) const = &BMessage::FindInt64;
	_Write<int64>(name, { &value, 1 }, { &absent, 1 }, wanted, find, &BMessage::AddInt64);
}


void
ArchiveWriter::Float(const char* name, float value, float absent, bool wanted)
{
	Floats(name, { &value, 1 }, { &absent, 1 }, wanted);
}


void
ArchiveWriter::Point(const char* name, BPoint value, BPoint absent, bool wanted)
{
	status_t (BMessage::*find)(const char*, int32, BPoint*) const = &BMessage::FindPoint;
	_Write<BPoint>(name, { &value, 1 }, { &absent, 1 }, wanted, find, &BMessage::AddPoint);
}


void
ArchiveWriter::Rect(const char* name, BRect value, BRect absent, bool wanted)
{
	status_t (BMessage::*find)(const char*, int32, BRect*) const = &BMessage::FindRect;
	_Write<BRect>(name, { &value, 1 }, { &absent, 1 }, wanted, find, &BMessage::AddRect);
}


void
ArchiveWriter::Int16s(
	const char* name, std::span<const int16> values, std::span<const int16> absent, bool wanted)
{
	status_t (BMessage::*find)(const char*, int32, int16*) const = &BMessage::FindInt16;
	_Write(name, values, absent, wanted, find, &BMessage::AddInt16);
}


void
ArchiveWriter::Int32s(
	const char* name, std::span<const int32> values, std::span<const int32> absent, bool wanted)
{
	status_t (BMessage::*find)(const char*, int32, int32*) const = &BMessage::FindInt32;
	_Write(name, values, absent, wanted, find, &BMessage::AddInt32);
}


void
ArchiveWriter::Floats(
	const char* name, std::span<const float> values, std::span<const float> absent, bool wanted)
{
	status_t (BMessage::*find)(const char*, int32, float*) const = &BMessage::FindFloat;
	_Write(name, values, absent, wanted, find, &BMessage::AddFloat);
}


void
ArchiveWriter::String(const char* name, const char* value, const char* absent, bool wanted)
{
	const char* read;
	if (!fHasSource || fSource.FindString(name, &read) != B_OK)
		read = absent;
	if (Keep(name, same_string(read, value)) || !wanted || value == nullptr)
		return;
	_Note(fArchive->AddString(name, value));
}


void
ArchiveWriter::Message(const char* name, const BMessage* value, bool wanted)
{
	BMessage read;
	const bool had = fHasSource && fSource.FindMessage(name, &read) == B_OK;
	bool unchanged = had == (value != nullptr);
	if (unchanged && had) {
		unchanged = read.what == value->what
			&& (MessagePrivate(&read).SharesDataWith(*value)
				|| read.HasSameData(*value, false, true));
	}
	if (Keep(name, unchanged) || !wanted || value == nullptr)
		return;
	_Note(fArchive->AddMessage(name, value));
}


void
ArchiveWriter::Data(const char* name, type_code type, const void* bytes, ssize_t size, bool wanted)
{
	const void* read;
	ssize_t readSize;
	const bool unchanged = fHasSource && fSource.FindData(name, type, &read, &readSize) == B_OK
		&& readSize == size && std::memcmp(read, bytes, size) == 0;
	if (Keep(name, unchanged) || !wanted)
		return;
	_Note(fArchive->AddData(name, type, bytes, size));
}


} // namespace BPrivate
