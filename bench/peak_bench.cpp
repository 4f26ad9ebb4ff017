// Peaks of a million samples, in one call and in blocks. peak_peers.py measures SciPy on the same signal.

#include <benchmark/benchmark.h>

#include <cmath>
#include <cstdint>

#include "krnumer/peak.h"
#include "krrt/krrt.h"

namespace {

constexpr int32_t kSamples = 1000000;

// A tone of 100 samples with one of 7 on it.
void FillTones(KrHandle array, int32_t begin) {
    auto* samples = static_cast<double*>(KrrtElements(array));
    for (int32_t i = 0; i < KrrtSize(array, 0); ++i)
        samples[i] = std::sin(0.0628 * (begin + i)) + 0.1 * std::sin(0.9 * (begin + i));
}

void Parabolas(benchmark::State& state) {
    const auto block = static_cast<int32_t>(state.range(1));
    const KrHandle input = KrrtNewArray(KRRT_DOUBLE, block);
    FillTones(input, 0);
    KrPeakRecord record{};
    record.input = input;
    record.width = static_cast<int32_t>(state.range(0));
    record.threshold = 0.5;
    record.locations = KrrtNewArray(KRRT_DOUBLE, 0);
    record.amplitudes = KrrtNewArray(KRRT_DOUBLE, 0);
    record.second_derivatives = KrrtNewArray(KRRT_DOUBLE, 0);
    KrPeakState detector;
    KrHandle work = nullptr;
    for (auto _ : state) {
        for (int32_t begin = 0; begin < kSamples; begin += block) {
            int32_t err;
            record.flags = (begin == 0 ? KRN_FIRST_BLOCK : 0) | (begin + block == kSamples ? KRN_LAST_BLOCK : 0);
            benchmark::DoNotOptimize(PeakD(&record, &detector, &work, &err));
        }
    }
    state.SetItemsProcessed(state.iterations() * kSamples);
    for (const KrHandle array : {input, record.locations, record.amplitudes, record.second_derivatives})
        KrrtFree(array);
}
BENCHMARK(Parabolas)
    ->Name("peaks of parabolas/krnumer")
    ->ArgNames({"width", "block"})
    ->ArgsProduct({{3, 5, 15, 51}, {1000, kSamples}})
    ->Unit(benchmark::kMillisecond);

void Runs(benchmark::State& state) {
    const KrHandle input = KrrtNewArray(KRRT_DOUBLE, kSamples);
    FillTones(input, 0);
    const KrHandle indices = KrrtNewArray(KRRT_INT32, 0);
    const double threshold = 0.5;
    const int32_t width = 10;
    for (auto _ : state) {
        int32_t count, err;
        benchmark::DoNotOptimize(PeakDetector(input, &threshold, &width, indices, &count, &err));
    }
    state.SetItemsProcessed(state.iterations() * kSamples);
    KrrtFree(input);
    KrrtFree(indices);
}
BENCHMARK(Runs)->Name("peaks of runs/krnumer")->Unit(benchmark::kMillisecond);

}  // namespace
