// BBitmapStream: a bitmap as a stream of the common image format.
#pragma once

#include <memory>

#include <Bitmap.h>
#include <DataIO.h>
#include <TranslatorFormats.h>


// The stream owns its bitmap until DetachBitmap(). Writing a header makes a new bitmap of that
// kind; a header that is not sensible ends in B_BAD_DATA. One thread at a time.
class BBitmapStream : public BPositionIO {
public:
	BBitmapStream(BBitmap* bitmap = NULL);
	virtual ~BBitmapStream();

	virtual ssize_t ReadAt(off_t position, void* buffer, size_t size);
	virtual ssize_t WriteAt(off_t position, const void* data, size_t size);
	virtual off_t Seek(off_t position, uint32 whence);
	virtual off_t Position() const;
	virtual off_t Size() const;
	virtual status_t SetSize(off_t size);
	virtual status_t GetSize(off_t* size) const;

	// B_ERROR if there is none, or its rows have not all been written. Any pointer is the
	// caller's from then on.
	status_t DetachBitmap(BBitmap** _bitmap);

private:
	void _WriteHeader();
	status_t _ReadHeader();

	TranslatorBitmap fHeader; // big-endian, as in the stream
	off_t fHeaderSize; // bytes of it that are known
	off_t fPosition;
	off_t fWritten; // end of what was written
	std::unique_ptr<BBitmap> fBitmap;
};
