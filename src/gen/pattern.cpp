#include "gen/pattern.h"

#include <algorithm>

#include "frame/numeric.h"
#include "frame/status.h"
#include "gen/sines.h"
#include "gen/wave.h"

namespace krnumer {

namespace {

bool CyclesFit(double cycles, int32_t n) {
    return !(cycles > n || cycles <= 0.0);
}

}  // namespace

int32_t SinePattern(double* y, int32_t n, double amplitude, double phase, double cycles) {
    if (!CyclesFit(cycles, n)) return kBadCycles;
    return SineWave(y, n, amplitude, cycles / n, &phase);
}

int32_t SquarePattern(double* y, int32_t n, double amplitude, double duty, double cycles) {
    if (!CyclesFit(cycles, n)) return kBadCycles;
    if (n < 1) return kEmptyInput;
    if (duty == 100.0) {
        std::fill_n(y, n, amplitude);
        return kOk;
    }
    const int32_t period = std::max(SaturateToInt32(n / cycles + 0.5), 1);
    const int32_t high = std::clamp(SaturateToInt32(period * duty * 0.01 + 0.5), 0, period);
    for (int32_t left = n; left > 0;) {
        const int32_t up = std::min(high, left);
        const int32_t down = std::min(period - high, left - up);
        y = std::fill_n(y, up, amplitude);
        y = std::fill_n(y, down, 0.0);
        left -= up + down;
    }
    return kOk;
}

int32_t ImpulsePattern(double* y, int32_t n, double amplitude, int32_t delay) {
    if (n < 1) return kEmptyInput;
    if (delay >= n || delay < 0) return kBadIndex;
    std::fill_n(y, n, 0.0);
    y[delay] = amplitude;
    return kOk;
}

int32_t PulsePattern(double* y, int32_t n, double amplitude, int32_t delay, int32_t width) {
    if (n < 1) return kEmptyInput;
    if (delay < 0 || width < 0 || std::int64_t{delay} + width > n) return kPulseDoesNotFit;
    y = std::fill_n(y, delay, 0.0);
    y = std::fill_n(y, width, amplitude);
    std::fill_n(y, n - delay - width, 0.0);
    return kOk;
}

int32_t SincPattern(double* y, int32_t n, double amplitude, double delay, double dt) {
    if (n < 1) return kEmptyInput;
    if (dt <= 0.0) return kBadSamplingInterval;
    SampleAngles(
        y, n, Sines, [=](int32_t i) { return (i * dt - delay) * kPi; },
        [=](double u, double sine) {
            const bool off_peak = u < 0.0 || u > 0.0;  // a time that is not a number counts as the peak
            return off_peak ? sine / u * amplitude : amplitude;
        });
    return kOk;
}

int32_t RampPattern(double* y, int32_t n, double start, double end, int32_t exclude_end) {
    if (exclude_end != 0 && n < 1) return kNoSample;
    if (exclude_end == 0 && n < 2 && !(n == 1 && start == end)) return kFewerThanTwo;
    const double step = (end - start) / (exclude_end == 0 ? n - 1 : n);
    y[0] = start;
    for (int32_t i = 1; i < n; ++i) y[i] = i * step + start;
    if (exclude_end == 0) y[n - 1] = end;
    return kOk;
}

}  // namespace krnumer
