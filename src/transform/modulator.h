// Multiplication by a rotating phasor, exp(i (phase + 2 pi k ratio)), as the first step of a digital down-converter.
#pragma once

#include <cmath>
#include <cstdint>

#include "frame/complex.h"

namespace krnumer {

// y[k] = x[k] times the phasor, which turns by `ratio` cycles a sample; x and y may be one array. `phase` is in
// radians, and on return the phase of the next sample, within 0 to 2 pi. A ratio of 0 changes nothing at all, not even
// by the phase.
//
// The phasor comes by repeated rotation, whose length is not renormalised: it drifts by about a rounding error a
// sample.
template <class T>
void Modulate(const T* x, int32_t n, double ratio, double* phase, Complex* y) {
    constexpr double kTwoPi = 6.283185307179586;
    constexpr double kTurn = 0.15915494309189535;  // 1 / (2 pi)
    if (ratio == 0.0) return;
    Complex rotor{std::cos(*phase), std::sin(*phase)};
    const Complex step{std::cos(kTwoPi * ratio), std::sin(kTwoPi * ratio)};
    const double end = *phase + ratio * n * kTwoPi;
    *phase = end - std::floor(end * kTurn) * kTwoPi;
    for (int32_t i = 0; i < n; ++i) {
        y[i] = x[i] * rotor;
        rotor = {rotor.re * step.re - rotor.im * step.im, rotor.re * step.im + rotor.im * step.re};
    }
}

}  // namespace krnumer
