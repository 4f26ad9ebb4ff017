#include "gen/sines.h"

#include <cmath>
#include <limits>
#include <random>
#include <vector>

#include "frame/numeric.h"
#include "gen/reference.h"
#include "support/vector_units.h"

namespace krnumer {
namespace {

using Function = void (*)(const double*, int32_t, double*);

std::vector<double> Of(Function f, const std::vector<double>& x) {
    std::vector<double> y(x.size());
    f(x.data(), static_cast<int32_t>(x.size()), y.data());
    return y;
}

// Units in the last place of the value.
double Error(double value, long double exact) {
    int exponent = 0;
    std::frexp(static_cast<double>(exact), &exponent);
    return static_cast<double>(std::fabs(value - exact) / std::ldexp(1.0L, exponent - 53));
}

// Angles of every size, and those beside multiples of pi / 4, where next to nothing is left of them.
std::vector<double> Angles() {
    std::vector<double> x;
    std::mt19937_64 random(1);
    for (const double largest : {1e-300, 1e-8, 0.1, 1.0, 3.0, 100.0, 1e4, 1.3e7}) {
        for (int i = 0; i < 5000; ++i) x.push_back(std::uniform_real_distribution<>(-largest, largest)(random));
    }
    for (int k = -16000000; k < 16000000; k += 997) {
        const double multiple = k * (kPi / 4.0);
        x.insert(x.end(), {multiple, std::nextafter(multiple, kInfinity), std::nextafter(multiple, -kInfinity)});
    }
    return x;
}

TEST(Sines, AreRoundedNearlyCorrectly) {
    if (std::numeric_limits<long double>::digits < 64) GTEST_SKIP() << "no longer type to compare with";
    const auto x = Angles();
    const auto sines = Of(Sines, x), cosines = Of(Cosines, x);
    for (std::size_t i = 0; i < x.size(); ++i) {
        EXPECT_LT(Error(sines[i], std::sin(static_cast<long double>(x[i]))), 0.53) << x[i];
        EXPECT_LT(Error(cosines[i], std::cos(static_cast<long double>(x[i]))), 0.53) << x[i];
    }
}

TEST(Sines, AreThoseOfTheLibraryForFarAndForNoAngles) {
    const std::vector<double> x = {1.4e7, -1e22, 1.7e308, kInfinity, -kInfinity, kQuietNaN, 1.0};
    const auto sines = Of(Sines, x), cosines = Of(Cosines, x);
    for (std::size_t i = 0; i + 1 < x.size(); ++i) {
        EXPECT_THAT(sines[i], testing::NanSensitiveDoubleEq(std::sin(x[i])));
        EXPECT_THAT(cosines[i], testing::NanSensitiveDoubleEq(std::cos(x[i])));
    }
    EXPECT_EQ(sines.back(), Of(Sines, {1.0})[0]) << "what stands beside it is of no matter";
    EXPECT_EQ(cosines.back(), Of(Cosines, {1.0})[0]);
}

TEST(Sines, KeepZerosAndTinyAngles) {
    for (const double x : {0.0, -0.0, 5e-324, -5e-324, 1e-310}) {
        const double sine = Of(Sines, {x})[0];
        EXPECT_EQ(sine, x);
        EXPECT_EQ(std::signbit(sine), std::signbit(x));
        EXPECT_EQ(Of(Cosines, {x})[0], 1.0);
    }
}

TEST(Sines, AreTheSameOnEveryVectorUnitAtEveryPlace) {
    const auto x = Angles();
    const auto sines = Of(Sines, x), cosines = Of(Cosines, x);
    OnEveryVectorUnit([&] {
        EXPECT_EQ(Of(Sines, x), sines);
        EXPECT_EQ(Of(Cosines, x), cosines);
    });
    for (std::size_t i = 0; i < 50; ++i) EXPECT_EQ(Of(Sines, {x[i]})[0], sines[i]);
    auto in_place = x;
    Sines(in_place.data(), static_cast<int32_t>(x.size()), in_place.data());
    EXPECT_EQ(in_place, sines);
}

TEST(SampleAngles, FillsEverySampleOnce) {
    for (const int32_t n : {0, 1, 255, 256, 257, 600}) {
        std::vector<double> y(static_cast<std::size_t>(n) + 1, 7.0);
        SampleAngles(
            y.data(), n, Cosines, [](int32_t i) { return 0.01 * i; },
            [](double angle, double cosine) { return angle + cosine; });
        for (int32_t i = 0; i < n; ++i)
            EXPECT_NEAR(y[static_cast<std::size_t>(i)], 0.01 * i + std::cos(0.01 * i), 1e-14);
        EXPECT_EQ(y.back(), 7.0);
    }
}

}  // namespace
}  // namespace krnumer
