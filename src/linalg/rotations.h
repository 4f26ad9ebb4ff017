// Plane rotations on rows, as the iterations on bidiagonal and tridiagonal matrices gather them for their vectors.
//
// The vectors are kept transposed while an iteration runs: one vector is one row, and a complex row is a real row of
// twice the length, because the rotations themselves are real.
#pragma once

#include <cmath>
#include <cstddef>

namespace krnumer {

// sqrt(a^2 + b^2) without overflow or underflow of the squares.
inline double Hypotenuse(double a, double b) {
    const double p = std::fabs(a);
    const double q = std::fabs(b);
    const double larger = p > q ? p : q;
    const double smaller = p > q ? q : p;
    const double ratio = smaller / larger;
    return larger == 0.0 ? 0.0 : larger * std::sqrt(1.0 + ratio * ratio);
}

// Vectors as consecutive rows of `length` doubles; no rows where only values are wanted.
struct VectorRows {
    VectorRows() = default;
    template <class T>
    VectorRows(T* elements, std::ptrdiff_t elements_per_row)
        : rows(reinterpret_cast<double*>(elements)),
          length(elements_per_row * static_cast<std::ptrdiff_t>(sizeof(T) / sizeof(double))) {}

    double* rows = nullptr;
    std::ptrdiff_t length = 0;

    explicit operator bool() const { return rows != nullptr; }
    double* operator[](std::ptrdiff_t i) const { return rows + i * length; }
};

// out (row-major, m by n) = the n rows of m elements as columns: row order[j] becomes column j.
template <class T>
void RowsToColumns(const T* rows, const std::ptrdiff_t* order, std::ptrdiff_t n, std::ptrdiff_t m, T* out) {
    for (std::ptrdiff_t j = 0; j < n; ++j) {
        const T* row = rows + order[j] * m;
        for (std::ptrdiff_t i = 0; i < m; ++i) out[i * n + j] = row[i];
    }
}

// x' = x c + y s and y' = y c - x s on two rows.
void RotateRows(double* x, double* y, std::ptrdiff_t length, double c, double s);

// A chain of rotations, each on the row that the one before left and the next: rows `first` and `first + step`, then
// `first + step` and `first + 2 step`, and so on, with (c[0], s[0]), (c[1], s[1]), ... The rows are walked once for the
// whole chain.
void RotateChain(VectorRows vectors, std::ptrdiff_t first, std::ptrdiff_t step, std::ptrdiff_t count, const double* c,
                 const double* s);

}  // namespace krnumer
