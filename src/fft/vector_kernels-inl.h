// The kernels of one radix for the instruction set that is being compiled.
#if defined(KRNUMER_FFT_VECTOR_KERNELS_INL_H) == defined(HWY_TARGET_TOGGLE)
#ifdef KRNUMER_FFT_VECTOR_KERNELS_INL_H
#undef KRNUMER_FFT_VECTOR_KERNELS_INL_H
#else
#define KRNUMER_FFT_VECTOR_KERNELS_INL_H
#endif

#include <algorithm>
#include <type_traits>

#include "fft/vector-inl.h"
#include "fft/vector_kernels.h"
#include "frame/numeric.h"

HWY_BEFORE_NAMESPACE();
namespace krnumer::HWY_NAMESPACE {

#if KRNUMER_FFT_HAS_VECTORS

#include "fft/dft-inl.h"

// Large butterflies are compiled once and work in memory; they have more values than there are registers anyway.
template <int r>
inline constexpr bool kLarge = r > 19 && r != 32;

// Sanitizers would spend minutes on every copy of a small one.
#if defined(__SANITIZE_ADDRESS__) || defined(__SANITIZE_THREAD__)
template <int r>
inline constexpr bool kInlined = false;
#else
template <int r>
inline constexpr bool kInlined = !kLarge<r>;
#endif

// What is less than a vector of N goes through vectors of half the width. Large butterflies go down at once to one
// complex column, or to none of real samples.
template <int r, size_t N>
inline constexpr size_t kNextWidth = kLarge<r> ? 2 : N / 2;

template <class Columns>
inline constexpr bool kReal = false;
template <size_t N>
inline constexpr bool kReal<RealColumns<N>> = true;

template <int r, class Columns, class Load, class Store>
KRNUMER_FFT_INLINE void InlinedDft(const Load& load, const Store& store) {
    if constexpr (kReal<Columns>) {
        RealDft<r, Columns>(load, store);
    } else {
        ComplexDft<r, Columns>(load, store);
    }
}

template <int r, class Columns>
KRNUMER_FFT_NOINLINE void DftInMemory(Columns* t) {
    InlinedDft<r, Columns>([&](int j) KRNUMER_FFT_INLINE_LAMBDA { return t[j]; },
                           [&](int k, Columns value) KRNUMER_FFT_INLINE_LAMBDA { t[k] = value; });
}

template <class Columns>
inline constexpr bool kSplit = false;
template <size_t N>
inline constexpr bool kSplit<SplitColumns<N>> = true;

// The transform of columns load(j) into store(q, value); reads all before it writes any.
template <int r, class Columns, class Load, class Store>
KRNUMER_FFT_INLINE void DftOfColumns(const Load& load, const Store& store) {
    if constexpr (kInlined<r>) {
        InlinedDft<r, Columns>(load, store);
    } else if constexpr (kSplit<Columns>) {
        ComplexColumns<kLanes> even[r], odd[r];
        for (int j = 0; j < r; ++j) Interleave(load(j), even[j], odd[j]);
        DftInMemory<r>(even);
        DftInMemory<r>(odd);
        for (int k = 0; k < r; ++k) store(k, Deinterleave(even[k], odd[k]));
    } else {
        Columns t[r];
        for (int j = 0; j < r; ++j) t[j] = load(j);
        DftInMemory<r>(t);
        for (int k = 0; k < r; ++k) store(k, t[k]);
    }
}

// ---- Columns: results of one vector leave it for as many places as it has columns ----

template <class T, size_t N>
using ColumnsOf = std::conditional_t<std::is_same_v<T, Complex>, ComplexColumns<N>, RealColumns<N>>;

// Columns in a vector of N doubles.
template <class T, size_t N>
inline constexpr int kColumns = static_cast<int>(N * sizeof(double) / sizeof(T));

// The results 0 .. W-1 of all columns, at out[places[l]]. Runs are as long as there are columns, or the halves of the
// vectors are stored on their own. No store overlaps another: what is stored is soon loaded again, and loads wait for
// stores that they cannot be served from.
template <class T, size_t N, int W>
KRNUMER_FFT_INLINE void StoreRuns(const hn::Vec<Tag<N>>* rows, T* out, const ptrdiff_t* places) {
    constexpr int kWidth = kColumns<T, N>;
    if constexpr (W == kWidth) {
        hn::Vec<Tag<N>> square[W];
        for (int i = 0; i < W; ++i) square[i] = rows[i];
        if constexpr (std::is_same_v<T, Complex>) {
            TransposePairs(square);
        } else {
            Transpose<N>(square);
        }
        for (int l = 0; l < W; ++l) hn::StoreU(square[l], Tag<N>(), reinterpret_cast<double*>(out + places[l]));
    } else if constexpr (N > 2) {
        const Tag<N / 2> d;
        hn::Vec<Tag<N / 2>> lower[W], upper[W];
        for (int i = 0; i < W; ++i) {
            lower[i] = hn::LowerHalf(d, rows[i]);
            upper[i] = hn::UpperHalf(d, rows[i]);
        }
        StoreRuns<T, N / 2, W>(lower, out, places);
        StoreRuns<T, N / 2, W>(upper, out, places + kWidth / 2);
    } else {
        alignas(16) double pair[2];
        hn::Store(rows[0], Tag<2>(), pair);
        out[places[0]] = pair[0];
        out[places[1]] = pair[1];
    }
}

// The r results of all columns, in runs of W and what is left in shorter ones.
template <int r, class T, size_t N, int W = kColumns<T, N>>
KRNUMER_FFT_INLINE void StoreColumns(const hn::Vec<Tag<N>>* rows, T* out, const ptrdiff_t* places) {
    constexpr int kWhole = r - r % W;
    KRNUMER_FFT_UNROLL
    for (int q = 0; q < kWhole; q += W) StoreRuns<T, N, W>(rows + q, out + q, places);
    if constexpr (kWhole < r) StoreColumns<r - kWhole, T, N, W / 2>(rows + kWhole, out + kWhole, places);
}

// One vector of columns.
template <int r, size_t N, class T>
KRNUMER_FFT_INLINE void TransformColumns(const T* in, ptrdiff_t step, T* out, const ptrdiff_t* places) {
    using Columns = ColumnsOf<T, N>;
    hn::Vec<Tag<N>> y[r];
    DftOfColumns<r, Columns>(
        [&](int j) KRNUMER_FFT_INLINE_LAMBDA {
            return Columns{hn::LoadU(Tag<N>(), reinterpret_cast<const double*>(in + j * step))};
        },
        [&](int q, Columns value) KRNUMER_FFT_INLINE_LAMBDA { y[q] = value.v; });
    StoreColumns<r, T, N>(y, out, places);
}

// The last vector overlaps the one before. Returns the number of columns that it did: all, or none that are fewer than
// the shortest vector has.
template <int r, size_t N, class T>
KRNUMER_FFT_INLINE int32_t ColumnsByVectors(const T* in, ptrdiff_t step, T* out, const ptrdiff_t* places,
                                            int32_t lanes) {
    constexpr int32_t kWidth = kColumns<T, N>;
    if (lanes >= kWidth) {
        int32_t l = 0;
        for (; l + kWidth <= lanes; l += kWidth) TransformColumns<r, N>(in + l, step, out, places + l);
        if (l < lanes) TransformColumns<r, N>(in + (lanes - kWidth), step, out, places + (lanes - kWidth));
        return lanes;
    } else if constexpr (N > 2 && !(kLarge<r> && std::is_same_v<T, double>)) {
        return ColumnsByVectors<r, kNextWidth<r, N>>(in, step, out, places, lanes);
    } else {
        return 0;
    }
}

template <int r, class T>
int32_t Columns(const T* in, ptrdiff_t step, T* out, const ptrdiff_t* places, int32_t lanes) {
    return ColumnsByVectors<r, kLanes>(in, step, out, places, lanes);
}

// ---- Stages ----

// Vectors of rows of a complex stage. Row 0 takes no twiddles: a product with 1 + 0i is another number where an
// infinity or a negative zero is about. `packed` are the twiddles of the first of these rows, in vectors of kLanes.
template <int r, size_t N, bool kFromRow0>
KRNUMER_FFT_INLINE void TransformRows(double* x, ptrdiff_t block, const double* packed) {
    using Columns = ComplexColumns<N>;
    const Tag<N> d;
    DftOfColumns<r, Columns>(
        [&](int j) KRNUMER_FFT_INLINE_LAMBDA {
            const Columns value{hn::LoadU(d, x + j * block)};
            if (j == 0 || (kFromRow0 && N == 2)) return value;
            const Columns w{hn::LoadU(d, packed + (j - 1) * ptrdiff_t{kLanes})};
            const Columns turned = Rotate(value, w);
            return kFromRow0 ? Columns{hn::IfThenElse(hn::FirstN(d, 2), value.v, turned.v)} : turned;
        },
        [&](int q, Columns value) KRNUMER_FFT_INLINE_LAMBDA { hn::StoreU(value.v, d, x + q * block); });
}

// Fewer rows than a vector of N holds, in shorter vectors.
template <int r, size_t N>
KRNUMER_FFT_NOINLINE void TransformLastRows(double* x, ptrdiff_t block, const double* packed, int32_t rows,
                                            bool from_row0) {
    if constexpr (N > 2) {
        constexpr size_t kWidth = kNextWidth<r, N>;
        constexpr int32_t kRows = kColumns<Complex, kWidth>;
        for (; rows >= kRows; rows -= kRows, packed += kWidth, x += kWidth) {
            if (from_row0) {
                TransformRows<r, kWidth, true>(x, block, packed);
            } else {
                TransformRows<r, kWidth, false>(x, block, packed);
            }
            from_row0 = false;
        }
        if (rows > 0) TransformLastRows<r, kWidth>(x, block, packed, rows, from_row0);
    }
}

template <int r>
void ComplexStage(Complex* data, ptrdiff_t block, const double* packed, int32_t rows, bool from_row0) {
    constexpr int32_t kRows = kColumns<Complex, kLanes>;
    constexpr ptrdiff_t kPacked = ptrdiff_t{r - 1} * ptrdiff_t{kLanes};
    double* x = &data->re;
    block *= 2;
    if (from_row0 && rows >= kRows) {
        TransformRows<r, kLanes, true>(x, block, packed);
        rows -= kRows;
        packed += kPacked;
        x += kLanes;
        from_row0 = false;
    }
    for (; rows >= kRows; rows -= kRows, packed += kPacked, x += kLanes)
        TransformRows<r, kLanes, false>(x, block, packed);
    if (rows > 0) TransformLastRows<r, kLanes>(x, block, packed, rows, from_row0);
}

// How much of a vector is there: all of it, or some lanes by a mask. Vectors of two doubles have no part.
constexpr bool kHasParts = kLanes > 2;

inline Mask<kLanes> FirstLanes(size_t count) {
    return hn::FirstN(Tag<kLanes>(), count);
}

template <bool kPart>
KRNUMER_FFT_INLINE hn::Vec<Tag<kLanes>> LoadLanes(const double* x, [[maybe_unused]] Mask<kLanes> lanes) {
    if constexpr (kPart) {
        return hn::MaskedLoad(lanes, Tag<kLanes>(), x);
    } else {
        return hn::LoadU(Tag<kLanes>(), x);
    }
}

template <bool kPart>
KRNUMER_FFT_INLINE void StoreLanes(hn::Vec<Tag<kLanes>> v, double* x, [[maybe_unused]] Mask<kLanes> lanes) {
    if constexpr (kPart) {
        hn::BlendedStore(v, lanes, Tag<kLanes>(), x);
    } else {
        hn::StoreU(v, Tag<kLanes>(), x);
    }
}

// A pointer that may lie outside the array while only masked lanes behind it are touched.
inline double* Displaced(double* x, ptrdiff_t offset) {
    return reinterpret_cast<double*>(reinterpret_cast<uintptr_t>(x) + static_cast<uintptr_t>(offset) * sizeof(double));
}

// Rows k, k+1, ... of a real stage, `pairs` of them with their partners m-k, m-k-1, ..., and row m/2 behind them if
// `lanes` is one more.
template <int r, bool kPart>
KRNUMER_FFT_INLINE void TransformRowPairs(double* data, ptrdiff_t m, ptrdiff_t k, const double* packed, size_t pairs,
                                          size_t lanes) {
    using Columns = SplitColumns<kLanes>;
    const Tag<kLanes> d;
    const Mask<kLanes> ascending = FirstLanes(lanes);
    const Mask<kLanes> ascending_pairs = FirstLanes(pairs);
    const Mask<kLanes> descending = hn::Not(FirstLanes(kLanes - lanes));
    const Mask<kLanes> descending_pairs = hn::Not(FirstLanes(kLanes - pairs));
    double* a = data + k;
    const ptrdiff_t partner = m - k - (ptrdiff_t{kLanes} - 1);
    DftOfColumns<r, Columns>(
        [&](int j) KRNUMER_FFT_INLINE_LAMBDA {
            const hn::Vec<Tag<kLanes>> re = LoadLanes<kPart>(a + j * m, ascending);
            const hn::Vec<Tag<kLanes>> im = LoadLanes<kPart>(Displaced(data, j * m + partner), descending_pairs);
            const Columns value{{re}, {hn::Reverse(d, im)}};
            if (j == 0) return value;
            const double* w = packed + (j - 1) * 2 * ptrdiff_t{kLanes};
            return Rotate(value, Columns{{hn::LoadU(d, w)}, {hn::LoadU(d, w + kLanes)}});
        },
        [&](int q, Columns value) KRNUMER_FFT_INLINE_LAMBDA {
            double* upper = Displaced(data, (r - 1 - q) * m + partner);
            if (2 * q < r) {
                StoreLanes<kPart>(value.re.v, a + q * m, ascending);
                // The middle one of the rows m/2 is real.
                StoreLanes<kPart>(hn::Reverse(d, value.im.v), upper, 2 * q + 1 < r ? descending : descending_pairs);
            } else {
                StoreLanes<kPart>(hn::Reverse(d, value.re.v), upper, descending_pairs);
                StoreLanes<kPart>(hn::Neg(value.im.v), a + q * m, ascending_pairs);
            }
        });
}

template <int r>
int32_t RealStage(double* data, const double* packed, int32_t m) {
    constexpr int32_t kWidth = static_cast<int32_t>(kLanes);
    constexpr ptrdiff_t kPacked = 2 * ptrdiff_t{r - 1} * ptrdiff_t{kLanes};
    const int32_t last_pair = (m - 1) / 2;
    int32_t k = 1;
    for (; k + kWidth - 1 <= last_pair; k += kWidth) {
        TransformRowPairs<r, false>(data, m, k, packed, kLanes, kLanes);
        packed += kPacked;
    }
    if constexpr (kHasParts) {
        if (k <= m / 2) {
            TransformRowPairs<r, true>(data, m, k, packed, Count(last_pair - k + 1), Count(m / 2 - k + 1));
            k = m / 2 + 1;
        }
    }
    return k;
}

// Rows a, a+1, ... of a real stage with their partners b, b+1, ..., which were put in this order before.
template <int r>
void RealPairs(double* a, double* b, ptrdiff_t block, const double* packed, int32_t pairs) {
    using Columns = SplitColumns<kLanes>;
    const Tag<kLanes> d;
    for (; pairs > 0; pairs -= static_cast<int32_t>(kLanes), a += kLanes, b += kLanes) {
        DftOfColumns<r, Columns>(
            [&](int j) KRNUMER_FFT_INLINE_LAMBDA {
                const Columns value{{hn::LoadU(d, a + j * block)}, {hn::LoadU(d, b + j * block)}};
                if (j == 0) return value;
                const double* w = packed + (j - 1) * 2 * ptrdiff_t{kLanes};
                return Rotate(value, Columns{{hn::LoadU(d, w)}, {hn::LoadU(d, w + kLanes)}});
            },
            [&](int q, Columns value) KRNUMER_FFT_INLINE_LAMBDA {
                const bool lower = 2 * q < r;
                hn::StoreU(lower ? value.re.v : hn::Neg(value.im.v), d, a + q * block);
                hn::StoreU(lower ? value.im.v : value.re.v, d, b + (r - 1 - q) * block);
            });
        packed += 2 * ptrdiff_t{r - 1} * ptrdiff_t{kLanes};
    }
}

template <int r>
inline constexpr VectorButterflies kVectorButterflies{{Columns<r, Complex>, ComplexStage<r>},
                                                      {Columns<r, double>, RealStage<r>, RealPairs<r>}};

#endif  // KRNUMER_FFT_HAS_VECTORS

}  // namespace krnumer::HWY_NAMESPACE
HWY_AFTER_NAMESPACE();

#endif
