#include "special/domain.h"

namespace krnumer {

// Not inline, so that a tracer finds it.
double DomainError(double value) {
    return value;
}

}  // namespace krnumer
