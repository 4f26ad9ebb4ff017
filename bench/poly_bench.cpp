// Roots of random real polynomials beside GSL's eigenvalues of the balanced companion matrix; multiplicities, divisors
// and integrals. poly_peers.py measures NumPy and SciPy.
#include <benchmark/benchmark.h>

#include <random>
#include <vector>

#include "frame/numeric.h"
#include "poly/gcd.h"
#include "poly/integration.h"
#include "poly/madsen_roots.h"
#include "poly/multiple_roots.h"

#ifdef KRNUMER_HAVE_GSL
#include <gsl/gsl_poly.h>
#endif

namespace krnumer {
namespace {

// Of normal distribution, the highest one 1.
std::vector<double> Coefficients(int64_t degree, unsigned seed = 1) {
    std::mt19937 random(seed);
    std::normal_distribution<double> normal;
    std::vector<double> c(static_cast<size_t>(degree) + 1, 1.0);
    for (size_t k = 0; k + 1 < c.size(); ++k) c[k] = normal(random);
    return c;
}

std::vector<double> Product(const std::vector<double>& a, const std::vector<double>& b) {
    std::vector<double> c(a.size() + b.size() - 1);
    for (size_t i = 0; i < a.size(); ++i)
        for (size_t j = 0; j < b.size(); ++j) c[i + j] += a[i] * b[j];
    return c;
}

int32_t Size(const std::vector<double>& c) {
    return static_cast<int32_t>(c.size());
}

void ByDescent(benchmark::State& state) {
    std::vector<Complex> c;
    for (const double value : Coefficients(state.range(0))) c.push_back({value, 0.0});
    std::vector<Complex> roots(c.size());
    int32_t count;
    for (auto _ : state)
        benchmark::DoNotOptimize(MadsenRoots(c.data(), static_cast<int32_t>(c.size()), 20, roots.data(), &count));
}
BENCHMARK(ByDescent)->Name("all roots/krnumer")->ArgName("degree")->Arg(20)->Arg(50)->Arg(100);

#ifdef KRNUMER_HAVE_GSL
void ByGsl(benchmark::State& state) {
    const std::vector<double> c = Coefficients(state.range(0));
    std::vector<double> roots(2 * c.size());
    gsl_poly_complex_workspace* const work = gsl_poly_complex_workspace_alloc(c.size());
    for (auto _ : state) benchmark::DoNotOptimize(gsl_poly_complex_solve(c.data(), c.size(), work, roots.data()));
    gsl_poly_complex_workspace_free(work);
}
BENCHMARK(ByGsl)->Name("all roots/GSL")->ArgName("degree")->Arg(20)->Arg(50)->Arg(100);
#endif

// Where no root is multiple, every degree of a divisor is tried in vain.
void ByMultiplicity(benchmark::State& state) {
    std::vector<double> c = Coefficients(state.range(0) / state.range(1));
    const std::vector<double> once = c;
    for (int64_t m = 1; m < state.range(1); ++m) c = Product(c, once);
    for (auto _ : state) {
        RootList roots;
        RootList refined;
        benchmark::DoNotOptimize(MultipleRoots(c.data(), Size(c), true, 0.0, &roots, &refined));
    }
}
BENCHMARK(ByMultiplicity)
    ->Name("roots with multiplicities/krnumer")
    ->ArgNames({"degree", "multiplicity"})
    ->ArgsProduct({{20, 40}, {1, 4}})
    ->Unit(benchmark::kMicrosecond);

void Divisor(benchmark::State& state) {
    const std::vector<double> common = Coefficients(state.range(0) / 2);
    const std::vector<double> p = Product(common, Coefficients(state.range(0) / 2, 2));
    const std::vector<double> q = Product(common, Coefficients(state.range(0) / 2, 3));
    for (auto _ : state) {
        Polynomial<double> gcd;
        Polynomial<double> u;
        Polynomial<double> v;
        benchmark::DoNotOptimize(PolyGCDCore(p.data(), Size(p), q.data(), Size(q), 0.0, &gcd, &u, &v));
    }
}
BENCHMARK(Divisor)->Name("common divisor/krnumer")->ArgName("degree")->Arg(20)->Arg(40)->Unit(benchmark::kMicrosecond);

void Integral(benchmark::State& state) {
    const std::vector<double> y = Coefficients(1000000);
    double integral;
    for (auto _ : state) {
        benchmark::DoNotOptimize(
            IntegrateCore(y.data(), Size(y), 0.5, IntegrationRule{static_cast<uint32_t>(state.range(0))}, &integral));
    }
}
BENCHMARK(Integral)->Name("integral/krnumer")->ArgName("rule")->DenseRange(0, 3)->Unit(benchmark::kMicrosecond);

}  // namespace
}  // namespace krnumer
