// Deadline: the end of a wait, from the flags and timeout of a kernel call.
#pragma once

#include <chrono>
#include <condition_variable>
#include <mutex>

#include <OS.h>

namespace BPrivate {


class Deadline {
public:
	// Without a timeout flag the wait has no end.
	Deadline(uint32 flags, bigtime_t timeout)
	{
		if ((flags & (B_RELATIVE_TIMEOUT | B_ABSOLUTE_TIMEOUT)) == 0)
			return;
		if (timeout == B_INFINITE_TIMEOUT)
			return;
		if ((flags & B_ABSOLUTE_TIMEOUT) != 0) {
			fEnd = timeout;
			return;
		}
		fPolls = timeout <= 0;
		const bigtime_t now = system_time();
		fEnd = timeout > B_INFINITE_TIMEOUT - now ? B_INFINITE_TIMEOUT : now + timeout;
	}

	// What a wait that came to its end reports.
	status_t Error() const { return fPolls ? B_WOULD_BLOCK : B_TIMED_OUT; }

	// Returns whether the predicate became true in time.
	template<typename Predicate>
	bool Wait(std::condition_variable& condition, std::unique_lock<std::mutex>& lock,
		Predicate predicate) const
	{
		if (fEnd == B_INFINITE_TIMEOUT) {
			condition.wait(lock, predicate);
			return true;
		}
		const bigtime_t left = fEnd - system_time();
		const auto end = std::chrono::steady_clock::now() + std::chrono::microseconds(left);
		return condition.wait_until(lock, end, predicate);
	}

private:
	bigtime_t fEnd = B_INFINITE_TIMEOUT;
	bool fPolls = false;
};


} // namespace BPrivate
