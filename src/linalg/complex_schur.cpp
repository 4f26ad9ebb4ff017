#include "linalg/complex_schur.h"

#include <algorithm>
#include <cmath>

#include "frame/numeric.h"
#include "frame/status.h"
#include "linalg/element.h"
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

class Iteration {
  public:
    Iteration(const ComplexHessenberg& problem, Complex* w, Complex* work)
        : h_(problem.h),
          n_(problem.n),
          low_(problem.low),
          columns_(problem.columns),
          norm_(problem.norm),
          w_(w),
          cosines_(work),
          sines_(reinterpret_cast<double*>(work + problem.n)) {}

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

  private:
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
        ReduceRows(l, en);
        const Complex last = At(en, en);
        const Complex phase = last.im != 0.0 ? last / Hypotenuse(last.re, last.im) : Complex{1.0, 0.0};
        if (last.im != 0.0) {
            At(en, en) = {Hypotenuse(last.re, last.im), 0.0};
            for (std::ptrdiff_t j = en + 1; j < LastColumn(en); ++j) At(en, j) = Conjugate(phase) * At(en, j);
        }
        RotateColumns(l, en);
        if (last.im != 0.0) {
            for (std::ptrdiff_t i = FirstRow(l); i <= en; ++i) At(i, en) *= phase;
            if (columns_ != nullptr)
                for (std::ptrdiff_t i = 0; i < n_; ++i) columns_[en * n_ + i] *= phase;
        }
    }

    // The rows and columns that the eigenvalues alone need are those of the block.
    std::ptrdiff_t LastColumn(std::ptrdiff_t en) const { return columns_ != nullptr ? n_ : en + 1; }
    std::ptrdiff_t FirstRow(std::ptrdiff_t l) const { return columns_ != nullptr ? 0 : l; }

    // Makes the block triangular by rotations of rows i - 1 and i.
    void ReduceRows(std::ptrdiff_t l, std::ptrdiff_t en) {
        for (std::ptrdiff_t i = l + 1; i <= en; ++i) {
            const Complex diagonal = At(i - 1, i - 1);
            const double below = At(i, i - 1).re;
            const double length = Hypotenuse(Hypotenuse(diagonal.re, diagonal.im), below);
            const Complex c = diagonal / length;
            const double s = below / length;
            cosines_[i] = c;
            sines_[i] = s;
            At(i - 1, i - 1) = {length, 0.0};
            At(i, i - 1) = {};
            Complex* upper = &At(i - 1, 0);
            Complex* lower = &At(i, 0);
            for (std::ptrdiff_t j = i; j < LastColumn(en); ++j) {
                const Complex y = upper[j], z = lower[j];
                upper[j] = Conjugate(c) * y + s * z;
                lower[j] = c * z - s * y;
            }
        }
    }

    // The inverse rotations from the right: row by row for the matrix, and on the rows that hold the columns of the
    // transformation.
    void RotateColumns(std::ptrdiff_t l, std::ptrdiff_t en) {
        for (std::ptrdiff_t i = FirstRow(l); i <= en; ++i) {
            Complex* row = &At(i, 0);
            for (std::ptrdiff_t j = std::max(l + 1, i); j <= en; ++j) Rotate(j, &row[j - 1], &row[j]);
        }
        if (columns_ == nullptr) return;
        for (std::ptrdiff_t j = l + 1; j <= en; ++j) {
            Complex* left = columns_ + (j - 1) * n_;
            for (std::ptrdiff_t i = 0; i < n_; ++i) Rotate(j, &left[i], &left[n_ + i]);
        }
    }

    void Rotate(std::ptrdiff_t j, Complex* left, Complex* right) const {
        const Complex y = *left, z = *right;
        *left = cosines_[j] * y + sines_[j] * z;
        *right = Conjugate(cosines_[j]) * z - sines_[j] * y;
    }

    Complex* h_;
    std::ptrdiff_t n_;
    std::ptrdiff_t low_;
    Complex* columns_;
    double norm_;
    Complex* w_;
    Complex* cosines_;
    double* sines_;
    Complex shifted_{};  // sum of all shifts, taken off the diagonal
};

}  // namespace

int32_t ReduceToComplexSchur(const ComplexHessenberg& problem, Complex* w, Complex* work) {
    for (std::ptrdiff_t i = 0; i < problem.n; ++i)
        if (i < problem.low || i > problem.high) w[i] = problem.h[i * (problem.n + 1)];
    Iteration iteration(problem, w, work);
    for (std::ptrdiff_t en = problem.high; en >= problem.low; --en)
        if (const int32_t status = iteration.Converge(en)) return status;
    return kOk;
}

}  // namespace krnumer
