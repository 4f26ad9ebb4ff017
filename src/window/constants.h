// A window's two figures of merit in spectral measurements.
#pragma once

#include <cstdint>

namespace krnumer {

struct WindowConstants {
    double enbw;          // equivalent noise bandwidth in bins, n sum(w^2) / sum(w)^2
    double coherentGain;  // mean of the weights
};

// The tabulated constants of a named window; a type without any leaves the record as it is.
void WinConstants(std::int32_t type, WindowConstants& constants);

// Measures the weights w[0..n). Both constants are NaN when there are none.
std::int32_t MeasureWindow(const double* w, std::int32_t n, WindowConstants& constants);

}  // namespace krnumer
