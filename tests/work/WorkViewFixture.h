// WorkViewFixture: a work view with a design in a window, used by mouse and keys.
#pragma once

#include <cstdlib>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <Button.h>
#include <Message.h>
#include <ScrollBar.h>
#include <ScrollView.h>

#include "archive/EditorCodes.h"
#include "support/TestWindow.h"
#include "work/WorkBackgroundView.h"
#include "work/WorkView.h"


// Of two pixels a point; to be made before the application.
struct SharpScreen {
	SharpScreen() { setenv("ARCHWAY_SCALE", "2", 1); }
};


// Stands for the editor: notes what it is told.
class Listener : public BView {
public:
	Listener() : BView(BRect(0, 0, 9, 9), "listener", B_FOLLOW_NONE, 0) {}

	void MessageReceived(BMessage* message) override
	{
		void* view;
		if (message->what == kSelectionChanged && message->FindPointer("what", &view) == B_OK)
			selections.push_back(static_cast<BView*>(view));
		else if (message->what == kSelectionMoved)
			moves++;
		else
			BView::MessageReceived(message);
	}

	std::vector<BView*> selections;
	int moves = 0;
};


// Tells of the presses that reach it.
class PressedView : public BView {
public:
	PressedView(BRect frame, const char* name) :
		BView(frame, name, B_FOLLOW_LEFT | B_FOLLOW_TOP, B_WILL_DRAW)
	{
	}

	void MouseDown(BPoint) override { presses++; }
	void KeyDown(const char*, int32) override { keys++; }

	int presses = 0;
	int keys = 0;
};


// A work view with a root that has a plain child, a button and a scroll view.
class WorkViewFixture : public testing::Test {
protected:
	WorkViewFixture() : window(BRect(40, 40, 539, 439))
	{
		listener = new Listener;
		window.Add(listener);
		workView = new WorkView(BRect(20, 20, 449, 349), B_FOLLOW_ALL_SIDES, listener);
		window.Add(workView);

		root =
			new BView(BRect(30, 40, 329, 239), "root", B_FOLLOW_LEFT | B_FOLLOW_TOP, B_WILL_DRAW);
		plain = new PressedView(BRect(20, 20, 119, 79), "plain");
		root->AddChild(plain);
		button = new BButton(BRect(20, 100, 119, 130), "button", "Press", new BMessage('prss'));
		root->AddChild(button);
		target = new BView(BRect(160, 20, 240, 90), "target", B_FOLLOW_ALL_SIDES, B_WILL_DRAW);
		scroll = new BScrollView(
			"scroll", target, B_FOLLOW_LEFT | B_FOLLOW_TOP, 0, true, true, B_FANCY_BORDER);
		root->AddChild(scroll);
		window.Locked([&] { workView->SetEditView(root); });
		listener->selections.clear();
	}

	// A point at a distance from the lower right corner of the view.
	BPoint FromCorner(BView* view, float dx, float dy)
	{
		const BRect bounds = view->Bounds();
		return BPoint(bounds.right - dx, bounds.bottom - dy);
	}

	TestWindow window;
	Listener* listener;
	WorkView* workView;
	BView* root;
	PressedView* plain;
	BButton* button;
	BView* target;
	BScrollView* scroll;
};
