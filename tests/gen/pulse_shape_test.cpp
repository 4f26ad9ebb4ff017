#include "gen/pulse_shape.h"

#include <cmath>
#include <functional>
#include <limits>

#include "frame/numeric.h"
#include "frame/status.h"
#include "gen/reference.h"

namespace krnumer {
namespace {

#include "reference/gen/pulse_shape.inc"

// A pulse of fixed parameters on an axis of time that is given (null: i dt - delay).
using Pulse = std::function<int32_t(const double* time, double* y, int32_t n, double dt, double delay)>;

Pulse Triangle(double amplitude, double width, double skew) {
    return [=](const double* time, double* y, int32_t n, double dt, double delay) {
        return AperiodicTriangle(time, y, n, amplitude, delay, dt, width, skew);
    };
}

Pulse Monopulse(double amplitude, double fc) {
    return [=](const double* time, double* y, int32_t n, double dt, double delay) {
        return GaussianMonopulse(time, y, n, dt, delay, fc, amplitude);
    };
}

Pulse Gaussian(double amplitude, double fc, double bandwidth, double attenuation) {
    return [=](const double* time, double* y, int32_t n, double dt, double delay) {
        return GaussianPulse(time, y, n, amplitude, delay, dt, fc, bandwidth, attenuation);
    };
}

Pulse Sinc(double amplitude, int32_t order) {
    return [=](const double* time, double* y, int32_t n, double dt, double delay) {
        return PeriodicSinc(time, y, n, amplitude, order, dt, delay);
    };
}

const std::vector<Pulse> kPulses = {Triangle(2.0, 1.5, 0.0), Triangle(2.0, 1.5, 1.0),      Triangle(2.0, 1.5, 0.4),
                                    Monopulse(2.0, 0.7),     Gaussian(2.0, 3.0, 0.5, 6.0), Sinc(2.0, 5)};

std::vector<double> Sample(const Pulse& pulse, int32_t n, double dt, double delay) {
    auto y = Samples(n);
    EXPECT_EQ(pulse(nullptr, y.data(), n, dt, delay), kOk);
    return y;
}

// The value at one time, taken on the uniform axis.
double At(const Pulse& pulse, double time) {
    return Sample(pulse, 1, 1.0, -time)[0];
}

void ExpectFailure(int32_t status, const Pulse& pulse, int32_t n, double dt) {
    std::vector<double> y(Count(n) + 1, 7.0);
    const std::vector<double> time(Count(n) + 1, 0.25);
    EXPECT_EQ(pulse(nullptr, y.data(), n, dt, 0.0), status);
    EXPECT_EQ(pulse(time.data(), y.data(), n, dt, 0.0), status) << "the axis of time takes no part in the checks";
    EXPECT_EQ(y, std::vector<double>(Count(n) + 1, 7.0)) << "a failure touches no sample";
}

const std::vector<double> kNotPositives = {0.0, -0.0, -1.0, -5e-324, -kInfinity};

// ---- What all pulses share -----------------------------------------------------------------------------------------

TEST(PulseShapes, AreSampledOnAGivenAxis) {
    const std::vector<double> times = {-3.0, 0.7, 0.1, 0.1, -0.2, 0.0, 1.3, 250.0};
    for (std::size_t p = 0; p < kPulses.size(); ++p) {
        const double shift = p < 3 ? 0.75 : 0.0;  // the triangles are centred by half their width
        auto y = Samples(8);
        ASSERT_EQ(kPulses[p](times.data(), y.data(), 8, 1.0, 999.0), kOk);
        for (std::size_t i = 0; i < times.size(); ++i) EXPECT_EQ(y[i], At(kPulses[p], times[i] + shift)) << p;

        auto in_place = times;
        ASSERT_EQ(kPulses[p](in_place.data(), in_place.data(), 8, 1.0, 999.0), kOk);
        EXPECT_EQ(in_place, y);
    }
}

TEST(PulseShapes, AreSampledFromTheDelayBackwards) {
    for (const Pulse& pulse : kPulses) {
        for (const int32_t n : kLengths) {
            const auto y = Sample(pulse, n, 0.01, 0.3);
            for (int32_t i = 0; i < n; ++i) ASSERT_EQ(y[Count(i)], At(pulse, i * 0.01 - 0.3));
        }
    }
}

TEST(PulseShapes, NeedAPositiveInterval) {
    for (const Pulse& pulse : kPulses)
        for (const double dt : kNotPositives) ExpectFailure(kBadSamplingInterval, pulse, 3, dt);
}

TEST(PulseShapes, NeedASampleBeforeAnInterval) {
    for (const Pulse& pulse : kPulses) {
        for (const int32_t n : {0, -1, std::numeric_limits<int32_t>::min()}) {
            ExpectFailure(kEmptyInput, pulse, n, 1.0);
            ExpectFailure(kEmptyInput, pulse, n, 0.0);
        }
    }
}

TEST(PulseShapes, LetNaNThrough) {
    const auto middle = [](const Pulse& pulse, double dt) { return Sample(pulse, 3, dt, 0.1)[1]; };
    EXPECT_EQ(middle(Triangle(2.0, 1.5, 0.4), kQuietNaN), 0.0);
    EXPECT_EQ(middle(Triangle(2.0, kQuietNaN, 0.4), 0.5), 0.0);
    EXPECT_EQ(middle(Triangle(2.0, 1.5, kQuietNaN), 0.5), 0.0);
    EXPECT_TRUE(std::isnan(middle(Monopulse(2.0, 0.7), kQuietNaN)));
    EXPECT_TRUE(std::isnan(middle(Monopulse(2.0, kQuietNaN), 0.5)));
    EXPECT_TRUE(std::isnan(middle(Gaussian(2.0, 3.0, 0.5, 6.0), kQuietNaN)));
    EXPECT_TRUE(std::isnan(middle(Gaussian(2.0, kQuietNaN, 0.5, 6.0), 0.5)));
    EXPECT_TRUE(std::isnan(middle(Gaussian(2.0, 3.0, kQuietNaN, 6.0), 0.5)));
    EXPECT_TRUE(std::isnan(middle(Gaussian(2.0, 3.0, 0.5, kQuietNaN), 0.5)));
    EXPECT_EQ(middle(Sinc(2.0, 5), kQuietNaN), 2.0) << "its sine is not above the limit of a zero";
}

// ---- Triangle ------------------------------------------------------------------------------------------------------

TEST(AperiodicTriangle, AgreesWithLinearInterpolation) {
    for (const auto& reference : kTriangles) {
        const auto& a = reference.arguments;
        const auto y = Sample(Triangle(a[0], a[3], a[4]), reference.n, a[2], a[1]);
        ExpectSamples(y, reference, 1e-14 * std::fabs(a[0]));
    }
}

TEST(AperiodicTriangle, JumpsOnTheSideWithoutASlope) {
    EXPECT_EQ(At(Triangle(3.0, 2.0, 0.0), 0.0), 3.0);
    EXPECT_EQ(At(Triangle(3.0, 2.0, 0.0), -5e-324), 0.0);
    EXPECT_EQ(At(Triangle(3.0, 2.0, 0.0), 2.0), 0.0);
    EXPECT_EQ(At(Triangle(3.0, 2.0, -0.0), 0.0), 3.0);
    EXPECT_EQ(At(Triangle(3.0, 2.0, 1.0), 2.0), 3.0);
    EXPECT_EQ(At(Triangle(3.0, 2.0, 1.0), 2.0000000000000004), 0.0);
    EXPECT_EQ(At(Triangle(3.0, 2.0, 1.0), 0.0), 0.0);
}

TEST(AperiodicTriangle, PeaksAtItsSkew) {
    EXPECT_EQ(At(Triangle(3.0, 2.0, 0.25), 0.5), 3.0);
    EXPECT_EQ(At(Triangle(3.0, 2.0, 0.25), 0.25), 1.5);
    EXPECT_EQ(At(Triangle(3.0, 2.0, 0.25), 1.25), 1.5);
    for (const double outside : {-0.1, 0.0, 2.0, 2.1, kInfinity, -kInfinity})
        EXPECT_EQ(At(Triangle(3.0, 2.0, 0.25), outside), 0.0);
}

TEST(AperiodicTriangle, IsCheckedInOrder) {
    for (const double width : kNotPositives) {
        ExpectFailure(kNotPositive, Triangle(1.0, width, 0.5), 3, 1.0);
        ExpectFailure(kNotPositive, Triangle(1.0, width, -1.0), 3, 0.0);
        ExpectFailure(kEmptyInput, Triangle(1.0, width, -1.0), 0, 0.0);
    }
    for (const double skew : {-5e-324, -1.0, 1.0000000000000002, kInfinity, -kInfinity}) {
        ExpectFailure(kBadProbability, Triangle(1.0, 1.0, skew), 3, 1.0);
        ExpectFailure(kBadSamplingInterval, Triangle(1.0, 1.0, skew), 3, 0.0);
    }
}

// ---- Gaussian pulses -----------------------------------------------------------------------------------------------

TEST(GaussianMonopulse, AgreesWithTheDerivativeOfTheGaussian) {
    for (const auto& reference : kMonopulses) {
        const auto& a = reference.arguments;
        ExpectSamples(Sample(Monopulse(a[0], a[3]), reference.n, a[2], a[1]), reference, 1e-14 * std::fabs(a[0]));
    }
}

TEST(GaussianMonopulse, ReachesTheAmplitudeOnBothSides) {
    const double extreme = 0.5 / (kPi * 4.0);  // where the second derivative of the Gaussian vanishes
    EXPECT_THAT(At(Monopulse(-3.0, 4.0), extreme), Near(-3.0, 1e-15));
    EXPECT_THAT(At(Monopulse(-3.0, 4.0), -extreme), Near(3.0, 1e-15));
    EXPECT_EQ(At(Monopulse(-3.0, 4.0), 0.0), 0.0);
    EXPECT_EQ(At(Monopulse(-3.0, 4.0), 1e3), 0.0);
}

TEST(GaussianMonopulse, LooksAtItsFrequencyFirst) {
    for (const double fc : kNotPositives) {
        ExpectFailure(kNotPositive, Monopulse(1.0, fc), 3, 1.0);
        ExpectFailure(kNotPositive, Monopulse(1.0, fc), 0, 0.0);
    }
}

TEST(GaussianPulse, AgreesWithTheModulatedGaussian) {
    for (const auto& reference : kGaussianPulses) {
        const auto& a = reference.arguments;
        const auto y = Sample(Gaussian(a[0], a[3], a[4], a[5]), reference.n, a[2], a[1]);
        ExpectSamples(y, reference, 2e-14 * std::fabs(a[0]));
    }
}

TEST(GaussianPulse, LooksAtItsParametersFirst) {
    for (const double bad : kNotPositives) {
        for (const Pulse& pulse :
             {Gaussian(1.0, bad, 0.5, 6.0), Gaussian(1.0, 1.0, bad, 6.0), Gaussian(1.0, 1.0, 0.5, bad)}) {
            ExpectFailure(kNotPositive, pulse, 3, 1.0);
            ExpectFailure(kNotPositive, pulse, 0, 0.0);
        }
    }
}

// ---- Periodic sinc -------------------------------------------------------------------------------------------------

TEST(PeriodicSinc, AgreesWithTheDirichletKernel) {
    for (const auto& reference : kPeriodicSincs) {
        const auto& a = reference.arguments;
        const auto y = Sample(Sinc(a[0], static_cast<int32_t>(a[1])), reference.n, a[2], a[3]);
        ExpectSamples(y, reference, 1e-12 * std::fabs(a[0]));
    }
}

TEST(PeriodicSinc, IsOneAtEveryZeroOfTheSine) {
    for (const int32_t order : {1, 2, 3, 4, 7, 100}) {
        EXPECT_EQ(At(Sinc(-2.5, order), 0.0), -2.5);
        EXPECT_EQ(At(Sinc(-2.5, order), 2.0 * kPi), -2.5) << "where the limit of even orders has the other sign";
        EXPECT_EQ(At(Sinc(-2.5, order), -2.0 * kPi), -2.5);
    }
    EXPECT_THAT(At(Sinc(1.0, 2), 2.0 * kPi + 1e-6), Near(-1.0, 1e-12));
}

TEST(PeriodicSinc, LooksAtItsOrderFirst) {
    for (const int32_t order : {0, -1, std::numeric_limits<int32_t>::min()}) {
        ExpectFailure(kNotPositive, Sinc(1.0, order), 3, 1.0);
        ExpectFailure(kNotPositive, Sinc(1.0, order), 0, 0.0);
    }
    EXPECT_LE(std::fabs(At(Sinc(1.0, std::numeric_limits<int32_t>::max()), 1.0)), 1e-8);
}

}  // namespace
}  // namespace krnumer
