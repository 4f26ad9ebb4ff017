// A module that may mark itself as a host and may offer the one service that the test uses.

#include <cstdio>

#include "krnumer/types.h"

#define EXPORT extern "C" __attribute__((visibility("default")))

#if defined(EXPORT_VERSION)
EXPORT int gKRRTVersion;
int gKRRTVersion = 1;
#endif

#if defined(EXPORT_SERVICE)
EXPORT int32_t ResizeNumberBlock(int32_t, int32_t, KrHandle*, int32_t) {
    std::puts("served by " MODULE_NAME);
    return 0;
}
#endif
