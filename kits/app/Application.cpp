#include <Application.h>

#include <algorithm>
#include <fstream>
#include <iterator>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <string>
#include <unistd.h>
#include <vector>

#include <AppDefs.h>
#include <Clipboard.h>
#include <Cursor.h>
#include <File.h>
#include <Message.h>
#include <MessageRunner.h>
#include <Resources.h>
#include <Roster.h>
#include <Window.h>

#include "app/private/ApplicationLink.h"
#include "app/private/CursorPrivate.h"
#include "app/private/Delivery.h"
#include "app/private/LooperCore.h"
#include "app/private/LooperPrivate.h"
#include "app/private/QuitSignals.h"
#include "server/Desktop.h"

using BPrivate::Desktop;
using BPrivate::LooperPrivate;
using BPrivate::LooperTable;

BApplication* be_app = nullptr;
BMessenger be_app_messenger;

namespace {

// The program's arguments, its own name first.
std::vector<std::string>
Arguments()
{
	std::ifstream file("/proc/self/cmdline", std::ios::binary);
	const std::string all { std::istreambuf_iterator<char>(file), {} };
	std::vector<std::string> arguments;
	for (size_t begin = 0; begin < all.size();) {
		const size_t end = std::min(all.find('\0', begin), all.size());
		arguments.push_back(all.substr(begin, end - begin));
		begin = end + 1;
	}
	return arguments;
}

} // namespace


BApplication::BApplication(const char* signature) : BLooper("application")
{
	status_t status = B_OK;
	_Init(signature, &status);
	if (status != B_OK) {
		fprintf(stderr, "%s: cannot start the desktop: %s\n", signature, strerror(status));
		exit(1);
	}
}


BApplication::BApplication(const char* signature, status_t* _error) : BLooper("application")
{
	status_t status = B_OK;
	_Init(signature, &status);
	if (_error != nullptr)
		*_error = status;
}


BApplication::BApplication(BMessage* data) : BLooper(data)
{
	status_t status = B_OK;
	_Init(data != nullptr ? data->FindString("mime_sig") : nullptr, &status);
}


void
BApplication::_Init(const char* signature, status_t* _error)
{
	if (be_app != nullptr) {
		debugger("2 BApplication objects were created. Only one is allowed.");
		*_error = fInitError = B_ALREADY_RUNNING;
		return;
	}
	fSignature = strdup(signature != nullptr ? signature : "");
	be_app = this;
	be_app_messenger = BMessenger(this);

	fLink = std::make_unique<BPrivate::ApplicationLink>(this);
	be_clipboard = new BClipboard("system");
	_PostArguments();
	*_error = fInitError = Desktop::Start(fLink.get());
}


BApplication::~BApplication()
{
	if (be_app != this) {
		free(fSignature);
		Lock();
		return;
	}

	// Windows that end may want the lock, and the desktop wants it never to be held.
	while (IsLocked())
		Unlock();
	_EndWindows();
	SetPulseRate(0);
	if (Desktop::Get() != nullptr)
		Desktop::Stop();

	Lock();
	delete be_clipboard;
	be_clipboard = nullptr;
	be_app = nullptr;
	be_app_messenger = BMessenger();
	free(fSignature);
}


// A program that opens archives already is an application, and a second one would end it.
BArchivable*
BApplication::Instantiate(BMessage* data)
{
	if (be_app != NULL)
		return NULL;
	return validate_instantiation(data, "BApplication") ? new BApplication(data) : nullptr;
}


status_t
BApplication::Archive(BMessage* data, bool deep) const
{
	const status_t status = BLooper::Archive(data, deep);
	return status == B_OK ? data->AddString("mime_sig", Signature()) : status;
}


status_t
BApplication::InitCheck() const
{
	return fInitError;
}


// #pragma mark - loop


thread_id
BApplication::Run()
{
	if (fRunCalled) {
		debugger("BApplication::Run was already called. Can only be called once.");
		return Thread();
	}
	if (!_CheckLocked("Run"))
		return B_ERROR;

	fRunCalled = true;
	fInCallersThread = true;
	const thread_id thread = find_thread(NULL);
	LooperPrivate(this).PostSystem(new BMessage(B_READY_TO_RUN));

	const BPrivate::QuitSignals signals(be_app_messenger);
	fCore->BeginLoop(thread);
	fCore->UnlockAll();
	_RunLoop();
	fCore->EndLoop();
	return thread;
}


void
BApplication::Quit()
{
	if (!fCore->IsLooping() || Thread() == find_thread(NULL)) {
		fTerminating = true;
		return;
	}
	LooperPrivate(this).PostSystem(new BMessage(_QUIT_));
}


bool
BApplication::QuitRequested()
{
	return _AskWindows();
}


// Asks each window that is there at its turn, and waits for those that agree to end. The lock is
// free meanwhile: a window that is asked may want it.
bool
BApplication::_AskWindows()
{
	const int32 locks = IsLocked() ? CountLocks() : 0;
	for (int32 i = 0; i < locks; i++)
		Unlock();

	std::vector<std::shared_ptr<BPrivate::LooperCore>> asked;
	bool agreed = true;
	while (agreed) {
		const auto core = LooperTable::NextWindow(asked);
		if (!core)
			break;
		asked.push_back(core);

		const BMessenger window = core->OwnMessenger();
		BMessage reply;
		if (window.SendMessage(B_QUIT_REQUESTED, &reply) != B_OK)
			continue; // it has just gone
		if (reply.what == B_REPLY && reply.FindBool("result"))
			core->WaitUntilDead();
		else
			agreed = !window.IsValid();
	}

	for (int32 i = 0; i < locks; i++)
		Lock();
	return agreed;
}


// Ends every window without asking, those that were never shown too.
void
BApplication::_EndWindows()
{
	for (const auto& core : LooperTable::AllWindows()) {
		// A window may end by itself meanwhile.
		if (core->Lock(core->IsLooping() ? B_INFINITE_TIMEOUT : 0) == B_OK)
			core->Looper()->Quit();
	}
}


void
BApplication::Pulse()
{
}


void
BApplication::ReadyToRun()
{
}


void
BApplication::MessageReceived(BMessage* message)
{
	BLooper::MessageReceived(message);
}


void
BApplication::ArgvReceived(int32 argc, char** argv)
{
}


void
BApplication::AppActivated(bool active)
{
}


void
BApplication::RefsReceived(BMessage* message)
{
}


void
BApplication::AboutRequested()
{
}


void
BApplication::DispatchMessage(BMessage* message, BHandler* handler)
{
	if (handler != this) {
		BLooper::DispatchMessage(message, handler);
		return;
	}

	switch (message->what) {
		case B_ARGV_RECEIVED:
			_HandleArguments(message);
			break;
		case B_REFS_RECEIVED:
			RefsReceived(message);
			break;
		case B_READY_TO_RUN:
			if (!fReadyToRunCalled) {
				fReadyToRunCalled = true;
				ReadyToRun();
			}
			break;
		case B_ABOUT_REQUESTED:
			AboutRequested();
			break;
		case B_PULSE:
			Pulse();
			break;
		case B_APP_ACTIVATED:
			AppActivated(message->FindBool("active"));
			break;
		default:
			BLooper::DispatchMessage(message, handler);
			break;
	}
}


// A program that was started without arguments hears of none.
void
BApplication::_PostArguments()
{
	const std::vector<std::string> arguments = Arguments();
	if (arguments.size() < 2)
		return;

	auto* message = new BMessage(B_ARGV_RECEIVED);
	message->AddInt32("argc", int32(arguments.size()));
	for (const std::string& argument : arguments)
		message->AddString("argv", argument.c_str());
	if (char* folder = getcwd(NULL, 0)) {
		message->AddString("cwd", folder);
		free(folder);
	}
	LooperPrivate(this).PostSystem(message);
}


void
BApplication::_HandleArguments(BMessage* message)
{
	std::vector<std::string> arguments;
	const char* argument = NULL;
	for (int32 i = 0; message->FindString("argv", i, &argument) == B_OK; i++)
		arguments.push_back(argument);

	std::vector<char*> pointers;
	for (std::string& text : arguments)
		pointers.push_back(text.data());
	pointers.push_back(NULL);
	ArgvReceived(int32(arguments.size()), pointers.data());
}


// #pragma mark - cursor


void
BApplication::ShowCursor()
{
	fCursorHidden = false;
	if (Desktop* desktop = Desktop::Get())
		desktop->SetCursorHidden(false);
}


void
BApplication::HideCursor()
{
	fCursorHidden = true;
	if (Desktop* desktop = Desktop::Get())
		desktop->SetCursorHidden(true);
}


void
BApplication::ObscureCursor()
{
	if (Desktop* desktop = Desktop::Get())
		desktop->ObscureCursor();
}


bool
BApplication::IsCursorHidden() const
{
	return fCursorHidden;
}


void
BApplication::SetCursor(const void* cursor)
{
	const BCursor made(cursor);
	SetCursor(&made);
}


void
BApplication::SetCursor(const BCursor* cursor, bool sync)
{
	Desktop* desktop = Desktop::Get();
	if (cursor != nullptr && desktop != nullptr)
		desktop->SetCursor(BPrivate::CursorPrivate::Shape(*cursor));
}


// #pragma mark - information


int32
BApplication::CountWindows() const
{
	return LooperTable::CountWindows();
}


BWindow*
BApplication::WindowAt(int32 index) const
{
	return LooperTable::WindowAt(index);
}


int32
BApplication::CountLoopers() const
{
	return LooperTable::CountLoopers();
}


BLooper*
BApplication::LooperAt(int32 index) const
{
	return LooperTable::LooperAt(index);
}


bool
BApplication::IsLaunching() const
{
	return !fReadyToRunCalled;
}


const char*
BApplication::Signature() const
{
	return fSignature != nullptr ? fSignature : "";
}


status_t
BApplication::GetAppInfo(app_info* info) const
{
	return be_roster->GetRunningAppInfo(Team(), info);
}


BResources*
BApplication::AppResources()
{
	// Read once, by whoever asks first. A program without resources has an empty set.
	static BResources* resources = [] {
		auto* made = new BResources;
		BFile program("/proc/self/exe", B_READ_ONLY);
		made->SetTo(&program);
		return made;
	}();
	return resources;
}


void
BApplication::SetPulseRate(bigtime_t rate)
{
	fPulseRunner.reset();
	if (rate > 0) {
		const BMessage pulse(B_PULSE);
		fPulseRunner = std::make_unique<BMessageRunner>(be_app_messenger, &pulse, rate);
	}
}
