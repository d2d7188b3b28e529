// AllocationMeter: how much heap a piece of work takes at most.
#pragma once

#include <cstddef>


// Counts what all threads of the program allocate from its making on, beyond what there was then.
// A program that uses it has its own malloc(), which counts and asks the C library's; under a
// sanitizer, which has its own as well, nothing is counted and IsCounting() is false.
class AllocationMeter {
public:
	AllocationMeter();

	static bool IsCounting();
	// The most bytes that were allocated at one time, and the largest single piece.
	size_t Peak() const;
	size_t Largest() const;
	// How many pieces were asked for, and how many bytes in all of them together.
	size_t Count() const;
	size_t Total() const;

private:
	size_t fLiveBefore;
	size_t fCountBefore;
	size_t fTotalBefore;
};
