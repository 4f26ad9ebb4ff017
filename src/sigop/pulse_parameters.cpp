#include "sigop/pulse_parameters.h"

#include <utility>

#include "frame/numeric.h"
#include "frame/scratch.h"
#include "frame/status.h"
#include "stat/histogram.h"
#include "stat/order.h"

namespace krnumer {
namespace {

struct Levels {
    double low, middle, high;
};

// The most frequent values of the lower and of the upper half.
int32_t FindStates(const double* x, int32_t n, double min, double max, double* base, double* top) {
    constexpr int32_t kBins = 101;
    constexpr int32_t kMiddle = kBins / 2;
    int32_t counts[kBins];
    double centers[kBins];
    if (const int32_t status = EqualWidthHistogram(x, n, min, max, counts, centers, kBins)) return status;
    int32_t lower = 0;
    int32_t upper = kBins - 1;
    for (int32_t i = 1; i < kMiddle; ++i)
        if (counts[i] > counts[lower]) lower = i;
    for (int32_t j = kBins - 2; j >= kMiddle; --j)
        if (counts[j] > counts[upper]) upper = j;
    *base = centers[lower];
    *top = centers[upper];
    return kOk;
}

// Where the line through the samples k - 1 and k meets the level. There is no sample before the first.
double Cross(const double* x, int32_t k, double level) {
    return k > 0 ? k - (x[k] - level) / (x[k] - x[k - 1]) : 0.0;
}

// Walks once along a positive pulse. Where it ends before a level is met, times count up to its last sample.
void MeasureTimes(const double* x, int32_t n, const Levels& levels, PulseMeasures* measures) {
    const int32_t end = n - 1;
    const double length = n;
    int32_t i = 0;
    int32_t last_low = -1;
    for (; i < end && !(x[i] >= levels.middle); ++i)
        if (x[i] < levels.low) last_low = i;
    measures->delay = i < end ? Cross(x, i, levels.middle) : end;

    while (i < end && !(x[i] >= levels.high)) ++i;
    measures->rise_time = i < end ? Cross(x, i, levels.high) - Cross(x, last_low + 1, levels.low) : length - last_low;

    int32_t last_high = -1;
    for (; i < end && !(x[i] <= levels.middle); ++i)
        if (x[i] >= levels.high) last_high = i;
    measures->width = (i < end ? Cross(x, i, levels.middle) : end) - measures->delay;

    while (i < end && !(x[i] <= levels.low)) ++i;
    measures->fall_time = i < end ? Cross(x, i, levels.low) - Cross(x, last_high + 1, levels.high) : length - last_high;
}

}  // namespace

int32_t MeasurePulse(const double* x, int32_t n, PulseMeasures* measures) {
    PulseMeasures found{};
    double min = 0.0, max = 0.0;
    int32_t min_index = 0, max_index = 0;
    if (const int32_t status = MinMaxIgnoreNaN(x, n, &max, &max_index, &min, &min_index)) return status;
    if (max == min) {
        found.top = found.base = x[0];
    } else {
        if (const int32_t status = FindStates(x, n, min, max, &found.base, &found.top)) return status;
        found.amplitude = found.top - found.base;
        found.overshoot = max - found.top;
        found.undershoot = found.base - min;
    }

    Levels levels{0.1 * found.amplitude + found.base, 0.5 * found.amplitude + found.base,
                  0.9 * found.amplitude + found.base};
    Scratch<double> mirrored;
    if (x[0] > levels.middle) {
        found.amplitude = -found.amplitude;
        std::swap(found.top, found.base);
        levels = {-levels.high, -levels.middle, -levels.low};
        if (!mirrored.Allocate(Count(n))) return kOutOfMemory;
        for (int32_t i = 0; i < n; ++i) mirrored[Count(i)] = -x[i];
        x = mirrored.data();
    }
    MeasureTimes(x, n, levels, &found);
    found.slew_rate = found.rise_time == 0.0 ? 1e+30 : found.amplitude * 0.8 / found.rise_time;
    *measures = found;
    return kOk;
}

}  // namespace krnumer
