#include "fft/fft2d.h"

#include "fft/table_slot.h"
#include "frame/entry.h"
#include "krnumer/fft.h"

using namespace krnumer;

namespace {

// An offset that is too large is found at once, a negative one by the core.
template <class T>
int32_t Forward(KrHandle x, int32_t row_offset, int32_t col_offset, int32_t fft_rows, int32_t fft_cols, int32_t shift,
                KrHandle y, void** slot_cols, void** slot_rows) {
    ByValue call;
    InMatrix<T> samples(call, x);
    OutMatrix<Complex> spectrum(call, y);
    if (samples.rows() < 1 || samples.columns() < 1) return call.Leave(kEmptyInput);
    if (row_offset >= samples.rows() || col_offset >= samples.columns()) return call.Leave(kBadIndex);
    if (fft_rows < 1 || fft_cols < 1) return call.Leave(kBadDimension);
    if (const int32_t status = BindTableSlot(slot_cols, fft_cols)) return call.Leave(status);
    if (const int32_t status = BindTableSlot(slot_rows, fft_rows)) return call.Fail(status);
    if (const int32_t host = spectrum.Resize(fft_rows, fft_cols)) return call.Fail(host);
    return call.Run([&] {
        const Section section{samples.rows(), samples.columns(), row_offset, col_offset, fft_rows, fft_cols};
        return ForwardFFT2D(samples.data(), section, shift, spectrum.data(),
                            {SlotTable(slot_cols), SlotTable(slot_rows)});
    });
}

// A real array that cannot be sized is out of memory, whatever the host says.
template <class T>
int32_t Inverse(KrHandle x, int32_t shift, KrHandle y, void** slot_cols, void** slot_rows) {
    ByValue call;
    InMatrix<Complex> spectrum(call, x);
    OutMatrix<T> samples(call, y);
    const int32_t rows = spectrum.rows();
    const int32_t columns = spectrum.columns();
    if (rows < 1 || columns < 1) return call.Leave(kEmptyInput);
    if (const int32_t status = BindTableSlot(slot_cols, columns)) return call.Leave(status);
    if (const int32_t status = BindTableSlot(slot_rows, rows)) return call.Leave(status);
    if (const int32_t host = samples.Resize(rows, columns))
        return call.Fail(std::is_same_v<T, double> ? kOutOfMemory : host);
    return call.Run([&] {
        return InverseFFT2D(spectrum.data(), rows, columns, shift, samples.data(),
                            {SlotTable(slot_cols), SlotTable(slot_rows)});
    });
}

}  // namespace

int32_t CxFFT2D_H(KrHandle x, int32_t row_offset, int32_t col_offset, int32_t fft_rows, int32_t fft_cols, int32_t shift,
                  KrHandle y, void** slot_cols, void** slot_rows) {
    return Forward<Complex>(x, row_offset, col_offset, fft_rows, fft_cols, shift, y, slot_cols, slot_rows);
}

int32_t ReFFT2D_H(KrHandle x, int32_t row_offset, int32_t col_offset, int32_t fft_rows, int32_t fft_cols, int32_t shift,
                  KrHandle y, void** slot_cols, void** slot_rows) {
    return Forward<double>(x, row_offset, col_offset, fft_rows, fft_cols, shift, y, slot_cols, slot_rows);
}

int32_t CxInvFFT2D_H(KrHandle x, int32_t shift, KrHandle y, void** slot_cols, void** slot_rows) {
    return Inverse<Complex>(x, shift, y, slot_cols, slot_rows);
}

int32_t ReInvFFT2D_H(KrHandle x, int32_t shift, KrHandle y, void** slot_cols, void** slot_rows) {
    return Inverse<double>(x, shift, y, slot_cols, slot_rows);
}
