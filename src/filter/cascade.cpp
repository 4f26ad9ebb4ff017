#include "filter/cascade.h"

#include <algorithm>
#include <type_traits>

#include "frame/pair.h"
#include "frame/status.h"

namespace krnumer {
namespace {

// One sample through one section.
template <int32_t kOrder, class Value, class Coefficient, class State>
inline Value Step(Value v, const Coefficient* a, const Coefficient* b, State* w) {
    Value back = a[0] * w[0];
    Value forward = b[1] * w[0];
    for (int32_t i = 1; i < kOrder; ++i) {
        back = back + a[i] * w[i];
        forward = forward + b[i + 1] * w[i];
    }
    const Value t = v - back;
    for (int32_t i = kOrder - 1; i > 0; --i) w[i] = w[i - 1];
    w[0] = t;
    return b[0] * t + forward;
}

// Neighbouring sections at work on neighbouring samples: while section k filters sample i, section k + 1 filters sample
// i - 1. Each section computes what it would compute alone, but none waits for the one before it.
template <class Signal, int32_t kOrder, int32_t kSections>
class Pipeline {
  public:
    Pipeline(Signal* x, int32_t n, const double* a, const double* b, Signal* state)
        : x_(x), n_(n), a_(a), b_(b), state_(state) {}

    void Run() {
        constexpr int32_t kFill = kSections - 1;
        int64_t step = 0;
        for (; step < kFill; ++step) StepActive(step);
        if (n_ > kFill) {
            StepAll();
            step = n_;
        }
        for (; step < int64_t{n_} + kFill; ++step) StepActive(step);
    }

  private:
    // A pair works for two sections of a real signal, or for both parts in one section of a complex signal; a wider
    // vector would wait just as long for the feedback, which is what the time goes into. A section too many computes
    // zeros.
    static constexpr bool kReal = std::is_same_v<Signal, double>;
    static constexpr int32_t kPairs = kReal ? (kSections + 1) / 2 : kSections;

    // Those sections that have a sample at this step, while the pipeline fills or drains.
    void StepActive(int64_t step) {
        for (int32_t k = kSections - 1; k >= 0; --k) {
            const int64_t i = step - k;
            if (i < 0 || i >= n_) continue;
            const Signal v = k == 0 ? x_[i] : between_[k - 1];
            const Signal filtered = Step<kOrder>(v, a_ + k * kOrder, b_ + k * (kOrder + 1), state_ + k * kOrder);
            (k == kSections - 1 ? x_[i] : between_[k]) = filtered;
        }
    }

    // All sections, at every step that has a sample for each.
    void StepAll() {
        Pair a[kPairs][kOrder], b[kPairs][kOrder + 1], w[kPairs][kOrder], v[kPairs];
        for (int32_t r = 0; r < kPairs; ++r) {
            for (int32_t i = 0; i < kOrder; ++i) {
                a[r][i] = Gather(r, [&](int32_t k) { return ForAllParts(a_[k * kOrder + i]); });
                w[r][i] = Gather(r, [&](int32_t k) { return state_[k * kOrder + i]; });
            }
            for (int32_t i = 0; i <= kOrder; ++i)
                b[r][i] = Gather(r, [&](int32_t k) { return ForAllParts(b_[k * (kOrder + 1) + i]); });
            v[r] = Gather(r, [&](int32_t k) { return between_[k]; });
        }
        constexpr int32_t kLast = kSections - 1;
        for (int32_t i = kLast; i < n_; ++i) {
            for (int32_t r = kPairs - 1; r > 0; --r) v[r] = kReal ? Pair{v[r - 1][1], v[r][0]} : v[r - 1];
            if constexpr (kReal) {
                v[0] = Pair{x_[i], v[0][0]};
            } else {
                v[0] = Pair{x_[i].re, x_[i].im};
            }
            for (int32_t r = 0; r < kPairs; ++r) v[r] = Step<kOrder>(v[r], a[r], b[r], w[r]);
            x_[i - kLast] = Of(kLast, v[kPairs - 1]);
        }
        for (int32_t k = 0; k < kSections; ++k) {
            const int32_t r = kReal ? k / 2 : k;
            for (int32_t i = 0; i < kOrder; ++i) state_[k * kOrder + i] = Of(k, w[r][i]);
            between_[k] = Of(k, v[r]);
        }
    }

    // The values that the sections of a pair have among those of all sections.
    template <class Values>
    static Pair Gather(int32_t r, Values values) {
        if constexpr (kReal) {
            return Pair{values(2 * r), 2 * r + 1 < kSections ? values(2 * r + 1) : 0.0};
        } else {
            const Complex value = values(r);
            return Pair{value.re, value.im};
        }
    }

    // What belongs to a section in its pair.
    static Signal Of(int32_t k, Pair pair) {
        if constexpr (kReal) {
            return pair[k % 2];
        } else {
            return {pair[0], pair[1]};
        }
    }

    static Signal ForAllParts(double coefficient) {
        if constexpr (kReal) {
            return coefficient;
        } else {
            return {coefficient, coefficient};
        }
    }

    Signal* x_;
    int32_t n_;
    const double* a_;
    const double* b_;
    Signal* state_;
    Signal between_[kSections] = {};  // what a section has handed to the next
};

// As many sections at once as the registers hold.
template <class Signal, int32_t kOrder>
constexpr int32_t kMostSections = std::is_same_v<Signal, double> || kOrder == 2 ? 4 : 2;

template <class Signal, int32_t kOrder, int32_t kSections = kMostSections<Signal, kOrder>>
void FilterBySections(Signal* x, int32_t n, const double* a, const double* b, Signal* state, int32_t sections) {
    for (; sections >= kSections; sections -= kSections) {
        Pipeline<Signal, kOrder, kSections>(x, n, a, b, state).Run();
        a += kSections * kOrder;
        b += kSections * (kOrder + 1);
        state += kSections * kOrder;
    }
    if constexpr (kSections > 1) FilterBySections<Signal, kOrder, kSections - 1>(x, n, a, b, state, sections);
}

template <class Signal>
int32_t Filter(Signal* x, int32_t n, Cascade<Signal>* cascade) {
    const int64_t sections = (int64_t{cascade->order} + 1) / 2;
    if (sections < 1) return kBadCoefficientCount;
    const int64_t m = cascade->na / sections;
    if ((m != 2 && m != 4) || cascade->na != m * sections || cascade->nb != (m + 1) * sections ||
        cascade->state_size != cascade->na)
        return kBadCoefficientCount;

    if (cascade->reset) std::fill_n(cascade->state, cascade->state_size, Signal{});
    cascade->reset = false;
    const auto filter = m == 2 ? FilterBySections<Signal, 2> : FilterBySections<Signal, 4>;
    filter(x, n, cascade->a, cascade->b, cascade->state, static_cast<int32_t>(sections));
    return kOk;
}

}  // namespace

int32_t CascadeFilter(double* x, int32_t n, Cascade<double>* cascade) {
    return Filter(x, n, cascade);
}

int32_t CascadeFilter(Complex* x, int32_t n, Cascade<Complex>* cascade) {
    return Filter(x, n, cascade);
}

}  // namespace krnumer
