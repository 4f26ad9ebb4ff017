#include "fft/table_slot.h"
#include "frame/entry.h"
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
        LinePlan plan(line, n, SlotTable(slot));
        if (!plan) return kOutOfMemory;
        return plan.Run(samples.data(), samples.size(), transformed.data());
    });
}

// What both directions of a two-dimensional transform share: tables, sizes, plans. core(along_rows, along_columns) does
// the rest.
template <class Core>
int32_t TransformMatrix(Call& call, OutMatrix<double>& transformed, int32_t rows, int32_t columns, void** slot_rows,
                        void** slot_columns, const LineTransform& line, Core core) {
    if (const int32_t status = BindTableSlot(slot_rows, line.table_length(rows))) return call.Fail(status);
    if (const int32_t status = BindTableSlot(slot_columns, line.table_length(columns))) return call.Fail(status);
    if (transformed.Resize(rows, columns)) return call.Fail(kOutOfMemory);
    return call.Run([&]() -> int32_t {
        LinePlan along_rows(line, columns, SlotTable(slot_columns));
        LinePlan along_columns(line, rows, SlotTable(slot_rows));
        if (!along_rows || !along_columns) return kOutOfMemory;
        return core(along_rows, along_columns);
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
    return TransformMatrix(call, transformed, rows, columns, slot_rows, slot_columns, line,
                           [&](LinePlan& along_rows, LinePlan& along_columns) {
                               double* const to = transformed.data();
                               const int32_t status = TransformRows(along_rows, samples.data(), samples.rows(),
                                                                    samples.columns(), to, rows);
                               return status != kOk ? status : TransformColumns(along_columns, to, to, columns);
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
    return TransformMatrix(call, samples, rows, columns, slot_rows, slot_columns, line,
                           [&](LinePlan& along_rows, LinePlan& along_columns) {
                               const double* const from = spectrum.data();
                               double* const to = samples.data();
                               if (first == First::kRows) {
                                   const int32_t status = TransformRows(along_rows, from, rows, columns, to, rows);
                                   return status != kOk ? status : TransformColumns(along_columns, to, to, columns);
                               }
                               const int32_t status = TransformColumns(along_columns, from, to, columns);
                               return status != kOk ? status : TransformRows(along_rows, to, rows, columns, to, rows);
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
