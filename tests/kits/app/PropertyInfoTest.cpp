#include <PropertyInfo.h>

#include <string>

#include <gtest/gtest.h>

#include <AppDefs.h>
#include <Handler.h>
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


TEST(PropertyInfo, ComesBackFromItsBytes)
{
	value_info values[] = {
		{ "Blink", 'blnk', B_COMMAND_KIND, "makes it blink", 5, {} },
		{},
	};
	const BPropertyInfo info(sProperties, values);
	BMessage message;
	ASSERT_EQ(B_OK, message.AddFlat("messages", &info));
	type_code type = 0;
	message.GetInfo("messages", &type);
	EXPECT_EQ(uint32(B_PROPERTY_INFO_TYPE), type);

	BPropertyInfo found;
	ASSERT_EQ(B_OK, message.FindFlat("messages", &found));
	ASSERT_EQ(2, found.CountProperties());
	ASSERT_EQ(1, found.CountValues());
	EXPECT_STREQ("View", found.Properties()[1].name);
	EXPECT_EQ(nullptr, found.Properties()[1].usage);
	EXPECT_EQ(uint32(B_SET_PROPERTY), found.Properties()[0].commands[1]);
	EXPECT_EQ(uint32(B_NAME_SPECIFIER), found.Properties()[1].specifiers[1]);
	EXPECT_STREQ("Blink", found.Values()[0].name);
	EXPECT_STREQ("makes it blink", found.Values()[0].usage);
	EXPECT_EQ(uint32('blnk'), found.Values()[0].value);
	EXPECT_EQ(B_BAD_TYPE, found.Unflatten(B_RAW_TYPE, "", 0));
}


TEST(PropertyInfo, BytesThatEndEarlyAreRefused)
{
	const BPropertyInfo info(sProperties);
	std::string bytes(info.FlattenedSize(), '\0');
	EXPECT_EQ(B_BUFFER_OVERFLOW, info.Flatten(bytes.data(), 3));
	ASSERT_EQ(B_OK, info.Flatten(bytes.data(), bytes.size()));
	BPropertyInfo found;
	for (size_t length = 0; length < bytes.size(); length++) {
		const std::string part(bytes.data(), length); // ends where it ends, for the sanitizer
		EXPECT_EQ(B_BAD_DATA, found.Unflatten(B_PROPERTY_INFO_TYPE, part.data(), length));
		EXPECT_EQ(0, found.CountProperties());
	}
	EXPECT_EQ(B_OK, found.Unflatten(B_PROPERTY_INFO_TYPE, bytes.data(), bytes.size()));
	EXPECT_EQ(2, found.CountProperties());
}


TEST(PropertyInfo, IsPartOfTheSupportedSuites)
{
	BHandler handler;
	BMessage suites;
	ASSERT_EQ(B_OK, handler.GetSupportedSuites(&suites));
	BPropertyInfo info;
	ASSERT_EQ(B_OK, suites.FindFlat("messages", &info));
	EXPECT_LT(0, info.CountProperties());
}
