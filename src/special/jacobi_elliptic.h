#pragma once

namespace krnumer {

struct JacobiElliptic {
    double sn, cn, dn;
    double phi;  // the amplitude
};

// The Jacobian elliptic functions of u for the parameter m = k^2 in 0 to 1; all 0 for m outside.
JacobiElliptic JacobiEllipticFunctions(double u, double m);

}  // namespace krnumer
