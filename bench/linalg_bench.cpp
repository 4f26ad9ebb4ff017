// Factorisations, solutions and inverses beside GSL and the LAPACK of OpenBLAS, all on the same matrices in one run.
#include <benchmark/benchmark.h>

#include <algorithm>
#include <cstdlib>
#include <random>
#include <string>
#include <vector>

#include "linalg/cores.h"
#include "linalg/element.h"

#ifdef KRNUMER_HAVE_GSL
#include <gsl/gsl_linalg.h>
#endif

extern "C" {
void dgetrf_(const int* m, const int* n, double* a, const int* lda, int* ipiv, int* info);
void zgetrf_(const int* m, const int* n, krnumer::Complex* a, const int* lda, int* ipiv, int* info);
void dgetri_(const int* n, double* a, const int* lda, const int* ipiv, double* work, const int* lwork, int* info);
void dpotrf_(const char* uplo, const int* n, double* a, const int* lda, int* info, std::size_t);
void zpotrf_(const char* uplo, const int* n, krnumer::Complex* a, const int* lda, int* info, std::size_t);
void dgesv_(const int* n, const int* nrhs, double* a, const int* lda, int* ipiv, double* b, const int* ldb, int* info);
void dposv_(const char* uplo, const int* n, const int* nrhs, double* a, const int* lda, double* b, const int* ldb,
            int* info, std::size_t);
void dgeqrf_(const int* m, const int* n, double* a, const int* lda, double* tau, double* work, const int* lwork,
             int* info);
}

namespace krnumer {
namespace {

constexpr int kOne = 1;

template <class T>
std::vector<T> RandomMatrix(int n) {
    std::mt19937_64 bits(1);
    std::uniform_real_distribution<double> uniform(-1.0, 1.0);
    std::vector<T> a(Count(n) * Count(n));
    for (T& element : a) {
        if constexpr (kIsComplex<T>) {
            element = {uniform(bits), uniform(bits)};
        } else {
            element = uniform(bits);
        }
    }
    return a;
}

// Diagonally dominant, with elements that fall off from the diagonal.
template <class T>
std::vector<T> DefiniteMatrix(int n) {
    std::vector<T> a(Count(n) * Count(n));
    for (int i = 0; i < n; ++i)
        for (int j = 0; j < n; ++j)
            a[Count(i) * Count(n) + Count(j)] = FromReal<T>((i == j ? n : 0.0) + 0.5 / (1 + std::abs(i - j)));
    return a;
}

template <class T>
std::vector<T> Packed(const std::vector<T>& a, int n) {
    std::vector<T> packed(PackedCount(n));
    PackTriangle(a.data(), n, kLower, packed.data());
    return packed;
}

// Times run(matrix, n, pivots) together with the copying of the matrix that it uses up, which is the same for all.
template <class T, class Run>
void Register(const std::string& name, std::vector<T> (*make)(int), Run run) {
    auto* const benchmark = benchmark::RegisterBenchmark(name.c_str(), [=](benchmark::State& state) {
        const int n = static_cast<int>(state.range(0));
        const std::vector<T> a = make(n);
        std::vector<T> matrix(a.size());
        std::vector<int> pivots(Count(n));
        for (auto _ : state) {
            std::copy(a.begin(), a.end(), matrix.begin());
            run(matrix.data(), n, pivots.data());
            benchmark::DoNotOptimize(matrix.data());
            benchmark::ClobberMemory();
        }
    });
    for (const int n : {3, 10, 50, 200, 500}) benchmark->ArgName("n")->Arg(n);
}

template <class T>
std::vector<T> PackedDefiniteMatrix(int n) {
    return Packed(DefiniteMatrix<T>(n), n);
}

std::vector<double> RightSide(int n) {
    return std::vector<double>(Count(n), 1.0);
}

#ifdef KRNUMER_HAVE_GSL
// GSL's matrices are views, its permutations are not.
class GslPermutation {
  public:
    explicit GslPermutation(int n) : permutation_(gsl_permutation_alloc(Count(n))) {}
    GslPermutation(const GslPermutation&) = delete;
    GslPermutation& operator=(const GslPermutation&) = delete;
    ~GslPermutation() { gsl_permutation_free(permutation_); }
    operator gsl_permutation*() const { return permutation_; }

  private:
    gsl_permutation* permutation_;
};
#endif

void RegisterFactorisations() {
    Register("LU/krnumer", RandomMatrix<double>, [](double* a, int n, int* pivots) {
        int parity;
        LUFactor(a, n, pivots, &parity);
    });
    Register("LU/LAPACK", RandomMatrix<double>, [](double* a, int n, int* pivots) {
        int info;
        dgetrf_(&n, &n, a, &n, pivots, &info);
    });
    Register("complex LU/krnumer", RandomMatrix<Complex>, [](Complex* a, int n, int* pivots) {
        int parity;
        LUFactor(a, n, pivots, &parity);
    });
    Register("complex LU/LAPACK", RandomMatrix<Complex>, [](Complex* a, int n, int* pivots) {
        int info;
        zgetrf_(&n, &n, a, &n, pivots, &info);
    });
    Register("Cholesky/krnumer", PackedDefiniteMatrix<double>, [](double* a, int n, int*) { CholeskyPacked(a, n); });
    Register("Cholesky/LAPACK", DefiniteMatrix<double>, [](double* a, int n, int*) {
        int info;
        dpotrf_("L", &n, a, &n, &info, 1);
    });
    Register("complex Cholesky/krnumer", PackedDefiniteMatrix<Complex>,
             [](Complex* a, int n, int*) { CholeskyPacked(a, n); });
    Register("complex Cholesky/LAPACK", DefiniteMatrix<Complex>, [](Complex* a, int n, int*) {
        int info;
        zpotrf_("L", &n, a, &n, &info, 1);
    });
    // R only, as the peers leave their Q in reflectors.
    Register("QR/krnumer", RandomMatrix<double>,
             [](double* a, int n, int*) { QRHouseholder(a, n, n, kROnly, nullptr, a); });
    Register("QR/LAPACK", RandomMatrix<double>, [](double* a, int n, int*) {
        std::vector<double> tau(Count(n)), work(64 * Count(n));
        const int lwork = 64 * n;
        int info;
        dgeqrf_(&n, &n, a, &n, tau.data(), work.data(), &lwork, &info);
    });
#ifdef KRNUMER_HAVE_GSL
    Register("LU/GSL", RandomMatrix<double>, [](double* a, int n, int*) {
        const GslPermutation permutation(n);
        gsl_matrix_view view = gsl_matrix_view_array(a, Count(n), Count(n));
        int sign;
        gsl_linalg_LU_decomp(&view.matrix, permutation, &sign);
    });
    Register("Cholesky/GSL", DefiniteMatrix<double>, [](double* a, int n, int*) {
        gsl_matrix_view view = gsl_matrix_view_array(a, Count(n), Count(n));
        gsl_linalg_cholesky_decomp1(&view.matrix);
    });
    Register("QR/GSL", RandomMatrix<double>, [](double* a, int n, int*) {
        std::vector<double> tau(Count(n));
        gsl_matrix_view view = gsl_matrix_view_array(a, Count(n), Count(n));
        gsl_vector_view scales = gsl_vector_view_array(tau.data(), Count(n));
        gsl_linalg_QR_decomp(&view.matrix, &scales.vector);
    });
#endif
}

void RegisterSolutions() {
    Register("solution by LU/krnumer", RandomMatrix<double>, [](double* a, int n, int*) {
        std::vector<double> b = RightSide(n), x(Count(n));
        LUSolveDirect(a, n, b.data(), x.data());
        benchmark::DoNotOptimize(x.data());
    });
    Register("solution by LU/LAPACK", RandomMatrix<double>, [](double* a, int n, int* pivots) {
        std::vector<double> b = RightSide(n);
        int info;
        dgesv_(&n, &kOne, a, &n, pivots, b.data(), &n, &info);
        benchmark::DoNotOptimize(b.data());
    });
    Register("solution by Cholesky/krnumer", DefiniteMatrix<double>, [](double* a, int n, int*) {
        std::vector<double> b = RightSide(n), x(Count(n));
        CholeskySolveFull(a, n, kUpper, b.data(), 1, x.data());
        benchmark::DoNotOptimize(x.data());
    });
    Register("solution by Cholesky/LAPACK", DefiniteMatrix<double>, [](double* a, int n, int*) {
        std::vector<double> b = RightSide(n);
        int info;
        dposv_("L", &n, &kOne, a, &n, b.data(), &n, &info, 1);
        benchmark::DoNotOptimize(b.data());
    });
    Register("inverse/krnumer", RandomMatrix<double>, [](double* a, int n, int*) { InvertByLU(a, n); });
    Register("inverse/LAPACK", RandomMatrix<double>, [](double* a, int n, int* pivots) {
        std::vector<double> work(64 * Count(n));
        const int lwork = 64 * n;
        int info;
        dgetrf_(&n, &n, a, &n, pivots, &info);
        dgetri_(&n, a, &n, pivots, work.data(), &lwork, &info);
    });
#ifdef KRNUMER_HAVE_GSL
    Register("solution by LU/GSL", RandomMatrix<double>, [](double* a, int n, int*) {
        std::vector<double> b = RightSide(n);
        const GslPermutation permutation(n);
        gsl_matrix_view view = gsl_matrix_view_array(a, Count(n), Count(n));
        gsl_vector_view x = gsl_vector_view_array(b.data(), Count(n));
        int sign;
        gsl_linalg_LU_decomp(&view.matrix, permutation, &sign);
        gsl_linalg_LU_svx(&view.matrix, permutation, &x.vector);
        benchmark::DoNotOptimize(b.data());
    });
    Register("solution by Cholesky/GSL", DefiniteMatrix<double>, [](double* a, int n, int*) {
        std::vector<double> b = RightSide(n);
        gsl_matrix_view view = gsl_matrix_view_array(a, Count(n), Count(n));
        gsl_vector_view x = gsl_vector_view_array(b.data(), Count(n));
        gsl_linalg_cholesky_decomp1(&view.matrix);
        gsl_linalg_cholesky_svx(&view.matrix, &x.vector);
        benchmark::DoNotOptimize(b.data());
    });
    Register("inverse/GSL", RandomMatrix<double>, [](double* a, int n, int*) {
        const GslPermutation permutation(n);
        gsl_matrix_view view = gsl_matrix_view_array(a, Count(n), Count(n));
        int sign;
        gsl_linalg_LU_decomp(&view.matrix, permutation, &sign);
        gsl_linalg_LU_invx(&view.matrix, permutation);
    });
#endif
}

const bool kRegistered = [] {
    RegisterFactorisations();
    RegisterSolutions();
    return true;
}();

}  // namespace
}  // namespace krnumer
