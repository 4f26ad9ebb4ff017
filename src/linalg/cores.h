// The cores of linear algebra that other families call. Matrices are dense and row-major, sizes int32, the result is
// a status. Each core is one template over the element; its complex form also goes by a name of its own.
#pragma once

#include "linalg/band.h"
#include "linalg/cholesky.h"
#include "linalg/cholesky_solve.h"
#include "linalg/eigen_general.h"
#include "linalg/eigen_polynomial.h"
#include "linalg/eigen_symmetric.h"
#include "linalg/finite.h"
#include "linalg/lu.h"
#include "linalg/lu_solve.h"
#include "linalg/measures.h"
#include "linalg/packed.h"
#include "linalg/products.h"
#include "linalg/qr.h"
#include "linalg/special_matrix.h"
#include "linalg/svd.h"
#include "linalg/svd_solve.h"
#include "linalg/transpose.h"
#include "linalg/triangular.h"

namespace krnumer {

inline constexpr auto& CxMatMulCore = MatMulCore<Complex>;
inline constexpr auto& CxMatVecCore = MatVecCore<Complex>;
inline constexpr auto& CxDotCore = DotCore<Complex>;
inline constexpr auto& CxTransposeCore = TransposeCore<Complex>;
inline constexpr auto& CxConjTransposeCore = ConjTransposeCore<Complex>;
inline constexpr auto& CxPackTriangle = PackTriangle<Complex>;
inline constexpr auto& CxUnpackTriangle = UnpackTriangle<Complex>;
inline constexpr auto& CxMakeSpecialMatrix = MakeSpecialMatrix<Complex>;
inline constexpr auto& CxSvdCore = SvdCore<Complex>;
inline constexpr auto& CxSvdValuesCore = SvdValuesCore<Complex>;
inline constexpr auto& CxNormCore = NormCore<Complex>;

inline constexpr int32_t (&CxLUFactor)(Complex*, int32_t, int32_t*, int32_t*) = LUFactor;
inline constexpr int32_t (&CxCholeskyPacked)(Complex*, int32_t) = CholeskyPacked;
inline constexpr auto& CxQRHouseholder = QRHouseholder<Complex>;
inline constexpr auto& CxQRPivoted = QRPivoted<Complex>;

inline constexpr auto& CxSvdSolve = SvdSolve<Complex>;
inline constexpr auto& CxPseudoInverseCore = PseudoInverseCore<Complex>;
inline constexpr auto& CxLUSolve = LUSolve<Complex>;
inline constexpr auto& CxLUSolveDirect = LUSolveDirect<Complex>;
inline constexpr auto& CxLUInverse = LUInverse<Complex>;
inline constexpr auto& CxCholeskySolveFull = CholeskySolveFull<Complex>;
inline constexpr auto& CxTriangularSolvePacked = TriangularSolvePacked<Complex>;
inline constexpr auto& CxTriangularInversePacked = TriangularInversePacked<Complex>;

}  // namespace krnumer
