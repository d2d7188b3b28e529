// RowFill: rectangles of one colour.
#pragma once

#include <SupportDefs.h>

namespace BPrivate {


// `rows` rows of `count` pixels, `stride` pixels apart. Takes what the processor has for it.
void FillRows(uint32* row, int32 stride, int32 rows, int32 count, uint32 pixel);

// The same by the C library, row by row: what the above is compared with.
void FillRowsPlainly(uint32* row, int32 stride, int32 rows, int32 count, uint32 pixel);


} // namespace BPrivate
