#include "linalg/band.h"

#include "frame/numeric.h"
#include "frame/scratch.h"
#include "frame/status.h"
#include "linalg/lapack.h"

namespace krnumer {

template <class T>
int32_t BandSolve(const T* ab, int32_t n, int32_t kl, int32_t ku, T* b, int32_t nrhs) {
    if (n < 1 || nrhs < 1) return kEmptyInput;
    if (kl < 0 || ku < 0 || std::int64_t{kl} + ku + 1 > n) return kBadDimension;
    const int32_t diagonals = kl + ku + 1;
    const std::int64_t leading = std::int64_t{kl} + diagonals;  // the factors fill kl diagonals more
    if (leading > INT32_MAX) return kOutOfMemory;

    const std::size_t rows = Count(n);
    const std::size_t sets = Count(nrhs);
    Scratch<T> factors(static_cast<std::size_t>(leading) * rows);
    Scratch<int32_t> pivots(rows);
    Scratch<T> columns(nrhs > 1 ? rows * sets : 0);
    if (!factors || !pivots || !columns) return kOutOfMemory;
    for (std::size_t j = 0; j < rows; ++j) {
        T* const column = factors.data() + j * static_cast<std::size_t>(leading) + kl;
        for (int32_t i = 0; i < diagonals; ++i) column[i] = ab[Count(i) * rows + j];
    }
    if (nrhs == 1)
        return lapack::Gbsv(n, kl, ku, 1, factors.data(), static_cast<int32_t>(leading), pivots.data(), b, n) > 0
                   ? kSingular
                   : kOk;

    for (std::size_t i = 0; i < rows; ++i)
        for (std::size_t j = 0; j < sets; ++j) columns[j * rows + i] = b[i * sets + j];
    const int32_t info =
        lapack::Gbsv(n, kl, ku, nrhs, factors.data(), static_cast<int32_t>(leading), pivots.data(), columns.data(), n);
    for (std::size_t i = 0; i < rows; ++i)
        for (std::size_t j = 0; j < sets; ++j) b[i * sets + j] = columns[j * rows + i];
    return info > 0 ? kSingular : kOk;
}

template int32_t BandSolve(const double*, int32_t, int32_t, int32_t, double*, int32_t);
template int32_t BandSolve(const Complex*, int32_t, int32_t, int32_t, Complex*, int32_t);

}  // namespace krnumer
