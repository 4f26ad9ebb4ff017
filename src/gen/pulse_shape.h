// Pulse shapes, sampled on an axis of time.
//
// The axis is `time` where it is given, of n values in seconds, which may be the array `y` itself; a null pointer asks
// for the uniform axis i dt - delay. `dt` has to be positive (-20016) and n at least 1 (-20003) with either axis.
#pragma once

#include <cstdint>

namespace krnumer {

// Triangle from 0 to `width` seconds whose peak stands at `skew` (0 to 1) of the width. On a given axis the triangle
// begins half a width before time 0. Checked in the order n, width (-20140), dt, skew (-20053).
int32_t AperiodicTriangle(const double* time, double* y, int32_t n, double amplitude, double delay, double dt,
                          double width, double skew);

// First derivative of a Gaussian with centre frequency `fc` in hertz, whose extremes are +-amplitude.
// Checked in the order fc (-20140), n, dt.
int32_t GaussianMonopulse(const double* time, double* y, int32_t n, double dt, double delay, double fc,
                          double amplitude);

// Cosine of `fc` hertz under a Gaussian envelope; the spectrum is `attenuation` dB down at the edges of `bandwidth`,
// which is a fraction of fc. Checked in the order fc, bandwidth, attenuation (-20140), n, dt.
int32_t GaussianPulse(const double* time, double* y, int32_t n, double amplitude, double delay, double dt, double fc,
                      double bandwidth, double attenuation);

// Dirichlet kernel sin(order t/2) / (order sin t/2). Where sin t/2 vanishes the value is 1, also at those zeros where
// the limit is -1. Checked in the order `order` (-20140), n, dt.
int32_t PeriodicSinc(const double* time, double* y, int32_t n, double amplitude, int32_t order, double dt,
                     double delay);

}  // namespace krnumer
