#include "kernel/private/Debugger.h"

#include <atomic>
#include <csignal>
#include <cstdio>

#include <Debug.h>
#include <OS.h>

static std::atomic<BPrivate::debugger_hook> sHook { nullptr };
static std::atomic<int> sDisabled { 0 };
static std::atomic<bool> sDebugEnabled { true };


void
debugger(const char* message)
{
	if (BPrivate::debugger_hook hook = sHook.load()) {
		hook(message);
		return;
	}

	thread_info info;
	const bool known = get_thread_info(find_thread(nullptr), &info) == B_OK;
	fprintf(stderr, "debugger: thread \"%s\": %s\n", known ? info.name : "?",
		message != nullptr ? message : "");
	if (sDisabled.load() == 0)
		raise(SIGTRAP);
}


int
disable_debugger(int state)
{
	return sDisabled.exchange(state);
}


namespace BPrivate {


debugger_hook
set_debugger_hook(debugger_hook hook)
{
	return sHook.exchange(hook);
}


void
assertion_failed(const char* condition, const char* file, int line)
{
	char text[512];
	snprintf(text, sizeof(text), "%s:%d: assertion failed: %s", file, line, condition);
	debugger(text);
}


bool
set_debug_enabled(bool enabled)
{
	return sDebugEnabled.exchange(enabled);
}


bool
is_debug_enabled()
{
	return sDebugEnabled;
}


} // namespace BPrivate
