#include "tests/support/DebuggerCatcher.h"

#include <gtest/gtest.h>
#include <mutex>

#include "kernel/private/Debugger.h"

namespace {

std::mutex sLock;
std::vector<std::string> sTexts;

void
Catch(const char* text)
{
	std::lock_guard lock(sLock);
	sTexts.push_back(text != nullptr ? text : "");
}

} // namespace


DebuggerCatcher::DebuggerCatcher()
{
	Take();
	BPrivate::set_debugger_hook(Catch);
}


DebuggerCatcher::~DebuggerCatcher()
{
	BPrivate::set_debugger_hook(nullptr);
	for (const std::string& text : Take())
		ADD_FAILURE() << "debugger: " << text;
}


std::vector<std::string>
DebuggerCatcher::Take()
{
	std::lock_guard lock(sLock);
	return std::exchange(sTexts, {});
}


bool
DebuggerCatcher::TakeOne()
{
	return Take().size() == 1;
}
