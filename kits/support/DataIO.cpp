#include <DataIO.h>

#include <cstdio>
#include <cstdlib>
#include <cstring>


BDataIO::BDataIO()
{
}


BDataIO::~BDataIO()
{
}


ssize_t
BDataIO::Read(void*, size_t)
{
	return B_NOT_SUPPORTED;
}


ssize_t
BDataIO::Write(const void*, size_t)
{
	return B_NOT_SUPPORTED;
}


status_t
BDataIO::Flush()
{
	return B_OK;
}


status_t
BDataIO::ReadExactly(void* buffer, size_t size, size_t* _bytesRead)
{
	size_t done = 0;
	status_t status = B_OK;
	while (done < size && status == B_OK) {
		const ssize_t moved = Read(static_cast<char*>(buffer) + done, size - done);
		if (moved > 0)
			done += size_t(moved);
		else
			status = moved == 0 ? status_t(B_PARTIAL_READ) : status_t(moved);
	}
	if (_bytesRead != nullptr)
		*_bytesRead = done;
	return status;
}


status_t
BDataIO::WriteExactly(const void* buffer, size_t size, size_t* _bytesWritten)
{
	size_t done = 0;
	status_t status = B_OK;
	while (done < size && status == B_OK) {
		const ssize_t moved = Write(static_cast<const char*>(buffer) + done, size - done);
		if (moved > 0)
			done += size_t(moved);
		else
			status = moved == 0 ? status_t(B_PARTIAL_WRITE) : status_t(moved);
	}
	if (_bytesWritten != nullptr)
		*_bytesWritten = done;
	return status;
}


// #pragma mark - BPositionIO


BPositionIO::BPositionIO()
{
}


BPositionIO::~BPositionIO()
{
}


ssize_t
BPositionIO::Read(void* buffer, size_t size)
{
	const off_t position = Position();
	const ssize_t moved = ReadAt(position, buffer, size);
	if (moved > 0)
		Seek(position + moved, SEEK_SET);
	return moved;
}


ssize_t
BPositionIO::Write(const void* buffer, size_t size)
{
	const off_t position = Position();
	const ssize_t moved = WriteAt(position, buffer, size);
	if (moved > 0)
		Seek(position + moved, SEEK_SET);
	return moved;
}


status_t
BPositionIO::ReadAtExactly(off_t position, void* buffer, size_t size, size_t* _bytesRead)
{
	size_t done = 0;
	status_t status = B_OK;
	while (done < size && status == B_OK) {
		const ssize_t moved =
			ReadAt(position + off_t(done), static_cast<char*>(buffer) + done, size - done);
		if (moved > 0)
			done += size_t(moved);
		else
			status = moved == 0 ? status_t(B_PARTIAL_READ) : status_t(moved);
	}
	if (_bytesRead != nullptr)
		*_bytesRead = done;
	return status;
}


status_t
BPositionIO::WriteAtExactly(off_t position, const void* buffer, size_t size, size_t* _bytesWritten)
{
	size_t done = 0;
	status_t status = B_OK;
	while (done < size && status == B_OK) {
		const ssize_t moved =
			WriteAt(position + off_t(done), static_cast<const char*>(buffer) + done, size - done);
		if (moved > 0)
			done += size_t(moved);
		else
			status = moved == 0 ? status_t(B_PARTIAL_WRITE) : status_t(moved);
	}
	if (_bytesWritten != nullptr)
		*_bytesWritten = done;
	return status;
}


status_t
BPositionIO::SetSize(off_t)
{
	return B_ERROR;
}


status_t
BPositionIO::GetSize(off_t* size) const
{
	if (size == nullptr)
		return B_BAD_VALUE;

	BPositionIO* self = const_cast<BPositionIO*>(this);
	const off_t position = Position();
	const off_t end = self->Seek(0, SEEK_END);
	if (end < 0)
		return status_t(end);
	self->Seek(position, SEEK_SET);
	*size = end;
	return B_OK;
}


// Where a seek leads, or B_BAD_VALUE.
static off_t
seek_target(off_t offset, uint32 seekMode, size_t position, size_t length)
{
	off_t base;
	switch (seekMode) {
		case SEEK_SET:
			base = 0;
			break;
		case SEEK_CUR:
			base = off_t(position);
			break;
		case SEEK_END:
			base = off_t(length);
			break;
		default:
			return B_BAD_VALUE;
	}

	off_t target;
	if (__builtin_add_overflow(base, offset, &target) || target < 0)
		return B_BAD_VALUE;
	return target;
}


// #pragma mark - BMemoryIO


BMemoryIO::BMemoryIO(void* data, size_t length) :
	fReadOnly(false), fBuffer(static_cast<char*>(data)), fLength(length), fBufferSize(length)
{
}


BMemoryIO::BMemoryIO(const void* data, size_t length) :
	fReadOnly(true), fBuffer(const_cast<char*>(static_cast<const char*>(data))), fLength(length),
	fBufferSize(length)
{
}


BMemoryIO::~BMemoryIO()
{
}


ssize_t
BMemoryIO::ReadAt(off_t position, void* buffer, size_t size)
{
	if (buffer == nullptr || position < 0)
		return B_BAD_VALUE;
	if (size_t(position) >= fLength || size == 0)
		return 0;
	size = min_c(size, fLength - size_t(position));
	memcpy(buffer, fBuffer + position, size);
	return ssize_t(size);
}


ssize_t
BMemoryIO::WriteAt(off_t position, const void* buffer, size_t size)
{
	if (fReadOnly)
		return B_NOT_ALLOWED;
	if (buffer == nullptr || position < 0)
		return B_BAD_VALUE;
	if (size_t(position) >= fBufferSize || size == 0)
		return 0;
	size = min_c(size, fBufferSize - size_t(position));
	memcpy(fBuffer + position, buffer, size);
	fLength = max_c(fLength, size_t(position) + size);
	return ssize_t(size);
}


off_t
BMemoryIO::Seek(off_t position, uint32 seekMode)
{
	const off_t target = seek_target(position, seekMode, fPosition, fLength);
	if (target >= 0)
		fPosition = size_t(target);
	return target;
}


off_t
BMemoryIO::Position() const
{
	return off_t(fPosition);
}


status_t
BMemoryIO::SetSize(off_t size)
{
	if (fReadOnly)
		return B_NOT_ALLOWED;
	if (size < 0)
		return B_BAD_VALUE;
	if (size_t(size) > fBufferSize)
		return B_ERROR;
	fLength = size_t(size);
	return B_OK;
}


// #pragma mark - BMallocIO


BMallocIO::BMallocIO()
{
}


BMallocIO::~BMallocIO()
{
	free(fData);
}


ssize_t
BMallocIO::ReadAt(off_t position, void* buffer, size_t size)
{
	if (buffer == nullptr || position < 0)
		return B_BAD_VALUE;
	if (size_t(position) >= fLength || size == 0)
		return 0;
	size = min_c(size, fLength - size_t(position));
	memcpy(buffer, fData + position, size);
	return ssize_t(size);
}


ssize_t
BMallocIO::WriteAt(off_t position, const void* buffer, size_t size)
{
	if (buffer == nullptr || position < 0)
		return B_BAD_VALUE;
	if (size == 0)
		return 0;
	size_t end;
	if (__builtin_add_overflow(size_t(position), size, &end) || !_Reserve(end))
		return B_NO_MEMORY;
	if (size_t(position) > fLength)
		memset(fData + fLength, 0, size_t(position) - fLength);
	memcpy(fData + position, buffer, size);
	fLength = max_c(fLength, end);
	return ssize_t(size);
}


off_t
BMallocIO::Seek(off_t position, uint32 seekMode)
{
	const off_t target = seek_target(position, seekMode, fPosition, fLength);
	if (target >= 0)
		fPosition = size_t(target);
	return target;
}


off_t
BMallocIO::Position() const
{
	return off_t(fPosition);
}


status_t
BMallocIO::SetSize(off_t size)
{
	if (size < 0)
		return B_BAD_VALUE;
	if (!_Reserve(size_t(size)))
		return B_NO_MEMORY;
	if (size_t(size) > fLength)
		memset(fData + fLength, 0, size_t(size) - fLength);
	fLength = size_t(size);
	return B_OK;
}


void
BMallocIO::SetBlockSize(size_t blockSize)
{
	fBlockSize = max_c(blockSize, size_t(1));
}


const void*
BMallocIO::Buffer() const
{
	return fData;
}


size_t
BMallocIO::BufferLength() const
{
	return fLength;
}


bool
BMallocIO::_Reserve(size_t size)
{
	if (size <= fCapacity)
		return true;
	if (size > SIZE_MAX / 2 - fBlockSize)
		return false;
	const size_t blocks = (size + fBlockSize - 1) / fBlockSize;
	const size_t capacity = max_c(blocks * fBlockSize, fCapacity * 2);
	char* data = static_cast<char*>(realloc(fData, capacity));
	if (data == nullptr)
		return false;
	fData = data;
	fCapacity = capacity;
	return true;
}
