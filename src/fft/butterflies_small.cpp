#include "fft/butterflies.h"
#include "fft/butterfly.h"

namespace krnumer {

const Butterflies* SmallButterflies(int32_t radix) {
    switch (radix) {
        case 2:
            return &kButterflies<2>;
        case 3:
            return &kButterflies<3>;
        case 4:
            return &kButterflies<4>;
        case 5:
            return &kButterflies<5>;
        case 7:
            return &kButterflies<7>;
        case 8:
            return &kButterflies<8>;
        case 9:
            return &kButterflies<9>;
        case 10:
            return &kButterflies<10>;
        case 11:
            return &kButterflies<11>;
        default:
            return nullptr;
    }
}

}  // namespace krnumer
