// The entry of libFuzzer: tools/fuzz builds and runs it.

#include <cstdio>
#include <cstdlib>
#include <span>

#include "sweep/fuzz.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    const std::span input(data, size);
    const std::string finding = sweep::Fuzz(input);
    if (!finding.empty()) {
        std::fprintf(stderr, "%s: %s\n", sweep::FuzzedScene(input).c_str(), finding.c_str());
        std::abort();
    }
    return 0;
}
