// Singular values and eigenvalues against 20 digits. Tolerances follow from the condition of each value: n units of
// rounding of the norm, times how far such a perturbation of the matrix moves it.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <fstream>
#include <map>
#include <sstream>
#include <string>
#include <vector>

#include "frame/status.h"
#include "linalg/eigen_general.h"
#include "linalg/eigen_symmetric.h"
#include "linalg/svd.h"
#include "linalg/test_matrices.h"

namespace krnumer {
namespace {

struct Reference {
    Complex value;
    double condition;
};

// The values of one quantity, by matrix.
std::map<std::string, std::vector<Reference>> Load(const std::string& wanted) {
    std::ifstream file(KRNUMER_REFERENCE "/decompositions.csv");
    std::map<std::string, std::vector<Reference>> references;
    for (std::string line; std::getline(file, line);) {
        std::replace(line.begin(), line.end(), ',', ' ');
        std::istringstream fields(line);
        std::string name, quantity;
        Reference reference{};
        fields >> name >> quantity >> reference.value.re >> reference.value.im >> reference.condition;
        EXPECT_TRUE(fields) << line;
        if (quantity == wanted) references[name].push_back(reference);
    }
    EXPECT_FALSE(references.empty());
    return references;
}

double Integer(int32_t i, int32_t j) {
    return (3 * i + 5 * j + i * j) % 11 - 5;
}
Complex GaussInteger(int32_t i, int32_t j) {
    return {static_cast<double>((7 * i + 3 * j) % 11 - 5), static_cast<double>((2 * i + 5 * j) % 7 - 3)};
}

// The matrix of that name, real ones as complex.
DenseMatrix<Complex> MatrixOf(const std::string& name) {
    if (name == "hilbert") return HilbertMatrix<Complex>(8, 8);
    if (name == "frank") return ToComplex(FrankMatrix(9));
    if (name == "grcar") return ToComplex(GrcarMatrix(10));
    if (name == "clement") return ToComplex(ClementMatrix(8));
    if (name == "wilkinson") return ToComplex(WilkinsonMatrix(11));
    if (name == "tall") return ToComplex(Generate<double>(7, 4, Integer));
    if (name == "square") return ToComplex(Generate<double>(6, 6, Integer));
    if (name == "complex_tall") return Generate<Complex>(6, 4, GaussInteger);
    DenseMatrix<Complex> square = Generate<Complex>(5, 5, GaussInteger);
    if (name == "complex_square") return square;
    EXPECT_EQ(name, "hermitian");
    return Generate<Complex>(5, 5, [&](int32_t i, int32_t j) { return square(i, j) + Conjugate(square(j, i)); });
}

bool IsReal(const DenseMatrix<Complex>& a) {
    return std::all_of(a.elements.begin(), a.elements.end(), [](Complex x) { return x.im == 0.0; });
}

DenseMatrix<double> RealPart(const DenseMatrix<Complex>& a) {
    return Generate<double>(a.rows, a.columns, [&a](int32_t i, int32_t j) { return a(i, j).re; });
}

// Expects one value near each reference.
void ExpectNear(std::vector<Complex> actual, const std::vector<Reference>& references, double unit) {
    ASSERT_EQ(actual.size(), references.size());
    for (const Reference& reference : references) {
        const auto distance = [&reference](Complex z) { return Modulus(z - reference.value); };
        const auto nearest = std::min_element(actual.begin(), actual.end(),
                                              [&](Complex a, Complex b) { return distance(a) < distance(b); });
        EXPECT_LE(distance(*nearest), unit * reference.condition) << testing::PrintToString(reference.value.re);
        actual.erase(nearest);
    }
}

std::vector<Complex> AsComplex(const std::vector<double>& values) {
    std::vector<Complex> result;
    for (const double value : values) result.push_back({value, 0.0});
    return result;
}

double Unit(const DenseMatrix<Complex>& a) {
    return std::max(a.rows, a.columns) * kEpsilon * FrobeniusNorm(a);
}

template <class T>
std::vector<Complex> SingularValues(const DenseMatrix<T>& a) {
    std::vector<double> s(Count(std::min(a.rows, a.columns)));
    EXPECT_EQ(SvdValuesCore(a.data(), a.rows, a.columns, s.data()), kOk);
    return AsComplex(s);
}

TEST(Decompositions, SingularValuesAreThoseOfHighPrecision) {
    for (const auto& [name, references] : Load("singular")) {
        SCOPED_TRACE(name);
        const DenseMatrix<Complex> a = MatrixOf(name);
        ExpectNear(SingularValues(a), references, Unit(a));
        ExpectNear(SingularValues(Adjoint(a)), references, Unit(a));
        if (IsReal(a)) ExpectNear(SingularValues(RealPart(a)), references, Unit(a));
    }
}

TEST(Decompositions, EigenvaluesAreThoseOfHighPrecision) {
    for (const auto& [name, references] : Load("general")) {
        SCOPED_TRACE(name);
        const DenseMatrix<Complex> a = MatrixOf(name);
        std::vector<Complex> w(Count(a.rows));
        ASSERT_EQ(CxEigenGeneralCore(a.data(), a.rows, 0, w.data(), nullptr), kOk);
        ExpectNear(w, references, Unit(a));
        if (!IsReal(a)) continue;
        ASSERT_EQ(EigenGeneralCore(RealPart(a).data(), a.rows, 0, w.data(), nullptr), kOk);
        ExpectNear(w, references, Unit(a));
    }
}

TEST(Decompositions, EigenvaluesOfHermitianMatricesAreThoseOfHighPrecision) {
    for (const auto& [name, references] : Load("hermitian")) {
        SCOPED_TRACE(name);
        const DenseMatrix<Complex> a = MatrixOf(name);
        std::vector<double> w(Count(a.rows));
        ASSERT_EQ(HermitianEigenCore(a.data(), a.rows, 0, w.data(), nullptr), kOk);
        ExpectNear(AsComplex(w), references, Unit(a));
        if (!IsReal(a)) continue;
        const DenseMatrix<double> real = RealPart(a);
        ASSERT_EQ(SymEigenCore(real.data(), a.rows, 0, w.data(), nullptr), kOk);
        ExpectNear(AsComplex(w), references, Unit(a));
    }
}

}  // namespace
}  // namespace krnumer
