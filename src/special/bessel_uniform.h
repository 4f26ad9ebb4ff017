#pragma once

namespace krnumer {

// J_v(x) for v from 200 on by expansions that are uniform in x. NaN where the Airy functions in them overflow, for x
// far below v.
double BesselJUniform(double v, double x);

}  // namespace krnumer
