// Twiddles in the order of the vector kernels: vector after vector of rows, and in each the r-1 columns. Those of
// complex rows have real and imaginary parts side by side, those of real rows have a vector of real parts before one of
// imaginary parts. Row 0, which takes no twiddles, and what fills up the last vector is 1.
#pragma once

#include <cstddef>
#include <cstdint>
#include <type_traits>

#include "fft/table.h"
#include "fft/vector_kernels.h"
#include "frame/complex.h"
#include "frame/numeric.h"

namespace krnumer {

// Rows in a vector of the kernels on elements T, Complex or double. With each come two doubles, whatever T.
template <class T>
int32_t RowsPerVector() {
    return std::is_same_v<T, Complex> ? VectorLanes() / 2 : VectorLanes();
}

// Doubles that a run of rows takes.
template <class T>
size_t PackedCount(int32_t rows, int32_t radix) {
    const int32_t vector = RowsPerVector<T>();
    return Count((rows + vector - 1) / vector) * Count(vector) * Count(2 * (radix - 1));
}

// Packs the twiddles of the rows row(first) .. row(end-1). Returns the end of what was written.
template <class T, class Row>
double* PackTwiddles(const stage_tables& stage, int32_t radix, int32_t first, int32_t end, Row row, double* packed) {
    const int32_t vector = RowsPerVector<T>();
    const ptrdiff_t columns = radix - 1;
    for (; first < end; first += vector) {
        for (ptrdiff_t j = 0; j < columns; ++j, packed += 2 * vector) {
            for (int32_t l = 0; l < vector; ++l) {
                const ptrdiff_t k = first + l < end ? row(first + l) : 0;
                const ptrdiff_t at = (k - 1) * columns + j;
                const Complex w = k > 0 ? Complex{stage.twiddleRe[at], stage.twiddleIm[at]} : Complex{1.0, 0.0};
                constexpr bool kTogether = std::is_same_v<T, Complex>;
                packed[kTogether ? 2 * l : l] = w.re;
                packed[kTogether ? 2 * l + 1 : vector + l] = w.im;
            }
        }
    }
    return packed;
}

}  // namespace krnumer
