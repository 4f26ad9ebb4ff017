#include "fft/direct.h"

#include "fft/stage.h"
#include "frame/numeric.h"
#include "frame/scratch.h"

namespace krnumer {
namespace {

// The direct transform as the kernel of a stage.
struct DirectKernel {
    int32_t r;
    const stage_tables& tables;
    Complex* work;  // r - 1 values

    int32_t points() const { return r; }
    int32_t Transform(Complex* t) const {
        DirectComplex(r, &t->re, &t->im, &t->re, &t->im, tables, 2, 2, work);
        return kOk;
    }
    int32_t TransformReal(double* x, ptrdiff_t stride) const {
        DirectReal(r, x, x, tables, stride, stride, &work->re);
        return kOk;
    }
};

// Calls step(j, t) with t = j q mod r for j = 1 .. r/2.
template <class Step>
void WalkMultiples(int32_t r, int32_t q, Step step) {
    int32_t t = q;
    for (int32_t j = 1; j <= r / 2; ++j) {
        step(j, t);
        t += q;
        if (t >= r) t -= r;
    }
}

}  // namespace

// X[0] is written last: until then its place may hold the sample 0 that all others need.
void DirectReal(int32_t r, const double* in, double* out, const stage_tables& tables, ptrdiff_t in_stride,
                ptrdiff_t out_stride, double* work) {
    const int32_t half = r / 2;
    double* sums = work;
    double* differences = work + half;
    const double first = in[0];
    for (int32_t j = 1; j <= half; ++j) {
        const double a = in[j * in_stride];
        const double b = in[(r - j) * in_stride];
        sums[j - 1] = a + b;
        differences[j - 1] = a - b;
    }
    for (int32_t q = 1; q <= half; ++q) {
        double re = first;
        double im = 0.0;
        WalkMultiples(r, q, [&](int32_t j, int32_t t) {
            re += sums[j - 1] * tables.dftCos[t];
            im += differences[j - 1] * tables.dftSin[t];
        });
        out[q * out_stride] = re;
        out[(r - q) * out_stride] = im;
    }
    double total = first;
    for (int32_t j = 0; j < half; ++j) total += sums[j];
    out[0] = total;
}

void DirectComplex(int32_t r, const double* in_re, const double* in_im, double* out_re, double* out_im,
                   const stage_tables& tables, ptrdiff_t in_stride, ptrdiff_t out_stride, Complex* work) {
    const int32_t half = r / 2;
    Complex* sums = work;
    Complex* differences = sums + half;
    const Complex first{in_re[0], in_im[0]};
    for (int32_t j = 1; j <= half; ++j) {
        const Complex a{in_re[j * in_stride], in_im[j * in_stride]};
        const Complex b{in_re[(r - j) * in_stride], in_im[(r - j) * in_stride]};
        sums[j - 1] = a + b;
        differences[j - 1] = a - b;
    }
    for (int32_t q = 1; q <= half; ++q) {
        Complex lower = first;
        Complex upper = first;
        WalkMultiples(r, q, [&](int32_t j, int32_t t) {
            const Complex even = sums[j - 1] * tables.dftCos[t];
            const Complex odd = differences[j - 1] * tables.dftSin[t];
            lower += Complex{even.re - odd.im, even.im + odd.re};
            upper += Complex{even.re + odd.im, even.im - odd.re};
        });
        out_re[q * out_stride] = lower.re;
        out_im[q * out_stride] = lower.im;
        out_re[(r - q) * out_stride] = upper.re;
        out_im[(r - q) * out_stride] = upper.im;
    }
    Complex total = first;
    for (int32_t j = 0; j < half; ++j) total += sums[j];
    out_re[0] = total.re;
    out_im[0] = total.im;
}

int32_t DirectRealLeaf(int32_t r, const stage_tables& tables, const double* in, double* out, int32_t in_stride,
                       int32_t out_stride, int32_t how_many) {
    Scratch<double> work(Count(r));
    if (!work) return kOutOfMemory;
    const ptrdiff_t step = ptrdiff_t{in_stride} * how_many;
    for (int32_t i = 0; i < how_many; ++i, in += in_stride, out += ptrdiff_t{r} * out_stride)
        DirectReal(r, in, out, tables, step, out_stride, work.data());
    return kOk;
}

int32_t DirectComplexLeaf(int32_t r, const stage_tables& tables, const double* in_re, const double* in_im,
                          double* out_re, double* out_im, int32_t in_stride, int32_t out_stride, int32_t how_many) {
    Scratch<Complex> work(Count(r));
    if (!work) return kOutOfMemory;
    const ptrdiff_t step = ptrdiff_t{in_stride} * how_many;
    const ptrdiff_t block = ptrdiff_t{r} * out_stride;
    for (int32_t i = 0; i < how_many; ++i) {
        DirectComplex(r, in_re, in_im, out_re, out_im, tables, step, out_stride, work.data());
        in_re += in_stride;
        in_im += in_stride;
        out_re += block;
        out_im += block;
    }
    return kOk;
}

int32_t DirectRealStage(int32_t r, const stage_tables& tables, double* data, int32_t stride, int32_t m) {
    Scratch<Complex> work(2 * Count(r));
    if (!work) return kOutOfMemory;
    const DirectKernel kernel{r, tables, work.data() + r};
    return CombineReal(kernel, work.data(), data, {tables.twiddleRe, tables.twiddleIm}, stride, m);
}

int32_t DirectComplexStage(int32_t r, const stage_tables& tables, double* re, double* im, int32_t stride, int32_t m) {
    Scratch<Complex> work(2 * Count(r));
    if (!work) return kOutOfMemory;
    const DirectKernel kernel{r, tables, work.data() + r};
    return CombineComplex(kernel, work.data(), re, im, {tables.twiddleRe, tables.twiddleIm}, stride, m);
}

}  // namespace krnumer
