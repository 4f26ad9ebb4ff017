#include "fft/table.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <climits>
#include <cmath>
#include <cstring>
#include <thread>
#include <vector>

#include "frame/complex.h"

namespace krnumer {
namespace {

using testing::ElementsAre;

std::vector<int32_t> FactorsOf(int32_t length) {
    const HeldTable table(length);
    return {table.get()->factors, table.get()->factors + table.get()->factorCount};
}

std::vector<int32_t> KindsOf(int32_t length) {
    const HeldTable table(length);
    return {table.get()->kinds, table.get()->kinds + table.get()->factorCount};
}

// Lengths of the list, from a table at its head.
std::vector<int32_t> LengthsFrom(const qmfft_table* table) {
    std::vector<int32_t> lengths;
    for (; table != nullptr; table = table->next) lengths.push_back(table->length);
    return lengths;
}

TEST(FftTable, RefusesLengthsBelowOne) {
    EXPECT_EQ(CreateTable(0), nullptr);
    EXPECT_EQ(CreateTable(-5), nullptr);
    EXPECT_EQ(CreateTable(INT32_MIN), nullptr);
    DestroyTable(nullptr);
}

TEST(FftTable, FactorsByTheOrderOfItsRadices) {
    EXPECT_THAT(FactorsOf(1), ElementsAre());
    EXPECT_THAT(FactorsOf(1000), ElementsAre(10, 10, 10));
    EXPECT_THAT(FactorsOf(1024), ElementsAre(32, 32));
    EXPECT_THAT(FactorsOf(64), ElementsAre(2, 32));
    EXPECT_THAT(FactorsOf(100), ElementsAre(10, 10));
    EXPECT_THAT(FactorsOf(120), ElementsAre(3, 4, 10));
    EXPECT_THAT(FactorsOf(20), ElementsAre(2, 10));
    EXPECT_THAT(FactorsOf(30), ElementsAre(3, 10));
    EXPECT_THAT(FactorsOf(54), ElementsAre(3, 18));
    EXPECT_THAT(FactorsOf(28), ElementsAre(2, 14));
    EXPECT_THAT(FactorsOf(106), ElementsAre(2, 53));
    EXPECT_THAT(KindsOf(106), ElementsAre(kButterfly, kRader));
    EXPECT_THAT(FactorsOf(46), ElementsAre(2, 23));
    EXPECT_THAT(KindsOf(46), ElementsAre(kButterfly, kDirect));
    EXPECT_THAT(FactorsOf(43), ElementsAre(43));
    EXPECT_THAT(KindsOf(43), ElementsAre(kButterfly));
    EXPECT_THAT(KindsOf(23), ElementsAre(kDirect));
    EXPECT_THAT(KindsOf(47), ElementsAre(kDirect));
    EXPECT_THAT(KindsOf(53), ElementsAre(kRader));
    // Kinds go along when the factors are sorted.
    EXPECT_THAT(FactorsOf(23 * 41 * 53), ElementsAre(23, 41, 53));
    EXPECT_THAT(KindsOf(23 * 41 * 53), ElementsAre(kDirect, kButterfly, kRader));
}

TEST(FftTable, IsSharedAndCounted) {
    qmfft_table* first = CreateTable(720);
    qmfft_table* second = CreateTable(720);
    EXPECT_EQ(first, second);
    EXPECT_EQ(first->refCount, 2u);
    DestroyTable(first);
    EXPECT_EQ(second->refCount, 1u);
    EXPECT_EQ(second->length, 720);
    DestroyTable(second);
}

TEST(FftTable, StandsAtTheHeadOfTheList) {
    qmfft_table* a = CreateTable(8);
    qmfft_table* b = CreateTable(9);
    qmfft_table* c = CreateTable(10);
    EXPECT_THAT(LengthsFrom(c), ElementsAre(10, 9, 8));
    EXPECT_EQ(c->prev, nullptr);
    EXPECT_EQ(b->prev, c);
    EXPECT_EQ(a->prev, b);
    DestroyTable(b);
    EXPECT_THAT(LengthsFrom(c), ElementsAre(10, 8));
    EXPECT_EQ(a->prev, c);
    DestroyTable(c);
    EXPECT_EQ(a->prev, nullptr);
    DestroyTable(a);
}

TEST(FftTable, OfLengthOneHasNoStages) {
    const HeldTable table(1);
    EXPECT_EQ(table.get()->factorCount, 0);
    EXPECT_EQ(table.get()->stages[0], nullptr);
}

TEST(FftTable, HoldsTwiddlesByRecurrence) {
    const HeldTable table(15);
    const stage_tables& stage = *table.get()->stages[0];
    for (int k = 1; k < 5; ++k) {
        for (int j = 1; j < 3; ++j) {
            const double angle = 6.283185307179586 * j * k / 15;
            EXPECT_NEAR(stage.twiddleRe[(k - 1) * 2 + j - 1], std::cos(angle), 1e-15);
            EXPECT_NEAR(stage.twiddleIm[(k - 1) * 2 + j - 1], -std::sin(angle), 1e-15);
        }
    }
    // Each row from the one above, to the bit.
    const double theta = 2 * (6.283185307179586 / 15);
    const double s = std::sin(theta / 2), t = -std::sin(theta), c = 2 * s * s;
    double re = 1 - c, im = t;
    for (int k = 1; k < 5; ++k) {
        EXPECT_EQ(stage.twiddleRe[(k - 1) * 2 + 1], re);
        EXPECT_EQ(stage.twiddleIm[(k - 1) * 2 + 1], im);
        const double next = re - (t * im + c * re);
        im = im - (c * im - t * re);
        re = next;
    }
    EXPECT_EQ(table.get()->stages[1]->twiddleRe, nullptr);
}

TEST(FftTable, SharesTheTableOfARaderPrime) {
    qmfft_table* parent = CreateTable(53);
    EXPECT_THAT(LengthsFrom(parent), ElementsAre(53, 52));
    EXPECT_EQ(parent->next->refCount, 1u);
    DestroyTable(parent);

    qmfft_table* other = CreateTable(52);
    parent = CreateTable(53);
    EXPECT_EQ(parent->stages[0]->raderTable, other);
    EXPECT_EQ(other->refCount, 2u);
    DestroyTable(parent);
    EXPECT_EQ(other->refCount, 1u);
    EXPECT_EQ(other->prev, nullptr);
    DestroyTable(other);

    parent = CreateTable(2809);
    EXPECT_THAT(LengthsFrom(parent), ElementsAre(2809, 52));
    EXPECT_EQ(parent->next->refCount, 2u);
    DestroyTable(parent);

    // 107 - 1 = 2 x 53
    parent = CreateTable(107);
    EXPECT_THAT(LengthsFrom(parent), ElementsAre(107, 106, 52));
    DestroyTable(parent);
}

TEST(FftTable, OrdersRaderSamplesByPowersOfTheLeastRoot) {
    const HeldTable table(53);
    const stage_tables& stage = *table.get()->stages[0];
    EXPECT_EQ(stage.raderIn[0], 0);
    EXPECT_EQ(stage.raderOut[0], 0);
    int32_t power = 1;  // of 2, the least primitive root of 53
    for (int32_t k = 1; k < 53; ++k) {
        EXPECT_EQ(stage.raderOut[k], power);
        EXPECT_EQ(stage.raderIn[k] * power % 53, 1);
        power = power * 2 % 53;
    }
}

TEST(NextGoodLength, AvoidsPrimesWithoutButterflies) {
    const std::vector<std::pair<int32_t, int32_t>> expected = {
        {INT32_MIN, 1}, {-3, 1},  {0, 1},   {1, 1},   {2, 2},   {23, 24},     {46, 48},    {47, 48},
        {53, 54},       {59, 60}, {97, 98}, {43, 43}, {94, 95}, {1009, 1014}, {1024, 1024}};
    for (const auto& [length, good] : expected) EXPECT_EQ(NextGoodLength(length), good) << length;
}

TEST(NextGoodLength, EndsAtTheLargestInteger) {
    EXPECT_EQ(NextGoodLength(INT32_MAX), 0);  // 2^31 - 1 is prime
}

TEST(FftTable, ServesManyThreadsAtOnce) {
    std::vector<std::thread> threads;
    for (int t = 0; t < 4; ++t) {
        threads.emplace_back([t] {
            for (int32_t i = 0; i < 60; ++i) {
                const int32_t length = i % 3 == 0 ? 107 : 30 + (i * 7 + t) % 40;
                const HeldTable table(length);
                ASSERT_TRUE(table);
                std::vector<Complex> x(static_cast<size_t>(length)), y(x);
                x[1] = {1.0, 0.0};
                ASSERT_EQ(ComplexFFT(table.get(), &x[0].re, &x[0].im, &y[0].re, &y[0].im, 2, 2, length), 0);
                ASSERT_NEAR(y[1].re, std::cos(6.283185307179586 / length), 1e-13);
            }
        });
    }
    for (std::thread& thread : threads) thread.join();
    const HeldTable probe(5);
    EXPECT_THAT(LengthsFrom(probe.get()), ElementsAre(5));
}

}  // namespace
}  // namespace krnumer
