#include "frame/entry.h"
#include "frame/scratch.h"
#include "krnumer/polynomial.h"
#include "poly/madsen_roots.h"
#include "poly/multiple_roots.h"

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

namespace {

template <class T>
int32_t RootsAndMultiplicities(KrHandle coef, int32_t distinct, double tol, KrHandle roots, KrHandle distinct_roots,
                               KrHandle mult) {
    ByValue call;
    InOut<T> polynomial(call, coef);  // an input, but emptied by a failure
    Out<Complex> found(call, roots);
    Out<Complex> refined(call, distinct_roots);
    Out<int32_t> multiplicities(call, mult);
    RootList found_list;
    RootList refined_list;
    const bool refine = distinct != 0;
    int32_t status = call.Map();
    if (status == kOk)
        status = MultipleRoots(polynomial.data(), polynomial.size(), refine, tol, &found_list, &refined_list);
    if (status != kOk) return call.Fail(status);
    const RootList& counted = refine ? refined_list : found_list;
    if (found.Resize(found_list.count) || refined.Resize(refined_list.count) || multiplicities.Resize(counted.count))
        return call.Fail(kOutOfMemory);
    found.Fill(found_list.roots.data());
    refined.Fill(refined_list.roots.data());
    multiplicities.Fill(counted.multiplicities.data());
    return call.Leave(kOk);
}

}  // namespace

int32_t MultPolyRoots_head(KrHandle coef, int32_t distinct, double tol, KrHandle roots, KrHandle distinctRoots,
                           KrHandle mult) {
    return RootsAndMultiplicities<double>(coef, distinct, tol, roots, distinctRoots, mult);
}
int32_t CxMultPolyRoots_head(KrHandle coef, int32_t distinct, double tol, KrHandle roots, KrHandle distinctRoots,
                             KrHandle mult) {
    return RootsAndMultiplicities<Complex>(coef, distinct, tol, roots, distinctRoots, mult);
}
