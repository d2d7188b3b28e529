// MessageData: its fields by their names.

#include <cstdlib>

#include <sys/random.h>

#include "app/private/MessageData.h"

namespace BPrivate {

namespace {

// Differs from run to run, so that nobody can prepare a file of names that all collide.
uint64
make_seed()
{
	uint64 seed;
	if (getrandom(&seed, sizeof(seed), GRND_NONBLOCK) != sizeof(seed))
		seed = reinterpret_cast<uint64>(&seed);
	return seed | 1;
}


const uint64 sSeed = make_seed();


uint64
mix(uint64 a, uint64 b)
{
	const auto product = static_cast<unsigned __int128>(a) * b;
	return uint64(product) ^ uint64(product >> 64);
}


uint32
hash_name(const char* name, size_t length)
{
	uint64 hash = sSeed ^ length;
	while (length > 8) {
		uint64 word;
		memcpy(&word, name, 8);
		hash = mix(hash ^ word, 0x9e3779b97f4a7c15ull);
		name += 8;
		length -= 8;
	}
	uint64 word = 0;
	if (length > 0)
		memcpy(&word, name, length);
	hash = mix(hash ^ word, sSeed ^ 0xe7037ed1a0b428dbull);
	return uint32(hash ^ hash >> 32);
}


// Whether that many fields find their places in the index quickly. A message of thousands of tiny
// fields should take no more memory than they are worth.
bool
is_roomy(uint32 slots, uint32 fields)
{
	return uint64(slots) * 2 >= uint64(fields) * 3;
}

} // namespace


int32
MessageData::Find(const char* name) const
{
	return Find(name, strlen(name));
}


int32
MessageData::Find(const char* name, size_t length) const
{
	const uint32 key = name_key(name, length);
	if ((fNameBits & name_bit(key)) == 0)
		return -1;
	if (fIndex == nullptr) {
		for (uint32 i = 0; i < fCount; i++) {
			if (_IsNamed(fFields[i], name, length, key))
				return int32(i);
		}
		return -1;
	}

	uint32 slot = hash_name(name, length) & fIndexMask;
	for (; fIndex[slot] != 0; slot = (slot + 1) & fIndexMask) {
		if (_IsNamed(fFields[fIndex[slot] - 1], name, length, key))
			return int32(fIndex[slot] - 1);
	}
	return -1;
}


const char*
MessageData::NameBytes(const MessageField& field) const
{
	const uint8* base = field.Has(MessageField::kNameInSource) ? fSourceBase : fStore;
	return reinterpret_cast<const char*>(base + field.name);
}


// All names are copied at the first question, since in the bytes they have no NUL.
const char*
MessageData::NameAt(uint32 index) const
{
	char* names = fNames.load(std::memory_order_acquire);
	if (names == nullptr) {
		size_t size = fCount * sizeof(uint32);
		for (uint32 i = 0; i < fCount; i++)
			size += fFields[i].nameLength + size_t(1);
		char* made = static_cast<char*>(malloc(size));
		if (made == nullptr)
			return nullptr;
		size_t offset = fCount * sizeof(uint32);
		for (uint32 i = 0; i < fCount; i++) {
			write_uint32(made + i * sizeof(uint32), uint32(offset));
			if (fFields[i].nameLength > 0)
				memcpy(made + offset, NameBytes(fFields[i]), fFields[i].nameLength);
			made[offset + fFields[i].nameLength] = '\0';
			offset += fFields[i].nameLength + size_t(1);
		}
		fHasDerived.store(true, std::memory_order_relaxed);
		if (fNames.compare_exchange_strong(names, made, std::memory_order_acq_rel))
			names = made;
		else
			free(made); // another thread was first
	}
	return names + read_uint32(names + index * sizeof(uint32));
}


// #pragma mark - private


// Enters a field, which is already counted, into the index; that is made when there are many.
void
MessageData::_AddToIndex(uint32 number)
{
	fNameBits |= name_bit(fFields[number].key);
	if (fIndex == nullptr && number < kFewFields)
		return;
	if (fIndex == nullptr || !is_roomy(fIndexMask + 1, number + 1)) {
		// Without memory for an index the look-up becomes a walk.
		_BuildIndex();
		return;
	}

	const MessageField& field = fFields[number];
	const char* name = NameBytes(field);
	uint32 slot = hash_name(name, field.nameLength) & fIndexMask;
	while (fIndex[slot] != 0) {
		// Of two fields of one name the first is found; the other needs no entry.
		if (_IsNamed(fFields[fIndex[slot] - 1], name, field.nameLength, field.key))
			return;
		slot = (slot + 1) & fIndexMask;
	}
	fIndex[slot] = number + 1;
}


bool
MessageData::_BuildIndex()
{
	uint32 slots = 64;
	while (!is_roomy(slots, fCount))
		slots *= 2;
	free(fIndex);
	fIndex = static_cast<uint32*>(calloc(slots, sizeof(uint32)));
	if (fIndex == nullptr)
		return false;
	fIndexMask = slots - 1;
	for (uint32 i = 0; i < fCount; i++)
		_AddToIndex(i);
	return true;
}


} // namespace BPrivate
