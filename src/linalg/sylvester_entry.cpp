#include <cstring>

#include "krnumer/linalg_equations.h"
#include "linalg/element.h"
#include "linalg/entry_support.h"
#include "linalg/sylvester.h"

using namespace krnumer;

namespace {

constexpr int32_t kTriangular = 1;

template <class T>
int32_t CheckSylvester(const ShapedView<const T, 2>& a, const ShapedView<const T, 2>& b, const ShapedView<T, 2>& c) {
    if (!IsSquare(a) || !IsSquare(b)) return kNotSquare;
    if (c.rows() != a.rows() || c.columns() != b.rows()) return kSizesDiffer;
    return IsEmpty(c) ? kEmptyInput : kOk;
}

template <class T>
int32_t Sylvester(KrHandle a, KrHandle b, KrHandle c, const SylvesterOptions& options, double* scale,
                  int32_t* singular) {
    ByValue call;
    InMatrix<T> left(call, a);
    InMatrix<T> right(call, b);
    InOutMatrix<T> sides(call, c);
    double factor = 1.0;
    int32_t near_singular = 0;
    int32_t status = CheckSylvester<T>(left, right, sides);
    if (status != kOk) {
        call.Fail(status);
    } else {
        status = call.Run([&] {
            return SylvesterCore(left.data(), right.data(), sides.data(), sides.rows(), sides.columns(), options,
                                 &factor, &near_singular);
        });
    }
    std::memcpy(scale, &factor, sizeof factor);
    std::memcpy(singular, &near_singular, sizeof near_singular);
    return status;
}

// The equation of Sylvester with the adjoint of A in the place of B.
template <class T>
int32_t Lyapunov(KrHandle a, KrHandle q, int32_t form, double* scale) {
    ByValue call;
    InMatrix<T> matrix(call, a);
    InOutMatrix<T> sides(call, q);
    const int32_t n = matrix.rows();
    double factor = 1.0;
    int32_t status = kOk;
    if (IsEmpty(matrix)) {
        status = kEmptyInput;
    } else if (!IsSquare(matrix)) {
        status = kNotSquare;
    } else if (sides.rows() != n || sides.columns() != n) {
        status = kSizesDiffer;
    }
    if (status != kOk) {
        call.Fail(status);
    } else {
        status = call.Run([&] {
            int32_t near_singular = 0;
            return SylvesterCore(matrix.data(), matrix.data(), sides.data(), n, n, SylvesterOptions{0, 1, 1, form},
                                 &factor, &near_singular);
        });
    }
    std::memcpy(scale, &factor, sizeof factor);
    return status;
}

}  // namespace

int32_t Lyapunov_head(KrHandle a, KrHandle q, int32_t form, double* scale) {
    return Lyapunov<double>(a, q, form, scale);
}
int32_t CxLyapunov_head(KrHandle a, KrHandle q, int32_t form, double* scale) {
    return Lyapunov<Complex>(a, q, form, scale);
}

int32_t Sylvester_head(KrHandle a, KrHandle b, KrHandle c, int32_t transA, int32_t transB, int32_t sign, double* scale,
                       int32_t* singular) {
    return Sylvester<double>(a, b, c, {transA, transB, sign, kTriangular}, scale, singular);
}
int32_t CxSylvester_head(KrHandle a, KrHandle b, KrHandle c, int32_t transA, int32_t transB, int32_t sign,
                         double* scale, int32_t* singular) {
    return Sylvester<Complex>(a, b, c, {transA, transB, sign, kTriangular}, scale, singular);
}

int32_t Sylvester81_head(KrHandle a, KrHandle b, KrHandle c, int32_t transA, int32_t transB, int32_t sign, int32_t form,
                         double* scale, int32_t* singular) {
    return Sylvester<double>(a, b, c, {transA, transB, sign, form}, scale, singular);
}
int32_t CxSylvester81_head(KrHandle a, KrHandle b, KrHandle c, int32_t transA, int32_t transB, int32_t sign,
                           int32_t form, double* scale, int32_t* singular) {
    return Sylvester<Complex>(a, b, c, {transA, transB, sign, form}, scale, singular);
}
