#include "settings.h"

#include <utility>

namespace krrt {
namespace {

constinit thread_local Settings settings{};

bool IsCounting(int32_t calls) {
    return calls >= KRRT_RESIZES && calls <= KRRT_BLOCKS;
}

}  // namespace

Settings& ThreadSettings() {
    return settings;
}

void Log(const KrrtResize& call) {
    if (settings.resize_count == INT32_MAX) return;
    settings.log[settings.resize_count++ % kLoggedCalls] = call;
}

}  // namespace krrt

using krrt::settings;

int32_t KrrtLeastAlignment(int32_t on) {
    return std::exchange(settings.least_alignment, on != 0);
}

int32_t KrrtMovingBlocks(int32_t on) {
    return std::exchange(settings.moving_blocks, on != 0);
}

uint64_t KrrtBlockLimit(uint64_t bytes) {
    return std::exchange(settings.block_limit, bytes);
}

void KrrtFail(int32_t calls, int32_t nth, int32_t status) {
    if (!krrt::IsCounting(calls)) return;
    settings.failures[calls] = {nth > 0 && status != KRRT_OK ? nth : 0, status};
}

int32_t KrrtFailurePending(int32_t calls) {
    return krrt::IsCounting(calls) ? settings.failures[calls].calls_left : 0;
}

int32_t KrrtResizeCount() {
    return settings.resize_count;
}

int32_t KrrtResizeCall(int32_t index, KrrtResize* call) {
    const int32_t count = settings.resize_count;
    if (call == nullptr || index < 0 || index >= count || index < count - krrt::kLoggedCalls) return 0;
    *call = settings.log[index % krrt::kLoggedCalls];
    return 1;
}

void KrrtForgetResizes() {
    settings.resize_count = 0;
}
