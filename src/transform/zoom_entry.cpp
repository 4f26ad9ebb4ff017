#include "fft/table_slot.h"
#include "frame/entry.h"
#include "krnumer/zoom.h"
#include "transform/chirp_z.h"
#include "transform/zoom.h"

using namespace krnumer;

namespace {

Complex Value(const KrComplex* z) {
    return {z->re, z->im};
}

template <class T>
int32_t Chirp(KrHandle x, const KrComplex* a, const KrComplex* w, int32_t m, int32_t algorithm, KrHandle y) {
    ByValue call;
    In<T> samples(call, x);
    Out<Complex> values(call, y);
    const int32_t n = samples.size();
    if (n < 1) return call.Fail(kEmptyInput);
    if (algorithm < 0 || algorithm > 1) return call.Fail(kBadSelector);
    const int32_t count = m > 0 ? m : n;
    if (values.Resize(count)) return call.Fail(kOutOfMemory);
    return call.Run([&] { return ChirpZ(samples.data(), n, Value(a), Value(w), count, algorithm, values.data()); });
}

template <class T>
int32_t Zoom(KrHandle x, int32_t phases, int32_t length, int32_t start, int32_t count, KrHandle y, void** slot) {
    ByValue call;
    InOut<T> samples(call, x, Access::kReplacedKept);
    Out<Complex> lines(call, y);
    if (phases < 1) return call.Fail(kBadOrder);
    if (count < 1) return call.Fail(kNoChannel);
    if (samples.size() < 1) return call.Leave(kOk);
    if (const int32_t status = BindTableSlot(slot, length)) return call.Fail(status);
    if (auto host = lines.Resize(count)) return call.Fail(host);
    return call.Run([&] {
        return ZoomTransform(samples.data(), samples.size(), phases, length, start, count, SlotTable(slot),
                             lines.data());
    });
}

}  // namespace

int32_t ChirpZT_head(KrHandle x, const KrComplex* a, const KrComplex* w, int32_t m, int32_t algorithm, KrHandle y) {
    return Chirp<double>(x, a, w, m, algorithm, y);
}
int32_t CxChirpZT_head(KrHandle x, const KrComplex* a, const KrComplex* w, int32_t m, int32_t algorithm, KrHandle y) {
    return Chirp<Complex>(x, a, w, m, algorithm, y);
}

int32_t InvChirpZT_head(KrHandle x, const KrComplex* a, const KrComplex* w, int32_t m, KrHandle y) {
    ByValue call;
    In<Complex> values(call, x);
    Out<Complex> samples(call, y);
    const int32_t n = values.size();
    if (n < 1) return call.Fail(kEmptyInput);
    const int32_t count = m > 0 ? m : n;
    if (count > n) return call.Fail(kBadDimension);
    if (samples.Resize(count)) return call.Fail(kOutOfMemory);
    return call.Run([&] { return InverseChirpZ(values.data(), n, Value(a), Value(w), count, samples.data()); });
}

int32_t CxDZTH(KrHandle x, int32_t p, int32_t k, int32_t start, int32_t count, KrHandle y, void** slot) {
    return Zoom<Complex>(x, p, k, start, count, y, slot);
}
int32_t ReDZTH(KrHandle x, int32_t p, int32_t k, int32_t start, int32_t count, KrHandle y, void** slot) {
    return Zoom<double>(x, p, k, start, count, y, slot);
}
