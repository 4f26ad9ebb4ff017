#include "peak/threshold_peaks.h"

#include "frame/status.h"

namespace krnumer {

int32_t FindThresholdPeaks(const double* x, int32_t n, double threshold, int32_t width, int32_t* indices,
                           int32_t* count) {
    if (n < 1) return kEmptyInput;
    if (width < 1 || width >= n) return kBadWidth;
    *count = 0;
    int32_t run = 0;
    for (int32_t i = 0; i < n; ++i) {
        run = x[i] >= threshold ? run + 1 : 0;
        if (run == width) indices[(*count)++] = i - width + 1;
    }
    return kOk;
}

}  // namespace krnumer
