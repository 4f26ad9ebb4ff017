// A band of lines out of a long discrete Fourier transform, from short ones.
#pragma once

#include <cstdint>

#include "fft/fft.h"
#include "frame/complex.h"

namespace krnumer {

// What a call with arguments that fit nothing returns: n, phases or length below 1, or a table of another length.
inline constexpr int32_t kBadZoom = -1;

// Lines start, start + 1, ... start + count - 1 of the transform of length L = phases times length of n samples, which
// are padded with zeros or, where n > L, folded in place. The fold takes up the samples behind the first `length`, not
// behind the first L, so it is true aliasing for one phase only. Each phase of the input is transformed with the table,
// and the phases are added up under a phasor that comes by repeated rotation.
template <class T>
int32_t ZoomTransform(T* x, int32_t n, int32_t phases, int32_t length, int32_t start, int32_t count,
                      const qmfft_table* table, Complex* y);

extern template int32_t ZoomTransform(double*, int32_t, int32_t, int32_t, int32_t, int32_t, const qmfft_table*,
                                      Complex*);
extern template int32_t ZoomTransform(Complex*, int32_t, int32_t, int32_t, int32_t, int32_t, const qmfft_table*,
                                      Complex*);

}  // namespace krnumer
