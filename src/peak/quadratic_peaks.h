// Peaks and valleys of a signal that arrives in blocks: a parabola is fitted by least squares to a window that slides
// along the samples, and its vertex is a peak where the slope at the window's middle changes sign.
#pragma once

#include <cstdint>

#include "frame/numeric.h"
#include "frame/scratch.h"
#include "peak/parabola_fit.h"

namespace krnumer {

struct Peak {
    double location;  // in samples from the begin of the signal
    double amplitude;
    double second_derivative;
};

class PeakList {
  public:
    int32_t count() const { return count_; }
    const Peak& operator[](int32_t i) const { return peaks_[Count(i)]; }
    Peak& last() { return peaks_[Count(count_ - 1)]; }

    // False without memory; the list stays.
    [[nodiscard]] bool Append(const Peak& peak);

  private:
    Scratch<Peak> peaks_;
    int32_t capacity_ = 0;
    int32_t count_ = 0;
};

struct PeakCriteria {
    bool valleys;
    double threshold;  // peaks lie above, valleys below
};

// A detector between two blocks. The arrays belong to the caller.
struct PeakScan {
    int32_t width;          // samples of a window, from 3 on
    uint32_t processed;     // windows looked at, that is the position of the next one in the signal
    int32_t held;           // samples in `history`, at most `width`
    bool rising;            // slope at the middle of the last window
    Parabola previous;      // fit to the last window
    const double* weights;  // 3 by width: their rows times a window are the coefficients of the parabola
    double* window;         // width: a window that lies in two blocks
    double* history;        // width: the last samples of the signal so far
};

// Adds the peaks of the n samples that come next. A window is looked at when the sample after it is there, or in the
// last block; so a signal gives the same windows however it is divided. A peak less than 1 sample from the last one
// found in this call is the same: the larger is kept. -20001.
int32_t FindQuadraticPeaks(PeakScan* scan, const double* x, int32_t n, const PeakCriteria& criteria, bool last_block,
                           PeakList* peaks);

}  // namespace krnumer
