#include "sigop/calculus.h"

#include "frame/status.h"

namespace krnumer {
namespace {

// Replaces every sample by step(previous, sample, next).
template <class Step>
void ForEachNeighbourhood(double* x, int32_t n, double initial, double final, Step step) {
    double previous = initial;
    for (int32_t i = 0; i < n - 1; ++i) {
        const double sample = x[i];
        x[i] = step(previous, sample, x[i + 1]);
        previous = sample;
    }
    x[n - 1] = step(previous, x[n - 1], final);
}

}  // namespace

int32_t Differentiate(double* x, int32_t n, double initial, double final, double dt) {
    if (!(dt > 0.0)) return kBadSamplingInterval;
    if (n < 1) return kEmptyInput;
    const double scale = 0.5 / dt;
    ForEachNeighbourhood(x, n, initial, final,
                         [=](double previous, double, double next) { return (next - previous) * scale; });
    return kOk;
}

int32_t Integrate(double* x, int32_t n, double initial, double final, double dt) {
    if (n < 1) return kEmptyInput;
    if (dt <= 0.0) return kBadSamplingInterval;
    const double sixth = dt * 0.16666666666666666;
    double integral = -0.0;  // leaves the first term as it is, whatever its sign
    ForEachNeighbourhood(x, n, initial, final, [&](double previous, double sample, double next) {
        return integral += (previous + 4.0 * sample + next) * sixth;
    });
    return kOk;
}

}  // namespace krnumer
