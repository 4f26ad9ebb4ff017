// Bands, bounds of coefficients and the goodness of fits, through their exports.

#include "krnumer/fit_bounds.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>

#include "fit/curves.h"
#include "fit/nist.h"
#include "frame/numeric.h"
#include "frame/status.h"
#include "krnumer/distributions.h"
#include "support/host_arrays.h"
#include "support/numbers.h"

namespace krnumer {
namespace {

using Values = std::vector<double>;

constexpr double kNaN = kQuietNaN;

enum class Model { kLine, kExponential, kPower, kLog, kGaussian };

constexpr Model kModels[] = {Model::kLine, Model::kExponential, Model::kPower, Model::kLog, Model::kGaussian};

std::string NameOf(Model model) {
    constexpr const char* kNames[] = {"line", "exponential", "power", "log", "gaussian"};
    return kNames[static_cast<int>(model)];
}

// What a band is asked for and what it comes out as.
struct Band {
    Values y, x, w{};
    Values coef{};
    double level = 0.95;
    double base = 10.0;
    Values upper{}, lower{}, upper_coef{}, lower_coef{};
    double deltas[3] = {-9, -9, -9};

    Band(Model model, bool weighted)
        : y(Reference(NameOf(model) + ".y")),
          x(Reference("x")),
          w(weighted ? Reference("w") : Values{}),
          coef(Reference(NameOf(model) + (weighted ? ".weighted" : "") + ".coef")) {}
    Band(Values y_in, Values x_in, Values coef_in) : y(std::move(y_in)), x(std::move(x_in)), coef(std::move(coef_in)) {}

    int32_t Confidence(Model model) {
        return Run([&](auto... data_and_outputs) { return CallConfidence(model, data_and_outputs...); });
    }
    int32_t Prediction(Model model) {
        return Run([&](KrHandle yh, KrHandle xh, KrHandle wh, KrHandle up, KrHandle low, KrHandle, KrHandle) {
            const Values& p = coef;
            switch (model) {
                case Model::kLine:
                    return PredBndLinear_head(yh, xh, wh, p[0], p[1], level, up, low);
                case Model::kExponential:
                    return PredBndExp_head(yh, xh, wh, p[0], p[1], level, up, low);
                case Model::kPower:
                    return PredBndPower_head(yh, xh, wh, p[0], p[1], level, up, low);
                case Model::kLog:
                    return PredBndLog_head(yh, xh, wh, base, p[0], p[1], level, up, low);
                default:
                    return PredBndGauss_head(yh, xh, wh, p[0], p[1], p[2], level, up, low);
            }
        });
    }

    Values HalfWidths() const {
        Values half;
        for (size_t i = 0; i < upper.size(); ++i) half.push_back((upper[i] - lower[i]) / 2);
        return half;
    }

    void ExpectFailed(int coefficients) const {
        for (const Values* array : {&upper, &lower, &upper_coef, &lower_coef}) EXPECT_TRUE(array->empty());
        for (int j = 0; j < coefficients; ++j) EXPECT_TRUE(SameBits(deltas[j], 0.0)) << "not NaN";
    }

  private:
    template <class Function>
    int32_t Run(Function function) {
        const HostArray<double> ordinates(y), abscissas(x), weights(w);
        HostArray<double> up{9}, low{9, 9}, up_coef{9}, low_coef{9, 9, 9, 9};
        const int32_t status = function(ordinates.handle(), abscissas.handle(), weights.handle(), up.handle(),
                                        low.handle(), up_coef.handle(), low_coef.handle());
        upper = up.values();
        lower = low.values();
        upper_coef = up_coef.values();
        lower_coef = low_coef.values();
        return status;
    }

    int32_t CallConfidence(Model model, KrHandle yh, KrHandle xh, KrHandle wh, KrHandle up, KrHandle low,
                           KrHandle up_coef, KrHandle low_coef) {
        const Values& p = coef;
        double* const d = deltas;
        switch (model) {
            case Model::kLine:
                return ConfBndLinear_head(yh, xh, wh, p[0], p[1], level, up, low, up_coef, low_coef, d, d + 1);
            case Model::kExponential:
                return ConfBndExp_head(yh, xh, wh, p[0], p[1], level, up, low, up_coef, low_coef, d, d + 1);
            case Model::kPower:
                return ConfBndPower_head(yh, xh, wh, p[0], p[1], level, up, low, up_coef, low_coef, d, d + 1);
            case Model::kLog:
                return ConfBndLog_head(yh, xh, wh, base, p[0], p[1], level, up, low, up_coef, low_coef, d, d + 1);
            default:
                return ConfBndGauss_head(yh, xh, wh, p[0], p[1], p[2], level, up, low, up_coef, low_coef, d, d + 1,
                                         d + 2);
        }
    }
};

double Quantile(double level, int32_t freedom) {
    const double p = 1 - (1 - level) / 2;
    double t;
    int32_t err;
    InvTdist_head(&p, &freedom, &t, &err);
    return t;
}

class FitBounds : public testing::Test {
    LeakCheck leaks_;
};

constexpr double kTolerance = 5e-5;  // of the quantile

TEST_F(FitBounds, BandsAreThoseOfTheTextbook) {
    for (const Model model : kModels) {
        for (const bool weighted : {false, true}) {
            const std::string row = NameOf(model) + (weighted ? ".weighted" : "");
            SCOPED_TRACE(row);
            Band band(model, weighted);
            ASSERT_EQ(band.Confidence(model), 0);
            EXPECT_THAT(band.HalfWidths(), AllNear(Reference(row + ".confidence"), kTolerance));
            ASSERT_EQ(band.upper_coef.size(), band.coef.size());
            ASSERT_EQ(band.lower_coef.size(), band.coef.size());
            for (size_t j = 0; j < band.coef.size(); ++j) {
                EXPECT_THAT(band.deltas[j], Near(Reference(row + ".deltas")[j], kTolerance));
                EXPECT_EQ(band.upper_coef[j], band.coef[j] + band.deltas[j]);
                EXPECT_EQ(band.lower_coef[j], band.coef[j] - band.deltas[j]);
            }
            const Values confidence = band.HalfWidths();
            ASSERT_EQ(band.Prediction(model), 0);
            EXPECT_THAT(band.HalfWidths(), AllNear(Reference(row + ".prediction"), kTolerance));
            for (size_t i = 0; i < confidence.size(); ++i) EXPECT_GT(band.HalfWidths()[i], confidence[i]);
        }
    }
}

TEST_F(FitBounds, HalfWidthsAreCertifiedDeviations) {
    const auto digits = [](const Certified& set, const Band& band, const Values& deviations) {
        const double t = Quantile(0.95, static_cast<int32_t>(set.y.size() - deviations.size()));
        Values found;
        for (size_t j = 0; j < deviations.size(); ++j) found.push_back(band.deltas[j] / t);
        return CorrectDigits(found, deviations);
    };
    const Certified norris = LoadCertified("Norris");
    Band line(norris.y, norris.x[0], {norris.coef[1], norris.coef[0]});
    ASSERT_EQ(line.Confidence(Model::kLine), 0);
    EXPECT_GT(digits(norris, line, {norris.deviations[1], norris.deviations[0]}), 11.5);

    const Certified wood = LoadCertified("DanWood");
    Band power(wood.y, wood.x[0], wood.coef);
    ASSERT_EQ(power.Confidence(Model::kPower), 0);
    EXPECT_GT(digits(wood, power, wood.deviations), 9.0);

    // Its form of the peak is b1 / b2 exp(...): the height has no certified deviation.
    const Certified eckerle = LoadCertified("Eckerle4");
    Band peak(eckerle.y, eckerle.x[0], {eckerle.coef[0] / eckerle.coef[1], eckerle.coef[2], eckerle.coef[1]});
    ASSERT_EQ(peak.Confidence(Model::kGaussian), 0);
    const double t = Quantile(0.95, static_cast<int32_t>(eckerle.y.size()) - 3);
    EXPECT_GT(CorrectDigits({peak.deltas[1] / t, peak.deltas[2] / t}, {eckerle.deviations[2], eckerle.deviations[1]}),
              9.0);
}

TEST_F(FitBounds, BasesOfLogarithmsGiveOneBand) {
    Band ten(Model::kLog, true);
    ASSERT_EQ(ten.Confidence(Model::kLog), 0);
    for (const double base : {2.71828, 2.0}) {
        Band band(Model::kLog, true);
        band.base = base;
        const double unit = (base == 2.71828 ? 1.0 : std::log(base)) / std::log(10.0);
        band.coef[0] *= unit;
        ASSERT_EQ(band.Confidence(Model::kLog), 0);
        EXPECT_THAT(band.upper, AllNear(ten.upper, 1e-12));
        EXPECT_THAT(band.deltas[0], Near(ten.deltas[0] * unit, 1e-11));
        EXPECT_THAT(band.deltas[1], Near(ten.deltas[1], 1e-11));
    }
}

TEST_F(FitBounds, TheWeightsOfALineHaveTheirSignInItsConfidenceBand) {
    for (const Model model : kModels) {
        Band given(model, true);
        ASSERT_EQ(given.Confidence(model), 0);
        Band negative = given;
        for (double& w : negative.w) w = -w;
        ASSERT_EQ(negative.Confidence(model), 0);
        for (size_t i = 0; i < given.upper.size(); ++i) {
            if (model == Model::kLine) {
                EXPECT_TRUE(std::isnan(negative.upper[i]) && std::isnan(negative.lower[i]));
            } else {
                EXPECT_EQ(negative.upper[i], given.upper[i]);
            }
        }
        EXPECT_EQ(std::isnan(negative.deltas[0]), model == Model::kLine);
        ASSERT_EQ(given.Prediction(model), 0);
        ASSERT_EQ(negative.Prediction(model), 0);
        EXPECT_EQ(negative.upper, given.upper);
    }
}

TEST_F(FitBounds, APointWithoutWeightCanBeAnywhere) {
    Band band(Model::kExponential, true);
    band.w[3] = 0.0;
    ASSERT_EQ(band.Prediction(Model::kExponential), 0);
    EXPECT_EQ(band.upper[3], kInfinity);
    EXPECT_EQ(band.lower[3], -kInfinity);
    EXPECT_TRUE(std::isfinite(band.upper[4]));
}

TEST_F(FitBounds, PerfectFitsHaveNoBand) {
    Band band({3, 5, 7, 9}, {1, 2, 3, 4}, {2, 1});
    ASSERT_EQ(band.Confidence(Model::kLine), 0);
    EXPECT_EQ(band.upper, band.y);
    EXPECT_EQ(band.lower, band.y);
    EXPECT_EQ(band.deltas[0], 0.0);
    ASSERT_EQ(band.Prediction(Model::kLine), 0);
    EXPECT_EQ(band.upper, band.y);
}

TEST_F(FitBounds, OneDegreeOfFreedomIsEnough) {
    Band band({1, 3, 4}, {1, 2, 3}, {1.5, -1.0 / 3});
    ASSERT_EQ(band.Confidence(Model::kLine), 0);
    const double s = std::sqrt(1.0 / 6);
    EXPECT_THAT(band.deltas[0], Near(12.706204736 * s / std::sqrt(2.0), 1e-4));
    band.level = 1 - 1e-9;
    ASSERT_EQ(band.Confidence(Model::kLine), 0);
    EXPECT_THAT(band.deltas[0], Near(10000 * s / std::sqrt(2.0), 1e-6)) << "the inverse ends there";
    Band two({1, 3}, {1, 2}, {2, -1});
    EXPECT_EQ(two.Confidence(Model::kLine), kFewerThanThree);
    two.ExpectFailed(2);
}

TEST_F(FitBounds, HardlyAnyConfidenceTurnsTheBandOver) {
    Band band(Model::kLine, false);
    band.level = 1e-17;
    ASSERT_EQ(band.Confidence(Model::kLine), 0);
    EXPECT_LT(band.upper[0], band.lower[0]) << "the quantile is the lower end of a bisection";
    EXPECT_GT(band.deltas[0], -1e-4);
}

TEST_F(FitBounds, TheyAreRefusedInOrder) {
    for (const Model model : kModels) {
        const int q = model == Model::kGaussian ? 3 : 2;
        const bool confidence[] = {true, false};
        for (const bool of_curve : confidence) {
            SCOPED_TRACE(NameOf(model));
            const auto expect = [&](Band band, int32_t status) {
                EXPECT_EQ(of_curve ? band.Confidence(model) : band.Prediction(model), status);
                EXPECT_TRUE(band.upper.empty() && band.lower.empty());
                if (of_curve) band.ExpectFailed(q);
            };
            const auto spoiled = [&](auto spoil) {
                Band band(model, true);
                spoil(band);
                return band;
            };
            expect(spoiled([&](Band& b) {
                       b.y.resize(static_cast<size_t>(q));
                       b.x.resize(1);
                   }),
                   q == 3 ? kTooFewForGaussian : kFewerThanThree);
            expect(spoiled([](Band& b) { b.x.pop_back(); }), kSizesDiffer);
            expect(spoiled([](Band& b) { b.w.pop_back(); }), kSizesDiffer);
            if (model == Model::kLog) {
                for (const double base : {0.0, -1.0, kNaN})
                    expect(spoiled([&](Band& b) {
                               b.base = base;
                               b.coef[0] = kNaN;
                           }),
                           kNotPositive);
            }
            for (const double bad : {kNaN, kInfinity, 1.7976931348623157e308})
                for (size_t j = 0; j < static_cast<size_t>(q); ++j)
                    expect(spoiled([&](Band& b) {
                               b.coef[j] = bad;
                               b.level = 0.0;
                           }),
                           kNotFinite);
            if (q == 3)
                expect(spoiled([](Band& b) {
                           b.coef[2] = 0.0;
                           b.level = 7.0;
                       }),
                       kZeroSigma);
            for (const double level : {0.0, 1.0, -0.5, 2.0, kNaN})
                expect(spoiled([&](Band& b) { b.level = level; }), kBadProbability);
            expect(spoiled([](Band& b) { b.x[2] = kNaN; }), kNotFinite);
        }
    }
}

struct Goodness {
    double sse = -9, r_square = -9, rmse = -9;
    int32_t Run(const Values& y, const Values& fit, const Values& w, int32_t dof) {
        return GoodnessOfFit_head(HostArray<double>(y).handle(), HostArray<double>(fit).handle(),
                                  HostArray<double>(w).handle(), dof, &sse, &r_square, &rmse);
    }
};

TEST_F(FitBounds, GoodnessIsThatOfRegression) {
    const Values y{1, 3, 2, 6, 9}, fit{1, 15.0 / 7, 23.0 / 7, 39.0 / 7, 9};
    Goodness g;
    ASSERT_EQ(g.Run(y, fit, {}, 0), 0);  // by hand
    EXPECT_THAT(g.sse, Near(18.0 / 7, 1e-13));
    EXPECT_THAT(g.rmse, Near(std::sqrt(6.0 / 7), 1e-13));
    EXPECT_THAT(g.r_square, Near(1 - 18.0 / 7 / 42.8, 1e-13));
    ASSERT_EQ(g.Run(y, fit, {}, 4), 0);
    EXPECT_THAT(g.rmse, Near(std::sqrt(9.0 / 14), 1e-13));
    for (const int32_t dof : {0, -3}) {
        Goodness again;
        ASSERT_EQ(again.Run(y, fit, {}, dof), 0);
        EXPECT_THAT(again.rmse, Near(std::sqrt(6.0 / 7), 1e-13));
    }
    const Values w{2, 1, -1, 3, 1};
    ASSERT_EQ(g.Run(y, fit, w, 0), 0);
    double errors = 0, total = 0;
    for (size_t i = 0; i < y.size(); ++i) {
        errors += w[i] * (y[i] - fit[i]) * (y[i] - fit[i]);
        total += w[i] * (y[i] - 4.2) * (y[i] - 4.2);
    }
    EXPECT_THAT(g.sse, Near(errors, 1e-12)) << "weights have their sign";
    EXPECT_THAT(g.r_square, Near(1 - errors / total, 1e-12)) << "about the plain mean";
}

TEST_F(FitBounds, GoodnessOfConstantData) {
    Goodness g;
    ASSERT_EQ(g.Run({2, 2, 2}, {2, 2, 2}, {}, 0), 0);
    EXPECT_EQ(g.r_square, 1.0);
    EXPECT_EQ(g.rmse, 0.0);
    ASSERT_EQ(g.Run({2, 2, 2}, {2, 2, 3}, {}, 0), 0);
    EXPECT_EQ(g.r_square, kInfinity);
    EXPECT_EQ(g.sse, 1.0);
    ASSERT_EQ(g.Run({1, 2}, {1, 3}, {}, 0), 0);
    EXPECT_EQ(g.rmse, kInfinity) << "no degree of freedom";
    ASSERT_EQ(g.Run({1, 2}, {1, 2}, {}, 0), 0);
    EXPECT_TRUE(std::isnan(g.rmse));
}

TEST_F(FitBounds, GoodnessIsRefusedInOrder) {
    const auto expect = [](const Values& y, const Values& fit, const Values& w, int32_t dof, int32_t status) {
        Goodness g;
        EXPECT_EQ(g.Run(y, fit, w, dof), status);
        for (const double value : {g.sse, g.r_square, g.rmse}) EXPECT_TRUE(IsQuietNaN(value));
    };
    expect({}, {1}, {}, 9, kEmptyInput);
    expect({1}, {1, 2}, {}, 9, kSizesDiffer);
    expect({1}, {1}, {1, 2}, 9, kSizesDiffer);
    expect({1}, {1}, {}, 9, kFewerThanTwo);
    expect({1, 2, 3}, {1, 2, 3}, {}, 3, kBadFreedom);
}

}  // namespace
}  // namespace krnumer
