#include "linalg/qz.h"

#include <algorithm>
#include <cmath>

#include "frame/numeric.h"
#include "frame/scratch.h"
#include "frame/status.h"
#include "linalg/block_sort.h"
#include "linalg/element.h"
#include "linalg/finite.h"
#include "linalg/lapack.h"
#include "linalg/qr.h"
#include "linalg/schur.h"
#include "linalg/transpose.h"

namespace krnumer {

namespace {

// The pencil in column-major arrays on its way to the Schur form.
template <class T>
class Pencil {
  public:
    int32_t Allocate(int32_t n) {
        n_ = n;
        const std::size_t elements = Count(n) * Count(n);
        // LAPACK asks for 6n doubles for vectors and 4n + 16 for exchanges, whatever the iteration asks for.
        work_size_ = std::max(6 * n, 4 * n + 16);
        const bool allocated = arrays_.Allocate(4 * elements) && values_.Allocate(3 * Count(n)) &&
                               work_.Allocate(Count(work_size_)) && rwork_.Allocate(2 * Count(n));
        if (!allocated) return kOutOfMemory;
        s = arrays_.data();
        p = s + elements;
        q = p + elements;
        z = q + elements;
        return kOk;
    }

    // Hessenberg-triangular form: B becomes triangular by its QR factors, and rotations do the rest.
    int32_t Reduce(const T* a, const T* b) {
        const std::size_t elements = Count(n_) * Count(n_);
        Scratch<T> factors(2 * elements);
        if (!factors) return kOutOfMemory;
        T* const r = factors.data() + elements;
        if (const int32_t status = QRHouseholder(b, n_, n_, kFullQR, factors.data(), r)) return status;
        TransposeCore(factors.data(), n_, n_, q);
        TransposeCore(r, n_, n_, p);
        const auto adjoint = kIsComplex<T> ? lapack::kConjugateTranspose : lapack::kTranspose;
        lapack::Gemm(lapack::kColumnMajor, adjoint, lapack::kTranspose, n_, n_, n_, FromReal<T>(1.0), q, n_, a, n_,
                     FromReal<T>(0.0), s, n_);
        lapack::Gghrd('V', 'I', n_, 1, n_, s, n_, p, n_, q, n_, z, n_);
        return kOk;
    }

    // The iteration runs twice on the same arrays; the second run settles what the first left.
    int32_t Iterate(bool want_q, bool want_z) {
        for (int32_t run = 0; run < 2; ++run) {
            const int32_t info = IterateOnce(want_q ? 'V' : 'N', want_z ? 'V' : 'N');
            if (info != 0) return info > 0 ? kNoConvergence : kLapackError;
        }
        return kOk;
    }

    // Sorts by `order`; `given_up` where a pair is 0/0.
    int32_t Sort(int32_t order, bool want_q, bool want_z, bool* given_up) {
        Scratch<double> keys(2 * Count(n_));
        Scratch<int32_t> sizes(Count(n_));
        if (!keys || !sizes) return kOutOfMemory;
        double* const numerators = keys.data();
        double* const denominators = numerators + n_;
        const bool by_modulus = order >= kModulusAscending;
        for (int32_t i = 0; i < n_; ++i) {
            const Complex a = alpha(i);
            const double d = RealPart(beta(i));
            if (a.re == 0.0 && a.im == 0.0 && beta(i) == T{}) {
                *given_up = true;
                return kOk;
            }
            numerators[i] = by_modulus ? lapack::Lapy2(a.re, a.im) : a.re;
            denominators[i] = by_modulus ? std::fabs(d) : d;
            sizes[Count(i)] = 1;
        }
        for (int32_t i = 0; !kIsComplex<T> && i + 1 < n_; ++i) {
            if (alpha(i).im == 0.0) continue;
            sizes[Count(i)] = 2;
            sizes[Count(++i)] = 0;
        }
        const bool ascending = order == kRealAscending || order == kModulusAscending;
        // Compares the quotients a/d and b/e without dividing; infinite ones come last in ascending order.
        const auto out_of_order = [=](int32_t i, int32_t j) {
            const double ae = numerators[i] * denominators[j];
            const double bd = numerators[j] * denominators[i];
            const double de = denominators[i] * denominators[j];
            if (ascending)
                return (ae > bd && de > 0.0) || (ae < bd && de < 0.0) || (denominators[i] == 0.0 && ae != 0.0);
            return (ae < bd && de > 0.0) || (ae > bd && de < 0.0) || (denominators[j] == 0.0 && bd != 0.0);
        };
        const auto exchange = [&](int32_t i, int32_t size) {
            const int32_t info = lapack::Tgexc(n_, s, n_, p, n_, want_q ? q : nullptr, n_, want_z ? z : nullptr, n_,
                                               i + 1, i + 1 + size, RealWork(), work_size_);
            if (info == 0) return kOk;
            return info < 0 ? kLapackError : kReorderingFailed;
        };
        return SortBlocks(sizes.data(), n_, out_of_order, exchange, [&](int32_t first, int32_t middle, int32_t last) {
            std::rotate(numerators + first, numerators + middle, numerators + last);
            std::rotate(denominators + first, denominators + middle, denominators + last);
            for (int32_t k = 0; k < 3; ++k) {
                T* const values = values_.data() + Count(k) * Count(n_);
                std::rotate(values + first, values + middle, values + last);
            }
        });
    }

    // Eigenvectors take the place of Q and Z.
    int32_t Vectors(bool left, bool right) {
        const char side = left && right ? 'B' : left ? 'L' : 'R';
        const int32_t info = lapack::Tgevc(side, 'B', n_, s, n_, p, n_, q, n_, z, n_, n_, work_.data(), rwork_.data());
        return info == 0 ? kOk : kLapackError;
    }

    Complex alpha(int32_t i) const {
        if constexpr (kIsComplex<T>) {
            return values_[Count(i)];
        } else {
            return {values_[Count(i)], values_[Count(n_) + Count(i)]};
        }
    }
    T beta(int32_t i) const { return values_[2 * Count(n_) + Count(i)]; }

    T* s;
    T* p;
    T* q;
    T* z;

  private:
    int32_t IterateOnce(char compq, char compz) {
        T* const first = values_.data();
        T* const second = first + n_;
        T* const third = second + n_;
        T asked{};
        const auto call = [&](T* space, int32_t size) {
            if constexpr (kIsComplex<T>) {
                return lapack::Hgeqz('S', compq, compz, n_, 1, n_, s, n_, p, n_, first, third, q, n_, z, n_, space,
                                     size, rwork_.data());
            } else {
                return lapack::Hgeqz('S', compq, compz, n_, 1, n_, s, n_, p, n_, first, second, third, q, n_, z, n_,
                                     space, size);
            }
        };
        if (const int32_t info = call(&asked, -1)) return info;
        return call(work_.data(), work_size_);
    }

    double* RealWork() {
        if constexpr (kIsComplex<T>) {
            return nullptr;
        } else {
            return work_.data();
        }
    }

    int32_t n_ = 0;
    int32_t work_size_ = 0;
    Scratch<T> arrays_;
    Scratch<T> values_;  // real: real parts, imaginary parts, beta; complex: alpha, unused, beta
    Scratch<T> work_;
    Scratch<double> rwork_;
};

template <class T>
void DeliverForm(const Pencil<T>& pencil, int32_t n, bool transposed_q, const QZOutputs<T>& out) {
    if (out.s != nullptr) TransposeCore(pencil.s, n, n, out.s);
    if (out.p != nullptr) TransposeCore(pencil.p, n, n, out.p);
    if (out.z != nullptr) TransposeCore(pencil.z, n, n, out.z);
    if (out.q == nullptr) return;
    if (transposed_q) {
        TransposeCore(pencil.q, n, n, out.q);
    } else {
        std::copy_n(pencil.q, Count(n) * Count(n), out.q);
    }
}

}  // namespace

template <class T>
int32_t QZCore(const T* a, const T* b, int32_t n, bool transposed_q, int32_t mode, int32_t order,
               const QZOutputs<T>& out, Complex* alpha, T* beta) {
    if (!IsEigenvalueOrder(order)) return kBadSelector;
    if (n < 1) return kEmptyInput;
    const std::size_t elements = Count(n) * Count(n);
    if (HasUnusable(a, elements) || HasUnusable(b, elements)) return kNotFinite;
    Pencil<T> pencil;
    if (const int32_t status = pencil.Allocate(n)) return status;
    if (const int32_t status = pencil.Reduce(a, b)) return status;
    if (mode == 0) DeliverForm(pencil, n, transposed_q, out);

    const bool want_q = out.q != nullptr || out.left != nullptr;
    const bool want_z = out.z != nullptr || out.right != nullptr;
    if (const int32_t status = pencil.Iterate(want_q, want_z)) return status;
    bool given_up = false;
    if (mode == 1 && order != kNoOrder) {
        if (const int32_t status = pencil.Sort(order, want_q, want_z, &given_up)) return status;
        if (const int32_t status = pencil.Iterate(want_q, want_z)) return status;
    }
    if (mode != 0) DeliverForm(pencil, n, transposed_q, out);
    for (int32_t i = 0; i < n; ++i) {
        alpha[i] = pencil.alpha(i);
        beta[i] = pencil.beta(i);
    }
    if (out.right != nullptr || out.left != nullptr) {
        if (const int32_t status = pencil.Vectors(out.left != nullptr, out.right != nullptr)) return status;
        if (out.right != nullptr) TransposeCore(pencil.z, n, n, out.right);
        if (out.left != nullptr) TransposeCore(pencil.q, n, n, out.left);
    }
    return given_up ? kWarnNotReordered : kOk;
}

void ExpandVectors(const double* packed, int32_t n, const Complex* values, Complex* vectors) {
    const std::size_t order = Count(n);
    for (std::size_t j = 0; j < order; ++j) {
        const bool pair = values[j].im != 0.0 && j + 1 < order;
        for (std::size_t i = 0; i < order; ++i) {
            const double re = packed[i * order + j];
            const double im = pair ? packed[i * order + j + 1] : 0.0;
            vectors[i * order + j] = {re, im};
            if (pair) vectors[i * order + j + 1] = {re, -im};
        }
        j += pair;
    }
}

template int32_t QZCore(const double*, const double*, int32_t, bool, int32_t, int32_t, const QZOutputs<double>&,
                        Complex*, double*);
template int32_t QZCore(const Complex*, const Complex*, int32_t, bool, int32_t, int32_t, const QZOutputs<Complex>&,
                        Complex*, Complex*);

}  // namespace krnumer
