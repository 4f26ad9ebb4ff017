#include "measure/graph.h"

#include <new>
#include <utility>

#include "frame/numeric.h"
#include "frame/status.h"
#include "measure/kinds.h"

namespace krnumer::measure {

namespace {

std::unique_ptr<Measurement> Make(Graph& graph, Kind kind) {
    for (const auto make : {MakeLevel, MakeCycle, MakeTransition}) {
        if (auto made = make(graph, kind)) return made;
    }
    return nullptr;
}

}  // namespace

void Graph::Use(const Parameters& parameters) {
    if (parameters_ == parameters) return;
    Clear();
    parameters_ = parameters;
}

void Graph::Clear() {
    for (const auto& measurement : measurements_) {
        if (measurement != nullptr) measurement->Clear();
    }
    parameters_.reset();
    histogram_ = {};
    crossings_.Clear();
    edges_.Clear();
}

Measurement* Graph::At(Kind kind) {
    if (kind < Kind::kSmallest || kind >= Kind::kNothing) return nullptr;
    std::unique_ptr<Measurement>& slot = measurements_[static_cast<size_t>(kind)];
    if (slot == nullptr) slot = Make(*this, kind);
    return slot.get();
}

int32_t Graph::Evaluate(Kind kind, const Signal& signal, Reading* reading) {
    Measurement* const measurement = At(kind);
    return measurement != nullptr ? measurement->Evaluate(signal, reading) : kUnexpectedKind;
}

int32_t Graph::Evaluate(Kind kind, const Signal& signal, double* value) {
    Reading reading;
    const int32_t status = Evaluate(kind, signal, &reading);
    *value = reading.value;
    return status;
}

int32_t Graph::FindHistogram(const Signal& signal, const Histogram** histogram) {
    *histogram = &histogram_;
    if (histogram_.counts) return kOk;
    const int32_t bins = parameters().bins;
    if (bins < 1) return kNoBins;
    double smallest, range;
    if (const int32_t status = Evaluate(Kind::kSmallest, signal, &smallest)) return status;
    if (const int32_t status = Evaluate(Kind::kRange, signal, &range)) return status;
    const double width = range / bins;
    if (!(width > 0.0)) return kFlatHistogram;

    Scratch<int32_t> counts(Count(bins), Scratch<int32_t>::kZeroed);
    if (!counts) throw std::bad_alloc();
    for (int32_t i = 0; i < signal.count(); ++i) {
        const double position = (signal[i] - smallest) / width;
        const int32_t bin = position >= bins ? bins - 1 : position > 0.0 ? static_cast<int32_t>(position) : 0;
        ++counts[Count(bin)];
    }
    histogram_ = {std::move(counts), smallest + 0.5 * width, width};
    return kOk;
}

// A block without any change has neither crossings nor edges, even where it lies right on a level.
int32_t Graph::IsFlat(const Signal& signal, bool* flat) {
    double smallest, largest;
    if (const int32_t status = Evaluate(Kind::kSmallest, signal, &smallest)) return status;
    if (const int32_t status = Evaluate(Kind::kLargest, signal, &largest)) return status;
    *flat = smallest == largest;
    return kOk;
}

int32_t Graph::FindCycle(const Signal& signal, int64_t first, Cycle* cycle) {
    if (first < 1) return kBadOccurrence;
    double level, band;
    bool flat;
    if (const int32_t status = Evaluate(Kind::kMidReference, signal, &level)) return status;
    if (const int32_t status = Evaluate(Kind::kBand, signal, &band)) return status;
    if (const int32_t status = IsFlat(signal, &flat)) return status;
    if (!flat) crossings_.Extend(signal, level, band, first + 2);
    if (crossings_.size() < first + 2) return kTooFewCrossings;
    *cycle = {crossings_[first - 1], crossings_[first], crossings_[first + 1]};
    return kOk;
}

int32_t Graph::FindEdges(const Signal& signal, int64_t number, const EdgeList** edges) {
    double lower, upper;
    bool flat;
    if (const int32_t status = Evaluate(Kind::kLowReference, signal, &lower)) return status;
    if (const int32_t status = Evaluate(Kind::kHighReference, signal, &upper)) return status;
    if (lower > upper) return kLevelsOutOfOrder;
    if (const int32_t status = IsFlat(signal, &flat)) return status;
    if (!flat) edges_.Extend(signal, lower, upper, number + 1);
    if (edges_.size() < number) return kTooFewCrossings;
    *edges = &edges_;
    return kOk;
}

}  // namespace krnumer::measure
