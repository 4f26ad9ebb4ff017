#include "filter/narrowband_design.h"

#include <algorithm>
#include <cmath>
#include <utility>

#include "filter/equiripple.h"
#include "frame/numeric.h"
#include "frame/status.h"

namespace krnumer {
namespace {

constexpr double kMostTaps = 1e6;  // also the largest factor that is looked at

// The request as it is designed: type after complements are taken, half widths around fc, and deviations.
struct Target {
    double fs;
    double fp, fstop;
    double fc;
    double pass_deviation, stop_deviation;
    int32_t type;

    double transition() const { return fstop - fp; }
    double stop_weight() const { return pass_deviation / stop_deviation; }

    // Turns pass band and stop band into each other.
    void SwapDeviations() { std::swap(pass_deviation, stop_deviation); }
    void Mirror() {
        fp = fs / 2.0 - fp;
        fstop = fs / 2.0 - fstop;
    }
    // A wide lowpass becomes the complement of a narrow highpass, which is designed as its mirror.
    void TakeComplement() {
        Mirror();
        std::swap(fp, fstop);
        SwapDeviations();
    }
};

// What a design settles before any tap is computed.
struct Plan {
    int32_t factor = 1;
    int32_t prototype = 0, interpolator = 0;  // lengths
    // Of bands: where the prototype has its centre, the how-manieth repetition of it is wanted, and how wide the
    // interpolator's transition may be.
    double centre = 0.0;
    double image = 1.0;
    double interpolator_transition = 0.0;
};

Target TargetOf(const NarrowbandRequest& request) {
    Target target{request.fs,  request.fp,     request.fstop,
                  request.fc,  request.ripple, std::pow(10.0, -request.attenuation / 20.0),
                  request.type};
    const double quarter = target.fs / 4.0;
    switch (request.type) {
        case kLowpass:
            if (target.fp > quarter) {
                target.type = kComplementaryLowpass;
                target.TakeComplement();
            }
            break;
        case kHighpass:
            target.Mirror();
            if (target.fp > quarter) {
                target.type = kComplementaryHighpass;
                target.TakeComplement();
            }
            break;
        case kBandpass:
            target.fp /= 2.0;
            target.fstop /= 2.0;
            break;
        case kBandstop:
            std::swap(target.fp, target.fstop);
            target.fp /= 2.0;
            target.fstop /= 2.0;
            target.SwapDeviations();
            break;
        default:
            break;
    }
    target.pass_deviation /= 2.0;
    return target;
}

bool IsPossible(const Target& target) {
    return target.fp > 0.0 && target.fp < target.fstop && target.fstop < target.fs / 2.0 &&
           target.stop_deviation > 0.0 && target.pass_deviation > 0.0;
}

bool IsBand(int32_t type) {
    return type == kBandpass || type == kBandstop;
}

// Truncated; false when there can be no such length.
bool ToLength(double value, int32_t* length) {
    if (!(value <= kMostTaps)) return false;
    *length = SaturateToInt32(std::max(value, -kMostTaps));
    return true;
}

// The number of taps that meet two deviations is this, divided by the width of the transition in cycles per sample
// (J. F. Kaiser, Proc. IEEE Int. Symp. Circuits and Systems, 20, 1974).
double TapsTimesTransition(double deviation_product) {
    return (-20.0 * std::log10(std::sqrt(deviation_product)) - 13.0) / 14.6;
}

struct Estimates {
    explicit Estimates(const Target& target)
        : of_two(TapsTimesTransition(target.pass_deviation * target.stop_deviation / 2.0)),
          of_one(TapsTimesTransition(target.pass_deviation * target.stop_deviation)) {}

    double of_two;  // for each of two filters in cascade, which share the pass band ripple
    double of_one;
};

// A lowpass: the best factor in closed form, unless one filter alone is no longer.
bool PlanLow(const Target& target, Plan* plan) {
    const Estimates estimates(target);
    const double fs = target.fs;
    const double d = target.transition();
    double factor = std::floor(fs / (std::sqrt(d * fs) + target.fp + target.fstop) + 0.5);
    if (!(factor <= kMostTaps)) return false;
    while (factor > 1.0 && factor * target.fstop >= fs / 2.0) factor -= 1.0;
    plan->factor = SaturateToInt32(factor);
    if (!ToLength(estimates.of_two / (factor * d / fs), &plan->prototype)) return false;
    if (plan->factor > 1 &&
        !ToLength(estimates.of_two / ((fs / factor - target.fstop - target.fp) / fs), &plan->interpolator))
        return false;

    int32_t single;
    if (!ToLength(estimates.of_one / (d / fs), &single)) return false;
    if (single <= plan->prototype + plan->interpolator) {
        plan->factor = 1;
        plan->prototype = single;
        plan->interpolator = 0;
    }
    return true;
}

// A band: among all factors for which the repetition of the prototype at fc stands free of its neighbours, the one with
// the fewest taps.
bool PlanBand(const Target& target, Plan* plan) {
    constexpr double kMostRepetitions = 1073741824.0;  // 2^30
    const Estimates estimates(target);
    const double fs = target.fs;
    const double d = target.transition();
    int32_t most;
    if (!ToLength(0.25 * fs / target.fstop, &most)) return false;
    if (!ToLength(estimates.of_one / (d / fs), &plan->prototype)) return false;
    plan->centre = target.fc;
    int32_t fewest = plan->prototype;
    for (int32_t factor = 2; factor <= most; ++factor) {
        const double spread = factor * target.fc;
        const double periods = std::floor(spread / fs);
        if (!(periods < kMostRepetitions)) continue;
        double centre = spread - periods * fs;
        double image = 2.0 * periods + 1.0;
        if (centre > fs / 2.0) {
            centre = fs - centre;
            image += 1.0;
        }
        if (!(centre + factor * target.fstop < fs / 2.0 && centre - factor * target.fstop > 0.0)) continue;

        const bool from_above =
            image == 1.0 || (image == factor && factor % 2 == 0) || (image != factor && centre > fs / 4.0);
        const double room = (from_above ? fs - 2.0 * centre : 2.0 * centre) / factor;
        const double transition = room - target.fstop - target.fp;
        int32_t prototype, interpolator;
        if (!ToLength(estimates.of_two / (factor * d / fs), &prototype)) return false;
        if (!ToLength(estimates.of_two / (transition / fs), &interpolator)) return false;
        if (prototype + interpolator >= fewest) continue;
        fewest = prototype + interpolator;
        *plan = {factor, prototype, interpolator, centre, image, transition};
    }
    return true;
}

// Estimates fall short for long filters.
int32_t Lengthened(int32_t length) {
    return length > 100 ? SaturateToInt32(1.1 * length) : length;
}

// The shortest filter from `length` on, in steps of a twentieth, whose deviation is small enough.
int32_t DesignTaps(const Target& target, const FirBand* bands, int32_t band_count, int32_t length, Taps* taps) {
    for (;; length = SaturateToInt32(std::ceil(1.05 * length))) {
        if (target.type != kLowpass && length % 2 == 0) ++length;
        if (!taps->values.Allocate(Count(length))) return kOutOfMemory;
        taps->count = length;
        double ripple;
        if (const int32_t status =
                EquirippleDesign(length, target.fs, bands, band_count, kMultiband, 0, taps->values.data(), &ripple))
            return status;
        if (ripple <= target.pass_deviation) return kOk;
    }
}

// Below `pass` 1 and above `stop` 0, or the other way round.
int32_t DesignLow(const Target& target, double pass, double stop, int32_t length, Taps* taps) {
    const FirBand bands[] = {{1.0, 0.0, pass, 1.0}, {0.0, stop, target.fs / 2.0, target.stop_weight()}};
    return DesignTaps(target, bands, 2, length, taps);
}
int32_t DesignHigh(const Target& target, double stop, double pass, int32_t length, Taps* taps) {
    const FirBand bands[] = {{0.0, 0.0, stop, target.stop_weight()}, {1.0, pass, target.fs / 2.0, 1.0}};
    return DesignTaps(target, bands, 2, length, taps);
}

// 1 within `pass` of the centre, 0 beyond `stop` of it.
int32_t DesignAround(const Target& target, double centre, double pass, double stop, int32_t length, Taps* taps) {
    const FirBand bands[] = {{0.0, 0.0, centre - stop, target.stop_weight()},
                             {1.0, centre - pass, centre + pass, 1.0},
                             {0.0, centre + stop, target.fs / 2.0, target.stop_weight()}};
    return DesignTaps(target, bands, 3, length, taps);
}

int32_t DesignPrototype(const Target& target, const Plan& plan, Taps* taps) {
    const double pass = plan.factor * target.fp;
    const double stop = plan.factor * target.fstop;
    const int32_t length = Lengthened(plan.prototype);
    return IsBand(target.type) ? DesignAround(target, plan.centre, pass, stop, length, taps)
                               : DesignLow(target, pass, stop, length, taps);
}

int32_t DesignInterpolator(const Target& target, const Plan& plan, Taps* taps) {
    const int32_t length = Lengthened(plan.interpolator);
    if (!IsBand(target.type)) return DesignLow(target, target.fp, target.fs / plan.factor - target.fstop, length, taps);
    const double stop = target.fp + plan.interpolator_transition;
    if (plan.image == 1.0) return DesignLow(target, target.fc + target.fp, target.fc + stop, length, taps);
    if (plan.image == plan.factor) return DesignHigh(target, target.fc - stop, target.fc - target.fp, length, taps);
    return DesignAround(target, target.fc, target.fp, stop, length, taps);
}

// Turns the response round: what was at frequency f is at half the sampling frequency less f.
void Alternate(Taps* taps) {
    const int32_t middle = (taps->count - 1) / 2;
    for (int32_t i = 1 - middle % 2; i < taps->count; i += 2) taps->values[Count(i)] = -taps->values[Count(i)];
}

void Negate(Taps* taps) {
    for (int32_t i = 0; i < taps->count; ++i) taps->values[Count(i)] = -taps->values[Count(i)];
}

// Lowpass filters become what the type asks for, complements less than nothing where they are to take away.
void GiveSigns(NarrowbandFilter* filter) {
    const bool two = filter->factor != 1;
    Taps* const whole = two ? &filter->interpolator : &filter->prototype;
    if (filter->type == kHighpass || filter->type == kComplementaryLowpass) {
        Alternate(whole);
        if (two && filter->factor % 2 != 0) Alternate(&filter->prototype);
    }
    if (IsComplement(filter->type)) Negate(whole);
}

}  // namespace

int32_t NarrowbandDesign(const NarrowbandRequest& request, NarrowbandFilter* filter) {
    const Target target = TargetOf(request);
    if (!IsPossible(target) || !IsFilterType(request.type)) return kBadBands;
    Plan plan;
    if (!(IsBand(target.type) ? PlanBand(target, &plan) : PlanLow(target, &plan))) return kBadBands;
    if (plan.prototype < 0 || plan.interpolator < 0) return kBadBands;

    filter->type = target.type;
    filter->factor = plan.factor;
    if (const int32_t status = DesignPrototype(target, plan, &filter->prototype)) return status;
    filter->interpolator.count = 0;
    if (plan.factor != 1) {
        if (const int32_t status = DesignInterpolator(target, plan, &filter->interpolator)) return status;
    }
    GiveSigns(filter);
    return kOk;
}

}  // namespace krnumer
