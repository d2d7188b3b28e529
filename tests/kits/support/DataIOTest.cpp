#include <cerrno>
#include <cstdio>
#include <cstring>
#include <string>

#include <gtest/gtest.h>

#include <ByteOrder.h>
#include <DataIO.h>
#include <StopWatch.h>
#include <UTF8.h>

#include "support/private/Errno.h"
#include "support/private/Result.h"
#include "support/private/Utf8.h"


TEST(MallocIO, GrowsAndFillsGapsWithZeros)
{
	BMallocIO stream;
	EXPECT_EQ(5, stream.Write("hello", 5));
	EXPECT_EQ(5, stream.Position());
	EXPECT_EQ(2, stream.WriteAt(8, "xy", 2));
	EXPECT_EQ(10u, stream.BufferLength());
	EXPECT_EQ(0, memcmp(stream.Buffer(), "hello\0\0\0xy", 10));
	EXPECT_EQ(B_OK, stream.SetSize(12));
	EXPECT_EQ(B_OK, stream.SetSize(3));
	off_t size;
	EXPECT_EQ(B_OK, stream.GetSize(&size));
	EXPECT_EQ(3, size);
	char buffer[10];
	EXPECT_EQ(2, stream.ReadAt(1, buffer, 10));
	EXPECT_EQ(0, stream.ReadAt(3, buffer, 10));
	EXPECT_EQ(B_BAD_VALUE, stream.ReadAt(-1, buffer, 10));
	EXPECT_EQ(B_BAD_VALUE, stream.SetSize(-1));
	EXPECT_EQ(B_NO_MEMORY, stream.WriteAt(INT64_MAX - 1, "x", 1));
}


TEST(MallocIO, Seeks)
{
	BMallocIO stream;
	stream.Write("0123456789", 10);
	EXPECT_EQ(4, stream.Seek(4, SEEK_SET));
	EXPECT_EQ(6, stream.Seek(2, SEEK_CUR));
	EXPECT_EQ(9, stream.Seek(-1, SEEK_END));
	EXPECT_EQ(B_BAD_VALUE, stream.Seek(-11, SEEK_END));
	EXPECT_EQ(B_BAD_VALUE, stream.Seek(0, 9));
	EXPECT_EQ(9, stream.Position());
	char last;
	EXPECT_EQ(1, stream.Read(&last, 1));
	EXPECT_EQ('9', last);
	EXPECT_EQ(0, stream.Read(&last, 1));
}


TEST(MemoryIO, StaysInItsWindow)
{
	char memory[8] = "abcdefg";
	BMemoryIO stream(memory, 7);
	EXPECT_EQ(3, stream.WriteAt(4, "xyz123", 6));
	EXPECT_STREQ("abcdxyz", memory);
	EXPECT_EQ(0, stream.WriteAt(7, "x", 1));
	EXPECT_EQ(B_OK, stream.SetSize(3));
	char buffer[8];
	EXPECT_EQ(3, stream.ReadAt(0, buffer, 8));
	EXPECT_EQ(B_ERROR, stream.SetSize(8));
	BMemoryIO constant(static_cast<const void*>("text"), 4);
	EXPECT_EQ(B_NOT_ALLOWED, constant.WriteAt(0, "x", 1));
	EXPECT_EQ(B_NOT_ALLOWED, constant.SetSize(1));
}


TEST(DataIO, MovesExactlyOrTellsHowFarItCame)
{
	BMallocIO stream;
	EXPECT_EQ(B_OK, stream.WriteExactly("hello", 5));
	char buffer[8];
	size_t moved = 99;
	EXPECT_EQ(B_PARTIAL_READ, stream.ReadAtExactly(2, buffer, 8, &moved));
	EXPECT_EQ(3u, moved);
	EXPECT_EQ(B_OK, stream.ReadAtExactly(0, buffer, 5));
	char small[2];
	BMemoryIO narrow(small, 2);
	EXPECT_EQ(B_PARTIAL_WRITE, narrow.WriteExactly("abc", 3, &moved));
	EXPECT_EQ(2u, moved);
}


TEST(ByteOrder, SwapsNumbersByTheirType)
{
	uint16 shorts[] = { 0x1122, 0x3344 };
	EXPECT_EQ(B_OK, swap_data(B_UINT16_TYPE, shorts, sizeof(shorts), B_SWAP_ALWAYS));
	EXPECT_EQ(0x2211, shorts[0]);
	EXPECT_EQ(0x4433, shorts[1]);
	uint32 value = 0x11223344;
	EXPECT_EQ(B_OK, swap_data(B_INT32_TYPE, &value, 4, B_SWAP_HOST_TO_BENDIAN));
	EXPECT_EQ(0x44332211u, value);
	EXPECT_EQ(B_OK, swap_data(B_INT32_TYPE, &value, 4, B_SWAP_LENDIAN_TO_HOST));
	EXPECT_EQ(0x44332211u, value);
	EXPECT_EQ(B_BAD_VALUE, swap_data(B_STRING_TYPE, &value, 4, B_SWAP_ALWAYS));
	EXPECT_TRUE(is_type_swapped(B_RECT_TYPE));
	EXPECT_FALSE(is_type_swapped(B_RGB_COLOR_TYPE));
	EXPECT_EQ(0x1122, uint16(B_SWAP_INT16(0x2211)));
	EXPECT_EQ(1.5, B_SWAP_DOUBLE(B_SWAP_DOUBLE(1.5)));
}


TEST(Utf8, WalksOverTextThatCannotBeTrusted)
{
	using namespace BPrivate;
	EXPECT_EQ(1, utf8_char_length("a", 1));
	EXPECT_EQ(2, utf8_char_length("\xc3\xa9", 2));
	EXPECT_EQ(1, utf8_char_length("\xc3", 1));
	EXPECT_EQ(1, utf8_char_length("\xc3(", 2));
	EXPECT_EQ(1, utf8_char_length("\x80", 1));
	EXPECT_EQ(0, utf8_char_length("", 0));
	EXPECT_EQ(3, utf8_previous_char_length("a\xe2\x82\xac", 4));
	EXPECT_EQ(1, utf8_previous_char_length("a\x82\xac", 3));
	EXPECT_EQ(0, utf8_previous_char_length("a", 0));
	EXPECT_TRUE(utf8_is_valid("a\xe2\x82\xac", 4));
	EXPECT_FALSE(utf8_is_valid("\xc0\x80", 2)); // too long
	EXPECT_FALSE(utf8_is_valid("\xed\xa0\x80", 3)); // half of a pair
	EXPECT_FALSE(utf8_is_valid("\xf4\x90\x80\x80", 4)); // beyond the last
	char buffer[4];
	for (uint32 codePoint : { 0x24u, 0xe9u, 0x20acu, 0x1f600u }) {
		const char* text = buffer;
		const int32 length = utf8_encode(codePoint, buffer);
		EXPECT_EQ(codePoint, utf8_next_code_point(&text, buffer + length));
		EXPECT_EQ(buffer + length, text);
	}
}


TEST(Utf8, ConvertsFromAndToOtherEncodings)
{
	char buffer[16] = "";
	int32 sourceLength = 3;
	int32 length = sizeof(buffer);
	int32 state = 0;
	EXPECT_EQ(
		B_OK, convert_to_utf8(B_ISO1_CONVERSION, "a\xe9z", &sourceLength, buffer, &length, &state));
	EXPECT_EQ(3, sourceLength);
	EXPECT_EQ("a\xc3\xa9z", std::string(buffer, size_t(length)));

	sourceLength = 6;
	length = sizeof(buffer);
	EXPECT_EQ(B_OK,
		convert_from_utf8(
			B_ISO1_CONVERSION, "\xc3\xa9\xe2\x82\xacz", &sourceLength, buffer, &length, &state));
	EXPECT_EQ("\xe9?z", std::string(buffer, size_t(length)));

	// What does not fit is left for the next call.
	sourceLength = 4;
	length = 3;
	EXPECT_EQ(B_OK,
		convert_to_utf8(
			B_ISO1_CONVERSION, "\xe9\xe9\xe9\xe9", &sourceLength, buffer, &length, &state));
	EXPECT_EQ(1, sourceLength);
	EXPECT_EQ(2, length);
	EXPECT_EQ(B_ERROR, convert_to_utf8(999, "a", &sourceLength, buffer, &length, &state));
}


TEST(Result, HoldsAValueOrAnError)
{
	const BPrivate::Result<std::string> value(std::string("text"));
	ASSERT_TRUE(value);
	EXPECT_EQ("text", *value);
	EXPECT_EQ(4u, value->size());
	const BPrivate::Result<std::string> error { status_t(B_BAD_DATA) };
	EXPECT_FALSE(error);
	EXPECT_EQ(B_BAD_DATA, error.Error());
}


TEST(Errno, BecomesAStatus)
{
	EXPECT_EQ(B_OK, BPrivate::status_from_errno(0));
	EXPECT_EQ(B_ENTRY_NOT_FOUND, BPrivate::status_from_errno(ENOENT));
	EXPECT_EQ(B_DEVICE_FULL, BPrivate::status_from_errno(ENOSPC));
	EXPECT_EQ(B_ERROR, BPrivate::status_from_errno(123456));
}


TEST(StopWatch, LeavesOutTheTimeItIsSuspended)
{
	BStopWatch watch("test", true);
	EXPECT_STREQ("test", watch.Name());
	EXPECT_LE(0, watch.Lap());
	watch.Suspend();
	const bigtime_t time = watch.ElapsedTime();
	snooze(2000);
	EXPECT_EQ(time, watch.ElapsedTime());
	EXPECT_EQ(0, watch.Lap());
	watch.Resume();
	EXPECT_LE(time, watch.ElapsedTime());
}
