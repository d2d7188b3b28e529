#include <climits>
#include <string>

#include <gtest/gtest.h>

#include <String.h>


TEST(String, IsMadeFromTextsAndParts)
{
	EXPECT_STREQ("", BString().String());
	EXPECT_STREQ("", BString(static_cast<const char*>(nullptr)).String());
	EXPECT_STREQ("hello", BString("hello").String());
	EXPECT_STREQ("hel", BString("hello", 3).String());
	EXPECT_STREQ("xxx", BString('x', 3).String());
	EXPECT_EQ(5, BString("hello").Length());
	EXPECT_EQ(3,
		BString("a\xc3\xa9"
				"b")
			.CountChars());
	BString source("moved");
	BString moved(std::move(source));
	EXPECT_EQ("moved", moved);
	EXPECT_EQ("", source);
	BString format;
	EXPECT_EQ("7 of x", format.SetToFormat("%d of %s", 7, "x"));
	EXPECT_EQ("<7 of x>", format.SetToFormat("<%s>", format.String()));
}


TEST(String, TakesPartsOfItself)
{
	BString text("0123456789");
	text.SetTo(text.String() + 4, 3);
	EXPECT_EQ("456", text);
	text.Append(text.String());
	EXPECT_EQ("456456", text);
	text.Insert(text, 3);
	EXPECT_EQ("456456456456", text);
	text = text;
	EXPECT_EQ("456456456456", text);
	text.SetTo(text, 2);
	EXPECT_EQ("45", text);
}


TEST(String, InsertsAndRemoves)
{
	BString text("hello");
	text.Append(" world").Prepend(">").Insert("...", 6).Append('!', 2);
	EXPECT_EQ(">hello... world!!", text);
	text.Insert("abcdef", 2, 2, 0);
	EXPECT_EQ("cd>hello... world!!", text);
	text.Insert("XYZ", -1);
	EXPECT_EQ("YZcd>hello... world!!", text);
	text.Remove(0, 5).RemoveFirst("...").RemoveAll("!");
	EXPECT_EQ("hello world", text);
	text.RemoveLast("o").RemoveSet("lr");
	EXPECT_EQ("heo wd", text);
	text.Remove(4, 100).Remove(-1, 2).Remove(9, 1);
	EXPECT_EQ("heo ", text);
	EXPECT_EQ("heo", text.Trim());
	BString part;
	text.MoveInto(part, 1, 1);
	EXPECT_EQ("e", part);
	EXPECT_EQ("ho", text);
	BString copied;
	BString("abcdef").CopyInto(copied, 2, 3);
	EXPECT_EQ("cde", copied);
}


TEST(String, ComparesWithAndWithoutCase)
{
	EXPECT_TRUE(BString("abc") < "abd");
	EXPECT_TRUE(BString("abc") == BString("abc"));
	EXPECT_TRUE("abc" == BString("abc"));
	EXPECT_TRUE(BString("ab") < BString("abc"));
	EXPECT_TRUE(BString("\xff") > "a");
	EXPECT_EQ(0, BString("ABC").ICompare("abc"));
	EXPECT_EQ(0, BString("abX").Compare("abY", 2));
	EXPECT_NE(0, BString("abX").Compare("abY"));
	EXPECT_TRUE(BString("filename.txt").EndsWith(".txt"));
	EXPECT_TRUE(BString("filename.txt").IStartsWith("FILE"));
	EXPECT_FALSE(BString("x").EndsWith("longer"));
}


TEST(String, FindsForwardAndBackward)
{
	const BString text("one two one two");
	EXPECT_EQ(4, text.FindFirst("two"));
	EXPECT_EQ(12, text.FindFirst("two", 5));
	EXPECT_EQ(B_ERROR, text.FindFirst("three"));
	EXPECT_EQ(12, text.FindLast("two"));
	EXPECT_EQ(4, text.FindLast("two", 14));
	EXPECT_EQ(8, text.IFindFirst("ONE", 1));
	EXPECT_EQ(2, text.FindFirst('e'));
	EXPECT_EQ(10, text.FindLast('e'));
	EXPECT_EQ(2, text.FindLast('e', 10));
	EXPECT_EQ(B_ERROR, text.FindLast('x'));
}


TEST(String, Replaces)
{
	BString text("one two one two one");
	text.ReplaceFirst("one", "1");
	EXPECT_EQ("1 two one two one", text);
	text.ReplaceLast("one", "three");
	EXPECT_EQ("1 two one two three", text);
	text.ReplaceAll("two", "");
	EXPECT_EQ("1  one  three", text);
	text.IReplaceAll("ONE", "ONE!");
	EXPECT_EQ("1  ONE!  three", text);
	text.ReplaceAll(' ', '_');
	EXPECT_EQ("1__ONE!__three", text);
	text.ReplaceSet("_!", "-");
	EXPECT_EQ("1-ONE-three", text);
	text.Replace('e', 'x', 1, 7);
	EXPECT_EQ("1-ONE-thrxe", text);
	text.ReplaceAll("", "never");
	EXPECT_EQ("1-ONE-thrxe", text);
}


TEST(String, ChangesLettersAndEscapes)
{
	EXPECT_EQ("hello world", BString("Hello WORLD").ToLower());
	EXPECT_EQ("HELLO", BString("hello").ToUpper());
	EXPECT_EQ("Hello world", BString("hELLO WORLD").Capitalize());
	EXPECT_EQ("Hello World-Wide", BString("hello world-wide").CapitalizeEachWord());
	EXPECT_EQ("a\\ b\\'c", BString("a b'c").CharacterEscape(" '", '\\'));
	EXPECT_EQ("a b'c", BString("a\\ b\\'c").CharacterDeescape('\\'));
}


TEST(String, PrintsNumbers)
{
	BString text;
	text << "a" << 'b' << 1 << 2u << -3L << 4ULL << 1.5 << true << BString("!");
	EXPECT_EQ("ab12-341.50true!", text);
}


TEST(String, LendsItsBuffer)
{
	BString text("abc");
	char* buffer = text.LockBuffer(100);
	EXPECT_STREQ("abc", buffer);
	strcpy(buffer, "a longer text than it was");
	text.UnlockBuffer();
	EXPECT_EQ("a longer text than it was", text);
	text.LockBuffer(0);
	text.UnlockBuffer(4);
	EXPECT_EQ("a lo", text);
	BString empty;
	strcpy(empty.LockBuffer(10), "xy");
	empty.UnlockBuffer(1);
	EXPECT_EQ("x", empty);
}


TEST(String, GivesCharactersOfSeveralBytes)
{
	const BString text("a\xc3\xa9\xe2\x82\xac");
	int32 bytes = 0;
	EXPECT_EQ(text.String() + 1, text.CharAt(1, &bytes));
	EXPECT_EQ(2, bytes);
	EXPECT_EQ(text.String() + 3, text.CharAt(2, &bytes));
	EXPECT_EQ(3, bytes);
	EXPECT_EQ(nullptr, text.CharAt(3));
	EXPECT_EQ('\0', text.ByteAt(6));
	EXPECT_EQ('\0', text.ByteAt(-1));
}


// Random changes against the standard's string.
TEST(String, IsAsAPlainStringAfterManyChanges)
{
	uint32 seed = 4711;
	const auto random = [&seed](uint32 below) {
		seed = seed * 1664525 + 1013904223;
		return (seed >> 8) % below;
	};
	BString text;
	std::string model;
	for (int step = 0; step < 20000; step++) {
		const std::string part(random(6), char('a' + random(3)));
		const auto at = random(uint32(model.size()) + 1);
		switch (random(5)) {
			case 0:
				text.Append(part.c_str());
				model += part;
				break;
			case 1:
				text.Insert(part.c_str(), int32(at));
				model.insert(at, part);
				break;
			case 2:
				text.Remove(int32(at), int32(part.size()));
				if (at < model.size())
					model.erase(at, part.size());
				break;
			case 3: {
				const size_t found = model.find(part);
				EXPECT_EQ(found == std::string::npos ? int32(B_ERROR) : int32(found),
					text.FindFirst(part.c_str()));
				break;
			}
			case 4:
				if (model.size() > 200) {
					text.Truncate(10);
					model.resize(10);
				}
				break;
		}
		ASSERT_EQ(model, text.String());
		ASSERT_EQ(int32(model.size()), text.Length());
	}
}


TEST(String, IsNotSearchedFromBeforeItsBeginning)
{
	const BString string("hello");
	EXPECT_EQ(B_ERROR, string.FindFirst("hello", -1));
	EXPECT_EQ(B_ERROR, string.IFindFirst("hello", -1));
	EXPECT_EQ(B_ERROR, string.FindFirst('h', -1));
	EXPECT_EQ(B_ERROR, string.FindLast("hello", -1));
	EXPECT_TRUE("hello" <= string && "hello" >= string);
	EXPECT_FALSE("hellp" <= string || "helln" >= string);
}


TEST(String, ExtremeNumbersDoNoHarm)
{
	BString string("hello");
	char buffer[8] = "kept";
	EXPECT_FALSE(string.MoveInto(buffer, 3, INT_MAX));
	EXPECT_FALSE(string.MoveInto(buffer, INT_MAX, 1));
	EXPECT_STREQ("kept", buffer);
	EXPECT_EQ(B_ERROR, string.FindLast("h", INT_MIN));
	EXPECT_EQ(B_ERROR, string.FindLast('h', INT_MIN));
	EXPECT_EQ(B_ERROR, string.FindFirst("h", INT_MAX));
	string.Insert("xyz", INT_MIN);
	string.Insert("xyz", INT_MAX, INT_MIN);
	string.Remove(INT_MIN, INT_MAX);
	EXPECT_STREQ("hello", string.String());
	string.Insert("xyz", INT_MAX);
	string.Truncate(INT_MAX);
	EXPECT_STREQ("helloxyz", string.String());
	string.Remove(3, INT_MAX);
	EXPECT_STREQ("hel", string.String());
}
