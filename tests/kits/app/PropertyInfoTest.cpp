#include <PropertyInfo.h>

#include <gtest/gtest.h>

#include <AppDefs.h>
#include <Message.h>

namespace {

property_info sProperties[] = {
	{ "Frame", { B_GET_PROPERTY, B_SET_PROPERTY }, { B_DIRECT_SPECIFIER }, NULL, 11, {}, {}, {} },
	{ "View", {}, { B_INDEX_SPECIFIER, B_NAME_SPECIFIER }, NULL, 22, {}, {}, {} },
	{},
};

} // namespace


TEST(PropertyInfo, FindsTheEntryOfACommandAndSpecifier)
{
	const BPropertyInfo info(sProperties);
	BMessage get(B_GET_PROPERTY);
	BMessage count(B_COUNT_PROPERTIES);
	uint32 data = 0;

	EXPECT_EQ(2, info.CountProperties());
	EXPECT_EQ(0, info.CountValues());
	EXPECT_EQ(0, info.FindMatch(&get, 0, NULL, B_DIRECT_SPECIFIER, "Frame", &data));
	EXPECT_EQ(11u, data);
	EXPECT_EQ(-1, info.FindMatch(&get, 0, NULL, B_INDEX_SPECIFIER, "Frame"));
	EXPECT_EQ(-1, info.FindMatch(&count, 0, NULL, B_DIRECT_SPECIFIER, "Frame"));
	EXPECT_EQ(1, info.FindMatch(&count, 0, NULL, B_NAME_SPECIFIER, "View"));
	EXPECT_EQ(-1, info.FindMatch(&get, 0, NULL, B_DIRECT_SPECIFIER, "Nothing"));
	EXPECT_EQ(-1, info.FindMatch(&get, 0, NULL, B_DIRECT_SPECIFIER, NULL));
}


TEST(PropertyInfo, ACommandIsForTheLastSpecifierOnly)
{
	const BPropertyInfo info(sProperties);
	BMessage count(B_COUNT_PROPERTIES);

	EXPECT_EQ(0, info.FindMatch(&count, 1, NULL, B_DIRECT_SPECIFIER, "Frame"));
}
