#include "fft/factor.h"

#include "fft/direct.h"
#include "fft/rader.h"
#include "frame/complex.h"
#include "frame/status.h"

namespace krnumer {

// The vector kernels of stages want adjacent elements, and twiddles that are packed row after row; those of stages that
// run in tiles are in another order.

int32_t RunRealLeaf(const qmfft_table* table, int32_t i, const double* in, double* out, int32_t in_stride,
                    int32_t out_stride, int32_t how_many) {
    const int32_t r = table->factors[i];
    switch (table->kinds[i]) {
        case kButterfly:
            table->realLeaf[i](in, out, in_stride, out_stride, how_many);
            return kOk;
        case kDirect:
            return DirectRealLeaf(r, *table->stages[i], in, out, in_stride, out_stride, how_many);
        default:
            return RaderRealLeaf(r, *table->stages[i], in, out, in_stride, out_stride, how_many);
    }
}

int32_t RunRealStage(const qmfft_table* table, int32_t i, double* data, int32_t stride, int32_t m) {
    const int32_t r = table->factors[i];
    const stage_tables& stage = *table->stages[i];
    switch (table->kinds[i]) {
        case kButterfly:
            if (stride == 1 && table->vectors[i] != nullptr && !RunsInTiles<double>(table, i)) {
                table->realLeaf[i](data, data, m, m, 1);  // row 0
                const int32_t k = table->vectors[i]->real.stage(data, stage.packedReal, m);
                if (2 * k <= m) ButterfliesOf(r)->real_rows(data, stage.twiddleRe, stage.twiddleIm, m, k, m);
            } else {
                table->realStage[i](data, stage.twiddleRe, stage.twiddleIm, stride, m);
            }
            return kOk;
        case kDirect:
            return DirectRealStage(r, stage, data, stride, m);
        default:
            return RaderRealStage(r, stage, data, stride, m);
    }
}

int32_t RunComplexLeaf(const qmfft_table* table, int32_t i, const double* in_re, const double* in_im, double* out_re,
                       double* out_im, int32_t in_stride, int32_t out_stride, int32_t how_many) {
    const int32_t r = table->factors[i];
    switch (table->kinds[i]) {
        case kButterfly:
            table->cplxLeaf[i](in_re, in_im, out_re, out_im, in_stride, out_stride, how_many);
            return kOk;
        case kDirect:
            return DirectComplexLeaf(r, *table->stages[i], in_re, in_im, out_re, out_im, in_stride, out_stride,
                                     how_many);
        default:
            return RaderComplexLeaf(r, *table->stages[i], in_re, in_im, out_re, out_im, in_stride, out_stride,
                                    how_many);
    }
}

int32_t RunComplexStage(const qmfft_table* table, int32_t i, double* re, double* im, int32_t stride, int32_t m) {
    const int32_t r = table->factors[i];
    const stage_tables& stage = *table->stages[i];
    switch (table->kinds[i]) {
        case kButterfly:
            if (im == re + 1 && stride == 2 && table->vectors[i] != nullptr && !RunsInTiles<Complex>(table, i)) {
                table->vectors[i]->complex.stage(reinterpret_cast<Complex*>(re), m, stage.packedComplex, m, true);
            } else {
                table->cplxStage[i](re, im, stage.twiddleRe, stage.twiddleIm, stride, m);
            }
            return kOk;
        case kDirect:
            return DirectComplexStage(r, stage, re, im, stride, m);
        default:
            return RaderComplexStage(r, stage, re, im, stride, m);
    }
}

}  // namespace krnumer
