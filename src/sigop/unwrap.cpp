#include "sigop/unwrap.h"

#include <cmath>

#include "frame/status.h"

namespace krnumer {

// The number of turns stays a double: it may be more than integers hold.
int32_t UnwrapPhase(double* x, int32_t n) {
    constexpr double kTurn = 6.283185307179586;
    constexpr double kPerTurn = 0.15915494309189535;
    if (n < 1) return kEmptyInput;
    for (int32_t i = 1; i < n; ++i) {
        const double turns = std::floor((x[i] - x[i - 1]) * kPerTurn + 0.5);
        x[i] -= turns * kTurn;
    }
    return kOk;
}

}  // namespace krnumer
