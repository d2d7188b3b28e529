#include <cstring>
#include <string>
#include <thread>
#include <vector>

#include <gtest/gtest.h>

#include <Entry.h>
#include <Flattenable.h>
#include <Message.h>
#include <Messenger.h>
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


class Word : public BFlattenable {
public:
	explicit Word(uint16 value = 0) : fValue(value) {}

	bool IsFixedSize() const override { return true; }
	type_code TypeCode() const override { return 'WORD'; }
	ssize_t FlattenedSize() const override { return 2; }
	status_t Flatten(void* buffer, ssize_t size) const override
	{
		if (size < 2)
			return B_BAD_VALUE;
		memcpy(buffer, &fValue, 2);
		return B_OK;
	}
	status_t Unflatten(type_code code, const void* buffer, ssize_t size) override
	{
		if (code != TypeCode() || size != 2)
			return B_BAD_DATA;
		memcpy(&fValue, buffer, 2);
		return B_OK;
	}

	uint16 Value() const { return fValue; }

private:
	uint16 fValue;
};


std::string
bytes_of(const BMessage& message, const char* name, type_code type, int32 index = 0)
{
	const void* data;
	ssize_t size;
	if (message.FindData(name, type, index, &data, &size) != B_OK)
		return "?";
	return std::string(static_cast<const char*>(data), size_t(size));
}

} // namespace


TEST(Message, IsEmptyAtFirst)
{
	const BMessage message;
	EXPECT_EQ(0u, message.what);
	EXPECT_TRUE(message.IsEmpty());
	EXPECT_EQ(0, message.CountNames(B_ANY_TYPE));
	EXPECT_EQ(18, message.FlattenedSize());
	EXPECT_EQ(uint32('abcd'), BMessage('abcd').what);
}


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


TEST(Message, AddRefusesWhatDoesNotFitTheField)
{
	BMessage message;
	ASSERT_EQ(B_OK, message.AddInt32("n", 1));
	EXPECT_EQ(B_BAD_TYPE, message.AddString("n", "text"));
	EXPECT_EQ(B_BAD_VALUE, message.AddData("n", B_INT32_TYPE, "12", 2));
	EXPECT_EQ(B_OK, message.AddData("n", B_ANY_TYPE, "1234", 4));
	EXPECT_EQ("n(2)", fields_of(message));

	EXPECT_EQ(B_BAD_VALUE, message.AddData("x", B_RAW_TYPE, nullptr, 4));
	EXPECT_EQ(B_BAD_VALUE, message.AddData("x", B_RAW_TYPE, "1", 0));
	EXPECT_EQ(B_BAD_VALUE, message.AddData("x", B_RAW_TYPE, "1", -1));
	EXPECT_EQ(B_BAD_VALUE, message.AddData(nullptr, B_RAW_TYPE, "1", 1));
	EXPECT_EQ(B_BAD_VALUE, message.AddString("x", static_cast<const char*>(nullptr)));
	EXPECT_EQ(B_BAD_VALUE, message.AddMessage("x", nullptr));
	EXPECT_EQ(B_BAD_VALUE, message.AddFlat("x", static_cast<BFlattenable*>(nullptr)));
	EXPECT_EQ(B_BAD_VALUE, message.AddInt32(std::string(256, 'n').c_str(), 1));
	EXPECT_EQ(B_OK, message.AddInt32(std::string(255, 'n').c_str(), 1));
	EXPECT_EQ(B_OK, message.AddInt32("", 1));
	EXPECT_TRUE(message.HasInt32(""));
}


TEST(Message, AFieldIsAsFixedAsItsFirstItem)
{
	BMessage message;
	ASSERT_EQ(B_OK, message.AddData("fixed", B_RAW_TYPE, "1234", 4, true));
	EXPECT_EQ(B_BAD_VALUE, message.AddData("fixed", B_RAW_TYPE, "12345", 5, false));
	ASSERT_EQ(B_OK, message.AddData("variable", B_RAW_TYPE, "1234", 4, false));
	EXPECT_EQ(B_OK, message.AddData("variable", B_RAW_TYPE, "12345", 5, true));

	type_code type;
	int32 count;
	bool fixed;
	ASSERT_EQ(B_OK, message.GetInfo("fixed", &type, &fixed));
	EXPECT_EQ(type_code(B_RAW_TYPE), type);
	EXPECT_TRUE(fixed);
	ASSERT_EQ(B_OK, message.GetInfo("variable", &type, &count, &fixed));
	EXPECT_EQ(2, count);
	EXPECT_FALSE(fixed);
}


TEST(Message, LookUpTellsWhatIsWrong)
{
	BMessage message;
	message.AddInt32("n", 7);
	const void* data = &message;
	ssize_t size = 99;
	EXPECT_EQ(B_BAD_VALUE, message.FindData("n", B_INT32_TYPE, 0, nullptr, &size));
	EXPECT_EQ(B_BAD_VALUE, message.FindData(nullptr, B_INT32_TYPE, 0, &data, &size));
	EXPECT_EQ(nullptr, data);
	EXPECT_EQ(B_NAME_NOT_FOUND, message.FindData("m", B_INT32_TYPE, 0, &data, &size));
	EXPECT_EQ(B_BAD_TYPE, message.FindData("n", B_FLOAT_TYPE, 0, &data, &size));
	EXPECT_EQ(B_BAD_INDEX, message.FindData("n", B_INT32_TYPE, 1, &data, &size));
	EXPECT_EQ(B_BAD_INDEX, message.FindData("n", B_INT32_TYPE, -1, &data, &size));
	EXPECT_EQ(99, size);
	EXPECT_EQ(B_OK, message.FindData("n", B_ANY_TYPE, 0, &data, nullptr));
	EXPECT_TRUE(message.HasData("n", B_ANY_TYPE));
	EXPECT_FALSE(message.HasData(nullptr, B_ANY_TYPE));
	EXPECT_FALSE(message.HasInt32("n", 1));
	EXPECT_FALSE(message.HasFloat("n"));
}


TEST(Message, AFailedLookUpGivesTheDefault)
{
	const BMessage message;
	int32 number = 5;
	EXPECT_EQ(B_NAME_NOT_FOUND, message.FindInt32("n", &number));
	EXPECT_EQ(0, number);
	BRect rect(1, 2, 3, 4);
	message.FindRect("n", &rect);
	EXPECT_EQ(BRect(), rect);
	BPoint point(1, 2);
	message.FindPoint("n", &point);
	EXPECT_EQ(BPoint(), point);
	bool flag = true;
	message.FindBool("n", &flag);
	EXPECT_FALSE(flag);
	const char* text = "x";
	message.FindString("n", &text);
	EXPECT_EQ(nullptr, text);
	BString string("x");
	message.FindString("n", &string);
	EXPECT_EQ("", string);
	void* pointer = &number;
	message.FindPointer("n", &pointer);
	EXPECT_EQ(nullptr, pointer);
	BMessage nested('full');
	nested.AddInt32("a", 1);
	message.FindMessage("n", &nested);
	EXPECT_EQ(0u, nested.what);
	EXPECT_TRUE(nested.IsEmpty());
	EXPECT_EQ(0.0f, message.FindFloat("n"));
	EXPECT_EQ(nullptr, message.FindString("n"));
	EXPECT_EQ(3, message.GetInt32("n", 3));
	EXPECT_STREQ("d", message.GetString("n", "d"));
}


TEST(Message, EveryTypeComesBack)
{
	BMessage message;
	message.AddRect("rect", BRect(1, 2, 3, 4));
	message.AddPoint("point", BPoint(5, 6));
	message.AddInt8("int8", -8);
	message.AddUInt8("uint8", 200);
	message.AddInt16("int16", -1600);
	message.AddUInt16("uint16", 60000);
	message.AddInt32("int32", -320000);
	message.AddUInt32("uint32", 4000000000u);
	message.AddInt64("int64", -64000000000);
	message.AddUInt64("uint64", 1ull << 63);
	message.AddBool("bool", true);
	message.AddFloat("float", 1.5f);
	message.AddDouble("double", -2.25);
	message.AddColor("color", rgb_color { 1, 2, 3, 4 });
	message.AddString("string", "text");
	message.AddString("string", BString("more"));
	message.AddPointer("pointer", &message);
	Word zero(0);
	message.AddFlat("flat", &zero);
	const Word word(777);
	message.AddFlat("flat", &word);
	BMessage nested('nest');
	nested.AddInt32("n", 1);
	message.AddMessage("message", &nested);

	EXPECT_EQ(BRect(1, 2, 3, 4), message.FindRect("rect"));
	EXPECT_EQ(BPoint(5, 6), message.FindPoint("point"));
	EXPECT_EQ(-8, message.FindInt8("int8"));
	EXPECT_EQ(200, message.GetUInt8("uint8", 0));
	EXPECT_EQ(-1600, message.FindInt16("int16"));
	EXPECT_EQ(60000, message.GetUInt16("uint16", 0));
	EXPECT_EQ(-320000, message.FindInt32("int32"));
	EXPECT_EQ(4000000000u, message.GetUInt32("uint32", 0));
	EXPECT_EQ(-64000000000, message.FindInt64("int64"));
	EXPECT_EQ(1ull << 63, message.GetUInt64("uint64", 0));
	EXPECT_TRUE(message.FindBool("bool"));
	EXPECT_EQ(1.5f, message.FindFloat("float"));
	EXPECT_EQ(-2.25, message.FindDouble("double"));
	EXPECT_EQ((rgb_color { 1, 2, 3, 4 }), message.GetColor("color", rgb_color {}));
	EXPECT_STREQ("text", message.FindString("string"));
	EXPECT_STREQ("more", message.FindString("string", 1));
	EXPECT_EQ(&message, message.GetPointer("pointer"));
	Word found;
	EXPECT_EQ(B_OK, message.FindFlat("flat", 1, &found));
	EXPECT_EQ(777, found.Value());
	BMessage foundMessage;
	EXPECT_EQ(B_OK, message.FindMessage("message", &foundMessage));
	EXPECT_EQ(uint32('nest'), foundMessage.what);
	EXPECT_EQ(1, foundMessage.FindInt32("n"));
}


TEST(Message, BoolsAreReadAsTrueUnlessZero)
{
	BMessage message;
	message.AddData("b", B_BOOL_TYPE, "\x02", 1);
	message.AddData("b", B_BOOL_TYPE, "\0", 1);
	EXPECT_TRUE(message.FindBool("b", 0));
	EXPECT_FALSE(message.FindBool("b", 1));
	message.AddBool("c", true);
	EXPECT_EQ("\x01", bytes_of(message, "c", B_BOOL_TYPE));
}


TEST(Message, AShorterItemThanTheTypeIsRefused)
{
	BMessage message;
	message.AddData("n", B_INT32_TYPE, "12", 2);
	int32 number = 9;
	EXPECT_EQ(B_BAD_VALUE, message.FindInt32("n", &number));
	EXPECT_EQ(0, number);
	message.AddData("r", B_RECT_TYPE, "12345678", 8, false);
	EXPECT_EQ(BRect(), message.FindRect("r"));
}


TEST(Message, AStringWithoutEndIsGivenOnlyAsACopy)
{
	BMessage message;
	message.AddData("s", B_STRING_TYPE, "abc", 3, false);
	const char* text;
	EXPECT_EQ(B_BAD_DATA, message.FindString("s", &text));
	EXPECT_EQ(nullptr, text);
	BString string;
	EXPECT_EQ(B_OK, message.FindString("s", &string));
	EXPECT_EQ("abc", string);
}


TEST(Message, InfoByIndexCountsAllOrTheOnesOfAType)
{
	BMessage message;
	EXPECT_EQ(B_BAD_INDEX, message.GetInfo(B_INT32_TYPE, 0, nullptr, nullptr));
	message.AddInt32("a", 1);
	message.AddString("b", "");
	message.AddInt32("c", 1);
	char* name = nullptr;
	type_code type = 0;
	int32 count = 0;
	EXPECT_EQ(B_OK, message.GetInfo(B_INT32_TYPE, 1, &name, &type, &count));
	EXPECT_STREQ("c", name);
	EXPECT_EQ(type_code(B_INT32_TYPE), type);
	EXPECT_EQ(1, count);
	EXPECT_EQ(B_BAD_INDEX, message.GetInfo(B_INT32_TYPE, 2, &name, &type));
	EXPECT_EQ(B_BAD_TYPE, message.GetInfo(B_FLOAT_TYPE, 0, &name, &type));
	EXPECT_EQ(B_BAD_INDEX, message.GetInfo(B_FLOAT_TYPE, 3, &name, &type));
	EXPECT_EQ(B_BAD_INDEX, message.GetInfo(B_ANY_TYPE, -1, &name, &type));
	EXPECT_STREQ("c", name);
	EXPECT_EQ(2, message.CountNames(B_INT32_TYPE));
	EXPECT_EQ(0, message.CountNames(B_FLOAT_TYPE));

	count = 5;
	EXPECT_EQ(B_NAME_NOT_FOUND, message.GetInfo("x", &type, &count));
	EXPECT_EQ(0, count);
	EXPECT_EQ(B_BAD_VALUE, message.GetInfo(static_cast<const char*>(nullptr), &type, &count));
}


TEST(Message, ReplaceKeepsThePlaceAndNeverAdds)
{
	BMessage message;
	message.AddString("a", "one");
	message.AddString("a", "two");
	message.AddInt32("b", 1);
	EXPECT_EQ(B_OK, message.ReplaceString("a", 1, "a longer text than before"));
	EXPECT_EQ(B_OK, message.ReplaceInt32("b", 2));
	EXPECT_STREQ("one", message.FindString("a", 0));
	EXPECT_STREQ("a longer text than before", message.FindString("a", 1));
	EXPECT_EQ(2, message.FindInt32("b"));
	EXPECT_EQ("a(2) b(1)", fields_of(message));

	EXPECT_EQ(B_NAME_NOT_FOUND, message.ReplaceInt32("x", 1));
	EXPECT_EQ(B_BAD_TYPE, message.ReplaceFloat("b", 1));
	EXPECT_EQ(B_BAD_INDEX, message.ReplaceInt32("b", 1, 1));
	EXPECT_EQ(B_BAD_VALUE, message.ReplaceData("b", B_INT32_TYPE, "12", 2));
	EXPECT_EQ(B_BAD_VALUE, message.ReplaceData("b", B_INT32_TYPE, nullptr, 4));
	EXPECT_EQ(B_OK, message.ReplaceData("a", B_ANY_TYPE, "x", 2));
	EXPECT_STREQ("x", message.FindString("a", 0));
}


TEST(Message, SetReplacesTheFirstItemOrAdds)
{
	BMessage message;
	EXPECT_EQ(B_OK, message.SetInt32("a", 1));
	EXPECT_EQ(B_OK, message.SetInt32("a", 2));
	EXPECT_EQ(2, message.FindInt32("a"));
	EXPECT_EQ(B_BAD_TYPE, message.SetString("a", "text"));
	EXPECT_EQ(B_OK, message.SetString("s", "text"));
	EXPECT_EQ("a(1) s(1)", fields_of(message));
}


TEST(Message, RemoveTellsWhatIsWrong)
{
	BMessage message;
	message.AddInt32("a", 1);
	EXPECT_EQ(B_BAD_INDEX, message.RemoveData("a", -1));
	EXPECT_EQ(B_BAD_VALUE, message.RemoveData(nullptr));
	EXPECT_EQ(B_NAME_NOT_FOUND, message.RemoveData("b"));
	EXPECT_EQ(B_BAD_INDEX, message.RemoveData("a", 1));
	EXPECT_EQ(B_BAD_VALUE, message.RemoveName(nullptr));
	EXPECT_EQ(B_NAME_NOT_FOUND, message.RemoveName("b"));
	EXPECT_EQ(B_OK, message.RemoveName("a"));
	EXPECT_TRUE(message.IsEmpty());
}


TEST(Message, RenameKeepsThePlace)
{
	BMessage message;
	message.AddInt32("a", 1);
	message.AddString("b", "one");
	message.AddString("b", "two");
	message.AddInt32("c", 3);
	EXPECT_EQ(B_OK, message.Rename("b", "a longer name"));
	EXPECT_EQ("a(1) a longer name(2) c(1)", fields_of(message));
	EXPECT_STREQ("two", message.FindString("a longer name", 1));
	EXPECT_FALSE(message.HasString("b"));
	EXPECT_EQ(B_NAME_NOT_FOUND, message.Rename("b", "d"));
	EXPECT_EQ(B_BAD_VALUE, message.Rename("a", nullptr));

	BMessage back;
	std::string bytes(size_t(message.FlattenedSize()), '\0');
	message.Flatten(bytes.data(), ssize_t(bytes.size()));
	ASSERT_EQ(B_OK, back.Unflatten(bytes.data()));
	EXPECT_EQ(fields_of(message), fields_of(back));
}


TEST(Message, MakeEmptyKeepsTheCode)
{
	BMessage message('code');
	message.AddInt32("a", 1);
	EXPECT_EQ(B_OK, message.MakeEmpty());
	EXPECT_EQ(uint32('code'), message.what);
	EXPECT_TRUE(message.IsEmpty());
}


TEST(Message, ACopyDoesNotSeeLaterChanges)
{
	BMessage original('orig');
	original.AddString("s", "first");
	BMessage copy(original);
	BMessage assigned;
	assigned = original;
	original.ReplaceString("s", "changed");
	copy.AddInt32("n", 1);
	original.what = 'late';
	EXPECT_EQ(uint32('orig'), copy.what);
	EXPECT_STREQ("first", copy.FindString("s"));
	EXPECT_STREQ("first", assigned.FindString("s"));
	EXPECT_STREQ("changed", original.FindString("s"));
	EXPECT_FALSE(original.HasInt32("n"));
	original = *&original;
	EXPECT_STREQ("changed", original.FindString("s"));
}


TEST(Message, AnAddedMessageDoesNotSeeLaterChanges)
{
	BMessage inner('in_1');
	inner.AddInt32("n", 1);
	BMessage outer;
	outer.AddMessage("m", &inner);
	inner.what = 'in_2';
	inner.ReplaceInt32("n", 2);
	outer.AddMessage("m", &inner);

	BMessage found;
	ASSERT_EQ(B_OK, outer.FindMessage("m", 0, &found));
	EXPECT_EQ(uint32('in_1'), found.what);
	EXPECT_EQ(1, found.FindInt32("n"));
	found.ReplaceInt32("n", 3);
	ASSERT_EQ(B_OK, outer.FindMessage("m", 0, &found));
	EXPECT_EQ(1, found.FindInt32("n"));
	ASSERT_EQ(B_OK, outer.FindMessage("m", 1, &found));
	EXPECT_EQ(uint32('in_2'), found.what);
	EXPECT_EQ(2, found.FindInt32("n"));

	ASSERT_EQ(B_OK, outer.ReplaceMessage("m", 0, &found));
	ASSERT_EQ(B_OK, outer.FindMessage("m", 0, &outer));
	EXPECT_EQ(2, outer.FindInt32("n"));
}


TEST(Message, ANestedMessageCanBeSeenAsItsBytes)
{
	BMessage inner('in_1');
	inner.AddInt32("n", 1);
	BMessage outer;
	outer.AddMessage("m", &inner);
	const std::string bytes = bytes_of(outer, "m", B_MESSAGE_TYPE);
	BMessage read;
	ASSERT_EQ(B_OK, read.Unflatten(bytes.data()));
	EXPECT_EQ(uint32('in_1'), read.what);
	EXPECT_TRUE(read.HasSameData(inner));
	outer.AddData("m", B_MESSAGE_TYPE, bytes.data(), ssize_t(bytes.size()));
	ASSERT_EQ(B_OK, outer.FindMessage("m", 1, &read));
	EXPECT_TRUE(read.HasSameData(inner));
}


TEST(Message, AppendAddsItemsInOrder)
{
	BMessage a('aaaa');
	a.AddInt32("n", 1);
	BMessage b('bbbb');
	b.AddInt32("n", 2);
	b.AddString("s", "text");
	EXPECT_EQ(B_OK, a.Append(b));
	EXPECT_EQ("n(2) s(1)", fields_of(a));
	EXPECT_EQ(uint32('aaaa'), a.what);
	EXPECT_EQ(B_OK, a.Append(a));
	EXPECT_EQ("n(4) s(2)", fields_of(a));
	BMessage c;
	c.AddInt32("z", 1);
	c.AddInt32("s", 1);
	EXPECT_EQ(B_BAD_TYPE, a.Append(c));
	EXPECT_EQ("n(4) s(2) z(1)", fields_of(a));
}


TEST(Message, SameDataIgnoresTheCodeAndIfAskedTheOrder)
{
	BMessage a('aaaa');
	a.AddInt32("n", 1);
	a.AddString("s", "text");
	BMessage b('bbbb');
	b.AddString("s", "text");
	b.AddInt32("n", 1);
	EXPECT_TRUE(a.HasSameData(b));
	EXPECT_FALSE(a.HasSameData(b, false));
	b.ReplaceInt32("n", 2);
	EXPECT_FALSE(a.HasSameData(b));
	b.RemoveName("n");
	EXPECT_FALSE(a.HasSameData(b));

	BMessage outerA;
	outerA.AddMessage("m", &a);
	BMessage outerB;
	b.AddInt32("n", 1);
	b.what = a.what;
	outerB.AddMessage("m", &b);
	EXPECT_FALSE(outerA.HasSameData(outerB));
	EXPECT_TRUE(outerA.HasSameData(outerB, true, true));
}


// A long series of changes against a plain model of what a message is.
TEST(Message, RandomChangesKeepAllItems)
{
	uint32 seed = 12345;
	const auto random = [&seed](uint32 below) {
		seed = seed * 1664525 + 1013904223;
		return (seed >> 8) % below;
	};
	struct Field {
		std::string name;
		bool isString;
		std::vector<std::string> items;
	};
	std::vector<Field> model;
	BMessage message;
	std::vector<BMessage> copies;
	for (int step = 0; step < 20000; step++) {
		const std::string name(1, char('a' + random(20)));
		size_t f = 0;
		while (f < model.size() && model[f].name != name)
			f++;
		const bool exists = f < model.size();
		const uint32 action = random(10);
		if (action < 5) {
			const bool isString = exists ? model[f].isString : random(2) == 0;
			std::string item(isString ? random(40) + 1 : 4, char('A' + random(26)));
			if (isString)
				item.back() = '\0';
			ASSERT_EQ(B_OK,
				message.AddData(name.c_str(), isString ? B_STRING_TYPE : B_INT32_TYPE, item.data(),
					ssize_t(item.size()), !isString));
			if (!exists)
				model.push_back({ name, isString, {} });
			model[f].items.push_back(item);
		} else if (exists && action < 8) {
			const uint32 i = random(uint32(model[f].items.size()));
			std::string item(model[f].isString ? random(60) + 1 : 4, char('a' + random(26)));
			if (model[f].isString)
				item.back() = '\0';
			ASSERT_EQ(B_OK,
				message.ReplaceData(
					name.c_str(), B_ANY_TYPE, int32(i), item.data(), ssize_t(item.size())));
			model[f].items[i] = item;
		} else if (exists && action == 8) {
			const uint32 i = random(uint32(model[f].items.size()));
			ASSERT_EQ(B_OK, message.RemoveData(name.c_str(), int32(i)));
			model[f].items.erase(model[f].items.begin() + i);
			if (model[f].items.empty())
				model.erase(model.begin() + long(f));
		} else if (random(20) == 0) {
			std::string bytes(size_t(message.FlattenedSize()), '\0');
			ASSERT_EQ(B_OK, message.Flatten(bytes.data(), ssize_t(bytes.size())));
			ASSERT_EQ(B_OK, message.Unflatten(bytes.data()));
		} else if (random(10) == 0)
			copies.push_back(message);

		if (step % 50 != 0)
			continue;
		ASSERT_EQ(int32(model.size()), message.CountNames(B_ANY_TYPE));
		for (size_t i = 0; i < model.size(); i++) {
			char* found;
			type_code type;
			int32 count;
			ASSERT_EQ(B_OK, message.GetInfo(B_ANY_TYPE, int32(i), &found, &type, &count));
			ASSERT_EQ(model[i].name, found);
			ASSERT_EQ(int32(model[i].items.size()), count);
			for (int32 k = 0; k < count; k++)
				ASSERT_EQ(model[i].items[size_t(k)], bytes_of(message, found, B_ANY_TYPE, k));
		}
	}
}


TEST(Message, ThreadsMayUseCopiesAtOnce)
{
	BMessage inner('innr');
	inner.AddString("text", "shared");
	BMessage original;
	for (int32 i = 0; i < 20; i++)
		original.AddInt32(std::to_string(i).c_str(), i);
	original.AddMessage("m", &inner);
	std::vector<std::thread> threads;
	for (int32 t = 0; t < 4; t++) {
		threads.emplace_back([copy = original, t]() mutable {
			for (int32 i = 0; i < 200; i++) {
				BMessage again(copy);
				char* name;
				type_code type;
				EXPECT_EQ(B_OK, again.GetInfo(B_ANY_TYPE, 3, &name, &type));
				EXPECT_STREQ("3", name);
				EXPECT_EQ("1BOF", bytes_of(again, "m", B_MESSAGE_TYPE).substr(0, 4));
				again.ReplaceInt32("3", t);
				BMessage found;
				EXPECT_EQ(B_OK, again.FindMessage("m", &found));
				found.AddInt32("n", i);
				EXPECT_LT(0, again.FlattenedSize());
			}
			EXPECT_EQ(3, copy.FindInt32("3"));
		});
	}
	for (std::thread& thread : threads)
		thread.join();
}


TEST(Message, SpecifiersAreAStack)
{
	BMessage message('PGET');
	EXPECT_FALSE(message.HasSpecifiers());
	int32 index;
	EXPECT_EQ(B_BAD_SCRIPT_SYNTAX, message.GetCurrentSpecifier(&index));
	EXPECT_EQ(B_OK, message.AddSpecifier("Frame"));
	EXPECT_EQ(B_OK, message.AddSpecifier("Window", 2));
	BMessage specifier;
	int32 form;
	const char* property;
	ASSERT_EQ(B_OK, message.GetCurrentSpecifier(&index, &specifier, &form, &property));
	EXPECT_EQ(1, index);
	EXPECT_EQ(2, form);
	EXPECT_STREQ("Window", property);
	EXPECT_EQ(2, specifier.FindInt32("index"));
	EXPECT_EQ(B_OK, message.PopSpecifier());
	ASSERT_EQ(B_OK, message.GetCurrentSpecifier(&index, &specifier, &form, &property));
	EXPECT_STREQ("Frame", property);
	EXPECT_EQ(B_OK, message.PopSpecifier());
	EXPECT_EQ(B_BAD_VALUE, message.PopSpecifier());
}


TEST(Message, RefsComeBackAndBadOnesDoNot)
{
	BMessage message;
	const entry_ref ref(dev_t(5), ino_t(1234567890123), "name");
	EXPECT_EQ(B_OK, message.AddRef("r", &ref));
	const std::string bytes = bytes_of(message, "r", B_REF_TYPE);
	EXPECT_EQ(17u, bytes.size());
	entry_ref found;
	EXPECT_EQ(B_OK, message.FindRef("r", &found));
	EXPECT_TRUE(found == ref);
	message.AddData("bad", B_REF_TYPE, "123456789012x", 13, false);
	EXPECT_EQ(B_BAD_VALUE, message.FindRef("bad", &found));
	EXPECT_EQ(nullptr, found.name);
}


TEST(Message, AddedToItselfItIsAddedAsItWas)
{
	BMessage message('self');
	message.AddInt32("number", 5);
	ASSERT_EQ(B_OK, message.AddMessage("own", &message));
	ASSERT_EQ(B_OK, message.AddMessage("own", &message));
	BMessage nested;
	ASSERT_EQ(B_OK, message.FindMessage("own", 1, &nested));
	EXPECT_EQ(5, nested.FindInt32("number"));
	BMessage first;
	ASSERT_EQ(B_OK, nested.FindMessage("own", &first));
	EXPECT_FALSE(first.HasMessage("own"));
	EXPECT_GT(message.FlattenedSize(), 0);
}
