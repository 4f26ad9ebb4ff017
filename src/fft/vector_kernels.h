// Butterflies on vectors of columns, for data whose elements are adjacent: complex numbers, or doubles.
//
// The arithmetic of every column is that of the plain butterflies, to the bit; only the columns of one vector are
// computed at once. The instruction set is chosen once, at run time.
#pragma once

#include <cstddef>
#include <cstdint>

#include "frame/complex.h"

namespace krnumer {

// Transforms `lanes` columns of r samples: column l is in[l + j step], j = 0 .. r-1, and its result goes to
// out[places[l] + q]. Returns how many were done; real columns fewer than a vector may be left to others.
template <class T>
using ColumnsKernel = int32_t (*)(const T* in, ptrdiff_t step, T* out, const ptrdiff_t* places, int32_t lanes);

// The kernels of one radix r. Stages work in place; `packed` are the twiddles of the rows that they do, in the order of
// the vectors.
struct ComplexKernels {
    ColumnsKernel<Complex> columns;
    // `rows` adjacent rows of a stage of blocks at a distance of `block`. Row 0 of all takes no twiddles.
    void (*stage)(Complex* data, ptrdiff_t block, const double* packed, int32_t rows, bool from_row0);
};

struct RealKernels {
    ColumnsKernel<double> columns;
    // Rows of a stage of adjacent blocks of length m, from row 1 on as far as vectors go; returns the first row that is
    // left.
    int32_t (*stage)(double* data, const double* packed, int32_t m);
    // Whole vectors of rows at a, and their partners in the same order at b, in blocks at a distance of `block`.
    void (*pairs)(double* a, double* b, ptrdiff_t block, const double* packed, int32_t pairs);
};

struct VectorButterflies {
    ComplexKernels complex;
    RealKernels real;
};

// Doubles in a vector of the chosen instruction set; 0 where there are none.
int32_t VectorLanes();

// The kernels of a radix, null where there are none.
const VectorButterflies* VectorButterfliesOf(int32_t radix);

}  // namespace krnumer
