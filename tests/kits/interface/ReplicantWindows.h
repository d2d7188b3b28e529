// Two windows: one with views to drag, one whose ground takes what is dropped.
#pragma once

#include <memory>
#include <vector>

#include <AppDefs.h>
#include <Dragger.h>
#include <StringView.h>

#include "ControlFixture.h"


// Notes the messages that are dropped on it.
class DropGround : public BView {
public:
	explicit DropGround(BRect frame) : BView(frame, "drops", B_FOLLOW_ALL, B_WILL_DRAW)
	{
		SetViewColor(216, 216, 216);
	}

	void MessageReceived(BMessage* message) override
	{
		if (message->WasDropped() && notes)
			dropped.push_back(*message);
		else
			BView::MessageReceived(message);
	}

	bool notes = true;
	std::vector<BMessage> dropped;
};


struct ReplicantWindows : ControlFixture {
	// The press that brings a window to the front may begin a drag.
	static constexpr uint32 kFlags = B_ASYNCHRONOUS_CONTROLS | B_WILL_ACCEPT_FIRST_CLICK;

	ReplicantWindows() :
		other(new BWindow(BRect(500, 50, 799, 349), "Other", B_TITLED_WINDOW, kFlags)),
		drops(new DropGround(other->Bounds()))
	{
		Locked([&] { window->SetFlags(kFlags); });
		other->AddChild(drops);
		other->Show();
		Driver::WaitUntilIdle();
	}

	~ReplicantWindows()
	{
		if (other->Lock())
			other->Quit();
	}

	template<class Action> auto LockedOther(Action action)
	{
		struct Unlocker {
			BWindow* window;
			~Unlocker()
			{
				window->Unlock();
				Driver::WaitUntilIdle();
			}
		};
		other->Lock();
		Unlocker unlocker { other };
		return action();
	}

	// A text with a dragger in its right bottom corner, in the first window.
	BDragger* AddText(const char* text = "A replicant")
	{
		BStringView* view = new BStringView(BRect(20, 20, 139, 49), "text", text);
		BDragger* dragger = new BDragger(BRect(112, 22, 119, 29), view);
		view->AddChild(dragger);
		Add(view);
		return dragger;
	}

	void DropOnOther(BDragger* dragger, BPoint where)
	{
		driver.Drag(dragger, BPoint(4, 4), drops, where);
	}

	BWindow* other;
	DropGround* drops;
};
