#include <algorithm>

#include "frame/status.h"
#include "measure/graph.h"
#include "measure/kinds.h"

namespace krnumer::measure {

namespace {

// Time of the rising or falling edge of a pair.
template <bool kRising>
class TransitionTime final : public Measurement {
    using Measurement::Measurement;

    int32_t Compute(const Signal& signal, Reading* reading) override {
        const int64_t pair = graph().parameters().occurrence;
        if (pair < 1) return kBadOccurrence;
        const EdgeList* edges;
        if (const int32_t status = graph().FindEdges(signal, 2 * pair, &edges)) return status;
        const Edge& first = (*edges)[2 * pair - 2];
        const Edge& edge = first.rising == kRising ? first : (*edges)[2 * pair - 1];
        const double left = edge.first().time;
        const double right = edge.last().time;
        *reading = {right - left, {left, right, 0.0, 0.0, 0.0, 0.0}};
        // known, or there would be no edge
        graph().Evaluate(kRising ? Kind::kLowReference : Kind::kHighReference, signal, &reading->markers[2]);
        graph().Evaluate(kRising ? Kind::kHighReference : Kind::kLowReference, signal, &reading->markers[3]);
        return kOk;
    }
};

// Height of a transition over its time.
template <Kind kTime>
class SlewRate final : public Measurement {
    using Measurement::Measurement;

    int32_t Compute(const Signal& signal, Reading* reading) override {
        Reading transition;
        double lower, upper;
        if (const int32_t status = graph().Evaluate(kTime, signal, &transition)) return status;
        if (const int32_t status = graph().Evaluate(Kind::kLowReference, signal, &lower)) return status;
        if (const int32_t status = graph().Evaluate(Kind::kHighReference, signal, &upper)) return status;
        if (transition.value <= 0.0) {
            reading->value = upper;
            return kZeroTransition;
        }
        *reading = {(upper - lower) / transition.value, transition.markers};
        return kOk;
    }
};

// How far the signal goes beyond its states around an edge, in percent of the amplitude: from the middle of the
// plateau before the edge to the middle of the one after it, or to the end of the signal behind the last edge.
// kAfter tells the edge of a pair: 0 its second one, 1 the first one of the next pair.
template <bool kOver, int64_t kAfter>
class Overshoot final : public Measurement {
    using Measurement::Measurement;

    int32_t Compute(const Signal& signal, Reading* reading) override {
        const int64_t pair = graph().parameters().occurrence;
        if (pair < 1) return kBadOccurrence;
        const int64_t number = 2 * pair + kAfter;
        const EdgeList* edges;
        if (const int32_t status = graph().FindEdges(signal, number, &edges)) return status;
        double state, amplitude;
        if (const int32_t status = graph().Evaluate(kOver ? Kind::kHighState : Kind::kLowState, signal, &state)) {
            return status;
        }
        if (const int32_t status = graph().Evaluate(Kind::kAmplitude, signal, &amplitude)) return status;

        const Edge& edge = (*edges)[number - 1];
        const int32_t begin = MidIndex((*edges)[number - 2], edge);
        int32_t last = signal.count() - 1;
        // Edges may come from a longer block that was measured before.
        if (edges->size() > number) last = std::min(last, MidIndex(edge, (*edges)[number]));
        if (begin > last) return kTooFewCrossings;
        int32_t extreme = begin;
        for (int32_t i = begin + 1; i <= last; ++i) {
            if (kOver ? signal[i] > signal[extreme] : signal[i] < signal[extreme]) extreme = i;
        }
        const double excess = kOver ? signal[extreme] - state : state - signal[extreme];
        *reading = {excess * 100.0 / amplitude,
                    {signal.t0() + begin * signal.dt(), signal.t0() + last * signal.dt(),
                     signal.t0() + extreme * signal.dt(), signal[extreme], state, 0.0}};
        return kOk;
    }

    // Between the end of an edge and the begin of the next.
    static int32_t MidIndex(const Edge& edge, const Edge& next) {
        return static_cast<int32_t>((int64_t{edge.last().index} + next.first().index) / 2);
    }
};

}  // namespace

std::unique_ptr<Measurement> MakeTransition(Graph& graph, Kind kind) {
    switch (kind) {
        case Kind::kFallTime:
            return std::make_unique<TransitionTime<false>>(graph, kind);
        case Kind::kRiseTime:
            return std::make_unique<TransitionTime<true>>(graph, kind);
        case Kind::kUndershoot:
            return std::make_unique<Overshoot<false, 0>>(graph, kind);
        case Kind::kOvershoot:
            return std::make_unique<Overshoot<true, 0>>(graph, kind);
        case Kind::kNextOvershoot:
            return std::make_unique<Overshoot<true, 1>>(graph, kind);
        case Kind::kNextUndershoot:
            return std::make_unique<Overshoot<false, 1>>(graph, kind);
        case Kind::kRisingSlew:
            return std::make_unique<SlewRate<Kind::kRiseTime>>(graph, kind);
        case Kind::kFallingSlew:
            return std::make_unique<SlewRate<Kind::kFallTime>>(graph, kind);
        default:
            return nullptr;
    }
}

}  // namespace krnumer::measure
