// Rows of numbers on their way between the data and what lies closer to the processor.
#pragma once

#include <cstddef>
#include <cstdint>

#include "fft/inline.h"
#include "hwy/cache_control.h"

namespace krnumer {

// `rows` rows of `count` doubles each; the steps lead from a row to the next. Rows do not overlap.
using RowsMove = void (*)(const double* from, ptrdiff_t from_step, double* to, ptrdiff_t to_step, int32_t rows,
                          int32_t count);

void CopyRows(const double* from, ptrdiff_t from_step, double* to, ptrdiff_t to_step, int32_t rows, int32_t count);

// Every row back to front.
void ReverseRows(const double* from, ptrdiff_t from_step, double* to, ptrdiff_t to_step, int32_t rows, int32_t count);

// CopyRows past the caches, for what would not stay in them; all lines must be written whole. What is read by others
// later needs a FlushStreams before.
void StreamRows(const double* from, ptrdiff_t from_step, double* to, ptrdiff_t to_step, int32_t rows, int32_t count);
void FlushStreams();

// Whether StreamRows may write rows that begin here.
inline bool IsLine(const void* p) {
    return reinterpret_cast<uintptr_t>(p) % 64 == 0;
}

// Fetches a line into the second-level cache; many lines would drive each other out of the first. Inlined by force, and
// so must be what calls it: a function that only fetches has no effect in the eyes of some compilers, which drop it.
KRNUMER_FFT_INLINE void FetchLine(const void* p) {
#if defined(__GNUC__) || defined(__clang__)
    __builtin_prefetch(p, 0, 2);
#else
    hwy::Prefetch(static_cast<const char*>(p));
#endif
}

}  // namespace krnumer
