#include "linalg/lu_solve.h"

#include <algorithm>
#include <cstddef>
#include <functional>
#include <numeric>
#include <utility>

#include "frame/numeric.h"
#include "frame/scratch.h"
#include "frame/status.h"
#include "linalg/element.h"
#include "linalg/factor_kernels.h"
#include "linalg/finite.h"
#include "linalg/lu.h"
#include "linalg/row_sums.h"

namespace krnumer {
namespace {

// Forward substitution takes this many rows at a time: their sums over what is known already run side by side.
constexpr size_t kTogether = 4;

template <class T>
void SolveUnitLower(const T* lu, size_t n, T* x) {
    for (size_t first = 0; first < n; first += kTogether) {
        const size_t count = std::min(kTogether, n - first);
        const T* const rows = lu + first * n;
        T sums[kTogether];
        ForEachRowSum(rows, static_cast<std::ptrdiff_t>(n), static_cast<std::ptrdiff_t>(count),
                      static_cast<std::ptrdiff_t>(first), x, [&sums](std::ptrdiff_t row, T sum) { sums[row] = sum; });
        for (size_t row = 0; row < count; ++row) {
            for (size_t j = first; j < first + row; ++j) sums[row] += rows[row * n + j] * x[j];
            x[first + row] -= sums[row];
        }
    }
}

template <class T>
int32_t SolveUpper(const T* lu, size_t n, T* x) {
    for (size_t i = n; i-- > 0;) {
        const T* const row = lu + i * n;
        if (row[i] == T{}) return kSingular;
        T sum{};
        for (size_t j = i + 1; j < n; ++j) sum += row[j] * x[j];
        x[i] = (x[i] - sum) / row[i];
    }
    return kOk;
}

// The two substitutions on neighbouring columns of a matrix at once, each column by the same operations as above.
template <class T>
class Strip {
  public:
    // At most this many columns, which the cache keeps from one row to the next.
    static constexpr size_t kWidth = 64;

    // x: n rows of `count` elements.
    Strip(const T* lu, size_t n, T* x, size_t count) : lu_(lu), n_(n), x_(x), count_(count) {}

    // The rows before `begin` are zero and stay so.
    void SolveUnitLower(size_t begin) {
        for (size_t first = begin; first < n_; first += kTogether) {
            const size_t rows = std::min(kTogether, n_ - first);
            std::fill_n(sums_, rows * count_, T{});
            SubtractTerms(first, rows, begin, first, sums_);
            for (size_t row = first; row < first + rows; ++row) {
                T* const sum = sums_ + (row - first) * count_;
                SubtractTerms(row, 1, first, row, sum);
                std::transform(Row(row), Row(row) + count_, sum, Row(row), std::plus<>());
            }
        }
    }

    void SolveUpper() {
        for (size_t i = n_; i-- > 0;) {
            const T pivot = lu_[i * n_ + i];
            if (pivot == T{}) return;
            std::fill_n(sums_, count_, T{});
            SubtractTerms(i, 1, i + 1, n_, sums_);
            for (size_t j = 0; j < count_; ++j) Row(i)[j] = (Row(i)[j] + sums_[j]) / pivot;
        }
    }

  private:
    T* Row(size_t i) { return x_ + i * count_; }

    // sums -= rows of the factor, from column `term` up to `end`, times the rows of X with these numbers.
    void SubtractTerms(size_t row, size_t rows, size_t term, size_t end, T* sums) {
        if (term == end) return;
        SubtractProduct(ProductOperands<T>{.c = sums,
                                           .c_row = {count_},
                                           .a = lu_ + row * n_ + term,
                                           .a_row = n_,
                                           .a_term = {1},
                                           .b = Row(term),
                                           .b_term = {count_},
                                           .rows = rows,
                                           .columns = count_,
                                           .terms = end - term});
    }

    const T* lu_;
    size_t n_;
    T* x_;
    size_t count_;
    T sums_[kTogether * kWidth];
};

}  // namespace

int32_t CheckPivots(const int32_t* pivots, int32_t n) {
    const bool fit = std::all_of(pivots, pivots + Count(n), [n](int32_t row) { return row >= 0 && row < n; });
    return fit ? kOk : kBadIndex;
}

template <class T>
int32_t LUSolve(const T* lu, const int32_t* pivots, const T* b, int32_t n, T* x) {
    if (n < 1) return kEmptyInput;
    if (x != b) std::copy_n(b, n, x);
    for (size_t i = 0; i < Count(n); ++i) std::swap(x[i], x[Count(pivots[i])]);
    SolveUnitLower(lu, Count(n), x);
    return SolveUpper(lu, Count(n), x);
}

template <class T>
int32_t LUInverse(const T* lu, const int32_t* pivots, int32_t order, T* inverse) {
    if (order < 1) return kEmptyInput;
    const size_t n = Count(order), strip_count = n * std::min(n, Strip<T>::kWidth);
    Scratch<T> work(strip_count + (inverse == lu ? n * n : 0));
    Scratch<int32_t> places(n);
    if (!work || !places) return kOutOfMemory;
    T* const x = work.data();
    if (inverse == lu) {
        std::copy_n(lu, n * n, x + strip_count);
        lu = x + strip_count;
    }
    // The columns of the inverse of L U are exchanged as the rows of A were.
    int32_t* const place = places.data();
    std::iota(place, place + n, 0);
    for (size_t i = 0; i < n; ++i) std::swap(place[i], place[Count(pivots[i])]);

    // Products with zeros may be NaN where the factors are not finite.
    const bool skips_zeros = n > Strip<T>::kWidth && !HasUnusable(lu, n * n);
    for (size_t first = 0; first < n; first += Strip<T>::kWidth) {
        const size_t count = std::min(n - first, Strip<T>::kWidth);
        std::fill_n(x, n * count, T{});
        for (size_t j = 0; j < count; ++j) x[(first + j) * count + j] = FromReal<T>(1.0);
        Strip<T> strip(lu, n, x, count);
        strip.SolveUnitLower(skips_zeros ? first : 0);
        strip.SolveUpper();
        for (size_t i = 0; i < n; ++i)
            for (size_t j = 0; j < count; ++j) inverse[i * n + Count(place[first + j])] = x[i * count + j];
    }
    return kOk;
}

template <class T>
int32_t LUSolveDirect(const T* a, int32_t n, const T* b, T* x) {
    if (n < 1) return kEmptyInput;
    Scratch<T> factors(Count(n) * Count(n));
    Scratch<int32_t> pivots(Count(n));
    if (!factors || !pivots) return kOutOfMemory;
    std::copy_n(a, Count(n) * Count(n), factors.data());
    int32_t parity = 0;
    if (LUFactor(factors.data(), n, pivots.data(), &parity) == kWarnZeroPivot) return kSingular;
    return LUSolve(factors.data(), pivots.data(), b, n, x);
}

template <class T>
int32_t InvertByLU(T* a, int32_t n) {
    if (n < 1) return kEmptyInput;
    Scratch<int32_t> pivots(Count(n));
    if (!pivots) return kOutOfMemory;
    int32_t parity = 0;
    if (LUFactor(a, n, pivots.data(), &parity) == kWarnZeroPivot) return kSingular;
    return LUInverse(a, pivots.data(), n, a);
}

#define KRNUMER_INSTANTIATE(T)                                                 \
    template int32_t LUSolve(const T*, const int32_t*, const T*, int32_t, T*); \
    template int32_t LUInverse(const T*, const int32_t*, int32_t, T*);         \
    template int32_t LUSolveDirect(const T*, int32_t, const T*, T*);           \
    template int32_t InvertByLU(T*, int32_t);
KRNUMER_INSTANTIATE(double)
KRNUMER_INSTANTIATE(Complex)
#undef KRNUMER_INSTANTIATE

}  // namespace krnumer
