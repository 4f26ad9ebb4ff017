#include "sigop/half_complex_arithmetic.h"

#include <algorithm>

namespace krnumer {
namespace {

// The values that have no imaginary part go through `real`, all others, re[k] and im[k], through `complex`.
template <class Real, class Pair>
void ForEachValue(int32_t n, Real real, Pair complex) {
    real(0);
    for (int32_t k = 1; k <= (n - 1) / 2; ++k) complex(k, n - k);
    if (n % 2 == 0) real(n / 2);
}

}  // namespace

void HalfComplexMultiply(const double* a, const double* b, double* out, int32_t n) {
    const auto multiply = [=](int32_t k) { out[k] = a[k] * b[k]; };
    if (a == b) {
        ForEachValue(n, multiply, [=](int32_t re, int32_t im) {
            out[re] = a[re] * a[re] + a[im] * a[im];
            out[im] = 0.0;
        });
        return;
    }
    ForEachValue(n, multiply, [=](int32_t re, int32_t im) {
        const double product = a[re] * b[re] - a[im] * b[im];
        out[im] = a[im] * b[re] + a[re] * b[im];
        out[re] = product;
    });
}

void HalfComplexDivide(const double* a, const double* b, double* out, int32_t n) {
    ForEachValue(
        n, [=](int32_t k) { out[k] = a[k] / b[k]; },
        [=](int32_t re, int32_t im) {
            const double scale = 1.0 / (b[re] * b[re] + b[im] * b[im]);
            const double quotient = (a[re] * b[re] + a[im] * b[im]) * scale;
            out[im] = (a[im] * b[re] - a[re] * b[im]) * scale;
            out[re] = quotient;
        });
}

void HartleyMultiply(const double* a, const double* b, double* out, int32_t n) {
    const double scale = 1.0 / n;
    ForEachValue(
        n, [=](int32_t k) { out[k] = a[k] * b[k] * scale; },
        [=](int32_t re, int32_t im) {
            const double product_re = (a[re] * b[re] - a[im] * b[im]) * scale;
            const double product_im = (a[im] * b[re] + a[re] * b[im]) * scale;
            out[re] = product_re - product_im;
            out[im] = product_re + product_im;
        });
}

void CopyUnfolded(const double* folded, int32_t n, double* x, int32_t count) {
    const int32_t half = n / 2 + 1;  // with the value in the middle, if there is one
    x[0] = folded[0];
    for (int32_t k = 1; k < std::min(count, half); ++k) x[k] = folded[k] - folded[n - k];
    if (n % 2 == 0 && n / 2 < count) x[n / 2] = folded[n / 2];
    for (int32_t k = half; k < count; ++k) x[k] = folded[n - k] + folded[k];
}

}  // namespace krnumer
