// Compiled once for every kind of vector unit that the machine may have.
#include "linalg/householder.h"

#include <algorithm>
#include <type_traits>

#include "frame/vector_targets.h"

#undef HWY_TARGET_INCLUDE
#define HWY_TARGET_INCLUDE "linalg/householder.cpp"
#include <hwy/foreach_target.h>
#include <hwy/highway.h>

#include "linalg/elements-inl.h"

#ifndef KRNUMER_LINALG_HOUSEHOLDER_PLAIN
#define KRNUMER_LINALG_HOUSEHOLDER_PLAIN
namespace krnumer {
namespace {

// The loops over a block. reflect_rows begins with add_products where there is a v.
template <class T>
struct Kernels {
    void (*sum_columns)(Spaced<T> v, const Block<T>& block, T* sums);
    void (*add_products)(Spaced<T> v, const T* sums, const Block<T>& block);
    void (*reflect_rows)(Spaced<T> v, const T* sums, const T* r, const T* scaled, const Block<T>& block);
};

// Without vectors, for so few elements that these are not worth their call.
namespace plain {

template <class T>
void SumColumns(Spaced<T> v, const Block<T>& block, T* sums) {
    std::fill_n(sums, block.columns, T{});
    for (std::ptrdiff_t k = 0; k < block.rows; ++k) {
        const T factor = Conjugate(v[k]);
        const T* const row = block.Row(k);
        for (std::ptrdiff_t j = 0; j < block.columns; ++j) sums[j] += factor * row[j];
    }
}

template <class T>
void AddProducts(Spaced<T> v, const T* sums, const Block<T>& block) {
    for (std::ptrdiff_t k = 0; k < block.rows; ++k) {
        const T factor = v[k];
        T* const row = block.Row(k);
        for (std::ptrdiff_t j = 0; j < block.columns; ++j) row[j] += factor * sums[j];
    }
}

template <class T>
void ReflectRows(Spaced<T> v, const T* sums, const T* r, const T* scaled, const Block<T>& block) {
    if (v.elements != nullptr) plain::AddProducts(v, sums, block);
    for (std::ptrdiff_t k = 0; k < block.rows; ++k) {
        T* const row = block.Row(k);
        T sum{};
        for (std::ptrdiff_t j = 0; j < block.columns; ++j) sum += row[j] * Conjugate(r[j]);
        for (std::ptrdiff_t j = 0; j < block.columns; ++j) row[j] += sum * scaled[j];
    }
}

template <class T>
constexpr Kernels<T> kKernels{SumColumns<T>, AddProducts<T>, ReflectRows<T>};

}  // namespace plain
}  // namespace
}  // namespace krnumer
#endif

HWY_BEFORE_NAMESPACE();
namespace krnumer::HWY_NAMESPACE {
namespace {

namespace hn = hwy::HWY_NAMESPACE;

#if HWY_TARGET == HWY_SCALAR

using plain::kKernels;

#else

// sums += conj(v) rows, for rows from `first` on.
template <size_t kRows, class T>
void SumRows(Spaced<T> v, const Block<T>& block, std::ptrdiff_t first, T* sums) {
    T factors[kRows];
    for (size_t row = 0; row < kRows; ++row) factors[row] = v[first + static_cast<std::ptrdiff_t>(row)];
    const T* const elements = block.Row(first);
    const auto stride = static_cast<size_t>(block.stride), columns = static_cast<size_t>(block.columns);
    ByFallingLength<T>(0, [&](auto d, size_t j) HWY_ATTR {
        constexpr size_t kStep = kElements<decltype(d), T>;
        for (; j + kStep <= columns; j += kStep) {
            auto sum = LoadElements(d, sums + j);
            for (size_t row = 0; row < kRows; ++row) {
                const RowVector<decltype(d), T> x(d, LoadElements(d, elements + row * stride + j), true);
                sum = hn::Add(sum, x.Times(d, &factors[row]));
            }
            StoreElements(sum, d, sums + j);
        }
        return j;
    });
}

template <class T>
void SumColumns(Spaced<T> v, const Block<T>& block, T* sums) {
    constexpr std::ptrdiff_t kTogether = kIsComplex<T> ? 4 : 8;
    std::fill_n(sums, block.columns, T{});
    std::ptrdiff_t k = 0;
    for (; k + kTogether <= block.rows; k += kTogether) SumRows<kTogether>(v, block, k, sums);
    for (; k < block.rows; ++k) SumRows<1>(v, block, k, sums);
}

// Rows from `first` on += factors sums.
template <size_t kRows, class T>
void AddToRows(const T* factors, const T* sums, const Block<T>& block, std::ptrdiff_t first) {
    T* const elements = block.Row(first);
    const auto stride = static_cast<size_t>(block.stride), columns = static_cast<size_t>(block.columns);
    ByFallingLength<T>(0, [&](auto d, size_t j) HWY_ATTR {
        constexpr size_t kStep = kElements<decltype(d), T>;
        for (; j + kStep <= columns; j += kStep) {
            const RowVector<decltype(d), T> sum(d, LoadElements(d, sums + j), false);
            for (size_t row = 0; row < kRows; ++row) {
                T* const x = elements + row * stride + j;
                StoreElements(hn::Add(LoadElements(d, x), sum.Times(d, &factors[row])), d, x);
            }
        }
        return j;
    });
}

template <class T>
void AddProducts(Spaced<T> v, const T* sums, const Block<T>& block) {
    constexpr std::ptrdiff_t kTogether = 4;
    std::ptrdiff_t k = 0;
    for (; k + kTogether <= block.rows; k += kTogether) {
        const T factors[kTogether] = {v[k], v[k + 1], v[k + 2], v[k + 3]};
        AddToRows<kTogether>(factors, sums, block, k);
    }
    for (; k < block.rows; ++k) AddToRows<1>(&v[k], sums, block, k);
}

// A few rows that are multiplied by conj(r) and, if kAdds, changed by v sums before.
template <bool kAdds, size_t kRows, class T>
class RowGroup {
  public:
    RowGroup(Spaced<T> v, const T* sums, const T* r, const Block<T>& block, std::ptrdiff_t first)
        : sums_(sums),
          r_(r),
          elements_(block.Row(first)),
          stride_(static_cast<size_t>(block.stride)),
          columns_(static_cast<size_t>(block.columns)) {
        if constexpr (kAdds)
            for (size_t row = 0; row < kRows; ++row) factors_[row] = v[first + static_cast<std::ptrdiff_t>(row)];
    }

    // The sums of products from column j on, until the columns that are left do not fill a vector: a vector of the sums
    // of some rows grows by the vectors of their products, transposed.
    template <class D>
    HWY_INLINE size_t Sum(D d, size_t j) {
        using V = hn::Vec<D>;
        constexpr size_t kStep = kElements<D, T>, kVectors = kRows / kStep;
        V running[kVectors];
        for (size_t q = 0; q < kVectors; ++q) running[q] = LoadElements(d, totals_ + q * kStep);
        for (; j + kStep <= columns_; j += kStep) {
            const RowVector<D, T> sum(d, kAdds ? LoadElements(d, sums_ + j) : hn::Zero(d), false);
            const ConjugateWeights<D, T> weights(d, LoadElements(d, r_ + j));
            for (size_t q = 0; q < kVectors; ++q) {
                V products[kStep];
                for (size_t i = 0; i < kStep; ++i) {
                    const size_t row = q * kStep + i;
                    T* const place = elements_ + row * stride_ + j;
                    V x = LoadElements(d, place);
                    if constexpr (kAdds) {
                        x = hn::Add(x, sum.Times(d, &factors_[row]));
                        StoreElements(x, d, place);
                    }
                    products[i] = weights.Times(d, x);
                }
                TransposeElements<T>(d, products);
                for (size_t i = 0; i < kStep; ++i) running[q] = hn::Add(running[q], products[i]);
            }
        }
        for (size_t q = 0; q < kVectors; ++q) StoreElements(running[q], d, totals_ + q * kStep);
        return j;
    }

    const T* totals() const { return totals_; }

  private:
    const T* sums_;
    const T* r_;
    T* elements_;
    size_t stride_, columns_;
    T factors_[kRows];
    T totals_[kRows] = {};
};

template <bool kAdds, class T>
void ReflectRowsAfter(Spaced<T> v, const T* sums, const T* r, const T* scaled, const Block<T>& block) {
    constexpr hn::CappedTag<double, 4> kWide;
    constexpr hn::CappedTag<double, sizeof(T) / sizeof(double)> kSingle;
    constexpr size_t kStep = kElements<decltype(kWide), T>;
    const auto reflect = [&](auto together, std::ptrdiff_t first) HWY_ATTR {
        constexpr size_t kRows = decltype(together)::value;
        RowGroup<kAdds, kRows, T> group(v, sums, r, block, first);
        size_t j = 0;
        if constexpr (kRows % kStep == 0) j = group.Sum(kWide, j);
        group.Sum(kSingle, j);
        AddToRows<kRows>(group.totals(), scaled, block, first);
    };
    std::ptrdiff_t k = 0;
    const auto reflect_all = [&](auto together) HWY_ATTR {
        for (; k + together <= block.rows; k += together) reflect(together, k);
    };
    reflect_all(std::integral_constant<std::ptrdiff_t, 4 * kStep>());
    reflect_all(std::integral_constant<std::ptrdiff_t, 2 * kStep>());
    reflect_all(std::integral_constant<std::ptrdiff_t, kStep>());
    if constexpr (kStep > 2) reflect_all(std::integral_constant<std::ptrdiff_t, kStep / 2>());
    reflect_all(std::integral_constant<std::ptrdiff_t, 1>());
}

template <class T>
void ReflectRows(Spaced<T> v, const T* sums, const T* r, const T* scaled, const Block<T>& block) {
    if (v.elements != nullptr) {
        ReflectRowsAfter<true>(v, sums, r, scaled, block);
    } else {
        ReflectRowsAfter<false>(v, sums, r, scaled, block);
    }
}

template <class T>
constexpr Kernels<T> kKernels{SumColumns<T>, AddProducts<T>, ReflectRows<T>};

#endif  // HWY_TARGET

const Kernels<double>& RealKernels() {
    return kKernels<double>;
}
const Kernels<Complex>& ComplexKernels() {
    return kKernels<Complex>;
}

}  // namespace
}  // namespace krnumer::HWY_NAMESPACE
HWY_AFTER_NAMESPACE();

#if HWY_ONCE
namespace krnumer {

HWY_EXPORT(RealKernels);
HWY_EXPORT(ComplexKernels);

namespace {

template <class T>
const Kernels<T>& KernelsFor(const Block<T>& block) {
    constexpr std::ptrdiff_t kSmall = 32;
    if (block.rows * block.columns < kSmall) return plain::kKernels<T>;
    if constexpr (kIsComplex<T>) {
        return HWY_DYNAMIC_DISPATCH(ComplexKernels)();
    } else {
        return HWY_DYNAMIC_DISPATCH(RealKernels)();
    }
}

}  // namespace

template <class T>
void SumColumns(Spaced<T> v, const Block<T>& block, T* sums) {
    KernelsFor(block).sum_columns(v, block, sums);
}

template <class T>
void AddProducts(Spaced<T> v, const T* sums, const Block<T>& block) {
    KernelsFor(block).add_products(v, sums, block);
}

template <class T>
void ReflectRows(const T* r, const T* scaled, const Block<T>& block) {
    KernelsFor(block).reflect_rows({}, nullptr, r, scaled, block);
}

template <class T>
void AddProductsAndReflectRows(Spaced<T> v, const T* sums, const T* r, const T* scaled, const Block<T>& block) {
    KernelsFor(block).reflect_rows(v, sums, r, scaled, block);
}

#define KRNUMER_INSTANTIATE(T)                                       \
    template void SumColumns(Spaced<T>, const Block<T>&, T*);        \
    template void AddProducts(Spaced<T>, const T*, const Block<T>&); \
    template void ReflectRows(const T*, const T*, const Block<T>&);  \
    template void AddProductsAndReflectRows(Spaced<T>, const T*, const T*, const T*, const Block<T>&);
KRNUMER_INSTANTIATE(double)
KRNUMER_INSTANTIATE(Complex)
#undef KRNUMER_INSTANTIATE

}  // namespace krnumer
#endif
