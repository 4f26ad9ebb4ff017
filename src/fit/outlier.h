// Points taken out of a data set before a fit. A mask holds 1 for a point that goes and 0 for one that stays.
#pragma once

#include <cstdint>

namespace krnumer {

// Marks the points of a list of indices, which may repeat. kBadIndex for one outside 0 to n - 1.
int32_t MaskByIndex(const int32_t* indices, int32_t count, int32_t n, uint8_t* mask, int32_t* left);

enum class OutlierRange : int32_t { kY = 0, kX = 1, kBoth = 2 };

// Marks the points that lie on or outside pairs of bounds, given in either order: one pair for y or x, or a pair for x
// and then one for y. A point that is NaN stays. kBadSelector; kFewerThanTwo or, for both, kTooFewForGaussian when
// bounds are missing; kNotFinite when one of those that count is NaN.
int32_t MaskByRange(const double* x, const double* y, int32_t n, const double* bounds, int32_t count, int32_t selector,
                    uint8_t* mask, int32_t* left);

// Copies the values of the points that stay, in their order.
void CopyUnmasked(const double* values, const uint8_t* mask, int32_t n, double* kept);

}  // namespace krnumer
