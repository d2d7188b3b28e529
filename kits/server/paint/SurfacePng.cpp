#include <QFile>
#include <QImage>
#include <QSaveFile>

#include <Errors.h>

#include "server/paint/Surface.h"

namespace BPrivate {


status_t
Surface::WritePng(const char* path, bool keepAlpha) const
{
	if (fBits == nullptr)
		return B_NO_INIT;
	const QImage image(fBits, fDeviceWidth, fDeviceHeight, fBytesPerRow,
		keepAlpha && fFormat == SurfaceFormat::kAlpha ? QImage::Format_ARGB32
													  : QImage::Format_RGB32);
	QSaveFile file(QFile::decodeName(path));
	if (!file.open(QIODevice::WriteOnly) || !image.save(&file, "PNG") || !file.commit())
		return B_IO_ERROR;
	return B_OK;
}


} // namespace BPrivate
