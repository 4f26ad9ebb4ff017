// Parabolas of neighbouring windows, side by side on every vector unit.

#include "peak/parabola_fit.h"

#include <cmath>
#include <random>
#include <vector>

#include "frame/numeric.h"
#include "frame/status.h"
#include "support/numbers.h"
#include "support/vector_units.h"

namespace krnumer {
namespace {

// Noise with stretches that are level, bent about their middle, or no numbers.
std::vector<double> Signal(std::size_t n) {
    std::mt19937 random(1);
    std::normal_distribution<double> normal;
    std::vector<double> x(n);
    for (std::size_t i = 0; i < n; ++i) {
        const double t = static_cast<double>(i % 16) - 8.0;
        const double shapes[] = {normal(random), 1.0, t * t, -t * t, normal(random), kInfinity, kQuietNaN, 1e308};
        x[i] = shapes[i / 16 % 8];
    }
    return x;
}

double OrderedSum(const double* weights, const double* x, int32_t width) {
    double sum = 0.0;
    for (int32_t j = 0; j < width; ++j) sum += weights[j] * x[j];
    return sum;
}

TEST(ParabolaFit, SumsInOrderOnEveryVectorUnit) {
    const std::vector<double> x = Signal(256);
    for (const int32_t width : {3, 4, 5, 9, 50}) {
        std::vector<double> weights(3 * Count(width));
        ASSERT_EQ(DesignParabolaWeights(width, weights.data()), kOk);
        OnEveryVectorUnit([&] {
            for (int32_t count = 1; count <= ParabolaFits::kMost; ++count) {
                const double* const first = x.data() + 2 * count;
                ParabolaFits fits;
                FitParabolas(weights.data(), width, first, count, &fits);
                for (int32_t k = 0; k < count; ++k) {
                    const double a[] = {OrderedSum(weights.data(), first + k, width),
                                        OrderedSum(weights.data() + width, first + k, width),
                                        OrderedSum(weights.data() + 2 * width, first + k, width)};
                    EXPECT_THAT((std::vector{fits.a0[k], fits.a1[k], fits.a2[k]}),
                                AllNear(std::vector<double>(a, a + 3), 0.0));
                    EXPECT_EQ(fits.IsRising(k), std::fabs(a[1]) <= 1e-10 ? a[2] > 0.0 : a[1] > 0.0);
                }
            }
        });
    }
}

TEST(ParabolaFit, FindsTheParabolaThatIsThere) {
    for (const int32_t width : {3, 4, 11}) {
        std::vector<double> weights(3 * Count(width)), x(Count(width));
        ASSERT_EQ(DesignParabolaWeights(width, weights.data()), kOk);
        for (int32_t i = 0; i < width; ++i) {
            const double t = i - 0.5 * (width - 1);
            x[Count(i)] = 2.0 - 3.0 * t + 0.5 * t * t;
        }
        ParabolaFits fits;
        FitParabolas(weights.data(), width, x.data(), 1, &fits);
        EXPECT_NEAR(fits[0].a0, 2.0, 1e-13);
        EXPECT_NEAR(fits[0].a1, -3.0, 1e-13);
        EXPECT_NEAR(fits[0].a2, 0.5, 1e-13);
    }
}

}  // namespace
}  // namespace krnumer
