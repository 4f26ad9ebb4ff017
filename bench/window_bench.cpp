// Windows beside the least that any of them could cost: a multiplication of the samples by weights computed before.
// times_multiply is the ratio of both in processor time, measured one after the other.
//
// Arguments: samples, and how many arrays take turns. One array stays in the caches; 16 of a million samples do not.
#include <benchmark/benchmark.h>

#include <cmath>
#include <cstddef>
#include <cstdint>
#include <ctime>
#include <type_traits>
#include <vector>

#include "frame/complex.h"
#include "frame/numeric.h"
#include "window/cosine_sum.h"
#include "window/dolph_chebyshev.h"
#include "window/generated.h"
#include "window/multiply.h"
#include "window/shaped.h"
#include "window/type.h"

namespace krnumer {
namespace {

template <class T>
using Arrays = std::vector<std::vector<T>>;

// Infinite samples, which no weight ever wears down to denormals, however often it is applied.
template <class T>
Arrays<T> NewArrays(const benchmark::State& state) {
    T sample;
    if constexpr (std::is_same_v<T, Complex>)
        sample = {kInfinity, kInfinity};
    else
        sample = kInfinity;
    return Arrays<T>(static_cast<std::size_t>(state.range(1)),
                     std::vector<T>(static_cast<std::size_t>(state.range(0)), sample));
}

double ProcessorSeconds() {
    return static_cast<double>(std::clock()) / CLOCKS_PER_SEC;
}

// Seconds for one multiplication of an array.
template <class T>
double MultiplySeconds(Arrays<T>& arrays) {
    const std::size_t n = arrays[0].size();
    const Arrays<double> weights(arrays.size(), std::vector<double>(n, 0.999));
    const std::size_t rounds = 100000000 / (n * arrays.size());
    const double start = ProcessorSeconds();
    for (std::size_t round = 0; round < rounds; ++round) {
        for (std::size_t turn = 0; turn < arrays.size(); ++turn) {
            MultiplyByWeights(arrays[turn].data(), weights[turn].data(), static_cast<int32_t>(n));
            benchmark::ClobberMemory();
        }
    }
    return (ProcessorSeconds() - start) / static_cast<double>(rounds * arrays.size());
}

template <class T, class Window>
void Measure(benchmark::State& state, Window window) {
    const int32_t n = static_cast<int32_t>(state.range(0));
    Arrays<T> arrays = NewArrays<T>(state);
    const double multiply = MultiplySeconds(arrays);
    const double start = ProcessorSeconds();
    std::size_t turn = 0;
    for (auto _ : state) {
        window(arrays[turn].data(), n);
        benchmark::ClobberMemory();
        if (++turn == arrays.size()) turn = 0;
    }
    const double seconds = (ProcessorSeconds() - start) / static_cast<double>(state.iterations());
    state.SetItemsProcessed(state.iterations() * n);
    state.counters["times_multiply"] = seconds / multiply;
}

void Cached(benchmark::internal::Benchmark* b) {
    b->Args({1000, 1})->Args({1000000, 1});
}

void CachedAndNot(benchmark::internal::Benchmark* b) {
    b->Args({1000, 1})->Args({1000000, 1})->Args({1000000, 16});
}

void Quadratic(benchmark::internal::Benchmark* b) {
    b->Args({100, 1})->Args({1000, 1})->Args({10000, 1});
}

// What a window costs that calls a cosine for each sample.
template <class T>
void CosinePerSample(T* x, int32_t n) {
    for (int32_t i = 0; i < n; ++i) x[i] *= 0.5 - 0.5 * std::cos(2.0 * kPi * i / n);
}

// The same weights for all arrays of a length.
const double* Precomputed(int32_t n) {
    static std::vector<double> weights;
    if (weights.size() < static_cast<std::size_t>(n)) weights.assign(static_cast<std::size_t>(n), 0.999);
    return weights.data();
}

#define WINDOW_BENCHMARK(name, arguments, call)                              \
    void name(benchmark::State& state) {                                     \
        Measure<double>(state, [](double* x, int32_t n) { return call; });   \
    }                                                                        \
    BENCHMARK(name)->Apply(arguments);                                       \
    void Cx##name(benchmark::State& state) {                                 \
        Measure<Complex>(state, [](Complex* x, int32_t n) { return call; }); \
    }                                                                        \
    BENCHMARK(Cx##name)->Apply(arguments)

WINDOW_BENCHMARK(Multiply, CachedAndNot, MultiplyByWeights(x, Precomputed(n), n));
WINDOW_BENCHMARK(HannByCosinePerSample, CachedAndNot, CosinePerSample(x, n));
WINDOW_BENCHMARK(Hann, CachedAndNot, NamedCosineWindow(x, n, kWindowHann, false));
WINDOW_BENCHMARK(Blackman, CachedAndNot, NamedCosineWindow(x, n, kWindowBlackman, false));
WINDOW_BENCHMARK(BlackmanHarris4, CachedAndNot, NamedCosineWindow(x, n, kWindowBlackmanHarris4, false));
WINDOW_BENCHMARK(FlatTop, CachedAndNot, NamedCosineWindow(x, n, kWindowFlatTop, false));
WINDOW_BENCHMARK(BlackmanHarris7, CachedAndNot, NamedCosineWindow(x, n, kWindowBlackmanHarris7, false));
WINDOW_BENCHMARK(BartlettHanning, Cached, BartlettHanningWindow(x, n));
WINDOW_BENCHMARK(Bohman, Cached, BohmanWindow(x, n));
WINDOW_BENCHMARK(Parzen, Cached, ParzenWindow(x, n));
WINDOW_BENCHMARK(Welch, Cached, WelchWindow(x, n));
WINDOW_BENCHMARK(Triangle, Cached, TriangleWindow(x, n));
WINDOW_BENCHMARK(Taper, Cached, CosineTaper(x, n, 0.2));
WINDOW_BENCHMARK(Exponential, Cached, ExponentialWindow(x, n, 0.1));
WINDOW_BENCHMARK(Force, Cached, ForceWindow(x, n, 50.0));
WINDOW_BENCHMARK(Kaiser, Cached, KaiserWindow(x, n, 6.0));
WINDOW_BENCHMARK(Gaussian, Cached, GaussianWindow(x, n, 0.2, false));
WINDOW_BENCHMARK(DolphChebyshev, Quadratic, DolphChebyshevWindow(x, n, 1e4, false));

}  // namespace
}  // namespace krnumer
