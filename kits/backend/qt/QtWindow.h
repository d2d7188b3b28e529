// QtWindow: a window of the desktop that shows a front image.
#pragma once

#include <QBackingStore>
#include <QWindow>

#include "backend/Backend.h"

class QDropEvent;
class QInputMethodEvent;
class QInputMethodQueryEvent;

namespace BPrivate {

class QtBackend;


// Logical, device and Qt's own coordinates: device pixels are logical ones by the backend's scale,
// Qt's are device pixels by the screen's ratio, which is 1 except on some Wayland desktops.
class QtWindow : public QWindow, public BackendWindow {
public:
	QtWindow(QtBackend& backend, FrontImage* image, const WindowTraits& traits);
	~QtWindow() override;

	void SetTraits(const WindowTraits& traits) override;
	void SetOwner(BackendWindow* owner, bool aboveAll) override;
	void SetShown(bool shown) override;
	void SetMinimized(bool minimized) override;
	void Activate() override;
	void Raise() override;
	void PutBehind(BackendWindow* other) override;
	void SetCursor(const CursorShape& shape) override;
	void SetTextSpot(BRect screen) override;
	void Flush(const BRegion& devicePixels) override;

	const WindowTraits& Traits() const { return fTraits; }
	FrontImage& Image() const { return *fImage; }
	void FloatAbove(bool above); // above all windows, if it is a floating one
	void TakeFrame(BRect frame); // as by the desktop
	void ShowCursor(); // its own, or none while the program hides it

protected:
	bool event(QEvent* event) override;
	void exposeEvent(QExposeEvent* event) override;
	void resizeEvent(QResizeEvent* event) override;
	void moveEvent(QMoveEvent* event) override;
	void mousePressEvent(QMouseEvent* event) override;
	void mouseReleaseEvent(QMouseEvent* event) override;
	void mouseMoveEvent(QMouseEvent* event) override;
	void wheelEvent(QWheelEvent* event) override;
	void keyPressEvent(QKeyEvent* event) override;
	void keyReleaseEvent(QKeyEvent* event) override;

private:
	void _ApplyFlags();
	void _ApplyFrame();
	void _Paint(const QRegion& region);
	void _FrameChanged();
	void _Report(BackendEvent::Type type);
	void _ReportMouse(const QMouseEvent& event, BackendEvent::Type type);
	void _ReportKey(const QKeyEvent& event, bool down);
	void _ReportDrag(QDropEvent& event, BackendEvent::Type type);
	bool _Close();
	void _AnswerInputMethod(QInputMethodQueryEvent& query) const;
	void _TakeInputMethod(const QInputMethodEvent& event);
	void _StateChanged();

	QtBackend& fBackend;
	FrontImage* fImage; // borrowed
	WindowTraits fTraits;
	QBackingStore fStore;
	QRect fGiven; // the geometry that stands for the frame of the traits
	BRect fReported;
	QCursor fCursor;
	BRect fTextSpot; // screen, logical
	int32 fRepeat = 0; // of the key that is held
	bool fMinimized = false;
	bool fFloatsAbove = false;
};


} // namespace BPrivate
