// Chirp-Z transform, X[k] = sum of x[j] A^-j W^(jk): the z-transform on the spiral A W^-k (L. R. Rabiner, R. W. Schafer
// and C. M. Rader, Bell Syst. Tech. J. 48, 1249, 1969), and its inverse.
#pragma once

#include <cstdint>

#include "frame/complex.h"

namespace krnumer {

// m values of the transform of n samples. kEmptyInput where n < 1, kBadSelector, then for A and after it for W
// kNotFinite and kZeroParameter. `algorithm` is a ConvolutionAlgorithm. The direct sum takes a power of W for every
// term; the other is a convolution with a chirp (L. I. Bluestein, IEEE Trans. AU 18, 451, 1970).
template <class T>
int32_t ChirpZ(const T* x, int32_t n, Complex a, Complex w, int32_t m, int32_t algorithm, Complex* y);

// The m samples whose transform passes through m of the n values x, those nearest the unit circle, by the explicit
// inverse of the Vandermonde matrix of a geometric sequence, in O(m^2) steps. Where |A| or |W| is not 1 its condition
// grows like a power of m. kEmptyInput, kNotFinite and kZeroParameter for A, W and 1/W, kBadDimension where m > n,
// kZeroBase where two points of the spiral coincide.
int32_t InverseChirpZ(const Complex* x, int32_t n, Complex a, Complex w, int32_t m, Complex* y);

// Coefficients c[0..m) of the monic polynomial of m roots, the highest left out. The roots are put in Leja order first,
// and stay so (L. Reichel, BIT 30, 332, 1990). `weights` holds m doubles.
void RootsToPolynomial(Complex* roots, int32_t m, double* weights, Complex* c);

extern template int32_t ChirpZ(const double*, int32_t, Complex, Complex, int32_t, int32_t, Complex*);
extern template int32_t ChirpZ(const Complex*, int32_t, Complex, Complex, int32_t, int32_t, Complex*);

}  // namespace krnumer
