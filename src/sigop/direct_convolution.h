// Convolution by its definition, on whichever vectors the machine has.
#pragma once

#include <cstdint>

#include "frame/complex.h"

namespace krnumer {

// An array of rows, one after the other.
template <class T>
struct Plane {
    const T* data;
    int32_t rows;
    int32_t columns;
};

// In which order the products of one output are added.
enum class TapOrder : uint8_t {
    kAscending,   // along the kernel
    kDescending,  // along the signal
};

// z[r][c] = sum of kernel[p][q] signal[r-p][c-q], of kernel.rows + signal.rows - 1 rows and as many columns. Rows of
// the kernel are taken ascending, elements of a row in the given order; every sum starts from 0. Fastest where rows of
// the kernel are the shorter ones.
void DirectConvolution(Plane<double> kernel, Plane<double> signal, TapOrder order, double* z);
void DirectConvolution(Plane<Complex> kernel, Plane<Complex> signal, TapOrder order, Complex* z);

}  // namespace krnumer
