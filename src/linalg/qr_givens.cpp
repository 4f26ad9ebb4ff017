#include <algorithm>
#include <cmath>
#include <utility>

#include "frame/numeric.h"
#include "frame/scratch.h"
#include "frame/status.h"
#include "linalg/qr.h"
#include "linalg/rotations.h"
#include "linalg/transpose.h"

namespace krnumer {
namespace {

// R, which starts as A, and the rotations gathered from the identity: Q transposed. Rows are walked, not columns.
struct Reduction {
    size_t m, n;
    double* r;
    double* gathered;

    double* Row(size_t i) const { return r + i * n; }
    double* GatheredRow(size_t i) const { return gathered + i * m; }
};

// Euclidean norm of column j. Scaled, so that it is 0 for a column of zeros only.
double ColumnNorm(const Reduction& a, size_t j) {
    bool only_zeros = true;
    double largest = 0.0;
    for (size_t i = 0; i < a.m; ++i) {
        only_zeros = only_zeros && a.Row(i)[j] == 0.0;
        largest = std::max(largest, std::fabs(a.Row(i)[j]));
    }
    if (only_zeros) return 0.0;
    double sum = 0.0;
    for (size_t i = 0; i < a.m; ++i) sum += (a.Row(i)[j] / largest) * (a.Row(i)[j] / largest);
    return largest * std::sqrt(sum);
}

// NaN is outside of every interval.
bool IsOutside(double x, double bound) {
    return !(x > -bound && x < bound);
}

// Works up each column from its bottom to the pivot row, annihilating elements by annihilate(i, j), which acts on rows
// i - 1 and i from column j on. The result is the number of pivots found.
template <class Annihilate>
size_t Reduce(const Reduction& a, Annihilate annihilate) {
    size_t pivot = 0;
    for (size_t j = 0; j < a.n && pivot < a.m; ++j) {
        const double norm = ColumnNorm(a, j);
        if (norm == 0.0) continue;
        // What the rotations of the earlier columns have left of a column of this norm by rounding.
        const double cut = static_cast<double>(j) * norm * kEpsilon / std::sqrt(static_cast<double>(a.m - pivot));
        bool has_pivot = IsOutside(a.Row(pivot)[j], cut);
        for (size_t i = a.m - 1; i > pivot; --i) {
            if (!IsOutside(a.Row(i)[j], cut)) continue;
            has_pivot = true;
            annihilate(i, j);
        }
        if (has_pivot) ++pivot;
        for (size_t i = pivot; i < a.m; ++i) a.Row(i)[j] = 0.0;
    }
    return pivot;
}

// cosine and sine that turn (a, b) into (sqrt(a^2 + b^2), 0).
std::pair<double, double> GivensRotation(double a, double b) {
    if (b == 0.0) return {1.0, 0.0};
    if (std::fabs(b) <= std::fabs(a)) {
        const double ratio = b / a, cosine = 1.0 / std::sqrt(1.0 + ratio * ratio);
        return {cosine, ratio * cosine};
    }
    const double ratio = a / b, sine = 1.0 / std::sqrt(1.0 + ratio * ratio);
    return {sine * ratio, sine};
}

// A rotation of two rows that are scaled by the roots of d1 and d2; the scales are updated.
struct FastRotation {
    enum class Type : uint8_t { kExchanging = 1, kKeeping = 2 } type = Type::kKeeping;
    double alpha = 0.0, beta = 0.0;

    FastRotation(double x1, double x2, double* d1, double* d2) {
        if (x2 == 0.0) return;
        alpha = -x1 / x2;
        beta = -alpha * *d2 / *d1;
        double gamma = -alpha * beta;
        if (gamma <= 1.0) {
            type = Type::kExchanging;
            *d1 = (1.0 + gamma) * std::exchange(*d2, (1.0 + gamma) * *d1);
        } else {
            alpha = 1.0 / alpha;
            beta = 1.0 / beta;
            gamma = 1.0 / gamma;
            *d1 *= 1.0 + gamma;
            *d2 *= 1.0 + gamma;
        }
    }

    void Apply(double* __restrict x, double* __restrict y, size_t count) const {
        if (type == Type::kExchanging) {
            for (size_t i = 0; i < count; ++i) {
                const double first = x[i] * beta + y[i];
                y[i] = y[i] * alpha + x[i];
                x[i] = first;
            }
        } else {
            for (size_t i = 0; i < count; ++i) {
                const double first = y[i] * beta + x[i];
                y[i] = x[i] * alpha + y[i];
                x[i] = first;
            }
        }
    }
};

size_t ReduceByGivens(const Reduction& a) {
    return Reduce(a, [&a](size_t i, size_t j) {
        double *const upper = a.Row(i - 1) + j, *const lower = a.Row(i) + j;
        const auto [cosine, sine] = GivensRotation(*upper, *lower);
        RotateRows(upper, lower, static_cast<std::ptrdiff_t>(a.n - j), cosine, sine);
        RotateRows(a.GatheredRow(i - 1), a.GatheredRow(i), static_cast<std::ptrdiff_t>(a.m), cosine, sine);
    });
}

// d: m elements for the squares of the scales.
size_t ReduceByFastGivens(const Reduction& a, double* d) {
    std::fill_n(d, a.m, 1.0);
    const size_t rank = Reduce(a, [&a, d](size_t i, size_t j) {
        double *const upper = a.Row(i - 1) + j, *const lower = a.Row(i) + j;
        const FastRotation rotation(*upper, *lower, &d[i - 1], &d[i]);
        rotation.Apply(upper, lower, a.n - j);
        rotation.Apply(a.GatheredRow(i - 1), a.GatheredRow(i), a.m);
    });
    for (size_t i = 0; i < a.m; ++i) {
        const double scale = 1.0 / std::sqrt(d[i]);
        for (size_t j = 0; j < a.n; ++j) a.Row(i)[j] *= scale;
        for (size_t j = 0; j < a.m; ++j) a.GatheredRow(i)[j] *= scale;
    }
    return rank;
}

// What the two methods have around them.
template <class Method>
int32_t QRByRotations(const double* a, int32_t m, int32_t n, double* q, double* r, int32_t* rank, Method reduce) {
    if (m < 1 || n < 1) return kEmptyInput;
    Scratch<double> gathered(Count(m) * Count(m), Scratch<double>::kZeroed);
    if (!gathered) return kOutOfMemory;
    for (size_t i = 0; i < Count(m); ++i) gathered[i * (Count(m) + 1)] = 1.0;
    if (r != a) std::copy_n(a, Count(m) * Count(n), r);
    *rank = static_cast<int32_t>(reduce(Reduction{Count(m), Count(n), r, gathered.data()}));
    return TransposeCore(gathered.data(), m, m, q);
}

}  // namespace

int32_t QRGivens(const double* a, int32_t m, int32_t n, double* q, double* r, int32_t* rank) {
    return QRByRotations(a, m, n, q, r, rank, ReduceByGivens);
}

int32_t QRFastGivens(const double* a, int32_t m, int32_t n, double* q, double* r, int32_t* rank) {
    Scratch<double> scales(Count(m));
    if (!scales) return kOutOfMemory;
    return QRByRotations(a, m, n, q, r, rank,
                         [&](const Reduction& reduction) { return ReduceByFastGivens(reduction, scales.data()); });
}

}  // namespace krnumer
