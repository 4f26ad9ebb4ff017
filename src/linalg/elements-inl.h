// Vectors of real or complex elements; real and imaginary parts of complex ones alternate. Included by sources that are
// compiled for every vector unit. The units have fused products, which would round differently; none is used, so every
// unit gives the same. That is also why complex arithmetic is written out in vectors: where the compiler finds it by
// itself, it fuses it.

#if defined(KRNUMER_LINALG_ELEMENTS_INL_H) == defined(HWY_TARGET_TOGGLE)
#ifdef KRNUMER_LINALG_ELEMENTS_INL_H
#undef KRNUMER_LINALG_ELEMENTS_INL_H
#else
#define KRNUMER_LINALG_ELEMENTS_INL_H
#endif

#include <hwy/highway.h>

#include <cstddef>

#include "linalg/element.h"

#if HWY_TARGET != HWY_SCALAR
HWY_BEFORE_NAMESPACE();
namespace krnumer::HWY_NAMESPACE {

namespace hn = hwy::HWY_NAMESPACE;

// Elements in a vector.
template <class D, class T>
inline constexpr std::size_t kElements = hn::MaxLanes(D()) / (sizeof(T) / sizeof(double));

template <class D, class T>
HWY_INLINE hn::Vec<D> LoadElements(D d, const T* elements) {
    return hn::LoadU(d, reinterpret_cast<const double*>(elements));
}

template <class D, class T>
HWY_INLINE void StoreElements(hn::Vec<D> v, D d, T* elements) {
    hn::StoreU(v, d, reinterpret_cast<double*>(elements));
}

// A vector of a row, ready to be multiplied by single elements, which may be conjugated.
template <class D, class T>
struct RowVector {
    using V = hn::Vec<D>;

    HWY_INLINE RowVector(D, V elements, bool) : row(elements) {}
    HWY_INLINE V Times(D d, const T* a) const { return hn::Mul(hn::Set(d, *a), row); }

    V row;
};

// a b = a.re (b.re, b.im) + a.im (-b.im, b.re), or with (b.im, -b.re) if a is conjugated.
template <class D>
struct RowVector<D, Complex> {
    using V = hn::Vec<D>;

    HWY_INLINE RowVector(D d, V elements, bool conjugate_a)
        : row(elements), turned(hn::Xor(hn::Shuffle01(row), Signs(d, conjugate_a))) {}
    HWY_INLINE V Times(D d, const Complex* a) const {
        return hn::Add(hn::Mul(hn::Set(d, a->re), row), hn::Mul(hn::Set(d, a->im), turned));
    }
    static HWY_INLINE V Signs(D d, bool conjugate_a) {
        alignas(16) static constexpr double kSigns[3] = {-0.0, 0.0, -0.0};
        alignas(16) const double signs[2] = {kSigns[conjugate_a], kSigns[conjugate_a + 1]};
        return hn::LoadDup128(d, signs);
    }

    V row, turned;
};

// A vector of a row, ready to be multiplied element by element by others after its conjugation.
template <class D, class T>
struct ConjugateWeights {
    using V = hn::Vec<D>;

    HWY_INLINE ConjugateWeights(D, V elements) : weights(elements) {}
    HWY_INLINE V Times(D, V x) const { return hn::Mul(weights, x); }

    V weights;
};

// conj(w) x = w.re (x.re, x.im) + w.im (x.im, -x.re).
template <class D>
struct ConjugateWeights<D, Complex> {
    using V = hn::Vec<D>;

    HWY_INLINE ConjugateWeights(D, V elements) : re(hn::DupEven(elements)), im(hn::DupOdd(elements)) {}
    HWY_INLINE V Times(D d, V x) const {
        return hn::Add(hn::Mul(re, x), hn::Mul(im, RowVector<D, Complex>(d, x, true).turned));
    }

    V re, im;
};

// As many vectors as there are elements in one, transposed.
template <class T, class D>
HWY_INLINE void TransposeElements(D d, hn::Vec<D>* rows) {
    using V = hn::Vec<D>;
    constexpr std::size_t kCount = kElements<D, T>;
    static_assert(kCount <= 4 && (kCount < 4 || sizeof(T) == sizeof(double)));
    if constexpr (kCount == 2 && sizeof(T) > sizeof(double)) {
        const V first = hn::ConcatLowerLower(d, rows[1], rows[0]);
        rows[1] = hn::ConcatUpperUpper(d, rows[1], rows[0]);
        rows[0] = first;
    } else if constexpr (kCount == 2) {
        const V first = hn::InterleaveLower(d, rows[0], rows[1]);
        rows[1] = hn::InterleaveUpper(d, rows[0], rows[1]);
        rows[0] = first;
    } else if constexpr (kCount == 4) {
        const V even01 = hn::InterleaveLower(d, rows[0], rows[1]), odd01 = hn::InterleaveUpper(d, rows[0], rows[1]);
        const V even23 = hn::InterleaveLower(d, rows[2], rows[3]), odd23 = hn::InterleaveUpper(d, rows[2], rows[3]);
        rows[0] = hn::ConcatLowerLower(d, even23, even01);
        rows[1] = hn::ConcatLowerLower(d, odd23, odd01);
        rows[2] = hn::ConcatUpperUpper(d, even23, even01);
        rows[3] = hn::ConcatUpperUpper(d, odd23, odd01);
    }
}

// Calls columns(tag, column), which returns the first column that is left, for vectors of falling length.
template <class T, class Columns>
HWY_INLINE void ByFallingLength(std::size_t column, Columns columns) {
    constexpr hn::ScalableTag<double> kFull;
    column = columns(kFull, column);
    if constexpr (hn::MaxLanes(kFull) > 4) column = columns(hn::CappedTag<double, 4>(), column);
    if constexpr (hn::MaxLanes(kFull) > 2) column = columns(hn::CappedTag<double, 2>(), column);
    if constexpr (!kIsComplex<T>) columns(hn::CappedTag<double, 1>(), column);
}

}  // namespace krnumer::HWY_NAMESPACE
HWY_AFTER_NAMESPACE();
#endif

#endif
