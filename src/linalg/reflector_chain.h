// The reflectors of one double-shift QR sweep, applied to everything outside the block in which they were found.
#pragma once

#include <cstddef>

namespace krnumer {

// I - (x, y, z)^T (1, q, r) on three consecutive rows.
struct BulgeReflector {
    double x, y, z;
    double q, r;
};

// Reflector k of `count` acts on rows k, k + 1 and k + 2.
struct ReflectorChain {
    const BulgeReflector* reflectors;
    std::ptrdiff_t count;
    bool ends_short;  // the last one acts on two rows only
};

// From the left, on rows of `width` elements, `stride` apart.
void ReflectRowsByChain(const ReflectorChain& chain, double* rows, std::ptrdiff_t stride, std::ptrdiff_t width);

// From the right, on columns that are kept as rows.
void ReflectTransposedByChain(const ReflectorChain& chain, double* rows, std::ptrdiff_t stride, std::ptrdiff_t width);

// From the right, on `height` rows, `stride` apart: every row is walked once.
void ReflectColumnsByChain(const ReflectorChain& chain, double* rows, std::ptrdiff_t stride, std::ptrdiff_t height);

}  // namespace krnumer
