// Balancing before an eigenproblem (B. N. Parlett and C. Reinsch, Numer. Math. 13, 293, 1969): a permutation sets
// isolated eigenvalues apart, then powers of 2 even out rows and columns.
#pragma once

#include <cstddef>

namespace krnumer {

// What balancing did. Rows and columns from low to high form the block that is left.
struct Balance {
    std::ptrdiff_t low;
    std::ptrdiff_t high;
    double* scale;  // n: factors from low to high; elsewhere the place that was exchanged with this one, counted from 1
};

// Balances A, n by n, in place; scale has room for n.
template <class T>
Balance BalanceMatrix(T* a, std::ptrdiff_t n, double* scale);

// Turns one eigenvector of the balanced matrix into one of the original.
template <class T>
void Unbalance(const Balance& balance, std::ptrdiff_t n, T* vector);

}  // namespace krnumer
