// Level crossings of many channels.
#pragma once

#include <cstdint>

namespace krnumer {

// What triggers, an element per channel.
struct Triggers {
    const double* levels;
    const double* previous;    // the sample before the first
    const double* hysteresis;  // how far below (rising) or above (falling) the level a signal arms the trigger; |.|
    const int32_t* slopes;     // 1 rising, 0 falling; any other arms like a falling one and never hits
    int32_t most;              // hits per channel
};

// What was hit. `counts`, `flags` and `last` have an element per channel. `found` holds indices of samples, the hits of
// all channels in a row and a 0 for a channel without one, of which the first kMostTriggersFound are stored; it needs
// room for channels * most.
struct TriggerHits {
    int32_t* found;
    int32_t* counts;
    int32_t* flags;  // 1 where there is a hit
    double* last;    // the last sample, `previous` of the next block
};

inline constexpr int32_t kMostTriggersFound = 50;

// Looks for crossings in `channels` rows of n samples. A trigger is armed strictly beyond the hysteresis and hit by the
// first sample at or past the level, which disarms it.
void FindTriggers(const double* x, int32_t channels, int32_t n, const Triggers& triggers, const TriggerHits& hits);

}  // namespace krnumer
