#include "filter/iir_design.h"

#include <cmath>

#include "filter/elliptic_function.h"
#include "filter/filter_type.h"
#include "frame/numeric.h"
#include "frame/status.h"

namespace krnumer {
namespace {

int32_t CheckFrequencies(const FilterBand& band) {
    const bool two_edges = HasTwoEdges(band.type);
    if (band.order < 1) return kBadOrder;
    if (!(band.fl > 0.0)) return kBadFrequency;
    if (two_edges && !(band.fh > 0.0 && band.fl < band.fh)) return kBadFrequency;
    if (!(band.fs > 0.0)) return kBadFrequency;
    const double nyquist = band.fs / 2.0;
    if (band.fl > nyquist || (two_edges && band.fh > nyquist)) return kCutoffAboveNyquist;
    return kOk;
}

int32_t CheckOutput(const FilterBand& band, const CascadeOutput& output) {
    if (!IsFilterType(band.type)) return kBadSelector;
    const CascadeLengths lengths = LengthsOf(band.order, band.type);
    return output.na < lengths.a || output.nb < lengths.b ? kBadCoefficientCount : kOk;
}

// The section of the real pole, if the order is odd, and those of the pairs.
template <class PairAt>
int32_t WriteSections(const FilterBand& band, const CascadeOutput& output, double real_pole, PairAt pair_at) {
    SectionWriter writer(band, output.a, output.b);
    if (band.order % 2 != 0) writer.WriteReal(real_pole);
    for (int32_t k = 0; k < band.order / 2; ++k) writer.WritePair(pair_at(k));
    return kOk;
}

// Angle of the k-th of the poles on the unit circle, from the imaginary axis on.
double PoleAngle(int32_t order, int32_t k) {
    return (kPi / order + kPi) / 2.0 + k * kPi / order;
}

// Pairs of a prototype are those of the odd multiples of a step for an even order, of the even ones for an odd order.
double StepsOfPair(int32_t order, int32_t k) {
    return 2.0 * k + (order % 2 != 0 ? 2.0 : 1.0);
}

// Half axes of the ellipse on which the poles of a Chebyshev filter lie.
struct Ellipse {
    Ellipse(double base, int32_t order) {
        const double g = std::pow(base, 1.0 / order);
        major = (g + 1.0 / g) / 2.0;
        minor = (g - 1.0 / g) / 2.0;
    }
    double major, minor;
};

double FromDecibels(double decibels) {
    return std::pow(10.0, decibels / 10.0);
}

}  // namespace

CascadeLengths LengthsOf(int32_t order, int32_t type) {
    const int64_t sections = (int64_t{order} + 1) / 2;
    const int64_t section_order = HasTwoEdges(type) ? 4 : 2;
    return {section_order * sections, (section_order + 1) * sections};
}

int32_t ButterworthDesign(const FilterBand& band, const CascadeOutput& output) {
    if (const int32_t status = CheckFrequencies(band)) return status;
    if (const int32_t status = CheckOutput(band, output)) return status;
    return WriteSections(band, output, 1.0, [&](int32_t k) {
        return PolePair{-std::cos(PoleAngle(band.order, k)), 1.0};
    });
}

int32_t BesselDesign(const FilterBand& band, const CascadeOutput& output) {
    if (const int32_t status = CheckFrequencies(band)) return status;
    if (const int32_t status = CheckOutput(band, output)) return status;
    return WriteSections(band, output, 1.0, [&](int32_t k) {
        const double x = 1.0 - (2.0 * k + 1.0) / band.order;
        return PolePair{std::sqrt(1.0 - x * x), 1.0};
    });
}

int32_t ChebyshevDesign(const FilterBand& band, double ripple, const CascadeOutput& output) {
    if (const int32_t status = CheckFrequencies(band)) return status;
    if (!(ripple > 0.0)) return kBadRipple;
    if (const int32_t status = CheckOutput(band, output)) return status;

    const double r = FromDecibels(ripple);
    const Ellipse ellipse((std::sqrt(r) + 1.0) / std::sqrt(r - 1.0), band.order);
    const double s = ellipse.minor;
    const double s_square = s * s;
    const double c_square = ellipse.major * ellipse.major;

    // With an even order the response at the reference frequency is the lower bound of the ripple. One section takes
    // it.
    const int32_t lowered = band.order % 2 != 0 ? -1 : HasTwoEdges(band.type) ? band.order / 2 - 1 : 0;
    // A filter of first order has no ripple to shape; with two edges it is the Butterworth filter.
    const double real_pole = band.order == 1 && HasTwoEdges(band.type) ? 1.0 : s;
    return WriteSections(band, output, real_pole, [&](int32_t k) {
        const double angle = PoleAngle(band.order, k);
        PolePair pair;
        pair.damping = -std::cos(angle) * s;
        pair.square = (std::cos(2.0 * angle) * (s_square - c_square) + c_square + s_square) / 2.0;
        if (k == lowered) pair.gain = 1.0 / std::sqrt(r);
        return pair;
    });
}

// The poles are the reciprocals of those of a Chebyshev filter, and its extrema become zeros.
int32_t InverseChebyshevDesign(const FilterBand& band, double attenuation, const CascadeOutput& output) {
    if (const int32_t status = CheckFrequencies(band)) return status;
    if (!(attenuation > 0.0)) return kBadAttenuation;
    if (const int32_t status = CheckOutput(band, output)) return status;

    const double e = 1.0 / std::sqrt(FromDecibels(attenuation) - 1.0);
    const Ellipse ellipse((std::sqrt(e * e + 1.0) + 1.0) / e, band.order);
    return WriteSections(band, output, 1.0 / ellipse.minor, [&](int32_t k) {
        const double angle = PoleAngle(band.order, k);
        const double re = std::cos(angle) * ellipse.minor;
        const double im = std::sin(angle) * ellipse.major;
        const double square = re * re + im * im;
        const double inverse_zero = std::sin(StepsOfPair(band.order, k) * kPi / (2.0 * band.order));
        return PolePair{-re / square, 1.0 / square, inverse_zero * inverse_zero};
    });
}

// T. W. Parks, C. S. Burrus, Digital Filter Design, Wiley 1987, section 7.2.7.
int32_t EllipticDesign(const FilterBand& band, double ripple, double attenuation, const CascadeOutput& output) {
    if (const int32_t status = CheckFrequencies(band)) return status;
    if (!(ripple > 0.0)) return kBadRipple;
    if (!(attenuation > 0.0)) return kBadAttenuation;
    if (!(attenuation > ripple)) return kAttenuationBelowRipple;
    if (const int32_t status = CheckOutput(band, output)) return status;

    // The modulus k1 belongs to the ratio of the two ripples, k to the steepness that the order gives for it.
    const double e = std::sqrt(FromDecibels(ripple) - 1.0);
    const double k1 = e / std::sqrt(FromDecibels(attenuation) - 1.0);
    const double complete_k1 = CompleteK(std::sqrt(1.0 - k1 * k1));
    const double k = ModulusFromRatio(CompleteK(k1) / complete_k1 / band.order);
    const double complementary = std::sqrt(1.0 - k * k);
    const double step = CompleteK(complementary) / band.order;
    const JacobiValues v = JacobiSnCnDn(step * IncompleteEl1(1.0 / e, k1) / complete_k1, k);

    const double product = v.sn * v.cn;
    const double real_pole = product / (1.0 - v.sn * v.sn);
    return WriteSections(band, output, real_pole, [&](int32_t i) {
        const JacobiValues u = JacobiSnCnDn(StepsOfPair(band.order, i) * step, complementary);
        const double w = 1.0 - u.dn * u.dn * v.sn * v.sn;
        const double sigma = u.cn * u.dn * product / w;
        const double omega = u.sn * v.dn / w;
        PolePair pair{sigma, omega * omega + sigma * sigma, (u.sn * k) * (u.sn * k)};
        if (i == 0 && band.order % 2 == 0) pair.gain = 1.0 / std::sqrt(e * e + 1.0);
        return pair;
    });
}

}  // namespace krnumer
