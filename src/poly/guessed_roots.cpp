#include "poly/guessed_roots.h"

#include <algorithm>
#include <cmath>

#include "frame/numeric.h"
#include "frame/scratch.h"
#include "frame/status.h"

namespace krnumer {

namespace {

double Horner(const double* c, int32_t n, double x) {
    double value = 0.0;
    for (int32_t k = n - 1; k >= 0; --k) value = value * x + c[k];
    return value;
}

}  // namespace

double NewtonRoot(const double* c, const double* derivative, int32_t n, double guess, int32_t limit, double tol) {
    constexpr double kLongest = 5.0;  // times the step before
    constexpr int32_t kStalled = 5;   // steps without a smaller |p|
    double x = guess;
    double p = Horner(c, n, x);
    if (p == 0.0) return x;
    double slope = Horner(derivative, n - 1, x);
    double step = slope == 0.0 ? 1.0 : p / slope;
    double length = std::fabs(step);
    double best = x;
    double least = 1e30;
    int32_t stalled = 0;
    for (int32_t pass = 0; pass < limit; ++pass) {
        p = Horner(c, n, x);
        if (p == 0.0) return x;
        if (std::fabs(p) < least) {
            least = std::fabs(p);
            best = x;
            stalled = 0;
        }
        slope = Horner(derivative, n - 1, x);
        if (slope != 0.0) {
            const double newton = p / slope;
            if (std::fabs(newton) < kLongest * length) {
                step = newton;
                length = std::fabs(step);
            }
        }
        if (x != 0.0 && (length / std::fabs(x) < tol || stalled == kStalled)) break;
        x -= step;
        ++stalled;
    }
    return best;
}

bool BairstowPair(const double* c, int32_t n, const Complex guesses[2], int32_t limit, double tol, double* work,
                  Complex roots[2]) {
    // The factor x^2 - u x - v.
    double u = guesses[0].re + guesses[1].re;
    double v = -(guesses[0].re * guesses[1].re - guesses[0].im * guesses[1].im);
    double change_u = std::fabs(u) * 1e12 < std::fabs(v) ? 1.2 : 0.1;
    double change_v = std::fabs(u) * 1e-12 > std::fabs(v) ? 1.2 : 0.1;
    double* const b = work;
    double* const d = work + n;
    const auto relative = [](double step, double before) {
        return before == 0.0 && step == 0.0 ? 0.0 : std::fabs(step / before);
    };
    for (int32_t pass = 0; pass < limit; ++pass) {
        // Synthetic division by the factor, twice; b[1], b[0] are the remainder, d holds the derivatives of b.
        b[n - 1] = c[n - 1];
        b[n - 2] = c[n - 2] + u * b[n - 1];
        d[n - 1] = b[n - 1];
        d[n - 2] = b[n - 2] + u * d[n - 1];
        for (int32_t k = n - 3; k >= 0; --k) {
            b[k] = c[k] + u * b[k + 1] + v * b[k + 2];
            d[k] = b[k] + u * d[k + 1] + v * d[k + 2];
        }
        const double determinant = d[2] * d[2] - d[1] * d[3];
        double step_u = 1.0;
        double step_v = 1.0;
        if (determinant != 0.0) {
            step_u = (d[3] * b[0] - d[2] * b[1]) / determinant;
            step_v = (d[1] * b[1] - d[2] * b[0]) / determinant;
        }
        const double next_u = relative(step_u, u);
        const double next_v = relative(step_v, v);
        const bool settled = next_u < tol && next_v < tol;
        if (!settled && !(next_u < change_u && next_v < change_v)) break;
        u += step_u;
        v += step_v;
        if (settled) break;
        change_u = next_u;
        change_v = next_v;
    }
    const double discriminant = u * u + 4.0 * v;
    if (discriminant < 0.0) {
        const double im = std::sqrt(-discriminant) / 2.0;
        roots[0] = {u / 2.0, im};
        roots[1] = {u / 2.0, -im};
        return false;
    }
    const double root = std::sqrt(discriminant);
    roots[0] = {(root + u) / 2.0, 0.0};
    roots[1] = {(u - root) / 2.0, 0.0};
    return true;
}

int32_t RootsFromGuesses(const double* c, int32_t n, const double* real_guesses, int32_t real_count, int32_t real_limit,
                         double real_tol, const Complex* pair_guesses, int32_t pair_count, int32_t pair_limit,
                         double pair_tol, Complex* roots) {
    constexpr int32_t kLeastForPairs = 4;
    if (n < 1) return kWarnEmptyPolynomial;
    Scratch<double> work(2 * Count(n));
    Scratch<Complex> complex_roots(Count(pair_count) + 1);
    if (!work || !complex_roots) return kOutOfMemory;

    double* const derivative = work.data();
    for (int32_t k = 1; k < n; ++k) derivative[k - 1] = k * c[k];
    for (int32_t i = 0; i < real_count; ++i)
        roots[i] = {NewtonRoot(c, derivative, n, real_guesses[i], real_limit, real_tol), 0.0};

    Complex* next = roots + real_count;
    if (n < kLeastForPairs) {
        std::copy_n(pair_guesses, pair_count, next);
        return kOk;
    }
    Complex* const end = next + pair_count;
    Complex* next_complex = complex_roots.data();
    for (int32_t i = 0; i < pair_count; i += 2) {
        const Complex guesses[2] = {pair_guesses[i], pair_guesses[std::min(i + 1, pair_count - 1)]};
        Complex pair[2];
        if (BairstowPair(c, n, guesses, pair_limit, pair_tol, work.data(), pair)) {
            for (const Complex& root : pair)
                if (next != end) *next++ = root;
        } else {
            next_complex = std::copy_n(pair, 2, next_complex);
        }
    }
    std::copy_n(complex_roots.data(), std::min(next_complex - complex_roots.data(), end - next), next);
    return kOk;
}

}  // namespace krnumer
