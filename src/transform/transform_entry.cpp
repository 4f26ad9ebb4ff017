#include <algorithm>

#include "fft/table_slot.h"
#include "frame/entry.h"
#include "frame/scratch.h"
#include "krnumer/transform.h"
#include "transform/hartley.h"
#include "transform/trigonometric.h"

using namespace krnumer;

namespace {

enum class Refused { kLeavesOutput, kEmptiesOutput };

// A line of `size` samples, or of the length of X where that is not positive.
int32_t TransformLine(KrHandle x, KrHandle y, int32_t size, void** slot, const LineTransform& line, Refused refused) {
    ByValue call;
    In<double> samples(call, x);
    Out<double> transformed(call, y);
    if (samples.size() < 1) return call.Fail(kEmptyInput);
    const int32_t n = size > 0 ? size : samples.size();
    if (transformed.Resize(n)) {
        return refused == Refused::kLeavesOutput ? call.Leave(kOutOfMemory) : call.Fail(kOutOfMemory);
    }
    if (const int32_t status = BindTableSlot(slot, line.table_length(n))) return call.Fail(status);
    return call.Run([&]() -> int32_t {
        Scratch<double> work(LineWork(n));
        if (!work) return kOutOfMemory;
        return line.transform({samples.data(), samples.size(), 1}, transformed.data(), 1, n, work.data(),
                              SlotTable(slot));
    });
}

// What both directions of a two-dimensional transform share: checks, tables, sizes. core(work) does the rest.
template <class Core>
int32_t TransformMatrix(Call& call, OutMatrix<double>& transformed, int32_t rows, int32_t columns, void** slot_rows,
                        void** slot_columns, const LineTransform& line, Core core) {
    if (const int32_t status = BindTableSlot(slot_rows, line.table_length(rows))) return call.Fail(status);
    if (const int32_t status = BindTableSlot(slot_columns, line.table_length(columns))) return call.Fail(status);
    if (transformed.Resize(rows, columns)) return call.Fail(kOutOfMemory);
    return call.Run([&]() -> int32_t {
        Scratch<double> work(LineWork(std::max(rows, columns)));
        if (!work) return kOutOfMemory;
        return core(work.data());
    });
}

int32_t ForwardMatrix(KrHandle x, KrHandle y, int32_t rows, int32_t columns, void** slot_rows, void** slot_columns,
                      const LineTransform& line) {
    ByValue call;
    InMatrix<double> samples(call, x);
    OutMatrix<double> transformed(call, y);
    if (samples.rows() < 1 || samples.columns() < 1) return call.Fail(kEmptyInput);
    if (rows <= 0) rows = samples.rows();
    if (columns <= 0) columns = samples.columns();
    return TransformMatrix(call, transformed, rows, columns, slot_rows, slot_columns, line, [&](double* work) {
        const double* from = samples.data();
        Scratch<double> resized;
        if (rows != samples.rows() || columns != samples.columns()) {
            if (!resized.Allocate(Count(rows) * Count(columns), resized.kZeroed)) return kOutOfMemory;
            const int32_t width = std::min(columns, samples.columns());
            for (int32_t row = 0; row < std::min(rows, samples.rows()); ++row) {
                std::copy_n(from + Count(row) * Count(samples.columns()), width,
                            resized.data() + Count(row) * Count(columns));
            }
            from = resized.data();
        }
        double* const to = transformed.data();
        if (const int32_t status =
                TransformRows(line.transform, from, to, rows, columns, work, SlotTable(slot_columns))) {
            return status;
        }
        return TransformColumns(line.transform, to, to, rows, columns, work, SlotTable(slot_rows));
    });
}

enum class First { kRows, kColumns };

int32_t InverseMatrix(KrHandle x, KrHandle y, void** slot_rows, void** slot_columns, const LineTransform& line,
                      First first) {
    ByValue call;
    InMatrix<double> spectrum(call, x);
    OutMatrix<double> samples(call, y);
    const int32_t rows = spectrum.rows();
    const int32_t columns = spectrum.columns();
    if (rows < 1 || columns < 1) return call.Fail(kEmptyInput);
    return TransformMatrix(call, samples, rows, columns, slot_rows, slot_columns, line, [&](double* work) {
        const double* const from = spectrum.data();
        double* const to = samples.data();
        const qmfft_table* const row_table = SlotTable(slot_columns);
        const qmfft_table* const column_table = SlotTable(slot_rows);
        if (first == First::kRows) {
            if (const int32_t status = TransformRows(line.transform, from, to, rows, columns, work, row_table)) {
                return status;
            }
            return TransformColumns(line.transform, to, to, rows, columns, work, column_table);
        }
        if (const int32_t status = TransformColumns(line.transform, from, to, rows, columns, work, column_table)) {
            return status;
        }
        return TransformRows(line.transform, to, to, rows, columns, work, row_table);
    });
}

int32_t TransformInPlace(KrHandle x, void** slot, int32_t (*core)(double*, int32_t, const qmfft_table*)) {
    ByValue call;
    InOut<double> samples(call, x);
    if (samples.size() < 1) return call.Fail(kEmptyInput);
    if (const int32_t status = BindTableSlot(slot, samples.size())) return call.Fail(status);
    return call.Run([&] { return core(samples.data(), samples.size(), SlotTable(slot)); });
}

}  // namespace

int32_t DCT_1DH(KrHandle x, KrHandle y, int32_t size, void** slot) {
    return TransformLine(x, y, size, slot, kCosine, Refused::kLeavesOutput);
}
int32_t DST_1DH(KrHandle x, KrHandle y, int32_t size, void** slot) {
    return TransformLine(x, y, size, slot, kSine, Refused::kLeavesOutput);
}
int32_t InvDCT_1DH(KrHandle x, KrHandle y, void** slot) {
    return TransformLine(x, y, 0, slot, kInverseCosine, Refused::kEmptiesOutput);
}
int32_t InvDST_1DH(KrHandle x, KrHandle y, void** slot) {
    return TransformLine(x, y, 0, slot, kInverseSine, Refused::kEmptiesOutput);
}

int32_t DCT_2DH(KrHandle x, KrHandle y, int32_t rows, int32_t cols, void** slotRows, void** slotCols) {
    return ForwardMatrix(x, y, rows, cols, slotRows, slotCols, kCosine);
}
int32_t DST_2DH(KrHandle x, KrHandle y, int32_t rows, int32_t cols, void** slotRows, void** slotCols) {
    return ForwardMatrix(x, y, rows, cols, slotRows, slotCols, kSine);
}
int32_t InvDCT_2DH(KrHandle x, KrHandle y, void** slotRows, void** slotCols) {
    return InverseMatrix(x, y, slotRows, slotCols, kInverseCosine, First::kColumns);
}
int32_t InvDST_2DH(KrHandle x, KrHandle y, void** slotRows, void** slotCols) {
    return InverseMatrix(x, y, slotRows, slotCols, kInverseSine, First::kRows);
}

int32_t FastHilbertTransformH(KrHandle x, void** slot) {
    return TransformInPlace(x, slot, HilbertTransform);
}
int32_t InvFastHilbertTransformH(KrHandle x, void** slot) {
    return TransformInPlace(x, slot, InverseHilbertTransform);
}
int32_t FHTH(KrHandle x, void** slot) {
    return TransformInPlace(x, slot, HartleyTransform);
}
int32_t InvFHTH(KrHandle x, void** slot) {
    return TransformInPlace(x, slot, InverseHartleyTransform);
}
