// The random sequence and the noise made of it, against a generator written in Python and against the laws.

#include "gen/noise.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <fstream>
#include <numbers>
#include <sstream>

#include "frame/status.h"
#include "gen/riffle.h"
#include "support/numbers.h"

namespace krnumer {
namespace {

std::vector<std::vector<std::string>> Rows(const std::string& file) {
    std::ifstream in(std::string(KRNUMER_REFERENCE) + "/" + file);
    std::vector<std::vector<std::string>> rows;
    for (std::string line; std::getline(in, line);) {
        if (!line.empty() && line.back() == '\r') line.pop_back();
        std::istringstream cells(line);
        rows.emplace_back();
        for (std::string cell; std::getline(cells, cell, ',');) rows.back().push_back(cell);
    }
    EXPECT_FALSE(rows.empty()) << file;
    return rows;
}

RandomState Seeded(int32_t seed) {
    RandomState state{};
    Seed(state, seed);
    return state;
}

TEST(RandomSequence, IsThatOfTheThreeGenerators) {
    RandomState state{};
    int32_t seed = 0;
    for (const auto& row : Rows("noise_states.csv")) {
        if (std::stoi(row[0]) != seed) {
            seed = std::stoi(row[0]);
            Seed(state, seed);
        }
        RandomStep(state);
        ASSERT_EQ(state.s1, std::stoi(row[1])) << "seed " << seed;
        ASSERT_EQ(state.s2, std::stoi(row[2])) << "seed " << seed;
        ASSERT_EQ(state.s3, std::stoi(row[3])) << "seed " << seed;
    }
}

TEST(RandomSequence, GoesOnUnlessTheSeedIsPositive) {
    RandomState state{1, 2, 3};
    Seed(state, 0);
    Seed(state, -7);
    EXPECT_EQ(state.s1, 1);
    EXPECT_EQ(state.s2, 2);
    EXPECT_EQ(state.s3, 3);
}

TEST(RandomSequence, KeepsASignThatASeedBroughtIn) {
    RandomState state = Seeded(20000000);
    RandomStep(state);
    EXPECT_LT(state.s1, 0);
    int negative = 0;
    for (int i = 0; i < 1000; ++i) {
        negative += RandomInt15(state) < 0;
        EXPECT_LT(state.s1, 0);
        const double u = RandomUniform(state);
        EXPECT_GE(u, 0.0);
        EXPECT_LT(u, 1.0);
    }
    EXPECT_GT(negative, 0);
}

// Samples of a generator by its name in the reference, starting at a seed.
std::vector<double> Make(const std::string& kind, double a, double b, int32_t seed, int32_t n) {
    RandomState state{};
    GaussSpare spare{};
    BinomialCache cache{};
    std::vector<double> y(static_cast<size_t>(n));
    int32_t status = kOk;
    if (kind == "white") status = WhiteNoise(y.data(), n, a, seed, state);
    if (kind == "gauss") status = GaussianNoise(y.data(), n, a, seed, state, spare);
    if (kind == "gamma") status = GammaNoise(y.data(), n, static_cast<int32_t>(a), seed, state);
    if (kind == "poisson") status = PoissonNoise(y.data(), n, a, seed, state);
    if (kind == "binomial") {
        std::vector<uint32_t> counts(y.size());
        status = BinomialNoise(counts.data(), n, static_cast<int32_t>(a), b, seed, state, cache);
        std::copy(counts.begin(), counts.end(), y.begin());
    }
    EXPECT_EQ(status, kOk);
    return y;
}

TEST(Noise, AgreesWithTheReferenceSampleBySample) {
    for (const auto& row : Rows("noise_samples.csv")) {
        const auto n = static_cast<int32_t>(row.size()) - 4;
        const std::vector<double> y = Make(row[0], std::stod(row[1]), std::stod(row[2]), std::stoi(row[3]), n);
        for (size_t i = 0; i < y.size(); ++i)
            EXPECT_THAT(y[i], Near(std::stod(row[i + 4]), 1e-13, 1e-15)) << row[0] << " " << row[1] << " sample " << i;
    }
}

TEST(Noise, GoesOnFromBlockToBlock) {
    constexpr int32_t kTotal = 1000;
    const auto in_blocks = [](auto&& block) {
        int32_t made = 0;
        for (const int32_t size : {1, 2, 3, 94, 900}) {
            block(made, size, made == 0 ? 99 : -1);
            made += size;
        }
    };
    std::vector<double> y(kTotal);
    RandomState state{};
    GaussSpare spare{};
    in_blocks([&](int32_t at, int32_t size, int32_t seed) {
        EXPECT_EQ(GaussianNoise(y.data() + at, size, 1.5, seed, state, spare), kOk);
    });
    EXPECT_EQ(y, Make("gauss", 1.5, 0, 99, kTotal));
    in_blocks([&](int32_t at, int32_t size, int32_t seed) {
        EXPECT_EQ(PoissonNoise(y.data() + at, size, 30.0, seed, state), kOk);
    });
    EXPECT_EQ(y, Make("poisson", 30.0, 0, 99, kTotal));
    BinomialCache cache{};
    std::vector<uint32_t> counts(kTotal);
    in_blocks([&](int32_t at, int32_t size, int32_t seed) {
        EXPECT_EQ(BinomialNoise(counts.data() + at, size, 500, 0.3, seed, state, cache), kOk);
    });
    EXPECT_EQ(std::vector<double>(counts.begin(), counts.end()), Make("binomial", 500, 0.3, 99, kTotal));
}

// Greatest distance between the samples' distribution and the law, times the root of their number: above 1.95 in one
// of a thousand runs of a true source.
template <class Law>
double KolmogorovSmirnov(std::vector<double> samples, Law law) {
    std::sort(samples.begin(), samples.end());
    const auto n = static_cast<double>(samples.size());
    double distance = 0.0;
    for (size_t i = 0; i < samples.size(); ++i) {
        const double p = law(samples[i]);
        distance = std::max({distance, p - static_cast<double>(i) / n, static_cast<double>(i + 1) / n - p});
    }
    return distance * std::sqrt(n);
}

constexpr int32_t kMany = 1000000;

TEST(Noise, FollowsItsContinuousLaw) {
    EXPECT_LT(KolmogorovSmirnov(Make("white", 2.0, 0, 5, kMany), [](double x) { return (x + 2.0) / 4.0; }), 1.95);
    EXPECT_LT(KolmogorovSmirnov(Make("gauss", 3.0, 0, 5, kMany),
                                [](double x) { return 0.5 * std::erfc(-x / 3.0 / std::numbers::sqrt2); }),
              1.95);
    EXPECT_LT(KolmogorovSmirnov(Make("gamma", 1, 0, 5, kMany), [](double x) { return 1.0 - std::exp(-x); }), 1.95);
    // Waiting for k events: none of the Poisson counts below k.
    for (const int order : {5, 6, 12}) {
        const auto law = [order](double x) {
            double term = std::exp(-x);
            double sum = 0.0;
            for (int k = 0; k < order; ++k, term *= x / k) sum += term;
            return 1.0 - sum;
        };
        EXPECT_LT(KolmogorovSmirnov(Make("gamma", order, 0, 5, kMany), law), 1.95) << order;
    }
}

// Chi-square of counts against probabilities, as a normal deviate (E. B. Wilson and M. M. Hilferty, 1931).
template <class Probability>
double ChiSquareDeviate(const std::vector<double>& samples, int32_t classes, Probability probability) {
    std::vector<double> counts(static_cast<size_t>(classes), 0.0);
    for (const double sample : samples)
        if (sample < classes) counts[static_cast<size_t>(sample)] += 1.0;
    double chi_square = 0.0;
    double freedom = -1.0;
    for (int32_t k = 0; k < classes; ++k) {
        const double expected = probability(k) * static_cast<double>(samples.size());
        if (expected < 10.0) continue;
        const double difference = counts[static_cast<size_t>(k)] - expected;
        chi_square += difference * difference / expected;
        freedom += 1.0;
    }
    const double spread = 2.0 / (9.0 * freedom);
    return (std::cbrt(chi_square / freedom) - 1.0 + spread) / std::sqrt(spread);
}

TEST(Noise, FollowsItsDiscreteLaw) {
    for (const double mean : {0.5, 11.0, 12.0, 80.0}) {
        const auto law = [mean](int32_t k) { return std::exp(k * std::log(mean) - mean - std::lgamma(k + 1.0)); };
        EXPECT_LT(ChiSquareDeviate(Make("poisson", mean, 0, 5, kMany), 200, law), 3.3) << mean;
    }
    struct Binomial {
        int32_t trials;
        double p;
    };
    // A rare success is drawn by the Poisson limit, which a million draws cannot tell from the law.
    for (const auto& [trials, p] : {Binomial{10, 0.3}, {24, 0.9}, {100, 0.25}, {1000, 0.97}, {100000, 1e-6}}) {
        const auto law = [trials = trials, p = p](int32_t k) {
            if (k > trials) return 0.0;
            return std::exp(std::lgamma(trials + 1.0) - std::lgamma(k + 1.0) - std::lgamma(trials - k + 1.0) +
                            k * std::log(p) + (trials - k) * std::log1p(-p));
        };
        EXPECT_LT(ChiSquareDeviate(Make("binomial", trials, p, 5, kMany), 1001, law), 3.3) << trials << " " << p;
    }
}

TEST(Noise, OfCertainEventsIsConstant) {
    EXPECT_THAT(Make("binomial", 0, 0.5, 3, 9), testing::Each(0.0));
    for (const double trials : {7.0, 1000.0}) {
        EXPECT_THAT(Make("binomial", trials, 0.0, 3, 9), testing::Each(0.0));
        EXPECT_THAT(Make("binomial", trials, 1.0, 3, 9), testing::Each(trials));
    }
    EXPECT_THAT(Make("poisson", 0.0, 0, 3, 9), testing::Each(0.0));
}

TEST(BinomialNoise, UsesWhatTheCacheHolds) {
    constexpr double kP = 0.25;
    RandomState state{};
    BinomialCache fresh{};
    uint32_t counts[20];
    ASSERT_EQ(BinomialNoise(counts, 20, 300, kP, 11, state, fresh), kOk);
    EXPECT_EQ(fresh.last_trials, 300);
    EXPECT_EQ(fresh.trials, 300.0);
    EXPECT_EQ(fresh.last_p, kP);
    EXPECT_EQ(fresh.last_q, 1.0 - kP);
    EXPECT_EQ(fresh.log_p, std::log(kP));
    EXPECT_THAT(fresh.log_gamma_trials, Near(std::lgamma(301.0), 1e-14, 0.0));

    BinomialCache wrong = fresh;
    wrong.log_gamma_trials += 1.0;  // accepts too much, and what it accepts shows that it was used
    uint32_t others[20];
    ASSERT_EQ(BinomialNoise(others, 20, 300, kP, 11, state, wrong), kOk);
    EXPECT_NE(testing::PrintToString(counts), testing::PrintToString(others));
    EXPECT_EQ(wrong.log_gamma_trials, fresh.log_gamma_trials + 1.0);
}

TEST(GaussianNoise, DropsItsSpareFromSeedZeroOn) {
    RandomState state = Seeded(5);
    GaussSpare spare{1, 0.25};
    double y;
    ASSERT_EQ(GaussianNoise(&y, 1, 2.0, -1, state, spare), kOk);
    EXPECT_EQ(y, 0.5);
    EXPECT_EQ(spare.have_spare, 0);
    spare = {1, 0.25};
    const RandomState before = state;
    RandomState copy = before;
    ASSERT_EQ(GaussianNoise(&y, 1, 2.0, 0, state, spare), kOk);
    double again;
    GaussSpare none{};
    ASSERT_EQ(GaussianNoise(&again, 1, 2.0, -1, copy, none), kOk);
    EXPECT_EQ(y, again) << "the state goes on, the spare is gone";
    EXPECT_EQ(spare.have_spare, 1);
}

TEST(Noise, GivesUpOnAStateThatIsStuck) {
    double y[3];
    uint32_t counts[3];
    GaussSpare spare{};
    BinomialCache cache{};
    for (const int32_t seed : {-1, 47333376, 2 * 47333376}) {
        RandomState state{};
        EXPECT_EQ(GaussianNoise(y, 3, 1.0, seed, state, spare), kNoConvergence);
        state = {};
        EXPECT_EQ(GammaNoise(y, 3, 6, seed, state), kNoConvergence);
        state = {};
        EXPECT_EQ(GammaNoise(y, 3, 5, seed, state), kOk);
        EXPECT_EQ(PoissonNoise(y, 3, 20.0, -1, state), kOk);
        EXPECT_EQ(BinomialNoise(counts, 3, 100, 0.5, -1, state, cache), kOk);
        EXPECT_EQ(WhiteNoise(y, 3, 2.0, -1, state), kOk);
        EXPECT_THAT(y, testing::Each(-2.0));
    }
}

TEST(PoissonNoise, LetsNaNThrough) {
    RandomState state{};
    double y[2];
    EXPECT_EQ(PoissonNoise(y, 2, kQuietNaN, 3, state), kOk);
    EXPECT_TRUE(std::isnan(y[0]) && std::isnan(y[1]));
}

TEST(PeriodicNoise, HasAFlatSpectrumOfWholeRadians) {
    for (const int32_t n : {1, 2, 3, 4, 5, 8, 30, 97, 128}) {
        RandomState state{};
        std::vector<double> y(static_cast<size_t>(n));
        ASSERT_EQ(PeriodicNoise(y.data(), n, 1.5, 77, state), kOk);
        RandomState again = Seeded(77);
        const double turn = 2.0 * std::numbers::pi / n;
        std::vector<double> phases;
        for (int32_t k = 1; k <= (n - 1) / 2; ++k) phases.push_back(RandomInt15(again));
        for (int32_t i = 0; i < n; ++i) {
            double expected = 0.0;
            for (int32_t k = 1; k <= (n - 1) / 2; ++k) {
                const double angle = turn * (k * i % n);
                const double phase = phases[static_cast<size_t>(k - 1)];
                expected += 1.5 * (std::cos(angle) * std::cos(phase) - std::sin(angle) * std::sin(phase));
            }
            EXPECT_NEAR(y[static_cast<size_t>(i)], expected, 1e-12) << n;
        }
        EXPECT_EQ(state.s1, again.s1) << "one draw for each line";
    }
}

TEST(Riffle, TellsWhereElementsCameFrom) {
    for (const int32_t n : {1, 2, 3, 10, 97, 500}) {
        RandomState state{};
        std::vector<double> x(static_cast<size_t>(n));
        for (size_t i = 0; i < x.size(); ++i) x[i] = 100.0 + static_cast<double>(i);
        std::vector<int32_t> indices(x.size());
        ASSERT_EQ(Riffle(x.data(), indices.data(), n, 12, state), kOk);
        for (size_t i = 0; i < x.size(); ++i) EXPECT_EQ(x[i], 100.0 + indices[i]);
        std::vector<int32_t> numbers(x.size());
        RandomState again{};
        ASSERT_EQ(RiffleNumbers(numbers.data(), n, 12, again), kOk);
        EXPECT_EQ(numbers, indices);
        std::sort(numbers.begin(), numbers.end());
        for (int32_t i = 0; i < n; ++i) EXPECT_EQ(numbers[static_cast<size_t>(i)], i);
    }
}

TEST(Riffle, SwapsEachPositionWithOneOfTheWholeArray) {
    RandomState state = Seeded(8);
    RandomState again = state;
    int32_t numbers[5];
    ASSERT_EQ(RiffleNumbers(numbers, 5, -1, state), kOk);
    std::vector<int32_t> expected{0, 1, 2, 3, 4};
    for (size_t i = 0; i < 5; ++i) std::swap(expected[i], expected[static_cast<size_t>(RandomUniform(again) * 5)]);
    EXPECT_THAT(numbers, testing::ElementsAreArray(expected));
}

}  // namespace
}  // namespace krnumer
