#include "krnumer/window.h"

#include <vector>

#include "sweep/sweep.h"

namespace {

const std::vector<double> kReal{1, 2, 3, 4, 5, 6, 7};
const std::vector<krnumer::Complex> kComplex{{1, -1}, {2, 0}, {3, 1}, {4, 4}, {5, -2}, {6, 0}};

// A window applied to real or complex samples, whatever its further arguments.
template <class Window, class... Parameters>
int32_t PlayReal(sweep::Scene& scene, Window window, Parameters... parameters) {
    const KrHandle x = scene.Replaced(scene.Doubles(kReal));
    return scene.Call(window, x, parameters...);
}

template <class Window, class... Parameters>
int32_t PlayComplex(sweep::Scene& scene, Window window, Parameters... parameters) {
    const KrHandle x = scene.Replaced(scene.Complexes(kComplex));
    return scene.Call(window, x, parameters...);
}

}  // namespace

SWEEP(AllCosWinH) {
    return PlayReal(scene, AllCosWinH, 7, 1);
}
SWEEP(CxAllCosWinH) {
    return PlayComplex(scene, CxAllCosWinH, 7, 1);
}
SWEEP(GenCosWinH) {
    return PlayReal(scene, GenCosWinH, scene.Doubles({0.4, 0.5, 0.1}));
}
SWEEP(CxGenCosWinH) {
    return PlayComplex(scene, CxGenCosWinH, scene.Doubles({0.4, 0.5, 0.1}));
}
SWEEP(ScaledGenCosWinH) {
    return PlayReal(scene, ScaledGenCosWinH, scene.Doubles({0.4, 0.5, 0.1}));
}
SWEEP(ScaledCxGenCosWinH) {
    return PlayComplex(scene, ScaledCxGenCosWinH, scene.Doubles({0.4, 0.5, 0.1}));
}
SWEEP(BartHannWinH) {
    return PlayReal(scene, BartHannWinH);
}
SWEEP(CxBartHannWinH) {
    return PlayComplex(scene, CxBartHannWinH);
}
SWEEP(BohmanWinH) {
    return PlayReal(scene, BohmanWinH);
}
SWEEP(CxBohmanWinH) {
    return PlayComplex(scene, CxBohmanWinH);
}
SWEEP(ParzenWinH) {
    return PlayReal(scene, ParzenWinH);
}
SWEEP(CxParzenWinH) {
    return PlayComplex(scene, CxParzenWinH);
}
SWEEP(WelchWinH) {
    return PlayReal(scene, WelchWinH);
}
SWEEP(CxWelchWinH) {
    return PlayComplex(scene, CxWelchWinH);
}
SWEEP(TriangleWinH) {
    return PlayReal(scene, TriangleWinH);
}
SWEEP(CxTriangleWinH) {
    return PlayComplex(scene, CxTriangleWinH);
}
SWEEP(CosTaperedH) {
    return PlayReal(scene, CosTaperedH, 0.7);
}
SWEEP(CxCosTaperedH) {
    return PlayComplex(scene, CxCosTaperedH, 0.7);
}
SWEEP(ExpWinH) {
    return PlayReal(scene, ExpWinH, 0.1);
}
SWEEP(CxExpWinH) {
    return PlayComplex(scene, CxExpWinH, 0.1);
}
SWEEP(ForceWinH) {
    return PlayReal(scene, ForceWinH, 60.0);
}
SWEEP(CxForceWinH) {
    return PlayComplex(scene, CxForceWinH, 60.0);
}
SWEEP(KaiserH) {
    return PlayReal(scene, KaiserH, 5.0);
}
SWEEP(CxKaiserH) {
    return PlayComplex(scene, CxKaiserH, 5.0);
}
SWEEP(GaussWinH) {
    return PlayReal(scene, GaussWinH, 0.2, 0);
}
SWEEP(CxGaussWinH) {
    return PlayComplex(scene, CxGaussWinH, 0.2, 0);
}
SWEEP(DolChebyWinH) {
    return PlayReal(scene, DolChebyWinH, 100.0, 0);
}
SWEEP(CxDolChebyWinH) {
    return PlayComplex(scene, CxDolChebyWinH, 100.0, 0);
}

SWEEP(TriangleWin) {
    return PlayReal(scene, TriangleWin, scene.err());
}
SWEEP(CosTapered) {
    return PlayReal(scene, CosTapered, scene.err());
}

SWEEP(ExpWindCIN) {
    const double final_value = 0.1;
    return PlayReal(scene, ExpWindCIN, &final_value, scene.err());
}
SWEEP(ForceWindCIN) {
    const double duty = 60.0;
    return PlayReal(scene, ForceWindCIN, &duty, scene.err());
}
SWEEP(Kaiser_Bessel) {
    const double beta = 5.0;
    return PlayReal(scene, Kaiser_Bessel, &beta, scene.err());
}

namespace {

// No memory for the weights leaves the record as it came.
KrWindowConstants* Constants(sweep::Scene& scene) {
    return reinterpret_cast<KrWindowConstants*>(scene.Numbers(2, sweep::OnFailure::kOther));
}

}  // namespace

SWEEP(NumWinConstH) {
    const KrHandle x = scene.Doubles(kReal);
    auto* constants = reinterpret_cast<KrWindowConstants*>(scene.Numbers(2));
    return scene.Call(NumWinConstH, x, constants);
}

SWEEP(ScaledWinH) {
    return PlayReal(scene, ScaledWinH, 1, 0.0, Constants(scene));
}
SWEEP_MORE(ScaledWinH, measured) {
    return PlayReal(scene, ScaledWinH, 60, 5.0, Constants(scene));
}
SWEEP(CxScaledWinH) {
    return PlayComplex(scene, CxScaledWinH, 1, 0.0, Constants(scene));
}
SWEEP_MORE(CxScaledWinH, measured) {
    return PlayComplex(scene, CxScaledWinH, 61, 100.0, Constants(scene));
}
SWEEP(SymmWinH) {
    return PlayReal(scene, SymmWinH, 32, 0.0);
}
SWEEP(CxSymmWinH) {
    return PlayComplex(scene, CxSymmWinH, 62, 0.3);
}
