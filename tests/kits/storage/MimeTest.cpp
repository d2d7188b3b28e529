#include <sched.h>
#include <sys/stat.h>
#include <unistd.h>

#include <AppFileInfo.h>
#include <Entry.h>
#include <File.h>
#include <Message.h>
#include <Mime.h>
#include <NodeInfo.h>
#include <ResourceStrings.h>
#include <Resources.h>
#include <Roster.h>
#include <String.h>

#include "MimeFixture.h"

namespace {

using BAppFileInfoTest = MimeDatabaseTest;

} // namespace


TEST_F(BMimeTypeTest, KnowsWhatATypeIs)
{
	EXPECT_TRUE(BMimeType::IsValid("text/plain"));
	EXPECT_TRUE(BMimeType::IsValid("text"));
	for (const char* bad : { "", "text/", "/plain", "a/b/c", "te xt/plain", "text/pl@in" })
		EXPECT_FALSE(BMimeType::IsValid(bad)) << bad;
	EXPECT_FALSE(BMimeType::IsValid(NULL));
	BMimeType type("TEXT/Plain");
	EXPECT_TRUE(type == "text/plain");
	EXPECT_FALSE(type.IsSupertypeOnly());
	BMimeType super;
	ASSERT_EQ(B_OK, type.GetSupertype(&super));
	EXPECT_STREQ("TEXT", super.Type());
	EXPECT_TRUE(super.Contains(&type));
	EXPECT_FALSE(type.Contains(&super));
	EXPECT_EQ(B_BAD_VALUE, super.GetSupertype(&type));
	EXPECT_EQ(B_BAD_VALUE, type.SetTo("no type/"));
	EXPECT_EQ(NULL, type.Type());
}


TEST_F(BMimeTypeTest, GuessesByNames)
{
	const std::pair<const char*, const char*> cases[] = { { "a.txt", "text/plain" },
		{ "A.TXT", "text/plain" }, { "a.C", "text/x-c" }, { "a.c", "text/x-c++" },
		{ "a.tar.gz", "application/x-tar-gz" }, { "/some/where/a.gz", "application/gzip" },
		{ "makefile", "text/x-make" }, { "nothing", "application/octet-stream" } };
	for (const auto& [name, expected] : cases) {
		BMimeType type;
		ASSERT_EQ(B_OK, BMimeType::GuessMimeType(name, &type));
		EXPECT_STREQ(expected, type.Type()) << name;
	}
}


TEST_F(BMimeTypeTest, GuessesByBytes)
{
	EXPECT_EQ("image/png", Guess("\x89PNG and more"));
	EXPECT_EQ("application/octet-stream", Guess("\x89PN"));
	EXPECT_EQ("image/x-nested", Guess("N.......ok"));
	EXPECT_EQ("application/octet-stream", Guess("N......."));
	EXPECT_EQ("image/x-masked", Guess("\xf7"));
	EXPECT_EQ("application/octet-stream", Guess(""));
}


TEST_F(BMimeTypeTest, AFileWithoutAttributeHasAGuessedType)
{
	WriteFile(fFolder / "picture", "\x89PNG and more");
	BNode node((fFolder / "picture").c_str());
	char type[B_MIME_TYPE_LENGTH + 1];
	ASSERT_EQ(B_OK, BNodeInfo(&node).GetType(type));
	EXPECT_STREQ("image/png", type);
	BNode directory(fFolder.Path().c_str());
	ASSERT_EQ(B_OK, BNodeInfo(&directory).GetType(type));
	EXPECT_STREQ("application/x-vnd.Be-directory", type);
	ASSERT_EQ(B_OK, update_mime_info((fFolder / "picture").c_str(), 0, 1, 0));
	attr_info info;
	EXPECT_EQ(B_OK, node.GetAttrInfo("BEOS:TYPE", &info));
}


TEST_F(BMimeTypeTest, DescribesInTheUsersLanguage)
{
	char text[B_MIME_TYPE_LENGTH + 1];
	BMimeType type("image/png");
	ASSERT_EQ(B_OK, type.GetShortDescription(text));
	EXPECT_STREQ("PNG-Bild & mehr", text);
	BMessage extensions;
	ASSERT_EQ(B_OK, type.GetFileExtensions(&extensions));
	EXPECT_STREQ("png", extensions.FindString("extensions", (int32)0));
	EXPECT_STREQ("apng", extensions.FindString("extensions", (int32)1));
	EXPECT_EQ(B_ENTRY_NOT_FOUND, BMimeType("image/none").GetShortDescription(text));
}


TEST_F(BMimeTypeTest, WhatIsSetStays)
{
	BMimeType type("application/x-test");
	EXPECT_FALSE(type.IsInstalled());
	ASSERT_EQ(B_OK, type.Install());
	EXPECT_TRUE(type.IsInstalled());
	ASSERT_EQ(B_OK, type.SetShortDescription("A test"));
	ASSERT_EQ(B_OK, type.SetPreferredApp("application/x-vnd.Test"));
	char text[B_MIME_TYPE_LENGTH + 1];
	ASSERT_EQ(B_OK, BMimeType("Application/X-Test").GetShortDescription(text));
	EXPECT_STREQ("A test", text);
	BMessage types;
	ASSERT_EQ(B_OK, BMimeType::GetInstalledTypes("application", &types));
	bool found = false;
	const char* name;
	for (int32 i = 0; types.FindString("types", i, &name) == B_OK; i++)
		found = found || strcmp(name, "application/x-test") == 0;
	EXPECT_TRUE(found);
	ASSERT_EQ(B_OK, type.SetShortDescription(NULL));
	EXPECT_EQ(B_ENTRY_NOT_FOUND, type.GetShortDescription(text));
	ASSERT_EQ(B_OK, type.Delete());
	EXPECT_FALSE(type.IsInstalled());
	EXPECT_EQ(B_ENTRY_NOT_FOUND, type.Delete());
}


TEST_F(BAppFileInfoTest, WritesAttributesAndResources)
{
	const std::string path = fFolder / "program";
	WriteFile(path, "");
	{
		BFile file(path.c_str(), B_READ_WRITE);
		BAppFileInfo info(&file);
		ASSERT_EQ(B_OK, info.SetSignature("application/x-vnd.Test"));
		ASSERT_EQ(B_OK, info.SetAppFlags(5));
		BMessage types;
		types.AddString("types", "text");
		ASSERT_EQ(B_OK, info.SetSupportedTypes(&types));
		version_info version = { 1, 2, 3, 4, 5, "short", "long" };
		ASSERT_EQ(B_OK, info.SetVersionInfo(&version, B_SYSTEM_VERSION_KIND));
		EXPECT_TRUE(info.IsSupportedType("text/plain"));
		EXPECT_FALSE(info.IsSupportedType("image/png"));
	}
	BFile file(path.c_str(), B_READ_ONLY);
	for (const info_location where : { B_USE_ATTRIBUTES, B_USE_RESOURCES }) {
		BAppFileInfo info(&file);
		info.SetInfoLocation(where);
		char signature[B_MIME_TYPE_LENGTH + 1];
		ASSERT_EQ(B_OK, info.GetSignature(signature));
		EXPECT_STREQ("application/x-vnd.Test", signature);
		uint32 flags = 0;
		ASSERT_EQ(B_OK, info.GetAppFlags(&flags));
		EXPECT_EQ(5u, flags);
		version_info version;
		ASSERT_EQ(B_OK, info.GetVersionInfo(&version, B_SYSTEM_VERSION_KIND));
		EXPECT_EQ(3u, version.minor);
		EXPECT_STREQ("short", version.short_info);
		BMessage types;
		ASSERT_EQ(B_OK, info.GetSupportedTypes(&types));
		EXPECT_STREQ("text", types.FindString("types", (int32)0));
	}
}


TEST_F(BAppFileInfoTest, StringsComeFromResources)
{
	const std::string path = fFolder / "strings";
	WriteFile(path, "");
	{
		BResources resources(path.c_str());
		resources.AddResource('CSTR', 1, "hello", 6);
		resources.AddResource('CSTR', 2, "endless", 7);
	}
	entry_ref ref;
	ASSERT_EQ(B_OK, get_ref_for_path(path.c_str(), &ref));
	BResourceStrings strings(ref);
	ASSERT_EQ(B_OK, strings.InitCheck());
	EXPECT_STREQ("hello", strings.FindString(1));
	EXPECT_EQ(NULL, strings.FindString(2));
	EXPECT_EQ(NULL, strings.FindString(3));
	std::unique_ptr<BString> copy(strings.NewString(1));
	ASSERT_NE(nullptr, copy);
	EXPECT_STREQ("hello", copy->String());
}


TEST_F(BMimeTypeTest, LeadsToTheProgramForIt)
{
	const std::string program = fFolder / "program.sh";
	WriteFile(program, "#!/bin/sh\nprintf '%s ' \"$@\" > \"$0.new\" && mv \"$0.new\" \"$0.out\"\n");
	chmod(program.c_str(), 0755);
	WriteFile(fFolder / "file.txt", "text");
	entry_ref programRef;
	entry_ref fileRef;
	ASSERT_EQ(B_OK, get_ref_for_path(program.c_str(), &programRef));
	ASSERT_EQ(B_OK, get_ref_for_path((fFolder / "file.txt").c_str(), &fileRef));
	entry_ref found;
	EXPECT_EQ(B_LAUNCH_FAILED_NO_PREFERRED_APP, be_roster->FindApp("text/plain", &found));
	EXPECT_EQ(B_BAD_VALUE, be_roster->FindApp("no type/", &found));
	EXPECT_EQ(B_BAD_VALUE, be_roster->FindApp((entry_ref*)NULL, &found));

	// The supertype's program is taken when the type has none.
	ASSERT_EQ(B_OK, BMimeType("text").SetPreferredApp("application/x-vnd.Program"));
	EXPECT_EQ(B_LAUNCH_FAILED_APP_NOT_FOUND, be_roster->FindApp("text/plain", &found));
	ASSERT_EQ(B_OK, BMimeType("application/x-vnd.Program").SetAppHint(&programRef));
	EXPECT_EQ(B_OK, be_roster->FindApp("text/plain", &found));
	EXPECT_TRUE(programRef == found);
	EXPECT_EQ(B_OK, be_roster->FindApp(&fileRef, &found));
	EXPECT_TRUE(programRef == found);

	BMessage message(B_REFS_RECEIVED);
	message.AddRef("refs", &fileRef);
	team_id team = -1;
	ASSERT_EQ(B_OK, be_roster->Launch("text/plain", &message, &team));
	EXPECT_LT(0, team);
	while (access((program + ".out").c_str(), F_OK) != 0)
		sched_yield();
	EXPECT_EQ(fFolder / "file.txt" + std::string(" "), ReadFile(program + ".out"));
}
