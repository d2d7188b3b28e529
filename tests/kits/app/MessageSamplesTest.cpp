// The messages in all sample files, against the dumps that lie beside them.

#include <cstring>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include <Message.h>
#include <MessageForm.h>
#include <Resources.h>

#include "support/Dump.h"

namespace {

// Calls the function with each message of the samples: its bytes, its dump and where it is.
template<typename Function>
void
for_each_message(Function function)
{
	int messages = 0;
	for (const std::string& path : test::sample_files()) {
		const std::vector<test::DumpResource> dump = test::read_dump(test::dump_of(path));
		BResources resources(path.c_str());
		for (const test::DumpResource& expected : dump) {
			SCOPED_TRACE(path + " " + std::to_string(expected.id));
			size_t size = 0;
			const void* data = resources.LoadResource(expected.type, expected.id, &size);
			ASSERT_NE(nullptr, data);
			ASSERT_EQ(expected.size, size);
			if (expected.message == nullptr)
				continue;
			messages++;
			function(data, size, expected);
		}
	}
	EXPECT_LT(150, messages);
}


std::string
flatten(const BMessage& message, message_form form)
{
	std::string bytes(size_t(flattened_message_size(message, form)), '\x55');
	EXPECT_EQ(B_OK, flatten_message(message, form, bytes.data(), ssize_t(bytes.size())));
	return bytes;
}


#define SKIP_WITHOUT_SAMPLES()                                                                     \
	if (test::samples_folder().empty())                                                            \
	GTEST_SKIP() << "ARCHWAY_SAMPLES names no folder"

} // namespace


TEST(MessageSamples, EveryMessageIsWhatItsDumpSays)
{
	SKIP_WITHOUT_SAMPLES();
	for_each_message([](const void* data, size_t size, const test::DumpResource& expected) {
		BMessage message;
		size_t used = 0;
		message_damage damage { 0, "" };
		ASSERT_EQ(B_OK, unflatten_message(&message, data, size, &damage, &used)) << damage.reason;
		EXPECT_EQ(size, used);
		EXPECT_EQ("", test::difference(message, *expected.message));
	});
}


TEST(MessageSamples, FlatteningInTheSameFormGivesTheSameBytes)
{
	SKIP_WITHOUT_SAMPLES();
	for_each_message([](const void* data, size_t size, const test::DumpResource& expected) {
		message_form_info info;
		ASSERT_EQ(B_OK, get_message_form(data, size, &info));
		EXPECT_EQ(size, info.size);
		EXPECT_TRUE(info.checksum_matches);
		if (info.big_endian)
			return;
		BMessage message;
		ASSERT_EQ(B_OK, unflatten_message(&message, data, size));
		const std::string again = flatten(message, info.form);
		ASSERT_EQ(size, again.size());
		EXPECT_EQ(0, memcmp(data, again.data(), size));
		// So do copies of all fields into a new message, but for what stands in the padding.
		BMessage rebuilt(message.what);
		ASSERT_EQ(B_OK, rebuilt.Append(message));
		EXPECT_EQ(size, flatten(rebuilt, info.form).size());
	});
}


TEST(MessageSamples, ConversionBetweenTheFormsLosesNothing)
{
	SKIP_WITHOUT_SAMPLES();
	for_each_message([](const void* data, size_t size, const test::DumpResource& expected) {
		BMessage message;
		ASSERT_EQ(B_OK, unflatten_message(&message, data, size));
		for (message_form form : { B_HAIKU_FORM, B_R5_FORM, B_R5_WIDE_FORM, B_HAIKU_FORM }) {
			const std::string bytes = flatten(message, form);
			BMessage back;
			ASSERT_EQ(B_OK, unflatten_message(&back, bytes.data(), bytes.size()));
			EXPECT_EQ("", test::difference(back, *expected.message));
			EXPECT_TRUE(back.HasSameData(message, false, true));
			// Nested messages have been turned into the form too, so this is its only writing.
			EXPECT_EQ(bytes, flatten(back, form));
			message = back;
		}
	});
}


TEST(MessageSamples, AllTheFormsAreAmongThem)
{
	SKIP_WITHOUT_SAMPLES();
	bool seen[2][5] = {};
	for_each_message([&](const void* data, size_t size, const test::DumpResource&) {
		message_form_info info;
		ASSERT_EQ(B_OK, get_message_form(data, size, &info));
		seen[info.big_endian ? 1 : 0][info.form] = true;
	});
	EXPECT_TRUE(seen[0][B_R5_FORM]);
	EXPECT_TRUE(seen[0][B_R5_WIDE_FORM]);
	EXPECT_TRUE(seen[0][B_HAIKU_FORM]);
	EXPECT_TRUE(seen[1][B_R5_FORM]);
}
