// Interpolation, splines and the removal of outliers, through their exports.

#include "krnumer/interpolation.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cmath>
#include <fstream>
#include <sstream>

#include "frame/numeric.h"
#include "frame/status.h"
#include "support/host_arrays.h"

namespace krnumer {
namespace {

using testing::ElementsAre;
using Values = std::vector<double>;

class Interpolation : public testing::Test {
  protected:
    LeakCheck leaks_;
    double value_ = -9.0;
    double estimate_ = -9.0;
    int32_t err_ = 77;

    using Function = int32_t (*)(KrHandle, KrHandle, const double*, double*, double*, int32_t*);

    int32_t Call(Function interpolate, const Values& y, const Values& x, double x0) {
        err_ = 77;
        EXPECT_EQ(
            interpolate(HostArray<double>(y).handle(), HostArray<double>(x).handle(), &x0, &value_, &estimate_, &err_),
            0);
        return err_;
    }
    void ExpectNaN() const {
        EXPECT_TRUE(IsQuietNaN(value_));
        EXPECT_TRUE(IsQuietNaN(estimate_));
    }
};

TEST_F(Interpolation, ReproducesPolynomials) {
    const auto cubic = [](double x) { return ((2.0 * x - 1.0) * x + 3.0) * x - 5.0; };
    const Values x{3, -1, 0.5, 2, 5, -2};
    Values y;
    for (const double point : x) y.push_back(cubic(point));
    for (const double x0 : {-3.0, -1.0, 0.0, 1.25, 4.9, 8.0}) {
        ASSERT_EQ(Call(PolyInterp_head, y, x, x0), 0);
        EXPECT_NEAR(value_, cubic(x0), 1e-11);
        EXPECT_NEAR(estimate_, 0.0, 1e-10) << "the last two degrees correct nothing";
    }
}

TEST_F(Interpolation, ReproducesRationalFunctions) {
    const auto rational = [](double x) { return (1.0 + 2.0 * x) / (3.0 + x * x); };
    Values x;
    Values y;
    for (int i = 0; i < 5; ++i) {
        x.push_back(0.7 * i);
        y.push_back(rational(x.back()));
    }
    for (const double x0 : {0.1, 0.9, 1.5, 2.6}) {
        ASSERT_EQ(Call(RatInterp_head, y, x, x0), 0);
        EXPECT_NEAR(value_, rational(x0), 1e-8);
    }
}

TEST_F(Interpolation, GivesTheOrdinateAtAPoint) {
    const Values x{4, 1, 3, 2};
    const Values y{10, 20, 15, 70};
    for (size_t i = 0; i < x.size(); ++i) {
        ASSERT_EQ(Call(PolyInterp_head, y, x, x[i]), 0);
        EXPECT_NEAR(value_, y[i], 1e-13);
        EXPECT_TRUE(std::isfinite(estimate_));
        ASSERT_EQ(Call(RatInterp_head, y, x, x[i]), 0);
        EXPECT_EQ(value_, y[i]);
        EXPECT_EQ(estimate_, 0.0);
    }
    ASSERT_EQ(Call(RatInterp_head, {7, 8}, {1, 1}, 1.0), 0);
    EXPECT_EQ(value_, 7.0) << "the first of equal points";
}

TEST_F(Interpolation, OfASinglePointIsConstant) {
    for (const Function interpolate : {PolyInterp_head, RatInterp_head}) {
        ASSERT_EQ(Call(interpolate, {7}, {2}, 5.0), 0);
        EXPECT_EQ(value_, 7.0);
        EXPECT_EQ(estimate_, 0.0);
    }
}

TEST_F(Interpolation, RefusesWhatItCannotInterpolate) {
    for (const Function interpolate : {PolyInterp_head, RatInterp_head}) {
        EXPECT_EQ(Call(interpolate, {1, 2}, {1}, 0.0), kSizesDiffer);
        ExpectNaN();
        EXPECT_EQ(Call(interpolate, {}, {}, 0.0), kEmptyInput);
        ExpectNaN();
    }
    EXPECT_EQ(Call(PolyInterp_head, {1, 2, 3}, {1, 2, 1}, 2.0), kRepeatedAbscissa) << "even at a point of the table";
    ExpectNaN();
}

TEST_F(Interpolation, RefusesAPole) {
    // 1/x through (-1, -1) and (1, 1) has its pole at 0; the tableau meets t = c exactly there.
    EXPECT_EQ(Call(RatInterp_head, {-1.0 - 1e-10, 1}, {-1, 1}, 0.0), kInterpolantPole);
    ExpectNaN();
}

// ---- Splines ----

struct SplineReference {
    std::string kind;
    int32_t n;
    double first, second;
    Values x, y, w, result;
};

std::vector<SplineReference> References() {
    std::ifstream in(std::string(KRNUMER_REFERENCE) + "/splines.csv");
    std::vector<SplineReference> all;
    for (std::string line; std::getline(in, line);) {
        std::istringstream cells(line);
        std::vector<std::string> words;
        for (std::string word; std::getline(cells, word, ',');) words.push_back(word);
        SplineReference one{words[0], std::stoi(words[1]), std::stod(words[2]), std::stod(words[3]), {}, {}, {}, {}};
        size_t next = 4;
        for (Values* values : {&one.x, &one.y, &one.w, &one.result})
            for (int32_t i = 0; i < one.n; ++i) values->push_back(std::stod(words[next++]));
        all.push_back(std::move(one));
    }
    EXPECT_EQ(all.size(), 28u);
    return all;
}

class Splines : public testing::Test {
  protected:
    LeakCheck leaks_;
    HostArray<double> y2_{9};
    double value_ = -9.0;
    double residue_ = -9.0;
    int32_t err_ = 77;

    int32_t Second(const Values& y, const Values& x, double first = 1e30, double last = 1e30) {
        EXPECT_EQ(Spline_head(HostArray<double>(y).handle(), HostArray<double>(x).handle(), &first, &last, y2_.handle(),
                              &err_),
                  0);
        return err_;
    }
    int32_t Evaluate(const Values& y, const Values& x, const Values& y2, double x0) {
        EXPECT_EQ(SpInterp_head(HostArray<double>(y).handle(), HostArray<double>(x).handle(),
                                HostArray<double>(y2).handle(), &x0, &value_, &err_),
                  0);
        return err_;
    }
    int32_t Smooth(Values& y, const Values& x, const Values& w, const Values& lambda, double p) {
        HostArray<double> ordinates(y);
        const int32_t status =
            CubicSplineFit_head(ordinates.handle(), HostArray<double>(x).handle(), HostArray<double>(w).handle(),
                                HostArray<double>(lambda).handle(), p, &residue_);
        y = ordinates.values();
        return status;
    }
};

TEST_F(Splines, RefuseMalformedArrays) {
    HostArray<double> y{1, 2, 3}, x{1, 2, 3}, none;
    y.SetDimension(0, INT32_MIN);
    EXPECT_EQ(CubicSplineFit_head(y.handle(), x.handle(), none.handle(), none.handle(), 0.5, &residue_), kSizesDiffer);
    EXPECT_TRUE(y.empty());
}

TEST_F(Splines, AgreeWithSciPy) {
    for (const SplineReference& one : References()) {
        if (one.kind == "smooth") {
            Values y = one.y;
            ASSERT_EQ(Smooth(y, one.x, one.w, {}, one.first), 0);
            for (size_t i = 0; i < y.size(); ++i) EXPECT_NEAR(y[i], one.result[i], 1e-9) << one.n << " " << one.first;
        } else {
            ASSERT_EQ(Second(one.y, one.x, one.first, one.second), 0);
            for (int32_t i = 0; i < one.n; ++i) EXPECT_NEAR(y2_[i], one.result[static_cast<size_t>(i)], 1e-11) << one.n;
        }
    }
}

TEST_F(Splines, PassThroughTheirPointsAndGoOnBeyondThem) {
    const Values x{0, 1, 3, 4};
    const Values y{1, 3, -2, 0};
    ASSERT_EQ(Second(y, x, 0.5, -1.0), 0);
    const Values y2 = y2_.values();
    for (size_t i = 0; i < x.size(); ++i) {
        ASSERT_EQ(Evaluate(y, x, y2, x[i]), 0);
        EXPECT_NEAR(value_, y[i], 1e-15);
    }
    // The end piece is one cubic: its fourth difference vanishes across the end of the table.
    double f[5];
    for (int i = 0; i < 5; ++i) {
        ASSERT_EQ(Evaluate(y, x, y2, 3.5 + 0.25 * i), 0);
        f[i] = value_;
    }
    EXPECT_NEAR(f[0] - 4 * f[1] + 6 * f[2] - 4 * f[3] + f[4], 0.0, 1e-13);
    ASSERT_EQ(Evaluate(y, x, y2, 1e-4), 0);
    EXPECT_NEAR((value_ - y[0]) / 1e-4, 0.5, 1e-3) << "the slope at the first end";
}

TEST_F(Splines, OnDescendingTablesAreTheSame) {
    const Values x{0, 1, 3, 4};
    const Values y{1, 3, -2, 0};
    const Values x_down(x.rbegin(), x.rend());
    const Values y_down(y.rbegin(), y.rend());
    ASSERT_EQ(Second(y, x), 0);
    const Values up = y2_.values();
    ASSERT_EQ(Second(y_down, x_down), 0);
    const Values down = y2_.values();
    for (const double x0 : {-1.0, 0.0, 0.3, 1.0, 2.0, 3.7, 4.0, 6.0}) {
        ASSERT_EQ(Evaluate(y, x, up, x0), 0);
        const double expected = value_;
        ASSERT_EQ(Evaluate(y_down, x_down, down, x0), 0);
        EXPECT_NEAR(value_, expected, 1e-13);
    }
}

TEST_F(Splines, AreNaturalFromACertainSlopeOn) {
    const Values x{0, 1, 3, 4};
    const Values y{1, 3, -2, 0};
    ASSERT_EQ(Second(y, x, 9.9e29, 1e30), 0);
    EXPECT_EQ(y2_[0], 0.0);
    EXPECT_EQ(y2_[3], 0.0);
    ASSERT_EQ(Second(y, x, std::nextafter(9.9e29, 0.0), 1e30), 0);
    EXPECT_NE(y2_[0], 0.0);
}

TEST_F(Splines, OfFewPoints) {
    ASSERT_EQ(Second({5}, {1}, 2.0, 3.0), 0);
    EXPECT_THAT(y2_.values(), ElementsAre(0));
    ASSERT_EQ(Second({5, 7}, {1, 1}), 0) << "two equal abscissas with natural ends are not looked at";
    EXPECT_THAT(y2_.values(), ElementsAre(0, 0));
    EXPECT_EQ(Second({}, {}), kEmptyInput);
    EXPECT_TRUE(y2_.empty());
}

TEST_F(Splines, RefuseRepeatedAbscissas) {
    for (const Values& x : {Values{0, 0, 1}, Values{0, 1, 1}, Values{1, 0, 1}}) {
        EXPECT_EQ(Second({1, 2, 3}, x), kRepeatedAbscissa);
        EXPECT_TRUE(y2_.empty());
    }
    EXPECT_EQ(Second({1, 2}, {1}), kSizesDiffer);
    EXPECT_EQ(Evaluate({1, 2, 3}, {0, 1, 1}, {0, 0, 0}, 5.0), kRepeatedAbscissa);
    EXPECT_TRUE(IsQuietNaN(value_));
    EXPECT_EQ(Evaluate({1, 2}, {0}, {0}, 5.0), kSizesDiffer);
    EXPECT_EQ(Evaluate({1}, {0}, {0, 0}, 5.0), kSizesDiffer);
    EXPECT_EQ(Evaluate({}, {}, {}, 5.0), kEmptyInput);
    EXPECT_EQ(Evaluate({1}, {0}, {0}, 5.0), kRepeatedAbscissa) << "a single point has no width";
}

TEST_F(Splines, HandOnTheHostsStatus) {
    HostArray<double> x{1, 2};
    const double slope = 0.0;
    const FailResize fail(1, 4711);
    EXPECT_EQ(Spline_head(x.handle(), x.handle(), &slope, &slope, y2_.handle(), &err_), 4711);
    EXPECT_EQ(err_, kOutOfMemory);
    EXPECT_TRUE(y2_.empty());
}

TEST_F(Splines, AreNotEvaluatedWithoutABlock) {
    HostArray<double> x{1, 2};
    KrBlock* nothing = nullptr;
    const double x0 = 1.5;
    for (int missing = 0; missing < 3; ++missing) {
        KrHandle tables[] = {x.handle(), x.handle(), x.handle()};
        tables[missing] = &nothing;
        EXPECT_EQ(SpInterp_head(tables[0], tables[1], tables[2], &x0, &value_, &err_), 0);
        EXPECT_EQ(err_, kEmptyInput);
        EXPECT_TRUE(IsQuietNaN(value_));
    }
}

TEST_F(Splines, SmoothToARegressionLine) {
    const Values x{0, 1, 2, 4, 5, 7, 8, 9};
    Values y{1, 3, 2, 6, 5, 9, 8, 11};
    const Values w{1, 2, 1, 1, 3, 1, 1, 2};
    double s = 0, sx = 0, sy = 0, sxx = 0, sxy = 0;
    for (size_t i = 0; i < x.size(); ++i) {
        s += w[i];
        sx += w[i] * x[i];
        sy += w[i] * y[i];
        sxx += w[i] * x[i] * x[i];
        sxy += w[i] * x[i] * y[i];
    }
    const double slope = (s * sxy - sx * sy) / (s * sxx - sx * sx);
    const double intercept = (sy - slope * sx) / s;
    ASSERT_EQ(Smooth(y, x, w, {}, 0.0), 0);
    for (size_t i = 0; i < x.size(); ++i) EXPECT_NEAR(y[i], intercept + slope * x[i], 1e-12);
    EXPECT_NEAR(residue_, 0.0, 1e-20) << "p is 0, and a line has no curvature";
}

TEST_F(Splines, LeaveTheDataAtFullBalance) {
    const Values y{1, 3, 2, 6};
    for (const Values& x : {Values{0, 1, 2, 4}, Values{4, 2, 1, 0}}) {
        Values smoothed = y;
        ASSERT_EQ(Smooth(smoothed, x, {0, 0, 0, 0}, {}, 1.0), 0) << "neither steps nor weights are looked at";
        EXPECT_EQ(smoothed, y);
        EXPECT_EQ(residue_, 0.0);
    }
    Values repeated = y;
    EXPECT_EQ(Smooth(repeated, {0, 1, 1, 2}, {}, {}, 1.0), kRepeatedAbscissa);
    EXPECT_TRUE(repeated.empty());
}

TEST_F(Splines, ChooseTheirBalanceOutsideZeroToOne) {
    const Values x{0, 1, 2, 4, 5, 7, 8, 9};
    const Values y{1, 3, 2, 6, 5, 9, 8, 11};
    const double p = 8.0 / (8.0 + std::pow(9.0 / 8.0, 3));
    Values expected = y;
    ASSERT_EQ(Smooth(expected, x, {}, {}, p), 0);
    for (const double balance : {-1.0, 2.0, kQuietNaN}) {
        Values smoothed = y;
        ASSERT_EQ(Smooth(smoothed, x, {}, {}, balance), 0);
        EXPECT_EQ(smoothed, expected);
    }
    Values x_close = x;
    for (double& value : x_close) value *= 1e-7;  // where the balance rounds to 1
    Values smoothed = y;
    ASSERT_EQ(Smooth(smoothed, x_close, {}, {}, -1.0), 0);
    EXPECT_EQ(smoothed, y);
}

TEST_F(Splines, WeighTheRoughnessOfEachInterval) {
    const Values x{0, 1, 2, 3, 4, 5, 6, 7};
    const Values y{0, 0, 0, 5, 5, 0, 0, 0};
    Values even = y;
    ASSERT_EQ(Smooth(even, x, {}, Values(7, 1.0), 0.5), 0);
    Values plain = y;
    ASSERT_EQ(Smooth(plain, x, {}, {}, 0.5), 0);
    EXPECT_EQ(even, plain);
    Values negative = y;
    ASSERT_EQ(Smooth(negative, x, Values(8, -1.0), Values(7, -1.0), 0.5), 0);
    EXPECT_EQ(negative, plain) << "weights count by magnitude";
    // A function with a stiffer middle is smoother there: compare the functional of both with the stiff weights.
    const Values stiff{1, 1, 100, 100, 100, 1, 1};
    Values fitted = y;
    ASSERT_EQ(Smooth(fitted, x, {}, stiff, 0.5), 0);
    const double best = residue_;
    Values other = y;
    ASSERT_EQ(Smooth(other, x, {}, {}, 0.5), 0);
    EXPECT_NE(fitted, other);
    EXPECT_GT(best, residue_) << "stiffness costs";
}

TEST_F(Splines, SmoothWithoutAbscissasOverIndices) {
    const Values y{1, 3, 2, 6, 5, 9, 8, 11};
    Values expected = y;
    ASSERT_EQ(Smooth(expected, {0, 1, 2, 3, 4, 5, 6, 7}, {}, {}, 0.5), 0);
    Values smoothed = y;
    ASSERT_EQ(Smooth(smoothed, {}, {}, {}, 0.5), 0);
    EXPECT_EQ(smoothed, expected);
}

TEST_F(Splines, SmoothingChecksItsData) {
    const auto expect = [this](Values y, const Values& x, const Values& w, const Values& lambda, double p,
                               int32_t status) {
        residue_ = -9.0;
        EXPECT_EQ(Smooth(y, x, w, lambda, p), status);
        EXPECT_TRUE(y.empty());
        EXPECT_TRUE(IsQuietNaN(residue_));
    };
    const Values seven{1, 2, 3, 4, 5, 6, 7};
    expect(seven, {1, 2}, {}, {}, 0.5, kSizesDiffer);
    expect(seven, seven, {1}, {}, 0.5, kSizesDiffer);
    expect(seven, seven, {}, seven, 0.5, kSizesDiffer);
    expect({}, {}, {}, {}, 0.5, kFewerThanTwo);
    expect({1}, {1}, {}, {}, 0.5, kFewerThanTwo);
    expect(seven, {1, 2, 2, 4, 5, 6, 7}, {}, {}, 0.5, kRepeatedAbscissa);
    expect(seven, {7, 6, 5, 4, 3, 2, 1}, {}, {}, 2.0, kRepeatedAbscissa);
    expect(seven, {1, 2, kQuietNaN, 4, 5, 6, 7}, {}, {}, 0.5, kRepeatedAbscissa);
    expect(seven, seven, {1, 1, 0, 1, 1, 1, 1}, {}, 0.5, kZeroParameter);
    expect(seven, seven, {}, {1, 1, 0, 1, 1, 1}, 0.5, kZeroParameter);
    for (const int32_t n : {3, 4, 5, 6}) {
        const Values few(seven.begin(), seven.begin() + n);
        expect(few, few, {}, {}, 0.5, kBadDimension);
    }
    Values two{1, 2};
    EXPECT_EQ(Smooth(two, {5, 5}, {0, 0}, {}, 0.5), 0) << "two points are not looked at";
    EXPECT_EQ(residue_, 0.0);
    EXPECT_EQ(two, (Values{1, 2}));
}

// ---- Outliers ----

class Outliers : public testing::Test {
  protected:
    LeakCheck leaks_;
    Values y_{1, 2, 3, 4};
    Values x_{10, 20, 30, 40};
    Values w_;
    HostArray<double> y_out_{9}, x_out_{9}, w_out_{9};
    HostArray<uint8_t> mask_{9};
    HostArray<int32_t> removed_{9};

    int32_t ByIndex(const std::vector<int32_t>& indices) {
        return RmvOutlierIndx_head(HostArray<double>(y_).handle(), HostArray<double>(x_).handle(),
                                   HostArray<double>(w_).handle(), HostArray<int32_t>(indices).handle(),
                                   y_out_.handle(), x_out_.handle(), w_out_.handle(), mask_.handle());
    }
    int32_t ByRange(const Values& range, int32_t selector) {
        return RmvOutlierRng_head(HostArray<double>(y_).handle(), HostArray<double>(x_).handle(),
                                  HostArray<double>(w_).handle(), HostArray<double>(range).handle(), selector,
                                  y_out_.handle(), x_out_.handle(), w_out_.handle(), removed_.handle());
    }
    void ExpectEmptied(const auto& last) const {
        EXPECT_TRUE(y_out_.empty());
        EXPECT_TRUE(x_out_.empty());
        EXPECT_TRUE(w_out_.empty());
        EXPECT_TRUE(last.empty());
    }
};

TEST_F(Outliers, AreRemovedByIndex) {
    w_ = {5, 6, 7, 8};
    EXPECT_EQ(ByIndex({2, 0, 2}), 0);
    EXPECT_THAT(y_out_.values(), ElementsAre(2, 4));
    EXPECT_THAT(x_out_.values(), ElementsAre(20, 40));
    EXPECT_THAT(w_out_.values(), ElementsAre(6, 8));
    EXPECT_THAT(mask_.values(), ElementsAre(1, 0, 1, 0));
    w_.clear();
    EXPECT_EQ(ByIndex({0, 1, 2, 3}), 0);
    EXPECT_TRUE(y_out_.empty());
    EXPECT_TRUE(w_out_.empty());
    EXPECT_THAT(mask_.values(), ElementsAre(1, 1, 1, 1));
}

TEST_F(Outliers, ByIndexChecksInOrder) {
    for (const int32_t index : {4, -1}) {
        EXPECT_EQ(ByIndex({0, index}), kBadIndex);
        ExpectEmptied(mask_);
    }
    EXPECT_EQ(ByIndex({}), kEmptyInput);
    ExpectEmptied(mask_);
    w_ = {1};
    EXPECT_EQ(ByIndex({}), kSizesDiffer);
    y_.clear();
    EXPECT_EQ(ByIndex({}), kEmptyInput);
}

TEST_F(Outliers, AreRemovedByRange) {
    EXPECT_EQ(ByRange({4, 1}, 0), 0);
    EXPECT_THAT(y_out_.values(), ElementsAre(2, 3)) << "points on a bound go";
    EXPECT_THAT(removed_.values(), ElementsAre(0, 3));
    EXPECT_EQ(ByRange({15, 35}, 1), 0);
    EXPECT_THAT(x_out_.values(), ElementsAre(20, 30));
    EXPECT_EQ(ByRange({5, 35, 2.5, 9}, 2), 0);
    EXPECT_THAT(y_out_.values(), ElementsAre(3)) << "the pair for x comes first";
    EXPECT_EQ(ByRange({0, 9}, 0x10000), 0) << "the low 16 bits of the selector count";
    EXPECT_THAT(y_out_.values(), ElementsAre(1, 2, 3, 4));
    EXPECT_TRUE(removed_.empty());
}

TEST_F(Outliers, ThatAreNaNStay) {
    y_[1] = kQuietNaN;
    EXPECT_EQ(ByRange({2.5, 3.5}, 0), 0);
    EXPECT_THAT(x_out_.values(), ElementsAre(20, 30));
}

TEST_F(Outliers, ByRangeChecksInOrder) {
    EXPECT_EQ(ByRange({}, 7), kEmptyInput);
    ExpectEmptied(removed_);
    for (const int32_t selector : {3, 7, -1, 0xFFFF}) EXPECT_EQ(ByRange({kQuietNaN}, selector), kBadSelector);
    EXPECT_EQ(ByRange({kQuietNaN}, 0), kFewerThanTwo);
    EXPECT_EQ(ByRange({kQuietNaN}, 1), kFewerThanTwo);
    EXPECT_EQ(ByRange({1, 2, kQuietNaN}, 2), kTooFewForGaussian);
    EXPECT_EQ(ByRange({1, kQuietNaN}, 0), kNotFinite);
    EXPECT_EQ(ByRange({1, 2, 3, kQuietNaN}, 2), kNotFinite);
    ExpectEmptied(removed_);
    EXPECT_EQ(ByRange({0, 9, kQuietNaN}, 0), 0) << "a bound that is not used does not count";
    x_.pop_back();
    EXPECT_EQ(ByRange({}, 7), kSizesDiffer);
    y_.clear();
    EXPECT_EQ(ByRange({}, 7), kEmptyInput);
}

TEST_F(Outliers, MayBeTakenOutInPlace) {
    HostArray<double> y(y_);
    HostArray<double> x(x_);
    HostArray<int32_t> indices{1};
    HostArray<double> none;
    EXPECT_EQ(RmvOutlierIndx_head(y.handle(), x.handle(), none.handle(), indices.handle(), y.handle(), x.handle(),
                                  w_out_.handle(), mask_.handle()),
              0);
    EXPECT_THAT(y.values(), ElementsAre(1, 3, 4));
    EXPECT_THAT(x.values(), ElementsAre(10, 30, 40));
}

}  // namespace
}  // namespace krnumer
