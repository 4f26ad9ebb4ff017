// What a context saves: all measurements of a block in one context, beside one of them alone and beside each in a
// context of its own.

#include <benchmark/benchmark.h>

#include <cmath>
#include <cstdint>
#include <vector>

#include "krnumer/measure.h"

namespace {

std::vector<double> NoisyPulses(int64_t count) {
    std::vector<double> samples;
    uint32_t noise = 1;
    for (int64_t i = 0; i < count; ++i) {
        noise = noise * 1664525 + 1013904223;
        samples.push_back(std::tanh(20.0 * std::sin(0.01 * static_cast<double>(i))) + 1e-11 * noise);
    }
    return samples;
}

void Fetch(int32_t id, int32_t selector, const std::vector<double>& samples) {
    const KrLevels levels{90.0, 50.0, 10.0, KRN_LEVELS_PERCENT};
    const KrStateMethod method{KRN_STATES_BY_HISTOGRAM, 256};
    double result;
    KrMarkers box;
    benchmark::DoNotOptimize(measurements_fetch(id, selector, &levels, &method, 1, 0.0, 1.0, samples.data(),
                                                static_cast<int32_t>(samples.size()), &result, &box));
    benchmark::DoNotOptimize(result);
}

template <class Body>
void Measure(benchmark::State& state, Body body) {
    const std::vector<double> samples = NoisyPulses(state.range(0));
    uint32_t id = 0;
    measurements_create(&id);
    for (auto _ : state) {
        measurements_clear(static_cast<int32_t>(id));
        body(static_cast<int32_t>(id), samples);
    }
    measurements_destroy(static_cast<int32_t>(id));
    state.SetItemsProcessed(state.iterations() * state.range(0));
}

void Sizes(benchmark::internal::Benchmark* b) {
    b->ArgName("n")->Arg(1000)->Arg(100000);
}

// All 33, each of which looks at the first occurrence.
template <class Body>
void ForAll(Body body) {
    for (int32_t selector = KRN_SMALLEST; selector < KRN_NO_MEASUREMENT; ++selector) {
        if (selector != KRN_FALL_TIME + 2) body(selector);
    }
}

void RiseTime(benchmark::State& state) {
    Measure(state, [](int32_t id, const auto& samples) { Fetch(id, KRN_RISE_TIME, samples); });
}
BENCHMARK(RiseTime)->Name("rise time/krnumer")->Apply(Sizes);

void AllInOneContext(benchmark::State& state) {
    Measure(state,
            [](int32_t id, const auto& samples) { ForAll([&](int32_t selector) { Fetch(id, selector, samples); }); });
}
BENCHMARK(AllInOneContext)->Name("all 33, one context/krnumer")->Apply(Sizes);

void AllByThemselves(benchmark::State& state) {
    Measure(state,
            [](int32_t, const auto& samples) { ForAll([&](int32_t selector) { Fetch(-1, selector, samples); }); });
}
BENCHMARK(AllByThemselves)->Name("all 33, a context for each/krnumer")->Apply(Sizes);

}  // namespace
