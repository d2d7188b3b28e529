// BApplication: the program, its connection to the desktop, and its main looper.
#pragma once

#include <AppDefs.h>
#include <Cursor.h>
#include <InterfaceDefs.h>
#include <Looper.h>
#include <Messenger.h>
#include <Point.h>
#include <Rect.h>

class BMessageRunner;
class BResources;
class BWindow;
struct app_info;

namespace BPrivate {
class ApplicationLink;
}


// One per program, made before any window, font or bitmap, in the thread that will call Run().
// Windows live without the loop running.
class _EXPORT BApplication : public BLooper {
public:
	BApplication(const char* signature);
	BApplication(const char* signature, status_t* _error);
	BApplication(BMessage* data);
	virtual ~BApplication();

	static BArchivable* Instantiate(BMessage* data);
	virtual status_t Archive(BMessage* data, bool deep = true) const;
	status_t InitCheck() const;

	// Runs the loop in the calling thread, and returns when it was quit.
	virtual thread_id Run();
	// Makes Run() return; deletes nothing.
	virtual void Quit();
	// Asks every window, each in its own thread; ends those that agree, stops at the first refusal.
	virtual bool QuitRequested();

	virtual void Pulse();
	virtual void ReadyToRun();
	virtual void MessageReceived(BMessage* message);
	virtual void ArgvReceived(int32 argc, char** argv);
	virtual void AppActivated(bool active);
	virtual void RefsReceived(BMessage* message);
	virtual void AboutRequested();
	virtual void DispatchMessage(BMessage* message, BHandler* handler);

	virtual BHandler* ResolveSpecifier(
		BMessage* message, int32 index, BMessage* specifier, int32 form, const char* property);
	virtual status_t GetSupportedSuites(BMessage* data);

	void ShowCursor();
	void HideCursor();
	void ObscureCursor();
	bool IsCursorHidden() const;
	void SetCursor(const void* cursor);
	void SetCursor(const BCursor* cursor, bool sync = true);

	int32 CountWindows() const;
	BWindow* WindowAt(int32 index) const;
	int32 CountLoopers() const;
	BLooper* LooperAt(int32 index) const;
	// Not running yet: messages wait until Run().
	bool IsLaunching() const;
	const char* Signature() const;
	status_t GetAppInfo(app_info* info) const;
	// The resources of the program's file; never NULL, empty when it has none.
	static BResources* AppResources();

	void SetPulseRate(bigtime_t rate);

private:
	void _Init(const char* signature, status_t* _error);
	void _PostArguments();
	void _HandleArguments(BMessage* message);
	BMessenger _WindowFor(const BMessage& specifier, int32 form) const;
	bool _AskWindows();
	void _EndWindows();

	char* fSignature = nullptr;
	status_t fInitError = B_OK;
	std::unique_ptr<BPrivate::ApplicationLink> fLink;
	std::unique_ptr<BMessageRunner> fPulseRunner;
	bool fCursorHidden = false;
	bool fRunCalled = false;
	bool fReadyToRunCalled = false;
};

extern _EXPORT BApplication* be_app;
extern _EXPORT BMessenger be_app_messenger;
