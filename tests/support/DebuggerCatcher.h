// DebuggerCatcher: lets debugger() return, and keeps what it was told.
#pragma once

#include <string>
#include <vector>


// One at a time. Calls of debugger() on any thread are collected; those that the test has not
// taken when the catcher goes are a failure of the test.
class DebuggerCatcher {
public:
	DebuggerCatcher();
	~DebuggerCatcher();
	DebuggerCatcher(const DebuggerCatcher&) = delete;
	DebuggerCatcher& operator=(const DebuggerCatcher&) = delete;

	// The texts since the last call, oldest first.
	std::vector<std::string> Take();
	// Whether there was exactly one; takes it.
	bool TakeOne();
};
