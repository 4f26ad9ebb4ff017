#pragma once

namespace krnumer {

// Whittaker's parabolic cylinder function D_v(x).
double ParabolicCylinder(double v, double x);

}  // namespace krnumer
