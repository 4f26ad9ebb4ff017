#include "peak/quadratic_peaks.h"

#include <algorithm>
#include <bit>
#include <cmath>
#include <cstring>

#include "frame/numeric.h"
#include "frame/status.h"

namespace krnumer {

namespace {

constexpr double kLeastCurvature = 1e-10;

// Below this width a sign change of the slope says too little, and the curvature alone decides.
constexpr int32_t kLeastWidthOfSlopes = 5;

double Vertex(const Parabola& parabola) {
    return -parabola.a1 / (2.0 * parabola.a2);
}

class Scan {
  public:
    Scan(PeakScan* state, const PeakCriteria& criteria, PeakList* peaks)
        : state_(*state), criteria_(criteria), peaks_(*peaks), half_(0.5 * (state->width - 1)) {}

    // Looks at the next windows, one or more.
    int32_t Take(const ParabolaFits& fits, int32_t count) {
        for (uint64_t candidates = Candidates(fits, count); candidates != 0; candidates &= candidates - 1) {
            const int32_t k = std::countr_zero(candidates);
            const Parabola previous = k > 0 ? fits[k - 1] : state_.previous;
            const uint32_t position = state_.processed + static_cast<uint32_t>(k);
            if (const int32_t status = Judge(fits[k], previous, position)) return status;
        }
        state_.rising = fits.IsRising(count - 1);
        state_.previous = fits[count - 1];
        state_.processed += static_cast<uint32_t>(count);
        return kOk;
    }

  private:
    // A bit for each window: where the slope has another sign than in the window before, or where the bend is right.
    uint64_t Candidates(const ParabolaFits& fits, int32_t count) const {
        if (state_.width >= kLeastWidthOfSlopes) {
            const uint64_t all = ~uint64_t{0} >> (ParabolaFits::kMost - count);
            return (fits.rising ^ (fits.rising << 1 | (state_.rising ? 1 : 0))) & all;
        }
        uint64_t bent_right = 0;
        for (int32_t k = 0; k < count; ++k) bent_right |= uint64_t{IsBentRight(fits[k])} << k;
        return bent_right;
    }

    bool IsBentRight(const Parabola& parabola) const {
        return criteria_.valleys ? parabola.a2 > 0.0 : parabola.a2 < 0.0;
    }

    // A window that begins at `position` of the signal.
    int32_t Judge(Parabola parabola, const Parabola& previous, double position) {
        if (std::fabs(2.0 * parabola.a2) < kLeastCurvature) return kOk;
        double vertex = Vertex(parabola);
        if (position > 0.0 && vertex < -0.5) {
            // nearer to the middle of the window before, perhaps
            if (2.0 * previous.a2 == 0.0) return kOk;
            const double previous_vertex = Vertex(previous);
            if (std::fabs(previous_vertex) < std::fabs(vertex)) {
                parabola = previous;
                vertex = previous_vertex;
                position -= 1.0;
            }
        }
        if (std::fabs(vertex) > 0.5 * half_ + 2.220446049250313e-15) return kOk;
        const double amplitude = (vertex * parabola.a2 + parabola.a1) * vertex + parabola.a0;
        const bool beyond = criteria_.valleys ? amplitude < criteria_.threshold : amplitude > criteria_.threshold;
        if (!IsBentRight(parabola) || !beyond) return kOk;
        return Add({position + vertex + half_, amplitude, 2.0 * parabola.a2});
    }

    int32_t Add(const Peak& peak) {
        if (peaks_.count() == 0 || std::fabs(peak.location - peaks_.last().location) >= 1.0) {
            return peaks_.Append(peak) ? kOk : kOutOfMemory;
        }
        const double last = peaks_.last().amplitude;
        if (criteria_.valleys ? peak.amplitude < last : peak.amplitude >= last) peaks_.last() = peak;
        return kOk;
    }

    PeakScan& state_;
    const PeakCriteria& criteria_;
    PeakList& peaks_;
    const double half_;
};

}  // namespace

bool PeakList::Append(const Peak& peak) {
    constexpr int32_t kStep = 512;
    if (count_ == capacity_) {
        if (!peaks_.Grow(Count(capacity_) + kStep)) return false;
        capacity_ += kStep;
    }
    ++count_;
    last() = peak;
    return true;
}

int32_t FindQuadraticPeaks(PeakScan* state, const double* x, int32_t n, const PeakCriteria& criteria, bool last_block,
                           PeakList* peaks) {
    const int32_t width = state->width;
    const int32_t missing = std::min(width - state->held, n);
    std::copy_n(x, missing, state->history + state->held);
    state->held += missing;
    if (state->held < width) return kOk;
    const double* const fresh = x + missing;
    const int32_t count = n - missing;

    Scan scan(state, criteria, peaks);
    ParabolaFits fits;
    if (state->processed == 0) {
        FitParabolas(state->weights, width, state->history, 1, &fits);
        state->rising = fits.IsRising(0);
    }
    // Window i starts i samples into the history with the new samples behind it.
    const int64_t windows = int64_t{count} + (last_block ? 1 : 0);
    for (int64_t i = 0; i < windows;) {
        int32_t fitted = 1;
        if (i < width) {
            const auto begin = static_cast<int32_t>(i);
            std::copy_n(state->history + begin, width - begin, state->window);
            std::copy_n(fresh, begin, state->window + (width - begin));
            FitParabolas(state->weights, width, state->window, 1, &fits);
        } else {
            fitted = static_cast<int32_t>(std::min<int64_t>(windows - i, ParabolaFits::kMost));
            FitParabolas(state->weights, width, fresh + (i - width), fitted, &fits);
        }
        if (const int32_t status = scan.Take(fits, fitted)) return status;
        i += fitted;
    }

    const int32_t kept = std::max(width - count, 0);
    std::memmove(state->history, state->history + (width - kept), Count(kept) * sizeof(double));
    std::copy_n(fresh + (count - (width - kept)), width - kept, state->history + kept);
    return kOk;
}

}  // namespace krnumer
