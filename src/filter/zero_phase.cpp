#include "filter/zero_phase.h"

#include <algorithm>

#include "filter/direct_form.h"
#include "frame/numeric.h"
#include "frame/scratch.h"
#include "frame/status.h"

namespace krnumer {

int32_t FilterBothWays(const ZeroPhaseFilter& filter, double* x, int32_t n) {
    if (n < 1) return kEmptyInput;
    const int32_t padding = std::max({filter.na, filter.nb, 0});
    const int64_t length = int64_t{n} + 2 * int64_t{padding};
    if (length > INT32_MAX) return kOutOfMemory;
    Scratch<double> work(static_cast<size_t>(length), Scratch<double>::kZeroed);
    if (!work) return kOutOfMemory;
    double* const padded = work.data();
    std::copy_n(x, n, padded + padding);
    for (int pass = 0; pass < 2; ++pass) {
        if (const int32_t status =
                DirectFormFilter(padded, static_cast<int32_t>(length), filter.a, filter.na, filter.b, filter.nb,
                                 filter.forward_states[pass], filter.reverse_states[pass], padded))
            return status;
        std::reverse(padded, padded + length);
    }
    std::copy_n(padded + padding, n, x);
    return kOk;
}

}  // namespace krnumer
