#include "linalg/eigen_polynomial.h"

#include <algorithm>
#include <cstddef>

#include "frame/numeric.h"
#include "frame/scratch.h"
#include "frame/status.h"
#include "linalg/eigen_general.h"
#include "linalg/finite.h"

namespace krnumer {

int32_t PolyFromRoots(const Complex* roots, int32_t n, Complex* out) {
    if (n < 0) return kEmptyInput;
    out[0] = {1.0, 0.0};
    for (std::ptrdiff_t degree = 1; degree <= n; ++degree) {
        const Complex root = roots[degree - 1];
        out[degree] = out[degree - 1];
        for (std::ptrdiff_t k = degree - 1; k > 0; --k) out[k] = out[k - 1] - root * out[k];
        out[0] = -(root * out[0]);
    }
    return n + 1;
}

int32_t CharacteristicPolynomial(const double* a, int32_t n, double* c) {
    if (n < 1) return kEmptyInput;
    const std::size_t size = Count(n);
    if (HasUnusable(a, size * size)) return kNotFinite;
    Scratch<Complex> block(2 * size + 1);
    if (!block) return kOutOfMemory;
    Complex* eigenvalues = block.data();
    Complex* coefficients = eigenvalues + size;
    if (const int32_t status = EigenGeneralCore(a, n, 0, eigenvalues, nullptr)) return status;
    const int32_t count = PolyFromRoots(eigenvalues, n, coefficients);
    std::transform(coefficients, coefficients + count, c, [](Complex z) { return z.re; });
    return kOk;
}

int32_t MatrixFromEigenvalues(const Complex* eigenvalues, int32_t n, double* m) {
    if (n < 1) return kEmptyInput;
    const std::size_t size = Count(n);
    Scratch<Complex> coefficients(size + 1);
    if (!coefficients) return kOutOfMemory;
    PolyFromRoots(eigenvalues, n, coefficients.data());
    std::fill_n(m, size * size, 0.0);
    for (std::size_t i = 0; i + 1 < size; ++i) m[i * size + i + 1] = 1.0;
    double* last = m + (size - 1) * size;
    std::transform(coefficients.data(), coefficients.data() + size, last, [](Complex z) { return -z.re; });
    return kOk;
}

}  // namespace krnumer
