#include "krnumer/anova.h"

#include "sweep/sweep.h"

namespace {

const std::vector<double> kObservations{1, 3, 2, 5, 4, 4, 7, 9, 6, 2, 1, 8, 3, 5, 5, 2};
const std::vector<int32_t> kA{0, 0, 0, 0, 0, 0, 0, 0, 1, 1, 1, 1, 1, 1, 1, 1};
const std::vector<int32_t> kB{0, 0, 0, 0, 1, 1, 1, 1, 0, 0, 0, 0, 1, 1, 1, 1};
const std::vector<int32_t> kC{0, 0, 1, 1, 0, 0, 1, 1, 0, 0, 1, 1, 0, 0, 1, 1};
constexpr int32_t kLevels = 2;

}  // namespace

SWEEP(Anova1Way_head) {
    const KrHandle y = scene.Doubles(kObservations);
    const KrHandle a = scene.Integers(kA);
    double* s[7];
    for (double*& scalar : s) scalar = scene.Number();
    return scene.Call(Anova1Way_head, y, a, &kLevels, s[0], s[1], s[2], s[3], s[4], s[5], s[6], scene.err());
}

SWEEP(Anova2Way_head) {
    const KrHandle y = scene.Doubles(kObservations);
    const KrHandle a = scene.Integers(kA);
    const KrHandle b = scene.Integers(kB);
    const KrHandle table = scene.OutMatrix();
    double* p[3];
    for (double*& scalar : p) scalar = scene.Number();
    const int32_t r = 4;
    return scene.Call(Anova2Way_head, y, a, b, &r, &kLevels, &kLevels, table, p[0], p[1], p[2], scene.err());
}

SWEEP(ANOVA3Way_head) {
    const KrHandle y = scene.Doubles(kObservations);
    const KrHandle a = scene.Integers(kA);
    const KrHandle b = scene.Integers(kB);
    const KrHandle c = scene.Integers(kC);
    const KrHandle table = scene.OutMatrix();
    double* p[7];
    for (double*& scalar : p) scalar = scene.Number();
    const int32_t r = 2;
    return scene.Call(ANOVA3Way_head, y, a, b, c, &r, &kLevels, &kLevels, &kLevels, table, p[0], p[1], p[2], p[3], p[4],
                      p[5], p[6], scene.err());
}

SWEEP(Contingency_head) {
    const KrHandle counts = scene.IntegerMatrix(2, 3, {10, 20, 30, 6, 9, 17});
    double* chi_square = scene.Number();
    double* p = scene.Number();
    return scene.Call(Contingency_head, counts, chi_square, p, scene.err());
}
