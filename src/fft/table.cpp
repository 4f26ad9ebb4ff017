#include "fft/table.h"

#include <cmath>
#include <cstddef>
#include <cstdlib>
#include <limits>
#include <mutex>
#include <type_traits>

#include "fft/rader.h"
#include "fft/vector_transform.h"
#include "frame/memory.h"
#include "frame/numeric.h"

namespace krnumer {
namespace {

static_assert(std::is_standard_layout_v<qmfft_table> && offsetof(qmfft_table, factorCount) == 168);
static_assert(sizeof(void*) != 8 || offsetof(qmfft_table, stages) == 176);

constexpr double kTwoPi = 6.283185307179586;

std::mutex table_lock;
qmfft_table* table_list = nullptr;

// ---- Factors ----

// In the order of preference; 10 before everything, composites before their primes.
constexpr int32_t kRadices[] = {10, 43, 41, 37, 32, 31, 29, 19, 18, 17, 16, 14, 13, 11, 9, 8, 7, 5, 4, 3, 2};

// The primes that have a butterfly.
constexpr int32_t kGoodPrimes[] = {43, 41, 37, 31, 29, 19, 17, 13, 11, 7, 5, 3, 2};

constexpr int32_t kLeastRaderPrime = 50;

FactorKind KindOfPrime(int32_t prime) {
    return prime < kLeastRaderPrime ? kDirect : kRader;
}

void AppendFactor(qmfft_table* table, int32_t factor, FactorKind kind) {
    table->factors[table->factorCount] = factor;
    table->kinds[table->factorCount] = kind;
    ++table->factorCount;
}

// The leaf takes the largest factor, since it runs without twiddles.
void SortFactors(qmfft_table* table) {
    for (int32_t i = 0; i < table->factorCount; ++i) {
        for (int32_t j = i + 1; j < table->factorCount; ++j) {
            if (table->factors[i] <= table->factors[j]) continue;
            std::swap(table->factors[i], table->factors[j]);
            std::swap(table->kinds[i], table->kinds[j]);
        }
    }
}

void FactorLength(qmfft_table* table) {
    int32_t rest = table->length;
    for (int32_t radix : kRadices) {
        for (; rest % radix == 0 && rest > 1; rest /= radix) AppendFactor(table, radix, kButterfly);
    }
    for (int32_t f = 3; int64_t{f} * f <= rest; f += 2) {
        for (; rest % f == 0; rest /= f) AppendFactor(table, f, KindOfPrime(f));
    }
    if (rest > 1) AppendFactor(table, rest, KindOfPrime(rest));
    SortFactors(table);
}

void BindButterflies(qmfft_table* table) {
    for (int32_t i = 0; i < table->factorCount; ++i) {
        if (table->kinds[i] != kButterfly) continue;
        const Butterflies* butterflies = ButterfliesOf(table->factors[i]);
        table->realLeaf[i] = butterflies->real_leaf;
        table->realStage[i] = butterflies->real_stage;
        table->cplxLeaf[i] = butterflies->complex_leaf;
        table->cplxStage[i] = butterflies->complex_stage;
        table->vectors[i] = VectorButterfliesOf(table->factors[i]);
    }
}

// ---- Stage tables ----

template <class T>
bool Allocate(T** pointer, size_t count) {
    if (count > PTRDIFF_MAX / sizeof(T)) return false;
    *pointer = static_cast<T*>(AllocateMemory(count * sizeof(T)));
    return *pointer != nullptr;
}

bool BuildTwiddles(stage_tables* stage, int32_t radix, int32_t m) {
    const size_t count = Count(m - 1) * Count(radix - 1);
    if (!Allocate(&stage->twiddleRe, count) || !Allocate(&stage->twiddleIm, count)) return false;
    FillRotations(kTwoPi / (static_cast<double>(radix) * m), stage->twiddleRe, stage->twiddleIm, m - 1, radix - 1);
    return true;
}

bool PackTwiddles(const qmfft_table* table, int32_t i, int32_t m) {
    stage_tables* stage = table->stages[i];
    if (!Allocate(&stage->packedComplex, CountStageTwiddles<Complex>(table, i, m)) ||
        !Allocate(&stage->packedReal, CountStageTwiddles<double>(table, i, m))) {
        return false;
    }
    PackStageTwiddles<Complex>(table, i, m, stage->packedComplex);
    PackStageTwiddles<double>(table, i, m, stage->packedReal);
    return true;
}

bool BuildDirect(stage_tables* stage, int32_t radix) {
    if (!Allocate(&stage->dftCos, Count(radix)) || !Allocate(&stage->dftSin, Count(radix))) return false;
    stage->dftCos[0] = 1.0;
    stage->dftSin[0] = 0.0;
    FillRotations(kTwoPi / radix, stage->dftCos + 1, stage->dftSin + 1, radix - 1, 1);
    return true;
}

bool BuildRader(stage_tables* stage, int32_t radix) {
    if (!Allocate(&stage->raderRe, Count(radix - 1)) || !Allocate(&stage->raderIm, Count(radix - 1)) ||
        !Allocate(&stage->raderIn, Count(radix)) || !Allocate(&stage->raderOut, Count(radix))) {
        return false;
    }
    stage->raderTable = BuildTable(radix - 1);
    return stage->raderTable != nullptr && FillRaderTables(stage, radix);
}

bool BuildStages(qmfft_table* table) {
    for (int32_t i = 0; i < table->factorCount; ++i) {
        table->stages[i] = static_cast<stage_tables*>(std::calloc(1, sizeof(stage_tables)));
        if (table->stages[i] == nullptr) return false;
    }
    if (!MakePlan<Complex>(table, &table->complexPlan) || !MakePlan<double>(table, &table->realPlan)) return false;
    int32_t m = table->length;
    for (int32_t i = 0; i < table->factorCount - 1; ++i) {
        m /= table->factors[i];
        if (!BuildTwiddles(table->stages[i], table->factors[i], m)) return false;
        if (table->vectors[i] != nullptr && !PackTwiddles(table, i, m)) return false;
    }
    for (int32_t i = 0; i < table->factorCount; ++i) {
        if (table->kinds[i] == kDirect && !BuildDirect(table->stages[i], table->factors[i])) return false;
    }
    for (int32_t i = 0; i < table->factorCount; ++i) {
        if (table->kinds[i] == kRader && !BuildRader(table->stages[i], table->factors[i])) return false;
    }
    return true;
}

// Also of a table that is half built: what was not made is null.
void FreeStages(qmfft_table* table) {
    for (int32_t i = 0; i < table->factorCount; ++i) {
        stage_tables* stage = table->stages[i];
        if (stage == nullptr) continue;
        ReleaseTable(stage->raderTable);
        for (double* values : {stage->dftCos, stage->dftSin, stage->twiddleRe, stage->twiddleIm, stage->raderRe,
                               stage->raderIm, stage->packedComplex, stage->packedReal}) {
            std::free(values);
        }
        std::free(stage->raderIn);
        std::free(stage->raderOut);
        std::free(stage);
    }
    std::free(table->complexPlan.places);
    std::free(table->realPlan.places);
}

// ---- List ----

qmfft_table* FindTable(int32_t length) {
    for (qmfft_table* table = table_list; table != nullptr; table = table->next) {
        if (table->length != length) continue;
        ++table->refCount;
        return table;
    }
    return nullptr;
}

void LinkTable(qmfft_table* table) {
    table->prev = nullptr;
    table->next = table_list;
    if (table_list != nullptr) table_list->prev = table;
    table_list = table;
    table->refCount = 1;
}

void UnlinkTable(qmfft_table* table) {
    (table->prev != nullptr ? table->prev->next : table_list) = table->next;
    if (table->next != nullptr) table->next->prev = table->prev;
}

// Columns `first` to before first + N of FillRotations. Each value of a column waits for the one above; columns side by
// side wait together.
template <int N>
void FillColumns(double delta, int32_t first, double* re, double* im, int32_t rows, int32_t columns) {
    double t[N], c[N], x[N], y[N];
    for (int j = 0; j < N; ++j) {
        const double theta = (first + j + 1) * delta;
        const double half_sine = std::sin(theta / 2);
        t[j] = -std::sin(theta);
        c[j] = 2 * half_sine * half_sine;
        x[j] = 1 - c[j];
        y[j] = t[j];
    }
    re += first;
    im += first;
    for (int32_t k = 0; k < rows; ++k, re += columns, im += columns) {
        for (int j = 0; j < N; ++j) {
            re[j] = x[j];
            im[j] = y[j];
        }
        for (int j = 0; j < N; ++j) {
            const double next = x[j] - (t[j] * y[j] + c[j] * x[j]);
            y[j] -= c[j] * y[j] - t[j] * x[j];
            x[j] = next;
        }
    }
}

}  // namespace

void FillRotations(double delta, double* re, double* im, int32_t rows, int32_t columns) {
    int32_t first = 0;
    const auto fill = [&]<int N>(std::integral_constant<int, N>) {
        for (; columns - first >= N; first += N) FillColumns<N>(delta, first, re, im, rows, columns);
    };
    fill(std::integral_constant<int, 8>());
    fill(std::integral_constant<int, 4>());
    fill(std::integral_constant<int, 2>());
    fill(std::integral_constant<int, 1>());
}

// Linking comes last, so that nobody finds a table that is still being built.
qmfft_table* BuildTable(int32_t length) {
    if (length < 1) return nullptr;
    if (qmfft_table* found = FindTable(length)) return found;
    auto* table = static_cast<qmfft_table*>(std::calloc(1, sizeof(qmfft_table)));
    if (table == nullptr) return nullptr;
    table->length = length;
    FactorLength(table);
    BindButterflies(table);
    if (!BuildStages(table)) {
        FreeStages(table);
        std::free(table);
        return nullptr;
    }
    LinkTable(table);
    return table;
}

void ReleaseTable(qmfft_table* table) {
    if (table == nullptr || --table->refCount > 0) return;
    UnlinkTable(table);
    FreeStages(table);
    std::free(table);
}

qmfft_table* CreateTable(int32_t length) {
    const std::lock_guard lock(table_lock);
    return BuildTable(length);
}

void DestroyTable(qmfft_table* table) {
    const std::lock_guard lock(table_lock);
    ReleaseTable(table);
}

int32_t NextGoodLength(int32_t length) {
    for (int32_t candidate = length < 2 ? 1 : length;; ++candidate) {
        int32_t rest = candidate;
        for (int32_t prime : kGoodPrimes)
            while (rest % prime == 0) rest /= prime;
        if (rest == 1) return candidate;
        if (candidate == std::numeric_limits<int32_t>::max()) return 0;
    }
}

}  // namespace krnumer
