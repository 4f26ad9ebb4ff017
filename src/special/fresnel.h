#pragma once

namespace krnumer {

// The Fresnel integrals of cos(pi t^2 / 2) and sin(pi t^2 / 2) from 0 to x. Either pointer may be null.
void FresnelIntegrals(double x, double* c, double* s);

}  // namespace krnumer
