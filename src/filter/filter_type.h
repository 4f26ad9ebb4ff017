// What a filter lets through.
#pragma once

#include <cstdint>

namespace krnumer {

enum FilterType : int32_t { kLowpass, kHighpass, kBandpass, kBandstop };

constexpr bool IsFilterType(int32_t type) {
    return type >= kLowpass && type <= kBandstop;
}

// Whether a filter has two edges instead of one cut-off. A number that is no type counts as if it had.
constexpr bool HasTwoEdges(int32_t type) {
    return type != kLowpass && type != kHighpass;
}

}  // namespace krnumer
