// Convolution and correlation of planes, as cores.

#include "sigop/convolution2d.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "frame/status.h"
#include "sigop/signals.h"
#include "support/numbers.h"

namespace krnumer {
namespace {

template <class T>
struct Matrix {
    int32_t rows, columns;
    std::vector<T> values;
};

int32_t Run(const Matrix<double>& x, const Matrix<double>& y, double* z, int32_t part, int32_t algorithm) {
    return Convolve2DReal(x.values.data(), x.rows, x.columns, y.values.data(), y.rows, y.columns, z, part, algorithm);
}
int32_t Run(const Matrix<Complex>& x, const Matrix<Complex>& y, Complex* z, int32_t part, int32_t algorithm) {
    return Convolve2DComplex(x.values.data(), x.rows, x.columns, y.values.data(), y.rows, y.columns, z, part,
                             algorithm);
}
int32_t RunCorrelation(const Matrix<double>& x, const Matrix<double>& y, double* z, int32_t algorithm) {
    return Correlate2DReal(x.values.data(), x.rows, x.columns, y.values.data(), y.rows, y.columns, z, algorithm);
}
int32_t RunCorrelation(const Matrix<Complex>& x, const Matrix<Complex>& y, Complex* z, int32_t algorithm) {
    return Correlate2DComplex(x.values.data(), x.rows, x.columns, y.values.data(), y.rows, y.columns, z, algorithm);
}

template <class T>
std::vector<T> Convolution(const Matrix<T>& x, const Matrix<T>& y, int32_t part, int32_t algorithm) {
    const PlaneSize size = OutputSize({x.rows, x.columns}, {y.rows, y.columns}, part);
    std::vector<T> z(Count(size.rows) * Count(size.columns));
    EXPECT_EQ(Run(x, y, z.data(), part, algorithm), kOk);
    return z;
}

template <class T>
std::vector<T> Correlation(const Matrix<T>& x, const Matrix<T>& y, int32_t algorithm) {
    std::vector<T> z(Count(FullLength(x.rows, y.rows)) * Count(FullLength(x.columns, y.columns)));
    EXPECT_EQ(RunCorrelation(x, y, z.data(), algorithm), kOk);
    return z;
}

// In the stated order: rows of the smaller plane, then its columns.
template <class T>
std::vector<T> NaiveConvolution(const Matrix<T>& x, const Matrix<T>& y) {
    const bool x_is_kernel = x.values.size() < y.values.size();
    const Matrix<T>& kernel = x_is_kernel ? x : y;
    const Matrix<T>& other = x_is_kernel ? y : x;
    const int32_t rows = FullLength(x.rows, y.rows);
    const int32_t columns = FullLength(x.columns, y.columns);
    std::vector<T> z;
    for (int32_t r = 0; r < rows; ++r) {
        for (int32_t c = 0; c < columns; ++c) {
            T sum{};
            for (int32_t p = 0; p < kernel.rows; ++p) {
                for (int32_t q = 0; q < kernel.columns; ++q) {
                    if (r < p || r - p >= other.rows || c < q || c - q >= other.columns) continue;
                    sum += kernel.values[Count(p * kernel.columns + q)] *
                           other.values[Count((r - p) * other.columns + c - q)];
                }
            }
            z.push_back(sum);
        }
    }
    return z;
}

template <class T>
class PlaneTest : public testing::Test {
  protected:
    Matrix<T> RandomPlane(int32_t rows, int32_t columns) { return {rows, columns, random_.Samples<T>(rows * columns)}; }
    Matrix<T> RandomPlane(int32_t most) { return RandomPlane(random_.Integer(1, most), random_.Integer(1, most)); }

    RandomSignals random_;
};
using Elements = testing::Types<double, Complex>;
TYPED_TEST_SUITE(PlaneTest, Elements);

TYPED_TEST(PlaneTest, AgreesWithGoldenData) {
    using T = TypeParam;
    const Golden golden("convolution2d");
    const std::string kind = std::is_same_v<T, Complex> ? "complex" : "float";
    for (const std::string& name : golden.Cases(kind)) {
        SCOPED_TRACE(name);
        const auto sizes = golden.Integers(name + ".sizes");
        const Matrix<T> x{sizes[0], sizes[1], golden.Get<T>(name + ".x")};
        const Matrix<T> y{sizes[2], sizes[3], golden.Get<T>(name + ".y")};
        const auto near = [&](const char* what) { return AllNear(golden.Get<T>(name + what), 0.0, 2e-14); };
        for (const int32_t algorithm : {kDirect, kFrequencyDomain}) {
            EXPECT_THAT(Convolution(x, y, kFullOutput, algorithm), near(".full"));
            EXPECT_THAT(Convolution(x, y, kSameOutput, algorithm), near(".same"));
            EXPECT_THAT(Correlation(x, y, algorithm), near(".correlation"));
            const bool wide = x.rows < x.columns || y.rows < y.columns;
            if (x.rows < y.rows || x.columns < y.columns || (kind == "complex" && wide)) continue;
            EXPECT_THAT(Convolution(x, y, kValidOutput, algorithm), near(".valid"));
        }
    }
}

TYPED_TEST(PlaneTest, DirectSumsRunAlongRowsAndColumnsOfTheSmallerPlane) {
    for (int round = 0; round < 60; ++round) {
        const auto x = this->RandomPlane(round % 2 == 0 ? 6 : 50);
        const auto y = this->RandomPlane(round % 3 == 0 ? 40 : 7);
        EXPECT_THAT(Convolution(x, y, kFullOutput, kDirect), SameBitsAs(NaiveConvolution(x, y)));
    }
}

TYPED_TEST(PlaneTest, BothAlgorithmsAgreeInEveryPart) {
    for (int round = 0; round < 60; ++round) {
        const auto x = this->RandomPlane(30);
        const auto y = this->RandomPlane(round % 2 == 0 ? 4 : 30);
        const auto full = Convolution(x, y, kFullOutput, kDirect);
        EXPECT_THAT(Convolution(x, y, kFullOutput, kFrequencyDomain), AllNear(full, 0.0, 2e-13));
        const auto same = Convolution(x, y, kSameOutput, kDirect);
        EXPECT_THAT(Convolution(x, y, kSameOutput, kFrequencyDomain), AllNear(same, 0.0, 2e-13));
        const size_t columns = Count(FullLength(x.columns, y.columns));
        for (size_t r = 0; r < Count(x.rows); ++r)
            for (size_t c = 0; c < Count(x.columns); ++c)
                ASSERT_EQ(same[r * Count(x.columns) + c],
                          full[(r + Count(y.rows / 2)) * columns + c + Count(y.columns / 2)]);
    }
}

// Sizes with large prime factors: 53, 59 and 23.
TYPED_TEST(PlaneTest, TakesTheExactSizeInTheFrequencyDomain) {
    const auto x = this->RandomPlane(50, 54);
    const auto y = this->RandomPlane(4, 6);
    EXPECT_THAT(Convolution(x, y, kFullOutput, kFrequencyDomain),
                AllNear(Convolution(x, y, kFullOutput, kDirect), 0.0, 1e-13));
    const auto u = this->RandomPlane(20, 1);
    const auto v = this->RandomPlane(4, 1);
    EXPECT_THAT(Convolution(u, v, kFullOutput, kFrequencyDomain),
                AllNear(Convolution(u, v, kFullOutput, kDirect), 0.0, 1e-13));
}

TYPED_TEST(PlaneTest, RefusesInOrder) {
    const auto x = this->RandomPlane(2, 2);
    const auto y = this->RandomPlane(3, 3);
    TypeParam z[16] = {};
    for (int axis = 0; axis < 4; ++axis) {
        auto empty_x = x, empty_y = y;
        (axis == 0 ? empty_x.rows : axis == 1 ? empty_x.columns : axis == 2 ? empty_y.rows : empty_y.columns) = 0;
        EXPECT_EQ(Run(empty_x, empty_y, z, kValidOutput, 9), kEmptyInput);
        EXPECT_EQ(RunCorrelation(empty_x, empty_y, z, 9), kEmptyInput);
    }
    EXPECT_EQ(Run(x, y, z, kFullOutput, 2), kBadSelector);
    EXPECT_EQ(Run(x, y, z, kFullOutput, -1), kBadSelector);
    EXPECT_EQ(RunCorrelation(x, y, z, 2), kBadSelector);
    for (const TypeParam value : z) EXPECT_EQ(value, TypeParam{});
}

// Each of a pair of complex planes is compared with itself, not with the other.
TYPED_TEST(PlaneTest, TheValidPartAsksForShapes) {
    const bool real = std::is_same_v<TypeParam, double>;
    TypeParam z[64];
    const auto run = [&](PlaneSize x, PlaneSize y) {
        return Run(this->RandomPlane(x.rows, x.columns), this->RandomPlane(y.rows, y.columns), z, kValidOutput, 0);
    };
    EXPECT_EQ(run({2, 5}, {1, 1}), real ? kOk : kBadDimension);
    EXPECT_EQ(run({5, 3}, {1, 2}), real ? kOk : kBadDimension);
    EXPECT_EQ(run({5, 3}, {2, 1}), kOk);
    EXPECT_EQ(run({2, 2}, {3, 3}), real ? kBadDimension : kOk);  // nothing is left to write
    EXPECT_EQ(run({2, 5}, {9, 9}), kBadDimension);
}

}  // namespace
}  // namespace krnumer
