#pragma once

namespace krnumer {

// The Struve function H_v(x).
double Struve(double v, double x);

}  // namespace krnumer
