// Shift, rotation and conversion of points, and Euler angles.

#include <fstream>
#include <random>
#include <sstream>
#include <string>
#include <vector>

#include "frame/numeric.h"
#include "frame/status.h"
#include "krnumer/coord.h"
#include "support/host_arrays.h"

namespace krnumer {
namespace {

using testing::ElementsAre;

std::vector<std::vector<double>> ReadNumbers(const std::string& name) {
    std::ifstream file(KRNUMER_REFERENCE "/" + name);
    std::vector<std::vector<double>> lines;
    for (std::string line; std::getline(file, line);) {
        std::istringstream words(line);
        lines.emplace_back();
        for (double number; words >> number;) lines.back().push_back(number);
    }
    EXPECT_GE(lines.size(), 30u) << name;
    return lines;
}

class Coordinates : public testing::Test {
  protected:
    // Leaves nothing in the outputs, however they came.
    void ExpectEmpty(int32_t status, int32_t expected) {
        EXPECT_EQ(status, expected);
        for (HostArray<double>* out : {&X_, &Y_, &Z_}) {
            EXPECT_TRUE(out->empty());
            *out = HostArray<double>{9, 9};
        }
    }

    LeakCheck leaks_;
    HostArray<double> x_{1, 2}, y_{3, 5}, z_{7, 11};
    HostArray<double> none_, three_{1, 2, 3};
    HostArray<double> X_{9, 9, 9}, Y_, Z_{9};
};

TEST_F(Coordinates, Shift) {
    EXPECT_EQ(CartesianShift2D_head(x_.handle(), y_.handle(), 0.5, -1, X_.handle(), Y_.handle()), 0);
    EXPECT_THAT(X_.values(), ElementsAre(1.5, 2.5));
    EXPECT_THAT(Y_.values(), ElementsAre(2, 4));
    EXPECT_EQ(
        CartesianShift3D_head(x_.handle(), y_.handle(), z_.handle(), 1, 2, 3, X_.handle(), Y_.handle(), Z_.handle()),
        0);
    EXPECT_THAT(X_.values(), ElementsAre(2, 3));
    EXPECT_THAT(Y_.values(), ElementsAre(5, 7));
    EXPECT_THAT(Z_.values(), ElementsAre(10, 14));
}

TEST_F(Coordinates, OutputsMayBeTheInputs) {
    EXPECT_EQ(CoordRotation2D_head(x_.handle(), y_.handle(), kPi / 2, y_.handle(), x_.handle()), 0);
    EXPECT_THAT(y_.values(), AllNear({3.0, 5.0}, 1e-15));
    EXPECT_THAT(x_.values(), AllNear({-1.0, -2.0}, 1e-15));
}

TEST_F(Coordinates, RotationInThePlane) {
    EXPECT_EQ(CoordRotation2D_head(x_.handle(), y_.handle(), 0.3, X_.handle(), Y_.handle()), 0);
    EXPECT_THAT(X_.values(),
                AllNear({1 * std::cos(0.3) + 3 * std::sin(0.3), 2 * std::cos(0.3) + 5 * std::sin(0.3)}, 1e-15));
    EXPECT_THAT(Y_.values(),
                AllNear({3 * std::cos(0.3) - 1 * std::sin(0.3), 5 * std::cos(0.3) - 2 * std::sin(0.3)}, 1e-15));
}

TEST_F(Coordinates, ConversionsAgreeWithMultiplePrecision) {
    for (const auto& line : ReadNumbers("conversion.txt")) {
        HostArray<double> a{line[2]}, b{line[3]}, c{line[4]};
        const auto kind = static_cast<int32_t>(line[0]);
        const auto units = static_cast<int32_t>(line[1]);
        EXPECT_EQ(CoordConversion_head(a.handle(), b.handle(), c.handle(), kind, units, X_.handle(), Y_.handle(),
                                       Z_.handle()),
                  0);
        SCOPED_TRACE(testing::Message() << "kind " << kind << ", units " << units);
        EXPECT_THAT(X_.values(), AllNear({line[5]}, 4e-15, 4e-15));
        EXPECT_THAT(Y_.values(), AllNear({line[6]}, 4e-15, 4e-15));
        EXPECT_THAT(Z_.values(), AllNear({line[7]}, 4e-15, 4e-15));
    }
}

TEST_F(Coordinates, ConversionsRoundTrip) {
    std::mt19937_64 random(3);
    std::normal_distribution<double> normal;
    const std::pair<int32_t, int32_t> kThereAndBack[] = {{0, 1}, {2, 3}};
    for (const int32_t units : {0, 1}) {
        for (const auto& [there, back] : kThereAndBack) {
            std::vector<double> x(100), y(100), z(100);
            for (auto* axis : {&x, &y, &z})
                for (double& value : *axis) value = normal(random);
            z[0] = x[1] = y[2] = x[3] = y[3] = 0.0;
            HostArray<double> a(x), b(y), c(z);
            CoordConversion_head(a.handle(), b.handle(), c.handle(), there, units, a.handle(), b.handle(), c.handle());
            CoordConversion_head(a.handle(), b.handle(), c.handle(), back, units, a.handle(), b.handle(), c.handle());
            EXPECT_THAT(a.values(), AllNear(x, 1e-14, 1e-14));
            EXPECT_THAT(b.values(), AllNear(y, 1e-14, 1e-14));
            EXPECT_THAT(c.values(), AllNear(z, 1e-14, 1e-14));
        }
    }
}

TEST_F(Coordinates, ACommonAzimuthIsCopied) {
    HostArray<double> r{2}, azimuth{1.2345678901234567}, third{30};
    for (const int32_t kind : {4, 5}) {
        for (const int32_t units : {0, 1}) {
            EXPECT_EQ(CoordConversion_head(r.handle(), azimuth.handle(), third.handle(), kind, units, X_.handle(),
                                           Y_.handle(), Z_.handle()),
                      0);
            EXPECT_EQ(Y_[0], azimuth[0]);
        }
    }
}

TEST_F(Coordinates, ConversionSelectors) {
    const auto convert = [this](int32_t kind, int32_t units) {
        return CoordConversion_head(x_.handle(), y_.handle(), z_.handle(), kind, units, X_.handle(), Y_.handle(),
                                    Z_.handle());
    };
    EXPECT_EQ(convert(65536 + 2, 0), 0) << "the low 16 bits count";
    EXPECT_THAT(Z_.values(), ElementsAre(7, 11));
    EXPECT_EQ(convert(-65536, 0), 0);
    for (const int32_t kind : {6, -1, 65535}) ExpectEmpty(convert(kind, 0), kBadSelector);
    for (const int32_t units : {2, -1, 65536, 65537}) ExpectEmpty(convert(0, units), kBadSelector);
    HostArray<double>* const inputs[] = {&x_, &y_, &z_};
    for (HostArray<double>* input : inputs) {
        std::swap(*input, three_);
        ExpectEmpty(convert(9, 9), kBadDimension);
        std::swap(*input, three_);
    }
    x_ = HostArray<double>();
    ExpectEmpty(convert(9, 9), kEmptyInput);
}

TEST_F(Coordinates, RotationsAgreeWithProductsOfElementaryOnes) {
    for (const auto& line : ReadNumbers("rotation.txt")) {
        const std::vector<double> direction(line.begin() + 3, line.begin() + 12);
        HostMatrix<double> d;
        EXPECT_EQ(Euler2Direction_head(line[0], line[1], line[2], d.handle()), 0);
        EXPECT_EQ(d.rows(), 3);
        EXPECT_EQ(d.columns(), 3);
        EXPECT_THAT(d.values(), AllNear(direction, 0.0, 4e-16));
        double phi, theta, psi;
        EXPECT_EQ(Direction2Euler_head(d.handle(), &phi, &theta, &psi), 0);
        const double sine = std::sin(line[1]);
        EXPECT_THAT(phi, Near(line[0], 0.0, 2e-15 / sine));
        EXPECT_THAT(theta, Near(line[1], 0.0, 2e-15 / sine));
        EXPECT_THAT(psi, Near(line[2], 0.0, 2e-15 / sine));

        HostArray<double> x{line[12]}, y{line[13]}, z{line[14]};
        EXPECT_EQ(CoordRotationEuler_head(x.handle(), y.handle(), z.handle(), line[0], line[1], line[2], X_.handle(),
                                          Y_.handle(), Z_.handle()),
                  0);
        const std::vector<double> turned{X_[0], Y_[0], Z_[0]};
        EXPECT_THAT(turned, AllNear({line[15], line[16], line[17]}, 0.0, 4e-15));
        EXPECT_EQ(CoordRotationDirect_head(x.handle(), y.handle(), z.handle(), d.handle(), 1, X_.handle(), Y_.handle(),
                                           Z_.handle()),
                  0);
        EXPECT_THAT(turned, SameBitsAs(std::vector<double>{X_[0], Y_[0], Z_[0]}));
        std::vector<double> angles;
        for (const double cosine : d.values()) angles.push_back(std::acos(cosine));
        HostMatrix<double> a(3, 3, angles);
        EXPECT_EQ(CoordRotationDirect_head(x.handle(), y.handle(), z.handle(), a.handle(), 0, X_.handle(), Y_.handle(),
                                           Z_.handle()),
                  0);
        EXPECT_THAT(turned, AllNear({X_[0], Y_[0], Z_[0]}, 0.0, 4e-15));
        EXPECT_THAT(a.values(), SameBitsAs(angles)) << "the angles stay";
    }
}

TEST_F(Coordinates, DirectRotationChecksInItsOrder) {
    HostMatrix<double> good(3, 3, {1, 0, 0, 0, 1, 0, 0, 0, 1}), bad(3, 2);
    const auto rotate = [this](const HostArray<double>& x, const HostMatrix<double>& d, int32_t form) {
        return CoordRotationDirect_head(x.handle(), y_.handle(), z_.handle(), d.handle(), form, X_.handle(),
                                        Y_.handle(), Z_.handle());
    };
    ExpectEmpty(rotate(none_, bad, 9), kEmptyInput);
    ExpectEmpty(rotate(three_, bad, 9), kBadDimension);
    ExpectEmpty(rotate(x_, bad, 9), kBadDimension);
    for (const int32_t form : {2, -1, 65537}) ExpectEmpty(rotate(x_, good, form), kBadSelector);
    EXPECT_EQ(rotate(x_, good, 1), 0);
    EXPECT_THAT(X_.values(), ElementsAre(1, 2));
    for (const auto& [rows, columns] : {std::pair(0, 0), std::pair(2, 3), std::pair(4, 3), std::pair(1, 9)}) {
        HostMatrix<double> d(rows, columns);
        EXPECT_EQ(rotate(x_, d, 1), kBadDimension);
        double angles[3] = {};
        EXPECT_EQ(Direction2Euler_head(d.handle(), &angles[0], &angles[1], &angles[2]), kBadDimension);
        for (const double angle : angles) EXPECT_TRUE(IsQuietNaN(angle));
    }
}

TEST_F(Coordinates, NoAnglesAreTheIdentity) {
    HostMatrix<double> d(1, 1, {5});
    EXPECT_EQ(Euler2Direction_head(0, 0, 0, d.handle()), 0);
    EXPECT_THAT(d.values(), ElementsAre(1, 0, 0, 0, 1, 0, 0, 0, 1));
}

TEST_F(Coordinates, EulerAnglesOfTheIdentity) {
    HostMatrix<double> d(3, 3, {1, 0, 0, 0, 1, 0, 0, 0, 1});
    double phi, theta, psi;
    EXPECT_EQ(Direction2Euler_head(d.handle(), &phi, &theta, &psi), 0);
    EXPECT_EQ(phi, kPi) << "atan2(0, -0)";
    EXPECT_EQ(theta, 0.0);
    EXPECT_EQ(psi, 0.0);
    d.Set(2, 2, 1.0000001);
    EXPECT_EQ(Direction2Euler_head(d.handle(), &phi, &theta, &psi), 0);
    EXPECT_TRUE(std::isnan(theta));
    EXPECT_EQ(psi, 0.0);
}

TEST_F(Coordinates, RefusalsOfTheOthers) {
    const auto expect_all = [&](const HostArray<double>& x, const HostArray<double>& y, int32_t expected) {
        Z_ = HostArray<double>();
        ExpectEmpty(CartesianShift2D_head(x.handle(), y.handle(), 1, 1, X_.handle(), Y_.handle()), expected);
        Z_ = HostArray<double>();
        ExpectEmpty(CoordRotation2D_head(x.handle(), y.handle(), 1, X_.handle(), Y_.handle()), expected);
        ExpectEmpty(
            CartesianShift3D_head(x.handle(), x.handle(), y.handle(), 1, 1, 1, X_.handle(), Y_.handle(), Z_.handle()),
            expected);
        ExpectEmpty(
            CoordRotationEuler_head(x.handle(), x.handle(), y.handle(), 1, 1, 1, X_.handle(), Y_.handle(), Z_.handle()),
            expected);
    };
    expect_all(none_, x_, kEmptyInput);
    expect_all(none_, none_, kEmptyInput);
    expect_all(x_, none_, kBadDimension);
    expect_all(x_, three_, kBadDimension);
}

TEST_F(Coordinates, RefusedSizes) {
    for (int32_t nth = 1; nth <= 3; ++nth) {
        const FailResize refused(nth, 4711);
        ExpectEmpty(CoordRotationEuler_head(x_.handle(), y_.handle(), z_.handle(), 1, 1, 1, X_.handle(), Y_.handle(),
                                            Z_.handle()),
                    kOutOfMemory);
    }
    HostMatrix<double> d(1, 1);
    const FailResize refused;
    EXPECT_EQ(Euler2Direction_head(1, 2, 3, d.handle()), kOutOfMemory);
    EXPECT_TRUE(d.empty());
}

}  // namespace
}  // namespace krnumer
