#pragma once

#include <cmath>
#include <limits>

namespace krnumer {

// ln(x / 2) for x > 0, finite for the least double as well, half of which is 0.
inline double LnHalf(double x) {
    constexpr double kLnTwo = 0.6931471805599453;
    return x < std::numeric_limits<double>::min() ? std::log(x) - kLnTwo : std::log(0.5 * x);
}

}  // namespace krnumer
