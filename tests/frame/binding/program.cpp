// A program that makes krnumer ask for its host, after it has done what its arguments say:
//     load PATH    loads a module into the global scope
//     name PATH    loads a module and names it as the host
//     unname       names no module again
//     use          calls an export that empties an array
//     quiet        calls an export that needs no host

#include <dlfcn.h>

#include <cstdio>
#include <cstdlib>
#include <cstring>

#include "krnumer/krnumer.h"

#define EXPORT extern "C" __attribute__((visibility("default")))

#if defined(EXPORT_VERSION)
EXPORT int gKRRTVersion;
int gKRRTVersion = 1;
#endif

#if defined(EXPORT_ZONE)
EXPORT void* MakeZoneBlock() {
    std::puts("MakeZoneBlock was called");
    return nullptr;
}
#endif

#if defined(EXPORT_SERVICE)
EXPORT int32_t ResizeNumberBlock(int32_t, int32_t, KrHandle*, int32_t) {
    std::puts("served by program");
    return 0;
}
#endif

namespace {

struct Array {
    int32_t size;
    int32_t elements[2];
};

void Use() {
    Array none{0, {}};
    Array counts{1, {}};
    Array centers{1, {}};
    Array* blocks[] = {&none, &counts, &centers};
    const int32_t bins = 0;
    int32_t err;
    histgran_head(reinterpret_cast<KrHandle>(&blocks[0]), &bins, reinterpret_cast<KrHandle>(&blocks[1]),
                  reinterpret_cast<KrHandle>(&blocks[2]), &err);
    std::printf("status %d, sizes %d %d\n", err, counts.size, centers.size);
}

void UseQuietly() {
    Array none{0, {}};
    Array* block = &none;
    double mean;
    int32_t err;
    Mean_head(reinterpret_cast<KrHandle>(&block), &mean, &err);
    std::printf("status %d\n", err);
}

void* Load(const char* path, int flags) {
    void* const module = dlopen(path, RTLD_NOW | flags);
    if (module == nullptr) {
        std::puts(dlerror());
        std::exit(2);
    }
    return module;
}

}  // namespace

int main(int count, char** arguments) {
    for (int i = 1; i < count; ++i) {
        const char* const what = arguments[i];
        if (std::strcmp(what, "use") == 0) Use();
        if (std::strcmp(what, "quiet") == 0) UseQuietly();
        if (std::strcmp(what, "unname") == 0 && SetKRRTModule(nullptr) != nullptr) return 3;
        if (std::strcmp(what, "load") == 0) Load(arguments[++i], RTLD_GLOBAL);
        if (std::strcmp(what, "name") == 0) {
            void* const module = Load(arguments[++i], RTLD_LOCAL);
            if (SetKRRTModule(module) != module) return 3;
        }
    }
    return 0;
}
