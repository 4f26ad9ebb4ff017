#include "krnumer/fft.h"

#include "frame/status.h"
#include "sweep/sweep.h"

using krnumer::Complex;
using sweep::OnFailure;

namespace {

// Lengths with factors of all kinds: butterflies, a direct one, Rader's.
std::vector<Complex> Complexes(int32_t n) {
    std::vector<Complex> x;
    for (int32_t i = 0; i < n; ++i) x.push_back({1.0 / (1 + i), i * 0.25});
    return x;
}

std::vector<double> Doubles(int32_t n) {
    std::vector<double> x;
    for (Complex z : Complexes(n)) x.push_back(z.re + z.im);
    return x;
}

// A slot that cannot be bound leaves the outputs alone, so that they are not looked at.
constexpr OnFailure kKept = OnFailure::kOther;

using Simple = int32_t(KrHandle, KrHandle, void**);

int32_t PlaySimple(sweep::Scene& scene, Simple* function, KrHandle x, KrHandle y) {
    void* slot = nullptr;
    return scene.Call(function, x, y, &slot);
}

using Forward2d = int32_t(KrHandle, int32_t, int32_t, int32_t, int32_t, int32_t, KrHandle, void**, void**);

int32_t PlayForward(sweep::Scene& scene, Forward2d* function, KrHandle x) {
    const KrHandle y = scene.OutComplexMatrix(kKept);
    void *columns = nullptr, *rows = nullptr;
    return scene.Call(function, x, 1, 0, 23, 8, 1, y, &columns, &rows);
}

using Inverse2d = int32_t(KrHandle, int32_t, KrHandle, void**, void**);

int32_t PlayInverse(sweep::Scene& scene, Inverse2d* function, KrHandle y) {
    const KrHandle x = scene.ComplexMatrix(5, 6, Complexes(30));
    void *columns = nullptr, *rows = nullptr;
    return scene.Call(function, x, 1, y, &columns, &rows);
}

}  // namespace

SWEEP(create_qmfft_table) {
    return scene.Call([] {
        qmfft_table* table = create_qmfft_table(23 * 53 * 4);
        if (table == nullptr) return krnumer::kOutOfMemory;
        destroy_qmfft_table(table);
        return krnumer::kOk;
    });
}
SWEEP(destroy_qmfft_table) {
    return scene.Call([] {
        destroy_qmfft_table(nullptr);
        return krnumer::kOk;
    });
}

SWEEP(CxQMFFTH) {
    return PlaySimple(scene, CxQMFFTH, scene.Complexes(Complexes(106)), scene.OutComplexes(kKept));
}
SWEEP(InvCxQMFFTH) {
    return PlaySimple(scene, InvCxQMFFTH, scene.Complexes(Complexes(46)), scene.OutComplexes(kKept));
}
SWEEP(ReQMFFTH) {
    return PlaySimple(scene, ReQMFFTH, scene.Doubles(Doubles(106)), scene.OutComplexes(kKept));
}
SWEEP(ReQMFFTHCH) {
    return PlaySimple(scene, ReQMFFTHCH, scene.Doubles(Doubles(46)), scene.OutDoubles());
}
SWEEP(InvReQMFFTH) {
    return PlaySimple(scene, InvReQMFFTH, scene.Complexes(Complexes(53)), scene.OutDoubles(kKept));
}
SWEEP(InvReQMFFTHCH) {
    const KrHandle x = scene.Doubles(Doubles(15));
    return PlaySimple(scene, InvReQMFFTHCH, scene.Replaced(x, kKept), scene.OutDoubles());
}

SWEEP(CxQMFFTH80) {
    const KrHandle x = scene.Complexes(Complexes(9));
    const KrHandle y = scene.OutComplexes(kKept);
    void* slot = nullptr;
    return scene.Call(CxQMFFTH80, x, y, &slot, 2, 12, 1);
}
SWEEP(InvCxQMFFTH80) {
    const KrHandle x = scene.Complexes(Complexes(9));
    const KrHandle y = scene.OutComplexes(kKept);
    void* slot = nullptr;
    return scene.Call(InvCxQMFFTH80, x, y, &slot, 1);
}
SWEEP(ReQMFFTH80) {
    const KrHandle x = scene.Doubles(Doubles(9));
    const KrHandle y = scene.OutComplexes(kKept);
    void* slot = nullptr;
    scene.SurvivesRefusedAllocation();
    return scene.Call(ReQMFFTH80, x, y, &slot, 2, 12, 1);
}
SWEEP(InvReQMFFTH80) {
    const KrHandle x = scene.Complexes(Complexes(10));
    const KrHandle y = scene.OutDoubles(kKept);
    void* slot = nullptr;
    return scene.Call(InvReQMFFTH80, x, y, &slot, 1);
}

SWEEP(CxFFT2D_H) {
    return PlayForward(scene, CxFFT2D_H, scene.ComplexMatrix(5, 6, Complexes(30)));
}
SWEEP(ReFFT2D_H) {
    return PlayForward(scene, ReFFT2D_H, scene.Matrix(5, 6, Doubles(30)));
}
SWEEP(CxInvFFT2D_H) {
    return PlayInverse(scene, CxInvFFT2D_H, scene.OutComplexMatrix(kKept));
}
SWEEP(ReInvFFT2D_H) {
    return PlayInverse(scene, ReInvFFT2D_H, scene.OutMatrix(kKept));
}
