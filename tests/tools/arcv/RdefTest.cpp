// Resource definition text: what the compiler accepts, and that the decompiler writes nothing else.

#include <string.h>

#include <limits>
#include <random>

#include <gtest/gtest.h>

#include <Message.h>
#include <TypeConstants.h>

#include "kits/storage/TemporaryFolder.h"
#include "tools/arcv/Input.h"
#include "tools/arcv/TypeCode.h"
#include "tools/arcv/rdef/Compiler.h"
#include "tools/arcv/rdef/Decompiler.h"

using namespace Arcv;

namespace {

struct Compiled {
	bool fine;
	std::string error;
	int32 line;
	size_t warnings;
	std::unique_ptr<BResources> resources;

	std::string Bytes(type_code type, int32 id) const
	{
		size_t size = 0;
		const void* data = resources->LoadResource(type, id, &size);
		return data != NULL ? std::string(static_cast<const char*>(data), size) : "(none)";
	}

	BMessage Message(type_code type, int32 id) const
	{
		const std::string bytes = Bytes(type, id);
		BMessage message;
		EXPECT_TRUE(IsMessage(bytes.data(), bytes.size(), &message));
		return message;
	}
};


Compiled
Compile(const std::string& text, const CompileOptions& options = {})
{
	Compiled result;
	result.resources = std::make_unique<BResources>();
	Compiler compiler(options, *result.resources);
	result.fine = compiler.Compile("text", text);
	result.error = compiler.Error().reason;
	result.line = result.fine ? 0 : compiler.Error().line;
	result.warnings = compiler.Warnings().size();
	return result;
}


// The bytes of the one resource of this text.
std::string
Bytes(const std::string& data, type_code type)
{
	const Compiled compiled = Compile("resource(1) " + data + ";");
	EXPECT_TRUE(compiled.fine) << data << ": " << compiled.error;
	return compiled.Bytes(type, 1);
}


template<typename Value>
std::string
Number(Value number)
{
	return std::string(reinterpret_cast<const char*>(&number), sizeof(number));
}


void
ExpectError(const std::string& text, const std::string& reason, int32 line = 1)
{
	const Compiled compiled = Compile(text);
	EXPECT_FALSE(compiled.fine) << text;
	EXPECT_NE(std::string::npos, compiled.error.find(reason)) << text << ": " << compiled.error;
	EXPECT_EQ(line, compiled.line) << text;
}


std::string
Fields(const BMessage& message)
{
	std::string text;
	char* name;
	type_code type;
	int32 count;
	for (int32 i = 0; message.GetInfo(B_ANY_TYPE, i, &name, &type, &count) == B_OK; i++)
		text += std::string(name) + " " + TypeText(type) + " " + std::to_string(count) + ", ";
	return text;
}

} // namespace


TEST(RdefCompiler, IntegersInAllBases)
{
	for (const char* text : { "12", "0xC", "014", "0b1100" })
		EXPECT_EQ(Number<int32>(12), Bytes(text, B_INT32_TYPE)) << text;
	EXPECT_EQ(Number<int32>(8), Bytes("08", B_INT32_TYPE));
	EXPECT_EQ(Number<int32>('ARCV'), Bytes("'ARCV'", B_INT32_TYPE));
	EXPECT_EQ(Number<int32>(-1294967296), Bytes("3000000000", B_INT32_TYPE));
	EXPECT_EQ(Number<int32>(std::numeric_limits<int32>::min()), Bytes("-2147483648", B_INT32_TYPE));
	EXPECT_EQ(Number<uint64>(UINT64_MAX), Bytes("(uint64)18446744073709551615", B_UINT64_TYPE));
	EXPECT_EQ(Number<int64>(-5), Bytes("(int64)-5", B_INT64_TYPE));
	EXPECT_EQ(Number<int8>(-2), Bytes("(int8)-2", B_INT8_TYPE));
	EXPECT_EQ(Number<uint64>(5), Bytes("(raw)5", B_RAW_TYPE));
	EXPECT_EQ(Number<int16>(5), Bytes("(raw)(int16)5", B_RAW_TYPE));
}


TEST(RdefCompiler, FloatsKeepTheirBits)
{
	for (const char* text : { "0.5", ".5", "5e-1", "(float)0.5" })
		EXPECT_EQ(Number<float>(0.5f), Bytes(text, B_FLOAT_TYPE)) << text;
	EXPECT_EQ(Number<float>(5.0f), Bytes("5.", B_FLOAT_TYPE));
	EXPECT_EQ(Number<float>(-0.0f), Bytes("-0.0", B_FLOAT_TYPE));
	EXPECT_EQ(Number<double>(0.1), Bytes("(double)0.1", B_DOUBLE_TYPE));
	EXPECT_EQ(Number<float>(-1.0f), Bytes("(float)-1", B_FLOAT_TYPE));
	EXPECT_EQ(Number<float>(4294967295.0f), Bytes("(float)4294967295", B_FLOAT_TYPE));
}


TEST(RdefCompiler, StringsWithEscapes)
{
	EXPECT_EQ(std::string("hello\0", 6), Bytes("\"hello\"", B_STRING_TYPE));
	EXPECT_EQ(std::string("a\0b\0", 4), Bytes("\"a\\0b\"", B_STRING_TYPE));
	EXPECT_EQ(std::string("\b\f\n\r\t\v\"\\?\0", 10),
		Bytes("\"\\b\\f\\n\\r\\t\\v\\\"\\\\\\?\"", B_STRING_TYPE));
	EXPECT_EQ(std::string("AAA\0", 4), Bytes("\"\\x41\\0x41\\101\"", B_STRING_TYPE));
	EXPECT_EQ(std::string("ab\0", 3), Bytes("\"a\"\n\t\"b\"", B_STRING_TYPE));
	EXPECT_EQ("\x01\x02\xff", Bytes("$\"0102\" $\"Ff\"", B_RAW_TYPE));
	ExpectError("resource(1) \"a\n\";", "no end");
	ExpectError("resource(1) $\"123\";", "hexadecimal");
}


TEST(RdefCompiler, ExpressionsHavePrecedence)
{
	const std::pair<const char*, int32> cases[] = { { "1 + 2 * 3", 7 }, { "(1 + 2) * 3", 9 },
		{ "1 | 6 & 3", 3 }, { "5 ^ 1 | 8", 12 }, { "~0", -1 }, { "10 - 3 - 2", 5 },
		{ "7 % 4 / 2", 1 }, { "~1 & 7", 6 }, { "(int32) 5 + 3", 8 } };
	for (const auto& [text, value] : cases)
		EXPECT_EQ(Number<int32>(value), Bytes(text, B_INT32_TYPE)) << text;
	ExpectError("resource(1) 1 / 0;", "no result");
	ExpectError("resource(1) (int8)1 + 1;", "32 bits");
	ExpectError("resource(1) 1.5 + 1;", "32 bits");
}


TEST(RdefCompiler, HeadsGiveIdNameAndType)
{
	const Compiled compiled = Compile("enum { kOne = 7, kTwo, };\n"
									  "resource 1; resource(5) #'ABCD' 2; resource(6, \"six\") 3;"
									  "resource(\"seven\") (int8)4; resource(kTwo) 5;"
									  "resource(-3) #0x41414141 6; resource() #200 true;"
									  "resource(kOne, \"k\") 7; resource(#'CSTR') $\"00\";"
									  "resource(9, \"nine\") ( #'WXYZ' ) (int8)8;");
	ASSERT_TRUE(compiled.fine) << compiled.error;
	const char* name = NULL;
	EXPECT_TRUE(compiled.resources->HasResource(B_INT32_TYPE, 1));
	EXPECT_TRUE(compiled.resources->HasResource('ABCD', 5));
	ASSERT_TRUE(compiled.resources->GetResourceInfo(B_INT32_TYPE, 6, &name, NULL));
	EXPECT_STREQ("six", name);
	ASSERT_TRUE(compiled.resources->GetResourceInfo(B_INT8_TYPE, 1, &name, NULL));
	EXPECT_STREQ("seven", name);
	EXPECT_TRUE(compiled.resources->HasResource(B_INT32_TYPE, 8));
	EXPECT_TRUE(compiled.resources->HasResource('AAAA', -3));
	EXPECT_TRUE(compiled.resources->HasResource(200, 1));
	EXPECT_TRUE(compiled.resources->HasResource('CSTR', 1));
	EXPECT_EQ("\x08", compiled.Bytes('WXYZ', 9));
	ExpectError("resource(1)\n(#'ABCD' 5);", "')' is expected", 2);
	ExpectError("resource(1) 5 + (#'ABCD') 5;", "a value is expected");
	ExpectError("resource 1;\nresource 2;", "duplicate resource LONG:1", 2);
	CompileOptions merging;
	merging.merge = true;
	EXPECT_EQ(Number<int32>(2), Compile("resource 1; resource 2;", merging).Bytes('LONG', 1));
	CompileOptions naming;
	naming.autoNames = true;
	const Compiled named = Compile("enum { kId = 4 }; resource(kId) 1;", naming);
	ASSERT_TRUE(named.resources->GetResourceInfo(B_INT32_TYPE, 4, &name, NULL));
	EXPECT_STREQ("kId", name);
}


TEST(RdefCompiler, ResourcesOfApplicationsHaveTheirOwnNamesAndIds)
{
	const struct {
		const char* data;
		type_code type;
		int32 id;
		const char* name;
	} kResources[] = { { "app_signature \"a/b\"", 'MIMS', 1, "BEOS:APP_SIG" },
		{ "app_name_catalog_entry \"a:b:c\"", 'CSTR', 1, "SYS:NAME" },
		{ "app_flags B_ARGV_ONLY", 'APPF', 1, "BEOS:APP_FLAGS" },
		{ "app_version { 1 }", 'APPV', 1, "BEOS:APP_VERSION" },
		{ "file_types message { \"types\" = \"a/b\" }", 'MSGG', 1, "BEOS:FILE_TYPES" },
		{ "large_icon array { $\"00\" }", 'ICON', 101, "BEOS:L:STD_ICON" },
		{ "mini_icon array { $\"00\" }", 'MICN', 101, "BEOS:M:STD_ICON" },
		{ "vector_icon array { $\"00\" }", 'VICN', 101, "BEOS:ICON" },
		{ "png_icon array { $\"00\" }", 'PNG ', 101, "BEOS:ICON" } };
	for (const auto& resource : kResources) {
		const Compiled compiled = Compile(std::string("resource ") + resource.data + ";");
		ASSERT_TRUE(compiled.fine) << resource.data << ": " << compiled.error;
		const char* name = NULL;
		ASSERT_TRUE(
			compiled.resources->GetResourceInfo(resource.type, resource.id, &name, NULL))
			<< resource.data;
		EXPECT_STREQ(resource.name, name);
	}
}


TEST(RdefCompiler, CompoundsTakeNamedAndOrderedFields)
{
	const float rect[] = { 1, 0, 0, 9 };
	const std::string bytes(reinterpret_cast<const char*>(rect), sizeof(rect));
	EXPECT_EQ(bytes, Bytes("rect { left = 1.0, bottom = 9.0 }", B_RECT_TYPE));
	EXPECT_EQ(bytes, Bytes("rect { 1.0, 0.0, 0.0, 9.0 }", B_RECT_TYPE));
	EXPECT_EQ(std::string(16, '\0'), Bytes("rect", B_RECT_TYPE));
	EXPECT_EQ("\1\2\3\xff", Bytes("rgb_color { 1, 2, 3 }", B_RGB_COLOR_TYPE));
	const float negative[] = { -1, 0, 0, 0 };
	EXPECT_EQ(std::string(reinterpret_cast<const char*>(negative), 16),
		Bytes("rect { -1 }", B_RECT_TYPE));
	ExpectError("resource(1) rect { 1, 2, 3, 4, 5 };", "too many fields");
	ExpectError("resource(1) rect { wrong = 1 };", "neither a type nor a symbol");
	const std::string version =
		Bytes("app_version { minor = 3, variety = B_APPV_BETA, short_info = \"s\" }", 'APPV');
	ASSERT_EQ(340u, version.size());
	EXPECT_EQ(Number<uint32>(3) + Number<uint32>(2), version.substr(8, 8));
	EXPECT_EQ("s", std::string(version.c_str() + 20));
}


TEST(RdefCompiler, OwnTypesWorkLikeTheOthers)
{
	const Compiled compiled = Compile(
		"type(10, \"ten\") #'PAIR' pair { int32 a = 4, float b, string c[4] = \"abcdef\", bool d };"
		"resource pair { 1, c = \"x\" }; resource(2) pair;");
	ASSERT_TRUE(compiled.fine) << compiled.error;
	EXPECT_EQ(Number<int32>(1) + Number<float>(0) + std::string("x\0\0\0\0", 5),
		compiled.Bytes('PAIR', 10));
	EXPECT_EQ(
		Number<int32>(4) + Number<float>(0) + std::string("abc\0\0", 5), compiled.Bytes('PAIR', 2));
	ExpectError("type int32 { int8 a };", "there already");
}


TEST(RdefCompiler, CastsRefuseWhatMakesNoSense)
{
	for (const char* text : { "(int32)1.5", "(bool)1", "(string)5", "(message)5", "(rect)5",
			 "(float)\"a\"", "(int32)true" })
		ExpectError(std::string("resource(1) ") + text + ";", "cannot cast");
}


TEST(RdefCompiler, ArchivesGetTheirClassLast)
{
	const Compiled compiled =
		Compile("resource(2) #'ARCV' archive(\"add\", 'what') BView {\n\"x\" = 1, \"y\" = 2.5,"
				"rect \"r\" = rect { 1.0, 2.0 }, \"c\" = rgb_color { 1, 2, 3 },"
				"#'RGBB' \"cc\" = rgb_color { 1, 2, 3, 4 }, \"e\" = \"\" };");
	ASSERT_TRUE(compiled.fine) << compiled.error;
	const BMessage message = compiled.Message('ARCV', 2);
	EXPECT_EQ(static_cast<uint32>('what'), message.what);
	EXPECT_EQ("x LONG 1, y FLOT 1, r RECT 1, c RGBC 1, cc RGBB 1, e CSTR 1, class CSTR 1, "
			  "add_on CSTR 1, ",
		Fields(message));
	EXPECT_STREQ("BView", message.FindString("class"));
	EXPECT_EQ("class CSTR 1, ",
		Fields(Compile("resource(1) archive BView { \"\" = $\"\" };").Message('MSGG', 1)));
	ExpectError("resource(1) archive BView;", "braces");
	ExpectError("resource(1) archive BView {};", "at least one field");
	ExpectError("resource(1) archive a::b { \"x\" = 1 };", "character");
}


TEST(RdefCompiler, MessagesTakeFieldsOfManyKinds)
{
	const Compiled compiled = Compile(
		"resource(1) message('abcd') { \"n\" = 5, \"n\" = 6, int8 \"i\" = 5, \"b\" = true,"
		"#'BOOL' \"odd\" = 1, \"m\" = message { \"k\" = archive BView { \"x\" = 1 } },"
		"\"d\" = array { $\"00FF\", 1.5, \"text\" }, #'CSTR' array \"s\" = array { \"a\" \"b\" },"
		"\"n\" = \"dropped\", \"empty\" = $\"\" };");
	ASSERT_TRUE(compiled.fine) << compiled.error;
	EXPECT_EQ(2u, compiled.warnings);
	const BMessage message = compiled.Message('MSGG', 1);
	EXPECT_EQ("n LONG 2, i BYTE 1, b BOOL 1, odd BOOL 1, m MSGG 1, d RAWT 1, s CSTR 1, ",
		Fields(message));
	const void* data;
	ssize_t size;
	ASSERT_EQ(B_OK, message.FindData("odd", B_BOOL_TYPE, &data, &size));
	EXPECT_EQ(4, size);
	ASSERT_EQ(B_OK, message.FindData("d", B_RAW_TYPE, &data, &size));
	EXPECT_EQ(11, size);
	EXPECT_EQ(0u, Compile("resource(1) message;").Message('MSGG', 1).what);
	ExpectError("resource(1) message { \"a\" = 1, };", "closing brace");
	ExpectError("resource(1) message { bool \"b\" = 1 };", "cannot cast");
}


TEST(RdefCompiler, FilesAreFoundInTheFoldersGiven)
{
	TemporaryFolder folder;
	WriteFile(folder / "symbols.h", "enum { kSeven = 7 };\n");
	WriteFile(folder / "again.h", "#include \"again.h\"\n");
	WriteFile(folder / "bytes", "imported");
	CompileOptions options;
	options.includeFolders = { folder.Path() };
	const Compiled compiled = Compile("#include \"symbols.h\"\nresource(kSeven) import \"bytes\";"
									  "resource(8) array import \"bytes\";",
		options);
	ASSERT_TRUE(compiled.fine) << compiled.error;
	EXPECT_EQ("imported", compiled.Bytes('RAWT', 7));
	EXPECT_EQ("imported", compiled.Bytes('RAWT', 8));
	EXPECT_FALSE(Compile("#include \"again.h\"\n", options).fine);
	EXPECT_FALSE(Compile("#include \"none.h\"\n", options).fine);
	EXPECT_FALSE(Compile("resource(1) import \"bytes\";").fine);
}


TEST(RdefCompiler, ErrorsNameTheirLine)
{
	ExpectError("// comment\n/* more\nlines */ resource(1) ?;", "means nothing", 3);
	ExpectError("resource(1)\n5\n", "';' is expected", 3);
	ExpectError("resource(1) message {\n\"a\" = 1\n\"b\" = 2 };", "',' is expected", 3);
	ExpectError("resource(unknown) 1;", "known symbol");
	ExpectError("/* no end", "no end");
	ExpectError("nonsense", "expected");
	ExpectError("resource(1) 99999999999999999999;", "64 bits");
	const Compiled deep = Compile("resource(1) " + std::string(100000, '(') + "1;");
	EXPECT_FALSE(deep.fine);
	std::string nested = "resource(1) ";
	for (int i = 0; i < 100000; i++)
		nested += "message { \"a\" = ";
	EXPECT_FALSE(Compile(nested).fine);
	EXPECT_FALSE(Compile("resource(1) " + std::string(100000, '~') + "1;").fine);
}


// #pragma mark - decompiler

namespace {

void
ExpectSame(const BMessage& expected, const BMessage& found, const std::string& text)
{
	EXPECT_EQ(expected.what, found.what) << text;
	ASSERT_EQ(Fields(expected), Fields(found)) << text;
	char* name;
	type_code type;
	int32 count;
	for (int32 i = 0; expected.GetInfo(B_ANY_TYPE, i, &name, &type, &count) == B_OK; i++) {
		for (int32 j = 0; j < count; j++) {
			BMessage expectedNested;
			BMessage foundNested;
			if (type == B_MESSAGE_TYPE && expected.FindMessage(name, j, &expectedNested) == B_OK) {
				ASSERT_EQ(B_OK, found.FindMessage(name, j, &foundNested)) << text;
				ExpectSame(expectedNested, foundNested, text);
				continue;
			}
			const void* expectedData = NULL;
			const void* foundData = NULL;
			ssize_t expectedSize = 0;
			ssize_t foundSize = -1;
			expected.FindData(name, type, j, &expectedData, &expectedSize);
			found.FindData(name, type, j, &foundData, &foundSize);
			ASSERT_EQ(expectedSize, foundSize) << name << "\n" << text;
			EXPECT_EQ(0, memcmp(expectedData, foundData, expectedSize)) << name << "\n" << text;
		}
	}
}


void
ExpectRoundTrip(const BMessage& message)
{
	std::string bytes(message.FlattenedSize(), '\0');
	ASSERT_EQ(B_OK, message.Flatten(bytes.data(), bytes.size()));
	const std::string text = ResourceText('ARCV', 3, "name", bytes.data(), bytes.size());
	const Compiled compiled = Compile(text);
	ASSERT_TRUE(compiled.fine) << compiled.error << "\n" << text;
	ExpectSame(message, compiled.Message('ARCV', 3), text);
}

} // namespace


TEST(RdefDecompiler, WritesArchivesAsArchives)
{
	BMessage message('what');
	message.AddString("class", "BView");
	message.AddInt32("x", 5);
	std::string bytes(message.FlattenedSize(), '\0');
	ASSERT_EQ(B_OK, message.Flatten(bytes.data(), bytes.size()));
	EXPECT_EQ("\nresource(1, \"a \\\"name\\\"\") #'ARCV' archive(, 'what') BView {\n"
			  "\t/*class*/ \"x\" = 5\n};\n",
		ResourceText('ARCV', 1, "a \"name\"", bytes.data(), bytes.size()));
	EXPECT_EQ("\nresource(-1) \"text\";\n", ResourceText('CSTR', -1, "", "text", 5));
	EXPECT_EQ("\nresource(1) #'MIMS' \"a/b\";\n", ResourceText('MIMS', 1, "", "a/b", 4));
	EXPECT_EQ("\nresource(1) #200 $\"00ff\";\n", ResourceText(200, 1, "", "\0\xff", 2));
}


TEST(RdefDecompiler, ClassesStayWhereTheyAre)
{
	for (int place = 0; place < 3; place++) {
		for (const std::vector<const char*>& classes :
			std::vector<std::vector<const char*>> { { "BView" }, { "MyView", "BView" }, { "a::b" },
				{ "archive" }, { "" }, { "a", "b", "a b" } }) {
			BMessage message;
			for (int i = 0; i < 3; i++) {
				if (i == place) {
					for (const char* name : classes)
						message.AddString("class", name);
				}
				if (i < 2)
					message.AddInt32(i == 0 ? "first" : "second", i);
			}
			message.AddString("add_on", "sig");
			ExpectRoundTrip(message);
		}
	}
	BMessage only;
	only.AddString("class", "BView");
	ExpectRoundTrip(only);
	ExpectRoundTrip(BMessage());
	ExpectRoundTrip(BMessage(7));
	BMessage number;
	number.AddInt32("class", 5);
	ExpectRoundTrip(number);
}


TEST(RdefDecompiler, OddValuesComeBackBitForBit)
{
	BMessage message;
	message.AddFloat("nan", std::numeric_limits<float>::quiet_NaN());
	message.AddFloat("inf", -std::numeric_limits<float>::infinity());
	message.AddFloat("zero", -0.0f);
	message.AddFloat("third", 1.0f / 3);
	message.AddFloat("tiny", std::numeric_limits<float>::denorm_min());
	message.AddDouble("tenth", 0.1);
	message.AddDouble("large", 1e300);
	message.AddInt32("least", std::numeric_limits<int32>::min());
	message.AddInt64("least64", std::numeric_limits<int64>::min());
	message.AddUInt64("most64", std::numeric_limits<uint64>::max());
	message.AddData("bool", B_BOOL_TYPE, "\2", 1);
	message.AddData("wide", B_BOOL_TYPE, "\1\0\0\0", 4);
	message.AddData("rect", B_RECT_TYPE, "short", 5);
	message.AddData("endless", B_STRING_TYPE, "abc", 3);
	message.AddData("zeros", B_STRING_TYPE, "a\0001\0x41\0", 9);
	message.AddData("bytes", B_STRING_TYPE, "\xff\xfe\1\x7f\0", 5);
	message.AddString("lines", ("one\ntwo\n" + std::string(300, 'x')).c_str());
	message.AddString("umlauts", std::string(40, 'x').append("äöüß日本語äöüß日本語").c_str());
	message.AddData("raw", B_RAW_TYPE, std::string(1000, '\7').data(), 1000);
	message.AddData("time", B_TIME_TYPE, "12345678", 8);
	message.AddData("size", 'SIZE', "12345678", 8);
	message.AddData("pointer", B_POINTER_TYPE, "abc", 4);
	message.AddData("quote", 'a\'b\\', "abc", 4);
	message.AddData("broken", B_MESSAGE_TYPE, "nonsense", 8, false);
	message.AddInt32("a \"name\"\\\n\t", 1);
	message.AddInt32("", 2);
	BMessage nested;
	nested.AddMessage("more", &message);
	nested.AddMessage("more", &nested);
	message.AddMessage("nested", &nested);
	ExpectRoundTrip(message);
}


TEST(RdefDecompiler, RandomMessagesComeBack)
{
	std::mt19937 random(5);
	const type_code types[] = { B_INT8_TYPE, B_INT16_TYPE, B_INT32_TYPE, B_INT64_TYPE, B_FLOAT_TYPE,
		B_DOUBLE_TYPE, B_BOOL_TYPE, B_STRING_TYPE, B_RAW_TYPE, B_RECT_TYPE, B_POINT_TYPE,
		B_RGB_COLOR_TYPE, B_RGB_32_BIT_TYPE, B_SIZE_T_TYPE, B_OFF_T_TYPE, 'odd!', 1 };
	for (int round = 0; round < 300; round++) {
		BMessage message(random() % 3 == 0 ? random() : 0);
		for (unsigned field = random() % 8; field > 0; field--) {
			const std::string name(1 + random() % 3, static_cast<char>(' ' + random() % 90));
			const type_code type = types[random() % std::size(types)];
			for (unsigned item = 1 + random() % 3; item > 0; item--) {
				std::string data(1 + random() % 20, '\0');
				for (char& byte : data)
					byte = static_cast<char>(random() % 4 == 0 ? 0 : random());
				message.AddData(name.c_str(), type, data.data(), data.size(), false);
			}
		}
		ExpectRoundTrip(message);
		if (HasFailure())
			return;
	}
}


TEST(RdefDecompiler, ResourcesOfAnyBytesComeBack)
{
	std::mt19937 random(7);
	const type_code types[] = { 'ARCV', 'CSTR', 'LONG', 'RAWT', 'MIMS', 'DBLE', 'RECT', 'BOOL', 5 };
	for (int round = 0; round < 500; round++) {
		std::string data(random() % 80, '\0');
		for (char& byte : data)
			byte = static_cast<char>(random() % 2 == 0 ? 'a' + random() % 26 : random());
		const type_code type = types[random() % std::size(types)];
		const std::string text = ResourceText(type, 1, "", data.data(), data.size());
		const Compiled compiled = Compile(text);
		ASSERT_TRUE(compiled.fine) << compiled.error << text;
		ASSERT_EQ(data, compiled.Bytes(type, 1)) << text;
	}
}
