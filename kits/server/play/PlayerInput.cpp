// The commands of the Player that are mouse and keys.

#include "server/play/Player.h"

#include <cstdlib>

#include <TypeConstants.h>

#include "backend/FolderDrop.h"
#include "server/Desktop.h"
#include "server/DesktopThread.h"
#include "server/input/PointerInput.h"

namespace BPrivate {


// #pragma mark - mouse


void
Player::_Click(PlayTokenReader& reader)
{
	const Gesture gesture = _TakeGesture(reader);
	reader.ExpectEnd();
	_ClickAt(gesture);
}


void
Player::_ClickAt(const Gesture& gesture)
{
	fInput.SetModifiers(gesture.modifiers);
	fInput.Move(gesture.where);
	WaitUntilIdle();
	fInput.BeginGesture();
	for (int32 i = 0; i < gesture.times; i++) {
		fInput.Press(gesture.button);
		WaitUntilIdle();
		fInput.Release(gesture.button);
		WaitUntilIdle();
	}
	fInput.SetModifiers(0);
}


void
Player::_Press(PlayTokenReader& reader)
{
	const Gesture gesture = _TakeGesture(reader);
	reader.ExpectEnd();
	fInput.SetModifiers(gesture.modifiers);
	fInput.Move(gesture.where);
	WaitUntilIdle();
	fInput.BeginGesture();
	fInput.Press(gesture.button);
}


void
Player::_Move(PlayTokenReader& reader)
{
	const Gesture gesture = _TakeGesture(reader);
	reader.ExpectEnd();
	fInput.SetModifiers(gesture.modifiers);
	fInput.Move(gesture.where);
}


void
Player::_Release(PlayTokenReader& reader)
{
	reader.ExpectEnd();
	if (fInput.Buttons() == 0)
		throw PlayError { "a button that is held", "none" };
	fInput.Release(fInput.Buttons());
	fInput.SetModifiers(0);
}


void
Player::_MoveInSteps(BPoint to, int32 steps)
{
	const BPoint from = fInput.Where();
	for (int32 i = 1; i <= steps; i++) {
		const float part = static_cast<float>(i) / static_cast<float>(steps);
		fInput.Move(BPoint(static_cast<float>(static_cast<int32>(from.x + (to.x - from.x) * part)),
			static_cast<float>(static_cast<int32>(from.y + (to.y - from.y) * part))));
		WaitUntilIdle();
	}
}


// The target is looked for when the button is down: the press may change what is on the screen.
void
Player::_Drag(PlayTokenReader& reader)
{
	Gesture gesture;
	gesture.where = _TakePlace(reader);
	if (!reader.TakeWord("to"))
		throw PlayError { "to", reader.AtEnd() ? "the end of the line" : reader.Peek()->text };
	if (reader.TakeWord("folder")) {
		const std::string folder = reader.TakeText("a folder");
		_TakeOptions(reader, gesture);
		reader.ExpectEnd();
		_DragToFolder(gesture, folder);
		return;
	}

	PlayTokenReader options = reader;
	ViewPath::Read(options);
	if (options.TakeWord("at"))
		options.Take("a point X,Y");
	_TakeOptions(options, gesture);
	options.ExpectEnd();

	fInput.SetModifiers(gesture.modifiers);
	fInput.Move(gesture.where);
	WaitUntilIdle();
	fInput.BeginGesture();
	fInput.Press(gesture.button);
	WaitUntilIdle();
	_MoveInSteps(_TakePlace(reader), gesture.steps);
	fInput.Release(gesture.button);
	WaitUntilIdle();
	fInput.SetModifiers(0);
}


void
Player::_DragToFolder(const Gesture& gesture, const std::string& folder)
{
	fInput.SetModifiers(gesture.modifiers);
	fInput.Move(gesture.where);
	WaitUntilIdle();
	fInput.BeginGesture();
	fInput.Press(gesture.button);
	WaitUntilIdle();
	_MoveInSteps(gesture.where + BPoint(20, 20), gesture.steps);
	bool dragging = false;
	fDesktop.RunOnDisplay([&] { dragging = fDesktop.Pointer().IsDragging(); });
	if (!dragging) {
		fInput.Release(gesture.button);
		fInput.SetModifiers(0);
		throw PlayError { "a drag", "nothing is dragged" };
	}
	fInput.Leave();
	WaitUntilIdle();
	fInput.DropOnFolder(folder.c_str());
	WaitUntilIdle();
	fInput.SetModifiers(0);
}


void
Player::_Drop(PlayTokenReader& reader)
{
	const std::string file = reader.TakeText("a file");
	if (!reader.TakeWord("on"))
		throw PlayError { "on", reader.AtEnd() ? "the end of the line" : reader.Peek()->text };
	const BPoint where = _TakePlace(reader);
	reader.ExpectEnd();

	char* path = realpath(file.c_str(), nullptr);
	if (path == nullptr)
		throw PlayError { "a file, " + file, "there is none" };
	const std::string list = uri_of_path(path) + "\r\n";
	std::free(path);
	BMessage data;
	data.AddData(
		"text/uri-list", B_MIME_TYPE, list.data(), static_cast<ssize_t>(list.size()), false);
	fInput.Move(where);
	fInput.ForeignDrag(BackendEvent::Type::DragEntered, data);
	fInput.ForeignDrag(BackendEvent::Type::DragMoved, data);
	WaitUntilIdle();
	fInput.ForeignDrag(BackendEvent::Type::Dropped, data);
}


void
Player::_Wheel(PlayTokenReader& reader)
{
	const BPoint where = _TakePlace(reader);
	float x, y;
	reader.TakePair("notches DX,DY", &x, &y);
	reader.ExpectEnd();
	fInput.Move(where);
	WaitUntilIdle();
	fInput.Wheel(BPoint(x, y));
}


// #pragma mark - keys


void
Player::_PressKey(const KeyStroke& stroke)
{
	fInput.KeyDown(stroke);
	WaitUntilIdle();
	fInput.KeyUp(stroke);
	WaitUntilIdle();
}


void
Player::_Type(PlayTokenReader& reader)
{
	const std::string text = reader.TakeText("a text");
	reader.ExpectEnd();
	std::string_view rest = text;
	while (!rest.empty()) {
		const size_t length = character_length(rest);
		_PressKey(stroke_of_character(rest.substr(0, length)));
		rest.remove_prefix(length);
	}
}


void
Player::_Key(PlayTokenReader& reader)
{
	const std::string name = reader.TakeText("a key");
	KeyStroke stroke;
	if (!stroke_of_name(name, &stroke))
		throw PlayError { "a key", name };
	Gesture gesture;
	_TakeOptions(reader, gesture);
	reader.ExpectEnd();

	fInput.SetModifiers(gesture.modifiers);
	for (int32 i = 0; i < gesture.times; i++)
		_PressKey(stroke);
	fInput.SetModifiers(0);
}


// #pragma mark - menus and alerts


void
Player::_MoveToMenuItem(const std::string& label)
{
	WaitUntilIdle();
	const std::optional<FoundView> item = fFinder.LookMenuItem(label);
	if (!item)
		throw PlayError { "menu item \"" + label + '"', "no open menu has it" };
	if (!item->node.enabled)
		throw PlayError { "menu item \"" + label + '"', "it is disabled" };
	if (!item->node.visible.IsValid())
		throw PlayError { "menu item \"" + label + '"', "it is scrolled away" };
	const BRect visible = item->node.visible;
	_MoveInSteps(BPoint(static_cast<float>(static_cast<int32>((visible.left + visible.right) / 2)),
					 static_cast<float>(static_cast<int32>((visible.top + visible.bottom) / 2))),
		3);
}


void
Player::_Menu(PlayTokenReader& reader)
{
	const std::string menu = reader.TakeText("a menu's label");
	const ViewNode root = fFinder.Describe(fFinder.DefaultWindow().id);
	std::vector<const ViewNode*> bars, items;
	ViewFinder::CollectMatches(root, { PathStep::Kind::Class, "BMenuBar", true }, bars);
	for (const ViewNode* bar : bars)
		ViewFinder::CollectMatches(*bar, { PathStep::Kind::Item, plain_label(menu) }, items);
	if (items.empty() || !items.front()->visible.IsValid())
		throw PlayError { "menu \"" + menu + '"', bars.empty() ? "no menu bar" : "no such menu" };

	Gesture gesture;
	gesture.where = items.front()->visible.LeftTop() + BPoint(3, 3);
	fInput.Move(gesture.where);
	WaitUntilIdle();
	fInput.BeginGesture();
	fInput.Press(1);
	do
		_MoveToMenuItem(reader.TakeText("a menu item"));
	while (!reader.AtEnd());
	fInput.Release(1);
}


void
Player::_Choose(PlayTokenReader& reader)
{
	const ViewPath path = ViewPath::Read(reader);
	const std::string item = reader.TakeText("a menu item");
	reader.ExpectEnd();

	const FoundView field = fFinder.FindVisible(path);
	std::vector<const ViewNode*> bars;
	ViewFinder::CollectMatches(field.node, { PathStep::Kind::Class, "BMenuBar", true }, bars);
	if (bars.empty() || !bars.front()->visible.IsValid())
		throw PlayError { path.source, "it has no menu" };
	const BRect visible = bars.front()->visible;
	fInput.Move(BPoint(static_cast<float>(static_cast<int32>((visible.left + visible.right) / 2)),
		static_cast<float>(static_cast<int32>((visible.top + visible.bottom) / 2))));
	WaitUntilIdle();
	fInput.BeginGesture();
	fInput.Press(1);
	_MoveToMenuItem(item);
	fInput.Release(1);
}


void
Player::_Answer(PlayTokenReader& reader)
{
	const std::string label = reader.TakeText("a button's label");
	reader.ExpectEnd();

	const std::vector<WindowNode> windows = fFinder.Windows();
	for (auto it = windows.rbegin(); it != windows.rend(); ++it) {
		if (!it->isAlert || !it->shown)
			continue;
		const ViewNode root = fFinder.Describe(it->id);
		std::vector<const ViewNode*> buttons;
		ViewFinder::CollectMatches(root, { PathStep::Kind::Class, "BButton", true }, buttons);
		for (const ViewNode* button : buttons) {
			if (plain_label(button->label) != plain_label(label))
				continue;
			Gesture gesture;
			gesture.where = button->visible.LeftTop()
				+ BPoint(static_cast<float>(static_cast<int32>(button->visible.Width() / 2)),
					static_cast<float>(static_cast<int32>(button->visible.Height() / 2)));
			_ClickAt(gesture);
			return;
		}
		throw PlayError { "an alert with \"" + label + '"', "one without" };
	}
	throw PlayError { "an alert with \"" + label + '"', "no alert" };
}


// #pragma mark - the desktop


void
Player::_Inject(BackendEvent event, uint32 window)
{
	Desktop::Get()->Inject(event, window);
}


void
Player::_Open(PlayTokenReader& reader)
{
	const std::string file = reader.TakeText("a file");
	reader.ExpectEnd();
	char* path = realpath(file.c_str(), nullptr);
	if (path == nullptr)
		throw PlayError { "a file, " + file, "there is none" };
	Desktop::Get()->OpenFile(path);
	std::free(path);
}


void
Player::_Resize(PlayTokenReader& reader)
{
	const WindowNode window = _TakeWindow(reader);
	float width, height;
	reader.TakePair("a size W,H", &width, &height);
	reader.ExpectEnd();

	BackendEvent event;
	event.type = BackendEvent::Type::WindowChanged;
	event.frame.Set(
		window.frame.left, window.frame.top, window.frame.left + width, window.frame.top + height);
	_Inject(event, window.id);
}


void
Player::_Activate(PlayTokenReader& reader)
{
	BackendEvent event;
	event.type = BackendEvent::Type::WindowActivated;
	const WindowNode window = _TakeWindow(reader);
	reader.ExpectEnd();
	_Inject(event, window.id);
}


void
Player::_Close(PlayTokenReader& reader)
{
	BackendEvent event;
	event.type = BackendEvent::Type::CloseRequested;
	const WindowNode window = _TakeWindow(reader);
	reader.ExpectEnd();
	_Inject(event, window.id);
}


} // namespace BPrivate
