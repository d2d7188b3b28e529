// ControlFixture: a window that notes its messages, with views in it and a user in front of it.
#pragma once

#include <memory>
#include <string>
#include <vector>

#include <Application.h>
#include <Autolock.h>
#include <Message.h>
#include <View.h>
#include <Window.h>
#include <gtest/gtest.h>

#include "support/Driver.h"


class RecordingWindow : public BWindow {
public:
	RecordingWindow() :
		BWindow(BRect(50, 50, 449, 349), "Controls", B_TITLED_WINDOW, B_ASYNCHRONOUS_CONTROLS)
	{
	}

	void MessageReceived(BMessage* message) override
	{
		if (message->HasPointer("source"))
			fReceived.push_back(*message);
		else
			BWindow::MessageReceived(message);
	}

	std::vector<BMessage> fReceived;
};


class ControlFixture {
public:
	ControlFixture() :
		app("application/x-vnd.Archway-test"), window(new RecordingWindow), target(window)
	{
		ground = new BView(window->Bounds(), "ground", B_FOLLOW_ALL, B_WILL_DRAW);
		ground->SetViewColor(216, 216, 216);
		window->AddChild(ground);
		window->Show();
		Driver::WaitUntilIdle();
	}

	~ControlFixture()
	{
		if (target.LockTarget())
			window->Quit();
	}

	template<class View> View* Add(View* view)
	{
		window->Lock();
		ground->AddChild(view);
		window->Unlock();
		Driver::WaitUntilIdle();
		return view;
	}

	// Runs under the window's lock, and waits until what it caused is done.
	template<class Action> auto Locked(Action action)
	{
		struct Unlocker {
			BWindow* window;
			~Unlocker()
			{
				window->Unlock();
				Driver::WaitUntilIdle();
			}
		};
		window->Lock();
		Unlocker unlocker { window };
		return action();
	}

	void Focus(BView* view)
	{
		Locked([&] { view->MakeFocus(true); });
	}

	// The messages with this code so far, oldest first.
	std::vector<BMessage> Received(uint32 what)
	{
		Driver::WaitUntilIdle();
		std::vector<BMessage> result;
		Locked([&] {
			for (const BMessage& message : window->fReceived) {
				if (message.what == what)
					result.push_back(message);
			}
		});
		return result;
	}

	int32 CountReceived(uint32 what) { return static_cast<int32>(Received(what).size()); }

	BApplication app;
	RecordingWindow* window;
	const BMessenger target; // the window; invalid when that is closed
	BView* ground;
	Driver driver;
};


// The names of the fields after those of BView, in stored order, with spaces between.
inline std::string
OwnFieldNames(const BMessage& archive)
{
	static const std::string kViewFields = " class _name _frame _resize_mode _flags _evmask _fname "
										   "_fflt _color _uicolor _uitint _dbuf _origin _scale "
										   "_psize _ploc _lmcapjoin _lmmiter _blend _dmod "
										   "BView:sizes BView:alignment _show _views BView:layout ";
	std::string result;
	char* name;
	type_code type;
	int32 count;
	for (int32 i = 0; archive.GetInfo(B_ANY_TYPE, i, &name, &type, &count) == B_OK; i++) {
		if (kViewFields.find(" " + std::string(name) + " ") != std::string::npos)
			continue;
		result += (result.empty() ? "" : " ") + std::string(name);
	}
	return result;
}


inline BMessage
ArchiveOf(const BArchivable& object, bool deep = true)
{
	BMessage archive;
	EXPECT_EQ(B_OK, object.Archive(&archive, deep));
	return archive;
}


template<class Object>
std::unique_ptr<Object>
Revive(BMessage archive)
{
	BArchivable* object = instantiate_object(&archive);
	Object* result = dynamic_cast<Object*>(object);
	EXPECT_NE(nullptr, result);
	if (result == nullptr)
		delete object;
	return std::unique_ptr<Object>(result);
}


// What was read comes out again: unchanged, and after having been in a shown window.
template<class View>
void
ExpectArchiveRoundTrip(ControlFixture& fixture, const BMessage& archive)
{
	std::unique_ptr<View> revived = Revive<View>(archive);
	ASSERT_NE(nullptr, revived);
	EXPECT_TRUE(archive.HasSameData(ArchiveOf(*revived), false, true));

	fixture.Add(revived.get());
	fixture.Locked([&] {
		revived->RemoveSelf();
		EXPECT_TRUE(archive.HasSameData(ArchiveOf(*revived), false, true));
	});
}


template<class View>
void
ExpectRoundTrip(ControlFixture& fixture, const View& view)
{
	ExpectArchiveRoundTrip<View>(fixture, ArchiveOf(view));
}


// The fields that every control adds to what it sends.
inline void
ExpectInvocationFields(const BMessage& message, const BView* source, int32 value)
{
	EXPECT_TRUE(message.HasInt64("when"));
	void* pointer = nullptr;
	EXPECT_EQ(B_OK, message.FindPointer("source", &pointer));
	EXPECT_EQ(static_cast<const void*>(source), pointer);
	int32 number = -1;
	EXPECT_EQ(B_OK, message.FindInt32("be:value", &number));
	EXPECT_EQ(value, number);
	EXPECT_TRUE(message.HasMessenger("be:sender"));
}
