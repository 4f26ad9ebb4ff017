// General linear least squares, y = H c, and one step of a non-linear fit.
#pragma once

#include <cstdint>

namespace krnumer {

// How a least-squares problem is solved. The normal equations cost least and square the condition number.
enum LeastSquaresMethod : int32_t {
    kSvdMethod = 0,     // singular values, all that are not 0
    kGivensMethod = 1,  // QR factorisation; the three names run one code
    kFastGivensMethod = 2,
    kHouseholderMethod = 3,
    kLUMethod = 4,            // normal equations
    kCholeskyMethod = 5,      // normal equations
    kTruncatedSvdMethod = 6,  // singular values above m eps times the largest
};

// The k coefficients c that minimise the sum of |w[i]| (y[i] - (H c)[i])^2, H m by k, weights 1 where w is null.
// `covariance`, k by k, is the pseudo-inverse of H'WH. The fit H c and its mean square error come where both are asked
// for. Any output but `coef` may be null.
//
// kBadOrder where k < 1, kUnderdetermined where m < k, kBadSelector, in this order; kSingular from a method without
// singular values; kNotFinite, kNotPositiveDefinite, kNoConvergence and kOutOfMemory as the solver says.
int32_t GenLSFitCore(const double* h, int32_t m, int32_t k, const double* y, const double* w, double* coef,
                     double* best_fit, double* mse, double* covariance, int32_t method);

// One step of Levenberg and Marquardt: the diagonal of the hessian is multiplied by 1 + lambda, and the solution for
// the gradient added to the coefficients. kNotFinite, kNoConvergence, kOutOfMemory; +20001 for a rank-deficient
// hessian, with the step done.
int32_t GetNewCoefCore(const double* hessian, const double* gradient, int32_t k, double lambda, double* coef);

}  // namespace krnumer
