// Tables of the Fourier transform: how a length is factored, which butterflies run it, and its trigonometric values.
#pragma once

#include <cstddef>
#include <cstdint>
#include <type_traits>

#include "fft/fft.h"
#include "fft/vector_kernels.h"
#include "frame/complex.h"

namespace krnumer {

// A signed 32-bit length never needs more.
inline constexpr int kMaxFactors = 20;

// How a factor is executed.
enum FactorKind : int32_t {
    kButterfly = 0,  // generated straight-line code
    kDirect = 1,     // the symmetric sum of a prime below 50
    kRader = 2,      // convolution, for primes of 50 and above
};

// r real samples at in[i in_stride + j in_stride how_many] give their half-complex form at out[(i r + q) out_stride],
// for each i below how_many.
using RealLeaf = void (*)(const double* in, double* out, int32_t in_stride, int32_t out_stride, int32_t how_many);
// Combines r consecutive half-complex blocks of length m into one of length r m, in place.
using RealStage = void (*)(double* data, const double* twiddle_re, const double* twiddle_im, int32_t stride, int32_t m);
// The same on complex data.
using ComplexLeaf = void (*)(const double* in_re, const double* in_im, double* out_re, double* out_im,
                             int32_t in_stride, int32_t out_stride, int32_t how_many);
using ComplexStage = void (*)(double* re, double* im, const double* twiddle_re, const double* twiddle_im,
                              int32_t stride, int32_t m);

// The four butterflies of one radix.
struct Butterflies {
    RealLeaf real_leaf;
    RealStage real_stage;
    ComplexLeaf complex_leaf;
    ComplexStage complex_stage;
    // What real_stage does with rows k >= 1 to before `end`, and with their partners, at stride 1.
    void (*real_rows)(double* data, const double* twiddle_re, const double* twiddle_im, int32_t m, int32_t k,
                      int32_t end);
};

// The butterflies of a radix, null where it has none.
const Butterflies* ButterfliesOf(int32_t radix);

// Tables of one factor; those that its kind and place do not call for are null.
struct stage_tables {
    double* dftCos;           // kDirect: cos(2 pi k / r)
    double* dftSin;           // kDirect: -sin(2 pi k / r)
    double* twiddleRe;        // all factors but the last: m-1 rows, k = 1 .. m-1, of r-1 columns, j = 1 .. r-1
    double* twiddleIm;        // of exp(-2 pi i j k / (r m))
    qmfft_table* raderTable;  // kRader: the table of length r-1
    double* raderRe;          // kRader: spectrum of the convolution kernel, r-1 values
    double* raderIm;
    int32_t* raderIn;       // kRader: order in which samples are read, r entries
    int32_t* raderOut;      // kRader: order in which they are written, r entries
    double* packedComplex;  // twiddles in the order of the vector kernels; null where there are none
    double* packedReal;
};

// How the factors are gone through on adjacent elements: the first `depth` of them leave sub-sequences, which are
// transformed some at a time, and their own stages follow.
struct VectorPlan {
    int32_t depth;
    int32_t sequences;  // how many sub-sequences there are; 0 in an empty plan
    int32_t length;     // of each
    int32_t together;   // how many are transformed at a time
    bool tiled;         // whether the stages are run in tiles
    bool far;           // whether so because the data come from memory
    ptrdiff_t* places;  // where the results of the sub-sequences begin, in the order of their first samples
};

}  // namespace krnumer

// The table of one length. Immutable while it is linked, but for its count and its links.
struct qmfft_table {
    int32_t length;
    uint32_t refCount;
    int32_t factors[krnumer::kMaxFactors];  // ascending
    int32_t kinds[krnumer::kMaxFactors];
    int32_t factorCount;  // 0 for length 1
    krnumer::stage_tables* stages[krnumer::kMaxFactors];
    krnumer::RealLeaf realLeaf[krnumer::kMaxFactors];
    krnumer::RealStage realStage[krnumer::kMaxFactors];
    krnumer::ComplexLeaf cplxLeaf[krnumer::kMaxFactors];
    krnumer::ComplexStage cplxStage[krnumer::kMaxFactors];
    qmfft_table* prev;
    qmfft_table* next;
    const krnumer::VectorButterflies* vectors[krnumer::kMaxFactors];  // null where there are none
    krnumer::VectorPlan complexPlan;
    krnumer::VectorPlan realPlan;
};

namespace krnumer {

// The plan for elements T, Complex or double.
template <class T>
const VectorPlan& PlanOf(const qmfft_table* table) {
    if constexpr (std::is_same_v<T, Complex>) return table->complexPlan;
    if constexpr (std::is_same_v<T, double>) return table->realPlan;
}

template <class T>
bool RunsInTiles(const qmfft_table* table, int32_t i) {
    return PlanOf<T>(table).tiled && i < PlanOf<T>(table).depth;
}

// Steps of creation and release that expect the table lock to be held. BuildTable finds or makes a held table; null
// for a length below 1 or without memory, and then nothing is left behind.
qmfft_table* BuildTable(int32_t length);
void ReleaseTable(qmfft_table* table);

// Writes exp(-i j k delta), rows k = 1 .. `rows` of columns j = 1 .. `columns`, by the recurrence of the twiddles: one
// sine each for the angle of a column and its half, then two products and two sums a value.
// Source: R. C. Singleton, IEEE Trans. Audio Electroacoust. 17, 1969.
void FillRotations(double delta, double* re, double* im, int32_t rows, int32_t columns);

}  // namespace krnumer
