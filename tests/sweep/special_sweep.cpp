// Special functions have no arrays and no status: their scenes only show that they are called and repeat.
#include "krnumer/special.h"

#include "sweep/sweep.h"

namespace {

template <class... Parameters, class... Arguments>
int32_t Plain(sweep::Scene& scene, void (*function)(Parameters...), Arguments... arguments) {
    double* const out = scene.Number();
    return scene.Call(function, arguments..., out);
}

}  // namespace

SWEEP(KR_Gamma) {
    return Plain(scene, KR_Gamma, 2.5, 1.0);
}
SWEEP(KR_GammaC) {
    return Plain(scene, KR_GammaC, 2.5, 6.0);
}
SWEEP(KR_LnGamma) {
    return Plain(scene, KR_LnGamma, 40.0);
}
SWEEP(KR_Beta) {
    return Plain(scene, KR_Beta, 2.0, 3.0, 0.4);
}
SWEEP(KR_Fact) {
    return Plain(scene, KR_Fact, 40);
}
SWEEP(KR_LnFact) {
    return Plain(scene, KR_LnFact, 40);
}
SWEEP(KR_Psi) {
    return Plain(scene, KR_Psi, -1.3);
}
SWEEP(KR_Stirling) {
    return Plain(scene, KR_Stirling, 40.0);
}

SWEEP(KR_Erf) {
    return Plain(scene, KR_Erf, 0.5);
}
SWEEP(KR_ErfC) {
    return Plain(scene, KR_ErfC, 2.0);
}
SWEEP(KR_Dawson) {
    return Plain(scene, KR_Dawson, 5.0);
}
SWEEP(KR_FresnelIntegrals) {
    double* const values = scene.Numbers(2);
    return scene.Call(KR_FresnelIntegrals, 3.0, values, values + 1);
}
SWEEP(KR_ExpI) {
    return Plain(scene, KR_ExpI, 0.5, 3);
}
SWEEP(KR_CosI) {
    return Plain(scene, KR_CosI, 6.0);
}
SWEEP(KR_SinI) {
    return Plain(scene, KR_SinI, 6.0);
}
SWEEP(KR_CoshI) {
    return Plain(scene, KR_CoshI, 10.0);
}
SWEEP(KR_SinhI) {
    return Plain(scene, KR_SinhI, 10.0);
}

SWEEP(KR_Elliptic1) {
    return Plain(scene, KR_Elliptic1, 0.5, 1.0);
}
SWEEP(KR_Elliptic2) {
    return Plain(scene, KR_Elliptic2, 0.5, 1.0);
}
SWEEP(KR_EllipticJ) {
    double* const values = scene.Numbers(4);
    return scene.Call(KR_EllipticJ, 1.5, 0.6, values, values + 1, values + 2, values + 3);
}
SWEEP(KR_Gauss) {
    return Plain(scene, KR_Gauss, 0.95, 1.3, 0.7, 2.6);
}
SWEEP(KR_Kummer) {
    return Plain(scene, KR_Kummer, 3.0, 1.5, 2.5);
}
SWEEP(KR_Tricomi) {
    return Plain(scene, KR_Tricomi, 2.0, 0.7, 1.3);
}
SWEEP(KR_Diln) {
    return Plain(scene, KR_Diln, 1.7);
}
SWEEP(KR_ParabolicCylinder) {
    return Plain(scene, KR_ParabolicCylinder, 1.0, 0.5);
}
SWEEP(KR_Zeta) {
    return Plain(scene, KR_Zeta, 3.5);
}

SWEEP(KR_BesselJr) {
    return Plain(scene, KR_BesselJr, 2.25, 30.0);
}
SWEEP(KR_BesselYr) {
    return Plain(scene, KR_BesselYr, 0.25, 3.0);
}
SWEEP(KR_BesselJs) {
    return Plain(scene, KR_BesselJs, 3, 2.0);
}
SWEEP(KR_BesselYs) {
    return Plain(scene, KR_BesselYs, 3, 2.0);
}
SWEEP(KR_BesselIr) {
    return Plain(scene, KR_BesselIr, 2.7, 3.0);
}
SWEEP(KR_BesselKn) {
    return Plain(scene, KR_BesselKn, 4, 2.0);
}
SWEEP(KR_KelvinI) {
    double* const values = scene.Numbers(2);
    return scene.Call(KR_KelvinI, 2.0, 3, values, values + 1);
}
SWEEP(KR_KelvinK) {
    double* const values = scene.Numbers(2);
    return scene.Call(KR_KelvinK, 2.0, 3, values, values + 1);
}
SWEEP(KR_Airy) {
    double* const values = scene.Numbers(4);
    return scene.Call(KR_Airy, 5.0, values, values + 1, values + 2, values + 3);
}
SWEEP(KR_Struve) {
    return Plain(scene, KR_Struve, 25.0, 0.0);
}
