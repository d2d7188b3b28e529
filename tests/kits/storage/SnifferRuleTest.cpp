#include <string.h>

#include <random>
#include <string>

#include <Entry.h>
#include <Message.h>
#include <Mime.h>
#include <String.h>

#include "MimeFixture.h"

namespace {

// What is wrong with the rule; nothing if it is right.
std::string
Error(const std::string& rule)
{
	BString error;
	const status_t status = BMimeType::CheckSnifferRule(rule.c_str(), &error);
	EXPECT_TRUE(status == B_OK || status == B_BAD_MIME_SNIFFER_RULE);
	EXPECT_EQ(status == B_OK, error.Length() == 0);
	EXPECT_EQ(status, BMimeType::CheckSnifferRule(rule.c_str(), NULL));
	return error.String();
}


// Whether bytes are of the type that has this rule.
bool
Matches(const std::string& rule, const std::string& bytes)
{
	EXPECT_EQ(B_OK, BMimeType("x-test/ruled").SetSnifferRule(rule.c_str())) << rule;
	return BMimeTypeTest::Guess(bytes) == "x-test/ruled";
}

} // namespace


TEST_F(BMimeTypeTest, ARuleMatchesTheBeginningOfAFile)
{
	EXPECT_TRUE(Matches("0.5 (\"%XY\")", "%XY and more"));
	EXPECT_FALSE(Matches("0.5 (\"%XY\")", " %XY"));
	EXPECT_FALSE(Matches("0.5 (\"%XY\")", "%X"));
	EXPECT_FALSE(Matches("0.5 (\"%XY\")", ""));
}


TEST_F(BMimeTypeTest, ARuleWithSeveralExpressionsNeedsAllOfThem)
{
	const std::string rule = "0.5 (AB) [4](CD)\n\t[8:10] ( EF )";
	EXPECT_TRUE(Matches(rule, "AB..CD....EF"));
	EXPECT_FALSE(Matches(rule, "AB..CD"));
	EXPECT_FALSE(Matches(rule, "AB......EF"));
	EXPECT_FALSE(Matches(rule, "....CD....EF"));
}


TEST_F(BMimeTypeTest, OnePatternOfARulesExpressionIsEnough)
{
	for (const char* bytes : { "one", "two", "three" })
		EXPECT_TRUE(Matches("0.5 (one|\"two\" | 'three')", bytes)) << bytes;
	EXPECT_FALSE(Matches("0.5 (one|\"two\" | 'three')", "four"));
}


TEST_F(BMimeTypeTest, ARulesRangeSaysWhereAPatternBegins)
{
	EXPECT_FALSE(Matches("0.5 [2:4] (ab)", ".ab"));
	EXPECT_TRUE(Matches("0.5 [2:4] (ab)", "..ab"));
	EXPECT_TRUE(Matches("0.5 [ 2 : 4 ] (ab)", "....ab"));
	EXPECT_FALSE(Matches("0.5 [2:4] (ab)", ".....ab"));
	EXPECT_TRUE(Matches("0.5 [3] (ab)", "...ab"));
	EXPECT_FALSE(Matches("0.5 [3] (ab)", "ab..ab"));
	EXPECT_FALSE(Matches("0.5 [3] (ab)", "...a"));
}


TEST_F(BMimeTypeTest, APatternOfARuleMayHaveItsOwnRange)
{
	const std::string rule = "0.5 (ab | [2] cd | [4:5] ef)";
	for (const char* bytes : { "ab", "..cd", "....ef", ".....ef" })
		EXPECT_TRUE(Matches(rule, bytes)) << bytes;
	for (const char* bytes : { "..ab", "cd", "ef", "......ef" })
		EXPECT_FALSE(Matches(rule, bytes)) << bytes;
}


TEST_F(BMimeTypeTest, ARangeBehindTheBytesMatchesNothing)
{
	EXPECT_FALSE(Matches("0.5 [2147483647] (a)", "aaaa"));
	EXPECT_FALSE(Matches("0.5 [0:2147483647] (b)", "aaaa"));
	EXPECT_TRUE(Matches("0.5 [0:2147483647] (b)", "aaab"));
	EXPECT_FALSE(Matches("0.5 [0:2147483647] (b)", std::string(64 * 1024, 'a') + "b"));
	EXPECT_TRUE(Matches("0.5 [0:2147483647] (b)", std::string(64 * 1024 - 1, 'a') + "b"));
}


TEST_F(BMimeTypeTest, AFlagMakesARuleBlindForCase)
{
	for (const char* bytes : { "<html>", "<HTML>", "<hTmL>", "<Head>" })
		EXPECT_TRUE(Matches("0.5 (-i \"<Html\" | '<head')", bytes)) << bytes;
	EXPECT_FALSE(Matches("0.5 (\"<Html\" | '<head')", "<HTML>"));
	// It holds for its own list only.
	EXPECT_FALSE(Matches("0.5 (-i ab) [2](cd)", "ABCD"));
	EXPECT_TRUE(Matches("0.5 (-i ab) [2](cd)", "ABcd"));
	EXPECT_TRUE(Matches("0.5 (-i[1]ab)", ".AB"));
	EXPECT_TRUE(Matches("0.5 (-icon)", "-icon"));
}


TEST_F(BMimeTypeTest, AMaskSaysWhichBitsOfAPatternCount)
{
	EXPECT_TRUE(Matches("0.5 (0xf0 & 0xf0)", "\xf7"));
	EXPECT_FALSE(Matches("0.5 (0xf0 & 0xf0)", "\x77"));
	EXPECT_TRUE(Matches("0.5 [1:3] (\"a.b\" & 0xff00ff)", "...axb"));
	EXPECT_FALSE(Matches("0.5 [1:3] (\"a.b\" & 0xff00ff)", "...ax"));
	EXPECT_TRUE(Matches("0.5 (no | 'ab'&\"\\xff\\337\")", "aB"));
}


TEST_F(BMimeTypeTest, TextsOfRulesHaveTheEscapesOfC)
{
	const std::string all("\a\b\f\n\r\t\v\\\"'\0z\x7f\xffz", 15);
	EXPECT_TRUE(Matches("0.5 (\"\\a\\b\\f\\n\\r\\t\\v\\\\\\\"'\\0z\\177\\xFFz\")", all));
	EXPECT_TRUE(Matches("0.5 ('\\a\\b\\f\\n\\r\\t\\v\\\\\"\\'\\0z\\177\\xFFz')", all));
	EXPECT_TRUE(Matches("0.5 (\\a\\b\\f\\n\\r\\t\\v\\\\\\\"\\'\\0z\\177\\xFFz)", all));
	EXPECT_TRUE(Matches("0.5 ('\\1011')", "A1"));
	EXPECT_TRUE(Matches("0.5 ('\\x411')", "A1"));
	EXPECT_TRUE(Matches("0.5 ('\\q(|)')", "q(|)"));
}


TEST_F(BMimeTypeTest, RulesHaveBytesAndWords)
{
	EXPECT_TRUE(Matches("0.5 (0x00Ff41)",
		std::string("\0\xff"
					"A",
			3)));
	EXPECT_TRUE(Matches("0.5 (0XcafeBABE)", "\xca\xfe\xba\xbe"));
	EXPECT_TRUE(Matches("0.5 (#!/bin/sh\\ -x)", "#!/bin/sh -x"));
	EXPECT_TRUE(Matches("0.5 (a\\|b\\(c\\)\\[d\\]\\&)", "a|b(c)[d]&"));
	EXPECT_TRUE(Matches("0.5 (\xc3\xa4)", "\xc3\xa4"));
}


TEST_F(BMimeTypeTest, ARulesPriorityIsFromZeroToOne)
{
	for (const char* good : { "0", "0.0", "1", "1.0", ".5", "0.25", "1e-1", "0.5(", " \t0.5" }) {
		const std::string rule = std::string(good) + (strchr(good, '(') ? "a)" : " (a)");
		EXPECT_EQ("", Error(rule)) << rule;
	}
	EXPECT_EQ("character 1: the priority is not from 0.0 to 1.0", Error("1.01 (a)"));
	EXPECT_EQ("character 2: the priority is not from 0.0 to 1.0", Error(" 1e999 (a)"));
	for (const char* bad : { "-0.5 (a)", "+0.5 (a)", "nan (a)", "inf (a)", "(a)", "", "." })
		EXPECT_EQ("character 1: a priority from 0.0 to 1.0 is expected", Error(bad)) << bad;
	EXPECT_EQ("character 4: a space is expected behind the priority", Error("0.5x (a)"));
	EXPECT_EQ("character 2: a space is expected behind the priority", Error("0x1 (a)"));
}


TEST_F(BMimeTypeTest, AnErrorInARuleHasItsPlace)
{
	const std::pair<const char*, const char*> cases[] = {
		{ "0.5", "character 4: \"(\" or \"[\" is expected" },
		{ "0.5 a", "character 5: \"(\" or \"[\" is expected" },
		{ "0.5 (a) b", "character 9: \"(\" or \"[\" is expected" },
		{ "0.5 [1] a", "character 9: \"(\" is expected" },
		{ "0.5 [", "character 6: a number is expected" },
		{ "0.5 [-1] (a)", "character 6: a number is expected" },
		{ "0.5 [1:] (a)", "character 8: a number is expected" },
		{ "0.5 [1 2] (a)", "character 8: \":\" or \"]\" is expected" },
		{ "0.5 [1:2:3] (a)", "character 9: \"]\" is expected" },
		{ "0.5 [2:1] (a)", "character 5: the range ends before it begins" },
		{ "0.5 [2147483648] (a)", "character 6: the number is too large" },
		{ "0.5 [0:99999999999999999999999] (a)", "character 8: the number is too large" },
		{ "0.5 ()", "character 6: a pattern is expected" },
		{ "0.5 (", "character 6: a pattern is expected" },
		{ "0.5 (a |", "character 9: a pattern is expected" },
		{ "0.5 (a || b)", "character 9: a pattern is expected" },
		{ "0.5 (-i )", "character 9: a pattern is expected" },
		{ "0.5 ((a))", "character 6: a pattern is expected" },
		{ "0.5 (a b)", "character 8: \"|\" or \")\" is expected" },
		{ "0.5 (a", "character 7: \"|\" or \")\" is expected" },
		{ "0.5 [1] ([2] a)", "character 10: the list of patterns has a range already" },
		{ "0.5 (a | \"b)", "character 10: the quotation mark is never closed" },
		{ "0.5 ('a\\')", "character 6: the quotation mark is never closed" },
		{ "0.5 (\"\")", "character 6: the text is empty" },
		{ "0.5 (0x)", "character 6: the text is empty" },
		{ "0.5 (0x123)", "character 6: hexadecimal digits come in pairs" },
		{ "0.5 (0x12g4)", "character 10: a hexadecimal digit is expected" },
		{ "0.5 (a\\", "character 7: nothing follows the backslash" },
		{ "0.5 ('\\400')", "character 7: the octal number is larger than \\377" },
		{ "0.5 ('\\xg')", "character 7: hexadecimal digits are expected behind \"\\x\"" },
		{ "0.5 (ab &)", "character 10: a mask is expected" },
		{ "0.5 (ab & 0xff)", "character 11: the mask is not as long as its pattern" },
		{ "0.5 (ab & 0xffff & 0xffff)", "character 18: \"|\" or \")\" is expected" },
		// Characters are counted, not their bytes.
		{ "0.5 (\xc3\xa4\xe2\x82\xac x)", "character 9: \"|\" or \")\" is expected" },
	};
	for (const auto& [rule, error] : cases)
		EXPECT_EQ(error, Error(rule)) << rule;
	EXPECT_EQ(B_BAD_VALUE, BMimeType::CheckSnifferRule(NULL, NULL));
}


TEST_F(BMimeTypeTest, ABadRuleIsNotSet)
{
	BMimeType type("x-test/ruled");
	ASSERT_EQ(B_OK, type.SetSnifferRule("0.5 (a)"));
	EXPECT_EQ(B_BAD_MIME_SNIFFER_RULE, type.SetSnifferRule("0.5 (b"));
	BString rule;
	ASSERT_EQ(B_OK, BMimeType("X-Test/Ruled").GetSnifferRule(&rule));
	EXPECT_STREQ("0.5 (a)", rule.String());
	EXPECT_EQ("x-test/ruled", Guess("a"));
	ASSERT_EQ(B_OK, type.SetSnifferRule(NULL));
	EXPECT_EQ(B_ENTRY_NOT_FOUND, type.GetSnifferRule(&rule));
	EXPECT_EQ("application/octet-stream", Guess("a"));
	EXPECT_EQ(B_BAD_VALUE, type.GetSnifferRule(NULL));
	EXPECT_EQ(B_NO_INIT, BMimeType().SetSnifferRule("0.5 (a)"));
}


TEST_F(BMimeTypeTest, TheRuleOfTheHighestPriorityCounts)
{
	ASSERT_EQ(B_OK, BMimeType("x-test/low").SetSnifferRule("0.3 (ab)"));
	ASSERT_EQ(B_OK, BMimeType("x-test/high").SetSnifferRule("0.7 (ab)"));
	ASSERT_EQ(B_OK, BMimeType("x-test/other").SetSnifferRule("0.9 (cd)"));
	EXPECT_EQ("x-test/high", Guess("ab"));
	ASSERT_EQ(B_OK, BMimeType("x-test/high").Delete());
	EXPECT_EQ("x-test/low", Guess("ab"));
}


TEST_F(BMimeTypeTest, ARuleCompetesWithTheSharedDatabase)
{
	BMimeType type("x-test/ruled");
	ASSERT_EQ(B_OK, type.SetSnifferRule("0.49 (\"\\x89PNG\")"));
	EXPECT_EQ("image/png", Guess("\x89PNG"));
	ASSERT_EQ(B_OK, type.SetSnifferRule("0.5 (\"\\x89PNG\")"));
	EXPECT_EQ("x-test/ruled", Guess("\x89PNG"));

	WriteFile(fFolder / "file.txt", "word");
	entry_ref ref;
	ASSERT_EQ(B_OK, get_ref_for_path((fFolder / "file.txt").c_str(), &ref));
	BMimeType guess;
	ASSERT_EQ(B_OK, type.SetSnifferRule("0.4 (word)"));
	ASSERT_EQ(B_OK, BMimeType::GuessMimeType(&ref, &guess));
	EXPECT_STREQ("text/plain", guess.Type());
	ASSERT_EQ(B_OK, type.SetSnifferRule("0.8 (word)"));
	ASSERT_EQ(B_OK, BMimeType::GuessMimeType(&ref, &guess));
	EXPECT_STREQ("x-test/ruled", guess.Type());
}


TEST_F(BMimeTypeTest, AFileIsReadAsFarAsARuleLooks)
{
	WriteFile(fFolder / "file", std::string(5000, '.') + "here");
	entry_ref ref;
	ASSERT_EQ(B_OK, get_ref_for_path((fFolder / "file").c_str(), &ref));
	ASSERT_EQ(B_OK, BMimeType("x-test/ruled").SetSnifferRule("0.8 [4000:5000] (here)"));
	BMimeType guess;
	ASSERT_EQ(B_OK, BMimeType::GuessMimeType(&ref, &guess));
	EXPECT_STREQ("x-test/ruled", guess.Type());
}


TEST_F(BMimeTypeTest, AnExtensionThatWasSetTellsTheType)
{
	BMessage extensions;
	extensions.AddString("extensions", "Ruled");
	extensions.AddString("extensions", "txt");
	ASSERT_EQ(B_OK, BMimeType("x-test/ruled").SetFileExtensions(&extensions));
	const std::pair<const char*, const char*> cases[] = { { "a.ruled", "x-test/ruled" },
		{ "/b.c/a.b.RULED", "x-test/ruled" }, { "a.txt", "x-test/ruled" }, { "a.png", "image/png" },
		{ "ruled", "application/octet-stream" } };
	for (const auto& [name, expected] : cases) {
		BMimeType type;
		ASSERT_EQ(B_OK, BMimeType::GuessMimeType(name, &type));
		EXPECT_STREQ(expected, type.Type()) << name;
	}
}


TEST_F(BMimeTypeTest, HostileRulesEndSoon)
{
	EXPECT_EQ("character 4097: the rule is too long", Error("0.5 (" + std::string(5000, 'a')));
	EXPECT_EQ("character 4097: the rule is too long", Error(std::string(10000000, '(')));
	EXPECT_NE("", Error("0.5 " + std::string(4000, '(')));
	std::string many = "0.5 ";
	while (many.size() < 4000)
		many += "[0:2147483647](-i a|b)";
	EXPECT_EQ("", Error(many));
	EXPECT_TRUE(Matches(many, std::string(100000, 'B')));
	EXPECT_FALSE(Matches(many, std::string(100000, 'c')));
	const std::string masked =
		"0.5 [0:2147483647](" + std::string(2000, 'a') + "b & " + std::string(2000, 'a') + "b)";
	EXPECT_FALSE(Matches(masked, std::string(2500, 'a')));
}


// Whatever a text is, it is a rule or the error has a place in it.
TEST_F(BMimeTypeTest, RandomRulesAreReadOrRefused)
{
	static const char* const kParts[] = { "0.5 ", "1", "(", ")", "[", "]", ":", "|", "&", "\"", "'",
		"\\", "x", "0x", "41", "-i", " ", "a", "\n", "\xff", "\xc3", "[0:9]", "(a)", "\\7" };
	std::mt19937 random(20);
	int32 rules = 0;
	for (int32 i = 0; i < 100000; i++) {
		std::string text = i % 2 == 0 ? "0.5 (" : "";
		for (uint32 left = random() % 12; left > 0; left--)
			text += kParts[random() % std::size(kParts)];
		if (i % 4 == 0)
			text += ")";
		BString error;
		if (BMimeType::CheckSnifferRule(text.c_str(), &error) == B_OK) {
			// Now and then one is tried, on bytes that some of them match.
			if (++rules % 100 == 0)
				Matches(text, "aaaa\nA" + text);
			continue;
		}
		int place = 0;
		ASSERT_EQ(1, sscanf(error.String(), "character %d: ", &place)) << text;
		ASSERT_LE(1, place) << text;
		ASSERT_LE(place, static_cast<int>(text.size()) + 1) << text;
	}
	// Enough of both, so that both are tested.
	EXPECT_LT(1000, rules);
	EXPECT_GT(99000, rules);
}
