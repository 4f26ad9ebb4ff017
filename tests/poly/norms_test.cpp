// Unit vectors, and polar and rectangular form.

#include "poly/norms.h"

#include <fstream>
#include <random>
#include <sstream>
#include <string>
#include <vector>

#include "frame/numeric.h"
#include "frame/status.h"
#include "krnumer/vector.h"
#include "support/host_arrays.h"

namespace krnumer {
namespace {

using testing::ElementsAre;

struct Case {
    double p;
    double norm;
    std::vector<double> elements;
};

std::vector<Case> ReadCases(const std::string& wanted) {
    std::ifstream file(KRNUMER_REFERENCE "/norms.txt");
    std::vector<Case> cases;
    for (std::string line, kind, word; std::getline(file, line);) {
        std::istringstream words(line);
        Case c;
        words >> kind >> word >> c.norm;
        c.p = std::stod(word);  // streams do not read infinities
        for (double element; words >> element;) c.elements.push_back(element);
        if (kind == wanted) cases.push_back(c);
    }
    EXPECT_GT(cases.size(), 40u);
    return cases;
}

double PowerError(double p) {
    return std::isinf(p) ? 1e-15 : 1e-15 * (3.0 + std::fabs(p) + 1.0 / std::fabs(p));
}

TEST(UnitVector, HasTheNormOfExactArithmetic) {
    for (const Case& c : ReadCases("real")) {
        HostArray<double> x(c.elements);
        double norm = -7.0;
        int32_t err = 77;
        EXPECT_EQ(unitVector80_head(x.handle(), c.p, &norm, &err), 0);
        EXPECT_EQ(err, 0);
        EXPECT_THAT(norm, Near(c.norm, PowerError(c.p))) << "p " << c.p;
        for (int32_t i = 0; i < x.size(); ++i) EXPECT_EQ(x[i], c.elements[static_cast<std::size_t>(i)] * (1.0 / norm));
        if (c.p == 2.0) {
            HostArray<double> y(c.elements);
            double same = -7.0;
            EXPECT_EQ(unitVector_head(y.handle(), &same, &err), 0);
            EXPECT_EQ(same, norm);
            EXPECT_THAT(y.values(), SameBitsAs(x.values()));
        }
    }
}

TEST(UnitVector, HasTheComplexNormOfExactArithmetic) {
    for (const Case& c : ReadCases("complex")) {
        std::vector<Complex> elements;
        for (std::size_t i = 0; i < c.elements.size(); i += 2) elements.push_back({c.elements[i], c.elements[i + 1]});
        HostArray<Complex> x(elements);
        double norm = -7.0;
        EXPECT_EQ(CxUnitVector80_head(x.handle(), c.p, &norm), 0);
        EXPECT_THAT(norm, Near(c.norm, PowerError(c.p))) << "p " << c.p;
        for (int32_t i = 0; i < x.size(); ++i) EXPECT_EQ(x[i], elements[static_cast<std::size_t>(i)] * (1.0 / norm));
        if (c.p == 2.0) {
            HostArray<Complex> y(elements);
            double same = -7.0;
            EXPECT_EQ(CxUnitVector_head(y.handle(), &same), 0);
            EXPECT_EQ(same, norm);
            EXPECT_THAT(y.values(), SameBitsAs(x.values()));
        }
    }
}

TEST(UnitVector, ByTheReciprocal) {
    HostArray<double> x{49, 0};
    double norm = -7.0;
    int32_t err = 77;
    EXPECT_EQ(unitVector_head(x.handle(), &norm, &err), 0);
    EXPECT_EQ(norm, 49.0);
    EXPECT_EQ(x[0], 49.0 * (1.0 / 49.0));
}

TEST(UnitVector, ZeroStays) {
    HostArray<double> x{0, -0.0};
    double norm = -7.0;
    int32_t err = 77;
    EXPECT_EQ(unitVector_head(x.handle(), &norm, &err), 0);
    EXPECT_EQ(err, 0);
    EXPECT_EQ(norm, 0.0);
    EXPECT_THAT(x.values(), SameBitsAs(std::vector<double>{0.0, -0.0}));
    HostArray<Complex> z{{0, 0}};
    EXPECT_EQ(CxUnitVector_head(z.handle(), &norm), 0);
    EXPECT_EQ(norm, 0.0);
}

TEST(UnitVector, ANegativeOrderAndAZeroElement) {
    HostArray<double> x{3, 0, 4};
    double norm = -7.0;
    int32_t err = 77;
    EXPECT_EQ(unitVector80_head(x.handle(), -1.5, &norm, &err), 0);
    EXPECT_EQ(err, 0);
    EXPECT_EQ(norm, 0.0);
    EXPECT_THAT(x.values(), ElementsAre(3, 0, 4));
    EXPECT_EQ(unitVector80_head(x.handle(), -kInfinity, &norm, &err), 0);
    EXPECT_EQ(norm, 0.0);
}

TEST(UnitVector, RefusesInItsOrder) {
    const auto expect = [](double p, int32_t size, int32_t status) {
        HostArray<double> x(size);
        double norm = -7.0;
        int32_t err = 77;
        EXPECT_EQ(unitVector80_head(x.handle(), p, &norm, &err), 0);
        EXPECT_EQ(err, status);
        EXPECT_TRUE(IsQuietNaN(norm));
        EXPECT_TRUE(x.empty());
        HostArray<Complex> z(size);
        norm = -7.0;
        EXPECT_EQ(CxUnitVector80_head(z.handle(), p, &norm), status);
        EXPECT_TRUE(IsQuietNaN(norm));
        EXPECT_TRUE(z.empty());
    };
    expect(kQuietNaN, 0, kEmptyInput);
    expect(0.0, 0, kEmptyInput);
    expect(kQuietNaN, 2, kNotFinite);
    expect(0.0, 2, kZeroParameter);
    expect(-0.0, 2, kZeroParameter);
    HostArray<double> x;
    double norm = -7.0;
    int32_t err = 77;
    EXPECT_EQ(unitVector_head(x.handle(), &norm, &err), 0);
    EXPECT_EQ(err, kEmptyInput);
    EXPECT_TRUE(IsQuietNaN(norm));
    HostArray<Complex> z;
    EXPECT_EQ(CxUnitVector_head(z.handle(), &norm), kEmptyInput);
    EXPECT_TRUE(IsQuietNaN(norm));
}

TEST(Polar, ToRectangular) {
    HostArray<double> r{2, 1, -1}, theta{0, kPi / 2, 0.5};
    int32_t err = 77;
    EXPECT_EQ(PolarToRect1D_head(r.handle(), theta.handle(), &err), 0);
    EXPECT_EQ(err, 0);
    EXPECT_THAT(r.values(), AllNear({2.0, 0.0, -std::cos(0.5)}, 1e-15, 1e-16));
    EXPECT_THAT(theta.values(), AllNear({0.0, 1.0, -std::sin(0.5)}, 1e-15));
}

TEST(Polar, FromRectangular) {
    HostArray<double> x{3, -1, 0, 0}, y{4, 0, -2, 5};
    int32_t err = 77;
    EXPECT_EQ(RectToPolar1D_head(x.handle(), y.handle(), &err), 0);
    EXPECT_EQ(err, 0);
    EXPECT_THAT(x.values(), ElementsAre(5, 1, 2, 5));
    EXPECT_THAT(y.values(), AllNear({std::atan(4.0 / 3.0), kPi, -kPi / 2, kPi / 2}, 1e-15));
}

TEST(Polar, TheOriginHasAngleZero) {
    HostArray<double> x{0.0, -0.0, 0.0, -0.0}, y{0.0, 0.0, -0.0, -0.0};
    int32_t err = 77;
    EXPECT_EQ(RectToPolar1D_head(x.handle(), y.handle(), &err), 0);
    const std::vector<double> zeros(4);
    EXPECT_THAT(x.values(), SameBitsAs(zeros));
    EXPECT_THAT(y.values(), SameBitsAs(zeros));
}

TEST(Polar, RoundTrip) {
    std::mt19937_64 random(5);
    std::normal_distribution<double> normal;
    std::vector<double> x(500), y(500);
    for (double& value : x) value = normal(random);
    for (double& value : y) value = normal(random);
    HostArray<double> r(x), theta(y);
    int32_t err = 77;
    RectToPolar1D_head(r.handle(), theta.handle(), &err);
    for (const double angle : theta.values()) EXPECT_LE(std::fabs(angle), kPi);
    PolarToRect1D_head(r.handle(), theta.handle(), &err);
    EXPECT_THAT(r.values(), AllNear(x, 1e-14, 2e-15));
    EXPECT_THAT(theta.values(), AllNear(y, 1e-14, 2e-15));
}

TEST(Polar, Refusals) {
    const auto expect = [](int32_t n, int32_t m, int32_t status) {
        for (const auto convert : {PolarToRect1D_head, RectToPolar1D_head}) {
            HostArray<double> x(n), y(m);
            int32_t err = 77;
            EXPECT_EQ(convert(x.handle(), y.handle(), &err), 0);
            EXPECT_EQ(err, status);
            EXPECT_TRUE(x.empty());
            EXPECT_TRUE(y.empty());
        }
    };
    expect(0, 0, kEmptyInput);
    expect(0, 2, kSizesDiffer);
    expect(2, 0, kSizesDiffer);
    expect(2, 3, kSizesDiffer);
}

TEST(NormCores, WriteElsewhere) {
    double x[] = {3, 4};
    double y[2] = {}, norm;
    EXPECT_EQ(UnitVectorCore<double>(x, 2, 1.0, &norm, y), 0);
    EXPECT_EQ(norm, 7.0);
    EXPECT_EQ(x[0], 3.0);
    EXPECT_EQ(y[0], 3.0 * (1.0 / 7.0));
    double angle[] = {0, 0}, a[2], b[2];
    EXPECT_EQ(PolarToRect(x, angle, 2, a, b), 0);
    EXPECT_THAT(a, ElementsAre(3, 4));
    EXPECT_THAT(b, ElementsAre(0, 0));
    EXPECT_EQ(RectToPolar(x, angle, 0, a, b), kEmptyInput);
}

}  // namespace
}  // namespace krnumer
