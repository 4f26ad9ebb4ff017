// Approximate greatest common divisor of two polynomials, from the singular values of Sylvester matrices (R. M.
// Corless, P. M. Gianni, B. M. Trager and S. M. Watt, ISSAC 1995, 195).
#pragma once

#include <cstdint>

#include "frame/complex.h"
#include "frame/scratch.h"

namespace krnumer {

// A polynomial, coefficients from the constant up.
template <class T>
struct Polynomial {
    Scratch<T> coefficients;
    int32_t size = 0;
};

// The divisor of p and q, with the highest coefficient 1, and what is left of each. A divisor is seen where the least
// singular value of a Sylvester matrix of c columns is below sqrt(c) tol; a tol that is not positive means 1e-8.
//
// kEmptyInput, kBadCoefficient for data that cannot be used, as they come or over the highest coefficient,
// kZeroPolynomial; kNoConvergence, kOutOfMemory.
template <class T>
int32_t PolyGCDCore(const T* p, int32_t p_size, const T* q, int32_t q_size, double tol, Polynomial<T>* gcd,
                    Polynomial<T>* p_cofactor, Polynomial<T>* q_cofactor);

extern template int32_t PolyGCDCore(const double*, int32_t, const double*, int32_t, double, Polynomial<double>*,
                                    Polynomial<double>*, Polynomial<double>*);
extern template int32_t PolyGCDCore(const Complex*, int32_t, const Complex*, int32_t, double, Polynomial<Complex>*,
                                    Polynomial<Complex>*, Polynomial<Complex>*);

}  // namespace krnumer
