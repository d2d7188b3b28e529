// Two pieces of work measured in turns, so that both meet the same machine.
#pragma once

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <ctime>
#include <vector>

namespace bench {


// What a thread does alone is measured by its processor time, which other programs disturb less
// than the clock on the wall; work that waits for other threads by that clock.
inline clockid_t clockOfWork = CLOCK_MONOTONIC;

inline double
now()
{
	timespec time;
	clock_gettime(clockOfWork, &time);
	return double(time.tv_sec) + double(time.tv_nsec) * 1e-9;
}


inline double
seconds(const auto& work, int repeats)
{
	const double start = now();
	for (int i = 0; i < repeats; i++)
		work();
	return (now() - start) / repeats;
}


// ARCHWAY_BENCH in the environment chooses the comparisons whose names contain it.
inline bool
is_chosen(const char* what)
{
	const char* chosen = getenv("ARCHWAY_BENCH");
	return chosen == nullptr || strstr(what, chosen) != nullptr;
}


// Prints the median of nine ratios with the lowest and the highest, and returns whether the median
// meets the goal. Each turn runs both for some milliseconds, after one run that does not count, so
// that neither tidies up the heap that the other left.
inline bool
compare(const char* what, double goal, const auto& ours, const auto& theirs)
{
	if (!is_chosen(what))
		return true;
	constexpr int kTurns = 9;
	constexpr double kTurnSeconds = 0.03;
	const auto repeats_for = [&](const auto& work) {
		return std::max(1, int(kTurnSeconds / std::max(seconds(work, 1), 1e-9)));
	};
	ours();
	const int ourRepeats = repeats_for(ours);
	theirs();
	const int theirRepeats = repeats_for(theirs);
	std::vector<double> ratios;
	double ourTime = 0;
	double theirTime = 0;
	for (int turn = 0; turn < kTurns; turn++) {
		ours();
		ourTime = seconds(ours, ourRepeats);
		theirs();
		theirTime = seconds(theirs, theirRepeats);
		ratios.push_back(ourTime / theirTime);
	}
	std::sort(ratios.begin(), ratios.end());
	const double median = ratios[kTurns / 2];
	printf("%-52s %7.3f  [%.3f .. %.3f]  goal %.2f  %s  (%.2f us / %.2f us)\n", what, median,
		ratios.front(), ratios.back(), goal, median <= goal ? "met" : "NOT MET", ourTime * 1e6,
		theirTime * 1e6);
	return median <= goal;
}


} // namespace bench
