#include "backend/qt/QtKeys.h"

#include <QBitmap>

#include <InterfaceDefs.h>

#include "backend/KeyTable.h"
#include "server/CursorShape.h"

namespace BPrivate {

namespace {

struct NamedKey {
	int key; // Qt's
	const char* name; // of the key table
};

constexpr NamedKey kNamedKeys[] = {
	{ Qt::Key_Return, "Return" },
	{ Qt::Key_Enter, "Enter" },
	{ Qt::Key_Tab, "Tab" },
	{ Qt::Key_Backtab, "Tab" },
	{ Qt::Key_Escape, "Escape" },
	{ Qt::Key_Space, "Space" },
	{ Qt::Key_Backspace, "Backspace" },
	{ Qt::Key_Delete, "Delete" },
	{ Qt::Key_Insert, "Insert" },
	{ Qt::Key_Left, "Left" },
	{ Qt::Key_Right, "Right" },
	{ Qt::Key_Up, "Up" },
	{ Qt::Key_Down, "Down" },
	{ Qt::Key_Home, "Home" },
	{ Qt::Key_End, "End" },
	{ Qt::Key_PageUp, "PageUp" },
	{ Qt::Key_PageDown, "PageDown" },
	{ Qt::Key_Print, "Print" },
	{ Qt::Key_ScrollLock, "Scroll" },
	{ Qt::Key_Pause, "Pause" },
	{ Qt::Key_Menu, "Menu" },
};


bool
NamedStroke(int key, KeyStroke* _stroke)
{
	if (key >= Qt::Key_F1 && key <= Qt::Key_F12) {
		const std::string name = "F" + std::to_string(key - Qt::Key_F1 + 1);
		return stroke_of_name(name, _stroke);
	}
	for (const NamedKey& named : kNamedKeys) {
		if (named.key == key)
			return stroke_of_name(named.name, _stroke);
	}
	return false;
}


struct ModifierKey {
	int32 key; // of the key table
	uint32 right; // the bits when it is the right-hand one
};

constexpr ModifierKey kRightKeys[] = {
	{ 0x56, B_RIGHT_SHIFT_KEY },
	{ 0x60, B_RIGHT_CONTROL_KEY | B_RIGHT_COMMAND_KEY },
	{ 0x5f, B_RIGHT_OPTION_KEY },
	{ 0x67, B_RIGHT_OPTION_KEY },
};


uint32
GeneralModifier(int key)
{
	switch (key) {
		case Qt::Key_Shift:
			return B_SHIFT_KEY;
		case Qt::Key_Control:
			return B_CONTROL_KEY;
		case Qt::Key_Alt:
		case Qt::Key_Meta:
		case Qt::Key_Super_L:
		case Qt::Key_Super_R:
			return B_OPTION_KEY;
		case Qt::Key_Menu:
			return B_MENU_KEY;
		default:
			return 0;
	}
}

} // namespace


uint32
buttons_of(Qt::MouseButtons buttons)
{
	uint32 result = 0;
	if (buttons & Qt::LeftButton)
		result |= 1;
	if (buttons & Qt::RightButton)
		result |= 2;
	if (buttons & Qt::MiddleButton)
		result |= 4;
	return result;
}


// #pragma mark - modifiers


uint32
ModifierState::Update(Qt::KeyboardModifiers modifiers)
{
	uint32 held = 0;
	if (modifiers & Qt::ShiftModifier)
		held |= B_SHIFT_KEY | (fRight & B_RIGHT_SHIFT_KEY);
	if (modifiers & Qt::ControlModifier)
		held |= B_CONTROL_KEY | (fRight & (B_RIGHT_CONTROL_KEY | B_RIGHT_COMMAND_KEY));
	if (modifiers & (Qt::AltModifier | Qt::MetaModifier))
		held |= B_OPTION_KEY | (fRight & B_RIGHT_OPTION_KEY);
	fModifiers = complete_modifiers(held);
	return fModifiers;
}


// The modifiers of a modifier key's own event are those from before it.
void
ModifierState::Note(const QKeyEvent& event, bool down)
{
	const uint32 general = GeneralModifier(event.key());
	if (general == 0)
		return;
	const int32 key = key_of_scan_code(event.nativeScanCode());
	for (const ModifierKey& right : kRightKeys) {
		if (right.key == key)
			fRight = down ? fRight | right.right : fRight & ~right.right;
	}

	Qt::KeyboardModifiers modifiers = event.modifiers();
	const Qt::KeyboardModifier bit = general == B_SHIFT_KEY ? Qt::ShiftModifier
		: general == B_CONTROL_KEY                          ? Qt::ControlModifier
		: general == B_OPTION_KEY                           ? Qt::AltModifier
															: Qt::NoModifier;
	modifiers.setFlag(bit, down);
	Update(modifiers);
	if (general == B_MENU_KEY && down)
		fModifiers |= B_MENU_KEY;
}


// #pragma mark - keys


void
describe_key(const QKeyEvent& event, BackendEvent* _event)
{
	_event->key = key_of_scan_code(event.nativeScanCode());
	if (GeneralModifier(event.key()) != 0)
		return;

	KeyStroke stroke;
	if (NamedStroke(event.key(), &stroke)) {
		if (_event->key == 0)
			_event->key = stroke.key;
		_event->text = stroke.text;
		_event->rawCharacter = stroke.rawCharacter;
		return;
	}

	// With Control or Alt held the layout types control characters or nothing; programs look for
	// the letter itself.
	const int key = event.key();
	const bool isAscii = key > ' ' && key < 0x7f;
	const bool held = (event.modifiers() & (Qt::ControlModifier | Qt::AltModifier)) != 0;
	const QString text = event.text();
	const bool printable = !text.isEmpty() && text[0].isPrint();
	if (held && isAscii && !printable) {
		const bool shift = (event.modifiers() & Qt::ShiftModifier) != 0;
		const QChar character = QChar(key);
		_event->text = QString(shift ? character : character.toLower()).toStdString();
	} else if (printable) {
		_event->text = text.toStdString();
	}
	if (!_event->text.empty())
		_event->rawCharacter = isAscii ? QChar(key).toLower().unicode() : key;
}


// #pragma mark - cursors


namespace {

Qt::CursorShape
NamedCursor(int32 id)
{
	// In the order of the platform's ids, from 1.
	static constexpr Qt::CursorShape kShapes[] = { Qt::ArrowCursor, Qt::IBeamCursor,
		Qt::ArrowCursor, Qt::DragCopyCursor, Qt::CrossCursor, Qt::PointingHandCursor,
		Qt::OpenHandCursor, Qt::ClosedHandCursor, Qt::WhatsThisCursor, Qt::IBeamCursor,
		Qt::SizeAllCursor, Qt::BlankCursor, Qt::ForbiddenCursor, Qt::BusyCursor, Qt::SizeVerCursor,
		Qt::SizeHorCursor, Qt::SizeVerCursor, Qt::SizeHorCursor, Qt::SizeBDiagCursor,
		Qt::SizeFDiagCursor, Qt::SizeFDiagCursor, Qt::SizeBDiagCursor, Qt::SizeVerCursor,
		Qt::SizeHorCursor, Qt::SizeBDiagCursor, Qt::SizeFDiagCursor, Qt::CrossCursor,
		Qt::CrossCursor, Qt::DragLinkCursor };
	const size_t index = static_cast<size_t>(id - 1);
	return index < std::size(kShapes) ? kShapes[index] : Qt::ArrowCursor;
}

} // namespace


QCursor
cursor_of(const CursorShape& shape)
{
	if (shape.id == CursorShape::kFromPicture && shape.picture != nullptr) {
		const CursorPicture& picture = *shape.picture;
		const QImage image(reinterpret_cast<const uchar*>(picture.pixels.data()), picture.width,
			picture.height, QImage::Format_ARGB32);
		return QCursor(QPixmap::fromImage(image), picture.hotX, picture.hotY);
	}
	if (shape.id != CursorShape::kFromBits)
		return QCursor(NamedCursor(shape.id));

	constexpr int kSide = 16;
	constexpr size_t kColors = 4, kMask = kColors + 32;
	QImage image(kSide, kSide, QImage::Format_ARGB32);
	image.fill(0);
	for (int y = 0; y < kSide; y++) {
		for (int x = 0; x < kSide; x++) {
			const size_t byte = static_cast<size_t>(y) * 2 + static_cast<size_t>(x) / 8;
			const uint8 bit = static_cast<uint8>(0x80 >> (x % 8));
			if ((shape.bits[kMask + byte] & bit) != 0) {
				const bool black = (shape.bits[kColors + byte] & bit) != 0;
				image.setPixel(x, y, black ? qRgb(0, 0, 0) : qRgb(255, 255, 255));
			}
		}
	}
	return QCursor(QPixmap::fromImage(image), shape.bits[3], shape.bits[2]);
}


} // namespace BPrivate
