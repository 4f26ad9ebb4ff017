// Reflectors: what they do to the vector that they were made of, and their application to blocks against its
// definition, to the last bit on every vector unit.
#include "linalg/householder.h"

#include <gtest/gtest.h>

#include <vector>

#include "linalg/test_matrices.h"
#include "support/vector_units.h"

namespace krnumer {
namespace {

template <class T>
class Householder : public ::testing::Test {};
using Elements = ::testing::Types<double, Complex>;
TYPED_TEST_SUITE(Householder, Elements);

// I + v v^H / h on a column.
template <class T>
std::vector<T> Reflected(const std::vector<T>& v, double h, std::vector<T> x) {
    T projection{};
    for (std::size_t k = 0; k < v.size(); ++k) projection += Conjugate(v[k]) * x[k];
    for (std::size_t k = 0; k < v.size(); ++k) x[k] += v[k] * (projection / h);
    return x;
}

TYPED_TEST(Householder, TurnsItsVectorIntoTheFirstUnitVector) {
    using T = TypeParam;
    for (int32_t n = 1; n <= 9; ++n) {
        const std::vector<T> x = RandomMatrix<T>(n, 1, 5).elements;
        std::vector<T> v = x;
        const Reflector<T> reflector = MakeReflector(v.data(), n, 1);
        const std::vector<T> image = Reflected(v, reflector.h, x);
        double squares = 0.0;
        for (std::size_t k = 0; k < x.size(); ++k) {
            EXPECT_LE(Modulus(image[k] - (k == 0 ? reflector.image : T{})), 1e-15) << n;
            squares += SquaredModulus(x[k]);
        }
        EXPECT_NEAR(SquaredModulus(reflector.image), squares, 1e-14) << n;
        EXPECT_LE(RealPart(Conjugate(reflector.image) * x[0]), 0.0) << "the phase is not the opposite one";
    }
}

TYPED_TEST(Householder, LeavesAZeroVectorAlone) {
    std::vector<TypeParam> x(4);
    const Reflector<TypeParam> reflector = MakeReflector(x.data(), 4, 1);
    EXPECT_EQ(reflector.h, 0.0);
    EXPECT_EQ(reflector.image, TypeParam{});
    EXPECT_EQ(x, std::vector<TypeParam>(4));
}

constexpr int32_t kSizes[] = {1, 2, 3, 4, 5, 7, 8, 9, 15, 16, 17, 31, 33};

TYPED_TEST(Householder, ReflectsBlocksInTheOrderOfTheirElements) {
    using T = TypeParam;
    for (const int32_t m : kSizes) {
        for (const int32_t n : kSizes) {
            const DenseMatrix<T> a = RandomMatrix<T>(m, n, 1), v = RandomMatrix<T>(m, 3, 2),
                                 r = RandomMatrix<T>(n, 1, 3), scaled = RandomMatrix<T>(n, 1, 4);
            std::vector<T> sums(Count(n));
            DenseMatrix<T> added = a, both(m, n), rows = a;
            for (int32_t k = 0; k < m; ++k)
                for (int32_t j = 0; j < n; ++j) sums[Count(j)] += Conjugate(v(k, 1)) * a(k, j);
            for (int32_t k = 0; k < m; ++k)
                for (int32_t j = 0; j < n; ++j) added(k, j) += v(k, 1) * sums[Count(j)];
            both = added;
            for (DenseMatrix<T>* x : {&both, &rows}) {
                for (int32_t k = 0; k < m; ++k) {
                    T sum{};
                    for (int32_t j = 0; j < n; ++j) sum += (*x)(k, j) * Conjugate(r(j, 0));
                    for (int32_t j = 0; j < n; ++j) (*x)(k, j) += sum * scaled(j, 0);
                }
            }
            OnEveryVectorUnit([&] {
                SCOPED_TRACE(testing::Message() << m << " by " << n);
                const Spaced<T> column{v.data() + 1, 3};
                DenseMatrix<T> x = a, y = a, z = a;
                std::vector<T> found(Count(n));
                SumColumns(column, {x.data(), m, n, n}, found.data());
                EXPECT_EQ(found, sums);
                AddProducts(column, sums.data(), Block<T>{x.data(), m, n, n});
                EXPECT_EQ(x, added);
                ReflectRows(r.data(), scaled.data(), Block<T>{y.data(), m, n, n});
                EXPECT_EQ(y, rows);
                AddProductsAndReflectRows(column, sums.data(), r.data(), scaled.data(), Block<T>{z.data(), m, n, n});
                EXPECT_EQ(z, both);
            });
        }
    }
}

}  // namespace
}  // namespace krnumer
