// Where a signal passes its reference levels: crossings of the middle level, and edges between the outer ones. Both
// lists are as long as anybody has asked, and go on from where they stopped.
#pragma once

#include <cstdint>
#include <vector>

#include "measure/measurement.h"

namespace krnumer::measure {

enum class State : uint8_t { kUnknown, kHigh, kLow };

// Passage through the middle level. Rising and falling ones alternate.
struct Crossing {
    double time;
    bool rising;
};

// A crossing counts when the signal has left the band around the level on the other side since the last one, so that
// noise within the band is none.
class CrossingList {
  public:
    // Looks for more until `wanted` are found or the samples end. Throws std::bad_alloc.
    void Extend(const Signal& signal, double level, double band, int64_t wanted);
    void Clear();

    int64_t size() const { return static_cast<int64_t>(crossings_.size()); }
    const Crossing& operator[](int64_t i) const { return crossings_[static_cast<size_t>(i)]; }

  private:
    std::vector<Crossing> crossings_;
    int32_t position_ = 0;
    State state_ = State::kUnknown;
    bool armed_ = false;
};

// Passage through one level: the sample before it and its interpolated time.
struct Passage {
    int32_t index;
    double time;
};

// Transition between the lower and the upper level. Rising and falling ones alternate.
struct Edge {
    Passage lower;
    Passage upper;
    bool rising;

    const Passage& first() const { return rising ? lower : upper; }
    const Passage& last() const { return rising ? upper : lower; }
};

// Each edge starts with the last passage through the level it leaves and ends with the first one through the level it
// reaches.
class EdgeList {
  public:
    // Looks for more until `wanted` are found or the samples end. Throws std::bad_alloc.
    void Extend(const Signal& signal, double lower, double upper, int64_t wanted);
    void Clear();

    int64_t size() const { return static_cast<int64_t>(edges_.size()); }
    const Edge& operator[](int64_t i) const { return edges_[static_cast<size_t>(i)]; }

  private:
    std::vector<Edge> edges_;
    Edge pending_{};
    bool passed_lower_ = false;
    bool passed_upper_ = false;
    int32_t position_ = 0;
    State state_ = State::kUnknown;
};

}  // namespace krnumer::measure
