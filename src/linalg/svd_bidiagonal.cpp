#include "linalg/svd_bidiagonal.h"

#include <algorithm>
#include <cmath>

#include "frame/numeric.h"
#include "frame/status.h"

namespace krnumer {

namespace {

// The rotations of one sweep on one side, gathered so that they meet the vectors all at once.
class Sweep {
  public:
    // `work` has room for 2 n numbers where there are vectors, and is not looked at otherwise.
    Sweep(VectorRows vectors, double* work, std::ptrdiff_t n)
        : vectors_(vectors), c_(work), s_(vectors ? work + n : nullptr) {}

    void Set(std::ptrdiff_t j, double c, double s) {
        if (!vectors_) return;
        c_[j] = c;
        s_[j] = s;
    }

    void Apply(std::ptrdiff_t l, std::ptrdiff_t k) {
        if (vectors_) RotateChain(vectors_, l, 1, k - l, c_ + l, s_ + l);
    }

  private:
    VectorRows vectors_;
    double* c_;
    double* s_;
};

class Iteration {
  public:
    Iteration(const Bidiagonal& b, double norm, VectorRows left, VectorRows right, double* work)
        : w_(b.diagonal),
          e_(b.superdiagonal),
          norm_(norm),
          left_(left),
          right_(right),
          left_sweep_(left, work, b.n),
          right_sweep_(right, right ? work + 2 * b.n : nullptr, b.n) {}

    // Sweeps over the block that ends at k until w[k] is a singular value.
    int32_t Converge(std::ptrdiff_t k) {
        for (int32_t sweeps = 0;; ++sweeps) {
            const std::ptrdiff_t l = Split(k);
            if (l == k) break;
            if (sweeps == kSvdIterationLimit - 1) return kNoConvergence;
            SweepDown(l, k);
        }
        if (w_[k] < 0.0) {
            w_[k] = -w_[k];
            if (right_) {
                double* v = right_[k];
                for (std::ptrdiff_t q = 0; q < right_.length; ++q) v[q] = -v[q];
            }
        }
        return kOk;
    }

  private:
    // A band around zero that is absolute: of the width of rounding at the norm, and never below epsilon.
    bool Negligible(double x) const { return std::fabs(x) + norm_ - norm_ < kEpsilon; }

    // Where the block that ends at k begins.
    std::ptrdiff_t Split(std::ptrdiff_t k) {
        for (std::ptrdiff_t l = k; l > 0; --l) {
            if (Negligible(e_[l])) return l;
            if (Negligible(w_[l - 1])) {
                Cancel(l, k);
                return l;
            }
        }
        return 0;
    }

    // A zero on the diagonal at l - 1 lets the rest of its row be rotated away against the rows below. A bulge that
    // has become negligible is passed over; the ones behind it are still looked at.
    void Cancel(std::ptrdiff_t l, std::ptrdiff_t k) {
        double c = 0.0;
        double s = 1.0;
        for (std::ptrdiff_t i = l; i <= k; ++i) {
            const double f = s * e_[i];
            e_[i] = c * e_[i];
            if (std::fabs(f) + norm_ == norm_) continue;
            const double g = w_[i];
            w_[i] = Hypotenuse(f, g);
            const double inverse = 1.0 / w_[i];
            c = g * inverse;
            s = -f * inverse;
            if (left_) RotateRows(left_[l - 1], left_[i], left_.length, c, s);
        }
    }

    // First element of the sweep's first column, with the shift from the bottom 2 by 2 minor.
    double ShiftedFirst(std::ptrdiff_t l, std::ptrdiff_t k) const {
        const double x = w_[l];
        const double y = w_[k - 1];
        const double z = w_[k];
        const double g = e_[k - 1];
        const double h = e_[k];
        const double f = ((y - z) * (y + z) + (g - h) * (g + h)) / (2.0 * h * y);
        const double root = std::copysign(Hypotenuse(f, 1.0), f);
        return ((x - z) * (x + z) + h * (y / (f + root) - h)) / x;
    }

    void SweepDown(std::ptrdiff_t l, std::ptrdiff_t k) {
        double f = ShiftedFirst(l, k);
        double x = w_[l];
        double c = 1.0;
        double s = 1.0;
        for (std::ptrdiff_t j = l; j < k; ++j) {
            double g = c * e_[j + 1];
            double h = s * e_[j + 1];
            double y = w_[j + 1];
            e_[j] = Hypotenuse(f, h);
            if (e_[j] != 0.0) {
                c = f / e_[j];
                s = h / e_[j];
            } else {
                c = 1.0;
                s = 0.0;
            }
            right_sweep_.Set(j, c, s);
            f = x * c + g * s;
            g = g * c - x * s;
            h = y * s;
            y = y * c;
            w_[j] = Hypotenuse(f, h);
            if (w_[j] != 0.0) {
                c = f / w_[j];
                s = h / w_[j];
            }
            left_sweep_.Set(j, c, s);
            f = c * g + s * y;
            x = c * y - s * g;
        }
        e_[l] = 0.0;
        e_[k] = f;
        w_[k] = x;
        right_sweep_.Apply(l, k);
        left_sweep_.Apply(l, k);
    }

    double* w_;
    double* e_;
    double norm_;
    VectorRows left_;
    VectorRows right_;
    Sweep left_sweep_;
    Sweep right_sweep_;
};

}  // namespace

int32_t DiagonaliseBidiagonal(const Bidiagonal& b, VectorRows left, VectorRows right, double* work) {
    double norm = 0.0;
    for (std::ptrdiff_t i = 0; i < b.n; ++i) {
        const double size = std::fabs(b.diagonal[i]) + std::fabs(b.superdiagonal[i]);
        if (!std::isfinite(size)) return kNoConvergence;  // nothing would ever count as zero
        norm = std::max(norm, size);
    }
    Iteration iteration(b, norm, left, right, work);
    for (std::ptrdiff_t k = b.n; k-- > 0;)
        if (const int32_t status = iteration.Converge(k)) return status;
    return kOk;
}

}  // namespace krnumer
