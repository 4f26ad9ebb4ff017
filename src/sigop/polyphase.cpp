#include "sigop/polyphase.h"

#include <algorithm>

#include "frame/status.h"
#include "sigop/history.h"

namespace krnumer {
namespace {

// The products of one output: the first tap that meets a sample, and that sample. Further ones follow at L taps.
class Position {
  public:
    Position(const RationalRate& rate, int64_t start)
        : up_(rate.up), taps_(rate.taps), tap_((rate.taps - 1) / 2 - start) {
        PassTaps();
    }

    int64_t tap() const { return tap_; }
    int64_t input() const { return input_; }
    int64_t products() const { return tap_ < taps_ ? (taps_ - 1 - tap_) / up_ + 1 : 0; }

    void Advance(int64_t steps) {
        tap_ -= steps;
        PassTaps();
    }

  private:
    void PassTaps() {
        if (tap_ >= 0) return;
        const int64_t samples = (up_ - 1 - tap_) / up_;
        input_ += samples;
        tap_ += samples * up_;
    }

    int64_t up_;
    int64_t taps_;
    int64_t tap_;
    int64_t input_ = 0;
};

// n products of taps, `up` apart, with neighbouring samples.
template <class T>
T AddProducts(T sum, const double* filter, int64_t tap, int64_t up, const T* samples, int64_t first, int64_t n) {
    for (int64_t i = 0; i < n; ++i) sum += filter[tap + i * up] * samples[first + i];
    return sum;
}

// The outputs of one channel. Four advance together as soon as all their samples are new: the additions of one have to
// wait for each other.
template <class T>
void FilterChannel(const RationalRate& rate, Position position, const T* history, int64_t history_count, const T* x,
                   T* out, int32_t count) {
    constexpr int kTogether = 4;
    const int64_t up = rate.up;
    const double gain = rate.up;
    const double* const filter = rate.filter;
    while (count > 0) {
        if (position.input() < history_count || count < kTogether) {
            const int64_t tap = position.tap();
            const int64_t input = position.input();
            const int64_t products = position.products();
            const int64_t old = std::clamp<int64_t>(history_count - input, 0, products);
            const T sum = AddProducts(T{}, filter, tap, up, history, input, old);
            *out++ =
                gain * AddProducts(sum, filter, tap + old * up, up, x, input + old - history_count, products - old);
            position.Advance(rate.down);
            --count;
            continue;
        }
        int64_t taps[kTogether];
        int64_t inputs[kTogether];
        int64_t products[kTogether];
        for (int k = 0; k < kTogether; ++k, position.Advance(rate.down)) {
            taps[k] = position.tap();
            inputs[k] = position.input() - history_count;
            products[k] = position.products();
        }
        const int64_t common = *std::min_element(products, products + kTogether);
        T sums[kTogether] = {};
        for (int64_t i = 0; i < common; ++i)
            for (int k = 0; k < kTogether; ++k) sums[k] += filter[taps[k] + i * up] * x[inputs[k] + i];
        for (int k = 0; k < kTogether; ++k) {
            *out++ = gain * AddProducts(sums[k], filter, taps[k] + common * up, up, x, inputs[k] + common,
                                        products[k] - common);
        }
        count -= kTogether;
    }
}

}  // namespace

int32_t CheckRational(const RationalRate& rate, const RationalStream& stream) {
    if (stream.start < 0 || stream.history_count < 0) return kNegativeState;
    if (rate.up < 1 || rate.down < 1) return kNotPositive;
    return kOk;
}

int64_t RationalOutputCount(const RationalRate& rate, const RationalStream& stream, int32_t n) {
    const int64_t samples = int64_t{stream.history_count} + n;
    const int64_t room = samples * rate.up - (rate.taps - 1) / 2 - stream.start - 1;
    return room < 0 ? 0 : room / rate.down + 1;
}

template <class T>
int32_t PolyphaseResample(const T* x, int32_t channels, int32_t n, const RationalRate& rate, RationalStream* stream,
                          T* history, int32_t capacity, T* out, int32_t count) {
    if (const int32_t status = CheckRational(rate, *stream)) return status;
    if (rate.taps % 2 == 0) return kEvenLength;
    n = std::max(n, 0);
    const int64_t old = stream->history_count;
    if (old > capacity) return kHistoryTooSmall;

    // A stream that waits for its first output drops nothing once it has samples.
    const int64_t next = stream->start + std::max<int64_t>(count, 0) * rate.down;
    const bool drops = count > 0 || old == 0;
    const int64_t dropped = drops ? std::min(Position(rate, next).input(), old + n) : 0;
    const int64_t kept = old + n - dropped;
    if (kept > capacity) return kHistoryTooSmall;

    const Position position(rate, stream->start);
    for (int64_t channel = 0; channel < channels; ++channel) {
        T* const samples_before = history + channel * capacity;
        const T* const samples = x + channel * n;
        FilterChannel<T>(rate, position, samples_before, old, samples, out + channel * count, count);
        KeepSamples<T>(samples_before, old, dropped, samples, n);
    }
    *stream = {static_cast<int32_t>(next - dropped * rate.up), static_cast<int32_t>(kept)};
    return kOk;
}

template int32_t PolyphaseResample(const double*, int32_t, int32_t, const RationalRate&, RationalStream*, double*,
                                   int32_t, double*, int32_t);
template int32_t PolyphaseResample(const Complex*, int32_t, int32_t, const RationalRate&, RationalStream*, Complex*,
                                   int32_t, Complex*, int32_t);

}  // namespace krnumer
