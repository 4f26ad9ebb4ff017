#include "linalg/svd_solve.h"

#include <algorithm>

#include "frame/numeric.h"
#include "frame/scratch.h"
#include "frame/status.h"
#include "linalg/finite.h"
#include "linalg/products.h"
#include "linalg/svd.h"
#include "linalg/transpose.h"

namespace krnumer {

namespace {

// The thin decomposition of an m by n matrix, on its way to the inverse.
template <class T>
class ThinSvd {
  public:
    int32_t Decompose(const T* a, int32_t m, int32_t n) {
        m_ = m;
        n_ = n;
        k_ = std::min(m, n);
        if (!vectors_.Allocate((Count(m) + Count(n)) * Count(k_)) || !s_.Allocate(Count(k_))) return kOutOfMemory;
        return SvdCore(a, m, n, u(), s_.data(), v(), false);
    }

    double largest() const { return s_[0]; }

    // Divides the columns of V by their singular values, or clears them where cut(s) says so; how many were kept.
    template <class Cut>
    int32_t DivideColumns(Cut cut) {
        int32_t kept = 0;
        for (int32_t j = 0; j < k_; ++j) {
            const double s = s_[Count(j)];
            const bool keep = !cut(s);
            const double factor = keep ? 1.0 / s : 0.0;
            for (int32_t i = 0; i < n_; ++i) {
                T& element = v()[Count(i) * Count(k_) + Count(j)];
                element = keep ? element * factor : T{};
            }
            kept += keep;
        }
        return kept;
    }

    // V U^H, n by m.
    int32_t Inverse(T* out) {
        const int32_t status = ConjTransposeInPlace(u(), m_, k_);
        return status != kOk ? status : MatMulCore(v(), u(), n_, k_, m_, out);
    }

    int32_t size() const { return k_; }

  private:
    T* u() { return vectors_.data(); }
    T* v() { return vectors_.data() + Count(m_) * Count(k_); }

    int32_t m_ = 0, n_ = 0, k_ = 0;
    Scratch<T> vectors_;
    Scratch<double> s_;
};

}  // namespace

template <class T>
int32_t SvdSolve(const T* a, int32_t m, int32_t n, const T* b, int32_t nrhs, T* x, double tol) {
    if (m < 1 || n < 1 || nrhs < 1) return kEmptyInput;
    if (HasUnusable(b, Count(m) * Count(nrhs))) return kNotFinite;
    ThinSvd<T> svd;
    if (const int32_t status = svd.Decompose(a, m, n)) return status;
    const double factor = tol > 0.0 ? tol : kEpsilon;
    const double cut = std::max(m, n) * svd.largest() * factor;
    const int32_t kept = svd.DivideColumns([cut](double s) { return s <= cut; });
    Scratch<T> inverse(Count(n) * Count(m));
    if (!inverse) return kOutOfMemory;
    if (const int32_t status = svd.Inverse(inverse.data())) return status;
    if (const int32_t status = MatMulCore(inverse.data(), b, n, m, nrhs, x)) return status;
    return kept == svd.size() ? kOk : kWarnRankDeficient;
}

template <class T>
int32_t PseudoInverseCore(T* a, int32_t m, int32_t n, double tol, T* out) {
    if (m < 1 || n < 1) return kEmptyInput;
    ThinSvd<T> svd;
    if (const int32_t status = svd.Decompose(a, m, n)) return status;
    const double cut = tol >= 0.0 ? tol : std::max(m, n) * svd.largest() * kEpsilon;
    svd.DivideColumns([cut](double s) { return cut >= s; });
    return svd.Inverse(out != nullptr ? out : a);
}

template int32_t SvdSolve(const double*, int32_t, int32_t, const double*, int32_t, double*, double);
template int32_t SvdSolve(const Complex*, int32_t, int32_t, const Complex*, int32_t, Complex*, double);
template int32_t PseudoInverseCore(double*, int32_t, int32_t, double, double*);
template int32_t PseudoInverseCore(Complex*, int32_t, int32_t, double, Complex*);

}  // namespace krnumer
