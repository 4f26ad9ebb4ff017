#include "frame/entry.h"
#include "frame/scratch.h"
#include "krnumer/stat.h"
#include "stat/histogram.h"

using namespace krnumer;

int32_t GenHistH(KrHandle x, KrHandle bins, KrHandle histogram, KrOutOfRange* counters, int32_t* err) {
    ByReference call(err);
    In<double> samples(call, x);
    In<KrInterval> records(call, bins);
    Out<int32_t> counts(call, histogram);
    // All failures look alike to the caller, and the dimension word goes on telling the number of intervals.
    const auto fail = [&] {
        counts.ReleaseElements();
        *counters = {};
        return call.Leave(kOutOfMemory);
    };

    const int32_t m = records.size();
    if (m < 0 || counts.Resize(m) || call.Map()) return fail();
    Scratch<Interval> intervals(Count(m));
    if (!intervals) return fail();
    for (size_t j = 0; j < Count(m); ++j) {
        const KrInterval& record = records.data()[j];
        intervals[j] = {record.lower, record.upper, Inclusion{record.inclusion}};
    }
    OutOfRange lost;
    if (IntervalHistogram(samples.data(), samples.size(), intervals.data(), m, counts.data(), &lost)) return fail();
    *counters = {lost.outside, lost.below, lost.above};
    return call.Deliver(kOk);
}

int32_t histgran_head(KrHandle x, const int32_t* bins, KrHandle histogram, KrHandle centers, int32_t* err) {
    ByReference call(err);
    In<double> samples(call, x);
    Out<int32_t> counts(call, histogram);
    Out<double> middles(call, centers);
    if (samples.size() < 1 || *bins < 1) return call.Fail(kEmptyInput);
    if (auto host = middles.Resize(*bins)) return call.HostFailure(host);
    if (auto host = counts.Resize(*bins)) return call.HostFailure(host);
    return call.Run(
        [&] { return Histogram(samples.data(), samples.size(), counts.data(), middles.data(), middles.size()); });
}
