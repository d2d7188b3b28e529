// Any bytes as an image: a file of one of the known formats, or a stream of rows.

#include <memory>
#include <stdlib.h>

#include <Bitmap.h>
#include <BitmapStream.h>
#include <DataIO.h>
#include <TranslationUtils.h>

namespace {

void
Require(bool condition)
{
	if (!condition)
		abort();
}

} // namespace


extern "C" int
LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
	BMemoryIO file(static_cast<const void*>(data), size);
	const std::unique_ptr<BBitmap> bitmap(BTranslationUtils::GetBitmap(&file));
	if (bitmap != nullptr) {
		Require(bitmap->IsValid() && bitmap->BitsLength() > 0);
		Require(
			bitmap->BytesPerRow() * (bitmap->Bounds().IntegerHeight() + 1) == bitmap->BitsLength());
	}

	// A stream takes the same bytes in pieces, and never claims more than it has.
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
		Require((size_t)written->BitsLength() + sizeof(TranslatorBitmap) <= size);
	}
	return 0;
}
