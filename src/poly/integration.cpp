#include "poly/integration.h"

#include <cmath>

#include "frame/numeric.h"
#include "frame/scratch.h"
#include "frame/status.h"

namespace krnumer {

namespace {

// Integral over one panel of so many intervals of width 1, without its factor.
template <int kIntervals>
double Panel(const double* y) {
    if constexpr (kIntervals == 1) return y[0] + y[1];
    if constexpr (kIntervals == 2) return y[0] + 4.0 * y[1] + y[2];
    if constexpr (kIntervals == 3) return 3.0 * (y[0] + y[3]) + 9.0 * (y[1] + y[2]);
    if constexpr (kIntervals == 4) return 14.0 * (y[0] + y[4]) + 64.0 * (y[1] + y[3]) + 24.0 * y[2];
}

constexpr double kFactor[] = {0.0, 0.5, 0.3333333333333333, 0.125, 0.022222222222222223};

// A panel at the end of rules with more intervals. Three samples are summed from the middle on.
template <int kIntervals>
double LastPanel(const double* y, int32_t n, double h) {
    const double* const last = y + n - 1 - kIntervals;
    const double panel = kIntervals == 2 ? 4.0 * last[1] + last[2] + last[0] : Panel<kIntervals>(last);
    return panel * h * kFactor[kIntervals];
}

template <int kIntervals>
double Panels(const double* y, int32_t n, double h) {
    const int32_t left_over = (n - 1) % kIntervals;
    double sum = 0.0;
    for (int32_t i = 0; i < n - 1 - left_over; i += kIntervals) sum += Panel<kIntervals>(y + i);
    const double integral = sum * h * kFactor[kIntervals];
    switch (left_over) {
        case 1:
            return integral + LastPanel<1>(y, n, h);
        case 2:
            return integral + LastPanel<2>(y, n, h);
        case 3:
            return integral + LastPanel<3>(y, n, h);
        default:
            return integral;
    }
}

double Trapezoids(const double* y, int32_t n, double h) {
    double sum = 0.0;
    for (int32_t i = 1; i < n - 1; ++i) sum += y[i];
    return h * (0.5 * (y[0] + y[n - 1]) + sum);
}

}  // namespace

int32_t IntegrateCore(const double* y, int32_t n, double step, IntegrationRule rule, double* integral) {
    if (rule > IntegrationRule::kBoole) return kBadSelector;
    if (n < static_cast<int32_t>(rule) + 2) return kBadDimension;
    const double h = std::fabs(step);
    switch (rule) {
        case IntegrationRule::kTrapezoid:
            *integral = Trapezoids(y, n, h);
            break;
        case IntegrationRule::kSimpson:
            *integral = Panels<2>(y, n, h);
            break;
        case IntegrationRule::kSimpson38:
            *integral = Panels<3>(y, n, h);
            break;
        case IntegrationRule::kBoole:
            *integral = Panels<4>(y, n, h);
            break;
    }
    return kOk;
}

int32_t IntegrateGrid(const double* y, const int32_t* sizes, int rank, const double* steps, IntegrationRule rule,
                      double* integral) {
    if (rank == 1) return IntegrateCore(y, sizes[0], steps[0], rule, integral);
    size_t slab = 1;
    for (int axis = 1; axis < rank; ++axis) slab *= Count(sizes[axis]);
    Scratch<double> slabs(Count(sizes[0]));
    if (!slabs) return kOutOfMemory;
    for (size_t i = 0; i < Count(sizes[0]); ++i) {
        if (const int32_t status = IntegrateGrid(y + i * slab, sizes + 1, rank - 1, steps, rule, &slabs[i]))
            return status;
    }
    return IntegrateCore(slabs.data(), sizes[0], steps[rank - 1], rule, integral);
}

}  // namespace krnumer
