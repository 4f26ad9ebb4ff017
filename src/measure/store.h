// Measurement contexts and the store that knows them by their identifiers. Both may be used by several threads at
// once; memory that cannot be had is std::bad_alloc.
#pragma once

#include <cstdint>
#include <memory>
#include <mutex>
#include <unordered_map>

#include "measure/graph.h"

namespace krnumer::measure {

// The measurements of one signal. Two calls run one after the other.
class Context {
  public:
    // What was computed for the same parameters is not computed again, whatever the signal is now.
    // kBadMeasurementInterval, kNoSamples, or the status of the measurement.
    int32_t Fetch(const Parameters& parameters, Kind kind, const Signal& signal, Reading* reading);

    // Forgets what was computed.
    void Clear();

  private:
    std::mutex mutex_;
    Graph graph_;
};

// The lock is held for looking up only. A context that is removed while another thread measures with it lives until
// that measurement is done.
class Store {
  public:
    static constexpr uint32_t kFirstId = 1112;
    static constexpr uint32_t kGreatestId = 0xFFFFFFFE;  // the next one stands for a context of a single call

    explicit Store(uint32_t first_id = kFirstId, uint32_t greatest_id = kGreatestId)
        : next_id_(first_id), greatest_id_(greatest_id) {}

    // Adds a context and gives its identifier: the one after the last, after the greatest again 1, past those in use.
    uint32_t Create();

    // Null where the identifier is unknown.
    std::shared_ptr<Context> Find(uint32_t id);
    std::shared_ptr<Context> Remove(uint32_t id);

  private:
    uint32_t After(uint32_t id) const { return id < greatest_id_ ? id + 1 : 1; }

    std::mutex mutex_;
    std::unordered_map<uint32_t, std::shared_ptr<Context>> contexts_;
    uint32_t next_id_;
    uint32_t greatest_id_;
};

}  // namespace krnumer::measure
