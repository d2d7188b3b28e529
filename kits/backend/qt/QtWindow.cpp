#include "backend/qt/QtWindow.h"

#include <algorithm>
#include <cmath>

#include <QGuiApplication>
#include <QPainter>

#include "backend/qt/QtBackend.h"
#include "backend/qt/QtKeys.h"
#include "server/FrontImage.h"
#include "server/paint/Surface.h"

namespace BPrivate {

namespace {

constexpr QRgb kEmptyColor = 0xffd8d8d8; // where nothing has been painted yet
constexpr float kUnlimited = 16000;

} // namespace


QtWindow::QtWindow(QtBackend& backend, FrontImage* image, const WindowTraits& traits) :
	fBackend(backend), fImage(image), fTraits(traits), fStore(this)
{
	setSurfaceType(QSurface::RasterSurface);
	_ApplyFlags();
	setTitle(QString::fromStdString(traits.title));
	_ApplyFrame();
	fReported = traits.frame;
	create();
	fBackend.AddWindow(this);
}


QtWindow::~QtWindow()
{
	fBackend.RemoveWindow(this);
}


// #pragma mark - what the server asks for


void
QtWindow::SetTraits(const WindowTraits& traits)
{
	const WindowTraits before = fTraits;
	fTraits = traits;
	if (traits.title != before.title)
		setTitle(QString::fromStdString(traits.title));
	const bool flagsChanged = traits.kind != before.kind || traits.hasBorder != before.hasBorder
		|| traits.hasTitle != before.hasTitle || traits.closable != before.closable
		|| traits.minimizable != before.minimizable || traits.zoomable != before.zoomable
		|| traits.takesFocus != before.takesFocus;
	if (flagsChanged)
		_ApplyFlags();
	_ApplyFrame();
	_FrameChanged();
}


void
QtWindow::_ApplyFlags()
{
	Qt::WindowFlags flags;
	switch (fTraits.kind) {
		case WindowTraits::Kind::Normal:
			flags = Qt::Window;
			break;
		case WindowTraits::Kind::Floating:
			flags = Qt::Tool;
			break;
		case WindowTraits::Kind::Modal:
			flags = Qt::Dialog;
			break;
		case WindowTraits::Kind::Menu:
			flags = Qt::ToolTip | Qt::BypassWindowManagerHint;
			break;
	}
	if (!fTraits.hasBorder) {
		flags |= Qt::FramelessWindowHint;
	} else {
		flags |= Qt::CustomizeWindowHint;
		flags.setFlag(Qt::WindowTitleHint, fTraits.hasTitle);
		flags.setFlag(Qt::WindowSystemMenuHint, fTraits.hasTitle);
		flags.setFlag(Qt::WindowCloseButtonHint, fTraits.hasTitle && fTraits.closable);
		flags.setFlag(Qt::WindowMinimizeButtonHint, fTraits.hasTitle && fTraits.minimizable);
		flags.setFlag(Qt::WindowMaximizeButtonHint, fTraits.hasTitle && fTraits.zoomable);
	}
	flags.setFlag(Qt::WindowDoesNotAcceptFocus, !fTraits.takesFocus);
	flags.setFlag(Qt::WindowStaysOnTopHint, fFloatsAbove);
	setFlags(flags);
	// A floating window that comes back with its program leaves the keyboard where it is; one that
	// the program opens is made active by itself.
	setProperty("_q_showWithoutActivating", fTraits.kind == WindowTraits::Kind::Floating);
}


// Desktops keep a window above one other, or above all. The second is meant while the program is
// active only.
void
QtWindow::FloatAbove(bool above)
{
	const bool floats = above && fTraits.kind == WindowTraits::Kind::Floating;
	if (floats == fFloatsAbove)
		return;
	fFloatsAbove = floats;
	_ApplyFlags();
}


void
QtWindow::_ApplyFrame()
{
	const auto size = [this](float width, float height) {
		const float ratio = fBackend.Scale() / fBackend.Ratio();
		return QSize(static_cast<int>(std::lround((std::min(width, kUnlimited) + 1) * ratio)),
			static_cast<int>(std::lround((std::min(height, kUnlimited) + 1) * ratio)));
	};
	// What a program sets is not bound by its limits for the user.
	const float width = fTraits.frame.Width(), height = fTraits.frame.Height();
	setMinimumSize(size(std::min(fTraits.minWidth, width), std::min(fTraits.minHeight, height)));
	setMaximumSize(size(std::max(fTraits.maxWidth, width), std::max(fTraits.maxHeight, height)));

	const QRect given = fBackend.ToQt(fTraits.frame);
	if (given == fGiven && given == geometry())
		return;
	fGiven = given;
	setGeometry(given);
}


void
QtWindow::TakeFrame(BRect frame)
{
	setGeometry(fBackend.ToQt(frame));
}


void
QtWindow::SetOwner(BackendWindow* owner, bool aboveAll)
{
	// Where it can float above all of them it needs no owner among them.
	const bool floats = aboveAll && fTraits.kind == WindowTraits::Kind::Floating
		&& QGuiApplication::platformName() == QLatin1String("xcb");
	QWindow* parent = floats ? nullptr : dynamic_cast<QtWindow*>(owner);
	if (transientParent() != parent)
		setTransientParent(parent);
}


void
QtWindow::SetShown(bool shown)
{
	if (shown && windowState() == Qt::WindowMinimized)
		setWindowState(Qt::WindowNoState);
	setVisible(shown);
	if (shown && fTraits.kind == WindowTraits::Kind::Menu)
		raise();
}


void
QtWindow::SetMinimized(bool minimized)
{
	setWindowState(minimized ? Qt::WindowMinimized : Qt::WindowNoState);
}


void
QtWindow::Activate()
{
	if (windowState() == Qt::WindowMinimized)
		setWindowState(Qt::WindowNoState);
	fBackend.NoteRequest(this);
	raise();
	requestActivate();
}


void
QtWindow::Raise()
{
	raise();
}


void
QtWindow::PutBehind(BackendWindow* other)
{
	// Desktops can put a window behind all others only.
	lower();
}


void
QtWindow::SetCursor(const CursorShape& shape)
{
	fCursor = cursor_of(shape);
	ShowCursor();
}


void
QtWindow::ShowCursor()
{
	setCursor(fBackend.IsCursorHidden() ? QCursor(Qt::BlankCursor) : fCursor);
}


void
QtWindow::SetTextSpot(BRect screen)
{
	fTextSpot = screen;
	if (QGuiApplication::focusWindow() == this)
		QGuiApplication::inputMethod()->update(Qt::ImCursorRectangle);
}


// #pragma mark - pixels


void
QtWindow::Flush(const BRegion& devicePixels)
{
	if (!isExposed())
		return;

	const qreal ratio = fBackend.Ratio();
	QRegion region;
	for (int32 i = 0; i < devicePixels.CountRects(); i++) {
		const clipping_rect part = devicePixels.RectAtInt(i);
		const QRectF rect(part.left / ratio, part.top / ratio, (part.right - part.left + 1) / ratio,
			(part.bottom - part.top + 1) / ratio);
		region += rect.toAlignedRect();
	}
	_Paint(region);
}


void
QtWindow::_Paint(const QRegion& wanted)
{
	const QRegion region = wanted & QRect(QPoint(), size());
	if (region.isEmpty())
		return;
	if (fStore.size() != size())
		fStore.resize(size());

	fStore.beginPaint(region);
	{
		QPainter painter(fStore.paintDevice());
		painter.setCompositionMode(QPainter::CompositionMode_Source);
		FrontImage::Guard guard(*fImage);
		const Surface* front = guard.Pixels();
		QImage image;
		QRect covered;
		if (front != nullptr) {
			image = QImage(reinterpret_cast<const uchar*>(front->Row(0)), front->DeviceWidth(),
				front->DeviceHeight(), front->BytesPerRow(), QImage::Format_RGB32);
			image.setDevicePixelRatio(fBackend.Ratio());
			covered = QRectF(QPointF(), image.deviceIndependentSize()).toAlignedRect();
		}
		for (const QRect& rect : region - covered)
			painter.fillRect(rect, QColor::fromRgb(kEmptyColor));
		const qreal ratio = fBackend.Ratio();
		const QRegion shown = region & covered;
		for (const QRect& rect : shown) {
			if (ratio == 1) {
				// Rows are copied as they are.
				painter.drawImage(rect.topLeft(), image, rect);
				continue;
			}
			const QRectF source(
				rect.x() * ratio, rect.y() * ratio, rect.width() * ratio, rect.height() * ratio);
			painter.drawImage(QRectF(rect), image, source);
		}
	}
	fStore.endPaint();
	fStore.flush(region);
}


void
QtWindow::exposeEvent(QExposeEvent* event)
{
	if (!isExposed())
		return;
	_Paint(QRegion(QRect(QPoint(), size())));
	_Report(BackendEvent::Type::WindowShown);
}


// #pragma mark - geometry and state


void
QtWindow::resizeEvent(QResizeEvent* event)
{
	_FrameChanged();
}


void
QtWindow::moveEvent(QMoveEvent* event)
{
	_FrameChanged();
}


void
QtWindow::_FrameChanged()
{
	// The frame that was asked for is not lost by rounding there and back.
	const QRect now = geometry();
	BRect frame = fBackend.FromQt(now);
	if (now.size() == fGiven.size()) {
		frame.right = frame.left + fTraits.frame.Width();
		frame.bottom = frame.top + fTraits.frame.Height();
	}
	if (now.topLeft() == fGiven.topLeft())
		frame.OffsetTo(fTraits.frame.LeftTop());
	if (frame == fReported)
		return;

	fReported = frame;
	BackendEvent event;
	event.type = BackendEvent::Type::WindowChanged;
	event.window = this;
	event.frame = frame;
	fBackend.Sink().HandleEvent(event);
}


void
QtWindow::_StateChanged()
{
	const bool minimized = windowState() == Qt::WindowMinimized;
	if (minimized == fMinimized)
		return;
	fMinimized = minimized;
	BackendEvent event;
	event.type = BackendEvent::Type::Minimized;
	event.window = this;
	event.flag = minimized;
	fBackend.Sink().HandleEvent(event);
}


void
QtWindow::_Report(BackendEvent::Type type)
{
	BackendEvent event;
	event.type = type;
	event.window = this;
	event.when = system_time();
	fBackend.Sink().HandleEvent(event);
}


} // namespace BPrivate
