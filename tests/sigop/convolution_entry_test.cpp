// The exports of convolution and correlation: statuses, their order, and what they leave in their outputs.

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "frame/status.h"
#include "krnumer/sigop.h"
#include "sigop/signals.h"
#include "support/host_arrays.h"

namespace krnumer {
namespace {

using testing::ElementsAre;

constexpr int32_t kDirect = 0;
constexpr int32_t kSpectral = 1;
constexpr int32_t kNoAlgorithm = 2;

class SequenceExports : public testing::Test {
  protected:
    LeakCheck leaks_;
    HostArray<double> x_{1, 2, 3}, y_{4, 5}, z_{9, 9, 9, 9, 9, 9}, none_;
    HostArray<Complex> cx_{{1, 1}, {2, 0}, {0, 3}}, cy_{{4, 0}, {0, 5}}, cz_{{9, 9}}, cnone_;
    int32_t err_ = 77;
};

TEST_F(SequenceExports, Convolve) {
    for (const int32_t algorithm : {kDirect, kSpectral}) {
        EXPECT_EQ(Convolution(x_.handle(), y_.handle(), z_.handle(), &algorithm, &err_), 0);
        EXPECT_EQ(err_, 0);
        EXPECT_THAT(z_.values(), AllNear({4.0, 13.0, 22.0, 15.0}, 1e-14));
        EXPECT_EQ(CxConvolution(cx_.handle(), cy_.handle(), cz_.handle(), algorithm, 0, 99), 0);
        EXPECT_THAT(cz_.values(), AllNear({Complex{4, 4}, {3, 5}, {0, 22}, {-15, 0}}, 1e-14));
    }
}

TEST_F(SequenceExports, Correlate) {
    for (const int32_t algorithm : {kDirect, kSpectral}) {
        EXPECT_EQ(Rxy(x_.handle(), y_.handle(), z_.handle(), &algorithm, &err_), 0);
        EXPECT_EQ(err_, 0);
        EXPECT_THAT(z_.values(), AllNear({12.0, 23.0, 14.0, 5.0}, 1e-14));
        EXPECT_EQ(Rxy80(x_.handle(), y_.handle(), z_.handle(), &algorithm, 1, &err_), 0);
        EXPECT_THAT(z_.values(), AllNear({12.0, 11.5, 7.0, 5.0}, 1e-14));
        EXPECT_EQ(Rxy80(x_.handle(), y_.handle(), z_.handle(), &algorithm, 2, &err_), 0);
        EXPECT_THAT(z_.values(), AllNear({4.0, 23.0 / 3, 14.0 / 3, 5.0 / 3}, 1e-14));
        for (const int32_t correlate : {1, -5}) {
            EXPECT_EQ(CxConvolution(cx_.handle(), cy_.handle(), cz_.handle(), algorithm, correlate, 0), 0);
            EXPECT_THAT(cz_.values(), AllNear({Complex{0, -12}, {23, 0}, {4, 6}, {5, 5}}, 1e-14));
        }
        EXPECT_EQ(CxConvolution(cx_.handle(), cy_.handle(), cz_.handle(), algorithm, 1, 1), 0);
        EXPECT_THAT(cz_[1], Near(Complex{11.5, 0}, 1e-14));
    }
}

TEST_F(SequenceExports, AutocorrelateInPlace) {
    EXPECT_EQ(AutoCorrelation(x_.handle(), &err_), 0);
    EXPECT_EQ(err_, 0);
    EXPECT_THAT(x_.values(), AllNear({3.0, 8.0, 14.0, 8.0, 3.0}, 1e-14));
    HostArray<double> y{1, 2, 3};
    EXPECT_EQ(AutoCorrelation80(y.handle(), 1, &err_), 0);
    EXPECT_THAT(y.values(), AllNear({3.0, 4.0, 14.0 / 3, 4.0, 3.0}, 1e-14));
    HostArray<double> one{1};
    EXPECT_EQ(AutoCorrelation(one.handle(), &err_), 0);
    EXPECT_THAT(one.values(), ElementsAre(1));
}

TEST_F(SequenceExports, TakeOneArrayTwiceAndAsOutput) {
    HostArray<double> x{1, 2, 3};
    EXPECT_EQ(Convolution(x.handle(), x.handle(), z_.handle(), &kSpectral, &err_), 0);
    EXPECT_THAT(z_.values(), AllNear({1.0, 4.0, 10.0, 12.0, 9.0}, 1e-14));
    EXPECT_EQ(Rxy(x.handle(), x.handle(), z_.handle(), &kSpectral, &err_), 0);
    EXPECT_THAT(z_.values(), AllNear({3.0, 8.0, 14.0, 8.0, 3.0}, 1e-14));
    EXPECT_EQ(Convolution(x.handle(), y_.handle(), x.handle(), &kDirect, &err_), 0);
    EXPECT_THAT(x.values(), ElementsAre(4, 13, 22, 15));
    EXPECT_EQ(Deconvolution(x.handle(), x.handle(), &err_), 0);
    EXPECT_THAT(x.values(), AllNear({1.0}, 1e-14));
}

TEST_F(SequenceExports, RefuseEmptyInputs) {
    const auto expect_empty = [&](int32_t result, int32_t expected_result) {
        EXPECT_EQ(result, expected_result);
        EXPECT_TRUE(z_.empty());
        EXPECT_TRUE(cz_.empty());
        z_ = HostArray<double>{9};
        cz_ = HostArray<Complex>{{9, 9}};
    };
    for (const bool first : {true, false}) {
        const KrHandle x = first ? none_.handle() : x_.handle();
        const KrHandle y = first ? y_.handle() : none_.handle();
        cz_ = HostArray<Complex>();
        expect_empty(Convolution(x, y, z_.handle(), &kNoAlgorithm, &err_), 0);
        EXPECT_EQ(err_, kEmptyInput);
        cz_ = HostArray<Complex>();
        expect_empty(Rxy80(x, y, z_.handle(), &kDirect, 9, &err_), 0);
        EXPECT_EQ(err_, kEmptyInput);
        z_ = HostArray<double>();
        expect_empty(CxConvolution(first ? cnone_.handle() : cx_.handle(), first ? cy_.handle() : cnone_.handle(),
                                   cz_.handle(), 5, 1, 9),
                     kEmptyInput);
    }
    EXPECT_EQ(AutoCorrelation80(none_.handle(), 9, &err_), 0);
    EXPECT_EQ(err_, kEmptyInput);
    EXPECT_TRUE(none_.empty());
}

TEST_F(SequenceExports, RealOnesTakeAnyAlgorithmAndThenOnlySize) {
    EXPECT_EQ(Convolution(x_.handle(), y_.handle(), z_.handle(), &kNoAlgorithm, &err_), 0);
    EXPECT_EQ(err_, 0);
    EXPECT_THAT(z_.values(), ElementsAre(9, 9, 9, 9));
    EXPECT_EQ(Rxy80(x_.handle(), y_.handle(), z_.handle(), &kNoAlgorithm, 1, &err_), 0);
    EXPECT_EQ(err_, 0);
    EXPECT_THAT(z_.values(), ElementsAre(9, 9, 9, 9));
}

TEST_F(SequenceExports, RefuseUnknownSelectors) {
    for (const int32_t algorithm : {kDirect, kSpectral, kNoAlgorithm}) {
        for (const int32_t normalization : {-1, 3}) {
            EXPECT_EQ(Rxy80(x_.handle(), y_.handle(), z_.handle(), &algorithm, normalization, &err_), 0);
            EXPECT_EQ(err_, kBadSelector);
            EXPECT_TRUE(z_.empty());
            EXPECT_EQ(CxConvolution(cx_.handle(), cy_.handle(), cz_.handle(), algorithm, 1, normalization),
                      kBadSelector);
            EXPECT_TRUE(cz_.empty());
        }
    }
    EXPECT_EQ(CxConvolution(cx_.handle(), cy_.handle(), cz_.handle(), kNoAlgorithm, 0, 0), kBadSelector);
    EXPECT_TRUE(cz_.empty());
    EXPECT_EQ(AutoCorrelation80(x_.handle(), 3, &err_), 0);
    EXPECT_EQ(err_, kBadSelector);
    EXPECT_TRUE(x_.empty());
}

TEST_F(SequenceExports, ReportRefusedResizes) {
    const auto refused = [](auto call) {
        const FailResize fail(1, 4711);
        const int32_t result = call();
        EXPECT_TRUE(fail.happened());
        return result;
    };
    EXPECT_EQ(refused([&] { return Convolution(x_.handle(), y_.handle(), z_.handle(), &kDirect, &err_); }), 0);
    EXPECT_EQ(err_, kOutOfMemory);
    EXPECT_TRUE(z_.empty());
    z_ = HostArray<double>{9};
    EXPECT_EQ(refused([&] { return Rxy(x_.handle(), y_.handle(), z_.handle(), &kDirect, &err_); }), 0);
    EXPECT_EQ(err_, kOutOfMemory);
    EXPECT_TRUE(z_.empty());
    EXPECT_EQ(refused([&] { return CxConvolution(cx_.handle(), cy_.handle(), cz_.handle(), 0, 0, 0); }), kOutOfMemory);
    EXPECT_TRUE(cz_.empty());
    EXPECT_EQ(refused([&] { return Deconvolution(x_.handle(), y_.handle(), &err_); }), kOutOfMemory);
    EXPECT_EQ(err_, kOutOfMemory);
    EXPECT_TRUE(x_.empty());
    x_ = HostArray<double>{1, 2};
    EXPECT_EQ(refused([&] { return AutoCorrelation(x_.handle(), &err_); }), 0);
    EXPECT_EQ(err_, kOutOfMemory);
    EXPECT_TRUE(x_.empty());
}

TEST_F(SequenceExports, RefuseLengthsThatNoArrayCanHave) {
    x_.SetDimension(0, 2000000000);
    y_.SetDimension(0, 2000000000);
    EXPECT_EQ(Convolution(x_.handle(), y_.handle(), z_.handle(), &kSpectral, &err_), 0);
    EXPECT_EQ(err_, kOutOfMemory);
    EXPECT_TRUE(z_.empty());
}

TEST_F(SequenceExports, Deconvolve) {
    HostArray<double> x{4, 13, 22, 15};
    EXPECT_EQ(Deconvolution(x.handle(), y_.handle(), &err_), 0);
    EXPECT_EQ(err_, 0);
    EXPECT_THAT(x.values(), AllNear({1.0, 2.0, 3.0}, 1e-14));
}

TEST_F(SequenceExports, DeconvolutionTellsItsStatusTwice) {
    const auto expect_refusal = [&](HostArray<double>& x, KrHandle y, int32_t status) {
        EXPECT_EQ(Deconvolution(x.handle(), y, &err_), status);
        EXPECT_EQ(err_, status);
        EXPECT_TRUE(x.empty());
    };
    HostArray<double> longest(8388609);
    expect_refusal(longest, none_.handle(), kTooLong);
    longest = HostArray<double>(8388609);
    expect_refusal(none_, longest.handle(), kTooLong);
    expect_refusal(none_, y_.handle(), kEmptyInput);
    expect_refusal(y_, x_.handle(), kBadDimension);
    expect_refusal(x_, none_.handle(), kEmptyInput);
}

class PlaneExports : public testing::Test {
  protected:
    LeakCheck leaks_;
    HostMatrix<double> x_{2, 3, {1, 2, 3, 4, 5, 6}}, y_{2, 2, {1, 10, 100, 1000}}, z_{1, 1, {9}}, none_;
    HostMatrix<Complex> cx_{3, 2, {{1, 0}, {4, 0}, {2, 0}, {5, 0}, {3, 0}, {6, 0}}}, cy_{1, 1, {{0, 2}}}, cz_{1, 1},
        cnone_;
};

TEST_F(PlaneExports, GiveAllOfTheConvolutionOrAPart) {
    const auto convolved = [&](int32_t part, int32_t algorithm) {
        EXPECT_EQ(Convolve_2DH(x_.handle(), y_.handle(), z_.handle(), part, algorithm), 0);
        return z_.values();
    };
    for (const int32_t algorithm : {kDirect, kSpectral}) {
        EXPECT_THAT(
            convolved(0, algorithm),
            AllNear({1.0, 12.0, 23.0, 30.0, 104.0, 1245.0, 2356.0, 3060.0, 400.0, 4500.0, 5600.0, 6000.0}, 1e-12));
        EXPECT_EQ(z_.rows(), 3);
        EXPECT_EQ(z_.columns(), 4);
        EXPECT_THAT(convolved(1, algorithm), AllNear({1245.0, 2356.0, 3060.0, 4500.0, 5600.0, 6000.0}, 1e-12));
        EXPECT_EQ(z_.rows(), 2);
        EXPECT_EQ(z_.columns(), 3);
        EXPECT_THAT(convolved(2, algorithm), AllNear({1245.0, 2356.0}, 1e-12));
        EXPECT_EQ(z_.rows(), 1);
        EXPECT_EQ(z_.columns(), 2);
    }
}

TEST_F(PlaneExports, CorrelateWithTheFirstPlaneReversed) {
    HostMatrix<double> reversed(2, 3, {6, 5, 4, 3, 2, 1});
    HostMatrix<double> expected;
    for (const int32_t algorithm : {kDirect, kSpectral}) {
        EXPECT_EQ(Correlation_2DH(x_.handle(), y_.handle(), z_.handle(), algorithm), 0);
        EXPECT_EQ(Convolve_2DH(reversed.handle(), y_.handle(), expected.handle(), 0, kDirect), 0);
        EXPECT_THAT(z_.values(), AllNear(expected.values(), 1e-12));
        EXPECT_EQ(z_.rows(), 3);
        EXPECT_EQ(CxCorrelation_2DH(cy_.handle(), cx_.handle(), cz_.handle(), algorithm), 0);
        EXPECT_THAT(cz_.values(), AllNear({Complex{0, -2}, {0, -8}, {0, -4}, {0, -10}, {0, -6}, {0, -12}}, 1e-14));
    }
}

TEST_F(PlaneExports, AKernelOfOneElementScales) {
    HostMatrix<double> two(1, 1, {2});
    for (const int32_t part : {0, 1, 2}) {
        for (const int32_t algorithm : {kDirect, kSpectral}) {
            EXPECT_EQ(Convolve_2DH(x_.handle(), two.handle(), z_.handle(), part, algorithm), 0);
            EXPECT_THAT(z_.values(), AllNear({2.0, 4.0, 6.0, 8.0, 10.0, 12.0}, 1e-14));
            EXPECT_EQ(CxConvolve_2DH(cx_.handle(), cy_.handle(), cz_.handle(), part, algorithm), 0);
            EXPECT_THAT(cz_.values(), AllNear({Complex{0, 2}, {0, 8}, {0, 4}, {0, 10}, {0, 6}, {0, 12}}, 1e-14));
        }
    }
}

TEST_F(PlaneExports, RefuseEmptyPlanesFirst) {
    HostMatrix<double> no_columns(2, 0);
    for (const HostMatrix<double>* empty : {&none_, &no_columns}) {
        EXPECT_EQ(Convolve_2DH(empty->handle(), y_.handle(), z_.handle(), 9, 9), kEmptyInput);
        EXPECT_TRUE(z_.empty());
        EXPECT_EQ(Convolve_2DH(x_.handle(), empty->handle(), z_.handle(), 9, 9), kEmptyInput);
        EXPECT_EQ(Correlation_2DH(empty->handle(), y_.handle(), z_.handle(), 9), kEmptyInput);
        EXPECT_EQ(Correlation_2DH(x_.handle(), empty->handle(), z_.handle(), 9), kEmptyInput);
    }
    EXPECT_EQ(CxConvolve_2DH(cnone_.handle(), cy_.handle(), cz_.handle(), 9, 9), kEmptyInput);
    EXPECT_TRUE(cz_.empty());
    EXPECT_EQ(CxCorrelation_2DH(cx_.handle(), cnone_.handle(), cz_.handle(), 9), kEmptyInput);
}

TEST_F(PlaneExports, RefusePartsThatAreNone) {
    for (const int32_t part : {-1, 3}) {
        z_ = HostMatrix<double>(1, 1);
        EXPECT_EQ(Convolve_2DH(x_.handle(), y_.handle(), z_.handle(), part, 0), kBadSelector);
        EXPECT_TRUE(z_.empty());
        EXPECT_EQ(CxConvolve_2DH(cx_.handle(), cy_.handle(), cz_.handle(), part, 0), kBadSelector);
        EXPECT_TRUE(cz_.empty());
    }
}

TEST_F(PlaneExports, RefuseAnEmptyValidPart) {
    EXPECT_EQ(Convolve_2DH(y_.handle(), x_.handle(), z_.handle(), 2, 9), kBadDimension);
    EXPECT_TRUE(z_.empty());
    HostMatrix<double> tall(3, 1, {1, 2, 3});
    EXPECT_EQ(Convolve_2DH(y_.handle(), tall.handle(), z_.handle(), 2, 0), kBadDimension);
    EXPECT_EQ(CxConvolve_2DH(cy_.handle(), cx_.handle(), cz_.handle(), 2, 0), kBadDimension);
    EXPECT_TRUE(cz_.empty());
}

// No elements behind the words of a refusal that comes from the core.
TEST_F(PlaneExports, KeepTheDimensionsWhenTheCoreRefuses) {
    const ResizeLog resizes;
    EXPECT_EQ(Convolve_2DH(x_.handle(), y_.handle(), z_.handle(), 1, 9), kBadSelector);
    EXPECT_EQ(z_.dimension(0), 2);
    EXPECT_EQ(z_.dimension(1), 3);
    EXPECT_EQ(resizes.size(), 2);
    EXPECT_EQ(resizes[1].totalElements, 0);

    HostMatrix<Complex> wide(2, 5), one(1, 1);
    EXPECT_EQ(CxConvolve_2DH(wide.handle(), one.handle(), cz_.handle(), 2, kDirect), kBadDimension);
    EXPECT_EQ(cz_.dimension(0), 2);
    EXPECT_EQ(cz_.dimension(1), 5);
    HostMatrix<double> real_wide(2, 5), real_one(1, 1);
    EXPECT_EQ(Convolve_2DH(real_wide.handle(), real_one.handle(), z_.handle(), 2, kDirect), 0);
    HostMatrix<Complex> tall(5, 3), flat(1, 2);
    EXPECT_EQ(CxConvolve_2DH(tall.handle(), flat.handle(), cz_.handle(), 2, kDirect), kBadDimension);
}

TEST_F(PlaneExports, CorrelationsAreEmptiedWhenTheCoreRefuses) {
    EXPECT_EQ(Correlation_2DH(x_.handle(), y_.handle(), z_.handle(), 2), kBadSelector);
    EXPECT_TRUE(z_.empty());
    EXPECT_EQ(CxCorrelation_2DH(cx_.handle(), cy_.handle(), cz_.handle(), -1), kBadSelector);
    EXPECT_TRUE(cz_.empty());
}

TEST_F(PlaneExports, ReportRefusedResizes) {
    {
        const FailResize fail(1, 4711);
        EXPECT_EQ(Convolve_2DH(x_.handle(), y_.handle(), z_.handle(), 0, 0), kOutOfMemory);
    }
    EXPECT_TRUE(z_.empty());
    {
        const FailResize fail(1, 4711);
        EXPECT_EQ(CxCorrelation_2DH(cx_.handle(), cy_.handle(), cz_.handle(), 0), kOutOfMemory);
    }
    EXPECT_TRUE(cz_.empty());
}

TEST_F(PlaneExports, RefuseSizesThatNoArrayCanHave) {
    x_.SetDimension(0, 2000000000);
    y_.SetDimension(0, 2000000000);
    EXPECT_EQ(Convolve_2DH(x_.handle(), y_.handle(), z_.handle(), 0, 0), kOutOfMemory);
    EXPECT_TRUE(z_.empty());
    EXPECT_EQ(Correlation_2DH(x_.handle(), y_.handle(), z_.handle(), 0), kOutOfMemory);
}

}  // namespace
}  // namespace krnumer
