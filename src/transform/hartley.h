// Hilbert and Hartley transforms of real samples, in place. Tables have length n.
#pragma once

#include <cstdint>

#include "fft/fft.h"

namespace krnumer {

// The spectrum times -i at positive and i at negative frequencies; DC and, for even n, the highest line are 0.
int32_t HilbertTransform(double* x, int32_t n, const qmfft_table* table);
int32_t InverseHilbertTransform(double* x, int32_t n, const qmfft_table* table);

// Re X[k] - Im X[k] (R. N. Bracewell, Proc. IEEE 72, 1010, 1984); the inverse has the factor 1/n.
int32_t HartleyTransform(double* x, int32_t n, const qmfft_table* table);
int32_t InverseHartleyTransform(double* x, int32_t n, const qmfft_table* table);

}  // namespace krnumer
