// Impulse responses whose second half follows from the first.
#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

namespace krnumer {

// All of `taps` values, the second half being `sign` times the first one reversed.
inline std::vector<double> Mirrored(const std::vector<double>& half, int32_t taps, double sign) {
    std::vector<double> all = half;
    for (std::size_t i = static_cast<std::size_t>(taps) / 2; i-- > 0;) all.push_back(sign * half[i]);
    return all;
}

}  // namespace krnumer
