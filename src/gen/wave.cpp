#include "gen/wave.h"

#include <algorithm>
#include <cmath>

#include "frame/numeric.h"
#include "frame/status.h"
#include "gen/phase.h"
#include "gen/sines.h"

namespace krnumer {

namespace {

constexpr Period kTurn(kFullTurn);
constexpr double kPerTurn = 0.002777777777777778;  // 1 / 360

}  // namespace

int32_t SineWave(double* y, int32_t n, double amplitude, double frequency, double* phase) {
    if (n < 1) return kEmptyInput;
    const double step = 2.0 * kPi * frequency;
    const double start = *phase * kDegree;
    *phase = kTurn.Remainder(n * frequency * kFullTurn + *phase);

    y[0] = amplitude * std::sin(start);
    if (n == 1) return kOk;
    y[1] = amplitude * std::sin(start + step);

    // A branch and not a minimum and a maximum: it is nearly never taken, and costs the recurrence no waiting.
    const double limit = std::fabs(amplitude);
    const auto limited = [limit](double value) {
        if (std::fabs(value) > limit) [[unlikely]]
            return std::copysign(limit, value);
        return value;
    };

    // Even sines with odd cosines and odd sines with even cosines are two chains that never meet. The time goes into
    // waiting for their products and sums, so both are walked side by side.
    const double twice_sine = 2.0 * std::sin(step);
    double even_sine = y[0];
    double odd_sine = y[1];
    double even_cosine = amplitude * std::cos(start);
    double odd_cosine = amplitude * std::cos(start + step);
    int32_t k = 2;
    for (; k < n - 1; k += 2) {
        even_sine = limited(even_sine + twice_sine * odd_cosine);
        even_cosine -= twice_sine * odd_sine;
        odd_cosine -= twice_sine * even_sine;
        odd_sine = limited(odd_sine + twice_sine * even_cosine);
        y[k] = even_sine;
        y[k + 1] = odd_sine;
    }
    if (k < n) y[k] = limited(even_sine + twice_sine * odd_cosine);
    return kOk;
}

int32_t ArbitraryWave(double* y, int32_t n, double amplitude, double frequency, double* phase, const double* table,
                      int32_t table_size, int32_t interpolation) {
    if (n < 1) return kEmptyInput;
    if (table_size < 1) {
        for (int32_t i = 0; i < n; ++i) y[i] = amplitude * 0.0;
        *phase = 0.0;
        return kOk;
    }
    const double length = table_size;
    const Period period(length);
    const double step = length * frequency;
    double position = *phase * length * kPerTurn;
    // One sample waits for another in the running sum only, so the rest is done for several side by side.
    constexpr int32_t kBlock = 64;
    double entries[kBlock];
    for (int32_t done = 0, size; done < n; done += size) {
        size = std::min(n - done, kBlock);
        const double first = position;
        for (int32_t i = 0; i < size; ++i, position += step) entries[i] = position;
        const bool near = Period::IsNear(first) && Period::IsNear(position);
        for (int32_t i = 0; i < size; ++i) {
            const double entry = near ? period.NearRemainder(entries[i]) : period.Remainder(entries[i]);
            entries[i] = entry < length ? entry : 0.0;  // NaN reads the first
        }
        for (int32_t i = 0; i < size; ++i) {
            const int32_t before = static_cast<int32_t>(entries[i]);
            double value = table[before];
            if (interpolation == 1) {
                const int32_t after = before + 1 < table_size ? before + 1 : 0;
                value += (entries[i] - before) * (table[after] - value);
            }
            y[done + i] = value * amplitude;
        }
    }
    *phase = kTurn.Remainder(kFullTurn / length * position);
    return kOk;
}

int32_t Chirp(double* y, int32_t n, double amplitude, double f1, double f2) {
    if (n < 1) return kEmptyInput;
    const double sweep = (f2 - f1) * kPi / n;
    const double start = 2.0 * kPi * f1;
    SampleAngles(
        y, n, Sines, [=](int32_t i) { return (i * sweep + start) * i; },
        [=](double, double sine) { return amplitude * sine; });
    return kOk;
}

}  // namespace krnumer
