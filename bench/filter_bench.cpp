// Filters at work: samples per second over long signals. filter_peers.py measures SciPy.
#include <benchmark/benchmark.h>

#include <algorithm>
#include <cmath>
#include <random>
#include <vector>

#include "filter/cascade.h"
#include "filter/direct_form.h"
#include "filter/iir_design.h"
#include "filter/median_filter.h"
#include "filter/savitzky_golay.h"
#include "frame/numeric.h"

#if defined(KRNUMER_HAVE_LIQUID)
#include <liquid/liquid.h>
#include <complex>  // before liquid, whose complex type follows it
#endif

namespace krnumer {
namespace {

constexpr int32_t kSamples = 1000000;

const std::vector<double>& Noise() {
    static const std::vector<double> noise = [] {
        std::mt19937_64 random(1);
        std::normal_distribution<double> normal;
        std::vector<double> samples(Count(kSamples));
        for (double& sample : samples) sample = normal(random);
        return samples;
    }();
    return noise;
}

template <class T>
T FromReal(double value) {
    if constexpr (std::is_same_v<T, double>) return value;
    if constexpr (!std::is_same_v<T, double>) return {value, 0.0};
}

void CountSamples(benchmark::State& state, int32_t samples) {
    state.SetItemsProcessed(state.iterations() * samples);
}

struct Coefficients {
    std::vector<double> a, b;
};

// Butterworth lowpass (sections of order 2) or bandpass (of order 4).
Coefficients Design(int32_t sections, int32_t section_order) {
    const FilterBand band{1.0, 0.1, 0.3, 2 * sections, section_order == 2 ? 0 : 2};
    const CascadeLengths lengths = LengthsOf(band.order, band.type);
    Coefficients made{std::vector<double>(static_cast<size_t>(lengths.a)),
                      std::vector<double>(static_cast<size_t>(lengths.b))};
    ButterworthDesign(band,
                      {made.a.data(), static_cast<int32_t>(lengths.a), made.b.data(), static_cast<int32_t>(lengths.b)});
    return made;
}

void Sections(benchmark::internal::Benchmark* b) {
    b->ArgNames({"order", "sections"})->Args({2, 1})->Args({2, 4})->Args({2, 8})->Args({4, 4});
}

template <class Signal>
void FilterByCascade(benchmark::State& state) {
    const int32_t section_order = static_cast<int32_t>(state.range(0)), sections = static_cast<int32_t>(state.range(1));
    const Coefficients made = Design(sections, section_order);
    std::vector<Signal> x(Count(kSamples)), memory(made.a.size());
    const auto size = [](const auto& array) { return static_cast<int32_t>(array.size()); };
    Cascade<Signal> cascade{sections * 2,  true,         made.a.data(), size(made.a),
                            made.b.data(), size(made.b), memory.data(), size(memory)};
    // Filtered in place, so what came out of one round goes into the next; noise first, and noise it stays.
    std::copy_n(reinterpret_cast<const Signal*>(Noise().data()), kSamples / static_cast<int32_t>(sizeof(Signal) / 8),
                x.data());
    for (auto _ : state) {
        CascadeFilter(x.data(), kSamples, &cascade);
        benchmark::ClobberMemory();
        state.PauseTiming();
        std::copy_n(reinterpret_cast<const Signal*>(Noise().data()),
                    kSamples / static_cast<int32_t>(sizeof(Signal) / 8), x.data());
        state.ResumeTiming();
    }
    CountSamples(state, kSamples);
}
BENCHMARK(FilterByCascade<double>)->Name("cascade/krnumer")->Apply(Sections);
BENCHMARK(FilterByCascade<Complex>)->Name("cascade, complex signal/krnumer")->Apply(Sections);

#if defined(KRNUMER_HAVE_LIQUID)
// Of single precision, the only one that liquid has. A section of order 4 is two of order 2 there.
void LiquidCascade(benchmark::State& state) {
    const unsigned sections = static_cast<unsigned>(state.range(1) * state.range(0) / 2);
    const Coefficients made = Design(static_cast<int32_t>(sections), 2);
    std::vector<float> a, b;
    for (unsigned k = 0; k < sections; ++k) {
        a.insert(a.end(), {1.0F, static_cast<float>(made.a[2 * k]), static_cast<float>(made.a[2 * k + 1])});
        for (unsigned i = 0; i < 3; ++i) b.push_back(static_cast<float>(made.b[3 * k + i]));
    }
    iirfilt_rrrf filter = iirfilt_rrrf_create_sos(b.data(), a.data(), sections);
    std::vector<float> x(Noise().begin(), Noise().end()), y(x.size());
    for (auto _ : state) {
        iirfilt_rrrf_execute_block(filter, x.data(), static_cast<unsigned>(kSamples), y.data());
        benchmark::DoNotOptimize(y.data());
        benchmark::ClobberMemory();
    }
    iirfilt_rrrf_destroy(filter);
    CountSamples(state, kSamples);
}
BENCHMARK(LiquidCascade)->Name("cascade/liquid-dsp (float)")->Apply(Sections);
#endif

// The difference equation with `taps` coefficients on the input side, and as many on the output side or none.
template <class Signal, class Coefficient>
void FilterDirectly(benchmark::State& state) {
    const int32_t taps = static_cast<int32_t>(state.range(0));
    const bool recursive = state.range(1) != 0;
    std::vector<Coefficient> a(Count(taps)), b(Count(taps));
    for (size_t k = 0; k < a.size(); ++k) {
        const double decay = std::pow(0.7, static_cast<double>(k));
        a[k] = FromReal<Coefficient>(decay);
        b[k] = FromReal<Coefficient>(1.0 / taps);
    }
    std::vector<Signal> x(Count(kSamples)), y(Count(kSamples)), forward(Count(taps)), reverse(Count(taps));
    for (size_t i = 0; i < x.size(); ++i) x[i] = FromReal<Signal>(Noise()[i]);
    for (auto _ : state) {
        DirectFormFilter(x.data(), kSamples, recursive ? a.data() : nullptr, recursive ? taps : 0, b.data(), taps,
                         forward.data(), reverse.data(), y.data());
        benchmark::DoNotOptimize(y.data());
        benchmark::ClobberMemory();
    }
    CountSamples(state, kSamples);
}
void Taps(benchmark::internal::Benchmark* b) {
    b->ArgNames({"taps", "recursive"})->Args({64, 1})->Args({64, 0})->Args({3, 1});
}
BENCHMARK(FilterDirectly<double, double>)->Name("direct form/krnumer")->Apply(Taps);
BENCHMARK(FilterDirectly<Complex, double>)->Name("direct form, complex signal/krnumer")->Apply(Taps);
BENCHMARK(FilterDirectly<Complex, Complex>)->Name("complex direct form/krnumer")->Apply(Taps);

void FilterByMedian(benchmark::State& state) {
    const int32_t rank = static_cast<int32_t>(state.range(0)) / 2;
    constexpr int32_t kFewer = 100000;
    std::vector<double> x(Count(kFewer));
    for (auto _ : state) {
        std::copy_n(Noise().begin(), kFewer, x.begin());
        MedianFilter(x.data(), kFewer, rank, rank);
        benchmark::DoNotOptimize(x.data());
        benchmark::ClobberMemory();
    }
    CountSamples(state, kFewer);
}
BENCHMARK(FilterByMedian)->Name("running median/krnumer")->ArgName("width")->Arg(5)->Arg(51)->Arg(501);

void SmoothByPolynomials(benchmark::State& state) {
    const int32_t frame = static_cast<int32_t>(state.range(0));
    std::vector<double> y(Count(kSamples));
    for (auto _ : state) {
        SavitzkyGolayFilter(Noise().data(), kSamples, 3, frame, nullptr, y.data());
        benchmark::DoNotOptimize(y.data());
        benchmark::ClobberMemory();
    }
    CountSamples(state, kSamples);
}
BENCHMARK(SmoothByPolynomials)->Name("Savitzky-Golay/krnumer")->ArgName("width")->Arg(11)->Arg(101);

}  // namespace
}  // namespace krnumer
