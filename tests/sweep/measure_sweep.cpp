#include "krnumer/measure.h"

#include <gtest/gtest.h>

#include <array>

#include "sweep/sweep.h"

namespace {

int32_t Fetch(int32_t id, int32_t selector, double* result, double* box) {
    constexpr std::array<double, 14> kSquareWave{0, 0, 1, 1, 0, 0, 1, 1, 0, 0, 1, 1, 0, 0};
    const KrLevels levels{90.0, 50.0, 10.0, KRN_LEVELS_PERCENT};
    const KrStateMethod method{KRN_STATES_BY_EITHER, 10};
    return measurements_fetch(id, selector, &levels, &method, 1, 0.0, 1.0, kSquareWave.data(),
                              static_cast<int32_t>(kSquareWave.size()), result, reinterpret_cast<KrMarkers*>(box));
}

int32_t SweepFetch(sweep::Scene& scene, int32_t id, int32_t selector) {
    scene.RefusalGives(krnumer::kMeasurementOutOfMemory);
    double* result = scene.Number(sweep::OnFailure::kOther);
    double* box = scene.Numbers(6, sweep::OnFailure::kOther);
    return scene.Call(Fetch, id, selector, result, box);
}

int32_t NewContext() {
    uint32_t id = 0;
    measurements_create(&id);
    return static_cast<int32_t>(id);
}

}  // namespace

SWEEP(measurements_create) {
    scene.RefusalGives(krnumer::kMeasurementOutOfMemory);
    uint32_t id = 0;
    const int32_t status = scene.Call(measurements_create, &id);
    measurements_destroy(static_cast<int32_t>(id));
    return status;
}

SWEEP(measurements_fetch) {
    const int32_t id = NewContext();
    const int32_t status = SweepFetch(scene, id, KRN_NEXT_OVERSHOOT);
    double result;
    double box[6];
    EXPECT_EQ(Fetch(id, KRN_NEXT_OVERSHOOT, &result, box), 0) << "whatever was refused, the context serves on";
    measurements_destroy(id);
    return status;
}

SWEEP_MORE(measurements_fetch, single_call) {
    return SweepFetch(scene, -1, KRN_CYCLE_RMS);
}

SWEEP(measurements_clear) {
    const int32_t id = NewContext();
    double result;
    double box[6];
    Fetch(id, KRN_PERIOD, &result, box);
    const int32_t status = scene.Call(measurements_clear, id);
    measurements_destroy(id);
    return status;
}

SWEEP(measurements_destroy) {
    const int32_t id = NewContext();
    return scene.Call(measurements_destroy, id);
}
