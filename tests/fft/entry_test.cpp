#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <climits>
#include <limits>
#include <vector>

#include "fft/samples.h"
#include "fft/table.h"
#include "frame/status.h"
#include "krnumer/fft.h"
#include "support/host_arrays.h"

namespace krnumer {
namespace {

using testing::ElementsAre;

constexpr int32_t kHostRefusal = 77;
constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();
constexpr double kTolerance = 1e-14;

// What a slot points to holds one pointer.
const qmfft_table* TableOf(void* slot) {
    return *static_cast<qmfft_table**>(slot);
}

// Slots of one calling instance, released at its end.
class FftEntry : public testing::Test {
  protected:
    HostInstance instance;
    void* slot = nullptr;
    void* other = nullptr;
};

std::vector<LongComplex> Shifted(std::vector<LongComplex> x) {
    const size_t n = x.size();
    std::rotate(x.begin(), x.begin() + static_cast<std::ptrdiff_t>(n - n / 2), x.end());
    return x;
}

std::vector<Complex> Rounded(const std::vector<LongComplex>& x) {
    std::vector<Complex> y;
    for (LongComplex z : x) y.push_back({static_cast<double>(z.real()), static_cast<double>(z.imag())});
    return y;
}

// Samples from `offset` on, cut or padded to a length.
template <class T>
std::vector<T> SectionOf(const std::vector<T>& x, int32_t offset, int32_t length) {
    std::vector<T> section(static_cast<size_t>(length));
    for (size_t i = 0; i < section.size() && i + static_cast<size_t>(offset) < x.size(); ++i)
        section[i] = x[i + static_cast<size_t>(offset)];
    return section;
}

const std::vector<int32_t> kLengths = {1, 2, 3, 4, 5, 8, 15, 23, 46, 53, 64, 100, 210};

TEST_F(FftEntry, TransformsComplexSamples) {
    for (int32_t n : kLengths) {
        const std::vector<Complex> x = RandomComplex(n);
        const HostArray<Complex> in(x);
        HostArray<Complex> out{{9, 9}};
        ASSERT_EQ(CxQMFFTH(in.handle(), out.handle(), &slot), kOk);
        ASSERT_EQ(out.size(), n);
        EXPECT_LT(RelativeError(out.values(), ReferenceOf(x)), kTolerance);
        HostArray<Complex> back;
        ASSERT_EQ(InvCxQMFFTH(out.handle(), back.handle(), &slot), kOk);
        EXPECT_LT(RelativeError(back.values(), x), kTolerance);
        EXPECT_EQ(in.values(), x);
    }
}

TEST_F(FftEntry, TransformsRealSamples) {
    for (int32_t n : kLengths) {
        const std::vector<double> x = RandomReal(n);
        const HostArray<double> in(x);
        HostArray<Complex> out{{9, 9}};
        ASSERT_EQ(ReQMFFTH(in.handle(), out.handle(), &slot), kOk);
        ASSERT_EQ(out.size(), n);
        EXPECT_LT(RelativeError(out.values(), ReferenceOf(x)), kTolerance);
        EXPECT_EQ(out[0].im, 0.0);
        if (n % 2 == 0) {
            EXPECT_EQ(out[n / 2].im, 0.0);
        }
        for (int32_t k = 1; k < n; ++k) EXPECT_EQ(out[n - k], Conjugate(out[k]));
        HostArray<double> back;
        ASSERT_EQ(InvReQMFFTH(out.handle(), back.handle(), &slot), kOk);
        ASSERT_EQ(back.size(), n);
        for (int32_t k = 0; k < n; ++k) EXPECT_NEAR(back[k], x[static_cast<size_t>(k)], kTolerance * 10);
    }
}

TEST_F(FftEntry, TransformsIntoHalfComplexForm) {
    for (int32_t n : kLengths) {
        const std::vector<double> x = RandomReal(n);
        const HostArray<double> in(x);
        HostArray<Complex> full;
        HostArray<double> half, back;
        ASSERT_EQ(ReQMFFTH(in.handle(), full.handle(), &other), kOk);
        ASSERT_EQ(ReQMFFTHCH(in.handle(), half.handle(), &slot), kOk);
        ASSERT_EQ(half.size(), n);
        for (int32_t p = 0; p < n; ++p) EXPECT_EQ(half[p], 2 * p <= n ? full[p].re : full[n - p].im);
        EXPECT_EQ(in.values(), x);

        const std::vector<double> spectrum = half.values();
        ASSERT_EQ(InvReQMFFTHCH(half.handle(), back.handle(), &slot), kOk);
        for (int32_t k = 0; k < n; ++k) EXPECT_NEAR(back[k], x[static_cast<size_t>(k)], kTolerance * 10);
        // The spectrum comes back scaled and folded.
        const double scale = 1.0 / n;
        EXPECT_EQ(half[0], spectrum[0] * scale);
        for (int32_t k = 1; 2 * k < n; ++k) {
            const double a = spectrum[static_cast<size_t>(k)] * scale;
            const double b = spectrum[static_cast<size_t>(n - k)] * scale;
            EXPECT_EQ(half[k], a - b);
            EXPECT_EQ(half[n - k], a + b);
        }
    }
}

TEST_F(FftEntry, ShiftsSpectra) {
    for (int32_t n : kLengths) {
        const std::vector<Complex> x = RandomComplex(n);
        const HostArray<Complex> in(x);
        HostArray<Complex> out, back;
        ASSERT_EQ(CxQMFFTH80(in.handle(), out.handle(), &slot, 0, n, 1), kOk);
        EXPECT_LT(RelativeError(out.values(), Rounded(Shifted(ReferenceOf(x)))), kTolerance);
        ASSERT_EQ(InvCxQMFFTH80(out.handle(), back.handle(), &slot, 7), kOk);
        EXPECT_LT(RelativeError(back.values(), x), kTolerance);

        const std::vector<double> r = RandomReal(n);
        const HostArray<double> real(r);
        HostArray<double> real_back;
        ASSERT_EQ(ReQMFFTH80(real.handle(), out.handle(), &slot, 0, n, -1), kOk);
        EXPECT_LT(RelativeError(out.values(), Rounded(Shifted(ReferenceOf(r)))), kTolerance);
        ASSERT_EQ(InvReQMFFTH80(out.handle(), real_back.handle(), &slot, 1), kOk);
        for (int32_t k = 0; k < n; ++k) EXPECT_NEAR(real_back[k], r[static_cast<size_t>(k)], kTolerance * 10);
    }
}

TEST_F(FftEntry, CutsAndPadsItsSamples) {
    const std::vector<Complex> x = RandomComplex(10);
    const std::vector<double> r = RandomReal(10);
    for (int32_t offset : {0, 3, 9}) {
        for (int32_t size : {1, 4, 7, 10, 16}) {
            const HostArray<Complex> in(x);
            const HostArray<double> real(r);
            HostArray<Complex> out;
            ASSERT_EQ(CxQMFFTH80(in.handle(), out.handle(), &slot, offset, size, 0), kOk);
            EXPECT_LT(RelativeError(out.values(), ReferenceOf(SectionOf(x, offset, size))), kTolerance);
            ASSERT_EQ(ReQMFFTH80(real.handle(), out.handle(), &slot, offset, size, 0), kOk);
            EXPECT_LT(RelativeError(out.values(), ReferenceOf(SectionOf(r, offset, size))), kTolerance);
        }
    }
}

// Complex samples behind the end are zero; only a negative offset has no meaning.
TEST_F(FftEntry, TakesComplexSamplesBehindTheEndForZero) {
    const HostArray<Complex> in{{1, 2}, {3, 4}};
    HostArray<Complex> out{{9, 9}};
    for (int32_t offset : {2, 3, INT32_MAX}) {
        ASSERT_EQ(CxQMFFTH80(in.handle(), out.handle(), &slot, offset, 3, 1), kOk);
        EXPECT_THAT(out.values(), ElementsAre(Complex{}, Complex{}, Complex{}));
    }
}

TEST_F(FftEntry, RefusesBadArgumentsInOrder) {
    const HostArray<Complex> none, some{{1, 0}, {2, 0}};
    const HostArray<double> none_real, some_real{1, 2};
    HostArray<Complex> out{{9, 8}};
    HostArray<double> out_real{5};
    EXPECT_EQ(CxQMFFTH(none.handle(), out.handle(), &slot), kEmptyInput);
    EXPECT_EQ(CxQMFFTH80(none.handle(), out.handle(), &slot, -1, 0, 0), kEmptyInput);
    EXPECT_EQ(CxQMFFTH80(some.handle(), out.handle(), &slot, -1, 0, 0), kNoChannel);
    EXPECT_EQ(CxQMFFTH80(some.handle(), out.handle(), &slot, -1, 4, 0), kBadIndex);
    EXPECT_EQ(InvCxQMFFTH(none.handle(), out.handle(), &slot), kEmptyInput);
    EXPECT_EQ(InvCxQMFFTH80(none.handle(), out.handle(), &slot, 1), kEmptyInput);
    EXPECT_EQ(ReQMFFTH(none_real.handle(), out.handle(), &slot), kEmptyInput);
    EXPECT_EQ(ReQMFFTH80(none_real.handle(), out.handle(), &slot, -1, 0, 0), kEmptyInput);
    EXPECT_EQ(ReQMFFTH80(some_real.handle(), out.handle(), &slot, -1, 0, 0), kBadIndex);
    EXPECT_EQ(ReQMFFTH80(some_real.handle(), out.handle(), &slot, 2, 4, 0), kBadIndex);
    EXPECT_EQ(ReQMFFTH80(some_real.handle(), out.handle(), &slot, 1, 0, 0), kNoChannel);
    EXPECT_EQ(ReQMFFTH80(some_real.handle(), out.handle(), &slot, 1, -7, 0), kNoChannel);
    EXPECT_EQ(ReQMFFTHCH(none_real.handle(), out_real.handle(), &slot), kEmptyInput);
    EXPECT_EQ(InvReQMFFTH(none.handle(), out_real.handle(), &slot), kEmptyInput);
    EXPECT_EQ(InvReQMFFTH80(none.handle(), out_real.handle(), &slot, 1), kEmptyInput);
    EXPECT_EQ(InvReQMFFTHCH(none_real.handle(), out_real.handle(), &slot), kEmptyInput);
    // None of them touched its output, or the slot.
    EXPECT_THAT(out.values(), ElementsAre(Complex{9, 8}));
    EXPECT_THAT(out_real.values(), ElementsAre(5));
    EXPECT_EQ(slot, nullptr);
}

TEST_F(FftEntry, TakesANegativeLengthWordForEmpty) {
    HostArray<Complex> in{{1, 0}}, out{{9, 8}};
    in.SetDimension(0, -3);
    EXPECT_EQ(CxQMFFTH(in.handle(), out.handle(), &slot), kEmptyInput);
    EXPECT_EQ(InvCxQMFFTH(in.handle(), out.handle(), &slot), kEmptyInput);
}

// A complex output hands on the status of the host; a real one is out of memory whatever it was.
TEST_F(FftEntry, EmptiesItsOutputWhenTheHostRefuses) {
    const HostArray<Complex> in{{1, 0}, {2, 0}, {3, 0}};
    const HostArray<double> real{1, 2, 3};
    const auto expect = [&](int32_t status, auto&& output, auto&& call) {
        const FailResize fail(1, kHostRefusal);
        EXPECT_EQ(call(output), status);
        EXPECT_TRUE(output.empty());
    };
    using Complexes = HostArray<Complex>;
    using Doubles = HostArray<double>;
    expect(kHostRefusal, Complexes{{9, 9}}, [&](auto& y) { return CxQMFFTH(in.handle(), y.handle(), &slot); });
    expect(kHostRefusal, Complexes{{9, 9}}, [&](auto& y) { return InvCxQMFFTH(in.handle(), y.handle(), &slot); });
    expect(kHostRefusal, Complexes{{9, 9}}, [&](auto& y) { return ReQMFFTH(real.handle(), y.handle(), &slot); });
    EXPECT_NE(slot, nullptr);
    void* fresh = nullptr;
    expect(kOutOfMemory, Doubles{9}, [&](auto& y) { return ReQMFFTHCH(real.handle(), y.handle(), &fresh); });
    expect(kOutOfMemory, Doubles{9}, [&](auto& y) {
        HostArray<double> spectrum{1, 2, 3};
        const int32_t status = InvReQMFFTHCH(spectrum.handle(), y.handle(), &fresh);
        EXPECT_THAT(spectrum.values(), ElementsAre(1, 2, 3));
        return status;
    });
    EXPECT_EQ(fresh, nullptr);
    expect(kOutOfMemory, Doubles{9}, [&](auto& y) { return InvReQMFFTH(in.handle(), y.handle(), &fresh); });
    EXPECT_NE(fresh, nullptr);
}

TEST_F(FftEntry, EmptiesRealOutputsAsComplexOnes) {
    const HostArray<Complex> in{{1, 0}, {2, 0}, {3, 0}};
    HostArray<double> out{9};
    const FailResize fail(1, kHostRefusal);
    const ResizeLog log;
    ASSERT_EQ(InvReQMFFTH(in.handle(), out.handle(), &slot), kOutOfMemory);
    ASSERT_EQ(log.size(), 2);
    EXPECT_EQ(log[0].typeCode, KRRT_DOUBLE);
    EXPECT_EQ(log[1].typeCode, KRRT_COMPLEX);
    EXPECT_EQ(log[1].totalElements, 0);
}

TEST_F(FftEntry, ReadsOneHalfOfAHermitianSpectrum) {
    const HostArray<Complex> spectrum{{6, kNaN}, {1, 2}, {4, kNaN}, {kNaN, kNaN}};
    const HostArray<Complex> clean{{6, 0}, {1, 2}, {4, 0}, {1, -2}};
    HostArray<double> x, y;
    ASSERT_EQ(InvReQMFFTH(spectrum.handle(), x.handle(), &slot), kOk);
    ASSERT_EQ(InvReQMFFTH(clean.handle(), y.handle(), &slot), kOk);
    EXPECT_EQ(x.values(), y.values());
}

TEST_F(FftEntry, WorksOnOneArray) {
    const std::vector<Complex> x = RandomComplex(12);
    const HostArray<Complex> both(x);
    ASSERT_EQ(CxQMFFTH80(both.handle(), both.handle(), &slot, 2, 20, 1), kOk);
    EXPECT_LT(RelativeError(both.values(), Rounded(Shifted(ReferenceOf(SectionOf(x, 2, 20))))), kTolerance);
    const std::vector<double> r = RandomReal(12);
    const HostArray<double> real(r);
    ASSERT_EQ(ReQMFFTHCH(real.handle(), real.handle(), &slot), kOk);
    ASSERT_EQ(InvReQMFFTHCH(real.handle(), real.handle(), &slot), kOk);
    for (int32_t k = 0; k < 12; ++k) EXPECT_NEAR(real[k], r[static_cast<size_t>(k)], kTolerance);
}

TEST_F(FftEntry, KeepsTheTableOfItsLastLength) {
    const HostArray<Complex> a(RandomComplex(16)), b(RandomComplex(20));
    HostArray<Complex> out;
    ASSERT_EQ(CxQMFFTH(a.handle(), out.handle(), &slot), kOk);
    void* record = slot;
    const qmfft_table* table = TableOf(slot);
    EXPECT_EQ(table->length, 16);
    EXPECT_EQ(table->refCount, 1u);
    EXPECT_EQ(instance.pending_cleanups(), 1);

    ASSERT_EQ(CxQMFFTH(a.handle(), out.handle(), &slot), kOk);
    EXPECT_EQ(TableOf(slot), table);
    EXPECT_EQ(table->refCount, 1u);
    ASSERT_EQ(CxQMFFTH(a.handle(), out.handle(), &other), kOk);
    EXPECT_EQ(TableOf(other), table);
    EXPECT_EQ(table->refCount, 2u);

    ASSERT_EQ(CxQMFFTH(b.handle(), out.handle(), &slot), kOk);
    EXPECT_EQ(slot, record);
    EXPECT_EQ(TableOf(slot)->length, 20);
    EXPECT_EQ(table->refCount, 1u);
    EXPECT_EQ(instance.pending_cleanups(), 2);  // one for each slot
}

TEST_F(FftEntry, ReleasesTablesWithTheInstance) {
    qmfft_table* table = create_qmfft_table(16);
    {
        const HostInstance caller;
        const HostArray<Complex> x(RandomComplex(16));
        HostArray<Complex> out;
        void* own = nullptr;
        ASSERT_EQ(CxQMFFTH(x.handle(), out.handle(), &own), kOk);
        EXPECT_EQ(table->refCount, 2u);
    }
    EXPECT_EQ(table->refCount, 1u);
    destroy_qmfft_table(table);
}

TEST_F(FftEntry, HandsOutTables) {
    EXPECT_EQ(create_qmfft_table(0), nullptr);
    EXPECT_EQ(create_qmfft_table(-1), nullptr);
    destroy_qmfft_table(nullptr);
    qmfft_table* table = create_qmfft_table(106);
    ASSERT_NE(table, nullptr);
    EXPECT_EQ(create_qmfft_table(106), table);
    EXPECT_EQ(table->refCount, 2u);
    EXPECT_EQ(table->factorCount, 2);
    EXPECT_EQ(table->factors[1], 53);
    destroy_qmfft_table(table);
    EXPECT_EQ(table->refCount, 1u);
    destroy_qmfft_table(table);
}

}  // namespace
}  // namespace krnumer
