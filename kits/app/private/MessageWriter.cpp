#include "app/private/MessageWriter.h"

#include <TypeConstants.h>

#include "app/private/MessageReader.h"

namespace BPrivate {

namespace {

constexpr size_t kLargestMessage = 0x7fffffff;


void
write_uint16(uint8* to, uint16 value)
{
	memcpy(to, &value, sizeof(value));
}


bool
holds_messages(const MessageField& field)
{
	return field.type == B_MESSAGE_TYPE && !field.Has(MessageField::kFixed);
}

} // namespace


// #pragma mark - the parts of the R5 form


uint8*
write_r5_header(uint8* to, size_t size, uint32 what)
{
	write_uint32(to, kR5Magic);
	write_uint32(to + 8, uint32(size));
	write_uint32(to + 12, what);
	to[16] = kR5Valid;
	// The sum takes groups of four bytes as big-endian numbers, then the one byte that is left.
	const uint32 sum = __builtin_bswap32(uint32(size)) + __builtin_bswap32(what) + kR5Valid;
	write_uint32(to + 4, sum);
	return to + kR5HeaderSize;
}


uint8*
write_r5_field_head(uint8* to, const MessageField& field, size_t size, message_form form)
{
	const bool mini = form == B_R5_FORM && field.count <= 255 && size <= 255;
	*to++ = kR5Valid | (mini ? kR5Mini : 0) | (field.Has(MessageField::kFixed) ? kR5Fixed : 0)
		| (field.count == 1 ? kR5Single : 0);
	write_uint32(to, field.type);
	to += 4;
	if (mini) {
		if (field.count != 1)
			*to++ = uint8(field.count);
		*to++ = uint8(size);
	} else {
		if (field.count != 1) {
			write_uint32(to, field.count);
			to += 4;
		}
		write_uint32(to, uint32(size));
		to += 4;
	}
	*to++ = uint8(min_c(field.nameLength, 255));
	return to;
}


// Longer names than the form can hold are cut.
uint8*
write_r5_field_header(
	uint8* to, const MessageData& data, const MessageField& field, size_t size, message_form form)
{
	to = write_r5_field_head(to, field, size, form);
	const size_t length = min_c(field.nameLength, 255);
	if (length > 0)
		memcpy(to, data.NameBytes(field), length);
	return to + length;
}


uint8*
write_padded_item(uint8* to, const uint8* item)
{
	const size_t size = read_uint32(item);
	const size_t padded = padded_item_size(size);
	memcpy(to, item, size + 4);
	memset(to + 4 + size, 0, padded - 4 - size);
	return to + padded;
}


uint8*
write_plain_item(uint8* to, const MessageData& nested)
{
	const size_t size = nested.FlatSize();
	const size_t padded = padded_item_size(size);
	write_uint32(to, uint32(size));
	nested.WritePlain(nested.What(), to + 4);
	memset(to + 4 + size, 0, padded - 4 - size);
	return to + padded;
}


size_t
padded_field_size(const MessageData& data, const MessageField& field)
{
	if (!field.Has(MessageField::kPacked))
		return field.size;
	size_t size = 0;
	for (uint32 i = 0; i < field.count; i++)
		size += padded_item_size(read_uint32(data.BytesAt(data.PlaceAt(field, i))));
	return size;
}


bool
stays_as_it_is(const uint8* bytes, size_t size, int32 level)
{
	if (level > B_MAX_MESSAGE_NESTING)
		return true;
	// Bytes that are read and let go again need no owner.
	SharedBytes* loan = SharedBytes::Adopt(bytes, size, nullptr, nullptr);
	if (loan == nullptr)
		return true;
	MessageReader reader(loan, bytes, size, level);
	MessageData* data = reader.Read();
	if (data == nullptr)
		return true;

	bool stays = read_uint32(bytes) == kR5Magic;
	for (uint32 i = 0; i < data->CountFields() && stays; i++)
		stays = data->FieldAt(i).Has(MessageField::kCompact);
	stays = stays && data->IsPlain();
	data->Release();
	return stays;
}


SharedBytes*
flatten_to_bytes(const MessageData& data, uint32 what)
{
	MessageWriter writer(&data, what, B_R5_FORM);
	if (writer.Size() < 0)
		return nullptr;
	SharedBytes* bytes = SharedBytes::Create(size_t(writer.Size()));
	if (bytes != nullptr)
		writer.Write(bytes->Bytes());
	return bytes;
}


uint32
haiku_name_hash(const char* name, size_t length)
{
	uint32 hash = 0;
	for (size_t i = 0; i < length; i++) {
		const auto byte = uint32(int32(static_cast<signed char>(name[i])));
		hash = (hash << 7 ^ hash >> 24) ^ byte;
	}
	return hash ^ hash << 12;
}


// #pragma mark - measuring


MessageWriter::MessageWriter(const MessageData* data, uint32 what, message_form form) :
	fData(data), fWhat(what), fForm(form)
{
	size_t size;
	if (data == nullptr)
		size = form == B_HAIKU_FORM ? kHaikuHeaderSize : kR5HeaderSize + 1;
	else if (form == B_R5_FORM && data->IsPlain())
		size = data->FlatSize();
	else
		size = _Measure(*data, 0);
	fSize = size <= kLargestMessage ? ssize_t(size) : ssize_t(B_NO_MEMORY);
}


MessageWriter::~MessageWriter()
{
	for (const Nested& nested : fNested) {
		if (nested.data != nullptr)
			nested.data->Release();
	}
}


size_t
MessageWriter::_Measure(const MessageData& data, int32 depth)
{
	return fForm == B_HAIKU_FORM ? _MeasureHaiku(data, depth) : _MeasureR5(data, depth);
}


size_t
MessageWriter::_MeasureR5(const MessageData& data, int32 depth)
{
	if (fForm == B_R5_FORM && data.IsPlain())
		return data.FlatSize();

	size_t size = kR5HeaderSize + 1;
	for (uint32 i = 0; i < data.CountFields(); i++) {
		const MessageField& field = data.FieldAt(i);
		const size_t place = fFieldSizes.size();
		fFieldSizes.push_back(0);
		const size_t bytes = _MeasureItems(data, i, depth);
		fFieldSizes[place] = bytes;
		size += r5_field_header_length(field.count, bytes, fForm) + min_c(field.nameLength, 255)
			+ bytes;
	}
	return size;
}


size_t
MessageWriter::_MeasureHaiku(const MessageData& data, int32 depth)
{
	size_t size = kHaikuHeaderSize;
	for (uint32 i = 0; i < data.CountFields(); i++) {
		const size_t place = fFieldSizes.size();
		fFieldSizes.push_back(0);
		const size_t bytes = _MeasureItems(data, i, depth);
		fFieldSizes[place] = bytes;
		size += kHaikuFieldSize + data.FieldAt(i).nameLength + 1 + bytes;
	}
	return size;
}


size_t
MessageWriter::_MeasureItems(const MessageData& data, uint32 number, int32 depth)
{
	const MessageField& field = data.FieldAt(number);
	if (field.Has(MessageField::kFixed))
		return field.size;
	size_t size = 0;
	for (uint32 i = 0; i < field.count; i++) {
		const size_t bytes = _MeasureItem(data, number, i, depth);
		size += fForm == B_HAIKU_FORM ? bytes + 4 : padded_item_size(bytes);
	}
	return size;
}


size_t
MessageWriter::_MeasureItem(const MessageData& data, uint32 number, uint32 index, int32 depth)
{
	if (!holds_messages(data.FieldAt(number)))
		return data.ItemSizeAt(number, index);

	const size_t place = fNested.size();
	MessageData* nested = _NestedToConvert(data, number, index, depth);
	fNested.push_back({ nested, 0 });
	const size_t size =
		nested != nullptr ? _Measure(*nested, depth + 1) : data.ItemSizeAt(number, index);
	fNested[place].size = size;
	return size;
}


// A reference, or NULL when the bytes of the item are to be taken over.
MessageData*
MessageWriter::_NestedToConvert(
	const MessageData& data, uint32 number, uint32 index, int32 depth) const
{
	if (MessageData* nested = data.MessageAt(number, index)) {
		nested->Acquire();
		return nested;
	}
	if (depth >= B_MAX_MESSAGE_NESTING)
		return nullptr;
	const uint8* bytes = data.BytesAt(data.PlaceAt(data.FieldAt(number), index));
	if (fForm == B_R5_FORM && stays_as_it_is(bytes + 4, read_uint32(bytes), depth + 1))
		return nullptr;
	return data.GetMessage(number, index);
}


// #pragma mark - writing


void
MessageWriter::Write(uint8* to)
{
	fNextNested = 0;
	fNextField = 0;
	if (fData != nullptr) {
		_Write(*fData, fWhat, size_t(fSize), to);
		return;
	}
	MessageData* empty = MessageData::Create();
	if (empty == nullptr)
		return;
	_Write(*empty, fWhat, size_t(fSize), to);
	empty->Release();
}


uint8*
MessageWriter::_Write(const MessageData& data, uint32 what, size_t size, uint8* to)
{
	return fForm == B_HAIKU_FORM ? _WriteHaiku(data, what, size, to)
								 : _WriteR5(data, what, size, to);
}


uint8*
MessageWriter::_WriteR5(const MessageData& data, uint32 what, size_t size, uint8* to)
{
	if (fForm == B_R5_FORM && data.IsPlain())
		return data.WritePlain(what, to);

	to = write_r5_header(to, size, what);
	for (uint32 i = 0; i < data.CountFields(); i++) {
		to = write_r5_field_header(to, data, data.FieldAt(i), fFieldSizes[fNextField++], fForm);
		to = _WriteItems(data, i, to);
	}
	*to++ = 0;
	return to;
}


uint8*
MessageWriter::_WriteHaiku(const MessageData& data, uint32 what, size_t size, uint8* to)
{
	const uint32 count = data.CountFields();
	uint8* header = _WriteHaikuHeader(data, what, size, to);
	uint8* const area = header + count * kHaikuFieldSize;
	uint8* at = area;
	for (uint32 i = 0; i < count; i++, header += kHaikuFieldSize) {
		const MessageField& field = data.FieldAt(i);
		write_uint16(header, field.Has(MessageField::kFixed) ? 3 : 1);
		write_uint16(header + 2, uint16(field.nameLength + 1));
		write_uint32(header + 4, field.type);
		write_uint32(header + 8, field.count);
		write_uint32(header + 12, uint32(fFieldSizes[fNextField++]));
		write_uint32(header + 16, uint32(at - area));
		if (field.nameLength > 0)
			memcpy(at, data.NameBytes(field), field.nameLength);
		at[field.nameLength] = 0;
		at = _WriteItems(data, i, at + field.nameLength + 1);
	}
	return at;
}


// The header with its hash chains; the links of the fields are written along with it.
uint8*
MessageWriter::_WriteHaikuHeader(const MessageData& data, uint32 what, size_t size, uint8* to) const
{
	const uint32 count = data.CountFields();
	memset(to, 0xff, kHaikuHeaderSize);
	write_uint32(to, kHaikuMagic);
	write_uint32(to + 4, what);
	write_uint32(to + 8, 1);
	write_uint32(to + 36, uint32(size - kHaikuHeaderSize - count * kHaikuFieldSize));
	write_uint32(to + 40, count);
	write_uint32(to + 44, kHaikuHashSize);

	uint8* const fields = to + kHaikuHeaderSize;
	uint8* ends[kHaikuHashSize]; // where the next link of each chain goes
	for (uint32 slot = 0; slot < kHaikuHashSize; slot++)
		ends[slot] = to + 48 + slot * 4;
	for (uint32 i = 0; i < count; i++) {
		const MessageField& field = data.FieldAt(i);
		const uint32 slot =
			haiku_name_hash(data.NameBytes(field), field.nameLength) % kHaikuHashSize;
		write_uint32(ends[slot], i);
		ends[slot] = fields + i * kHaikuFieldSize + 20;
		write_uint32(ends[slot], 0xffffffff);
	}
	return fields;
}


uint8*
MessageWriter::_WriteItems(const MessageData& data, uint32 number, uint8* to)
{
	const MessageField& field = data.FieldAt(number);
	if (field.Has(MessageField::kFixed)) {
		const uint8* items = data.Base(field) + field.data;
		return append_bytes(to, items, items + field.size);
	}

	const bool packed = fForm == B_HAIKU_FORM;
	for (uint32 i = 0; i < field.count; i++) {
		const ItemPlace place = data.PlaceAt(field, i);
		const Nested nested =
			holds_messages(field) ? fNested[fNextNested++] : Nested { nullptr, 0 };
		if (nested.data != nullptr) {
			write_uint32(to, uint32(nested.size));
			uint8* end = _Write(*nested.data, nested.data->What(), nested.size, to + 4);
			const size_t padding = packed ? 0 : padded_item_size(nested.size) - 4 - nested.size;
			memset(end, 0, padding);
			to = end + padding;
		} else if (packed) {
			const uint8* item = data.BytesAt(place);
			to = append_bytes(to, item, item + 4 + read_uint32(item));
		} else
			to = write_padded_item(to, data.BytesAt(place));
	}
	return to;
}


} // namespace BPrivate
