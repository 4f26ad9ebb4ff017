// Moving sums and modulators, which the time of a copy of the samples bounds, and cosine and sine transforms beside FFTW,
// planned once. transform_peers.py measures NumPy and SciPy.
#include <benchmark/benchmark.h>

#include <algorithm>
#include <cmath>
#include <cstring>
#include <vector>

#include "frame/complex.h"
#include "frame/numeric.h"
#include "transform/modulator.h"
#include "transform/moving_average.h"
#include "transform/trigonometric.h"

#ifdef KRNUMER_HAVE_FFTW
#include <fftw3.h>
#endif

namespace krnumer {
namespace {

constexpr int32_t kSamples = 1000000;

// Samples without zeros and subnormal numbers, which are slow.
template <class T>
std::vector<T> Samples(int32_t n) {
    std::vector<T> x(Count(n));
    for (int32_t i = 0; i < n; ++i) {
        const double phase = 0.7 * i;
        if constexpr (std::is_same_v<T, double>) {
            x[Count(i)] = 1.5 + std::sin(phase);
        } else {
            x[Count(i)] = {1.5 + std::sin(phase), std::cos(phase)};
        }
    }
    return x;
}

// ---- Streams: bytes of the input per second -------------------------------------------------------------------------

template <class T, class Run>
void Stream(benchmark::State& state, Run run) {
    std::vector<T> x = Samples<T>(kSamples);
    for (auto _ : state) {
        run(x.data());
        benchmark::DoNotOptimize(x.data());
        benchmark::ClobberMemory();
    }
    state.SetBytesProcessed(state.iterations() * static_cast<int64_t>(x.size() * sizeof(T)));
}

template <class T>
void Copy(benchmark::State& state) {
    std::vector<T> y(Count(kSamples));
    Stream<T>(state, [&](const T* x) {
        std::memcpy(y.data(), x, y.size() * sizeof(T));
        benchmark::DoNotOptimize(y.data());
    });
}
BENCHMARK(Copy<double>)->Name("copy/memcpy");
BENCHMARK(Copy<Complex>)->Name("copy, complex/memcpy");

// The samples would grow by the gain from run to run, so every run begins with a copy of them.
template <class T>
void Cascade(benchmark::State& state) {
    const auto stages = static_cast<int32_t>(state.range(0));
    const auto window = static_cast<int32_t>(state.range(1));
    std::vector<T> sums(Count(stages)), history(Count(stages) * Count(window)), y(Count(kSamples));
    int32_t index = 0;
    Stream<T>(state, [&](const T* x) {
        std::memcpy(y.data(), x, y.size() * sizeof(T));
        CascadedMovingSums(y.data(), kSamples, stages, window, sums.data(), history.data(), &index);
        benchmark::DoNotOptimize(y.data());
    });
}
void CascadeShapes(benchmark::internal::Benchmark* benchmark) {
    for (const auto& [stages, window] : {std::pair{1, 16}, {3, 16}, {3, 1000}})
        benchmark->ArgNames({"stages", "window"})->Args({stages, window});
}
BENCHMARK(Cascade<double>)->Name("moving sums/krnumer")->Apply(CascadeShapes);
BENCHMARK(Cascade<Complex>)->Name("moving sums, complex/krnumer")->Apply(CascadeShapes);

// In place: the sums overwrite a part of the samples, so every run begins with a copy of that part.
template <class T>
void DecimatedSums(benchmark::State& state) {
    const auto width = static_cast<int32_t>(state.range(0));
    const std::vector<T> front = Samples<T>(kSamples / width);
    T sum{};
    int32_t count = 0;
    Stream<T>(state, [&](T* x) {
        std::memcpy(x, front.data(), front.size() * sizeof(T));
        benchmark::DoNotOptimize(DecimatedMovingSums(x, kSamples, width, &sum, &count));
    });
}
void Widths(benchmark::internal::Benchmark* benchmark) {
    benchmark->ArgName("width")->Arg(4)->Arg(100);
}
BENCHMARK(DecimatedSums<double>)->Name("decimated sums/krnumer")->Apply(Widths);
BENCHMARK(DecimatedSums<Complex>)->Name("decimated sums, complex/krnumer")->Apply(Widths);

template <class T>
void Modulator(benchmark::State& state) {
    std::vector<Complex> y(Count(kSamples));
    double phase = 0.0;
    Stream<T>(state, [&](const T* x) {
        Modulate(x, kSamples, 0.1234, &phase, y.data());
        benchmark::DoNotOptimize(y.data());
    });
}
BENCHMARK(Modulator<double>)->Name("modulator/krnumer");
BENCHMARK(Modulator<Complex>)->Name("modulator, complex/krnumer");

// ---- Cosine and sine transforms: samples per second -----------------------------------------------------------------

void Lengths(benchmark::internal::Benchmark* benchmark) {
    for (const int n : {1000, 1001, 1024, 100000}) benchmark->ArgName("n")->Arg(n);
}

void TransformLine(benchmark::State& state, LineTransform line) {
    const auto n = static_cast<int32_t>(state.range(0));
    const std::vector<double> x = Samples<double>(n);
    std::vector<double> y(Count(n));
    const HeldTable table(line.table_length(n));
    for (auto _ : state) {
        LinePlan plan(line, n, table.get());
        plan.Run(x.data(), n, y.data());
        benchmark::DoNotOptimize(y.data());
    }
    state.SetItemsProcessed(state.iterations() * n);
}
BENCHMARK_CAPTURE(TransformLine, cosine, kCosine)->Name("cosine transform/krnumer")->Apply(Lengths);
BENCHMARK_CAPTURE(TransformLine, inverse_cosine, kInverseCosine)
    ->Name("inverse cosine transform/krnumer")
    ->Apply(Lengths);
BENCHMARK_CAPTURE(TransformLine, sine, kSine)->Name("sine transform/krnumer")->Apply(Lengths);

#ifdef KRNUMER_HAVE_FFTW

void TransformFftw(benchmark::State& state, fftw_r2r_kind kind) {
    const auto n = static_cast<int32_t>(state.range(0));
    std::vector<double> x(Count(n)), y(Count(n));
    const fftw_plan plan = fftw_plan_r2r_1d(n, x.data(), y.data(), kind, FFTW_MEASURE);
    x = Samples<double>(n);
    for (auto _ : state) {
        fftw_execute_r2r(plan, x.data(), y.data());
        benchmark::DoNotOptimize(y.data());
    }
    state.SetItemsProcessed(state.iterations() * n);
    fftw_destroy_plan(plan);
}
BENCHMARK_CAPTURE(TransformFftw, cosine, FFTW_REDFT10)->Name("cosine transform/FFTW")->Apply(Lengths);
BENCHMARK_CAPTURE(TransformFftw, inverse_cosine, FFTW_REDFT01)->Name("inverse cosine transform/FFTW")->Apply(Lengths);
BENCHMARK_CAPTURE(TransformFftw, sine, FFTW_RODFT00)->Name("sine transform/FFTW")->Apply(Lengths);

#endif

}  // namespace
}  // namespace krnumer
