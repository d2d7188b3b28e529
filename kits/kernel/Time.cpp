#include <OS.h>

#include <cerrno>
#include <ctime>

#include <sys/sysinfo.h>
#include <unistd.h>


static bigtime_t
read_clock(clockid_t clock)
{
	timespec now;
	clock_gettime(clock, &now);
	return bigtime_t(now.tv_sec) * 1000000 + now.tv_nsec / 1000;
}


bigtime_t
system_time(void)
{
	return read_clock(CLOCK_MONOTONIC);
}


uint32
real_time_clock(void)
{
	return static_cast<uint32>(real_time_clock_usecs() / 1000000);
}


bigtime_t
real_time_clock_usecs(void)
{
	return read_clock(CLOCK_REALTIME);
}


status_t
snooze(bigtime_t microseconds)
{
	if (microseconds <= 0)
		return B_OK;
	const bigtime_t now = system_time();
	const bigtime_t end =
		microseconds > B_INFINITE_TIMEOUT - now ? B_INFINITE_TIMEOUT : now + microseconds;
	return snooze_until(end, B_SYSTEM_TIMEBASE);
}


status_t
snooze_until(bigtime_t time, int timeBase)
{
	if (timeBase != B_SYSTEM_TIMEBASE)
		return B_BAD_VALUE;

	timespec end;
	end.tv_sec = time_t(time / 1000000);
	end.tv_nsec = long(time % 1000000) * 1000;
	// A signal does not shorten the sleep: nobody here is interrupted on purpose.
	while (clock_nanosleep(CLOCK_MONOTONIC, TIMER_ABSTIME, &end, nullptr) == EINTR) {
	}
	return B_OK;
}


status_t
get_system_info(system_info* info)
{
	if (info == nullptr)
		return B_BAD_VALUE;

	struct sysinfo host;
	if (sysinfo(&host) != 0)
		return B_ERROR;
	info->cpu_count = static_cast<int32>(sysconf(_SC_NPROCESSORS_ONLN));
	info->page_size = static_cast<int32>(sysconf(_SC_PAGESIZE));
	info->max_pages = uint64(host.totalram) * host.mem_unit / info->page_size;
	info->used_pages = info->max_pages - uint64(host.freeram) * host.mem_unit / info->page_size;
	info->boot_time = real_time_clock_usecs() - system_time();
	return B_OK;
}


int32
is_computer_on(void)
{
	return 1;
}


double
is_computer_on_fire(void)
{
	return 0;
}
