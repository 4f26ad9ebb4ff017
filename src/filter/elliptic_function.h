// Elliptic integrals and functions as the elliptic filter needs them: real, and told their modulus by the
// complementary one, which is what the arithmetic-geometric mean starts from.
#pragma once

namespace krnumer {

// K(k) for the complementary modulus k' = sqrt(1 - k^2).
double CompleteK(double complementary);

struct JacobiValues {
    double sn, cn, dn;
};

// sn(u), cn(u) and dn(u) for the complementary modulus, with u from 0 to 2 K.
JacobiValues JacobiSnCnDn(double u, double complementary);

// F(arctan x) for the complementary modulus.
double IncompleteEl1(double x, double complementary);

// The modulus k at which K(k') / K(k) is `ratio`.
double ModulusFromRatio(double ratio);

}  // namespace krnumer
