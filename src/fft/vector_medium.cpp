#include "fft/vector_groups.h"
#include "fft/vector_targets.h"

#undef HWY_TARGET_INCLUDE
#define HWY_TARGET_INCLUDE "fft/vector_medium.cpp"
#include "hwy/foreach_target.h"  // IWYU pragma: keep
//
#include "fft/vector_kernels-inl.h"

HWY_BEFORE_NAMESPACE();
namespace krnumer::HWY_NAMESPACE {

const VectorButterflies* MediumRadix([[maybe_unused]] int32_t radix) {
#if KRNUMER_FFT_HAS_VECTORS
    switch (radix) {
        case 13:
            return &kVectorButterflies<13>;
        case 14:
            return &kVectorButterflies<14>;
        case 16:
            return &kVectorButterflies<16>;
        case 17:
            return &kVectorButterflies<17>;
        case 18:
            return &kVectorButterflies<18>;
        case 19:
            return &kVectorButterflies<19>;
        case 32:
            return &kVectorButterflies<32>;
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

HWY_EXPORT(MediumRadix);

const VectorButterflies* MediumVectorButterflies(int32_t radix) {
    return HWY_DYNAMIC_DISPATCH(MediumRadix)(radix);
}

}  // namespace krnumer
#endif
