// Exponential, logarithm, square root and powers, through their exports.

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cmath>

#include "frame/numeric.h"
#include "frame/status.h"
#include "krnumer/linalg_function.h"
#include "linalg/matrices.h"
#include "reference/linalg/functions.inc"

namespace krnumer {
namespace {

using testing::DoubleNear;
using testing::ElementsAre;
using testing::Pointwise;

class MatrixFunctions : public testing::Test {
  protected:
    LeakCheck leaks_;
    int32_t err_ = 77;
    HostMatrix<Complex> out_{1, 1, {Complex{}}};
};

template <class T>
class FunctionsOfBothTypes : public MatrixFunctions {
  protected:
    // Expects the function in the place of `a`, called with the other arguments, to be near.
    template <class Function, class... Others>
    void ExpectInPlace(Function function, Matrix<T> expected, double tolerance, Others... others) {
        const auto a = ToHost(GoldenFunctions<T>::Values().a);
        EXPECT_EQ(function(a.handle(), others...), 0);
        EXPECT_LE(Distance(FromHost(a), expected), tolerance * FrobeniusNorm(expected));
    }
};
TYPED_TEST_SUITE(FunctionsOfBothTypes, ElementTypes);

TYPED_TEST(FunctionsOfBothTypes, AreThoseOfSciPy) {
    using T = TypeParam;
    const auto& golden = GoldenFunctions<T>::Values();
    int32_t* const err = &this->err_;
    this->ExpectInPlace(Pick<T>(MatrixExp_head, CxMatrixExp_head), golden.exponential, 1e-8, err);
    const auto power = Pick<T>(MatrixPower_head, CxMatrixPower_head);
    this->ExpectInPlace(power, golden.fifth, 1e-14, 5);
    this->ExpectInPlace(power, golden.inverse_square, 1e-12, -2);
    if constexpr (kIsComplex<T>) {
        this->ExpectInPlace(CxMatrixLn_head, golden.logarithm, 1e-8, err);
        this->ExpectInPlace(CxMatrixSqrt_head, golden.root, 1e-13, err);
    } else {
        const auto real_part = Generate<double>(4, 4, [&](int32_t i, int32_t j) { return golden.root(i, j).re; });
        this->ExpectInPlace(MatrixSqrt_head, real_part, 1e-13, err);
        const auto a = ToHost(golden.a);
        EXPECT_EQ(MatrixSqrtH(a.handle(), this->out_.handle()), 0);
        EXPECT_LE(Distance(FromHost(this->out_), golden.root), 1e-13 * FrobeniusNorm(golden.root));
        EXPECT_EQ(MatrixLn_head(a.handle(), this->out_.handle(), err), 0);
        EXPECT_LE(Distance(FromHost(this->out_), golden.logarithm), 1e-8 * FrobeniusNorm(golden.logarithm));
    }
    EXPECT_TRUE(*err == 0 || *err == kWarnInaccurate);
}

TEST_F(MatrixFunctions, ExponentialIsGoodToItsOrder) {
    HostMatrix<double> zero(2, 2);
    EXPECT_EQ(MatrixExp_head(zero.handle(), &err_), 0);
    EXPECT_EQ(err_, 0);
    EXPECT_THAT(zero.values(), ElementsAre(1, 0, 0, 1));
    HostMatrix<double> nilpotent(2, 2, {0, 1, 0, 0});
    EXPECT_EQ(MatrixExp_head(nilpotent.handle(), &err_), 0);
    EXPECT_THAT(nilpotent.values(), Pointwise(DoubleNear(1e-15), {1.0, 1.0, 0.0, 1.0}));
    HostMatrix<double> scalar(1, 1, {0.99});
    EXPECT_EQ(MatrixExp_head(scalar.handle(), &err_), 0);
    const double error = std::fabs(scalar(0, 0) / std::exp(0.99) - 1.0);
    EXPECT_GT(error, 3.6e-8) << "no more than it was asked for";
    EXPECT_LT(error, 3.8e-8);
    // A rotation by one radian, real and as its complex eigenvalue.
    HostMatrix<double> rotation(2, 2, {0, -1, 1, 0});
    EXPECT_EQ(MatrixExp_head(rotation.handle(), &err_), 0);
    EXPECT_NEAR(rotation(0, 0), std::cos(1.0), 1e-8);
    EXPECT_NEAR(rotation(1, 0), std::sin(1.0), 1e-8);
    HostMatrix<Complex> imaginary(1, 1, {{0, 1}});
    EXPECT_EQ(CxMatrixExp_head(imaginary.handle(), &err_), 0);
    EXPECT_NEAR(imaginary(0, 0).re, std::cos(1.0), 1e-8);
    EXPECT_NEAR(imaginary(0, 0).im, std::sin(1.0), 1e-8);
}

TEST_F(MatrixFunctions, ExponentialOfWhatIsNotFiniteIsNaN) {
    for (const double value : {kQuietNaN, kInfinity, -kInfinity}) {
        HostMatrix<double> a(2, 2, {value, 1, 0, 2});
        EXPECT_EQ(MatrixExp_head(a.handle(), &err_), 0);
        EXPECT_EQ(err_, 0);
        EXPECT_TRUE(std::isnan(a(0, 0)));
    }
}

TEST_F(MatrixFunctions, LogarithmInvertsTheExponential) {
    HostMatrix<double> identity(2, 2, {1, 0, 0, 1});
    EXPECT_EQ(MatrixLn_head(identity.handle(), out_.handle(), &err_), 0);
    EXPECT_EQ(err_, 0);
    for (const Complex& element : out_.values()) EXPECT_EQ(Modulus(element), 0.0);
    HostMatrix<double> a(3, 3, {4, 1, 0, 1, 3, 1, 0.5, 1, 5});
    EXPECT_EQ(MatrixLn_head(a.handle(), out_.handle(), &err_), 0);
    EXPECT_TRUE(err_ == 0 || err_ == kWarnInaccurate);
    EXPECT_EQ(CxMatrixExp_head(out_.handle(), &err_), 0);
    for (int32_t i = 0; i < 3; ++i)
        for (int32_t j = 0; j < 3; ++j) EXPECT_NEAR(out_(i, j).re, a(i, j), 1e-7);
    HostMatrix<Complex> z(2, 2, {{2, 1}, {1, 0}, {0, -1}, {3, 0}});
    const auto before = z.values();
    EXPECT_EQ(CxMatrixLn_head(z.handle(), &err_), 0);
    EXPECT_EQ(CxMatrixExp_head(z.handle(), &err_), 0);
    for (size_t i = 0; i < 4; ++i) EXPECT_NEAR(Modulus(z.values()[i] - before[i]), 0.0, 1e-7);
}

TEST_F(MatrixFunctions, LogarithmOfADefectiveMatrixIsDoubtful) {
    HostMatrix<double> jordan(2, 2, {2, 1, 0, 2});
    EXPECT_EQ(MatrixLn_head(jordan.handle(), out_.handle(), &err_), 0);
    EXPECT_TRUE(err_ == 0 || err_ == kWarnInaccurate);
    EXPECT_NEAR(out_(0, 0).re, std::log(2.0), 1e-6);
    EXPECT_NEAR(out_(0, 1).re, 0.5, 1e-5);
    HostMatrix<double> singular(2, 2, {1, 0, 0, 0});
    EXPECT_EQ(MatrixLn_head(singular.handle(), out_.handle(), &err_), 0);
    EXPECT_EQ(err_, kZeroBase);
    EXPECT_TRUE(out_.empty());
}

TEST_F(MatrixFunctions, LogarithmsWhoseExponentialOverflowsAreNotAccepted) {
    // Defective to working precision, so that the elements of the logarithm reach 1e10.
    HostMatrix<double> gallery(5, 5,
                               {-9,   11,     -21,  63,    -252, 70,     -69,   141,  -421,  1684, -575,  575,  -1149,
                                3451, -13801, 3891, -3891, 7782, -23345, 93365, 1024, -1024, 2048, -6144, 24572});
    EXPECT_EQ(MatrixLn_head(gallery.handle(), out_.handle(), &err_), 0);
    EXPECT_NE(err_, 0);
}

TEST_F(MatrixFunctions, RootsSquareToTheMatrix) {
    HostMatrix<double> a(3, 3, {4, 1, 0, 1, 3, 1, 0.5, 1, 5});
    EXPECT_EQ(MatrixSqrtH(a.handle(), out_.handle()), 0);
    EXPECT_LE(Distance(Product(FromHost(out_), FromHost(out_)), ToComplex(FromHost(a))), 1e-13);
    HostMatrix<double> in_place(3, 3, a.values());
    EXPECT_EQ(MatrixSqrt_head(in_place.handle(), &err_), 0);
    for (int32_t i = 0; i < 3; ++i) EXPECT_EQ(in_place(i, i), out_(i, i).re);
    HostMatrix<double> negative(1, 1, {-4});
    EXPECT_EQ(MatrixSqrtH(negative.handle(), out_.handle()), 0);
    EXPECT_NEAR(out_(0, 0).im, 2.0, 1e-15);
    EXPECT_EQ(MatrixSqrt_head(negative.handle(), &err_), 0);
    EXPECT_NEAR(negative(0, 0), 0.0, 1e-15) << "only the real part is kept";
    HostMatrix<Complex> z(2, 2, {{2, 1}, {1, 0}, {0, -1}, {3, 0}});
    const auto before = FromHost(z);
    EXPECT_EQ(CxMatrixSqrt_head(z.handle(), &err_), 0);
    EXPECT_LE(Distance(Product(FromHost(z), FromHost(z)), before), 1e-14);
}

TEST_F(MatrixFunctions, RootsWarnBySecondSmallestEigenvalue) {
    const auto status = [this](const HostMatrix<double>& a) { return MatrixSqrtH(a.handle(), out_.handle()); };
    EXPECT_EQ(status(HostMatrix<double>(2, 2)), kWarnInaccurate);
    for (const Complex& element : out_.values()) EXPECT_EQ(Modulus(element), 0.0);
    EXPECT_EQ(status(HostMatrix<double>(2, 2, {4, 0, 0, 0})), 0);
    EXPECT_EQ(status(HostMatrix<double>(3, 3, {4, 0, 0, 0, 0, 0, 0, 0, 0})), kWarnInaccurate);
    EXPECT_EQ(status(HostMatrix<double>(1, 1)), 0);
    EXPECT_EQ(status(HostMatrix<double>(2, 2, {0, 1, 0, 0})), kWarnInaccurate);
    EXPECT_FALSE(std::isfinite(out_(0, 1).re)) << "there is no root";
}

TEST_F(MatrixFunctions, PowersAreRepeatedProducts) {
    HostMatrix<double> fibonacci(2, 2, {1, 1, 1, 0});
    EXPECT_EQ(MatrixPower_head(fibonacci.handle(), 30), 0);
    EXPECT_THAT(fibonacci.values(), ElementsAre(1346269, 832040, 832040, 514229));
    HostMatrix<double> inverse(2, 2, {2, 0, 0, 4});
    EXPECT_EQ(MatrixPower_head(inverse.handle(), -3), 0);
    EXPECT_THAT(inverse.values(), Pointwise(DoubleNear(1e-16), {0.125, 0.0, 0.0, 1.0 / 64}));
    HostMatrix<double> singular(2, 2, {1, 1, 1, 1});
    EXPECT_EQ(MatrixPower_head(singular.handle(), -1), 0);
    EXPECT_THAT(singular.values(), Pointwise(DoubleNear(1e-15), {0.25, 0.25, 0.25, 0.25}));
    HostMatrix<Complex> turn(1, 1, {{0, 1}});
    EXPECT_EQ(CxMatrixPower_head(turn.handle(), 7), 0);
    EXPECT_EQ(turn(0, 0), (Complex{0, -1}));
    HostMatrix<double> unit(1, 1, {1});
    EXPECT_EQ(MatrixPower_head(unit.handle(), INT32_MIN), 0);
    EXPECT_EQ(unit(0, 0), 1.0);
}

TEST_F(MatrixFunctions, PowersOfNaN) {
    HostMatrix<double> a(1, 1, {kQuietNaN});
    EXPECT_EQ(MatrixPower_head(a.handle(), 2), 0);
    EXPECT_TRUE(std::isnan(a(0, 0)));
    EXPECT_EQ(MatrixPower_head(a.handle(), 0), 0);
    EXPECT_EQ(a(0, 0), 1.0);
    HostMatrix<double> b(1, 1, {kQuietNaN});
    EXPECT_EQ(MatrixPower_head(b.handle(), -1), kNotFinite);
    EXPECT_TRUE(b.empty());
}

TEST_F(MatrixFunctions, CheckShapeAndData) {
    const auto by_reference = [this](auto function, auto&& matrix, int32_t status) {
        EXPECT_EQ(function(matrix.handle(), &err_), 0);
        EXPECT_EQ(err_, status);
        EXPECT_TRUE(matrix.empty());
    };
    for (const auto function : {MatrixExp_head, MatrixSqrt_head}) {
        by_reference(function, HostMatrix<double>(0, 0), kEmptyInput);
        by_reference(function, HostMatrix<double>(0, 3), kNotSquare);
        by_reference(function, HostMatrix<double>(2, 3), kNotSquare);
    }
    for (const auto function : {CxMatrixExp_head, CxMatrixLn_head, CxMatrixSqrt_head})
        by_reference(function, HostMatrix<Complex>(0, 3), kNotSquare);
    by_reference(MatrixSqrt_head, HostMatrix<double>(1, 1, {kQuietNaN}), kNotFinite);
    by_reference(CxMatrixLn_head, HostMatrix<Complex>(1, 1, {{kInfinity, 0}}), kNotFinite);
    EXPECT_EQ(MatrixLn_head(HostMatrix<double>(0, 3).handle(), out_.handle(), &err_), 0);
    EXPECT_EQ(err_, kNotSquare);
    EXPECT_TRUE(out_.empty());
    EXPECT_EQ(MatrixSqrtH(HostMatrix<double>(0, 3).handle(), out_.handle()), kEmptyInput);
    EXPECT_EQ(MatrixSqrtH(HostMatrix<double>(2, 3).handle(), out_.handle()), kNotSquare);
    HostMatrix<double> flat(0, 3);
    EXPECT_EQ(MatrixPower_head(flat.handle(), 2), kEmptyInput);
    HostMatrix<double> wide(2, 3);
    EXPECT_EQ(MatrixPower_head(wide.handle(), 0), kNotSquare);
}

}  // namespace
}  // namespace krnumer
