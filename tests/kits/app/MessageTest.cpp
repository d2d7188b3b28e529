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
fields_of(const BMessage& message)
{
	std::string text;
	char* name;
	type_code type;
	int32 count;
	for (int32 i = 0; message.GetInfo(B_ANY_TYPE, i, &name, &type, &count) == B_OK; i++)
		text += std::string(i > 0 ? " " : "") + name + "(" + std::to_string(count) + ")";
	return text;
}

} // namespace


TEST(Message, NewFieldsGoToTheEndAndMoreItemsStayInPlace)
{
	BMessage message;
	EXPECT_EQ(B_OK, message.AddInt32("a", 1));
	EXPECT_EQ(B_OK, message.AddString("b", "two"));
	EXPECT_EQ(B_OK, message.AddBool("c", true));
	EXPECT_EQ(B_OK, message.AddInt32("a", 4));
	EXPECT_EQ("a(2) b(1) c(1)", fields_of(message));

	EXPECT_EQ(B_OK, message.RemoveData("a", 0));
	EXPECT_EQ(4, message.FindInt32("a"));
	EXPECT_EQ(B_OK, message.RemoveData("a", 0));
	EXPECT_EQ("b(1) c(1)", fields_of(message));
	EXPECT_EQ(B_OK, message.AddInt32("a", 5));
	EXPECT_EQ("b(1) c(1) a(1)", fields_of(message));
}
