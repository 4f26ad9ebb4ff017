#include "fft/vector_tiles.h"

#include <algorithm>
#include <type_traits>

#include "fft/inline.h"
#include "fft/vector_rows.h"
#include "fft/vector_twiddles.h"
#include "frame/complex.h"
#include "frame/numeric.h"
#include "hwy/cache_control.h"

namespace krnumer {
namespace {

// Data up to this size stay in the second-level cache between the passes; data from the other size on do not stay in
// any, together with what they are made of and with the twiddles.
constexpr size_t kCachedBytes = 512 * 1024;
constexpr size_t kFarBytes = 6 * 1024 * 1024;

// Far data are worth copying to tiles whatever the distance of their rows. Others are only if it is a multiple of a
// page, so that all rows compete for the same few places in the caches, and if one stage combines more rows than those
// hold; twice as many, where what was driven out is close at hand.
constexpr size_t kPage = 4096;
constexpr int32_t kTooManyRows = 16;

// Sub-sequences up to this length are left to the factors behind those in tiles.
constexpr int32_t kLongestSubsequence = 2048;

// With more rows, the parts of them that a tile holds would be shorter than 256 bytes, and the memory poorly used.
template <class T>
constexpr int32_t kMostRows = kTileDoubles / (2 * 256 / static_cast<int32_t>(sizeof(T)));

// A tile of far data takes no more of a row, in elements: what is fetched ahead should still be there when its turn
// comes. But it has as many elements at least, however few its rows are.
constexpr int32_t kFarWidth = 64;
constexpr int32_t kLeastTile = 2048;

// What comes from memory is fetched this long before it is used: rows, and doubles of twiddles.
constexpr int32_t kRowsAhead = 64;
constexpr ptrdiff_t kTwiddlesAhead = 1536;

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
    bool far;
    ptrdiff_t step[kMaxFactors];  // distance in a tile of the blocks that a factor combines, in doubles
};

// Widths are whole lines of doubles, and so whole vectors.
constexpr int32_t kLine = 8;

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
    Pass pass{end - 1, end, table->factors[end - 1], m, m, 0, PlanOf<T>(table).far, {}};
    while (pass.first > 0 && pass.rows * table->factors[pass.first - 1] <= kMostRows<T>)
        pass.rows *= table->factors[--pass.first];
    if constexpr (kIsReal<T>) pass.columns = (m - 1) / 2;
    pass.width = std::min(kTileDoubles / (2 * pass.rows), pass.columns + kLine - 1);
    if (pass.far) pass.width = std::min(pass.width, std::max(kFarWidth, kLeastTile / pass.rows));
    pass.width = pass.width / kLine * kLine;
    while (PlaceRows(table, pass) > kTileDoubles + kPaddingDoubles) pass.width -= kLine;
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

// What a tile holds of a row: columns k, or columns m - k of real rows.
struct Strip {
    int32_t row;
    bool mirrored;
};

// The rows that call c combines in the block from row `first` on: `count` of them at a distance of `apart`, which is
// `step` in the tile.
template <class T>
struct Group {
    Group(int32_t first, int32_t c, int32_t radix, int32_t rows, ptrdiff_t distance)
        : count(radix), apart(rows), step(distance) {
        if constexpr (kIsReal<T>) {
            strips[0] = {first + c / 2, c % 2 != 0};
            strips[1] = {first + rows - 1 - c / 2, c % 2 == 0};
        } else {
            strips[0] = {first + c, false};
        }
    }
    Strip strips[kIsReal<T> ? 2 : 1];
    int32_t count, apart;
    ptrdiff_t step;
};

// Columns from `start` on of a block of the data, and the place where they are worked on.
template <class T>
struct Tile {
    const qmfft_table* table;
    const Pass& pass;
    T* data;
    double* place;
    int32_t start, count;
    bool streamed;

    static constexpr int32_t kDoubles = static_cast<int32_t>(sizeof(T) / sizeof(double));  // in an element

    double* At(Strip strip) const {
        return place + RowInTile(table, pass, strip.row) + (strip.mirrored ? pass.width : 0);
    }
    double* InData(Strip strip) const {
        auto* row = reinterpret_cast<double*>(data + ptrdiff_t{strip.row} * pass.m);
        if (strip.mirrored) return row + pass.m - start - count;
        return kIsReal<T> ? row + 1 + start : row + 2 * start;
    }
};

// Zeros fill up the last vector of real columns.
template <class T>
void CopyIn(const Tile<T>& tile, const Group<T>& group) {
    const ptrdiff_t apart = ptrdiff_t{group.apart} * tile.pass.m * tile.kDoubles;
    const int32_t doubles = tile.count * tile.kDoubles;
    for (const Strip strip : group.strips) {
        double* to = tile.At(strip);
        (strip.mirrored ? ReverseRows : CopyRows)(tile.InData(strip), apart, to, group.step, group.count, doubles);
        if (!kIsReal<T> || doubles % kLine == 0) continue;
        for (int32_t j = 0; j < group.count; ++j, to += group.step)
            std::fill(to + doubles, to + (doubles / kLine + 1) * kLine, 0.0);
    }
}

template <class T>
void CopyOut(const Tile<T>& tile, const Group<T>& group) {
    const ptrdiff_t apart = ptrdiff_t{group.apart} * tile.pass.m * tile.kDoubles;
    for (const Strip strip : group.strips) {
        const RowsMove move = strip.mirrored ? ReverseRows : tile.streamed ? StreamRows : CopyRows;
        move(tile.At(strip), group.step, tile.InData(strip), apart, group.count, tile.count * tile.kDoubles);
    }
}

// Fetches rows that are copied later. Behind the last one of a tile is the first one of the next.
template <class T>
KRNUMER_FFT_INLINE void FetchRows(const Tile<T>& tile, int32_t row, int32_t end) {
    const Pass& pass = tile.pass;
    for (; row < end; ++row) {
        const bool next = row >= pass.rows;
        const int32_t start = tile.start + (next ? pass.width : 0);
        const int32_t count = std::min(pass.width, pass.columns - start);
        if (count < 1) return;
        const Tile<T> part{tile.table, pass, tile.data, tile.place, start, count, false};
        for (const bool mirrored : {false, true}) {
            if (mirrored && !kIsReal<T>) break;
            const double* x = part.InData({next ? row - pass.rows : row, mirrored});
            for (int32_t i = 0; i < count * tile.kDoubles; i += kLine) FetchLine(x + i);
        }
    }
}

// Fetches those of `count` twiddles from w[ahead] on that are before `end`.
KRNUMER_FFT_INLINE void FetchTwiddles(const double* w, ptrdiff_t ahead, ptrdiff_t count, const double* end) {
    count = std::min(count, end - w - ahead);
    for (ptrdiff_t i = 0; i < count; i += kLine) hwy::Prefetch(w + ahead + i);
}

// How many columns of far data go through a kernel at a time: a vector in the largest butterfly, and as much work in
// others. Fetching a lot between two calls would be waited for; a little comes in while the kernel computes.
template <class T>
int32_t ColumnsAtOnce(const Pass& pass, int32_t radix) {
    return pass.far ? RowsPerVector<T>() * std::max(32 / radix, 1) : pass.width;
}

// The first stage of a pass brings its rows from the data, and the last one puts them back, while they are at hand. The
// first block of a stage fetches the twiddles for all.
template <class T>
void RunStage(const Tile<T>& tile, int32_t i) {
    const Pass& pass = tile.pass;
    const int32_t r = tile.table->factors[i];
    const int32_t rows = RowsBehind(tile.table, pass, i);
    const int32_t at_once = ColumnsAtOnce<T>(pass, r);
    const VectorButterflies* kernels = tile.table->vectors[i];
    const stage_tables& stage = *tile.table->stages[i];
    const double* packed = kIsReal<T> ? stage.packedReal : stage.packedComplex;
    const double* end = packed + static_cast<ptrdiff_t>(PackedCount<T>(pass.columns, r)) * rows;
    packed += static_cast<ptrdiff_t>(PackedCount<T>(tile.start, r)) * rows;
    const auto w_ahead = pass.far ? kTwiddlesAhead : static_cast<ptrdiff_t>(PackedCount<T>(tile.count, r));
    const int32_t rows_ahead = std::min(kRowsAhead, pass.rows);
    for (int32_t row = 0; row < pass.rows; row += r * rows) {
        const double* w = packed;
        for (int32_t c = 0; c < rows; ++c) {
            const Group<T> group(row, c, r, rows, pass.step[i]);
            if (i == pass.end - 1) CopyIn(tile, group);
            double* a = tile.At(group.strips[0]);
            double* b = tile.At(group.strips[kIsReal<T> ? 1 : 0]);
            for (int32_t k = 0; k < tile.count; k += at_once) {
                const int32_t count = std::min(at_once, tile.count - k);
                const auto taken = static_cast<ptrdiff_t>(PackedCount<T>(count, r));
                if (row == 0) FetchTwiddles(w, w_ahead, taken, end);
                if (pass.far && i == pass.end - 1) {
                    const int32_t coming = row + rows_ahead;
                    FetchRows(tile, coming + r * k / tile.count, coming + r * (k + count) / tile.count);
                }
                if constexpr (kIsReal<T>) {
                    kernels->real.pairs(a + k, b + k, group.step, w, count);
                } else {
                    kernels->complex.stage(reinterpret_cast<Complex*>(a) + k, group.step / 2, w, count,
                                           tile.start + k == 0 && c == 0);
                }
                w += taken;
            }
            if (i == pass.first) CopyOut(tile, group);
        }
    }
}

template <class T>
KRNUMER_FFT_NOINLINE void RunTiles(const qmfft_table* table, const Pass& pass, T* data) {
    alignas(64) double place[kTileDoubles + kPaddingDoubles];
    const bool streamed = !kIsReal<T> && pass.far && IsLine(data) && Count(pass.m) * sizeof(T) % 64 == 0;
    for (int32_t start = 0; start < pass.columns; start += pass.width) {
        const int32_t count = std::min(pass.width, pass.columns - start);
        const Tile<T> tile{table, pass, data, place, start, count, streamed};
        for (int32_t i = pass.end; i-- > pass.first;) RunStage(tile, i);
    }
    if (streamed) FlushStreams();
}

// ---- Real columns beside the tiles: 0 and m/2, which are their own partners ----

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
    if (pass.m % 2 == 0) CombineColumn(table, pass, pass.m / 2, data);
}

}  // namespace

template <class T>
int32_t CountTiledFactors(const qmfft_table* table) {
    int32_t length = table->length;
    int32_t tiled = 0;
    for (; tiled < table->factorCount - 1 && length > kLongestSubsequence; length /= table->factors[tiled++])
        if (table->vectors[tiled] == nullptr) return 0;
    if (tiled == 0 || AreFar<T>(table)) return tiled;
    const bool rows_collide = Count(length) * sizeof(T) % kPage == 0;
    const int32_t too_many = AreCached<T>(table) ? 2 * kTooManyRows : kTooManyRows;
    return rows_collide && table->factors[tiled - 1] >= too_many ? tiled : 0;
}

template <class T>
bool AreCached(const qmfft_table* table) {
    return Count(table->length) * sizeof(T) <= kCachedBytes;
}

template <class T>
bool AreFar(const qmfft_table* table) {
    return Count(table->length) * sizeof(T) >= kFarBytes;
}

template <class T>
int32_t LanesBeforeTiles(int32_t length) {
    constexpr int32_t kInLine = 64 / sizeof(T);
    const auto held = static_cast<int32_t>(kTileDoubles * sizeof(double) / sizeof(T)) / length;
    return std::clamp(held / kInLine * kInLine, kInLine, kMostLanes);
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
template bool AreCached<Complex>(const qmfft_table*);
template bool AreCached<double>(const qmfft_table*);
template bool AreFar<Complex>(const qmfft_table*);
template bool AreFar<double>(const qmfft_table*);
template int32_t LanesBeforeTiles<Complex>(int32_t);
template int32_t LanesBeforeTiles<double>(int32_t);
template void CombineInTiles(const qmfft_table*, Complex*);
template void CombineInTiles(const qmfft_table*, double*);
template size_t PackedCountInTiles<Complex>(const qmfft_table*, int32_t);
template size_t PackedCountInTiles<double>(const qmfft_table*, int32_t);
template void PackTwiddlesInTiles<Complex>(const qmfft_table*, int32_t, double*);
template void PackTwiddlesInTiles<double>(const qmfft_table*, int32_t, double*);

}  // namespace krnumer
