// RealScreen: an X screen in memory with a window manager, for tests in real windows.
#pragma once

#include <memory>
#include <string>
#include <vector>

#include "scenarios/Program.h"


class RealScreen {
public:
	// Whether this system has the programs that it takes.
	static bool IsAvailable();

	RealScreen();
	~RealScreen();

	// Whether screen and window manager answer.
	bool IsRunning() const { return fIsRunning; }

	// What a program needs to show its windows here.
	std::vector<std::string> Environment() const;

	// Mouse, keys and windows, as a person uses them. Returns what xdotool printed, without the
	// final newline; an error fails the test.
	std::string Do(const std::vector<std::string>& xdotool) const;

	// The window whose title matches the regular expression, as soon as it is shown.
	std::string WaitForWindow(const std::string& title) const;

	// Whether so many windows with a title that matches are shown in time.
	bool WaitForCount(const std::string& title, int count) const;

	// What the screen shows there, and whether it shows something else in time.
	std::string PixelOfScreen(int x, int y) const { return _Pixel("root", x, y); }
	bool WaitForChange(int x, int y, const std::string& before) const;

	// Whether the pixel of the window's contents becomes that colour ("#rrggbb") in time.
	bool WaitForPixel(const std::string& window, int x, int y, const std::string& color) const;

private:
	std::string _Pixel(const std::string& window, int x, int y) const;

	std::string fDisplay;
	std::unique_ptr<RunningProgram> fServer;
	std::unique_ptr<RunningProgram> fManager;
	bool fIsRunning = false;
};
