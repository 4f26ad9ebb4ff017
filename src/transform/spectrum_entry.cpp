#include "fft/table_slot.h"
#include "frame/entry.h"
#include "krnumer/spectrum.h"
#include "transform/spectrum.h"

using namespace krnumer;

namespace {

template <class T>
int32_t Cross(KrHandle x, KrHandle y, KrHandle z, void** slot) {
    ByValue call;
    In<T> samples(call, x);
    In<T> others(call, y);
    Out<Complex> cross(call, z);
    const int32_t n = samples.size();
    if (n < 1 || others.size() < 1) return call.Fail(kEmptyInput);
    if (others.size() != n) return call.Fail(kSizesDiffer);
    if (cross.Resize(n)) return call.Fail(kOutOfMemory);
    if (const int32_t status = BindTableSlot(slot, n)) return call.Fail(status);
    return call.Run([&] { return CrossSpectrum(samples.data(), others.data(), n, SlotTable(slot), cross.data()); });
}

}  // namespace

int32_t SpectrumH(KrHandle x, void** slot) {
    ByValue call;
    InOut<double> samples(call, x);
    const int32_t n = samples.size();
    if (n < 1) return call.Fail(kEmptyInput);
    if (const int32_t status = BindTableSlot(slot, n)) return call.Fail(status);
    return call.Run([&] { return PowerSpectrum(samples.data(), n, SlotTable(slot)); });
}

int32_t CxSpectrumH(KrHandle x, KrHandle y, void** slot) {
    ByValue call;
    In<Complex> samples(call, x);
    Out<double> power(call, y);
    const int32_t n = samples.size();
    if (n < 1) return call.Fail(kEmptyInput);
    if (const int32_t status = BindTableSlot(slot, n)) return call.Fail(status);
    if (power.Resize(n)) return call.Fail(kOutOfMemory);
    return call.Run([&] { return PowerSpectrum(samples.data(), n, SlotTable(slot), power.data()); });
}

int32_t CrossSpectrumH(KrHandle x, KrHandle y, KrHandle z, void** slot) {
    return Cross<double>(x, y, z, slot);
}
int32_t CxCrossSpectrumH(KrHandle x, KrHandle y, KrHandle z, void** slot) {
    return Cross<Complex>(x, y, z, slot);
}
