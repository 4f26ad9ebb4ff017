// The measurements of one signal under one set of parameters, with what they have in common: each is computed once.
#pragma once

#include <array>
#include <cstdint>
#include <memory>
#include <optional>

#include "frame/scratch.h"
#include "measure/measurement.h"
#include "measure/transitions.h"

namespace krnumer::measure {

// How often the signal is at which height.
struct Histogram {
    Scratch<int32_t> counts;
    double first_center = 0.0;
    double width = 0.0;
};

// A full cycle at the middle level: three crossings in a row.
struct Cycle {
    Crossing begin;
    Crossing middle;
    Crossing end;
};

// Its functions throw std::bad_alloc where memory cannot be had; nothing is lost by that.
class Graph {
  public:
    Graph() = default;
    Graph(const Graph&) = delete;
    Graph& operator=(const Graph&) = delete;

    // Forgets what was computed under other parameters.
    void Use(const Parameters& parameters);
    // Forgets everything.
    void Clear();

    const Parameters& parameters() const { return *parameters_; }

    // kUnexpectedKind where there is no such measurement, or the status of what failed; the reading then keeps a
    // value only where the failing measurement left one.
    int32_t Evaluate(Kind kind, const Signal& signal, Reading* reading);
    // The value alone.
    int32_t Evaluate(Kind kind, const Signal& signal, double* value);

    // Hands a reading to the measurement of this kind.
    void Store(Kind kind, const Reading& reading) { At(kind)->Store(reading); }

    // kNoBins, kFlatHistogram. The pointer holds until the graph is cleared.
    int32_t FindHistogram(const Signal& signal, const Histogram** histogram);

    // The cycle that begins with crossing number `first`, counted from 1. kBadOccurrence, kTooFewCrossings.
    int32_t FindCycle(const Signal& signal, int64_t first, Cycle* cycle);

    // The list of edges with number `number`, counted from 1, and the one after it if there is any. kLevelsOutOfOrder,
    // kTooFewCrossings. The pointer holds until the graph is cleared.
    int32_t FindEdges(const Signal& signal, int64_t number, const EdgeList** edges);

  private:
    static constexpr size_t kKinds = static_cast<size_t>(Kind::kNothing);

    Measurement* At(Kind kind);
    int32_t IsFlat(const Signal& signal, bool* flat);

    std::array<std::unique_ptr<Measurement>, kKinds> measurements_;
    std::optional<Parameters> parameters_;
    Histogram histogram_;
    CrossingList crossings_;
    EdgeList edges_;
};

}  // namespace krnumer::measure
