// What the application does with its windows.
#include <Application.h>

#include <atomic>
#include <functional>
#include <gtest/gtest.h>

#include <AppDefs.h>
#include <Message.h>
#include <Messenger.h>
#include <Window.h>

namespace {

constexpr const char* kSignature = "application/x-vnd.Archway-test";

// Answers a request as it is told, and tells of its end.
class TestWindow : public BWindow {
public:
	explicit TestWindow(const char* name, std::atomic<int>* living) :
		BWindow(BRect(10, 10, 109, 109), name, B_TITLED_WINDOW, 0), fLiving(living)
	{
		(*fLiving)++;
	}

	~TestWindow() override { (*fLiving)--; }

	bool QuitRequested() override
	{
		asked = true;
		return !onRequest || onRequest();
	}

	std::function<bool()> onRequest;
	std::atomic<bool> asked { false };

private:
	std::atomic<int>* fLiving; // borrowed
};

} // namespace


TEST(ApplicationWindows, AreThoseThatWereShown)
{
	BApplication app(kSignature);
	std::atomic<int> living = 0;
	auto* first = new TestWindow("first", &living);
	auto* second = new TestWindow("second", &living);
	EXPECT_EQ(0, app.CountWindows());

	second->Show();
	first->Show();

	EXPECT_EQ(2, app.CountWindows());
	EXPECT_EQ(second, app.WindowAt(0));
	EXPECT_EQ(first, app.WindowAt(1));
	EXPECT_EQ(nullptr, app.WindowAt(2));

	second->Lock();
	second->Quit();
	EXPECT_EQ(1, app.CountWindows());
	EXPECT_EQ(first, app.WindowAt(0));
}


TEST(ApplicationWindows, EndWithTheApplication)
{
	std::atomic<int> living = 0;
	{
		BApplication app(kSignature);
		(new TestWindow("shown", &living))->Show();
		new TestWindow("never shown", &living);
		EXPECT_EQ(2, living);
	}
	EXPECT_EQ(0, living);
}


TEST(ApplicationWindows, AreAskedAndEndWhenTheyAgree)
{
	BApplication app(kSignature);
	std::atomic<int> living = 0;
	(new TestWindow("first", &living))->Show();
	(new TestWindow("second", &living))->Show();
	app.PostMessage(B_QUIT_REQUESTED);

	app.Run();

	EXPECT_EQ(0, living);
	EXPECT_EQ(0, app.CountWindows());
}


TEST(ApplicationWindows, ARefusalKeepsTheRest)
{
	BApplication app(kSignature);
	std::atomic<int> living = 0;
	auto* first = new TestWindow("first", &living);
	auto* second = new TestWindow("second", &living);
	auto* third = new TestWindow("third", &living);
	second->onRequest = [] { return false; };
	for (BWindow* window : { first, second, third })
		window->Show();

	EXPECT_FALSE(app.QuitRequested());

	EXPECT_EQ(2, living);
	EXPECT_TRUE(second->asked);
	EXPECT_FALSE(third->asked);
	EXPECT_EQ(second, app.WindowAt(0));
}


TEST(ApplicationWindows, MayLockTheApplicationWhenTheyAreAsked)
{
	BApplication app(kSignature);
	std::atomic<int> living = 0;
	std::atomic<bool> locked = false;
	auto* window = new TestWindow("window", &living);
	window->onRequest = [&] {
		locked = app.Lock();
		if (locked)
			app.Unlock();
		return true;
	};
	window->Show();
	app.PostMessage(B_QUIT_REQUESTED);

	app.Run();

	EXPECT_TRUE(locked);
	EXPECT_EQ(0, living);
}


TEST(ApplicationWindows, AWindowOpenedWhileTheyAreAskedIsAskedToo)
{
	BApplication app(kSignature);
	std::atomic<int> living = 0;
	auto* window = new TestWindow("window", &living);
	window->onRequest = [&] {
		(new TestWindow("late", &living))->Show();
		return true;
	};
	window->Show();

	EXPECT_TRUE(app.QuitRequested());

	EXPECT_EQ(0, living);
}


TEST(ApplicationWindows, AnswerScriptsByTheirIndexAndTitle)
{
	class Asker : public BLooper {
	public:
		void MessageReceived(BMessage* message) override
		{
			for (BMessage& script : scripts) {
				BMessage reply;
				be_app_messenger.SendMessage(&script, &reply);
				answers.push_back(
					reply.what == B_REPLY ? reply.FindString("result") : "not understood");
			}
			be_app_messenger.SendMessage(B_QUIT_REQUESTED);
		}
		std::vector<BMessage> scripts;
		std::vector<std::string> answers;
	};
	BApplication app(kSignature);
	std::atomic<int> living = 0;
	for (const char* title : { "first", "second" }) {
		auto* window = new TestWindow(title, &living);
		window->SetName((std::string("name of ") + title).c_str());
		window->Show();
	}
	auto* asker = new Asker;
	for (int i = 0; i < 4; i++) {
		asker->scripts.emplace_back(B_GET_PROPERTY);
		asker->scripts[i].AddSpecifier("InternalName");
	}
	asker->scripts[0].AddSpecifier("Window", int32(1));
	asker->scripts[1].AddSpecifier("Window", "first");
	asker->scripts[2].AddSpecifier("Window", int32(2));
	asker->scripts[3].AddSpecifier("Window", "third");
	asker->Run();
	asker->PostMessage('go  ');

	app.Run();

	asker->Lock();
	EXPECT_EQ((std::vector<std::string> {
				  "name of second", "name of first", "not understood", "not understood" }),
		asker->answers);
	asker->Quit();
}
