// Roots of a polynomial with their multiplicities (Z. Zeng, Math. Comp. 74, 869, 2005): a multiple root stays one root.
#pragma once

#include <cstdint>

#include "frame/complex.h"
#include "frame/scratch.h"

namespace krnumer {

struct RootList {
    Scratch<Complex> roots;
    Scratch<int32_t> multiplicities;
    int32_t count = 0;
};

// The distinct roots of c[0] + ... + c[n-1] x^(n-1): `roots` as its greatest common divisors tell them apart, the root
// 0 last; with `refine`, `refined` holds them by descending modulus and improved with their multiplicities held fixed.
// Where the multiplicities do not add up, or cannot be held, the list (`refined`, or without it `roots`) becomes that
// of the eigenvalues of the companion matrix. A tol that is not positive means 1e-10.
//
// kEmptyInput, kBadCoefficient for data that cannot be used, kZeroPolynomial, kBadOrder for a constant; kNoConvergence,
// kOutOfMemory.
template <class T>
int32_t MultipleRoots(const T* c, int32_t n, bool refine, double tol, RootList* roots, RootList* refined);

extern template int32_t MultipleRoots(const double*, int32_t, bool, double, RootList*, RootList*);
extern template int32_t MultipleRoots(const Complex*, int32_t, bool, double, RootList*, RootList*);

}  // namespace krnumer
