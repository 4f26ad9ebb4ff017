// The measurements by topic. Each function makes the object of a kind, or null for a kind of another topic, and
// throws std::bad_alloc.
#pragma once

#include <memory>

#include "measure/measurement.h"

namespace krnumer::measure {

// Of the whole block: extremes, states, reference levels, means.
std::unique_ptr<Measurement> MakeLevel(Graph& graph, Kind kind);

// Of a cycle or pulse between crossings of the middle level.
std::unique_ptr<Measurement> MakeCycle(Graph& graph, Kind kind);

// Of an edge between the outer levels.
std::unique_ptr<Measurement> MakeTransition(Graph& graph, Kind kind);

}  // namespace krnumer::measure
