#pragma once

namespace krnumer {

// Dawson's integral: e^(-x^2) times the integral of e^(t^2) from 0 to x.
double Dawson(double x);

}  // namespace krnumer
