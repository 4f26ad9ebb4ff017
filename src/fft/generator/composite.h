// Short transforms of composite size, and the choice among all sizes.
#pragma once

#include <span>

#include "fft/generator/program.h"

namespace krnumer::generator {

// Transform of x.size() points: any prime, 4, 8, 9, 10, 14, 16, 18 or 32.
Spectrum ShortTransform(Program& program, std::span<const Term> x);

}  // namespace krnumer::generator
