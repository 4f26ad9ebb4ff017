// Windows of real samples, and some of complex ones. No window could cost less than the multiplication of the samples by
// weights computed before. window_peers.py measures SciPy.
#include <benchmark/benchmark.h>

#include <cmath>
#include <cstdint>
#include <initializer_list>
#include <string>
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

// On infinite samples, which no weight ever wears down to denormals, however often it is applied.
template <class T, class Window>
void Measure(benchmark::State& state, Window window) {
    const int32_t n = static_cast<int32_t>(state.range(0));
    T sample;
    if constexpr (std::is_same_v<T, Complex>)
        sample = {kInfinity, kInfinity};
    else
        sample = kInfinity;
    std::vector<T> samples(Count(n), sample);
    for (auto _ : state) {
        window(samples.data(), n);
        benchmark::ClobberMemory();
    }
    state.SetItemsProcessed(state.iterations() * n);
}

template <class T = double, class Window>
void Register(const std::string& name, Window window, std::initializer_list<int32_t> lengths = {1000, 1000000}) {
    auto* const benchmark =
        benchmark::RegisterBenchmark(name.c_str(), [=](benchmark::State& state) { Measure<T>(state, window); });
    for (const int32_t n : lengths) benchmark->ArgName("n")->Arg(n);
}

// What a window costs that calls a cosine for each sample.
void CosinePerSample(double* x, int32_t n) {
    for (int32_t i = 0; i < n; ++i) x[i] *= 0.5 - 0.5 * std::cos(2.0 * kPi * i / n);
}

void Multiply(double* x, int32_t n) {
    static const std::vector<double> weights(1000000, 0.999);
    MultiplyByWeights(x, weights.data(), n);
}

const bool kRegistered = [] {
    struct Named {
        const char* name;
        int32_t type;
    };
    const Named cosine_sums[] = {{"Hann", kWindowHann},
                                 {"Blackman", kWindowBlackman},
                                 {"Blackman-Harris 4", kWindowBlackmanHarris4},
                                 {"flat top", kWindowFlatTop},
                                 {"Blackman-Harris 7", kWindowBlackmanHarris7}};
    Register("multiplication/plain loop", Multiply);
    Register("Hann/std::cos", CosinePerSample);
    for (const auto& [name, type] : cosine_sums) {
        const auto window = [type = type](auto* x, int32_t n) { NamedCosineWindow(x, n, type, false); };
        Register(std::string(name) + "/krnumer", window);
        Register<Complex>(std::string(name) + ", complex/krnumer", window);
    }
    Register("Bartlett-Hann/krnumer", [](double* x, int32_t n) { BartlettHanningWindow(x, n); });
    Register("Bohman/krnumer", [](double* x, int32_t n) { BohmanWindow(x, n); });
    Register("Parzen/krnumer", [](double* x, int32_t n) { ParzenWindow(x, n); });
    Register("Welch/krnumer", [](double* x, int32_t n) { WelchWindow(x, n); });
    Register("triangle/krnumer", [](double* x, int32_t n) { TriangleWindow(x, n); });
    Register("cosine taper/krnumer", [](double* x, int32_t n) { CosineTaper(x, n, 0.2); });
    Register("exponential/krnumer", [](double* x, int32_t n) { ExponentialWindow(x, n, 0.1); });
    Register("force/krnumer", [](double* x, int32_t n) { ForceWindow(x, n, 50.0); });
    Register("Kaiser/krnumer", [](double* x, int32_t n) { KaiserWindow(x, n, 6.0); });
    Register("Gaussian/krnumer", [](double* x, int32_t n) { GaussianWindow(x, n, 0.2, false); });
    Register("Dolph-Chebyshev/krnumer", [](double* x, int32_t n) { DolphChebyshevWindow(x, n, 1e4, false); },
             {100, 1000});
    return true;
}();

}  // namespace
}  // namespace krnumer
