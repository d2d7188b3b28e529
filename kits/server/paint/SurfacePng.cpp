#include <array>

#include <QByteArray>
#include <QFile>
#include <QSaveFile>
#include <QtEndian>

#include <Errors.h>

#include "server/paint/Surface.h"

namespace BPrivate {

// Written here rather than by the toolkit's image writer: that one loads plug-ins, which belong to
// the thread that asked first and outlive it.
namespace {

uint32
crc_of(const QByteArray& bytes)
{
	static const std::array<uint32, 256> kTable = [] {
		std::array<uint32, 256> table;
		for (uint32 i = 0; i < 256; i++) {
			uint32 value = i;
			for (int bit = 0; bit < 8; bit++)
				value = (value & 1) != 0 ? 0xedb88320 ^ (value >> 1) : value >> 1;
			table[i] = value;
		}
		return table;
	}();

	uint32 crc = 0xffffffff;
	for (const char byte : bytes)
		crc = kTable[(crc ^ static_cast<uint8>(byte)) & 0xff] ^ (crc >> 8);
	return crc ^ 0xffffffff;
}


void
append_number(QByteArray& bytes, uint32 number)
{
	char big[4];
	qToBigEndian(number, big);
	bytes.append(big, sizeof(big));
}


void
append_chunk(QByteArray& png, const char* type, const QByteArray& data)
{
	append_number(png, static_cast<uint32>(data.size()));
	const QByteArray body = QByteArray(type, 4) + data;
	png += body;
	append_number(png, crc_of(body));
}


// The rows as the format wants them: a filter byte of 0, then red, green, blue and perhaps alpha.
QByteArray
rows_of(const uint8* bits, int32 width, int32 height, int32 bytesPerRow, bool alpha)
{
	const int32 channels = alpha ? 4 : 3;
	QByteArray rows(static_cast<qsizetype>(height) * (1 + width * channels), '\0');
	uint8* out = reinterpret_cast<uint8*>(rows.data());
	for (int32 y = 0; y < height; y++) {
		const uint8* in = bits + static_cast<size_t>(y) * bytesPerRow;
		out++;
		for (int32 x = 0; x < width; x++, in += 4, out += channels) {
			out[0] = in[2];
			out[1] = in[1];
			out[2] = in[0];
			if (alpha)
				out[3] = in[3];
		}
	}
	return rows;
}

} // namespace


status_t
Surface::WritePng(const char* path, bool keepAlpha) const
{
	if (fBits == nullptr)
		return B_NO_INIT;
	const bool alpha = keepAlpha && fFormat == SurfaceFormat::kAlpha;

	QByteArray header;
	append_number(header, static_cast<uint32>(fDeviceWidth));
	append_number(header, static_cast<uint32>(fDeviceHeight));
	// Eight bits a channel, with or without alpha; deflated, filtered by row, not interlaced.
	const char properties[] = { 8, static_cast<char>(alpha ? 6 : 2), 0, 0, 0 };
	header.append(properties, sizeof(properties));

	// The toolkit puts the length in front of the deflated stream.
	const QByteArray deflated =
		qCompress(rows_of(fBits, fDeviceWidth, fDeviceHeight, fBytesPerRow, alpha)).mid(4);

	QByteArray png("\x89PNG\r\n\x1a\n", 8);
	append_chunk(png, "IHDR", header);
	append_chunk(png, "IDAT", deflated);
	append_chunk(png, "IEND", QByteArray());

	QSaveFile file(QFile::decodeName(path));
	if (!file.open(QIODevice::WriteOnly) || file.write(png) != png.size() || !file.commit())
		return B_IO_ERROR;
	return B_OK;
}


} // namespace BPrivate
