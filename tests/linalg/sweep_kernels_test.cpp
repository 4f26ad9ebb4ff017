// Rotations and reflectors of a sweep, against their definition one at a time: to the last bit, at every width.
#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <vector>

#include "linalg/matrices.h"
#include "linalg/reflector_chain.h"
#include "linalg/rotation_chain.h"
#include "linalg/rotations.h"
#include "support/vector_units.h"

namespace krnumer {
namespace {

constexpr int32_t kRows = 23;
constexpr int32_t kWidths[] = {1, 2, 3, 4, 5, 7, 8, 9, 15, 16, 17, 31, 32, 33, 40, 63, 64, 65, 130};

TEST(RotateChain, RotatesNeighboursOneAfterTheOther) {
    RandomBits bits(1);
    std::vector<double> c(kRows), s(kRows);
    for (int32_t i = 0; i < kRows; ++i) {
        const double angle = 3.0 * Uniform(bits);
        c[Count(i)] = std::cos(angle);
        s[Count(i)] = std::sin(angle);
    }
    for (const int32_t width : kWidths) {
        for (const int32_t step : {1, -1}) {
            const int32_t first = step > 0 ? 1 : kRows - 2, count = kRows - 3;
            const DenseMatrix<double> a = RandomMatrix<double>(kRows, width, 2);
            DenseMatrix<double> actual = a, expected = a;
            RotateChain({actual.data(), width}, first, step, count, c.data(), s.data());
            for (int32_t k = 0; k < count; ++k)
                RotateRows(expected.data() + (first + k * step) * width,
                           expected.data() + (first + (k + 1) * step) * width, width, c[Count(k)], s[Count(k)]);
            EXPECT_EQ(actual, expected) << width;
        }
    }
}

TEST(RotateRows, TakesTheSecondIntoTheFirst) {
    std::vector<double> x{3.0, 1.0}, y{4.0, 0.0};
    RotateRows(x.data(), y.data(), 2, 0.6, 0.8);
    EXPECT_DOUBLE_EQ(x[0], 5.0);
    EXPECT_NEAR(y[0], 0.0, 1e-15);
    EXPECT_EQ(x[1], 0.6);
    EXPECT_EQ(y[1], -0.8);
}

// I - (x, y, z)^T (1, q, r) from the left on rows k to k + 2, or from the right on columns that stand as rows.
void Reflect(const BulgeReflector& f, bool from_left, bool is_short, int32_t k, DenseMatrix<double>* a) {
    for (int32_t j = 0; j < a->columns; ++j) {
        double& first = (*a)(k, j);
        double& second = (*a)(k + 1, j);
        double none = 0.0;
        double& third = is_short ? none : (*a)(k + 2, j);
        double p = from_left ? first + f.q * second : f.x * first + f.y * second;
        if (!is_short) p = p + (from_left ? f.r : f.z) * third;
        first -= from_left ? p * f.x : p;
        second -= p * (from_left ? f.y : f.q);
        third -= p * (from_left ? f.z : f.r);
    }
}

TEST(ReflectorChain, ReflectsTriplesOneAfterTheOther) {
    RandomBits bits(3);
    for (const bool ends_short : {false, true}) {
        const int32_t count = ends_short ? kRows - 1 : kRows - 2;
        std::vector<BulgeReflector> reflectors(Count(count));
        for (BulgeReflector& f : reflectors)
            f = {Uniform(bits), Uniform(bits), Uniform(bits), Uniform(bits), Uniform(bits)};
        const ReflectorChain chain{reflectors.data(), count, ends_short};
        for (const int32_t width : kWidths) {
            const DenseMatrix<double> a = RandomMatrix<double>(kRows, width, 4);
            DenseMatrix<double> expected_left = a, expected_right = a;
            for (int32_t k = 0; k < count; ++k) {
                const bool is_short = ends_short && k == count - 1;
                Reflect(reflectors[Count(k)], true, is_short, k, &expected_left);
                Reflect(reflectors[Count(k)], false, is_short, k, &expected_right);
            }
            OnEveryVectorUnit([&] {
                DenseMatrix<double> left = a, right = a, across = Adjoint(a);
                ReflectRowsByChain(chain, left.data(), width, width);
                ReflectTransposedByChain(chain, right.data(), width, width);
                ReflectColumnsByChain(chain, across.data(), kRows, width);
                EXPECT_EQ(left, expected_left) << width;
                EXPECT_EQ(right, expected_right) << width;
                EXPECT_EQ(Adjoint(across), expected_right) << width;
            });
        }
    }
}

TEST(RotationChain, RotatesComplexPairsOneAfterTheOther) {
    constexpr int32_t kLong = 70;  // several tiles
    RandomBits bits(5);
    std::vector<ComplexRotation> rotations(kLong - 1);
    for (ComplexRotation& r : rotations) r = {RandomElement<Complex>(bits), Uniform(bits)};
    for (const int32_t height : {2, 9, kLong}) {
        const RotationChain chain{rotations.data(), height - 1};
        for (const int32_t width : kWidths) {
            const DenseMatrix<Complex> a = RandomMatrix<Complex>(height, width, 6);
            DenseMatrix<Complex> expected_left = a, expected_right = a;
            for (int32_t k = 0; k < height - 1; ++k) {
                const auto [c, s] = rotations[Count(k)];
                const auto rotate = [k](Complex cosine, double sine, DenseMatrix<Complex>* b) {
                    for (int32_t j = 0; j < b->columns; ++j) {
                        const Complex y = (*b)(k, j), z = (*b)(k + 1, j);
                        (*b)(k, j) = cosine * y + sine * z;
                        (*b)(k + 1, j) = Conjugate(cosine) * z - sine * y;
                    }
                };
                rotate(Conjugate(c), s, &expected_left);
                rotate(c, s, &expected_right);
            }
            OnEveryVectorUnit([&] {
                DenseMatrix<Complex> left = a, right = a, across = Transposed(a);
                RotateRowsByChain(chain, left.data(), width, width);
                RotateTransposedByChain(chain, right.data(), width, width);
                RotateColumnsByChain(chain, across.data(), height, width);
                EXPECT_EQ(left, expected_left) << width;
                EXPECT_EQ(right, expected_right) << width;
                EXPECT_EQ(Transposed(across), expected_right) << width;
            });
        }
    }
}

TEST(Hypotenuse, NeitherOverflowsNorUnderflows) {
    EXPECT_EQ(Hypotenuse(0.0, 0.0), 0.0);
    EXPECT_EQ(Hypotenuse(-3.0, 0.0), 3.0);
    EXPECT_EQ(Hypotenuse(0.0, -3.0), 3.0);
    EXPECT_DOUBLE_EQ(Hypotenuse(3e200, -4e200), 5e200);
    EXPECT_DOUBLE_EQ(Hypotenuse(-4e-200, 3e-200), 5e-200);
    EXPECT_TRUE(std::isnan(Hypotenuse(kQuietNaN, 1.0)));
    EXPECT_TRUE(std::isnan(Hypotenuse(1.0, kQuietNaN)));
}

}  // namespace
}  // namespace krnumer
