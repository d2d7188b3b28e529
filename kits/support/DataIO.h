// BDataIO, BPositionIO: streams; BMemoryIO, BMallocIO: streams over memory.
#pragma once

#include <SupportDefs.h>

// Read() and Write() return the number of bytes moved, 0 at the end, or an error.
class BDataIO {
public:
	BDataIO();
	virtual ~BDataIO();
	BDataIO(const BDataIO&) = delete;
	BDataIO& operator=(const BDataIO&) = delete;

	virtual ssize_t Read(void* buffer, size_t size);
	virtual ssize_t Write(const void* buffer, size_t size);
	virtual status_t Flush();

	// Moves exactly that many bytes: B_PARTIAL_READ at an early end, B_PARTIAL_WRITE.
	status_t ReadExactly(void* buffer, size_t size, size_t* _bytesRead = NULL);
	status_t WriteExactly(const void* buffer, size_t size, size_t* _bytesWritten = NULL);
};

class BPositionIO : public BDataIO {
public:
	BPositionIO();
	~BPositionIO() override;

	// At the stream's position, which moves by the bytes moved.
	ssize_t Read(void* buffer, size_t size) override;
	ssize_t Write(const void* buffer, size_t size) override;

	virtual ssize_t ReadAt(off_t position, void* buffer, size_t size) = 0;
	virtual ssize_t WriteAt(off_t position, const void* buffer, size_t size) = 0;

	status_t ReadAtExactly(off_t position, void* buffer, size_t size, size_t* _bytesRead = NULL);
	status_t WriteAtExactly(
		off_t position, const void* buffer, size_t size, size_t* _bytesWritten = NULL);

	virtual off_t Seek(off_t position, uint32 seekMode) = 0; // SEEK_SET, SEEK_CUR, SEEK_END
	virtual off_t Position() const = 0;
	virtual status_t SetSize(off_t size);
	virtual status_t GetSize(off_t* size) const;
};

// A window on the caller's memory, which must outlive it. Never grows.
class BMemoryIO : public BPositionIO {
public:
	BMemoryIO(void* data, size_t length);
	BMemoryIO(const void* data, size_t length); // read only: B_NOT_ALLOWED on writing
	~BMemoryIO() override;

	ssize_t ReadAt(off_t position, void* buffer, size_t size) override;
	ssize_t WriteAt(off_t position, const void* buffer, size_t size) override;
	off_t Seek(off_t position, uint32 seekMode) override;
	off_t Position() const override;
	status_t SetSize(off_t size) override; // up to the length given at first

private:
	bool fReadOnly;
	char* fBuffer; // borrowed
	size_t fLength;
	size_t fBufferSize;
	size_t fPosition = 0;
};

// Memory of its own that grows as it is written; a gap that was never written reads as zeros.
class BMallocIO : public BPositionIO {
public:
	BMallocIO();
	~BMallocIO() override;

	ssize_t ReadAt(off_t position, void* buffer, size_t size) override;
	ssize_t WriteAt(off_t position, const void* buffer, size_t size) override;
	off_t Seek(off_t position, uint32 seekMode) override;
	off_t Position() const override;
	status_t SetSize(off_t size) override;

	void SetBlockSize(size_t blockSize); // by how much it grows at least
	const void* Buffer() const; // valid until the next change; NULL when nothing was written
	size_t BufferLength() const;

private:
	bool _Reserve(size_t size);

	size_t fBlockSize = 256;
	size_t fCapacity = 0;
	size_t fLength = 0;
	char* fData = nullptr;
	size_t fPosition = 0;
};
