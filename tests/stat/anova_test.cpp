// Analysis of variance against R and NIST, and its exports.

#include "krnumer/anova.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <fstream>
#include <numeric>
#include <random>
#include <sstream>

#include "frame/numeric.h"
#include "frame/status.h"
#include "support/host_arrays.h"

namespace krnumer {
namespace {

struct OneWay {
    double ss_between = -9, ms_between = -9, f = -9, p = -9, ss_within = -9, ms_within = -9, ss_total = -9;
    int32_t err = 77;

    int32_t Call(const HostArray<double>& y, const HostArray<int32_t>& levels, int32_t k) {
        EXPECT_EQ(Anova1Way_head(y.handle(), levels.handle(), &k, &ss_between, &ms_between, &f, &p, &ss_within,
                                 &ms_within, &ss_total, &err),
                  0);
        return err;
    }
    void ExpectNaN() const {
        for (const double value : {ss_between, ms_between, f, p, ss_within, ms_within, ss_total})
            EXPECT_TRUE(IsQuietNaN(value));
    }
};

// A data set of NIST with its certified F.
struct Certified {
    std::vector<double> y;
    std::vector<int32_t> groups;
    double ss_between, ss_within, f;
};

Certified Load(const std::string& name) {
    std::ifstream in(std::string(KRNUMER_REFERENCE) + "/nist/" + name + ".dat");
    Certified set{};
    bool data = false;
    for (std::string line; std::getline(in, line);) {
        std::istringstream words(line);
        std::string first;
        std::string second;
        words >> first >> second;
        if (first == "Data:" && line.find("Instrument") + line.find("Treatment") != 2 * std::string::npos) data = true;
        double df;
        double ms;
        if (first == "Between" && words >> df >> set.ss_between >> ms >> set.f) continue;
        if (first == "Within" && words >> df >> set.ss_within) continue;
        if (!data || first == "Data:" || second.empty()) continue;
        set.groups.push_back(std::stoi(first) - 1);
        set.y.push_back(std::stod(second));
    }
    EXPECT_FALSE(set.y.empty()) << name;
    return set;
}

TEST(OneWayAnova, AgreesWithCertifiedValues) {
    for (const char* name : {"SiRstv", "SmLs01", "SmLs02", "AtmWtAg"}) {
        const Certified set = Load(name);
        OneWay anova;
        const int32_t k = *std::max_element(set.groups.begin(), set.groups.end()) + 1;
        ASSERT_EQ(anova.Call(HostArray<double>(set.y), HostArray<int32_t>(set.groups), k), 0);
        // The one-pass sums lose the leading digits that all observations share; rounding errors add up like a random
        // walk.
        const double squares = std::inner_product(set.y.begin(), set.y.end(), set.y.begin(), 0.0);
        const double lost = 4.0 * std::sqrt(static_cast<double>(set.y.size())) * kEpsilon * squares;
        EXPECT_THAT(anova.ss_between, Near(set.ss_between, 1e-13, lost)) << name;
        EXPECT_THAT(anova.ss_within, Near(set.ss_within, 1e-13, lost)) << name;
        EXPECT_THAT(anova.ss_total, Near(set.ss_between + set.ss_within, 1e-13, lost)) << name;
        EXPECT_THAT(anova.f, Near(set.f, 2.0 * lost * (1.0 / set.ss_between + 1.0 / set.ss_within), 0.0)) << name;
    }
}

TEST(OneWayAnova, CancelsWhereTheMeanDwarfsTheSpread) {
    for (const char* name : {"SmLs04", "SmLs05", "SmLs07"}) {
        const Certified set = Load(name);
        OneWay anova;
        ASSERT_EQ(anova.Call(HostArray<double>(set.y), HostArray<int32_t>(set.groups), 9), 0);
        EXPECT_GT(std::fabs(anova.f / set.f - 1.0), 0.1) << name << ": the sums are formed in one pass";
    }
}

TEST(OneWayAnova, ChecksInOrder) {
    OneWay anova;
    HostArray<double> y{1, 2, 3};
    HostArray<int32_t> levels{0, 1, 1};
    HostArray<double> none;
    HostArray<int32_t> no_levels;
    EXPECT_EQ(anova.Call(y, no_levels, 0), kSizesDiffer);
    anova.ExpectNaN();
    EXPECT_EQ(anova.Call(none, no_levels, 0), kEmptyInput);
    EXPECT_EQ(anova.Call(y, levels, 1), kTooFewLevels);
    EXPECT_EQ(anova.Call(y, levels, 3), kTooFewLevels);
    EXPECT_EQ(anova.Call(HostArray<double>{1, 2}, HostArray<int32_t>{0, 1}, 2), kTooFewLevels);
    for (const int32_t level : {2, -1, INT32_MIN}) {
        EXPECT_EQ(anova.Call(y, HostArray<int32_t>{0, 1, level}, 2), kBadLevel);
        anova.ExpectNaN();
    }
    EXPECT_EQ(anova.Call(y, HostArray<int32_t>{1, 1, 1}, 2), kEmptyCell);
    EXPECT_EQ(anova.Call(y, levels, 2), 0);
    EXPECT_THAT(anova.ss_between, Near(1.5, 1e-14, 0.0));
    EXPECT_THAT(anova.ss_within, Near(0.5, 1e-14, 0.0));
}

TEST(OneWayAnova, WithoutSpreadHasNoF) {
    OneWay anova;
    EXPECT_EQ(anova.Call(HostArray<double>{2, 2, 2}, HostArray<int32_t>{0, 1, 1}, 2), 0);
    EXPECT_TRUE(std::isnan(anova.f));
    EXPECT_TRUE(std::isnan(anova.p));
    EXPECT_EQ(anova.Call(HostArray<double>{1, 2, 2}, HostArray<int32_t>{0, 1, 1}, 2), 0);
    ASSERT_TRUE(std::isinf(anova.f));
    EXPECT_EQ(anova.p, 0.0);
}

// A call of the two- or three-way analysis.
struct Design {
    int32_t factors;
    int32_t r;
    std::vector<int32_t> counts;  // signed numbers of levels
    std::vector<double> y;
    std::vector<std::vector<int32_t>> levels;
    HostMatrix<double> table{1, 1, {-9.0}};
    std::vector<double> p = std::vector<double>(7, -9.0);
    int32_t err = 77;

    int32_t Call() {
        HostArray<double> observations(y);
        HostArray<int32_t> a(levels[0]);
        HostArray<int32_t> b(levels[1]);
        if (factors == 2) {
            return Anova2Way_head(observations.handle(), a.handle(), b.handle(), &r, &counts[0], &counts[1],
                                  table.handle(), &p[0], &p[1], &p[2], &err);
        }
        HostArray<int32_t> c(levels[2]);
        return ANOVA3Way_head(observations.handle(), a.handle(), b.handle(), c.handle(), &r, &counts[0], &counts[1],
                              &counts[2], table.handle(), &p[0], &p[1], &p[2], &p[3], &p[4], &p[5], &p[6], &err);
    }
    void ExpectFailure(int32_t status) {
        err = 77;
        EXPECT_EQ(Call(), 0);
        EXPECT_EQ(err, status);
        EXPECT_TRUE(table.empty());
        for (size_t i = 0; i < (factors == 2 ? 3u : 7u); ++i) EXPECT_TRUE(IsQuietNaN(p[i]));
        HostMatrix<double> fresh(1, 1, {-9.0});
        table = std::move(fresh);
    }
};

// The last factor runs fastest, then the others, each cell with its r observations in a row.
Design Balanced(std::vector<int32_t> counts, int32_t r, std::vector<double> y = {}) {
    Design design;
    design.factors = static_cast<int32_t>(counts.size());
    design.r = r;
    design.counts = counts;
    design.levels.resize(counts.size());
    int32_t n = r;
    for (const int32_t count : counts) n *= std::abs(count);
    for (int32_t i = 0; i < n; ++i) {
        int32_t cell = i / r;
        for (size_t k = counts.size(); k-- > 0; cell /= std::abs(counts[k]))
            design.levels[k].push_back(cell % std::abs(counts[k]));
    }
    if (y.empty())
        for (int32_t i = 0; i < n; ++i) y.push_back(i * i % 7);
    design.y = std::move(y);
    return design;
}

TEST(BalancedAnova, AgreesWithR) {
    std::ifstream in(std::string(KRNUMER_REFERENCE) + "/anova.csv");
    std::mt19937 random(1);
    int designs = 0;
    for (std::string line; std::getline(in, line); ++designs) {
        std::istringstream cells(line);
        std::vector<double> numbers;
        for (std::string cell; std::getline(cells, cell, ',');) numbers.push_back(std::stod(cell));
        const auto factors = static_cast<size_t>(numbers[0]);
        const auto r = static_cast<int32_t>(numbers[1]);
        std::vector<int32_t> counts;
        for (size_t k = 0; k < factors; ++k) counts.push_back(static_cast<int32_t>(numbers[2 + k]));
        Design design = Balanced(counts, r);
        const size_t n = design.y.size();
        const size_t effects = factors == 2 ? 3 : 7;
        auto next = numbers.begin() + 5;
        design.y.assign(next, next + static_cast<std::ptrdiff_t>(n));
        next += static_cast<std::ptrdiff_t>(n);

        // The order of the observations is free.
        std::vector<size_t> order(n);
        std::iota(order.begin(), order.end(), 0u);
        std::shuffle(order.begin(), order.end(), random);
        const Design sorted = Balanced(counts, r, design.y);
        for (size_t i = 0; i < n; ++i) {
            design.y[i] = sorted.y[order[i]];
            for (size_t k = 0; k < factors; ++k) design.levels[k][i] = sorted.levels[k][order[i]];
        }

        ASSERT_EQ(design.Call(), 0);
        ASSERT_EQ(design.err, 0) << line;
        ASSERT_EQ(design.table.rows(), static_cast<int32_t>(effects + 1));
        ASSERT_EQ(design.table.columns(), 4);
        for (size_t i = 0; i < effects; ++i) {
            EXPECT_THAT(design.table(static_cast<int32_t>(i), 3), Near(*next++, 1e-8, 1e-10)) << line << " F " << i;
            EXPECT_THAT(design.p[i], Near(*next++, 1e-8, 1e-11)) << line << " p " << i;
        }
        EXPECT_EQ(design.table(static_cast<int32_t>(effects), 3), 0.0);
        for (int32_t i = 0; i <= static_cast<int32_t>(effects); ++i)
            EXPECT_THAT(design.table(i, 0), Near(*next++, 1e-9, 1e-10)) << line << " sum of squares " << i;
        for (int32_t i = 0; i <= static_cast<int32_t>(effects); ++i) {
            EXPECT_EQ(design.table(i, 1), *next) << line;
            EXPECT_EQ(design.table(i, 2), *next != 0.0 ? design.table(i, 0) / *next : 0.0);
            ++next;
        }
    }
    EXPECT_EQ(designs, 70);
}

TEST(BalancedAnova, SumsTheLevelsInTheOrderOfTheData) {
    Design design = Balanced({2, 2}, 2);
    design.y = {1e16, 1.0, -1e16, 1.0, 0.0, 0.0, 0.0, 0.0};  // 1 altogether, of which the first 1 is lost
    design.levels = {{0, 0, 0, 0, 1, 1, 1, 1}, {0, 1, 0, 1, 0, 1, 0, 1}};
    ASSERT_EQ(design.Call(), 0);
    EXPECT_EQ(design.table(0, 0), 1.0 / 4 - 1.0 / 8);
    EXPECT_EQ(design.table(1, 0), 4.0 / 4 - 1.0 / 8);
}

TEST(BalancedAnova, WithoutReplicationsHasNoInteraction) {
    Design design = Balanced({2, 3}, 1);
    ASSERT_EQ(design.Call(), 0);
    EXPECT_EQ(design.err, 0);
    for (int32_t column = 0; column < 4; ++column) EXPECT_EQ(design.table(2, column), 0.0);
    EXPECT_EQ(design.p[2], 0.0);
    EXPECT_EQ(design.table(3, 1), 2.0);
}

TEST(BalancedAnova, TwoWaysAreCheckedInOrder) {
    Design design = Balanced({2, 3}, 2);
    design.levels[1].pop_back();
    design.ExpectFailure(kSizesDiffer);
    design = Balanced({2, 3}, 2);
    design.r = 3;
    design.counts = {1, 3};
    design.ExpectFailure(kBadDataCount);
    design = Balanced({1, 3}, 2);
    design.ExpectFailure(kTooFewLevels);
    design = Balanced({2, 3}, 2);
    design.levels[0][5] = 2;
    design.ExpectFailure(kBadLevel);
    design.levels[0][5] = -1;
    design.ExpectFailure(kBadLevel);
    design.levels[0][5] = 1;  // one cell has one more, another one less
    design.ExpectFailure(kUnbalanced);
    for (const auto& counts : {std::vector{-2, 3}, std::vector{2, -3}, std::vector{-2, -3}}) {
        design = Balanced(counts, 1);
        design.ExpectFailure(kNoFreedomLeft);
    }
}

TEST(BalancedAnova, CountsNoObservationsBeforeLevelsAndReplications) {
    Design design = Balanced({2, 2}, 1);
    design.y.clear();
    design.levels = {{}, {}};
    design.counts = {65536, 65536};  // a product of 2^32
    design.ExpectFailure(kBadDataCount);
    design.counts = {INT32_MIN, 2};
    design.ExpectFailure(kBadDataCount);
    design.r = 0;
    design.counts = {1, 5};
    design.ExpectFailure(kTooFewLevels);
    design.counts = {2, 5};
    design.ExpectFailure(kEmptyCell);
}

TEST(BalancedAnova, ThreeWaysAreCheckedInOrder) {
    Design design = Balanced({2, 3, 2}, 2);
    design.levels[2].pop_back();
    design.ExpectFailure(kSizesDiffer);
    design = Balanced({2, 3, 2}, 2);
    design.r = 1;
    design.ExpectFailure(kBadDataCount);
    design = Balanced({1, 3, 2}, 1);
    design.ExpectFailure(kEmptyCell);  // replications before levels here
    design = Balanced({1, 3, 2}, 2);
    design.ExpectFailure(kTooFewLevels);
    design = Balanced({2, 3, 2}, 2);
    design.levels[1][7] = 3;
    design.ExpectFailure(kBadLevel);
    design.levels[1][7] = 0;
    design.ExpectFailure(kUnbalanced);
}

TEST(BalancedAnova, OfRandomFactorsThroughoutHasNoTestOfTheMainEffects) {
    Design design = Balanced({-2, -3, -2}, 2);
    ASSERT_EQ(design.Call(), 0);
    EXPECT_EQ(design.err, 0);
    for (int32_t effect = 0; effect < 3; ++effect) {
        EXPECT_EQ(design.table(effect, 3), -1.0);
        EXPECT_EQ(design.p[static_cast<size_t>(effect)], -1.0);
    }
}

TEST(BalancedAnova, ReportsATableThatCannotBeSized) {
    for (const auto& counts : {std::vector{2, 3}, std::vector{2, 3, 2}}) {
        Design design = Balanced(counts, 2);
        const FailResize fail(1, 4711);
        design.ExpectFailure(kOutOfMemory);
    }
}

TEST(Contingency, AgreesWithPearsonsTest) {
    // scipy.stats.chi2_contingency([[10, 20, 30], [6, 9, 17]], correction=False)
    HostMatrix<int32_t> counts(2, 3, {10, 20, 30, 6, 9, 17});
    double chi_square;
    double p;
    int32_t err = 77;
    EXPECT_EQ(Contingency_head(counts.handle(), &chi_square, &p, &err), 0);
    EXPECT_EQ(err, 0);
    EXPECT_THAT(chi_square, Near(0.27157465150403504, 1e-13, 0.0));
    EXPECT_THAT(p, Near(0.873028283380073, 1e-10, 0.0));
}

TEST(Contingency, OfEqualCellsIsZero) {
    for (const int32_t count : {3, 60000, INT32_MAX}) {
        HostMatrix<int32_t> counts(2, 2, {count, count, count, count});
        double chi_square;
        double p;
        int32_t err;
        Contingency_head(counts.handle(), &chi_square, &p, &err);
        EXPECT_EQ(err, 0);
        EXPECT_EQ(chi_square, 0.0);
        EXPECT_EQ(p, 1.0);
    }
}

TEST(Contingency, WithAnEmptyRowIsNaNWithoutACode) {
    HostMatrix<int32_t> counts(2, 2, {0, 0, 3, 4});
    double chi_square;
    double p;
    int32_t err;
    Contingency_head(counts.handle(), &chi_square, &p, &err);
    EXPECT_EQ(err, 0);
    EXPECT_TRUE(std::isnan(chi_square));
    EXPECT_EQ(p, 1.0);
}

TEST(Contingency, ChecksItsTable) {
    const auto expect = [](const HostMatrix<int32_t>& counts, int32_t status) {
        double chi_square = -9.0;
        double p = -9.0;
        int32_t err = 77;
        EXPECT_EQ(Contingency_head(counts.handle(), &chi_square, &p, &err), 0);
        EXPECT_EQ(err, status);
        EXPECT_TRUE(IsQuietNaN(chi_square));
        EXPECT_TRUE(IsQuietNaN(p));
    };
    expect(HostMatrix<int32_t>(), kTableTooSmall);
    expect(HostMatrix<int32_t>(1, 3, {-1, 2, 3}), kTableTooSmall);
    expect(HostMatrix<int32_t>(3, 1, {1, 2, 3}), kTableTooSmall);
    expect(HostMatrix<int32_t>(2, 2, {1, 2, -1, 3}), kNegativeCell);
    HostMatrix<int32_t> malformed(2, 2, {1, 2, 3, 4});
    malformed.SetDimension(1, -1);
    expect(malformed, kNegativeCell);
}

}  // namespace
}  // namespace krnumer
