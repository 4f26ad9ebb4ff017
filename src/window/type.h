// The numbers by which callers name a window. There is no window 10.
#pragma once

#include <cstdint>

namespace krnumer {

enum WindowType : std::int32_t {
    kWindowRectangle = 0,
    kWindowHann = 1,
    kWindowHamming = 2,
    kWindowBlackmanHarris3 = 3,
    kWindowExactBlackman = 4,
    kWindowBlackman = 5,
    kWindowFlatTop = 6,
    kWindowBlackmanHarris4 = 7,
    kWindowBlackmanHarris7 = 8,
    kWindowLowSideLobe = 9,
    kWindowBlackmanNuttall = 11,

    kWindowTriangle = 30,
    kWindowBartlettHanning = 31,
    kWindowBohman = 32,
    kWindowParzen = 33,
    kWindowWelch = 34,

    kWindowKaiser = 60,
    kWindowDolphChebyshev = 61,
    kWindowGaussian = 62,
};

}  // namespace krnumer
