#include "server/paint/CoverageRaster.h"

#include <algorithm>
#include <math.h>
#include <string.h>
#include <utility>
#include <vector>

namespace BPrivate {

namespace {

struct Memory {
	std::vector<float> sums;
	std::vector<uint8> coverage;
};

thread_local Memory sMemory;

} // namespace


CoverageRaster::CoverageRaster(const clipping_rect& rect) :
	fRect(rect), fWidth(rect.right - rect.left + 1), fHeight(rect.bottom - rect.top + 1)
{
	sMemory.sums.assign((size_t)(fWidth + 2) * fHeight, 0);
	fSums = sMemory.sums.data();
}


// What lies left of the rectangle still counts for everything right of it, so it is moved to the
// left edge; what lies right of it counts for nothing.
void
CoverageRaster::AddLine(double x0, double y0, double x1, double y1)
{
	x0 -= fRect.left;
	x1 -= fRect.left;
	y0 = y0 - fRect.top;
	y1 = y1 - fRect.top;
	if (std::max(y0, y1) <= 0 || std::min(y0, y1) >= fHeight || std::min(x0, x1) >= fWidth)
		return;

	auto cutAt = [&](double edge, auto& self, double fromX, double fromY, double toX,
					 double toY) -> void {
		const bool crosses = (fromX < edge) != (toX < edge) && fromX != edge && toX != edge;
		if (crosses) {
			const double y = fromY + (toY - fromY) * (edge - fromX) / (toX - fromX);
			self(edge, self, fromX, fromY, edge, y);
			self(edge, self, edge, y, toX, toY);
		} else if (edge == 0)
			self((double)fWidth, self, fromX, fromY, toX, toY);
		else {
			const double limit = fWidth;
			_AddInside(std::clamp(fromX, 0.0, limit), fromY, std::clamp(toX, 0.0, limit), toY);
		}
	};
	cutAt(0, cutAt, x0, y0, x1, y1);
}


const uint8*
CoverageRaster::Finish(bool evenOdd)
{
	sMemory.coverage.resize((size_t)fWidth * fHeight);
	uint8* to = sMemory.coverage.data();
	const float* from = fSums;
	for (int32 y = 0; y < fHeight; y++, from += fWidth + 2) {
		float sum = 0;
		for (int32 x = 0; x < fWidth; x++) {
			sum += from[x];
			float inside = fabsf(sum);
			if (evenOdd) {
				inside = fmodf(inside, 2);
				inside = inside > 1 ? 2 - inside : inside;
			}
			*to++ = (uint8)(std::min(inside, 1.0f) * 255 + 0.5f);
		}
	}
	return sMemory.coverage.data();
}


// #pragma mark - private


// Both ends lie between the left and the right edge.
void
CoverageRaster::_AddInside(float x0, float y0, float x1, float y1)
{
	if (y0 == y1)
		return;
	float direction = 1;
	if (y0 > y1) {
		std::swap(x0, x1);
		std::swap(y0, y1);
		direction = -1;
	}
	const float slope = (x1 - x0) / (y1 - y0);
	if (y0 < 0) {
		x0 -= y0 * slope;
		y0 = 0;
	}
	float x = x0;
	const int32 last = std::min(fHeight, (int32)ceilf(y1));
	for (int32 y = (int32)y0; y < last; y++) {
		float* row = fSums + (size_t)y * (fWidth + 2);
		const float height = std::min((float)(y + 1), y1) - std::max((float)y, y0);
		const float next = std::clamp(x + slope * height, 0.0f, (float)fWidth);
		const float share = height * direction;
		const float left = std::min(x, next);
		const float right = std::max(x, next);
		const int32 first = (int32)left;
		const int32 end = (int32)ceilf(right);
		if (end <= first + 1) {
			const float middle = (left + right) / 2 - first;
			row[first] += share * (1 - middle);
			row[first + 1] += share * middle;
		} else {
			// The line crosses several pixels of the row: a triangle in the first, trapezoids, and
			// the rest of a triangle in the last.
			const float perPixel = 1 / (right - left);
			const float inFirst = first + 1 - left;
			const float area = perPixel * inFirst * inFirst / 2;
			row[first] += share * area;
			const float inLast = right - (end - 1);
			const float lastArea = perPixel * inLast * inLast / 2;
			if (end == first + 2)
				row[first + 1] += share * (1 - area - lastArea);
			else {
				const float second = perPixel * (1.5f - (left - first));
				row[first + 1] += share * (second - area);
				for (int32 at = first + 2; at < end - 1; at++)
					row[at] += share * perPixel;
				const float beforeLast = second + (end - first - 3) * perPixel;
				row[end - 1] += share * (1 - beforeLast - lastArea);
			}
			row[end] += share * lastArea;
		}
		x = next;
	}
}


} // namespace BPrivate
