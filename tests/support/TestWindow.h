// TestWindow: an application and one shown window, for tests of views.
#pragma once

#include <functional>

#include <Application.h>
#include <View.h>
#include <Window.h>

#include "support/Driver.h"


class TestWindow {
public:
	explicit TestWindow(BRect frame = BRect(50, 50, 449, 349)) :
		fApplication("application/x-vnd.Archway-test"),
		fWindow(new BWindow(frame, "test", B_TITLED_WINDOW, B_ASYNCHRONOUS_CONTROLS))
	{
		fWindow->Show();
		Driver::WaitUntilIdle();
	}

	~TestWindow()
	{
		if (fWindow->Lock())
			fWindow->Quit();
	}

	BWindow* Window() { return fWindow; }

	template<class View> View* Add(View* view)
	{
		Locked([&] { fWindow->AddChild(view); });
		return view;
	}

	// Runs the function with the window locked, then waits until the program is idle.
	void Locked(const std::function<void()>& function)
	{
		fWindow->Lock();
		function();
		fWindow->Unlock();
		Driver::WaitUntilIdle();
	}

	Driver driver;

private:
	BApplication fApplication;
	BWindow* fWindow; // ends with Quit()
};
