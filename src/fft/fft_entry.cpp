#include "krnumer/fft.h"

#include <algorithm>

#include "fft/fft.h"
#include "fft/half_complex.h"
#include "fft/table_slot.h"
#include "frame/entry.h"
#include "frame/scratch.h"

using namespace krnumer;

qmfft_table* create_qmfft_table(int32_t length) {
    return CreateTable(length);
}

void destroy_qmfft_table(qmfft_table* table) {
    DestroyTable(table);
}

// ---- Complex samples ----

int32_t CxQMFFTH80(KrHandle x, KrHandle y, void** slot, int32_t offset, int32_t fft_size, int32_t shift) {
    ByValue call;
    In<Complex> samples(call, x);
    Out<Complex> spectrum(call, y);
    if (samples.size() < 1) return call.Leave(kEmptyInput);
    if (fft_size < 1) return call.Leave(kNoChannel);
    if (offset < 0) return call.Leave(kBadIndex);
    if (const int32_t status = BindTableSlot(slot, fft_size)) return call.Leave(status);

    const int32_t available = std::max(0, samples.size() - offset);
    Scratch<Complex> padded;
    if (fft_size > available && !padded.Allocate(Count(fft_size), padded.kZeroed)) return call.Leave(kOutOfMemory);
    if (const int32_t host = spectrum.Resize(fft_size)) return call.Fail(host);
    return call.Run([&] {
        const Complex* in = samples.data() + std::min(offset, samples.size());
        if (padded) in = std::copy_n(in, available, padded.data()) - available;
        Complex* out = spectrum.data();
        if (const int32_t status = ComplexFFT(SlotTable(slot), &in->re, &in->im, &out->re, &out->im, 2, 2, fft_size)) {
            return status;
        }
        if (shift != 0) ShiftSpectrum(out, fft_size);
        return kOk;
    });
}

int32_t CxQMFFTH(KrHandle x, KrHandle y, void** slot) {
    ByValue call;
    const In<Complex> samples(call, x);
    return CxQMFFTH80(x, y, slot, 0, samples.size(), 0);
}

int32_t InvCxQMFFTH80(KrHandle x, KrHandle y, void** slot, int32_t shift) {
    ByValue call;
    In<Complex> spectrum(call, x);
    Out<Complex> samples(call, y);
    const int32_t n = spectrum.size();
    if (n < 1) return call.Leave(kEmptyInput);
    if (const int32_t status = BindTableSlot(slot, n)) return call.Leave(status);
    if (const int32_t host = samples.Resize(n)) return call.Fail(host);
    return call.Run([&] {
        const Complex* in = spectrum.data();
        Scratch<Complex> unshifted;
        if (shift != 0) {
            if (!unshifted.Allocate(Count(n))) return kOutOfMemory;
            CopyUnshifted(in, n, unshifted.data());
            in = unshifted.data();
        }
        Complex* out = samples.data();
        return InverseComplexFFT(SlotTable(slot), &in->re, &in->im, &out->re, &out->im, 2, 2, n);
    });
}

int32_t InvCxQMFFTH(KrHandle x, KrHandle y, void** slot) {
    return InvCxQMFFTH80(x, y, slot, 0);
}

// ---- Real samples ----

int32_t ReQMFFTH80(KrHandle x, KrHandle y, void** slot, int32_t offset, int32_t fft_size, int32_t shift) {
    ByValue call;
    In<double> samples(call, x);
    Out<Complex> spectrum(call, y);
    if (samples.size() < 1) return call.Leave(kEmptyInput);
    if (offset < 0 || offset >= samples.size()) return call.Leave(kBadIndex);
    if (fft_size < 1) return call.Leave(kNoChannel);
    if (const int32_t status = BindTableSlot(slot, fft_size)) return call.Leave(status);
    if (const int32_t host = spectrum.Resize(fft_size)) return call.Fail(host);
    return call.Run([&] {
        const int32_t available = samples.size() - offset;
        const double* in = samples.data() + offset;
        Scratch<double> padded;
        if (fft_size > available) {
            // Without memory the result has its size and says nothing; callers rely on the status.
            if (!padded.Allocate(Count(fft_size), padded.kZeroed)) return kOk;
            in = std::copy_n(in, available, padded.data()) - available;
        }
        Complex* out = spectrum.data();
        double* half_complex = HalfComplexPart(out, fft_size);
        if (const int32_t status = RealFFT(SlotTable(slot), in, half_complex, 1, 1, fft_size)) return status;
        ExpandHalfComplex(out, fft_size, shift);
        return kOk;
    });
}

int32_t ReQMFFTH(KrHandle x, KrHandle y, void** slot) {
    ByValue call;
    const In<double> samples(call, x);
    return ReQMFFTH80(x, y, slot, 0, samples.size(), 0);
}

int32_t ReQMFFTHCH(KrHandle x, KrHandle y, void** slot) {
    ByValue call;
    In<double> samples(call, x);
    Out<double> spectrum(call, y);
    spectrum.EmptyAs(kElementKind<Complex>.type_code);
    const int32_t n = samples.size();
    if (n < 1) return call.Leave(kEmptyInput);
    if (spectrum.Resize(n)) return call.Fail(kOutOfMemory);
    if (const int32_t status = BindTableSlot(slot, n)) return call.Fail(status);
    return call.Run([&] { return RealFFT(SlotTable(slot), samples.data(), spectrum.data(), 1, 1, n); });
}

int32_t InvReQMFFTH80(KrHandle x, KrHandle y, void** slot, int32_t shift) {
    ByValue call;
    In<Complex> spectrum(call, x);
    Out<double> samples(call, y);
    samples.EmptyAs(kElementKind<Complex>.type_code);
    const int32_t n = spectrum.size();
    if (n < 1) return call.Leave(kEmptyInput);
    if (const int32_t status = BindTableSlot(slot, n)) return call.Leave(status);
    Scratch<double> half_complex(Count(n));
    if (!half_complex) return call.Leave(kOutOfMemory);
    if (samples.Resize(n)) return call.Fail(kOutOfMemory);
    return call.Run([&] {
        PackHalfComplex(spectrum.data(), n, shift, half_complex.data());
        return InverseRealFFT(SlotTable(slot), half_complex.data(), samples.data(), 1, 1, n);
    });
}

int32_t InvReQMFFTH(KrHandle x, KrHandle y, void** slot) {
    return InvReQMFFTH80(x, y, slot, 0);
}

int32_t InvReQMFFTHCH(KrHandle x, KrHandle y, void** slot) {
    ByValue call;
    InOut<double> spectrum(call, x, Access::kReplacedKept);
    Out<double> samples(call, y);
    samples.EmptyAs(kElementKind<Complex>.type_code);
    const int32_t n = spectrum.size();
    if (n < 1) return call.Leave(kEmptyInput);
    if (samples.Resize(n)) return call.Fail(kOutOfMemory);
    if (const int32_t status = BindTableSlot(slot, n)) return call.Fail(status);
    return call.Run([&] { return InverseRealFFT(SlotTable(slot), spectrum.data(), samples.data(), 1, 1, n); });
}
