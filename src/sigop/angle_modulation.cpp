#include "sigop/angle_modulation.h"

#include <cmath>

#include "frame/numeric.h"

namespace krnumer {
namespace {

constexpr double kTurn = 6.283185307179586;
constexpr double kDegreesPerRadian = 57.29577951308232;
constexpr double kRadiansPerDegree = 0.017453292519943295;

// |trunc x| in 32 bits. What does not fit counts as less than everything that does.
int32_t WholeMagnitude(double x) {
    const int32_t whole = TruncateToInt32(x);
    return whole < 0 ? WrappingMultiply(whole, -1) : whole;
}

// advance(x) gives the step of the phase, angle(a, x) the angle of the sine from that of the carrier. Returns the last
// angle of the carrier.
template <class Advance, class Angle>
double Modulate(double* x, int32_t n, double c, AngleModulator* modulator, Advance advance, Angle angle) {
    const double period = kTurn / c;
    double phase = modulator->phase;
    double peak = modulator->peak;
    for (int32_t i = 0; i < n; ++i) {
        if (WholeMagnitude(x[i]) > WholeMagnitude(peak)) peak = x[i];
        phase += advance(x[i]);
        phase += phase >= period ? -period : period;
        x[i] = std::sin(angle(c * phase, x[i]));
    }
    *modulator = {phase, peak};
    return c * phase * kDegreesPerRadian;
}

}  // namespace

double ModulateFrequency(double* x, int32_t n, double c, double f, AngleModulator* modulator) {
    return Modulate(
        x, n, c, modulator, [=](double sample) { return sample * kTurn + f * kTurn; },
        [](double carrier, double) { return carrier; });
}

double ModulatePhase(double* x, int32_t n, double c, double f, AngleModulator* modulator) {
    const double angle = Modulate(
        x, n, c, modulator, [=](double) { return f * kTurn; },
        [](double carrier, double sample) { return carrier + sample * kRadiansPerDegree; });
    return n > 0 ? angle + x[n - 1] : angle;
}

}  // namespace krnumer
