// Any bytes as an image: a file of one of the known formats, or a stream of rows. What was read is
// written and read again.

#include <memory>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <sys/mman.h>
#include <unistd.h>

#include <Bitmap.h>
#include <BitmapStream.h>
#include <DataIO.h>
#include <Entry.h>
#include <TranslationUtils.h>
#include <TranslatorFormats.h>
#include <TranslatorRoster.h>

namespace {

void
Require(bool condition)
{
	if (!condition)
		abort();
}


void
RequireSame(const BBitmap& first, const BBitmap& second)
{
	Require(first.Bounds() == second.Bounds() && first.ColorSpace() == second.ColorSpace()
		&& first.BitsLength() == second.BitsLength()
		&& memcmp(first.Bits(), second.Bits(), first.BitsLength()) == 0);
}


void
RequireSound(const BBitmap& bitmap)
{
	Require(bitmap.IsValid() && bitmap.BitsLength() > 0);
	Require(bitmap.BytesPerRow() * (bitmap.Bounds().IntegerHeight() + 1) == bitmap.BitsLength());
}


// A bitmap is a stream of its header and rows, from which another one of the same kind is made.
void
WriteAndRead(const BBitmap& bitmap)
{
	BBitmapStream stream(new BBitmap(&bitmap));
	off_t size = 0;
	Require(stream.GetSize(&size) == B_OK && size == stream.Size());
	Require(size == bitmap.BitsLength() + static_cast<off_t>(sizeof(TranslatorBitmap)));
	Require(stream.SetSize(size) == B_OK && stream.SetSize(-1) != B_OK);
	Require(stream.Seek(-1, SEEK_SET) < 0 && stream.Seek(1, SEEK_END) < 0);
	Require(stream.Seek(0, SEEK_END) == size && stream.Seek(0, SEEK_CUR) == size);
	Require(stream.Seek(0, SEEK_SET) == 0 && stream.Position() == 0);
	BBitmapStream copy;
	char piece[1000];
	ssize_t read;
	while ((read = stream.Read(piece, sizeof(piece))) > 0)
		Require(copy.Write(piece, read) == read);
	BBitmap* made = NULL;
	Require(copy.DetachBitmap(&made) == B_OK);
	const std::unique_ptr<BBitmap> owner(made);
	RequireSame(bitmap, *made);
}


// A file without losses gives the same pixels.
void
EncodeAndDecode(const BBitmap& bitmap)
{
	if (bitmap.BitsLength() > 64 * 1024)
		return; // takes longer than it tells
	BBitmapStream stream(new BBitmap(&bitmap));
	BMallocIO file;
	Require(BTranslatorRoster::Default()->Translate(&stream, NULL, NULL, &file, 'PNG ') == B_OK);
	BMemoryIO again(file.Buffer(), file.BufferLength());
	const std::unique_ptr<BBitmap> decoded(BTranslationUtils::GetBitmap(&again));
	Require(decoded != nullptr);
	// A file knows whole pixels with red, green, blue and alpha.
	Require(decoded->Bounds().IntegerWidth() == bitmap.Bounds().IntegerWidth()
		&& decoded->Bounds().IntegerHeight() == bitmap.Bounds().IntegerHeight());
	if (bitmap.ColorSpace() == B_RGBA32 && decoded->BytesPerRow() == bitmap.BytesPerRow())
		Require(memcmp(bitmap.Bits(), decoded->Bits(), bitmap.BitsLength()) == 0);
}


// The same bytes in a file, which is nowhere but in memory.
void
ReadAsFile(const uint8_t* data, size_t size, const BBitmap* expected)
{
	const int memory = memfd_create("image", 0);
	Require(memory >= 0 && write(memory, data, size) == static_cast<ssize_t>(size));
	char path[40];
	snprintf(path, sizeof(path), "/proc/self/fd/%d", memory);
	const std::unique_ptr<BBitmap> bitmap(BTranslationUtils::GetBitmap(path));
	Require((bitmap != nullptr) == (expected != NULL));
	if (bitmap != nullptr)
		RequireSame(*expected, *bitmap);
	entry_ref ref;
	if (get_ref_for_path(path, &ref) == B_OK)
		delete BTranslationUtils::GetBitmap(&ref);
	close(memory);
}


// What can be read and written is known whatever was read before. Without an application there are
// no resources to take an image from.
void
RequireFormats(BTranslatorRoster& roster)
{
	translator_id* translators = NULL;
	int32 count = 0;
	Require(roster.GetAllTranslators(&translators, &count) == B_OK && count > 0);
	const translation_format* formats = NULL;
	int32 formatCount = 0;
	Require(
		roster.GetInputFormats(translators[0], &formats, &formatCount) == B_OK && formatCount > 5);
	Require(
		roster.GetOutputFormats(translators[0], &formats, &formatCount) == B_OK && formatCount > 3);
	delete[] translators;
	Require(BTranslationUtils::GetBitmap('bits', "name") == NULL);
	Require(BTranslationUtils::GetBitmap('bits', 1) == NULL);
}


// A stream takes bytes in pieces, and never claims more than it has.
void
ReadAsRows(const uint8_t* data, size_t size)
{
	BBitmapStream stream;
	for (size_t at = 0; at < size;) {
		const ssize_t written = stream.Write(data + at, size - at < 7 ? size - at : 7);
		if (written <= 0)
			break;
		at += written;
	}
	BBitmap* written = NULL;
	if (stream.DetachBitmap(&written) == B_OK) {
		const std::unique_ptr<BBitmap> owner(written);
		Require(static_cast<size_t>(written->BitsLength()) + sizeof(TranslatorBitmap) <= size);
		WriteAndRead(*written);
	}
}

} // namespace


extern "C" int
LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
	BMemoryIO file(static_cast<const void*>(data), size);
	const std::unique_ptr<BBitmap> bitmap(BTranslationUtils::GetBitmap(&file));
	if (bitmap != nullptr) {
		RequireSound(*bitmap);
		WriteAndRead(*bitmap);
		EncodeAndDecode(*bitmap);
	}
	translator_info info;
	file.Seek(0, SEEK_SET);
	BTranslatorRoster* roster = BTranslatorRoster::Default();
	const status_t known = roster->Identify(&file, NULL, &info);
	Require(bitmap == nullptr || known == B_OK);
	// A file takes several calls of the system, so not each time.
	if (size % 8 == 0) {
		ReadAsFile(data, size, bitmap.get());
		RequireFormats(*roster);
	}
	ReadAsRows(data, size);
	return 0;
}
