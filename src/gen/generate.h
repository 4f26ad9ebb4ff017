// The entry points that fill an array with n samples, all alike.
#pragma once

#include "frame/entry.h"

namespace krnumer {

// Sizes the array to *n samples and has core(samples, n) fill it.
template <class Core>
int32_t Generate(KrHandle x, const int32_t* n, int32_t* err, Core core) {
    ByReference call(err);
    Out<double> samples(call, x);
    if (*n < 1) return call.Fail(kEmptyInput);
    if (auto host = samples.Resize(*n)) return call.HostFailure(host);
    return call.Run([&] { return core(samples.data(), *n); });
}

}  // namespace krnumer
