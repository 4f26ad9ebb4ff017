#include "filter/fir_design.h"

#include <cmath>

#include "filter/filter_type.h"
#include "frame/numeric.h"
#include "frame/status.h"

namespace krnumer {
namespace {

constexpr double kPerPi = 0.3183098861837907;  // 1 / pi

// Contribution of an edge to the impulse response. Seen from the middle of the filter it is sin(w t) / (pi t), and the
// angle advances by w from tap to tap.
class Edge {
  public:
    Edge(double sign, double w, int32_t taps) : sign_(sign), w_(w), angle_(-(taps - 1) * w / 2.0) {}

    double Next() {
        const double value = sign_ * std::sin(angle_);
        angle_ += w_;
        return value;
    }
    double MiddleTimesPi() const { return sign_ * w_; }

  private:
    double sign_;
    double w_;
    double angle_;
};

}  // namespace

int32_t TruncatedIdealDesign(double fs, double fl, double fh, int32_t type, double* h, int32_t taps) {
    if (!IsFilterType(type)) return kBadSelector;
    const bool two_edges = HasTwoEdges(type);
    const double nyquist = fs / 2.0;
    if (taps < 1) return kBadOrder;
    if (fl > nyquist || (two_edges && fh > nyquist)) return kCutoffAboveNyquist;
    if (!(fs > 0.0 && fl > 0.0)) return kBadFrequency;
    if (two_edges && !(fh > 0.0 && fl < fh)) return kBadFrequency;
    const bool passes_nyquist = type == kHighpass || type == kBandstop;
    if (passes_nyquist && taps % 2 == 0) return kEvenLength;

    // What lies below an edge is let through by a lowpass, and by a bandpass for its upper edge.
    const double lower_sign = type == kLowpass || type == kBandstop ? 1.0 : -1.0;
    Edge lower(lower_sign, 2.0 * kPi * fl / fs, taps);
    Edge upper(-lower_sign, two_edges ? 2.0 * kPi * fh / fs : 0.0, taps);
    double divisor = -(taps - 1) * kPi / 2.0;
    for (int32_t i = 0; i < taps / 2; ++i) {
        h[i] = h[taps - 1 - i] = (upper.Next() + lower.Next()) / divisor;
        divisor += kPi;
    }
    if (taps % 2 != 0)
        h[taps / 2] = (passes_nyquist ? 1.0 : 0.0) + (upper.MiddleTimesPi() + lower.MiddleTimesPi()) * kPerPi;
    return kOk;
}

}  // namespace krnumer
