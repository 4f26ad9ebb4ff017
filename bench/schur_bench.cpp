// Schur forms of matrices and pencils beside the drivers of LAPACK, functions of matrices and Sylvester's equation beside
// SciPy (schur_peers.py).

#include <benchmark/benchmark.h>

#include <random>
#include <vector>

#include "linalg/matrix_function.h"
#include "linalg/qz.h"
#include "linalg/schur.h"
#include "linalg/sylvester.h"

extern "C" {
void dgees_(const char* jobvs, const char* sort, const void* select, const int* n, double* a, const int* lda, int* sdim,
            double* wr, double* wi, double* vs, const int* ldvs, double* work, const int* lwork, int* bwork, int* info,
            std::size_t, std::size_t);
void dgges_(const char* jobvsl, const char* jobvsr, const char* sort, const void* select, const int* n, double* a,
            const int* lda, double* b, const int* ldb, int* sdim, double* alphar, double* alphai, double* beta,
            double* vsl, const int* ldvsl, double* vsr, const int* ldvsr, double* work, const int* lwork, int* bwork,
            int* info, std::size_t, std::size_t, std::size_t);
}

namespace {

using krnumer::Complex;

std::vector<double> RandomMatrix(int n, unsigned seed = 1) {
    std::mt19937_64 bits(seed);
    std::normal_distribution<double> normal;
    std::vector<double> a(static_cast<std::size_t>(n) * static_cast<std::size_t>(n));
    for (double& x : a) x = normal(bits);
    return a;
}

void Sizes(benchmark::internal::Benchmark* b) {
    for (const int n : {10, 50, 200}) b->ArgName("n")->Arg(n);
    b->Unit(benchmark::kMicrosecond);
}

void Check(benchmark::State& state, int status) {
    if (status < 0) state.SkipWithError("failed");
}

// ---- Schur form with vectors ----------------------------------------------------------------------------------------

void SchurKrnumer(benchmark::State& state) {
    const int n = static_cast<int>(state.range(0));
    const auto a = RandomMatrix(n);
    auto t = a, z = a;
    std::vector<Complex> w(a.size());
    for (auto _ : state) Check(state, krnumer::SchurCore(a.data(), n, krnumer::kNoOrder, z.data(), t.data(), w.data()));
}
BENCHMARK(SchurKrnumer)->Name("Schur form/krnumer")->Apply(Sizes);

void SchurInOrderKrnumer(benchmark::State& state) {
    const int n = static_cast<int>(state.range(0));
    const auto a = RandomMatrix(n);
    auto t = a, z = a;
    std::vector<Complex> w(a.size());
    for (auto _ : state)
        Check(state, krnumer::SchurCore(a.data(), n, krnumer::kModulusAscending, z.data(), t.data(), w.data()));
}
BENCHMARK(SchurInOrderKrnumer)->Name("Schur form in order/krnumer")->Apply(Sizes);

void SchurLapack(benchmark::State& state) {
    const int n = static_cast<int>(state.range(0));
    const auto a = RandomMatrix(n);
    auto t = a, z = a, re = a, im = a;
    int info = 0, sdim = 0, query = -1;
    double size = 0.0;
    const auto call = [&](double* work, const int* length) {
        dgees_("V", "N", nullptr, &n, t.data(), &n, &sdim, re.data(), im.data(), z.data(), &n, work, length, nullptr,
               &info, 1, 1);
    };
    call(&size, &query);
    const int length = static_cast<int>(size);
    std::vector<double> work(static_cast<std::size_t>(length));
    for (auto _ : state) {
        t = a;
        call(work.data(), &length);
    }
}
BENCHMARK(SchurLapack)->Name("Schur form/LAPACK")->Apply(Sizes);

// ---- Generalised Schur form with both factors -----------------------------------------------------------------------

void QZKrnumer(benchmark::State& state) {
    const int n = static_cast<int>(state.range(0));
    const auto a = RandomMatrix(n), b = RandomMatrix(n, 2);
    auto s = a, p = a, q = a, z = a, beta = a;
    std::vector<Complex> alpha(a.size());
    const krnumer::QZOutputs<double> out{s.data(), p.data(), q.data(), z.data()};
    for (auto _ : state)
        Check(state,
              krnumer::QZCore(a.data(), b.data(), n, true, 1, krnumer::kNoOrder, out, alpha.data(), beta.data()));
}
BENCHMARK(QZKrnumer)->Name("generalised Schur form/krnumer")->Apply(Sizes);

void QZLapack(benchmark::State& state) {
    const int n = static_cast<int>(state.range(0));
    const auto a = RandomMatrix(n), b = RandomMatrix(n, 2);
    auto s = a, p = a, q = a, z = a, re = a, im = a, beta = a;
    int info = 0, sdim = 0, query = -1;
    double size = 0.0;
    const auto call = [&](double* work, const int* length) {
        dgges_("V", "V", "N", nullptr, &n, s.data(), &n, p.data(), &n, &sdim, re.data(), im.data(), beta.data(),
               q.data(), &n, z.data(), &n, work, length, nullptr, &info, 1, 1, 1);
    };
    call(&size, &query);
    const int length = static_cast<int>(size);
    std::vector<double> work(static_cast<std::size_t>(length));
    for (auto _ : state) {
        s = a;
        p = b;
        call(work.data(), &length);
    }
}
BENCHMARK(QZLapack)->Name("generalised Schur form/LAPACK")->Apply(Sizes);

// ---- Functions and equations ----------------------------------------------------------------------------------------

void Exponential(benchmark::State& state) {
    const int n = static_cast<int>(state.range(0));
    const auto a = RandomMatrix(n);
    auto e = a;
    for (auto _ : state) {
        e = a;
        Check(state, krnumer::ExpCore(e.data(), n));
    }
}
BENCHMARK(Exponential)->Name("exponential/krnumer")->Apply(Sizes);

std::vector<Complex> ToComplex(const std::vector<double>& a) {
    std::vector<Complex> z;
    for (const double x : a) z.push_back({x, 0.0});
    return z;
}

void SquareRoot(benchmark::State& state) {
    const int n = static_cast<int>(state.range(0));
    const auto a = ToComplex(RandomMatrix(n));
    auto root = a;
    for (auto _ : state) {
        root = a;
        Check(state, krnumer::CxSqrtCore(root.data(), n));
    }
}
BENCHMARK(SquareRoot)->Name("square root/krnumer")->Apply(Sizes);

void Logarithm(benchmark::State& state) {
    const int n = static_cast<int>(state.range(0));
    const auto a = ToComplex(RandomMatrix(n));
    auto logarithm = a;
    for (auto _ : state) {
        logarithm = a;
        Check(state, krnumer::CxLnCore(logarithm.data(), n));
    }
}
BENCHMARK(Logarithm)->Name("logarithm/krnumer")->Apply(Sizes);

void SylvesterEquation(benchmark::State& state) {
    const int n = static_cast<int>(state.range(0));
    const auto a = RandomMatrix(n), b = RandomMatrix(n, 2), c = RandomMatrix(n, 3);
    auto x = c;
    double scale;
    int32_t singular;
    for (auto _ : state) {
        x = c;
        Check(state, krnumer::SylvesterCore(a.data(), b.data(), x.data(), n, n, {0, 0, 1, 0}, &scale, &singular));
    }
}
BENCHMARK(SylvesterEquation)->Name("Sylvester equation/krnumer")->Apply(Sizes);

}  // namespace
