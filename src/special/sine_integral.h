#pragma once

namespace krnumer {

// The sine integral, of sin(t) / t from 0 to x, and the cosine integral, of cos(t) / t from infinity to |x|. Either
// pointer may be null.
void SiCi(double x, double* si, double* ci);

}  // namespace krnumer
