// What an entry point costs over its core: the mean of one sample, and the other ways of passing arrays.

#include <benchmark/benchmark.h>

#include "krnumer/krnumer.h"
#include "krrt/krrt.h"
#include "stat/moments.h"

namespace {

void MeanCore(benchmark::State& state) {
    const double sample = 1.5;
    for (auto _ : state) {
        double mean;
        const double* x = &sample;
        benchmark::DoNotOptimize(x);
        benchmark::DoNotOptimize(krnumer::Mean(x, 1, &mean));
        benchmark::DoNotOptimize(mean);
    }
}
BENCHMARK(MeanCore)->Name("core/krnumer");

void MeanEntry(benchmark::State& state, int32_t least_alignment) {
    KrrtLeastAlignment(least_alignment);
    const KrHandle x = KrrtNewArray(KRRT_DOUBLE, 1);
    KrrtLeastAlignment(0);
    for (auto _ : state) {
        double mean;
        int32_t err;
        benchmark::DoNotOptimize(Mean_head(x, &mean, &err));
        benchmark::DoNotOptimize(mean);
    }
    KrrtFree(x);
}
BENCHMARK_CAPTURE(MeanEntry, aligned, 0)->Name("entry point/krnumer");
BENCHMARK_CAPTURE(MeanEntry, least_alignment, 1)->Name("entry point, elements out of alignment/krnumer");

// One output that keeps its size: the host's resize is in it.
void ImpulseEntry(benchmark::State& state) {
    const KrHandle x = KrrtNewArray(KRRT_DOUBLE, 1);
    const int32_t n = 1;
    const int32_t delay = 0;
    const double amplitude = 2.0;
    for (auto _ : state) {
        int32_t err;
        benchmark::DoNotOptimize(ImpulsePtrn(x, &n, &amplitude, &delay, &err));
    }
    KrrtFree(x);
}
BENCHMARK(ImpulseEntry)->Name("entry point that sizes an output/krnumer");

}  // namespace
