// Newton-Cotes integration, cores and exports.

#include "poly/integration.h"

#include <fstream>
#include <sstream>
#include <string>
#include <vector>

#include "frame/numeric.h"
#include "frame/status.h"
#include "krnumer/integration.h"
#include "support/host_arrays.h"

namespace krnumer {
namespace {

using Samples = std::vector<double>;

double Integral(const Samples& y, double step, int32_t rule, int32_t expected_status = kOk) {
    HostArray<double> samples(y);
    double integral = -7.0;
    int32_t err = 77;
    EXPECT_EQ(NumerIntegration_head(samples.handle(), &step, &rule, &integral, &err), 0);
    EXPECT_EQ(err, expected_status);
    return integral;
}

TEST(Integration, LeastNumbersOfSamples) {
    EXPECT_EQ(Integral({3, 5}, 0.5, 0), 2.0);
    EXPECT_EQ(Integral({0, 1, 4}, 1, 1), 4.0 * 2.0 * 0.3333333333333333);
    EXPECT_EQ(Integral({0, 1, 8, 27}, 1, 2), 20.25);
    EXPECT_THAT(Integral({0, 1, 32, 243, 1024}, 1, 3), Near(4096.0 / 6.0, 1e-15));
}

TEST(Integration, IntervalsLeftOver) {
    EXPECT_EQ(Integral({0, 1, 4, 9}, 1, 1), 8 * 0.3333333333333333 + 6.5) << "one panel and a trapezoid";
    EXPECT_EQ(Integral({0, 1, 8, 27, 64}, 1, 2), 20.25 + 45.5) << "one panel and a trapezoid";
    EXPECT_EQ(Integral({0, 1, 8, 27, 64, 125}, 1, 2), 20.25 + (27 + 256 + 125) * 0.3333333333333333);
    EXPECT_THAT(Integral({0, 1, 4, 9, 16, 25, 36, 49}, 1, 3), Near(343.0 / 3.0, 1e-15)) << "one panel and 3/8";
    EXPECT_THAT(Integral({0, 1, 4, 9, 16, 25, 36}, 1, 3), Near(72.0, 1e-15)) << "one panel and Simpson's";
    EXPECT_THAT(Integral({0, 1, 4, 9, 16, 25}, 1, 3), Near(64.0 / 3.0 + 20.5, 1e-15)) << "one panel and a trapezoid";
}

TEST(Integration, LastThreeSamplesAreSummedFromTheMiddle) {
    constexpr double kHuge = 0x1p54;
    EXPECT_EQ(Integral({0, 0, 0, 1, kHuge / 4, -kHuge}, 1, 2), 3 * 0.125 + 1 * 0.3333333333333333);
}

TEST(Integration, StepCountsByItsAbsoluteValue) {
    for (int32_t rule = 0; rule < 4; ++rule)
        EXPECT_EQ(Integral({1, 5, 2, 7, 3, 3}, -0.3, rule), Integral({1, 5, 2, 7, 3, 3}, 0.3, rule));
    EXPECT_EQ(Integral({1, 2}, 0.0, 0), 0.0);
}

TEST(Integration, ExactUpToTheDegreeOfTheRule) {
    constexpr int kDegrees[] = {1, 3, 3, 5};
    for (int32_t rule = 0; rule < 4; ++rule) {
        for (int degree = 0; degree <= kDegrees[rule]; ++degree) {
            for (int32_t n = 1 + (rule + 1); n <= 1 + 8 * (rule + 1); n += rule + 1) {
                Samples y;
                for (int32_t i = 0; i < n; ++i) y.push_back(std::pow(i, degree));
                EXPECT_THAT(Integral(y, 1.0, rule), Near(std::pow(n - 1, degree + 1) / (degree + 1), 1e-14))
                    << "rule " << rule << ", degree " << degree << ", samples " << n;
            }
        }
    }
}

// Rules, steps, sizes, samples and integrals of integration.txt.
struct Case {
    int32_t rule;
    Samples steps;
    std::vector<int32_t> sizes;
    Samples samples;
    double integral;
};

template <class T>
std::vector<T> ReadList(std::istream& words) {
    std::size_t count = 0;
    words >> count;
    std::vector<T> list(count);
    for (T& element : list) words >> element;
    return list;
}

std::vector<Case> ReadCases() {
    std::ifstream file(KRNUMER_REFERENCE "/integration.txt");
    std::vector<Case> cases;
    for (std::string line; std::getline(file, line);) {
        std::istringstream words(line);
        Case c;
        words >> c.rule;
        c.steps = ReadList<double>(words);
        c.sizes = ReadList<int32_t>(words);
        c.samples = ReadList<double>(words);
        words >> c.integral;
        EXPECT_TRUE(words) << line;
        cases.push_back(c);
    }
    EXPECT_GT(cases.size(), 50u);
    return cases;
}

double IntegralBy(const Case& c) {
    HostArray<double> steps(c.steps);
    double integral = -7.0;
    switch (c.sizes.size()) {
        case 1:
            return Integral(c.samples, c.steps[0], c.rule);
        case 2: {
            HostMatrix<double> y(c.sizes[0], c.sizes[1], c.samples);
            EXPECT_EQ(NumerIntegration2D_head(y.handle(), steps.handle(), c.rule, &integral), 0);
            return integral;
        }
        default: {
            HostCube<double> y(c.sizes[0], c.sizes[1], c.sizes[2], c.samples);
            EXPECT_EQ(NumerIntegration3D_head(y.handle(), steps.handle(), c.rule, &integral), 0);
            return integral;
        }
    }
}

TEST(Integration, AgreesWithExactArithmetic) {
    for (const Case& c : ReadCases()) {
        double magnitude = 0.0;
        for (const double sample : c.samples) magnitude += 2.0 * std::fabs(sample);
        for (const double step : c.steps) magnitude *= std::fabs(step);
        EXPECT_THAT(IntegralBy(c), Near(c.integral, 0.0, 4e-16 * magnitude))
            << c.rule << ", " << c.sizes.size() << "-D";
    }
}

TEST(Integration, RefusesInItsOrder) {
    EXPECT_TRUE(IsQuietNaN(Integral({}, 1, 9, kEmptyInput)));
    for (const int32_t rule : {4, 9, -1, std::numeric_limits<int32_t>::min()})
        EXPECT_TRUE(IsQuietNaN(Integral({1}, 1, rule, kBadSelector)));
    for (int32_t rule = 0; rule < 4; ++rule) {
        EXPECT_TRUE(IsQuietNaN(Integral(Samples(static_cast<std::size_t>(rule + 1)), 1, rule, kBadDimension)));
    }
    EXPECT_TRUE(IsQuietNaN(Integral({1, 2}, 1, 1, kBadDimension)));
}

TEST(Integration, RefusesOnAGridInItsOrder) {
    const auto integrate = [](int32_t rows, int32_t columns, int32_t steps, int32_t rule) {
        HostMatrix<double> y(rows, columns);
        HostArray<double> widths(steps);
        double integral = -7.0;
        const int32_t status = NumerIntegration2D_head(y.handle(), widths.handle(), rule, &integral);
        EXPECT_EQ(IsQuietNaN(integral), status != 0);
        return status;
    };
    EXPECT_EQ(integrate(0, 0, 0, 9), kBadDimension);
    EXPECT_EQ(integrate(2, 3, 0, 9), kBadDimension);
    EXPECT_EQ(integrate(3, 2, 0, 9), kBadDimension);
    EXPECT_EQ(integrate(3, 3, 1, 9), kFewerThanTwo);
    EXPECT_EQ(integrate(3, 3, 2, 4), kBadSelector);
    EXPECT_EQ(integrate(3, 3, 2, -1), kBadSelector);
    EXPECT_EQ(integrate(3, 3, 2, 0x10001), kOk) << "the low 16 bits count";
    EXPECT_EQ(integrate(3, 3, 5, 1), kOk);
    EXPECT_EQ(integrate(3, 3, 2, 2), kBadDimension) << "the rule needs more";
    EXPECT_EQ(integrate(3, 3, 2, 3), kBadDimension);
    EXPECT_EQ(integrate(4, 3, 2, 2), kBadDimension);
    EXPECT_EQ(integrate(3, 4, 2, 2), kBadDimension);
    EXPECT_EQ(integrate(4, 4, 2, 2), kOk);
}

TEST(Integration, RefusesInABoxInItsOrder) {
    const auto integrate = [](int32_t pages, int32_t rows, int32_t columns, int32_t steps, int32_t rule) {
        HostCube<double> y(pages, rows, columns);
        HostArray<double> widths(steps);
        double integral = -7.0;
        const int32_t status = NumerIntegration3D_head(y.handle(), widths.handle(), rule, &integral);
        EXPECT_EQ(IsQuietNaN(integral), status != 0);
        return status;
    };
    EXPECT_EQ(integrate(2, 3, 3, 0, 9), kBadDimension);
    EXPECT_EQ(integrate(3, 2, 3, 0, 9), kBadDimension);
    EXPECT_EQ(integrate(3, 3, 2, 0, 9), kBadDimension);
    EXPECT_EQ(integrate(3, 3, 3, 2, 9), kFewerThanThree);
    EXPECT_EQ(integrate(3, 3, 3, 3, 4), kBadSelector);
    EXPECT_EQ(integrate(3, 3, 3, 3, 3), kBadDimension);
    EXPECT_EQ(integrate(3, 3, 3, 3, 1), kOk);
}

TEST(Integration, FirstStepBelongsToTheColumns) {
    HostMatrix<double> ramp(3, 4, {0, 1, 2, 3, 0, 1, 2, 3, 0, 1, 2, 3});
    HostArray<double> steps{2, 10};
    double integral = 0.0;
    EXPECT_EQ(NumerIntegration2D_head(ramp.handle(), steps.handle(), 0, &integral), 0);
    EXPECT_EQ(integral, 4.5 * 2 * 2 * 10);
}

TEST(Integration, CoresWithoutMemoryOrData) {
    double integral = -7.0;
    const double y = 1.0;
    EXPECT_EQ(IntegrateCore(&y, 0, 1.0, IntegrationRule::kTrapezoid, &integral), kBadDimension);
    EXPECT_EQ(IntegrateCore(&y, -5, 1.0, IntegrationRule::kBoole, &integral), kBadDimension);
    EXPECT_EQ(IntegrateCore(&y, 1, 1.0, IntegrationRule{4}, &integral), kBadSelector);
    EXPECT_EQ(integral, -7.0);
}

}  // namespace
}  // namespace krnumer
