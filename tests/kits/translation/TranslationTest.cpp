#include <TranslationKit.h>

#include <File.h>
#include <Message.h>
#include <algorithm>
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


// #pragma mark - added translators

namespace {

constexpr uint32 kTestFormat = 'tstf';
constexpr char kTestData[] = "test data";

// Knows data that begins with a word of its own, and writes the word reversed.
class TestTranslator : public BTranslator {
public:
	TestTranslator(bool* _deleted) : fDeleted(_deleted) {}

	const char* TranslatorName() const override { return "Test"; }
	const char* TranslatorInfo() const override { return "For the test"; }
	int32 TranslatorVersion() const override { return 123; }

	const translation_format* InputFormats(int32* _count) const override
	{
		*_count = 1;
		return &kFormat;
	}

	const translation_format* OutputFormats(int32* _count) const override
	{
		return InputFormats(_count);
	}

	status_t Identify(BPositionIO* source, const translation_format*, BMessage*,
		translator_info* _info, uint32 outType) override
	{
		char word[sizeof(kTestData) - 1];
		if (source->Read(word, sizeof(word)) != ssize_t(sizeof(word))
			|| memcmp(word, kTestData, sizeof(word)) != 0
			|| (outType != 0 && outType != kTestFormat))
			return B_NO_TRANSLATOR;
		_info->type = kTestFormat;
		_info->group = B_TRANSLATOR_TEXT;
		_info->quality = _info->capability = 0.5;
		strcpy(_info->name, "Test format");
		strcpy(_info->MIME, "text/x-test");
		return B_OK;
	}

	status_t Translate(BPositionIO* source, const translator_info*, BMessage*, uint32,
		BPositionIO* destination) override
	{
		char word[sizeof(kTestData) - 1];
		source->Read(word, sizeof(word));
		std::reverse(word, word + sizeof(word));
		destination->Write(word, sizeof(word));
		return B_OK;
	}

protected:
	~TestTranslator() override { *fDeleted = true; }

private:
	static constexpr translation_format kFormat = { kTestFormat, B_TRANSLATOR_TEXT, 0.5, 0.5,
		"text/x-test", "Test format" };

	bool* fDeleted; // borrowed
};

} // namespace


TEST(Translator, IsAskedWhenItWasAdded)
{
	bool deleted = false;
	BTranslatorRoster roster;
	BTranslator* translator = new TestTranslator(&deleted);
	ASSERT_EQ(B_OK, roster.AddTranslator(translator));
	BMemoryIO source(kTestData, strlen(kTestData));
	translator_info info;
	ASSERT_EQ(B_OK, roster.Identify(&source, NULL, &info));
	EXPECT_EQ(kTestFormat, info.type);
	EXPECT_STREQ("text/x-test", info.MIME);
	EXPECT_EQ(B_NO_TRANSLATOR, roster.Identify(&source, NULL, &info, 0, NULL, B_PNG_FORMAT));

	for (const bool byInfo : { true, false }) {
		BMallocIO destination;
		ASSERT_EQ(B_OK,
			byInfo ? roster.Translate(&source, NULL, NULL, &destination, kTestFormat)
				   : roster.Translate(info.translator, &source, NULL, &destination, kTestFormat));
		EXPECT_EQ("atad tset",
			std::string(
				static_cast<const char*>(destination.Buffer()), destination.BufferLength()));
	}
	EXPECT_EQ(B_NO_TRANSLATOR,
		BTranslatorRoster::Default()->Translate(
			info.translator, &source, NULL, &source, kTestFormat));
	translator->Release();
	EXPECT_FALSE(deleted);
}


TEST(Translator, IsListedAndToldAbout)
{
	bool deleted = false;
	{
		BTranslatorRoster roster;
		BTranslator* translator = new TestTranslator(&deleted);
		EXPECT_EQ(B_BAD_VALUE, roster.AddTranslator(NULL));
		roster.AddTranslator(translator);
		EXPECT_EQ(2, translator->ReferenceCount());
		EXPECT_EQ(translator, translator->Release());

		translator_id* ids;
		int32 count;
		ASSERT_EQ(B_OK, roster.GetAllTranslators(&ids, &count));
		ASSERT_EQ(2, count);
		const translator_id id = ids[1];
		delete[] ids;
		const char* name;
		const char* text;
		int32 version;
		ASSERT_EQ(B_OK, roster.GetTranslatorInfo(id, &name, &text, &version));
		EXPECT_STREQ("Test", name);
		EXPECT_STREQ("For the test", text);
		EXPECT_EQ(123, version);
		const translation_format* formats;
		ASSERT_EQ(B_OK, roster.GetInputFormats(id, &formats, &count));
		ASSERT_EQ(1, count);
		EXPECT_EQ(kTestFormat, formats[0].type);
		ASSERT_EQ(B_OK, roster.GetOutputFormats(id, &formats, &count));
		BMessage settings;
		EXPECT_EQ(B_ERROR, roster.GetConfigurationMessage(id, &settings));
		EXPECT_EQ(B_NO_TRANSLATOR, roster.GetConfigurationMessage(99, &settings));
	}
	EXPECT_TRUE(deleted);
}


TEST(Translator, TheBetterOneIsTaken)
{
	bool deleted = false;
	BTranslatorRoster roster;
	BTranslator* translator = new TestTranslator(&deleted);
	roster.AddTranslator(translator);
	translator->Release();
	const std::string png = Encode(B_PNG_FORMAT, 3, 3);
	BMemoryIO image(static_cast<const void*>(png.data()), png.size());
	translator_info* infos;
	int32 count;
	ASSERT_EQ(B_OK, roster.GetTranslators(&image, NULL, &infos, &count));
	ASSERT_EQ(1, count);
	EXPECT_EQ(uint32(B_PNG_FORMAT), infos[0].type);
	delete[] infos;
	BBitmapStream stream;
	EXPECT_EQ(B_OK, roster.Translate(&image, NULL, NULL, &stream, B_TRANSLATOR_BITMAP));
}
