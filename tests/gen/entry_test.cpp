// The exports of the family: statuses, their order, and what they leave in their outputs.

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <functional>

#include "frame/numeric.h"
#include "frame/status.h"
#include "krnumer/gen.h"
#include "support/host_arrays.h"

namespace krnumer {
namespace {

using testing::DoubleNear;
using testing::ElementsAre;
using testing::Pointwise;

class GenEntry : public testing::Test {
  protected:
    LeakCheck leaks_;
    HostArray<double> x_{9, 9};
    int32_t n_ = 4;
    double amplitude_ = 2.0;
    double frequency_ = 0.125;
    double phase_ = 30.0;
    double duty_ = 50.0;
    double cycles_ = 1.0;
    double dt_ = 0.5;
    double delay_ = 0.0;
    double end_ = 3.0;
    int32_t index_ = 1;
    int32_t width_ = 2;
    int32_t linear_ = 1;
    HostArray<double> table_{0, 1};
    int32_t err_ = 77;

    void ExpectEmptied(int32_t result, int32_t status) {
        EXPECT_EQ(result, 0);
        EXPECT_EQ(err_, status);
        EXPECT_TRUE(x_.empty());
        x_ = HostArray<double>{9, 9};
        err_ = 77;
    }

    // The exports that report through err and size the array as their one resize.
    std::vector<std::function<int32_t()>> Sized() {
        const KrHandle x = x_.handle();
        return {
            [=, this] { return SineWaveCIN(x, &n_, &amplitude_, &frequency_, &phase_, &err_); },
            [=, this] { return SquareWaveCIN(x, &n_, &amplitude_, &frequency_, &phase_, &duty_, &err_); },
            [=, this] { return SawtoothWaveCIN(x, &n_, &amplitude_, &frequency_, &phase_, &err_); },
            [=, this] { return TriangleWaveCIN(x, &n_, &amplitude_, &frequency_, &phase_, &err_); },
            [=, this] {
                return ArbitraryWaveCIN(x, &n_, &amplitude_, &frequency_, &phase_, table_.handle(), &linear_, &err_);
            },
            [=, this] { return ChirpCIN(x, &n_, &amplitude_, &frequency_, &end_, &err_); },
            [=, this] { return SinePtrn(x, &n_, &amplitude_, &phase_, &cycles_, &err_); },
            [=, this] { return Square(x, &n_, &amplitude_, &duty_, &cycles_, &err_); },
            [=, this] { return ImpulsePtrn(x, &n_, &amplitude_, &index_, &err_); },
            [=, this] { return PulsePtrn(x, &n_, &amplitude_, &index_, &width_, &err_); },
            [=, this] { return SincWave(x, &n_, &amplitude_, &delay_, &dt_, &err_); },
        };
    }
};

TEST_F(GenEntry, NeedsASample) {
    for (const int32_t n : {0, -1, INT32_MIN}) {
        n_ = n;
        for (size_t i = 0; i < Sized().size(); ++i) {
            SCOPED_TRACE(i);
            ExpectEmptied(Sized()[i](), kEmptyInput);
        }
    }
    EXPECT_EQ(phase_, 30.0) << "a call that fails before its core leaves the phase";
}

TEST_F(GenEntry, HandsOnTheHostsStatus) {
    for (size_t i = 0; i < Sized().size(); ++i) {
        SCOPED_TRACE(i);
        const FailResize fail(1, 4711);
        const int32_t result = Sized()[i]();
        EXPECT_EQ(result, 4711);
        ExpectEmptied(0, kOutOfMemory);
    }
    EXPECT_EQ(phase_, 30.0);
}

TEST_F(GenEntry, SizesItsArray) {
    for (size_t i = 0; i < Sized().size(); ++i) {
        SCOPED_TRACE(i);
        EXPECT_EQ(Sized()[i](), 0);
        EXPECT_EQ(err_, 0);
        EXPECT_EQ(x_.size(), 4);
        x_ = HostArray<double>{9};
    }
}

TEST_F(GenEntry, RefusesSizesBeyondAllMemory) {
    const BlockLimit limit(1 << 20);
    n_ = INT32_MAX;
    for (size_t i = 0; i < Sized().size(); ++i) {
        SCOPED_TRACE(i);
        Sized()[i]();
        ExpectEmptied(0, kOutOfMemory);
    }
}

TEST_F(GenEntry, WavesHandTheirPhaseOn) {
    frequency_ = 0.25;
    phase_ = 270.0;
    n_ = 3;
    SawtoothWaveCIN(x_.handle(), &n_, &amplitude_, &frequency_, &phase_, &err_);
    EXPECT_THAT(x_.values(), ElementsAre(-1, 0, 1));
    EXPECT_EQ(phase_, 180.0);
    TriangleWaveCIN(x_.handle(), &n_, &amplitude_, &frequency_, &phase_, &err_);
    EXPECT_THAT(x_.values(), ElementsAre(0, -2, 0));
    SquareWaveCIN(x_.handle(), &n_, &amplitude_, &frequency_, &phase_, &duty_, &err_);
    EXPECT_THAT(x_.values(), ElementsAre(2, -2, -2)) << "the sample on the edge is low";
    phase_ = 90.0;
    SineWaveCIN(x_.handle(), &n_, &amplitude_, &frequency_, &phase_, &err_);
    EXPECT_THAT(x_.values(), Pointwise(DoubleNear(1e-15), {2.0, 0.0, -2.0}));
}

TEST_F(GenEntry, PatternsKeepTheirPhase) {
    EXPECT_EQ(SinePtrn(x_.handle(), &n_, &amplitude_, &phase_, &cycles_, &err_), 0);
    EXPECT_EQ(phase_, 30.0);
}

TEST_F(GenEntry, ArbitraryWaveReadsATableThatIsItsOutput) {
    HostArray<double> both{0, 1};
    frequency_ = 0.25;
    phase_ = 0.0;
    amplitude_ = 1.0;
    EXPECT_EQ(ArbitraryWaveCIN(both.handle(), &n_, &amplitude_, &frequency_, &phase_, both.handle(), &linear_, &err_),
              0);
    EXPECT_THAT(both.values(), ElementsAre(0, 0.5, 1, 0.5));
}

TEST_F(GenEntry, ArbitraryWaveOfAnEmptyTableIsZero) {
    HostArray<double> none;
    EXPECT_EQ(ArbitraryWaveCIN(x_.handle(), &n_, &amplitude_, &frequency_, &phase_, none.handle(), &linear_, &err_), 0);
    EXPECT_THAT(x_.values(), ElementsAre(0, 0, 0, 0));
    EXPECT_EQ(phase_, 0.0);
}

TEST_F(GenEntry, SinePatternTakesAsManyCyclesAsSamples) {
    cycles_ = 4.0;
    EXPECT_EQ(SinePtrn(x_.handle(), &n_, &amplitude_, &phase_, &cycles_, &err_), 0);
    EXPECT_EQ(err_, 0);
    for (const double cycles : {4.5, 0.0, -1.0}) {
        cycles_ = cycles;
        ExpectEmptied(SinePtrn(x_.handle(), &n_, &amplitude_, &phase_, &cycles_, &err_), kBadCycles);
    }
}

TEST_F(GenEntry, SquareChecksDutyThenCycles) {
    const auto square = [this] { return Square(x_.handle(), &n_, &amplitude_, &duty_, &cycles_, &err_); };
    duty_ = 0.0;
    ExpectEmptied(square(), kBadDuty);
    cycles_ = 2.5;  // above half the samples
    ExpectEmptied(square(), kBadCycles);
    {
        const FailResize fail(1, 4711);
        EXPECT_EQ(square(), 4711);
        ExpectEmptied(0, kOutOfMemory);
    }
    n_ = 0;
    ExpectEmptied(square(), kEmptyInput);
    n_ = 5;
    cycles_ = 2.5;  // half the samples counts whole
    duty_ = 50.0;
    ExpectEmptied(square(), kBadCycles);
    cycles_ = 2.0;
    EXPECT_EQ(square(), 0);
    EXPECT_EQ(err_, 0);
}

TEST_F(GenEntry, SquareFallsToZeroAndIsHighFromFullDutyOn) {
    EXPECT_EQ(Square(x_.handle(), &n_, &amplitude_, &duty_, &cycles_, &err_), 0);
    EXPECT_THAT(x_.values(), ElementsAre(2, 2, 0, 0));
    for (const double duty : {100.0, 150.0, 1e300, kInfinity}) {
        duty_ = duty;
        EXPECT_EQ(Square(x_.handle(), &n_, &amplitude_, &duty_, &cycles_, &err_), 0);
        EXPECT_THAT(x_.values(), ElementsAre(2, 2, 2, 2));
    }
    duty_ = kQuietNaN;
    EXPECT_EQ(Square(x_.handle(), &n_, &amplitude_, &duty_, &cycles_, &err_), 0);
    EXPECT_EQ(err_, 0);
    EXPECT_THAT(x_.values(), ElementsAre(0, 0, 0, 0));
}

TEST_F(GenEntry, ImpulsesAndPulsesHaveToFit) {
    for (const int32_t delay : {4, -1}) {
        index_ = delay;
        ExpectEmptied(ImpulsePtrn(x_.handle(), &n_, &amplitude_, &index_, &err_), kBadIndex);
    }
    index_ = 3;
    ExpectEmptied(PulsePtrn(x_.handle(), &n_, &amplitude_, &index_, &width_, &err_), kPulseDoesNotFit);
    index_ = INT32_MAX;
    width_ = INT32_MAX;
    ExpectEmptied(PulsePtrn(x_.handle(), &n_, &amplitude_, &index_, &width_, &err_), kPulseDoesNotFit);
}

TEST_F(GenEntry, SincNeedsAnInterval) {
    dt_ = 0.0;
    ExpectEmptied(SincWave(x_.handle(), &n_, &amplitude_, &delay_, &dt_, &err_), kBadSamplingInterval);
    dt_ = kQuietNaN;
    EXPECT_EQ(SincWave(x_.handle(), &n_, &amplitude_, &delay_, &dt_, &err_), 0);
    EXPECT_THAT(x_.values(), ElementsAre(2, 2, 2, 2)) << "a time that is NaN counts as the peak";
}

TEST_F(GenEntry, RampsWithAndWithoutTheirEnd) {
    EXPECT_EQ(RampPtrn80(x_.handle(), 4, 0.0, 4.0, 1), 0);
    EXPECT_THAT(x_.values(), ElementsAre(0, 1, 2, 3));
    EXPECT_EQ(RampPtrn80(x_.handle(), 4, 0.0, 3.0, 0), 0);
    EXPECT_THAT(x_.values(), ElementsAre(0, 1, 2, 3));
}

TEST_F(GenEntry, RampsNeedTheirEnds) {
    const auto ramp = [this](int32_t n, double start, double end, int32_t option, int32_t status) {
        EXPECT_EQ(RampPtrn80(x_.handle(), n, start, end, option), status);
        EXPECT_TRUE(x_.empty());
        x_ = HostArray<double>{9, 9};
        if (option != 0) return;
        ExpectEmptied(RampPtrn(x_.handle(), &n, &start, &end, &err_), status);
    };
    ramp(1, 0.0, 1.0, 0, kFewerThanTwo);
    ramp(0, 1.0, 1.0, 0, kFewerThanTwo);
    ramp(-5, 1.0, 1.0, 0, kFewerThanTwo);
    ramp(0, 0.0, 1.0, 1, kNoSample);
    ramp(0, 0.0, 1.0, 2, kNoSample);
    const FailResize fail(1, 4711);
    ramp(3, 0.0, 1.0, 1, kOutOfMemory);
}

TEST_F(GenEntry, RampsReportARefusedSizeThroughErr) {
    const FailResize fail(1, 4711);
    const double start = 0.0;
    ExpectEmptied(RampPtrn(x_.handle(), &n_, &start, &end_, &err_), kOutOfMemory);
}

TEST_F(GenEntry, ARampOfOneSampleIsItsEnd) {
    const int32_t n = 1;
    const double start = 0.0;
    const double end = -0.0;
    EXPECT_EQ(RampPtrn(x_.handle(), &n, &start, &end, &err_), 0);
    ASSERT_EQ(x_.size(), 1);
    EXPECT_TRUE(std::signbit(x_[0]));
}

// The four pulse shapes with good parameters, over an array and a number of samples.
class PulseShapeEntry : public testing::TestWithParam<int32_t (*)(KrHandle, int32_t, double)> {
  protected:
    LeakCheck leaks_;
    HostArray<double> none_;
};

TEST_P(PulseShapeEntry, FillsAnEmptyArray) {
    EXPECT_EQ(GetParam()(none_.handle(), 5, 0.25), 0);
    EXPECT_EQ(none_.size(), 5);
}

TEST_P(PulseShapeEntry, RefusesAnArrayThatHoldsElements) {
    for (const int32_t n : {5, 0, -1}) {
        HostArray<double> axis{0, 1};
        EXPECT_EQ(GetParam()(axis.handle(), n, 0.25), kBadSamplingInterval);
        EXPECT_TRUE(axis.empty());
    }
}

TEST_P(PulseShapeEntry, NeedsSamplesAndAnInterval) {
    EXPECT_EQ(GetParam()(none_.handle(), 0, 0.25), kEmptyInput);
    EXPECT_EQ(GetParam()(none_.handle(), 5, 0.0), kBadSamplingInterval);
    EXPECT_TRUE(none_.empty());
}

TEST_P(PulseShapeEntry, HandsOnTheHostsStatus) {
    const FailResize fail(1, 4711);
    EXPECT_EQ(GetParam()(none_.handle(), 5, 0.25), 4711);
    EXPECT_TRUE(none_.empty());
}

INSTANTIATE_TEST_SUITE_P(
    All, PulseShapeEntry,
    testing::Values([](KrHandle x, int32_t n, double dt) { return AperiodTriangleH(x, n, 2, 0, dt, 1, 0.5); },
                    [](KrHandle x, int32_t n, double dt) { return GaussMonopulseH(x, n, dt, 0, 1, 2); },
                    [](KrHandle x, int32_t n, double dt) { return GaussPulseH(x, n, 2, 0, dt, 1, 0.5, 6); },
                    [](KrHandle x, int32_t n, double dt) { return PeriodicSincH(x, n, 2, 3, dt, 0); }));

TEST_F(GenEntry, PulseShapesLookAtTheirParametersBeforeTheAxis) {
    const auto expect = [](int32_t (*call)(KrHandle), int32_t status) {
        HostArray<double> axis{0, 1};
        EXPECT_EQ(call(axis.handle()), status);
        EXPECT_TRUE(axis.empty());
    };
    expect([](KrHandle x) { return AperiodTriangleH(x, 5, 2, 0, 0.25, 0, 2); }, kNotPositive);
    expect([](KrHandle x) { return AperiodTriangleH(x, 5, 2, 0, 0.25, 1, 2); }, kBadSamplingInterval);
    expect([](KrHandle x) { return GaussMonopulseH(x, 5, 0.25, 0, 0, 2); }, kNotPositive);
    expect([](KrHandle x) { return GaussPulseH(x, 5, 2, 0, 0.25, 0, 0.5, 6); }, kNotPositive);
    expect([](KrHandle x) { return GaussPulseH(x, 5, 2, 0, 0.25, 1, 0, 6); }, kNotPositive);
    expect([](KrHandle x) { return GaussPulseH(x, 5, 2, 0, 0.25, 1, 0.5, 0); }, kNotPositive);
    expect([](KrHandle x) { return PeriodicSincH(x, 5, 2, 0, 0.25, 0); }, kNotPositive);
    HostArray<double> none;
    EXPECT_EQ(AperiodTriangleH(none.handle(), 5, 2, 0, 0.25, 1, 1.5), kBadProbability);
    EXPECT_EQ(AperiodTriangleH(none.handle(), 0, 2, 0, 0.25, 0, 1.5), kEmptyInput) << "the count before the width";
    EXPECT_EQ(GaussMonopulseH(none.handle(), 0, 0.25, 0, 0, 2), kEmptyInput) << "an empty array has its count first";
}

}  // namespace
}  // namespace krnumer
