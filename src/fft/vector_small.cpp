#include "fft/vector_groups.h"
#include "fft/vector_targets.h"

#undef HWY_TARGET_INCLUDE
#define HWY_TARGET_INCLUDE "fft/vector_small.cpp"
#include "hwy/foreach_target.h"  // IWYU pragma: keep
//
#include "fft/vector_kernels-inl.h"

HWY_BEFORE_NAMESPACE();
namespace krnumer::HWY_NAMESPACE {

const VectorButterflies* SmallRadix([[maybe_unused]] int32_t radix) {
#if KRNUMER_FFT_HAS_VECTORS
    switch (radix) {
        case 2:
            return &kVectorButterflies<2>;
        case 3:
            return &kVectorButterflies<3>;
        case 4:
            return &kVectorButterflies<4>;
        case 5:
            return &kVectorButterflies<5>;
        case 7:
            return &kVectorButterflies<7>;
        case 8:
            return &kVectorButterflies<8>;
        case 9:
            return &kVectorButterflies<9>;
        case 10:
            return &kVectorButterflies<10>;
        case 11:
            return &kVectorButterflies<11>;
        default:
            break;
    }
#endif
    return nullptr;
}

}  // namespace krnumer::HWY_NAMESPACE
HWY_AFTER_NAMESPACE();

#if HWY_ONCE
namespace krnumer {

HWY_EXPORT(SmallRadix);

const VectorButterflies* SmallVectorButterflies(int32_t radix) {
    return HWY_DYNAMIC_DISPATCH(SmallRadix)(radix);
}

}  // namespace krnumer
#endif
