#include "backend/qt/DragPicture.h"

#include <QBitmap>
#include <QPainter>

namespace BPrivate {

namespace {

// What is more than half transparent is left out where the desktop cannot blend.
QRegion
ShapeOf(const QImage& image, const QPoint& offset)
{
	const qreal ratio = image.devicePixelRatio();
	QImage unscaled = image;
	unscaled.setDevicePixelRatio(1);
	if (ratio != 1)
		unscaled = unscaled.scaled(image.deviceIndependentSize().toSize());
	const QRegion shape(QBitmap::fromImage(unscaled.createAlphaMask()));
	return shape - QRect(offset, QSize(1, 1));
}

} // namespace


DragPicture::DragPicture(const QImage& image, const QPoint& offset) :
	fImage(image), fOffset(offset), fStore(this)
{
	setFlags(Qt::ToolTip | Qt::FramelessWindowHint | Qt::BypassWindowManagerHint
		| Qt::WindowTransparentForInput | Qt::WindowDoesNotAcceptFocus);
	QSurfaceFormat format;
	format.setAlphaBufferSize(8);
	setFormat(format);
	setOpacity(0.8);
	resize(image.deviceIndependentSize().toSize());
	create();
	setMask(ShapeOf(image, offset));
}


void
DragPicture::MoveTo(const QPoint& pointer)
{
	setPosition(pointer - fOffset);
	if (!isVisible())
		show();
}


void
DragPicture::exposeEvent(QExposeEvent* event)
{
	if (!isExposed())
		return;
	const QRect all(QPoint(), size());
	fStore.resize(size());
	fStore.beginPaint(all);
	{
		// A desktop that cannot blend shows what is half seen through as if it lay on white; one
		// that can blends the window as a whole.
		QPainter painter(fStore.paintDevice());
		painter.fillRect(all, Qt::white);
		painter.drawImage(QPoint(), fImage);
	}
	fStore.endPaint();
	fStore.flush(all);
}


} // namespace BPrivate
