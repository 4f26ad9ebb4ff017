#include "krnumer/linalg_svd.h"

#include "sweep/sweep.h"

SWEEP(SVD_head) {
    const KrHandle a = scene.Replaced(scene.Matrix(2, 3, {1, 2, 3, 4, 5, 7}));
    const KrHandle s = scene.OutDoubles();
    const KrHandle v = scene.OutMatrix();
    return scene.Call(SVD_head, a, s, v, scene.err());
}

SWEEP(CxSVD_head) {
    const KrHandle a = scene.Replaced(scene.ComplexMatrix(3, 2, {{1, 1}, {2, 0}, {3, -1}, {4, 2}, {5, 0}, {7, 1}}));
    const KrHandle s = scene.OutComplexes();
    const KrHandle v = scene.OutComplexMatrix();
    return scene.Call(CxSVD_head, a, s, v, scene.err());
}

SWEEP(SVDEx_head) {
    const KrHandle a = scene.Matrix(3, 2, {1, 2, 3, 4, 5, 7});
    const KrHandle u = scene.OutMatrix();
    const KrHandle s = scene.OutDoubles();
    const KrHandle v = scene.OutMatrix();
    return scene.Call(SVDEx_head, a, 1, u, s, v);
}

SWEEP(CxSVDEx_head) {
    const KrHandle a = scene.ComplexMatrix(2, 3, {{1, 1}, {2, 0}, {3, -1}, {4, 2}, {5, 0}, {7, 1}});
    const KrHandle u = scene.OutComplexMatrix();
    const KrHandle s = scene.OutDoubles();
    const KrHandle v = scene.OutComplexMatrix();
    return scene.Call(CxSVDEx_head, a, 1, u, s, v);
}

SWEEP(SVDS_head) {
    const KrHandle a = scene.Matrix(2, 3, {1, 2, 3, 4, 5, 7});
    const KrHandle s = scene.OutDoubles();
    return scene.Call(SVDS_head, a, s, scene.err());
}

SWEEP(CxSVDS_head) {
    const KrHandle a = scene.ComplexMatrix(2, 3, {{1, 1}, {2, 0}, {3, -1}, {4, 2}, {5, 0}, {7, 1}});
    const KrHandle s = scene.OutDoubles();
    return scene.Call(CxSVDS_head, a, s, scene.err());
}
