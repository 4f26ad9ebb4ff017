// The Sylvester equation op(A) X + sign X op(B) = scale C, by Schur forms of A and B (R. H. Bartels and G. W. Stewart,
// Comm. ACM 15, 820, 1972).
#pragma once

#include <cstdint>

namespace krnumer {

// The selectors as a caller gives them.
struct SylvesterOptions {
    int32_t transpose_a;  // 0, or 1 for the transpose, which is the conjugate transpose of a complex matrix
    int32_t transpose_b;
    int32_t sign;  // 1 or -1
    int32_t form;  // 0: any matrices; 1: A and B are upper (quasi-)triangular already
};

// A is m by m, B n by n, C m by n, row-major; X takes the place of C. `scale` up to 1 keeps X from overflow. Where A
// and -sign B have (nearly) a common eigenvalue, `singular` is 1, `scale` is 1, and X solves least squares: of the
// whole equation with the least norm where it is small, column by column where it is large. The two scalars are written
// on success only.
//
// -20003: m or n below 1; -20061: a bad selector; -20068: data that cannot be used; -20062: no convergence; -20073,
// -20074: LAPACK reports a failed reordering; -20999: LAPACK fails otherwise; -20001.
template <class T>
int32_t SylvesterCore(const T* a, const T* b, T* c, int32_t m, int32_t n, const SylvesterOptions& options,
                      double* scale, int32_t* singular);

}  // namespace krnumer
