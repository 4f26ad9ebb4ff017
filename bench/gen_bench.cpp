// Waves, beside a sine for every sample; gen_peers.py measures NumPy and SciPy. No wave could cost less than the plain
// multiplication of the array, which memory limits.
#include <benchmark/benchmark.h>

#include <cmath>
#include <vector>

#include "frame/numeric.h"
#include "gen/pattern.h"
#include "gen/pulse_shape.h"
#include "gen/wave.h"

namespace krnumer {
namespace {

constexpr double kFrequency = 0.0123;

// `make(y, n)` fills n samples; the counter is samples per second.
template <class Make>
void Measure(benchmark::State& state, Make make) {
    const int32_t n = static_cast<int32_t>(state.range(0));
    std::vector<double> y(Count(n), 1.0);
    for (auto _ : state) {
        make(y.data(), n);
        benchmark::DoNotOptimize(y.data());
        benchmark::ClobberMemory();
    }
    state.SetItemsProcessed(state.iterations() * n);
}

template <class Make>
void Register(const char* name, Make make) {
    benchmark::RegisterBenchmark(name, [make](benchmark::State& state) { Measure(state, make); })
        ->ArgName("n")
        ->Arg(1000)
        ->Arg(1000000);
}

// The yardsticks.

void Multiply(benchmark::State& state) {
    const std::vector<double> factors(Count(static_cast<int32_t>(state.range(0))), 1.0);
    Measure(state, [&](double* y, int32_t n) {
        for (int32_t i = 0; i < n; ++i) y[i] *= factors[Count(i)];
    });
}
BENCHMARK(Multiply)->Name("multiplication/plain loop")->ArgName("n")->Arg(1000)->Arg(1000000);

void SinePerSample(double* y, int32_t n) {
    const double step = 2.0 * kPi * kFrequency;
    for (int32_t i = 0; i < n; ++i) y[i] = 2.0 * std::sin(i * step + 0.5);
}

// Waves carry this phase on from call to call.
double phase = 30.0;

const std::vector<double> kTable(512, 0.5);
const int32_t kTableSize = static_cast<int32_t>(kTable.size());

const bool kRegistered = [] {
    Register("sine/std::sin", SinePerSample);
    Register("sine/krnumer", [](double* y, int32_t n) { SineWave(y, n, 2.0, kFrequency, &phase); });
    Register("sawtooth/krnumer", [](double* y, int32_t n) { SawtoothWave(y, n, 2.0, kFrequency, &phase); });
    Register("triangle/krnumer", [](double* y, int32_t n) { TriangleWave(y, n, 2.0, kFrequency, &phase); });
    Register("square/krnumer", [](double* y, int32_t n) { SquareWave(y, n, 2.0, kFrequency, &phase, 30.0); });
    Register("table, sample before/krnumer",
             [](double* y, int32_t n) { ArbitraryWave(y, n, 2.0, kFrequency, &phase, kTable.data(), kTableSize, 0); });
    Register("table, interpolated/krnumer",
             [](double* y, int32_t n) { ArbitraryWave(y, n, 2.0, kFrequency, &phase, kTable.data(), kTableSize, 1); });
    Register("chirp/krnumer", [](double* y, int32_t n) { Chirp(y, n, 2.0, 0.0, 0.4); });

    Register("square pattern/krnumer", [](double* y, int32_t n) { SquarePattern(y, n, 2.0, 30.0, n / 50.0); });
    Register("pulse pattern/krnumer", [](double* y, int32_t n) { PulsePattern(y, n, 2.0, n / 3, n / 4); });
    Register("ramp pattern/krnumer", [](double* y, int32_t n) { RampPattern(y, n, 0.0, 1.0, 0); });
    Register("sinc pattern/krnumer", [](double* y, int32_t n) { SincPattern(y, n, 2.0, 3.0, 0.1); });

    Register("triangle pulse/krnumer",
             [](double* y, int32_t n) { AperiodicTriangle(nullptr, y, n, 2.0, 0.3, 1.0 / n, 0.4, 0.3); });
    Register("Gaussian monopulse/krnumer",
             [](double* y, int32_t n) { GaussianMonopulse(nullptr, y, n, 1.0 / n, 0.5, 3.0, 2.0); });
    Register("Gaussian pulse/krnumer",
             [](double* y, int32_t n) { GaussianPulse(nullptr, y, n, 2.0, 0.5, 1.0 / n, 10.0, 0.5, 6.0); });
    Register("periodic sinc/krnumer", [](double* y, int32_t n) { PeriodicSinc(nullptr, y, n, 2.0, 7, 0.01, 0.5); });
    return true;
}();

}  // namespace
}  // namespace krnumer
