// Classical filters as cascades of sections, in closed form.
#pragma once

#include <cstdint>

#include "filter/bilinear.h"

namespace krnumer {

// Lengths of the coefficient arrays of a cascade.
struct CascadeLengths {
    int64_t a, b;
};
CascadeLengths LengthsOf(int32_t order, int32_t type);

// Where the coefficients of a cascade go; each array at least of the length above.
struct CascadeOutput {
    double* a;
    int32_t na;
    double* b;
    int32_t nb;
};

// Maximally flat: the poles of the prototype lie on the unit circle, at equal angles.
int32_t ButterworthDesign(const FilterBand& band, const CascadeOutput& output);

// Poles on the unit circle with equally spaced imaginary parts.
int32_t BesselDesign(const FilterBand& band, const CascadeOutput& output);

// Equal ripple in the pass band, in decibels.
int32_t ChebyshevDesign(const FilterBand& band, double ripple, const CascadeOutput& output);

// Equal ripple in the stop band, `attenuation` decibels below the pass band.
int32_t InverseChebyshevDesign(const FilterBand& band, double attenuation, const CascadeOutput& output);

// Equal ripple in both.
int32_t EllipticDesign(const FilterBand& band, double ripple, double attenuation, const CascadeOutput& output);

}  // namespace krnumer
