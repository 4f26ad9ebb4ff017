// What tests ask of the host, and what it saw: one record per thread.
#pragma once

#include <cstddef>
#include <cstdint>

#include "krrt/krrt.h"

namespace krrt {

inline constexpr int32_t kLoggedCalls = 64;

struct OrderedFailure {
    int32_t calls_left;  // 0: none ordered
    int32_t status;

    // Counts one call; the status it has to fail with, or 0.
    int32_t Count() { return calls_left > 0 && --calls_left == 0 ? status : KRRT_OK; }
};

// Trivial throughout, so that a thread's first use of it allocates nothing.
struct Settings {
    bool least_alignment;
    bool moving_blocks;
    uint64_t block_limit;
    OrderedFailure failures[3];
    int32_t resize_count;
    KrrtResize log[kLoggedCalls];
};

Settings& ThreadSettings();

void Log(const KrrtResize& call);

}  // namespace krrt
