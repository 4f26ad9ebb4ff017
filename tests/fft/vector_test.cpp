// Vectors compute several columns at once and nothing else: whatever the instruction set, the bits are those of the
// plain butterflies, which strides above 1 still call for.
#include "fft/vector_targets.h"
//
#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <vector>

#include "fft/fft.h"
#include "fft/samples.h"
#include "fft/vector_kernels.h"
#include "frame/numeric.h"
#include "frame/status.h"
#include "hwy/highway.h"
#include "support/numbers.h"

namespace krnumer {
namespace {

// Pretends that the processor has one instruction set only.
class InstructionSet {
  public:
    explicit InstructionSet(int64_t target) { Use(target); }
    ~InstructionSet() { Use(0); }
    InstructionSet(const InstructionSet&) = delete;
    InstructionSet& operator=(const InstructionSet&) = delete;

  private:
    static void Use(int64_t target) {
        hwy::SetSupportedTargetsForTest(target);
        hwy::GetChosenTarget().Update(hwy::SupportedTargets());
    }
};

std::vector<int64_t> Targets() {
    std::vector<int64_t> targets = hwy::SupportedAndGeneratedTargets();
    if (targets.back() != HWY_STATIC_TARGET) targets.push_back(HWY_STATIC_TARGET);
    return targets;
}

TEST(VectorLanes, AreThoseOfTheInstructionSet) {
    for (const int64_t target : Targets()) {
        const InstructionSet set(target);
        const int32_t expected = target == HWY_AVX3 ? 8 : target == HWY_AVX2 ? 4 : target >= HWY_EMU128 ? 0 : 2;
        EXPECT_EQ(VectorLanes(), expected) << hwy::TargetName(target);
    }
}

class VectorFft : public testing::TestWithParam<int64_t> {};

// Real and imaginary parts in arrays of their own are out of the vectors' reach.
void TransformPlainly(const HeldTable& table, const std::vector<Complex>& x, std::vector<double>& re,
                      std::vector<double>& im) {
    const auto n = static_cast<int32_t>(x.size());
    std::vector<double> x_re, x_im;
    for (Complex z : x) {
        x_re.push_back(z.re);
        x_im.push_back(z.im);
    }
    ASSERT_EQ(ComplexFFT(table.get(), x_re.data(), x_im.data(), re.data(), im.data(), 1, 1, n), kOk);
}

void ExpectSameBits(int32_t n) {
    const HeldTable table(n);
    ASSERT_TRUE(table);
    const std::vector<Complex> x = RandomComplex(n);
    std::vector<Complex> y(x.size());
    std::vector<double> re(x.size()), im(x.size());
    TransformPlainly(table, x, re, im);
    ASSERT_EQ(ComplexFFT(table.get(), &x[0].re, &x[0].im, &y[0].re, &y[0].im, 2, 2, n), kOk);
    for (size_t k = 0; k < x.size(); ++k)
        ASSERT_TRUE(SameBits(y[k], Complex{re[k], im[k]})) << "complex, n = " << n << " at " << k;

    const std::vector<double> r = RandomReal(n);
    std::vector<double> fast(r.size()), plain(3 * r.size());
    ASSERT_EQ(RealFFT(table.get(), r.data(), fast.data(), 1, 1, n), kOk);
    ASSERT_EQ(RealFFT(table.get(), r.data(), plain.data(), 1, 3, n), kOk);
    for (size_t k = 0; k < r.size(); ++k)
        ASSERT_TRUE(SameBits(fast[k], plain[3 * k])) << "real, n = " << n << " at " << k;
}

TEST_P(VectorFft, GivesTheBitsOfThePlainButterfliesUpTo1500) {
    const InstructionSet set(GetParam());
    for (int32_t n = 1; n <= 1500; ++n) ExpectSameBits(n);
}

TEST_P(VectorFft, GivesTheBitsOfThePlainButterfliesAtLargeLengths) {
    const InstructionSet set(GetParam());
    for (int32_t n : {2048, 2187, 2809, 3125, 4096, 8192, 10007, 16384, 30030, 46189, 100000, 161051})
        ExpectSameBits(n);
}

// Rows that are powers of two apart, and data beyond the caches, go through tiles: in one pass and in several, with
// even and odd numbers of rows and columns.
TEST_P(VectorFft, GivesTheBitsOfThePlainButterfliesInTiles) {
    const InstructionSet set(GetParam());
    for (int32_t n : {32768, 65536, 131072, 531441, 1000000, 1048576, 1594323}) ExpectSameBits(n);
}

// Results that begin at a cache line go past the caches, others through them.
TEST_P(VectorFft, GivesTheSameBitsWhereverItWrites) {
    const InstructionSet set(GetParam());
    constexpr size_t kLine = 64 / sizeof(Complex);
    for (int32_t n : {400000, 531441, 1048576}) {
        const HeldTable table(n);
        const std::vector<Complex> x = RandomComplex(n);
        std::vector<Complex> room(x.size() + 2 * kLine);
        Complex* line = room.data();
        while (reinterpret_cast<uintptr_t>(line) % 64 != 0) ++line;
        ASSERT_EQ(ComplexFFT(table.get(), &x[0].re, &x[0].im, &line->re, &line->im, 2, 2, n), kOk);
        const std::vector<Complex> y(line, line + n);
        ++line;
        ASSERT_EQ(ComplexFFT(table.get(), &x[0].re, &x[0].im, &line->re, &line->im, 2, 2, n), kOk);
        for (size_t k = 0; k < y.size(); ++k) ASSERT_TRUE(SameBits(line[k], y[k])) << "n = " << n << " at " << k;
    }
}

// Infinities and zeros with a sign go through row 0 as they are.
TEST_P(VectorFft, TurnsNoRowThatTakesNoTwiddle) {
    const InstructionSet set(GetParam());
    for (int32_t n : {6, 12, 64, 100}) {
        const HeldTable table(n);
        std::vector<Complex> x(static_cast<size_t>(n), {-0.0, -0.0}), y(x);
        std::vector<double> re(x.size()), im(x.size());
        TransformPlainly(table, x, re, im);
        ASSERT_EQ(ComplexFFT(table.get(), &x[0].re, &x[0].im, &y[0].re, &y[0].im, 2, 2, n), kOk);
        for (size_t k = 0; k < x.size(); ++k) EXPECT_TRUE(SameBits(y[k], Complex{re[k], im[k]})) << n << " at " << k;
        x[0].im = kInfinity;
        TransformPlainly(table, x, re, im);
        ASSERT_EQ(ComplexFFT(table.get(), &x[0].re, &x[0].im, &y[0].re, &y[0].im, 2, 2, n), kOk);
        for (size_t k = 0; k < x.size(); ++k) {
            EXPECT_EQ(y[k].re != y[k].re, re[k] != re[k]) << n << " at " << k;
            EXPECT_EQ(y[k].im != y[k].im, im[k] != im[k]) << n << " at " << k;
        }
    }
}

// Just as many elements as there are, with nothing behind them.
TEST_P(VectorFft, StaysWithinItsArrays) {
    const InstructionSet set(GetParam());
    for (int32_t n = 2; n < 200; ++n) {
        const HeldTable table(n);
        const std::unique_ptr<double[]> in(new double[static_cast<size_t>(2 * n)]());
        const std::unique_ptr<double[]> out(new double[static_cast<size_t>(2 * n)]());
        ASSERT_EQ(ComplexFFT(table.get(), in.get(), in.get() + 1, out.get(), out.get() + 1, 2, 2, n), kOk);
        const std::unique_ptr<double[]> real(new double[static_cast<size_t>(n)]());
        const std::unique_ptr<double[]> half(new double[static_cast<size_t>(n)]());
        ASSERT_EQ(RealFFT(table.get(), real.get(), half.get(), 1, 1, n), kOk);
    }
}

INSTANTIATE_TEST_SUITE_P(All, VectorFft, testing::ValuesIn(Targets()),
                         [](const auto& target) { return std::string(hwy::TargetName(target.param)); });

}  // namespace
}  // namespace krnumer
