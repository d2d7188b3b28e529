#include <string>

#include <gtest/gtest.h>

#include <Debug.h>
#include <OS.h>
#include <image.h>

#include "kernel/private/Activity.h"
#include "kernel/private/Debugger.h"

using BPrivate::wait_until_idle;
using BPrivate::WaitingScope;
using BPrivate::Worker;


TEST(Activity, IsQuietWhenAllWorkIsDone)
{
	EXPECT_TRUE(wait_until_idle(0));
	Worker worker;
	worker.AddWork(2);
	EXPECT_FALSE(worker.IsIdle());
	EXPECT_FALSE(wait_until_idle(1000));
	worker.WorkDone();
	EXPECT_FALSE(wait_until_idle(0));
	worker.WorkDone();
	EXPECT_TRUE(wait_until_idle(0));
}


TEST(Activity, AWaitingWorkerCountsAsIdle)
{
	Worker worker;
	worker.AddWork();
	{
		WaitingScope outer(&worker);
		WaitingScope inner(&worker);
		EXPECT_TRUE(wait_until_idle(0));
		worker.AddWork();
		EXPECT_TRUE(worker.IsIdle());
		WaitingScope none(nullptr);
	}
	EXPECT_FALSE(wait_until_idle(0));
	worker.WorkDone(2);
	EXPECT_TRUE(wait_until_idle(0));
}


TEST(Activity, AWorkerThatIsGoneHasNoWork)
{
	{
		Worker worker;
		worker.AddWork(5);
		EXPECT_FALSE(wait_until_idle(0));
	}
	EXPECT_TRUE(wait_until_idle(0));
}


TEST(Activity, WakesWhoWaitsForQuiet)
{
	static Worker* sWorker;
	Worker worker;
	sWorker = &worker;
	worker.AddWork();
	const thread_id thread = spawn_thread(
		[](void*) -> status_t {
			sWorker->WorkDone();
			return B_OK;
		},
		"worker", 10, nullptr);
	resume_thread(thread);
	EXPECT_TRUE(wait_until_idle(B_INFINITE_TIMEOUT));
	status_t result;
	wait_for_thread(thread, &result);
}


TEST(Debugger, TellsItsHookWhatIsWrong)
{
	static std::string sText;
	sText.clear();
	const BPrivate::debugger_hook old =
		BPrivate::set_debugger_hook([](const char* message) { sText = message; });
	debugger("a misuse");
	EXPECT_EQ("a misuse", sText);
	BPrivate::assertion_failed("1 == 2", "File.cpp", 7);
	EXPECT_EQ("File.cpp:7: assertion failed: 1 == 2", sText);
	BPrivate::set_debugger_hook(old);
}


TEST(Image, TheProgramIsTheFirstOne)
{
	int32 cookie = 0;
	image_info info;
	ASSERT_EQ(B_OK, get_next_image_info(0, &cookie, &info));
	EXPECT_EQ(B_APP_IMAGE, info.type);
	EXPECT_NE(std::string::npos, std::string(info.name).find("tests"));
	image_info again;
	ASSERT_EQ(B_OK, get_image_info(info.id, &again));
	EXPECT_STREQ(info.name, again.name);
	int32 images = 1;
	while (get_next_image_info(0, &cookie, &info) == B_OK)
		images++;
	EXPECT_LT(2, images);
	EXPECT_EQ(B_BAD_IMAGE_ID, get_image_info(-3, &info));
}


TEST(Image, WhatIsNoAddOnIsRefused)
{
	EXPECT_EQ(B_BAD_VALUE, load_add_on(nullptr));
	EXPECT_EQ(B_ENTRY_NOT_FOUND, load_add_on("/no/such/file"));
	EXPECT_EQ(B_NOT_AN_EXECUTABLE, load_add_on("/etc/passwd"));
	EXPECT_EQ(B_BAD_IMAGE_ID, unload_add_on(-3));
	void* symbol;
	EXPECT_EQ(B_BAD_IMAGE_ID, get_image_symbol(-3, "x", B_SYMBOL_TYPE_ANY, &symbol));
	EXPECT_EQ(B_BAD_VALUE, get_image_symbol(-3, nullptr, B_SYMBOL_TYPE_ANY, &symbol));
}
