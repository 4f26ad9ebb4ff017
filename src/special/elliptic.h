// Elliptic integrals of the first and second kind, by the parameter m = k^2 in 0 to 1.
#pragma once

namespace krnumer {

// Complete: K(m) and E(m).
double EllipticK(double m);
double EllipticE(double m);

// Incomplete: F(phi | m) and E(phi | m), the integrals of 1 / sqrt(1 - m sin^2) and of sqrt(1 - m sin^2) from 0 to phi.
double EllipticF(double phi, double m);
double EllipticE(double phi, double m);

}  // namespace krnumer
