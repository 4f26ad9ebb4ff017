#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cmath>
#include <fstream>
#include <map>
#include <sstream>

#include "fft/generator/composite.h"
#include "fft/generator/emit.h"

namespace krnumer::generator {
namespace {

struct Counts {
    OperationCount real, complex;
};

// Operations of each butterfly; of 14, 18 and 32 the work beside the two butterflies that they call.
const std::map<int, Counts> kCounts = {
    {2, {{0, 2}, {0, 4}}},         {3, {{2, 4}, {4, 12}}},          {4, {{0, 6}, {0, 16}}},
    {5, {{5, 13}, {10, 34}}},      {7, {{8, 30}, {16, 72}}},        {8, {{2, 20}, {4, 52}}},
    {9, {{10, 36}, {20, 88}}},     {10, {{10, 36}, {20, 88}}},      {11, {{20, 74}, {40, 168}}},
    {13, {{20, 82}, {40, 188}}},   {14, {{0, 14}, {0, 28}}},        {16, {{10, 60}, {20, 148}}},
    {17, {{41, 121}, {82, 274}}},  {18, {{0, 18}, {0, 36}}},        {19, {{38, 184}, {76, 404}}},
    {29, {{80, 390}, {160, 836}}}, {31, {{80, 358}, {160, 776}}},   {32, {{26, 44}, {60, 94}}},
    {37, {{95, 459}, {190, 990}}}, {41, {{140, 530}, {280, 1140}}}, {43, {{128, 678}, {256, 1440}}},
};

const std::map<int, int> kBuiltOnTwo = {{14, 7}, {18, 9}, {32, 16}};

TEST(FftGenerator, ReachesTheOperationCounts) {
    ASSERT_EQ(kCounts.size(), std::size(kRadices));
    for (int points : kRadices) {
        OperationCount real = Butterfly(points).RealCount();
        OperationCount complex = Butterfly(points).ComplexCount();
        if (const auto base = kBuiltOnTwo.find(points); base != kBuiltOnTwo.end()) {
            real = real - 2 * Butterfly(base->second).RealCount();
            complex = complex - 2 * Butterfly(base->second).ComplexCount();
        }
        const Counts& expected = kCounts.at(points);
        EXPECT_EQ(real.multiplications, expected.real.multiplications) << points;
        EXPECT_EQ(real.additions, expected.real.additions) << points;
        EXPECT_EQ(complex.multiplications, expected.complex.multiplications) << points;
        EXPECT_EQ(complex.additions, expected.complex.additions) << points;
    }
}

// The spectrum that a program gives for the samples, half by half in the precision of the generator.
std::vector<LongComplex> Execute(const Butterfly& butterfly, const std::vector<LongReal>& samples) {
    std::vector<LongReal> values;
    for (const Node& node : butterfly.program.nodes()) {
        switch (node.kind) {
            case Node::kInput:
                values.push_back(samples[static_cast<size_t>(node.a)]);
                break;
            case Node::kAdd:
                values.push_back(values[static_cast<size_t>(node.a)] + values[static_cast<size_t>(node.b)]);
                break;
            case Node::kSubtract:
                values.push_back(values[static_cast<size_t>(node.a)] - values[static_cast<size_t>(node.b)]);
                break;
            case Node::kScale:
                values.push_back(LongReal(node.factor) * values[static_cast<size_t>(node.a)]);
                break;
        }
    }
    const auto value = [&](Term term) {
        if (term.node < 0) return LongReal(0.0);
        return term.negative ? -values[static_cast<size_t>(term.node)] : values[static_cast<size_t>(term.node)];
    };
    std::vector<LongComplex> spectrum;
    for (size_t k = 0; k < butterfly.spectrum.real.size(); ++k)
        spectrum.push_back({value(butterfly.spectrum.real[k]), value(butterfly.spectrum.imaginary[k])});
    return spectrum;
}

// What is left is the rounding of the constants to doubles.
TEST(FftGenerator, TransformsEveryUnitVector) {
    for (int points : kRadices) {
        const Butterfly butterfly(points);
        for (int j = 0; j < points; ++j) {
            std::vector<LongReal> samples(static_cast<size_t>(points));
            samples[static_cast<size_t>(j)] = 1.0;
            const std::vector<LongComplex> spectrum = Execute(butterfly, samples);
            for (int k = 0; 2 * k <= points; ++k) {
                const LongComplex expected = RootOfUnity(points, j * k % points);
                const LongComplex actual = spectrum[static_cast<size_t>(k)];
                EXPECT_NEAR(static_cast<double>(actual.re), static_cast<double>(expected.re), 4e-14) << points;
                EXPECT_NEAR(static_cast<double>(actual.im), static_cast<double>(expected.im), 4e-14) << points;
            }
        }
    }
}

std::vector<double> ConstantsOf(int points) {
    std::vector<double> constants;
    const Butterfly butterfly(points);
    for (const Node& node : butterfly.program.nodes())
        if (node.kind == Node::kScale) constants.push_back(node.factor);
    return constants;
}

// The constants of 7 points as they are printed to 15 places, in the order of the cyclotomic polynomials that they
// belong to, after the mean: those of the even half first here.
TEST(FftGenerator, FindsTheConstantsOfSevenPoints) {
    const double expected[] = {-1.166666666666667, -0.678447933946105, 0.846010735815048,  -0.055854267289648,
                               0.440958551844098,  -1.408811651299382, -0.193096429713794, 0.533969360337725};
    const std::vector<double> constants = ConstantsOf(7);
    ASSERT_EQ(constants.size(), std::size(expected));
    for (size_t i = 0; i < constants.size(); ++i) EXPECT_NEAR(constants[i], expected[i], 5.1e-16);
}

TEST(FftGenerator, LeavesFullDoublesInTheSmallSizes) {
    EXPECT_THAT(ConstantsOf(3), testing::UnorderedElementsAre(-1.5, 0.8660254037844386));
    EXPECT_THAT(ConstantsOf(5), testing::Contains(-0.5590169943749475));
    EXPECT_THAT(ConstantsOf(8), testing::ElementsAre(0.7071067811865476, -0.7071067811865476));
    EXPECT_THAT(ConstantsOf(32), testing::Contains(0.19509032201612828));
}

TEST(FftGenerator, MadeTheCommittedButterflies) {
    for (int points : kRadices) {
        std::ifstream file(std::string(KRNUMER_BUTTERFLIES) + "/" + FileName(points), std::ios::binary);
        std::ostringstream committed;
        committed << file.rdbuf();
        EXPECT_EQ(committed.str(), FileText(points)) << "run the target fft_butterflies";
    }
}

}  // namespace
}  // namespace krnumer::generator
