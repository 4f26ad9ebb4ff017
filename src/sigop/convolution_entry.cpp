#include <algorithm>

#include "frame/entry.h"
#include "frame/scratch.h"
#include "krnumer/sigop.h"
#include "sigop/convolution.h"
#include "sigop/convolution2d.h"

using namespace krnumer;

namespace {

// Two sequences and the full length of their convolution. A handle passed twice reaches the core as one pointer.
template <class T, class Core>
int32_t Combine(Call&& call, KrHandle x, KrHandle y, KrHandle z, Core core) {
    In<T> first(call, x);
    In<T> second(call, y);
    Out<T> combined(call, z);
    if (first.size() < 1 || second.size() < 1) return call.Fail(kEmptyInput);
    if (combined.Resize(FullLength(first.size(), second.size())) != 0) return call.Fail(kOutOfMemory);
    return call.Run([&] {
        const T* other = x == y ? first.data() : second.data();
        return core(first.data(), first.size(), other, second.size(), combined.data());
    });
}

int32_t CorrelateWithItself(KrHandle x, int32_t normalization, int32_t* err) {
    ByReference call(err);
    InOut<double> samples(call, x);
    const int32_t n = samples.size();
    if (n < 1) return call.Fail(kEmptyInput);
    Scratch<double> copy(Count(n));
    if (!copy) return call.Fail(kOutOfMemory);
    if (const int32_t status = call.Map()) return call.Fail(status);
    std::copy_n(samples.data(), n, copy.data());
    if (samples.Resize(FullLength(n, n)) != 0) return call.Fail(kOutOfMemory);
    return call.Run(
        [&] { return CorrelateReal(copy.data(), n, copy.data(), n, kFrequencyDomain, samples.data(), normalization); });
}

void DeconvolveInPlace(KrHandle x, KrHandle y, int32_t* err) {
    ByReference call(err);
    InOut<double> samples(call, x);
    In<double> kernel(call, y);
    int32_t status = call.Map();
    if (status == kOk) status = Deconvolve(samples.data(), samples.size(), kernel.data(), kernel.size());
    if (status == kOk && samples.Resize(samples.size() - kernel.size() + 1) != 0) status = kOutOfMemory;
    call.Deliver(status);
}

template <class T>
bool IsEmpty(const In<T, 2>& plane) {
    return plane.rows() < 1 || plane.columns() < 1;
}

template <class T, class Core>
int32_t ConvolvePlanes(KrHandle x, KrHandle y, KrHandle z, int32_t output_size, int32_t algorithm, Core core) {
    ByValue call;
    InMatrix<T> first(call, x);
    InMatrix<T> second(call, y);
    OutMatrix<T> convolved(call, z);
    if (IsEmpty(first) || IsEmpty(second)) return call.Fail(kEmptyInput);
    if (output_size < kFullOutput || output_size > kValidOutput) return call.Fail(kBadSelector);
    const PlaneSize size = OutputSize({first.rows(), first.columns()}, {second.rows(), second.columns()}, output_size);
    if (output_size == kValidOutput && (size.rows < 1 || size.columns < 1)) return call.Fail(kBadDimension);
    if (convolved.Resize(size.rows, size.columns) != 0) return call.Fail(kOutOfMemory);
    if (const int32_t status = call.Map()) return call.Fail(status);
    const int32_t status = core(first.data(), first.rows(), first.columns(), second.data(), second.rows(),
                                second.columns(), convolved.data(), output_size, algorithm);
    if (status != kOk) convolved.ReleaseElements();
    return call.Leave(status);
}

template <class T, class Core>
int32_t CorrelatePlanes(KrHandle x, KrHandle y, KrHandle z, int32_t algorithm, Core core) {
    ByValue call;
    InMatrix<T> first(call, x);
    InMatrix<T> second(call, y);
    OutMatrix<T> correlated(call, z);
    if (IsEmpty(first) || IsEmpty(second)) return call.Fail(kEmptyInput);
    const int32_t host =
        correlated.Resize(FullLength(first.rows(), second.rows()), FullLength(first.columns(), second.columns()));
    if (host != 0) return call.Fail(kOutOfMemory);
    return call.Run([&] {
        return core(first.data(), first.rows(), first.columns(), second.data(), second.rows(), second.columns(),
                    correlated.data(), algorithm);
    });
}

}  // namespace

int32_t Convolution(KrHandle x, KrHandle y, KrHandle z, const int32_t* algorithm, int32_t* err) {
    return Combine<double>(ByReference(err), x, y, z,
                           [&](const double* a, int32_t na, const double* b, int32_t nb, double* out) {
                               return ConvolveReal(a, na, b, nb, *algorithm, out);
                           });
}

int32_t CxConvolution(KrHandle x, KrHandle y, KrHandle z, int32_t algorithm, int32_t correlate, int32_t normalization) {
    return Combine<Complex>(ByValue(), x, y, z,
                            [&](const Complex* a, int32_t na, const Complex* b, int32_t nb, Complex* out) {
                                if (correlate == 0) return ConvolveComplex(a, na, b, nb, algorithm, out);
                                return CorrelateComplex(a, na, b, nb, algorithm, out, normalization);
                            });
}

int32_t Rxy(KrHandle x, KrHandle y, KrHandle z, const int32_t* algorithm, int32_t* err) {
    return Rxy80(x, y, z, algorithm, kNotNormalized, err);
}

int32_t Rxy80(KrHandle x, KrHandle y, KrHandle z, const int32_t* algorithm, int32_t normalization, int32_t* err) {
    return Combine<double>(ByReference(err), x, y, z,
                           [&](const double* a, int32_t na, const double* b, int32_t nb, double* out) {
                               return CorrelateReal(a, na, b, nb, *algorithm, out, normalization);
                           });
}

int32_t AutoCorrelation(KrHandle x, int32_t* err) {
    return CorrelateWithItself(x, kNotNormalized, err);
}

int32_t AutoCorrelation80(KrHandle x, int32_t normalization, int32_t* err) {
    return CorrelateWithItself(x, normalization, err);
}

int32_t Deconvolution(KrHandle x, KrHandle y, int32_t* err) {
    DeconvolveInPlace(x, y, err);
    return *err;
}

int32_t Convolve_2DH(KrHandle x, KrHandle y, KrHandle z, int32_t outputSize, int32_t algorithm) {
    return ConvolvePlanes<double>(x, y, z, outputSize, algorithm, Convolve2DReal);
}
int32_t CxConvolve_2DH(KrHandle x, KrHandle y, KrHandle z, int32_t outputSize, int32_t algorithm) {
    return ConvolvePlanes<Complex>(x, y, z, outputSize, algorithm, Convolve2DComplex);
}

int32_t Correlation_2DH(KrHandle x, KrHandle y, KrHandle z, int32_t algorithm) {
    return CorrelatePlanes<double>(x, y, z, algorithm, Correlate2DReal);
}
int32_t CxCorrelation_2DH(KrHandle x, KrHandle y, KrHandle z, int32_t algorithm) {
    return CorrelatePlanes<Complex>(x, y, z, algorithm, Correlate2DComplex);
}
