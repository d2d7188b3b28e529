// arcv render, by the pictures that it writes.

#include <set>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <Bitmap.h>
#include <DataIO.h>
#include <Message.h>
#include <TranslationUtils.h>

#include "Program.h"
#include "kits/storage/TemporaryFolder.h"

using testing::HasSubstr;

namespace {

const std::string kDialog = ARCHWAY_TEST_DATA "/resources/23-dialog.rsrc";


// The colours of a picture, and its size.
struct Picture {
	int32 width = 0;
	int32 height = 0;
	std::set<uint32> colors;

	explicit Picture(const std::string& path)
	{
		const std::string bytes = ReadFile(path);
		BMemoryIO stream(static_cast<const void*>(bytes.data()), bytes.size());
		const std::unique_ptr<BBitmap> bitmap(BTranslationUtils::GetBitmap(&stream));
		if (bitmap == nullptr)
			return;
		width = bitmap->Bounds().IntegerWidth() + 1;
		height = bitmap->Bounds().IntegerHeight() + 1;
		for (int32 y = 0; y < height; y++) {
			const auto* row = reinterpret_cast<const uint32*>(
				static_cast<const char*>(bitmap->Bits()) + y * bitmap->BytesPerRow());
			for (int32 x = 0; x < width; x++)
				colors.insert(row[x] & 0xffffff);
		}
	}
};


std::string
Flatten(const BMessage& message)
{
	std::string bytes(message.FlattenedSize(), '\0');
	EXPECT_EQ(B_OK, message.Flatten(bytes.data(), bytes.size()));
	return bytes;
}


BMessage
Archive(const char* className)
{
	BMessage archive;
	archive.AddString("class", className);
	archive.AddRect("_frame", BRect(5, 5, 104, 54));
	archive.AddInt32("_color", 0x000000ff);
	archive.AddInt32("_color", 0x336699ff);
	archive.AddInt32("_color", 0x336699ff);
	return archive;
}

} // namespace


TEST(ArcvRender, PaintsAWholePanel)
{
	TemporaryFolder folder;
	const ProgramResult result = RunArcv({ "render", kDialog, "-o", folder / "picture.png" });
	EXPECT_EQ(0, result.status) << result.errors;
	const Picture picture(folder / "picture.png");
	EXPECT_EQ(361, picture.width);
	EXPECT_EQ(261, picture.height);
	EXPECT_GT(picture.colors.size(), 20u); // labels have many shades
	EXPECT_EQ(0, RunArcv({ "render", kDialog, "ARCV:2", "-o", folder / "two.png" }).status);
	EXPECT_TRUE(ReadFile(folder / "picture.png") == ReadFile(folder / "two.png"));
}


TEST(ArcvRender, PaintsAMessageAlone)
{
	TemporaryFolder folder;
	WriteFile(folder / "archive", Flatten(Archive("BView")));
	ASSERT_EQ(0, RunArcv({ "render", folder / "archive", "-o", folder / "picture.png" }).status);
	const Picture picture(folder / "picture.png");
	EXPECT_EQ(100, picture.width);
	EXPECT_EQ(50, picture.height);
	EXPECT_EQ(std::set<uint32> { 0x336699 }, picture.colors);
}


TEST(ArcvRender, AnUnknownClassIsShownByItsName)
{
	TemporaryFolder folder;
	WriteFile(folder / "archive", Flatten(Archive("NobodyKnowsThis")));
	ASSERT_EQ(0, RunArcv({ "render", folder / "archive", "-o", folder / "picture.png" }).status);
	EXPECT_GT(Picture(folder / "picture.png").colors.size(), 3u);
}


TEST(ArcvRender, WhatIsNoViewIsRefused)
{
	TemporaryFolder folder;
	BMessage message;
	message.AddString("class", "NobodyKnowsThis");
	WriteFile(folder / "archive", Flatten(message));
	const ProgramResult result =
		RunArcv({ "render", folder / "archive", "-o", folder / "picture.png" });
	EXPECT_EQ(1, result.status);
	EXPECT_THAT(result.errors, HasSubstr("the archive is no view"));
	EXPECT_EQ(1, RunArcv({ "render", kDialog, "ARCV:77", "-o", folder / "picture.png" }).status);
	EXPECT_EQ(1u, folder.Count());
	BMessage huge = Archive("BView");
	huge.ReplaceRect("_frame", BRect(0, 0, 1e30f, 10));
	WriteFile(folder / "archive", Flatten(huge));
	EXPECT_EQ(0, RunArcv({ "render", folder / "archive", "-o", folder / "picture.png" }).status);
	EXPECT_EQ(8192, Picture(folder / "picture.png").width);
}
