// BRoster: what is known about running applications.
#pragma once

#include <Entry.h>
#include <Messenger.h>
#include <OS.h>
#include <SupportDefs.h>

class BList;
class BMessage;

struct _EXPORT app_info {
	app_info();
	~app_info() = default;

	thread_id thread = -1;
	team_id team = -1;
	port_id port = -1;
	uint32 flags = 0;
	entry_ref ref;
	char signature[B_MIME_TYPE_LENGTH] = {};
};

#define B_SINGLE_LAUNCH 0x0
#define B_MULTIPLE_LAUNCH 0x1
#define B_EXCLUSIVE_LAUNCH 0x2
#define B_LAUNCH_MASK 0x3
#define B_BACKGROUND_APP 0x4
#define B_ARGV_ONLY 0x8

// What StartWatching() tells about, and the codes of what it sends.
enum {
	B_REQUEST_LAUNCHED = 0x1,
	B_REQUEST_QUIT = 0x2,
	B_REQUEST_ACTIVATED = 0x4,
};

enum {
	B_SOME_APP_LAUNCHED = 'BRAS',
	B_SOME_APP_QUIT = 'BRAQ',
	B_SOME_APP_ACTIVATED = 'BRAW',
};


// Knows the applications of this team only: there is no registry of programs on this desktop.
class _EXPORT BRoster {
public:
	BRoster();
	~BRoster();

	bool IsRunning(const char* signature) const;
	bool IsRunning(entry_ref* ref) const;
	team_id TeamFor(const char* signature) const; // B_ERROR when it does not run
	team_id TeamFor(entry_ref* ref) const;
	void GetAppList(BList* teams) const;
	void GetAppList(const char* signature, BList* teams) const;
	status_t GetAppInfo(const char* signature, app_info* info) const;
	status_t GetAppInfo(entry_ref* ref, app_info* info) const;
	status_t GetRunningAppInfo(team_id team, app_info* info) const;
	status_t GetActiveAppInfo(app_info* info) const;
	// The window manager decides who is in front: B_NOT_SUPPORTED for the running application.
	status_t ActivateApp(team_id team) const;
	status_t Broadcast(BMessage* message) const;
	status_t Broadcast(BMessage* message, BMessenger replyTo) const;
	// The program for a type, or for a file: that of the type's or file's preferred signature.
	// B_LAUNCH_FAILED_NO_PREFERRED_APP or B_LAUNCH_FAILED_APP_NOT_FOUND when there is none.
	status_t FindApp(const char* mimeType, entry_ref* _app) const;
	status_t FindApp(entry_ref* ref, entry_ref* _app) const;
	// Starts the program for the type. It gets the files in "refs" of the message as arguments.
	status_t Launch(
		const char* mimeType, BMessage* initialMessage = NULL, team_id* _team = NULL) const;
	status_t Launch(const char* mimeType, int argc, char** arguments, team_id* _team = NULL) const;
	// Opens the file or address with the desktop's own program for it.
	status_t Launch(
		const entry_ref* ref, const BMessage* initialMessage = NULL, team_id* _team = NULL) const;
};

extern _EXPORT const BRoster* be_roster;
