// The sum of a sample has its order, so speed comes from forming the sums of neighbouring samples side by side, on
// whatever vector unit the machine has.
#include "filter/direct_form.h"

#include <algorithm>
#include <type_traits>

#include "filter/stream.h"
#include "frame/status.h"
#include "frame/vector_targets.h"

#undef HWY_TARGET_INCLUDE
#define HWY_TARGET_INCLUDE "filter/direct_form.cpp"
#include <hwy/foreach_target.h>
#include <hwy/highway.h>

HWY_BEFORE_NAMESPACE();
namespace krnumer::HWY_NAMESPACE {

namespace hn = hwy::HWY_NAMESPACE;

// How many sums are formed side by side: 32 where all that they need is known, 8 where the outputs are too new, and one
// at a time in between.
constexpr int32_t kWide = 32;
constexpr int32_t kNarrow = 8;

enum class Sign { kPlus, kMinus };

template <Sign kSign, class T>
T Combine(T sum, T term) {
    if constexpr (kSign == Sign::kPlus) return sum + term;
    return sum - term;
}

template <Sign kSign, class D, class V = hn::Vec<D>>
V CombineProduct(D d, V sum, V coefficient, const double* delayed) {
    const V term = hn::Mul(coefficient, hn::LoadU(d, delayed));
    if constexpr (kSign == Sign::kPlus) return hn::Add(sum, term);
    return hn::Sub(sum, term);
}

// Doubles side by side, a complex sample being two of them.
template <Sign kSign, int32_t kDoubles, class Sample>
void AddRealTerms(double* sums, const Stream<Sample>& stream, int32_t first, const double* coefficients, int32_t oldest,
                  int32_t newest) {
    const hn::CappedTag<double, kDoubles> d;
    constexpr size_t kPerSample = sizeof(Sample) / sizeof(double);
    const auto delayed = [&](int32_t lag) HWY_ATTR {
        return reinterpret_cast<const double*>(stream.Delayed(lag)) + kPerSample * static_cast<size_t>(first);
    };
    const size_t lanes = hn::Lanes(d);
    if (4 * lanes > kDoubles) {
        for (size_t j = 0; j < kDoubles; j += lanes) {
            auto sum = hn::LoadU(d, sums + j);
            for (int32_t k = oldest; k >= newest; --k)
                sum = CombineProduct<kSign>(d, sum, hn::Set(d, coefficients[k]), delayed(k) + j);
            hn::StoreU(sum, d, sums + j);
        }
        return;
    }
    for (size_t j = 0; j < kDoubles; j += 4 * lanes) {
        auto sum0 = hn::LoadU(d, sums + j);
        auto sum1 = hn::LoadU(d, sums + j + lanes);
        auto sum2 = hn::LoadU(d, sums + j + 2 * lanes);
        auto sum3 = hn::LoadU(d, sums + j + 3 * lanes);
        for (int32_t k = oldest; k >= newest; --k) {
            const auto coefficient = hn::Set(d, coefficients[k]);
            const double* samples = delayed(k) + j;
            sum0 = CombineProduct<kSign>(d, sum0, coefficient, samples);
            sum1 = CombineProduct<kSign>(d, sum1, coefficient, samples + lanes);
            sum2 = CombineProduct<kSign>(d, sum2, coefficient, samples + 2 * lanes);
            sum3 = CombineProduct<kSign>(d, sum3, coefficient, samples + 3 * lanes);
        }
        hn::StoreU(sum0, d, sums + j);
        hn::StoreU(sum1, d, sums + j + lanes);
        hn::StoreU(sum2, d, sums + j + 2 * lanes);
        hn::StoreU(sum3, d, sums + j + 3 * lanes);
    }
}

// To kCount sums, those of the samples from `first` on, adds the products of coefficients[k] and the samples k back, k
// from `oldest` down to `newest`.
template <Sign kSign, int32_t kCount, class Sum, class Sample, class Coefficient>
void AddTerms(Sum* sums, const Stream<Sample>& stream, int32_t first, const Coefficient* coefficients, int32_t oldest,
              int32_t newest) {
    if constexpr (std::is_same_v<Coefficient, double> && kCount > 1) {
        constexpr int32_t kDoubles = kCount * static_cast<int32_t>(sizeof(Sample) / sizeof(double));
        AddRealTerms<kSign, kDoubles>(reinterpret_cast<double*>(sums), stream, first, coefficients, oldest, newest);
    } else {
        for (int32_t k = oldest; k >= newest; --k) {
            const Sample* delayed = stream.Delayed(k) + first;
            for (int32_t j = 0; j < kCount; ++j) sums[j] = Combine<kSign>(sums[j], coefficients[k] * delayed[j]);
        }
    }
}

// A quotient by 1 need not be formed. In complex arithmetic it is more than the dividend again.
inline bool IsOne(double divisor) {
    return divisor == 1.0;
}
inline bool IsOne(Complex) {
    return false;
}

template <class Input, class Coefficient, class Output>
struct DirectForm {
    Stream<Input> inputs;
    Stream<Output> outputs;
    Output* sums;  // of the block; where they are complete, the outputs stand in their place
    const Coefficient* a;
    const Coefficient* b;
    int32_t oldest_output;
    int32_t oldest_input;
    bool divides;

    // Forms the sums over inputs in groups of kCount, as far as they go.
    template <int32_t kCount>
    int32_t Feedforward(int32_t first, int32_t count) {
        for (; first + kCount <= count; first += kCount)
            AddTerms<Sign::kPlus, kCount>(sums + first, inputs, first, b, oldest_input, 0);
        return first;
    }

    // Completes the sums by the outputs at most `oldest` samples back, in groups of kCount.
    template <int32_t kCount>
    int32_t Feedback(int32_t first, int32_t count, int32_t oldest) {
        for (; first + kCount <= count; first += kCount) {
            AddTerms<Sign::kMinus, kCount>(sums + first, outputs, first, a, oldest, kCount);
            if constexpr (kCount == 1) {
                if (divides) sums[first] = sums[first] / a[0];
            } else {
                constexpr int32_t kSmaller = kCount == kWide ? kNarrow : 1;
                Feedback<kSmaller>(first, first + kCount, std::min(oldest, kCount - 1));
            }
        }
        return first;
    }
};

template <class Input, class Coefficient, class Output>
int32_t Filter(const Input* x, int32_t n, const Coefficient* a, int32_t na, const Coefficient* b, int32_t nb,
               Input* forward_state, Output* reverse_state, Output* y) {
    if (nb < 1 || n < 1) return kEmptyInput;
    const bool recursive = a != nullptr && na > 0;
    const int32_t oldest_output = recursive ? na - 1 : 0;
    DirectForm<Input, Coefficient, Output> form{
        {forward_state, nb - 1},  {reverse_state, oldest_output}, nullptr, a, b, oldest_output, nb - 1,
        recursive && !IsOne(a[0])};
    for (int32_t count; n > 0; n -= count, x += count, y += count) {
        count = std::min(n, Stream<Input>::kBlock);
        std::copy_n(x, count, form.inputs.Begin());
        form.sums = form.outputs.Begin();
        std::fill_n(form.sums, count, Output{});

        int32_t first = form.template Feedforward<kWide>(0, count);
        first = form.template Feedforward<kNarrow>(first, count);
        form.template Feedforward<1>(first, count);
        if (recursive) {
            first = form.template Feedback<kWide>(0, count, oldest_output);
            first = form.template Feedback<kNarrow>(first, count, oldest_output);
            form.template Feedback<1>(first, count, oldest_output);
        }
        std::copy_n(form.sums, count, y);
        form.inputs.End(count);
        form.outputs.End(count);
    }
    return kOk;
}

int32_t FilterReal(const double* x, int32_t n, const double* a, int32_t na, const double* b, int32_t nb,
                   double* forward_state, double* reverse_state, double* y) {
    return Filter(x, n, a, na, b, nb, forward_state, reverse_state, y);
}
int32_t FilterComplexByReal(const Complex* x, int32_t n, const double* a, int32_t na, const double* b, int32_t nb,
                            Complex* forward_state, Complex* reverse_state, Complex* y) {
    return Filter(x, n, a, na, b, nb, forward_state, reverse_state, y);
}
// Compiled for the least vector unit only: for others, GCC makes fused operations of complex products, whatever it is
// told about contractions.
#if HWY_TARGET == HWY_STATIC_TARGET
int32_t FilterComplex(const Complex* x, int32_t n, const Complex* a, int32_t na, const Complex* b, int32_t nb,
                      Complex* forward_state, Complex* reverse_state, Complex* y) {
    return Filter(x, n, a, na, b, nb, forward_state, reverse_state, y);
}
int32_t FilterRealByComplex(const double* x, int32_t n, const Complex* a, int32_t na, const Complex* b, int32_t nb,
                            double* forward_state, Complex* reverse_state, Complex* y) {
    return Filter(x, n, a, na, b, nb, forward_state, reverse_state, y);
}
#endif

}  // namespace krnumer::HWY_NAMESPACE
HWY_AFTER_NAMESPACE();

#if HWY_ONCE
namespace krnumer {

HWY_EXPORT(FilterReal);
HWY_EXPORT(FilterComplexByReal);

int32_t DirectFormFilter(const double* x, int32_t n, const double* a, int32_t na, const double* b, int32_t nb,
                         double* forward_state, double* reverse_state, double* y) {
    return HWY_DYNAMIC_DISPATCH(FilterReal)(x, n, a, na, b, nb, forward_state, reverse_state, y);
}

int32_t DirectFormFilter(const Complex* x, int32_t n, const double* a, int32_t na, const double* b, int32_t nb,
                         Complex* forward_state, Complex* reverse_state, Complex* y) {
    return HWY_DYNAMIC_DISPATCH(FilterComplexByReal)(x, n, a, na, b, nb, forward_state, reverse_state, y);
}

int32_t DirectFormFilter(const Complex* x, int32_t n, const Complex* a, int32_t na, const Complex* b, int32_t nb,
                         Complex* forward_state, Complex* reverse_state, Complex* y) {
    return HWY_STATIC_DISPATCH(FilterComplex)(x, n, a, na, b, nb, forward_state, reverse_state, y);
}

int32_t DirectFormFilter(const double* x, int32_t n, const Complex* a, int32_t na, const Complex* b, int32_t nb,
                         double* forward_state, Complex* reverse_state, Complex* y) {
    return HWY_STATIC_DISPATCH(FilterRealByComplex)(x, n, a, na, b, nb, forward_state, reverse_state, y);
}

}  // namespace krnumer
#endif  // HWY_ONCE
