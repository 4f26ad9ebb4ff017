#include <algorithm>
#include <limits>

#include "frame/entry.h"
#include "krnumer/sigop.h"
#include "sigop/polyphase.h"

using namespace krnumer;

namespace {

// The two ranks that the exports have, as channels of samples.

template <class T>
int32_t Channels(const ShapedView<T, 1>&) {
    return 1;
}
template <class T>
int32_t Channels(const ShapedView<T, 2>& view) {
    return std::max(view.rows(), 0);
}

template <class T>
int32_t Length(const ShapedView<T, 1>& view) {
    return view.size();
}
template <class T>
int32_t Length(const ShapedView<T, 2>& view) {
    return view.columns();
}

template <class T>
int32_t Resize(WritableView<T, 1>& view, int32_t, int32_t length) {
    return view.Resize(length);
}
template <class T>
int32_t Resize(WritableView<T, 2>& view, int32_t channels, int32_t length) {
    return view.Resize(channels, length);
}

template <class T, int Rank>
int32_t Resample(KrHandle x, int32_t up, int32_t down, int32_t reset, int32_t* start, KrHandle filter, KrHandle history,
                 int32_t* history_count, KrHandle y) {
    ByValue call;
    In<T, Rank> samples(call, x);
    In<double> taps(call, filter);
    InOut<T, Rank> kept(call, history);
    Out<T, Rank> resampled(call, y);

    RationalRate rate{up, down, nullptr, std::max(taps.size(), 0)};
    if (const int32_t status = CheckRational(rate, {*start, *history_count})) return call.Fail(status);
    const int32_t channels = Channels(samples);
    bool fresh = reset != 0;
    if constexpr (Rank == 2) {
        if (!fresh && kept.rows() > 0 && channels > 0 && kept.rows() != channels) return call.Fail(kBadDimension);
        fresh = fresh || kept.rows() < 1;
    }
    if (fresh && Resize(kept, channels, channels > 0 ? RationalHistory(rate) : 0) != 0) return call.Fail(kOutOfMemory);
    if (reset != 0) *history_count = 0;

    RationalStream stream{*start, *history_count};
    const int64_t count = RationalOutputCount(rate, stream, Length(samples));
    if (count > std::numeric_limits<int32_t>::max()) return call.Fail(kOutOfMemory);
    if (count > 0 && Resize(resampled, channels, static_cast<int32_t>(count)) != 0) return call.Fail(kOutOfMemory);
    if (const int32_t status = call.Map()) return call.Fail(status);
    if (fresh) std::fill_n(kept.data(), kept.count(), T{});
    rate.filter = taps.data();
    const int32_t status = PolyphaseResample(samples.data(), channels, Length(samples), rate, &stream, kept.data(),
                                             Length(kept), resampled.data(), static_cast<int32_t>(count));
    if (status < 0) return call.Fail(status);
    *start = stream.start;
    *history_count = stream.history_count;
    if (count < 1) resampled.Empty();
    return call.Leave(kOk);
}

}  // namespace

int32_t RationalResample_H(KrHandle x, int32_t L, int32_t M, int32_t reset, int32_t* start, KrHandle filter,
                           KrHandle history, int32_t* historyCount, KrHandle y) {
    return Resample<double, 1>(x, L, M, reset, start, filter, history, historyCount, y);
}
int32_t CxRationalResample_H(KrHandle x, int32_t L, int32_t M, int32_t reset, int32_t* start, KrHandle filter,
                             KrHandle history, int32_t* historyCount, KrHandle y) {
    return Resample<Complex, 1>(x, L, M, reset, start, filter, history, historyCount, y);
}

int32_t RationalResampleMultiCh_H(KrHandle x, int32_t L, int32_t M, int32_t reset, int32_t* start, KrHandle filter,
                                  KrHandle history, int32_t* historyCount, KrHandle y) {
    return Resample<double, 2>(x, L, M, reset, start, filter, history, historyCount, y);
}
int32_t CxRationalResampleMCh_H(KrHandle x, int32_t L, int32_t M, int32_t reset, int32_t* start, KrHandle filter,
                                KrHandle history, int32_t* historyCount, KrHandle y) {
    return Resample<Complex, 2>(x, L, M, reset, start, filter, history, historyCount, y);
}
