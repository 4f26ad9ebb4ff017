#include "fft/rader.h"

#include <cstddef>

#include "fft/half_complex.h"
#include "fft/stage.h"
#include "frame/complex.h"
#include "frame/numeric.h"
#include "frame/scratch.h"

namespace krnumer {
namespace {

int32_t MultiplyModulo(int32_t a, int32_t b, int32_t r) {
    return static_cast<int32_t>(int64_t{a} * b % r);
}

int32_t LeastPrimitiveRoot(int32_t r) {
    for (int32_t root = 2; root < r; ++root) {
        int32_t order = 1;
        for (int32_t power = root; power != 1; power = MultiplyModulo(power, root, r)) ++order;
        if (order == r - 1) return root;
    }
    return 1;
}

// Complex values at a stride in doubles: with real and imaginary parts side by side, or in arrays of their own.
struct Interleaved {
    double* re;
    double* im;
    ptrdiff_t stride;

    Complex* At(ptrdiff_t k) const { return reinterpret_cast<Complex*>(re + k * stride); }
    Complex Get(ptrdiff_t k) const { return *At(k); }
    void Put(ptrdiff_t k, Complex value) const { *At(k) = value; }
};

struct Split {
    double* re;
    double* im;
    ptrdiff_t stride;

    Complex Get(ptrdiff_t k) const { return {re[k * stride], im[k * stride]}; }
    void Put(ptrdiff_t k, Complex value) const {
        re[k * stride] = value.re;
        im[k * stride] = value.im;
    }
};

// The transform of the convolution of `count` = r - 1 values, conjugated: z becomes the conjugate of z times the
// kernel's spectrum, so that one more forward transform gives the conjugate of the inverse one.
template <class Values>
void MultiplyByKernel(const stage_tables& tables, const Values& values, int32_t count) {
    for (int32_t k = 0; k < count; ++k) {
        const Complex z = values.Get(k);
        const Complex w{tables.raderRe[k], tables.raderIm[k]};
        values.Put(k, {z.re * w.re - z.im * w.im, -z.re * w.im - z.im * w.re});
    }
}

// r complex samples in(k); `out` may be where they are. `work` holds r - 1 values.
template <class In, class Out>
int32_t TransformByRader(int32_t r, const In& in, const Out& out, const stage_tables& tables, Complex* work) {
    const auto stride = static_cast<int32_t>(out.stride);
    const Out rest{out.re + stride, out.im + stride, stride};
    const Complex first = in(0);
    Complex total = first;
    for (int32_t k = 1; k < r; ++k) {
        work[k - 1] = in(tables.raderIn[k]);
        total += work[k - 1];
    }
    out.Put(0, total);
    if (const int32_t status =
            ComplexFFT(tables.raderTable, &work->re, &work->im, rest.re, rest.im, 2, stride, r - 1)) {
        return status;
    }
    MultiplyByKernel(tables, rest, r - 1);
    if (const int32_t status =
            ComplexFFT(tables.raderTable, rest.re, rest.im, &work->re, &work->im, stride, 2, r - 1)) {
        return status;
    }
    for (int32_t k = 1; k < r; ++k) out.Put(tables.raderOut[k], {first.re + work[k - 1].re, first.im - work[k - 1].im});
    return kOk;
}

int32_t RaderComplex(int32_t r, const double* in_re, const double* in_im, double* out_re, double* out_im,
                     const stage_tables& tables, ptrdiff_t in_stride, int32_t out_stride, Complex* work) {
    if (in_im == in_re + 1 && out_im == out_re + 1) {
        const auto in = [=](ptrdiff_t k) { return *reinterpret_cast<const Complex*>(in_re + k * in_stride); };
        return TransformByRader(r, in, Interleaved{out_re, out_im, out_stride}, tables, work);
    }
    const auto in = [=](ptrdiff_t k) { return Complex{in_re[k * in_stride], in_im[k * in_stride]}; };
    return TransformByRader(r, in, Split{out_re, out_im, out_stride}, tables, work);
}

// r real samples to half-complex form; in place is allowed. `work` and `spectrum` hold r - 1 values each.
int32_t RaderReal(int32_t r, const double* in, double* out, const stage_tables& tables, ptrdiff_t in_stride,
                  ptrdiff_t out_stride, Complex* work, Complex* spectrum) {
    const double first = in[0];
    double total = first;
    double* samples = &work->re;
    for (int32_t k = 1; k < r; ++k) {
        samples[k - 1] = in[tables.raderIn[k] * in_stride];
        total += samples[k - 1];
    }
    out[0] = total;
    double* half_complex = HalfComplexPart(spectrum, r - 1);
    if (const int32_t status = RealFFT(tables.raderTable, samples, half_complex, 1, 1, r - 1)) return status;
    ExpandHalfComplex(spectrum, r - 1, 0);
    MultiplyByKernel(tables, Interleaved{&spectrum->re, &spectrum->im, 2}, r - 1);
    if (const int32_t status =
            ComplexFFT(tables.raderTable, &spectrum->re, &spectrum->im, &work->re, &work->im, 2, 2, r - 1)) {
        return status;
    }
    for (int32_t k = 1; k < r; ++k) {
        const int32_t p = tables.raderOut[k];
        if (p > r / 2) continue;
        out[p * out_stride] = first + work[k - 1].re;
        out[(r - p) * out_stride] = -work[k - 1].im;
    }
    return kOk;
}

// Rader's transform as the kernel of a stage. Real samples take the column of the stage for their spectrum, which is
// free at that time.
struct RaderKernel {
    int32_t r;
    const stage_tables& tables;
    Complex* work;
    Complex* column;

    int32_t points() const { return r; }
    int32_t Transform(Complex* t) const { return RaderComplex(r, &t->re, &t->im, &t->re, &t->im, tables, 2, 2, work); }
    int32_t TransformReal(double* x, ptrdiff_t stride) const {
        return RaderReal(r, x, x, tables, stride, stride, work, column);
    }
};

}  // namespace

bool FillRaderTables(stage_tables* tables, int32_t r) {
    const int32_t root = LeastPrimitiveRoot(r);
    tables->raderIn[0] = tables->raderOut[0] = 0;
    tables->raderIn[1] = tables->raderOut[1] = 1;
    int32_t power = 1;
    for (int32_t t = 1; t < r - 1; ++t) {
        power = MultiplyModulo(power, root, r);
        tables->raderOut[t + 1] = power;
        tables->raderIn[r - t] = power;
    }

    // The factor of the inverse transform is carried by the kernel.
    FillRotations(6.283185307179586 / r, tables->raderRe, tables->raderIm, r - 1, 1);
    Scratch<Complex> kernel(Count(r - 1));
    if (!kernel) return false;
    const double scale = 1.0 / (r - 1);
    for (int32_t i = 0; i < r - 1; ++i) {
        const int32_t at = tables->raderOut[i + 1] - 1;
        kernel[Count(i)] = {scale * tables->raderRe[at], scale * tables->raderIm[at]};
    }
    return ComplexFFT(tables->raderTable, &kernel.data()->re, &kernel.data()->im, tables->raderRe, tables->raderIm, 2,
                      1, r - 1) == kOk;
}

int32_t RaderRealLeaf(int32_t r, const stage_tables& tables, const double* in, double* out, int32_t in_stride,
                      int32_t out_stride, int32_t how_many) {
    Scratch<Complex> work(2 * Count(r));
    if (!work) return kOutOfMemory;
    const ptrdiff_t step = ptrdiff_t{in_stride} * how_many;
    for (int32_t i = 0; i < how_many; ++i, in += in_stride, out += ptrdiff_t{r} * out_stride) {
        if (const int32_t status = RaderReal(r, in, out, tables, step, out_stride, work.data(), work.data() + r)) {
            return status;
        }
    }
    return kOk;
}

int32_t RaderComplexLeaf(int32_t r, const stage_tables& tables, const double* in_re, const double* in_im,
                         double* out_re, double* out_im, int32_t in_stride, int32_t out_stride, int32_t how_many) {
    Scratch<Complex> work(Count(r));
    if (!work) return kOutOfMemory;
    const ptrdiff_t step = ptrdiff_t{in_stride} * how_many;
    const ptrdiff_t block = ptrdiff_t{r} * out_stride;
    for (int32_t i = 0; i < how_many; ++i) {
        if (const int32_t status =
                RaderComplex(r, in_re, in_im, out_re, out_im, tables, step, out_stride, work.data())) {
            return status;
        }
        in_re += in_stride;
        in_im += in_stride;
        out_re += block;
        out_im += block;
    }
    return kOk;
}

int32_t RaderRealStage(int32_t r, const stage_tables& tables, double* data, int32_t stride, int32_t m) {
    Scratch<Complex> work(2 * Count(r));
    if (!work) return kOutOfMemory;
    const RaderKernel kernel{r, tables, work.data() + r, work.data()};
    return CombineReal(kernel, work.data(), data, {tables.twiddleRe, tables.twiddleIm}, stride, m);
}

int32_t RaderComplexStage(int32_t r, const stage_tables& tables, double* re, double* im, int32_t stride, int32_t m) {
    Scratch<Complex> work(2 * Count(r));
    if (!work) return kOutOfMemory;
    const RaderKernel kernel{r, tables, work.data() + r, work.data()};
    return CombineComplex(kernel, work.data(), re, im, {tables.twiddleRe, tables.twiddleIm}, stride, m);
}

}  // namespace krnumer
