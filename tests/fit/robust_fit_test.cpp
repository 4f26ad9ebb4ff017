// Fits by bisquare weights and by least absolute residuals, through their exports.

#include "krnumer/robust_fit.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <functional>
#include <limits>

#include "fit/curves.h"
#include "frame/numeric.h"
#include "frame/status.h"
#include "krnumer/linear_fit.h"
#include "krnumer/nonlinear_fit.h"
#include "support/host_arrays.h"
#include "support/numbers.h"

namespace krnumer {
namespace {

using Values = std::vector<double>;

constexpr double kNaN = kQuietNaN;
constexpr double kBase = 10.0;

enum class Model { kLine, kExponential, kPower, kLog, kGaussian };
enum class Way { kBisquare, kAbsolute };

constexpr Model kModels[] = {Model::kLine, Model::kExponential, Model::kPower, Model::kLog, Model::kGaussian};
constexpr Way kWays[] = {Way::kBisquare, Way::kAbsolute};

std::string NameOf(Model model) {
    constexpr const char* kNames[] = {"line", "exponential", "power", "log", "gaussian"};
    return kNames[static_cast<int>(model)];
}

// What a fit is called with and what it leaves.
struct Fit {
    Values y, x, w{}, init{};
    double tol = 1e-9;
    double msetol = 0.0;
    double base = kBase;
    int32_t method = 1;
    int32_t iter = 200;
    int32_t coef_only = 0;
    double coef[3] = {-9, -9, -9};
    double residue = -9;

    int32_t Run(Way way, Model model) {
        HostArray<double> ordinates(y);
        const HostArray<double> abscissas(x), weights(w), start(init);
        const bool bisquare = way == Way::kBisquare;
        double* const p = coef;
        const auto call = [&](auto* fit, auto... rest) {
            return fit(ordinates.handle(), abscissas.handle(), weights.handle(), rest...);
        };
        int32_t status = 0;
        switch (model) {
            case Model::kLine:
                status = bisquare ? call(BiLinearFit_head, tol, p, p + 1, &residue, &iter, coef_only)
                                  : call(LARLinearFit_head, tol, p, p + 1, &residue, &iter, msetol, coef_only);
                break;
            case Model::kExponential:
                status = call(bisquare ? BiExpFit_head : LARExpFit_head, tol, start.handle(), method, p, p + 1,
                              &residue, &iter, msetol, coef_only);
                break;
            case Model::kPower:
                status = call(bisquare ? BiPowerFit_head : LARPowerFit_head, tol, start.handle(), p, p + 1, &residue,
                              &iter, msetol, coef_only);
                break;
            case Model::kLog:
                status = bisquare ? call(BiLogFit_head, base, tol, p, p + 1, &residue, &iter, coef_only)
                                  : call(LARLogFit_head, base, tol, p, p + 1, &residue, &iter, msetol, coef_only);
                break;
            case Model::kGaussian:
                status = call(bisquare ? BiGaussFit_head : LARGaussFit_head, tol, start.handle(), p, p + 1, p + 2,
                              &residue, &iter, msetol, coef_only);
                break;
        }
        y = ordinates.values();
        return status;
    }
};

int CoefficientsOf(Model model) {
    return model == Model::kGaussian ? 3 : 2;
}

double ValueOf(Model model, const double* p, double x) {
    switch (model) {
        case Model::kLine:
            return p[0] * x + p[1];
        case Model::kExponential:
            return p[0] * std::exp(p[1] * x);
        case Model::kPower:
            return p[0] * std::pow(x, p[1]);
        case Model::kLog:
            return p[0] * std::log10(p[1] * x);
        default:
            return p[0] * std::exp(-0.5 * (x - p[1]) * (x - p[1]) / (p[2] * p[2]));
    }
}

Values Sampled(Model model, const double* p, const Values& x) {
    Values y;
    for (const double each : x) y.push_back(ValueOf(model, p, each));
    return y;
}

double MeanOf(const Values& y, const Values& fit, const Values& w, const std::function<double(double)>& f) {
    double sum = 0.0;
    for (size_t i = 0; i < y.size(); ++i) sum += f(y[i] - fit[i]) * (w.empty() ? 1.0 : std::fabs(w[i]));
    return sum / static_cast<double>(y.size());
}

class RobustFits : public testing::Test {
    LeakCheck leaks_;
};

TEST_F(RobustFits, OutliersHardlyMoveThem) {
    for (const Model model : kModels) {
        const std::string name = NameOf(model);
        const Values& clean = Reference(name + ".coef");
        for (const Way way : kWays) {
            SCOPED_TRACE(name + (way == Way::kBisquare ? " bisquare" : " absolute"));
            Fit fit{Reference(name + ".spoiled"), Reference("x")};
            fit.tol = 1e-6;
            const Values data = fit.y;
            ASSERT_EQ(fit.Run(way, model), 0);
            for (size_t j = 0; j < clean.size(); ++j) EXPECT_THAT(fit.coef[j], Near(clean[j], 0.06, 0.05));
            EXPECT_THAT(fit.y, AllNear(Sampled(model, fit.coef, fit.x), 1e-13));
            const double residue = way == Way::kBisquare
                                       ? MeanOf(data, fit.y, {}, [](double r) { return r * r; })
                                       : MeanOf(data, fit.y, {}, [](double r) { return std::fabs(r); });
            EXPECT_THAT(fit.residue, Near(residue, 1e-11));
            EXPECT_GE(fit.iter, 1);
            EXPECT_LE(fit.iter, 200);
        }
    }
}

TEST_F(RobustFits, AbsoluteResidualsComeNearTheirLeast) {
    for (const Model model : kModels) {
        const std::string name = NameOf(model);
        SCOPED_TRACE(name);
        Fit fit{Reference(name + ".spoiled"), Reference("x")};
        ASSERT_EQ(fit.Run(Way::kAbsolute, model), 0);
        const double least = Reference(name + ".lar").back();
        EXPECT_GT(fit.residue, least * (1 - 1e-9));
        EXPECT_LT(fit.residue, least * 1.02);
    }
}

// The loop over the weighted fit, with the weights of a fixed point put in: the fit to them gives the point again.
TEST_F(RobustFits, BisquareLinesSolveTheirEquation) {
    for (const bool weighted : {false, true}) {
        Fit fit{Reference("line.spoiled"), Reference("x"), weighted ? Reference("w") : Values{}};
        fit.tol = 1e-13;
        const Values data = fit.y;
        ASSERT_EQ(fit.Run(Way::kBisquare, Model::kLine), 0);
        const size_t n = data.size();
        const auto weight = [&](size_t i) { return weighted ? fit.w[i] : 1.0; };
        double s = 0, sx = 0, sxx = 0;
        for (size_t i = 0; i < n; ++i) {
            s += weight(i);
            sx += weight(i) * fit.x[i];
            sxx += weight(i) * fit.x[i] * fit.x[i];
        }
        Values r(n);
        for (size_t i = 0; i < n; ++i) {
            const double off = fit.x[i] - sx / s;
            const double h = weight(i) * (1 / s + off * off / (sxx - sx * sx / s));  // the textbook's leverage
            r[i] = (data[i] - fit.coef[0] * fit.x[i] - fit.coef[1]) * std::sqrt(weight(i) / (1 - h));
        }
        const auto median = [](Values v) {
            std::sort(v.begin(), v.end());
            return (v[v.size() / 2 - 1] + v[v.size() / 2]) / 2;
        };
        const double center = median(r);
        Values d(n);
        for (size_t i = 0; i < n; ++i) d[i] = std::fabs(r[i] - center);
        const double unit = 4.685 * median(d) / 0.6745;
        Values bisquare(n);
        for (size_t i = 0; i < n; ++i) {
            const double u = r[i] / unit;
            bisquare[i] = std::fabs(u) < 1 ? (1 - u * u) * (1 - u * u) * weight(i) : 0.0;
        }
        double slope, intercept;
        int32_t err;
        LinFitCoef80_head(HostArray<double>(data).handle(), HostArray<double>(fit.x).handle(),
                          HostArray<double>(bisquare).handle(), &slope, &intercept, &err);
        EXPECT_THAT(fit.coef[0], Near(slope, 1e-10));
        EXPECT_THAT(fit.coef[1], Near(intercept, 1e-10));
        EXPECT_THAT(fit.residue, Near(MeanOf(data, fit.y, fit.w, [](double each) { return each * each; }), 1e-12))
            << "with the caller's weights";
        EXPECT_EQ(std::count(bisquare.begin(), bisquare.end(), 0.0), 3) << "the outliers have no weight";
    }
}

// The curves are fitted within to a tolerance of their own, which limits how well they agree.
TEST_F(RobustFits, BisquareFitsAreFixedPointsOfLeastSquares) {
    for (const Model model : kModels) {
        for (const bool weighted : {false, true}) {
            const std::string row = NameOf(model) + (weighted ? ".weighted" : "");
            SCOPED_TRACE(row);
            Fit fit{Reference(NameOf(model) + ".spoiled"), Reference("x"), weighted ? Reference("w") : Values{}};
            ASSERT_EQ(fit.Run(Way::kBisquare, model), 0);
            const bool closed = model == Model::kLine || model == Model::kLog;
            const Values& expected = Reference(row + ".bisquare");
            for (size_t j = 0; j < expected.size(); ++j)
                EXPECT_THAT(fit.coef[j], Near(expected[j], closed ? 1e-6 : 1e-3));
        }
    }
}

TEST_F(RobustFits, CleanDataAreFittedExactly) {
    const Values x{1, 2, 3, 4, 5, 6, 7};
    const double truth[][3] = {{2, -1}, {0.5, 0.4}, {2, 1.5}, {3, 2}, {5, 4, 1.5}};
    for (const Model model : kModels) {
        for (const Way way : kWays) {
            for (const Values& w : {Values{}, Values{1, -2, 3, 1, 2, 1, 4}}) {
                SCOPED_TRACE(NameOf(model));
                const double* p = truth[static_cast<int>(model)];
                Fit fit{Sampled(model, p, x), x, w};
                ASSERT_EQ(fit.Run(way, model), 0);
                for (int j = 0; j < CoefficientsOf(model); ++j) EXPECT_THAT(fit.coef[j], Near(p[j], 1e-6));
                EXPECT_NEAR(fit.residue, 0.0, 1e-6);
            }
        }
    }
}

TEST_F(RobustFits, CoefficientsAloneLeaveTheRest) {
    for (const Model model : kModels) {
        for (const Way way : kWays) {
            Fit full{Reference(NameOf(model) + ".spoiled"), Reference("x"), Reference("w")};
            if (model == Model::kGaussian) full.init = {4, 3.2, 1.1};
            Fit alone = full;
            alone.coef_only = 1;
            const Values data = full.y;
            ASSERT_EQ(full.Run(way, model), 0);
            ASSERT_EQ(alone.Run(way, model), 0);
            for (int j = 0; j < 3; ++j) EXPECT_EQ(alone.coef[j], full.coef[j]);
            EXPECT_EQ(alone.iter, full.iter);
            EXPECT_EQ(alone.y, data);
            EXPECT_EQ(alone.residue, -9.0) << "not written";

            alone.x.pop_back();
            EXPECT_EQ(alone.Run(way, model), kSizesDiffer);
            EXPECT_EQ(alone.y, data) << "kept by a failure, too";
            for (int j = 0; j < CoefficientsOf(model); ++j) EXPECT_TRUE(IsQuietNaN(alone.coef[j]));
            EXPECT_TRUE(IsQuietNaN(alone.residue));
        }
    }
}

TEST_F(RobustFits, MakeThePassesOfTheirRules) {
    for (const Way way : kWays) {
        for (const Model model : kModels) {
            for (const bool weighted : {false, true}) {
                const std::string name = NameOf(model) + (weighted ? ".weighted" : "");
                for (const Loop& loop : Loops((way == Way::kBisquare ? "bisquare." : "absolute.") + name)) {
                    SCOPED_TRACE(testing::Message() << name << ", tolerance " << loop.tol << ", " << loop.budget);
                    Fit fit{Reference(NameOf(model) + ".spoiled"), Reference("x"),
                            weighted ? Reference("w") : Values{}};
                    fit.tol = loop.tol;
                    fit.iter = loop.budget;
                    ASSERT_EQ(fit.Run(way, model), 0);
                    EXPECT_EQ(fit.iter, loop.steps);
                    for (size_t j = 0; j < loop.coef.size(); ++j) EXPECT_THAT(fit.coef[j], Near(loop.coef[j], 1e-8));
                    EXPECT_THAT(fit.residue, Near(loop.error, 1e-8));
                }
            }
        }
    }
}

TEST_F(RobustFits, BudgetsOfPasses) {
    for (const Model model : kModels) {
        for (const int32_t budget : {std::numeric_limits<int32_t>::min(), -1, 0, 1, 2}) {
            SCOPED_TRACE(NameOf(model));
            Fit bisquare{Reference(NameOf(model) + ".spoiled"), Reference("x")};
            bisquare.tol = 1e-14;
            bisquare.iter = budget;
            Fit absolute = bisquare;
            ASSERT_EQ(bisquare.Run(Way::kBisquare, model), 0);
            EXPECT_EQ(bisquare.iter, std::max(budget, 1)) << "one pass in any case";
            ASSERT_EQ(absolute.Run(Way::kAbsolute, model), 0);
            EXPECT_LE(absolute.iter, std::max(budget, 0));
            EXPECT_EQ(absolute.iter > 0, budget > 0);
        }
    }
}

TEST_F(RobustFits, WithoutABudgetAbsoluteFitsAreThePreliminaryOnes) {
    for (const Model model : {Model::kLine, Model::kLog}) {
        Fit fit{Reference(NameOf(model) + ".y"), Reference("x"), Reference("w")};
        fit.iter = 0;
        const Values data = fit.y;
        ASSERT_EQ(fit.Run(Way::kAbsolute, model), 0);
        for (size_t j = 0; j < 2; ++j)
            EXPECT_THAT(fit.coef[j], Near(Reference(NameOf(model) + ".weighted.coef")[j], 1e-7));
        EXPECT_THAT(fit.residue, Near(MeanOf(data, fit.y, fit.w, [](double r) { return std::fabs(r); }), 1e-13));
    }
}

TEST_F(RobustFits, HugeBudgetsDoNotOverflow) {
    for (const Model model : kModels) {
        for (const Way way : kWays) {
            Fit fit{Reference(NameOf(model) + ".y"), Reference("x")};
            fit.iter = std::numeric_limits<int32_t>::max();
            fit.tol = 1e-4;
            ASSERT_EQ(fit.Run(way, model), 0);
            EXPECT_GE(fit.iter, 1);
            EXPECT_LT(fit.iter, 1000);
        }
    }
}

TEST_F(RobustFits, ExactGaussiansAreTriedAgain) {
    const Values x{0, 1, 2, 3, 4, 5, 6};
    const double truth[] = {2, 3, 1.5};
    const Values y = Sampled(Model::kGaussian, truth, x);
    Fit fit{y, x};
    ASSERT_EQ(fit.Run(Way::kAbsolute, Model::kGaussian), 0);
    EXPECT_EQ(fit.iter, 1);
    EXPECT_NEAR(fit.residue, 0.0, 1e-14);

    Fit none{y, x};
    none.iter = 0;
    ASSERT_EQ(none.Run(Way::kAbsolute, Model::kGaussian), 0);
    EXPECT_EQ(none.iter, 0);
    double narrow = 0.0;
    for (size_t i = 0; i < x.size(); ++i) narrow += std::fabs(y[i] - 2 * std::exp(-(x[i] - 3) * (x[i] - 3) / 2.25));
    EXPECT_THAT(none.residue, Near(narrow / 7, 1e-13)) << "of the curve without the half";
    EXPECT_THAT(none.y, AllNear(y, 1e-13));
}

TEST_F(RobustFits, PerfectAbsoluteFitsAreTheirPreliminaryOnes) {
    Fit fit{{0, 0, 0, 0}, {1, 2, 3, 4}};
    for (const Model model : {Model::kLine, Model::kLog}) {
        Fit zero = fit;
        ASSERT_EQ(zero.Run(Way::kAbsolute, model), 0);
        EXPECT_EQ(zero.iter, 0);
        EXPECT_EQ(zero.residue, 0.0);
        EXPECT_EQ(zero.coef[0], 0.0) << "not the stand-in for the fit before";
        Fit bisquare = fit;
        ASSERT_EQ(bisquare.Run(Way::kBisquare, Model::kLine), 0);
        EXPECT_EQ(bisquare.iter, 0) << "nothing spreads";
        EXPECT_EQ(bisquare.coef[0], 0.0);
    }
}

TEST_F(RobustFits, TwoPointsHaveTheLineThroughBoth) {
    for (const Values& w : {Values{}, Values{0, 0}, Values{1, 3}}) {
        for (const Way way : kWays) {
            Fit fit{{1, 4}, {2, 3}, w};
            ASSERT_EQ(fit.Run(way, Model::kLine), 0);
            EXPECT_EQ(fit.coef[0], 3.0);
            EXPECT_EQ(fit.coef[1], -5.0);
            EXPECT_EQ(fit.iter, 0);
            EXPECT_EQ(fit.residue, way == Way::kAbsolute ? 1.0 : 0.0);
            EXPECT_EQ(fit.y, (Values{1, 4}));
        }
    }
}

TEST_F(RobustFits, OneZeroAbscissaIsLeftOutOfTheSlopes) {
    Fit fit{{1, 3, 5, 7, 20}, {0, 1, 2, 3, 4}};
    ASSERT_EQ(fit.Run(Way::kAbsolute, Model::kLine), 0);
    EXPECT_THAT(fit.coef[0], Near(2.0, 1e-7));
    EXPECT_THAT(fit.coef[1], Near(1.0, 1e-7));
    EXPECT_THAT(fit.residue, Near(11.0 / 5, 1e-7));
    Fit two{{1, 3, 5}, {0, -0.0, 2}};
    EXPECT_EQ(two.Run(Way::kAbsolute, Model::kLine), kTableTooSmall);
    EXPECT_TRUE(two.y.empty());
    for (const double value : {two.coef[0], two.coef[1], two.residue}) EXPECT_TRUE(IsQuietNaN(value));
}

TEST_F(RobustFits, NaNInTheData) {
    Values x, y;
    for (int i = 1; i <= 30; ++i) {
        x.push_back(i);
        y.push_back(1.0 + i % 7);
    }
    y[11] = kNaN;
    for (const Model model : {Model::kExponential, Model::kPower}) {
        for (const Way way : kWays) {
            Fit fit{y, x};
            EXPECT_EQ(fit.Run(way, model), kHoldsNaN);
            EXPECT_TRUE(fit.y.empty());
            EXPECT_EQ(fit.iter, 200) << "left by a failure";
        }
    }
    Fit bisquare{y, x};
    EXPECT_EQ(bisquare.Run(Way::kBisquare, Model::kLine), kHoldsNaN);
    Fit logarithm{y, x};
    EXPECT_EQ(logarithm.Run(Way::kAbsolute, Model::kLog), kHoldsNaN);
    for (const size_t i : {size_t{0}, size_t{11}, size_t{29}}) {
        Fit line{y, x};
        line.y[i] = kNaN;
        EXPECT_EQ(line.Run(Way::kAbsolute, Model::kLine), 0) << "no median is asked for";
        EXPECT_TRUE(std::isnan(line.coef[0]) && std::isnan(line.coef[1]) && std::isnan(line.residue));
        Fit weights{y, x, Values(30, 1.0)};
        weights.y[11] = 1.0;
        weights.w[i] = kNaN;
        EXPECT_EQ(weights.Run(Way::kAbsolute, Model::kLine), 0);
    }
    Fit gaussian{y, x};
    gaussian.x[3] = kInfinity;
    EXPECT_EQ(gaussian.Run(Way::kBisquare, Model::kGaussian), kNotFinite);
}

TEST_F(RobustFits, TheyAreRefusedInOrder) {
    for (const Way way : kWays) {
        for (const Model model : kModels) {
            Fit sizes{{1, 2, 3}, {1, 2}};
            sizes.base = -1;
            EXPECT_EQ(sizes.Run(way, model), kSizesDiffer);
            EXPECT_TRUE(sizes.y.empty());
            Fit weights{{1, 2, 3}, {1, 2, 3}, {1, 2}};
            EXPECT_EQ(weights.Run(way, model), kSizesDiffer);
            Fit one{{1}, {1}};
            one.method = 9;
            EXPECT_EQ(one.Run(way, model), model == Model::kGaussian ? kFewerThanThree : kFewerThanTwo);
            for (int j = 0; j < CoefficientsOf(model); ++j) EXPECT_TRUE(IsQuietNaN(one.coef[j]));
            EXPECT_TRUE(IsQuietNaN(one.residue));
        }
        for (const double base : {0.0, -1.0, kNaN}) {
            Fit fit{{1}, {1}};
            fit.base = base;
            EXPECT_EQ(fit.Run(way, Model::kLog), kNotPositive);
        }
        Fit mixed{{1, 2, 3}, {1, -2, 3}};
        EXPECT_EQ(mixed.Run(way, Model::kLog), kMixedSigns);
        Fit power{{1, 2, 3}, {1, 0, 3}};
        EXPECT_EQ(power.Run(way, Model::kPower), kNotPositive);
        Fit method{{1, 2, 3}, {1, 2, 3}};
        method.method = 2;
        EXPECT_EQ(method.Run(way, Model::kExponential), kBadSelector);
        Fit zeros{{0, 0, 0}, {1, 2, 3}};
        EXPECT_EQ(zeros.Run(way, Model::kExponential), kUnderdetermined);
        Fit flat{{1, 2, 3}, {1, 2, 3}, {}, {1, 1, 0}};
        EXPECT_EQ(flat.Run(way, Model::kGaussian), kZeroSigma);
    }
}

TEST_F(RobustFits, StartValuesOfTheWrongLengthAreAWarning) {
    for (const Way way : kWays) {
        for (const Model model : {Model::kExponential, Model::kPower, Model::kGaussian}) {
            Fit own{Reference(NameOf(model) + ".y"), Reference("x")};
            Fit few = own;
            ASSERT_EQ(own.Run(way, model), 0);
            few.init = {3};
            EXPECT_EQ(few.Run(way, model), kWarnInitialIgnored);
            EXPECT_EQ(few.coef[0], own.coef[0]);
            EXPECT_EQ(few.y, own.y) << "the results stand";
            EXPECT_EQ(few.residue, own.residue);
        }
    }
}

TEST_F(RobustFits, LogarithmsAloneMakeExponentialsRobustToo) {
    for (const Way way : kWays) {
        Fit fit{Reference("exponential.y"), Reference("x")};
        fit.method = static_cast<int32_t>(0xABCD0000);
        ASSERT_EQ(fit.Run(way, Model::kExponential), 0) << "16 bits count";
        EXPECT_THAT(fit.coef[1], Near(Reference("exponential.coef")[1], 0.05));
    }
}

}  // namespace
}  // namespace krnumer
