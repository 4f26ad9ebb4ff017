// Calls of the special functions' exports, whose results come through pointers.
#pragma once

#include "frame/numeric.h"

namespace krnumer {

// What an output holds that nobody wrote to.
inline constexpr double kUntouched = -8.765432101e-99;

// The result of an export with one output: Value(KR_Psi, 0.5).
template <class... Parameters, class... Arguments>
double Value(void (*function)(Parameters...), Arguments... arguments) {
    double out = kUntouched;
    function(arguments..., &out);
    return out;
}

}  // namespace krnumer
