// Filters without feedback: the ideal response cut off, without any window.
#pragma once

#include <cstdint>

namespace krnumer {

// h[0] ... h[taps-1], symmetric. `fl` is the cut-off of a lowpass or highpass, which do not look at `fh`, and the lower
// edge of a bandpass or bandstop.
int32_t TruncatedIdealDesign(double fs, double fl, double fh, int32_t type, double* h, int32_t taps);

}  // namespace krnumer
