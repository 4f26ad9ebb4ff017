#include "fft/vector_transform.h"

#include <algorithm>
#include <cstdlib>
#include <type_traits>

#include "fft/factor.h"
#include "fft/vector_tiles.h"
#include "fft/vector_twiddles.h"
#include "frame/complex.h"
#include "frame/numeric.h"
#include "frame/status.h"
#include "hwy/cache_control.h"

namespace krnumer {
namespace {

// Columns that are taken together: a cache line of neighbouring samples at least, so that lines are used whole however
// far apart the samples of one column are.
template <class T>
constexpr int32_t kGroup = 64 / sizeof(T);

// Data up to this size stay in the second-level cache between the passes, and no pass needs to be cut into blocks.
constexpr size_t kCachedBytes = 512 * 1024;

void RunColumns(const qmfft_table* table, int32_t i, const Complex* in, ptrdiff_t step, Complex* out,
                const ptrdiff_t* places, int32_t lanes) {
    table->vectors[i]->complex.columns(in, step, out, places, lanes);
}

void RunColumns(const qmfft_table* table, int32_t i, const double* in, ptrdiff_t step, double* out,
                const ptrdiff_t* places, int32_t lanes) {
    int32_t l = table->vectors[i]->real.columns(in, step, out, places, lanes);
    for (; l < lanes; ++l) table->realLeaf[i](in + l, out + places[l], static_cast<int32_t>(step), 1, 1);
}

int32_t RunStage(const qmfft_table* table, int32_t i, Complex* data, int32_t m) {
    return RunComplexStage(table, i, &data->re, &data->im, 2, m);
}

int32_t RunStage(const qmfft_table* table, int32_t i, double* data, int32_t m) {
    return RunRealStage(table, i, data, 1, m);
}

// Fetches samples that are far apart before they are read.
template <class T>
void PrefetchLanes(const T* in, ptrdiff_t step, int32_t count, int32_t lanes) {
    for (int32_t j = 0; j < count; ++j, in += step)
        for (int32_t l = 0; l < lanes; l += kGroup<T>) hwy::Prefetch(in + l);
}

// The factors from i on, of `lanes` neighbouring sub-sequences of length n; their samples are `step` apart.
template <class T>
int32_t TransformLanes(const qmfft_table* table, int32_t i, int32_t n, const T* in, ptrdiff_t step, T* out,
                       const ptrdiff_t* places, int32_t lanes) {
    const int32_t r = table->factors[i];
    if (i == table->factorCount - 1) {
        RunColumns(table, i, in, step, out, places, lanes);
        return kOk;
    }
    const int32_t m = n / r;
    const bool far_apart = i == table->factorCount - 2 && PlanOf<T>(table).tiled;
    for (int32_t b = 0; b < r; ++b) {
        if (far_apart && b + 1 < r) PrefetchLanes(in + (b + 1) * step, r * step, m, lanes);
        if (const int32_t status =
                TransformLanes(table, i + 1, m, in + b * step, r * step, out + ptrdiff_t{b} * m, places, lanes)) {
            return status;
        }
    }
    for (int32_t l = 0; l < lanes; ++l)
        if (const int32_t status = RunStage(table, i, out + places[l], m)) return status;
    return kOk;
}

// The stages behind the plan's sub-sequences go through all data one after the other, or in tiles.
template <class T>
int32_t Transform(const qmfft_table* table, const VectorPlan& plan, const T* in, T* out) {
    if (plan.depth == 0) {
        RunColumns(table, 0, in, 1, out, plan.places, 1);
        return kOk;
    }
    for (int32_t start = 0; start < plan.sequences; start += plan.together) {
        const int32_t lanes = std::min(plan.together, plan.sequences - start);
        if (const int32_t status = TransformLanes(table, plan.depth, plan.length, in + start, plan.sequences, out,
                                                  plan.places + start, lanes)) {
            return status;
        }
    }
    if (plan.tiled) {
        CombineInTiles(table, out);
        return kOk;
    }
    int32_t length = plan.length;
    for (int32_t i = plan.depth; i-- > 0;) {
        const int32_t m = length;
        length *= table->factors[i];
        for (int32_t start = 0; start < table->length; start += length)
            if (const int32_t status = RunStage(table, i, out + start, m)) return status;
    }
    return kOk;
}

// The rows that a stage of blocks of length m takes, as the kernels take them: those of a real stage bring the rest
// with them, and row 0 takes no twiddles.
template <class T>
constexpr int32_t kFirstRow = std::is_same_v<T, Complex> ? 0 : 1;

template <class T>
int32_t LastRow(int32_t m) {
    return std::is_same_v<T, Complex> ? m - 1 : m / 2;
}

}  // namespace

template <class T>
bool MakePlan(const qmfft_table* table, VectorPlan* plan) {
    const int32_t last = table->factorCount - 1;
    if (last < 0 || table->vectors[last] == nullptr) return true;
    const bool cached = Count(table->length) * sizeof(T) <= kCachedBytes;
    const int32_t tiled = cached ? 0 : CountTiledFactors<T>(table);
    plan->tiled = tiled > 0;
    plan->length = table->length;
    plan->sequences = 1;
    while (plan->depth < last && (tiled > 0 ? plan->depth < tiled : cached || plan->sequences < kGroup<T>)) {
        plan->sequences *= table->factors[plan->depth];
        plan->length /= table->factors[plan->depth++];
    }
    plan->together = tiled > 0 ? LanesBeforeTiles<T>(plan->length) : cached ? plan->sequences : kGroup<T>;

    plan->places = static_cast<ptrdiff_t*>(std::malloc(Count(plan->sequences) * sizeof(ptrdiff_t)));
    if (plan->places == nullptr) return false;
    plan->places[0] = 0;
    ptrdiff_t known = 1;
    ptrdiff_t block = table->length;
    for (int32_t i = 0; i < plan->depth; ++i) {
        block /= table->factors[i];
        for (ptrdiff_t b = 1; b < table->factors[i]; ++b)
            for (ptrdiff_t s = 0; s < known; ++s) plan->places[b * known + s] = b * block + plan->places[s];
        known *= table->factors[i];
    }
    return true;
}

int32_t VectorComplexFFT(const qmfft_table* table, const double* in, double* out) {
    return Transform(table, table->complexPlan, reinterpret_cast<const Complex*>(in), reinterpret_cast<Complex*>(out));
}

int32_t VectorRealFFT(const qmfft_table* table, const double* in, double* out) {
    return Transform(table, table->realPlan, in, out);
}

template <class T>
size_t CountStageTwiddles(const qmfft_table* table, int32_t i, int32_t m) {
    if (RunsInTiles<T>(table, i)) return PackedCountInTiles<T>(table, i);
    return PackedCount<T>(LastRow<T>(m) + 1 - kFirstRow<T>, table->factors[i]);
}

template <class T>
void PackStageTwiddles(const qmfft_table* table, int32_t i, int32_t m, double* packed) {
    if (RunsInTiles<T>(table, i)) {
        PackTwiddlesInTiles<T>(table, i, packed);
    } else {
        const auto row = [](int32_t k) { return k; };
        PackTwiddles<T>(*table->stages[i], table->factors[i], kFirstRow<T>, LastRow<T>(m) + 1, row, packed);
    }
}

template bool MakePlan<Complex>(const qmfft_table*, VectorPlan*);
template bool MakePlan<double>(const qmfft_table*, VectorPlan*);
template size_t CountStageTwiddles<Complex>(const qmfft_table*, int32_t, int32_t);
template size_t CountStageTwiddles<double>(const qmfft_table*, int32_t, int32_t);
template void PackStageTwiddles<Complex>(const qmfft_table*, int32_t, int32_t, double*);
template void PackStageTwiddles<double>(const qmfft_table*, int32_t, int32_t, double*);

}  // namespace krnumer
