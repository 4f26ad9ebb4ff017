#include "linalg/real_schur.h"

#include <algorithm>
#include <cmath>

#include "frame/numeric.h"
#include "frame/status.h"
#include "linalg/delayed_sweeps.h"
#include "linalg/reflector_chain.h"
#include "linalg/rotations.h"

namespace krnumer {

namespace {

// What a sweep does to the transformation.
struct DoubleShiftSweep {
    using Link = BulgeReflector;

    ReflectorChain chain;
    std::ptrdiff_t first;

    void ApplyTo(double* columns, std::ptrdiff_t stride, std::ptrdiff_t width) const {
        ReflectTransposedByChain(chain, columns + first * stride, stride, width);
    }
};

class Iteration {
  public:
    Iteration(const RealHessenberg& problem, Complex* w)
        : h_(problem.h), n_(problem.n), low_(problem.low), columns_(problem.columns), norm_(problem.norm), w_(w) {}

    int32_t Run(std::ptrdiff_t high) {
        if (!sweeps_.Start(columns_, n_)) return kOutOfMemory;
        for (std::ptrdiff_t en = high; en >= low_;)
            if (const int32_t status = Converge(&en)) return status;
        sweeps_.Apply();
        return kOk;
    }

  private:
    // Sweeps until one eigenvalue or a pair separates at the end of the block up to `en`; low up to en - 1 or en - 2 is
    // left then.
    int32_t Converge(std::ptrdiff_t* en_left) {
        const std::ptrdiff_t en = *en_left;
        for (int32_t sweeps = 0;; ++sweeps) {
            const std::ptrdiff_t l = Split(en);
            if (l == en) {
                StoreOne(en);
                *en_left = en - 1;
                return kOk;
            }
            if (l == en - 1) {
                StorePair(en);
                *en_left = en - 2;
                return kOk;
            }
            if (sweeps == kDoubleShiftLimit) return kNoConvergence;
            const bool exceptional = sweeps == 10 || sweeps == 20 || sweeps == 30;
            Sweep(l, en, exceptional ? ExceptionalShift(en) : BottomShift(en));
        }
    }

    // The two shifts as the roots of (s - x) (s - y) = w.
    struct Shift {
        double x, y, w;
    };
    // First column of the double step, scaled.
    struct FirstColumn {
        std::ptrdiff_t row;
        double p, q, r;
    };

    double& At(std::ptrdiff_t i, std::ptrdiff_t j) { return h_[i * n_ + j]; }
    double* Row(std::ptrdiff_t i) { return h_ + i * n_; }

    // Where the unreduced block that ends at en begins.
    std::ptrdiff_t Split(std::ptrdiff_t en) {
        std::ptrdiff_t l = en;
        for (; l > low_; --l) {
            double s = std::fabs(At(l - 1, l - 1)) + std::fabs(At(l, l));
            if (s == 0.0) s = norm_;
            if (kEpsilon * s >= std::fabs(At(l, l - 1))) break;
        }
        return l;
    }

    Shift BottomShift(std::ptrdiff_t en) { return {At(en, en), At(en - 1, en - 1), At(en, en - 1) * At(en - 1, en)}; }

    Shift ExceptionalShift(std::ptrdiff_t en) {
        const double x = At(en, en);
        shifted_ += x;
        for (std::ptrdiff_t i = low_; i <= en; ++i) At(i, i) -= x;
        const double s = std::fabs(At(en, en - 1)) + std::fabs(At(en - 1, en - 2));
        return {0.75 * s, 0.75 * s, -0.4375 * s * s};
    }

    // Two consecutive small subdiagonal elements let the sweep start further down.
    FirstColumn FindStart(std::ptrdiff_t l, std::ptrdiff_t en, const Shift& shift) {
        for (std::ptrdiff_t m = en - 2;; --m) {
            const double z = At(m, m);
            double r = shift.x - z;
            double s = shift.y - z;
            double p = (r * s - shift.w) / At(m + 1, m) + At(m, m + 1);
            double q = At(m + 1, m + 1) - z - r - s;
            r = At(m + 2, m + 1);
            s = std::fabs(p) + std::fabs(q) + std::fabs(r);
            p /= s;
            q /= s;
            r /= s;
            if (m == l) return {m, p, q, r};
            const double beside = std::fabs(At(m - 1, m - 1)) + std::fabs(z) + std::fabs(At(m + 1, m + 1));
            if (std::fabs(At(m, m - 1)) * (std::fabs(q) + std::fabs(r)) <= kEpsilon * (std::fabs(p) * beside))
                return {m, p, q, r};
        }
    }

    void Sweep(std::ptrdiff_t l, std::ptrdiff_t en, const Shift& shift) {
        const FirstColumn start = FindStart(l, en, shift);
        const std::ptrdiff_t m = start.row;
        for (std::ptrdiff_t i = m + 2; i <= en; ++i) At(i, i - 2) = 0.0;
        for (std::ptrdiff_t i = m + 3; i <= en; ++i) At(i, i - 3) = 0.0;
        BulgeReflector* const reflectors = sweeps_.NextLinks();
        ChaseBulge(l, en, start, reflectors);
        ApplyOutside(l, m, en, reflectors);
        sweeps_.Add({{reflectors, en - m, true}, m});
    }

    // Within the block every reflector meets a few columns at once; those from `front` on wait until the next ones
    // depend on them. From the right it meets only the rows that the next reflectors need; what stands above them is
    // left to ApplyOutside.
    void ChaseBulge(std::ptrdiff_t l, std::ptrdiff_t en, const FirstColumn& start, BulgeReflector* reflectors) {
        constexpr std::ptrdiff_t kStrip = 32;
        const std::ptrdiff_t m = start.row;
        std::ptrdiff_t front = m;
        double p = start.p, q = start.q, r = start.r;
        for (std::ptrdiff_t k = m; k < en; ++k) {
            if (std::min(k + 2, en) >= front) {
                const std::ptrdiff_t width = std::min(kStrip, en + 1 - front);
                ReflectRowsByChain({reflectors, k - m, false}, Row(m) + front, n_, width);
                front += width;
            }
            const bool is_last = k == en - 1;
            BulgeReflector& f = reflectors[k - m];
            double x = 1.0;
            if (k > m) {
                p = At(k, k - 1);
                q = At(k + 1, k - 1);
                r = is_last ? 0.0 : At(k + 2, k - 1);
                x = std::fabs(p) + std::fabs(q) + std::fabs(r);
                if (x == 0.0) {
                    f = {};
                    continue;
                }
                p /= x;
                q /= x;
                r /= x;
            }
            const double s = std::copysign(std::sqrt(p * p + q * q + r * r), p);
            if (k > m) {
                At(k, k - 1) = -s * x;
            } else if (l != m) {
                At(k, k - 1) = -At(k, k - 1);
            }
            p += s;
            f = {p / s, q / s, r / s, q / p, r / p};
            ReflectInBlock(f, k, front, en);
        }
    }

    void ReflectInBlock(const BulgeReflector& f, std::ptrdiff_t k, std::ptrdiff_t front, std::ptrdiff_t en) {
        double* a = Row(k);
        double* b = Row(k + 1);
        if (k == en - 1) {
            for (std::ptrdiff_t j = k; j < front; ++j) {
                const double p = a[j] + f.q * b[j];
                a[j] -= p * f.x;
                b[j] -= p * f.y;
            }
            const double p = f.x * b[k] + f.y * b[k + 1];
            b[k] -= p;
            b[k + 1] -= p * f.q;
            return;
        }
        double* c = Row(k + 2);
        for (std::ptrdiff_t j = k; j < front; ++j) {
            const double p = a[j] + f.q * b[j] + f.r * c[j];
            a[j] -= p * f.x;
            b[j] -= p * f.y;
            c[j] -= p * f.z;
        }
        for (std::ptrdiff_t i = k + 1; i <= std::min(en, k + 3); ++i) {
            double* row = Row(i) + k;
            const double p = f.x * row[0] + f.y * row[1] + f.z * row[2];
            row[0] -= p;
            row[1] -= p * f.q;
            row[2] -= p * f.r;
        }
    }

    // What the sweep on rows and columns m to en owes to the rest: the rows above, up to the place of each reflector,
    // and with the transformation also the columns to the right.
    void ApplyOutside(std::ptrdiff_t l, std::ptrdiff_t m, std::ptrdiff_t en, const BulgeReflector* reflectors) {
        const auto chain = [&](std::ptrdiff_t from, std::ptrdiff_t to) {
            return ReflectorChain{reflectors + (from - m), to - from, to == en};
        };
        const std::ptrdiff_t top = columns_ != nullptr ? 0 : l;
        ReflectColumnsByChain(chain(m, en), Row(top) + m, n_, m + 1 - top);
        // Row i starts at reflector i; a few rows are brought to the same one, then they go on together.
        constexpr std::ptrdiff_t kTogether = 8;
        for (std::ptrdiff_t i = m + 1; i < en; i += kTogether) {
            const std::ptrdiff_t rows = std::min(kTogether, en - i);
            const std::ptrdiff_t common = i + rows - 1;
            for (std::ptrdiff_t j = i; j < common; ++j) ReflectColumnsByChain(chain(j, common), Row(j) + j, n_, 1);
            ReflectColumnsByChain(chain(common, en), Row(i) + common, n_, rows);
        }
        if (columns_ != nullptr) ReflectRowsByChain(chain(m, en), Row(m) + en + 1, n_, n_ - en - 1);
    }

    void StoreOne(std::ptrdiff_t en) {
        At(en, en) += shifted_;
        w_[en] = {At(en, en), 0.0};
    }

    void StorePair(std::ptrdiff_t en) {
        const std::ptrdiff_t na = en - 1;
        const Shift block = BottomShift(en);
        const double p = (block.y - block.x) / 2.0;
        const double q = p * p + block.w;
        const double root = std::sqrt(std::fabs(q));
        At(en, en) = block.x + shifted_;
        At(na, na) = block.y + shifted_;
        const double x = At(en, en);
        if (q < 0.0) {
            w_[na] = {x + p, root};
            w_[en] = {x + p, -root};
            return;
        }
        const double z = p + std::copysign(root, p);
        w_[na] = w_[en] = {x + z, 0.0};
        if (z != 0.0) w_[en].re = x - block.w / z;
        if (columns_ != nullptr) Separate(en, z);
    }

    // Turns the block of a real pair, with an eigenvalue that differs by z from its last diagonal element, triangular.
    void Separate(std::ptrdiff_t en, double z) {
        const std::ptrdiff_t na = en - 1;
        const double below = At(en, na);
        const double s = std::fabs(below) + std::fabs(z);
        double p = below / s;
        double q = z / s;
        const double r = std::sqrt(p * p + q * q);
        p /= r;
        q /= r;
        RotateRows(Row(na) + na, Row(en) + na, n_ - na, q, p);
        for (std::ptrdiff_t i = 0; i <= en; ++i) {
            double* row = Row(i);
            const double a = row[na];
            row[na] = q * a + p * row[en];
            row[en] = q * row[en] - p * a;
        }
        sweeps_.Apply();
        RotateRows(columns_ + na * n_, columns_ + en * n_, n_, q, p);
    }

    double* h_;
    std::ptrdiff_t n_;
    std::ptrdiff_t low_;
    double* columns_;
    double norm_;
    Complex* w_;
    DelayedSweeps<double, DoubleShiftSweep> sweeps_;
    double shifted_ = 0.0;  // sum of the exceptional shifts, taken off the diagonal
};

}  // namespace

int32_t ReduceToRealSchur(const RealHessenberg& problem, Complex* w) {
    for (std::ptrdiff_t i = 0; i < problem.n; ++i)
        if (i < problem.low || i > problem.high) w[i] = {problem.h[i * problem.n + i], 0.0};
    return Iteration(problem, w).Run(problem.high);
}

}  // namespace krnumer
