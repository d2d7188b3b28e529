#include "server/paint/RowFill.h"

#include <wchar.h>

namespace BPrivate {

namespace {

using Fill = void (*)(uint32* row, int32 stride, int32 rows, int32 count, uint32 pixel);

// Longer rows are the C library's, which knows about caches.
constexpr int32 kLongRow = 1024;


#if defined(__x86_64__)

// At the small sizes of controls a call of the library for every row costs more than its pixels.
// Pieces between the first and the last stand on their own boundaries, so that none lies in two
// lines of the cache; those two may overlap their neighbours.
template<int kBytes>
[[gnu::always_inline]] inline void
FillWide(uint32* row, int32 stride, int32 rows, int32 count, uint32 pixel)
{
	typedef uint32 Piece __attribute__((vector_size(kBytes), aligned(4), may_alias));
	typedef uint32 WholePiece __attribute__((vector_size(kBytes), may_alias));
	constexpr int32 kPixels = kBytes / sizeof(uint32);
	if (count < kPixels || count > kLongRow) {
		FillRowsPlainly(row, stride, rows, count, pixel);
		return;
	}
	const Piece piece = Piece {} + pixel;
	for (; rows > 0; rows--, row += stride) {
		*reinterpret_cast<Piece*>(row) = piece;
		uint32* const last = row + count - kPixels;
		const uintptr_t boundary = reinterpret_cast<uintptr_t>(row + kPixels) & -uintptr_t(kBytes);
		for (uint32* at = reinterpret_cast<uint32*>(boundary); at < last; at += kPixels)
			*reinterpret_cast<WholePiece*>(at) = piece;
		*reinterpret_cast<Piece*>(last) = piece;
	}
}


[[gnu::target("avx512f")]] void
FillBy64(uint32* row, int32 stride, int32 rows, int32 count, uint32 pixel)
{
	FillWide<64>(row, stride, rows, count, pixel);
}


[[gnu::target("avx2")]] void
FillBy32(uint32* row, int32 stride, int32 rows, int32 count, uint32 pixel)
{
	FillWide<32>(row, stride, rows, count, pixel);
}


Fill
ChooseFill()
{
	if (__builtin_cpu_supports("avx512f"))
		return FillBy64;
	return __builtin_cpu_supports("avx2") ? FillBy32 : FillRowsPlainly;
}

#else

Fill
ChooseFill()
{
	return FillRowsPlainly;
}

#endif

const Fill sFill = ChooseFill();

} // namespace


void
FillRows(uint32* row, int32 stride, int32 rows, int32 count, uint32 pixel)
{
	sFill(row, stride, rows, count, pixel);
}


void
FillRowsPlainly(uint32* row, int32 stride, int32 rows, int32 count, uint32 pixel)
{
	static_assert(sizeof(wchar_t) == sizeof(uint32));
	for (; rows > 0; rows--, row += stride) {
		if (count > 4) {
			wmemset(reinterpret_cast<wchar_t*>(row), pixel, count);
			continue;
		}
		for (int32 i = 0; i < count; i++)
			row[i] = pixel;
	}
}


} // namespace BPrivate
