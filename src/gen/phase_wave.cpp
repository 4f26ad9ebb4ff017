// Sawtooth, triangle and square. The loops are plain C++; they are compiled once for every kind of vector unit that the
// machine may have, and no kind rounds differently from another.
#include <cmath>

#include "frame/status.h"
#include "frame/vector_targets.h"
#include "gen/phase.h"
#include "gen/wave.h"

#undef HWY_TARGET_INCLUDE
#define HWY_TARGET_INCLUDE "gen/phase_wave.cpp"
#include <hwy/foreach_target.h>
#include <hwy/highway.h>

HWY_BEFORE_NAMESPACE();
namespace krnumer::HWY_NAMESPACE {

constexpr double kPerHalfTurn = 0.005555555555555556;  // 1 / 180

// `shape` gives the wave of amplitude 1 at a phase from 0 to 360 degrees, where it is the same as at 0.
template <class Shape>
int32_t PhaseDrivenWave(double* y, int32_t n, double amplitude, double frequency, double* phase, Shape shape) {
    if (n < 1) return kEmptyInput;
    constexpr Period turn(kFullTurn);
    const double start = *phase;
    const auto phase_at = [=](int32_t i) HWY_ATTR { return start + i * frequency * kFullTurn; };
    const double end = phase_at(n);
    // The phase moves in one direction, so what lies between two near ends is near too.
    if (Period::IsNear(start) && Period::IsNear(end)) {
        for (int32_t i = 0; i < n; ++i) y[i] = amplitude * shape(turn.NearRemainder(phase_at(i)));
    } else {
        for (int32_t i = 0; i < n; ++i) y[i] = amplitude * shape(turn.Remainder(phase_at(i)));
    }
    *phase = turn.Remainder(end);
    return kOk;
}

int32_t Sawtooth(double* y, int32_t n, double amplitude, double frequency, double* phase) {
    return PhaseDrivenWave(y, n, amplitude, frequency, phase, [](double degrees) HWY_ATTR {
        const double half_turns = degrees * kPerHalfTurn;
        return degrees < 180.0 ? half_turns : half_turns - 2.0;
    });
}

int32_t Triangle(double* y, int32_t n, double amplitude, double frequency, double* phase) {
    // Half the height: the loop saves a multiplication where the amplitude can be doubled before.
    const auto half = [](double degrees) HWY_ATTR {
        const double half_turns = degrees * kPerHalfTurn;
        const double about_zero = half_turns < 1.5 ? half_turns : half_turns - 2.0;
        return about_zero < 0.5 ? about_zero : 1.0 - about_zero;
    };
    const double twice = 2.0 * amplitude;
    if (std::isfinite(twice)) return PhaseDrivenWave(y, n, twice, frequency, phase, half);
    return PhaseDrivenWave(y, n, amplitude, frequency, phase,
                           [=](double degrees) HWY_ATTR { return 2.0 * half(degrees); });
}

int32_t Square(double* y, int32_t n, double amplitude, double frequency, double* phase, double duty) {
    const double edge = duty > 0.0 ? duty * 3.6 : 0.0;  // from 100 % on, every phase is below it
    return PhaseDrivenWave(y, n, amplitude, frequency, phase, [=](double degrees) HWY_ATTR {
        const double turned = degrees >= kFullTurn ? 0.0 : degrees;
        return turned < edge ? 1.0 : -1.0;
    });
}

}  // namespace krnumer::HWY_NAMESPACE
HWY_AFTER_NAMESPACE();

#if HWY_ONCE
namespace krnumer {

HWY_EXPORT(Sawtooth);
HWY_EXPORT(Triangle);
HWY_EXPORT(Square);

int32_t SawtoothWave(double* y, int32_t n, double amplitude, double frequency, double* phase) {
    return HWY_DYNAMIC_DISPATCH(Sawtooth)(y, n, amplitude, frequency, phase);
}

int32_t TriangleWave(double* y, int32_t n, double amplitude, double frequency, double* phase) {
    return HWY_DYNAMIC_DISPATCH(Triangle)(y, n, amplitude, frequency, phase);
}

int32_t SquareWave(double* y, int32_t n, double amplitude, double frequency, double* phase, double duty) {
    return HWY_DYNAMIC_DISPATCH(Square)(y, n, amplitude, frequency, phase, duty);
}

}  // namespace krnumer
#endif
