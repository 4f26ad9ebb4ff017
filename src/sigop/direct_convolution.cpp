// A block of neighbouring outputs grows together: one tap of the kernel meets the samples that face it, a few vectors
// of them, while the sums stay in registers. So the outputs are vectorised and each sum keeps its own order.
#include "sigop/direct_convolution.h"

#include <algorithm>
#include <type_traits>

#include "frame/numeric.h"
#include "frame/vector_targets.h"

#undef HWY_TARGET_INCLUDE
#define HWY_TARGET_INCLUDE "sigop/direct_convolution.cpp"
#include <hwy/foreach_target.h>
#include <hwy/highway.h>

namespace krnumer {

// out[k] += tap samples[k], compiled once and for the least machine: where there are fused operations, GCC before 12.3
// puts them into complex products although it is told not to (its bug 107647).
void AddProducts(double tap, const double* samples, int64_t count, double* out);
void AddProducts(Complex tap, const Complex* samples, int64_t count, Complex* out);

}  // namespace krnumer

HWY_BEFORE_NAMESPACE();
namespace krnumer::HWY_NAMESPACE {
namespace {

namespace hn = hwy::HWY_NAMESPACE;
using Tag = hn::ScalableTag<double>;
using Vector = hn::Vec<Tag>;

// tap times samples, with the real part of the tap in all lanes and the imaginary part, negative where it meets one, in
// those of complex samples.
template <class T>
HWY_INLINE Vector Product(Vector re, Vector im, Vector samples) {
    if constexpr (std::is_same_v<T, Complex>) {
        return hn::Add(hn::Mul(re, samples), hn::Mul(im, hn::Reverse2(Tag(), samples)));
    } else {
        return hn::Mul(re, samples);
    }
}

// A row of the kernel, a row of the signal and the row of outputs that they add to.
template <class T>
class RowPair {
  public:
    RowPair(const T* kernel, int64_t taps, const T* signal, int64_t samples, T* z)
        : kernel_(kernel), signal_(signal), z_(z), taps_(taps), samples_(samples) {}

    void Add(TapOrder order) const {
        const int64_t outputs = taps_ + samples_ - 1;
        for (int64_t k = 0; k < outputs; k += block_) AddBlock(k, std::min(outputs, k + block_) - 1, order);
    }

  private:
    static constexpr int kDoubles = sizeof(T) / sizeof(double);
    static constexpr int kVectors = 4;

    // Outputs first .. last. Of the taps that reach any of them, from .. to, those in the middle reach all.
    void AddBlock(int64_t first, int64_t last, TapOrder order) const {
        const int64_t from = std::max<int64_t>(0, first - samples_ + 1);
        const int64_t to = std::min(taps_ - 1, last);
        int64_t middle_from = std::max<int64_t>(0, last - samples_ + 1);
        int64_t middle_to = std::min(taps_ - 1, first);
        // A vector of one double holds no complex sample.
        constexpr bool kHasVectors = HWY_TARGET != HWY_SCALAR;
        if (!kHasVectors || last - first + 1 < block_ || middle_from > middle_to) {
            middle_from = from;
            middle_to = from - 1;
        }
        if (order == TapOrder::kAscending) {
            for (int64_t t = from; t < middle_from; ++t) AddTap(t, first, last);
            if (middle_from <= middle_to) AddTaps(middle_from, middle_to - middle_from + 1, 1, first);
            for (int64_t t = middle_to + 1; t <= to; ++t) AddTap(t, first, last);
        } else {
            for (int64_t t = to; t > middle_to; --t) AddTap(t, first, last);
            if (middle_from <= middle_to) AddTaps(middle_to, middle_to - middle_from + 1, -1, first);
            for (int64_t t = middle_from - 1; t >= from; --t) AddTap(t, first, last);
        }
    }

    // One tap to those outputs of the block that it reaches.
    void AddTap(int64_t t, int64_t first, int64_t last) const {
        const int64_t from = std::max(first, t);
        const int64_t count = std::min(last, t + samples_ - 1) - from + 1;
        AddProducts(kernel_[t], signal_ + (from - t), count, z_ + from);
    }

    // `count` taps from t on, in steps of one up or down, to a whole block.
    HWY_INLINE void AddTaps(int64_t t, int64_t count, int64_t step, int64_t first) const {
        const Tag tag;
        const size_t lanes = hn::Lanes(tag);
        const double* tap = AsDoubles(kernel_ + t);
        const double* samples = AsDoubles(signal_ + (first - t));
        double* out = AsDoubles(z_ + first);
        Vector sum0 = hn::LoadU(tag, out);
        Vector sum1 = hn::LoadU(tag, out + lanes);
        Vector sum2 = hn::LoadU(tag, out + 2 * lanes);
        Vector sum3 = hn::LoadU(tag, out + 3 * lanes);
        for (step *= kDoubles; count > 0; --count, tap += step, samples -= step) {
            const Vector re = hn::Set(tag, tap[0]);
            const Vector im =
                kDoubles == 2 ? hn::OddEven(hn::Set(tag, tap[kDoubles - 1]), hn::Set(tag, -tap[kDoubles - 1])) : re;
            sum0 = hn::Add(sum0, Product<T>(re, im, hn::LoadU(tag, samples)));
            sum1 = hn::Add(sum1, Product<T>(re, im, hn::LoadU(tag, samples + lanes)));
            sum2 = hn::Add(sum2, Product<T>(re, im, hn::LoadU(tag, samples + 2 * lanes)));
            sum3 = hn::Add(sum3, Product<T>(re, im, hn::LoadU(tag, samples + 3 * lanes)));
        }
        hn::StoreU(sum0, tag, out);
        hn::StoreU(sum1, tag, out + lanes);
        hn::StoreU(sum2, tag, out + 2 * lanes);
        hn::StoreU(sum3, tag, out + 3 * lanes);
    }

    static const double* AsDoubles(const T* x) { return reinterpret_cast<const double*>(x); }
    static double* AsDoubles(T* x) { return reinterpret_cast<double*>(x); }

    const T* kernel_;
    const T* signal_;
    T* z_;
    int64_t taps_;
    int64_t samples_;
    const int64_t block_ = kVectors * static_cast<int64_t>(hn::Lanes(Tag())) / kDoubles;
};

template <class T>
void Convolve(Plane<T> kernel, Plane<T> signal, TapOrder order, T* z) {
    const int64_t rows = int64_t{kernel.rows} + signal.rows - 1;
    const int64_t columns = int64_t{kernel.columns} + signal.columns - 1;
    std::fill_n(z, rows * columns, T{});
    for (int64_t r = 0; r < rows; ++r) {
        const int64_t last = std::min<int64_t>(r, kernel.rows - 1);
        for (int64_t p = std::max<int64_t>(0, r - signal.rows + 1); p <= last; ++p) {
            RowPair<T>(kernel.data + p * kernel.columns, kernel.columns, signal.data + (r - p) * signal.columns,
                       signal.columns, z + r * columns)
                .Add(order);
        }
    }
}

void ConvolveDoubles(Plane<double> kernel, Plane<double> signal, TapOrder order, double* z) {
    Convolve(kernel, signal, order, z);
}
void ConvolveComplexes(Plane<Complex> kernel, Plane<Complex> signal, TapOrder order, Complex* z) {
    Convolve(kernel, signal, order, z);
}

}  // namespace
}  // namespace krnumer::HWY_NAMESPACE
HWY_AFTER_NAMESPACE();

#if HWY_ONCE
namespace krnumer {

HWY_EXPORT(ConvolveDoubles);
HWY_EXPORT(ConvolveComplexes);

HWY_NOINLINE void AddProducts(double tap, const double* samples, int64_t count, double* out) {
    for (int64_t k = 0; k < count; ++k) out[k] += tap * samples[k];
}
HWY_NOINLINE void AddProducts(Complex tap, const Complex* samples, int64_t count, Complex* out) {
    for (int64_t k = 0; k < count; ++k) out[k] += tap * samples[k];
}

void DirectConvolution(Plane<double> kernel, Plane<double> signal, TapOrder order, double* z) {
    HWY_DYNAMIC_DISPATCH(ConvolveDoubles)(kernel, signal, order, z);
}
void DirectConvolution(Plane<Complex> kernel, Plane<Complex> signal, TapOrder order, Complex* z) {
    HWY_DYNAMIC_DISPATCH(ConvolveComplexes)(kernel, signal, order, z);
}

}  // namespace krnumer
#endif
