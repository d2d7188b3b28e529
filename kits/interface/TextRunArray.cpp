// BTextView: arrays of runs, in memory and as bytes.
#include "TextView.h"

#include <algorithm>
#include <cstdlib>
#include <cstring>
#include <new>

#include <ByteOrder.h>

#include "interface/private/TextViewPrivate.h"

using namespace BPrivate;

namespace {

constexpr uint32 kMagic = 'Ali!';
constexpr size_t kHeaderSize = 12;
constexpr size_t kRunSize = 148;
constexpr size_t kNameSize = 64;
constexpr size_t kStyleName = 4 + kNameSize;
constexpr size_t kSizeField = kStyleName + kNameSize;
constexpr size_t kShearField = kSizeField + 4;
constexpr size_t kFaceField = kShearField + 4;
constexpr size_t kColorField = kFaceField + 2;


// All numbers are big-endian, and stand anywhere.
void
put32(uint8* at, uint32 value)
{
	value = B_HOST_TO_BENDIAN_INT32(value);
	memcpy(at, &value, sizeof(value));
}


uint32
get32(const uint8* at)
{
	uint32 value;
	memcpy(&value, at, sizeof(value));
	return B_BENDIAN_TO_HOST_INT32(value);
}


void
put_float(uint8* at, float value)
{
	uint32 bits;
	memcpy(&bits, &value, sizeof(bits));
	put32(at, bits);
}


float
get_float(const uint8* at)
{
	const uint32 bits = get32(at);
	float value;
	memcpy(&value, &bits, sizeof(value));
	return value;
}


void
flatten_run(const text_run& run, uint8* at)
{
	put32(at, run.offset);
	font_family family;
	font_style style;
	run.font.GetFamilyAndStyle(&family, &style);
	strncpy(reinterpret_cast<char*>(at + 4), family, kNameSize - 1);
	strncpy(reinterpret_cast<char*>(at + kStyleName), style, kNameSize - 1);
	put_float(at + kSizeField, run.font.Size());
	put_float(at + kShearField, run.font.Shear());
	const uint16 face = B_HOST_TO_BENDIAN_INT16(run.font.Face());
	memcpy(at + kFaceField, &face, sizeof(face));
	at[kColorField] = run.color.red;
	at[kColorField + 1] = run.color.green;
	at[kColorField + 2] = run.color.blue;
	at[kColorField + 3] = 255;
}


// An unknown family leaves the plain font; a known one with an unknown style takes its first.
text_run
unflatten_run(const uint8* at)
{
	text_run run;
	run.offset = static_cast<int32>(get32(at));
	char family[kNameSize + 1] = {};
	char style[kNameSize + 1] = {};
	memcpy(family, at + 4, kNameSize);
	memcpy(style, at + kStyleName, kNameSize);
	font_family familyName = {};
	font_style styleName = {};
	strncpy(familyName, family, sizeof(familyName) - 1);
	strncpy(styleName, style, sizeof(styleName) - 1);
	if (familyName[0] != '\0' && run.font.SetFamilyAndStyle(familyName, styleName) != B_OK)
		run.font.SetFamilyAndStyle(familyName, NULL);

	const float size = get_float(at + kSizeField);
	if (size > 0 && size < 10000)
		run.font.SetSize(size);
	const float shear = get_float(at + kShearField);
	if (shear >= 45 && shear <= 135)
		run.font.SetShear(shear);
	uint16 face;
	memcpy(&face, at + kFaceField, sizeof(face));
	face = B_BENDIAN_TO_HOST_INT16(face);
	// Some writers put this one everywhere.
	if (face != B_REGULAR_FACE)
		run.font.SetFace(face);
	run.color = { at[kColorField], at[kColorField + 1], at[kColorField + 2], at[kColorField + 3] };
	return run;
}

} // namespace


namespace BPrivate {


text_run_array*
unflatten_runs(const void* data, ssize_t size)
{
	const uint8* bytes = static_cast<const uint8*>(data);
	if (bytes == NULL || size < static_cast<ssize_t>(kHeaderSize) || get32(bytes) != kMagic
		|| get32(bytes + 4) != 0)
		return NULL;
	const uint32 count = get32(bytes + 8);
	if (count > (size - kHeaderSize) / kRunSize)
		return NULL;

	text_run_array* array = BTextView::AllocRunArray(static_cast<int32>(count));
	if (array == NULL)
		return NULL;
	for (uint32 i = 0; i < count; i++)
		array->runs[i] = unflatten_run(bytes + kHeaderSize + i * kRunSize);
	return array;
}


} // namespace BPrivate


text_run_array*
BTextView::AllocRunArray(int32 entryCount, int32* _size)
{
	if (entryCount < 0)
		return NULL;
	const size_t size =
		sizeof(text_run_array) + std::max<int32>(0, entryCount - 1) * sizeof(text_run);
	text_run_array* array = static_cast<text_run_array*>(calloc(1, size));
	if (array == NULL)
		return NULL;
	array->count = entryCount;
	for (int32 i = 0; i < std::max<int32>(1, entryCount); i++)
		new (&array->runs[i]) text_run();
	if (_size != NULL)
		*_size = static_cast<int32>(size);
	return array;
}


text_run_array*
BTextView::CopyRunArray(const text_run_array* other, int32 countDelta)
{
	if (other == NULL)
		return NULL;
	text_run_array* copy = AllocRunArray(other->count + countDelta);
	if (copy != NULL)
		std::copy_n(other->runs, std::min(copy->count, other->count), copy->runs);
	return copy;
}


void
BTextView::FreeRunArray(text_run_array* array)
{
	free(array);
}


void*
BTextView::FlattenRunArray(const text_run_array* runs, int32* _size)
{
	if (runs == NULL || runs->count < 0)
		return NULL;
	const size_t size = kHeaderSize + runs->count * kRunSize;
	uint8* bytes = static_cast<uint8*>(calloc(1, size));
	if (bytes == NULL)
		return NULL;
	put32(bytes, kMagic);
	put32(bytes + 8, runs->count);
	for (int32 i = 0; i < runs->count; i++)
		flatten_run(runs->runs[i], bytes + kHeaderSize + i * kRunSize);
	if (_size != NULL)
		*_size = static_cast<int32>(size);
	return bytes;
}


// Trusts the count that the header gives: the caller knows how long the data are.
text_run_array*
BTextView::UnflattenRunArray(const void* data, int32* _size)
{
	const uint8* bytes = static_cast<const uint8*>(data);
	if (bytes == NULL || get32(bytes) != kMagic || get32(bytes + 4) != 0)
		return NULL;
	const uint32 count = get32(bytes + 8);
	if (count > INT32_MAX / kRunSize)
		return NULL;
	text_run_array* array = unflatten_runs(data, kHeaderSize + count * kRunSize);
	if (array != NULL && _size != NULL) {
		*_size = static_cast<int32>(
			sizeof(text_run_array) + std::max<int32>(0, array->count - 1) * sizeof(text_run));
	}
	return array;
}
