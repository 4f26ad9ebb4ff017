// LAPACK and BLAS as the cores call them: one name for the real and the complex routine, scalars by value, info as
// the result. Matrices are column-major with their leading dimension, as the Fortran routines want them.
//
// A bad argument ends in info < 0, silently. No routine starts a thread, and all may be called from several threads at
// once.
#pragma once

#include <cstddef>
#include <cstdint>
#include <type_traits>

#include "frame/complex.h"
#include "frame/numeric.h"
#include "frame/scratch.h"
#include "frame/status.h"

namespace krnumer::lapack {

// The routines' own signatures. Fortran takes every argument by address, which a reference is; the length of each
// character argument follows at the end.
namespace fortran {

using Int = std::int32_t;
using Length = std::size_t;

template <class T>
using Gbsv = void(const Int& n, const Int& kl, const Int& ku, const Int& nrhs, T* ab, const Int& ldab, Int* ipiv, T* b,
                  const Int& ldb, Int& info);
template <class T>
using Gehrd = void(const Int& n, const Int& ilo, const Int& ihi, T* a, const Int& lda, T* tau, T* work,
                   const Int& lwork, Int& info);
template <class T>
using Gebal = void(const char& job, const Int& n, T* a, const Int& lda, Int& ilo, Int& ihi, double* scale, Int& info,
                   Length);
template <class T>
using Gebak = void(const char& job, const char& side, const Int& n, const Int& ilo, const Int& ihi, const double* scale,
                   const Int& m, T* v, const Int& ldv, Int& info, Length, Length);
template <class T>
using Gelqf = void(const Int& m, const Int& n, T* a, const Int& lda, T* tau, T* work, const Int& lwork, Int& info);
template <class T>
using Orglq = void(const Int& m, const Int& n, const Int& k, T* a, const Int& lda, const T* tau, T* work,
                   const Int& lwork, Int& info);
template <class T>
using Trsyl = void(const char& trana, const char& tranb, const Int& isgn, const Int& m, const Int& n, const T* a,
                   const Int& lda, const T* b, const Int& ldb, T* c, const Int& ldc, double& scale, Int& info, Length,
                   Length);
template <class T>
using Gghrd = void(const char& compq, const char& compz, const Int& n, const Int& ilo, const Int& ihi, T* a,
                   const Int& lda, T* b, const Int& ldb, T* q, const Int& ldq, T* z, const Int& ldz, Int& info, Length,
                   Length);

extern "C" {

Gbsv<double> dgbsv_;
Gbsv<Complex> zgbsv_;
Gehrd<double> dgehrd_;
Gehrd<Complex> zgehrd_;
Gehrd<double> dorghr_;
Gehrd<Complex> zunghr_;
Gebal<double> dgebal_;
Gebal<Complex> zgebal_;
Gebak<double> dgebak_;
Gebak<Complex> zgebak_;
Gelqf<double> dgelqf_;
Gelqf<Complex> zgelqf_;
Orglq<double> dorglq_;
Orglq<Complex> zunglq_;
Orglq<double> dorgqr_;
Orglq<Complex> zungqr_;
Trsyl<double> dtrsyl_;
Trsyl<Complex> ztrsyl_;
Gghrd<double> dgghrd_;
Gghrd<Complex> zgghrd_;

void dgeqp3_(const Int& m, const Int& n, double* a, const Int& lda, Int* jpvt, double* tau, double* work,
             const Int& lwork, Int& info);
void zgeqp3_(const Int& m, const Int& n, Complex* a, const Int& lda, Int* jpvt, Complex* tau, Complex* work,
             const Int& lwork, double* rwork, Int& info);

void dgees_(const char& jobvs, const char& sort, Int (*select)(const double*, const double*), const Int& n, double* a,
            const Int& lda, Int& sdim, double* wr, double* wi, double* vs, const Int& ldvs, double* work,
            const Int& lwork, Int* bwork, Int& info, Length, Length);
void zgees_(const char& jobvs, const char& sort, Int (*select)(const Complex*), const Int& n, Complex* a,
            const Int& lda, Int& sdim, Complex* w, Complex* vs, const Int& ldvs, Complex* work, const Int& lwork,
            double* rwork, Int* bwork, Int& info, Length, Length);

void dtrexc_(const char& compq, const Int& n, double* t, const Int& ldt, double* q, const Int& ldq, Int& ifst,
             Int& ilst, double* work, Int& info, Length);
void ztrexc_(const char& compq, const Int& n, Complex* t, const Int& ldt, Complex* q, const Int& ldq, const Int& ifst,
             const Int& ilst, Int& info, Length);

void dhgeqz_(const char& job, const char& compq, const char& compz, const Int& n, const Int& ilo, const Int& ihi,
             double* h, const Int& ldh, double* t, const Int& ldt, double* alphar, double* alphai, double* beta,
             double* q, const Int& ldq, double* z, const Int& ldz, double* work, const Int& lwork, Int& info, Length,
             Length, Length);
void zhgeqz_(const char& job, const char& compq, const char& compz, const Int& n, const Int& ilo, const Int& ihi,
             Complex* h, const Int& ldh, Complex* t, const Int& ldt, Complex* alpha, Complex* beta, Complex* q,
             const Int& ldq, Complex* z, const Int& ldz, Complex* work, const Int& lwork, double* rwork, Int& info,
             Length, Length, Length);

void dtgexc_(const Int& wantq, const Int& wantz, const Int& n, double* a, const Int& lda, double* b, const Int& ldb,
             double* q, const Int& ldq, double* z, const Int& ldz, Int& ifst, Int& ilst, double* work, const Int& lwork,
             Int& info);
void ztgexc_(const Int& wantq, const Int& wantz, const Int& n, Complex* a, const Int& lda, Complex* b, const Int& ldb,
             Complex* q, const Int& ldq, Complex* z, const Int& ldz, const Int& ifst, Int& ilst, Int& info);

void dtgevc_(const char& side, const char& howmny, const Int* select, const Int& n, const double* s, const Int& lds,
             const double* p, const Int& ldp, double* vl, const Int& ldvl, double* vr, const Int& ldvr, const Int& mm,
             Int& m, double* work, Int& info, Length, Length);
void ztgevc_(const char& side, const char& howmny, const Int* select, const Int& n, const Complex* s, const Int& lds,
             const Complex* p, const Int& ldp, Complex* vl, const Int& ldvl, Complex* vr, const Int& ldvr,
             const Int& mm, Int& m, Complex* work, double* rwork, Int& info, Length, Length);

void dgelsd_(const Int& m, const Int& n, const Int& nrhs, double* a, const Int& lda, double* b, const Int& ldb,
             double* s, const double& rcond, Int& rank, double* work, const Int& lwork, Int* iwork, Int& info);
double dlapy2_(const double& x, const double& y);

void cblas_dgemm(int order, int transa, int transb, Int m, Int n, Int k, double alpha, const double* a, Int lda,
                 const double* b, Int ldb, double beta, double* c, Int ldc);
void cblas_zgemm(int order, int transa, int transb, Int m, Int n, Int k, const Complex* alpha, const Complex* a,
                 Int lda, const Complex* b, Int ldb, const Complex* beta, Complex* c, Int ldc);
}

template <class T, class Real, class Twin>
constexpr auto Choose([[maybe_unused]] Real* real, [[maybe_unused]] Twin* complex) {
    if constexpr (std::is_same_v<T, Complex>) {
        return complex;
    } else {
        static_assert(std::is_same_v<T, double>);
        return real;
    }
}

}  // namespace fortran

// --- Linear equations and least squares -----------------------------------------------------------------------------

// Solves with an n by n band matrix by LU with partial pivoting; ab needs kl rows of room above the band.
template <class T>
int32_t Gbsv(int32_t n, int32_t kl, int32_t ku, int32_t nrhs, T* ab, int32_t ldab, int32_t* ipiv, T* b, int32_t ldb) {
    int32_t info = 0;
    fortran::Choose<T>(fortran::dgbsv_, fortran::zgbsv_)(n, kl, ku, nrhs, ab, ldab, ipiv, b, ldb, info);
    return info;
}

// Minimum-norm least squares by the divide and conquer SVD.
inline int32_t Gelsd(int32_t m, int32_t n, int32_t nrhs, double* a, int32_t lda, double* b, int32_t ldb, double* s,
                     double rcond, int32_t& rank, double* work, int32_t lwork, int32_t* iwork) {
    int32_t info = 0;
    fortran::dgelsd_(m, n, nrhs, a, lda, b, ldb, s, rcond, rank, work, lwork, iwork, info);
    return info;
}

// op(A) X + isgn X op(B) = scale C with upper (quasi-)triangular A and B; X replaces C.
template <class T>
int32_t Trsyl(char trana, char tranb, int32_t isgn, int32_t m, int32_t n, const T* a, int32_t lda, const T* b,
              int32_t ldb, T* c, int32_t ldc, double& scale) {
    int32_t info = 0;
    fortran::Choose<T>(fortran::dtrsyl_, fortran::ztrsyl_)(trana, tranb, isgn, m, n, a, lda, b, ldb, c, ldc, scale,
                                                           info, 1, 1);
    return info;
}

// --- Orthogonal factorisations --------------------------------------------------------------------------------------

template <class T>
int32_t Gelqf(int32_t m, int32_t n, T* a, int32_t lda, T* tau, T* work, int32_t lwork) {
    int32_t info = 0;
    fortran::Choose<T>(fortran::dgelqf_, fortran::zgelqf_)(m, n, a, lda, tau, work, lwork, info);
    return info;
}

// DORGLQ, ZUNGLQ: the first m rows of the k reflectors' product.
template <class T>
int32_t Orglq(int32_t m, int32_t n, int32_t k, T* a, int32_t lda, const T* tau, T* work, int32_t lwork) {
    int32_t info = 0;
    fortran::Choose<T>(fortran::dorglq_, fortran::zunglq_)(m, n, k, a, lda, tau, work, lwork, info);
    return info;
}

// DORGQR, ZUNGQR: the first n columns of the k reflectors' product.
template <class T>
int32_t Orgqr(int32_t m, int32_t n, int32_t k, T* a, int32_t lda, const T* tau, T* work, int32_t lwork) {
    int32_t info = 0;
    fortran::Choose<T>(fortran::dorgqr_, fortran::zungqr_)(m, n, k, a, lda, tau, work, lwork, info);
    return info;
}

// QR with column pivoting. The complex routine needs rwork of 2n doubles, the real one none.
template <class T>
int32_t Geqp3(int32_t m, int32_t n, T* a, int32_t lda, int32_t* jpvt, T* tau, T* work, int32_t lwork,
              [[maybe_unused]] double* rwork) {
    int32_t info = 0;
    if constexpr (std::is_same_v<T, Complex>) {
        fortran::zgeqp3_(m, n, a, lda, jpvt, tau, work, lwork, rwork, info);
    } else {
        fortran::dgeqp3_(m, n, a, lda, jpvt, tau, work, lwork, info);
    }
    return info;
}

// --- Balancing, Hessenberg and Schur forms --------------------------------------------------------------------------

template <class T>
int32_t Gebal(char job, int32_t n, T* a, int32_t lda, int32_t& ilo, int32_t& ihi, double* scale) {
    int32_t info = 0;
    fortran::Choose<T>(fortran::dgebal_, fortran::zgebal_)(job, n, a, lda, ilo, ihi, scale, info, 1);
    return info;
}

template <class T>
int32_t Gebak(char job, char side, int32_t n, int32_t ilo, int32_t ihi, const double* scale, int32_t m, T* v,
              int32_t ldv) {
    int32_t info = 0;
    fortran::Choose<T>(fortran::dgebak_, fortran::zgebak_)(job, side, n, ilo, ihi, scale, m, v, ldv, info, 1, 1);
    return info;
}

template <class T>
int32_t Gehrd(int32_t n, int32_t ilo, int32_t ihi, T* a, int32_t lda, T* tau, T* work, int32_t lwork) {
    int32_t info = 0;
    fortran::Choose<T>(fortran::dgehrd_, fortran::zgehrd_)(n, ilo, ihi, a, lda, tau, work, lwork, info);
    return info;
}

// DORGHR, ZUNGHR: the orthogonal factor of Gehrd.
template <class T>
int32_t Orghr(int32_t n, int32_t ilo, int32_t ihi, T* a, int32_t lda, T* tau, T* work, int32_t lwork) {
    int32_t info = 0;
    fortran::Choose<T>(fortran::dorghr_, fortran::zunghr_)(n, ilo, ihi, a, lda, tau, work, lwork, info);
    return info;
}

// Schur form without ordering. The complex routine needs rwork of n doubles.
inline int32_t Gees(char jobvs, int32_t n, double* a, int32_t lda, double* wr, double* wi, double* vs, int32_t ldvs,
                    double* work, int32_t lwork) {
    int32_t info = 0, sdim = 0;
    fortran::dgees_(jobvs, 'N', nullptr, n, a, lda, sdim, wr, wi, vs, ldvs, work, lwork, nullptr, info, 1, 1);
    return info;
}

inline int32_t Gees(char jobvs, int32_t n, Complex* a, int32_t lda, Complex* w, Complex* vs, int32_t ldvs,
                    Complex* work, int32_t lwork, double* rwork) {
    int32_t info = 0, sdim = 0;
    fortran::zgees_(jobvs, 'N', nullptr, n, a, lda, sdim, w, vs, ldvs, work, lwork, rwork, nullptr, info, 1, 1);
    return info;
}

// Moves the diagonal block at ifst to ilst, counted from 1. The real routine needs work of n doubles.
template <class T>
int32_t Trexc(char compq, int32_t n, T* t, int32_t ldt, T* q, int32_t ldq, int32_t ifst, int32_t ilst,
              [[maybe_unused]] double* work) {
    int32_t info = 0;
    if constexpr (std::is_same_v<T, Complex>) {
        fortran::ztrexc_(compq, n, t, ldt, q, ldq, ifst, ilst, info, 1);
    } else {
        fortran::dtrexc_(compq, n, t, ldt, q, ldq, ifst, ilst, work, info, 1);
    }
    return info;
}

// --- Pencils --------------------------------------------------------------------------------------------------------

template <class T>
int32_t Gghrd(char compq, char compz, int32_t n, int32_t ilo, int32_t ihi, T* a, int32_t lda, T* b, int32_t ldb, T* q,
              int32_t ldq, T* z, int32_t ldz) {
    int32_t info = 0;
    fortran::Choose<T>(fortran::dgghrd_, fortran::zgghrd_)(compq, compz, n, ilo, ihi, a, lda, b, ldb, q, ldq, z, ldz,
                                                           info, 1, 1);
    return info;
}

// QZ iteration. The complex routine needs rwork of n doubles.
inline int32_t Hgeqz(char job, char compq, char compz, int32_t n, int32_t ilo, int32_t ihi, double* h, int32_t ldh,
                     double* t, int32_t ldt, double* alphar, double* alphai, double* beta, double* q, int32_t ldq,
                     double* z, int32_t ldz, double* work, int32_t lwork) {
    int32_t info = 0;
    fortran::dhgeqz_(job, compq, compz, n, ilo, ihi, h, ldh, t, ldt, alphar, alphai, beta, q, ldq, z, ldz, work, lwork,
                     info, 1, 1, 1);
    return info;
}

inline int32_t Hgeqz(char job, char compq, char compz, int32_t n, int32_t ilo, int32_t ihi, Complex* h, int32_t ldh,
                     Complex* t, int32_t ldt, Complex* alpha, Complex* beta, Complex* q, int32_t ldq, Complex* z,
                     int32_t ldz, Complex* work, int32_t lwork, double* rwork) {
    int32_t info = 0;
    fortran::zhgeqz_(job, compq, compz, n, ilo, ihi, h, ldh, t, ldt, alpha, beta, q, ldq, z, ldz, work, lwork, rwork,
                     info, 1, 1, 1);
    return info;
}

// Moves the pair at ifst to ilst, counted from 1; q and z follow where they are not null. The real routine needs work
// of lwork >= 4n + 16 doubles.
template <class T>
int32_t Tgexc(int32_t n, T* a, int32_t lda, T* b, int32_t ldb, T* q, int32_t ldq, T* z, int32_t ldz, int32_t ifst,
              int32_t ilst, [[maybe_unused]] double* work, [[maybe_unused]] int32_t lwork) {
    int32_t info = 0;
    const int32_t wantq = q != nullptr, wantz = z != nullptr;
    if constexpr (std::is_same_v<T, Complex>) {
        fortran::ztgexc_(wantq, wantz, n, a, lda, b, ldb, q, ldq, z, ldz, ifst, ilst, info);
    } else {
        fortran::dtgexc_(wantq, wantz, n, a, lda, b, ldb, q, ldq, z, ldz, ifst, ilst, work, lwork, info);
    }
    return info;
}

// Eigenvectors of a pencil in Schur form. work holds 6n doubles, or 2n complex and rwork 2n doubles.
template <class T>
int32_t Tgevc(char side, char howmny, int32_t n, const T* s, int32_t lds, const T* p, int32_t ldp, T* vl, int32_t ldvl,
              T* vr, int32_t ldvr, int32_t mm, T* work, [[maybe_unused]] double* rwork) {
    int32_t info = 0, m = 0;
    if constexpr (std::is_same_v<T, Complex>) {
        fortran::ztgevc_(side, howmny, nullptr, n, s, lds, p, ldp, vl, ldvl, vr, ldvr, mm, m, work, rwork, info, 1, 1);
    } else {
        fortran::dtgevc_(side, howmny, nullptr, n, s, lds, p, ldp, vl, ldvl, vr, ldvr, mm, m, work, info, 1, 1);
    }
    return info;
}

// --- BLAS -----------------------------------------------------------------------------------------------------------

enum Order { kRowMajor = 101, kColumnMajor = 102 };
enum Transposition { kNoTranspose = 111, kTranspose = 112, kConjugateTranspose = 113 };

// C = alpha op(A) op(B) + beta C, m by n, with k as the inner dimension.
inline void Gemm(Order order, Transposition transa, Transposition transb, int32_t m, int32_t n, int32_t k, double alpha,
                 const double* a, int32_t lda, const double* b, int32_t ldb, double beta, double* c, int32_t ldc) {
    fortran::cblas_dgemm(order, transa, transb, m, n, k, alpha, a, lda, b, ldb, beta, c, ldc);
}

inline void Gemm(Order order, Transposition transa, Transposition transb, int32_t m, int32_t n, int32_t k,
                 Complex alpha, const Complex* a, int32_t lda, const Complex* b, int32_t ldb, Complex beta, Complex* c,
                 int32_t ldc) {
    fortran::cblas_zgemm(order, transa, transb, m, n, k, &alpha, a, lda, b, ldb, &beta, c, ldc);
}

// Modulus without unnecessary overflow.
inline double Lapy2(double x, double y) {
    return fortran::dlapy2_(x, y);
}

// --- Workspace ------------------------------------------------------------------------------------------------------

// Runs call(work, lwork), which returns info, twice: as a query with lwork = -1, then with the array that it asked for
// in work[0]. A query with info other than 0 is the end of it. The result says whether there was memory.
template <class T, class Call>
[[nodiscard]] int32_t CallWithWorkspace(int32_t& info, Scratch<T>& work, Call&& call) {
    T asked{};
    info = call(&asked, -1);
    if (info != 0) return kOk;
    double size = 0.0;
    if constexpr (std::is_same_v<T, Complex>) {
        size = asked.re;
    } else {
        size = asked;
    }
    const int32_t lwork = SaturateToInt32(size);
    if (!work.Allocate(Count(lwork))) return kOutOfMemory;
    info = call(work.data(), lwork);
    return kOk;
}

}  // namespace krnumer::lapack
