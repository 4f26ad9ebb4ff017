// Rows cut into strips of a few vectors' width, for kernels that walk down many rows with a strip in registers.
// Included by sources that are compiled for every vector unit.

#if defined(KRNUMER_LINALG_STRIPS_INL_H) == defined(HWY_TARGET_TOGGLE)
#ifdef KRNUMER_LINALG_STRIPS_INL_H
#undef KRNUMER_LINALG_STRIPS_INL_H
#else
#define KRNUMER_LINALG_STRIPS_INL_H
#endif

#include <hwy/highway.h>

#include <cstddef>

HWY_BEFORE_NAMESPACE();
namespace krnumer::HWY_NAMESPACE {

namespace hn = hwy::HWY_NAMESPACE;

// What is left of the row at `column`, at most kLanes - 1 elements wide, by halves.
template <std::size_t kLanes, class Strip>
HWY_INLINE void FinishStrips(double* row, std::ptrdiff_t column, std::ptrdiff_t length, const Strip& strip) {
    if constexpr (kLanes > 1) {
        constexpr std::size_t kHalf = kLanes / 2;
        if (length - column >= static_cast<std::ptrdiff_t>(kHalf)) {
            strip.template Run<1>(hn::CappedTag<double, kHalf>(), row + column);
            column += static_cast<std::ptrdiff_t>(kHalf);
        }
        FinishStrips<kHalf>(row, column, length, strip);
    }
}

// Runs the strip on all columns of a row of `length` elements: strip.Run<vectors>(tag, first element).
template <class Strip>
HWY_INLINE void ForEachStrip(double* row, std::ptrdiff_t length, const Strip& strip) {
    constexpr int kTogether = 4;
    constexpr hn::CappedTag<double, 8> d;
    constexpr std::size_t kLanes = hn::MaxLanes(d);
    constexpr auto kStep = static_cast<std::ptrdiff_t>(kLanes);

    std::ptrdiff_t column = 0;
    for (; column + kTogether * kStep <= length; column += kTogether * kStep)
        strip.template Run<kTogether>(d, row + column);
    for (; column + kStep <= length; column += kStep) strip.template Run<1>(d, row + column);
    FinishStrips<kLanes>(row, column, length, strip);
}

}  // namespace krnumer::HWY_NAMESPACE
HWY_AFTER_NAMESPACE();

#endif
