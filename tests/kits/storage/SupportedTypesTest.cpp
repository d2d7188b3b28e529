#include <string.h>

#include <filesystem>
#include <string>

#include <AppFileInfo.h>
#include <Bitmap.h>
#include <Entry.h>
#include <File.h>
#include <Message.h>
#include <Mime.h>

#include "MimeFixture.h"

namespace {

BMessage
Types(std::initializer_list<const char*> types)
{
	BMessage message;
	for (const char* type : types)
		message.AddString("types", type);
	return message;
}


// The strings of a field, joined by spaces.
std::string
Joined(const BMessage& message, const char* field)
{
	std::string joined;
	const char* text;
	for (int32 i = 0; message.FindString(field, i, &text) == B_OK; i++)
		joined += (i > 0 ? " " : "") + std::string(text);
	return joined;
}


std::string
AppsFor(const char* type)
{
	BMessage apps;
	EXPECT_EQ(B_OK, BMimeType(type).GetSupportingApps(&apps));
	return Joined(apps, "applications");
}

} // namespace


TEST_F(BMimeTypeTest, ProgramsSupportTypesAndSupertypes)
{
	const BMessage both = Types({ "text/plain", "text" });
	const BMessage family = Types({ "Text" });
	const BMessage one = Types({ "Text/Plain", "text/plain" });
	ASSERT_EQ(B_OK, BMimeType("application/x-both").SetSupportedTypes(&both));
	ASSERT_EQ(B_OK, BMimeType("application/x-family").SetSupportedTypes(&family));
	ASSERT_EQ(B_OK, BMimeType("application/x-one").SetSupportedTypes(&one));

	BMessage apps;
	ASSERT_EQ(B_OK, BMimeType("TEXT/plain").GetSupportingApps(&apps));
	EXPECT_EQ(
		"application/x-both application/x-one application/x-family", Joined(apps, "applications"));
	EXPECT_EQ(2, apps.FindInt32("be:sub"));
	EXPECT_EQ(1, apps.FindInt32("be:super"));
	ASSERT_EQ(B_OK, BMimeType("text").GetSupportingApps(&apps));
	EXPECT_EQ("application/x-both application/x-family", Joined(apps, "applications"));
	EXPECT_EQ(2, apps.FindInt32("be:super"));
	EXPECT_FALSE(apps.HasInt32("be:sub"));
	ASSERT_EQ(B_OK, BMimeType("image/png").GetSupportingApps(&apps));
	EXPECT_EQ("", Joined(apps, "applications"));
	EXPECT_EQ(0, apps.FindInt32("be:sub"));
	EXPECT_EQ(B_BAD_VALUE, BMimeType("text").GetSupportingApps(NULL));
	EXPECT_EQ(B_NO_INIT, BMimeType().GetSupportingApps(&apps));
}


TEST_F(BMimeTypeTest, SupportedTypesAreKeptAndInstalled)
{
	BMimeType app("application/x-vnd.Test");
	BMessage types;
	EXPECT_EQ(B_ENTRY_NOT_FOUND, app.GetSupportedTypes(&types));
	const BMessage set = Types({ "x-test/new", "text" });
	ASSERT_EQ(B_OK, app.SetSupportedTypes(&set));
	ASSERT_EQ(B_OK, BMimeType("application/x-vnd.test").GetSupportedTypes(&types));
	EXPECT_EQ("x-test/new text", Joined(types, "types"));
	EXPECT_TRUE(BMimeType("x-test/new").IsInstalled());

	const BMessage bad = Types({ "text/plain", "no type/" });
	EXPECT_EQ(B_BAD_VALUE, app.SetSupportedTypes(&bad));
	ASSERT_EQ(B_OK, app.GetSupportedTypes(&types));
	EXPECT_EQ("x-test/new text", Joined(types, "types"));
	ASSERT_EQ(B_OK, app.SetSupportedTypes(NULL));
	EXPECT_EQ(B_ENTRY_NOT_FOUND, app.GetSupportedTypes(&types));
	EXPECT_EQ("", AppsFor("x-test/new"));
}


TEST_F(BMimeTypeTest, FormerTypesStayListedUntilAFullSync)
{
	BMimeType app("application/x-app");
	BMessage types = Types({ "x-test/a", "x-test/b" });
	ASSERT_EQ(B_OK, app.SetSupportedTypes(&types));
	types = Types({ "x-test/b" });
	ASSERT_EQ(B_OK, app.SetSupportedTypes(&types, false));
	types = Types({ "x-test/c" });
	ASSERT_EQ(B_OK, app.SetSupportedTypes(&types, false));
	for (const char* type : { "x-test/a", "x-test/b", "x-test/c" })
		EXPECT_EQ("application/x-app", AppsFor(type)) << type;
	ASSERT_EQ(B_OK, app.GetSupportedTypes(&types));
	EXPECT_EQ("x-test/c", Joined(types, "types"));

	// One that is supported again is no longer a former one.
	types = Types({ "x-test/a" });
	ASSERT_EQ(B_OK, app.SetSupportedTypes(&types, false));
	ASSERT_EQ(B_OK, app.SetSupportedTypes(&types, true));
	EXPECT_EQ("application/x-app", AppsFor("x-test/a"));
	EXPECT_EQ("", AppsFor("x-test/b"));
	EXPECT_EQ("", AppsFor("x-test/c"));
}


TEST_F(BMimeTypeTest, ProgramsForAnyFileNameTheGeneralType)
{
	const BMessage any = Types({ B_FILE_MIME_TYPE });
	const BMessage family = Types({ "application" });
	ASSERT_EQ(B_OK, BMimeType("application/x-any").SetSupportedTypes(&any));
	ASSERT_EQ(B_OK, BMimeType("application/x-family").SetSupportedTypes(&family));
	BMessage apps;
	ASSERT_EQ(B_OK, BMimeType::GetWildcardApps(&apps));
	EXPECT_EQ("application/x-any", Joined(apps, "applications"));
	EXPECT_EQ("", AppsFor("text/plain"));
	EXPECT_EQ(B_BAD_VALUE, BMimeType::GetWildcardApps(NULL));
}


TEST_F(BMimeTypeTest, AProgramsFileTellsWhatItSupports)
{
	const std::string path = fFolder / "program";
	WriteFile(path, "");
	BFile file(path.c_str(), B_READ_WRITE);
	BAppFileInfo info(&file);
	BMessage types = Types({ "x-test/a", "x-test/b" });
	ASSERT_EQ(B_OK, info.SetSupportedTypes(&types));
	EXPECT_EQ("", AppsFor("x-test/a")); // nobody's

	ASSERT_EQ(B_OK, info.SetSignature("application/x-vnd.test"));
	ASSERT_EQ(B_OK, info.SetSupportedTypes(&types));
	EXPECT_EQ("application/x-vnd.test", AppsFor("x-test/a"));
	types = Types({ "x-test/b" });
	ASSERT_EQ(B_OK, info.SetSupportedTypes(&types, false));
	EXPECT_EQ("application/x-vnd.test", AppsFor("x-test/a"));
	ASSERT_EQ(B_OK, info.SetSupportedTypes(&types, true));
	EXPECT_EQ("", AppsFor("x-test/a"));
	EXPECT_EQ("application/x-vnd.test", AppsFor("x-test/b"));
	ASSERT_EQ(B_OK, info.SetSupportedTypes(NULL, true));
	EXPECT_EQ("", AppsFor("x-test/b"));
}


TEST_F(BMimeTypeTest, AProgramsFileMakesItsSignatureKnown)
{
	std::filesystem::create_directories(fFolder / "apps/more");
	const std::string path = fFolder / "apps/more/Program";
	WriteFile(path, "");
	WriteFile(fFolder / "apps/other", "no program");
	BBitmap icon(BRect(0, 0, 15, 15), B_CMAP8);
	memset(icon.Bits(), 7, icon.BitsLength());
	BMessage types = Types({ "x-test/a" });
	{
		BFile file(path.c_str(), B_READ_WRITE);
		BAppFileInfo info(&file);
		ASSERT_EQ(B_OK, info.SetSupportedTypes(&types));
		ASSERT_EQ(B_OK, info.SetIcon(&icon, B_MINI_ICON));
		ASSERT_EQ(B_OK, info.SetIconForType("x-test/a", &icon, B_MINI_ICON));
		ASSERT_EQ(B_OK, info.SetSignature("application/x-vnd.test"));
	}
	EXPECT_EQ(B_ENTRY_NOT_FOUND, create_app_meta_mime((fFolder / "apps/other").c_str(), 0, 1, 0));
	EXPECT_EQ(B_ENTRY_NOT_FOUND, create_app_meta_mime((fFolder / "none").c_str(), 1, 1, 0));
	EXPECT_EQ(B_BAD_VALUE, create_app_meta_mime(NULL, 1, 1, 0));
	ASSERT_EQ(B_OK, create_app_meta_mime((fFolder / "apps").c_str(), 1, 1, 0));

	BMimeType app("application/x-vnd.test");
	entry_ref hint;
	ASSERT_EQ(B_OK, app.GetAppHint(&hint));
	EXPECT_STREQ("Program", hint.name);
	char text[B_MIME_TYPE_LENGTH + 1];
	ASSERT_EQ(B_OK, app.GetShortDescription(text));
	EXPECT_STREQ("Program", text);
	EXPECT_EQ("application/x-vnd.test", AppsFor("x-test/a"));
	for (const char* type : { static_cast<const char*>(NULL), "x-test/a" }) {
		BBitmap found(BRect(0, 0, 15, 15), B_CMAP8);
		ASSERT_EQ(B_OK, app.GetIconForType(type, &found, B_MINI_ICON));
		EXPECT_EQ(0, memcmp(icon.Bits(), found.Bits(), icon.BitsLength()));
		EXPECT_EQ(B_ENTRY_NOT_FOUND, app.GetIconForType(type, &found, B_LARGE_ICON));
	}

	// What was set stays unless it is to be replaced.
	ASSERT_EQ(B_OK, app.SetShortDescription("A test"));
	ASSERT_EQ(B_OK, create_app_meta_mime(path.c_str(), 0, 1, 0));
	ASSERT_EQ(B_OK, app.GetShortDescription(text));
	EXPECT_STREQ("A test", text);
	ASSERT_EQ(B_OK, create_app_meta_mime(path.c_str(), 0, 1, 1));
	ASSERT_EQ(B_OK, app.GetShortDescription(text));
	EXPECT_STREQ("Program", text);
}
