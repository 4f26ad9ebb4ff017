// Convolution beside plain loops and beside FFTW, planned once and run at the next length it is fast at, with the table
// of the transform held by someone else, as that plan is, and with none; changes of the sampling rate beside
// liquid-dsp, which computes in single precision, and beside a copy of the samples. sigop_peers.py measures NumPy and
// SciPy.
#include <benchmark/benchmark.h>

#include <algorithm>
#include <cmath>
#include <cstring>
#include <vector>

#include "fft/fft.h"
#include "frame/numeric.h"
#include "sigop/convolution.h"
#include "sigop/convolution2d.h"
#include "sigop/decimate.h"
#include "sigop/polyphase.h"
#include "sigop/resample.h"

#ifdef KRNUMER_HAVE_FFTW
#include <fftw3.h>
#endif
#ifdef KRNUMER_HAVE_LIQUID
#include <liquid/liquid.h>
#endif

namespace krnumer {
namespace {

// Samples without zeros and subnormal numbers, which are slow.
template <class T>
std::vector<T> Samples(size_t n) {
    std::vector<T> x(n);
    for (size_t i = 0; i < n; ++i) {
        const double phase = 0.7 * static_cast<double>(i);
        if constexpr (std::is_same_v<T, double>) {
            x[i] = 1.5 + std::sin(phase);
        } else {
            x[i] = {1.5 + std::sin(phase), std::cos(phase)};
        }
    }
    return x;
}

template <class T>
struct Sequences {
    explicit Sequences(const benchmark::State& state)
        : nx(static_cast<int32_t>(state.range(0))),
          ny(static_cast<int32_t>(state.range(1))),
          x(Samples<T>(Count(nx))),
          y(Samples<T>(Count(ny))),
          z(Count(FullLength(nx, ny))) {}

    int32_t nx, ny;
    std::vector<T> x, y, z;
};

// Products of a direct convolution per second.
void SetProducts(benchmark::State& state) {
    state.SetItemsProcessed(state.iterations() * state.range(0) * state.range(1));
}

void DirectReal(benchmark::State& state) {
    Sequences<double> s(state);
    for (auto _ : state) {
        ConvolveReal(s.x.data(), s.nx, s.y.data(), s.ny, kDirect, s.z.data());
        benchmark::DoNotOptimize(s.z.data());
    }
    SetProducts(state);
}

void DirectComplex(benchmark::State& state) {
    Sequences<Complex> s(state);
    for (auto _ : state) {
        ConvolveComplex(s.x.data(), s.nx, s.y.data(), s.ny, kDirect, s.z.data());
        benchmark::DoNotOptimize(s.z.data());
    }
    SetProducts(state);
}

template <class T>
void NaiveLoop(benchmark::State& state) {
    Sequences<T> s(state);
    for (auto _ : state) {
        T* const z = s.z.data();
        std::fill(s.z.begin(), s.z.end(), T{});
        for (int32_t i = 0; i < s.nx; ++i)
            for (int32_t j = 0; j < s.ny; ++j) z[i + j] += s.x[Count(i)] * s.y[Count(j)];
        benchmark::DoNotOptimize(z);
    }
    SetProducts(state);
}

void DirectLengths(benchmark::internal::Benchmark* benchmark) {
    for (const auto& [nx, ny] : {std::pair{1000, 1000}, {100000, 32}, {100000, 1000}})
        benchmark->ArgNames({"nx", "ny"})->Args({nx, ny});
}
BENCHMARK(DirectReal)->Name("direct convolution/krnumer")->Apply(DirectLengths);
BENCHMARK(NaiveLoop<double>)->Name("direct convolution/plain loop")->Apply(DirectLengths);
BENCHMARK(DirectComplex)->Name("direct convolution, complex/krnumer")->Apply(DirectLengths);
BENCHMARK(NaiveLoop<Complex>)->Name("direct convolution, complex/plain loop")->Apply(DirectLengths);

void SpectralReal(benchmark::State& state, bool table_held) {
    Sequences<double> s(state);
    const HeldTable table(table_held ? NextGoodLength(FullLength(s.nx, s.ny)) : 1);
    for (auto _ : state) {
        ConvolveReal(s.x.data(), s.nx, s.y.data(), s.ny, kFrequencyDomain, s.z.data());
        benchmark::DoNotOptimize(s.z.data());
    }
    state.SetItemsProcessed(state.iterations() * FullLength(s.nx, s.ny));
}

void SpectralLengths(benchmark::internal::Benchmark* benchmark) {
    for (const auto& [nx, ny] : {std::pair{1000, 1000}, {100000, 1000}, {1000000, 1000000}})
        benchmark->ArgNames({"nx", "ny"})->Args({nx, ny});
}
BENCHMARK_CAPTURE(SpectralReal, table_held, true)->Name("convolution by FFT/krnumer")->Apply(SpectralLengths);
BENCHMARK_CAPTURE(SpectralReal, table_built, false)
    ->Name("convolution by FFT, no table/krnumer")
    ->Apply(SpectralLengths);

#ifdef KRNUMER_HAVE_FFTW

int FastLength(int n) {
    for (;; ++n) {
        int rest = n;
        for (const int prime : {2, 3, 5, 7})
            while (rest % prime == 0) rest /= prime;
        if (rest == 1) return n;
    }
}

void SpectralFftw(benchmark::State& state) {
    Sequences<double> s(state);
    const int n = FastLength(FullLength(s.nx, s.ny));
    const size_t bins = static_cast<size_t>(n) / 2 + 1;
    double* a = fftw_alloc_real(static_cast<size_t>(n));
    fftw_complex* fa = fftw_alloc_complex(bins);
    fftw_complex* fb = fftw_alloc_complex(bins);
    fftw_plan forward = fftw_plan_dft_r2c_1d(n, a, fa, FFTW_ESTIMATE);
    fftw_plan inverse = fftw_plan_dft_c2r_1d(n, fa, a, FFTW_ESTIMATE);
    const auto transform = [&](const std::vector<double>& x, fftw_complex* spectrum) {
        std::fill(std::copy(x.begin(), x.end(), a), a + n, 0.0);
        fftw_execute_dft_r2c(forward, a, spectrum);
    };
    for (auto _ : state) {
        transform(s.x, fa);
        transform(s.y, fb);
        for (size_t k = 0; k < bins; ++k) {
            const double re = (fa[k][0] * fb[k][0] - fa[k][1] * fb[k][1]) / n;
            fa[k][1] = (fa[k][0] * fb[k][1] + fa[k][1] * fb[k][0]) / n;
            fa[k][0] = re;
        }
        fftw_execute_dft_c2r(inverse, fa, a);
        std::copy_n(a, s.z.size(), s.z.begin());
        benchmark::DoNotOptimize(s.z.data());
    }
    state.SetItemsProcessed(state.iterations() * static_cast<int64_t>(s.z.size()));
    fftw_destroy_plan(forward);
    fftw_destroy_plan(inverse);
    fftw_free(a);
    fftw_free(fa);
    fftw_free(fb);
}
BENCHMARK(SpectralFftw)->Name("convolution by FFT/FFTW")->Apply(SpectralLengths);

#endif

// An image and a kernel.
void Planes(benchmark::State& state, int32_t algorithm) {
    const std::vector<double> x = Samples<double>(512 * 512), y = Samples<double>(31 * 31);
    std::vector<double> z(542 * 542);
    for (auto _ : state) {
        Convolve2DReal(x.data(), 512, 512, y.data(), 31, 31, z.data(), kFullOutput, algorithm);
        benchmark::DoNotOptimize(z.data());
    }
}
BENCHMARK_CAPTURE(Planes, direct, kDirect)->Name("plane convolution, direct/krnumer");
BENCHMARK_CAPTURE(Planes, frequency_domain, kFrequencyDomain)->Name("plane convolution by FFT/krnumer");

// ---- Decimation: bytes of the input per second, beside a copy -----------------------------------------------------

template <class Run>
void Stream(benchmark::State& state, Run run) {
    const std::vector<double> x = Samples<double>(1000000);
    std::vector<double> y = x;
    for (auto _ : state) {
        run(x, y);
        benchmark::DoNotOptimize(y.data());
        benchmark::ClobberMemory();
    }
    state.SetBytesProcessed(state.iterations() * static_cast<int64_t>(x.size() * sizeof(double)));
}

void Copy(benchmark::State& state) {
    Stream(state, [](const std::vector<double>& x, std::vector<double>& y) {
        std::memcpy(y.data(), x.data(), x.size() * sizeof(double));
    });
}
BENCHMARK(Copy)->Name("copy/memcpy");

// In place: the block shrinks to its own beginning, and what is behind it stays, so that every run reads samples.
void DecimateBlock(benchmark::State& state, bool averaging) {
    const auto factor = static_cast<int32_t>(state.range(0));
    int32_t count = 0;
    Stream(state, [&](const std::vector<double>& x, std::vector<double>& y) {
        Decimate(y.data(), static_cast<int32_t>(x.size()), factor, averaging, &count);
    });
}
BENCHMARK_CAPTURE(DecimateBlock, every, false)->Name("decimation/krnumer")->ArgName("factor")->Arg(4)->Arg(100);
BENCHMARK_CAPTURE(DecimateBlock, means, true)->Name("decimation by means/krnumer")->ArgName("factor")->Arg(4)->Arg(100);

// ---- Resampling by 160/147 in blocks of 14700, filters of 10 samples to both sides; outputs per second -------------

constexpr int32_t kUp = 160;
constexpr int32_t kDown = 147;
constexpr int32_t kBlock = 14700;
constexpr int32_t kReach = 10;

// A windowed sinc of 2 reach points per sample and side.
std::vector<double> WindowedSinc(int32_t points_per_sample) {
    const int32_t half = kReach * points_per_sample;
    std::vector<double> taps;
    for (int32_t i = -half; i <= half; ++i) {
        const double t = kPi * i / points_per_sample;
        taps.push_back((i == 0 ? 1.0 : std::sin(t) / t) * (0.5 + 0.5 * std::cos(kPi * i / (half + 1))) /
                       points_per_sample);
    }
    return taps;
}

template <class T>
void Rational(benchmark::State& state) {
    const std::vector<double> filter = WindowedSinc(kUp);
    const RationalRate rate{kUp, kDown, filter.data(), static_cast<int32_t>(filter.size())};
    const std::vector<T> x = Samples<T>(kBlock);
    std::vector<T> history(Count(RationalHistory(rate)));
    std::vector<T> y(20000);
    RationalStream stream{0, 0};
    int64_t outputs = 0;
    for (auto _ : state) {
        const auto count = static_cast<int32_t>(RationalOutputCount(rate, stream, kBlock));
        PolyphaseResample(x.data(), 1, kBlock, rate, &stream, history.data(), static_cast<int32_t>(history.size()),
                          y.data(), count);
        benchmark::DoNotOptimize(y.data());
        outputs += count;
    }
    state.SetItemsProcessed(outputs);
}
BENCHMARK(Rational<double>)->Name("rational resampling/krnumer");
BENCHMARK(Rational<Complex>)->Name("rational resampling, complex/krnumer");

template <class T, bool nearest>
void Constant(benchmark::State& state) {
    const std::vector<double> table = WindowedSinc(64);
    const ResampleKernel kernel{table.data(), static_cast<int32_t>(table.size()), 64, nearest};
    const std::vector<T> x = Samples<T>(kBlock);
    std::vector<T> history(50);
    std::vector<double> taps(50);
    std::vector<T> y(20000);
    ResampleStream<T> stream{};
    stream.history = history.data();
    stream.taps = taps.data();
    stream.history_capacity = stream.taps_capacity = 50;
    stream.ratio = static_cast<double>(kDown) / kUp;
    int64_t outputs = 0;
    for (auto _ : state) {
        int32_t count = 0;
        ResampleRun(x.data(), kBlock, kernel, &stream, y.data(), 20000, &count, true);
        benchmark::DoNotOptimize(y.data());
        outputs += count;
    }
    state.SetItemsProcessed(outputs);
}
BENCHMARK(Constant<double, false>)->Name("constant resampling/krnumer");
BENCHMARK(Constant<double, true>)->Name("constant resampling, nearest/krnumer");
BENCHMARK(Constant<Complex, false>)->Name("constant resampling, complex/krnumer");

#ifdef KRNUMER_HAVE_LIQUID

void RationalLiquid(benchmark::State& state) {
    const std::vector<double> filter = WindowedSinc(kUp);
    std::vector<float> taps(filter.begin(), filter.end());
    const rresamp_rrrf resampler = rresamp_rrrf_create(kUp, kDown, kReach, taps.data());
    std::vector<float> x(kBlock, 1.0f);
    std::vector<float> y(20000);
    for (auto _ : state) {
        rresamp_rrrf_execute_block(resampler, x.data(), kBlock / kDown, y.data());
        benchmark::DoNotOptimize(y.data());
    }
    state.SetItemsProcessed(state.iterations() * (kBlock / kDown) * kUp);
    rresamp_rrrf_destroy(resampler);
}
BENCHMARK(RationalLiquid)->Name("rational resampling/liquid-dsp (float)");

void ConstantLiquid(benchmark::State& state) {
    const resamp_rrrf resampler =
        resamp_rrrf_create(static_cast<float>(kUp) / static_cast<float>(kDown), kReach, 0.45f, 60.0f, 64);
    std::vector<float> x(kBlock, 1.0f);
    std::vector<float> y(20000);
    int64_t outputs = 0;
    for (auto _ : state) {
        unsigned int count = 0;
        resamp_rrrf_execute_block(resampler, x.data(), kBlock, y.data(), &count);
        benchmark::DoNotOptimize(y.data());
        outputs += count;
    }
    state.SetItemsProcessed(outputs);
    resamp_rrrf_destroy(resampler);
}
BENCHMARK(ConstantLiquid)->Name("constant resampling/liquid-dsp (float)");

#endif

}  // namespace
}  // namespace krnumer
