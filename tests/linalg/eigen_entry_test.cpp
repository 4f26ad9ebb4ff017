#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <vector>

#include "frame/status.h"
#include "krnumer/linalg_eigen.h"
#include "linalg/eigen_general.h"
#include "linalg/eigen_symmetric.h"
#include "linalg/test_matrices.h"
#include "support/host_arrays.h"
#include "support/numbers.h"

namespace krnumer {
namespace {

using testing::ElementsAre;

template <class T>
HostMatrix<T> Host(const DenseMatrix<T>& a) {
    return HostMatrix<T>(a.rows, a.columns, a.elements);
}

template <class T>
bool WithoutDimensions(const HostMatrix<T>& a) {
    return a.rows() == 0 && a.columns() == 0;
}

// Sizes, and what they are told to be.
struct BadSize {
    int32_t rows, columns, status;
};
constexpr BadSize kBadSizes[] = {{0, 0, kEmptyInput}, {0, 3, kNotSquare}, {3, 0, kNotSquare}, {2, 3, kNotSquare}};

struct General {
    explicit General(HostMatrix<double>& a, int32_t want_vectors) {
        EXPECT_EQ(EigenValueVector_head(a.handle(), &want_vectors, w.handle(), v.handle(), &err), 0);
    }
    int32_t err = 77;
    HostArray<Complex> w{{9, 9}};
    HostMatrix<Complex> v{1, 2, {{9, 9}, {9, 9}}};
};

TEST(EigenValueVector_head, DeliversValuesAndVectors) {
    const DenseMatrix<double> a = RandomMatrix<double>(5, 5, 1);
    std::vector<Complex> w(5);
    DenseMatrix<Complex> v(5, 5);
    ASSERT_EQ(EigenGeneralCore(a.data(), 5, 1, w.data(), v.data()), kOk);
    HostMatrix<double> input = Host(a);
    const General both(input, 1);
    EXPECT_EQ(both.err, 0);
    EXPECT_EQ(both.w.values(), w);
    EXPECT_EQ(both.v.rows(), 5);
    EXPECT_EQ(both.v.columns(), 5);
    EXPECT_EQ(both.v.values(), v.elements);
    EXPECT_EQ(input.values(), a.elements);
}

TEST(EigenValueVector_head, LeavesVectorsEmptyThatNobodyWants) {
    HostMatrix<double> input = Host(RandomMatrix<double>(5, 5, 1));
    const General values(input, 0), both(input, 1);
    EXPECT_EQ(values.err, 0);
    EXPECT_EQ(values.w.values(), both.w.values());
    EXPECT_TRUE(WithoutDimensions(values.v));
}

TEST(EigenValueVector_head, PutsTheDiagonalOfATriangularMatrixInPlace) {
    HostMatrix<double> input(3, 3, {0.1, 5, 6, 0, -0.3, 7, 0, 0, 0.2});
    EXPECT_THAT(General(input, 0).w.values(), ElementsAre(Complex{0.1, 0}, Complex{-0.3, 0}, Complex{0.2, 0}));
}

TEST(EigenValueVector_head, EmptiesBothOnFailure) {
    const auto expect_failure = [](HostMatrix<double>& a, int32_t want_vectors, int32_t status) {
        const General result(a, want_vectors);
        EXPECT_EQ(result.err, status);
        EXPECT_EQ(result.w.size(), 0);
        EXPECT_TRUE(WithoutDimensions(result.v));
    };
    for (const BadSize& bad : kBadSizes) {
        HostMatrix<double> a(bad.rows, bad.columns);
        expect_failure(a, 1, bad.status);
        expect_failure(a, 5, bad.status);
    }
    HostMatrix<double> a(2, 2, {1, 2, 3, 4});
    for (const int32_t want : {-1, 2}) expect_failure(a, want, kBadSelector);
    a.Set(0, 1, kQuietNaN);
    for (const int32_t want : {0, 1}) expect_failure(a, want, kNotFinite);
    expect_failure(a, 2, kBadSelector);
    EXPECT_EQ(a.rows(), 2);
}

struct ComplexEigen {
    ComplexEigen(const DenseMatrix<Complex>& matrix, int32_t kind, int32_t want_vectors) : a(Host(matrix)) {
        EXPECT_EQ(CxEigenValueVector_head(a.handle(), &kind, &want_vectors, w.handle(), &err), 0);
    }
    int32_t err = 77;
    HostMatrix<Complex> a;
    HostArray<Complex> w{{9, 9}};
};

TEST(CxEigenValueVector_head, PutsTheVectorsOfAGeneralMatrixInItsPlace) {
    const DenseMatrix<Complex> a = RandomMatrix<Complex>(6, 6, 2);
    std::vector<Complex> w(6);
    DenseMatrix<Complex> v(6, 6);
    ASSERT_EQ(CxEigenGeneralCore(a.data(), 6, 1, w.data(), v.data()), kOk);
    const ComplexEigen both(a, 0, 1);
    EXPECT_EQ(both.err, 0);
    EXPECT_EQ(both.w.values(), w);
    EXPECT_EQ(both.a.values(), v.elements);
}

TEST(CxEigenValueVector_head, SpreadsTheValuesOfAHermitianMatrix) {
    const DenseMatrix<Complex> a = RandomHermitian<Complex>(6, 3);
    std::vector<double> w(6);
    DenseMatrix<Complex> v(6, 6);
    ASSERT_EQ(HermitianEigenCore(a.data(), 6, 1, w.data(), v.data()), kOk);
    const ComplexEigen both(a, 1, 1);
    EXPECT_EQ(both.err, 0);
    ASSERT_EQ(both.w.size(), 6);
    for (int32_t i = 0; i < 6; ++i) EXPECT_EQ(both.w[i], (Complex{w[Count(i)], 0.0}));
    EXPECT_EQ(both.a.values(), v.elements);
}

TEST(CxEigenValueVector_head, EmptiesAWhenNobodyWantsVectors) {
    for (const int32_t kind : {0, 1}) {
        const DenseMatrix<Complex> a = RandomHermitian<Complex>(6, 3);
        const ComplexEigen values(a, kind, 0), both(a, kind, 1);
        EXPECT_EQ(values.err, 0);
        EXPECT_EQ(values.w.size(), 6);
        EXPECT_TRUE(WithoutDimensions(values.a));
        EXPECT_THAT(values.w.values(), AllNear(both.w.values(), 1e-13, 1e-14));
    }
}

TEST(CxEigenValueVector_head, TakesTheRealPartOfASingleHermitianElement) {
    DenseMatrix<Complex> a(1, 1);
    a(0, 0) = {3.0, 4.0};
    const ComplexEigen hermitian(a, 1, 1), general(a, 0, 1);
    EXPECT_EQ(hermitian.w[0], (Complex{3.0, 0.0}));
    EXPECT_EQ(hermitian.a(0, 0), (Complex{1.0, 0.0}));
    EXPECT_EQ(general.w[0], (Complex{3.0, 4.0}));
}

TEST(CxEigenValueVector_head, EmptiesBothOnFailure) {
    const auto expect_failure = [](const DenseMatrix<Complex>& a, int32_t kind, int32_t want, int32_t status) {
        const ComplexEigen result(a, kind, want);
        EXPECT_EQ(result.err, status);
        EXPECT_TRUE(WithoutDimensions(result.a));
        EXPECT_EQ(result.w.size(), 0);
    };
    for (const BadSize& bad : kBadSizes) {
        expect_failure(DenseMatrix<Complex>(bad.rows, bad.columns), 0, 1, bad.status);
        expect_failure(DenseMatrix<Complex>(bad.rows, bad.columns), 7, 7, bad.status);
    }
    DenseMatrix<Complex> a = RandomHermitian<Complex>(3, 4);
    for (const int32_t kind : {-1, 2}) expect_failure(a, kind, 1, kBadSelector);
    for (const int32_t kind : {0, 1}) expect_failure(a, kind, 2, kBadSelector);
    a(0, 1).im = kInfinity;
    for (const int32_t kind : {0, 1}) {
        expect_failure(a, kind, 0, kNotFinite);
        expect_failure(a, kind, 2, kBadSelector);
    }
}

struct Symmetric {
    Symmetric(const DenseMatrix<double>& matrix, int32_t want_vectors) : a(Host(matrix)) {
        EXPECT_EQ(SymEvectorEvalue_head(a.handle(), &want_vectors, w.handle(), &err), 0);
    }
    int32_t err = 77;
    HostMatrix<double> a;
    HostArray<double> w{9, 9};
};

TEST(SymEvectorEvalue_head, PutsTheVectorsInThePlaceOfTheMatrix) {
    const DenseMatrix<double> a = RandomHermitian<double>(6, 5);
    std::vector<double> w(6);
    DenseMatrix<double> v(6, 6);
    ASSERT_EQ(SymEigenCore(a.data(), 6, 1, w.data(), v.data()), kOk);
    const Symmetric both(a, 1);
    EXPECT_EQ(both.err, 0);
    EXPECT_EQ(both.w.values(), w);
    EXPECT_EQ(both.a.values(), v.elements);
    const Symmetric values(a, 0);
    EXPECT_EQ(values.err, 0);
    EXPECT_EQ(values.w.values(), w);
    EXPECT_TRUE(WithoutDimensions(values.a));
}

TEST(SymEvectorEvalue_head, DoesNotMindAnUnsymmetricMatrix) {
    DenseMatrix<double> a(2, 2);
    a.elements = {1.0, 50.0, 0.0, 3.0};
    const Symmetric values(a, 0);
    EXPECT_EQ(values.err, 0);
    EXPECT_THAT(values.w.values(), ElementsAre(1.0, 3.0));
}

TEST(SymEvectorEvalue_head, EmptiesBothOnFailure) {
    const auto expect_failure = [](const DenseMatrix<double>& a, int32_t want, int32_t status) {
        const Symmetric result(a, want);
        EXPECT_EQ(result.err, status);
        EXPECT_TRUE(WithoutDimensions(result.a));
        EXPECT_EQ(result.w.size(), 0);
    };
    for (const BadSize& bad : kBadSizes) expect_failure(DenseMatrix<double>(bad.rows, bad.columns), 4, bad.status);
    DenseMatrix<double> a = RandomHermitian<double>(3, 6);
    for (const int32_t want : {-1, 2}) expect_failure(a, want, kBadSelector);
    a(0, 2) = kQuietNaN;  // above the diagonal, where nothing is used
    expect_failure(a, 1, kNotFinite);
    expect_failure(a, 3, kBadSelector);
}

TEST(SymEvectorEvalue_head, SizesTheValuesBeforeItMissesTheElements) {
    FailResize refuse(1, 7, KRRT_RESIZES);
    EXPECT_EQ(Symmetric(DenseMatrix<double>(0, 0), 0).err, kOutOfMemory);
    EXPECT_TRUE(refuse.happened());
}

struct Polynomial {
    explicit Polynomial(const DenseMatrix<double>& a) {
        HostMatrix<double> input = Host(a);
        EXPECT_EQ(MatrixCharacteristicPoly_head(input.handle(), c.handle(), &err), 0);
    }
    int32_t err = 77;
    HostArray<double> c{9, 9};
};

TEST(MatrixCharacteristicPoly_head, StartsWithTheConstantAndEndsWithOne) {
    const auto identity = Generate<double>(2, 2, [](int32_t i, int32_t j) { return i == j ? 1.0 : 0.0; });
    EXPECT_THAT(Polynomial(identity).c.values(), ElementsAre(1.0, -2.0, 1.0));
    DenseMatrix<double> one(1, 1);
    one(0, 0) = -4.0;
    EXPECT_THAT(Polynomial(one).c.values(), ElementsAre(4.0, 1.0));
}

TEST(MatrixCharacteristicPoly_head, KnowsTraceAndDeterminant) {
    DenseMatrix<double> a(3, 3);
    a.elements = {2, -1, 4, 3, 0, 5, -2, 7, 1};
    const Polynomial p(a);
    EXPECT_EQ(p.err, 0);
    EXPECT_THAT(p.c.values(), AllNear(std::vector<double>{-27.0, -22.0, -3.0, 1.0}, 1e-13));
}

TEST(MatrixCharacteristicPoly_head, EmptiesTheCoefficientsOnFailure) {
    for (const BadSize& bad : kBadSizes) {
        const Polynomial p(DenseMatrix<double>(bad.rows, bad.columns));
        EXPECT_EQ(p.err, bad.status);
        EXPECT_EQ(p.c.size(), 0);
    }
    DenseMatrix<double> a(2, 2);
    a(1, 1) = kInfinity;
    const Polynomial p(a);
    EXPECT_EQ(p.err, kNotFinite);
    EXPECT_EQ(p.c.size(), 0);
}

struct Companion {
    explicit Companion(HostArray<Complex> lambda) {
        EXPECT_EQ(CreateMatrixFromEVs_head(lambda.handle(), m.handle(), &err), 0);
    }
    int32_t err = 77;
    HostMatrix<double> m{1, 3};
};

TEST(CreateMatrixFromEVs_head, PutsTheCoefficientsIntoTheLastRow) {
    const Companion companion({{1, 0}, {2, 0}});
    EXPECT_EQ(companion.err, 0);
    EXPECT_EQ(companion.m.rows(), 2);
    EXPECT_EQ(companion.m.columns(), 2);
    EXPECT_THAT(companion.m.values(), ElementsAre(0, 1, -2, 3));
    EXPECT_THAT(Companion({{-7, 0}}).m.values(), ElementsAre(-7));
    EXPECT_THAT(Companion({{1, 2}, {3, 0}, {1, -2}}).m.values(), ElementsAre(0, 1, 0, 0, 0, 1, 15, -11, 5));
}

TEST(CreateMatrixFromEVs_head, LosesImaginaryPartsSilently) {
    const Companion companion({{1, 1}, {2, 0}});
    EXPECT_EQ(companion.err, 0);
    EXPECT_THAT(companion.m.values(), ElementsAre(0, 1, -2, 3));
}

TEST(CreateMatrixFromEVs_head, ReturnsTheEigenvalues) {
    const std::vector<Complex> lambda{{0.5, 2}, {0.5, -2}, {-3, 0}, {4, 0}, {1, 0.25}, {1, -0.25}};
    Companion companion{HostArray<Complex>(lambda)};
    std::vector<Complex> w(6);
    ASSERT_EQ(EigenGeneralCore(companion.m.values().data(), 6, 0, w.data(), nullptr), kOk);
    for (const Complex& wanted : lambda)
        EXPECT_TRUE(std::any_of(w.begin(), w.end(), [&](Complex z) { return Modulus(z - wanted) < 1e-12; }));
}

TEST(CreateMatrixFromEVs_head, NeedsEigenvalues) {
    const Companion companion{HostArray<Complex>()};
    EXPECT_EQ(companion.err, kEmptyInput);
    EXPECT_TRUE(WithoutDimensions(companion.m));
}

}  // namespace
}  // namespace krnumer
