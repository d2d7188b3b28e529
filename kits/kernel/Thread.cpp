#include <OS.h>

#include <atomic>
#include <condition_variable>
#include <cstring>
#include <deque>
#include <memory>
#include <mutex>
#include <string>
#include <vector>

#include <sys/resource.h>
#include <time.h>
#include <unistd.h>

#include "kernel/private/Table.h"

using BPrivate::Table;

namespace {

struct ExitCallback {
	void (*function)(void*);
	void* data;
};

struct Thread {
	std::mutex lock;
	std::condition_variable changed;
	thread_id id = -1;
	std::string name;
	int32 priority = B_NORMAL_PRIORITY;
	thread_func function = nullptr;
	void* argument = nullptr;
	bool started = false;
	bool finished = false;
	status_t result = B_OK;
	pthread_t handle {};
	std::vector<ExitCallback> exitCallbacks; // used by the thread itself only

	bool hasData = false;
	thread_id sender = -1;
	int32 code = 0;
	std::vector<char> data;
};

// How many threads that have ended are remembered, so that a late wait gets their result.
constexpr size_t kRememberedThreads = 1024;

struct Registry {
	Table<Thread> threads;
	std::mutex lock;
	std::deque<thread_id> finished; // oldest first, guarded by the lock
};

// Never destroyed: threads may still end while the program's static objects are taken down.
Registry&
registry()
{
	static Registry* sRegistry = new Registry;
	return *sRegistry;
}


void
finish(Thread& thread, status_t result)
{
	while (!thread.exitCallbacks.empty()) {
		const ExitCallback callback = thread.exitCallbacks.back();
		thread.exitCallbacks.pop_back();
		callback.function(callback.data);
	}

	const thread_id id = thread.id;
	{
		std::unique_lock lock(thread.lock);
		thread.finished = true;
		thread.result = result;
		thread.changed.notify_all();
	}

	std::shared_ptr<Thread> forgotten;
	std::unique_lock lock(registry().lock);
	registry().finished.push_back(id);
	if (registry().finished.size() > kRememberedThreads) {
		forgotten = registry().threads.Remove(registry().finished.front());
		registry().finished.pop_front();
	}
}


// The calling thread's record. A thread that was not made here gets one on the first call, and
// loses it when it ends.
struct Self {
	std::shared_ptr<Thread> thread;
	bool foreign = false;
	status_t result = B_OK;

	~Self()
	{
		if (thread != nullptr && foreign) {
			registry().threads.Remove(thread->id);
			thread.reset();
		} else if (thread != nullptr)
			finish(*thread, result);
	}
};

thread_local Self sSelf;


Thread&
self()
{
	if (sSelf.thread == nullptr) {
		auto thread = std::make_shared<Thread>();
		char name[16] = "";
		pthread_getname_np(pthread_self(), name, sizeof(name));
		thread->name = name;
		thread->started = true;
		thread->handle = pthread_self();
		sSelf.thread = thread;
		sSelf.foreign = true;
		thread->id = registry().threads.Add(thread);
	}
	return *sSelf.thread;
}


void
set_host_name(pthread_t handle, const std::string& name)
{
	pthread_setname_np(handle, name.substr(0, 15).c_str());
}


void*
run(void* argument)
{
	{
		std::unique_ptr<std::shared_ptr<Thread>> handed(
			static_cast<std::shared_ptr<Thread>*>(argument));
		sSelf.thread = *handed;
	}
	set_host_name(pthread_self(), sSelf.thread->name);
	sSelf.result = sSelf.thread->function(sSelf.thread->argument);
	return nullptr;
}


// The lock of the thread is held.
status_t
start(const std::shared_ptr<Thread>& thread)
{
	auto handed = std::make_unique<std::shared_ptr<Thread>>(thread);
	pthread_attr_t attributes;
	pthread_attr_init(&attributes);
	pthread_attr_setdetachstate(&attributes, PTHREAD_CREATE_DETACHED);
	const int error = pthread_create(&thread->handle, &attributes, run, handed.get());
	pthread_attr_destroy(&attributes);
	if (error != 0)
		return B_NO_MORE_THREADS;
	handed.release();
	thread->started = true;
	return B_OK;
}

} // namespace


thread_id
spawn_thread(thread_func function, const char* name, int32 priority, void* data)
{
	if (function == nullptr)
		return B_BAD_VALUE;

	auto thread = std::make_shared<Thread>();
	thread->name = std::string(name != nullptr ? name : "").substr(0, B_OS_NAME_LENGTH - 1);
	thread->priority = priority;
	thread->function = function;
	thread->argument = data;

	// The id is set before anyone can learn it.
	std::unique_lock lock(thread->lock);
	thread->id = registry().threads.Add(thread);
	return thread->id;
}


status_t
resume_thread(thread_id id)
{
	std::shared_ptr<Thread> thread = registry().threads.Get(id);
	if (thread == nullptr)
		return B_BAD_THREAD_ID;
	std::unique_lock lock(thread->lock);
	if (thread->started)
		return B_BAD_THREAD_STATE;
	return start(thread);
}


status_t
kill_thread(thread_id id)
{
	std::shared_ptr<Thread> thread = registry().threads.Get(id);
	if (thread == nullptr)
		return B_BAD_THREAD_ID;
	std::unique_lock lock(thread->lock);
	if (thread->finished)
		return B_BAD_THREAD_ID;
	if (thread->started)
		return B_NOT_ALLOWED;
	thread->started = true;
	lock.unlock();
	finish(*thread, B_INTERRUPTED);
	return B_OK;
}


status_t
wait_for_thread(thread_id id, status_t* _returnCode)
{
	std::shared_ptr<Thread> thread = registry().threads.Get(id);
	if (thread == nullptr || thread == sSelf.thread)
		return B_BAD_THREAD_ID;

	std::unique_lock lock(thread->lock);
	if (!thread->started) {
		const status_t status = start(thread);
		if (status != B_OK)
			return status;
	}
	thread->changed.wait(lock, [&] { return thread->finished; });
	if (_returnCode != nullptr)
		*_returnCode = thread->result;
	return B_OK;
}


void
exit_thread(status_t status)
{
	self();
	sSelf.result = status;
	pthread_exit(nullptr);
}


thread_id
find_thread(const char* name)
{
	if (name == nullptr)
		return self().id;
	const thread_id id = registry().threads.Find([name](Thread& thread) {
		std::unique_lock lock(thread.lock);
		return !thread.finished && thread.name == name;
	});
	return id >= 0 ? id : B_NAME_NOT_FOUND;
}


status_t
rename_thread(thread_id id, const char* newName)
{
	if (newName == nullptr)
		return B_BAD_VALUE;
	self();
	std::shared_ptr<Thread> thread = registry().threads.Get(id);
	if (thread == nullptr)
		return B_BAD_THREAD_ID;
	std::unique_lock lock(thread->lock);
	thread->name = std::string(newName).substr(0, B_OS_NAME_LENGTH - 1);
	if (thread->started && !thread->finished)
		set_host_name(thread->handle, thread->name);
	return B_OK;
}


status_t
set_thread_priority(thread_id id, int32 newPriority)
{
	std::shared_ptr<Thread> thread = registry().threads.Get(id);
	if (thread == nullptr)
		return B_BAD_THREAD_ID;
	std::unique_lock lock(thread->lock);
	const int32 oldPriority = thread->priority;
	thread->priority = newPriority;
	return oldPriority;
}


status_t
on_exit_thread(void (*callback)(void*), void* data)
{
	if (callback == nullptr)
		return B_BAD_VALUE;
	self().exitCallbacks.push_back({ callback, data });
	return B_OK;
}


status_t
send_data(thread_id id, int32 code, const void* buffer, size_t bufferSize)
{
	if (buffer == nullptr && bufferSize > 0)
		return B_BAD_VALUE;
	const thread_id sender = find_thread(nullptr);
	std::shared_ptr<Thread> thread = registry().threads.Get(id);
	if (thread == nullptr)
		return B_BAD_THREAD_ID;

	std::unique_lock lock(thread->lock);
	thread->changed.wait(lock, [&] { return thread->finished || !thread->hasData; });
	if (thread->finished)
		return B_BAD_THREAD_ID;
	const char* bytes = static_cast<const char*>(buffer);
	thread->data.assign(bytes, bytes + bufferSize);
	thread->code = code;
	thread->sender = sender;
	thread->hasData = true;
	thread->changed.notify_all();
	return B_OK;
}


int32
receive_data(thread_id* _sender, void* buffer, size_t bufferSize)
{
	Thread& thread = self();
	std::unique_lock lock(thread.lock);
	thread.changed.wait(lock, [&] { return thread.hasData; });
	if (_sender != nullptr)
		*_sender = thread.sender;
	if (buffer != nullptr && !thread.data.empty())
		memcpy(buffer, thread.data.data(), min_c(bufferSize, thread.data.size()));
	thread.data.clear();
	thread.hasData = false;
	thread.changed.notify_all();
	return thread.code;
}


bool
has_data(thread_id id)
{
	std::shared_ptr<Thread> thread = registry().threads.Get(id);
	if (thread == nullptr)
		return false;
	std::unique_lock lock(thread->lock);
	return thread->hasData;
}


status_t
_get_thread_info(thread_id id, thread_info* info, size_t size)
{
	if (info == nullptr || size != sizeof(thread_info))
		return B_BAD_VALUE;
	self();
	std::shared_ptr<Thread> thread = registry().threads.Get(id);
	if (thread == nullptr)
		return B_BAD_THREAD_ID;

	std::unique_lock lock(thread->lock);
	if (thread->finished)
		return B_BAD_THREAD_ID;
	memset(info, 0, sizeof(*info));
	info->thread = id;
	info->team = getpid();
	strncpy(info->name, thread->name.c_str(), B_OS_NAME_LENGTH - 1);
	info->state = thread->started ? B_THREAD_RUNNING : B_THREAD_SUSPENDED;
	info->priority = thread->priority;
	info->sem = -1;

	clockid_t clock;
	timespec used;
	if (thread->started && pthread_getcpuclockid(thread->handle, &clock) == 0
		&& clock_gettime(clock, &used) == 0)
		info->user_time = bigtime_t(used.tv_sec) * 1000000 + used.tv_nsec / 1000;
	return B_OK;
}


status_t
_get_next_thread_info(team_id team, int32* cookie, thread_info* info, size_t size)
{
	return BPrivate::NextInfo(registry().threads, team, cookie, info, size, _get_thread_info);
}


// #pragma mark - storage of a thread

namespace {

constexpr int32 kMaxSlots = 64;
std::atomic<int32> sNextSlot { 0 };
thread_local void* sSlots[kMaxSlots];

} // namespace


int32
tls_allocate(void)
{
	int32 slot = sNextSlot.load();
	do {
		if (slot >= kMaxSlots)
			return B_NO_MEMORY;
	} while (!sNextSlot.compare_exchange_weak(slot, slot + 1));
	return slot;
}


void*
tls_get(int32 index)
{
	return index >= 0 && index < kMaxSlots ? sSlots[index] : nullptr;
}


void**
tls_address(int32 index)
{
	return index >= 0 && index < kMaxSlots ? &sSlots[index] : nullptr;
}


void
tls_set(int32 index, void* value)
{
	if (index >= 0 && index < kMaxSlots)
		sSlots[index] = value;
}
