// Hypergeometric functions of Gauss, Kummer and Tricomi.
#pragma once

namespace krnumer {

// 2F1(a, b; c; x).
double Hypergeometric2F1(double a, double b, double c, double x);

// M(a, b, x) = 1F1(a; b; x).
double KummerM(double a, double b, double x);

// U(a, b, x), for x > 0.
double TricomiU(double a, double b, double x);

}  // namespace krnumer
