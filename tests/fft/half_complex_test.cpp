#include "fft/half_complex.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <limits>
#include <vector>

#include "fft/samples.h"
#include "support/numbers.h"

namespace krnumer {
namespace {

constexpr double kNone = std::numeric_limits<double>::quiet_NaN();

std::vector<Complex> Expand(const std::vector<double>& half_complex, int32_t shift) {
    const auto n = static_cast<int32_t>(half_complex.size());
    std::vector<Complex> data(half_complex.size(), {kNone, kNone});
    std::copy(half_complex.begin(), half_complex.end(), HalfComplexPart(data.data(), n));
    ExpandHalfComplex(data.data(), n, shift);
    return data;
}

TEST(ExpandHalfComplex, FillsInTheConjugates) {
    EXPECT_EQ(Expand({7}, 0), (std::vector<Complex>{{7, 0}}));
    EXPECT_EQ(Expand({7, 5}, 0), (std::vector<Complex>{{7, 0}, {5, 0}}));
    EXPECT_EQ(Expand({7, 5, 3}, 0), (std::vector<Complex>{{7, 0}, {5, 3}, {5, -3}}));
    EXPECT_EQ(Expand({7, 5, 3, 1}, 0), (std::vector<Complex>{{7, 0}, {5, 1}, {3, 0}, {5, -1}}));
    EXPECT_EQ(Expand({1, 2, 3, 4, 5}, 0), (std::vector<Complex>{{1, 0}, {2, 5}, {3, 4}, {3, -4}, {2, -5}}));
}

TEST(ExpandHalfComplex, PutsTheMeanInTheMiddleWhenShifted) {
    EXPECT_EQ(Expand({7}, 1), (std::vector<Complex>{{7, 0}}));
    EXPECT_EQ(Expand({7, 5}, 1), (std::vector<Complex>{{5, 0}, {7, 0}}));
    EXPECT_EQ(Expand({7, 5, 3, 1}, -9), (std::vector<Complex>{{3, 0}, {5, -1}, {7, 0}, {5, 1}}));
    EXPECT_EQ(Expand({1, 2, 3, 4, 5}, 1), (std::vector<Complex>{{3, -4}, {2, -5}, {1, 0}, {2, 5}, {3, 4}}));
    // y[j] = X[(j - n/2) mod n]
    for (int32_t n = 1; n < 40; ++n) {
        const std::vector<double> h = RandomReal(n);
        const std::vector<Complex> plain = Expand(h, 0), shifted = Expand(h, 1);
        for (int32_t j = 0; j < n; ++j) {
            EXPECT_TRUE(SameBits(shifted[static_cast<size_t>(j)], plain[static_cast<size_t>((j - n / 2 + n) % n)]))
                << n << " at " << j;
        }
    }
}

TEST(PackHalfComplex, UndoesTheExpansion) {
    for (int32_t n = 1; n < 40; ++n) {
        const std::vector<double> h = RandomReal(n);
        for (int32_t shift : {0, 1}) {
            std::vector<double> packed(h.size());
            PackHalfComplex(Expand(h, shift).data(), n, shift, packed.data());
            EXPECT_EQ(packed, h) << n;
        }
    }
}

TEST(PackHalfComplex, ReadsOneHalf) {
    std::vector<double> packed(4);
    const std::vector<Complex> plain{{7, kNone}, {5, 1}, {3, kNone}, {kNone, kNone}};
    PackHalfComplex(plain.data(), 4, 0, packed.data());
    EXPECT_THAT(packed, testing::ElementsAre(7, 5, 3, 1));
    const std::vector<Complex> shifted{{3, kNone}, {kNone, kNone}, {7, kNone}, {5, 1}};
    PackHalfComplex(shifted.data(), 4, 1, packed.data());
    EXPECT_THAT(packed, testing::ElementsAre(7, 5, 3, 1));
}

TEST(ShiftSpectrum, IsUndoneByCopyUnshifted) {
    for (int32_t n : {1, 2, 4, 5, 9}) {
        const std::vector<Complex> x = RandomComplex(n);
        std::vector<Complex> shifted = x, back(x.size());
        ShiftSpectrum(shifted.data(), n);
        EXPECT_EQ(shifted[static_cast<size_t>(n / 2)], x[0]);
        CopyUnshifted(shifted.data(), n, back.data());
        EXPECT_EQ(back, x);
    }
}

}  // namespace
}  // namespace krnumer
