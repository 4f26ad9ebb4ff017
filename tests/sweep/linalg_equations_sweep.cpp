#include "krnumer/linalg_equations.h"

#include "linalg/element.h"
#include "sweep/sweep.h"

namespace {

using krnumer::Complex;

template <class T>
KrHandle Square(sweep::Scene& scene) {
    if constexpr (krnumer::kIsComplex<T>) {
        return scene.ComplexMatrix(2, 2, {{1, 1}, {2, 0}, {0, 0}, {4, -1}});
    } else {
        return scene.Matrix(2, 2, {1, 2, 0, 4});
    }
}

// A matrix that shares an eigenvalue with the negative of the one above: the equation is singular.
template <class T>
KrHandle Opposite(sweep::Scene& scene) {
    if constexpr (krnumer::kIsComplex<T>) {
        return scene.ComplexMatrix(2, 2, {{-1, -1}, {1, 0}, {0, 0}, {3, 0}});
    } else {
        return scene.Matrix(2, 2, {-1, 1, 0, 3});
    }
}

template <class T>
KrHandle RightSide(sweep::Scene& scene) {
    if constexpr (krnumer::kIsComplex<T>) {
        return scene.Replaced(scene.ComplexMatrix(2, 2, {{1, 0}, {2, 1}, {3, 0}, {0, -4}}));
    } else {
        return scene.Replaced(scene.Matrix(2, 2, {1, 2, 3, -4}));
    }
}

template <class T, class Function>
int32_t PlayLyapunov(sweep::Scene& scene, Function function) {
    const KrHandle a = Square<T>(scene);
    const KrHandle q = RightSide<T>(scene);
    double* scale = scene.Number(sweep::OnFailure::kOther);
    return scene.Call(function, a, q, 0, scale);
}

template <class T, class Function, class... Form>
int32_t PlaySylvester(sweep::Scene& scene, KrHandle b, Function function, Form... form) {
    const KrHandle a = Square<T>(scene);
    const KrHandle c = RightSide<T>(scene);
    double* scale = scene.Number(sweep::OnFailure::kOther);
    int32_t* singular = scene.Integer(-1);
    return scene.Call(function, a, b, c, 0, 0, 1, form..., scale, singular);
}

}  // namespace

SWEEP(Lyapunov_head) {
    return PlayLyapunov<double>(scene, Lyapunov_head);
}
SWEEP(CxLyapunov_head) {
    return PlayLyapunov<Complex>(scene, CxLyapunov_head);
}
SWEEP(Sylvester_head) {
    return PlaySylvester<double>(scene, Square<double>(scene), Sylvester_head);
}
SWEEP(CxSylvester_head) {
    return PlaySylvester<Complex>(scene, Square<Complex>(scene), CxSylvester_head);
}
SWEEP(Sylvester81_head) {
    return PlaySylvester<double>(scene, Square<double>(scene), Sylvester81_head, 0);
}
SWEEP(CxSylvester81_head) {
    return PlaySylvester<Complex>(scene, Square<Complex>(scene), CxSylvester81_head, 0);
}

// Without memory for the whole equation, its columns are solved one after the other.
SWEEP_MORE(Sylvester81_head, singular) {
    scene.SurvivesRefusedAllocation();
    return PlaySylvester<double>(scene, Opposite<double>(scene), Sylvester81_head, 0);
}
SWEEP_MORE(CxSylvester81_head, singular) {
    scene.SurvivesRefusedAllocation();
    return PlaySylvester<Complex>(scene, Opposite<Complex>(scene), CxSylvester81_head, 0);
}
