// How the special functions tell of arguments outside their domain: by their value, and by passing one place.
#pragma once

#include "frame/numeric.h"

namespace krnumer {

// Every domain error passes here with the value that tells of it, NaN or an infinity or a limit. Returns that value and
// does nothing else: a place for a debugger or a tracer to wait at.
double DomainError(double value);

// +1 for +infinity, -1 for -infinity, 0 for all other values.
constexpr int IsInfSign(double x) {
    return x == kInfinity ? 1 : x == -kInfinity ? -1 : 0;
}

}  // namespace krnumer
