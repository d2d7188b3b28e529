// What the sources of BRegion share.
#pragma once

#include <Region.h>

namespace BPrivate {


// Far outside of every drawing, yet no sum of two overflows.
constexpr int32 kMaxCoordinate = 0x3fffffff;

constexpr clipping_rect kEmptyRect = { 0, 0, -1, -1 };


} // namespace BPrivate


enum class BRegion::Operation { kUnion, kIntersection, kDifference, kEither };
