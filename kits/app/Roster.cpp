#include <Roster.h>

#include <limits.h>
#include <string.h>
#include <strings.h>
#include <unistd.h>

#include <Application.h>
#include <List.h>
#include <Message.h>
#include <Messenger.h>

#include "app/private/LooperCore.h"

namespace {

const BRoster sRoster;

} // namespace

const BRoster* be_roster = &sRoster;


app_info::app_info() = default;


BRoster::BRoster() = default;


BRoster::~BRoster() = default;


bool
BRoster::IsRunning(const char* signature) const
{
	return TeamFor(signature) >= 0;
}


bool
BRoster::IsRunning(entry_ref* ref) const
{
	return TeamFor(ref) >= 0;
}


team_id
BRoster::TeamFor(const char* signature) const
{
	const bool ours = be_app != nullptr && signature != nullptr
		&& strcasecmp(signature, be_app->Signature()) == 0;
	return ours ? getpid() : B_ERROR;
}


team_id
BRoster::TeamFor(entry_ref* ref) const
{
	app_info info;
	const bool known = ref != nullptr && GetRunningAppInfo(getpid(), &info) == B_OK;
	return known && info.ref == *ref ? getpid() : B_ERROR;
}


void
BRoster::GetAppList(BList* teams) const
{
	if (teams != nullptr && be_app != nullptr)
		teams->AddItem(reinterpret_cast<void*>(intptr_t(getpid())));
}


void
BRoster::GetAppList(const char* signature, BList* teams) const
{
	if (IsRunning(signature))
		GetAppList(teams);
}


status_t
BRoster::GetAppInfo(const char* signature, app_info* info) const
{
	return IsRunning(signature) ? GetRunningAppInfo(getpid(), info) : B_ERROR;
}


status_t
BRoster::GetAppInfo(entry_ref* ref, app_info* info) const
{
	return IsRunning(ref) ? GetRunningAppInfo(getpid(), info) : B_ERROR;
}


status_t
BRoster::GetRunningAppInfo(team_id team, app_info* info) const
{
	if (info == nullptr)
		return B_BAD_VALUE;
	if (be_app == nullptr || team != getpid())
		return B_BAD_TEAM_ID;

	*info = app_info();
	info->team = team;
	info->thread = be_app->Thread();
	if (const auto core = BPrivate::LooperTable::Find(be_app))
		info->port = core->PortId();
	strncpy(info->signature, be_app->Signature(), sizeof(info->signature) - 1);

	char path[PATH_MAX];
	const ssize_t length = readlink("/proc/self/exe", path, sizeof(path) - 1);
	if (length <= 0)
		return B_ENTRY_NOT_FOUND;
	path[length] = '\0';
	return get_ref_for_path(path, &info->ref);
}


status_t
BRoster::GetActiveAppInfo(app_info* info) const
{
	return GetRunningAppInfo(getpid(), info);
}


status_t
BRoster::ActivateApp(team_id team) const
{
	return be_app != nullptr && team == getpid() ? B_NOT_SUPPORTED : B_BAD_TEAM_ID;
}


status_t
BRoster::Broadcast(BMessage* message) const
{
	return be_app_messenger.SendMessage(message);
}


status_t
BRoster::Broadcast(BMessage* message, BMessenger replyTo) const
{
	return be_app_messenger.SendMessage(message, replyTo);
}
