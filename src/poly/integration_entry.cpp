#include "frame/entry.h"
#include "krnumer/integration.h"
#include "poly/integration.h"

using namespace krnumer;

namespace {

template <int kRank>
int32_t IntegrateArray(KrHandle y, KrHandle steps, int32_t rule, int32_t too_few_steps, double* integral) {
    ByValue call;
    In<double, kRank> samples(call, y);
    In<double> widths(call, steps);
    Result<double> result(call, integral);
    int32_t sizes[kRank];
    for (int axis = 0; axis < kRank; ++axis) {
        sizes[axis] = samples.dimension(axis);
        if (sizes[axis] < 3) return call.Fail(kBadDimension);
    }
    if (widths.size() < kRank) return call.Fail(too_few_steps);
    const IntegrationRule selected{static_cast<uint32_t>(rule) & 0xFFFF};
    if (selected > IntegrationRule::kBoole) return call.Fail(kBadSelector);
    return call.Run(
        [&] { return IntegrateGrid(samples.data(), sizes, kRank, widths.data(), selected, result.data()); });
}

}  // namespace

int32_t NumerIntegration_head(KrHandle y, const double* dt, const int32_t* rule, double* integral, int32_t* err) {
    ByReference call(err);
    In<double> samples(call, y);
    Result<double> result(call, integral);
    if (samples.size() < 1) return call.Fail(kEmptyInput);
    const IntegrationRule selected{static_cast<uint32_t>(*rule)};
    return call.Run([&] { return IntegrateCore(samples.data(), samples.size(), *dt, selected, result.data()); });
}

int32_t NumerIntegration2D_head(KrHandle y, KrHandle steps, int32_t rule, double* integral) {
    return IntegrateArray<2>(y, steps, rule, kFewerThanTwo, integral);
}

int32_t NumerIntegration3D_head(KrHandle y, KrHandle steps, int32_t rule, double* integral) {
    return IntegrateArray<3>(y, steps, rule, kFewerThanThree, integral);
}
