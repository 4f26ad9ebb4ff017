#include "fft/vector_groups.h"
#include "fft/vector_targets.h"

#undef HWY_TARGET_INCLUDE
#define HWY_TARGET_INCLUDE "fft/vector_large.cpp"
#include "hwy/foreach_target.h"  // IWYU pragma: keep
//
#include "fft/vector_kernels-inl.h"

HWY_BEFORE_NAMESPACE();
namespace krnumer::HWY_NAMESPACE {

const VectorButterflies* LargeRadix([[maybe_unused]] int32_t radix) {
#if KRNUMER_FFT_HAS_VECTORS
    switch (radix) {
        case 29:
            return &kVectorButterflies<29>;
        case 31:
            return &kVectorButterflies<31>;
        case 37:
            return &kVectorButterflies<37>;
        case 41:
            return &kVectorButterflies<41>;
        case 43:
            return &kVectorButterflies<43>;
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

HWY_EXPORT(LargeRadix);

const VectorButterflies* LargeVectorButterflies(int32_t radix) {
    return HWY_DYNAMIC_DISPATCH(LargeRadix)(radix);
}

}  // namespace krnumer
#endif
