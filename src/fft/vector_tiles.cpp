#include "fft/vector_tiles.h"

#include <algorithm>
#include <type_traits>

#include "fft/inline.h"
#include "fft/vector_twiddles.h"
#include "frame/complex.h"
#include "frame/numeric.h"
#include "hwy/cache_control.h"

namespace krnumer {
namespace {

// Larger data are worth copying to tiles whatever the distance of their rows; smaller data only if it is a multiple of a
// page, so that all rows compete for the same few places in the caches.
constexpr size_t kLargeBytes = 8 * 1024 * 1024;
constexpr size_t kPage = 4096;

// Sub-sequences up to this length are left to the factors behind those in tiles.
constexpr int32_t kLongestSubsequence = 2048;

// A tile, which lies on the stack, and what may be lost between its rows.
constexpr int32_t kTileDoubles = 32 * 1024;
constexpr int32_t kPaddingDoubles = 2 * 1024;

// With more rows, the parts of them that a tile holds would be shorter than 256 bytes, and the memory poorly used.
template <class T>
constexpr int32_t kMostRows = kTileDoubles / (2 * 256 / static_cast<int32_t>(sizeof(T)));

// Rows at multiples of 2 KiB would share few places in the first-level cache. Distances count doubles.
constexpr ptrdiff_t Spread(ptrdiff_t distance) {
    return distance % 256 == 0 ? distance + 8 : distance;
}

// A pass over the data: the stages of the factors from `first` to before `end`, on blocks of rows m elements long. In a
// tile, a row holds `width` complex numbers; or as many doubles of columns k and then as many of columns m - k.
struct Pass {
    int32_t first, end;
    int32_t rows, m;
    int32_t columns;  // that are done in tiles
    int32_t width;
    ptrdiff_t step[kMaxFactors];  // distance in a tile of the blocks that a factor combines, in doubles
};

template <class T>
constexpr bool kIsReal = std::is_same_v<T, double>;

// Places the rows of a tile. Returns the doubles that it takes.
ptrdiff_t PlaceRows(const qmfft_table* table, Pass& pass) {
    ptrdiff_t distance = Spread(2 * ptrdiff_t{pass.width});
    for (int32_t i = pass.end; i-- > pass.first; distance = Spread(distance * table->factors[i]))
        pass.step[i] = distance;
    return distance;
}

// The pass that ends before factor `end`; the factors from there on make m.
template <class T>
Pass MakePass(const qmfft_table* table, int32_t end, int32_t m) {
    Pass pass{end - 1, end, table->factors[end - 1], m, m, 0, {}};
    while (pass.first > 0 && pass.rows * table->factors[pass.first - 1] <= kMostRows<T>)
        pass.rows *= table->factors[--pass.first];
    const int32_t lanes = VectorLanes();
    if constexpr (kIsReal<T>) pass.columns = (m - 1) / 2 / lanes * lanes;
    pass.width = std::min(kTileDoubles / (2 * pass.rows), pass.columns + lanes - 1) / lanes * lanes;
    while (PlaceRows(table, pass) > kTileDoubles + kPaddingDoubles) pass.width -= lanes;
    return pass;
}

// The passes of a table, in the order in which they run: run(pass).
template <class T, class Run>
void ForEachPass(const qmfft_table* table, Run run) {
    const VectorPlan& plan = PlanOf<T>(table);
    int32_t m = plan.length;
    for (int32_t end = plan.depth; end > 0;) {
        const Pass pass = MakePass<T>(table, end, m);
        run(pass);
        end = pass.first;
        m *= pass.rows;
    }
}

// Where row `row` of a block is in a tile.
ptrdiff_t RowInTile(const qmfft_table* table, const Pass& pass, int32_t row) {
    ptrdiff_t place = 0;
    for (int32_t i = pass.end; i-- > pass.first; row /= table->factors[i])
        place += row % table->factors[i] * pass.step[i];
    return place;
}

// How many rows of the pass a block has that factor i combines.
int32_t RowsBehind(const qmfft_table* table, const Pass& pass, int32_t i) {
    int32_t rows = 1;
    while (++i < pass.end) rows *= table->factors[i];
    return rows;
}

// A stage of a tile takes its rows in `rows` calls, each for all columns. Call c of a complex stage is for row c. Those
// of a real stage are in turn for columns k of row c/2, and columns m - k of it; their partners are in the row that
// mirrors it. The row of `column` in call c, as the twiddles count rows:
template <class T>
ptrdiff_t StageRow(const Pass& pass, int32_t c, int32_t column) {
    const ptrdiff_t m = pass.m;
    if constexpr (!kIsReal<T>) return c * m + column;
    return c % 2 == 0 ? c / 2 * m + (column + 1) : (c / 2 + 1) * m - (column + 1);
}

// ---- Tiles ----

void CopyIn(const Pass&, const Complex* row, int32_t start, int32_t count, double* to) {
    std::copy_n(row + start, count, reinterpret_cast<Complex*>(to));
}

void CopyOut(const Pass&, const double* from, int32_t start, int32_t count, Complex* row) {
    std::copy_n(reinterpret_cast<const Complex*>(from), count, row + start);
}

void CopyIn(const Pass& pass, const double* row, int32_t start, int32_t count, double* to) {
    const double* end = row + pass.m - start;
    std::copy_n(row + 1 + start, count, to);
    std::reverse_copy(end - count, end, to + pass.width);
}

void CopyOut(const Pass& pass, const double* from, int32_t start, int32_t count, double* row) {
    const double* mirrored = from + pass.width;
    std::copy_n(from, count, row + 1 + start);
    std::reverse_copy(mirrored, mirrored + count, row + pass.m - start - count);
}

// Twiddles come from memory as the data do, and would be waited for.
void Prefetch(const double* x, ptrdiff_t count) {
    for (ptrdiff_t i = 0; i < count; i += 8) hwy::Prefetch(x + i);
}

template <class T>
void RunStage(const qmfft_table* table, const Pass& pass, int32_t i, int32_t start, int32_t count, double* tile) {
    const int32_t r = table->factors[i];
    const int32_t rows = RowsBehind(table, pass, i);
    const auto call = static_cast<ptrdiff_t>(PackedCount<T>(count, r));
    const double* packed = kIsReal<T> ? table->stages[i]->packedReal : table->stages[i]->packedComplex;
    const double* end = packed + static_cast<ptrdiff_t>(PackedCount<T>(pass.columns, r)) * rows;
    packed += static_cast<ptrdiff_t>(PackedCount<T>(start, r)) * rows;
    for (int32_t row = 0; row < pass.rows; row += r * rows) {
        double* block = tile + RowInTile(table, pass, row);
        const double* w = packed;
        for (int32_t c = 0; c < rows; ++c, w += call) {
            Prefetch(w + call, std::min(call, end - (w + call)));
            if constexpr (kIsReal<T>) {
                double* a = block + RowInTile(table, pass, c / 2);
                double* b = block + RowInTile(table, pass, rows - 1 - c / 2);
                (c % 2 == 0 ? b : a) += pass.width;
                table->vectors[i]->real.pairs(a, b, pass.step[i], w, count);
            } else {
                auto* first = reinterpret_cast<Complex*>(block + RowInTile(table, pass, c));
                table->vectors[i]->complex.stage(first, pass.step[i] / 2, w, count, start == 0 && c == 0);
            }
        }
    }
}

template <class T>
KRNUMER_FFT_NOINLINE void RunTiles(const qmfft_table* table, const Pass& pass, T* data) {
    alignas(64) double tile[kTileDoubles + kPaddingDoubles];
    for (int32_t start = 0; start < pass.columns; start += pass.width) {
        const int32_t count = std::min(pass.width, pass.columns - start);
        for (int32_t row = 0; row < pass.rows; ++row)
            CopyIn(pass, data + ptrdiff_t{row} * pass.m, start, count, tile + RowInTile(table, pass, row));
        for (int32_t i = pass.end; i-- > pass.first;) RunStage<T>(table, pass, i, start, count, tile);
        for (int32_t row = 0; row < pass.rows; ++row)
            CopyOut(pass, tile + RowInTile(table, pass, row), start, count, data + ptrdiff_t{row} * pass.m);
    }
}

// ---- Real columns beside the tiles: 0 and m/2, which are their own partners, and what is less than a vector ----

void CombineColumn(const qmfft_table* table, const Pass& pass, int32_t k, double* data) {
    for (int32_t i = pass.end; i-- > pass.first;) {
        const int32_t r = table->factors[i];
        const stage_tables& stage = *table->stages[i];
        const auto* butterflies = ButterfliesOf(r);
        const int32_t rows = RowsBehind(table, pass, i);
        const int32_t m = rows * pass.m;
        const auto run = [&](double* block, int32_t row) {
            if (2 * row <= m) butterflies->real_rows(block, stage.twiddleRe, stage.twiddleIm, m, row, row + 1);
        };
        for (int32_t first = 0; first < pass.rows; first += r * rows) {
            double* block = data + ptrdiff_t{first} * pass.m;
            if (k == 0) table->realLeaf[i](block, block, m, m, 1);
            for (int32_t row = 0; row < rows; ++row) {
                if (k > 0) run(block, row * pass.m + k);
                if (2 * k < pass.m) run(block, (row + 1) * pass.m - k);
            }
        }
    }
}

void CombineColumnsBesideTiles(const qmfft_table* table, const Pass& pass, double* data) {
    CombineColumn(table, pass, 0, data);
    for (int32_t k = pass.columns + 1; k <= pass.m / 2; ++k) CombineColumn(table, pass, k, data);
}

}  // namespace

template <class T>
int32_t CountTiledFactors(const qmfft_table* table) {
    int32_t length = table->length;
    int32_t tiled = 0;
    for (; tiled < table->factorCount - 1 && length > kLongestSubsequence; length /= table->factors[tiled++])
        if (table->vectors[tiled] == nullptr) return 0;
    const bool rows_collide = Count(length) * sizeof(T) % kPage == 0;
    return rows_collide || Count(table->length) * sizeof(T) > kLargeBytes ? tiled : 0;
}

template <class T>
int32_t LanesBeforeTiles(int32_t length) {
    constexpr int32_t kLine = 64 / sizeof(T);
    const auto held = static_cast<int32_t>(kTileDoubles * sizeof(double) / sizeof(T)) / length;
    return std::max(held / kLine, 1) * kLine;
}

template <class T>
void CombineInTiles(const qmfft_table* table, T* data) {
    ForEachPass<T>(table, [&](const Pass& pass) {
        const ptrdiff_t block = ptrdiff_t{pass.rows} * pass.m;
        for (ptrdiff_t start = 0; start < table->length; start += block) {
            RunTiles(table, pass, data + start);
            if constexpr (kIsReal<T>) CombineColumnsBesideTiles(table, pass, data + start);
        }
    });
}

template <class T>
size_t PackedCountInTiles(const qmfft_table* table, int32_t i) {
    size_t count = 0;
    ForEachPass<T>(table, [&](const Pass& pass) {
        if (i < pass.first || i >= pass.end) return;
        count = PackedCount<T>(pass.columns, table->factors[i]) * Count(RowsBehind(table, pass, i));
    });
    return count;
}

template <class T>
void PackTwiddlesInTiles(const qmfft_table* table, int32_t i, double* packed) {
    ForEachPass<T>(table, [&](const Pass& pass) {
        if (i < pass.first || i >= pass.end) return;
        const int32_t rows = RowsBehind(table, pass, i);
        for (int32_t start = 0; start < pass.columns; start += pass.width) {
            const int32_t end = std::min(start + pass.width, pass.columns);
            for (int32_t c = 0; c < rows; ++c) {
                const auto row = [&](int32_t column) { return StageRow<T>(pass, c, column); };
                packed = PackTwiddles<T>(*table->stages[i], table->factors[i], start, end, row, packed);
            }
        }
    });
}

template int32_t CountTiledFactors<Complex>(const qmfft_table*);
template int32_t CountTiledFactors<double>(const qmfft_table*);
template int32_t LanesBeforeTiles<Complex>(int32_t);
template int32_t LanesBeforeTiles<double>(int32_t);
template void CombineInTiles(const qmfft_table*, Complex*);
template void CombineInTiles(const qmfft_table*, double*);
template size_t PackedCountInTiles<Complex>(const qmfft_table*, int32_t);
template size_t PackedCountInTiles<double>(const qmfft_table*, int32_t);
template void PackTwiddlesInTiles<Complex>(const qmfft_table*, int32_t, double*);
template void PackTwiddlesInTiles<double>(const qmfft_table*, int32_t, double*);

}  // namespace krnumer
