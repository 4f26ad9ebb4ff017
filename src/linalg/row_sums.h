// Sums of products of several rows with one vector, side by side: each sum keeps the order of its terms, and none has
// to wait for the additions of another.
#pragma once

#include <cstddef>

namespace krnumer {

// sums[r] = row r of the block (rows `stride` apart) times x, over `columns` columns.
template <int kRows, class T>
void RowSums(const T* block, std::ptrdiff_t stride, std::ptrdiff_t columns, const T* x, T* sums) {
    T running[kRows] = {};
    for (std::ptrdiff_t j = 0; j < columns; ++j)
        for (int row = 0; row < kRows; ++row) running[row] += block[row * stride + j] * x[j];
    for (int row = 0; row < kRows; ++row) sums[row] = running[row];
}

// take(row, sum) for every one of `rows` rows.
template <class T, class Take>
void ForEachRowSum(const T* block, std::ptrdiff_t stride, std::ptrdiff_t rows, std::ptrdiff_t columns, const T* x,
                   Take&& take) {
    constexpr int kTogether = 4;
    T sums[kTogether];
    std::ptrdiff_t i = 0;
    for (; i + kTogether <= rows; i += kTogether) {
        RowSums<kTogether>(block + i * stride, stride, columns, x, sums);
        for (int row = 0; row < kTogether; ++row) take(i + row, sums[row]);
    }
    for (; i < rows; ++i) {
        RowSums<1>(block + i * stride, stride, columns, x, sums);
        take(i, sums[0]);
    }
}

}  // namespace krnumer
