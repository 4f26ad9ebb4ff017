#include "fft/rader.h"

#include <cstddef>
#include <type_traits>

#include "fft/half_complex.h"
#include "fft/stage.h"
#include "fft/vector_transform.h"
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

// A value of the convolution's spectrum, which is the conjugate of the samples' times the kernel's, so that one more
// forward transform gives the conjugate of the inverse one.
Complex ConjugateProduct(Complex z, Complex w) {
    return {z.re * w.re - z.im * w.im, z.re * -w.im - z.im * w.re};
}

template <class Values>
void MultiplyByKernel(const stage_tables& tables, const Values& values, int32_t count) {
    for (int32_t k = 0; k < count; ++k) {
        const Complex z = values.Get(k);
        const Complex w{tables.raderRe[k], tables.raderIm[k]};
        values.Put(k, ConjugateProduct(z, w));
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

// Transforms of neighbouring sequences run side by side as long as their work stays in the caches: what each value of
// one waits for is done for several.
constexpr int32_t kMostLanes = 8;
constexpr int32_t kLongestLane = 1024;

// Vectors should not straddle cache lines.
constexpr size_t kLine = 64 / sizeof(Complex);

Complex* NextLine(Complex* work) {
    const size_t behind = reinterpret_cast<uintptr_t>(work) / sizeof(Complex) % kLine;
    return work + (kLine - behind) % kLine;
}

bool RunsInLanes(int32_t r, const stage_tables& tables) {
    const VectorPlan& plan = tables.raderTable->complexPlan;
    return r <= kLongestLane && plan.sequences > 0 && !plan.tiled;
}

// `lanes` sequences l of r complex samples in(k, l); out(k, l, value) takes the results. `work` holds 2 lanes (r - 1)
// values.
template <int32_t lanes, class In, class Out>
int32_t TransformLanesByRader(int32_t r, const In& in, const Out& out, const stage_tables& tables, Complex* work) {
    const int32_t count = r - 1;
    Complex* const side_by_side = work;
    Complex* const one_by_one = work + ptrdiff_t{lanes} * count;
    ptrdiff_t places[lanes];
    Complex first[lanes], total[lanes];
    for (int32_t l = 0; l < lanes; ++l) {
        places[l] = ptrdiff_t{l} * count;
        first[l] = total[l] = in(0, l);
    }
    const auto transform = [&] {
        return VectorComplexFFTs(tables.raderTable, side_by_side, lanes, one_by_one, places, lanes);
    };
    for (int32_t k = 0; k < count; ++k) {
        Complex* const row = side_by_side + ptrdiff_t{k} * lanes;
        for (int32_t l = 0; l < lanes; ++l) row[l] = in(tables.raderIn[k + 1], l);
        const double* values = &row->re;  // as doubles, for vectors
        double* sums = &total->re;
        for (int32_t i = 0; i < 2 * lanes; ++i) sums[i] += values[i];
    }
    for (int32_t l = 0; l < lanes; ++l) out(0, l, total[l]);
    if (const int32_t status = transform()) return status;
    for (int32_t k = 0; k < count; ++k) {
        const Complex w{tables.raderRe[k], tables.raderIm[k]};
        Complex* const row = side_by_side + ptrdiff_t{k} * lanes;
        for (int32_t l = 0; l < lanes; ++l) row[l] = ConjugateProduct(one_by_one[places[l] + k], w);
    }
    if (const int32_t status = transform()) return status;
    for (int32_t l = 0; l < lanes; ++l) {
        const Complex* const result = one_by_one + places[l];
        for (int32_t k = 0; k < count; ++k)
            out(tables.raderOut[k + 1], l, {first[l].re + result[k].re, first[l].im - result[k].im});
    }
    return kOk;
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
    const ptrdiff_t step = ptrdiff_t{in_stride} * how_many;
    const ptrdiff_t block = ptrdiff_t{r} * out_stride;
    const bool lanes = how_many > 1 && in_im == in_re + 1 && out_im == out_re + 1 && RunsInLanes(r, tables);
    Scratch<Complex> work(lanes ? 2 * kMostLanes * Count(r) + kLine : Count(r));
    if (!work) return kOutOfMemory;
    int32_t i = 0;
    const auto run_lanes = [&]<int32_t count>(std::integral_constant<int32_t, count>) {
        for (; how_many - i >= count; i += count) {
            const auto in = [from = in_re + ptrdiff_t{i} * in_stride, in_stride, step](ptrdiff_t k, ptrdiff_t l) {
                return *reinterpret_cast<const Complex*>(from + l * in_stride + k * step);
            };
            const auto out = [to = out_re + i * block, block, out_stride](ptrdiff_t k, ptrdiff_t l, Complex value) {
                *reinterpret_cast<Complex*>(to + l * block + k * out_stride) = value;
            };
            if (const int32_t status = TransformLanesByRader<count>(r, in, out, tables, NextLine(work.data())))
                return status;
        }
        return kOk;
    };
    if (lanes) {
        if (const int32_t status = run_lanes(std::integral_constant<int32_t, kMostLanes>())) return status;
        if (const int32_t status = run_lanes(std::integral_constant<int32_t, kMostLanes / 2>())) return status;
        if (const int32_t status = run_lanes(std::integral_constant<int32_t, kMostLanes / 4>())) return status;
    }
    for (; i < how_many; ++i) {
        const ptrdiff_t from = ptrdiff_t{i} * in_stride;
        const ptrdiff_t to = i * block;
        if (const int32_t status = RaderComplex(r, in_re + from, in_im + from, out_re + to, out_im + to, tables, step,
                                                out_stride, work.data())) {
            return status;
        }
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
