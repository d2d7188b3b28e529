// Threads, semaphores, ports, areas and time.
#pragma once

#include <pthread.h>

#include <SupportDefs.h>

enum { B_OS_NAME_LENGTH = 32 };

#define B_PAGE_SIZE 4096
#define B_INFINITE_TIMEOUT (9223372036854775807LL)

// How a timeout (microseconds) is meant.
enum {
	B_TIMEOUT = 0x8,
	B_RELATIVE_TIMEOUT = 0x8,
	B_ABSOLUTE_TIMEOUT = 0x10,
};

typedef int32 area_id;
typedef int32 port_id;
typedef int32 sem_id;
typedef int32 team_id;
typedef int32 thread_id;

// #pragma mark - time

#ifdef __cplusplus
extern "C" {
#endif

// Microseconds since the machine started; never runs backwards.
bigtime_t system_time(void);
// Seconds and microseconds since the epoch.
uint32 real_time_clock(void);
bigtime_t real_time_clock_usecs(void);

status_t snooze(bigtime_t microseconds);
enum { B_SYSTEM_TIMEBASE = 0 };
status_t snooze_until(bigtime_t time, int timeBase);

// Prints the text and the thread's name on standard error and stops in the debugger (SIGTRAP).
void debugger(const char* message);
int disable_debugger(int state);

// #pragma mark - threads

#define B_IDLE_PRIORITY 0
#define B_LOWEST_ACTIVE_PRIORITY 1
#define B_LOW_PRIORITY 5
#define B_NORMAL_PRIORITY 10
#define B_DISPLAY_PRIORITY 15
#define B_URGENT_DISPLAY_PRIORITY 20
#define B_REAL_TIME_DISPLAY_PRIORITY 100
#define B_URGENT_PRIORITY 110
#define B_REAL_TIME_PRIORITY 120

typedef status_t (*thread_func)(void*);
typedef thread_func thread_entry;

typedef enum {
	B_THREAD_RUNNING = 1,
	B_THREAD_READY,
	B_THREAD_RECEIVING,
	B_THREAD_ASLEEP,
	B_THREAD_SUSPENDED,
	B_THREAD_WAITING
} thread_state;

typedef struct {
	thread_id thread;
	team_id team;
	char name[B_OS_NAME_LENGTH];
	thread_state state;
	int32 priority;
	sem_id sem;
	bigtime_t user_time;
	bigtime_t kernel_time;
	void* stack_base;
	void* stack_end;
} thread_info;

// A new thread sleeps until it is resumed. Priorities are kept and reported; the host's scheduler
// treats all threads alike.
thread_id spawn_thread(thread_func function, const char* name, int32 priority, void* data);
status_t resume_thread(thread_id thread);
// Ends a thread that was not resumed yet; the host cannot safely stop one that runs, so the answer
// is then B_NOT_ALLOWED.
status_t kill_thread(thread_id thread);
// Waits for the end of the thread and gives its result; any number of threads may wait, also late.
status_t wait_for_thread(thread_id thread, status_t* _returnCode);
void exit_thread(status_t status);
thread_id find_thread(const char* name); // NULL: the calling thread
status_t rename_thread(thread_id thread, const char* newName);
status_t set_thread_priority(thread_id thread, int32 newPriority); // the priority it had
status_t on_exit_thread(void (*callback)(void*), void* data);
// One message waits in a thread's buffer; sending another waits until it has been received.
status_t send_data(thread_id thread, int32 code, const void* buffer, size_t bufferSize);
int32 receive_data(thread_id* _sender, void* buffer, size_t bufferSize);
bool has_data(thread_id thread);

status_t _get_thread_info(thread_id id, thread_info* info, size_t size);
// Walks the threads of a team (0 means this one), oldest first. The cookie starts at 0.
status_t _get_next_thread_info(team_id team, int32* cookie, thread_info* info, size_t size);
#define get_thread_info(id, info) _get_thread_info((id), (info), sizeof(*(info)))
#define get_next_thread_info(team, cookie, info)                                                   \
	_get_next_thread_info((team), (cookie), (info), sizeof(*(info)))

// A slot of storage of which each thread has its own value, at first NULL.
int32 tls_allocate(void);
void* tls_get(int32 index);
void** tls_address(int32 index);
void tls_set(int32 index, void* value);

// #pragma mark - semaphores

// acquire_sem_etc() and release_sem_etc() flags, beside the timeouts.
enum {
	B_CAN_INTERRUPT = 0x01,
	B_CHECK_PERMISSION = 0x04,
	B_DO_NOT_RESCHEDULE = 0x02,
	B_RELEASE_ALL = 0x08,
};

typedef struct sem_info {
	sem_id sem;
	team_id team;
	char name[B_OS_NAME_LENGTH];
	int32 count;
	thread_id latest_holder;
} sem_info;

sem_id create_sem(int32 count, const char* name);
status_t delete_sem(sem_id id); // waiting threads return with B_BAD_SEM_ID
status_t acquire_sem(sem_id id);
status_t acquire_sem_etc(sem_id id, int32 count, uint32 flags, bigtime_t timeout);
status_t release_sem(sem_id id);
status_t release_sem_etc(sem_id id, int32 count, uint32 flags);
status_t get_sem_count(sem_id id, int32* _count);
status_t _get_sem_info(sem_id id, sem_info* info, size_t size);
status_t _get_next_sem_info(team_id team, int32* cookie, sem_info* info, size_t size);
#define get_sem_info(id, info) _get_sem_info((id), (info), sizeof(*(info)))
#define get_next_sem_info(team, cookie, info)                                                      \
	_get_next_sem_info((team), (cookie), (info), sizeof(*(info)))
// There is one team only, which owns everything already.
status_t set_sem_owner(sem_id id, team_id team);

// #pragma mark - ports

typedef struct port_info {
	port_id port;
	team_id team;
	char name[B_OS_NAME_LENGTH];
	int32 capacity;
	int32 queue_count;
	int32 total_count; // messages written so far
} port_info;

port_id create_port(int32 capacity, const char* name);
port_id find_port(const char* name);
status_t close_port(port_id id); // what is queued may still be read
status_t delete_port(port_id id);
status_t write_port(port_id id, int32 code, const void* buffer, size_t bufferSize);
status_t write_port_etc(
	port_id id, int32 code, const void* buffer, size_t bufferSize, uint32 flags, bigtime_t timeout);
ssize_t read_port(port_id id, int32* _code, void* buffer, size_t bufferSize);
ssize_t read_port_etc(
	port_id id, int32* _code, void* buffer, size_t bufferSize, uint32 flags, bigtime_t timeout);
ssize_t port_buffer_size(port_id id);
ssize_t port_buffer_size_etc(port_id id, uint32 flags, bigtime_t timeout);
ssize_t port_count(port_id id);
status_t set_port_owner(port_id id, team_id team); // see set_sem_owner()
status_t _get_port_info(port_id id, port_info* info, size_t size);
status_t _get_next_port_info(team_id team, int32* cookie, port_info* info, size_t size);
#define get_port_info(id, info) _get_port_info((id), (info), sizeof(*(info)))
#define get_next_port_info(team, cookie, info)                                                     \
	_get_next_port_info((team), (cookie), (info), sizeof(*(info)))

// #pragma mark - areas

enum { B_ANY_ADDRESS = 0, B_EXACT_ADDRESS = 1, B_BASE_ADDRESS = 2, B_CLONE_ADDRESS = 3 };
enum { B_NO_LOCK = 0, B_LAZY_LOCK = 1, B_FULL_LOCK = 2, B_CONTIGUOUS = 3 };
enum { B_READ_AREA = 1, B_WRITE_AREA = 2 };

typedef struct area_info {
	area_id area;
	char name[B_OS_NAME_LENGTH];
	size_t size;
	uint32 lock;
	uint32 protection;
	team_id team;
	uint32 ram_size;
	uint32 copy_count;
	uint32 in_count;
	uint32 out_count;
	void* address;
} area_info;

// Zeroed memory of whole pages; the size must be a multiple of B_PAGE_SIZE.
area_id create_area(const char* name, void** _address, uint32 addressSpec, size_t size, uint32 lock,
	uint32 protection);
// The same memory at another address.
area_id clone_area(
	const char* name, void** _address, uint32 addressSpec, uint32 protection, area_id source);
area_id find_area(const char* name);
area_id area_for(void* address);
status_t delete_area(area_id id);
status_t set_area_protection(area_id id, uint32 protection);
// The address stays; B_ERROR when there is no room behind the area, or it has clones.
status_t resize_area(area_id id, size_t newSize);
status_t _get_area_info(area_id id, area_info* info, size_t size);
// The cookie starts at 0.
status_t _get_next_area_info(team_id team, ssize_t* cookie, area_info* info, size_t size);
#define get_next_area_info(team, cookie, info)                                                     \
	_get_next_area_info((team), (cookie), (info), sizeof(*(info)))
#define get_area_info(id, info) _get_area_info((id), (info), sizeof(*(info)))

// #pragma mark - teams

#define B_CURRENT_TEAM 0

typedef struct {
	team_id team;
	int32 thread_count;
	int32 image_count;
	int32 area_count;
	thread_id debugger_nub_thread;
	port_id debugger_nub_port;
	int32 argc;
	char args[64];
	uid_t uid;
	gid_t gid;
} team_info;

// Of this team alone: B_BAD_TEAM_ID for others.
status_t _get_team_info(team_id team, team_info* info, size_t size);
status_t _get_next_team_info(int32* cookie, team_info* info, size_t size);
#define get_team_info(team, info) _get_team_info((team), (info), sizeof(*(info)))
#define get_next_team_info(cookie, info) _get_next_team_info((cookie), (info), sizeof(*(info)))

// #pragma mark - system

typedef struct {
	int32 cpu_count;
	uint64 max_pages;
	uint64 used_pages;
	int32 page_size;
	bigtime_t boot_time;
} system_info;

status_t get_system_info(system_info* info);
int32 is_computer_on(void);
double is_computer_on_fire(void);

#ifdef __cplusplus
}
#endif
