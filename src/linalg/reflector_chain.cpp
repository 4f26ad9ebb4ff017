// Compiled once for every kind of vector unit that the machine may have. No products are fused, so every unit gives the
// same.
#include "linalg/reflector_chain.h"

#include "frame/vector_targets.h"

#undef HWY_TARGET_INCLUDE
#define HWY_TARGET_INCLUDE "linalg/reflector_chain.cpp"
#include <hwy/foreach_target.h>
#include <hwy/highway.h>

#include "linalg/elements-inl.h"
#include "linalg/strips-inl.h"

HWY_BEFORE_NAMESPACE();
namespace krnumer::HWY_NAMESPACE {
namespace {

namespace hn = hwy::HWY_NAMESPACE;

enum class Side { kLeft, kRight };

// A reflector in every lane: the weights of the sum of products that it takes, and of what it subtracts. The first
// weight of one of the two is 1.
template <Side side, class D>
struct Weights {
    using V = hn::Vec<D>;

    HWY_INLINE Weights(D d, const BulgeReflector& f)
        : x(hn::Set(d, f.x)), y(hn::Set(d, f.y)), z(hn::Set(d, f.z)), q(hn::Set(d, f.q)), r(hn::Set(d, f.r)) {}

    HWY_INLINE V Sum(V a, V b) const {
        if constexpr (side == Side::kLeft) {
            return hn::Add(a, hn::Mul(q, b));
        } else {
            return hn::Add(hn::Mul(x, a), hn::Mul(y, b));
        }
    }
    HWY_INLINE V Sum(V a, V b, V c) const { return hn::Add(Sum(a, b), hn::Mul(side == Side::kLeft ? r : z, c)); }
    HWY_INLINE V First(V p) const { return side == Side::kLeft ? hn::Mul(p, x) : p; }
    HWY_INLINE V Second(V p) const { return hn::Mul(p, side == Side::kLeft ? y : q); }
    HWY_INLINE V Third(V p) const { return hn::Mul(p, side == Side::kLeft ? z : r); }

    V x, y, z, q, r;
};

// One strip of columns through the whole chain: the two rows that the next reflector shares stay in registers.
template <Side side>
struct ReflectStrip {
    const ReflectorChain& chain;
    std::ptrdiff_t stride;

    template <int kVectors, class D>
    HWY_INLINE void Run(D d, double* row) const {
        using V = hn::Vec<D>;
        const auto lanes = static_cast<std::ptrdiff_t>(hn::MaxLanes(d));
        V a[kVectors], b[kVectors];
        for (int i = 0; i < kVectors; ++i) a[i] = hn::LoadU(d, row + i * lanes);
        for (int i = 0; i < kVectors; ++i) b[i] = hn::LoadU(d, row + stride + i * lanes);
        const BulgeReflector* const last = chain.reflectors + chain.count - (chain.ends_short ? 1 : 0);
        for (const BulgeReflector* f = chain.reflectors; f != last; ++f, row += stride) {
            const Weights<side, D> weights(d, *f);
            for (int i = 0; i < kVectors; ++i) {
                const V c = hn::LoadU(d, row + 2 * stride + i * lanes);
                const V p = weights.Sum(a[i], b[i], c);
                hn::StoreU(hn::Sub(a[i], weights.First(p)), d, row + i * lanes);
                a[i] = hn::Sub(b[i], weights.Second(p));
                b[i] = hn::Sub(c, weights.Third(p));
            }
        }
        if (chain.ends_short) {
            const Weights<side, D> weights(d, *last);
            for (int i = 0; i < kVectors; ++i) {
                const V p = weights.Sum(a[i], b[i]);
                a[i] = hn::Sub(a[i], weights.First(p));
                b[i] = hn::Sub(b[i], weights.Second(p));
            }
        }
        for (int i = 0; i < kVectors; ++i) hn::StoreU(a[i], d, row + i * lanes);
        for (int i = 0; i < kVectors; ++i) hn::StoreU(b[i], d, row + stride + i * lanes);
    }
};

void ReflectLeft(const ReflectorChain& chain, double* rows, std::ptrdiff_t stride, std::ptrdiff_t width) {
    ForEachStrip(rows, width, ReflectStrip<Side::kLeft>{chain, stride});
}

void ReflectRight(const ReflectorChain& chain, double* rows, std::ptrdiff_t stride, std::ptrdiff_t width) {
    ForEachStrip(rows, width, ReflectStrip<Side::kRight>{chain, stride});
}

// A few rows through the chain, side by side.
template <int kRows>
HWY_INLINE void ReflectRowGroup(const ReflectorChain& chain, double* first, std::ptrdiff_t stride) {
    double a[kRows], b[kRows];
    for (int i = 0; i < kRows; ++i) a[i] = first[i * stride];
    for (int i = 0; i < kRows; ++i) b[i] = first[i * stride + 1];
    const BulgeReflector* const last = chain.reflectors + chain.count - (chain.ends_short ? 1 : 0);
    for (const BulgeReflector* f = chain.reflectors; f != last; ++f, ++first) {
        for (int i = 0; i < kRows; ++i) {
            const double c = first[i * stride + 2];
            const double p = f->x * a[i] + f->y * b[i] + f->z * c;
            first[i * stride] = a[i] - p;
            a[i] = b[i] - p * f->q;
            b[i] = c - p * f->r;
        }
    }
    for (int i = 0; i < kRows; ++i) {
        const double p = chain.ends_short ? last->x * a[i] + last->y * b[i] : 0.0;
        first[i * stride] = a[i] - p;
        first[i * stride + 1] = chain.ends_short ? b[i] - p * last->q : b[i];
    }
}

#if HWY_TARGET == HWY_SCALAR

void ReflectColumns(const ReflectorChain& chain, double* rows, std::ptrdiff_t stride, std::ptrdiff_t height) {
    for (std::ptrdiff_t i = 0; i < height; ++i) ReflectRowGroup<1>(chain, rows + i * stride, stride);
}

#else

// As ReflectRowGroup, by squares of a vector's length, which are turned in registers, as far as they go. Returns how many
// reflectors that were.
template <int kSquares, class D>
HWY_INLINE std::ptrdiff_t ReflectSquares(D d, const ReflectorChain& chain, double* first, std::ptrdiff_t stride) {
    using V = hn::Vec<D>;
    constexpr int kSide = static_cast<int>(hn::MaxLanes(d));
    const std::ptrdiff_t whole = chain.count - (chain.ends_short ? 1 : 0);
    V a[kSquares], b[kSquares];
    double column[2][kSide];
    for (int s = 0; s < kSquares; ++s) {
        for (int i = 0; i < kSide; ++i)
            for (int q = 0; q < 2; ++q) column[q][i] = first[(s * kSide + i) * stride + q];
        a[s] = hn::LoadU(d, column[0]);
        b[s] = hn::LoadU(d, column[1]);
    }
    std::ptrdiff_t k = 0;
    for (; k + kSide <= whole; k += kSide) {
        for (int s = 0; s < kSquares; ++s) {
            double* const corner = first + s * kSide * stride + k;
            V square[kSide];
            for (int i = 0; i < kSide; ++i) square[i] = hn::LoadU(d, corner + i * stride + 2);
            TransposeElements<double>(d, square);
            for (int q = 0; q < kSide; ++q) {
                const Weights<Side::kRight, D> weights(d, chain.reflectors[k + q]);
                const V c = square[q];
                const V p = weights.Sum(a[s], b[s], c);
                square[q] = hn::Sub(a[s], p);
                a[s] = hn::Sub(b[s], weights.Second(p));
                b[s] = hn::Sub(c, weights.Third(p));
            }
            TransposeElements<double>(d, square);
            for (int i = 0; i < kSide; ++i) hn::StoreU(square[i], d, corner + i * stride);
        }
    }
    for (int s = 0; s < kSquares; ++s) {
        hn::StoreU(a[s], d, column[0]);
        hn::StoreU(b[s], d, column[1]);
        for (int i = 0; i < kSide; ++i)
            for (int q = 0; q < 2; ++q) first[(s * kSide + i) * stride + k + q] = column[q][i];
    }
    return k;
}

void ReflectColumns(const ReflectorChain& chain, double* rows, std::ptrdiff_t stride, std::ptrdiff_t height) {
    constexpr hn::CappedTag<double, 4> d;
    constexpr std::ptrdiff_t kTogether = 8;
    std::ptrdiff_t i = 0;
    for (; i + kTogether <= height; i += kTogether) {
        const std::ptrdiff_t k = ReflectSquares<kTogether / hn::MaxLanes(d)>(d, chain, rows + i * stride, stride);
        const ReflectorChain rest{chain.reflectors + k, chain.count - k, chain.ends_short};
        ReflectRowGroup<4>(rest, rows + i * stride + k, stride);
        ReflectRowGroup<4>(rest, rows + (i + 4) * stride + k, stride);
    }
    for (; i < height; ++i) ReflectRowGroup<1>(chain, rows + i * stride, stride);
}

#endif  // HWY_TARGET

}  // namespace
}  // namespace krnumer::HWY_NAMESPACE
HWY_AFTER_NAMESPACE();

#if HWY_ONCE

namespace krnumer {

HWY_EXPORT(ReflectLeft);
HWY_EXPORT(ReflectRight);
HWY_EXPORT(ReflectColumns);

void ReflectRowsByChain(const ReflectorChain& chain, double* rows, std::ptrdiff_t stride, std::ptrdiff_t width) {
    HWY_DYNAMIC_DISPATCH(ReflectLeft)(chain, rows, stride, width);
}

void ReflectTransposedByChain(const ReflectorChain& chain, double* rows, std::ptrdiff_t stride, std::ptrdiff_t width) {
    HWY_DYNAMIC_DISPATCH(ReflectRight)(chain, rows, stride, width);
}

void ReflectColumnsByChain(const ReflectorChain& chain, double* rows, std::ptrdiff_t stride, std::ptrdiff_t height) {
    HWY_DYNAMIC_DISPATCH(ReflectColumns)(chain, rows, stride, height);
}

}  // namespace krnumer

#endif
