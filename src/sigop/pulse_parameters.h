// The measures of a pulse.
#pragma once

#include <cstdint>

namespace krnumer {

// Times in samples, slew rate per sample.
struct PulseMeasures {
    double top, base, amplitude;
    double delay, width;
    double slew_rate, fall_time, rise_time;
    double overshoot, undershoot;
};

// Top and base are the modes of the upper and lower half of a histogram of 101 bins; the crossings of 10, 50 and 90 %
// of the amplitude are interpolated. A waveform that begins above the middle is a negative pulse: its amplitude is
// negative and its times are those of its mirror image. Measures are written on success only. kEmptyInput where n < 1,
// kOutOfMemory.
int32_t MeasurePulse(const double* x, int32_t n, PulseMeasures* measures);

}  // namespace krnumer
