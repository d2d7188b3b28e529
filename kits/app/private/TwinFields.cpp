#include "app/private/TwinFields.h"

#include <algorithm>
#include <string_view>

namespace BPrivate {

namespace {

std::string_view
name_of(const MessageData& data, uint32 number)
{
	const MessageField& field = data.FieldAt(number);
	return std::string_view(data.NameBytes(field), field.nameLength);
}


bool
has_same_names(const MessageData& a, const MessageData& b)
{
	for (uint32 i = 0; i < a.CountFields(); i++) {
		if (a.FieldAt(i).key != b.FieldAt(i).key || name_of(a, i) != name_of(b, i))
			return false;
	}
	return true;
}


// Fields of one name are next to each other and keep their order.
std::vector<uint32>
sorted_by_name(const MessageData& data)
{
	std::vector<uint32> numbers(data.CountFields());
	for (uint32 i = 0; i < numbers.size(); i++)
		numbers[i] = i;
	std::stable_sort(numbers.begin(), numbers.end(),
		[&](uint32 a, uint32 b) { return name_of(data, a) < name_of(data, b); });
	return numbers;
}

} // namespace


bool
is_twin(const MessageData& data, uint32 field)
{
	const std::string_view name = name_of(data, field);
	return data.Find(name.data(), name.size()) != int32(field);
}


int32
next_of_name(const MessageData& data, uint32 field)
{
	for (uint32 i = field + 1; i < data.CountFields(); i++) {
		if (data.FieldAt(i).key == data.FieldAt(field).key
			&& name_of(data, i) == name_of(data, field))
			return int32(i);
	}
	return -1;
}


int32
corresponding_field(const MessageData& data, const MessageData& other, uint32 otherField)
{
	const std::string_view name = name_of(other, otherField);
	int32 found = data.Find(name.data(), name.size());
	int32 passed = other.Find(name.data(), name.size());
	while (found >= 0 && passed != int32(otherField)) {
		found = next_of_name(data, uint32(found));
		passed = next_of_name(other, uint32(passed));
	}
	return found;
}


bool
pair_fields(const MessageData& a, const MessageData& b, std::vector<uint32>* _pairs)
{
	_pairs->clear();
	if (has_same_names(a, b))
		return true;
	const std::vector<uint32> ofA = sorted_by_name(a);
	const std::vector<uint32> ofB = sorted_by_name(b);
	_pairs->resize(ofA.size());
	for (size_t i = 0; i < ofA.size(); i++) {
		if (name_of(a, ofA[i]) != name_of(b, ofB[i]))
			return false;
		(*_pairs)[ofA[i]] = ofB[i];
	}
	return true;
}


} // namespace BPrivate
