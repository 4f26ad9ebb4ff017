// Singular values, eigenvalues and their vectors beside GSL and the LAPACK of OpenBLAS.

#include <benchmark/benchmark.h>

#include <algorithm>
#include <random>
#include <vector>

#include "linalg/eigen_general.h"
#include "linalg/eigen_symmetric.h"
#include "linalg/svd.h"

#ifdef KRNUMER_HAVE_GSL
#include <gsl/gsl_eigen.h>
#include <gsl/gsl_linalg.h>
#endif

extern "C" {
void dgesvd_(const char* jobu, const char* jobvt, const int* m, const int* n, double* a, const int* lda, double* s,
             double* u, const int* ldu, double* vt, const int* ldvt, double* work, const int* lwork, int* info,
             std::size_t, std::size_t);
void dsyev_(const char* jobz, const char* uplo, const int* n, double* a, const int* lda, double* w, double* work,
            const int* lwork, int* info, std::size_t, std::size_t);
void dgeev_(const char* jobvl, const char* jobvr, const int* n, double* a, const int* lda, double* wr, double* wi,
            double* vl, const int* ldvl, double* vr, const int* ldvr, double* work, const int* lwork, int* info,
            std::size_t, std::size_t);
void zheev_(const char* jobz, const char* uplo, const int* n, krnumer::Complex* a, const int* lda, double* w,
            krnumer::Complex* work, const int* lwork, double* rwork, int* info, std::size_t, std::size_t);
void zgeev_(const char* jobvl, const char* jobvr, const int* n, krnumer::Complex* a, const int* lda,
            krnumer::Complex* w, krnumer::Complex* vl, const int* ldvl, krnumer::Complex* vr, const int* ldvr,
            krnumer::Complex* work, const int* lwork, double* rwork, int* info, std::size_t, std::size_t);
}

namespace {

using krnumer::Complex;

constexpr bool kSymmetric = true;

// The same matrix for every peer.
std::vector<double> RandomMatrix(int n, bool symmetric = false) {
    std::mt19937_64 bits(1);
    std::uniform_real_distribution<double> uniform(-1.0, 1.0);
    const auto size = static_cast<std::size_t>(n);
    std::vector<double> a(size * size);
    for (double& x : a) x = uniform(bits);
    for (std::size_t i = 0; symmetric && i < size; ++i)
        for (std::size_t j = 0; j < i; ++j) a[j * size + i] = a[i * size + j];
    return a;
}

std::vector<Complex> RandomComplexMatrix(int n, bool hermitian = false) {
    const std::vector<double> parts = RandomMatrix(2 * n);
    const auto size = static_cast<std::size_t>(n);
    std::vector<Complex> a(size * size);
    for (std::size_t i = 0; i < a.size(); ++i) a[i] = {parts[2 * i], parts[2 * i + 1]};
    for (std::size_t i = 0; hermitian && i < size; ++i) {
        a[i * size + i].im = 0.0;
        for (std::size_t j = 0; j < i; ++j) a[j * size + i] = krnumer::Conjugate(a[i * size + j]);
    }
    return a;
}

template <class T>
std::vector<T> Room(int n) {
    return std::vector<T>(static_cast<std::size_t>(n) * static_cast<std::size_t>(n));
}

void Sizes(benchmark::internal::Benchmark* b) {
    for (const int n : {3, 10, 50, 200}) b->ArgName("n")->Arg(n);
    b->Unit(benchmark::kMicrosecond);
}

// ---- Singular value decomposition with vectors ---------------------------------------------------------------------

void SvdKrnumer(benchmark::State& state) {
    const int n = static_cast<int>(state.range(0));
    const auto a = RandomMatrix(n);
    auto u = Room<double>(n), v = u;
    std::vector<double> s(u.size());
    for (auto _ : state) {
        const int32_t status = krnumer::SvdCore(a.data(), n, n, u.data(), s.data(), v.data(), false);
        if (status != 0) state.SkipWithError("no convergence");
    }
}
BENCHMARK(SvdKrnumer)->Name("singular values and vectors/krnumer")->Apply(Sizes);

void SvdLapack(benchmark::State& state) {
    const int n = static_cast<int>(state.range(0));
    const auto a = RandomMatrix(n);
    auto copy = a, u = a, v = a, s = a;
    int info = 0, query = -1;
    double size = 0.0;
    dgesvd_("S", "S", &n, &n, copy.data(), &n, s.data(), u.data(), &n, v.data(), &n, &size, &query, &info, 1, 1);
    const int length = static_cast<int>(size);
    std::vector<double> work(static_cast<std::size_t>(length));
    for (auto _ : state) {
        copy = a;
        dgesvd_("S", "S", &n, &n, copy.data(), &n, s.data(), u.data(), &n, v.data(), &n, work.data(), &length, &info, 1,
                1);
    }
}
BENCHMARK(SvdLapack)->Name("singular values and vectors/LAPACK")->Apply(Sizes);

void SvdValuesKrnumer(benchmark::State& state) {
    const int n = static_cast<int>(state.range(0));
    const auto a = RandomMatrix(n);
    std::vector<double> s(a.size());
    for (auto _ : state) krnumer::SvdValuesCore(a.data(), n, n, s.data());
}
BENCHMARK(SvdValuesKrnumer)->Name("singular values/krnumer")->Apply(Sizes);

void SvdValuesLapack(benchmark::State& state) {
    const int n = static_cast<int>(state.range(0));
    const auto a = RandomMatrix(n);
    auto copy = a, s = a;
    int info = 0, query = -1;
    double size = 0.0;
    dgesvd_("N", "N", &n, &n, copy.data(), &n, s.data(), nullptr, &n, nullptr, &n, &size, &query, &info, 1, 1);
    const int length = static_cast<int>(size);
    std::vector<double> work(static_cast<std::size_t>(length));
    for (auto _ : state) {
        copy = a;
        dgesvd_("N", "N", &n, &n, copy.data(), &n, s.data(), nullptr, &n, nullptr, &n, work.data(), &length, &info, 1,
                1);
    }
}
BENCHMARK(SvdValuesLapack)->Name("singular values/LAPACK")->Apply(Sizes);

#ifdef KRNUMER_HAVE_GSL
void SvdGsl(benchmark::State& state) {
    const auto n = static_cast<std::size_t>(state.range(0));
    const auto a = RandomMatrix(static_cast<int>(n));
    auto copy = a, v = a, s = a, work = a;
    gsl_matrix_view u = gsl_matrix_view_array(copy.data(), n, n), right = gsl_matrix_view_array(v.data(), n, n);
    gsl_vector_view values = gsl_vector_view_array(s.data(), n), space = gsl_vector_view_array(work.data(), n);
    for (auto _ : state) {
        std::copy(a.begin(), a.end(), copy.begin());
        gsl_linalg_SV_decomp(&u.matrix, &right.matrix, &values.vector, &space.vector);
    }
}
BENCHMARK(SvdGsl)->Name("singular values and vectors/GSL")->Apply(Sizes);
#endif

// ---- Symmetric eigenproblem with vectors ----------------------------------------------------------------------------

void SymmetricKrnumer(benchmark::State& state) {
    const int n = static_cast<int>(state.range(0));
    const auto a = RandomMatrix(n, kSymmetric);
    auto v = a, w = a;
    for (auto _ : state) krnumer::SymEigenCore(a.data(), n, 1, w.data(), v.data());
}
BENCHMARK(SymmetricKrnumer)->Name("symmetric eigenvectors/krnumer")->Apply(Sizes);

void SymmetricLapack(benchmark::State& state) {
    const int n = static_cast<int>(state.range(0));
    const auto a = RandomMatrix(n, kSymmetric);
    auto copy = a, w = a;
    int info = 0, query = -1;
    double size = 0.0;
    dsyev_("V", "L", &n, copy.data(), &n, w.data(), &size, &query, &info, 1, 1);
    const int length = static_cast<int>(size);
    std::vector<double> work(static_cast<std::size_t>(length));
    for (auto _ : state) {
        copy = a;
        dsyev_("V", "L", &n, copy.data(), &n, w.data(), work.data(), &length, &info, 1, 1);
    }
}
BENCHMARK(SymmetricLapack)->Name("symmetric eigenvectors/LAPACK")->Apply(Sizes);

#ifdef KRNUMER_HAVE_GSL
void SymmetricGsl(benchmark::State& state) {
    const auto n = static_cast<std::size_t>(state.range(0));
    const auto a = RandomMatrix(static_cast<int>(n), kSymmetric);
    auto copy = a, v = a, w = a;
    gsl_matrix_view matrix = gsl_matrix_view_array(copy.data(), n, n), vectors = gsl_matrix_view_array(v.data(), n, n);
    gsl_vector_view values = gsl_vector_view_array(w.data(), n);
    gsl_eigen_symmv_workspace* work = gsl_eigen_symmv_alloc(n);
    for (auto _ : state) {
        std::copy(a.begin(), a.end(), copy.begin());
        gsl_eigen_symmv(&matrix.matrix, &values.vector, &vectors.matrix, work);
    }
    gsl_eigen_symmv_free(work);
}
BENCHMARK(SymmetricGsl)->Name("symmetric eigenvectors/GSL")->Apply(Sizes);
#endif

void HermitianKrnumer(benchmark::State& state) {
    const int n = static_cast<int>(state.range(0));
    const auto a = RandomComplexMatrix(n, kSymmetric);
    auto v = a;
    std::vector<double> w(a.size());
    for (auto _ : state) krnumer::HermitianEigenCore(a.data(), n, 1, w.data(), v.data());
}
BENCHMARK(HermitianKrnumer)->Name("Hermitian eigenvectors/krnumer")->Apply(Sizes);

void HermitianLapack(benchmark::State& state) {
    const int n = static_cast<int>(state.range(0));
    const auto a = RandomComplexMatrix(n, kSymmetric);
    auto copy = a;
    std::vector<double> w(a.size()), real_work(3 * static_cast<std::size_t>(n));
    int info = 0, query = -1;
    Complex size{};
    zheev_("V", "L", &n, copy.data(), &n, w.data(), &size, &query, real_work.data(), &info, 1, 1);
    const int length = static_cast<int>(size.re);
    std::vector<Complex> work(static_cast<std::size_t>(length));
    for (auto _ : state) {
        copy = a;
        zheev_("V", "L", &n, copy.data(), &n, w.data(), work.data(), &length, real_work.data(), &info, 1, 1);
    }
}
BENCHMARK(HermitianLapack)->Name("Hermitian eigenvectors/LAPACK")->Apply(Sizes);

// ---- General eigenproblem with vectors ------------------------------------------------------------------------------

void GeneralKrnumer(benchmark::State& state) {
    const int n = static_cast<int>(state.range(0));
    const auto a = RandomMatrix(n);
    auto v = Room<Complex>(n), w = v;
    for (auto _ : state) krnumer::EigenGeneralCore(a.data(), n, 1, w.data(), v.data());
}
BENCHMARK(GeneralKrnumer)->Name("general eigenvectors/krnumer")->Apply(Sizes);

void GeneralLapack(benchmark::State& state) {
    const int n = static_cast<int>(state.range(0));
    const auto a = RandomMatrix(n);
    auto copy = a, v = a, re = a, im = a;
    int info = 0, query = -1;
    double size = 0.0;
    dgeev_("N", "V", &n, copy.data(), &n, re.data(), im.data(), nullptr, &n, v.data(), &n, &size, &query, &info, 1, 1);
    const int length = static_cast<int>(size);
    std::vector<double> work(static_cast<std::size_t>(length));
    for (auto _ : state) {
        copy = a;
        dgeev_("N", "V", &n, copy.data(), &n, re.data(), im.data(), nullptr, &n, v.data(), &n, work.data(), &length,
               &info, 1, 1);
    }
}
BENCHMARK(GeneralLapack)->Name("general eigenvectors/LAPACK")->Apply(Sizes);

#ifdef KRNUMER_HAVE_GSL
void GeneralGsl(benchmark::State& state) {
    const auto n = static_cast<std::size_t>(state.range(0));
    const auto a = RandomMatrix(static_cast<int>(n));
    auto copy = a;
    gsl_matrix_view matrix = gsl_matrix_view_array(copy.data(), n, n);
    gsl_vector_complex* values = gsl_vector_complex_alloc(n);
    gsl_matrix_complex* vectors = gsl_matrix_complex_alloc(n, n);
    gsl_eigen_nonsymmv_workspace* work = gsl_eigen_nonsymmv_alloc(n);
    for (auto _ : state) {
        std::copy(a.begin(), a.end(), copy.begin());
        gsl_eigen_nonsymmv(&matrix.matrix, values, vectors, work);
    }
    gsl_eigen_nonsymmv_free(work);
    gsl_matrix_complex_free(vectors);
    gsl_vector_complex_free(values);
}
BENCHMARK(GeneralGsl)->Name("general eigenvectors/GSL")->Apply(Sizes);
#endif

void ComplexGeneralKrnumer(benchmark::State& state) {
    const int n = static_cast<int>(state.range(0));
    const auto a = RandomComplexMatrix(n);
    auto v = a, w = a;
    for (auto _ : state) krnumer::CxEigenGeneralCore(a.data(), n, 1, w.data(), v.data());
}
BENCHMARK(ComplexGeneralKrnumer)->Name("complex eigenvectors/krnumer")->Apply(Sizes);

void ComplexGeneralLapack(benchmark::State& state) {
    const int n = static_cast<int>(state.range(0));
    const auto a = RandomComplexMatrix(n);
    auto copy = a, v = a, w = a;
    std::vector<double> real_work(2 * static_cast<std::size_t>(n));
    int info = 0, query = -1;
    Complex size{};
    zgeev_("N", "V", &n, copy.data(), &n, w.data(), nullptr, &n, v.data(), &n, &size, &query, real_work.data(), &info,
           1, 1);
    const int length = static_cast<int>(size.re);
    std::vector<Complex> work(static_cast<std::size_t>(length));
    for (auto _ : state) {
        copy = a;
        zgeev_("N", "V", &n, copy.data(), &n, w.data(), nullptr, &n, v.data(), &n, work.data(), &length,
               real_work.data(), &info, 1, 1);
    }
}
BENCHMARK(ComplexGeneralLapack)->Name("complex eigenvectors/LAPACK")->Apply(Sizes);

}  // namespace
