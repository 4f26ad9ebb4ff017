#pragma once

namespace krnumer {

// Riemann's zeta function of a real argument; 0 below -30.8148.
double Zeta(double x);

}  // namespace krnumer
