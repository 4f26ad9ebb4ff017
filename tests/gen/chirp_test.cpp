#include <cmath>

#include "frame/numeric.h"
#include "frame/status.h"
#include "gen/reference.h"
#include "gen/wave.h"

namespace krnumer {
namespace {

#include "reference/gen/chirp.inc"

TEST(Chirp, AgreesWithItsFormula) {
    for (const auto& reference : kChirps) {
        const auto& a = reference.arguments;
        auto y = Samples(reference.n);
        ASSERT_EQ(Chirp(y.data(), reference.n, a[0], a[1], a[2]), kOk);
        ExpectSamples(y, reference, 1e-15 * std::fabs(a[0]) * (reference.n + 1));
    }
}

TEST(Chirp, OfOneFrequencyIsASine) {
    auto y = Samples(200), sine = Samples(200);
    double phase = 0.0;
    ASSERT_EQ(Chirp(y.data(), 200, -3.0, 0.07, 0.07), kOk);
    ASSERT_EQ(SineWave(sine.data(), 200, -3.0, 0.07, &phase), kOk);
    EXPECT_THAT(y, AllNear(sine, 0.0, 1e-12));
}

TEST(Chirp, TakesAnyFrequency) {
    auto y = Samples(3);
    EXPECT_EQ(Chirp(y.data(), 3, 1.0, 1e300, -1e300), kOk);
    for (const double value : y) EXPECT_LE(std::fabs(value), 1.0);
    EXPECT_EQ(Chirp(y.data(), 3, 1.0, kInfinity, 0.0), kOk);
    EXPECT_TRUE(std::isnan(y[2]));
}

TEST(Chirp, NeedsASample) {
    double y = 5.0;
    EXPECT_EQ(Chirp(&y, 0, 1.0, 0.1, 0.2), kEmptyInput);
    EXPECT_EQ(Chirp(&y, -3, 1.0, 0.1, 0.2), kEmptyInput);
    EXPECT_EQ(y, 5.0);
}

}  // namespace
}  // namespace krnumer
