// Compiled once for every kind of vector unit that the machine may have. No products are fused, so every unit gives the
// same.
#include "linalg/rotations.h"

#include "frame/vector_targets.h"

#undef HWY_TARGET_INCLUDE
#define HWY_TARGET_INCLUDE "linalg/rotations.cpp"
#include <hwy/foreach_target.h>
#include <hwy/highway.h>

#include "linalg/strips-inl.h"

HWY_BEFORE_NAMESPACE();
namespace krnumer::HWY_NAMESPACE {
namespace {

namespace hn = hwy::HWY_NAMESPACE;

// One strip of columns through the whole chain: the row that the next rotation shares stays in registers.
struct RotateStrip {
    std::ptrdiff_t step;  // in elements, from row to row
    std::ptrdiff_t count;
    const double* c;
    const double* s;

    template <int kVectors, class D>
    HWY_INLINE void Run(D d, double* row) const {
        using V = hn::Vec<D>;
        const auto lanes = static_cast<std::ptrdiff_t>(hn::MaxLanes(d));
        V x[kVectors];
        for (int q = 0; q < kVectors; ++q) x[q] = hn::LoadU(d, row + q * lanes);
        for (std::ptrdiff_t r = 0; r < count; ++r) {
            const V cosine = hn::Set(d, c[r]);
            const V sine = hn::Set(d, s[r]);
            double* next = row + step;
            for (int q = 0; q < kVectors; ++q) {
                const V y = hn::LoadU(d, next + q * lanes);
                hn::StoreU(hn::Add(hn::Mul(x[q], cosine), hn::Mul(y, sine)), d, row + q * lanes);
                x[q] = hn::Sub(hn::Mul(y, cosine), hn::Mul(x[q], sine));
            }
            row = next;
        }
        for (int q = 0; q < kVectors; ++q) hn::StoreU(x[q], d, row + q * lanes);
    }
};

void RotateStrips(double* row, std::ptrdiff_t length, std::ptrdiff_t step, std::ptrdiff_t count, const double* c,
                  const double* s) {
    ForEachStrip(row, length, RotateStrip{step, count, c, s});
}

}  // namespace
}  // namespace krnumer::HWY_NAMESPACE
HWY_AFTER_NAMESPACE();

#if HWY_ONCE

namespace krnumer {

HWY_EXPORT(RotateStrips);

void RotateRows(double* x, double* y, std::ptrdiff_t length, double c, double s) {
    for (std::ptrdiff_t q = 0; q < length; ++q) {
        const double rotated = x[q] * c + y[q] * s;
        y[q] = y[q] * c - x[q] * s;
        x[q] = rotated;
    }
}

void RotateChain(VectorRows vectors, std::ptrdiff_t first, std::ptrdiff_t step, std::ptrdiff_t count, const double* c,
                 const double* s) {
    HWY_DYNAMIC_DISPATCH(RotateStrips)(vectors[first], vectors.length, step * vectors.length, count, c, s);
}

}  // namespace krnumer

#endif
