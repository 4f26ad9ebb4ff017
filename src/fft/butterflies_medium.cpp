#include "fft/butterflies.h"
#include "fft/butterfly.h"

namespace krnumer {

const Butterflies* MediumButterflies(int32_t radix) {
    switch (radix) {
        case 13:
            return &kButterflies<13>;
        case 14:
            return &kButterflies<14>;
        case 16:
            return &kButterflies<16>;
        case 17:
            return &kButterflies<17>;
        case 18:
            return &kButterflies<18>;
        case 19:
            return &kButterflies<19>;
        case 29:
            return &kButterflies<29>;
        case 31:
            return &kButterflies<31>;
        case 32:
            return &kButterflies<32>;
        default:
            return nullptr;
    }
}

}  // namespace krnumer
