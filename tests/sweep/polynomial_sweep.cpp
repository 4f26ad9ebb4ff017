#include "krnumer/polynomial.h"

#include "sweep/sweep.h"

SWEEP(PolyEv) {
    const KrHandle x = scene.Replaced(scene.Doubles({1, 2, 3}));
    const KrHandle coef = scene.Doubles({1, -2, 0.5});
    return scene.Call(PolyEv, x, coef, scene.err());
}

SWEEP(EvPoly2D) {
    const KrHandle x = scene.Replaced(scene.Matrix(2, 2, {1, 2, 3, 4}));
    const KrHandle coef = scene.Doubles({1, -2, 0.5});
    return scene.Call(EvPoly2D, x, coef, scene.err());
}

SWEEP(PolyRootsNtBst_head) {
    const KrHandle coef = scene.Doubles({-24, 26, -15, 6, -1, 0.1});
    const KrHandle guesses = scene.Doubles({1.5});
    const KrHandle pairs = scene.Complexes({{1, 1}, {1, -1}, {2, 0}});
    const KrHandle roots = scene.OutComplexes();
    return scene.Call(PolyRootsNtBst_head, coef, guesses, 20, 1e-12, pairs, 20, 1e-12, roots);
}

SWEEP(CxPolyRoots_head) {
    const KrHandle coef = scene.Replaced(scene.Complexes({{0, 0}, {24, 2}, {-50, 1}, {35, 0}, {-10, -3}, {1, 0}}));
    const int32_t limit = 20;
    return scene.Call(CxPolyRoots_head, coef, &limit, scene.err());
}

SWEEP(MultPolyRoots_head) {
    const KrHandle coef = scene.Replaced(scene.Doubles({0, 12, -28, 23, -8, 1}));
    const KrHandle roots = scene.OutComplexes();
    const KrHandle distinct = scene.OutComplexes();
    const KrHandle mult = scene.OutIntegers();
    return scene.Call(MultPolyRoots_head, coef, 1, -1.0, roots, distinct, mult);
}

SWEEP(MultPolyRoots_head_first_stage) {
    const KrHandle coef = scene.Replaced(scene.Doubles({0, 12, -28, 23, -8, 1}));
    const KrHandle roots = scene.OutComplexes();
    const KrHandle distinct = scene.OutComplexes();
    const KrHandle mult = scene.OutIntegers();
    return scene.Call(MultPolyRoots_head, coef, 0, -1.0, roots, distinct, mult);
}

SWEEP(CxMultPolyRoots_head) {
    const KrHandle coef = scene.Replaced(scene.Complexes({{0, 0}, {0, 3}, {2, 4}, {2, -1}, {0, -2}, {1, 0}}));
    const KrHandle roots = scene.OutComplexes();
    const KrHandle distinct = scene.OutComplexes();
    const KrHandle mult = scene.OutIntegers();
    return scene.Call(CxMultPolyRoots_head, coef, 1, -1.0, roots, distinct, mult);
}

SWEEP(PolyGCD_H) {
    const KrHandle p = scene.Doubles({0, -6, 1, 1});
    const KrHandle q = scene.Doubles({0, -2, -1, 1});
    const KrHandle gcd = scene.OutDoubles();
    const KrHandle u = scene.OutDoubles();
    const KrHandle v = scene.OutDoubles();
    return scene.Call(PolyGCD_H, p, q, -1.0, gcd, u, v, 1);
}

SWEEP(CxPolyGCD_H) {
    const KrHandle p = scene.Complexes({{0, 2}, {-2, -1}, {1, 0}});
    const KrHandle q = scene.Complexes({{0, 3}, {-3, -1}, {1, 0}});
    const KrHandle gcd = scene.OutComplexes();
    const KrHandle u = scene.OutComplexes();
    const KrHandle v = scene.OutComplexes();
    return scene.Call(CxPolyGCD_H, p, q, -1.0, gcd, u, v, 1);
}
