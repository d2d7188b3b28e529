// PressHistory: the last presses and what the pointer did, for drags that begin late.
#pragma once

#include <deque>
#include <vector>

#include "backend/BackendEvent.h"

namespace BPrivate {


struct PressRecord {
	int32 serial = 0;
	uint32 buttons = 0;
	bool released = false;
	BackendEvent release; // when released
	std::vector<BackendEvent> moves; // between press and release
};


class PressHistory {
public:
	void Begin(int32 serial, const BackendEvent& event);
	void Move(const BackendEvent& event);
	void End(const BackendEvent& event);
	// NULL when it was too long ago. Serial 0 means the last one.
	const PressRecord* Find(int32 serial) const;

private:
	// A window that is busy for longer than this many presses has lost its drag.
	static constexpr size_t kPresses = 16;
	static constexpr size_t kMoves = 256;

	std::deque<PressRecord> fPresses; // newest last
};


} // namespace BPrivate
