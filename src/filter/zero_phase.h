// Filtering forward and backward, which cancels the phase.
#pragma once

#include <cstdint>

namespace krnumer {

// A filter in direct form (see direct_form.h) with a pair of states for each direction.
struct ZeroPhaseFilter {
    const double* a;  // null without feedback
    int32_t na;
    const double* b;
    int32_t nb;
    double* forward_states[2];  // nb - 1 values each
    double* reverse_states[2];  // na - 1 values each
};

// Filters x in place. On both sides the signal is continued by as many zeros as the longer coefficient array has
// elements, into which the responses of both passes may die out.
int32_t FilterBothWays(const ZeroPhaseFilter& filter, double* x, int32_t n);

}  // namespace krnumer
