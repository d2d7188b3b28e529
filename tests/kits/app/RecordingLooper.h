// RecordingLooper: a looper and handlers that note what reaches them.
#pragma once

#include <string>
#include <vector>

#include <AppDefs.h>
#include <Looper.h>
#include <Message.h>
#include <Messenger.h>


// "name:code" for each message, in the order of their handling. Under the looper's lock.
using Log = std::vector<std::string>;


inline std::string
Note(const char* name, uint32 what)
{
	const char code[] = { char(what >> 24), char(what >> 16), char(what >> 8), char(what), 0 };
	return std::string(name != nullptr ? name : "-") + ":" + code;
}


class RecordingHandler : public BHandler {
public:
	RecordingHandler(const char* name, Log* log) : BHandler(name), fLog(log) {}

	void MessageReceived(BMessage* message) override
	{
		fLog->push_back(Note(Name(), message->what));
		if (passOn)
			BHandler::MessageReceived(message);
	}

	bool passOn = false;

private:
	Log* fLog; // borrowed
};


class RecordingLooper : public BLooper {
public:
	explicit RecordingLooper(const char* name = "looper", int32 capacity = 100) :
		BLooper(name, B_NORMAL_PRIORITY, capacity)
	{
	}

	void MessageReceived(BMessage* message) override
	{
		// Its answer tells the test that everything before was handled.
		if (message->what == 'sync') {
			message->SendReply(B_REPLY);
			return;
		}
		log.push_back(Note(Name(), message->what));
		if (passOn)
			BLooper::MessageReceived(message);
	}

	// Returns when everything that is queued now was handled.
	void Sync()
	{
		BMessage reply;
		BMessenger(this).SendMessage('sync', &reply);
	}

	Log log;
	bool passOn = false;
};


// Ends a looper with its scope.
template<typename Class> class Running {
public:
	template<typename... Arguments>
	explicit Running(Arguments&&... arguments) :
		fLooper(new Class(std::forward<Arguments>(arguments)...)), fMessenger(fLooper)
	{
		fLooper->Run();
	}

	~Running()
	{
		if (fMessenger.LockTarget())
			fLooper->Quit();
	}

	Class* operator->() const { return fLooper; }
	Class* Get() const { return fLooper; }

private:
	Class* fLooper;
	BMessenger fMessenger;
};
