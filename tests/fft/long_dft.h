// The Fourier transform in long double, to compare with: O(n log n) at every length.
#pragma once

#include <complex>
#include <vector>

namespace krnumer {

using LongComplex = std::complex<long double>;

// X[k] = sum of x[j] exp(-2 pi i j k / n) by Bluestein's chirp convolution.
std::vector<LongComplex> LongDft(const std::vector<LongComplex>& x);

// The same by its definition, with the angle reduced in integers.
std::vector<LongComplex> LongDftByDefinition(const std::vector<LongComplex>& x);

}  // namespace krnumer
