// The bytes of a BPropertyInfo, and the lists that are read from them.
#pragma once

#include <deque>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include <PropertyInfo.h>

namespace BPrivate {

// Each list ends with an entry without a name.
struct PropertyTables {
	std::deque<std::string> texts; // what the lists' pointers lead to
	std::vector<property_info> properties;
	std::vector<value_info> values;
};

// Either list may be NULL.
std::string FlattenProperties(const property_info* properties, const value_info* values);

// NULL when the bytes end early or are nonsense. They need not be trusted.
std::unique_ptr<PropertyTables> UnflattenProperties(std::string_view bytes);

} // namespace BPrivate
