#include "scenarios/RealScreen.h"

#include <poll.h>
#include <unistd.h>

#include <algorithm>
#include <chrono>

#include <gtest/gtest.h>

namespace {


constexpr std::chrono::seconds kPatience(20);


// Asks again and again until the answer is yes or the patience ends. Each question takes a
// program's run, so that it does not keep a processor busy for nothing.
template<class Question>
bool
Poll(const Question& question)
{
	const auto end = std::chrono::steady_clock::now() + kPatience;
	do {
		if (question())
			return true;
	} while (std::chrono::steady_clock::now() < end);
	return false;
}


// The number of the display, which the server writes when it is ready for clients.
std::string
ReadDisplay(int pipe)
{
	std::string number;
	pollfd readable = { pipe, POLLIN, 0 };
	char byte;
	while (poll(&readable, 1, std::chrono::milliseconds(kPatience).count()) == 1
		&& read(pipe, &byte, 1) == 1 && byte != '\n')
		number += byte;
	return number;
}


std::string
WithoutNewline(std::string text)
{
	while (!text.empty() && text.back() == '\n')
		text.pop_back();
	return text;
}


} // namespace


bool
RealScreen::IsAvailable()
{
	for (const char* program : { "Xvfb", "openbox", "xdotool", "xprop", "import" }) {
		if (Run({ "sh", "-c", std::string("command -v ") + program }).status != 0)
			return false;
	}
	return true;
}


RealScreen::RealScreen()
{
	int ends[2];
	if (pipe(ends) != 0)
		return;
	// Without -noreset the server drops everybody when a first question ends before the window
	// manager has come.
	fServer = std::make_unique<RunningProgram>(
		std::vector<std::string> { "Xvfb", "-displayfd", std::to_string(ends[1]), "-screen", "0",
			"1600x1000x24", "-nolisten", "tcp", "-noreset" },
		std::vector<std::string>(), ends[1]);
	close(ends[1]);
	fDisplay = ':' + ReadDisplay(ends[0]);
	close(ends[0]);
	// A window that comes while the manager starts is never shown by it. So it says itself when it
	// has started.
	fManager = std::make_unique<RunningProgram>(
		std::vector<std::string> {
			"openbox", "--sm-disable", "--startup", "xprop -root -f READY 8s -set READY yes" },
		Environment());
	fIsRunning = Poll([this] {
		return Run({ "xprop", "-root", "READY" }, Environment()).output.find("yes")
			!= std::string::npos;
	});
}


// The manager goes first; without its server it would complain.
RealScreen::~RealScreen()
{
	fManager.reset();
	fServer.reset();
}


std::vector<std::string>
RealScreen::Environment() const
{
	return { "DISPLAY=" + fDisplay, "WAYLAND_DISPLAY=", "ARCHWAY_BACKEND=qt",
		"QT_QPA_PLATFORM=xcb" };
}


std::string
RealScreen::Do(const std::vector<std::string>& xdotool) const
{
	std::vector<std::string> command = { "xdotool" };
	command.insert(command.end(), xdotool.begin(), xdotool.end());
	const ProgramResult result = Run(command, Environment());
	EXPECT_EQ(0, result.status) << ::testing::PrintToString(command) << result.errors;
	return WithoutNewline(result.output);
}


std::string
RealScreen::WaitForWindow(const std::string& title) const
{
	std::string window;
	const bool found = Poll([&] {
		window = WithoutNewline(
			Run({ "xdotool", "search", "--onlyvisible", "--name", title }, Environment()).output);
		return !window.empty();
	});
	EXPECT_TRUE(found) << title;
	return window.substr(0, window.find('\n'));
}


bool
RealScreen::WaitForCount(const std::string& title, int count) const
{
	return Poll([&] {
		const std::string windows =
			Run({ "xdotool", "search", "--onlyvisible", "--name", title }, Environment()).output;
		return std::count(windows.begin(), windows.end(), '\n') == count;
	});
}


bool
RealScreen::WaitForChange(int x, int y, const std::string& before) const
{
	return Poll([&] { return PixelOfScreen(x, y) != before; });
}


bool
RealScreen::WaitForPixel(const std::string& window, int x, int y, const std::string& color) const
{
	return Poll([&] { return _Pixel(window, x, y).find(color) != std::string::npos; });
}


std::string
RealScreen::_Pixel(const std::string& window, int x, int y) const
{
	const std::string place = "1x1+" + std::to_string(x) + '+' + std::to_string(y);
	return Run({ "import", "-silent", "-window", window, "-crop", place, "-depth", "8", "txt:-" },
		Environment())
		.output;
}
