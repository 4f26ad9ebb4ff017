// Vectors of columns as the number type of the butterflies, for the instruction set that is being compiled.
#if defined(KRNUMER_FFT_VECTOR_INL_H) == defined(HWY_TARGET_TOGGLE)
#ifdef KRNUMER_FFT_VECTOR_INL_H
#undef KRNUMER_FFT_VECTOR_INL_H
#else
#define KRNUMER_FFT_VECTOR_INL_H
#endif

#include <cstddef>
#include <cstdint>

#include "fft/inline.h"
#include "frame/complex.h"
#include "hwy/highway.h"

HWY_BEFORE_NAMESPACE();
namespace krnumer::HWY_NAMESPACE {

namespace hn = hwy::HWY_NAMESPACE;

// Targets without vectors of doubles are served by the plain butterflies.
#define KRNUMER_FFT_HAS_VECTORS (HWY_TARGET != HWY_SCALAR && HWY_TARGET != HWY_EMU128)
#define KRNUMER_FFT_HAS_FMA (HWY_TARGET == HWY_AVX2 || HWY_TARGET == HWY_AVX3)

#if HWY_TARGET == HWY_AVX3
inline constexpr size_t kLanes = 8;
#elif HWY_TARGET == HWY_AVX2
inline constexpr size_t kLanes = 4;
#else
inline constexpr size_t kLanes = 2;
#endif

#if KRNUMER_FFT_HAS_VECTORS

template <size_t N>
using Tag = hn::FixedTag<double, N>;
template <size_t N>
using Mask = hn::Mask<Tag<N>>;

// The default constructors are written out because an implied one would not be compiled for this instruction set, and
// compilers refuse to inline vectors there.

// N real columns.
template <size_t N>
struct RealColumns {
    hn::Vec<Tag<N>> v;

    KRNUMER_FFT_INLINE RealColumns() {}
    KRNUMER_FFT_INLINE RealColumns(hn::Vec<Tag<N>> columns) : v(columns) {}

    friend KRNUMER_FFT_INLINE RealColumns operator+(RealColumns a, RealColumns b) { return {hn::Add(a.v, b.v)}; }
    friend KRNUMER_FFT_INLINE RealColumns operator-(RealColumns a, RealColumns b) { return {hn::Sub(a.v, b.v)}; }
    friend KRNUMER_FFT_INLINE RealColumns operator-(RealColumns a) { return {hn::Neg(a.v)}; }
    friend KRNUMER_FFT_INLINE RealColumns operator*(RealColumns a, double b) {
        return {hn::Mul(a.v, hn::Set(Tag<N>(), b))};
    }
    friend KRNUMER_FFT_INLINE RealColumns operator*(RealColumns a, RealColumns b) { return {hn::Mul(a.v, b.v)}; }
};

// N/2 complex columns, real and imaginary parts side by side.
template <size_t N>
struct ComplexColumns {
    hn::Vec<Tag<N>> v;

    KRNUMER_FFT_INLINE ComplexColumns() {}
    KRNUMER_FFT_INLINE ComplexColumns(hn::Vec<Tag<N>> columns) : v(columns) {}

    friend KRNUMER_FFT_INLINE ComplexColumns operator+(ComplexColumns a, ComplexColumns b) {
        return {hn::Add(a.v, b.v)};
    }
    friend KRNUMER_FFT_INLINE ComplexColumns operator-(ComplexColumns a, ComplexColumns b) {
        return {hn::Sub(a.v, b.v)};
    }
    friend KRNUMER_FFT_INLINE ComplexColumns operator*(ComplexColumns a, double b) {
        return {hn::Mul(a.v, hn::Set(Tag<N>(), b))};
    }
};

// N complex columns, real and imaginary parts in vectors of their own.
template <size_t N>
struct SplitColumns {
    RealColumns<N> re, im;

    KRNUMER_FFT_INLINE SplitColumns() {}
    KRNUMER_FFT_INLINE SplitColumns(RealColumns<N> real, RealColumns<N> imaginary) : re(real), im(imaginary) {}

    friend KRNUMER_FFT_INLINE SplitColumns operator+(SplitColumns a, SplitColumns b) {
        return {a.re + b.re, a.im + b.im};
    }
    friend KRNUMER_FFT_INLINE SplitColumns operator-(SplitColumns a, SplitColumns b) {
        return {a.re - b.re, a.im - b.im};
    }
    friend KRNUMER_FFT_INLINE SplitColumns operator*(SplitColumns a, double b) { return {a.re * b, a.im * b}; }
};

template <size_t N>
KRNUMER_FFT_INLINE SplitColumns<N> AddI(SplitColumns<N> a, SplitColumns<N> b) {
    return {a.re - b.im, a.im + b.re};
}
template <size_t N>
KRNUMER_FFT_INLINE SplitColumns<N> SubtractI(SplitColumns<N> a, SplitColumns<N> b) {
    return {a.re + b.im, a.im - b.re};
}
template <size_t N>
KRNUMER_FFT_INLINE SplitColumns<N> Rotate(SplitColumns<N> a, double re, double im) {
    return {a.re * re - a.im * im, a.re * im + a.im * re};
}
template <size_t N>
KRNUMER_FFT_INLINE SplitColumns<N> Rotate(SplitColumns<N> a, SplitColumns<N> w) {
    return {a.re * w.re - a.im * w.im, a.re * w.im + a.im * w.re};
}

// a - b in the real places and a + b in the imaginary ones, and the other way round. With a factor of exactly 1 the
// fused forms round once, as the sum does.
#if KRNUMER_FFT_HAS_FMA
#if HWY_TARGET == HWY_AVX3
KRNUMER_FFT_INLINE hn::Vec<Tag<8>> SubtractAdd(hn::Vec<Tag<8>> a, hn::Vec<Tag<8>> b) {
    return hn::Vec<Tag<8>>{_mm512_fmaddsub_pd(a.raw, _mm512_set1_pd(1.0), b.raw)};
}
KRNUMER_FFT_INLINE hn::Vec<Tag<8>> AddSubtract(hn::Vec<Tag<8>> a, hn::Vec<Tag<8>> b) {
    return hn::Vec<Tag<8>>{_mm512_fmsubadd_pd(a.raw, _mm512_set1_pd(1.0), b.raw)};
}
#endif
KRNUMER_FFT_INLINE hn::Vec<Tag<4>> SubtractAdd(hn::Vec<Tag<4>> a, hn::Vec<Tag<4>> b) {
    return hn::Vec<Tag<4>>{_mm256_addsub_pd(a.raw, b.raw)};
}
KRNUMER_FFT_INLINE hn::Vec<Tag<4>> AddSubtract(hn::Vec<Tag<4>> a, hn::Vec<Tag<4>> b) {
    return hn::Vec<Tag<4>>{_mm256_fmsubadd_pd(a.raw, _mm256_set1_pd(1.0), b.raw)};
}
KRNUMER_FFT_INLINE hn::Vec<Tag<2>> SubtractAdd(hn::Vec<Tag<2>> a, hn::Vec<Tag<2>> b) {
    return hn::Vec<Tag<2>>{_mm_addsub_pd(a.raw, b.raw)};
}
KRNUMER_FFT_INLINE hn::Vec<Tag<2>> AddSubtract(hn::Vec<Tag<2>> a, hn::Vec<Tag<2>> b) {
    return hn::Vec<Tag<2>>{_mm_fmsubadd_pd(a.raw, _mm_set1_pd(1.0), b.raw)};
}
#else
KRNUMER_FFT_INLINE hn::Vec<Tag<2>> NegatedReal(hn::Vec<Tag<2>> a) {
    alignas(16) static constexpr double kSigns[2] = {-0.0, 0.0};
    return hn::Xor(a, hn::Load(Tag<2>(), kSigns));
}
KRNUMER_FFT_INLINE hn::Vec<Tag<2>> SubtractAdd(hn::Vec<Tag<2>> a, hn::Vec<Tag<2>> b) {
    return hn::Add(a, NegatedReal(b));
}
KRNUMER_FFT_INLINE hn::Vec<Tag<2>> AddSubtract(hn::Vec<Tag<2>> a, hn::Vec<Tag<2>> b) {
    return hn::Sub(a, NegatedReal(b));
}
#endif

template <size_t N>
KRNUMER_FFT_INLINE ComplexColumns<N> AddI(ComplexColumns<N> a, ComplexColumns<N> b) {
    return {SubtractAdd(a.v, hn::Shuffle01(b.v))};
}
template <size_t N>
KRNUMER_FFT_INLINE ComplexColumns<N> SubtractI(ComplexColumns<N> a, ComplexColumns<N> b) {
    return {AddSubtract(a.v, hn::Shuffle01(b.v))};
}
template <size_t N>
KRNUMER_FFT_INLINE ComplexColumns<N> Rotate(ComplexColumns<N> a, double re, double im) {
    const Tag<N> d;
    return {SubtractAdd(hn::Mul(a.v, hn::Set(d, re)), hn::Mul(hn::Shuffle01(a.v), hn::Set(d, im)))};
}
template <size_t N>
KRNUMER_FFT_INLINE ComplexColumns<N> Rotate(ComplexColumns<N> a, ComplexColumns<N> w) {
    return {SubtractAdd(hn::Mul(a.v, hn::DupEven(w.v)), hn::Mul(hn::Shuffle01(a.v), hn::DupOdd(w.v)))};
}

// N split columns as the even and the odd ones of N/2 complex columns each, and back.
template <size_t N>
KRNUMER_FFT_INLINE void Interleave(SplitColumns<N> split, ComplexColumns<N>& even, ComplexColumns<N>& odd) {
    const Tag<N> d;
    even = {hn::InterleaveLower(d, split.re.v, split.im.v)};
    odd = {hn::InterleaveUpper(d, split.re.v, split.im.v)};
}
template <size_t N>
KRNUMER_FFT_INLINE SplitColumns<N> Deinterleave(ComplexColumns<N> even, ComplexColumns<N> odd) {
    const Tag<N> d;
    return {{hn::InterleaveLower(d, even.v, odd.v)}, {hn::InterleaveUpper(d, even.v, odd.v)}};
}

// ---- Transposition: vectors of one index and many columns become runs of one column ----

// 128-bit halves and quarters of vectors: complex numbers of columns.
KRNUMER_FFT_INLINE void TransposePairs(hn::Vec<Tag<2>>*) {}

#if KRNUMER_FFT_HAS_FMA
KRNUMER_FFT_INLINE void TransposePairs(hn::Vec<Tag<4>>* rows) {
    const Tag<4> d;
    const auto a = rows[0];
    rows[0] = hn::ConcatLowerLower(d, rows[1], a);
    rows[1] = hn::ConcatUpperUpper(d, rows[1], a);
}
#endif
#if HWY_TARGET == HWY_AVX3
KRNUMER_FFT_INLINE void TransposePairs(hn::Vec<Tag<8>>* rows) {
    const __m512d ab_lower = _mm512_shuffle_f64x2(rows[0].raw, rows[1].raw, 0x44);
    const __m512d ab_upper = _mm512_shuffle_f64x2(rows[0].raw, rows[1].raw, 0xEE);
    const __m512d cd_lower = _mm512_shuffle_f64x2(rows[2].raw, rows[3].raw, 0x44);
    const __m512d cd_upper = _mm512_shuffle_f64x2(rows[2].raw, rows[3].raw, 0xEE);
    rows[0].raw = _mm512_shuffle_f64x2(ab_lower, cd_lower, 0x88);
    rows[1].raw = _mm512_shuffle_f64x2(ab_lower, cd_lower, 0xDD);
    rows[2].raw = _mm512_shuffle_f64x2(ab_upper, cd_upper, 0x88);
    rows[3].raw = _mm512_shuffle_f64x2(ab_upper, cd_upper, 0xDD);
}
#endif

// N vectors of N doubles: pairs within 128 bits first, then those pairs as above.
template <size_t N>
KRNUMER_FFT_INLINE void Transpose(hn::Vec<Tag<N>>* rows) {
    const Tag<N> d;
    hn::Vec<Tag<N>> even[N / 2], odd[N / 2];
    for (size_t i = 0; i < N / 2; ++i) {
        even[i] = hn::InterleaveLower(d, rows[2 * i], rows[2 * i + 1]);
        odd[i] = hn::InterleaveUpper(d, rows[2 * i], rows[2 * i + 1]);
    }
    TransposePairs(even);
    TransposePairs(odd);
    for (size_t i = 0; i < N / 2; ++i) {
        rows[2 * i] = even[i];
        rows[2 * i + 1] = odd[i];
    }
}

#endif  // KRNUMER_FFT_HAS_VECTORS

}  // namespace krnumer::HWY_NAMESPACE
HWY_AFTER_NAMESPACE();

#endif
