#include "fft/butterflies.h"
#include "fft/butterfly.h"

namespace krnumer {

const Butterflies* LargeButterflies(int32_t radix) {
    switch (radix) {
        case 37:
            return &kButterflies<37>;
        case 41:
            return &kButterflies<41>;
        case 43:
            return &kButterflies<43>;
        default:
            return nullptr;
    }
}

}  // namespace krnumer
