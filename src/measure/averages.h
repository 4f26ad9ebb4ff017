// Averages of a stretch of a signal, summed in the order of the samples.
#pragma once

#include <cmath>
#include <cstdint>

#include "measure/measurement.h"

namespace krnumer::measure {

inline double Mean(const Signal& signal, int32_t begin, int32_t count) {
    double sum = 0.0;
    for (int32_t i = begin; i < begin + count; ++i) sum += signal[i];
    return sum / count;
}

inline double RootMeanSquare(const Signal& signal, int32_t begin, int32_t count) {
    double sum = 0.0;
    for (int32_t i = begin; i < begin + count; ++i) sum += signal[i] * signal[i];
    return std::sqrt(sum / count);
}

}  // namespace krnumer::measure
