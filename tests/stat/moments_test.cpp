#include "stat/moments.h"

#include <limits>

#include "frame/status.h"
#include "stat/samples.h"
#include "support/numbers.h"

namespace krnumer {
namespace {

using Samples = std::vector<double>;

// Bound of the relative rounding error of a sum of n terms and its quotient, to be multiplied by the mean magnitude.
double SumError(int32_t n) {
    return (n + 1) * kEpsilon;
}

double MeanMagnitude(const Samples& samples, double center, int32_t order) {
    double sum = 0.0;
    for (const double x : samples) sum += std::pow(std::fabs(x - center), order);
    return sum / Size(samples);
}

double MeanOf(const Samples& samples) {
    double mean = -99.0;
    EXPECT_EQ(Mean(samples.data(), Size(samples), &mean), kOk);
    return mean;
}

double MomentOf(const Samples& samples, int32_t order) {
    double moment = -99.0;
    EXPECT_EQ(Moment(samples.data(), Size(samples), order, &moment), kOk);
    return moment;
}

// What rounding can do to a central moment: the sum itself, and every deviation through the error of the mean.
double MomentError(const Samples& samples, int32_t order) {
    const double mean = MeanOf(samples);
    const int32_t n = Size(samples);
    return (SumError(n) + order * kEpsilon) * MeanMagnitude(samples, mean, order) +
           order * (SumError(n) + kEpsilon) * MeanMagnitude(samples, 0.0, 1) * MeanMagnitude(samples, mean, order - 1);
}

TEST(Mean, RefusesEmptyData) {
    double mean = 5.0;
    EXPECT_EQ(Mean(&mean, 0, &mean), kEmptyInput);
    EXPECT_EQ(Mean(&mean, std::numeric_limits<int32_t>::min(), &mean), kEmptyInput);
    EXPECT_EQ(mean, 5.0);
}

TEST(Mean, IsARunningSumInOrder) {
    EXPECT_EQ(MeanOf({3}), 3.0);
    EXPECT_EQ(MeanOf({1, 2, 4, 9}), 4.0);
    EXPECT_EQ(MeanOf({1e16, 1, -1e16, 1}), 0.25);  // the first 1 is lost
    EXPECT_EQ(MeanOf({1e308, 1e308, -1e308, -1e308}), kInfinity);
}

TEST(Mean, CarriesNaNAndInfinity) {
    EXPECT_TRUE(std::isnan(MeanOf({1, kQuietNaN, 3})));
    EXPECT_TRUE(std::isnan(MeanOf({kInfinity, -kInfinity})));
    EXPECT_EQ(MeanOf({1, -kInfinity}), -kInfinity);
}

TEST(Mean, AgreesWithExactArithmetic) {
    for (const auto& [set, parameter, values] : GoldenResults("mean")) {
        const Samples& samples = GoldenSamples().at(set);
        EXPECT_THAT(MeanOf(samples), Near(values[0], 0.0, SumError(Size(samples)) * MeanMagnitude(samples, 0.0, 1)))
            << set;
    }
}

TEST(Moment, ChecksTheDataBeforeTheOrder) {
    const double x = 1.0;
    double moment = 5.0;
    EXPECT_EQ(Moment(&x, 0, 0, &moment), kEmptyInput);
    EXPECT_EQ(Moment(&x, 1, 0, &moment), kBadOrder);
    EXPECT_EQ(Moment(&x, 1, std::numeric_limits<int32_t>::min(), &moment), kBadOrder);
    EXPECT_EQ(moment, 5.0);
}

TEST(Moment, OfSimpleData) {
    EXPECT_EQ(MomentOf({1, 3}, 2), 1.0);
    EXPECT_EQ(MomentOf({1, 3}, 3), 0.0);
    EXPECT_EQ(MomentOf({0, 0, 3}, 3), 2.0);
    EXPECT_EQ(MomentOf({7}, 2), 0.0);
    EXPECT_TRUE(std::isnan(MomentOf({1, kQuietNaN}, 2)));
    EXPECT_TRUE(std::isnan(MomentOf({1, kInfinity}, 2)));
}

TEST(Moment, OfOrderOneIsTheRoundingErrorOfTheMean) {
    const Samples samples{0.1, 0.2, 0.3, 0.4, 0.6, 0.7};
    const double mean = MeanOf(samples);
    double sum = 0.0;
    for (const double x : samples) sum += x - mean;
    ASSERT_NE(sum, 0.0);
    EXPECT_EQ(MomentOf(samples, 1), sum / 6);
}

TEST(Moment, AgreesWithExactArithmetic) {
    for (const auto& [set, parameter, values] : GoldenResults("moment")) {
        const Samples& samples = GoldenSamples().at(set);
        const int32_t order = std::stoi(parameter);
        EXPECT_THAT(MomentOf(samples, order), Near(values[0], 0.0, MomentError(samples, order)))
            << set << ", order " << order;
    }
}

// The shortcut for powers that stand still must not change a bit.
TEST(Moment, IsTheSameAsByPlainMultiplicationAtAnyOrder) {
    for (const double deviation : {0.0, 1e-200, 0.25, 0.7, 0.999, 1.0, 1.5, 1e200}) {
        const Samples samples{-deviation, deviation, -deviation, deviation + 3.0 * deviation};
        for (const int32_t order : {1, 2, 3, 4, 7, 100, 1001, 5000, 5001}) {
            const double mean = MeanOf(samples);
            double sum = 0.0;
            for (const double x : samples) {
                double power = x - mean;
                for (int32_t k = 1; k < order; ++k) power *= x - mean;
                sum += power;
            }
            const double moment = MomentOf(samples, order);
            if (std::isnan(sum)) {
                EXPECT_TRUE(std::isnan(moment)) << deviation << ", order " << order;
            } else {
                EXPECT_TRUE(SameBits(moment, sum / 4)) << deviation << ", order " << order;
            }
        }
    }
}

TEST(Moment, OfTheHighestOrderEnds) {
    constexpr int32_t kHighest = std::numeric_limits<int32_t>::max();
    EXPECT_EQ(MomentOf({0, 0, 3}, kHighest), kInfinity);
    EXPECT_EQ(MomentOf({0, 0, 3}, kHighest - 1), kInfinity);
    EXPECT_EQ(MomentOf({0, 0.5}, kHighest), 0.0);
    EXPECT_EQ(MomentOf({-1, 1}, kHighest), 0.0);
    EXPECT_TRUE(std::isnan(MomentOf({kQuietNaN, 1}, kHighest)));
}

int32_t MseOf(const Samples& x, const Samples& y, double* mse) {
    return MeanSquareError(x.data(), Size(x), y.data(), Size(y), mse);
}

TEST(MeanSquareError, RefusesEmptyData) {
    double mse = 5.0;
    EXPECT_EQ(MseOf({}, {1}, &mse), kEmptyInput);
    EXPECT_EQ(MseOf({1}, {}, &mse), kEmptyInput);
    EXPECT_EQ(MseOf({}, {}, &mse), kEmptyInput);
    EXPECT_EQ(mse, 5.0);
}

TEST(MeanSquareError, WarnsOfDifferentLengthsAndUsesTheShorter) {
    double mse = 5.0;
    EXPECT_EQ(MseOf({1, 2}, {1, 2, 3}, &mse), kWarnSizesDiffer);
    EXPECT_EQ(mse, 0.0);
    EXPECT_EQ(MseOf({1, 2, 3, 100, 200}, {2, 2, 5}, &mse), kWarnSizesDiffer);
    EXPECT_EQ(mse, 5.0 / 3.0);
    EXPECT_EQ(MseOf({1, 2, 3}, {2, 2, 5}, &mse), kOk);
    EXPECT_EQ(mse, 5.0 / 3.0);
}

TEST(MeanSquareError, KeepsItsFormOfTheSquare) {
    double mse = 5.0;
    EXPECT_EQ(MseOf({1e8 + 0.3}, {1e8 + 0.7}, &mse), kOk);
    EXPECT_EQ(mse, 0.0);
    EXPECT_EQ(MseOf({1e8 + 0.7}, {1e8 + 0.3}, &mse), kOk);
    EXPECT_EQ(mse, 2.0);                                      // other roundings, the other way round
    EXPECT_EQ(MseOf({94906267.0}, {94906265.0}, &mse), kOk);  // both squares need 54 bits
    EXPECT_EQ(mse, (94906265.0 - 2.0 * 94906267.0) * 94906265.0 + 94906267.0 * 94906267.0);
    EXPECT_EQ(MseOf({0.0}, {1e200}, &mse), kOk);
    EXPECT_EQ(mse, kInfinity);
    EXPECT_EQ(MseOf({1e200}, {1e200}, &mse), kOk);
    EXPECT_TRUE(std::isnan(mse));
}

TEST(MeanSquareError, AgreesWithExactArithmetic) {
    for (const auto& [set, other, values] : GoldenResults("mse")) {
        const Samples& x = GoldenSamples().at(set);
        const Samples& y = GoldenSamples().at(other);
        double mse = 0.0;
        EXPECT_EQ(MseOf(x, y, &mse), x.size() == y.size() ? kOk : kWarnSizesDiffer);
        const std::size_t common = std::min(x.size(), y.size());
        double magnitude = 0.0;
        for (std::size_t i = 0; i < common; ++i) magnitude += std::pow(std::fabs(x[i]) + std::fabs(y[i]), 2);
        const auto n = static_cast<int32_t>(common);
        EXPECT_THAT(mse, Near(values[0], 0.0, (SumError(n) + 2 * kEpsilon) * magnitude / n)) << set << ", " << other;
    }
}

TEST(RootMeanSquare, OfSimpleData) {
    double rms = 5.0;
    const Samples samples{3, -4, 0, 0};
    EXPECT_EQ(RootMeanSquare(samples.data(), 0, &rms), kEmptyInput);
    EXPECT_EQ(RootMeanSquare(samples.data(), -1, &rms), kEmptyInput);
    EXPECT_EQ(rms, 5.0);
    EXPECT_EQ(RootMeanSquare(samples.data(), 4, &rms), kOk);
    EXPECT_EQ(rms, 2.5);
    EXPECT_EQ(RootMeanSquare(samples.data() + 1, 1, &rms), kOk);
    EXPECT_EQ(rms, 4.0);
}

TEST(RootMeanSquare, CarriesNaNAndOverflow) {
    double rms = 5.0;
    const Samples samples{1e200, kQuietNaN};
    EXPECT_EQ(RootMeanSquare(samples.data(), 1, &rms), kOk);
    EXPECT_EQ(rms, kInfinity);
    EXPECT_EQ(RootMeanSquare(samples.data(), 2, &rms), kOk);
    EXPECT_TRUE(std::isnan(rms));
}

TEST(RootMeanSquare, AgreesWithExactArithmetic) {
    for (const auto& [set, parameter, values] : GoldenResults("rms")) {
        const Samples& samples = GoldenSamples().at(set);
        double rms = 0.0;
        EXPECT_EQ(RootMeanSquare(samples.data(), Size(samples), &rms), kOk);
        EXPECT_THAT(rms, Near(values[0], SumError(Size(samples)))) << set;
    }
}

class CertifiedData : public ::testing::TestWithParam<const char*> {};

TEST_P(CertifiedData, MeanAndStandardDeviation) {
    const auto [samples, mean, standard_deviation] = ReadCertifiedSet(GetParam());
    const int32_t n = Size(samples);
    ASSERT_GT(n, 2);
    EXPECT_THAT(MeanOf(samples), Near(mean, 5e-15, SumError(n) * MeanMagnitude(samples, 0.0, 1)));
    const double variance = standard_deviation * standard_deviation;
    EXPECT_THAT(MomentOf(samples, 2) * n / (n - 1), Near(variance, 5e-15, 2.0 * MomentError(samples, 2)));
}

INSTANTIATE_TEST_SUITE_P(Nist, CertifiedData,
                         ::testing::Values("Lew", "Lottery", "Mavro", "Michelso", "NumAcc1", "NumAcc2", "NumAcc3",
                                           "NumAcc4"),
                         [](const auto& parameter) { return std::string(parameter.param); });

}  // namespace
}  // namespace krnumer
