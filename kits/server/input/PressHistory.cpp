#include "server/input/PressHistory.h"

namespace BPrivate {


void
PressHistory::Begin(int32 serial, const BackendEvent& event)
{
	if (fPresses.size() == kPresses)
		fPresses.pop_front();
	PressRecord press;
	press.serial = serial;
	press.buttons = event.buttons;
	fPresses.push_back(std::move(press));
}


void
PressHistory::Move(const BackendEvent& event)
{
	if (fPresses.empty() || fPresses.back().released)
		return;

	// A long way is told with every other of its points.
	std::vector<BackendEvent>& moves = fPresses.back().moves;
	if (moves.size() == kMoves) {
		for (size_t i = 0; i < kMoves / 2; i++)
			moves[i] = std::move(moves[i * 2 + 1]);
		moves.resize(kMoves / 2);
	}
	moves.push_back(event);
}


void
PressHistory::End(const BackendEvent& event)
{
	if (fPresses.empty() || fPresses.back().released)
		return;
	fPresses.back().released = true;
	fPresses.back().release = event;
}


const PressRecord*
PressHistory::Find(int32 serial) const
{
	if (serial == 0)
		return fPresses.empty() ? nullptr : &fPresses.back();
	for (const PressRecord& press : fPresses) {
		if (press.serial == serial)
			return &press;
	}
	return nullptr;
}


} // namespace BPrivate
