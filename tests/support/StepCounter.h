// StepCounter: how many instructions of the machine some work takes.
#pragma once

#include <cstdint>
#include <functional>

namespace test {

// The same at every run but for a few, unlike the time that it takes. The work is done in a process
// of its own, one instruction after another, so some 100,000 of them take a second and nothing of it
// is left here. 0 where no process may look into another, as under some sanitizers: skip then.
int64_t count_steps(const std::function<void()>& work);

} // namespace test
