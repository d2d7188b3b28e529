#include "support/StepCounter.h"

#include <csignal>
#include <cstdlib>
#include <sys/ptrace.h>
#include <sys/wait.h>
#include <unistd.h>

namespace test {

namespace {

[[noreturn]] void
run_traced(const std::function<void()>& work)
{
	if (ptrace(PTRACE_TRACEME, 0, nullptr, nullptr) != 0)
		_exit(1);
	raise(SIGSTOP);
	work();
	_exit(0);
}


int64_t
steps_of(const std::function<void()>& work)
{
	const pid_t child = fork();
	if (child < 0)
		return 0;
	if (child == 0)
		run_traced(work);
	int64_t steps = 0;
	int state = 0;
	while (waitpid(child, &state, 0) == child && WIFSTOPPED(state)) {
		steps++;
		if (ptrace(PTRACE_SINGLESTEP, child, nullptr, nullptr) != 0) {
			kill(child, SIGKILL);
			waitpid(child, &state, 0);
			return 0;
		}
	}
	return WIFEXITED(state) && WEXITSTATUS(state) == 0 ? steps : 0;
}

} // namespace


int64_t
count_steps(const std::function<void()>& work)
{
#if defined(__SANITIZE_ADDRESS__) || defined(__SANITIZE_THREAD__)
	return 0;
#else
	const int64_t idle = steps_of([] {});
	const int64_t all = steps_of(work);
	return idle == 0 || all == 0 ? 0 : all - idle + 1;
#endif
}

} // namespace test
