// Lower-tail probabilities of the normal, t, chi-square and F distributions, and their inverses.
//
// The inverses of the last three are bisections: good to 1e-4 absolute, and never above the quantile.
#pragma once

#include <cstdint>

namespace krnumer {

double NormalDistribution(double x);
int32_t InverseNormalDistribution(double p, double* x);

int32_t TDistribution(double t, int32_t df, double* p);
int32_t InverseTDistribution(double p, int32_t df, double* t);

int32_t ChiSquareDistribution(double x, int32_t df, double* p);
int32_t InverseChiSquareDistribution(double p, int32_t df, double* x);

// n degrees of freedom above, m below.
int32_t FDistribution(double f, int32_t n, int32_t m, double* p);
int32_t InverseFDistribution(double p, int32_t n, int32_t m, double* f);

}  // namespace krnumer
