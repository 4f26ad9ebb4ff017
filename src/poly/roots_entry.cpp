#include "frame/entry.h"
#include "frame/scratch.h"
#include "krnumer/polynomial.h"
#include "poly/madsen_roots.h"

using namespace krnumer;

int32_t CxPolyRoots_head(KrHandle coef, const int32_t* limit, int32_t* err) {
    ByReference call(err);
    InOut<Complex> polynomial(call, coef);
    const int32_t n = polynomial.size();
    Scratch<Complex> roots(Count(n), Scratch<Complex>::kZeroed);
    int32_t count = 0;
    int32_t status = roots ? call.Map() : kOutOfMemory;
    if (status == kOk) status = MadsenRoots(polynomial.data(), n, *limit, roots.data(), &count);
    if (status != kOk) return call.Fail(status);
    if (polynomial.Resize(n - 1)) return call.Fail(kOutOfMemory);
    polynomial.Fill(roots.data());
    return call.Leave(kOk);
}
