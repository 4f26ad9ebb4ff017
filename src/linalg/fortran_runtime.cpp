// The two places where LAPACK reaches for a run time of its own, filled so that a library inside somebody else's
// process stays silent and alone.
//
// The Fortran run time proper is not linked: its start-up code opens units on the host's standard streams and hooks
// itself into the C library's printf. All that LAPACK needs of it is the concatenation of two strings, by which the
// blocked routines ask ILAENV for their block size ("LN" of side L and transposition N).

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <cstring>

extern "C" {

void xerbla_(const char* routine, const std::int32_t* argument, std::size_t routine_length);
void _gfortran_concat_string(std::size_t length, char* result, std::size_t left_length, const char* left,
                             std::size_t right_length, const char* right);

// Called on a bad argument, before the routine returns with info = -argument. The reference version prints and stops
// the program; info is all that the callers here want.
void xerbla_(const char* /*routine*/, const std::int32_t* /*argument*/, std::size_t /*routine_length*/) {}

// Fortran's left // right: cut or padded with blanks to the length of the result.
void _gfortran_concat_string(std::size_t length, char* result, std::size_t left_length, const char* left,
                             std::size_t right_length, const char* right) {
    const std::size_t from_left = std::min(length, left_length);
    const std::size_t from_right = std::min(length - from_left, right_length);
    std::memcpy(result, left, from_left);
    std::memcpy(result + from_left, right, from_right);
    std::memset(result + from_left + from_right, ' ', length - from_left - from_right);
}
}
