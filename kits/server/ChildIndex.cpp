#include "server/ChildIndex.h"

#include <algorithm>

#include "server/DirtyRegion.h"
#include "server/ServerView.h"

namespace BPrivate {

namespace {

// The size of each grid's cells as a power of two. The last one's are larger than any window.
constexpr int kMeshBits[] = { 5, 7, 10, 30 };
constexpr int kGrids = sizeof(kMeshBits) / sizeof(kMeshBits[0]);
constexpr int kGridShift = 62;
constexpr int kRowShift = 31;
constexpr int64 kCostOfACell = 2; // in children
constexpr int64 kMiddle = 1 << 30; // makes column and row numbers positive

// Frames round to whole pixels outwards, and sums of fractions to the nearest number.
constexpr int32 kSlack = 2;


uint64
cell_at(int grid, int64 column, int64 row)
{
	return static_cast<uint64>(grid) << kGridShift | static_cast<uint64>(row + kMiddle) << kRowShift
		| static_cast<uint64>(column + kMiddle);
}


// The columns and rows in which a child of the grid may have its left top.
struct CellRange {
	CellRange(const clipping_rect& area, int grid)
	{
		const int bits = kMeshBits[grid];
		const int64 reach = (int64(1) << bits) + kSlack;
		left = (area.left - reach) >> bits;
		top = (area.top - reach) >> bits;
		right = (int64(area.right) + kSlack) >> bits;
		bottom = (int64(area.bottom) + kSlack) >> bits;
	}

	int64 Count() const { return (right - left + 1) * (bottom - top + 1); }

	int64 left, top, right, bottom;
};

} // namespace


ChildIndex::ChildIndex(const ServerView& parent)
{
	uint64 order = 0;
	for (ServerView* child = parent.FirstChild(); child != nullptr; child = child->Next()) {
		child->SetOrder(order += kOrderGap);
		Add(*child);
	}
}


void
ChildIndex::Add(ServerView& child)
{
	Cell cell;
	if (!_CellOf(child.Frame(), &cell))
		return;
	std::vector<ServerView*>& views = fCells[cell];
	child.SetPlaceInCell(static_cast<uint32>(views.size()));
	views.push_back(&child);
}


void
ChildIndex::Remove(ServerView& child, BRect frame)
{
	Cell cell;
	if (!_CellOf(frame, &cell))
		return;
	// The last one of the cell takes the free place.
	std::vector<ServerView*>& views = fCells[cell];
	const uint32 place = child.PlaceInCell();
	views[place] = views.back();
	views[place]->SetPlaceInCell(place);
	views.pop_back();
	if (views.empty())
		fCells.erase(cell);
}


bool
ChildIndex::IsWorthAsking(std::span<const clipping_rect> areas, int32 children)
{
	if (children < kFewestChildren)
		return false;
	int64 cells = 0;
	for (const clipping_rect& area : areas) {
		for (int grid = 0; grid < kGrids; grid++)
			cells += CellRange(area, grid).Count();
	}
	return cells * kCostOfACell < children;
}


std::vector<ServerView*>
ChildIndex::Find(std::span<const clipping_rect> areas) const
{
	std::vector<ServerView*> found;
	for (const clipping_rect& area : areas) {
		for (int grid = 0; grid < kGrids; grid++) {
			const CellRange range(area, grid);
			for (int64 row = range.top; row <= range.bottom; row++) {
				for (int64 column = range.left; column <= range.right; column++) {
					const auto cell = fCells.find(cell_at(grid, column, row));
					if (cell != fCells.end())
						found.insert(found.end(), cell->second.begin(), cell->second.end());
				}
			}
		}
	}
	std::sort(found.begin(), found.end(),
		[](const ServerView* a, const ServerView* b) { return a->Order() < b->Order(); });
	found.erase(std::unique(found.begin(), found.end()), found.end());
	return found;
}


bool
ChildIndex::_CellOf(BRect frame, Cell* _cell)
{
	const clipping_rect pixels = to_pixels(frame);
	if (is_empty(pixels))
		return false;
	const int64 size =
		std::max(int64(pixels.right) - pixels.left, int64(pixels.bottom) - pixels.top);
	int grid = 0;
	while (grid < kGrids - 1 && size > int64(1) << kMeshBits[grid])
		grid++;
	*_cell = cell_at(grid, pixels.left >> kMeshBits[grid], pixels.top >> kMeshBits[grid]);
	return true;
}


} // namespace BPrivate
