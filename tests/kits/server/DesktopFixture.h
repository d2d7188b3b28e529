// DesktopFixture: a desktop with windows that write down what they are told.
#pragma once

#include <memory>
#include <mutex>
#include <vector>

#include <AppDefs.h>
#include <Message.h>
#include <gtest/gtest.h>

#include "backend/Backend.h"
#include "server/Desktop.h"
#include "server/ServerWindow.h"
#include "server/play/ScriptedInput.h"

namespace BPrivate {


class MessageLog {
public:
	void Add(BMessage* message)
	{
		std::lock_guard lock(fLock);
		fMessages.emplace_back(message);
	}

	// What came since the last call.
	std::vector<std::unique_ptr<BMessage>> Take()
	{
		std::lock_guard lock(fLock);
		return std::move(fMessages);
	}

private:
	std::mutex fLock;
	std::vector<std::unique_ptr<BMessage>> fMessages;
};


using Messages = std::vector<std::unique_ptr<BMessage>>;


class TestWindow : public WindowClient {
public:
	enum : uint32 {
		kTitledLook = 1,
		kNormalFeel = 0,
		kModalAppFeel = 1,
		kFloatingAppFeel = 4,
		kFloatingSubsetFeel = 5,
		kFloatingAllFeel = 6,
		kAcceptsFirstClick = 0x10,
		kAvoidFocus = 0x2000
	};

	explicit TestWindow(BRect frame, uint32 feel = kNormalFeel, uint32 flags = 0) :
		server(this, frame, "Test", kTitledLook, feel, flags)
	{
		server.Show();
	}

	void PostInput(BMessage* message) override { fLog.Add(message); }
	Messages Take() { return fLog.Take(); }

	// Of this code since the last call; the others are forgotten.
	Messages Take(uint32 what)
	{
		Messages all = fLog.Take(), wanted;
		for (std::unique_ptr<BMessage>& message : all) {
			if (message->what == what)
				wanted.push_back(std::move(message));
		}
		return wanted;
	}

private:
	MessageLog fLog; // before the window, whose events may come until it is gone

public:
	ServerWindow server;
};


class DesktopTest : public testing::Test, public ApplicationClient {
protected:
	void SetUp() override { ASSERT_EQ(B_OK, Desktop::Start(this)); }
	void TearDown() override { Desktop::Stop(); }

	void PostToApplication(BMessage* message) override { application.Add(message); }

	// Everything that was asked of the display thread is done afterwards.
	static void Settle()
	{
		Desktop::Get()->RunOnDisplay([] {});
	}

	void Click(BPoint where)
	{
		input.BeginGesture();
		input.Move(where);
		input.Press(1);
		input.Release(1);
		Settle();
	}

	MessageLog application;
	ScriptedInput input;
};


inline bool
IsElsewhere(const BMessage& message)
{
	return message.GetBool(kPointerElsewhere, false);
}


} // namespace BPrivate
