#include "linalg/finite.h"

#include <algorithm>
#include <limits>

namespace krnumer {

// The bounds are not symmetric: the number just below the largest passes, its negative does not.
int32_t CheckFiniteArray(const double* a, std::size_t count) {
    constexpr double kTooSmall = -1.7976931348623e308;
    constexpr double kTooLarge = std::numeric_limits<double>::max();
    constexpr std::size_t kBlock = 512;  // tested without a branch in between

    for (std::size_t start = 0; start < count; start += kBlock) {
        const std::size_t end = start + std::min(kBlock, count - start);
        bool unusable = false;
        for (std::size_t i = start; i < end; ++i) unusable |= !(a[i] > kTooSmall) | !(a[i] < kTooLarge);
        if (unusable) return 1;
    }
    return 0;
}

}  // namespace krnumer
