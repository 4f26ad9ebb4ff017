#include "peak/quadratic_peaks.h"

#include <algorithm>
#include <cmath>
#include <cstring>

#include "frame/numeric.h"
#include "frame/status.h"
#include "linalg/svd_solve.h"

namespace krnumer {

namespace {

constexpr double kLeastSlope = 1e-10;
constexpr double kLeastCurvature = 1e-10;

// Below this width a sign change of the slope says too little, and the curvature alone decides.
constexpr int32_t kLeastWidthOfSlopes = 5;

// Neighbouring windows, fitted together.
constexpr int kBatch = 16;

// Fits kWindows windows that start at x, x + 1 and so on. Every sum runs in the order of the samples.
template <int kWindows>
void Fit(const double* weights, int32_t width, const double* x, Parabola* parabolas) {
    double a0[kWindows] = {}, a1[kWindows] = {}, a2[kWindows] = {};
    const auto w = Count(width);
    for (size_t j = 0; j < w; ++j) {
        for (size_t k = 0; k < kWindows; ++k) {
            a0[k] += weights[j] * x[j + k];
            a1[k] += weights[w + j] * x[j + k];
            a2[k] += weights[2 * w + j] * x[j + k];
        }
    }
    for (int k = 0; k < kWindows; ++k) parabolas[k] = {a0[k], a1[k], a2[k]};
}

bool IsRising(const Parabola& parabola) {
    return std::fabs(parabola.a1) <= kLeastSlope ? parabola.a2 > 0.0 : parabola.a1 > 0.0;
}

double Vertex(const Parabola& parabola) {
    return -parabola.a1 / (2.0 * parabola.a2);
}

class Scan {
  public:
    Scan(PeakScan* state, const PeakCriteria& criteria, PeakList* peaks)
        : state_(*state), criteria_(criteria), peaks_(*peaks), half_(0.5 * (state->width - 1)) {}

    // Looks at the next window.
    int32_t Take(const Parabola& parabola) {
        const bool rising = IsRising(parabola);
        int32_t status = kOk;
        if (IsCandidate(parabola, rising)) status = Judge(parabola);
        state_.rising = rising;
        state_.previous = parabola;
        ++state_.processed;
        return status;
    }

  private:
    bool IsCandidate(const Parabola& parabola, bool rising) const {
        if (state_.width >= kLeastWidthOfSlopes) return rising != state_.rising;
        return IsBentRight(parabola);
    }

    bool IsBentRight(const Parabola& parabola) const {
        return criteria_.valleys ? parabola.a2 > 0.0 : parabola.a2 < 0.0;
    }

    int32_t Judge(Parabola parabola) {
        if (std::fabs(2.0 * parabola.a2) < kLeastCurvature) return kOk;
        double vertex = Vertex(parabola);
        double position = state_.processed;
        if (state_.processed > 0 && vertex < -0.5) {
            // nearer to the middle of the window before, perhaps
            const Parabola& previous = state_.previous;
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

int32_t DesignPeakWeights(int32_t width, double* weights) {
    const double half = 0.5 * (width - 1);
    for (int32_t i = 0; i < width; ++i) {
        const double x = i - half;
        double* const row = weights + 3 * Count(i);
        row[0] = 1.0;
        row[1] = x;
        row[2] = x * x;
    }
    return PseudoInverseCore<double>(weights, width, 3, -1.0, nullptr);
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
    Parabola parabolas[kBatch];
    if (state->processed == 0) {
        Fit<1>(state->weights, width, state->history, parabolas);
        state->rising = IsRising(parabolas[0]);
    }
    // Window i starts i samples into the history with the new samples behind it.
    const int64_t windows = int64_t{count} + (last_block ? 1 : 0);
    for (int64_t i = 0; i < windows;) {
        int fitted = 1;
        if (i < width) {
            const auto begin = static_cast<int32_t>(i);
            std::copy_n(state->history + begin, width - begin, state->window);
            std::copy_n(fresh, begin, state->window + (width - begin));
            Fit<1>(state->weights, width, state->window, parabolas);
        } else if (windows - i < kBatch) {
            Fit<1>(state->weights, width, fresh + (i - width), parabolas);
        } else {
            fitted = kBatch;
            Fit<kBatch>(state->weights, width, fresh + (i - width), parabolas);
        }
        for (int k = 0; k < fitted; ++k) {
            if (const int32_t status = scan.Take(parabolas[k])) return status;
        }
        i += fitted;
    }

    const int32_t kept = std::max(width - count, 0);
    std::memmove(state->history, state->history + (width - kept), Count(kept) * sizeof(double));
    std::copy_n(fresh + (count - (width - kept)), width - kept, state->history + kept);
    return kOk;
}

}  // namespace krnumer
