#include "linalg/band.h"

#include <limits>

#include "frame/numeric.h"
#include "frame/scratch.h"
#include "frame/status.h"
#include "linalg/lapack.h"
#include "linalg/transpose.h"

namespace krnumer {

template <class T>
int32_t BandSolve(const T* band, int32_t n, int32_t kl, int32_t ku, T* b, int32_t nrhs) {
    if (n < 1 || nrhs < 1) return kEmptyInput;
    if (kl < 0 || ku < 0 || int64_t{kl} + ku + 1 > n) return kBadDimension;
    const int64_t column_length = 2 * int64_t{kl} + ku + 1;  // LAPACK fills in kl more diagonals above
    if (column_length > std::numeric_limits<int32_t>::max()) return kOutOfMemory;
    const auto ldab = static_cast<int32_t>(column_length);
    Scratch<T> columns(Count(n) * Count(ldab)), b_columns(nrhs > 1 ? Count(n) * Count(nrhs) : 0);
    Scratch<int32_t> pivots(Count(n));
    if (!columns || !b_columns || !pivots) return kOutOfMemory;
    for (size_t i = 0; i < Count(kl + ku + 1); ++i)
        for (size_t j = 0; j < Count(n); ++j) columns[j * Count(ldab) + Count(kl) + i] = band[i * Count(n) + j];

    T* const x = nrhs > 1 ? b_columns.data() : b;
    if (x != b) TransposeCore(b, n, nrhs, x);
    const int32_t info = lapack::Gbsv(n, kl, ku, nrhs, columns.data(), ldab, pivots.data(), x, n);
    if (info < 0) return kLapackError;
    if (info > 0) return kSingular;
    return x != b ? TransposeCore(x, nrhs, n, b) : kOk;
}

template int32_t BandSolve(const double*, int32_t, int32_t, int32_t, double*, int32_t);
template int32_t BandSolve(const Complex*, int32_t, int32_t, int32_t, Complex*, int32_t);

}  // namespace krnumer
