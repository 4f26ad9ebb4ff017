// Convolution beside plain loops and beside FFTW, planned once and run at the next length it is fast at.
#include <benchmark/benchmark.h>

#include <algorithm>
#include <cmath>
#include <vector>

#include "frame/numeric.h"
#include "sigop/convolution.h"
#include "sigop/convolution2d.h"

#ifdef KRNUMER_HAVE_FFTW
#include <fftw3.h>
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
    for (const auto& [nx, ny] : {std::pair{1000, 1000}, {100000, 32}, {100000, 1000}}) benchmark->Args({nx, ny});
}
BENCHMARK(DirectReal)->Apply(DirectLengths);
BENCHMARK(NaiveLoop<double>)->Apply(DirectLengths);
BENCHMARK(DirectComplex)->Apply(DirectLengths);
BENCHMARK(NaiveLoop<Complex>)->Apply(DirectLengths);

void SpectralReal(benchmark::State& state) {
    Sequences<double> s(state);
    for (auto _ : state) {
        ConvolveReal(s.x.data(), s.nx, s.y.data(), s.ny, kFrequencyDomain, s.z.data());
        benchmark::DoNotOptimize(s.z.data());
    }
    state.SetItemsProcessed(state.iterations() * FullLength(s.nx, s.ny));
}

void SpectralLengths(benchmark::internal::Benchmark* benchmark) {
    for (const auto& [nx, ny] : {std::pair{1000, 1000}, {100000, 1000}, {1000000, 1000000}}) benchmark->Args({nx, ny});
    benchmark->Unit(benchmark::kMicrosecond);
}
BENCHMARK(SpectralReal)->Apply(SpectralLengths);

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
BENCHMARK(SpectralFftw)->Apply(SpectralLengths);

#endif

// An image and a kernel; SciPy's times come from sigop_scipy.py.
void Planes(benchmark::State& state, int32_t algorithm) {
    const std::vector<double> x = Samples<double>(512 * 512), y = Samples<double>(31 * 31);
    std::vector<double> z(542 * 542);
    for (auto _ : state) {
        Convolve2DReal(x.data(), 512, 512, y.data(), 31, 31, z.data(), kFullOutput, algorithm);
        benchmark::DoNotOptimize(z.data());
    }
}
BENCHMARK_CAPTURE(Planes, direct, kDirect)->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(Planes, frequency_domain, kFrequencyDomain)->Unit(benchmark::kMillisecond);

}  // namespace
}  // namespace krnumer
