// Messages in which several fields have one name, as only bytes from outside and Rename() make them.

#include <string>
#include <vector>

#include <gtest/gtest.h>

#include <Message.h>
#include <MessageForm.h>
#include <String.h>

#include "support/Dump.h"

namespace {

constexpr int32 kFieldCount = 5;


BMessage
child(const char* name)
{
	BMessage message('chld');
	message.AddString("_name", name);
	return message;
}


// Three fields "twin" of different types around others.
BMessage
with_twins()
{
	BMessage message('twin');
	message.AddInt32("before", 1);
	message.AddInt32("twin", 2);
	message.AddInt32("twin", 3);
	message.AddString("between", "between");
	message.AddString("second", "the second");
	const BMessage third = child("the third");
	message.AddMessage("third", &third);
	EXPECT_EQ(B_OK, message.Rename("second", "twin"));
	EXPECT_EQ(B_OK, message.Rename("third", "twin"));
	return message;
}


std::string
flatten(const BMessage& message, message_form form)
{
	std::string bytes(size_t(flattened_message_size(message, form)), '\0');
	EXPECT_EQ(B_OK, flatten_message(message, form, bytes.data(), ssize_t(bytes.size())));
	return bytes;
}


BMessage
read(const std::string& bytes)
{
	BMessage message;
	EXPECT_EQ(B_OK, unflatten_message(&message, bytes.data(), bytes.size()));
	return message;
}


// All fields with their values, by number.
std::string
text_of(const BMessage& message)
{
	std::string text;
	char* name;
	type_code type;
	int32 count;
	for (int32 i = 0; message.GetInfo(B_ANY_TYPE, i, &name, &type, &count) == B_OK; i++) {
		text += std::string(name) + (is_first_of_its_name(message, i) ? "=" : "'=");
		for (int32 k = 0; k < count; k++) {
			BMessage nested;
			const void* data = nullptr;
			ssize_t size = 0;
			EXPECT_EQ(B_OK, find_field_data(message, i, k, &data, &size));
			const char* bytes = static_cast<const char*>(data);
			if (find_field_message(message, i, k, &nested) == B_OK)
				text += "{" + text_of(nested) + "}";
			else if (type == B_STRING_TYPE)
				text += std::string(bytes, size_t(size) - 1);
			else
				text += std::to_string(int(bytes[0]));
			text += k + 1 < count ? "," : " ";
		}
	}
	return text;
}


const char* const kText =
	"before=1 twin=2,3 between=between twin'=the second twin'={_name=the third } ";

} // namespace


TEST(TwinFields, AreEnumeratedAndFoundByNumber)
{
	const BMessage message = with_twins();
	EXPECT_EQ(kFieldCount, message.CountNames(B_ANY_TYPE));
	EXPECT_EQ(kText, text_of(message));
	const void* data;
	ssize_t size;
	BMessage nested;
	EXPECT_EQ(B_BAD_INDEX, find_field_data(message, kFieldCount, 0, &data, &size));
	EXPECT_EQ(B_BAD_INDEX, find_field_data(message, -1, 0, &data, &size));
	EXPECT_EQ(B_BAD_INDEX, find_field_data(message, 1, 2, &data, &size));
	EXPECT_EQ(B_BAD_TYPE, find_field_message(message, 1, 0, &nested));
	EXPECT_FALSE(is_first_of_its_name(message, kFieldCount));
}


TEST(TwinFields, NamesFindTheFirst)
{
	BMessage message = with_twins();
	EXPECT_EQ(3, message.FindInt32("twin", 1));
	EXPECT_FALSE(message.HasString("twin"));
	EXPECT_EQ(B_OK, message.ReplaceInt32("twin", 1, 4));
	EXPECT_EQ(B_OK, message.AddInt32("twin", 5));
	EXPECT_EQ("before=1 twin=2,4,5 between=between twin'=the second twin'={_name=the third } ",
		text_of(message));
	EXPECT_EQ(B_OK, message.RemoveName("twin"));
	EXPECT_EQ(
		"before=1 between=between twin=the second twin'={_name=the third } ", text_of(message));
}


TEST(TwinFields, GoThroughEveryForm)
{
	const BMessage message = with_twins();
	const std::string r5 = flatten(message, B_R5_FORM);
	for (const message_form form : { B_R5_FORM, B_R5_WIDE_FORM, B_HAIKU_FORM }) {
		const std::string bytes = flatten(message, form);
		const BMessage there = read(bytes);
		EXPECT_EQ(kText, text_of(there)) << form;
		EXPECT_EQ(bytes, flatten(there, form)) << form;
		EXPECT_EQ(r5, flatten(there, B_R5_FORM)) << form;
		EXPECT_TRUE(message.HasSameData(there, false, true)) << form;
	}
}


TEST(TwinFields, StayWhenOthersChange)
{
	BMessage message = read(flatten(with_twins(), B_R5_FORM));
	const BMessage copy(message);
	message.RemoveName("before");
	message.ReplaceString("between", std::string(9000, 'b').c_str());
	message.ReplaceString("between", "short");
	EXPECT_EQ("twin=2,3 between=short twin'=the second twin'={_name=the third } ",
		text_of(read(flatten(message, B_R5_FORM))));
	EXPECT_EQ(kText, text_of(copy));
}


TEST(TwinFields, StayAmongManyFields)
{
	BMessage message = with_twins();
	for (int32 i = 0; i < 100; i++)
		message.AddInt32(std::to_string(i).c_str(), i);
	const BMessage there = read(flatten(message, B_R5_FORM));
	EXPECT_EQ(3, there.FindInt32("twin", 1));
	EXPECT_EQ(text_of(message), text_of(there));
	EXPECT_EQ(kText, text_of(there).substr(0, std::string(kText).size()));
}


// Turns the fields into another order: the i-th of one name stays the i-th.
TEST(TwinFields, AreComparedWithThoseInTheirPlace)
{
	const BMessage message = with_twins();
	BMessage moved(message);
	moved.RemoveName("before");
	moved.AddInt32("before", 1);
	EXPECT_TRUE(message.HasSameData(moved, true, true));
	EXPECT_FALSE(message.HasSameData(moved, false, true));

	BMessage first;
	first.AddInt32("a", 1);
	first.AddInt32("other", 0);
	first.AddInt32("b", 2);
	BMessage second(first);
	first.Rename("b", "a");
	second.Rename("a", "c");
	second.Rename("b", "a");
	second.Rename("c", "a");
	EXPECT_TRUE(first.HasSameData(second));
	second.ReplaceInt32("a", 2);
	EXPECT_FALSE(first.HasSameData(second));
	// The values are the same, but the second of the name comes first.
	BMessage third;
	third.AddInt32("other", 0);
	third.AddInt32("b", 2);
	third.AddInt32("a", 1);
	third.Rename("b", "a");
	EXPECT_FALSE(first.HasSameData(third));
	BMessage fourth;
	fourth.AddInt32("other", 0);
	fourth.AddInt32("a", 1);
	fourth.AddInt32("b", 2);
	fourth.Rename("b", "a");
	EXPECT_TRUE(first.HasSameData(fourth));
}


TEST(TwinFields, ADifferenceInTheLaterOnesIsSeen)
{
	const BMessage message = with_twins();
	std::string bytes = flatten(message, B_R5_FORM);
	bytes[bytes.find("the second")] = 'T';
	const BMessage changed = read(bytes);
	EXPECT_FALSE(message.HasSameData(changed, true, true));
	EXPECT_FALSE(message.HasSameData(changed, false, true));
	EXPECT_NE("", test::first_difference(message, changed));
}


// A hundred thousand fields without a name must not take the square of their time.
TEST(TwinFields, ManyAreComparedQuickly)
{
	constexpr int32 kMany = 100000;
	const char field[] = { 0x0f, 'G', 'N', 'O', 'L', 4, 0, 7, 0, 0, 0 };
	std::string bytes = flatten(BMessage('many'), B_R5_FORM);
	const std::string end = bytes.substr(bytes.size() - 1);
	bytes.pop_back();
	for (int32 i = 0; i < kMany; i++)
		bytes.append(field, sizeof(field));
	bytes += end;
	const uint32 size = uint32(bytes.size());
	memcpy(bytes.data() + 8, &size, sizeof(size));
	const BMessage message = read(bytes);
	ASSERT_EQ(kMany, message.CountNames(B_ANY_TYPE));
	BMessage other(message);
	other.AddInt32("new", 1);
	BMessage third = read(bytes);
	third.AddInt32("new", 1);
	EXPECT_TRUE(other.HasSameData(third, true, true));
	EXPECT_TRUE(is_first_of_its_name(message, 0));
	EXPECT_FALSE(is_first_of_its_name(message, kMany - 1));
	EXPECT_EQ(bytes.substr(12), flatten(message, B_R5_FORM).substr(12));
}
