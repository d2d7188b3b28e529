// The part of QtBackend that deals with input, drags and the clipboard.

#include "backend/qt/QtBackend.h"

#include <cstdio>
#include <cstring>

#include <QClipboard>
#include <QDrag>
#include <QPixmap>
#include <QScreen>

#include "backend/ScreenPainter.h"
#include "backend/qt/DragPicture.h"
#include "backend/qt/QtMime.h"
#include "backend/qt/QtWindow.h"

namespace BPrivate {


// #pragma mark - modifiers and pointer


uint32
QtBackend::UpdateModifiers(Qt::KeyboardModifiers modifiers)
{
	const uint32 before = fModifiers.Current();
	if (fModifiers.Update(modifiers) != before)
		_ReportModifiers();
	return fModifiers.Current();
}


uint32
QtBackend::NoteModifierKey(const QKeyEvent& event, bool down)
{
	const uint32 before = fModifiers.Current();
	fModifiers.Note(event, down);
	if (fModifiers.Current() != before)
		_ReportModifiers();
	return fModifiers.Current();
}


void
QtBackend::_ReportModifiers()
{
	BackendEvent event;
	event.type = BackendEvent::Type::ModifiersChanged;
	event.when = system_time();
	event.modifiers = fModifiers.Current();
	fSink->HandleEvent(event);
}


void
QtBackend::ReportPointer(const BackendEvent& event, quint64 timestamp)
{
	// The real pointer, which may rest anywhere, does not interfere with that of a script.
	if (fScripted)
		return;
	fPointer = event.where;
	if (fDragPicture != nullptr)
		fDragPicture->MoveTo(ToQt(BRect(fPointer, fPointer)).topLeft());
	fPressTime = event.type == BackendEvent::Type::ButtonPressed ? timestamp : 0;
	fSink->HandleEvent(event);
	fPressTime = 0;
}


void
QtBackend::PointerLeft(QtWindow* window)
{
	// While a button is down the window of the press goes on to hear of the pointer.
	if (fScripted || QGuiApplication::mouseButtons() != Qt::NoButton)
		return;
	BackendEvent event;
	event.type = BackendEvent::Type::PointerLeft;
	event.window = window;
	event.when = system_time();
	event.where = FromQt(QPointF(QCursor::pos()));
	event.modifiers = fModifiers.Current();
	event.buttons = buttons_of(QGuiApplication::mouseButtons());
	fSink->HandleEvent(event);
}


void
QtBackend::SetPointerGrab(BackendWindow* window)
{
	auto* wanted = static_cast<QtWindow*>(window);
	if (wanted == fGrabbing)
		return;
	// A window that is not on the screen yet cannot have it; it is asked for again when it is.
	if (wanted != nullptr && !wanted->setMouseGrabEnabled(true))
		return;
	if (wanted == nullptr)
		fGrabbing->setMouseGrabEnabled(false);
	fGrabbing = wanted;
}


void
QtBackend::SetCursorHidden(bool hidden)
{
	if (fCursorHidden == hidden)
		return;
	fCursorHidden = hidden;
	for (QtWindow* window : fWindows)
		window->ShowCursor();
}


// Qt Gui has no sound of its own; the terminal's bell is heard where there is one.
void
QtBackend::Beep()
{
	std::fputc('\a', stderr);
}


// #pragma mark - scripts


void
QtBackend::Inject(const BackendEvent& event)
{
	using Type = BackendEvent::Type;

	BackendEvent entered = event;
	if (entered.when == 0)
		entered.when = system_time();

	switch (event.type) {
		case Type::PointerMoved:
		case Type::ButtonPressed:
		case Type::ButtonReleased:
		case Type::WheelTurned:
		case Type::PointerLeft:
			_InjectPointer(entered);
			break;

		case Type::FolderDropped:
			fSimulated.DropOnFolder(entered, *fSink);
			break;

		case Type::WindowChanged:
			static_cast<QtWindow*>(event.window)->TakeFrame(event.frame);
			break;

		case Type::WindowActivated:
			static_cast<QtWindow*>(event.window)->Activate();
			break;

		default:
			fSink->HandleEvent(entered);
			break;
	}
}


void
QtBackend::_InjectPointer(const BackendEvent& event)
{
	fScripted = true;
	fPointer = event.where;
	if (fDragPicture != nullptr)
		fDragPicture->MoveTo(ToQt(BRect(fPointer, fPointer)).topLeft());

	auto* under = static_cast<QtWindow*>(WindowAt(event.where));
	if (fSimulated.IsActive()) {
		fSimulated.Follow(event, under, *fSink);
		return;
	}
	BackendEvent entered = event;
	entered.window = fScriptPressed != nullptr ? fScriptPressed : under;
	if (event.type == BackendEvent::Type::ButtonPressed && fScriptPressed == nullptr)
		fScriptPressed = under;
	if (event.buttons == 0)
		fScriptPressed = nullptr;
	fSink->HandleEvent(entered);
}


// #pragma mark - drags


void
QtBackend::SetDragPicture(const ScreenPicture* picture, BPoint offset)
{
	fDragPicture.reset();
	if (picture == nullptr)
		return;

	QImage image(picture->bits.data(), picture->width, picture->height, picture->width * 4,
		QImage::Format_ARGB32);
	image = image.convertToFormat(QImage::Format_ARGB32_Premultiplied);
	image.setDevicePixelRatio(fRatio);
	const float factor = fScale / fRatio;
	const QPoint hot(static_cast<int>(offset.x * factor), static_cast<int>(offset.y * factor));
	fDragPicture = std::make_unique<DragPicture>(image, hot);
	fDragPicture->MoveTo(ToQt(BRect(fPointer, fPointer)).topLeft());
}


bool
QtBackend::StartDesktopDrag(const DataOffer& offer, int32 session, uint32 buttons)
{
	if (fScripted) {
		fSimulated.Start(offer, session);
		fScriptPressed = nullptr;
		return true;
	}
	if (fInDrag || fWindows.empty())
		return false;

	// The drag runs a loop of its own until it ends, so it begins when this event is done with.
	fInDrag = true;
	Post([this, offer, session] { _RunDrag(offer, session); });
	return true;
}


void
QtBackend::_RunDrag(const DataOffer& offer, int32 session)
{
	QWindow* source = QGuiApplication::focusWindow();
	if (source == nullptr)
		source = fWindows.back();
	auto* drag = new QDrag(source);
	drag->setMimeData(new OfferMimeData(offer, session));
	if (fDragPicture != nullptr) {
		drag->setPixmap(QPixmap::fromImage(fDragPicture->Image()));
		drag->setHotSpot(fDragPicture->Offset());
		fDragPicture.reset();
	}
	const Qt::DropAction action =
		drag->exec(Qt::CopyAction | Qt::MoveAction | Qt::LinkAction, Qt::CopyAction);
	fInDrag = false;

	BackendEvent event;
	event.type = BackendEvent::Type::DragFinished;
	event.when = system_time();
	event.flag = action != Qt::IgnoreAction;
	fSink->HandleEvent(event);
}


void
QtBackend::ReportDrag(const BackendEvent& event)
{
	fPointer = event.where;
	fSink->HandleEvent(event);
}


void
QtBackend::DragLeft(QtWindow* window)
{
	BackendEvent event;
	event.type = BackendEvent::Type::DragLeft;
	event.window = window;
	event.when = system_time();
	event.where = fPointer;
	event.session = fInDrag ? -1 : 0;
	fSink->HandleEvent(event);
}


// #pragma mark - clipboard and pictures


void
QtBackend::SetClipboard(const DataOffer& offer)
{
	QGuiApplication::clipboard()->setMimeData(new OfferMimeData(offer));
}


DataOffer
QtBackend::Clipboard()
{
	return offer_of(QGuiApplication::clipboard()->mimeData());
}


bool
QtBackend::OwnsClipboard() const
{
	return QGuiApplication::clipboard()->ownsClipboard();
}


ScreenPicture
QtBackend::Picture(BRect screen)
{
	// What the desktop shows, where it lets programs see it.
	const QScreen* display = QGuiApplication::primaryScreen();
	const QRect place = ToQt(screen);
	if (QGuiApplication::platformName() == QLatin1String("xcb")) {
		QCoreApplication::processEvents(QEventLoop::ExcludeUserInputEvents);
		const QImage image =
			const_cast<QScreen*>(display)
				->grabWindow(0, place.x(), place.y(), place.width(), place.height())
				.toImage()
				.convertToFormat(QImage::Format_RGB32);
		ScreenPicture picture { image.width(), image.height(), {} };
		picture.bits.resize(size_t(image.width()) * image.height() * 4);
		for (int y = 0; y < image.height(); y++) {
			std::memcpy(&picture.bits[size_t(y) * image.width() * 4], image.constScanLine(y),
				size_t(image.width()) * 4);
		}
		return picture;
	}

	ScreenPainter painter(screen, fScale);
	for (QtWindow* window : fWindows) {
		if (window->isVisible())
			painter.DrawWindow(window->Traits().frame, window->Image());
	}
	return painter.Take();
}


} // namespace BPrivate
