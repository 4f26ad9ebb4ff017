// Butterflies on vectors of columns, for data whose elements are adjacent: complex numbers, or doubles.
//
// The arithmetic of every column is that of the plain butterflies, to the bit; only the columns of one vector are
// computed at once. The instruction set is chosen once, at run time.
#pragma once

#include <cstddef>
#include <cstdint>

#include "frame/complex.h"

namespace krnumer {

// The kernels of one radix r. A stage combines r adjacent blocks of length m; `packed` are its twiddles in the order
// of the vectors.
template <class T>
struct VectorKernels {
    // Transforms `lanes` columns of r samples: column l is in[l + j step], j = 0 .. r-1, and its result goes to
    // out[places[l] + q]. Returns how many were done; real columns fewer than a vector may be left to others.
    int32_t (*columns)(const T* in, ptrdiff_t step, T* out, const ptrdiff_t* places, int32_t lanes);
    // Complex: all rows. Real: rows from 1 on as far as vectors go; returns the first row that is left.
    int32_t (*stage)(T* data, const double* packed, int32_t m);
};

struct VectorButterflies {
    VectorKernels<Complex> complex;
    VectorKernels<double> real;
};

// Doubles in a vector of the chosen instruction set; 0 where there are none.
int32_t VectorLanes();

// The kernels of a radix, null where there are none.
const VectorButterflies* VectorButterfliesOf(int32_t radix);

}  // namespace krnumer
