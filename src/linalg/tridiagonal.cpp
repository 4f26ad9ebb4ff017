#include "linalg/tridiagonal.h"

#include <algorithm>
#include <cmath>

#include "frame/numeric.h"
#include "frame/status.h"

namespace krnumer {

namespace {

struct Rotation {
    double c;
    double s;
    double length;  // of (g, f), which the rotation turns into (length, 0)
};

// By the ratio of the smaller to the larger.
Rotation MakeRotation(double g, double f) {
    if (f == 0.0 && g == 0.0) return {1.0, 0.0, 0.0};
    if (std::fabs(f) >= std::fabs(g)) {
        const double ratio = g / f;
        const double root = std::sqrt(ratio * ratio + 1.0);
        const double s = 1.0 / root;
        return {ratio * s, s, f * root};
    }
    const double ratio = f / g;
    const double root = std::sqrt(ratio * ratio + 1.0);
    const double c = 1.0 / root;
    return {c, ratio * c, g * root};
}

// One sweep from m up to l, with the shift from the top 2 by 2 minor.
void SweepUp(std::ptrdiff_t l, std::ptrdiff_t m, double* d, double* e, VectorRows vectors, double* cosines,
             double* sines) {
    const double half = (d[l + 1] - d[l]) / (2.0 * e[l]);
    double g = d[m] - d[l] + e[l] / (half + std::copysign(Hypotenuse(half, 1.0), half));
    double c = 1.0, s = 1.0, p = 0.0;
    for (std::ptrdiff_t i = m - 1; i >= l; --i) {
        const double f = s * e[i];
        const double b = c * e[i];
        const Rotation rotation = MakeRotation(g, f);
        c = rotation.c;
        s = rotation.s;
        e[i + 1] = rotation.length;
        g = d[i + 1] - p;
        const double r = (d[i] - g) * s + 2.0 * c * b;
        p = s * r;
        d[i + 1] = g + p;
        g = c * r - b;
        if (vectors) {
            cosines[m - 1 - i] = c;
            sines[m - 1 - i] = s;
        }
    }
    d[l] -= p;
    e[l] = g;
    e[m] = 0.0;
    if (vectors) RotateChain(vectors, m, -1, m - l, cosines, sines);
}

}  // namespace

int32_t DiagonaliseTridiagonal(std::ptrdiff_t n, double* d, double* e, VectorRows vectors, double* work,
                               Negligible negligible) {
    e[n - 1] = 0.0;
    double* const sines = vectors ? work + n : nullptr;
    double largest = 0.0;
    const auto is_negligible = [&](std::ptrdiff_t m) {
        if (negligible == Negligible::kAgainstLargest) return std::fabs(e[m]) <= kEpsilon * largest;
        const double neighbours = std::fabs(d[m]) + std::fabs(d[m + 1]);
        return std::fabs(e[m]) + neighbours == neighbours;
    };
    for (std::ptrdiff_t l = 0; l < n; ++l) {
        largest = std::max(largest, std::fabs(d[l]) + std::fabs(e[l]));
        for (int32_t sweeps = 0;; ++sweeps) {
            std::ptrdiff_t m = l;
            while (m < n - 1 && !is_negligible(m)) ++m;
            if (m == l) break;
            if (sweeps == kQlIterationLimit) return kNoConvergence;
            SweepUp(l, m, d, e, vectors, work, sines);
        }
    }
    return kOk;
}

}  // namespace krnumer
