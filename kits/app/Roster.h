// BRoster: what is known about running applications.
#pragma once

#include <Entry.h>
#include <OS.h>
#include <SupportDefs.h>

class BList;
class BMessage;
class BMessenger;

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


// Knows the applications of this team only: there is no registry of programs on this desktop.
class _EXPORT BRoster {
public:
	BRoster();
	~BRoster();

	bool IsRunning(const char* signature) const;
	team_id TeamFor(const char* signature) const;
	void GetAppList(BList* teams) const;
	void GetAppList(const char* signature, BList* teams) const;
	status_t GetAppInfo(const char* signature, app_info* info) const;
	status_t GetRunningAppInfo(team_id team, app_info* info) const;
	status_t GetActiveAppInfo(app_info* info) const;
	status_t Broadcast(BMessage* message) const;
	status_t Broadcast(BMessage* message, BMessenger replyTo) const;
	// Opens the file or address with the desktop's own program for it.
	status_t Launch(
		const entry_ref* ref, const BMessage* initialMessage = NULL, team_id* _team = NULL) const;
};

extern _EXPORT const BRoster* be_roster;
