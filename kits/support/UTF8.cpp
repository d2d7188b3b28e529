#include <UTF8.h>

#include <cerrno>

#include <iconv.h>

namespace {

// By the values of the conversion codes.
constexpr const char* kEncodings[] = { "ISO-8859-1", "ISO-8859-2", "ISO-8859-3", "ISO-8859-4",
	"ISO-8859-5", "ISO-8859-6", "ISO-8859-7", "ISO-8859-8", "ISO-8859-9", "ISO-8859-10",
	"MACINTOSH", "SHIFT_JIS", "EUC-JP", "ISO-2022-JP", "CP1252", "UTF-16BE", "KOI8-R", "CP1251",
	"CP866", "CP437", "EUC-KR" };
constexpr uint32 kEncodingCount = sizeof(kEncodings) / sizeof(kEncodings[0]);


class Converter {
public:
	Converter(const char* to, const char* from) : fHandle(iconv_open(to, from)) {}

	~Converter()
	{
		if (IsValid())
			iconv_close(fHandle);
	}

	Converter(const Converter&) = delete;
	Converter& operator=(const Converter&) = delete;

	bool IsValid() const { return fHandle != iconv_t(-1); }

	// Returns the error number, 0 when the source was used up.
	int Convert(char** source, size_t* sourceLeft, char** destination, size_t* destinationLeft)
	{
		const size_t result = iconv(fHandle, source, sourceLeft, destination, destinationLeft);
		return result == size_t(-1) ? errno : 0;
	}

	void Finish(char** destination, size_t* destinationLeft)
	{
		iconv(fHandle, nullptr, nullptr, destination, destinationLeft);
	}

private:
	iconv_t fHandle;
};


// Bytes to skip for one character that cannot be converted.
size_t
bad_length(const char* source, size_t left, bool fromUtf8, bool wide)
{
	if (wide)
		return min_c(left, size_t(2));
	size_t length = 1;
	while (fromUtf8 && length < left && (static_cast<unsigned char>(source[length]) & 0xc0) == 0x80)
		length++;
	return length;
}


status_t
convert(const char* from, const char* to, const char* source, int32* sourceLength,
	char* destination, int32* destinationLength, char substitute, bool fromUtf8)
{
	if (source == nullptr || destination == nullptr || sourceLength == nullptr
		|| destinationLength == nullptr || *sourceLength < 0 || *destinationLength < 0)
		return B_BAD_VALUE;
	Converter converter(to, from);
	Converter substituter(to, "ASCII");
	if (!converter.IsValid() || !substituter.IsValid())
		return B_ERROR;

	char* in = const_cast<char*>(source);
	size_t inLeft = size_t(*sourceLength);
	char* out = destination;
	size_t outLeft = size_t(*destinationLength);
	const bool wide = !fromUtf8 && from == kEncodings[B_UNICODE_CONVERSION];
	while (inLeft > 0 && converter.Convert(&in, &inLeft, &out, &outLeft) == EILSEQ) {
		char* text = &substitute;
		size_t textLeft = 1;
		if (substituter.Convert(&text, &textLeft, &out, &outLeft) != 0)
			break;
		const size_t bad = bad_length(in, inLeft, fromUtf8, wide);
		in += bad;
		inLeft -= bad;
	}
	converter.Finish(&out, &outLeft);
	*sourceLength -= static_cast<int32>(inLeft);
	*destinationLength -= static_cast<int32>(outLeft);
	return B_OK;
}

} // namespace


status_t
convert_to_utf8(uint32 sourceEncoding, const char* source, int32* sourceLength, char* destination,
	int32* destinationLength, int32* state, char substitute)
{
	if (sourceEncoding >= kEncodingCount)
		return B_ERROR;
	return convert(kEncodings[sourceEncoding], "UTF-8", source, sourceLength, destination,
		destinationLength, substitute, false);
}


status_t
convert_from_utf8(uint32 destinationEncoding, const char* source, int32* sourceLength,
	char* destination, int32* destinationLength, int32* state, char substitute)
{
	if (destinationEncoding >= kEncodingCount)
		return B_ERROR;
	return convert("UTF-8", kEncodings[destinationEncoding], source, sourceLength, destination,
		destinationLength, substitute, true);
}
