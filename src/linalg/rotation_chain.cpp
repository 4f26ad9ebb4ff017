// Compiled once for every kind of vector unit that the machine may have. No products are fused, so every unit gives the
// same.
#include "linalg/rotation_chain.h"

#include "frame/vector_targets.h"

#undef HWY_TARGET_INCLUDE
#define HWY_TARGET_INCLUDE "linalg/rotation_chain.cpp"
#include <hwy/foreach_target.h>
#include <hwy/highway.h>

#include <algorithm>

#include "linalg/strips-inl.h"

HWY_BEFORE_NAMESPACE();
namespace krnumer::HWY_NAMESPACE {
namespace {

namespace hn = hwy::HWY_NAMESPACE;

enum class Side { kLeft, kRight };

#if HWY_TARGET == HWY_SCALAR

template <Side side>
void RotateStrips(const RotationChain& chain, Complex* rows, std::ptrdiff_t stride, std::ptrdiff_t width) {
    for (std::ptrdiff_t k = 0; k < chain.count; ++k, rows += stride) {
        const auto [cosine, s] = chain.rotations[k];
        const Complex c = side == Side::kLeft ? Conjugate(cosine) : cosine;
        for (std::ptrdiff_t i = 0; i < width; ++i) {
            const Complex y = rows[i], z = rows[stride + i];
            rows[i] = c * y + s * z;
            rows[stride + i] = Conjugate(c) * z - s * y;
        }
    }
}

#else

// One strip of columns through the whole chain: the row that the next rotation shares stays in registers.
template <Side side>
struct RotateStrip {
    const RotationChain& chain;
    std::ptrdiff_t stride;  // in doubles

    template <int kVectors, class D>
    HWY_INLINE void Run(D d, double* row) const {
        // Real and imaginary parts alternate, so nothing is left over for a single lane.
        if constexpr (hn::MaxLanes(d) > 1) {
            using V = hn::Vec<D>;
            const auto lanes = static_cast<std::ptrdiff_t>(hn::MaxLanes(d));
            V y[kVectors];
            for (int i = 0; i < kVectors; ++i) y[i] = hn::LoadU(d, row + i * lanes);
            const ComplexRotation* const end = chain.rotations + chain.count;
            for (const ComplexRotation* r = chain.rotations; r != end; ++r) {
                const V cosine = hn::Set(d, r->c.re);
                // What the other part of an element contributes to its product with conj(c), or from the right with c.
                const double im = side == Side::kLeft ? r->c.im : -r->c.im;
                const V turn = hn::OddEven(hn::Set(d, -im), hn::Set(d, im));
                const V sine = hn::Set(d, r->s);
                double* const next = row + stride;
                for (int i = 0; i < kVectors; ++i) {
                    const V z = hn::LoadU(d, next + i * lanes);
                    const V turned_y = hn::Add(hn::Mul(cosine, y[i]), hn::Mul(turn, hn::Reverse2(d, y[i])));
                    const V turned_z = hn::Sub(hn::Mul(cosine, z), hn::Mul(turn, hn::Reverse2(d, z)));
                    hn::StoreU(hn::Add(turned_y, hn::Mul(sine, z)), d, row + i * lanes);
                    y[i] = hn::Sub(turned_z, hn::Mul(sine, y[i]));
                }
                row = next;
            }
            for (int i = 0; i < kVectors; ++i) hn::StoreU(y[i], d, row + i * lanes);
        }
    }
};

template <Side side>
void RotateStrips(const RotationChain& chain, Complex* rows, std::ptrdiff_t stride, std::ptrdiff_t width) {
    ForEachStrip(reinterpret_cast<double*>(rows), 2 * width, RotateStrip<side>{chain, 2 * stride});
}

#endif

void RotateLeft(const RotationChain& chain, Complex* rows, std::ptrdiff_t stride, std::ptrdiff_t width) {
    RotateStrips<Side::kLeft>(chain, rows, stride, width);
}

void RotateRight(const RotationChain& chain, Complex* rows, std::ptrdiff_t stride, std::ptrdiff_t width) {
    RotateStrips<Side::kRight>(chain, rows, stride, width);
}

// Tile by tile the rows are transposed into a small square and back.
void RotateColumns(const RotationChain& chain, Complex* rows, std::ptrdiff_t stride, std::ptrdiff_t height) {
    constexpr std::ptrdiff_t kHeight = 16;
    constexpr std::ptrdiff_t kWidth = 32;
    Complex tile[(kWidth + 1) * kHeight];
    for (std::ptrdiff_t i = 0; i < height; i += kHeight) {
        const std::ptrdiff_t tile_height = std::min(kHeight, height - i);
        for (std::ptrdiff_t j = 0; j < chain.count; j += kWidth) {
            const std::ptrdiff_t count = std::min(kWidth, chain.count - j);
            Complex* const corner = rows + i * stride + j;
            for (std::ptrdiff_t q = 0; q <= count; ++q)
                for (std::ptrdiff_t p = 0; p < tile_height; ++p) tile[q * kHeight + p] = corner[p * stride + q];
            RotateRight({chain.rotations + j, count}, tile, kHeight, tile_height);
            for (std::ptrdiff_t p = 0; p < tile_height; ++p)
                for (std::ptrdiff_t q = 0; q <= count; ++q) corner[p * stride + q] = tile[q * kHeight + p];
        }
    }
}

}  // namespace
}  // namespace krnumer::HWY_NAMESPACE
HWY_AFTER_NAMESPACE();

#if HWY_ONCE

namespace krnumer {

HWY_EXPORT(RotateLeft);
HWY_EXPORT(RotateRight);
HWY_EXPORT(RotateColumns);

void RotateRowsByChain(const RotationChain& chain, Complex* rows, std::ptrdiff_t stride, std::ptrdiff_t width) {
    HWY_DYNAMIC_DISPATCH(RotateLeft)(chain, rows, stride, width);
}

void RotateTransposedByChain(const RotationChain& chain, Complex* rows, std::ptrdiff_t stride, std::ptrdiff_t width) {
    HWY_DYNAMIC_DISPATCH(RotateRight)(chain, rows, stride, width);
}

void RotateColumnsByChain(const RotationChain& chain, Complex* rows, std::ptrdiff_t stride, std::ptrdiff_t height) {
    HWY_DYNAMIC_DISPATCH(RotateColumns)(chain, rows, stride, height);
}

}  // namespace krnumer

#endif
