#include "linalg/triangular_vectors.h"

#include <algorithm>
#include <cmath>
#include <limits>

#include "frame/numeric.h"
#include "frame/scratch.h"
#include "frame/status.h"
#include "linalg/element.h"
#include "linalg/factor_kernels.h"

namespace krnumer {

namespace {

// What stands in for a zero pivot in a matrix of this norm.
double SmallestPivot(double norm) {
    return std::max(kEpsilon * norm, std::numeric_limits<double>::min());
}

// Scales what is known of a vector, x[i .. en], when its last component grew so large that the next step could
// overflow.
template <class T>
void Restrain(double size, std::ptrdiff_t i, std::ptrdiff_t en, T* x) {
    if (!(kEpsilon * size * size > 1.0)) return;
    for (std::ptrdiff_t j = i; j <= en; ++j) x[j] = x[j] / size;
}

// Several sums side by side, since a single one would have to wait for every addition.
template <class T>
T Dot(const T* a, const T* b, std::ptrdiff_t count) {
    constexpr std::ptrdiff_t kLanes = 8;
    T lanes[kLanes] = {};
    std::ptrdiff_t k = 0;
    for (; k + kLanes <= count; k += kLanes)
        for (std::ptrdiff_t q = 0; q < kLanes; ++q) lanes[q] += a[k + q] * b[k + q];
    T sum{};
    for (; k < count; ++k) sum += a[k] * b[k];
    for (const T lane : lanes) sum += lane;
    return sum;
}

class BackSubstitution {
  public:
    BackSubstitution(const RealHessenberg& schur, const Complex* w)
        : h_(schur.h), n_(schur.n), w_(w), smallest_(SmallestPivot(schur.norm)) {}

    // The eigenvector of the real eigenvalue w[en] in x[0 .. en].
    void SolveReal(std::ptrdiff_t en, double* x) {
        const double eigenvalue = w_[en].re;
        x[en] = 1.0;
        std::ptrdiff_t m = en;  // x is known from here on
        double corner = 0.0, residual_below = 0.0;
        for (std::ptrdiff_t i = en - 1; i >= 0; --i) {
            const double* row = Row(i);
            const double diagonal = row[i] - eigenvalue;
            const double residual = Dot(row + m, x + m, en - m + 1);
            if (w_[i].im < 0.0) {  // the second row of a block: both are solved at the first
                corner = diagonal;
                residual_below = residual;
                continue;
            }
            m = i;
            if (w_[i].im == 0.0) {
                x[i] = -residual / (diagonal != 0.0 ? diagonal : smallest_);
            } else {
                const double above = row[i + 1];
                const double below = Row(i + 1)[i];
                const double distance = w_[i].re - eigenvalue;
                const double determinant = distance * distance + w_[i].im * w_[i].im;
                const double t = (above * residual_below - corner * residual) / determinant;
                x[i] = t;
                x[i + 1] = std::fabs(above) > std::fabs(corner) ? (-residual - diagonal * t) / above
                                                                : (-residual_below - below * t) / corner;
            }
            Restrain(std::fabs(x[i]), i, en, x);
        }
    }

    // The eigenvector of the pair w[en - 1], w[en] in x + i y, for the eigenvalue with positive imaginary part.
    void SolvePair(std::ptrdiff_t en, double* x, double* y) {
        const std::ptrdiff_t na = en - 1;
        const double p = w_[en].re;
        const double q = w_[en].im;
        const double* last = Row(en);
        const double* upper = Row(na);
        if (std::fabs(last[na]) > std::fabs(upper[en])) {
            x[na] = q / last[na];
            y[na] = -(last[en] - p) / last[na];
        } else {
            const Complex z = Complex{0.0, -upper[en]} / Complex{upper[na] - p, q};
            x[na] = z.re;
            y[na] = z.im;
        }
        x[en] = 0.0;
        y[en] = 1.0;
        std::ptrdiff_t m = na;
        double corner = 0.0;
        Complex residual_below{};
        for (std::ptrdiff_t i = en - 2; i >= 0; --i) {
            const double* row = Row(i);
            const double diagonal = row[i] - p;
            const Complex residual{Dot(row + m, x + m, en - m + 1), Dot(row + m, y + m, en - m + 1)};
            if (w_[i].im < 0.0) {
                corner = diagonal;
                residual_below = residual;
                continue;
            }
            m = i;
            Complex z;
            if (w_[i].im == 0.0) {
                z = -residual / Complex{diagonal, q};
            } else {
                const double above = row[i + 1];
                const double below = Row(i + 1)[i];
                const double distance = w_[i].re - p;
                Complex determinant{distance * distance + w_[i].im * w_[i].im - q * q, 2.0 * distance * q};
                if (determinant == Complex{})
                    determinant.re = smallest_ * (std::fabs(diagonal) + std::fabs(q) + std::fabs(above) +
                                                  std::fabs(below) + std::fabs(corner));
                z = (residual_below * above - residual * Complex{corner, q}) / determinant;
                const Complex next = std::fabs(above) > std::fabs(corner) + std::fabs(q)
                                         ? (-residual - z * Complex{diagonal, q}) / above
                                         : (-residual_below - z * below) / Complex{corner, q};
                x[i + 1] = next.re;
                y[i + 1] = next.im;
            }
            x[i] = z.re;
            y[i] = z.im;
            const double size = std::max(std::fabs(z.re), std::fabs(z.im));
            Restrain(size, i, en, x);
            Restrain(size, i, en, y);
        }
    }

  private:
    const double* Row(std::ptrdiff_t i) const { return h_ + i * n_; }

    const double* h_;
    std::ptrdiff_t n_;
    const Complex* w_;
    double smallest_;  // stands in for a zero pivot
};

// The eigenvector of the eigenvalue w[en] of a triangular matrix in x[0 .. en].
void SolveTriangular(const ComplexHessenberg& schur, const Complex* w, std::ptrdiff_t en, Complex* x) {
    x[en] = {1.0, 0.0};
    for (std::ptrdiff_t i = en - 1; i >= 0; --i) {
        const Complex sum = Dot(schur.h + i * schur.n + i + 1, x + i + 1, en - i);
        Complex pivot = w[en] - w[i];
        if (pivot == Complex{}) pivot.re = SmallestPivot(schur.norm);
        x[i] = sum / pivot;
        Restrain(SumOfParts(x[i]), i, en, x);
    }
}

// Row j of h = x[0 .. extent], and zeros.
template <class Hessenberg, class T>
void StoreRow(const Hessenberg& schur, const T* x, std::ptrdiff_t extent, std::ptrdiff_t j) {
    T* const row = schur.h + j * schur.n;
    std::copy_n(x, extent + 1, row);
    std::fill(row + extent + 1, row + schur.n, T{});
}

// Multiplies the vectors, rows j of h up to extent(j), by the transformation, several at a time. Only its rows and
// columns from low to high are other than those of the unit matrix.
template <class T>
class Transformation {
  public:
    template <class Hessenberg>
    explicit Transformation(const Hessenberg& schur)
        : h_(schur.h), columns_(schur.columns), n_(schur.n), low_(schur.low), end_(schur.high + 1) {}

    template <class Extent>
    int32_t Apply(Extent extent) {
        if (low_ >= end_) return kOk;
        if (!negated_.Allocate(static_cast<std::size_t>(kGroup * n_))) return kOutOfMemory;
        const auto end_of = [&](std::ptrdiff_t j) { return std::min(extent(j) + 1, end_); };
        for (std::ptrdiff_t first = 0; first < n_; first += kGroup) {
            const std::ptrdiff_t count = std::min(kGroup, n_ - first);
            group_ = h_ + first * n_;
            std::transform(group_, group_ + count * n_, negated_.data(), [](T x) { return -x; });
            for (std::ptrdiff_t i = 0; i < count; ++i) std::fill(group_ + i * n_ + low_, group_ + i * n_ + end_, T{});
            const std::ptrdiff_t common = std::max(end_of(first), low_);
            AddColumns(0, count, low_, common);
            for (std::ptrdiff_t i = 1; i < count; ++i) AddColumns(i, 1, common, end_of(first + i));
        }
        return kOk;
    }

  private:
    static constexpr std::ptrdiff_t kGroup = 16;

    // To each of the rows, from `row` of the group on, columns first .. end - 1 times its elements.
    void AddColumns(std::ptrdiff_t row, std::ptrdiff_t rows, std::ptrdiff_t first, std::ptrdiff_t end) {
        if (first >= end) return;
        const auto n = static_cast<std::size_t>(n_);
        SubtractProduct(ProductOperands<T>{.c = group_ + row * n_ + low_,
                                           .c_row = {n},
                                           .a = negated_.data() + row * n_ + first,
                                           .a_row = n,
                                           .a_term = {1},
                                           .b = columns_ + first * n_ + low_,
                                           .b_term = {n},
                                           .rows = static_cast<std::size_t>(rows),
                                           .columns = static_cast<std::size_t>(end_ - low_),
                                           .terms = static_cast<std::size_t>(end - first)});
    }

    T* h_;
    const T* columns_;
    std::ptrdiff_t n_;
    std::ptrdiff_t low_;
    std::ptrdiff_t end_;
    T* group_ = nullptr;
    Scratch<T> negated_;  // the rows of the group
};

}  // namespace

int32_t SchurVectors(const RealHessenberg& schur, const Complex* w) {
    const std::ptrdiff_t n = schur.n;
    Scratch<double> vectors(static_cast<std::size_t>(2 * n));
    if (!vectors) return kOutOfMemory;
    BackSubstitution substitution(schur, w);
    double* x = vectors.data();
    double* y = x + n;
    for (std::ptrdiff_t en = n - 1; en >= 0; --en) {
        if (w[en].im == 0.0) {
            substitution.SolveReal(en, x);
            StoreRow(schur, x, en, en);
        } else {
            substitution.SolvePair(en, x, y);
            StoreRow(schur, x, en, en - 1);
            StoreRow(schur, y, en, en);
            --en;
        }
    }
    return Transformation<double>(schur).Apply([w](std::ptrdiff_t j) { return w[j].im > 0.0 ? j + 1 : j; });
}

int32_t SchurVectors(const ComplexHessenberg& schur, const Complex* w) {
    const std::ptrdiff_t n = schur.n;
    Scratch<Complex> x(static_cast<std::size_t>(n));
    if (!x) return kOutOfMemory;
    for (std::ptrdiff_t en = n - 1; en >= 0; --en) {
        SolveTriangular(schur, w, en, x.data());
        StoreRow(schur, x.data(), en, en);
    }
    return Transformation<Complex>(schur).Apply([](std::ptrdiff_t j) { return j; });
}

}  // namespace krnumer
