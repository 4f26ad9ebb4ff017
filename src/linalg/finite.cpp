#include "linalg/finite.h"

#include <algorithm>
#include <bit>
#include <cmath>
#include <limits>

namespace krnumer {
namespace {

// The bounds are not symmetric: the number just below the largest passes, its negative does not.
constexpr double kTooSmall = -1.7976931348623e308;
constexpr double kTooLarge = std::numeric_limits<double>::max();

// Whether a magnitude reaches that of the nearer bound. Bit patterns are in the order of the magnitudes, with NaN above
// all; the sum reaches the top bit where they reach that of the bound.
bool HasSuspect(const double* a, std::size_t count) {
    constexpr std::uint64_t kTop = std::uint64_t{1} << 63;
    constexpr std::uint64_t kRest = kTop - std::bit_cast<std::uint64_t>(-kTooSmall);
    std::uint64_t sums = 0;
    for (std::size_t i = 0; i < count; ++i) sums |= std::bit_cast<std::uint64_t>(std::fabs(a[i])) + kRest;
    return sums >= kTop;
}

bool IsUnusable(double x) {
    return !(x > kTooSmall) || !(x < kTooLarge);
}

}  // namespace

int32_t CheckFiniteArray(const double* a, std::size_t count) {
    constexpr std::size_t kBlock = 512;  // tested without a branch in between
    for (std::size_t start = 0; start < count; start += kBlock) {
        const double* const first = a + start;
        const std::size_t size = std::min(kBlock, count - start);
        if (HasSuspect(first, size) && std::any_of(first, first + size, IsUnusable)) return 1;
    }
    return 0;
}

}  // namespace krnumer
