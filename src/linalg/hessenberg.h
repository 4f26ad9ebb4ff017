// Reductions of a square row-major matrix by LAPACK: Hessenberg form, balancing, and the way back from balanced
// eigenvectors.
#pragma once

#include <cstdint>

namespace krnumer {

// A = Q H Q^H with H upper Hessenberg between rows ilo and ihi, counted from 0. H may be A itself. -20003, -20017
// unless 0 <= ilo <= ihi < n, -20068, -20001.
template <class T>
int32_t HessenbergCore(const T* a, int32_t n, int32_t ilo, int32_t ihi, T* h, T* q);

// Balances A in place (B. N. Parlett and C. Reinsch, Numer. Math. 13, 293, 1969). job: 0 nothing, 1 permute, 2 scale, 3
// both. ilo and ihi count from 0, the permutations in `scale` from 1. -20061, -20999, -20001.
template <class T>
int32_t BalanceCore(T* a, int32_t n, int32_t job, int32_t* ilo, int32_t* ihi, double* scale);

// Turns eigenvectors of the balanced matrix, right ones or with `left` left ones, into those of the original, in place.
// An ilo or ihi that fits no matrix leaves them. -20061; -20017 for a permutation that is none; -20001.
template <class T>
int32_t BackTransformCore(T* v, int32_t n, int32_t job, bool left, int32_t ilo, int32_t ihi, const double* scale);

}  // namespace krnumer
