#include "stat/distribution.h"

#include <gtest/gtest.h>

#include <cmath>
#include <fstream>
#include <limits>
#include <sstream>
#include <string>
#include <vector>

#include "frame/numeric.h"
#include "frame/status.h"
#include "krnumer/distributions.h"
#include "support/numbers.h"

namespace krnumer {
namespace {

constexpr int32_t kIntMax = std::numeric_limits<int32_t>::max();
constexpr int32_t kIntMin = std::numeric_limits<int32_t>::min();

struct Answer {
    double value = -1.25;
    int32_t err = 77;
};

std::ostream& operator<<(std::ostream& out, const Answer& answer) {
    return out << answer.value << " with status " << answer.err;
}

// A call with all scalars by pointer, which must return 0.
template <class... Parameters, class... Arguments>
Answer Ask(int32_t (*function)(Parameters...), Arguments... arguments) {
    Answer answer;
    EXPECT_EQ(function(&arguments..., &answer.value, &answer.err), 0);
    return answer;
}

double Normal(double x) {
    double p = -1.25;
    EXPECT_EQ(NormDist_head(&x, &p), 0);
    return p;
}

MATCHER_P(FailsWith, code, "is NaN with status " + std::to_string(code)) {
    return IsQuietNaN(arg.value) && arg.err == code;
}
MATCHER_P(Gives, value, "is " + Show(value) + " with status 0") {
    return SameBits(arg.value, value) && arg.err == kOk;
}

struct Sample {
    std::string distribution;
    int32_t n, m;
    double x, p;
};

std::vector<Sample> ReadSamples(const std::string& distribution) {
    std::vector<Sample> samples;
    std::ifstream file(KRNUMER_REFERENCE "/distributions.csv");
    for (std::string line; std::getline(file, line);) {
        std::istringstream fields(line);
        Sample sample;
        char comma;
        std::getline(fields, sample.distribution, ',');
        fields >> sample.n >> comma >> sample.m >> comma >> sample.x >> comma >> sample.p;
        EXPECT_FALSE(fields.fail()) << line;
        if (sample.distribution == distribution) samples.push_back(sample);
    }
    EXPECT_GE(samples.size(), 15u);
    return samples;
}

std::string Where(const Sample& s) {
    return s.distribution + ' ' + std::to_string(s.n) + ' ' + std::to_string(s.m) + " at " + Show(s.x);
}

// A bisection of low to high ends within 1e-4 below the quantile, or within the interval's last step at its top.
void ExpectBisected(const Answer& answer, const Sample& sample, double low, double high) {
    EXPECT_EQ(answer.err, kOk);
    const double slack = 1e-9 + 1e-8 * std::abs(sample.x);
    const double quantile = std::min(std::max(sample.x, low), high);
    EXPECT_LE(answer.value, std::max(quantile, low) + slack) << Where(sample);
    EXPECT_GE(answer.value, quantile - 1e-4 - slack) << Where(sample);
}

TEST(NormalDistribution, AgreesWithRToFiveDigits) {
    for (const Sample& s : ReadSamples("normal")) EXPECT_NEAR(Normal(s.x), s.p, 1.2e-5) << Where(s);
}

TEST(NormalDistribution, IsJustAboveOneHalfAtZero) {
    const double p = Normal(0.0);
    EXPECT_NEAR(p, 0.50000015555, 1e-11);
    EXPECT_EQ(Normal(-0.0), p);
    EXPECT_EQ(Normal(-1e-300), 1.0 - p);
}

TEST(NormalDistribution, IsSymmetric) {
    for (const double x : {0.1, 1.0, 2.5, 7.0}) EXPECT_EQ(Normal(-x), 1.0 - Normal(x));
}

TEST(NormalDistribution, TakesWhateverComes) {
    EXPECT_EQ(Normal(kInfinity), 1.0);
    EXPECT_EQ(Normal(-kInfinity), 0.0);
    EXPECT_EQ(Normal(1e200), 1.0);
    EXPECT_TRUE(std::isnan(Normal(kQuietNaN)));
}

TEST(InverseNormalDistribution, AgreesWithRToThreeDigits) {
    for (const Sample& s : ReadSamples("normal")) {
        const Answer answer = Ask(InvNdist_head, s.p);
        EXPECT_EQ(answer.err, kOk);
        EXPECT_NEAR(answer.value, s.x, 4.5e-4) << Where(s);
    }
}

TEST(InverseNormalDistribution, KnowsTheEnds) {
    EXPECT_THAT(Ask(InvNdist_head, 0.0), Gives(-kInfinity));
    EXPECT_THAT(Ask(InvNdist_head, -0.0), Gives(-kInfinity));
    EXPECT_THAT(Ask(InvNdist_head, 1.0), Gives(kInfinity));
}

TEST(InverseNormalDistribution, ChangesSidesAtOneHalf) {
    const double middle = Ask(InvNdist_head, 0.5).value;
    EXPECT_NEAR(middle, 0.0, 4.5e-4);
    EXPECT_EQ(Ask(InvNdist_head, 0.25).value, -Ask(InvNdist_head, 0.75).value);
    EXPECT_NEAR(Ask(InvNdist_head, std::nextafter(0.5, 0.0)).value, -middle, 1e-12);
}

TEST(InverseNormalDistribution, LosesTheSmallestProbabilities) {
    EXPECT_NEAR(Ask(InvNdist_head, 1e-150).value, -26.12, 0.01);
    const Answer answer = Ask(InvNdist_head, 7e-155);  // 1 / p^2 overflows
    EXPECT_TRUE(std::isnan(answer.value));
    EXPECT_EQ(answer.err, kOk);
}

TEST(InverseNormalDistribution, RefusesWhatIsNoProbability) {
    for (const double p : {-1e-300, 1.0000000000000002, kInfinity, -kInfinity, kQuietNaN}) {
        EXPECT_THAT(Ask(InvNdist_head, p), FailsWith(kBadProbability)) << p;
    }
}

TEST(TDistribution, AgreesWithR) {
    for (const Sample& s : ReadSamples("t")) {
        const Answer answer = Ask(TDist_head, s.x, s.n);
        EXPECT_EQ(answer.err, kOk);
        EXPECT_THAT(answer.value, Near(s.p, s.n > 10000 ? 1e-9 : s.n > 1000 ? 1e-11 : 1e-12, 1e-15)) << Where(s);
    }
}

TEST(TDistribution, HasClosedFormsForOneAndTwo) {
    for (const double t : {-30.0, -1.0, -0.1, 0.2, 1.0, 4.0}) {
        EXPECT_THAT(Ask(TDist_head, t, 1).value, Near(0.5 + std::atan(t) / kPi, 1e-13));
        EXPECT_THAT(Ask(TDist_head, t, 2).value, Near(0.5 + t / (2.0 * std::sqrt(2.0 + t * t)), 1e-12));
    }
}

TEST(TDistribution, IsOneHalfAtZero) {
    for (const int32_t df : {1, 2, 100, kIntMax}) {
        EXPECT_THAT(Ask(TDist_head, 0.0, df), Gives(0.5));
        EXPECT_THAT(Ask(TDist_head, -0.0, df), Gives(0.5));
    }
}

TEST(TDistribution, ReachesItsLimits) {
    EXPECT_THAT(Ask(TDist_head, kInfinity, 3), Gives(1.0));
    EXPECT_THAT(Ask(TDist_head, -kInfinity, 3), Gives(0.0));
    EXPECT_THAT(Ask(TDist_head, 1e200, 3), Gives(1.0));
    EXPECT_NEAR(Ask(TDist_head, 1.0, kIntMax).value, 0.841344746, 1e-6);
}

TEST(TDistribution, ChecksFreedomBeforeNaN) {
    for (const int32_t df : {0, -1, kIntMin}) {
        EXPECT_THAT(Ask(TDist_head, 1.0, df), FailsWith(kBadFreedom));
        EXPECT_THAT(Ask(TDist_head, kQuietNaN, df), FailsWith(kBadFreedom));
    }
    EXPECT_THAT(Ask(TDist_head, kQuietNaN, 1), FailsWith(kHoldsNaN));
}

TEST(InverseTDistribution, AgreesWithRToItsTolerance) {
    for (const Sample& s : ReadSamples("t")) ExpectBisected(Ask(InvTdist_head, s.p, s.n), s, -1e4, 1e4);
}

TEST(InverseTDistribution, GivesTheLowerEnd) {
    for (const int32_t df : {1, 7, 1000000}) EXPECT_THAT(Ask(InvTdist_head, 0.5, df), Gives(-20000.0 / 268435456.0));
}

TEST(InverseTDistribution, StopsAtTheEndsOfItsInterval) {
    EXPECT_THAT(Ask(InvTdist_head, 1e-9, 1), Gives(-10000.0));
    EXPECT_THAT(Ask(InvTdist_head, 1.0 - 1e-9, 1), Gives(10000.0 - 20000.0 / 268435456.0));
}

TEST(InverseTDistribution, KnowsTheEnds) {
    EXPECT_THAT(Ask(InvTdist_head, 0.0, 3), Gives(-kInfinity));
    EXPECT_THAT(Ask(InvTdist_head, 1.0, 3), Gives(kInfinity));
}

TEST(InverseTDistribution, ChecksFreedomBeforeProbability) {
    EXPECT_THAT(Ask(InvTdist_head, 2.0, 0), FailsWith(kBadFreedom));
    EXPECT_THAT(Ask(InvTdist_head, 0.0, kIntMin), FailsWith(kBadFreedom));
    for (const double p : {-0.1, 1.1, kQuietNaN}) {
        EXPECT_THAT(Ask(InvTdist_head, p, 1), FailsWith(kBadProbability));
    }
}

TEST(ChiSquareDistribution, AgreesWithR) {
    for (const Sample& s : ReadSamples("chi-square")) {
        const Answer answer = Ask(ChiSquare_head, s.x, s.n);
        EXPECT_EQ(answer.err, kOk);
        EXPECT_THAT(answer.value, Near(s.p, s.n > 1000 ? 1e-10 : 1e-11)) << Where(s);
    }
}

TEST(ChiSquareDistribution, IsZeroUpToZeroAndForNaN) {
    for (const double x : {0.0, -0.0, -1.0, -kInfinity, kQuietNaN}) {
        EXPECT_THAT(Ask(ChiSquare_head, x, 3), Gives(0.0)) << x;
        EXPECT_THAT(Ask(ChiSquare_head, x, 0), Gives(0.0)) << x;
    }
    EXPECT_THAT(Ask(ChiSquare_head, kInfinity, 3), Gives(1.0));
}

TEST(ChiSquareDistribution, TakesNoFreedomButKnowsNoValue) {
    const Answer answer = Ask(ChiSquare_head, 1.0, 0);
    EXPECT_TRUE(std::isnan(answer.value));
    EXPECT_EQ(answer.err, kOk);
    EXPECT_THAT(Ask(ChiSquare_head, 1.0, -1), FailsWith(kBadFreedom));
    EXPECT_THAT(Ask(ChiSquare_head, kQuietNaN, kIntMin), FailsWith(kBadFreedom));
}

TEST(ChiSquareDistribution, ReachesTheLargestFreedom) {
    EXPECT_NEAR(Ask(ChiSquare_head, 2147483647.0, kIntMax).value, 0.5, 1e-4);
}

TEST(InverseChiSquareDistribution, AgreesWithRToItsTolerance) {
    for (const Sample& s : ReadSamples("chi-square")) {
        if (s.n <= 1000) ExpectBisected(Ask(InvChiSquare_head, s.p, s.n), s, 0.0, kInfinity);
    }
}

TEST(InverseChiSquareDistribution, GrowsItsInterval) {
    for (const Sample& s : ReadSamples("chi-square")) {
        if (s.n <= 1000) continue;
        EXPECT_THAT(Ask(InvChiSquare_head, s.p, s.n).value, Near(s.x, 1e-6)) << Where(s);
    }
    // 5000, 10000 and on: the interval of the bisection and so the steps follow.
    const double x = Ask(InvChiSquare_head, 0.5, 12000).value;
    EXPECT_EQ(std::fmod(x * 268435456.0, 15000.0), 0.0);
}

TEST(InverseChiSquareDistribution, KnowsTheEnds) {
    EXPECT_THAT(Ask(InvChiSquare_head, 0.0, 3), Gives(0.0));
    EXPECT_THAT(Ask(InvChiSquare_head, 1.0, 3), Gives(kInfinity));
    EXPECT_THAT(Ask(InvChiSquare_head, 1e-300, 3), Gives(0.0));
}

TEST(InverseChiSquareDistribution, ChecksProbabilityBeforeFreedom) {
    for (const double p : {-0.1, 1.1, kQuietNaN}) {
        EXPECT_THAT(Ask(InvChiSquare_head, p, 0), FailsWith(kBadProbability));
    }
    for (const int32_t df : {0, -1, kIntMin}) {
        EXPECT_THAT(Ask(InvChiSquare_head, 0.5, df), FailsWith(kBadFreedom));
        EXPECT_THAT(Ask(InvChiSquare_head, 0.0, df), FailsWith(kBadFreedom));
    }
}

TEST(FDistribution, AgreesWithR) {
    for (const Sample& s : ReadSamples("f")) {
        const Answer answer = Ask(FDist_head, s.x, s.n, s.m);
        EXPECT_EQ(answer.err, kOk);
        EXPECT_NEAR(answer.value, s.p, 1e-12) << Where(s);
    }
}

TEST(FDistribution, HasItsMedianAtOneForEqualFreedoms) {
    EXPECT_NEAR(Ask(FDist_head, 1.0, 10, 10).value, 0.5, 1e-14);
    EXPECT_NEAR(Ask(FDist_head, 1.0, 1, 1).value, 0.5, 1e-14);
}

TEST(FDistribution, IsZeroUpToZero) {
    for (const double f : {0.0, -0.0, -2.0, -kInfinity}) EXPECT_THAT(Ask(FDist_head, f, 2, 3), Gives(0.0));
    EXPECT_THAT(Ask(FDist_head, kInfinity, 2, 3), Gives(1.0));
    EXPECT_THAT(Ask(FDist_head, 1e308, kIntMax, 3), Gives(1.0));
}

TEST(FDistribution, ChecksFreedomsBeforeNaN) {
    EXPECT_THAT(Ask(FDist_head, 1.0, 0, 1), FailsWith(kBadFreedom));
    EXPECT_THAT(Ask(FDist_head, 1.0, 1, 0), FailsWith(kBadFreedom));
    EXPECT_THAT(Ask(FDist_head, kQuietNaN, 1, kIntMin), FailsWith(kBadFreedom));
    EXPECT_THAT(Ask(FDist_head, kQuietNaN, 1, 1), FailsWith(kHoldsNaN));
}

TEST(InverseFDistribution, AgreesWithRToItsTolerance) {
    for (const Sample& s : ReadSamples("f")) ExpectBisected(Ask(InvFDist_head, s.p, s.n, s.m), s, 1e-6, 1e4);
}

TEST(InverseFDistribution, StopsAtTheEndsOfItsInterval) {
    EXPECT_THAT(Ask(InvFDist_head, 1e-12, 3, 3), Gives(1e-6));
    const Answer answer = Ask(InvFDist_head, 1.0 - 1e-6, 1, 1);
    EXPECT_EQ(answer.err, kOk);
    EXPECT_LT(answer.value, 10000.0);
    EXPECT_GE(answer.value, 10000.0 - 1e-4);
}

TEST(InverseFDistribution, KnowsTheEnds) {
    EXPECT_THAT(Ask(InvFDist_head, 0.0, 2, 3), Gives(0.0));
    EXPECT_THAT(Ask(InvFDist_head, 1.0, 2, 3), Gives(kInfinity));
}

TEST(InverseFDistribution, ChecksFreedomsBeforeProbability) {
    EXPECT_THAT(Ask(InvFDist_head, 2.0, 0, 1), FailsWith(kBadFreedom));
    EXPECT_THAT(Ask(InvFDist_head, 0.0, 1, -1), FailsWith(kBadFreedom));
    for (const double p : {-0.1, 1.1, kQuietNaN}) {
        EXPECT_THAT(Ask(InvFDist_head, p, 1, 1), FailsWith(kBadProbability));
    }
}

TEST(DistributionCores, LeaveTheResultOfAFailureAlone) {
    double value = 5.0;
    EXPECT_EQ(TDistribution(kQuietNaN, 1, &value), kHoldsNaN);
    EXPECT_EQ(InverseFDistribution(2.0, 1, 1, &value), kBadProbability);
    EXPECT_EQ(value, 5.0);
}

}  // namespace
}  // namespace krnumer
