#include "linalg/complex_schur.h"

#include <algorithm>
#include <cmath>

#include "frame/numeric.h"
#include "frame/status.h"
#include "linalg/delayed_sweeps.h"
#include "linalg/element.h"
#include "linalg/rotation_chain.h"
#include "linalg/rotations.h"

namespace krnumer {

namespace {

// The root with non-negative real part.
Complex SquareRoot(Complex z) {
    const double modulus = Hypotenuse(z.re, z.im);
    if (modulus == 0.0) return {};
    const double larger = std::sqrt(0.5 * (modulus + std::fabs(z.re)));
    const double smaller = 0.5 * z.im / larger;
    if (z.re >= 0.0) return {larger, smaller};
    return {std::fabs(smaller), std::copysign(larger, z.im)};
}

// What a sweep does to the transformation.
struct SingleShiftSweep {
    using Link = ComplexRotation;

    RotationChain chain;
    std::ptrdiff_t first;
    Complex phase;  // of the last column
    bool has_phase;

    void ApplyTo(Complex* columns, std::ptrdiff_t stride, std::ptrdiff_t width) const {
        RotateTransposedByChain(chain, columns + first * stride, stride, width);
        if (!has_phase) return;
        Complex* const last = columns + (first + chain.count) * stride;
        for (std::ptrdiff_t i = 0; i < width; ++i) last[i] *= phase;
    }
};

class Iteration {
  public:
    Iteration(const ComplexHessenberg& problem, Complex* w)
        : h_(problem.h), n_(problem.n), low_(problem.low), columns_(problem.columns), norm_(problem.norm), w_(w) {}

    int32_t Run(std::ptrdiff_t high) {
        if (!sweeps_.Start(columns_, n_)) return kOutOfMemory;
        for (std::ptrdiff_t en = high; en >= low_; --en)
            if (const int32_t status = Converge(en)) return status;
        sweeps_.Apply();
        return kOk;
    }

  private:
    // Sweeps until an eigenvalue separates at en.
    int32_t Converge(std::ptrdiff_t en) {
        for (int32_t sweeps = 0;; ++sweeps) {
            const std::ptrdiff_t l = Split(en);
            if (l == en) break;
            if (sweeps == kSingleShiftLimit) return kNoConvergence;
            Sweep(l, en, sweeps == 10 || sweeps == 20 ? ExceptionalShift(en) : BottomShift(en));
        }
        At(en, en) += shifted_;
        w_[en] = At(en, en);
        return kOk;
    }

    Complex& At(std::ptrdiff_t i, std::ptrdiff_t j) { return h_[i * n_ + j]; }

    // Where the unreduced block that ends at en begins.
    std::ptrdiff_t Split(std::ptrdiff_t en) {
        std::ptrdiff_t l = en;
        for (; l > low_; --l) {
            double s = SumOfParts(At(l - 1, l - 1)) + SumOfParts(At(l, l));
            if (s == 0.0) s = norm_;
            if (kEpsilon * s >= std::fabs(At(l, l - 1).re)) break;
        }
        return l;
    }

    // The eigenvalue of the bottom 2 by 2 minor that is closer to its last element.
    Complex BottomShift(std::ptrdiff_t en) {
        const Complex last = At(en, en);
        const Complex product = At(en - 1, en) * At(en, en - 1).re;
        if (product == Complex{}) return last;
        const Complex y = (At(en - 1, en - 1) - last) * 0.5;
        Complex z = SquareRoot(y * y + product);
        if (y.re * z.re + y.im * z.im < 0.0) z = -z;
        return last - product / (y + z);
    }

    Complex ExceptionalShift(std::ptrdiff_t en) {
        const double before = en - 2 >= low_ ? std::fabs(At(en - 1, en - 2).re) : 0.0;
        return {std::fabs(At(en, en - 1).re) + before, 0.0};
    }

    void Sweep(std::ptrdiff_t l, std::ptrdiff_t en, Complex shift) {
        for (std::ptrdiff_t i = low_; i <= en; ++i) At(i, i) -= shift;
        shifted_ += shift;
        const RotationChain chain = ReduceRows(l, en);
        const Complex last = At(en, en);
        const bool has_phase = last.im != 0.0;
        const Complex phase = has_phase ? last / Hypotenuse(last.re, last.im) : Complex{1.0, 0.0};
        if (has_phase) {
            At(en, en) = {Hypotenuse(last.re, last.im), 0.0};
            for (std::ptrdiff_t j = en + 1; j < LastColumn(en); ++j) At(en, j) = Conjugate(phase) * At(en, j);
        }
        RotateColumns(chain, l);
        if (has_phase)
            for (std::ptrdiff_t i = FirstRow(l); i <= en; ++i) At(i, en) *= phase;
        sweeps_.Add({chain, l, phase, has_phase});
    }

    // The rows and columns that the eigenvalues alone need are those of the block.
    std::ptrdiff_t LastColumn(std::ptrdiff_t en) const { return columns_ != nullptr ? n_ : en + 1; }
    std::ptrdiff_t FirstRow(std::ptrdiff_t l) const { return columns_ != nullptr ? 0 : l; }

    // Makes the block triangular. The rotations meet a few columns at once; the columns from `front` on wait until the
    // next rotation depends on them, or to the end.
    RotationChain ReduceRows(std::ptrdiff_t l, std::ptrdiff_t en) {
        constexpr std::ptrdiff_t kStrip = 16;
        ComplexRotation* const rotations = sweeps_.NextLinks();
        std::ptrdiff_t front = l;
        const auto advance = [&](std::ptrdiff_t done, std::ptrdiff_t to) {
            RotateRowsByChain({rotations, done}, &At(l, front), n_, to - front);
            front = to;
        };
        for (std::ptrdiff_t k = 0; k < en - l; ++k) {
            const std::ptrdiff_t i = l + k;
            if (i == front) advance(k, std::min(front + kStrip, LastColumn(en)));
            Complex* const upper = &At(i, 0);
            Complex* const lower = &At(i + 1, 0);
            const double below = lower[i].re;
            const double length = Hypotenuse(Hypotenuse(upper[i].re, upper[i].im), below);
            const Complex c = upper[i] / length;
            const double s = below / length;
            rotations[k] = {c, s};
            upper[i] = {length, 0.0};
            lower[i] = {};
            for (std::ptrdiff_t j = i + 1; j < front; ++j) {
                const Complex y = upper[j], z = lower[j];
                upper[j] = Conjugate(c) * y + s * z;
                lower[j] = c * z - s * y;
            }
        }
        advance(en - l, LastColumn(en));
        return {rotations, en - l};
    }

    // The inverse rotations from the right, on all rows down to the place of each.
    void RotateColumns(const RotationChain& chain, std::ptrdiff_t l) {
        const std::ptrdiff_t top = FirstRow(l);
        RotateColumnsByChain(chain, &At(top, l), n_, l + 1 - top);
        // Row l + k starts at rotation k - 1; a few rows are brought to the same one, then they go on together.
        constexpr std::ptrdiff_t kTogether = 16;
        for (std::ptrdiff_t k = 0; k < chain.count; k += kTogether) {
            const std::ptrdiff_t rows = std::min(kTogether, chain.count - k);
            const std::ptrdiff_t common = k + rows - 1;
            for (std::ptrdiff_t j = k; j < common; ++j)
                RotateColumnsByChain({chain.rotations + j, common - j}, &At(l + j + 1, l + j), n_, 1);
            RotateColumnsByChain({chain.rotations + common, chain.count - common}, &At(l + k + 1, l + common), n_,
                                 rows);
        }
    }

    Complex* h_;
    std::ptrdiff_t n_;
    std::ptrdiff_t low_;
    Complex* columns_;
    double norm_;
    Complex* w_;
    DelayedSweeps<Complex, SingleShiftSweep> sweeps_;
    Complex shifted_{};  // sum of all shifts, taken off the diagonal
};

}  // namespace

int32_t ReduceToComplexSchur(const ComplexHessenberg& problem, Complex* w) {
    for (std::ptrdiff_t i = 0; i < problem.n; ++i)
        if (i < problem.low || i > problem.high) w[i] = problem.h[i * (problem.n + 1)];
    return Iteration(problem, w).Run(problem.high);
}

}  // namespace krnumer
