// The events of a QtWindow that are input.

#include "backend/qt/QtWindow.h"

#include <QGuiApplication>
#include <QInputMethod>
#include <QWindowStateChangeEvent>

#include "backend/qt/QtBackend.h"
#include "backend/qt/QtKeys.h"
#include "backend/qt/QtMime.h"

namespace BPrivate {

namespace {

constexpr qreal kNotch = 120; // of a wheel, in eighths of a degree

} // namespace


bool
QtWindow::event(QEvent* event)
{
	using Type = BackendEvent::Type;

	switch (event->type()) {
		case QEvent::Close:
			// Whether it closes is for the window's own thread to say.
			event->ignore();
			_Report(Type::CloseRequested);
			return true;

		case QEvent::WindowStateChange:
			_StateChanged();
			return true;

		case QEvent::Leave:
			fBackend.PointerLeft(this);
			return true;

		case QEvent::DragEnter:
			_ReportDrag(*static_cast<QDropEvent*>(event), Type::DragEntered);
			return true;

		case QEvent::DragMove:
			_ReportDrag(*static_cast<QDropEvent*>(event), Type::DragMoved);
			return true;

		case QEvent::DragLeave:
			fBackend.DragLeft(this);
			return true;

		case QEvent::Drop:
			_ReportDrag(*static_cast<QDropEvent*>(event), Type::Dropped);
			return true;

		case QEvent::InputMethodQuery:
			_AnswerInputMethod(*static_cast<QInputMethodQueryEvent*>(event));
			return true;

		case QEvent::InputMethod:
			_TakeInputMethod(*static_cast<QInputMethodEvent*>(event));
			return true;

		default:
			return QWindow::event(event);
	}
}


// #pragma mark - mouse


void
QtWindow::mousePressEvent(QMouseEvent* event)
{
	_ReportMouse(*event, BackendEvent::Type::ButtonPressed);
}


void
QtWindow::mouseReleaseEvent(QMouseEvent* event)
{
	_ReportMouse(*event, BackendEvent::Type::ButtonReleased);
}


void
QtWindow::mouseMoveEvent(QMouseEvent* event)
{
	_ReportMouse(*event, BackendEvent::Type::PointerMoved);
}


void
QtWindow::_ReportMouse(const QMouseEvent& event, BackendEvent::Type type)
{
	BackendEvent told;
	told.type = type;
	told.window = this;
	told.when = system_time();
	told.where = fBackend.FromQt(event.globalPosition());
	told.buttons = buttons_of(event.buttons());
	told.button = buttons_of(event.button());
	if (type != BackendEvent::Type::PointerMoved && told.button == 0)
		return;
	told.modifiers = fBackend.UpdateModifiers(event.modifiers());
	fBackend.ReportPointer(told, event.timestamp());
}


void
QtWindow::wheelEvent(QWheelEvent* event)
{
	BackendEvent told;
	told.type = BackendEvent::Type::WheelTurned;
	told.window = this;
	told.when = system_time();
	told.where = fBackend.FromQt(event->globalPosition());
	told.buttons = buttons_of(event->buttons());
	told.modifiers = fBackend.UpdateModifiers(event->modifiers());
	const QPoint angle = event->angleDelta();
	told.delta.Set(
		static_cast<float>(-angle.x() / kNotch), static_cast<float>(-angle.y() / kNotch));
	fBackend.Sink().HandleEvent(told);
}


// #pragma mark - keyboard


void
QtWindow::keyPressEvent(QKeyEvent* event)
{
	fRepeat = event->isAutoRepeat() ? fRepeat + 1 : 0;
	_ReportKey(*event, true);
}


void
QtWindow::keyReleaseEvent(QKeyEvent* event)
{
	if (!event->isAutoRepeat())
		_ReportKey(*event, false);
}


void
QtWindow::_ReportKey(const QKeyEvent& event, bool down)
{
	BackendEvent told;
	told.type = down ? BackendEvent::Type::KeyPressed : BackendEvent::Type::KeyReleased;
	told.window = this;
	told.when = system_time();
	told.modifiers = fBackend.NoteModifierKey(event, down);
	told.repeat = fRepeat;
	describe_key(event, &told);
	fBackend.Sink().HandleEvent(told);
}


void
QtWindow::_AnswerInputMethod(QInputMethodQueryEvent& query) const
{
	if (query.queries() & Qt::ImEnabled)
		query.setValue(Qt::ImEnabled, true);
	if (query.queries() & Qt::ImCursorRectangle) {
		QRect spot = fBackend.ToQt(fTextSpot);
		spot.translate(-geometry().topLeft());
		query.setValue(Qt::ImCursorRectangle, spot);
	}
	if (query.queries() & Qt::ImHints)
		query.setValue(Qt::ImHints, static_cast<int>(Qt::ImhNone));
	query.accept();
}


void
QtWindow::_TakeInputMethod(const QInputMethodEvent& event)
{
	BackendEvent told;
	told.window = this;
	told.when = system_time();
	told.modifiers = fBackend.CurrentModifiers();
	if (!event.commitString().isEmpty()) {
		told.type = BackendEvent::Type::TextComposed;
		fBackend.Sink().HandleEvent(told);
		told.type = BackendEvent::Type::TextEntered;
		told.text = event.commitString().toStdString();
		fBackend.Sink().HandleEvent(told);
	}
	told.type = BackendEvent::Type::TextComposed;
	told.text = event.preeditString().toStdString();
	fBackend.Sink().HandleEvent(told);
}


// #pragma mark - drags


void
QtWindow::_ReportDrag(QDropEvent& event, BackendEvent::Type type)
{
	event.setDropAction(Qt::CopyAction);
	event.accept();

	const QMimeData* data = event.mimeData();
	BackendEvent told;
	told.type = type;
	told.window = this;
	told.when = system_time();
	told.where = fBackend.FromQt(mapToGlobal(event.position()));
	told.buttons = std::max<uint32>(buttons_of(event.buttons()), 1);
	told.modifiers = fBackend.UpdateModifiers(event.modifiers());
	told.session = data != nullptr ? session_of(*data) : 0;
	if (told.session == 0 && data != nullptr && type != BackendEvent::Type::DragMoved)
		told.message = message_of(*data);
	fBackend.ReportDrag(told);
}


} // namespace BPrivate
