// DragPicture: the picture that follows the pointer during a drag.
#pragma once

#include <QBackingStore>
#include <QImage>
#include <QWindow>

namespace BPrivate {


// A small window of its own that takes no input. It has a hole of one pixel under the pointer, so
// that the desktop names the window below when it is asked who is there.
class DragPicture : public QWindow {
public:
	// The image's offset of the pointer, in Qt's units.
	DragPicture(const QImage& image, const QPoint& offset);

	void MoveTo(const QPoint& pointer);
	const QImage& Image() const { return fImage; }
	const QPoint& Offset() const { return fOffset; }

protected:
	void exposeEvent(QExposeEvent* event) override;

private:
	QImage fImage;
	QPoint fOffset;
	QBackingStore fStore;
};


} // namespace BPrivate
