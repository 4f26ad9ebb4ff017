#include "poly/gcd.h"

#include <algorithm>
#include <cmath>
#include <utility>

#include "frame/numeric.h"
#include "frame/status.h"
#include "linalg/element.h"
#include "linalg/finite.h"
#include "linalg/svd.h"
#include "linalg/svd_solve.h"

namespace krnumer {

namespace {

template <class T>
int32_t Copy(const T* from, int32_t size, Polynomial<T>* to) {
    if (!to->coefficients.Allocate(Count(size))) return kOutOfMemory;
    std::copy_n(from, size, to->coefficients.data());
    to->size = size;
    return kOk;
}

// Divides by the highest coefficient. The complex quotient of a number and itself has the real part 1, but can have a
// rounding error for its imaginary part.
template <class T>
void Normalise(T* c, int32_t size) {
    const T highest = c[size - 1];
    for (int32_t i = 0; i < size; ++i) c[i] = c[i] / highest;
    c[size - 1] = FromReal<T>(RealPart(c[size - 1]));
}

// A polynomial of the caller's without its zeros at either end.
template <class T>
struct Trimmed {
    Trimmed(const T* c, int32_t n) : coefficients(c), size(n) {
        while (size > 0 && c[size - 1] == T{}) --size;
        while (low_zeros < size && c[low_zeros] == T{}) ++low_zeros;
    }
    void DropLow(int32_t count) {
        coefficients += count;
        size -= count;
    }

    const T* coefficients;
    int32_t size;
    int32_t low_zeros = 0;
};

// Writes the matrix of the multiplication by c, for factors of `columns` coefficients, into a matrix of `width` columns
// from column `first` on: column j holds c shifted down by j.
template <class T>
void Convolution(const T* c, int32_t size, int32_t columns, T* matrix, int32_t width, int32_t first) {
    for (int32_t j = 0; j < columns; ++j)
        for (int32_t i = 0; i < size; ++i) matrix[Count(i + j) * Count(width) + Count(first + j)] = c[i];
}

// Finds the degree of the divisor of a and b, a the longer. The cofactors u of a and v of b are the null vector of the
// matrix of b u - a v; where there is none, they are a and b. The divisor then has gcd_size coefficients.
template <class T>
int32_t FindCofactors(const Polynomial<T>& a, const Polynomial<T>& b, double tol, Polynomial<T>* u, Polynomial<T>* v,
                      int32_t* gcd_size) {
    const int32_t difference = a.size - b.size;
    for (int32_t degree = difference; degree <= a.size - 2; ++degree) {
        const int32_t u_size = degree + 1;
        const int32_t v_size = degree + 1 - difference;
        const int32_t rows = b.size + degree;
        const int32_t columns = u_size + v_size;
        const std::size_t width = Count(columns);
        Scratch<T> matrix(Count(rows) * width, Scratch<T>::kZeroed);
        Scratch<double> s(width);
        if (!matrix || !s) return kOutOfMemory;
        Convolution(b.coefficients.data(), b.size, u_size, matrix.data(), columns, 0);
        Convolution(a.coefficients.data(), a.size, v_size, matrix.data(), columns, u_size);
        if (const int32_t status = SvdValuesCore(matrix.data(), rows, columns, s.data())) return status;
        if (!(s[width - 1] < std::sqrt(static_cast<double>(columns)) * tol)) continue;

        Scratch<T> right(width * width);
        if (!right || !u->coefficients.Allocate(Count(u_size)) || !v->coefficients.Allocate(Count(v_size)))
            return kOutOfMemory;
        const int32_t status = SvdCore(matrix.data(), rows, columns, matrix.data(), s.data(), right.data(), false);
        if (status != kOk) return status;
        const auto null_vector = [&](int32_t i) { return right[Count(i) * width + width - 1]; };
        for (int32_t i = 0; i < u_size; ++i) u->coefficients[Count(i)] = null_vector(i);
        for (int32_t i = 0; i < v_size; ++i) v->coefficients[Count(i)] = -null_vector(u_size + i);
        u->size = u_size;
        v->size = v_size;
        Normalise(u->coefficients.data(), u_size);
        Normalise(v->coefficients.data(), v_size);
        *gcd_size = a.size - degree;
        return kOk;
    }
    *gcd_size = 1;
    const int32_t status = Copy(a.coefficients.data(), a.size, u);
    return status != kOk ? status : Copy(b.coefficients.data(), b.size, v);
}

// The g of `size` coefficients that comes nearest to u g = a and v g = b.
template <class T>
int32_t DivideByCofactors(const Polynomial<T>& a, const Polynomial<T>& b, const Polynomial<T>& u,
                          const Polynomial<T>& v, T* g, int32_t size) {
    const int32_t rows = a.size + b.size;
    Scratch<T> matrix(Count(rows) * Count(size), Scratch<T>::kZeroed);
    Scratch<T> right(Count(rows));
    if (!matrix || !right) return kOutOfMemory;
    Convolution(u.coefficients.data(), u.size, size, matrix.data(), size, 0);
    Convolution(v.coefficients.data(), v.size, size, matrix.data() + Count(a.size) * Count(size), size, 0);
    std::copy_n(b.coefficients.data(), b.size, std::copy_n(a.coefficients.data(), a.size, right.data()));
    const int32_t status = SvdSolve(matrix.data(), rows, size, right.data(), 1, g, -1.0);
    if (status < 0) return status;
    Normalise(g, size);
    return kOk;
}

}  // namespace

template <class T>
int32_t PolyGCDCore(const T* p, int32_t p_size, const T* q, int32_t q_size, double tol, Polynomial<T>* gcd,
                    Polynomial<T>* p_cofactor, Polynomial<T>* q_cofactor) {
    if (p_size < 1 || q_size < 1) return kEmptyInput;
    if (HasUnusable(p, Count(p_size)) || HasUnusable(q, Count(q_size))) return kBadCoefficient;
    if (tol <= 0.0) tol = 1e-8;
    Trimmed<T> longer(p, p_size);
    Trimmed<T> shorter(q, q_size);
    if (longer.size == 0 || shorter.size == 0) return kZeroPolynomial;
    const int32_t zeros = std::min(longer.low_zeros, shorter.low_zeros);
    longer.DropLow(zeros);
    shorter.DropLow(zeros);
    const bool swapped = longer.size < shorter.size;
    if (swapped) std::swap(longer, shorter);

    Polynomial<T> a;
    Polynomial<T> b;
    if (Copy(longer.coefficients, longer.size, &a) || Copy(shorter.coefficients, shorter.size, &b)) return kOutOfMemory;
    Normalise(a.coefficients.data(), a.size);
    Normalise(b.coefficients.data(), b.size);
    if (HasUnusable(a.coefficients.data(), Count(a.size)) || HasUnusable(b.coefficients.data(), Count(b.size)))
        return kBadCoefficient;

    Polynomial<T>* const u = swapped ? q_cofactor : p_cofactor;
    Polynomial<T>* const v = swapped ? p_cofactor : q_cofactor;
    int32_t size = 1;
    if (const int32_t status = FindCofactors(a, b, tol, u, v, &size)) return status;
    if (!gcd->coefficients.Allocate(Count(zeros) + Count(size))) return kOutOfMemory;
    gcd->size = zeros + size;
    std::fill_n(gcd->coefficients.data(), zeros, T{});
    T* const g = gcd->coefficients.data() + zeros;
    if (size > 1) return DivideByCofactors(a, b, *u, *v, g, size);
    g[0] = FromReal<T>(1.0);
    return kOk;
}

template int32_t PolyGCDCore(const double*, int32_t, const double*, int32_t, double, Polynomial<double>*,
                             Polynomial<double>*, Polynomial<double>*);
template int32_t PolyGCDCore(const Complex*, int32_t, const Complex*, int32_t, double, Polynomial<Complex>*,
                             Polynomial<Complex>*, Polynomial<Complex>*);

}  // namespace krnumer
