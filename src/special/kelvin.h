// Kelvin functions of integer order: Bessel functions of argument x e^(3 pi i / 4), by parts.
#pragma once

#include <cstdint>

namespace krnumer {

struct KelvinParts {
    double real, imaginary;
};

// ber_n(x) and bei_n(x).
KelvinParts KelvinI(int32_t n, double x);

// ker_n(x) and kei_n(x), for x > 0.
KelvinParts KelvinK(int32_t n, double x);

}  // namespace krnumer
