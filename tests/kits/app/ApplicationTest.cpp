#include <Application.h>

#include <condition_variable>
#include <gtest/gtest.h>
#include <mutex>
#include <signal.h>
#include <string.h>
#include <thread>
#include <unistd.h>

#include <AppDefs.h>
#include <Resources.h>
#include <Roster.h>

#include "tests/kits/app/RecordingLooper.h"
#include "tests/support/DebuggerCatcher.h"

namespace {

constexpr const char* kSignature = "application/x-vnd.Archway-test";

// Notes its hooks and quits when it is told to.
class TestApplication : public BApplication {
public:
	TestApplication() : BApplication(kSignature) {}

	void ReadyToRun() override { log.push_back("ready"); }
	void ArgvReceived(int32 argc, char** argv) override { log.push_back("argv"); }
	void RefsReceived(BMessage*) override { log.push_back("refs"); }
	void AboutRequested() override { log.push_back("about"); }
	void AppActivated(bool active) override { log.push_back(active ? "active" : "inactive"); }

	void Pulse() override
	{
		log.push_back("pulse");
		Quit();
	}

	bool QuitRequested() override
	{
		log.push_back("request");
		return BApplication::QuitRequested();
	}

	void MessageReceived(BMessage* message) override
	{
		log.push_back(Note("app", message->what));
		if (message->what == 'kill')
			kill(getpid(), SIGTERM);
	}

	Log log;
};

} // namespace


TEST(Application, IsKnownAsLongAsItLives)
{
	{
		TestApplication app;
		EXPECT_EQ(&app, be_app);
		EXPECT_STREQ(kSignature, be_app->Signature());
		EXPECT_TRUE(be_app_messenger == BMessenger(&app));
		EXPECT_TRUE(app.IsLocked());
		EXPECT_TRUE(app.IsLaunching());
		EXPECT_EQ(0, app.CountWindows());
		EXPECT_EQ(nullptr, app.WindowAt(0));
		EXPECT_GE(app.CountLoopers(), 1);
		EXPECT_EQ(B_OK, app.InitCheck());
	}
	EXPECT_EQ(nullptr, be_app);
	EXPECT_FALSE(be_app_messenger.IsValid());
}


TEST(Application, IsTheOnlyOne)
{
	DebuggerCatcher catcher;
	TestApplication app;
	status_t status = B_OK;
	{
		BApplication second(kSignature, &status);
		EXPECT_TRUE(catcher.TakeOne());
	}
	EXPECT_EQ(B_ALREADY_RUNNING, status);
	EXPECT_EQ(&app, be_app);
}


TEST(Application, AnArchiveMakesNoSecondOne)
{
	BApplication application(kSignature);
	BMessage archive;
	ASSERT_EQ(B_OK, application.Archive(&archive));
	DebuggerCatcher catcher;
	EXPECT_EQ(NULL, instantiate_object(&archive));
	EXPECT_TRUE(catcher.Take().empty());
	EXPECT_EQ(&application, be_app);
}


TEST(Application, RunsInTheCallersThreadAndHearsOfItsStartFirst)
{
	TestApplication app;
	BMessage refs(B_REFS_RECEIVED);
	app.PostMessage(&refs);
	BMessage active(B_APP_ACTIVATED);
	active.AddBool("active", true);
	app.PostMessage(B_ABOUT_REQUESTED);
	app.PostMessage(&active);
	std::thread other([] {
		// Comes behind B_READY_TO_RUN, which Run() posts before the loop answers.
		BMessage reply;
		be_app_messenger.SendMessage(B_GET_SUPPORTED_SUITES, &reply);
		be_app_messenger.SendMessage(B_QUIT_REQUESTED);
	});

	EXPECT_EQ(find_thread(NULL), app.Run());

	other.join();
	// The test's own arguments come first, if it was started with some.
	if (!app.log.empty() && app.log[0] == "argv")
		app.log.erase(app.log.begin());
	ASSERT_GE(app.log.size(), 4u);
	EXPECT_EQ("refs", app.log[0]);
	EXPECT_EQ("about", app.log[1]);
	EXPECT_EQ("active", app.log[2]);
	EXPECT_NE(app.log.end(), std::find(app.log.begin(), app.log.end(), "ready"));
	EXPECT_EQ("request", app.log.back());
	EXPECT_FALSE(app.IsLaunching());
}


TEST(Application, QuitMakesRunReturnFromAnyThread)
{
	TestApplication app;
	std::thread other([&] {
		BMessage reply;
		be_app_messenger.SendMessage(B_GET_SUPPORTED_SUITES, &reply);
		app.Lock();
		app.Quit();
		app.Unlock();
	});

	app.Run();

	other.join();
	EXPECT_EQ(&app, be_app);
}


TEST(Application, ASignalAsksItToQuit)
{
	TestApplication app;
	app.PostMessage('kill');

	app.Run();

	EXPECT_EQ("request", app.log.back());
}


TEST(Application, PulsesAtItsRate)
{
	TestApplication app;
	app.SetPulseRate(1000);

	app.Run();

	EXPECT_EQ("pulse", app.log.back());
}


TEST(Application, IsWhoAnswersGoToByDefault)
{
	TestApplication app;
	class Answering : public RecordingLooper {
	public:
		void MessageReceived(BMessage* message) override { message->SendReply('answ'); }
	};
	Running<Answering> looper;
	looper->PostMessage('mess');
	BMessage reply;
	BMessenger(looper.Get()).SendMessage('sync', &reply);
	app.PostMessage(B_QUIT_REQUESTED);

	app.Run();

	EXPECT_NE(app.log.end(), std::find(app.log.begin(), app.log.end(), "app:answ"));
}


TEST(Application, CanBeFoundByItsSignature)
{
	TestApplication app;
	status_t status = B_ERROR;

	EXPECT_TRUE(BMessenger(kSignature, -1, &status) == be_app_messenger);
	EXPECT_EQ(B_OK, status);
	EXPECT_TRUE(BMessenger(kSignature, getpid()) == be_app_messenger);
	EXPECT_FALSE(BMessenger("application/x-vnd.nobody", -1, &status).IsValid());
	EXPECT_NE(B_OK, status);
	EXPECT_TRUE(be_roster->IsRunning(kSignature));
	EXPECT_EQ(getpid(), be_roster->TeamFor(kSignature));
}


TEST(Application, KnowsItsFile)
{
	TestApplication app;
	app_info info;

	ASSERT_EQ(B_OK, app.GetAppInfo(&info));

	EXPECT_STREQ(kSignature, info.signature);
	EXPECT_STREQ("tests_app", info.ref.name);
	EXPECT_EQ(getpid(), info.team);
	ASSERT_NE(nullptr, BApplication::AppResources());
	EXPECT_EQ(BApplication::AppResources(), BApplication::AppResources());
}
