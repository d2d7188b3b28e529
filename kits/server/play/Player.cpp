#include "server/play/Player.h"

#include <algorithm>
#include <cstdio>
#include <cstdlib>

#include <AppDefs.h>

#include "server/DesktopThread.h"

namespace BPrivate {

namespace {

constexpr bigtime_t kIdlePatience = 60000000;
constexpr bigtime_t kWindowPatience = 30000000;
constexpr bigtime_t kSlice = 100000;

} // namespace


const Player::Command Player::kCommands[] = {
	{ "click", &Player::_Click },
	{ "press", &Player::_Press },
	{ "move", &Player::_Move },
	{ "release", &Player::_Release },
	{ "drag", &Player::_Drag },
	{ "drop", &Player::_Drop },
	{ "wheel", &Player::_Wheel },
	{ "type", &Player::_Type },
	{ "key", &Player::_Key },
	{ "menu", &Player::_Menu },
	{ "choose", &Player::_Choose },
	{ "answer", &Player::_Answer },
	{ "open", &Player::_Open },
	{ "resize", &Player::_Resize },
	{ "activate", &Player::_Activate },
	{ "close", &Player::_Close },
	{ "picture", &Player::_Picture },
	{ "tree", &Player::_Tree },
	{ "show", &Player::_Show },
	{ "expect", &Player::_Expect },
	{ "absent", &Player::_Absent },
	{ "windows", &Player::_Windows },
	{ "wait", &Player::_Wait },
	{ "run", &Player::_RunCommand },
	{ "echo", &Player::_Echo },
	{ "quit", &Player::_Quit },
	{ "quit!", &Player::_QuitNow },
};


Player::Player(DesktopThread& desktop, std::function<bool()> ended) :
	fDesktop(desktop), fEnded(std::move(ended)), fFinder(desktop)
{
}


Player::~Player()
{
	if (fOutput != stdout)
		std::fclose(fOutput);
}


void
Player::OpenOutput()
{
	const char* path = std::getenv("ARCHWAY_PLAY_OUT");
	if (path == nullptr || path[0] == '\0')
		return;
	std::FILE* file = std::fopen(path, "w");
	if (file == nullptr)
		throw PlayError { std::string("a file to write, ") + path, "it cannot be opened" };
	fOutput = file;
}


// A program makes its windows on its main thread, whose work nobody counts before it runs.
void
Player::WaitForFirstWindow()
{
	const bigtime_t end = system_time() + kWindowPatience;
	while (!fEnded()) {
		bool shown = false;
		fDesktop.Inspect([&](Inspector& inspector) {
			const std::vector<WindowNode> windows = inspector.Windows();
			shown = std::any_of(windows.begin(), windows.end(),
				[](const WindowNode& window) { return window.shown; });
		});
		if (shown)
			return;
		if (system_time() > end)
			throw PlayError { "a window", "none within 30 seconds" };
		snooze(10000);
	}
}


void
Player::WaitUntilIdle()
{
	const bigtime_t end = system_time() + kIdlePatience;
	while (!wait_until_idle(kSlice)) {
		if (fEnded())
			return;
		if (system_time() > end)
			throw PlayError { "an idle program", "one that is busy for a minute" };
	}
}


void
Player::Perform(PlayTokenReader& reader)
{
	const std::string name = reader.TakeText("a command");
	for (const Command& command : kCommands) {
		if (name == command.name) {
			(this->*command.perform)(reader);
			std::fflush(fOutput);
			return;
		}
	}
	throw PlayError { "a command", name };
}


void
Player::Quit()
{
	auto message = std::make_unique<BMessage>(B_QUIT_REQUESTED);
	message->AddBool("shortcut", true);
	fDesktop.PostToApplication(std::move(message));
}


// #pragma mark - parts of a line


BPoint
Player::_TakePlace(PlayTokenReader& reader)
{
	const ViewPath path = ViewPath::Read(reader);
	const FoundView found = fFinder.FindVisible(path);
	if (reader.TakeWord("at"))
		return _PlaceIn(found, reader.TakeText("a point X,Y"));
	const BRect visible = found.node.visible;
	return BPoint(static_cast<float>(static_cast<int32>((visible.left + visible.right) / 2)),
		static_cast<float>(static_cast<int32>((visible.top + visible.bottom) / 2)));
}


namespace {

// "12", "-3", "right-3", "left+2", "middle".
float
Coordinate(const std::string& text, float low, float high)
{
	struct Edge {
		const char* name;
		float at;
	};
	const Edge edges[] = { { "left", low }, { "top", low }, { "right", high }, { "bottom", high },
		{ "middle", static_cast<float>(static_cast<int32>((low + high) / 2)) } };

	float base = 0;
	std::string number = text;
	for (const Edge& edge : edges) {
		if (text.rfind(edge.name, 0) == 0) {
			base = edge.at;
			number = text.substr(std::char_traits<char>::length(edge.name));
			break;
		}
	}
	if (number.empty() && !text.empty())
		return base;
	char* end = nullptr;
	const float offset = std::strtof(number.c_str(), &end);
	if (number.empty() || *end != '\0')
		throw PlayError { "a coordinate", text };
	return base + offset;
}

} // namespace


BPoint
Player::_PlaceIn(const FoundView& found, const std::string& at)
{
	const size_t comma = at.find(',');
	if (comma == std::string::npos)
		throw PlayError { "a point X,Y", at };
	const BRect& bounds = found.node.bounds;
	const float x = Coordinate(at.substr(0, comma), bounds.left, bounds.right);
	const float y = Coordinate(at.substr(comma + 1), bounds.top, bounds.bottom);
	return found.node.screen.LeftTop() + (BPoint(x, y) - bounds.LeftTop());
}


Player::Gesture
Player::_TakeGesture(PlayTokenReader& reader)
{
	Gesture gesture;
	gesture.where = _TakePlace(reader);
	_TakeOptions(reader, gesture);
	return gesture;
}


void
Player::_TakeOptions(PlayTokenReader& reader, Gesture& gesture)
{
	constexpr int32 kMost = 10000;
	for (;;) {
		if (reader.TakeWord("button")) {
			const int32 button = std::clamp(reader.TakeNumber("a button from 1"), 1, 8);
			gesture.button = 1u << (button - 1);
		} else if (reader.TakeWord("times")) {
			gesture.times = std::clamp(reader.TakeNumber("how many times"), 1, kMost);
		} else if (reader.TakeWord("steps")) {
			gesture.steps = std::clamp(reader.TakeNumber("how many steps"), 1, kMost);
		} else if (reader.TakeWord("with")) {
			gesture.modifiers |= _TakeModifiers(reader);
		} else {
			return;
		}
	}
}


uint32
Player::_TakeModifiers(PlayTokenReader& reader)
{
	uint32 modifiers = 0;
	while (const PlayToken* next = reader.Peek()) {
		const uint32 modifier = modifier_of_name(next->text);
		if (modifier == 0)
			break;
		modifiers |= modifier;
		reader.Take("a modifier");
	}
	if (modifiers == 0)
		throw PlayError { "Shift, Control, Command or Option",
			reader.AtEnd() ? "the end of the line" : reader.Peek()->text };
	return modifiers;
}


WindowNode
Player::_TakeWindow(PlayTokenReader& reader)
{
	reader.TakeWord("window");
	return fFinder.WindowNamed(reader.TakeText("a window's title"));
}


void
Player::_Print(const std::string& text)
{
	std::fwrite(text.data(), 1, text.size(), fOutput);
}


} // namespace BPrivate
