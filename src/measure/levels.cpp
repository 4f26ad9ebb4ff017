#include "frame/numeric.h"
#include "frame/status.h"
#include "measure/averages.h"
#include "measure/graph.h"
#include "measure/kinds.h"

namespace krnumer::measure {

namespace {

// What stands for the whole block is drawn from its start to its end.
Reading OverBlock(const Signal& signal, double value) {
    return {value, {signal.t0(), signal.t0(), signal.end(), value, 0.0, 0.0}};
}

// Smallest and largest sample, found together.
class Extreme final : public Measurement {
    using Measurement::Measurement;

    int32_t Compute(const Signal& signal, Reading* reading) override {
        double smallest = signal[0];
        double largest = smallest;
        for (int32_t i = 1; i < signal.count(); ++i) {
            const double sample = signal[i];
            if (sample < smallest) smallest = sample;
            if (sample > largest) largest = sample;
        }
        graph().Store(Kind::kSmallest, OverBlock(signal, smallest));
        graph().Store(Kind::kLargest, OverBlock(signal, largest));
        *reading = kept();
        return kOk;
    }
};

template <Kind kUpper, Kind kLower>
class Difference final : public Measurement {
    using Measurement::Measurement;

    int32_t Compute(const Signal& signal, Reading* reading) override {
        double upper, lower;
        if (const int32_t status = graph().Evaluate(kUpper, signal, &upper)) return status;
        if (const int32_t status = graph().Evaluate(kLower, signal, &lower)) return status;
        *reading = {upper - lower, {signal.t0(), signal.t0(), signal.end(), lower, upper, 0.0}};
        return kOk;
    }
};

// The state where the signal dwells: the fullest bin of the upper or of the lower two fifths of the histogram, of
// equally full ones the outermost. A state that holds more than a twentieth of the samples serves as top or base too.
class StateLevel final : public Measurement {
    using Measurement::Measurement;

    int32_t Compute(const Signal& signal, Reading* reading) override {
        const Histogram* histogram;
        if (const int32_t status = graph().FindHistogram(signal, &histogram)) return status;
        const Scratch<int32_t>& counts = histogram->counts;
        const int32_t bins = graph().parameters().bins;
        const bool high = kind() == Kind::kHighState;

        const auto begin = static_cast<int32_t>((high ? 0.6 : 0.4) * bins);
        const int32_t end = high ? bins : -1;
        const int32_t step = high ? 1 : -1;
        int32_t fullest = begin;
        for (int32_t bin = begin; bin != end; bin += step) {
            if (counts[Count(bin)] >= counts[Count(fullest)]) fullest = bin;
        }

        const double level = fullest * histogram->width + histogram->first_center;
        const double half = 0.5 * histogram->width;
        *reading = {level, {signal.t0(), signal.t0(), signal.end(), level - half, level, level + half}};
        if (counts[Count(fullest)] > 0.05 * signal.count()) graph().Store(high ? Kind::kTop : Kind::kBase, *reading);
        return kOk;
    }
};

// Top and base: the state where it is well filled, the extreme where the signal only peaks there.
template <Kind kState, Kind kExtreme>
class Plateau final : public Measurement {
    using Measurement::Measurement;

    int32_t Compute(const Signal& signal, Reading* reading) override {
        double state;
        if (const int32_t status = graph().Evaluate(kState, signal, &state)) return status;
        if (!computed()) return graph().Evaluate(kExtreme, signal, reading);
        *reading = kept();
        return kOk;
    }
};

// The amplitude that is a hundred percent, and the level that is 0 percent.
int32_t FindScale(Graph& graph, const Signal& signal, double* amplitude, double* base) {
    struct Scale {
        Kind amplitude, base;
    };
    static constexpr Scale kScales[] = {
        {Kind::kAmplitude, Kind::kLowState}, {Kind::kRange, Kind::kSmallest}, {Kind::kTopToBase, Kind::kBase}};
    const int32_t method = graph.parameters().state_method;
    if (method < Parameters::kHistogram || method > Parameters::kHistogramOrExtremes) return kBadStateMethod;
    if (const int32_t status = graph.Evaluate(kScales[method].amplitude, signal, amplitude)) return status;
    return graph.Evaluate(kScales[method].base, signal, base);
}

// A reference level, or a distance of levels, in the signal's own units.
template <double Parameters::*kGiven, bool kIsLevel>
class Reference final : public Measurement {
    using Measurement::Measurement;

    int32_t Compute(const Signal& signal, Reading* reading) override {
        double level = graph().parameters().*kGiven;
        switch (graph().parameters().units) {
            case Parameters::kAbsolute:
                break;
            case Parameters::kPercent: {
                double amplitude, base;
                if (const int32_t status = FindScale(graph(), signal, &amplitude, &base)) return status;
                level = level * amplitude * 0.01;
                if (kIsLevel) level += base;
                break;
            }
            default:
                return kBadUnits;
        }
        *reading = OverBlock(signal, level);
        return kOk;
    }
};

template <double (*kAverage)(const Signal&, int32_t, int32_t)>
class BlockAverage final : public Measurement {
    using Measurement::Measurement;

    int32_t Compute(const Signal& signal, Reading* reading) override {
        *reading = OverBlock(signal, kAverage(signal, 0, signal.count()));
        return kOk;
    }
};

}  // namespace

std::unique_ptr<Measurement> MakeLevel(Graph& graph, Kind kind) {
    switch (kind) {
        case Kind::kSmallest:
        case Kind::kLargest:
            return std::make_unique<Extreme>(graph, kind);
        case Kind::kRange:
            return std::make_unique<Difference<Kind::kLargest, Kind::kSmallest>>(graph, kind);
        case Kind::kLowState:
        case Kind::kHighState:
            return std::make_unique<StateLevel>(graph, kind);
        case Kind::kAmplitude:
            return std::make_unique<Difference<Kind::kHighState, Kind::kLowState>>(graph, kind);
        case Kind::kTop:
            return std::make_unique<Plateau<Kind::kHighState, Kind::kLargest>>(graph, kind);
        case Kind::kBase:
            return std::make_unique<Plateau<Kind::kLowState, Kind::kSmallest>>(graph, kind);
        case Kind::kTopToBase:
            return std::make_unique<Difference<Kind::kTop, Kind::kBase>>(graph, kind);
        case Kind::kLowReference:
            return std::make_unique<Reference<&Parameters::low, true>>(graph, kind);
        case Kind::kMidReference:
            return std::make_unique<Reference<&Parameters::mid, true>>(graph, kind);
        case Kind::kHighReference:
            return std::make_unique<Reference<&Parameters::high, true>>(graph, kind);
        case Kind::kBand:
            return std::make_unique<Reference<&Parameters::margin, false>>(graph, kind);
        case Kind::kRms:
            return std::make_unique<BlockAverage<RootMeanSquare>>(graph, kind);
        case Kind::kMean:
            return std::make_unique<BlockAverage<Mean>>(graph, kind);
        default:
            return nullptr;
    }
}

}  // namespace krnumer::measure
