// Lines, polynomials and general linear models, through their exports.

#include "krnumer/linear_fit.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "fit/nist.h"
#include "frame/numeric.h"
#include "frame/status.h"
#include "support/host_arrays.h"

namespace krnumer {
namespace {

using testing::ElementsAre;
using Values = std::vector<double>;

class LinearFits : public testing::Test {
  protected:
    LeakCheck leaks_;
    HostArray<double> fit_{9}, coef_{9};
    HostMatrix<double> covariance_{1, 1, {9.0}};
    double slope_ = -9, intercept_ = -9, mse_ = -9;
    int32_t err_ = 77;

    int32_t Line(Values& y, const Values& x, const Values& w = {}) {
        HostArray<double> ordinates(y);
        const int32_t status = LinFit_head(ordinates.handle(), HostArray<double>(x).handle(),
                                           HostArray<double>(w).handle(), &slope_, &intercept_, &mse_);
        y = ordinates.values();
        return status;
    }
    int32_t Polynomial(const Values& x, const Values& y, int32_t order, int32_t method) {
        return PolyFit_head(HostArray<double>(x).handle(), HostArray<double>(y).handle(), order, method, fit_.handle(),
                            coef_.handle(), &mse_);
    }
    int32_t Polynomial81(const Values& x, const Values& y, int32_t order, const Values& w, int32_t method,
                         const std::vector<int32_t>& powers, const Values& values) {
        return PolyFit81_head(HostArray<double>(x).handle(), HostArray<double>(y).handle(), order,
                              HostArray<double>(w).handle(), method, HostArray<int32_t>(powers).handle(),
                              HostArray<double>(values).handle(), fit_.handle(), coef_.handle(), &mse_);
    }
    int32_t General(const HostMatrix<double>& h, const Values& y, const Values& w, int32_t method,
                    int32_t want_covariance, bool sigmas = false) {
        return (sigmas ? GenLSFit_head : GenLSFit80_head)(h.handle(), HostArray<double>(y).handle(),
                                                          HostArray<double>(w).handle(), method, want_covariance,
                                                          coef_.handle(), fit_.handle(), covariance_.handle(), &mse_);
    }
    void ExpectFailed() const {
        EXPECT_TRUE(fit_.empty());
        EXPECT_TRUE(coef_.empty());
        EXPECT_TRUE(IsQuietNaN(mse_));
    }
};

const Values kX{0, 1, 2, 4, 7};
const Values kY{1, 3, 2, 6, 9};

TEST_F(LinearFits, LinesAreThoseOfLeastSquares) {
    Values y = kY;
    ASSERT_EQ(Line(y, kX), 0);  // numpy.polyfit
    EXPECT_NEAR(slope_, 8.0 / 7.0, 1e-14);
    EXPECT_NEAR(intercept_, 1.0, 1e-14);
    EXPECT_NEAR(mse_, 18.0 / 35.0, 1e-14);
    for (size_t i = 0; i < y.size(); ++i) EXPECT_EQ(y[i], slope_ * kX[i] + intercept_);

    const Values w{1, -2, 1, 3, 0.5};
    Values weighted = kY;
    ASSERT_EQ(Line(weighted, kX, w), 0);
    double residual = 0.0;
    double moment = 0.0;
    double sum = 0.0;
    for (size_t i = 0; i < w.size(); ++i) {  // the normal equations
        const double r = kY[i] - weighted[i];
        residual += std::fabs(w[i]) * r;
        moment += std::fabs(w[i]) * r * kX[i];
        sum += std::fabs(w[i]) * r * r;
    }
    EXPECT_NEAR(residual, 0.0, 1e-13);
    EXPECT_NEAR(moment, 0.0, 1e-13);
    EXPECT_NEAR(mse_, sum / 5, 1e-14) << "over the number of points, not the sum of the weights";
}

TEST_F(LinearFits, LinesThroughTwoPointsAreExact) {
    Values y{1, 4};
    ASSERT_EQ(Line(y, {2, 3}), 0);
    EXPECT_NEAR(slope_, 3.0, 1e-15);
    EXPECT_NEAR(intercept_, -5.0, 1e-14);
    EXPECT_NEAR(mse_, 0.0, 1e-14);
    Values one{1};
    EXPECT_EQ(Line(one, {1}), kFewerThanTwo);
    EXPECT_TRUE(one.empty());
    for (const double value : {slope_, intercept_, mse_}) EXPECT_TRUE(IsQuietNaN(value));
}

TEST_F(LinearFits, LinesTakeWeightsInAnyUnit) {
    Values y = kY;
    ASSERT_EQ(Line(y, kX), 0);
    const double slope = slope_;
    for (const double unit : {1e200, 1e-200, 7.0}) {
        Values again = kY;
        ASSERT_EQ(Line(again, kX, Values(5, unit)), 0);
        EXPECT_NEAR(slope_, slope, 1e-14);
    }
    Values none = kY;
    ASSERT_EQ(Line(none, kX, Values(5, 0.0)), 0) << "no weight at all is no error";
    EXPECT_TRUE(std::isnan(slope_) && std::isnan(intercept_) && std::isnan(mse_) && std::isnan(none[0]));
}

TEST_F(LinearFits, LinesWithoutSpreadAreNotFinite) {
    Values y{1, 2, 3};
    ASSERT_EQ(Line(y, {5, 5, 5}), 0);
    EXPECT_FALSE(std::isfinite(slope_));
}

TEST_F(LinearFits, LineCoefficientsAreThoseOfTheLine) {
    HostArray<double> x(kX);
    HostArray<double> y(kY);
    HostArray<double> w{1, 2, 1, 3, 0.5};
    HostArray<double> none;
    Values fitted = kY;
    ASSERT_EQ(Line(fitted, kX, w.values()), 0);
    double slope = -9;
    double intercept = -9;
    EXPECT_EQ(LinFitCoef80_head(y.handle(), x.handle(), w.handle(), &slope, &intercept, &err_), 0);
    EXPECT_EQ(err_, 0);
    EXPECT_EQ(slope, slope_);
    EXPECT_EQ(intercept, intercept_);
    EXPECT_EQ(y.values(), kY) << "y is not replaced";
    fitted = kY;
    ASSERT_EQ(Line(fitted, kX), 0);
    EXPECT_EQ(LinFitCoef_head(y.handle(), x.handle(), &slope, &intercept, &err_), 0);
    EXPECT_EQ(slope, slope_);
    EXPECT_EQ(LinFitCoef80_head(y.handle(), x.handle(), none.handle(), &slope, &intercept, &err_), 0);
    EXPECT_EQ(slope, slope_);
}

TEST_F(LinearFits, LinesCheckTheirSizes) {
    Values y = kY;
    EXPECT_EQ(Line(y, {1, 2}), kSizesDiffer);
    EXPECT_TRUE(y.empty());
    y = kY;
    EXPECT_EQ(Line(y, kX, {1}), kSizesDiffer);
    HostArray<double> five(kX);
    HostArray<double> two{1, 2};
    EXPECT_EQ(LinFitCoef_head(five.handle(), two.handle(), &slope_, &intercept_, &err_), 0);
    EXPECT_EQ(err_, kSizesDiffer);
    EXPECT_TRUE(IsQuietNaN(slope_) && IsQuietNaN(intercept_));
    EXPECT_EQ(LinFitCoef80_head(five.handle(), five.handle(), two.handle(), &slope_, &intercept_, &err_), 0);
    EXPECT_EQ(err_, kSizesDiffer);
}

TEST_F(LinearFits, PolynomialsGoThroughTheirPoints) {
    const auto quartic = [](double x) { return (((0.5 * x - 1) * x + 2) * x - 3) * x + 4; };
    Values y;
    for (const double x : kX) y.push_back(quartic(x));
    for (int32_t method = 0; method <= 6; ++method) {
        ASSERT_EQ(Polynomial(kX, y, 4, method), 0) << method;
        const Values expected{4, -3, 2, -1, 0.5};
        for (int32_t p = 0; p <= 4; ++p) EXPECT_NEAR(coef_[p], expected[static_cast<size_t>(p)], 1e-6) << method;
        EXPECT_NEAR(mse_, 0.0, 1e-8);
        EXPECT_EQ(fit_.size(), 5);
    }
    EXPECT_EQ(Polynomial(kX, y, 5, 0), kUnderdetermined);
    ExpectFailed();
    EXPECT_EQ(Polynomial(kX, y, -1, 99), kNegativeOrder);
    EXPECT_EQ(Polynomial(kX, {1}, -1, 99), kSizesDiffer);
    for (const int32_t method : {-1, 7, 99}) EXPECT_EQ(Polynomial(kX, y, 2, method), kBadSelector);
    ExpectFailed();
}

TEST_F(LinearFits, PolynomialsKeepFixedCoefficients) {
    const Values w{1, 2, 1, 3, 0.5};
    for (int32_t method = 0; method <= 6; ++method) {
        ASSERT_EQ(Polynomial81(kX, kY, 3, w, method, {1, 9, 1, -2}, {7, 0, 0.25, 0}), 0);
        EXPECT_EQ(coef_[1], 0.25) << "the last value of a power counts, and powers out of range do not";
        Values reduced;
        for (size_t i = 0; i < kX.size(); ++i) reduced.push_back(kY[i] - 0.25 * kX[i]);
        HostMatrix<double> h(5, 3);
        for (int32_t i = 0; i < 5; ++i) {
            const double x = kX[static_cast<size_t>(i)];
            h.Set(i, 0, 1.0);
            h.Set(i, 1, x * x);
            h.Set(i, 2, x * x * x);
        }
        const Values coef = coef_.values();
        const double mse = mse_;
        ASSERT_EQ(General(h, reduced, w, method, 0), 0);
        EXPECT_NEAR(coef[0], coef_[0], 1e-12);
        EXPECT_NEAR(coef[2], coef_[1], 1e-12);
        EXPECT_NEAR(coef[3], coef_[2], 1e-12);
        EXPECT_NEAR(mse, mse_, 1e-12);
    }
}

TEST_F(LinearFits, PolynomialsFixedThroughoutSolveNothing) {
    ASSERT_EQ(Polynomial81(kX, kY, 1, {}, 99, {0, 1}, {1, 2}), 0) << "the method is not looked at";
    EXPECT_THAT(coef_.values(), ElementsAre(1, 2));
    EXPECT_THAT(fit_.values(), ElementsAre(1, 3, 5, 9, 15));
    EXPECT_NEAR(mse_, (0 + 0 + 9 + 9 + 36) / 5.0, 1e-14);
    EXPECT_EQ(Polynomial81({}, {}, 1, {}, 0, {0, 1}, {1, 2}), kEmptyInput);
    ExpectFailed();
    EXPECT_EQ(Polynomial81({1}, {1}, 2, {}, 0, {1}, {1, 2}), kSizesDiffer);
    EXPECT_EQ(Polynomial81({1}, {1}, 2, {1, 2}, 0, {1}, {1}), kSizesDiffer);
    EXPECT_EQ(Polynomial81({1}, {1}, 2, {}, 0, {1}, {1}), kUnderdetermined);
    EXPECT_EQ(Polynomial81({1}, {1}, 2, {}, 0, {1, 1}, {1, 1}), kUnderdetermined)
        << "repeated powers pass the first check and leave too many unknowns";
}

// Digits of the worst coefficient that the methods reach on the problems; the normal equations square their condition.
TEST_F(LinearFits, ReachTheDigitsOfTheirMethod) {
    struct Case {
        const char* name;
        int32_t order;  // of the polynomial; 0: the columns as they are
        bool constant;
        double svd, qr, lu, cholesky;  // negative: a status
    };
    const Case cases[] = {{"Norris", 1, true, 11.8, 11.1, 11.1, 11.3},
                          {"Pontius", 2, true, 3.9, 11.7, 10.2, kNotPositiveDefinite},
                          {"NoInt1", 0, false, 13.7, 13.8, 13.7, 13.7},
                          {"NoInt2", 0, false, 14, 14, 14, 14},
                          {"Filip", 10, true, 1.6, 6.9, -1, kNotPositiveDefinite},
                          {"Longley", 0, true, 8.4, 9.9, 6.4, 6.2},
                          {"Wampler1", 5, true, 8.1, 8.6, 5.9, 5.3},
                          {"Wampler2", 5, true, 8.8, 12.1, 8.4, 8.1},
                          {"Wampler3", 5, true, 5.3, 8.0, 5.9, 5.3},
                          {"Wampler4", 5, true, 3.3, 6.8, 5.9, 5.3},
                          {"Wampler5", 5, true, 1.3, 4.8, 5.9, 5.3}};
    for (const Case& one : cases) {
        const Certified set = LoadCertified(one.name);
        const auto rows = static_cast<int32_t>(set.y.size());
        const auto columns = static_cast<int32_t>(set.coef.size());
        HostMatrix<double> h(rows, columns);
        for (int32_t i = 0; i < rows; ++i) {
            double power = 1.0;
            for (int32_t j = 0; j < columns; ++j) {
                const auto row = static_cast<size_t>(i);
                if (one.order > 0) {
                    h.Set(i, j, power);
                    power *= set.x[0][row];
                } else {
                    h.Set(i, j, one.constant && j == 0 ? 1.0 : set.x[static_cast<size_t>(j) - one.constant][row]);
                }
            }
        }
        const auto expect = [&](int32_t method, double digits) {
            const int32_t status = General(h, set.y, {}, method, 0);
            if (digits < -1.0) {
                EXPECT_EQ(status, static_cast<int32_t>(digits)) << one.name << " method " << method;
                return;
            }
            ASSERT_EQ(status, 0) << one.name << " method " << method;
            EXPECT_GE(CorrectDigits(coef_.values(), set.coef), digits) << one.name << " method " << method;
        };
        expect(0, one.svd);
        for (const int32_t method : {1, 2, 3}) expect(method, one.qr);
        expect(4, one.lu);
        expect(5, one.cholesky);
    }
}

TEST_F(LinearFits, GeneralModelsWithWeightsAgreeWithCertifiedDeviations) {
    const Certified set = LoadCertified("Longley");
    HostMatrix<double> h(16, 7);
    for (int32_t i = 0; i < 16; ++i)
        for (int32_t j = 0; j < 7; ++j)
            h.Set(i, j, j == 0 ? 1.0 : set.x[static_cast<size_t>(j - 1)][static_cast<size_t>(i)]);
    ASSERT_EQ(General(h, set.y, {}, 0, 1), 0);
    for (int32_t j = 0; j < 7; ++j) {
        const double deviation = std::sqrt(covariance_(j, j) * set.rss / (16 - 7));
        EXPECT_NEAR(deviation / set.deviations[static_cast<size_t>(j)], 1.0, 1e-6);
    }
}

TEST_F(LinearFits, MethodsAgreeOnWeightedData) {
    HostMatrix<double> h(6, 3, {1, 0, 0, 1, 1, 1, 1, 2, 4, 1, 3, 9, 1, 4, 16, 1, 5, 25});
    const Values y{1, 3, 2, 5, 7, 6};
    const Values w{1, -2, 1, 1, 2, 0.5};
    ASSERT_EQ(General(h, y, w, 0, 1), 0);
    const Values coef = coef_.values();
    const Values covariance = covariance_.values();
    const double mse = mse_;
    for (int32_t method = 1; method <= 6; ++method) {
        ASSERT_EQ(General(h, y, w, method, 1), 0);
        for (size_t i = 0; i < 3; ++i) EXPECT_NEAR(coef_.values()[i], coef[i], 1e-12) << method;
        for (size_t i = 0; i < 9; ++i) EXPECT_NEAR(covariance_.values()[i], covariance[i], 1e-12) << method;
        EXPECT_NEAR(mse_, mse, 1e-13);
    }
    ASSERT_EQ(General(h, y, w, 1, 1), 0);
    const Values qr = coef_.values();
    for (const int32_t method : {2, 3}) {
        ASSERT_EQ(General(h, y, w, method, 1), 0);
        EXPECT_EQ(coef_.values(), qr) << "three names of one code";
    }
    // Standard deviations become weights of 1 / sigma^2; 0 stands for a weight of 1, and a longer array is not read to
    // its end.
    ASSERT_EQ(General(h, y, {1, 0.25, 1, 1, 4, 1}, 0, 1), 0);
    const Values by_weight = coef_.values();
    ASSERT_EQ(General(h, y, {1, -2, 0, 1, 0.5, 1, 77}, 0, 1, true), 0);
    EXPECT_EQ(coef_.values(), by_weight);
}

TEST_F(LinearFits, GeneralModelsCheckInOrder) {
    HostMatrix<double> h(3, 2, {1, 0, 1, 1, 1, 2});
    const Values y{1, 2, 4};
    EXPECT_EQ(General(h, {1, 2}, {}, 99, 1), kSizesDiffer);
    ExpectFailed();
    EXPECT_TRUE(covariance_.empty());
    EXPECT_EQ(General(h, y, {1, 2}, 99, 1), kSizesDiffer);
    EXPECT_EQ(General(HostMatrix<double>(3, 0), y, {}, 99, 1), kBadOrder);
    EXPECT_EQ(General(HostMatrix<double>(1, 2, {1, 2}), {1}, {}, 99, 1), kUnderdetermined);
    for (const int32_t method : {7, -1}) EXPECT_EQ(General(h, y, {}, method, 1), kBadSelector);
    ExpectFailed();
    ASSERT_EQ(General(h, y, {}, 0, 0), 0);
    EXPECT_TRUE(covariance_.empty()) << "not wanted";
    for (const int32_t nth : {1, 2, 3}) {
        const FailResize fail(nth, 4711);
        EXPECT_EQ(General(h, y, {}, 0, 1), kOutOfMemory);
        ExpectFailed();
    }
}

TEST_F(LinearFits, OnlySingularValuesTakeRankDeficientData) {
    HostMatrix<double> h(3, 2, {1, 1, 2, 2, 4, 4});
    const Values y{2, 4, 8};
    for (const int32_t method : {0, 6}) EXPECT_EQ(General(h, y, {}, method, 0), 0);
    EXPECT_NEAR(coef_[0], 1.0, 1e-14);
    EXPECT_NEAR(coef_[1], 1.0, 1e-14);
    EXPECT_EQ(General(h, y, {}, 4, 0), kSingular);
    EXPECT_EQ(General(h, y, {}, 5, 0), kNotPositiveDefinite);
    HostMatrix<double> zero(3, 2);
    EXPECT_EQ(General(zero, y, {}, 3, 0), kSingular);
}

TEST_F(LinearFits, TreatNaNAsTheirMethodDoes) {
    HostMatrix<double> h(3, 2, {1, 0, 1, kQuietNaN, 1, 2});
    const Values y{1, 2, 4};
    for (const int32_t method : {0, 5, 6}) EXPECT_EQ(General(h, y, {}, method, 0), kNotFinite) << method;
    for (const int32_t method : {1, 2, 3}) {
        EXPECT_EQ(General(h, y, {}, method, 0), 0);
        EXPECT_EQ(General(h, y, {}, method, 1), kNotFinite) << "the covariance tests for it";
    }
    EXPECT_EQ(General(h, y, {}, 4, 0), kSingular);
    EXPECT_EQ(General(h, y, {}, 4, 1), kNotFinite);
    HostMatrix<double> good(3, 2, {1, 0, 1, 1, 1, 2});
    for (const int32_t method : {0, 1, 2, 3, 4, 6}) {
        EXPECT_EQ(General(good, {1, kQuietNaN, 2}, {}, method, 0), 0);
        EXPECT_TRUE(std::isnan(coef_[0]));
    }
    EXPECT_EQ(General(good, {1, kQuietNaN, 2}, {}, 5, 0), kNotFinite);
}

// Enough rows that the solvers see the triangle of the system instead of it.
class LongSystems : public LinearFits {
  protected:
    static constexpr int32_t kRows = 10007;  // the last block is not full
    static constexpr double kTruth[] = {3.0, -2.0, 0.5};

    static double Basis(int32_t i, int32_t j) { return std::cos(0.001 * i * j); }

    LongSystems() : h_(kRows, 3), y_(kRows), w_(kRows) {
        for (int32_t i = 0; i < kRows; ++i) {
            double sum = 0.0;
            for (int32_t j = 0; j < 3; ++j) {
                h_.Set(i, j, Basis(i, j));
                sum += kTruth[j] * Basis(i, j);
            }
            // Blunders have no weight: with the weights the coefficients are exact.
            w_[Count(i)] = i % 3 == 0 ? 0.0 : i % 2 == 0 ? 2.0 : -0.25;
            y_[Count(i)] = i % 3 == 0 ? 1e3 * std::sin(i) : sum;
        }
    }

    HostMatrix<double> h_;
    Values y_, w_;
};

TEST_F(LongSystems, HaveTheCoefficientsAndTheCovarianceOfTheirRows) {
    double information[3][3] = {};
    for (int32_t i = 0; i < kRows; ++i)
        for (int32_t j = 0; j < 3; ++j)
            for (int32_t l = 0; l < 3; ++l) information[j][l] += std::fabs(w_[Count(i)]) * Basis(i, j) * Basis(i, l);
    for (int32_t method = 0; method <= 6; ++method) {
        ASSERT_EQ(General(h_, y_, w_, method, 1), 0);
        ASSERT_EQ(coef_.size(), 3);
        for (int32_t j = 0; j < 3; ++j) EXPECT_NEAR(coef_[j], kTruth[j], 2e-13) << method;
        for (int32_t j = 0; j < 3; ++j) {
            for (int32_t l = 0; l < 3; ++l) {
                double product = 0.0;
                for (int32_t k = 0; k < 3; ++k) product += information[j][k] * covariance_(k, l);
                EXPECT_NEAR(product, j == l, 1e-11) << method;
            }
        }
        EXPECT_EQ(fit_.size(), kRows);
        EXPECT_NEAR(fit_[1], kTruth[0] + kTruth[1] * Basis(1, 1) + kTruth[2] * Basis(1, 2), 1e-12);
        EXPECT_NEAR(mse_, 0.0, 1e-12);
    }
}

TEST_F(LongSystems, WithoutWeightsAgreeWithTheNormalEquations) {
    ASSERT_EQ(General(h_, y_, {}, 4, 0), 0);
    const Values normal = coef_.values();
    for (const int32_t method : {0, 1, 6}) {
        ASSERT_EQ(General(h_, y_, {}, method, 0), 0);
        for (size_t j = 0; j < 3; ++j) EXPECT_NEAR(coef_.values()[j], normal[j], 1e-10) << method;
    }
}

TEST_F(LongSystems, ShowWhatCannotBeUsed) {
    const double largest = std::numeric_limits<double>::max();
    for (const double value : {kQuietNaN, kInfinity, largest, -largest}) {
        for (const int32_t column : {0, 2}) {
            h_.Set(kRows - 1, column, value);
            for (const int32_t method : {0, 6}) EXPECT_EQ(General(h_, y_, {}, method, 0), kNotFinite);
            EXPECT_EQ(General(h_, y_, {}, 3, 0), 0) << "not looked at";
            h_.Set(kRows - 1, column, 1.0);
        }
    }
    for (int32_t i = 0; i < kRows; ++i) h_.Set(i, 1, 0.0);
    EXPECT_EQ(General(h_, y_, {}, 3, 0), kSingular);
    for (const int32_t method : {0, 6}) EXPECT_EQ(General(h_, y_, {}, method, 0), 0);
    EXPECT_EQ(coef_[1], 0.0);
    y_[5] = kQuietNaN;
    EXPECT_EQ(General(h_, y_, {}, 0, 0), 0);
    EXPECT_TRUE(std::isnan(coef_[0]));
}

TEST_F(LinearFits, StepsOfANonlinearFit) {
    HostArray<double> coef{1, 2};
    HostMatrix<double> hessian(2, 2, {4, 1, 1, 3});
    HostArray<double> gradient{1, -1};
    double lambda = 0.5;  // 6 a + b = 1, a + 4.5 b = -1
    EXPECT_EQ(GetNewCoef_head(coef.handle(), hessian.handle(), gradient.handle(), &lambda, &err_), 0);
    EXPECT_EQ(err_, 0);
    EXPECT_NEAR(coef[0], 1 + 5.5 / 26, 1e-14);
    EXPECT_NEAR(coef[1], 2 - 7.0 / 26, 1e-14);

    HostMatrix<double> deficient(2, 2, {1, 1, 1, 1});
    HostArray<double> again{1, 2};
    lambda = 0.0;
    EXPECT_EQ(GetNewCoef_head(again.handle(), deficient.handle(), HostArray<double>{2, 2}.handle(), &lambda, &err_), 0);
    EXPECT_EQ(err_, 0) << "a rank-deficient hessian has a step, too";
    EXPECT_NEAR(again[0], 2.0, 1e-14);
}

TEST_F(LinearFits, StepsCheckTheirData) {
    const auto step = [this](const Values& coef, const HostMatrix<double>& hessian, const Values& gradient,
                             double lambda) {
        HostArray<double> coefficients(coef);
        EXPECT_EQ(GetNewCoef_head(coefficients.handle(), hessian.handle(), HostArray<double>(gradient).handle(),
                                  &lambda, &err_),
                  0);
        EXPECT_TRUE(coefficients.empty());
        return err_;
    };
    const HostMatrix<double> two(2, 2, {4, 1, 1, 3});
    EXPECT_EQ(step({}, two, {1, 1}, 0.0), kEmptyInput);
    EXPECT_EQ(step({1}, two, {1}, 0.0), kEmptyInput);
    EXPECT_EQ(step({1, 2}, two, {1}, 0.0), kEmptyInput);
    EXPECT_EQ(step({1, 2}, HostMatrix<double>(2, 3), {1, 1}, 0.0), kEmptyInput);
    EXPECT_EQ(step({1, 2}, two, {1, 1}, kInfinity), kNotFinite);
    EXPECT_EQ(step({1, 2}, two, {1, kQuietNaN}, 0.0), kNotFinite);
    EXPECT_EQ(step({1, kQuietNaN}, two, {1, 1}, 0.0), kSingular);
}

}  // namespace
}  // namespace krnumer
