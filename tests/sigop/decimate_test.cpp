// Decimation of blocks and streams, as cores and as exports.

#include "sigop/decimate.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "frame/numeric.h"
#include "frame/status.h"
#include "krnumer/sigop.h"
#include "sigop/signals.h"
#include "support/host_arrays.h"

namespace krnumer {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

template <class T>
std::vector<T> Decimated(std::vector<T> x, int32_t factor, bool averaging) {
    int32_t count = -1;
    EXPECT_EQ(Decimate(x.data(), Size(x), factor, averaging, &count), kOk);
    x.resize(Count(count));
    return x;
}

// One block of a stream.
template <class T>
std::vector<T> Next(std::vector<T> x, int32_t factor, bool averaging, DecimationStream<T>* stream) {
    int32_t count = -1;
    EXPECT_EQ(DecimateContinuous(x.data(), Size(x), factor, averaging, false, stream, &count), kOk);
    x.resize(Count(count));
    return x;
}

template <class T>
class DecimateTest : public testing::Test {
  protected:
    RandomSignals random_;
};
using Elements = testing::Types<double, Complex>;
TYPED_TEST_SUITE(DecimateTest, Elements);

TYPED_TEST(DecimateTest, AgreesWithGoldenData) {
    using T = TypeParam;
    const Golden golden("resample");
    const std::string name = std::is_same_v<T, Complex> ? "decimate_complex" : "decimate_float";
    const auto x = golden.Get<T>(name + ".x");
    for (const int32_t m : {1, 2, 5, 23}) {
        EXPECT_THAT(Decimated(x, m, false), SameBitsAs(golden.Get<T>(name + ".every" + std::to_string(m))));
        EXPECT_THAT(Decimated(x, m, true), AllNear(golden.Get<T>(name + ".means" + std::to_string(m)), 0.0, 1e-15));
    }
}

TYPED_TEST(DecimateTest, MeansAreSumsInOrderAndOneDivision) {
    using T = TypeParam;
    const auto x = this->random_.template Samples<T>(1000);
    for (const int32_t m : {1, 3, 7, 40, 400, 1000}) {
        std::vector<T> expected;
        for (int32_t k = 0; k < 1000 / m; ++k) {
            T sum{};
            for (int32_t i = 0; i < m; ++i) sum += x[Count(k * m + i)];
            expected.push_back(sum / m);
        }
        EXPECT_THAT(Decimated(x, m, true), SameBitsAs(expected));
    }
}

// Blocks of any length, none and one sample among them.
TYPED_TEST(DecimateTest, BlocksOfAStreamGiveWhatTheWholeGives) {
    using T = TypeParam;
    for (int round = 0; round < 200; ++round) {
        const auto x = this->random_.template Samples<T>(this->random_.Integer(1, 200));
        const int32_t factor = this->random_.Integer(1, 30);
        const int32_t start = this->random_.Integer(0, round % 2 == 0 ? 0 : 40);
        for (const bool averaging : {false, true}) {
            DecimationStream<T> whole_stream{start, 0, T{}}, stream{start, 0, T{}};
            const auto whole = Next(x, factor, averaging, &whole_stream);
            std::vector<T> pieces;
            for (size_t first = 0; first < x.size();) {
                const size_t end = std::min(x.size(), first + Count(this->random_.Integer(0, round % 3 == 0 ? 1 : 40)));
                const auto piece =
                    Next<T>({x.begin() + static_cast<ptrdiff_t>(first), x.begin() + static_cast<ptrdiff_t>(end)},
                            factor, averaging, &stream);
                pieces.insert(pieces.end(), piece.begin(), piece.end());
                first = end;
            }
            EXPECT_THAT(pieces, SameBitsAs(whole)) << "factor " << factor << ", start " << start;
            EXPECT_EQ(stream.start, whole_stream.start);
            EXPECT_EQ(stream.partial_count, whole_stream.partial_count);
            EXPECT_TRUE(SameBits(stream.partial_sum, whole_stream.partial_sum));
            if (start == 0 && factor <= Size(x)) {
                auto block = Decimated(x, factor, averaging);
                const size_t more = averaging || Size(x) % factor == 0 ? 0 : 1;  // the sample that begins the tail
                ASSERT_EQ(whole.size(), block.size() + more);
                block.resize(whole.size(), whole.back());
                EXPECT_THAT(whole, SameBitsAs(block));
            }
        }
    }
}

TEST(DecimateContinuous, CountsDownToTheEndOfAMean) {
    DecimationStream<double> stream{0, 0, 0};
    EXPECT_THAT(Next<double>({1, 2}, 5, true, &stream), IsEmpty());
    EXPECT_EQ(stream.start, 3);
    EXPECT_EQ(stream.partial_count, 2);
    EXPECT_EQ(stream.partial_sum, 3);
    EXPECT_THAT(Next<double>({3}, 5, true, &stream), IsEmpty());
    EXPECT_EQ(stream.start, 2);
    EXPECT_EQ(stream.partial_count, 3);
    EXPECT_EQ(stream.partial_sum, 6);
    EXPECT_THAT(Next<double>({4, 5, 6}, 5, true, &stream), ElementsAre(3));
    EXPECT_EQ(stream.start, 4);
    EXPECT_EQ(stream.partial_count, 1);
    EXPECT_EQ(stream.partial_sum, 6);
    EXPECT_THAT(Next<double>({7, 8, 9, 10}, 5, true, &stream), ElementsAre(8));
    EXPECT_EQ(stream.start, 0);
    EXPECT_EQ(stream.partial_count, 0);
    EXPECT_EQ(stream.partial_sum, 0);
}

// A caller may say that an open mean needs no sample more.
TEST(DecimateContinuous, ReadsTheFirstSampleBehindAMeanThatIsComplete) {
    DecimationStream<double> stream{0, 1, -2};
    EXPECT_THAT(Next<double>({1, 3, 5, 9, 4}, 2, true, &stream), ElementsAre(-1, 2, 7));
    EXPECT_EQ(stream.start, 1);
    EXPECT_EQ(stream.partial_count, 1);
    EXPECT_EQ(stream.partial_sum, 4);
    stream = {0, 1, 3};
    EXPECT_THAT(Next<double>({0.5}, 2, true, &stream), ElementsAre(1.5));
    EXPECT_EQ(stream.partial_sum, 0.5);
}

TEST(DecimateContinuous, ChecksBeforeItResets) {
    double x = 1;
    int32_t count = -1;
    DecimationStream<double> stream{-1, 2, 3};
    EXPECT_EQ(DecimateContinuous(&x, 1, 0, true, true, &stream, &count), kNotPositive);
    EXPECT_EQ(DecimateContinuous(&x, 1, 1, true, true, &stream, &count), kNegativeState);
    EXPECT_EQ(stream.partial_count, 2);
    EXPECT_EQ(stream.partial_sum, 3);
    stream.start = 0;
    EXPECT_EQ(DecimateContinuous(&x, 1, 2, false, true, &stream, &count), kOk);
    EXPECT_EQ(stream.partial_count, 0);
    EXPECT_EQ(stream.partial_sum, 0);
    EXPECT_EQ(stream.start, 1);
}

// Whatever a caller puts into a stream, nothing outside the block is touched.
TEST(DecimateContinuous, IsSafeWithStreamsThatNoBlockLeft) {
    RandomSignals random;
    constexpr int32_t kNumbers[] = {0, 1, 2, 5, 30, 2147483647, -1, -30, -2147483647 - 1};
    for (const int32_t start : kNumbers) {
        for (const int32_t partial : kNumbers) {
            for (const int32_t factor : kNumbers) {
                for (const int32_t n : {0, 1, 2, 13}) {
                    for (const bool averaging : {false, true}) {
                        auto x = random.Samples<double>(n);
                        DecimationStream<double> stream{start, partial, 1.0};
                        int32_t count = 0;
                        const int32_t status =
                            DecimateContinuous(x.data(), n, factor, averaging, false, &stream, &count);
                        EXPECT_EQ(status, factor < 1 ? kNotPositive : start < 0 ? kNegativeState : kOk);
                        EXPECT_GE(count, 0);
                        EXPECT_LE(count, n);
                    }
                }
            }
        }
    }
}

class DecimateExports : public testing::Test {
  protected:
    LeakCheck leaks_;
    HostArray<double> x_{1, 2, 3, 4, 5, 6, 7}, none_;
    HostArray<Complex> cx_{{1, 1}, {3, 5}, {2, 0}, {4, 2}, {9, 9}}, cnone_;
    int32_t start_ = 0, partial_ = 0, err_ = 77;
    double sum_ = 0;
    KrComplex csum_{0, 0};
};

TEST_F(DecimateExports, DecimateBlocks) {
    const int32_t two = 2, seven = 7;
    const uint8_t keep = 0, average = 200;
    EXPECT_EQ(DecimateCIN(x_.handle(), &two, &average, &err_), 0);
    EXPECT_EQ(err_, 0);
    EXPECT_THAT(x_.values(), ElementsAre(1.5, 3.5, 5.5));
    x_ = HostArray<double>{1, 2, 3, 4, 5, 6, 7};
    EXPECT_EQ(DecimateCIN(x_.handle(), &seven, &keep, &err_), 0);
    EXPECT_THAT(x_.values(), ElementsAre(1));
    EXPECT_EQ(CxDecimate_H(cx_.handle(), 2, -1), 0);
    EXPECT_THAT(cx_.values(), ElementsAre(Complex{2, 3}, Complex{3, 1}));
    EXPECT_EQ(CxDecimate_H(cx_.handle(), 2, 0), 0);
    EXPECT_THAT(cx_.values(), ElementsAre(Complex{2, 3}));
}

TEST_F(DecimateExports, RefuseFactorsOutsideTheBlock) {
    const uint8_t keep = 0;
    for (const int32_t factor : {0, -1, 8}) {
        x_ = HostArray<double>(7);
        EXPECT_EQ(DecimateCIN(x_.handle(), &factor, &keep, &err_), 0);
        EXPECT_EQ(err_, kBadDecimation);
        EXPECT_TRUE(x_.empty());
        EXPECT_EQ(DecimateCIN(none_.handle(), &factor, &keep, &err_), 0);
        EXPECT_EQ(err_, kEmptyInput);
    }
    EXPECT_EQ(CxDecimate_H(cx_.handle(), 6, 0), kBadDecimation);
    EXPECT_TRUE(cx_.empty());
    EXPECT_EQ(CxDecimate_H(cnone_.handle(), 0, 0), kEmptyInput);
}

TEST_F(DecimateExports, DecimateStreams) {
    EXPECT_EQ(DecimateContinuous_H(x_.handle(), 3, 1, &start_, 0, &partial_, &sum_), 0);
    EXPECT_THAT(x_.values(), ElementsAre(2, 5));
    EXPECT_EQ(start_, 2);
    EXPECT_EQ(partial_, 1);
    EXPECT_EQ(sum_, 7);
    EXPECT_EQ(DecimateContinuous_H(none_.handle(), 3, 1, &start_, 0, &partial_, &sum_), 0);
    EXPECT_EQ(partial_, 1);
    HostArray<double> more{8, 0};
    EXPECT_EQ(DecimateContinuous_H(more.handle(), 3, 1, &start_, 0, &partial_, &sum_), 0);
    EXPECT_THAT(more.values(), ElementsAre(5));
    EXPECT_EQ(start_, 0);

    EXPECT_EQ(CxDecimateContinuous_H(cx_.handle(), 2, 1, &start_, 1, &partial_, &csum_), 0);
    EXPECT_THAT(cx_.values(), ElementsAre(Complex{2, 3}, Complex{3, 1}));
    EXPECT_EQ(csum_.re, 9);
    EXPECT_EQ(csum_.im, 9);
}

TEST_F(DecimateExports, ABlockWithoutOutputIsEmptyAndNoFailure) {
    EXPECT_EQ(DecimateContinuous_H(x_.handle(), 10, 1, &start_, 0, &partial_, &sum_), 0);
    EXPECT_TRUE(x_.empty());
    EXPECT_EQ(partial_, 7);
    start_ = 9;
    EXPECT_EQ(CxDecimateContinuous_H(cx_.handle(), 10, 0, &start_, 0, &partial_, &csum_), 0);
    EXPECT_TRUE(cx_.empty());
    EXPECT_EQ(start_, 4);
}

TEST_F(DecimateExports, RefuseStreamsInOrder) {
    start_ = -1;
    EXPECT_EQ(DecimateContinuous_H(x_.handle(), 0, 1, &start_, 1, &partial_, &sum_), kNotPositive);
    EXPECT_TRUE(x_.empty());
    EXPECT_EQ(CxDecimateContinuous_H(cx_.handle(), 1, 1, &start_, 1, &partial_, &csum_), kNegativeState);
    EXPECT_TRUE(cx_.empty());
    EXPECT_EQ(start_, -1);
}

TEST_F(DecimateExports, ReportRefusedResizes) {
    const int32_t two = 2;
    const uint8_t keep = 0;
    {
        const FailResize fail;
        EXPECT_EQ(DecimateCIN(x_.handle(), &two, &keep, &err_), 0);
    }
    EXPECT_EQ(err_, kOutOfMemory);
    EXPECT_TRUE(x_.empty());
    {
        const FailResize fail;
        EXPECT_EQ(CxDecimateContinuous_H(cx_.handle(), 2, 0, &start_, 0, &partial_, &csum_), kOutOfMemory);
    }
    EXPECT_TRUE(cx_.empty());
}

}  // namespace
}  // namespace krnumer
