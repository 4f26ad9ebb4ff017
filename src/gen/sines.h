// Sines and cosines of many angles at a time.
#pragma once

#include <algorithm>
#include <cstdint>

namespace krnumer {

// y[i] = sin(x[i]) or cos(x[i]), of any x, to 0.53 units in the last place where x is below 1.3e7, else as the C library
// gives them; y may be x. A value depends on its own angle only, and not on the vector unit: all round alike.
void Sines(const double* x, int32_t n, double* y);
void Cosines(const double* x, int32_t n, double* y);

// y[i] = value(angle(i), f(angle(i))), where f is Sines or Cosines, in blocks that the cache keeps.
template <class Function, class Angle, class Value>
void SampleAngles(double* y, int32_t n, Function f, Angle angle, Value value) {
    constexpr int32_t kBlock = 256;
    double angles[kBlock], results[kBlock];
    for (int32_t first = 0, count; first < n; first += count) {
        count = std::min(kBlock, n - first);
        for (int32_t i = 0; i < count; ++i) angles[i] = angle(first + i);
        f(angles, count, results);
        for (int32_t i = 0; i < count; ++i) y[first + i] = value(angles[i], results[i]);
    }
}

}  // namespace krnumer
