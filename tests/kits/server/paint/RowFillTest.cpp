#include "server/paint/RowFill.h"

#include <random>
#include <vector>

#include <gtest/gtest.h>

namespace BPrivate {


TEST(RowFill, IsTheSameAsThePlainWay)
{
	constexpr int32 kStride = 1300, kRows = 3;
	std::mt19937 random(3);
	std::vector<uint32> fast(kStride * (kRows + 2)), plain;
	for (int32 count = 0; count < 1200; count = count < 150 ? count + 1 : count + 97) {
		for (uint32& pixel : fast)
			pixel = random();
		plain = fast;
		const int32 left = static_cast<int32>(random() % 60);
		const uint32 color = random();
		FillRows(fast.data() + kStride + left, kStride, kRows, count, color);
		FillRowsPlainly(plain.data() + kStride + left, kStride, kRows, count, color);
		ASSERT_EQ(plain, fast) << count;
		for (int32 x = 0; x < kStride; x++) {
			if (x >= left && x < left + count) {
				ASSERT_EQ(color, fast[static_cast<size_t>(2 * kStride + x)]) << x;
			}
		}
	}
}


} // namespace BPrivate
