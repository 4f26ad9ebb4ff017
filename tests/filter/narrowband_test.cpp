#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "filter/cascade_response.h"
#include "filter/draw.h"
#include "filter/fir_reference.h"
#include "frame/numeric.h"
#include "frame/status.h"
#include "krnumer/filter.h"
#include "support/host_arrays.h"

namespace krnumer {
namespace {

struct NarrowbandReference {
    double fs, fp, fstop, fc, ripple, attenuation;
    int32_t type;
    int32_t designed_type, factor, prototype_size, interpolator_size;
    std::vector<double> prototype_half, interpolator_half;
};

#include "reference/filter/narrowband.inc"

constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();

// A design and its use.
struct Narrowband {
    double fs = 1000.0, fp = 20.0, fstop = 30.0, fc = 0.0, ripple = 0.01, attenuation = 60.0;
    int32_t type = 0, err = 77;
    HostArray<double> prototype{9.0, 9.0}, interpolator{9.0};
    KrNarrowbandFilter filter{-5, -6, prototype.handle(), interpolator.handle()};

    Narrowband() = default;
    explicit Narrowband(const NarrowbandReference& reference)
        : fs(reference.fs),
          fp(reference.fp),
          fstop(reference.fstop),
          fc(reference.fc),
          ripple(reference.ripple),
          attenuation(reference.attenuation),
          type(reference.type) {}

    int32_t Make() { return FIRNarrowCoef_head(&fs, &fp, &fstop, &fc, &ripple, &attenuation, &type, &filter, &err); }
    int32_t Refusal() {
        EXPECT_EQ(Make(), 0);
        EXPECT_TRUE(prototype.empty() && interpolator.empty());
        EXPECT_EQ(filter.type, -5);
        EXPECT_EQ(filter.factor, -6);
        return err;
    }

    std::vector<double> Filter(const std::vector<double>& x) {
        const HostArray<double> signal(x);
        HostArray<double> y;
        EXPECT_EQ(FIRnarrowFilter_head(signal.handle(), &filter, y.handle(), &err), 0);
        EXPECT_EQ(err, kOk);
        return y.values();
    }
};

double Magnitude(const std::vector<double>& h, double f) {
    return std::abs(AtFrequency(h.data(), h.size(), f));
}

TEST(NarrowbandDesign, AgreesWithTheReference) {
    for (const NarrowbandReference& reference : kNarrowband) {
        Narrowband design(reference);
        EXPECT_EQ(design.Make(), 0);
        ASSERT_EQ(design.err, kOk);
        EXPECT_EQ(design.filter.type, reference.designed_type);
        EXPECT_EQ(design.filter.factor, reference.factor);
        EXPECT_THAT(design.prototype.values(),
                    AllNear(Mirrored(reference.prototype_half, reference.prototype_size, 1.0), 0.0, 1e-11));
        EXPECT_THAT(design.interpolator.values(),
                    AllNear(Mirrored(reference.interpolator_half, reference.interpolator_size, 1.0), 0.0, 1e-11));
    }
}

// Measured on the response of the filter at work.
TEST(NarrowbandDesign, MeetsRippleAndAttenuation) {
    for (const NarrowbandReference& reference : kNarrowband) {
        Narrowband design(reference);
        design.Make();
        const std::vector<double> response = design.Filter({1.0});
        const double pass_width = reference.fp / 2.0, stop_width = reference.fstop / 2.0;
        double ripple = 0.0, leak = 0.0;
        for (double f = 0.0; f <= 500.0; f += 0.25) {
            bool passes, stops;
            switch (reference.type) {
                case 0:
                    passes = f <= reference.fp;
                    stops = f >= reference.fstop;
                    break;
                case 1:
                    passes = f >= reference.fp;
                    stops = f <= reference.fstop;
                    break;
                case 2:
                    passes = std::fabs(f - reference.fc) <= pass_width;
                    stops = std::fabs(f - reference.fc) >= stop_width;
                    break;
                default:
                    passes = std::fabs(f - reference.fc) >= pass_width;
                    stops = std::fabs(f - reference.fc) <= stop_width;
            }
            const double magnitude = Magnitude(response, f / reference.fs);
            if (passes) ripple = std::max(ripple, std::fabs(magnitude - 1.0));
            if (stops) leak = std::max(leak, magnitude);
        }
        EXPECT_LT(ripple, 1.001 * reference.ripple) << reference.type << ' ' << reference.fp;
        EXPECT_LT(20.0 * std::log10(leak), -reference.attenuation + 0.3) << reference.type << ' ' << reference.fp;
    }
}

TEST(NarrowbandDesign, NeedsFewerTapsThanOneFilter) {
    Narrowband design;
    design.Make();
    EXPECT_EQ(design.filter.factor, 7);
    EXPECT_LT(design.prototype.size() + design.interpolator.size(), 100);  // one filter takes some 250
}

TEST(NarrowbandDesign, RefusesWhatCannotBe) {
    const auto status = [](auto change) {
        Narrowband design;
        change(design);
        return design.Refusal();
    };
    for (const double bad : {0.0, -1.0, kNaN, -kInfinity})
        EXPECT_EQ(status([&](Narrowband& d) { d.fp = bad; }), kBadBands);
    for (const double bad : {20.0, 10.0, 500.0, 600.0, kNaN, kInfinity, -1.0})
        EXPECT_EQ(status([&](Narrowband& d) { d.fstop = bad; }), kBadBands);
    for (const double bad : {0.0, -1000.0, kNaN, 1e-300, kInfinity})
        EXPECT_EQ(status([&](Narrowband& d) { d.fs = bad; }), kBadBands);
    for (const double bad : {0.0, -1.0, kNaN, kInfinity})
        EXPECT_NE(status([&](Narrowband& d) { d.ripple = bad; }), kOk);
    for (const double bad : {1e5, kNaN, kInfinity})
        EXPECT_EQ(status([&](Narrowband& d) { d.attenuation = bad; }), kBadBands);
    EXPECT_NE(status([](Narrowband& d) { d.attenuation = -kInfinity; }), kOk);
    for (const int32_t type : {4, 5, -1, 6, std::numeric_limits<int32_t>::min()})
        EXPECT_EQ(status([&](Narrowband& d) { d.type = type; }), kBadBands);
    // The highpass is mirrored first, so its stop band has to lie below.
    EXPECT_EQ(status([](Narrowband& d) { d.type = 1; }), kBadBands);
    // Nothing to filter: the estimate of the length is negative.
    EXPECT_EQ(status([](Narrowband& d) { d.ripple = d.attenuation = 1.0; }), kBadBands);
    // More than a million taps.
    EXPECT_EQ(status([](Narrowband& d) { d.fstop = d.fp * (1.0 + 1e-9); }), kBadBands);
    for (const int32_t type : {2, 3}) {
        for (const double fc : {-100.0, 600.0, kNaN, kInfinity, 1e300, -1e300, 1e12}) {
            EXPECT_NE(status([&](Narrowband& d) {
                          d.type = type;
                          d.fc = fc;
                          if (type == 3) std::swap(d.fp, d.fstop);
                      }),
                      kOk);
        }
        EXPECT_EQ(status([&](Narrowband& d) {
                      d.type = type;
                      d.fc = 250.0;
                      d.fp = type == 2 ? 1e-9 : 2e-9;
                      d.fstop = type == 2 ? 2e-9 : 1e-9;
                  }),
                  kBadBands);
    }
}

TEST(NarrowbandDesign, ReportsTheHostsRefusal) {
    for (const int32_t nth : {1, 2}) {
        Narrowband design;
        const FailResize failure(nth, 4711);
        EXPECT_EQ(design.Refusal(), kOutOfMemory);
        EXPECT_TRUE(failure.happened());
    }
}

// ---- At work --------------------------------------------------------------------------------------------------------

template <class T>
class NarrowbandFiltering : public testing::Test {
  protected:
    static constexpr auto Export = [] {
        if constexpr (std::is_same_v<T, double>) return FIRnarrowFilter_head;
        if constexpr (!std::is_same_v<T, double>) return CxSigFIRnarrowFilter_head;
    }();

    int32_t Call(const std::vector<T>& x) {
        err_ = 77;
        const HostArray<T> signal(x);
        const KrNarrowbandFilter filter{type_, factor_, prototype_.handle(), interpolator_.handle()};
        return Export(signal.handle(), &filter, y_.handle(), &err_);
    }

    int32_t Refusal(const std::vector<T>& x) {
        y_ = HostArray<T>(3);
        EXPECT_EQ(Call(x), 0);
        EXPECT_TRUE(y_.empty());
        return err_;
    }

    LeakCheck leaks_;
    int32_t type_ = 0, factor_ = 1, err_ = 77;
    HostArray<double> prototype_{1.0, 2.0, 3.0}, interpolator_{1.0, -1.0, 0.5, 2.0};
    HostArray<T> y_;
    std::mt19937 random_{9};
};
using Signals = testing::Types<double, Complex>;
TYPED_TEST_SUITE(NarrowbandFiltering, Signals);

TYPED_TEST(NarrowbandFiltering, ConvolvesWithBothParts) {
    using T = TypeParam;
    const std::vector<double> prototype = this->prototype_.values(), interpolator = this->interpolator_.values();
    for (this->type_ = 0; this->type_ < 6; ++this->type_) {
        for (const int32_t factor : {1, 2, 3, 7, 100}) {
            for (const std::size_t n : {1, 2, 5, 64, 301}) {
                this->factor_ = factor;
                const auto x = DrawArray<T>(n, this->random_);
                EXPECT_EQ(this->Call(x), 0);
                EXPECT_EQ(this->err_, kOk);

                const std::size_t last = 2 * static_cast<std::size_t>(factor) + (factor > 1 ? 3 : 0);
                std::vector<T> expected(last + n);
                for (std::size_t i = 0; i < n; ++i) {
                    for (std::size_t j = 0; j < 3; ++j) {
                        for (std::size_t k = 0; k < (factor > 1 ? 4 : 1); ++k) {
                            T& sum = expected[i + j * static_cast<std::size_t>(factor) + k];
                            sum = sum + x[i] * (prototype[j] * (factor > 1 ? interpolator[k] : 1.0));
                        }
                    }
                    if (this->type_ >= 3) expected[i + last / 2] = expected[i + last / 2] + x[i];
                }
                EXPECT_THAT(this->y_.values(), AllNear(expected, 0.0, 1e-13)) << factor << ' ' << n;
            }
        }
    }
}

TYPED_TEST(NarrowbandFiltering, MayReplaceItsInput) {
    using T = TypeParam;
    const auto x = DrawArray<T>(20, this->random_);
    this->factor_ = 3;
    this->Call(x);
    HostArray<T> signal(x);
    const KrNarrowbandFilter filter{0, 3, this->prototype_.handle(), this->interpolator_.handle()};
    this->Export(signal.handle(), &filter, signal.handle(), &this->err_);
    EXPECT_THAT(signal.values(), SameBitsAs(this->y_.values()));
}

TYPED_TEST(NarrowbandFiltering, RefusesInAFixedOrder) {
    using T = TypeParam;
    const std::vector<T> none, one{FromReal<T>(1.0)};
    this->factor_ = 0;
    EXPECT_EQ(this->Refusal(none), kEmptyInput);
    for (const int32_t factor : {0, -1, std::numeric_limits<int32_t>::min()}) {
        this->factor_ = factor;
        EXPECT_EQ(this->Refusal(one), kBadSelector);
    }
    this->factor_ = std::numeric_limits<int32_t>::max();
    EXPECT_EQ(this->Refusal(one), kOutOfMemory);  // longer than any array
    this->interpolator_ = HostArray<double>();
    EXPECT_EQ(this->Refusal(one), kEmptyInput);
    this->factor_ = 1;
    EXPECT_EQ(this->Call(one), 0);
    EXPECT_EQ(this->err_, kOk);
    this->prototype_ = HostArray<double>();
    EXPECT_EQ(this->Refusal(one), kEmptyInput);
}

TYPED_TEST(NarrowbandFiltering, ReportsTheHostsRefusal) {
    const FailResize failure(1, 4711);
    EXPECT_EQ(this->Refusal({FromReal<TypeParam>(1.0)}), kOutOfMemory);
}

TEST(NarrowbandFiltering, DoesNotMixThePartsOfASignal) {
    const HostArray<double> prototype{1.0, 2.0}, interpolator{1.0};
    const HostArray<Complex> x{{kInfinity, 1.0}, {0.0, 2.0}};
    HostArray<Complex> y;
    int32_t err = 77;
    for (const int32_t factor : {1, 2}) {
        const KrNarrowbandFilter filter{0, factor, prototype.handle(), interpolator.handle()};
        CxSigFIRnarrowFilter_head(x.handle(), &filter, y.handle(), &err);
        for (const Complex& sample : y.values()) EXPECT_TRUE(std::isfinite(sample.im));
        EXPECT_EQ(y[0].re, kInfinity);
    }
}

}  // namespace
}  // namespace krnumer
