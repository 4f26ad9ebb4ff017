#include "window/constants.h"

#include "frame/numeric.h"
#include "frame/status.h"
#include "window/type.h"

namespace krnumer {

void WinConstants(std::int32_t type, WindowConstants& constants) {
    switch (type) {
        case kWindowRectangle:
            constants = {1.0, 1.0};
            break;
        case kWindowHann:
            constants = {1.5, 0.5};
            break;
        case kWindowHamming:
            constants = {1.362826, 0.54};
            break;
        case kWindowBlackmanHarris3:
            constants = {1.708538, 0.42323};
            break;
        case kWindowExactBlackman:
            constants = {1.693699, 0.42659071367};
            break;
        case kWindowBlackman:
            constants = {1.726757, 0.42};
            break;
        case kWindowFlatTop:
            constants = {3.770246506303, 0.215578948};
            break;
        case kWindowBlackmanHarris4:
            constants = {2.004353, 0.35875};
            break;
        case kWindowBlackmanHarris7:
            constants = {2.631905, 0.27105140069342415};
            break;
        case kWindowLowSideLobe:
            constants = {2.215350782519, 0.323215218};
            break;
        case kWindowBlackmanNuttall:
            constants = {1.9761117, 0.3635819};
            break;
        case kWindowBartlettHanning:
            constants = {1.45584787, 0.5};
            break;
        case kWindowBohman:
            constants = {1.78574087544, 0.40528473457};
            break;
        case kWindowParzen:
            constants = {1.91746031746, 0.375};
            break;
        case kWindowWelch:
            constants = {1.2, 0.66666667};
            break;
        default:
            break;
    }
}

std::int32_t MeasureWindow(const double* w, std::int32_t n, WindowConstants& constants) {
    if (n < 1) {
        constants = {kQuietNaN, kQuietNaN};
        return kEmptyInput;
    }
    double sum = 0.0, squares = 0.0;
    for (std::int32_t i = 0; i < n; ++i) {
        sum += w[i];
        squares += w[i] * w[i];
    }
    constants = {n * squares / (sum * sum), sum / n};
    return kOk;
}

}  // namespace krnumer
