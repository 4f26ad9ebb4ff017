#include "sigop/half_complex_arithmetic.h"

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

}  // namespace krnumer
