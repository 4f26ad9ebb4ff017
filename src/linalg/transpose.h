// Transposition of row-major matrices. A size below 1 is -20003.
#pragma once

#include <cstdint>

#include "frame/complex.h"

namespace krnumer {

// out, columns by rows, is the transpose of a, rows by columns. The two must not overlap.
template <class T>
int32_t TransposeCore(const T* a, int32_t rows, int32_t columns, T* out);
// The same with conjugation, where there is anything to conjugate.
template <class T>
int32_t ConjTransposeCore(const T* a, int32_t rows, int32_t columns, T* out);

// The transpose takes the place of the matrix, through a copy of it (-20001).
template <class T>
int32_t TransposeInPlace(T* a, int32_t rows, int32_t columns);
template <class T>
int32_t ConjTransposeInPlace(T* a, int32_t rows, int32_t columns);

}  // namespace krnumer
