// Some complex kernels of OpenBLAS load elements that they do not use from behind their operands: ZGEMV those of one
// more column, ZDOTU and ZDOTC with increments one more element. At the end of what is mapped that is a fault. The
// linker leads every call of them here (--wrap), where nothing is left behind the last element that a kernel may load.

#include <cstddef>
#include <cstdint>

#include "frame/complex.h"
#include "linalg/element.h"

using krnumer::Complex;

namespace {

using Int = std::int32_t;

using Zgemv = void(const char& trans, const Int& m, const Int& n, const Complex& alpha, const Complex* a,
                   const Int& lda, const Complex* x, const Int& incx, const Complex& beta, Complex* y, const Int& incy);
using Zdot = Complex(const Int& n, const Complex* x, const Int& incx, const Complex* y, const Int& incy);

}  // namespace

// NOLINTBEGIN(bugprone-reserved-identifier): the names are the linker's
extern "C" {

Zgemv __real_zgemv_, __wrap_zgemv_;
Zdot __real_zdotu_, __wrap_zdotu_, __real_zdotc_, __wrap_zdotc_;
}

namespace {

// A vector as BLAS hands it over: with a negative increment it begins at its last element.
template <class T>
class Strided {
  public:
    Strided(T* elements, Int n, Int step)
        : first_(step < 0 ? elements - std::ptrdiff_t{n - 1} * step : elements), step_(step) {}
    T& operator[](Int i) const { return first_[std::ptrdiff_t{i} * step_]; }

  private:
    T* first_;
    std::ptrdiff_t step_;
};

template <class Factor>
Complex Dot(Int n, const Complex* x, Int incx, const Complex* y, Int incy, Factor factor) {
    const Strided left(x, n, incx), right(y, n, incy);
    Complex sum{};
    for (Int i = 0; i < n; ++i) sum += factor(left[i]) * right[i];
    return sum;
}

}  // namespace

// The last column is kept from the kernel and added here.
void __wrap_zgemv_(const char& trans, const Int& m, const Int& n, const Complex& alpha, const Complex* a,
                   const Int& lda, const Complex* x, const Int& incx, const Complex& beta, Complex* y,
                   const Int& incy) {
    const bool is_fit = m > 0 && n > 0 && lda >= m && incx != 0 && incy != 0;
    if (trans != 'N' || !is_fit) return __real_zgemv_(trans, m, n, alpha, a, lda, x, incx, beta, y, incy);

    const Int last = n - 1;
    const Strided sums(y, m, incy);
    if (last > 0) {
        __real_zgemv_(trans, m, last, alpha, a, lda, incx < 0 ? x - incx : x, incx, beta, y, incy);
    } else {
        for (Int i = 0; i < m; ++i) sums[i] = beta == Complex{} ? Complex{} : beta * sums[i];
    }
    if (alpha == Complex{}) return;
    const Complex factor = alpha * Strided(x, n, incx)[last];
    const Complex* const column = a + std::ptrdiff_t{lda} * last;
    for (Int i = 0; i < m; ++i) sums[i] += factor * column[i];
}

Complex __wrap_zdotu_(const Int& n, const Complex* x, const Int& incx, const Complex* y, const Int& incy) {
    if (incx == 1 && incy == 1) return __real_zdotu_(n, x, incx, y, incy);
    return Dot(n, x, incx, y, incy, [](Complex element) { return element; });
}

Complex __wrap_zdotc_(const Int& n, const Complex* x, const Int& incx, const Complex* y, const Int& incy) {
    if (incx == 1 && incy == 1) return __real_zdotc_(n, x, incx, y, incy);
    return Dot(n, x, incx, y, incy, [](Complex element) { return Conjugate(element); });
}
// NOLINTEND(bugprone-reserved-identifier)
