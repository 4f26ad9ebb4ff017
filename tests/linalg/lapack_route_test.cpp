// LAPACK as it is linked in: the numbers come out right, bad arguments come back as info without a word and without
// the end of the process, no thread is started, and several threads may call at once.
#include <gtest/gtest.h>
#include <sys/mman.h>
#include <unistd.h>

#include <cstdlib>
#include <filesystem>
#include <iterator>
#include <new>
#include <string>
#include <thread>
#include <vector>

#include "linalg/lapack.h"

extern "C" {
void zgemv_(const char& trans, const int32_t& m, const int32_t& n, const krnumer::Complex& alpha,
            const krnumer::Complex* a, const int32_t& lda, const krnumer::Complex* x, const int32_t& incx,
            const krnumer::Complex& beta, krnumer::Complex* y, const int32_t& incy, std::size_t);
krnumer::Complex zdotu_(const int32_t& n, const krnumer::Complex* x, const int32_t& incx, const krnumer::Complex* y,
                        const int32_t& incy);
krnumer::Complex zdotc_(const int32_t& n, const krnumer::Complex* x, const int32_t& incx, const krnumer::Complex* y,
                        const int32_t& incy);
}

namespace krnumer {
namespace {

constexpr int32_t kSize = 96;

template <class T>
T Element(double re, double im) {
    if constexpr (std::is_same_v<T, Complex>) {
        return {re, im};
    } else {
        return re;
    }
}

// Small integers, so that every product below is exact whatever the order of its sums.
template <class T>
std::vector<T> IntegerMatrix(int32_t size, int32_t seed) {
    std::vector<T> matrix;
    for (int32_t i = 0; i < size * size; ++i) matrix.push_back(Element<T>((i * 7 + seed) % 11 - 5, (i * 3 + seed) % 5));
    return matrix;
}

template <class T>
std::vector<T> ProductByDefinition(const std::vector<T>& a, const std::vector<T>& b, int32_t size) {
    std::vector<T> c(a.size(), Element<T>(0, 0));
    for (int32_t i = 0; i < size; ++i)
        for (int32_t k = 0; k < size; ++k)
            for (int32_t j = 0; j < size; ++j)
                c[Count(i * size + j)] += a[Count(i * size + k)] * b[Count(k * size + j)];
    return c;
}

template <class T>
std::vector<T> Product(const std::vector<T>& a, const std::vector<T>& b, int32_t size) {
    std::vector<T> c(a.size());
    lapack::Gemm(lapack::kRowMajor, lapack::kNoTranspose, lapack::kNoTranspose, size, size, size, Element<T>(1, 0),
                 a.data(), size, b.data(), size, Element<T>(0, 0), c.data(), size);
    return c;
}

std::ptrdiff_t RunningThreads() {
    const std::filesystem::directory_iterator tasks("/proc/self/task");
    return std::distance(begin(tasks), end(tasks));
}

template <class T>
class LapackRoute : public testing::Test {};
using Elements = testing::Types<double, Complex>;
TYPED_TEST_SUITE(LapackRoute, Elements);

TYPED_TEST(LapackRoute, ReportsABadArgumentByInfoAlone) {
    std::vector<TypeParam> a(16), b(4);
    std::vector<int32_t> pivots(4);
    testing::internal::CaptureStdout();
    testing::internal::CaptureStderr();
    EXPECT_EQ(lapack::Gbsv<TypeParam>(-1, 1, 1, 1, a.data(), 4, pivots.data(), b.data(), 4), -1);
    EXPECT_EQ(lapack::Gbsv<TypeParam>(4, 1, 1, 1, a.data(), 3, pivots.data(), b.data(), 4), -6);
    int32_t low = 0, high = 0;
    std::vector<double> scale(4);
    EXPECT_EQ(lapack::Gebal<TypeParam>('?', 4, a.data(), 4, low, high, scale.data()), -1);
    // A leading dimension below the rows: the product is left undone.
    std::vector<TypeParam> c(4, Element<TypeParam>(7, 0));
    lapack::Gemm(lapack::kColumnMajor, lapack::kNoTranspose, lapack::kNoTranspose, 2, 2, 2, Element<TypeParam>(1, 0),
                 a.data(), 1, a.data(), 2, Element<TypeParam>(0, 0), c.data(), 2);
    EXPECT_EQ(c.back(), Element<TypeParam>(7, 0));
    EXPECT_EQ(testing::internal::GetCapturedStdout(), "");
    EXPECT_EQ(testing::internal::GetCapturedStderr(), "");
}

TYPED_TEST(LapackRoute, MultipliesExactly) {
    const auto a = IntegerMatrix<TypeParam>(kSize, 1), b = IntegerMatrix<TypeParam>(kSize, 2);
    EXPECT_EQ(Product(a, b, kSize), ProductByDefinition(a, b, kSize));
}

// The blocked reductions join option strings, which is all that is left of the Fortran run time: L Q gives A back.
TYPED_TEST(LapackRoute, FactorsInBlocks) {
    const auto a = IntegerMatrix<TypeParam>(kSize, 3);
    std::vector<TypeParam> q = a, tau(kSize), l(a.size(), Element<TypeParam>(0, 0));
    Scratch<TypeParam> work;
    int32_t info = -1;
    ASSERT_EQ(lapack::CallWithWorkspace(info, work,
                                        [&](TypeParam* space, int32_t size) {
                                            return lapack::Gelqf(kSize, kSize, q.data(), kSize, tau.data(), space,
                                                                 size);
                                        }),
              kOk);
    ASSERT_EQ(info, 0);
    for (int32_t j = 0; j < kSize; ++j)
        for (int32_t i = j; i < kSize; ++i) l[Count(i + j * kSize)] = q[Count(i + j * kSize)];
    ASSERT_EQ(lapack::CallWithWorkspace(info, work,
                                        [&](TypeParam* space, int32_t size) {
                                            return lapack::Orglq(kSize, kSize, kSize, q.data(), kSize, tau.data(),
                                                                 space, size);
                                        }),
              kOk);
    ASSERT_EQ(info, 0);
    // Column-major L Q is row-major Q L of the transposes.
    const auto product = Product(q, l, kSize);
    for (std::size_t i = 0; i < a.size(); ++i) {
        const TypeParam difference = product[i] - a[i];
        if constexpr (std::is_same_v<TypeParam, Complex>) {
            ASSERT_LT(Modulus(difference), 1e-12) << i;
        } else {
            ASSERT_NEAR(difference, 0.0, 1e-12) << i;
        }
    }
}

TYPED_TEST(LapackRoute, StartsNoThread) {
#if defined(__SANITIZE_THREAD__)
    GTEST_SKIP() << "the sanitizer has a thread of its own";
#endif
    constexpr int32_t kLarge = 400;
    const auto a = IntegerMatrix<TypeParam>(kLarge, 5);
    Product(a, a, kLarge);
    EXPECT_EQ(RunningThreads(), 1);
}

// Many short calls: what goes wrong, if it does, goes wrong where work buffers are given out.
TYPED_TEST(LapackRoute, ServesSeveralThreadsAtOnce) {
    constexpr int32_t kShort = 48;
    constexpr int kRounds = 2000;
    const auto a = IntegerMatrix<TypeParam>(kShort, 6), b = IntegerMatrix<TypeParam>(kShort, 7);
    const auto right = ProductByDefinition(a, b, kShort);
    constexpr std::size_t kThreads = 8;
    std::vector<int> wrong(kThreads, 0);
    {
        std::vector<std::jthread> threads;
        for (std::size_t thread = 0; thread < kThreads; ++thread) {
            threads.emplace_back([&, thread] {
                for (int round = 0; round < kRounds; ++round) wrong[thread] += Product(a, b, kShort) != right;
            });
        }
    }
    EXPECT_EQ(wrong, std::vector<int>(kThreads, 0));
}

// Elements whose last one is the last that may be read before unmapped memory.
class AtTheEdge {
  public:
    explicit AtTheEdge(std::size_t count) : page_(static_cast<std::size_t>(sysconf(_SC_PAGESIZE))) {
        const std::size_t bytes = count * sizeof(Complex);
        mapped_ = (bytes + page_ - 1) / page_ * page_;
        void* const memory = mmap(nullptr, mapped_ + page_, PROT_READ | PROT_WRITE, MAP_PRIVATE | MAP_ANONYMOUS, -1, 0);
        if (memory == MAP_FAILED) throw std::bad_alloc();
        memory_ = static_cast<char*>(memory);
        mprotect(memory_ + mapped_, page_, PROT_NONE);
        elements_ = reinterpret_cast<Complex*>(memory_ + mapped_ - bytes);
        for (std::size_t i = 0; i < count; ++i) elements_[i] = {1.0 + static_cast<double>(i % 5), -1.0};
    }
    AtTheEdge(const AtTheEdge&) = delete;
    AtTheEdge& operator=(const AtTheEdge&) = delete;
    ~AtTheEdge() { munmap(memory_, mapped_ + page_); }

    Complex* data() const { return elements_; }
    Complex operator[](std::size_t i) const { return elements_[i]; }

  private:
    std::size_t page_;
    std::size_t mapped_;
    char* memory_;
    Complex* elements_;
};

// The kernels of some processors load what lies behind the last column.
TEST(LapackBounds, KeepAMatrixTimesAVectorInsideOfTheMatrix) {
    for (int32_t m = 1; m <= 9; ++m) {
        for (int32_t n = 1; n <= 9; ++n) {
            for (const int32_t step : {1, 2, -1, -3}) {
                const auto x_count = Count((n - 1) * std::abs(step) + 1);
                const AtTheEdge a(Count(m * n)), x(x_count), y(Count(m));
                const auto x_at = [&](int32_t j) { return x[Count(step > 0 ? j * step : (j + 1 - n) * step)]; };
                std::vector<Complex> product(Count(m));
                for (int32_t i = 0; i < m; ++i) {
                    Complex sum{};
                    for (int32_t j = 0; j < n; ++j) sum += a[Count(j * m + i)] * x_at(j);
                    product[Count(i)] = Complex{2, 0} * sum + Complex{0, 3} * y[Count(i)];
                }
                zgemv_('N', m, n, Complex{2, 0}, a.data(), m, x.data(), step, Complex{0, 3}, y.data(), 1, 1);
                EXPECT_EQ(std::vector<Complex>(y.data(), y.data() + m), product) << m << " " << n << " " << step;
            }
        }
    }
}

TEST(LapackBounds, KeepADotProductInsideOfTheVectors) {
    for (int32_t n = 1; n <= 9; ++n) {
        for (const int32_t step : {1, 2, 5}) {
            const AtTheEdge x(Count((n - 1) * step + 1)), y(Count(n));
            Complex plain{}, conjugated{};
            for (int32_t i = 0; i < n; ++i) {
                plain += x[Count(i * step)] * y[Count(i)];
                conjugated += Conjugate(x[Count(i * step)]) * y[Count(i)];
            }
            EXPECT_EQ(zdotu_(n, x.data(), step, y.data(), 1), plain) << n << " " << step;
            EXPECT_EQ(zdotc_(n, x.data(), step, y.data(), 1), conjugated) << n << " " << step;
        }
    }
}

// A known spectrum through the Schur form, in both its signatures.
TEST(LapackSchur, FindsTheEigenvaluesOfARotation) {
    std::vector<double> real = {0, 1, -1, 0}, wr(2), wi(2), work(12);
    ASSERT_EQ(lapack::Gees('N', 2, real.data(), 2, wr.data(), wi.data(), nullptr, 1, work.data(), 12), 0);
    EXPECT_EQ(wr, (std::vector<double>{0, 0}));
    EXPECT_EQ(wi, (std::vector<double>{1, -1}));

    std::vector<Complex> twin = {{0, 0}, {1, 0}, {-1, 0}, {0, 0}}, w(2), space(8);
    std::vector<double> rwork(2);
    ASSERT_EQ(lapack::Gees('N', 2, twin.data(), 2, w.data(), nullptr, 1, space.data(), 8, rwork.data()), 0);
    EXPECT_NEAR(w[0].re, 0.0, 1e-15);
    EXPECT_NEAR(std::fabs(w[0].im), 1.0, 1e-15);
    EXPECT_NEAR(w[0].im + w[1].im, 0.0, 1e-15);
}

}  // namespace
}  // namespace krnumer
