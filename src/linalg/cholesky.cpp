// The packed columns of L are what they are in memory: the rows of the upper triangle U = L^T. A few rows are reduced
// by all finished ones at once. Every element is still reduced by the products of rows 0, 1, 2, ... in this order.
#include "linalg/cholesky.h"

#include <algorithm>
#include <cmath>

#include "frame/numeric.h"
#include "frame/status.h"
#include "linalg/element.h"
#include "linalg/factor_kernels.h"
#include "linalg/packed.h"

namespace krnumer {
namespace {

template <class T>
class PackedRows {
  public:
    PackedRows(T* packed, size_t n) : packed_(packed), n_(n) {}

    // Row j of U, to be indexed by column from j on.
    T* operator[](size_t j) const { return packed_ + (LowerDiagonal(j, n_) - j); }

    // Takes the products of rows 0 to first - 1 off `rows` rows of c.
    void SubtractEarlier(T* c, RowStep c_row, size_t first, size_t rows, size_t column, size_t columns) const {
        if (first == 0) return;
        SubtractProduct(ProductOperands<T>{.c = c,
                                           .c_row = c_row,
                                           .a = packed_ + first,
                                           .a_row = 1,
                                           .a_term = {n_ - 1, 1},
                                           .b = packed_ + column,
                                           .b_term = {n_ - 1, 1},
                                           .rows = rows,
                                           .columns = columns,
                                           .terms = first,
                                           .conjugate_a = true});
    }

  private:
    T* packed_;
    size_t n_;
};

// U of the leading `order` rows and columns of a square or of packed rows; false when it is not positive definite.
template <class T, class Rows>
bool FactorLeading(Rows& u, size_t order) {
    for (size_t j = 0; j < order; ++j) {
        for (size_t k = 0; k < j; ++k)
            for (size_t i = j; i < order; ++i) u[j][i] -= u[k][i] * Conjugate(u[k][j]);
        const double diagonal = RealPart(u[j][j]);
        if (diagonal <= 0.0) return false;
        u[j][j] = FromReal<T>(std::sqrt(diagonal));
        for (size_t i = j + 1; i < order; ++i) u[j][i] = u[j][i] / u[j][j];
    }
    return true;
}

// So few rows are not worth the call of a kernel.
constexpr size_t kFew = 10;

template <class T>
int32_t Factor(T* packed, int32_t order) {
    if (order < 1) return kEmptyInput;
    const size_t n = Count(order);
    const PackedRows<T> rows(packed, n);
    if (n <= kFew) return FactorLeading<T>(rows, n) ? kOk : kNotPositiveDefinite;
    for (size_t first = 0; first < n; first += kRowsTogether) {
        const size_t count = std::min(kRowsTogether, n - first), last = first + count;
        DiagonalSquare<T> square{};
        for (size_t j = 0; j < count; ++j) std::copy_n(rows[first + j] + first + j, count - j, square[j] + j);
        rows.SubtractEarlier(square[0], {kRowsTogether}, first, count, first, count);
        if (!FactorLeading<T>(square, count)) return kNotPositiveDefinite;
        for (size_t j = 0; j < count; ++j) std::copy_n(square[j] + j, count - j, rows[first + j] + first + j);
        if (last == n) break;
        rows.SubtractEarlier(rows[first] + last, {n - first - 1, 1}, first, count, last, n - last);
        T* const beside[] = {rows[first] + last, rows[first + 1] + last, rows[first + 2] + last,
                             rows[first + 3] + last};
        SolveBeside(square, beside, n - last);
    }
    return kOk;
}

// The largest magnitude, NaN aside. Several running maxima need not wait for each other.
double LargestMagnitude(const double* a, size_t count) {
    constexpr size_t kLanes = 16;
    double largest[kLanes] = {};
    size_t i = 0;
    for (; i + kLanes <= count; i += kLanes) {
        for (size_t lane = 0; lane < kLanes; ++lane) {
            const double magnitude = std::fabs(a[i + lane]);
            largest[lane] = magnitude > largest[lane] ? magnitude : largest[lane];
        }
    }
    for (; i < count; ++i) largest[0] = std::max(largest[0], std::fabs(a[i]));
    return *std::max_element(largest, largest + kLanes);
}

// Whether an element of the diagonal has lost half of its digits against the largest element of all.
bool IsNearlySingular(const double* packed, size_t n) {
    const double least = std::sqrt(kEpsilon) * LargestMagnitude(packed, n * (n + 1) / 2);
    for (size_t j = 0; j < n; ++j)
        if (packed[LowerDiagonal(j, n)] < least) return true;
    return false;
}

}  // namespace

int32_t CholeskyPacked(double* packed, int32_t n) {
    if (const int32_t status = Factor(packed, n)) return status;
    return IsNearlySingular(packed, Count(n)) ? kNotPositiveDefinite : kOk;
}

int32_t CholeskyPacked(Complex* packed, int32_t n) {
    return Factor(packed, n);
}

}  // namespace krnumer
