#include <algorithm>

#include "frame/scratch.h"
#include "krnumer/linalg_schur.h"
#include "linalg/element.h"
#include "linalg/entry_support.h"
#include "linalg/hessenberg.h"
#include "linalg/qz.h"
#include "linalg/schur.h"

using namespace krnumer;

// ---- Hessenberg form and balancing ----

namespace {

template <class T>
int32_t Hessenberg(KrHandle a, int32_t ilo, int32_t ihi, KrHandle q) {
    ByValue call;
    InOutMatrix<T> matrix(call, a);
    OutMatrix<T> factor(call, q);
    const int32_t n = matrix.rows();
    if (!IsSquare(matrix)) return call.Fail(kNotSquare);
    if (n < 1) return call.Fail(kEmptyInput);
    if (factor.Resize(n, n)) return call.Fail(kOutOfMemory);
    return call.Run([&] { return HessenbergCore(matrix.data(), n, ilo, ihi, matrix.data(), factor.data()); });
}

template <class T>
int32_t Balance(KrHandle a, int32_t job, int32_t* ilo, int32_t* ihi, KrHandle scale) {
    ByValue call;
    InOutMatrix<T> matrix(call, a);
    Out<double> factors(call, scale);
    const int32_t n = matrix.rows();
    if (IsEmpty(matrix)) return call.Fail(kEmptyInput);
    if (!IsSquare(matrix)) return call.Fail(kNotSquare);
    if (factors.Resize(n)) return call.Fail(kOutOfMemory);
    return call.Run([&] { return BalanceCore(matrix.data(), n, job, ilo, ihi, factors.data()); });
}

template <class T>
int32_t BackTransform(KrHandle v, int32_t job, int32_t side, int32_t ilo, int32_t ihi, KrHandle scale) {
    ByValue call;
    InOutMatrix<T> vectors(call, v);
    In<double> factors(call, scale);
    const int32_t n = vectors.rows();
    if (!IsSquare(vectors)) return call.Fail(kNotSquare);
    if (n < 1) return call.Fail(kEmptyInput);
    if (factors.size() != n) return call.Fail(kSizesDiffer);
    return call.Run([&] { return BackTransformCore(vectors.data(), n, job, side > 0, ilo, ihi, factors.data()); });
}

}  // namespace

int32_t Hessenberg_head(KrHandle a, int32_t ilo, int32_t ihi, KrHandle q) {
    return Hessenberg<double>(a, ilo, ihi, q);
}
int32_t CxHessenberg_head(KrHandle a, int32_t ilo, int32_t ihi, KrHandle q) {
    return Hessenberg<Complex>(a, ilo, ihi, q);
}

int32_t MatrixBalance_head(KrHandle a, int32_t job, int32_t* ilo, int32_t* ihi, KrHandle scale) {
    return Balance<double>(a, job, ilo, ihi, scale);
}
int32_t CxMatrixBalance_head(KrHandle a, int32_t job, int32_t* ilo, int32_t* ihi, KrHandle scale) {
    return Balance<Complex>(a, job, ilo, ihi, scale);
}

int32_t EigenVBack_head(KrHandle v, int32_t job, int32_t side, int32_t ilo, int32_t ihi, KrHandle scale) {
    return BackTransform<double>(v, job, side, ilo, ihi, scale);
}
int32_t CxEigenVBack_head(KrHandle v, int32_t job, int32_t side, int32_t ilo, int32_t ihi, KrHandle scale) {
    return BackTransform<Complex>(v, job, side, ilo, ihi, scale);
}

// ---- Schur decomposition ----

namespace {

// Vectors that nobody wants are emptied. Whether the host agrees to that is not asked.
template <class T>
int32_t SizeIfWanted(bool wanted, OutMatrix<T>& vectors, int32_t n) {
    return wanted ? vectors.Resize(n, n) : vectors.Clear();
}

template <class T>
int32_t Schur(KrHandle a, int32_t want_vectors, int32_t order, KrHandle z, KrHandle w) {
    ByValue call;
    InOutMatrix<T> matrix(call, a);
    OutMatrix<T> vectors(call, z);
    Out<Complex> values(call, w);
    const int32_t n = matrix.rows();
    if (IsEmpty(matrix)) return call.Fail(kEmptyInput);
    if (!IsSquare(matrix)) return call.Fail(kNotSquare);
    const bool wanted = want_vectors != 0;
    if (SizeIfWanted(wanted, vectors, n) || values.Resize(n)) return call.Fail(kOutOfMemory);
    return call.Run([&] {
        return SchurCore(matrix.data(), n, order, wanted ? vectors.data() : nullptr, matrix.data(), values.data());
    });
}

}  // namespace

int32_t Schur_head(KrHandle a, int32_t wantVectors, KrHandle z, KrHandle w) {
    return Schur<double>(a, wantVectors, kNoOrder, z, w);
}
int32_t CxSchur_head(KrHandle a, int32_t wantVectors, KrHandle z, KrHandle w) {
    return Schur<Complex>(a, wantVectors, kNoOrder, z, w);
}
int32_t Schur80_head(KrHandle a, int32_t wantVectors, int32_t order, KrHandle z, KrHandle w) {
    return Schur<double>(a, wantVectors, order, z, w);
}
int32_t CxSchur80_head(KrHandle a, int32_t wantVectors, int32_t order, KrHandle z, KrHandle w) {
    return Schur<Complex>(a, wantVectors, order, z, w);
}

// ---- Pencils ----

namespace {

template <class T>
int32_t CheckPencil(const ShapedView<T, 2>& a, const ShapedView<T, 2>& b) {
    if (!IsSquare(a) || !IsSquare(b)) return kNotSquare;
    if (a.rows() != b.rows()) return kPencilSizesDiffer;
    return a.rows() < 1 ? kEmptyInput : kOk;
}

// Right eigenvectors as complex columns: what the core delivers, expanded where it is real.
template <class T>
class RightVectors {
  public:
    int32_t Allocate(int32_t n) {
        if constexpr (kIsComplex<T>) return kOk;
        return packed_.Allocate(Count(n) * Count(n)) ? kOk : kOutOfMemory;
    }
    T* target(Complex* vectors) {
        if constexpr (kIsComplex<T>) {
            return vectors;
        } else {
            return packed_.data();
        }
    }
    void Expand(int32_t n, const Complex* values, Complex* vectors) {
        if constexpr (!kIsComplex<T>) ExpandVectors(packed_.data(), n, values, vectors);
    }

  private:
    Scratch<T> packed_;
};

template <class T>
int32_t DecomposePencil(KrHandle a, KrHandle b, int32_t mode, int32_t order, KrHandle alpha, KrHandle beta,
                        KrHandle v) {
    ByValue call;
    InOutMatrix<T> first(call, a);
    InOutMatrix<T> second(call, b);
    Out<Complex> numerators(call, alpha);
    Out<T> denominators(call, beta);
    OutMatrix<Complex> vectors(call, v);
    const int32_t n = first.rows();
    if (const int32_t status = CheckPencil<T>(first, second)) return call.Fail(status);
    if (!IsEigenvalueOrder(order)) return call.Fail(kBadSelector);
    if (numerators.Resize(n) || denominators.Resize(n) || vectors.Resize(n, n)) return call.Fail(kOutOfMemory);
    return call.Run([&]() -> int32_t {
        const size_t elements = Count(n) * Count(n);
        Scratch<T> factors(2 * elements);  // Q and Z, which take the places of A and B
        RightVectors<T> right;
        if (!factors || right.Allocate(n)) return kOutOfMemory;
        QZOutputs<T> out;
        out.q = factors.data();
        out.z = out.q + elements;
        out.right = right.target(vectors.data());
        const int32_t status =
            QZCore(first.data(), second.data(), n, true, mode, order, out, numerators.data(), denominators.data());
        if (status < 0) return status;
        right.Expand(n, numerators.data(), vectors.data());
        std::copy_n(out.q, elements, first.data());
        std::copy_n(out.z, elements, second.data());
        return status;
    });
}

enum PencilVectors : int32_t { kNoVectors = 0, kRightVectors = 1, kLeftVectors = 2, kBothVectors = 3 };

template <class T>
int32_t DecomposePencilWhole(KrHandle a, KrHandle b, KrHandle q, KrHandle z, KrHandle alpha, KrHandle beta,
                             int32_t which, KrHandle vr, KrHandle vl) {
    ByValue call;
    InOutMatrix<T> first(call, a);
    InOutMatrix<T> second(call, b);
    OutMatrix<T> left_factor(call, q);
    OutMatrix<T> right_factor(call, z);
    Out<Complex> numerators(call, alpha);
    Out<T> denominators(call, beta);
    OutMatrix<T> right(call, vr);
    OutMatrix<T> left(call, vl);
    const int32_t n = first.rows();
    if (const int32_t status = CheckPencil<T>(first, second)) return call.Fail(status);
    if (which < kNoVectors || which > kBothVectors) return call.Fail(kBadSelector);
    const bool want_right = (which & kRightVectors) != 0;
    const bool want_left = (which & kLeftVectors) != 0;
    if (left_factor.Resize(n, n) || right_factor.Resize(n, n) || numerators.Resize(n) || denominators.Resize(n) ||
        SizeIfWanted(want_right, right, n) || SizeIfWanted(want_left, left, n))
        return call.Fail(kOutOfMemory);
    return call.Run([&] {
        const QZOutputs<T> out{first.data(),
                               second.data(),
                               left_factor.data(),
                               right_factor.data(),
                               want_right ? right.data() : nullptr,
                               want_left ? left.data() : nullptr};
        return QZCore(first.data(), second.data(), n, false, 1, kNoOrder, out, numerators.data(), denominators.data());
    });
}

Complex Divide(Complex a, double b) {
    return {a.re / b, a.im / b};
}
Complex Divide(Complex a, Complex b) {
    return a / b;
}

template <class T>
int32_t PencilEigenvalues(KrHandle a, KrHandle b, int32_t want_vectors, KrHandle w, KrHandle v) {
    ByValue call;
    InMatrix<T> first(call, a);
    InMatrix<T> second(call, b);
    Out<Complex> values(call, w);
    OutMatrix<Complex> vectors(call, v);
    const int32_t n = first.rows();
    if (const int32_t status = CheckPencil<const T>(first, second)) return call.Fail(status);
    if (want_vectors != 0 && want_vectors != 1) return call.Fail(kBadSelector);
    const bool wanted = want_vectors != 0;
    if (values.Resize(n) || SizeIfWanted(wanted, vectors, n)) return call.Fail(kOutOfMemory);
    return call.Run([&]() -> int32_t {
        Scratch<T> denominators(Count(n));
        RightVectors<T> right;
        if (!denominators || (wanted && right.Allocate(n))) return kOutOfMemory;
        QZOutputs<T> out;
        if (wanted) out.right = right.target(vectors.data());
        const int32_t status =
            QZCore(first.data(), second.data(), n, true, 0, kNoOrder, out, values.data(), denominators.data());
        if (status != kOk) return status;
        if (wanted) right.Expand(n, values.data(), vectors.data());
        for (int32_t i = 0; i < n; ++i) values.data()[i] = Divide(values.data()[i], denominators[Count(i)]);
        return kOk;
    });
}

}  // namespace

int32_t QZ_head(KrHandle a, KrHandle b, KrHandle alpha, KrHandle beta, KrHandle v) {
    return QZ80_head(a, b, 0, kNoOrder, alpha, beta, v);
}
int32_t CxQZ_head(KrHandle a, KrHandle b, KrHandle alpha, KrHandle beta, KrHandle v) {
    return CxQZ80_head(a, b, 0, kNoOrder, alpha, beta, v);
}
int32_t QZ80_head(KrHandle a, KrHandle b, int32_t mode, int32_t order, KrHandle alpha, KrHandle beta, KrHandle v) {
    return DecomposePencil<double>(a, b, mode, order, alpha, beta, v);
}
int32_t CxQZ80_head(KrHandle a, KrHandle b, int32_t mode, int32_t order, KrHandle alpha, KrHandle beta, KrHandle v) {
    return DecomposePencil<Complex>(a, b, mode, order, alpha, beta, v);
}

int32_t TmiQZ_head(KrHandle a, KrHandle b, KrHandle q, KrHandle z, KrHandle alpha, KrHandle beta, int32_t which,
                   KrHandle vr, KrHandle vl) {
    return DecomposePencilWhole<double>(a, b, q, z, alpha, beta, which, vr, vl);
}
int32_t CxTmiQZ_head(KrHandle a, KrHandle b, KrHandle q, KrHandle z, KrHandle alpha, KrHandle beta, int32_t which,
                     KrHandle vr, KrHandle vl) {
    return DecomposePencilWhole<Complex>(a, b, q, z, alpha, beta, which, vr, vl);
}

int32_t GenEigenEx_head(KrHandle a, KrHandle b, int32_t wantVectors, KrHandle w, KrHandle v) {
    return PencilEigenvalues<double>(a, b, wantVectors, w, v);
}
int32_t CxGenEigenEx_head(KrHandle a, KrHandle b, int32_t wantVectors, KrHandle w, KrHandle v) {
    return PencilEigenvalues<Complex>(a, b, wantVectors, w, v);
}
