// Short forms for measuring with the exports.
#pragma once

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <utility>
#include <vector>

#include "krnumer/measure.h"
#include "support/numbers.h"

// Found by Google Test where the type is.
inline bool operator==(const KrMarkers& a, const KrMarkers& b) {
    return a.left == b.left && a.right == b.right && std::equal(a.values, a.values + 4, b.values);
}

namespace krnumer {

using Samples = std::vector<double>;

// A block with everything that measurements_fetch is asked with. Members are changed at will between calls.
struct Block {
    Samples samples;
    double t0 = 0.0;
    double dt = 1.0;
    KrLevels levels{90.0, 50.0, 10.0, KRN_LEVELS_PERCENT};
    KrStateMethod method{KRN_STATES_BY_EXTREMES, 100};
    int32_t occurrence = 1;

    int32_t count() const { return static_cast<int32_t>(samples.size()); }
};

// All there is, and those that depend on the occurrence.
inline std::vector<int32_t> AllMeasurements(int32_t first = KRN_SMALLEST) {
    std::vector<int32_t> kinds;
    for (int32_t kind = first; kind < KRN_NO_MEASUREMENT; ++kind) {
        if (kind != 21) kinds.push_back(kind);
    }
    return kinds;
}
inline std::vector<int32_t> CountingMeasurements() {
    return AllMeasurements(KRN_PERIOD);
}

struct Outcome {
    int32_t status;
    double value;
    KrMarkers box;
};

inline constexpr KrMarkers kUntouched{-7.0, -7.0, {-7.0, -7.0, -7.0, -7.0}};

inline Outcome Fetch(int32_t id, int32_t selector, const Block& block) {
    Outcome outcome{-1, -7.0, kUntouched};
    outcome.status = measurements_fetch(id, selector, &block.levels, &block.method, block.occurrence, block.t0,
                                        block.dt, block.samples.data(), block.count(), &outcome.value, &outcome.box);
    return outcome;
}

// In a context of its own.
inline Outcome Fetch(int32_t selector, const Block& block) {
    return Fetch(-1, selector, block);
}

inline double ValueOf(int32_t selector, const Block& block) {
    const Outcome outcome = Fetch(selector, block);
    EXPECT_EQ(outcome.status, 0) << "measurement " << selector;
    return outcome.value;
}

inline int32_t StatusOf(int32_t selector, const Block& block) {
    return Fetch(selector, block).status;
}

class NewContext {
  public:
    NewContext() { EXPECT_EQ(measurements_create(&id_), 0); }
    NewContext(const NewContext&) = delete;
    NewContext& operator=(const NewContext&) = delete;
    ~NewContext() { EXPECT_EQ(measurements_destroy(id()), 0); }

    int32_t id() const { return static_cast<int32_t>(id_); }

  private:
    uint32_t id_ = 0;
};

// Lines between corners (time, height), sampled at 0, 1, 2 ...
inline Samples Polyline(int32_t count, const std::vector<std::pair<double, double>>& corners) {
    Samples samples;
    std::size_t next = 1;
    for (int32_t i = 0; i < count; ++i) {
        while (next + 1 < corners.size() && corners[next].first <= i) ++next;
        const auto [t0, y0] = corners[next - 1];
        const auto [t1, y1] = corners[next];
        samples.push_back(y0 + (y1 - y0) * std::clamp((i - t0) / (t1 - t0), 0.0, 1.0));
    }
    return samples;
}

}  // namespace krnumer
