// Newton-Cotes integration of samples on a uniform grid.
#pragma once

#include <cstdint>

namespace krnumer {

// By the number of intervals that a panel has, less 1.
enum class IntegrationRule : uint32_t { kTrapezoid, kSimpson, kSimpson38, kBoole };

// Integral of n samples at distance |step|. Intervals that do not fill a panel at the end are integrated by the rule
// that they just fill.
//
// kBadSelector: no such rule; kBadDimension: fewer samples than a panel has. `integral` is written on success only.
int32_t IntegrateCore(const double* y, int32_t n, double step, IntegrationRule rule, double* integral);

// Along all axes of a dense row-major grid. `sizes` are given from the slowest axis to the fastest, `steps` the other
// way round. Fails as above for any axis, and with kOutOfMemory.
int32_t IntegrateGrid(const double* y, const int32_t* sizes, int rank, const double* steps, IntegrationRule rule,
                      double* integral);

}  // namespace krnumer
