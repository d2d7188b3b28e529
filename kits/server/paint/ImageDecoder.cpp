#include "server/paint/ImageDecoder.h"

#include <QBuffer>
#include <QGuiApplication>
#include <QImageReader>
#include <QImageWriter>
#include <QLoggingCategory>
#include <future>
#include <mutex>
#include <string.h>
#include <thread>
#include <unistd.h>

#include <Errors.h>

namespace BPrivate {

namespace {

// Readers whose headers do not tell the size are stopped by this many megabytes.
constexpr int kMaxMegabytes = kMaxImagePixels * 4 / (1024 * 1024);


// A picture of outlines may hold texts, whose fonts Qt has only within an application.
bool
IsUsable(const QByteArray& format)
{
	const bool isVector = format.startsWith("svg");
	return !isVector || qobject_cast<QGuiApplication*>(QCoreApplication::instance()) != nullptr;
}


std::vector<std::string>
ToNames(const QList<QByteArray>& formats)
{
	std::vector<std::string> names;
	for (const QByteArray& format : formats) {
		if (IsUsable(format))
			names.push_back(format.toStdString());
	}
	return names;
}


// Loads Qt's image plug-ins. Their loaders belong to the thread that asks for them first and break
// when they outlive it, so that thread waits until the program has ended.
void
LoadPlugins()
{
	std::promise<void> loaded;
	std::future<void> isLoaded = loaded.get_future();
	std::thread([loaded = std::move(loaded)]() mutable {
		QImageReader::supportedImageFormats();
		loaded.set_value();
		for (;;)
			pause();
	}).detach();
	isLoaded.wait();
}


// To be called before anything else is asked of Qt's images.
void
Prepare()
{
	static std::once_flag sOnce;
	std::call_once(sOnce, [] {
		QImageReader::setAllocationLimit(kMaxMegabytes);
		// Damage is reported by our own results.
		QLoggingCategory::setFilterRules("qt.gui.imageio*=false");
		LoadPlugins();
	});
}


// Whether every piece of a PNG file lies inside it. The library takes memory for a piece by the
// length that its header claims.
bool
HasWholeChunks(const uint8* data, size_t size)
{
	constexpr size_t kSignature = 8;
	constexpr size_t kAround = 12; // length, type, checksum

	for (size_t at = kSignature; at < size;) {
		if (size - at < kAround)
			return false;
		const uint32 length = (uint32)data[at] << 24 | (uint32)data[at + 1] << 16
			| (uint32)data[at + 2] << 8 | data[at + 3];
		if (length > size - at - kAround)
			return false;
		if (memcmp(data + at + 4, "IEND", 4) == 0)
			return true;
		at += kAround + length;
	}
	return false;
}


// Reads from memory that it does not copy.
class MemoryReader {
public:
	MemoryReader(const void* data, size_t size) :
		fBytes(QByteArray::fromRawData(static_cast<const char*>(data), size))
	{
		Prepare();

		fBuffer.setData(fBytes);
		fBuffer.open(QIODevice::ReadOnly);
		fReader.setDecideFormatFromContent(true);
		fReader.setAutoTransform(true);
		fReader.setDevice(&fBuffer);
	}

	// Empty if there is no reader for the bytes.
	QByteArray Format()
	{
		const QByteArray format = QImageReader::imageFormat(&fBuffer);
		return IsUsable(format) ? format : QByteArray();
	}
	bool IsWithinLimits() const
	{
		const QSize size = fReader.size();
		return !size.isValid()
			|| (size.width() <= kMaxImageSide && size.height() <= kMaxImageSide
				&& (int64)size.width() * size.height() <= kMaxImagePixels);
	}
	QImage Read() { return fReader.read(); }

private:
	QByteArray fBytes;
	QBuffer fBuffer;
	QImageReader fReader;
};

} // namespace


Result<DecodedImage>
DecodeImage(const void* data, size_t size)
{
	MemoryReader reader(data, size);
	const QByteArray format = reader.Format();
	if (format.isEmpty())
		return B_BAD_TYPE;
	if (format == "png" && !HasWholeChunks(static_cast<const uint8*>(data), size))
		return B_BAD_DATA;
	if (!reader.IsWithinLimits())
		return B_BAD_DATA;
	const QImage image = reader.Read().convertToFormat(QImage::Format_ARGB32);
	if (image.isNull() || image.width() > kMaxImageSide || image.height() > kMaxImageSide)
		return B_BAD_DATA;

	DecodedImage result;
	result.format = format.toStdString();
	result.surface = std::make_unique<Surface>();
	const status_t status = result.surface->SetTo(image.width(), image.height());
	if (status != B_OK)
		return status;
	for (int32 y = 0; y < image.height(); y++)
		memcpy(result.surface->Row(y), image.constScanLine(y), (size_t)image.width() * 4);
	return result;
}


Result<std::string>
IdentifyImage(const void* data, size_t size)
{
	const QByteArray format = MemoryReader(data, size).Format();
	if (format.isEmpty())
		return B_BAD_TYPE;
	return format.toStdString();
}


Result<std::string>
EncodeImage(const Surface& surface, const std::string& format)
{
	if (!surface.IsValid())
		return B_BAD_VALUE;
	Prepare();
	const QImage image(reinterpret_cast<const uchar*>(surface.Row(0)), surface.DeviceWidth(),
		surface.DeviceHeight(), surface.BytesPerRow(),
		surface.Format() == SurfaceFormat::kAlpha ? QImage::Format_ARGB32 : QImage::Format_RGB32);
	QBuffer buffer;
	buffer.open(QIODevice::WriteOnly);
	QImageWriter writer(&buffer, QByteArray::fromStdString(format));
	if (!writer.canWrite() || !writer.write(image))
		return B_BAD_TYPE;
	return buffer.data().toStdString();
}


std::vector<std::string>
ReadableImageFormats()
{
	Prepare();
	return ToNames(QImageReader::supportedImageFormats());
}


std::vector<std::string>
WritableImageFormats()
{
	Prepare();
	return ToNames(QImageWriter::supportedImageFormats());
}


} // namespace BPrivate
