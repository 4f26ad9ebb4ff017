// What tables, transforms and their entry points do when an allocation fails, and where they make none.
#if defined(KRNUMER_REFUSES_ALLOCATIONS)

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <vector>

#include "fft/fft.h"
#include "fft/samples.h"
#include "fft/table.h"
#include "frame/complex.h"
#include "frame/status.h"
#include "krnumer/fft.h"
#include "support/host_arrays.h"
#include "sweep/allocator.h"

namespace krnumer {
namespace {

using testing::ElementsAre;

TEST(FftTableWithoutMemory, IsNotMadeWhenAnyAllocationFails) {
    // Twiddles, a direct factor, Rader factors of two levels.
    for (int32_t length : {1, 7, 1000, 46, 47 * 53, 107 * 23}) {
        int32_t failures = 0;
        for (;; ++failures) {
            qmfft_table* table;
            bool refused;
            {
                const sweep::ArmedAllocator allocator(failures + 1);
                table = CreateTable(length);
                refused = sweep::ArmedAllocator::refused();
            }
            if (!refused) {
                ASSERT_NE(table, nullptr);
                DestroyTable(table);
                break;
            }
            ASSERT_EQ(table, nullptr) << length << " at allocation " << failures + 1;
            const HeldTable probe(6);
            EXPECT_EQ(probe.get()->next, nullptr);
            EXPECT_EQ(sweep::LiveAllocations(), 0);
        }
        EXPECT_GE(failures, length == 1 ? 1 : 2);
        EXPECT_EQ(sweep::LiveAllocations(), 0);
    }
}

TEST(FftWithoutMemory, AllocatesNothingAtListedRadices) {
    for (int32_t n : {16, 1000, 1024, 4096, 30030, 43 * 41, 131072}) {
        const HeldTable table(n);
        const std::vector<Complex> x = RandomComplex(n);
        std::vector<Complex> y(x.size());
        const sweep::ArmedAllocator allocator(0);
        ASSERT_EQ(ComplexFFT(table.get(), &x[0].re, &x[0].im, &y[0].re, &y[0].im, 2, 2, n), kOk);
        ASSERT_EQ(RealFFT(table.get(), &x[0].re, &y[0].re, 1, 1, n), kOk);
        EXPECT_EQ(sweep::ArmedAllocator::allocations(), 0);
    }
}

TEST(FftWithoutMemory, ReportsMissingMemory) {
    for (int32_t n : {23, 46, 23 * 23, 53, 106, 53 * 53, 107}) {
        const HeldTable table(n);
        const std::vector<Complex> x = RandomComplex(n);
        std::vector<Complex> y(x.size());
        for (const bool real : {false, true}) {
            int32_t refused = 0;
            for (bool met = true; met;) {
                const sweep::ArmedAllocator allocator(++refused);
                const int32_t status = real ? RealFFT(table.get(), &x[0].re, &y[0].re, 1, 1, n)
                                            : ComplexFFT(table.get(), &x[0].re, &x[0].im, &y[0].re, &y[0].im, 2, 2, n);
                met = sweep::ArmedAllocator::refused();
                ASSERT_EQ(status, met ? kOutOfMemory : kOk) << n;
            }
            EXPECT_GT(refused, 1) << n;
            EXPECT_EQ(sweep::LiveAllocations(), 0);
        }
    }
}

// Slots of one calling instance, released at its end.
class FftEntryWithoutMemory : public testing::Test {
  protected:
    HostInstance instance;
    void* slot = nullptr;
    void* other = nullptr;
};

TEST_F(FftEntryWithoutMemory, AllocatesNothingOnceItsSlotIsBound) {
    const HostArray<Complex> x(RandomComplex(30));
    const HostArray<double> r(RandomReal(30));
    HostArray<Complex> out;
    ASSERT_EQ(CxQMFFTH(x.handle(), out.handle(), &slot), kOk);
    ASSERT_EQ(ReQMFFTH(r.handle(), out.handle(), &other), kOk);
    const sweep::ArmedAllocator allocator(0);
    ASSERT_EQ(CxQMFFTH(x.handle(), out.handle(), &slot), kOk);
    ASSERT_EQ(ReQMFFTH(r.handle(), out.handle(), &other), kOk);
    EXPECT_EQ(sweep::ArmedAllocator::allocations(), 0);
}

// A fresh slot stays null; a slot in use loses its table, and is bound again later with the one clean-up it has.
TEST_F(FftEntryWithoutMemory, SurvivesATableThatCannotBeMade) {
    const HostArray<Complex> a(RandomComplex(16)), b(RandomComplex(20));
    HostArray<Complex> out{{9, 8}};
    for (int32_t nth : {1, 2, 3}) {
        const sweep::ArmedAllocator allocator(nth);
        ASSERT_EQ(CxQMFFTH(a.handle(), out.handle(), &slot), kOutOfMemory);
        EXPECT_EQ(slot, nullptr);
    }
    EXPECT_EQ(instance.pending_cleanups(), 0);
    EXPECT_THAT(out.values(), ElementsAre(Complex{9, 8}));

    ASSERT_EQ(CxQMFFTH(a.handle(), out.handle(), &slot), kOk);
    {
        const sweep::ArmedAllocator allocator(1);
        ASSERT_EQ(CxQMFFTH(b.handle(), out.handle(), &slot), kOutOfMemory);
    }
    ASSERT_NE(slot, nullptr);
    EXPECT_EQ(*static_cast<qmfft_table**>(slot), nullptr);
    ASSERT_EQ(CxQMFFTH(b.handle(), out.handle(), &slot), kOk);
    EXPECT_EQ(instance.pending_cleanups(), 1);
    {
        const sweep::ArmedAllocator allocator(1);
        ASSERT_EQ(CxQMFFTH(a.handle(), out.handle(), &slot), kOutOfMemory);
    }
}

// Without memory for the padding the result has its size, no contents, and the status of success.
TEST_F(FftEntryWithoutMemory, SizesARealResultThatItCannotPad) {
    const HostArray<double> x{1, 2, 3};
    HostArray<Complex> out;
    ASSERT_EQ(ReQMFFTH80(x.handle(), out.handle(), &slot, 0, 6, 0), kOk);
    HostArray<Complex> other_out;
    const sweep::ArmedAllocator allocator(1);
    EXPECT_EQ(ReQMFFTH80(x.handle(), other_out.handle(), &slot, 0, 6, 0), kOk);
    EXPECT_TRUE(sweep::ArmedAllocator::refused());
    EXPECT_EQ(other_out.size(), 6);
}

// Without a table for the rows the output stays; without one for the columns it is emptied.
TEST_F(FftEntryWithoutMemory, TellsItsSlotsApartWhenATableCannotBeMade) {
    const HostMatrix<Complex> in(2, 3);
    HostMatrix<Complex> out(1, 1, {{9, 8}});
    {
        const sweep::ArmedAllocator allocator(1);
        EXPECT_EQ(CxFFT2D_H(in.handle(), 0, 0, 2, 3, 0, out.handle(), &slot, &other), kOutOfMemory);
    }
    EXPECT_THAT(out.values(), ElementsAre(Complex{9, 8}));
    EXPECT_EQ(slot, nullptr);
    HostMatrix<Complex> sized(1, 1);
    ASSERT_EQ(CxFFT2D_H(in.handle(), 0, 0, 2, 3, 0, sized.handle(), &slot, &other), kOk);
    {
        const sweep::ArmedAllocator allocator(1);
        EXPECT_EQ(CxFFT2D_H(in.handle(), 0, 0, 4, 3, 0, out.handle(), &slot, &other), kOutOfMemory);
    }
    EXPECT_TRUE(out.empty());
}

}  // namespace
}  // namespace krnumer

#endif
