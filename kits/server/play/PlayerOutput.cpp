// The commands of the Player that look at the program, or at the world.

#include "server/play/Player.h"

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <sys/wait.h>
#include <unistd.h>

#include "server/Desktop.h"
#include "server/DesktopThread.h"
#include "server/play/Picture.h"
#include "server/play/ViewText.h"

namespace BPrivate {

namespace {

constexpr int32 kWaitSeconds = 10;
constexpr bigtime_t kLookInterval = 20000;

} // namespace


void
Player::_Picture(PlayTokenReader& reader)
{
	const std::string path = reader.TakeText("a file to write");
	BRect place = fDesktop.ScreenFrame();
	if (!reader.AtEnd()) {
		const ViewPath view = ViewPath::Read(reader);
		reader.ExpectEnd();
		place = fFinder.FindVisible(view).node.visible;
	}
	if (Desktop::Get()->SavePicture(path.c_str(), place) != B_OK)
		throw PlayError { "a picture " + path, "it cannot be written" };
}


void
Player::_Tree(PlayTokenReader& reader)
{
	if (reader.AtEnd()) {
		_Print(tree_of(fFinder.DescribeWindow(fFinder.DefaultWindow()).node));
		return;
	}
	const ViewPath path = ViewPath::Read(reader);
	reader.ExpectEnd();
	_Print(tree_of(fFinder.Find(path).node));
}


// Reads "VIEW PROPERTY" and tells what the view has.
std::string
Player::_Property(PlayTokenReader& reader, std::string* _described)
{
	const ViewPath path = ViewPath::Read(reader);
	const std::string property = reader.TakeText("a property");
	const FoundView found = fFinder.Find(path);
	*_described = path.source + ' ' + property;
	if (property == "pixel") {
		const std::string at = reader.TakeText("a point X,Y");
		const BPoint where = _PlaceIn(found, at);
		const ScreenPicture picture =
			Desktop::Get()->Picture(BRect(where.x, where.y, where.x, where.y));
		*_described += ' ' + at;
		return text_of_color(color_at(picture, 0, 0));
	}

	std::string value;
	if (!property_of(found.node, property, &value))
		throw PlayError { "a property", property };
	return value;
}


void
Player::_Show(PlayTokenReader& reader)
{
	std::string described;
	const std::string value = _Property(reader, &described);
	reader.ExpectEnd();
	_Print(value + '\n');
}


void
Player::_Expect(PlayTokenReader& reader)
{
	std::string described;
	const std::string value = _Property(reader, &described);
	const bool contains = reader.TakeWord("~");
	const std::string wanted = reader.TakeRest();
	const bool holds = contains ? value.find(wanted) != std::string::npos : value == wanted;
	if (!holds)
		throw PlayError { described + (contains ? " ~ \"" : " \"") + wanted + '"',
			'"' + value + '"' };
}


void
Player::_Absent(PlayTokenReader& reader)
{
	const ViewPath path = ViewPath::Read(reader);
	reader.ExpectEnd();
	if (fFinder.Look(path))
		throw PlayError { "no " + path.source, "there is one" };
}


void
Player::_Windows(PlayTokenReader& reader)
{
	const int32 wanted = reader.TakeNumber("a number of windows");
	reader.ExpectEnd();
	std::string titles;
	int32 count = 0;
	for (const WindowNode& window : fFinder.Windows()) {
		if (!window.shown || window.isMenu)
			continue;
		count++;
		titles += (titles.empty() ? ": \"" : ", \"") + window.title + '"';
	}
	if (count != wanted)
		throw PlayError { std::to_string(wanted) + " windows", std::to_string(count) + titles };
}


void
Player::_Wait(PlayTokenReader& reader)
{
	const ViewPath path = ViewPath::Read(reader);
	const int32 seconds = reader.AtEnd() ? kWaitSeconds : reader.TakeNumber("seconds");
	reader.ExpectEnd();

	const bigtime_t end = system_time() + bigtime_t(seconds) * 1000000;
	while (!fEnded()) {
		WaitUntilIdle();
		const std::optional<FoundView> found = fFinder.Look(path);
		if (found && found->window.shown && !found->node.hidden)
			return;
		if (system_time() >= end)
			throw PlayError { path.source, "not within " + std::to_string(seconds) + " seconds" };
		snooze(kLookInterval);
	}
}


void
Player::_RunCommand(PlayTokenReader& reader)
{
	const std::string command = reader.TakeText("a shell command");
	reader.ExpectEnd();
	std::fflush(fOutput);
	const int status = std::system(command.c_str());
	const int code = WIFEXITED(status) ? WEXITSTATUS(status) : 128;
	if (status == -1 || code != 0)
		throw PlayError { "status 0 of " + command, "status " + std::to_string(code) };
}


void
Player::_Echo(PlayTokenReader& reader)
{
	_Print(reader.TakeRest() + '\n');
}


void
Player::_Quit(PlayTokenReader& reader)
{
	reader.ExpectEnd();
	Quit();
}


void
Player::_QuitNow(PlayTokenReader& reader)
{
	reader.ExpectEnd();
	std::fflush(nullptr);
	_exit(0);
}


} // namespace BPrivate
