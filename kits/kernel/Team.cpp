#include <OS.h>

#include <cstdio>
#include <cstring>

#include <unistd.h>

#include <image.h>

#include "kernel/private/Table.h"


static void
read_arguments(team_info* info)
{
	FILE* file = fopen("/proc/self/cmdline", "r");
	if (file == nullptr)
		return;
	// Each argument ends with a NUL.
	for (int next; (next = fgetc(file)) != EOF;) {
		if (next == '\0')
			info->argc++;
	}
	rewind(file);
	const size_t length = fread(info->args, 1, sizeof(info->args) - 1, file);
	fclose(file);
	for (size_t i = 0; i + 1 < length; i++) {
		if (info->args[i] == '\0')
			info->args[i] = ' ';
	}
}


status_t
_get_team_info(team_id team, team_info* info, size_t size)
{
	if (info == nullptr || size != sizeof(team_info))
		return B_BAD_VALUE;
	if (!BPrivate::IsOwnTeam(team))
		return B_BAD_TEAM_ID;

	memset(info, 0, sizeof(*info));
	info->team = getpid();
	info->debugger_nub_thread = -1;
	info->debugger_nub_port = -1;
	info->uid = getuid();
	info->gid = getgid();
	thread_info thread;
	for (int32 cookie = 0; get_next_thread_info(team, &cookie, &thread) == B_OK;)
		info->thread_count++;
	area_info area;
	for (ssize_t cookie = 0; get_next_area_info(team, &cookie, &area) == B_OK;)
		info->area_count++;
	image_info image;
	for (int32 cookie = 0; get_next_image_info(team, &cookie, &image) == B_OK;)
		info->image_count++;
	read_arguments(info);
	return B_OK;
}


status_t
_get_next_team_info(int32* cookie, team_info* info, size_t size)
{
	if (cookie == nullptr || info == nullptr || *cookie != 0)
		return B_BAD_VALUE;
	*cookie = 1;
	return _get_team_info(B_CURRENT_TEAM, info, size);
}
