// Decimation by a whole factor, of a block or of a stream. Instances exist for double and Complex.
#pragma once

#include <cstdint>

#include "frame/complex.h"

namespace krnumer {

// Keeps every factor-th sample, or the mean of every factor samples, at the beginning of x; what is left at the end is
// dropped. kEmptyInput where n < 1, kBadDecimation unless 1 <= factor <= n.
template <class T>
int32_t Decimate(T* x, int32_t n, int32_t factor, bool averaging, int32_t* count);

// Where a decimated stream stands between two blocks.
template <class T>
struct DecimationStream {
    int32_t start;          // samples to pass over before the next one is kept, or the next mean is complete or begun
    int32_t partial_count;  // samples in a mean that is not complete
    T partial_sum;          // and their sum
};

// The same with what is left kept in the stream, so that the blocks of a signal give what the whole would give. `reset`
// forgets the incomplete mean, not the start. kNotPositive where factor < 1, kNegativeState where the start is
// negative; the stream stays as it is then. A stream that no block could have left is safe, whatever it gives.
template <class T>
int32_t DecimateContinuous(T* x, int32_t n, int32_t factor, bool averaging, bool reset, DecimationStream<T>* stream,
                           int32_t* count);

extern template int32_t Decimate(double*, int32_t, int32_t, bool, int32_t*);
extern template int32_t Decimate(Complex*, int32_t, int32_t, bool, int32_t*);
extern template int32_t DecimateContinuous(double*, int32_t, int32_t, bool, bool, DecimationStream<double>*, int32_t*);
extern template int32_t DecimateContinuous(Complex*, int32_t, int32_t, bool, bool, DecimationStream<Complex>*,
                                           int32_t*);

}  // namespace krnumer
