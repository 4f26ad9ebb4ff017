#include "poly/root_structure.h"

#include <algorithm>
#include <cmath>
#include <utility>

#include "frame/numeric.h"
#include "frame/scratch.h"
#include "frame/status.h"
#include "linalg/eigen_general.h"
#include "linalg/element.h"
#include "linalg/qr.h"
#include "linalg/svd.h"

namespace krnumer {

template <class T>
bool MakeMonic(T* f, int32_t degree) {
    const T highest = f[0];
    if (highest == T{}) return false;
    if (highest == FromReal<T>(1.0)) return true;
    f[0] = FromReal<T>(1.0);
    for (int32_t i = 1; i <= degree; ++i) f[i] = f[i] / highest;
    return true;
}

template <class T>
double RowWeight(T right) {
    const double size = Modulus(right);
    return size >= 1.0 ? 1.0 / size : 1.0;
}

// Eigenvalues of the companion matrix. On roots in symmetrical places the iteration may go in circles; the same matrix
// in another order of its rows and columns, or transposed, then takes other steps.
template <class T>
int32_t CompanionRoots(const T* f, int32_t degree, Complex* roots) {
    struct Order {
        bool backward, transposed;
    };
    const std::size_t n = Count(degree);
    Scratch<T> companion(n * n);
    if (!companion) return kOutOfMemory;
    for (const Order order : {Order{false, false}, Order{true, false}, Order{false, true}, Order{true, true}}) {
        const auto at = [&](std::size_t i, std::size_t j) -> T& {
            if (order.backward) {
                i = n - 1 - i;
                j = n - 1 - j;
            }
            return companion[order.transposed ? j * n + i : i * n + j];
        };
        std::fill_n(companion.data(), n * n, T{});
        for (std::size_t i = 0; i < n; ++i) at(0, i) = -f[i + 1];
        for (std::size_t i = 1; i < n; ++i) at(i, i - 1) = FromReal<T>(1.0);
        int32_t status;
        if constexpr (kIsComplex<T>) {
            status = CxEigenGeneralCore(companion.data(), degree, 0, roots, nullptr);
        } else {
            status = EigenGeneralCore(companion.data(), degree, 0, roots, nullptr);
        }
        if (status != kNoConvergence) return status;
    }
    return kNoConvergence;
}

namespace {

// Columns that hold c, shifted down by one more each, from (row, first) of a matrix of `width` columns on.
template <class T>
void ShiftedColumns(const T* c, int32_t size, int32_t columns, T* matrix, int32_t width, int32_t row, int32_t first) {
    for (int32_t j = 0; j < columns; ++j)
        for (int32_t i = 0; i < size; ++i) matrix[Count(row + i + j) * Count(width) + Count(first + j)] = c[i];
}

// R X = B and R^H X = B in place, R upper.
template <class T>
void SolveUpper(const T* r, int32_t n, T* x) {
    const auto at = [&](int32_t i, int32_t j) { return r[Count(i) * Count(n) + Count(j)]; };
    for (int32_t i = n - 1; i >= 0; --i) {
        for (int32_t j = i + 1; j < n; ++j) x[i] -= at(i, j) * x[j];
        x[i] = x[i] / at(i, i);
    }
}
template <class T>
void SolveAdjoint(const T* r, int32_t n, T* x) {
    const auto at = [&](int32_t i, int32_t j) { return Conjugate(r[Count(i) * Count(n) + Count(j)]); };
    for (int32_t i = 0; i < n; ++i) {
        for (int32_t j = 0; j < i; ++j) x[i] -= at(j, i) * x[j];
        x[i] = x[i] / at(i, i);
    }
}

// x = A^H b.
template <class T>
void MultiplyAdjoint(const T* a, int32_t rows, int32_t columns, const T* b, T* x) {
    std::fill_n(x, columns, T{});
    for (int32_t i = 0; i < rows; ++i)
        for (int32_t j = 0; j < columns; ++j) x[j] += Conjugate(a[Count(i) * Count(columns) + Count(j)]) * b[i];
}

// The x that makes the weighted A x - b least, with one correction by the semi-normal equations (A. Bjorck, Linear
// Algebra Appl. 88/89, 31, 1987). A and b are weighted in place.
template <class T>
int32_t WeightedRefinedLS(T* a, int32_t rows, int32_t columns, T* b, const double* weights, T* x) {
    const std::size_t n = Count(columns);
    Scratch<T> q(Count(rows) * n);
    Scratch<T> r(n * n);
    Scratch<T> correction(n);
    if (!q || !r || !correction) return kOutOfMemory;
    for (int32_t i = 0; i < rows; ++i) {
        const T weight = FromReal<T>(weights[i]);
        b[i] *= weight;
        for (int32_t j = 0; j < columns; ++j) a[Count(i) * n + Count(j)] *= weight;
    }
    if (const int32_t status = QRHouseholder(a, rows, columns, kEconomyQR, q.data(), r.data())) return status;
    double largest = 0.0;
    for (std::size_t i = 0; i < n; ++i) largest = std::max(largest, Modulus(r[i * n + i]));
    for (std::size_t i = 0; i < n; ++i)
        if (r[i * n + i] == T{}) r[i * n + i] = FromReal<T>(largest * kEpsilon);

    MultiplyAdjoint(q.data(), rows, columns, b, x);
    SolveUpper(r.data(), columns, x);
    for (int32_t i = 0; i < rows; ++i)
        for (int32_t j = 0; j < columns; ++j) b[i] -= a[Count(i) * n + Count(j)] * x[j];
    MultiplyAdjoint(a, rows, columns, b, correction.data());
    SolveAdjoint(r.data(), columns, correction.data());
    SolveUpper(r.data(), columns, correction.data());
    for (int32_t j = 0; j < columns; ++j) x[j] += correction[Count(j)];
    return kOk;
}

// f = g u and f' = g v, all with the highest coefficient 1, u of degree k.
template <class T>
struct Factors {
    Factors(int32_t f_degree, int32_t u_degree)
        : d(f_degree), k(u_degree), all(Count(d) + Count(k) + 2, Scratch<T>::kZeroed) {}
    explicit operator bool() const { return bool(all); }
    T* g() { return all.data(); }
    T* u() { return g() + (d - k + 1); }
    T* v() { return u() + (k + 1); }

    int32_t d;
    int32_t k;
    Scratch<T> all;
};

// The level of the chain at f of degree d.
template <class T>
struct Level {
    const T* f;
    const T* derivative;  // of degree d - 1, with the highest coefficient 1
    int32_t d;

    int32_t equations() const { return 2 * d - 1; }  // those of f', then those of f, without the highest coefficients
    int32_t NullVector(int32_t k, double* sigma, Factors<T>* factors) const;
    int32_t Divide(Factors<T>* factors) const;
    double Residual(Factors<T>& factors, const double* weights, T* residual) const;
    int32_t Refine(Factors<T>* factors, double* least) const;
};

// The least singular value of the matrix of f' u - f v, and u and v as its vector, not yet scaled.
template <class T>
int32_t Level<T>::NullVector(int32_t k, double* sigma, Factors<T>* factors) const {
    const int32_t rows = d + k;
    const int32_t columns = 2 * k + 1;
    const std::size_t width = Count(columns);
    Scratch<T> matrix(Count(rows) * width, Scratch<T>::kZeroed);
    Scratch<T> right(width * width);
    Scratch<double> s(width);
    if (!matrix || !right || !s) return kOutOfMemory;
    ShiftedColumns(derivative, d, k + 1, matrix.data(), columns, 0, 0);
    ShiftedColumns(f, d + 1, k, matrix.data(), columns, 0, k + 1);
    const int32_t status = SvdCore(matrix.data(), rows, columns, matrix.data(), s.data(), right.data(), false);
    if (status != kOk) return status;
    *sigma = s[width - 1];
    for (std::size_t i = 0; i < width; ++i) factors->u()[i] = right[i * width + width - 1];  // v follows u
    return kOk;
}

// g of f = g u.
template <class T>
int32_t Level<T>::Divide(Factors<T>* factors) const {
    const int32_t columns = d - factors->k + 1;
    Scratch<T> matrix(Count(d + 1) * Count(columns), Scratch<T>::kZeroed);
    Scratch<T> right(Count(d + 1));
    Scratch<double> weights(Count(d + 1));
    if (!matrix || !right || !weights) return kOutOfMemory;
    ShiftedColumns(factors->u(), factors->k + 1, columns, matrix.data(), columns, 0, 0);
    for (int32_t i = 0; i <= d; ++i) {
        right[Count(i)] = f[i];
        weights[Count(i)] = RowWeight(f[i]);
    }
    return WeightedRefinedLS(matrix.data(), d + 1, columns, right.data(), weights.data(), factors->g());
}

// g v - f' and g u - f; the largest of them by weight.
template <class T>
double Level<T>::Residual(Factors<T>& factors, const double* weights, T* residual) const {
    const int32_t k = factors.k;
    const auto subtract_product = [&](const T* factor, int32_t degree, const T* product, T* to) {
        for (int32_t i = 1; i <= d - k + degree; ++i) {
            T sum = -product[i];
            for (int32_t j = std::max(0, i - degree); j <= std::min(i, d - k); ++j)
                sum += factors.g()[j] * factor[i - j];
            to[i - 1] = sum;
        }
    };
    subtract_product(factors.v(), k - 1, derivative, residual);
    subtract_product(factors.u(), k, f, residual + (d - 1));
    double largest = 0.0;
    for (int32_t i = 0; i < equations(); ++i) {
        const double size = weights[i] * Modulus(residual[i]);
        if (!(size <= largest)) largest = size;
        if (std::isnan(largest)) break;
    }
    return largest;
}

// Gauss-Newton iteration for g, u and v, as long as the residual falls.
template <class T>
int32_t Level<T>::Refine(Factors<T>* factors, double* least) const {
    constexpr int32_t kMostSteps = 200;
    const int32_t k = factors->k;
    const int32_t rest = d - k;  // the degree of g
    const int32_t rows = equations();
    const int32_t columns = d + k - 1;
    Factors<T> next(d, k);
    Scratch<double> weights(Count(rows));
    Scratch<T> residual(Count(rows));
    Scratch<T> step(Count(columns));
    if (!next || !weights || !residual || !step) return kOutOfMemory;
    for (int32_t i = 1; i < d; ++i) weights[Count(i - 1)] = RowWeight(derivative[i]);
    for (int32_t i = 1; i <= d; ++i) weights[Count(d - 1 + i - 1)] = RowWeight(f[i]);

    *least = Residual(*factors, weights.data(), residual.data());
    for (int32_t pass = 0; pass < kMostSteps; ++pass) {
        Scratch<T> jacobian(Count(rows) * Count(columns), Scratch<T>::kZeroed);
        if (!jacobian) return kOutOfMemory;
        // The unknowns are those of g, u, v below their highest coefficients, as are the equations.
        ShiftedColumns(factors->v(), k, rest, jacobian.data(), columns, 0, 0);
        ShiftedColumns(factors->u(), k + 1, rest, jacobian.data(), columns, d - 1, 0);
        ShiftedColumns(factors->g(), rest + 1, k, jacobian.data(), columns, d - 1, rest);
        ShiftedColumns(factors->g(), rest + 1, k - 1, jacobian.data(), columns, 0, rest + k);
        const int32_t status =
            WeightedRefinedLS(jacobian.data(), rows, columns, residual.data(), weights.data(), step.data());
        if (status != kOk) return status;
        const T* change = step.data();
        const auto apply = [&](const T* from, int32_t degree, T* to) {
            to[0] = from[0];
            for (int32_t i = 1; i <= degree; ++i) to[i] = from[i] - *change++;
        };
        apply(factors->g(), rest, next.g());
        apply(factors->u(), k, next.u());
        apply(factors->v(), k - 1, next.v());
        const double size = Residual(next, weights.data(), residual.data());
        if (!(size < *least)) return kOk;
        *least = size;
        std::swap(factors->all, next.all);
    }
    return kOk;
}

// What is asked of a divisor; it only ever grows stricter.
struct Thresholds {
    double singular_value;
    double residual;
};

// The square-free part u of f, as the factor of least degree that is accepted, and what it leaves, g.
template <class T>
int32_t SquareFreePart(const Level<T>& level, Thresholds* thresholds, Scratch<T>* u, int32_t* u_degree, Scratch<T>* g) {
    constexpr double kFall = 5e-5;     // of a singular value against that of the degree before
    constexpr double kMargin = 100.0;  // of the next level against this one
    const int32_t d = level.d;
    double largest = 0.0;
    for (int32_t i = 0; i <= d; ++i) largest = std::max(largest, Modulus(level.f[i]));
    double sigma = 0.0;
    for (int32_t k = 1; k < d; ++k) {
        Factors<T> factors(d, k);
        if (!factors) return kOutOfMemory;
        const double former = sigma;
        if (const int32_t status = level.NullVector(k, &sigma, &factors)) return status;
        if (sigma >= largest * thresholds->singular_value && former * kFall <= sigma) continue;
        if (!MakeMonic(factors.u(), k) || !MakeMonic(factors.v(), k - 1)) continue;
        if (const int32_t status = level.Divide(&factors)) return status;
        if (!MakeMonic(factors.g(), d - k)) continue;
        double residual = 0.0;
        if (const int32_t status = level.Refine(&factors, &residual)) return status;
        if (!(residual < thresholds->residual)) continue;

        thresholds->residual = std::min(thresholds->residual, kMargin * residual);
        thresholds->singular_value = std::min(thresholds->singular_value, kMargin * sigma / largest);
        std::copy_n(factors.u(), k + 1, u->data());
        std::copy_n(factors.g(), d - k + 1, g->data());
        *u_degree = k;
        return kOk;
    }
    std::copy_n(level.f, d + 1, u->data());  // no root is multiple
    *u_degree = d;
    return kOk;
}

int32_t Nearest(const Complex* roots, int32_t count, Complex z) {
    int32_t nearest = 0;
    for (int32_t i = 1; i < count; ++i)
        if (SquaredModulus(roots[i] - z) < SquaredModulus(roots[nearest] - z)) nearest = i;
    return nearest;
}

}  // namespace

template <class T>
int32_t RootStructure(const T* f, int32_t degree, double tol, Complex* roots, int32_t* multiplicities, int32_t* count) {
    constexpr double kSingularValue = 100.0;  // times tol
    const std::size_t size = Count(degree) + 1;
    Scratch<T> current(size);
    Scratch<T> next(size);
    Scratch<T> derivative(size);
    Scratch<T> u(size);
    Scratch<Complex> level_roots(size);
    if (!current || !next || !derivative || !u || !level_roots) return kOutOfMemory;
    std::copy_n(f, size, current.data());
    Thresholds thresholds{kSingularValue * tol, tol};
    *count = 0;
    for (int32_t d = degree; d >= 1;) {
        MakeMonic(current.data(), d);
        for (int32_t i = 0; i < d; ++i) derivative[Count(i)] = FromReal<T>(d - i) * current[Count(i)];
        MakeMonic(derivative.data(), d - 1);
        int32_t k = 0;
        const Level<T> level{current.data(), derivative.data(), d};
        if (const int32_t status = SquareFreePart(level, &thresholds, &u, &k, &next)) return status;
        if (const int32_t status = CompanionRoots(u.data(), k, level_roots.data())) return status;
        const int32_t repeats = k == 1 ? d : 1;  // a single root accounts for all that is left
        if (*count == 0) {
            *count = k;
            std::copy_n(level_roots.data(), k, roots);
            std::fill_n(multiplicities, k, repeats);
        } else {
            for (int32_t i = 0; i < k; ++i) multiplicities[Nearest(roots, *count, level_roots[Count(i)])] += repeats;
        }
        if (k == 1) break;
        d -= k;
        std::swap(current, next);
    }
    return kOk;
}

template bool MakeMonic(double*, int32_t);
template bool MakeMonic(Complex*, int32_t);
template double RowWeight(double);
template double RowWeight(Complex);
template int32_t CompanionRoots(const double*, int32_t, Complex*);
template int32_t CompanionRoots(const Complex*, int32_t, Complex*);
template int32_t RootStructure(const double*, int32_t, double, Complex*, int32_t*, int32_t*);
template int32_t RootStructure(const Complex*, int32_t, double, Complex*, int32_t*, int32_t*);

}  // namespace krnumer
