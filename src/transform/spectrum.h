// Power and cross power spectra, two-sided: |X[k]|^2 / n^2 and conj(X[k]) Y[k] / n^2, all n lines filled. A single
// sample is its own line. Tables have length n.
#pragma once

#include <cstdint>

#include "fft/fft.h"
#include "frame/complex.h"

namespace krnumer {

// In place.
int32_t PowerSpectrum(double* x, int32_t n, const qmfft_table* table);

int32_t PowerSpectrum(const Complex* x, int32_t n, const qmfft_table* table, double* power);

int32_t CrossSpectrum(const double* x, const double* y, int32_t n, const qmfft_table* table, Complex* cross);
int32_t CrossSpectrum(const Complex* x, const Complex* y, int32_t n, const qmfft_table* table, Complex* cross);

}  // namespace krnumer
