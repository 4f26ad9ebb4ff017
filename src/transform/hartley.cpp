#include "transform/hartley.h"

#include "frame/numeric.h"
#include "frame/scratch.h"
#include "frame/status.h"

namespace krnumer {

int32_t HilbertTransform(double* x, int32_t n, const qmfft_table* table) {
    if (n < 1) return kEmptyInput;
    if (n == 1) {
        x[0] = 0.0;
        return kOk;
    }
    Scratch<double> spectrum(Count(n));
    if (!spectrum) return kOutOfMemory;
    double* const w = spectrum.data();
    if (const int32_t status = RealFFT(table, x, w, 1, 1, n)) return status;
    w[0] = 0.0;
    if (n % 2 == 0) w[n / 2] = 0.0;
    for (int32_t k = 1; k <= (n - 1) / 2; ++k) {
        const double re = w[k];
        w[k] = w[n - k];
        w[n - k] = -re;
    }
    return InverseRealFFT(table, w, x, 1, 1, n);
}

int32_t InverseHilbertTransform(double* x, int32_t n, const qmfft_table* table) {
    if (const int32_t status = HilbertTransform(x, n, table)) return status;
    for (int32_t i = 0; i < n; ++i) x[i] = -x[i];
    return kOk;
}

int32_t HartleyTransform(double* x, int32_t n, const qmfft_table* table) {
    if (n < 1) return kEmptyInput;
    if (n == 1) return kOk;
    Scratch<double> spectrum(Count(n));
    if (!spectrum) return kOutOfMemory;
    double* const w = spectrum.data();
    if (const int32_t status = RealFFT(table, x, w, 1, 1, n)) return status;
    x[0] = w[0];
    for (int32_t k = 1; k <= (n - 1) / 2; ++k) {
        x[k] = w[k] - w[n - k];
        x[n - k] = w[k] + w[n - k];
    }
    if (n % 2 == 0) x[n / 2] = w[n / 2];
    return kOk;
}

int32_t InverseHartleyTransform(double* x, int32_t n, const qmfft_table* table) {
    if (const int32_t status = HartleyTransform(x, n, table)) return status;
    const double scale = 1.0 / n;
    for (int32_t i = 0; i < n; ++i) x[i] *= scale;
    return kOk;
}

}  // namespace krnumer
