// The inner loops of the LU and Cholesky factorisations.
//
// Every element is reduced by its products one after the other, in the order of the terms, each rounded by itself:
// what a loop over the terms gives, whatever is done at the same time.
#pragma once

#include <cstddef>

#include "frame/complex.h"

namespace krnumer {

// From one row to the next: `step` elements on, then `shrink` less each time. Rows of a packed triangle shrink by 1.
struct RowStep {
    size_t step;
    size_t shrink = 0;
};

template <class T>
struct ProductOperands {
    T* c;  // rows by columns; elements of a row lie side by side, as in b
    RowStep c_row;
    const T* a;  // rows by terms
    size_t a_row;
    RowStep a_term;
    const T* b;  // terms by columns
    RowStep b_term;
    size_t rows, columns, terms;
    bool conjugate_a = false;
};

// C -= A B, or with A conjugated.
void SubtractProduct(const ProductOperands<double>& operands);
void SubtractProduct(const ProductOperands<Complex>& operands);

// Rows of an upper triangular factor that are worked on together, and the square where they meet the diagonal.
inline constexpr size_t kRowsTogether = 4;
template <class T>
using DiagonalSquare = T[kRowsTogether][kRowsTogether];

// Forward substitution: in each of `count` columns of the rows, X in square^H X = rows takes their place. The square is
// upper triangular with a real diagonal.
void SolveBeside(const DiagonalSquare<double>& square, double* const* rows, size_t count);
void SolveBeside(const DiagonalSquare<Complex>& square, Complex* const* rows, size_t count);

}  // namespace krnumer
