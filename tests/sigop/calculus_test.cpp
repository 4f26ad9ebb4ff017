// Derivative, integral and unwrapping, as cores and as exports.

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cmath>

#include "frame/numeric.h"
#include "frame/status.h"
#include "krnumer/sigop.h"
#include "sigop/calculus.h"
#include "sigop/signals.h"
#include "sigop/unwrap.h"
#include "support/host_arrays.h"

namespace krnumer {
namespace {

using testing::ElementsAre;

TEST(Calculus, AgreesWithExactFractions) {
    const Golden golden("time_domain");
    for (const std::string& name : golden.Cases("calculus")) {
        SCOPED_TRACE(name);
        const auto& ends = golden.Reals(name + ".ends");
        auto x = golden.Reals(name + ".x");
        EXPECT_EQ(Differentiate(x.data(), Size(x), ends[0], ends[1], ends[2]), kOk);
        EXPECT_THAT(x, AllNear(golden.Reals(name + ".derivative"), 4e-16));
        x = golden.Reals(name + ".x");
        EXPECT_EQ(Integrate(x.data(), Size(x), ends[0], ends[1], ends[2]), kOk);
        EXPECT_THAT(x, AllNear(golden.Reals(name + ".integral"), 0.0, 1e-14));
    }
}

class CalculusExports : public testing::Test {
  protected:
    LeakCheck leaks_;
    HostArray<double> x_{1, 4, 9}, none_;
    double initial_ = 0.0, final_ = 16.0, dt_ = 1.0;
    int32_t err_ = 77;
};

TEST_F(CalculusExports, WorkInPlace) {
    EXPECT_EQ(Derivative(x_.handle(), &initial_, &final_, &dt_, &err_), 0);
    EXPECT_EQ(err_, 0);
    EXPECT_THAT(x_.values(), ElementsAre(2, 4, 6));
    x_ = HostArray<double>{1, 4, 9};
    EXPECT_EQ(Integral(x_.handle(), &initial_, &final_, &dt_, &err_), 0);
    EXPECT_EQ(err_, 0);
    EXPECT_THAT(x_.values(), AllNear({8.0 / 6, 34.0 / 6, 90.0 / 6}, 1e-15));
}

TEST_F(CalculusExports, ASingleSampleTakesBothEnds) {
    HostArray<double> x{3};
    EXPECT_EQ(Derivative(x.handle(), &initial_, &final_, &dt_, &err_), 0);
    EXPECT_THAT(x.values(), ElementsAre(8));
    x = HostArray<double>{3};
    EXPECT_EQ(Integral(x.handle(), &initial_, &final_, &dt_, &err_), 0);
    EXPECT_THAT(x.values(), AllNear({28.0 / 6}, 1e-15));
}

TEST_F(CalculusExports, TheIntegralOfNegativeZeroIsNegativeZero) {
    x_ = HostArray<double>{-0.0, -0.0};
    initial_ = final_ = -0.0;
    EXPECT_EQ(Integral(x_.handle(), &initial_, &final_, &dt_, &err_), 0);
    for (const double value : x_.values()) EXPECT_TRUE(std::signbit(value));
}

TEST_F(CalculusExports, RefuseTheIntervalOrTheEmptyInputFirst) {
    for (const double dt : {0.0, -1.0, -kInfinity}) {
        dt_ = dt;
        for (const bool empty : {false, true}) {
            HostArray<double> x(empty ? 0 : 2);
            EXPECT_EQ(Derivative(x.handle(), &initial_, &final_, &dt_, &err_), 0);
            EXPECT_EQ(err_, kBadSamplingInterval);
            EXPECT_TRUE(x.empty());
            x = HostArray<double>(empty ? 0 : 2);
            EXPECT_EQ(Integral(x.handle(), &initial_, &final_, &dt_, &err_), 0);
            EXPECT_EQ(err_, empty ? kEmptyInput : kBadSamplingInterval);
            EXPECT_TRUE(x.empty());
        }
    }
    dt_ = 1.0;
    EXPECT_EQ(Derivative(none_.handle(), &initial_, &final_, &dt_, &err_), 0);
    EXPECT_EQ(err_, kEmptyInput);
}

TEST_F(CalculusExports, AnIntervalOfNaNIsRefusedByTheDerivativeOnly) {
    dt_ = kQuietNaN;
    HostArray<double> x{1, 2};
    EXPECT_EQ(Integral(x.handle(), &initial_, &final_, &dt_, &err_), 0);
    EXPECT_EQ(err_, 0);
    EXPECT_TRUE(std::isnan(x[0]) && std::isnan(x[1]));
    EXPECT_EQ(Derivative(x.handle(), &initial_, &final_, &dt_, &err_), 0);
    EXPECT_EQ(err_, kBadSamplingInterval);
    EXPECT_TRUE(x.empty());
}

constexpr double kTurn = 6.283185307179586;

TEST(Unwrap, AgreesWithGoldenData) {
    const Golden golden("time_domain");
    for (const std::string& name : golden.Cases("phase")) {
        SCOPED_TRACE(name);
        auto x = golden.Reals(name + ".x");
        EXPECT_EQ(UnwrapPhase(x.data(), Size(x)), kOk);
        EXPECT_THAT(x, AllNear(golden.Reals(name + ".unwrapped"), 0.0, 1e-12));
    }
}

TEST(Unwrap, LeavesSmallStepsAloneAndTakesHalfATurnDown) {
    std::vector<double> x{0, 3.1, 0.1, -3.0, -5.9};
    const auto same = x;
    EXPECT_EQ(UnwrapPhase(x.data(), Size(x)), kOk);
    EXPECT_THAT(x, SameBitsAs(same));
    std::vector<double> up{0, kPi}, down{0, -kPi};
    UnwrapPhase(up.data(), 2);
    UnwrapPhase(down.data(), 2);
    EXPECT_THAT(up, ElementsAre(0, kPi - kTurn));
    EXPECT_THAT(down, ElementsAre(0, -kPi));
}

TEST(Unwrap, CountsTurnsBeyondIntegers) {
    std::vector<double> x{0, 1e11, 1e11, -1e300};
    EXPECT_EQ(UnwrapPhase(x.data(), 4), kOk);
    EXPECT_LE(std::abs(x[1]), kPi + 1e-4);
    EXPECT_LE(std::abs(x[2] - x[1]), kPi + 1e-4);
    EXPECT_TRUE(std::isfinite(x[3]));
}

TEST(Unwrap, ExportWorksInPlaceAndRefusesNothing) {
    int32_t err = 77;
    HostArray<double> x{0, 7}, one{9}, none;
    EXPECT_EQ(unWrap(x.handle(), &err), 0);
    EXPECT_EQ(err, 0);
    EXPECT_THAT(x.values(), ElementsAre(0, 7 - kTurn));
    EXPECT_EQ(unWrap(one.handle(), &err), 0);
    EXPECT_THAT(one.values(), ElementsAre(9));
    EXPECT_EQ(unWrap(none.handle(), &err), 0);
    EXPECT_EQ(err, kEmptyInput);
}

}  // namespace
}  // namespace krnumer
