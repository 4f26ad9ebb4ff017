#include "fft/vector_kernels.h"

#include "fft/vector_groups.h"
#include "fft/vector_targets.h"
#include "frame/numeric.h"

#undef HWY_TARGET_INCLUDE
#define HWY_TARGET_INCLUDE "fft/vector_kernels.cpp"
#include "hwy/foreach_target.h"  // IWYU pragma: keep
//
#include "fft/vector-inl.h"

HWY_BEFORE_NAMESPACE();
namespace krnumer::HWY_NAMESPACE {

int32_t Lanes() {
    return KRNUMER_FFT_HAS_VECTORS ? static_cast<int32_t>(kLanes) : 0;
}

}  // namespace krnumer::HWY_NAMESPACE
HWY_AFTER_NAMESPACE();

#if HWY_ONCE
namespace krnumer {

HWY_EXPORT(Lanes);

int32_t VectorLanes() {
    return HWY_DYNAMIC_DISPATCH(Lanes)();
}

const VectorButterflies* VectorButterfliesOf(int32_t radix) {
    for (const auto group : {SmallVectorButterflies, MediumVectorButterflies, LargeVectorButterflies})
        if (const VectorButterflies* found = group(radix)) return found;
    return nullptr;
}

}  // namespace krnumer
#endif
