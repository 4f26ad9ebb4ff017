// The exports of noise: statuses, their order, and what they leave in outputs and records.

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cstring>

#include "frame/numeric.h"
#include "frame/status.h"
#include "krnumer/noise.h"
#include "support/host_arrays.h"

namespace krnumer {
namespace {

static_assert(sizeof(KrRandomState) == 12 && sizeof(KrGaussSpare) == 12 && sizeof(KrBinomialCache) == 52);
static_assert(offsetof(KrGaussSpare, spare) == 4 && offsetof(KrBinomialCache, lastTrials) == 48);

class NoiseEntry : public testing::Test {
  protected:
    LeakCheck leaks_;
    HostArray<double> x_{9, 9};
    HostArray<uint32_t> counts_{9, 9};
    int32_t n_ = 5;
    double scale_ = 2.0;
    int32_t seed_ = 7;
    int32_t err_ = 77;
    KrRandomState state_{1, 2, 3};
    KrGaussSpare spare_{0, 0.0};
    KrBinomialCache cache_{};

    void ExpectUntouched() const {
        EXPECT_EQ(state_.s1, 1);
        EXPECT_EQ(state_.s2, 2);
        EXPECT_EQ(state_.s3, 3);
        EXPECT_EQ(cache_.lastTrials, 0);
    }
    void ExpectEmptied(int32_t result, int32_t status) {
        EXPECT_EQ(result, 0);
        EXPECT_EQ(err_, status);
        EXPECT_TRUE(x_.empty());
        x_ = HostArray<double>{9, 9};
    }
    int32_t White() { return white(x_.handle(), &n_, &scale_, &seed_, &err_, &state_); }
    int32_t Gaussian() { return Gauss(x_.handle(), &n_, &scale_, &seed_, &err_, &state_, &spare_); }
    int32_t Periodic() { return PeriodNoise(&n_, &scale_, &seed_, x_.handle(), &err_, &state_); }
    int32_t Binomial(int32_t n, int32_t trials, double p) {
        return BinomialNoiseH(counts_.handle(), n, trials, p, seed_, &state_, &cache_);
    }
};

TEST_F(NoiseEntry, NeedsASampleAndDoesNotSeedWithout) {
    n_ = 0;
    ExpectEmptied(White(), kEmptyInput);
    ExpectEmptied(Gaussian(), kEmptyInput);
    ExpectEmptied(Periodic(), kEmptyInput);
    EXPECT_EQ(GammaNoiseH(x_.handle(), 0, 2, seed_, &state_), kEmptyInput);
    EXPECT_EQ(PoissonNoiseH(x_.handle(), 0, 2, seed_, &state_), kEmptyInput);
    EXPECT_EQ(RiffleIntNum_head(counts_.handle(), 0, seed_, &state_), kEmptyInput);
    EXPECT_EQ(Binomial(0, 30, 0.5), kEmptyInput);
    EXPECT_TRUE(counts_.empty());
    ExpectUntouched();
}

TEST_F(NoiseEntry, LooksAtParametersBeforeTheCount) {
    EXPECT_EQ(GammaNoiseH(x_.handle(), 0, 0, seed_, &state_), kBadSelector);
    EXPECT_EQ(PoissonNoiseH(x_.handle(), 0, -1, seed_, &state_), kBadSelector);
    EXPECT_EQ(Binomial(0, -1, 0.5), kBadSelector);
    for (const double p : {-0.1, 1.1, kQuietNaN}) EXPECT_EQ(Binomial(0, 30, p), kBadSelector);
    ExpectUntouched();
    EXPECT_EQ(PoissonNoiseH(x_.handle(), 2, kQuietNaN, seed_, &state_), 0) << "NaN is not below 0";
}

TEST_F(NoiseEntry, ReportsARefusedSizeAndDoesNotSeed) {
    for (int i = 0; i < 3; ++i) {
        const FailResize fail(1, 4711);
        EXPECT_EQ(i == 0 ? White() : i == 1 ? Gaussian() : Periodic(), 4711);
        ExpectEmptied(0, kOutOfMemory);
    }
    const auto refused = [](auto call) {
        const FailResize fail(1, 4711);
        EXPECT_EQ(call(), kOutOfMemory);
    };
    refused([&] { return GammaNoiseH(x_.handle(), 5, 2, seed_, &state_); });
    refused([&] { return PoissonNoiseH(x_.handle(), 5, 2, seed_, &state_); });
    refused([&] { return Binomial(5, 30, 0.5); });
    refused([&] { return RiffleIntNum_head(counts_.handle(), 5, seed_, &state_); });
    ExpectUntouched();
}

TEST_F(NoiseEntry, RepeatsASeedAndGoesOnWithoutOne) {
    HostArray<double> whole;
    KrRandomState other{};
    int32_t n = 10;
    EXPECT_EQ(white(whole.handle(), &n, &scale_, &seed_, &err_, &other), 0);
    EXPECT_EQ(White(), 0);
    const std::vector<double> first = x_.values();
    seed_ = -1;
    EXPECT_EQ(White(), 0);
    std::vector<double> joined = first;
    for (const double value : x_.values()) joined.push_back(value);
    EXPECT_EQ(joined, whole.values());
    EXPECT_EQ(std::memcmp(&state_, &other, sizeof other), 0);
}

TEST_F(NoiseEntry, AStateOfZerosGivesTheLowerBound) {
    state_ = {0, 0, 0};
    seed_ = -1;
    EXPECT_EQ(White(), 0);
    EXPECT_THAT(x_.values(), testing::Each(-2.0));
}

TEST_F(NoiseEntry, GivesUpOnAStateThatIsStuck) {
    state_ = {0, 0, 0};
    seed_ = -1;
    ExpectEmptied(Gaussian(), kNoConvergence);
    EXPECT_EQ(GammaNoiseH(x_.handle(), 5, 6, -1, &state_), kNoConvergence);
    EXPECT_TRUE(x_.empty());
}

TEST_F(NoiseEntry, KeepsTheSpareOfAnOddBlock) {
    EXPECT_EQ(Gaussian(), 0);
    EXPECT_EQ(spare_.haveSpare, 1);
    const double spare = spare_.spare;
    n_ = 1;
    seed_ = -1;
    EXPECT_EQ(Gaussian(), 0);
    EXPECT_EQ(x_[0], spare * scale_);
    EXPECT_EQ(spare_.haveSpare, 0);
}

TEST_F(NoiseEntry, TakesRecordsAtAnyAddress) {
    char bytes[sizeof(KrBinomialCache) + 1] = {};
    auto* cache = reinterpret_cast<KrBinomialCache*>(bytes + 1);
    EXPECT_EQ(BinomialNoiseH(counts_.handle(), 5, 100, 0.4, seed_, &state_, cache), 0);
    double trials;
    std::memcpy(&trials, bytes + 1 + offsetof(KrBinomialCache, trials), sizeof trials);
    EXPECT_EQ(trials, 100.0);
}

TEST_F(NoiseEntry, PeriodicNoiseOfOneOrTwoSamplesIsZero) {
    for (const int32_t n : {1, 2}) {
        n_ = n;
        EXPECT_EQ(Periodic(), 0);
        EXPECT_EQ(err_, 0);
        EXPECT_THAT(x_.values(), testing::Each(0.0));
        EXPECT_EQ(x_.size(), n);
    }
}

template <class T>
struct Shuffle;
template <>
struct Shuffle<double> {
    static constexpr auto Call = RiffleArrayDBL_head;
    static double Element(int32_t i) { return 10.0 + i; }
};
template <>
struct Shuffle<Complex> {
    static constexpr auto Call = RiffleArrayCDB_head;
    static Complex Element(int32_t i) { return {10.0 + i, -1.0 * i}; }
};
template <>
struct Shuffle<int32_t> {
    static constexpr auto Call = RiffleArrayInt_head;
    static int32_t Element(int32_t i) { return 10 + i; }
};

template <class T>
class RiffleEntry : public testing::Test {
  protected:
    RiffleEntry() : x_(6), indices_{9} {
        for (int32_t i = 0; i < 6; ++i) x_.Set(i, Shuffle<T>::Element(i));
    }
    int32_t Call() { return Shuffle<T>::Call(x_.handle(), indices_.handle(), 7, &state_); }
    void ExpectShuffled() {
        ASSERT_EQ(indices_.size(), 6);
        for (int32_t i = 0; i < 6; ++i) EXPECT_EQ(x_[i], Shuffle<T>::Element(indices_[i]));
    }
    void ExpectEmptied() const {
        EXPECT_TRUE(x_.empty());
        EXPECT_TRUE(indices_.empty());
    }

    LeakCheck leaks_;
    HostArray<T> x_;
    HostArray<int32_t> indices_;
    KrRandomState state_{1, 2, 3};
};

using Shuffled = testing::Types<double, Complex, int32_t>;
TYPED_TEST_SUITE(RiffleEntry, Shuffled);

TYPED_TEST(RiffleEntry, TellsWhereElementsCameFrom) {
    EXPECT_EQ(this->Call(), 0);
    this->ExpectShuffled();
}

TYPED_TEST(RiffleEntry, NeedsAnElement) {
    this->x_ = HostArray<TypeParam>();
    EXPECT_EQ(this->Call(), kEmptyInput);
    this->ExpectEmptied();
    EXPECT_EQ(this->state_.s1, 1);
}

TYPED_TEST(RiffleEntry, FailsWhenTheIndicesHaveNoPlace) {
    for (const int32_t host : {4711, -5}) {
        HostArray<TypeParam> fresh(6);
        this->x_ = std::move(fresh);
        const FailResize fail(1, host);
        EXPECT_EQ(this->Call(), kOutOfMemory);
        this->ExpectEmptied();
    }
}

TYPED_TEST(RiffleEntry, IsContentWithIndicesThatAreLongEnough) {
    HostArray<int32_t> longer(8);
    this->indices_ = std::move(longer);
    {
        const FailResize fail(1, 4711);
        EXPECT_EQ(this->Call(), 0) << "a positive status only counts where the place is missing";
    }
    this->ExpectShuffled();
    HostArray<int32_t> again(8);
    this->indices_ = std::move(again);
    const FailResize fail(1, -5);
    EXPECT_EQ(this->Call(), kOutOfMemory);
    this->ExpectEmptied();
}

}  // namespace
}  // namespace krnumer
