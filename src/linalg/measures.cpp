#include "linalg/measures.h"

#include <algorithm>
#include <cmath>
#include <cstddef>

#include "frame/numeric.h"
#include "frame/scratch.h"
#include "frame/status.h"
#include "linalg/cholesky.h"
#include "linalg/eigen_symmetric.h"
#include "linalg/element.h"
#include "linalg/finite.h"
#include "linalg/lu.h"
#include "linalg/lu_solve.h"
#include "linalg/packed.h"
#include "linalg/svd.h"

namespace krnumer {

namespace {

// The singular values, for measures that need no vectors.
template <class T>
class SingularValues {
  public:
    SingularValues(const T* a, int32_t m, int32_t n) : values_(Count(std::min(m, n))) {
        status_ = values_ ? SvdValuesCore(a, m, n, values_.data()) : kOutOfMemory;
    }

    int32_t status() const { return status_; }
    double operator[](std::size_t i) const { return values_[i]; }

  private:
    Scratch<double> values_;
    int32_t status_;
};

// What cannot be told from rounding beside the largest singular value.
double RoundingThreshold(int32_t m, int32_t n, double largest) {
    return std::max(m, n) * largest * kEpsilon;
}

// The column sums run side by side, so that rows are walked.
template <class T>
double OneNorm(const T* a, std::size_t m, std::size_t n) {
    constexpr std::size_t kTogether = 64;
    double largest = 0.0;
    for (std::size_t first = 0; first < n; first += kTogether) {
        const std::size_t columns = std::min(kTogether, n - first);
        double sums[kTogether] = {};
        for (std::size_t i = 0; i < m; ++i)
            for (std::size_t j = 0; j < columns; ++j) sums[j] += Modulus(a[i * n + first + j]);
        for (std::size_t j = 0; j < columns; ++j)
            if (sums[j] > largest) largest = sums[j];
    }
    return largest;
}

template <class T>
double InfinityNorm(const T* a, std::size_t m, std::size_t n) {
    double largest = 0.0;
    for (std::size_t i = 0; i < m; ++i) {
        double sum = 0.0;
        for (std::size_t j = 0; j < n; ++j) sum += Modulus(a[i * n + j]);
        if (sum > largest) largest = sum;
    }
    return largest;
}

template <class T>
double FrobeniusNorm(const T* a, std::size_t count) {
    double sum = 0.0;
    for (std::size_t i = 0; i < count; ++i) sum += SquaredModulus(a[i]);
    return std::sqrt(sum);
}

// The norms that are sums of magnitudes or squares.
template <class T>
double SummedNorm(const T* a, int32_t m, int32_t n, int32_t type) {
    if (type == kOneNorm) return OneNorm(a, Count(m), Count(n));
    if (type == kInfinityNorm) return InfinityNorm(a, Count(m), Count(n));
    return FrobeniusNorm(a, Count(m) * Count(n));
}

template <class T>
int32_t CheckMeasured(const T* a, int32_t m, int32_t n, int32_t type) {
    if (m < 1 || n < 1) return kEmptyInput;
    if (HasUnusable(a, Count(m) * Count(n))) return kNotFinite;
    return type < kTwoNorm || type > kInfinityNorm ? kBadSelector : kOk;
}

template <class T>
T DiagonalProduct(const T* a, std::size_t n) {
    T product = FromReal<T>(1.0);
    for (std::size_t i = 0; i < n; ++i) product *= a[i * (n + 1)];
    return product;
}

template <class T>
int32_t DeterminantByLU(const T* a, int32_t n, T* determinant) {
    const std::size_t size = Count(n);
    Scratch<T> lu(size * size);
    Scratch<int32_t> pivots(size);
    if (!lu || !pivots) return kOutOfMemory;
    std::copy_n(a, size * size, lu.data());
    int32_t parity = 0;
    const int32_t status = LUFactor(lu.data(), n, pivots.data(), &parity);
    if (status < 0) return status;
    if (status > 0) {
        *determinant = T{};
        return kOk;
    }
    const T product = DiagonalProduct(lu.data(), size);
    *determinant = parity != 0 ? -product : product;
    return kOk;
}

template <class T>
int32_t DeterminantByCholesky(const T* a, int32_t n, T* determinant) {
    const std::size_t size = Count(n);
    Scratch<T> packed(PackedCount(n));
    if (!packed) return kOutOfMemory;
    if (const int32_t status = PackTriangle(a, n, kLower, packed.data())) return status;
    if (const int32_t status = CholeskyPacked(packed.data(), n)) return status;
    T product = FromReal<T>(1.0);
    for (std::size_t j = 0; j < size; ++j) product *= packed[LowerDiagonal(j, size)];
    *determinant = FromReal<T>(RealPart(product * product));
    return kOk;
}

bool IsHermitian(const double* a, std::size_t n) {
    for (std::size_t i = 0; i < n; ++i)
        for (std::size_t j = i + 1; j < n; ++j)
            if (a[i * n + j] != a[j * n + i]) return false;
    return true;
}

// The diagonal is compared with itself, so it has to be real.
bool IsHermitian(const Complex* a, std::size_t n) {
    for (std::size_t i = 0; i < n; ++i)
        for (std::size_t j = i; j < n; ++j)
            if (!(a[i * n + j] == Conjugate(a[j * n + i]))) return false;
    return true;
}

}  // namespace

template <class T>
int32_t NormCore(const T* a, int32_t m, int32_t n, int32_t type, double* norm) {
    if (const int32_t status = CheckMeasured(a, m, n, type)) return status;
    if (type != kTwoNorm) {
        *norm = SummedNorm(a, m, n, type);
        return kOk;
    }
    const SingularValues<T> s(a, m, n);
    if (s.status() == kOk) *norm = s[0];
    return s.status();
}

template <class T>
int32_t ConditionCore(const T* a, int32_t m, int32_t n, int32_t type, double* condition) {
    if (const int32_t status = CheckMeasured(a, m, n, type)) return status;
    if (type == kTwoNorm) {
        const SingularValues<T> s(a, m, n);
        if (s.status() != kOk) return s.status();
        const double smallest = s[Count(std::min(m, n)) - 1];
        *condition = smallest <= RoundingThreshold(m, n, s[0]) ? kInfinity : s[0] / smallest;
        return kOk;
    }
    if (m != n) return kNotSquare;

    const std::size_t size = Count(n);
    Scratch<T> inverse(size * size);
    Scratch<int32_t> pivots(size);
    if (!inverse || !pivots) return kOutOfMemory;
    std::copy_n(a, size * size, inverse.data());
    int32_t parity = 0;
    const int32_t status = LUFactor(inverse.data(), n, pivots.data(), &parity);
    if (status < 0) return status;
    if (status > 0) {
        *condition = kInfinity;
        return kOk;
    }
    if (const int32_t failed = LUInverse(inverse.data(), pivots.data(), n, inverse.data())) return failed;
    *condition = SummedNorm(a, m, n, type) * SummedNorm(inverse.data(), m, n, type);
    return kOk;
}

template <class T>
int32_t RankCore(const T* a, int32_t m, int32_t n, double tolerance, int32_t* rank) {
    const SingularValues<T> s(a, m, n);
    if (s.status() != kOk) return s.status();
    const double threshold = tolerance >= 0.0 ? tolerance : RoundingThreshold(m, n, s[0]);
    *rank = 0;
    for (std::size_t i = 0; i < Count(std::min(m, n)); ++i)
        if (s[i] > threshold) ++*rank;
    return kOk;
}

template <class T>
int32_t DeterminantCore(const T* a, int32_t n, int32_t type, T* determinant) {
    if (n < 1) return kEmptyInput;
    switch (type) {
        case kGeneralMatrix:
            return DeterminantByLU(a, n, determinant);
        case kPositiveDefinite:
            return DeterminantByCholesky(a, n, determinant);
        case kLowerTriangular:
        case kUpperTriangular:
            *determinant = DiagonalProduct(a, Count(n));
            return kOk;
        default:
            return kBadSelector;
    }
}

template <class T>
int32_t PositiveDefiniteCore(const T* a, int32_t n, int32_t* flag) {
    *flag = 0;
    if (n < 1) return kEmptyInput;
    const std::size_t size = Count(n);
    if (!IsHermitian(a, size)) return kOk;
    Scratch<double> w(size);
    if (!w) return kOutOfMemory;
    int32_t status;
    if constexpr (kIsComplex<T>) {
        if (HasUnusable(a, size * size)) return kNotFinite;
        status = HermitianEigenCore(a, n, 0, w.data(), nullptr);
    } else {
        status = SymEigenCore(a, n, 0, w.data(), nullptr);
    }
    if (status != kOk) return status;
    const double threshold = std::max(std::fabs(w[0]), std::fabs(w[size - 1])) * kEpsilon;
    *flag = std::all_of(w.data(), w.data() + size, [threshold](double x) { return x > threshold; });
    return kOk;
}

#define KRNUMER_INSTANTIATE(T)                                                    \
    template int32_t NormCore(const T*, int32_t, int32_t, int32_t, double*);      \
    template int32_t ConditionCore(const T*, int32_t, int32_t, int32_t, double*); \
    template int32_t RankCore(const T*, int32_t, int32_t, double, int32_t*);      \
    template int32_t DeterminantCore(const T*, int32_t, int32_t, T*);             \
    template int32_t PositiveDefiniteCore(const T*, int32_t, int32_t*);
KRNUMER_INSTANTIATE(double)
KRNUMER_INSTANTIATE(Complex)
#undef KRNUMER_INSTANTIATE

}  // namespace krnumer
