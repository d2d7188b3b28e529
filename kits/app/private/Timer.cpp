#include "app/private/Timer.h"

#include <algorithm>
#include <chrono>
#include <thread>

#include <Message.h>

namespace BPrivate {
namespace {

// A shorter interval would do nothing but fill the target's port.
constexpr bigtime_t kShortest = 1000;

} // namespace


// Never destroyed: its thread may be sending while the program's static objects go.
Timer&
Timer::Get()
{
	static Timer* timer = new Timer;
	return *timer;
}


int32
Timer::Add(const BMessenger& target, const BMessage* message, bigtime_t interval, int32 count,
	const BMessenger& replyTo)
{
	if (message == nullptr || interval <= 0 || count == 0 || !target.IsValid())
		return B_BAD_VALUE;

	std::lock_guard lock(fLock);
	if (!fRunning) {
		fRunning = true;
		std::thread([this] { _Run(); }).detach();
	}

	interval = std::max(interval, kShortest);
	const int32 id = fNextId++;
	const bigtime_t due = system_time() + interval;
	fEntries.emplace(
		id, Entry { target, replyTo, std::make_unique<BMessage>(*message), interval, count, due });
	fSchedule.emplace(due, id);
	fChanged.notify_one();
	return id;
}


void
Timer::Remove(int32 id)
{
	std::lock_guard lock(fLock);
	_Forget(id);
}


status_t
Timer::SetInterval(int32 id, bigtime_t interval)
{
	if (interval <= 0)
		return B_BAD_VALUE;

	std::lock_guard lock(fLock);
	const auto found = fEntries.find(id);
	if (found == fEntries.end())
		return B_BAD_VALUE;

	Entry& entry = found->second;
	fSchedule.erase({ entry.due, id });
	entry.interval = std::max(interval, kShortest);
	entry.due = system_time() + entry.interval;
	fSchedule.emplace(entry.due, id);
	fChanged.notify_one();
	return B_OK;
}


status_t
Timer::SetCount(int32 id, int32 count)
{
	std::lock_guard lock(fLock);
	const auto found = fEntries.find(id);
	if (found == fEntries.end())
		return B_BAD_VALUE;
	if (count == 0)
		_Forget(id);
	else
		found->second.count = count;
	return B_OK;
}


status_t
Timer::GetInfo(int32 id, bigtime_t* _interval, int32* _count)
{
	std::lock_guard lock(fLock);
	const auto found = fEntries.find(id);
	if (found == fEntries.end())
		return B_BAD_VALUE;
	if (_interval != nullptr)
		*_interval = found->second.interval;
	if (_count != nullptr)
		*_count = found->second.count;
	return B_OK;
}


void
Timer::_Run()
{
	std::unique_lock lock(fLock);
	while (true) {
		if (fSchedule.empty()) {
			fChanged.wait(lock);
			continue;
		}
		const bigtime_t now = system_time();
		const bigtime_t due = fSchedule.begin()->first;
		if (due > now)
			fChanged.wait_for(lock, std::chrono::microseconds(due - now));
		else
			_SendDue(now);
	}
}


// Sending under the lock never waits, and makes sure that a removed runner is silent.
void
Timer::_SendDue(bigtime_t now)
{
	while (!fSchedule.empty() && fSchedule.begin()->first <= now) {
		const int32 id = fSchedule.begin()->second;
		Entry& entry = fEntries.at(id);
		if (!_Send(entry)) {
			_Forget(id);
			continue;
		}
		fSchedule.erase(fSchedule.begin());
		// Beats that were missed are not made up for.
		entry.due = std::max(entry.due + entry.interval, now + 1);
		fSchedule.emplace(entry.due, id);
	}
}


// False when it was the last one, or the target is gone.
bool
Timer::_Send(Entry& entry)
{
	const status_t status = entry.target.SendMessage(entry.message.get(), entry.replyTo, 0);
	if (status == B_BAD_PORT_ID)
		return false;
	// A target that has no time now misses a beat but gets its count.
	if (status == B_OK && entry.count > 0)
		entry.count--;
	return entry.count != 0;
}


void
Timer::_Forget(int32 id)
{
	const auto found = fEntries.find(id);
	if (found == fEntries.end())
		return;
	fSchedule.erase({ found->second.due, id });
	fEntries.erase(found);
}


} // namespace BPrivate
