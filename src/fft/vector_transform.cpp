#include "fft/vector_transform.h"

#include <algorithm>
#include <cstdlib>
#include <type_traits>

#include "fft/factor.h"
#include "fft/inline.h"
#include "fft/vector_rows.h"
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

// ---- Sub-sequences of data from memory ----
//
// Their samples are fetched while others are transformed, and little at a time, or the processor waits for them.

// Where the samples of leaf q of a sub-sequence are.
template <class T>
const T* LeafSamples(const qmfft_table* table, const VectorPlan& plan, const T* in, int32_t q) {
    const int32_t last = table->factorCount - 1;
    ptrdiff_t step = table->length / table->factors[last];
    for (int32_t i = last; i-- > plan.depth; q /= table->factors[i]) {
        step /= table->factors[i];
        in += q % table->factors[i] * step;
    }
    return in;
}

// Fetches samples j of `lanes` sub-sequences, from j on to before `end`.
template <class T>
KRNUMER_FFT_INLINE void FetchSamples(const T* in, ptrdiff_t step, int32_t j, int32_t end, int32_t lanes) {
    for (; j < end; ++j)
        for (int32_t l = 0; l < lanes; l += kGroup<T>) FetchLine(in + j * step + l);
}

// Fetches where `lanes` sub-sequences put their next `count` values: a line is not written before it is there.
template <class T>
KRNUMER_FFT_INLINE void FetchPlaces(const T* out, const ptrdiff_t* places, int32_t lanes, int32_t count) {
    for (int32_t l = 0; l < lanes; ++l)
        for (int32_t k = 0; k < count; k += kGroup<T>) FetchLine(out + places[l] + k);
}

// The leaves of `lanes` neighbouring sub-sequences. Those of the `following` next ones come after them. Their places in
// `out` may be far, too.
template <class T>
void TransformFarLeaves(const qmfft_table* table, const VectorPlan& plan, const T* in, int32_t lanes, int32_t following,
                        T* out, const ptrdiff_t* places, bool far_places) {
    const int32_t last = table->factorCount - 1;
    const int32_t r = table->factors[last];
    const int32_t leaves = plan.length / r;
    const ptrdiff_t step = table->length / r;
    for (int32_t q = 0; q < leaves; ++q, out += r) {
        const bool ends = q == leaves - 1;
        const T* x = LeafSamples(table, plan, in, q);
        const T* next = ends ? in + lanes : LeafSamples(table, plan, in, q + 1);
        const int32_t fetched = ends ? following : lanes;
        for (int32_t l = 0; l < lanes; l += kGroup<T>) {
            const int32_t count = std::min(kGroup<T>, lanes - l);
            FetchSamples(next, step, r * l / lanes, r * (l + count) / lanes, fetched);
            if (far_places && !ends) FetchPlaces(out + r, places + l, count, r);
            RunColumns(table, last, x + l, step, out, places + l, count);
        }
    }
}

// The stages of a sub-sequence behind its leaves.
template <class T>
int32_t RunStagesOfLane(const qmfft_table* table, const VectorPlan& plan, T* lane) {
    int32_t m = table->factors[table->factorCount - 1];
    for (int32_t i = table->factorCount - 1; i-- > plan.depth; m *= table->factors[i])
        for (int32_t start = 0; start < plan.length; start += m * table->factors[i])
            if (const int32_t status = RunStage(table, i, lane + start, m)) return status;
    return kOk;
}

// Calls run(start, lanes, following) for the sub-sequences that are transformed together; stops at a status.
template <class Run>
int32_t ForEachGroup(const VectorPlan& plan, const Run& run) {
    for (int32_t start = 0; start < plan.sequences; start += plan.together) {
        const int32_t lanes = std::min(plan.together, plan.sequences - start);
        const int32_t following = std::min(plan.together, plan.sequences - start - lanes);
        if (const int32_t status = run(start, lanes, following)) return status;
    }
    return kOk;
}

template <class T>
int32_t TransformFarLanes(const qmfft_table* table, const VectorPlan& plan, const T* in, T* out) {
    return ForEachGroup(plan, [&](int32_t start, int32_t lanes, int32_t following) {
        const ptrdiff_t* places = plan.places + start;
        TransformFarLeaves(table, plan, in + start, lanes, following, out, places, true);
        for (int32_t l = 0; l < lanes; ++l)
            if (const int32_t status = RunStagesOfLane(table, plan, out + places[l])) return status;
        return kOk;
    });
}

// The same with the results on the stack and from there straight to memory, without what it held before.
KRNUMER_FFT_NOINLINE int32_t StreamFarLanes(const qmfft_table* table, const VectorPlan& plan, const Complex* in,
                                            Complex* out) {
    alignas(64) Complex results[(kTileDoubles + kPaddingDoubles) / 2];
    ptrdiff_t places[kMostLanes];
    for (int32_t l = 0; l < plan.together; ++l) places[l] = ptrdiff_t{l} * (plan.length + kGroup<Complex>);
    const int32_t status = ForEachGroup(plan, [&](int32_t start, int32_t lanes, int32_t following) {
        TransformFarLeaves(table, plan, in + start, lanes, following, results, places, false);
        for (int32_t l = 0; l < lanes; ++l) {
            Complex* const lane = results + places[l];
            if (const int32_t failure = RunStagesOfLane(table, plan, lane)) return failure;
            StreamRows(&lane->re, 0, &out[plan.places[start + l]].re, 0, 1, 2 * plan.length);
        }
        return kOk;
    });
    FlushStreams();
    return status;
}

int32_t TransformFar(const qmfft_table* table, const VectorPlan& plan, const Complex* in, Complex* out) {
    const bool whole_lines = IsLine(out) && plan.length % kGroup<Complex> == 0;
    return whole_lines ? StreamFarLanes(table, plan, in, out) : TransformFarLanes(table, plan, in, out);
}

int32_t TransformFar(const qmfft_table* table, const VectorPlan& plan, const double* in, double* out) {
    return TransformFarLanes(table, plan, in, out);
}

// The stages behind the plan's sub-sequences go through all data one after the other, or in tiles.
template <class T>
int32_t Transform(const qmfft_table* table, const VectorPlan& plan, const T* in, T* out) {
    if (plan.depth == 0) {
        RunColumns(table, 0, in, 1, out, plan.places, 1);
        return kOk;
    }
    if (plan.far) {
        if (const int32_t status = TransformFar(table, plan, in, out)) return status;
        CombineInTiles(table, out);
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
    const bool cached = AreCached<T>(table);  // no pass needs to be cut into blocks then
    const int32_t tiled = CountTiledFactors<T>(table);
    plan->tiled = tiled > 0;
    plan->far = plan->tiled && AreFar<T>(table);
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

int32_t VectorComplexFFTs(const qmfft_table* table, const Complex* in, ptrdiff_t step, Complex* out,
                          const ptrdiff_t* places, int32_t lanes) {
    return TransformLanes(table, 0, table->length, in, step, out, places, lanes);
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
