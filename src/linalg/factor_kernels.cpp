// Compiled once for every kind of vector unit that the machine may have. Tiles stay in registers while the terms go by;
// the columns of a tile fill vectors.
#include "linalg/factor_kernels.h"

#include "frame/vector_targets.h"
#include "linalg/element.h"

#undef HWY_TARGET_INCLUDE
#define HWY_TARGET_INCLUDE "linalg/factor_kernels.cpp"
#include <hwy/foreach_target.h>
#include <hwy/highway.h>

#include "linalg/elements-inl.h"

HWY_BEFORE_NAMESPACE();
namespace krnumer::HWY_NAMESPACE {
namespace {

namespace hn = hwy::HWY_NAMESPACE;

struct RowWalk {
    explicit RowWalk(RowStep row) : step(row.step), shrink(row.shrink) {}
    void Next() {
        offset += step;
        step -= shrink;
    }

    size_t offset = 0, step, shrink;
};

#if HWY_TARGET == HWY_SCALAR

template <class T>
void Subtract(const ProductOperands<T>& in) {
    RowWalk c_row(in.c_row);
    for (size_t row = 0; row < in.rows; ++row, c_row.Next()) {
        RowWalk a_term(in.a_term), b_term(in.b_term);
        for (size_t term = 0; term < in.terms; ++term, a_term.Next(), b_term.Next()) {
            const T element = in.a[row * in.a_row + a_term.offset];
            const T factor = in.conjugate_a ? Conjugate(element) : element;
            for (size_t column = 0; column < in.columns; ++column)
                in.c[c_row.offset + column] -= factor * in.b[b_term.offset + column];
        }
    }
}

template <class T>
void Solve(const DiagonalSquare<T>& square, T* const* rows, size_t count) {
    for (size_t row = 0; row < kRowsTogether; ++row) {
        for (size_t k = 0; k < row; ++k)
            for (size_t i = 0; i < count; ++i) rows[row][i] -= rows[k][i] * Conjugate(square[k][row]);
        for (size_t i = 0; i < count; ++i) rows[row][i] = rows[row][i] / square[row][row];
    }
}

#else

template <class D>
HWY_INLINE hn::Vec<D> Quotient(D d, hn::Vec<D> x, double divisor) {
    return hn::Div(x, hn::Set(d, divisor));
}

// Smith's quotient by a divisor without imaginary part.
template <class D>
HWY_INLINE hn::Vec<D> Quotient(D d, hn::Vec<D> x, Complex divisor) {
    alignas(16) static constexpr double kRatio[2] = {0.0, -0.0};
    return hn::Div(hn::Add(x, hn::Mul(hn::Shuffle01(x), hn::LoadDup128(d, kRatio))), hn::Set(d, divisor.re));
}

template <size_t kRows, size_t kVectors, class D, class T>
HWY_INLINE void SubtractTile(D d, const ProductOperands<T>& in, const T* a, RowWalk& c_row, size_t column) {
    T* c[kRows];
    for (size_t row = 0; row < kRows; ++row, c_row.Next()) c[row] = in.c + c_row.offset + column;
    hn::Vec<D> tile[kRows][kVectors];
    for (size_t row = 0; row < kRows; ++row)
        for (size_t v = 0; v < kVectors; ++v) tile[row][v] = LoadElements(d, c[row] + v * kElements<D, T>);

    RowWalk a_term(in.a_term), b_term(in.b_term);
    for (size_t term = 0; term < in.terms; ++term, a_term.Next(), b_term.Next()) {
        const T* const b = in.b + b_term.offset + column;
        for (size_t v = 0; v < kVectors; ++v) {
            const RowVector<D, T> factor(d, LoadElements(d, b + v * kElements<D, T>), in.conjugate_a);
            for (size_t row = 0; row < kRows; ++row)
                tile[row][v] = hn::Sub(tile[row][v], factor.Times(d, a + a_term.offset + row * in.a_row));
        }
    }

    for (size_t row = 0; row < kRows; ++row)
        for (size_t v = 0; v < kVectors; ++v) StoreElements(tile[row][v], d, c[row] + v * kElements<D, T>);
}

// Tiles of as many columns as there are vectors for, in all rows; then the next columns, so that b stays in the cache.
template <size_t kVectors, class D, class T>
HWY_INLINE size_t SubtractColumns(D d, const ProductOperands<T>& in, size_t column) {
    constexpr size_t kTall = 4;
    constexpr size_t kWide = kVectors * kElements<D, T>;
    for (; column + kWide <= in.columns; column += kWide) {
        RowWalk c_row(in.c_row);
        for (size_t row = 0; row < in.rows; row += kTall) {
            const T* const a = in.a + row * in.a_row;
            switch (in.rows - row) {
                case 1:
                    SubtractTile<1, kVectors>(d, in, a, c_row, column);
                    break;
                case 2:
                    SubtractTile<2, kVectors>(d, in, a, c_row, column);
                    break;
                case 3:
                    SubtractTile<3, kVectors>(d, in, a, c_row, column);
                    break;
                default:
                    SubtractTile<kTall, kVectors>(d, in, a, c_row, column);
            }
        }
    }
    return column;
}

template <class D, class T>
HWY_INLINE size_t SolveColumns(D d, const DiagonalSquare<T>& square, T* const* rows, size_t column, size_t count) {
    for (; column + kElements<D, T> <= count; column += kElements<D, T>) {
        hn::Vec<D> solved[kRowsTogether];
        for (size_t row = 0; row < kRowsTogether; ++row) {
            hn::Vec<D> x = LoadElements(d, rows[row] + column);
            for (size_t k = 0; k < row; ++k)
                x = hn::Sub(x, RowVector<D, T>(d, solved[k], true).Times(d, &square[k][row]));
            solved[row] = Quotient(d, x, square[row][row]);
            StoreElements(solved[row], d, rows[row] + column);
        }
    }
    return column;
}

template <class T>
void Subtract(const ProductOperands<T>& in) {
    const hn::ScalableTag<double> d;
    const size_t first = in.rows == 1 ? SubtractColumns<8>(d, in, 0) : 0;
    const size_t column = SubtractColumns<2>(d, in, first);
    ByFallingLength<T>(column, [&in](auto tag, size_t at) HWY_ATTR { return SubtractColumns<1>(tag, in, at); });
}

template <class T>
void Solve(const DiagonalSquare<T>& square, T* const* rows, size_t count) {
    ByFallingLength<T>(0, [&](auto d, size_t first) HWY_ATTR { return SolveColumns(d, square, rows, first, count); });
}

#endif  // HWY_TARGET

void SubtractReal(const ProductOperands<double>& operands) {
    Subtract(operands);
}
void SubtractComplex(const ProductOperands<Complex>& operands) {
    Subtract(operands);
}
void SolveReal(const DiagonalSquare<double>& square, double* const* rows, size_t count) {
    Solve(square, rows, count);
}
void SolveComplex(const DiagonalSquare<Complex>& square, Complex* const* rows, size_t count) {
    Solve(square, rows, count);
}

}  // namespace
}  // namespace krnumer::HWY_NAMESPACE
HWY_AFTER_NAMESPACE();

#if HWY_ONCE
namespace krnumer {

HWY_EXPORT(SubtractReal);
HWY_EXPORT(SubtractComplex);
HWY_EXPORT(SolveReal);
HWY_EXPORT(SolveComplex);

void SubtractProduct(const ProductOperands<double>& operands) {
    HWY_DYNAMIC_DISPATCH(SubtractReal)(operands);
}
void SubtractProduct(const ProductOperands<Complex>& operands) {
    HWY_DYNAMIC_DISPATCH(SubtractComplex)(operands);
}

void SolveBeside(const DiagonalSquare<double>& square, double* const* rows, size_t count) {
    HWY_DYNAMIC_DISPATCH(SolveReal)(square, rows, count);
}
void SolveBeside(const DiagonalSquare<Complex>& square, Complex* const* rows, size_t count) {
    HWY_DYNAMIC_DISPATCH(SolveComplex)(square, rows, count);
}

}  // namespace krnumer
#endif
