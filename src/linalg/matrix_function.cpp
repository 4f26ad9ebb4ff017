#include "linalg/matrix_function.h"

#include <algorithm>
#include <cmath>
#include <utility>

#include "frame/numeric.h"
#include "frame/scratch.h"
#include "frame/status.h"
#include "linalg/eigen_general.h"
#include "linalg/element.h"
#include "linalg/finite.h"
#include "linalg/lapack.h"
#include "linalg/lu.h"
#include "linalg/lu_solve.h"
#include "linalg/products.h"
#include "linalg/schur.h"
#include "linalg/svd_solve.h"

namespace krnumer {

namespace {

// Largest row sum of magnitudes; NaN where one is NaN.
template <class T>
double InfinityNorm(const T* a, int32_t n) {
    double norm = 0.0;
    for (std::size_t i = 0; i < Count(n); ++i) {
        double sum = 0.0;
        for (std::size_t j = 0; j < Count(n); ++j) sum += Modulus(a[i * Count(n) + j]);
        if (sum > norm || std::isnan(sum)) norm = sum;
        if (std::isnan(norm)) break;
    }
    return norm;
}

template <class T>
void AddToDiagonal(T* a, int32_t n, double value) {
    for (std::size_t i = 0; i < Count(n); ++i) a[i * (Count(n) + 1)] += FromReal<T>(value);
}

template <class T>
void SetIdentity(T* a, int32_t n) {
    std::fill_n(a, Count(n) * Count(n), T{});
    AddToDiagonal(a, n, 1.0);
}

template <class T>
int32_t Multiply(const T* a, const T* b, int32_t n, T* c) {
    return MatMulCore(a, b, n, n, n, c);
}

// log(M) = V log(D) V^-1 for M = V D V^-1. `out` may be M.
int32_t EigenLogarithm(const Complex* m, int32_t n, Complex* out) {
    const std::size_t order = Count(n);
    Scratch<Complex> work(2 * order * order + order);
    if (!work) return kOutOfMemory;
    Complex* const v = work.data();
    Complex* const inverse = v + order * order;
    Complex* const values = inverse + order * order;
    if (const int32_t status = CxEigenGeneralCore(m, n, 1, values, v)) return status;
    std::copy_n(v, order * order, inverse);
    if (const int32_t status = InvertByLU(inverse, n)) return status;
    for (std::size_t j = 0; j < order; ++j) {
        if (!(SquaredModulus(values[j]) > 0.0)) return kZeroBase;
        values[j] = {std::log(Modulus(values[j])), std::atan2(values[j].im, values[j].re)};
    }
    for (std::size_t i = 0; i < order; ++i)
        for (std::size_t j = 0; j < order; ++j) v[i * order + j] = v[i * order + j] * values[j];
    return Multiply(v, inverse, n, out);
}

double LargestModulus(const Complex* a, std::size_t count) {
    double largest = 0.0;
    for (std::size_t i = 0; i < count; ++i) largest = std::max(largest, Modulus(a[i]));
    return largest;
}

// Moves every element a little, by a logistic sequence, so that equal eigenvalues part.
void Perturb(Complex* a, int32_t n) {
    double u = 0.142857;
    const auto next = [&u, n] {
        u = 4.0 * u * (1.0 - u);
        return u * 1e-12 / n;
    };
    for (std::size_t i = 0; i < Count(n) * Count(n); ++i) {
        a[i].re += next();
        a[i].im += next();
    }
}

// One correction of the logarithm, L - (exp(L) - A) exp(L)^-1. `converged` compares with the sign: negative parts fail.
int32_t CorrectLogarithm(const Complex* a, int32_t n, Complex* logarithm, bool* converged, bool* finite) {
    const std::size_t count = Count(n) * Count(n);
    Scratch<Complex> work(3 * count);
    if (!work) return kOutOfMemory;
    Complex* const e = work.data();
    Complex* const inverse = e + count;
    Complex* const g = inverse + count;
    std::copy_n(logarithm, count, e);
    if (const int32_t status = ExpCore(e, n)) return status;
    std::copy_n(e, count, inverse);
    if (const int32_t status = InvertByLU(inverse, n)) return status;
    for (std::size_t i = 0; i < count; ++i) e[i] -= a[i];
    if (const int32_t status = Multiply(e, inverse, n, g)) return status;
    *finite = !HasUnusable(g, count);
    if (!*finite) return kOk;
    *converged = true;
    for (std::size_t i = 0; i < count; ++i) {
        logarithm[i] -= g[i];
        if (!(logarithm[i].re * 1e-12 >= g[i].re && logarithm[i].im * 1e-12 >= g[i].im)) *converged = false;
    }
    return kOk;
}

Complex PrincipalRoot(Complex z) {
    if (z == Complex{}) return z;
    const double r = std::sqrt(Modulus(z));
    const double angle = std::atan2(z.im, z.re) / 2.0;
    return {r * std::cos(angle), r * std::sin(angle)};
}

// The root of an upper triangular matrix.
void TriangularRoot(const Complex* t, int32_t n, Complex* s) {
    constexpr double kNearZero = 1e-12;
    const std::size_t order = Count(n);
    std::fill_n(s, order * order, Complex{});
    for (std::size_t j = 0; j < order; ++j) {
        s[j * order + j] = PrincipalRoot(t[j * order + j]);
        for (std::size_t i = j; i-- > 0;) {
            Complex b = t[i * order + j];
            for (std::size_t k = i + 1; k < j; ++k) b -= s[i * order + k] * s[k * order + j];
            const Complex d = s[i * order + i] + s[j * order + j];
            const bool vanishes = SumOfParts(d) < kNearZero && SumOfParts(b) < kNearZero;
            s[i * order + j] = vanishes ? Complex{} : b / d;
        }
    }
}

}  // namespace

int32_t PadeOrder(double tol, double b) {
    const double target = tol / (b * std::exp(b));
    double error = 1.0 / 6.0;
    int32_t order = 1;
    while (!(error * std::exp(error) <= target)) {
        ++order;
        const double q = order;
        const double odd = 2.0 * q - 1.0;
        const double even = 2.0 * q;
        error = error * (q * q * odd) / (odd * odd * even * even) * 0.25 / (2.0 * q + 1.0);
    }
    return order;
}

template <class T>
int32_t ExpCore(T* a, int32_t n) {
    if (n < 1) return kEmptyInput;
    const std::size_t count = Count(n) * Count(n);
    Scratch<T> work(4 * count);
    Scratch<int32_t> pivots(Count(n));
    if (!work || !pivots) return kOutOfMemory;
    T* const x = work.data();
    T* const d = x + count;
    T* p = d + count;
    T* t = p + count;

    const double norm = InfinityNorm(a, n);
    if (!std::isfinite(norm)) {
        // No power of two brings the matrix into the range of the approximant.
        std::fill_n(reinterpret_cast<double*>(a), count * sizeof(T) / sizeof(double), kQuietNaN);
        return kOk;
    }
    const int32_t squarings = norm >= 0.5 ? static_cast<int32_t>(std::log(norm) / std::log(2.0) + 1.0) : 0;
    const double factor = std::ldexp(1.0, squarings);
    const int32_t order = PadeOrder(1e-8, norm);
    for (std::size_t i = 0; i < count; ++i) {
        x[i] = a[i] / factor;
        a[i] = x[i] / 2.0;
        d[i] = x[i] / -2.0;
    }
    AddToDiagonal(a, n, 1.0);
    AddToDiagonal(d, n, 1.0);
    if (const int32_t status = Multiply(x, x, n, p)) return status;
    double c = 0.5;
    double sign = 1.0;
    for (int32_t k = 2; k <= order; ++k) {
        c = c * (order - k + 1.0) / ((2.0 * order - k + 1.0) * k);
        for (std::size_t i = 0; i < count; ++i) {
            a[i] += c * p[i];
            d[i] += sign * c * p[i];
        }
        if (k == order) break;
        if (const int32_t status = Multiply(p, x, n, t)) return status;
        std::swap(p, t);
        sign = -sign;
    }

    int32_t parity;
    LUFactor(d, n, pivots.data(), &parity);  // what is singular shows in the result
    if (const int32_t status = LUInverse(d, pivots.data(), n, d)) return status;
    if (const int32_t status = Multiply(d, a, n, t)) return status;
    for (int32_t s = 0; s < squarings; ++s) {
        if (const int32_t status = Multiply(t, t, n, p)) return status;
        std::swap(p, t);
    }
    std::copy_n(t, count, a);
    return kOk;
}

int32_t CxLnCore(Complex* a, int32_t n) {
    if (n < 1) return kEmptyInput;
    const std::size_t count = Count(n) * Count(n);
    if (HasUnusable(a, count)) return kNotFinite;
    Scratch<Complex> work(2 * count);
    if (!work) return kOutOfMemory;
    Complex* const logarithm = work.data();
    Complex* const other = logarithm + count;
    if (const int32_t status = EigenLogarithm(a, n, logarithm)) return status;

    std::copy_n(logarithm, count, other);
    if (const int32_t status = ExpCore(other, n)) return status;
    const double scale = LargestModulus(a, count) + LargestModulus(other, count);
    double difference = 0.0;
    for (std::size_t i = 0; i < count; ++i) difference = std::max(difference, Modulus(a[i] - other[i]));
    bool converged = !HasUnusable(other, count) && difference / scale < 1e-12;
    if (!converged) {
        std::copy_n(a, count, other);
        Perturb(other, n);
        if (const int32_t status = EigenLogarithm(other, n, logarithm)) return status;
        bool finite = true;
        for (int32_t pass = 0; pass < 2 && finite && !converged; ++pass)
            if (const int32_t status = CorrectLogarithm(a, n, logarithm, &converged, &finite)) return status;
    }
    std::copy_n(logarithm, count, a);
    return converged ? kOk : kWarnInaccurate;
}

int32_t CxSqrtCore(Complex* a, int32_t n) {
    if (n < 1) return kEmptyInput;
    const std::size_t count = Count(n) * Count(n);
    if (HasUnusable(a, count)) return kNotFinite;
    Scratch<Complex> work(3 * count + Count(n));
    if (!work) return kOutOfMemory;
    Complex* const u = work.data();
    Complex* const t = u + count;
    Complex* const s = t + count;
    Complex* const values = s + count;
    if (const int32_t status = SchurCore(a, n, kModulusDescending, u, t, values)) return status;
    const bool doubtful = n != 1 && SumOfParts(values[n - 2]) < 1e-12;
    TriangularRoot(t, n, s);
    if (const int32_t status = Multiply(u, s, n, t)) return status;
    lapack::Gemm(lapack::kRowMajor, lapack::kNoTranspose, lapack::kConjugateTranspose, n, n, n, Complex{1.0, 0.0}, t, n,
                 u, n, Complex{}, a, n);
    return doubtful ? kWarnInaccurate : kOk;
}

template <class T>
int32_t PowerCore(const T* a, int32_t n, int32_t power, T* out) {
    if (n < 1) return kEmptyInput;
    const std::size_t count = Count(n) * Count(n);
    if (power == 0) {
        SetIdentity(out, n);
        return kOk;
    }
    Scratch<T> work(3 * count);
    if (!work) return kOutOfMemory;
    T* x = work.data();
    T* r = x + count;
    T* spare = r + count;
    std::copy_n(a, count, x);
    if (power < 0) {
        if (const int32_t status = PseudoInverseCore<T>(x, n, n, -1.0, nullptr)) return status;
    }
    uint32_t bits = power < 0 ? 0u - static_cast<uint32_t>(power) : static_cast<uint32_t>(power);
    if ((bits & 1) != 0) {
        std::copy_n(x, count, r);
    } else {
        SetIdentity(r, n);
    }
    while ((bits >>= 1) != 0) {
        if (const int32_t status = Multiply(x, x, n, spare)) return status;
        std::swap(x, spare);
        if ((bits & 1) == 0) continue;
        if (const int32_t status = Multiply(x, r, n, spare)) return status;
        std::swap(r, spare);
    }
    std::copy_n(r, count, out);
    return kOk;
}

template int32_t ExpCore(double*, int32_t);
template int32_t ExpCore(Complex*, int32_t);
template int32_t PowerCore(const double*, int32_t, int32_t, double*);
template int32_t PowerCore(const Complex*, int32_t, int32_t, Complex*);

}  // namespace krnumer
