#include <TranslationKit.h>

#include <File.h>
#include <gtest/gtest.h>
#include <memory>
#include <random>
#include <stdio.h>
#include <string.h>
#include <string>
#include <unistd.h>

namespace {

std::unique_ptr<BBitmap>
MakeBitmap(int32 width, int32 height, color_space space = B_RGBA32)
{
	auto bitmap = std::make_unique<BBitmap>(BRect(0, 0, width - 1, height - 1), 0, space);
	std::mt19937 random(width);
	uint8* bits = static_cast<uint8*>(bitmap->Bits());
	for (int32 i = 0; i < bitmap->BitsLength(); i++)
		bits[i] = i % 4 == 3 ? 255 : random();
	return bitmap;
}


std::string
Encode(uint32 type, int32 width, int32 height)
{
	BBitmapStream source(MakeBitmap(width, height).release());
	BMallocIO destination;
	EXPECT_EQ(
		B_OK, BTranslatorRoster::Default()->Translate(&source, NULL, NULL, &destination, type));
	return std::string(static_cast<const char*>(destination.Buffer()), destination.BufferLength());
}


std::unique_ptr<BBitmap>
Decode(const std::string& bytes)
{
	BMemoryIO stream(static_cast<const void*>(bytes.data()), bytes.size());
	return std::unique_ptr<BBitmap>(BTranslationUtils::GetBitmap(&stream));
}


void
PutNumber(std::string& bytes, size_t at, uint32 number)
{
	for (int i = 0; i < 4; i++)
		bytes[at + i] = number >> (24 - 8 * i);
}

} // namespace


TEST(Translation, LosslessFormatsGiveTheSamePixels)
{
	const std::unique_ptr<BBitmap> original = MakeBitmap(37, 21);
	for (uint32 type : { (uint32)'PNG ', (uint32)'BMP ', (uint32)B_TRANSLATOR_BITMAP }) {
		const std::unique_ptr<BBitmap> copy = Decode(Encode(type, 37, 21));
		ASSERT_NE(nullptr, copy);
		ASSERT_EQ(original->Bounds(), copy->Bounds());
		EXPECT_EQ(0, memcmp(original->Bits(), copy->Bits(), original->BitsLength()));
	}
}


TEST(Translation, FilesAreReadByPath)
{
	char path[] = "/tmp/archway-translation-XXXXXX";
	const int file = mkstemp(path);
	ASSERT_GE(file, 0);
	const std::string png = Encode('PNG ', 5, 4);
	ASSERT_EQ((ssize_t)png.size(), write(file, png.data(), png.size()));
	close(file);

	const std::unique_ptr<BBitmap> bitmap(BTranslationUtils::GetBitmapFile(path));
	unlink(path);

	ASSERT_NE(nullptr, bitmap);
	EXPECT_EQ(BRect(0, 0, 4, 3), bitmap->Bounds());
	EXPECT_EQ(nullptr, BTranslationUtils::GetBitmapFile(path));
	EXPECT_EQ(nullptr, BTranslationUtils::GetBitmapFile(NULL));
}


TEST(Translation, DataIsIdentified)
{
	const std::string png = Encode('PNG ', 5, 4);
	BMemoryIO stream(static_cast<const void*>(png.data()), png.size());
	translator_info info;
	ASSERT_EQ(B_OK, BTranslatorRoster::Default()->Identify(&stream, NULL, &info));
	EXPECT_EQ((uint32)'PNG ', info.type);
	EXPECT_EQ((uint32)B_TRANSLATOR_BITMAP, info.group);
	EXPECT_STREQ("image/png", info.MIME);
}


TEST(Translation, OtherDataHasNoTranslator)
{
	const std::string text = "This is no image at all, just a text.";
	BMemoryIO stream(static_cast<const void*>(text.data()), text.size());
	BMallocIO destination;
	translator_info info;
	EXPECT_EQ(B_NO_TRANSLATOR, BTranslatorRoster::Default()->Identify(&stream, NULL, &info));
	EXPECT_EQ(B_NO_TRANSLATOR,
		BTranslatorRoster::Default()->Translate(
			&stream, NULL, NULL, &destination, B_TRANSLATOR_BITMAP));
	EXPECT_EQ(nullptr, Decode(text));
	EXPECT_EQ(nullptr, Decode(""));
}


TEST(Translation, BombIsRefused)
{
	std::string png = Encode('PNG ', 5, 4);
	PutNumber(png, 16, 60000);
	PutNumber(png, 20, 60000);
	EXPECT_EQ(nullptr, Decode(png));

	std::string bits = Encode(B_TRANSLATOR_BITMAP, 5, 4);
	PutNumber(bits, 20, 0x7fffffff);
	EXPECT_EQ(nullptr, Decode(bits));
}


TEST(Translation, DamagedImagesAreSafe)
{
	std::mt19937 random(6);
	for (uint32 type : { (uint32)'PNG ', (uint32)'BMP ', (uint32)'JPEG', (uint32)'bits' }) {
		const std::string good = Encode(type, 9, 7);
		for (size_t length = 0; length < good.size(); length++)
			Decode(good.substr(0, length));
		for (int i = 0; i < 300; i++) {
			std::string bad = good;
			bad[random() % bad.size()] ^= 1 << random() % 8;
			Decode(bad);
		}
	}
}


TEST(Translation, FormatsAreListed)
{
	const translation_format* formats;
	int32 count;
	ASSERT_EQ(B_OK, BTranslatorRoster::Default()->GetInputFormats(1, &formats, &count));
	bool png = false;
	bool jpeg = false;
	for (int32 i = 0; i < count; i++) {
		png |= formats[i].type == 'PNG ';
		jpeg |= formats[i].type == 'JPEG';
	}
	EXPECT_TRUE(png && jpeg);
	EXPECT_EQ(B_NO_TRANSLATOR, BTranslatorRoster::Default()->GetInputFormats(99, &formats, &count));
}


TEST(BitmapStream, ReadsAsHeaderAndRows)
{
	std::unique_ptr<BBitmap> bitmap = MakeBitmap(3, 2);
	const std::string rows(static_cast<const char*>(bitmap->Bits()), bitmap->BitsLength());
	BBitmapStream stream(bitmap.release());
	EXPECT_EQ(32 + 24, stream.Size());
	std::string all(100, '\0');
	ASSERT_EQ(56, stream.Read(all.data(), all.size()));
	EXPECT_EQ("bits", all.substr(0, 4));
	EXPECT_EQ(rows, all.substr(32, 24));
	EXPECT_EQ(0, stream.Read(all.data(), all.size()));
}


TEST(BitmapStream, BytewiseWritingMakesTheBitmap)
{
	BBitmapStream source(MakeBitmap(3, 2).release());
	std::string bytes(source.Size(), '\0');
	source.ReadAt(0, bytes.data(), bytes.size());

	BBitmapStream stream;
	BBitmap* bitmap = NULL;
	for (char byte : bytes) {
		EXPECT_EQ(B_ERROR, stream.DetachBitmap(&bitmap));
		ASSERT_EQ(1, stream.Write(&byte, 1));
	}
	ASSERT_EQ(B_OK, stream.DetachBitmap(&bitmap));
	const std::unique_ptr<BBitmap> owner(bitmap);
	EXPECT_EQ(0, memcmp(bitmap->Bits(), bytes.data() + 32, 24));
}
