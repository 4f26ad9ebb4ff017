#include "fft/butterflies.h"

namespace krnumer {

const Butterflies* ButterfliesOf(int32_t radix) {
    for (const auto group : {SmallButterflies, MediumButterflies, LargeButterflies})
        if (const Butterflies* found = group(radix)) return found;
    return nullptr;
}

}  // namespace krnumer
