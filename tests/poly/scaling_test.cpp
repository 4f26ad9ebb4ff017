// Scaling and linear maps in place.

#include "poly/scaling.h"

#include <random>
#include <vector>

#include "frame/numeric.h"
#include "frame/status.h"
#include "krnumer/vector.h"
#include "support/host_arrays.h"

namespace krnumer {
namespace {

using testing::Each;
using testing::ElementsAre;

class Scaling : public testing::Test {
  protected:
    LeakCheck leaks_;
    double scale_ = -7.0;
    double offset_ = -7.0;
    int32_t err_ = 77;
};

TEST_F(Scaling, ToTheUnitRange) {
    HostArray<double> x{3, 7, 5, 4};
    EXPECT_EQ(Scale1DCIN(x.handle(), &offset_, &scale_, &err_), 0);
    EXPECT_EQ(err_, 0);
    EXPECT_EQ(scale_, 2.0);
    EXPECT_EQ(offset_, 5.0);
    EXPECT_THAT(x.values(), ElementsAre(-1, 1, 0, -0.5));
    HostMatrix<double> m(2, 2, {3, 7, 5, 4});
    EXPECT_EQ(Scale(m.handle(), &scale_, &offset_, &err_), 0);
    EXPECT_EQ(scale_, 2.0);
    EXPECT_EQ(offset_, 5.0);
    EXPECT_THAT(m.values(), ElementsAre(-1, 1, 0, -0.5));
    EXPECT_EQ(m.rows(), 2);
}

TEST_F(Scaling, ConstantsBecomeZero) {
    HostArray<double> x{4, 4, 4};
    EXPECT_EQ(Scale1DCIN(x.handle(), &offset_, &scale_, &err_), 0);
    EXPECT_EQ(scale_, 1.0);
    EXPECT_EQ(offset_, 4.0);
    EXPECT_THAT(x.values(), Each(0.0));
    HostArray<double> close{0.0, 4e-324, 0.0};  // the reciprocal of the extent overflows
    EXPECT_EQ(Scale1DCIN(close.handle(), &offset_, &scale_, &err_), 0);
    EXPECT_EQ(scale_, 1.0);
    EXPECT_EQ(offset_, 4e-324);
}

TEST_F(Scaling, LeavesNaNOut) {
    HostArray<double> x{kQuietNaN, 1, kQuietNaN, 3};
    EXPECT_EQ(Scale1DCIN(x.handle(), &offset_, &scale_, &err_), 0);
    EXPECT_EQ(scale_, 1.0);
    EXPECT_EQ(offset_, 2.0);
    EXPECT_TRUE(std::isnan(x[0]));
    EXPECT_EQ(x[1], -1.0);
    EXPECT_EQ(x[3], 1.0);
    HostArray<double> none{kQuietNaN, kQuietNaN};
    EXPECT_EQ(Scale1DCIN(none.handle(), &offset_, &scale_, &err_), 0);
    EXPECT_EQ(err_, 0);
    EXPECT_TRUE(IsQuietNaN(scale_));
    EXPECT_TRUE(IsQuietNaN(offset_));
    EXPECT_EQ(none.size(), 2);
    EXPECT_TRUE(std::isnan(none[0]));
}

TEST_F(Scaling, ByTheReciprocal) {
    HostArray<double> x{49, -49, 0};
    EXPECT_EQ(Scale1DCIN(x.handle(), &offset_, &scale_, &err_), 0);
    EXPECT_EQ(x[0], 49.0 * (1.0 / 49.0));
    EXPECT_NE(x[0], 1.0);
    HostArray<double> y{49, 7};
    EXPECT_EQ(QS1D(y.handle(), &scale_, &err_), 0);
    EXPECT_EQ(y[0], 49.0 * (1.0 / 49.0));
}

TEST_F(Scaling, ByTheLargestMagnitude) {
    HostArray<double> x{1, -4, 2, kQuietNaN};
    EXPECT_EQ(QS1D(x.handle(), &scale_, &err_), 0);
    EXPECT_EQ(scale_, 4.0);
    EXPECT_THAT(x.values(), SameBitsAs(std::vector<double>{0.25, -1, 0.5, kQuietNaN}));
    HostMatrix<double> m(1, 3, {1, -4, 2});
    EXPECT_EQ(QScale(m.handle(), &scale_, &err_), 0);
    EXPECT_EQ(scale_, 4.0);
    EXPECT_THAT(m.values(), ElementsAre(0.25, -1, 0.5));
}

TEST_F(Scaling, ZerosStay) {
    HostArray<double> x{0.0, -0.0};
    EXPECT_EQ(QS1D(x.handle(), &scale_, &err_), 0);
    EXPECT_EQ(err_, 0);
    EXPECT_EQ(scale_, 0.0);
    EXPECT_THAT(x.values(), SameBitsAs(std::vector<double>{0.0, -0.0}));
}

TEST_F(Scaling, ToMeanAndDeviation) {
    HostArray<double> x{2, 4, 4, 4, 5, 5, 7, 9};
    double deviation = -7.0, mean = -7.0;
    EXPECT_EQ(Norm1(x.handle(), &deviation, &mean, &err_), 0);
    EXPECT_EQ(err_, 0);
    EXPECT_EQ(deviation, 2.0);
    EXPECT_EQ(mean, 5.0);
    EXPECT_THAT(x.values(), ElementsAre(-1.5, -0.5, -0.5, -0.5, 0, 0, 1, 2));
    HostMatrix<double> m(2, 4, {2, 4, 4, 4, 5, 5, 7, 9});
    EXPECT_EQ(Norm2(m.handle(), &deviation, &mean, &err_), 0);
    EXPECT_EQ(deviation, 2.0);
    EXPECT_EQ(mean, 5.0);
    EXPECT_EQ(m(1, 3), 2.0);
}

TEST_F(Scaling, ConstantsHaveNoDeviation) {
    HostArray<double> x{3, 3, 3};
    EXPECT_EQ(Norm1(x.handle(), &scale_, &offset_, &err_), 0);
    EXPECT_EQ(err_, 0);
    EXPECT_EQ(scale_, 0.0);
    EXPECT_EQ(offset_, 3.0);
    for (const double value : x.values()) EXPECT_TRUE(std::isnan(value));
}

TEST_F(Scaling, AlongALine) {
    const double slope = 2.0, intercept = -1.0;
    HostArray<double> x{0, 1, 2.5};
    EXPECT_EQ(Line1(x.handle(), &slope, &intercept, &err_), 0);
    EXPECT_EQ(err_, 0);
    EXPECT_THAT(x.values(), ElementsAre(-1, 1, 4));
    HostMatrix<double> m(3, 1, {0, 1, 2.5});
    EXPECT_EQ(LinEv(m.handle(), &slope, &intercept, &err_), 0);
    EXPECT_THAT(m.values(), ElementsAre(-1, 1, 4));
}

TEST_F(Scaling, MultipliesBeforeItAdds) {
    const double slope = 1.0 + 0x1p-30, intercept = -1.0 - 0x1p-29;
    HostArray<double> x{slope};  // the square needs more digits than a double has
    EXPECT_EQ(Line1(x.handle(), &slope, &intercept, &err_), 0);
    EXPECT_EQ(x[0], 0.0) << "no fused operation";
}

TEST_F(Scaling, OfNothing) {
    const double one = 1.0;
    const auto expect_empty = [this](const HostBlock& x, int32_t result) {
        EXPECT_EQ(result, 0);
        EXPECT_EQ(err_, kEmptyInput);
        EXPECT_TRUE(x.empty());
        err_ = 77;
    };
    const auto expect_scalars = [this] {
        EXPECT_TRUE(IsQuietNaN(scale_));
        EXPECT_TRUE(IsQuietNaN(offset_));
        scale_ = offset_ = -7.0;
    };
    HostArray<double> x;
    expect_empty(x, Scale1DCIN(x.handle(), &offset_, &scale_, &err_));
    expect_scalars();
    expect_empty(x, Norm1(x.handle(), &scale_, &offset_, &err_));
    expect_scalars();
    expect_empty(x, QS1D(x.handle(), &scale_, &err_));
    EXPECT_TRUE(IsQuietNaN(scale_));
    expect_empty(x, Line1(x.handle(), &one, &one, &err_));
    for (const auto& [rows, columns] : {std::pair(0, 0), std::pair(0, 3), std::pair(3, 0)}) {
        HostMatrix<double> m(rows, columns);
        expect_empty(m, Scale(m.handle(), &scale_, &offset_, &err_));
        expect_scalars();
        m = HostMatrix<double>(rows, columns);
        expect_empty(m, Norm2(m.handle(), &scale_, &offset_, &err_));
        expect_scalars();
        m = HostMatrix<double>(rows, columns);
        expect_empty(m, QScale(m.handle(), &scale_, &err_));
        EXPECT_TRUE(IsQuietNaN(scale_));
        m = HostMatrix<double>(rows, columns);
        expect_empty(m, LinEv(m.handle(), &one, &one, &err_));
    }
}

TEST_F(Scaling, RandomDataFillTheRangeAndHaveDeviationOne) {
    std::mt19937_64 random(7);
    std::normal_distribution<double> normal(3.0, 20.0);
    for (int32_t n = 2; n < 200; n += 7) {
        std::vector<double> samples(static_cast<std::size_t>(n));
        for (double& sample : samples) sample = normal(random);
        HostArray<double> x(samples);
        Scale1DCIN(x.handle(), &offset_, &scale_, &err_);
        double largest = 0.0;
        for (int32_t i = 0; i < n; ++i) {
            largest = std::max(largest, std::fabs(x[i]));
            EXPECT_THAT(x[i] * scale_ + offset_, Near(samples[static_cast<std::size_t>(i)], 1e-14, 1e-14 * scale_));
        }
        EXPECT_THAT(largest, Near(1.0, 1e-14));
        HostArray<double> y(samples);
        Norm1(y.handle(), &scale_, &offset_, &err_);
        double sum = 0.0, squares = 0.0;
        for (const double value : y.values()) {
            sum += value;
            squares += value * value;
        }
        EXPECT_THAT(sum / n, Near(0.0, 0.0, 1e-13));
        EXPECT_THAT(squares / n, Near(1.0, 1e-13));
    }
}

TEST(ScalingCores, WriteElsewhere) {
    double x[] = {1, 3};
    double y[2], first, second;
    EXPECT_EQ(ScaleToUnitRange(x, 2, &first, &second, y), 0);
    EXPECT_THAT(y, ElementsAre(-1, 1));
    EXPECT_EQ(ScaleByMagnitude(x, 2, &first, y), 0);
    EXPECT_EQ(y[1], 3.0 * (1.0 / 3.0));
    EXPECT_EQ(Standardize(x, 2, &first, &second, y), 0);
    EXPECT_THAT(y, ElementsAre(-1, 1));
    EXPECT_EQ(MapLinearly(x, 2, 2.0, 1.0, y), 0);
    EXPECT_THAT(y, ElementsAre(3, 7));
    EXPECT_THAT(x, ElementsAre(1, 3));
    double none[] = {kQuietNaN};
    EXPECT_EQ(ScaleToUnitRange(none, 1, &first, &second, y), 0);
    EXPECT_TRUE(std::isnan(y[0]));
    EXPECT_EQ(MapLinearly(x, 0, 2.0, 1.0, y), kEmptyInput);
    EXPECT_EQ(ScaleByMagnitude(x, -1, &first, y), kEmptyInput);
}

}  // namespace
}  // namespace krnumer
