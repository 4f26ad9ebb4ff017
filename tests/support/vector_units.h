// The same code on every vector unit that it was compiled for and that this machine has.
#pragma once

#include <gtest/gtest.h>
#include <hwy/targets.h>

namespace krnumer {

// Calls `body` once for each of them. Only the cores that are linked into the test program follow; the shared library
// has made its own choice.
template <class Body>
void OnEveryVectorUnit(Body body) {
    for (const int64_t unit : hwy::SupportedAndGeneratedTargets()) {
        hwy::SetSupportedTargetsForTest(unit);
        SCOPED_TRACE(hwy::TargetName(unit));
        body();
    }
    hwy::SetSupportedTargetsForTest(0);
}

}  // namespace krnumer
