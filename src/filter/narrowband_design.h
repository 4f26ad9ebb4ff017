// Narrow filters that cost little: a prototype with taps M apart, whose response repeats M times, and an interpolator
// that takes the repetitions away (Y. Neuvo, C.-Y. Dong, S. K. Mitra, Interpolated finite impulse response filters,
// IEEE Trans. Acoust. Speech Signal Process. ASSP-32, 563 (1984)).
#pragma once

#include <cstdint>

#include "filter/filter_type.h"
#include "frame/scratch.h"

namespace krnumer {

// What a narrowband filter is to do. Types above those of all filters are complements: the signal itself, delayed, is
// added to what the prototype and the interpolator make of it.
enum NarrowbandType : int32_t { kComplementaryLowpass = 4, kComplementaryHighpass = 5 };

constexpr bool IsComplement(int32_t type) {
    return type == kBandstop || type == kComplementaryLowpass || type == kComplementaryHighpass;
}

struct NarrowbandRequest {
    double fs;
    double fp, fstop;  // edges, or the full widths of pass band and stop band around fc
    double fc;
    double ripple;       // of the pass band, peak to peak
    double attenuation;  // of the stop band in decibels
    int32_t type;        // a FilterType
};

struct Taps {
    Scratch<double> values;
    int32_t count = 0;
};

struct NarrowbandFilter {
    int32_t type;    // a FilterType or a NarrowbandType
    int32_t factor;  // distance of the prototype's taps; with 1 there is no interpolator
    Taps prototype;
    Taps interpolator;
};

int32_t NarrowbandDesign(const NarrowbandRequest& request, NarrowbandFilter* filter);

}  // namespace krnumer
