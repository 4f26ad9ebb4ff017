#include <algorithm>
#include <utility>

#include "frame/numeric.h"
#include "frame/status.h"
#include "measure/averages.h"
#include "measure/graph.h"
#include "measure/kinds.h"

namespace krnumer::measure {

namespace {

class CycleMeasurement : public Measurement {
  protected:
    using Measurement::Measurement;

    // The crossings on the middle level are drawn at their times.
    Reading Between(double left, double right, double value, const Signal& signal) const {
        double level = 0.0;
        graph().Evaluate(Kind::kMidReference, signal, &level);  // known, or there would be no crossing
        return {value, {left, right, level, level, 0.0, 0.0}};
    }
};

class Period final : public CycleMeasurement {
    using CycleMeasurement::CycleMeasurement;

    int32_t Compute(const Signal& signal, Reading* reading) override {
        Cycle cycle;
        if (const int32_t status = graph().FindCycle(signal, graph().parameters().occurrence, &cycle)) return status;
        *reading = Between(cycle.begin.time, cycle.end.time, cycle.end.time - cycle.begin.time, signal);
        return kOk;
    }
};

class Frequency final : public Measurement {
    using Measurement::Measurement;

    int32_t Compute(const Signal& signal, Reading* reading) override {
        Reading period;
        if (const int32_t status = graph().Evaluate(Kind::kPeriod, signal, &period)) return status;
        if (period.value <= 0.0) return kNoPeriod;
        *reading = {1.0 / period.value, period.markers};
        return kOk;
    }
};

// Average over the samples nearest to the cycle, whose markers hold its begin.
template <double (*kAverage)(const Signal&, int32_t, int32_t)>
class CycleAverage final : public Measurement {
    using Measurement::Measurement;

    int32_t Compute(const Signal& signal, Reading* reading) override {
        Reading period;
        if (const int32_t status = graph().Evaluate(Kind::kPeriod, signal, &period)) return status;
        const int32_t begin = Nearest((period.markers[0] - signal.t0()) / signal.dt(), signal.count());
        const int32_t count = Nearest(period.value / signal.dt(), signal.count() - begin);
        if (count == 0) return kNoPeriod;
        *reading = {kAverage(signal, begin, count), period.markers};
        return kOk;
    }

    static int32_t Nearest(double samples, int32_t most) { return std::clamp(SaturateToInt32(samples + 0.5), 0, most); }
};

template <bool kHigh>
class Duty final : public CycleMeasurement {
    using CycleMeasurement::CycleMeasurement;

    int32_t Compute(const Signal& signal, Reading* reading) override {
        Cycle cycle;
        if (const int32_t status = graph().FindCycle(signal, graph().parameters().occurrence, &cycle)) return status;
        const auto [begin, middle, end] = cycle;
        const double pulse = begin.rising == kHigh ? middle.time - begin.time : end.time - middle.time;
        *reading = Between(begin.time, end.time, pulse / (end.time - begin.time), signal);
        return kOk;
    }
};

// The complete pulse of this polarity with the wanted number. One more crossing has to follow it.
template <bool kPositive>
class PulseWidth final : public CycleMeasurement {
    using CycleMeasurement::CycleMeasurement;

    int32_t Compute(const Signal& signal, Reading* reading) override {
        Cycle cycle;
        const int64_t pulse = graph().parameters().occurrence;
        if (const int32_t status = graph().FindCycle(signal, 2 * pulse - 1, &cycle)) return status;
        const auto [left, right] = cycle.begin.rising == kPositive ? std::pair(cycle.begin.time, cycle.middle.time)
                                                                   : std::pair(cycle.middle.time, cycle.end.time);
        *reading = Between(left, right, right - left, signal);
        return kOk;
    }
};

template <Kind kWidth>
class PulseCenter final : public Measurement {
    using Measurement::Measurement;

    int32_t Compute(const Signal& signal, Reading* reading) override {
        Reading width;
        if (const int32_t status = graph().Evaluate(kWidth, signal, &width)) return status;
        *reading = {(width.markers[0] + width.markers[1]) * 0.5, width.markers};
        return kOk;
    }
};

}  // namespace

std::unique_ptr<Measurement> MakeCycle(Graph& graph, Kind kind) {
    switch (kind) {
        case Kind::kPeriod:
            return std::make_unique<Period>(graph, kind);
        case Kind::kFrequency:
            return std::make_unique<Frequency>(graph, kind);
        case Kind::kCycleRms:
            return std::make_unique<CycleAverage<RootMeanSquare>>(graph, kind);
        case Kind::kCycleMean:
            return std::make_unique<CycleAverage<Mean>>(graph, kind);
        case Kind::kDutyHigh:
            return std::make_unique<Duty<true>>(graph, kind);
        case Kind::kDutyLow:
            return std::make_unique<Duty<false>>(graph, kind);
        case Kind::kPositiveWidth:
            return std::make_unique<PulseWidth<true>>(graph, kind);
        case Kind::kNegativeWidth:
            return std::make_unique<PulseWidth<false>>(graph, kind);
        case Kind::kPositiveCenter:
            return std::make_unique<PulseCenter<Kind::kPositiveWidth>>(graph, kind);
        case Kind::kNegativeCenter:
            return std::make_unique<PulseCenter<Kind::kNegativeWidth>>(graph, kind);
        default:
            return nullptr;
    }
}

}  // namespace krnumer::measure
