// ChildIndex: finds those of a view's many children that may lie in an area.
#pragma once

#include <span>
#include <unordered_map>
#include <vector>

#include <Region.h>

namespace BPrivate {

class ServerView;


// Grids of four meshes, one over the other. A child is in one cell only: that of its left top in the
// finest grid whose cells are no smaller than the child. So it is found from its own cell and from
// those to the right and below, and is put elsewhere in constant time. Positions and areas are in the
// parent's coordinates. A child without pixels is never found.
class ChildIndex {
public:
	static constexpr int32 kFewestChildren = 32; // fewer are looked at one after the other
	static constexpr uint64 kOrderGap = 1 << 20; // between the numbers of neighbours at first

	// Numbers the children by their order, from kOrderGap.
	explicit ChildIndex(const ServerView& parent);

	// The child has a number of its own.
	void Add(ServerView& child);
	// The frame is the one with which the child was added.
	void Remove(ServerView& child, BRect frame);

	// Whether to look into the cells costs less than to look at this many children.
	static bool IsWorthAsking(std::span<const clipping_rect> areas, int32 children);

	// In their order, each once: all that reach into one of the areas, and some that come close.
	std::vector<ServerView*> Find(std::span<const clipping_rect> areas) const;

private:
	typedef uint64 Cell;
	typedef std::unordered_map<Cell, std::vector<ServerView*>> Cells;

	static bool _CellOf(BRect frame, Cell* _cell);

	Cells fCells;
};


} // namespace BPrivate
