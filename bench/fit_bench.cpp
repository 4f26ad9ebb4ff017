// Lines, polynomials and robust lines: points per second. fit_peers.py measures NumPy.
#include <benchmark/benchmark.h>

#include <random>
#include <vector>

#include "fit/least_squares.h"
#include "fit/line.h"
#include "fit/polynomial.h"
#include "fit/robust.h"
#include "frame/numeric.h"

#if defined(KRNUMER_HAVE_GSL)
#include <gsl/gsl_fit.h>
#include <gsl/gsl_multifit.h>
#endif

namespace krnumer {
namespace {

// A parabola with noise on [-1, 1]. The last of 10 points are outliers where `spoilt` says so.
struct Points {
    explicit Points(int64_t n, bool spoilt = false) : x(static_cast<size_t>(n)), y(x.size()), fit(x.size()) {
        std::mt19937_64 random(1);
        std::normal_distribution<double> normal;
        for (size_t i = 0; i < x.size(); ++i) {
            x[i] = 2.0 * static_cast<double>(i) / static_cast<double>(x.size() - 1) - 1.0;
            const double noise = spoilt && i % 10 == 9 ? 50.0 + 10.0 * normal(random) : 0.1 * normal(random);
            y[i] = 3.0 + 2.0 * x[i] - (spoilt ? 0.0 : x[i] * x[i]) + noise;
        }
    }
    int32_t size() const { return static_cast<int32_t>(x.size()); }
    FitData data() const { return {x.data(), y.data(), nullptr, size()}; }

    std::vector<double> x, y, fit;
};

template <class Fit>
void Run(benchmark::State& state, Fit fit) {
    int32_t status = 0;
    for (auto _ : state) benchmark::DoNotOptimize(status |= fit());
    if (status != 0) state.SkipWithError("the fit failed");
    state.SetItemsProcessed(state.iterations() * state.range(0));
}

// ---- Lines ----

void LinePoints(benchmark::internal::Benchmark* b) {
    b->ArgName("n")->Arg(10000)->Arg(1000000);
}

void Line(benchmark::State& state) {
    Points points(state.range(0));
    double slope, intercept, mse;
    Run(state, [&] {
        return LinFitCore(points.x.data(), points.y.data(), points.size(), nullptr, points.fit.data(), &slope,
                          &intercept, &mse);
    });
}
BENCHMARK(Line)->Name("line/krnumer")->Apply(LinePoints);

// ---- Polynomials, by each method ----

void PolynomialOrders(benchmark::internal::Benchmark* b) {
    b->ArgNames({"n", "order"})->ArgsProduct({{10000}, {2, 5, 10}});
}

void Polynomial(benchmark::State& state, int32_t method) {
    Points points(state.range(0));
    const auto order = static_cast<int32_t>(state.range(1));
    std::vector<double> coef(Count(order + 1));
    double mse;
    Run(state, [&] {
        return PolyFitCore(points.x.data(), points.y.data(), nullptr, points.size(), order, method, nullptr, nullptr, 0,
                           points.fit.data(), coef.data(), &mse);
    });
}
BENCHMARK_CAPTURE(Polynomial, svd, kSvdMethod)->Name("polynomial by SVD/krnumer")->Apply(PolynomialOrders);
BENCHMARK_CAPTURE(Polynomial, qr, kHouseholderMethod)->Name("polynomial by QR/krnumer")->Apply(PolynomialOrders);
BENCHMARK_CAPTURE(Polynomial, lu, kLUMethod)->Name("polynomial by LU/krnumer")->Apply(PolynomialOrders);
BENCHMARK_CAPTURE(Polynomial, cholesky, kCholeskyMethod)
    ->Name("polynomial by Cholesky/krnumer")
    ->Apply(PolynomialOrders);

// ---- Robust lines ----

void BisquareLine(benchmark::State& state) {
    Points points(state.range(0), true);
    double coef[2], residue;
    Run(state, [&] {
        int32_t steps = 100;
        return BisquareFit(LineFitter{}, points.data(), nullptr, 1e-4, coef, &steps, points.fit.data(), &residue);
    });
}
BENCHMARK(BisquareLine)->Name("bisquare line/krnumer")->ArgName("n")->Arg(100000);

void AbsoluteLine(benchmark::State& state) {
    Points points(state.range(0), true);
    double coef[2], residue;
    Run(state, [&] {
        int32_t steps = 100;
        return LeastAbsoluteLine(points.data(), 1e-4, -1.0, coef, &steps, points.fit.data(), &residue);
    });
}
BENCHMARK(AbsoluteLine)->Name("least absolute line/krnumer")->ArgName("n")->Arg(100000);

// ---- GSL ----

#if defined(KRNUMER_HAVE_GSL)

gsl_vector_const_view View(const std::vector<double>& values) {
    return gsl_vector_const_view_array(values.data(), values.size());
}

void GslLine(benchmark::State& state) {
    const Points points(state.range(0));
    double c0, c1, cov00, cov01, cov11, sum;
    Run(state, [&] {
        return gsl_fit_linear(points.x.data(), 1, points.y.data(), 1, points.x.size(), &c0, &c1, &cov00, &cov01, &cov11,
                              &sum);
    });
}
BENCHMARK(GslLine)->Name("line/GSL")->Apply(LinePoints);

// The matrix of powers is part of the fit, as it is in ours.
void Powers(const std::vector<double>& x, gsl_matrix* powers) {
    for (size_t i = 0; i < powers->size1; ++i) {
        double power = 1.0;
        for (size_t j = 0; j < powers->size2; ++j, power *= x[i]) gsl_matrix_set(powers, i, j, power);
    }
}

void GslPolynomial(benchmark::State& state) {
    const Points points(state.range(0));
    const auto m = points.x.size(), k = static_cast<size_t>(state.range(1)) + 1;
    const auto y = View(points.y);
    gsl_matrix *const powers = gsl_matrix_alloc(m, k), *const covariance = gsl_matrix_alloc(k, k);
    gsl_vector* const coef = gsl_vector_alloc(k);
    gsl_multifit_linear_workspace* const work = gsl_multifit_linear_alloc(m, k);
    double sum;
    Run(state, [&] {
        Powers(points.x, powers);
        return gsl_multifit_linear(powers, &y.vector, coef, covariance, &sum, work);
    });
    gsl_multifit_linear_free(work);
    gsl_vector_free(coef);
    gsl_matrix_free(covariance);
    gsl_matrix_free(powers);
}
// GSL fits by SVD, which stands beside each of our methods.
BENCHMARK(GslPolynomial)->Name("polynomial by SVD/GSL")->Apply(PolynomialOrders);
BENCHMARK(GslPolynomial)->Name("polynomial by QR/GSL")->Apply(PolynomialOrders);
BENCHMARK(GslPolynomial)->Name("polynomial by LU/GSL")->Apply(PolynomialOrders);
BENCHMARK(GslPolynomial)->Name("polynomial by Cholesky/GSL")->Apply(PolynomialOrders);

void GslBisquareLine(benchmark::State& state) {
    const Points points(state.range(0), true);
    const auto y = View(points.y);
    gsl_matrix *const powers = gsl_matrix_alloc(points.x.size(), 2), *const covariance = gsl_matrix_alloc(2, 2);
    gsl_vector* const coef = gsl_vector_alloc(2);
    gsl_multifit_robust_workspace* const work =
        gsl_multifit_robust_alloc(gsl_multifit_robust_bisquare, points.x.size(), 2);
    Run(state, [&] {
        Powers(points.x, powers);
        return gsl_multifit_robust(powers, &y.vector, coef, covariance, work);
    });
    gsl_multifit_robust_free(work);
    gsl_vector_free(coef);
    gsl_matrix_free(covariance);
    gsl_matrix_free(powers);
}
BENCHMARK(GslBisquareLine)->Name("bisquare line/GSL")->ArgName("n")->Arg(100000);

#endif

}  // namespace
}  // namespace krnumer
