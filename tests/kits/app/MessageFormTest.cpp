// The bytes of flattened messages.

#include <cstring>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include <DataIO.h>
#include <Message.h>
#include <MessageForm.h>
#include <Rect.h>
#include <String.h>

namespace {

std::string
from_hex(const char* text)
{
	std::string bytes;
	for (const char* at = text; *at != '\0';) {
		if (*at == ' ') {
			at++;
			continue;
		}
		bytes += char(std::stoi(std::string(at, 2), nullptr, 16));
		at += 2;
	}
	return bytes;
}


std::string
flatten(const BMessage& message, message_form form)
{
	std::string bytes(size_t(flattened_message_size(message, form)), '\x55');
	EXPECT_EQ(B_OK, flatten_message(message, form, bytes.data(), ssize_t(bytes.size())));
	return bytes;
}


std::string
r5(const BMessage& message)
{
	return flatten(message, B_R5_FORM);
}


status_t
read(const std::string& bytes, BMessage* message)
{
	// A block of its own lets a checker see a look beyond the end.
	std::vector<char> block;
	block.reserve(bytes.size() + 1);
	block.assign(bytes.begin(), bytes.end());
	return unflatten_message(message, block.data(), block.size());
}


// Looks at everything that a message has, as a reader of an archive would.
int32
walk(const BMessage& message, int32 depth = 0)
{
	int32 items = 0;
	char* name;
	type_code type;
	int32 count;
	for (int32 i = 0; message.GetInfo(B_ANY_TYPE, i, &name, &type, &count) == B_OK; i++) {
		for (int32 k = 0; k < count; k++) {
			const void* data;
			ssize_t size;
			BMessage nested;
			if (type == B_MESSAGE_TYPE && message.FindMessage(name, k, &nested) == B_OK)
				items += walk(nested, depth + 1);
			if (message.FindData(name, type, k, &data, &size) == B_OK) {
				items++;
				const volatile char last = static_cast<const char*>(data)[size - 1];
				(void)last;
			}
		}
	}
	return items;
}


BMessage
small_archive()
{
	BMessage archive('ARCV');
	archive.AddString("class", "BView");
	archive.AddString("_name", "view");
	archive.AddRect("_frame", BRect(0, 1, 10, 20.5));
	archive.AddInt32("_flags", 0x20000000);
	return archive;
}


BMessage
arrays()
{
	BMessage message(1);
	message.AddInt32("v", 1);
	message.AddInt32("v", 2);
	message.AddInt32("v", -1);
	message.AddString("s", "a");
	message.AddString("s", "hello");
	message.AddString("s", "");
	return message;
}


// A message of every kind of field, with messages in it.
BMessage
mixed_message()
{
	BMessage message = arrays();
	BMessage inner = small_archive();
	BMessage innermost('deep');
	innermost.AddBool("yes", true);
	inner.AddMessage("_msg", &innermost);
	message.AddMessage("_views", &inner);
	message.AddMessage("_views", &innermost);
	message.AddData("raw", B_RAW_TYPE, "12345", 5, false);
	message.AddData("fixed", B_RAW_TYPE, "12345", 5, true);
	message.AddData("fixed", B_RAW_TYPE, "67890", 5, true);
	std::string longText(300, 'x');
	message.AddString("long", longText.c_str());
	return message;
}

const char* kEmpty = "31424f46 01000012 12000000 00000000 01 00";
const char* kCount =
	"31424f46 7b65748d 22000000 6b74657a 01 0f 474e4f4c 04 05 636f756e74 05000000 00";
const char* kCountWide =
	"31424f46 7b657490 25000000 6b74657a 01 0d 474e4f4c 04000000 05 636f756e74 05000000 00";
const char* kCountBig =
	"464f4231 7a65748e 00000022 7a65746b 01 0f 4c4f4e47 04 05 636f756e74 00000005 00";
const char* kArchive = "31424f46 425243ce 78000000 56435241 01"
					   "0b 52545343 10 05 636c617373 06000000 425669657700 000000000000"
					   "0b 52545343 10 05 5f6e616d65 05000000 7669657700 00000000000000"
					   "0f 54434552 10 06 5f6672616d65 00000000 0000803f 00002041 0000a441"
					   "0f 474e4f4c 04 06 5f666c616773 00000020 00";
const char* kArrays =
	"31424f46 01000051 50000000 01000000 01"
	"07 474e4f4c 03 0c 01 76 01000000 02000000 ffffffff"
	"03 52545343 03 20 01 73 02000000 6100 0000 06000000 68656c6c6f00 000000000000"
	"01000000 00 000000 00";
const char* kNested =
	"31424f46 0100008c 8c000000 00000000 01"
	"0b 52545343 10 05 636c617373 08000000 4257696e646f7700 00000000"
	"03 4747534d 02 50 06 5f7669657773 2e000000"
	"31424f46 0100002e 2e000000 00000000 01"
	"0b 52545343 10 05 636c617373 05000000 42426f7800 00000000000000 00 000000000000"
	"12000000 31424f46 01000019 12000000 07000000 01 00 0000 00";
const char* kEmptyHaiku =
	"484d4631 00000000 01000000 ffffffff ffffffff ffffffff ffffffff ffffffff ffffffff"
	"00000000 00000000 05000000 ffffffff ffffffff ffffffff ffffffff ffffffff";
const char* kArchiveHaiku =
	"484d4631 56435241 01000000 ffffffff ffffffff ffffffff ffffffff ffffffff ffffffff"
	"41000000 04000000 05000000 00000000 03000000 01000000 ffffffff ffffffff"
	"0100 0600 52545343 01000000 0a000000 00000000 02000000"
	"0100 0600 52545343 01000000 09000000 10000000 ffffffff"
	"0300 0700 54434552 01000000 10000000 1f000000 ffffffff"
	"0300 0700 474e4f4c 01000000 04000000 36000000 ffffffff"
	"636c61737300 06000000 425669657700 5f6e616d6500 05000000 7669657700"
	"5f6672616d6500 00000000 0000803f 00002041 0000a441 5f666c61677300 00000020";
const char* kArraysHaiku =
	"484d4631 01000000 01000000 ffffffff ffffffff ffffffff ffffffff ffffffff ffffffff"
	"25000000 02000000 05000000 01000000 00000000 ffffffff ffffffff ffffffff"
	"0300 0200 474e4f4c 03000000 0c000000 00000000 ffffffff"
	"0100 0200 52545343 03000000 15000000 0e000000 ffffffff"
	"7600 01000000 02000000 ffffffff 7300 02000000 6100 06000000 68656c6c6f00 01000000 00";

} // namespace


TEST(MessageForm, R5IsWrittenCompactly)
{
	EXPECT_EQ(from_hex(kEmpty), r5(BMessage()));
	BMessage count('zetk');
	count.AddInt32("count", 5);
	EXPECT_EQ(from_hex(kCount), r5(count));
	EXPECT_EQ(from_hex(kArchive), r5(small_archive()));
	EXPECT_EQ(from_hex(kArrays), r5(arrays()));

	BMessage window;
	window.AddString("class", "BWindow");
	BMessage box;
	box.AddString("class", "BBox");
	BMessage seven(7);
	window.AddMessage("_views", &box);
	window.AddMessage("_views", &seven);
	EXPECT_EQ(from_hex(kNested), r5(window));
}


TEST(MessageForm, R5CanBeWrittenWide)
{
	BMessage count('zetk');
	count.AddInt32("count", 5);
	EXPECT_EQ(from_hex(kCountWide), flatten(count, B_R5_WIDE_FORM));
}


TEST(MessageForm, HaikuHasAHashTable)
{
	EXPECT_EQ(from_hex(kEmptyHaiku), flatten(BMessage(), B_HAIKU_FORM));
	EXPECT_EQ(from_hex(kArchiveHaiku), flatten(small_archive(), B_HAIKU_FORM));
	EXPECT_EQ(from_hex(kArraysHaiku), flatten(arrays(), B_HAIKU_FORM));
}


TEST(MessageForm, AllFormsAreRead)
{
	BMessage message;
	for (const char* bytes : { kCount, kCountWide, kCountBig }) {
		ASSERT_EQ(B_OK, read(from_hex(bytes), &message));
		EXPECT_EQ(uint32('zetk'), message.what);
		EXPECT_EQ(5, message.FindInt32("count"));
	}
	for (const char* bytes : { kArrays, kArraysHaiku }) {
		ASSERT_EQ(B_OK, read(from_hex(bytes), &message));
		EXPECT_EQ(1u, message.what);
		EXPECT_TRUE(message.HasSameData(arrays(), false));
	}
	ASSERT_EQ(B_OK, read(from_hex(kArchiveHaiku), &message));
	EXPECT_TRUE(message.HasSameData(small_archive(), false));
}


TEST(MessageForm, TheFormIsToldFromTheFirstBytes)
{
	const struct {
		const char* bytes;
		message_form form;
		bool bigEndian;
	} cases[] = { { kEmpty, B_R5_FORM, false }, { kCount, B_R5_FORM, false },
		{ kCountWide, B_R5_WIDE_FORM, false }, { kCountBig, B_R5_FORM, true },
		{ kArchiveHaiku, B_HAIKU_FORM, false } };
	for (const auto& expected : cases) {
		const std::string bytes = from_hex(expected.bytes);
		message_form_info info;
		ASSERT_EQ(B_OK, get_message_form(bytes.data(), bytes.size(), &info));
		EXPECT_EQ(expected.form, info.form);
		EXPECT_EQ(expected.bigEndian, info.big_endian);
		EXPECT_EQ(bytes.size(), info.size);
		EXPECT_TRUE(info.checksum_matches);
	}
	message_form_info info;
	EXPECT_EQ(B_NOT_A_MESSAGE, get_message_form("FOB9aaaaaaaaaaaaaaaaaa", 22, &info));
	EXPECT_EQ(B_NOT_A_MESSAGE, get_message_form("FOB", 3, &info));
}


TEST(MessageForm, AWrongChecksumIsReportedAndRead)
{
	std::string bytes = from_hex(kCount);
	bytes[4] = char(bytes[4] + 1);
	message_form_info info;
	ASSERT_EQ(B_OK, get_message_form(bytes.data(), bytes.size(), &info));
	EXPECT_FALSE(info.checksum_matches);
	BMessage message;
	ASSERT_EQ(B_OK, read(bytes, &message));
	EXPECT_EQ(5, message.FindInt32("count"));
}


TEST(MessageForm, ItemsOfTheOtherByteOrderAreSwapped)
{
	// Code 'abcd'; short 0x1234; long long; double -2.25; point (1, 2); rectangle; colour; three
	// numbers of a field; a string.
	const std::string bytes = from_hex("464f4231 00000000 000000a8 61626364 01"
									   "0f 53485254 02 01 61 1234"
									   "0f 4c4c4e47 08 01 62 123456789abcdef0"
									   "0f 44424c45 08 01 63 c002000000000000"
									   "0f 42504e54 08 01 64 3f800000 40000000"
									   "0f 52454354 10 01 65 3f800000 40000000 40400000 40800000"
									   "0f 52474243 04 01 66 ff8000ff"
									   "07 4c4f4e47 02 08 01 67 00000001 ffffffff"
									   "0b 43535452 08 01 68 00000002 6100 0000 00");
	ASSERT_LE(bytes.size(), 0xa8u);
	std::string sized = bytes;
	sized[11] = char(bytes.size());
	BMessage message;
	ASSERT_EQ(B_OK, read(sized, &message));
	EXPECT_EQ(uint32('abcd'), message.what);
	EXPECT_EQ(0x1234, message.FindInt16("a"));
	EXPECT_EQ(0x123456789abcdef0, message.FindInt64("b"));
	EXPECT_EQ(-2.25, message.FindDouble("c"));
	EXPECT_EQ(BPoint(1, 2), message.FindPoint("d"));
	EXPECT_EQ(BRect(1, 2, 3, 4), message.FindRect("e"));
	const void* color;
	ssize_t size;
	ASSERT_EQ(B_OK, message.FindData("f", B_RGB_COLOR_TYPE, &color, &size));
	EXPECT_EQ(0, memcmp(color, "\xff\x80\x00\xff", 4));
	EXPECT_EQ(1, message.FindInt32("g", 0));
	EXPECT_EQ(-1, message.FindInt32("g", 1));
	EXPECT_STREQ("a", message.FindString("h"));
}


TEST(MessageForm, DanoMessagesAreRead)
{
	// A number alone, two points, and two strings of which the first ends at 3 and the second
	// starts at 8.
	std::string bytes =
		from_hex("32424f46 00000000 64636261 00000000"
				 "61444753 1c000000 474e4f4c 04000000 01 6e 00 0000000000 05000000 00000000"
				 "61444146 30000000 544e5042 08000000 01 70 00 0000000000 02000000 00000000"
				 "0000803f 00000040 00004040 00008040"
				 "61444156 34000000 52545343 00000000 01 73 00 0000000000 02000000 0b000000"
				 "616200 0000000000 636400 03000000 0b000000"
				 "0000");
	while (bytes.size() % 8 != 0)
		bytes += '\0';
	bytes += from_hex("6e454444 08000000");
	bytes[4] = char(bytes.size());

	BMessage message;
	message_damage damage { 0, "" };
	ASSERT_EQ(B_OK, unflatten_message(&message, bytes.data(), bytes.size(), &damage))
		<< damage.reason << " at " << damage.offset;
	EXPECT_EQ(uint32('abcd'), message.what);
	EXPECT_EQ(5, message.FindInt32("n"));
	EXPECT_EQ(BPoint(1, 2), message.FindPoint("p", 0));
	EXPECT_EQ(BPoint(3, 4), message.FindPoint("p", 1));
	EXPECT_STREQ("ab", message.FindString("s", 0));
	EXPECT_STREQ("cd", message.FindString("s", 1));
	EXPECT_EQ(3, message.CountNames(B_ANY_TYPE));

	for (size_t length = 0; length < bytes.size(); length++)
		EXPECT_NE(B_OK, read(bytes.substr(0, length), &message)) << length;
}


TEST(MessageForm, PaddingIsCarriedAlongAndMeansNothing)
{
	const std::string bytes =
		from_hex("31424f46 01000036 36000000 00000000 01 0b 52545343 18 05 7479706573 10000000"
				 "6170706c69636174696f6e2f7a697000 000f474e 00");
	BMessage message;
	ASSERT_EQ(B_OK, read(bytes, &message));
	EXPECT_STREQ("application/zip", message.FindString("types"));
	EXPECT_EQ(bytes, r5(message));

	BMessage clean;
	clean.AddString("types", "application/zip");
	EXPECT_TRUE(clean.HasSameData(message));
	EXPECT_NE(bytes, r5(clean));
}


TEST(MessageForm, NestedMessagesTakeTheFormOfTheirParent)
{
	const BMessage message = mixed_message();
	for (message_form first : { B_R5_FORM, B_R5_WIDE_FORM, B_HAIKU_FORM }) {
		BMessage read1;
		ASSERT_EQ(B_OK, read(flatten(message, first), &read1));
		for (message_form second : { B_R5_FORM, B_R5_WIDE_FORM, B_HAIKU_FORM })
			EXPECT_EQ(flatten(message, second), flatten(read1, second)) << first << second;
	}
}


TEST(MessageForm, ANestedItemThatIsNoMessageStaysAsItIs)
{
	BMessage message;
	message.AddData("m", B_MESSAGE_TYPE, "no message", 10, false);
	message.AddInt32("n", 1);
	BMessage back;
	for (message_form form : { B_HAIKU_FORM, B_R5_FORM, B_R5_WIDE_FORM }) {
		ASSERT_EQ(B_OK, read(flatten(message, form), &back));
		BMessage nested('keep');
		EXPECT_EQ(B_NOT_A_MESSAGE, back.FindMessage("m", &nested));
		EXPECT_EQ(0u, nested.what);
		const void* data;
		ssize_t size;
		ASSERT_EQ(B_OK, back.FindData("m", B_MESSAGE_TYPE, &data, &size));
		EXPECT_EQ(
			std::string("no message"), std::string(static_cast<const char*>(data), size_t(size)));
	}
}


TEST(MessageForm, TheSizeIsExact)
{
	const BMessage message = mixed_message();
	const ssize_t size = message.FlattenedSize();
	std::string bytes(size_t(size) + 1, '\x55');
	EXPECT_EQ(B_BUFFER_OVERFLOW, message.Flatten(bytes.data(), size - 1));
	EXPECT_EQ(B_BAD_VALUE, message.Flatten(static_cast<char*>(nullptr), size));
	EXPECT_EQ(B_BAD_VALUE, message.Flatten(bytes.data(), -1));
	EXPECT_EQ(B_OK, message.Flatten(bytes.data(), size));
	EXPECT_EQ('\x55', bytes.back());
}


TEST(MessageForm, AStreamIsLeftBehindTheMessage)
{
	BMallocIO stream;
	ssize_t written = 0;
	const BMessage message = mixed_message();
	ASSERT_EQ(B_OK, message.Flatten(&stream, &written));
	EXPECT_EQ(message.FlattenedSize(), written);
	const std::string haiku = flatten(message, B_HAIKU_FORM);
	stream.Write(haiku.data(), haiku.size());
	stream.Write("rest", 4);

	stream.Seek(0, SEEK_SET);
	BMessage read;
	ASSERT_EQ(B_OK, read.Unflatten(&stream));
	EXPECT_EQ(off_t(written), stream.Position());
	EXPECT_TRUE(read.HasSameData(message, false, true));
	ASSERT_EQ(B_OK, read.Unflatten(&stream));
	EXPECT_TRUE(read.HasSameData(message, false, true));
	EXPECT_EQ(off_t(written) + off_t(haiku.size()), stream.Position());
	EXPECT_EQ(B_NOT_A_MESSAGE, read.Unflatten(&stream));
	EXPECT_TRUE(read.IsEmpty());
}


TEST(MessageForm, WhatIsNoMessageIsRefused)
{
	BMessage message('keep');
	EXPECT_EQ(B_BAD_VALUE, message.Unflatten(static_cast<const char*>(nullptr)));
	EXPECT_EQ(B_BAD_VALUE, message.Unflatten(static_cast<BDataIO*>(nullptr)));
	EXPECT_EQ(B_NOT_A_MESSAGE, read("", &message));
	EXPECT_EQ(B_NOT_A_MESSAGE, read("FOB", &message));
	EXPECT_EQ(B_NOT_A_MESSAGE, read("PMSGPMSGPMSGPMSGPMSG", &message));
	EXPECT_EQ(B_BAD_VALUE, read(from_hex(kEmptyHaiku).substr(0, 67), &message));
	std::string invalid = from_hex(kEmptyHaiku);
	invalid[8] = 0;
	EXPECT_EQ(B_BAD_VALUE, read(invalid, &message));
}


TEST(MessageForm, DamageIsNamedWithItsPlace)
{
	std::string bytes = from_hex(kArchive);
	bytes[0x16] = char(0xff); // the size of the first field's data
	BMessage message;
	message.AddInt32("old", 1);
	message_damage damage { 0, nullptr };
	EXPECT_EQ(B_BAD_VALUE, unflatten_message(&message, bytes.data(), bytes.size(), &damage));
	EXPECT_EQ(0x1du, damage.offset);
	EXPECT_STREQ("the field's data pass the end of the message", damage.reason);
	EXPECT_TRUE(message.IsEmpty());
}


TEST(MessageForm, EveryTruncationIsRefused)
{
	for (message_form form : { B_R5_FORM, B_R5_WIDE_FORM, B_HAIKU_FORM }) {
		const std::string bytes = flatten(mixed_message(), form);
		for (size_t length = 0; length < bytes.size(); length++) {
			BMessage message;
			EXPECT_NE(B_OK, read(bytes.substr(0, length), &message)) << length;
			EXPECT_TRUE(message.IsEmpty());
			BMemoryIO stream(bytes.data(), length);
			EXPECT_NE(B_OK, message.Unflatten(&stream)) << length;
			EXPECT_TRUE(message.IsEmpty());
		}
	}
}


// Whatever is read can be looked at and written again, and what is written is read.
TEST(MessageForm, NoFlippedBitDoesHarm)
{
	for (message_form form : { B_R5_FORM, B_R5_WIDE_FORM, B_HAIKU_FORM }) {
		const std::string bytes = flatten(mixed_message(), form);
		for (size_t i = 0; i < bytes.size() * 8; i++) {
			std::string flipped = bytes;
			flipped[i / 8] = char(flipped[i / 8] ^ (1 << (i % 8)));
			BMessage message;
			if (read(flipped, &message) != B_OK)
				continue;
			walk(message);
			for (message_form out : { B_R5_FORM, B_HAIKU_FORM }) {
				BMessage back;
				ASSERT_EQ(B_OK, read(flatten(message, out), &back)) << i;
				ASSERT_EQ(message.CountNames(B_ANY_TYPE), back.CountNames(B_ANY_TYPE));
			}
		}
	}
}


TEST(MessageForm, CountsAndSizesBeyondTheBytesAreRefused)
{
	for (message_form form : { B_R5_WIDE_FORM, B_HAIKU_FORM }) {
		const std::string bytes = flatten(mixed_message(), form);
		for (size_t i = 4; i + 4 <= bytes.size(); i++) {
			for (uint32 value : { 0u, 1u, 0x7fffffffu, 0x80000000u, 0xffffffffu, 0x10000000u }) {
				std::string changed = bytes;
				memcpy(changed.data() + i, &value, sizeof(value));
				BMessage message;
				if (read(changed, &message) == B_OK) {
					EXPECT_LT(walk(message), 100);
				}
			}
		}
	}
}


TEST(MessageForm, DeepNestingEndsInAnError)
{
	// Written by hand: each level is a header, one field around the next level, and its end.
	constexpr int kLevels = 100000;
	constexpr size_t kFront = 17 + 1 + 4 + 4 + 1 + 1 + 4;
	std::string front;
	std::string back;
	std::vector<size_t> sizes { 18 };
	for (int i = 1; i < kLevels; i++) {
		const size_t padded = (sizes.back() + 4 + 7) & ~size_t(7);
		sizes.push_back(kFront - 4 + padded + 1);
	}
	const auto put = [](std::string& to, uint32 value) {
		to.append(reinterpret_cast<const char*>(&value), sizeof(value));
	};
	std::vector<std::string> ends;
	for (int i = kLevels - 1; i > 0; i--) {
		put(front, 'FOB1');
		put(front, 0);
		put(front, uint32(sizes[size_t(i)]));
		put(front, uint32(i));
		front += '\x01';
		front += '\x09';
		put(front, B_MESSAGE_TYPE);
		const size_t inner = sizes[size_t(i) - 1];
		const size_t padded = (inner + 4 + 7) & ~size_t(7);
		put(front, uint32(padded));
		front += "\x01m";
		put(front, uint32(inner));
		ends.push_back(std::string(padded - 4 - inner + 1, '\0'));
	}
	std::string bytes = front + r5(BMessage(7));
	for (auto end = ends.rbegin(); end != ends.rend(); ++end)
		bytes += *end;
	ASSERT_EQ(sizes.back(), bytes.size());

	BMessage message;
	ASSERT_EQ(B_OK, read(bytes, &message));
	int depth = 0;
	while (message.HasMessage("m")) {
		BMessage next;
		const status_t status = message.FindMessage("m", &next);
		if (status != B_OK) {
			EXPECT_EQ(B_BAD_DATA, status);
			break;
		}
		message = next;
		depth++;
	}
	EXPECT_EQ(int(B_MAX_MESSAGE_NESTING), depth);

	// Written again in any form it loses nothing, at whatever depth.
	ASSERT_EQ(B_OK, read(bytes, &message));
	EXPECT_LE(bytes.size(), r5(message).size());
	BMessage again;
	EXPECT_EQ(B_OK, read(flatten(message, B_HAIKU_FORM), &again));
	EXPECT_TRUE(again.HasMessage("m"));
}


// They are written whole at any depth; as deep as they can be read, they are found.
TEST(MessageForm, MessagesCanBePutIntoEachOtherWithoutEnd)
{
	BMessage message(7);
	for (int i = 0; i < 2000; i++) {
		BMessage outer(uint32(i) + 8);
		ASSERT_EQ(B_OK, outer.AddMessage("m", &message));
		message = outer;
	}
	EXPECT_LT(2000u * 30, r5(message).size());
	for (int i = 0; i < B_MAX_MESSAGE_NESTING; i++) {
		BMessage inner;
		ASSERT_EQ(B_OK, message.FindMessage("m", &inner)) << i;
		EXPECT_EQ(2006u - uint32(i), inner.what);
		message = inner;
	}
}


// #pragma mark - salvage


namespace {

BMessage
panel_of_three()
{
	BMessage panel(5);
	panel.AddString("class", "BView");
	panel.AddInt32("numbers", 1);
	panel.AddInt32("numbers", 2);
	panel.AddInt32("numbers", 3);
	for (const char* name : { "first", "second", "third" }) {
		BMessage child;
		child.AddString("class", "BButton");
		child.AddString("_name", name);
		child.AddString("_label", "Press this button");
		panel.AddMessage("_views", &child);
	}
	panel.AddString("last", "the end");
	return panel;
}

} // namespace


TEST(MessageSalvage, AWholeMessageComesBackWhole)
{
	for (message_form form : { B_R5_FORM, B_R5_WIDE_FORM, B_HAIKU_FORM }) {
		const std::string bytes = flatten(panel_of_three(), form);
		BMessage message;
		std::vector<message_damage> damages;
		EXPECT_EQ(B_OK, salvage_message(&message, bytes.data(), bytes.size(), &damages));
		EXPECT_TRUE(damages.empty());
		EXPECT_TRUE(message.HasSameData(panel_of_three(), false, true));
		EXPECT_EQ(bytes, flatten(message, form));
	}
}


TEST(MessageSalvage, OfACutMessageTheStartIsLeft)
{
	for (message_form form : { B_R5_FORM, B_R5_WIDE_FORM, B_HAIKU_FORM }) {
		const std::string bytes = flatten(panel_of_three(), form);
		const size_t cut = bytes.find("third") - 60; // in the second child
		BMessage message;
		std::vector<message_damage> damages;
		ASSERT_EQ(B_OK, salvage_message(&message, bytes.data(), cut, &damages));
		EXPECT_FALSE(damages.empty());
		for (const message_damage& damage : damages)
			EXPECT_LE(damage.offset, cut);
		EXPECT_STREQ("BView", message.FindString("class"));
		EXPECT_EQ(3, message.FindInt32("numbers", 2));
		BMessage child;
		ASSERT_EQ(B_OK, message.FindMessage("_views", 0, &child));
		EXPECT_STREQ("Press this button", child.FindString("_label"));
		ASSERT_EQ(B_OK, message.FindMessage("_views", 1, &child));
		EXPECT_STREQ("BButton", child.FindString("class"));
		EXPECT_FALSE(message.HasString("last"));
	}
}


TEST(MessageSalvage, ADamagedChildLosesItsOwnFieldsOnly)
{
	std::string bytes = flatten(panel_of_three(), B_R5_FORM);
	const size_t name = bytes.find("second");
	bytes[name - 4] = char(0xff); // the size of the text
	bytes[name - 3] = char(0xff);
	BMessage message;
	EXPECT_EQ(B_OK, read(bytes, &message)); // it is the child that cannot be read
	BMessage child;
	EXPECT_NE(B_OK, message.FindMessage("_views", 1, &child));
	std::vector<message_damage> damages;
	ASSERT_EQ(B_OK, salvage_message(&message, bytes.data(), bytes.size(), &damages));
	ASSERT_EQ(1u, damages.size());
	EXPECT_EQ(name - 4, damages[0].offset);
	ASSERT_EQ(B_OK, message.FindMessage("_views", 1, &child));
	EXPECT_STREQ("BButton", child.FindString("class"));
	EXPECT_FALSE(child.HasString("_name"));
	EXPECT_STREQ("Press this button", child.FindString("_label"));
	ASSERT_EQ(B_OK, message.FindMessage("_views", 2, &child));
	EXPECT_STREQ("third", child.FindString("_name"));
	EXPECT_STREQ("the end", message.FindString("last"));
}


TEST(MessageSalvage, NoCutAndNoFlippedBitDoesHarm)
{
	for (message_form form : { B_R5_FORM, B_HAIKU_FORM }) {
		const std::string bytes = flatten(panel_of_three(), form);
		const auto salvage = [&](const std::string& damaged) {
			BMessage message;
			if (salvage_message(&message, damaged.data(), damaged.size()) != B_OK)
				return;
			BMessage back;
			ASSERT_EQ(B_OK, read(flatten(message, form), &back));
			EXPECT_TRUE(back.HasSameData(message, false, true));
		};
		for (size_t length = 0; length < bytes.size(); length++)
			salvage(bytes.substr(0, length));
		for (size_t i = 0; i < bytes.size() * 8; i++) {
			std::string flipped = bytes;
			flipped[i / 8] = char(flipped[i / 8] ^ (1 << (i % 8)));
			salvage(flipped);
		}
	}
}


TEST(MessageForm, NamesTooLongForOneFormAreCutInIt)
{
	// In the other byte order, so that the fields are copied.
	std::string bytes = "1FMH"; // FMH1 of the big end
	const auto put = [&](uint32 value) {
		for (int shift = 24; shift >= 0; shift -= 8)
			bytes += char(value >> shift);
	};
	put(7); // what
	put(1); // valid
	for (int i = 0; i < 6; i++)
		put(0xffffffff);
	put(301 + 4); // data
	put(1); // fields
	put(5);
	for (int i = 0; i < 5; i++)
		put(0xffffffff);
	put(3 << 16 | 301); // flags and the name's length
	put(B_INT32_TYPE);
	put(1);
	put(4);
	put(0);
	put(0xffffffff);
	bytes += std::string(300, 'n') + '\0';
	put(12345);
	BMessage message;
	ASSERT_EQ(B_OK, read(bytes, &message));
	EXPECT_EQ(12345, message.FindInt32(std::string(300, 'n').c_str()));
	message.AddInt32("next", 6);
	BMessage back;
	ASSERT_EQ(B_OK, read(flatten(message, B_R5_FORM), &back));
	EXPECT_EQ(12345, back.FindInt32(std::string(255, 'n').c_str()));
	EXPECT_EQ(6, back.FindInt32("next"));
}
