// The columns are split in halves, recursively (S. Toledo, SIAM J. Matrix Anal. Appl. 18, 1065, 1997), so that nearly
// all of the work is products of matrices. Every element is still reduced by the products of columns 0, 1, 2, ... in
// this order, as if each column were finished before the next is touched.
#include "linalg/lu.h"

#include <algorithm>
#include <numeric>
#include <utility>

#include "frame/numeric.h"
#include "frame/status.h"
#include "linalg/element.h"
#include "linalg/factor_kernels.h"

namespace krnumer {
namespace {

// What pivots are compared by: the magnitude, or its square.
double PivotSize(double a) {
    return Modulus(a);
}
double PivotSize(Complex a) {
    return SquaredModulus(a);
}

template <class T>
class Elimination {
  public:
    Elimination(T* a, size_t n, int32_t* pivots) : a_(a), n_(n), pivots_(pivots) {}

    // Finishes columns from `begin` up to `end`, all columns before them being finished.
    void Factor(size_t begin, size_t end) {
        if (end - begin <= kNarrow) {
            for (size_t k = begin; k < end; ++k) FactorColumn(k, end);
            return;
        }
        const size_t middle = begin + (end - begin) / 2;
        Factor(begin, middle);
        SolveUnitLower(begin, middle, middle, end);
        Subtract(middle, n_, begin, middle, middle, end);
        Factor(middle, end);
    }

    int32_t exchanges() const { return exchanges_; }
    bool column_failed() const { return column_failed_; }

  private:
    static constexpr size_t kNarrow = 4;

    T* Row(size_t i) { return a_ + i * n_; }

    // Rows x columns -= rows x terms times terms x columns.
    void Subtract(size_t row, size_t row_end, size_t term, size_t term_end, size_t column, size_t column_end) {
        SubtractProduct(ProductOperands<T>{.c = Row(row) + column,
                                           .c_row = {n_},
                                           .a = Row(row) + term,
                                           .a_row = n_,
                                           .a_term = {1},
                                           .b = Row(term) + column,
                                           .b_term = {n_},
                                           .rows = row_end - row,
                                           .columns = column_end - column,
                                           .terms = term_end - term});
    }

    // Rows of U from the rows of A: forward substitution with the unit lower triangle on the diagonal.
    void SolveUnitLower(size_t begin, size_t end, size_t column, size_t column_end) {
        if (end - begin == 1) return;
        const size_t middle = begin + (end - begin) / 2;
        SolveUnitLower(begin, middle, column, column_end);
        Subtract(middle, end, begin, middle, column, column_end);
        SolveUnitLower(middle, end, column, column_end);
    }

    // Finds the pivot of column k, divides by it and takes its products off the columns up to `end`.
    void FactorColumn(size_t k, size_t end) {
        double largest = 0.0;
        size_t pivot = n_;
        for (size_t i = k; i < n_; ++i) {
            const double size = PivotSize(Row(i)[k]);
            if (size > largest) {
                largest = size;
                pivot = i;
            }
        }
        const T* const top = Row(k);
        if (pivot == n_) {
            column_failed_ = true;
        } else {
            if (pivot != k) {
                std::swap_ranges(Row(k), Row(k) + n_, Row(pivot));
                pivots_[k] = static_cast<int32_t>(pivot);
                ++exchanges_;
            }
            for (size_t i = k + 1; i < n_; ++i) Row(i)[k] = Row(i)[k] / top[k];
        }
        for (size_t i = k + 1; i < n_; ++i)
            for (size_t j = k + 1; j < end; ++j) Row(i)[j] -= Row(i)[k] * top[j];
    }

    T* a_;
    size_t n_;
    int32_t* pivots_;
    int32_t exchanges_ = 0;
    bool column_failed_ = false;
};

template <class T>
int32_t Factor(T* a, int32_t n, int32_t* pivots, int32_t* parity) {
    if (n < 1) return kEmptyInput;
    std::iota(pivots, pivots + n, 0);
    Elimination<T> elimination(a, Count(n), pivots);
    elimination.Factor(0, Count(n));
    *parity = elimination.exchanges() % 2;
    return elimination.column_failed() ? kWarnZeroPivot : kOk;
}

}  // namespace

int32_t LUFactor(double* a, int32_t n, int32_t* pivots, int32_t* parity) {
    return Factor(a, n, pivots, parity);
}
int32_t LUFactor(Complex* a, int32_t n, int32_t* pivots, int32_t* parity) {
    return Factor(a, n, pivots, parity);
}

}  // namespace krnumer
