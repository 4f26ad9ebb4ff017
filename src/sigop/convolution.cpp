#include "sigop/convolution.h"

#include <algorithm>
#include <bit>
#include <type_traits>

#include "frame/scratch.h"
#include "frame/status.h"
#include "sigop/direct_convolution.h"
#include "sigop/half_complex_arithmetic.h"
#include "sigop/spectrum.h"

namespace krnumer {
namespace {

template <class T>
int32_t ConvolveSpectra(const T* x, int32_t nx, const T* y, int32_t ny, T* z) {
    const int32_t n = NextGoodLength(FullLength(nx, ny));
    const HeldTable table(n);
    Scratch<T> work(3 * Count(n));
    if (!table || !work) return kOutOfMemory;
    T* a = work.data();
    T* b = a + n;
    T* c = b + n;
    CopyPadded(x, nx, a, n);
    CopyPadded(y, ny, b, n);
    if (const int32_t status = Forward(table.get(), a, c, n)) return status;
    if (const int32_t status = Forward(table.get(), b, a, n)) return status;
    return InverseOfProduct(table.get(), c, a, n, b, z, FullLength(nx, ny));
}

// The shorter sequence is the kernel. The sums of real data follow x, those of complex data the longer sequence.
template <class T>
void ConvolveDirectly(const T* x, int32_t nx, const T* y, int32_t ny, T* z) {
    const bool x_is_kernel = nx < ny;
    const Plane<T> kernel{x_is_kernel ? x : y, 1, std::min(nx, ny)};
    const Plane<T> signal{x_is_kernel ? y : x, 1, std::max(nx, ny)};
    const bool along_kernel = std::is_same_v<T, double> && x_is_kernel;
    DirectConvolution(kernel, signal, along_kernel ? TapOrder::kAscending : TapOrder::kDescending, z);
}

template <class T>
int32_t Convolve(const T* x, int32_t nx, const T* y, int32_t ny, int32_t algorithm, T* z) {
    if (nx < 1 || ny < 1) return kEmptyInput;
    if (FullLength(nx, ny) < 0) return kOutOfMemory;
    switch (algorithm) {
        case kDirect:
            ConvolveDirectly(x, nx, y, ny, z);
            return kOk;
        case kFrequencyDomain:
            return ConvolveSpectra(x, nx, y, ny, z);
        default:
            return std::is_same_v<T, double> ? kOk : kBadSelector;
    }
}

// The inverse transform of the power spectrum is the circular autocorrelation: negative lags stand at its end.
int32_t Autocorrelate(const double* x, int32_t nx, double* z) {
    if (nx < 1) return kEmptyInput;
    if (FullLength(nx, nx) < 0) return kOutOfMemory;
    const int32_t n = NextGoodLength(FullLength(nx, nx));
    const HeldTable table(n);
    Scratch<double> work(2 * Count(n));
    if (!table || !work) return kOutOfMemory;
    double* a = work.data();
    double* b = a + n;
    CopyPadded(x, nx, a, n);
    if (const int32_t status = Forward(table.get(), a, b, n)) return status;
    HalfComplexMultiply(b, b, b, n);
    if (const int32_t status = Inverse(table.get(), b, a, n)) return status;
    std::copy_n(a + (n - nx + 1), nx - 1, z);
    std::copy_n(a, nx, z + nx - 1);
    return kOk;
}

// Sums of real data follow y; of complex data y is the second factor, and the kernel where the lengths are equal.
template <class T>
int32_t ConvolveReversed(const T* x, int32_t nx, const T* y, int32_t ny, int32_t algorithm, T* z) {
    if (nx < 1 || ny < 1) return kEmptyInput;
    Scratch<T> reversed(Count(nx));
    if (!reversed) return kOutOfMemory;
    CopyReversed(x, Count(nx), reversed.data());
    if constexpr (std::is_same_v<T, double>) {
        return Convolve(y, ny, reversed.data(), nx, algorithm, z);
    } else {
        return Convolve(reversed.data(), nx, y, ny, algorithm, z);
    }
}

bool IsNormalization(int32_t normalization) {
    return normalization >= kNotNormalized && normalization <= kBiased;
}

template <class T>
void Normalize(T* z, int32_t nx, int32_t ny, int32_t normalization) {
    if (normalization == kNotNormalized) return;
    const auto [shorter, longer] = std::minmax(nx, ny);
    const int32_t length = FullLength(nx, ny);
    for (int32_t k = 0; k < length; ++k) {
        z[k] = z[k] / (normalization == kUnbiased ? std::min({k + 1, shorter, length - k}) : longer);
    }
}

}  // namespace

int32_t ConvolveReal(const double* x, int32_t nx, const double* y, int32_t ny, int32_t algorithm, double* z) {
    return Convolve(x, nx, y, ny, algorithm, z);
}
int32_t ConvolveComplex(const Complex* x, int32_t nx, const Complex* y, int32_t ny, int32_t algorithm, Complex* z) {
    return Convolve(x, nx, y, ny, algorithm, z);
}

int32_t CorrelateReal(const double* x, int32_t nx, const double* y, int32_t ny, int32_t algorithm, double* z,
                      int32_t normalization) {
    const bool with_itself = x == y && nx == ny && algorithm == kFrequencyDomain;
    const int32_t status = with_itself ? Autocorrelate(x, nx, z) : ConvolveReversed(x, nx, y, ny, algorithm, z);
    if (status != kOk) return status;
    if (!IsNormalization(normalization)) return kBadSelector;
    if (algorithm == kDirect || algorithm == kFrequencyDomain) Normalize(z, nx, ny, normalization);
    return kOk;
}
int32_t CorrelateComplex(const Complex* x, int32_t nx, const Complex* y, int32_t ny, int32_t algorithm, Complex* z,
                         int32_t normalization) {
    if (const int32_t status = ConvolveReversed(x, nx, y, ny, algorithm, z)) return status;
    if (!IsNormalization(normalization)) return kBadSelector;
    Normalize(z, nx, ny, normalization);
    return kOk;
}

int32_t Deconvolve(double* x, int32_t n, const double* y, int32_t m) {
    if (n > kLongestDeconvolution || m > kLongestDeconvolution) return kTooLong;
    if (n < 1 || m < 1) return kEmptyInput;
    if (n < m) return kBadDimension;
    const int32_t length = static_cast<int32_t>(std::bit_ceil(static_cast<uint32_t>(n)));
    Scratch<double> work(3 * Count(length));
    if (!work) return kOutOfMemory;
    const HeldTable table(length);
    if (!table) return kOk;
    double* a = work.data();
    double* b = a + length;
    double* c = b + length;
    CopyPadded(x, n, a, length);
    if (const int32_t status = Forward(table.get(), a, c, length)) return status;
    CopyPadded(y, m, a, length);
    if (const int32_t status = Forward(table.get(), a, b, length)) return status;
    HalfComplexDivide(c, b, b, length);
    if (const int32_t status = Inverse(table.get(), b, a, length)) return status;
    std::copy_n(a, n - m + 1, x);
    return kOk;
}

}  // namespace krnumer
