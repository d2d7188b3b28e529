#include <BitmapStream.h>

#include <algorithm>
#include <stdio.h>
#include <string.h>

#include <ByteOrder.h>
#include <Errors.h>

namespace {

constexpr off_t kHeaderSize = sizeof(TranslatorBitmap);
static_assert(sizeof(TranslatorBitmap) == 32, "the header has no padding");


BRect
SwapRect(const BRect& rect)
{
	return BRect(B_BENDIAN_TO_HOST_FLOAT(rect.left), B_BENDIAN_TO_HOST_FLOAT(rect.top),
		B_BENDIAN_TO_HOST_FLOAT(rect.right), B_BENDIAN_TO_HOST_FLOAT(rect.bottom));
}

} // namespace


BBitmapStream::BBitmapStream(BBitmap* bitmap) :
	fHeader(), fHeaderSize(0), fPosition(0), fWritten(0), fBitmap(bitmap)
{
	if (fBitmap != nullptr && fBitmap->IsValid())
		_WriteHeader();
}


BBitmapStream::~BBitmapStream()
{
}


ssize_t
BBitmapStream::ReadAt(off_t position, void* buffer, size_t size)
{
	if (buffer == NULL || position < 0)
		return B_BAD_VALUE;
	if (fBitmap == nullptr)
		return B_NO_INIT;
	if (position >= Size())
		return 0;
	size = std::min<off_t>(size, Size() - position);
	size_t copied = 0;
	if (position < kHeaderSize) {
		copied = std::min<size_t>(size, kHeaderSize - position);
		memcpy(buffer, reinterpret_cast<const char*>(&fHeader) + position, copied);
		position += copied;
	}
	if (copied < size) {
		memcpy(static_cast<char*>(buffer) + copied,
			static_cast<const char*>(fBitmap->Bits()) + position - kHeaderSize, size - copied);
	}
	return size;
}


ssize_t
BBitmapStream::WriteAt(off_t position, const void* data, size_t size)
{
	if (data == NULL || position < 0 || position > fWritten)
		return B_BAD_VALUE;
	const char* from = static_cast<const char*>(data);
	size_t written = 0;
	if (position < kHeaderSize) {
		written = std::min<size_t>(size, kHeaderSize - position);
		memcpy(reinterpret_cast<char*>(&fHeader) + position, from, written);
		position += written;
		fHeaderSize = std::max(fHeaderSize, position);
		if (fHeaderSize == kHeaderSize) {
			const status_t status = _ReadHeader();
			if (status != B_OK)
				return status;
		}
	}
	if (written < size && fBitmap != nullptr) {
		const off_t start = position - kHeaderSize;
		const off_t room = std::max<off_t>(0, fBitmap->BitsLength() - start);
		const size_t count = std::min<off_t>(size - written, room);
		memcpy(static_cast<char*>(fBitmap->Bits()) + start, from + written, count);
		position += count;
		written += count;
	}
	fWritten = std::max(fWritten, position);
	return written;
}


off_t
BBitmapStream::Seek(off_t position, uint32 whence)
{
	off_t base = 0;
	if (whence == SEEK_CUR)
		base = fPosition;
	else if (whence == SEEK_END)
		base = Size();
	else if (whence != SEEK_SET)
		return B_BAD_VALUE;
	off_t target;
	if (__builtin_add_overflow(base, position, &target) || target < 0 || target > Size())
		return B_BAD_VALUE;
	fPosition = target;
	return fPosition;
}


off_t
BBitmapStream::Position() const
{
	return fPosition;
}


off_t
BBitmapStream::Size() const
{
	if (fBitmap == nullptr || fHeaderSize < kHeaderSize)
		return fHeaderSize;
	return kHeaderSize + fBitmap->BitsLength();
}


status_t
BBitmapStream::SetSize(off_t size)
{
	// The header decides the size.
	return size >= 0 ? B_OK : B_BAD_VALUE;
}


status_t
BBitmapStream::GetSize(off_t* size) const
{
	if (size == NULL)
		return B_BAD_VALUE;
	*size = Size();
	return B_OK;
}


status_t
BBitmapStream::DetachBitmap(BBitmap** _bitmap)
{
	if (_bitmap == NULL)
		return B_BAD_VALUE;
	*_bitmap = NULL;
	if (fBitmap == nullptr || !fBitmap->IsValid() || fWritten < Size())
		return B_ERROR;
	*_bitmap = fBitmap.release();
	fHeaderSize = fPosition = fWritten = 0;
	return B_OK;
}


// #pragma mark - private


void
BBitmapStream::_WriteHeader()
{
	fHeader.magic = B_HOST_TO_BENDIAN_INT32(B_TRANSLATOR_BITMAP);
	fHeader.bounds = SwapRect(fBitmap->Bounds());
	fHeader.rowBytes = B_HOST_TO_BENDIAN_INT32(fBitmap->BytesPerRow());
	fHeader.colors = (color_space)B_HOST_TO_BENDIAN_INT32(fBitmap->ColorSpace());
	fHeader.dataSize = B_HOST_TO_BENDIAN_INT32(fBitmap->BitsLength());
	fHeaderSize = kHeaderSize;
	fWritten = kHeaderSize + fBitmap->BitsLength();
}


// Makes the bitmap that the header describes, unless there is such a one already.
status_t
BBitmapStream::_ReadHeader()
{
	const BRect bounds = SwapRect(fHeader.bounds);
	const color_space space = (color_space)B_BENDIAN_TO_HOST_INT32(fHeader.colors);
	const int32 rowBytes = B_BENDIAN_TO_HOST_INT32(fHeader.rowBytes);
	const uint32 dataSize = B_BENDIAN_TO_HOST_INT32(fHeader.dataSize);
	if ((uint32)B_BENDIAN_TO_HOST_INT32(fHeader.magic) != B_TRANSLATOR_BITMAP || rowBytes <= 0)
		return B_BAD_DATA;
	if (fBitmap != nullptr && fBitmap->Bounds() == bounds && fBitmap->ColorSpace() == space
		&& fBitmap->BytesPerRow() == rowBytes)
		return B_OK;

	fBitmap = std::make_unique<BBitmap>(bounds, 0, space, rowBytes);
	if (fBitmap->IsValid() && (uint32)fBitmap->BitsLength() == dataSize)
		return B_OK;
	fBitmap.reset();
	fHeaderSize = 0;
	return B_BAD_DATA;
}
