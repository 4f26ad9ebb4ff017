// Exponential, power, logarithmic and Gaussian curves, through their exports.

#include "krnumer/nonlinear_fit.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "fit/curves.h"
#include "fit/nist.h"
#include "frame/numeric.h"
#include "frame/status.h"
#include "support/host_arrays.h"
#include "support/numbers.h"

namespace krnumer {
namespace {

using Values = std::vector<double>;

constexpr double kNaN = kQuietNaN;
constexpr int32_t kMost = std::numeric_limits<int32_t>::max();

enum class Curve { kExponential, kPower, kGaussian };

// What a fit is called with and what it leaves.
struct Fit {
    Values y, x, w{}, init{};
    double tol = 0.0;
    double msetol = 0.0;
    int32_t iter = 1000;
    int32_t method = 1;
    double coef[3] = {-9, -9, -9};
    double mse = -9;

    int32_t Run(Curve curve) {
        HostArray<double> ordinates(y);
        const HostArray<double> abscissas(x), weights(w), start(init);
        const auto call = [&](auto* fit, auto... outputs) {
            return fit(ordinates.handle(), abscissas.handle(), weights.handle(), tol, start.handle(), outputs...);
        };
        int32_t status = 0;
        switch (curve) {
            case Curve::kExponential:
                status = call(ExpFit80_head, method, &coef[0], &coef[1], &mse, &iter, msetol);
                break;
            case Curve::kPower:
                status = call(PowerFit_head, &coef[0], &coef[1], &mse, &iter, msetol);
                break;
            case Curve::kGaussian:
                status = call(GaussianPeakFit_head, &coef[0], &coef[1], &coef[2], &mse, &iter, msetol);
                break;
        }
        y = ordinates.values();
        return status;
    }

    // The entry point without the fitted values.
    int32_t RunCoefficients(Curve curve) {
        HostArray<double> ordinates(y);
        const HostArray<double> abscissas(x), weights(w), start(init);
        const KrHandle data[3] = {ordinates.handle(), abscissas.handle(), weights.handle()};
        int32_t status = 0;
        switch (curve) {
            case Curve::kExponential:
                status = ExpFitCoef80_head(data[0], data[1], data[2], method, tol, start.handle(), &coef[0], &coef[1],
                                           &iter, msetol);
                break;
            case Curve::kPower:
                status = PowerFitCoef_head(data[0], data[1], data[2], tol, start.handle(), &coef[0], &coef[1], &iter,
                                           msetol);
                break;
            case Curve::kGaussian:
                status = GaussianPeakFitCoef_head(data[0], data[1], data[2], tol, start.handle(), &coef[0], &coef[1],
                                                  &coef[2], &iter, msetol);
                break;
        }
        y = ordinates.values();
        return status;
    }

    int32_t RunLog(double base) {
        HostArray<double> ordinates(y);
        const int32_t status = LogFit_head(ordinates.handle(), HostArray<double>(x).handle(),
                                           HostArray<double>(w).handle(), base, &coef[0], &coef[1], &mse);
        y = ordinates.values();
        return status;
    }

    void ExpectFailed(int count = 2) const {
        EXPECT_TRUE(y.empty());
        for (int j = 0; j < count; ++j) EXPECT_TRUE(IsQuietNaN(coef[j]));
        EXPECT_TRUE(IsQuietNaN(mse));
    }
};

Fit OfReference(const std::string& name, bool weighted) {
    return {Reference(name + ".y"), Reference("x"), weighted ? Reference("w") : Values{}};
}

Values Sampled(const Values& x, auto model) {
    Values y;
    for (const double each : x) y.push_back(model(each));
    return y;
}

class CurveFits : public testing::Test {
    LeakCheck leaks_;
};

TEST_F(CurveFits, IteratedFitsAreThoseOfLeastSquares) {
    struct Case {
        const char* name;
        Curve curve;
        int coefficients;
        double tolerance;
    };
    for (const Case& c : {Case{"exponential", Curve::kExponential, 2, 1e-7}, Case{"power", Curve::kPower, 2, 1e-7},
                          Case{"gaussian", Curve::kGaussian, 3, 1e-5}}) {
        for (const bool weighted : {false, true}) {
            SCOPED_TRACE(c.name);
            const std::string row = std::string(c.name) + (weighted ? ".weighted" : "");
            Fit fit = OfReference(c.name, weighted);
            fit.tol = 1e-12;
            fit.iter = 20000;
            const Values data = fit.y;
            ASSERT_EQ(fit.Run(c.curve), 0);
            for (int j = 0; j < c.coefficients; ++j)
                EXPECT_THAT(fit.coef[j], Near(Reference(row + ".coef")[static_cast<size_t>(j)], c.tolerance));
            EXPECT_THAT(fit.mse, Near(Reference(row + ".mse")[0], 1e-8));
            EXPECT_GT(fit.iter, 0);

            Fit coefficients = OfReference(c.name, weighted);
            coefficients.tol = 1e-12;
            coefficients.iter = 20000;
            ASSERT_EQ(coefficients.RunCoefficients(c.curve), 0);
            for (int j = 0; j < c.coefficients; ++j) EXPECT_EQ(coefficients.coef[j], fit.coef[j]);
            EXPECT_EQ(coefficients.iter, fit.iter);
            EXPECT_EQ(coefficients.y, data) << "the ordinates stay";

            for (double& each : fit.w) each = -each;
            fit.y = data;
            fit.iter = 20000;
            ASSERT_EQ(fit.Run(c.curve), 0);
            EXPECT_EQ(fit.coef[0], coefficients.coef[0]) << "weights count by magnitude";
        }
    }
}

TEST_F(CurveFits, MakeTheStepsOfTheirRules) {
    const std::pair<Curve, std::string> curves[] = {
        {Curve::kExponential, "exponential"}, {Curve::kPower, "power"}, {Curve::kGaussian, "gaussian"}};
    for (const auto& [curve, name] : curves) {
        for (const bool weighted : {false, true}) {
            for (const Loop& loop : Loops("plain." + name + (weighted ? ".weighted" : ""))) {
                SCOPED_TRACE(testing::Message() << name << ", tolerance " << loop.tol << ", budget " << loop.budget);
                Fit fit = OfReference(name, weighted);
                fit.tol = loop.tol;
                fit.iter = loop.budget;
                ASSERT_EQ(fit.Run(curve), 0);
                EXPECT_EQ(fit.iter, loop.steps);
                for (size_t j = 0; j < loop.coef.size(); ++j) EXPECT_THAT(fit.coef[j], Near(loop.coef[j], 1e-8));
                EXPECT_THAT(fit.mse, Near(loop.error, 1e-8));
            }
        }
    }
}

TEST_F(CurveFits, LogarithmsToAnyBaseAreOneCurve) {
    for (const bool weighted : {false, true}) {
        const std::string row = weighted ? "log.weighted" : "log";
        for (const double base : {10.0, 2.71828, 2.0, 0.3}) {
            Fit fit = OfReference("log", weighted);
            ASSERT_EQ(fit.RunLog(base), 0);
            const double unit = base == 2.71828 ? 1.0 : std::log(base);
            EXPECT_THAT(fit.coef[0], Near(Reference(row + ".coef")[0] * unit / std::log(10.0), 1e-7));
            EXPECT_THAT(fit.coef[1], Near(Reference(row + ".coef")[1], 1e-7));
            EXPECT_THAT(fit.mse, Near(Reference(row + ".mse")[0], 1e-9));

            const Fit data = OfReference("log", weighted);
            const HostArray<double> y(data.y), x(data.x), w(data.w);
            double a, b;
            ASSERT_EQ(LogFitCoef_head(y.handle(), x.handle(), w.handle(), base, &a, &b), 0);
            EXPECT_EQ(a, fit.coef[0]);
            EXPECT_EQ(b, fit.coef[1]);
            EXPECT_EQ(y.values(), data.y);
        }
    }
}

TEST_F(CurveFits, TheNaturalBaseIsFiveDecimals) {
    Fit natural = OfReference("log", false);
    ASSERT_EQ(natural.RunLog(2.71828), 0);
    Fit general = OfReference("log", false);
    ASSERT_EQ(general.RunLog(2.718281828459045), 0);
    EXPECT_THAT(general.coef[0], Near(natural.coef[0], 1e-14));
    Fit beside = OfReference("log", false);
    ASSERT_EQ(beside.RunLog(2.718280000001), 0);
    EXPECT_THAT(beside.coef[0] / natural.coef[0], Near(std::log(2.71828), 1e-11)) << "a base like any other";
}

TEST_F(CurveFits, NegativeAbscissasHaveLogarithmsToo) {
    Fit fit{Sampled({1, 2, 3, 4}, [](double x) { return 2.0 * std::log10(3.0 * x); }), {-1, -2, -3, -4}};
    ASSERT_EQ(fit.RunLog(10.0), 0);
    EXPECT_THAT(fit.coef[0], Near(2.0, 1e-13));
    EXPECT_THAT(fit.coef[1], Near(-3.0, 1e-13));
}

TEST_F(CurveFits, AFlatLogarithmHasNoOffset) {
    for (const double sign : {1.0, -1.0}) {
        Fit fit{{0, 0, 0}, {sign * 1, sign * 2, sign * 4}};
        ASSERT_EQ(fit.RunLog(10.0), 0);
        EXPECT_EQ(fit.coef[0], 0.0);
        EXPECT_EQ(fit.coef[1], sign);
    }
    Fit mean{{2, 5, 2}, {1, 10, 100}};
    ASSERT_EQ(mean.RunLog(10.0), 0);
    ASSERT_EQ(mean.coef[0], 0.0);
    EXPECT_EQ(mean.coef[1], 1.0);
    for (const double each : mean.y) EXPECT_EQ(each, 0.0) << "not the mean";
    EXPECT_THAT(mean.mse, Near(11.0, 1e-15));
}

TEST_F(CurveFits, LogarithmsAreRefusedInOrder) {
    Fit sizes{{1, 2, 3}, {1, 2}};
    EXPECT_EQ(sizes.RunLog(-1.0), kSizesDiffer);
    sizes.ExpectFailed();
    Fit weights{{1, 2, 3}, {1, 2, 3}, {1, 1}};
    EXPECT_EQ(weights.RunLog(-1.0), kSizesDiffer);
    for (const double base : {0.0, -2.0, kNaN}) {
        Fit fit{{1}, {1}};
        EXPECT_EQ(fit.RunLog(base), kNotPositive);
        fit.ExpectFailed();
    }
    Fit one{{1}, {0}};
    EXPECT_EQ(one.RunLog(10.0), kFewerThanTwo);
    for (const double x : {0.0, -1.0, kNaN}) {
        Fit fit{{1, 2, 3}, {1, x, 2}};
        EXPECT_EQ(fit.RunLog(10.0), kMixedSigns);
        fit.ExpectFailed();
    }
    HostArray<double> y{1, 2};
    double a = 1, b = 1;
    EXPECT_EQ(
        LogFitCoef_head(y.handle(), HostArray<double>{1, -2}.handle(), HostArray<double>().handle(), 10.0, &a, &b),
        kMixedSigns);
    EXPECT_TRUE(IsQuietNaN(a) && IsQuietNaN(b));
    EXPECT_EQ(y.size(), 2);
}

TEST_F(CurveFits, ThePowerCurveHasItsCertifiedDigits) {
    const Certified set = LoadCertified("DanWood");
    struct Case {
        Values init;
        double tol;
        double digits;
        int32_t least_steps, most_steps;
    };
    for (const Case& c : {Case{{}, 0.0, 7.6, 2, 2}, Case{{}, 1e-14, 9.0, 4, 6}, Case{{1, 5}, 1e-14, 7.9, 5, 10},
                          Case{{0.7, 4}, 1e-14, 7.9, 5, 10}}) {
        Fit fit{set.y, set.x[0], {}, c.init, c.tol, 1e-300};
        ASSERT_EQ(fit.Run(Curve::kPower), 0);
        EXPECT_GT(CorrectDigits({fit.coef[0], fit.coef[1]}, set.coef), c.digits);
        EXPECT_GE(fit.iter, c.least_steps);
        EXPECT_LE(fit.iter, c.most_steps);
    }
}

TEST_F(CurveFits, TheGaussianDescendsAsFarAsItsToleranceSays) {
    const Certified set = LoadCertified("Eckerle4");
    const Values certified{set.coef[0], set.coef[2], std::fabs(set.coef[1])};  // area, centre, width
    struct Case {
        Values init;
        double tol;
        double digits;
        int32_t steps;
    };
    for (const Case& c : {Case{{}, 0.0, 2.2, 205}, Case{{}, 1e-12, 6.0, 2076}, Case{{0.3, 450, 5}, 1e-12, 6.0, 2811}}) {
        Fit fit{set.y, set.x[0], {}, c.init, c.tol, 0.0, 100000};
        ASSERT_EQ(fit.Run(Curve::kGaussian), 0);
        EXPECT_GT(CorrectDigits({fit.coef[0] * fit.coef[2], fit.coef[1], fit.coef[2]}, certified), c.digits);
        EXPECT_NEAR(fit.iter, c.steps, c.steps / 50);
    }
    Fit astray{set.y, set.x[0], {}, {0.1, 500, 10}, 0.0, 0.0, 100000};
    ASSERT_EQ(astray.Run(Curve::kGaussian), 0);
    EXPECT_EQ(astray.iter, 4);
    EXPECT_NEAR(astray.mse * static_cast<double>(set.y.size()) / set.rss, 478, 5);
}

TEST_F(CurveFits, GaussiansOnASampleAreFoundAtOnce) {
    const Values x{0, 1, 2, 3, 4, 5, 6};
    Fit fit{Sampled(x, [](double t) { return -2.0 * std::exp(-0.5 * (t - 3) * (t - 3) / 2.25); }), x};
    ASSERT_EQ(fit.Run(Curve::kGaussian), 0);
    EXPECT_EQ(fit.iter, 0);
    EXPECT_THAT(fit.coef[0], Near(-2.0, 1e-14));
    EXPECT_THAT(fit.coef[1], Near(3.0, 1e-14));
    EXPECT_THAT(fit.coef[2], Near(1.5, 1e-14));
}

TEST_F(CurveFits, TallGaussiansStayAtTheirStart) {
    const Values x{0, 1, 2, 3, 4, 5, 6};
    Fit fit{{0, 300, 500, 1000, 700, 100, 50}, x, {}, {900, 2.5, -1.0}};
    ASSERT_EQ(fit.Run(Curve::kGaussian), 0);
    EXPECT_EQ(fit.iter, 0);
    EXPECT_EQ(fit.coef[0], 900.0);
    EXPECT_EQ(fit.coef[1], 2.5);
    EXPECT_EQ(fit.coef[2], 1.0) << "without its sign";
}

TEST_F(CurveFits, BudgetsAllowOneStepMore) {
    for (const Curve curve : {Curve::kExponential, Curve::kPower}) {
        for (const auto& [budget, steps] : {std::pair{-1, 0}, {0, 1}, {1, 2}}) {
            Fit fit = OfReference(curve == Curve::kPower ? "power" : "exponential", false);
            fit.init = {2.0, curve == Curve::kPower ? 1.5 : 0.33};
            fit.tol = 1e-15;
            fit.iter = budget;
            ASSERT_EQ(fit.Run(curve), 0);
            EXPECT_EQ(fit.iter, steps);
            if (budget < 0) {
                EXPECT_EQ(fit.coef[0], fit.init[0]);
                EXPECT_EQ(fit.coef[1], fit.init[1]);
            }
        }
    }
    for (const auto& [budget, steps] : {std::pair{-1, 0}, {0, 1}, {7, 8}}) {
        Fit fit = OfReference("gaussian", false);
        fit.tol = 1e-15;
        fit.iter = budget;
        ASSERT_EQ(fit.Run(Curve::kGaussian), 0);
        EXPECT_EQ(fit.iter, steps);
    }
}

TEST_F(CurveFits, AWorseStepBeyondATenthOfTheBudgetIsTheLast) {
    for (const auto& [budget, last] : {std::pair{1, true}, {1000, false}}) {
        Fit fit = OfReference("exponential", false);
        fit.init = {1.0, 0.1};
        fit.iter = budget;
        ASSERT_EQ(fit.Run(Curve::kExponential), 0);
        EXPECT_EQ(fit.iter == 1, last);
        EXPECT_EQ(fit.coef[0] == 1.0, last) << "the best of all steps stands";
    }
}

TEST_F(CurveFits, StepsEndWhereTheyOverflow) {
    Fit fit = OfReference("exponential", false);
    fit.init = {1e-3, 4.0};
    fit.iter = 1000;
    ASSERT_EQ(fit.Run(Curve::kExponential), 0);
    for (int j = 0; j < 2; ++j) EXPECT_TRUE(std::isfinite(fit.coef[j]));
    EXPECT_LT(fit.iter, 1000);
}

TEST_F(CurveFits, LogarithmsAloneFitCleanExponentials) {
    const Values x{0, 1, 2, 3};
    const auto model = [](double t) { return -0.5 * std::exp(0.7 * t); };
    HostArray<double> y(Sampled(x, model));
    const HostArray<double> abscissas(x);
    double a, b, mse;
    ASSERT_EQ(ExpFitCoef_head(y.handle(), abscissas.handle(), &a, &b), 0);
    EXPECT_THAT(a, Near(-0.5, 1e-13));
    EXPECT_THAT(b, Near(0.7, 1e-13));
    ASSERT_EQ(ExpFit_head(y.handle(), abscissas.handle(), HostArray<double>().handle(), &a, &b, &mse), 0);
    EXPECT_THAT(a, Near(-0.5, 1e-13));
    EXPECT_NEAR(mse, 0.0, 1e-15);
    EXPECT_THAT(y.values(), AllNear(Sampled(x, model), 1e-13));

    // The weighted line through the logarithms, by its normal equations.
    Fit noisy = OfReference("exponential", false);
    const Values data = noisy.y;
    noisy.method = 0;
    noisy.iter = 77;
    noisy.init = {1, 1};
    ASSERT_EQ(noisy.Run(Curve::kExponential), 0);
    EXPECT_EQ(noisy.iter, 77) << "nothing was iterated";
    double residual = 0.0, moment = 0.0;
    for (size_t i = 0; i < data.size(); ++i) {
        const double r = data[i] * data[i] * (std::log(data[i] / noisy.coef[0]) - noisy.coef[1] * noisy.x[i]);
        residual += r;
        moment += r * noisy.x[i];
    }
    EXPECT_NEAR(residual, 0.0, 1e-9);
    EXPECT_NEAR(moment, 0.0, 1e-8);
}

TEST_F(CurveFits, StandardDeviationsBecomeWeights) {
    const Fit data = OfReference("exponential", false);
    Values sigma(data.x.size(), 2.0), w(data.x.size(), 0.25);
    sigma[3] = 0.0;
    w[3] = 1.0;
    HostArray<double> y(data.y);
    double a, b, mse;
    ASSERT_EQ(
        ExpFit_head(y.handle(), HostArray<double>(data.x).handle(), HostArray<double>(sigma).handle(), &a, &b, &mse),
        0);
    Fit same = data;
    same.w = w;
    same.method = 0;
    ASSERT_EQ(same.Run(Curve::kExponential), 0);
    EXPECT_EQ(a, same.coef[0]);
    EXPECT_EQ(b, same.coef[1]);
    EXPECT_EQ(mse, same.mse);
    EXPECT_EQ(y.values(), same.y);
}

TEST_F(CurveFits, ThePrevailingSignIsFitted) {
    Fit tie{{-1, -2, 3, 4}, {0, 1, 2, 3}};
    tie.method = 0;
    ASSERT_EQ(tie.Run(Curve::kExponential), 0);
    EXPECT_GT(tie.coef[0], 0.0) << "without a majority the sign is positive";
    Fit negative{{-1, -2, -3, 4}, {0, 1, 2, 3}};
    negative.method = 0;
    ASSERT_EQ(negative.Run(Curve::kExponential), 0);
    EXPECT_LT(negative.coef[0], 0.0);
    Fit zeros{{0, 0, 0}, {1, 2, 3}};
    EXPECT_EQ(zeros.Run(Curve::kExponential), kUnderdetermined);
    zeros.ExpectFailed();
    Fit overflow{{1, 1e200, 3}, {1, 2, 3}};
    EXPECT_EQ(overflow.Run(Curve::kExponential), kNotFinite) << "y^2 is a weight";
}

TEST_F(CurveFits, StartValuesOfTheWrongLengthAreAWarning) {
    for (const Curve curve : {Curve::kExponential, Curve::kPower, Curve::kGaussian}) {
        const bool peak = curve == Curve::kGaussian;
        Fit own = OfReference(peak ? "gaussian" : "power", false);
        own.iter = -1;
        Fit few = own;
        ASSERT_EQ(own.Run(curve), 0);
        few.init = {1};
        EXPECT_EQ(few.Run(curve), kWarnInitialIgnored);
        EXPECT_EQ(few.coef[0], own.coef[0]) << "they are ignored";
        EXPECT_EQ(few.y, own.y);

        Fit many = OfReference(peak ? "gaussian" : "power", false);
        many.iter = -1;
        many.init = {1.5, 0.25, 0.5, 7};
        EXPECT_EQ(many.Run(curve), kWarnInitialIgnored);
        EXPECT_EQ(many.coef[0], 1.5) << "the first ones are used";
        EXPECT_EQ(many.coef[1], 0.25);

        for (const double bad : {kNaN, kInfinity, -1.7976931348623157e308}) {
            Fit unusable = OfReference(peak ? "gaussian" : "power", false);
            unusable.iter = -1;
            unusable.init = {bad, 1};
            if (peak) unusable.init.push_back(1);
            EXPECT_EQ(unusable.Run(curve), 0) << "and no warning";
            EXPECT_EQ(unusable.coef[0], own.coef[0]);
        }
    }
    Fit failed{{1}, {1}, {}, {1}};
    EXPECT_EQ(failed.Run(Curve::kExponential), kFewerThanTwo) << "a failure goes before the warning";
}

TEST_F(CurveFits, ExponentialsAreRefusedInOrder) {
    Fit sizes{{1, 2}, {1}};
    sizes.iter = 5;
    EXPECT_EQ(sizes.Run(Curve::kExponential), kSizesDiffer);
    sizes.ExpectFailed();
    EXPECT_EQ(sizes.iter, 5);
    Fit weights{{1, 2}, {1, 2}, {1}};
    EXPECT_EQ(weights.Run(Curve::kExponential), kSizesDiffer);
    Fit one{{1}, {1}};
    one.method = 7;
    EXPECT_EQ(one.Run(Curve::kExponential), kFewerThanTwo);
    for (const int32_t method : {2, 0xFFFF, -1}) {
        Fit fit{{1, 2}, {1, 2}};
        fit.method = method;
        EXPECT_EQ(fit.Run(Curve::kExponential), kBadSelector);
        fit.ExpectFailed();
        Fit coefficients{{1, 2}, {1, 2}};
        coefficients.method = method;
        EXPECT_EQ(coefficients.RunCoefficients(Curve::kExponential), kBadSelector);
        EXPECT_EQ(coefficients.y.size(), 2u);
        EXPECT_TRUE(IsQuietNaN(coefficients.coef[0]) && IsQuietNaN(coefficients.coef[1]));
    }
    Fit wide = OfReference("exponential", false);
    wide.method = 0x7ABC0001;
    EXPECT_EQ(wide.Run(Curve::kExponential), 0) << "16 bits count";
    EXPECT_EQ(ExpFitCoef_head(HostArray<double>{1, 2}.handle(), HostArray<double>{1}.handle(), &sizes.coef[0],
                              &sizes.coef[1]),
              kSizesDiffer);
}

TEST_F(CurveFits, PowersNeedPositiveAbscissas) {
    for (const double x : {0.0, -1.0, kNaN}) {
        Fit fit{{1, 2, 3}, {1, x, 3}};
        EXPECT_EQ(fit.Run(Curve::kPower), kNotPositive);
        fit.ExpectFailed();
    }
    Fit one{{1}, {-1}};
    EXPECT_EQ(one.Run(Curve::kPower), kFewerThanTwo);
}

TEST_F(CurveFits, GaussiansAreRefusedInOrder) {
    Fit two{{1, 2}, {kNaN, 1}};
    EXPECT_EQ(two.Run(Curve::kGaussian), kFewerThanThree);
    two.ExpectFailed(3);
    Fit bad{{1, 2, 3}, {1, kInfinity, 3}};
    EXPECT_EQ(bad.Run(Curve::kGaussian), kNotFinite);
    bad.ExpectFailed(3);
    Fit flat{{1, 2, 3}, {1, 2, 3}, {}, {1, 2, 0}};
    EXPECT_EQ(flat.Run(Curve::kGaussian), kZeroSigma);
    flat.ExpectFailed(3);
    Fit column{{1, 2, 3}, {1, 1, 1}};
    EXPECT_EQ(column.Run(Curve::kGaussian), kZeroSigma);
}

TEST_F(CurveFits, GaussiansWithoutAWidthAreNaN) {
    for (const Values& y : {Values{0, 0, 0, 0}, Values{0, 0, 5, 0.1}, Values{1, kNaN, 2, 1}}) {
        for (const int32_t budget : {10, kMost}) {
            Fit fit{y, {1, 2, 3, 4}};
            fit.iter = budget;
            ASSERT_EQ(fit.Run(Curve::kGaussian), 0);
            EXPECT_TRUE(std::isnan(fit.coef[2]) && std::isnan(fit.mse));
            EXPECT_EQ(fit.iter, budget == kMost ? kMost : budget + 1);
        }
    }
}

}  // namespace
}  // namespace krnumer
