// Special functions: time of a call beside Boost.Math and GSL on the same arguments.
//
// The library is called through its exports. Boost works in double, as the others do, instead of its default of
// promoting to long double.
#include <benchmark/benchmark.h>

#include <cmath>
#include <cstdint>
#include <limits>
#include <random>
#include <string>
#include <utility>
#include <vector>

#include "krnumer/special.h"

#if defined(KRNUMER_HAVE_BOOST)
#include <boost/math/special_functions.hpp>
#include <boost/math/special_functions/hypergeometric_1F1.hpp>
#endif
#if defined(KRNUMER_HAVE_GSL)
#include <gsl/gsl_errno.h>
#include <gsl/gsl_sf.h>
#endif

namespace {

constexpr size_t kArguments = 1024;
constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();

struct Arguments {
    double a, b, c, d;
};

struct Range {
    double low, high;
    bool whole = false;
};

std::vector<Arguments> Draw(const std::vector<Range>& ranges) {
    std::mt19937_64 random(1);
    const auto draw = [&](size_t i) {
        if (i >= ranges.size()) return 0.0;
        const double value = std::uniform_real_distribution<double>(ranges[i].low, ranges[i].high)(random);
        return ranges[i].whole ? std::floor(value) : value;
    };
    std::vector<Arguments> arguments(kArguments);
    for (Arguments& x : arguments) x = {draw(0), draw(1), draw(2), draw(3)};
    return arguments;
}

// One call an iteration. The calls do not depend on one another.
template <class Function>
void Measure(const std::string& name, const std::vector<Range>& ranges, Function function) {
    benchmark::RegisterBenchmark(name.c_str(), [=, arguments = Draw(ranges)](benchmark::State& state) {
        size_t i = 0;
        for (auto _ : state) {
            benchmark::DoNotOptimize(function(arguments[i]));
            i = (i + 1) % kArguments;
        }
    });
}

// The result of an export.
template <class... Parameters, class... Values>
double Call(void (*function)(Parameters...), Values... values) {
    double out;
    function(values..., &out);
    return out;
}

int32_t Integer(double x) {
    return static_cast<int32_t>(x);
}

#if defined(KRNUMER_HAVE_BOOST)
namespace bm = boost::math;
using Policy = bm::policies::policy<bm::policies::promote_double<false>, bm::policies::promote_float<false>,
                                    bm::policies::domain_error<bm::policies::ignore_error>,
                                    bm::policies::overflow_error<bm::policies::ignore_error>>;
constexpr Policy kPolicy;
#define BOOST(name, call) Measure(std::string(name) + "/Boost.Math", ranges, [](const Arguments& x) { return call; })
#else
#define BOOST(name, call)
#endif
#if defined(KRNUMER_HAVE_GSL)
#define GSL(name, call) Measure(std::string(name) + "/GSL", ranges, [](const Arguments& x) { return call; })
#else
#define GSL(name, call)
#endif
#define OURS(name, call) Measure(std::string(name) + "/krnumer", ranges, [](const Arguments& x) { return call; })

void GammaFamily() {
    {
        const std::vector<Range> ranges{{-10.0, 30.0}};
        OURS("Gamma", Call(KR_Gamma, x.a, kNaN));
        BOOST("Gamma", bm::tgamma(x.a, kPolicy));
        GSL("Gamma", gsl_sf_gamma(x.a));
    }
    {
        const std::vector<Range> ranges{{0.1, 200.0}};
        OURS("LnGamma", Call(KR_LnGamma, x.a));
        BOOST("LnGamma", bm::lgamma(x.a, kPolicy));
        GSL("LnGamma", gsl_sf_lngamma(x.a));
    }
    {
        const std::vector<Range> ranges{{0.1, 30.0}};
        OURS("Psi", Call(KR_Psi, x.a));
        BOOST("Psi", bm::digamma(x.a, kPolicy));
        GSL("Psi", gsl_sf_psi(x.a));
    }
    {
        const std::vector<Range> ranges{{0.1, 30.0}, {0.1, 30.0}};
        OURS("Beta", Call(KR_Beta, x.a, x.b, kNaN));
        BOOST("Beta", bm::beta(x.a, x.b, kPolicy));
        GSL("Beta", gsl_sf_beta(x.a, x.b));
    }
    {
        const std::vector<Range> ranges{{0.5, 30.0}, {0.0, 40.0}};
        OURS("LowerGamma", Call(KR_Gamma, x.a, x.b));
        BOOST("LowerGamma", bm::gamma_p(x.a, x.b, kPolicy));
        GSL("LowerGamma", gsl_sf_gamma_inc_P(x.a, x.b));
        OURS("UpperGamma", Call(KR_GammaC, x.a, x.b));
        BOOST("UpperGamma", bm::gamma_q(x.a, x.b, kPolicy));
        GSL("UpperGamma", gsl_sf_gamma_inc_Q(x.a, x.b));
    }
    {
        const std::vector<Range> ranges{{0.5, 30.0}, {0.5, 30.0}, {0.0, 1.0}};
        OURS("IncompleteBeta", Call(KR_Beta, x.a, x.b, x.c));
        BOOST("IncompleteBeta", bm::ibeta(x.a, x.b, x.c, kPolicy));
        GSL("IncompleteBeta", gsl_sf_beta_inc(x.a, x.b, x.c));
    }
    {
        const std::vector<Range> ranges{{0.0, 170.0, true}};
        OURS("Factorial", Call(KR_Fact, Integer(x.a)));
        BOOST("Factorial", bm::factorial<double>(static_cast<unsigned>(x.a), kPolicy));
        GSL("Factorial", gsl_sf_fact(static_cast<unsigned>(x.a)));
        OURS("LnFactorial", Call(KR_LnFact, Integer(x.a)));
        BOOST("LnFactorial", bm::lgamma(x.a + 1.0, kPolicy));
        GSL("LnFactorial", gsl_sf_lnfact(static_cast<unsigned>(x.a)));
    }
    {
        const std::vector<Range> ranges{{33.0, 170.0}};
        OURS("Stirling", Call(KR_Stirling, x.a));
        BOOST("Stirling", bm::tgamma(x.a, kPolicy));
        GSL("Stirling", gsl_sf_gamma(x.a));
    }
}

void BesselFamily() {
    {
        const std::vector<Range> ranges{{0.0, 60.0}};
        OURS("J0", Call(KR_BesselJr, 0.0, x.a));
        BOOST("J0", bm::cyl_bessel_j(0, x.a, kPolicy));
        GSL("J0", gsl_sf_bessel_J0(x.a));
        OURS("Y1", Call(KR_BesselYr, 1.0, x.a));
        BOOST("Y1", bm::cyl_neumann(1, x.a, kPolicy));
        GSL("Y1", gsl_sf_bessel_Y1(x.a));
        OURS("K0", Call(KR_BesselKn, 0, x.a));
        BOOST("K0", bm::cyl_bessel_k(0, x.a, kPolicy));
        GSL("K0", gsl_sf_bessel_K0(x.a));
        OURS("I0", Call(KR_BesselIr, 0.0, x.a));
        BOOST("I0", bm::cyl_bessel_i(0, x.a, kPolicy));
        GSL("I0", gsl_sf_bessel_I0(x.a));
    }
    {
        const std::vector<Range> ranges{{2.0, 31.0, true}, {0.1, 60.0}};
        OURS("Jn", Call(KR_BesselJr, x.a, x.b));
        BOOST("Jn", bm::cyl_bessel_j(Integer(x.a), x.b, kPolicy));
        GSL("Jn", gsl_sf_bessel_Jn(Integer(x.a), x.b));
        OURS("Yn", Call(KR_BesselYr, x.a, x.b));
        BOOST("Yn", bm::cyl_neumann(Integer(x.a), x.b, kPolicy));
        GSL("Yn", gsl_sf_bessel_Yn(Integer(x.a), x.b));
        OURS("In", Call(KR_BesselIr, x.a, x.b));
        BOOST("In", bm::cyl_bessel_i(Integer(x.a), x.b, kPolicy));
        GSL("In", gsl_sf_bessel_In(Integer(x.a), x.b));
        OURS("Kn", Call(KR_BesselKn, Integer(x.a), x.b));
        BOOST("Kn", bm::cyl_bessel_k(Integer(x.a), x.b, kPolicy));
        GSL("Kn", gsl_sf_bessel_Kn(Integer(x.a), x.b));
        OURS("SphericalJ", Call(KR_BesselJs, Integer(x.a), x.b));
        BOOST("SphericalJ", bm::sph_bessel(static_cast<unsigned>(x.a), x.b, kPolicy));
        GSL("SphericalJ", gsl_sf_bessel_jl(Integer(x.a), x.b));
        OURS("SphericalY", Call(KR_BesselYs, Integer(x.a), x.b));
        BOOST("SphericalY", bm::sph_neumann(static_cast<unsigned>(x.a), x.b, kPolicy));
        GSL("SphericalY", gsl_sf_bessel_yl(Integer(x.a), x.b));
    }
    {
        const std::vector<Range> ranges{{0.1, 30.0}, {0.1, 60.0}};
        OURS("Jv", Call(KR_BesselJr, x.a, x.b));
        BOOST("Jv", bm::cyl_bessel_j(x.a, x.b, kPolicy));
        GSL("Jv", gsl_sf_bessel_Jnu(x.a, x.b));
        OURS("Yv", Call(KR_BesselYr, x.a, x.b));
        BOOST("Yv", bm::cyl_neumann(x.a, x.b, kPolicy));
        GSL("Yv", gsl_sf_bessel_Ynu(x.a, x.b));
        OURS("Iv", Call(KR_BesselIr, x.a, x.b));
        BOOST("Iv", bm::cyl_bessel_i(x.a, x.b, kPolicy));
        GSL("Iv", gsl_sf_bessel_Inu(x.a, x.b));
    }
    {
        const std::vector<Range> ranges{{-10.0, 10.0}};
        const auto sum = [](const double* v) { return v[0] + v[1] + v[2] + v[3]; };
        Measure("Airy/krnumer", ranges, [=](const Arguments& x) {
            double v[4];
            KR_Airy(x.a, v, v + 1, v + 2, v + 3);
            return sum(v);
        });
        BOOST("Airy", bm::airy_ai(x.a, kPolicy) + bm::airy_bi(x.a, kPolicy) + bm::airy_ai_prime(x.a, kPolicy) +
                          bm::airy_bi_prime(x.a, kPolicy));
        GSL("Airy", gsl_sf_airy_Ai(x.a, GSL_PREC_DOUBLE) + gsl_sf_airy_Bi(x.a, GSL_PREC_DOUBLE) +
                        gsl_sf_airy_Ai_deriv(x.a, GSL_PREC_DOUBLE) + gsl_sf_airy_Bi_deriv(x.a, GSL_PREC_DOUBLE));
    }
}

void Integrals() {
    {
        const std::vector<Range> ranges{{-4.0, 4.0}};
        OURS("Erf", Call(KR_Erf, x.a));
        BOOST("Erf", bm::erf(x.a, kPolicy));
        GSL("Erf", gsl_sf_erf(x.a));
        OURS("ErfC", Call(KR_ErfC, x.a));
        BOOST("ErfC", bm::erfc(x.a, kPolicy));
        GSL("ErfC", gsl_sf_erfc(x.a));
    }
    {
        const std::vector<Range> ranges{{0.1, 20.0}, {1.0, 10.0, true}};
        OURS("Dawson", Call(KR_Dawson, x.a));
        GSL("Dawson", gsl_sf_dawson(x.a));
        OURS("ExpI", Call(KR_ExpI, x.a, Integer(x.b)));
        BOOST("ExpI", bm::expint(static_cast<unsigned>(x.b), x.a, kPolicy));
        GSL("ExpI", gsl_sf_expint_En(Integer(x.b), x.a));
        OURS("SinI", Call(KR_SinI, x.a));
        GSL("SinI", gsl_sf_Si(x.a));
        OURS("CosI", Call(KR_CosI, x.a));
        GSL("CosI", gsl_sf_Ci(x.a));
        OURS("SinhI", Call(KR_SinhI, x.a));
        GSL("SinhI", gsl_sf_Shi(x.a));
        OURS("CoshI", Call(KR_CoshI, x.a));
        GSL("CoshI", gsl_sf_Chi(x.a));
    }
}

void Others() {
    {
        const std::vector<Range> ranges{{0.0, 0.99}, {-1.5, 1.5}};
        OURS("EllipticK", Call(KR_Elliptic1, x.a, kNaN));
        BOOST("EllipticK", bm::ellint_1(std::sqrt(x.a), kPolicy));
        GSL("EllipticK", gsl_sf_ellint_Kcomp(std::sqrt(x.a), GSL_PREC_DOUBLE));
        OURS("EllipticE", Call(KR_Elliptic2, x.a, kNaN));
        BOOST("EllipticE", bm::ellint_2(std::sqrt(x.a), kPolicy));
        GSL("EllipticE", gsl_sf_ellint_Ecomp(std::sqrt(x.a), GSL_PREC_DOUBLE));
        OURS("EllipticF", Call(KR_Elliptic1, x.a, x.b));
        BOOST("EllipticF", bm::ellint_1(std::sqrt(x.a), x.b, kPolicy));
        GSL("EllipticF", gsl_sf_ellint_F(x.b, std::sqrt(x.a), GSL_PREC_DOUBLE));
        OURS("EllipticEPhi", Call(KR_Elliptic2, x.a, x.b));
        BOOST("EllipticEPhi", bm::ellint_2(std::sqrt(x.a), x.b, kPolicy));
        GSL("EllipticEPhi", gsl_sf_ellint_E(x.b, std::sqrt(x.a), GSL_PREC_DOUBLE));
        Measure("EllipticJ/krnumer", ranges, [](const Arguments& x) {
            double v[4];
            KR_EllipticJ(x.b, x.a, v, v + 1, v + 2, v + 3);
            return v[0] + v[1] + v[2];
        });
#if defined(KRNUMER_HAVE_BOOST)
        Measure("EllipticJ/Boost.Math", ranges, [](const Arguments& x) {
            double cn, dn;
            const double sn = bm::jacobi_elliptic(std::sqrt(x.a), x.b, &cn, &dn, kPolicy);
            return sn + cn + dn;
        });
#endif
#if defined(KRNUMER_HAVE_GSL)
        Measure("EllipticJ/GSL", ranges, [](const Arguments& x) {
            double sn, cn, dn;
            gsl_sf_elljac_e(x.b, x.a, &sn, &cn, &dn);
            return sn + cn + dn;
        });
#endif
    }
    {
        const std::vector<Range> ranges{{0.1, 4.0}, {0.1, 4.0}, {0.5, 9.0}, {-0.95, 0.95}};
        OURS("Gauss", Call(KR_Gauss, x.d, x.a, x.b, x.c));
        GSL("Gauss", gsl_sf_hyperg_2F1(x.a, x.b, x.c, x.d));
    }
    {
        const std::vector<Range> ranges{{0.1, 4.0}, {0.5, 6.0}, {-10.0, 30.0}};
        OURS("Kummer", Call(KR_Kummer, x.c, x.a, x.b));
        BOOST("Kummer", bm::hypergeometric_1F1(x.a, x.b, x.c, kPolicy));
        GSL("Kummer", gsl_sf_hyperg_1F1(x.a, x.b, x.c));
    }
    {
        const std::vector<Range> ranges{{0.1, 2.0}, {0.1, 2.0}, {0.1, 40.0}};
        OURS("Tricomi", Call(KR_Tricomi, x.c, x.a, x.b));
        GSL("Tricomi", gsl_sf_hyperg_U(x.a, x.b, x.c));
    }
    {
        const std::vector<Range> ranges{{0.0, 10.0}};
        OURS("Dilogarithm", Call(KR_Diln, x.a));
        GSL("Dilogarithm", gsl_sf_dilog(1.0 - x.a));
    }
    {
        const std::vector<Range> ranges{{-20.0, 60.0}};
        OURS("Zeta", Call(KR_Zeta, x.a));
        BOOST("Zeta", bm::zeta(x.a, kPolicy));
        GSL("Zeta", gsl_sf_zeta(x.a));
    }
}

[[maybe_unused]] const bool registered = [] {
#if defined(KRNUMER_HAVE_GSL)
    gsl_set_error_handler_off();
#endif
    GammaFamily();
    BesselFamily();
    Integrals();
    Others();
    return true;
}();

}  // namespace
