#include "filter/median_filter.h"

#include <algorithm>
#include <cmath>

#include "frame/numeric.h"
#include "frame/scratch.h"
#include "frame/status.h"
#include "stat/order.h"

namespace krnumer {
namespace {

// The samples of the window in ascending order, NaNs first.
class SortedWindow {
  public:
    SortedWindow(double* samples, size_t size) : samples_(samples), size_(size) {}

    double Median() const {
        const double upper = samples_[size_ / 2];
        return size_ % 2 != 0 ? upper : (samples_[size_ / 2 - 1] + upper) / 2.0;
    }

    // Puts one sample in the place of another, moving what lies between them.
    void Replace(double leaving, double entering) {
        const size_t gap = std::min(CountBelow(leaving), size_ - 1);
        const size_t place = CountBelow(entering);
        if (place > gap) {
            std::copy(samples_ + gap + 1, samples_ + place, samples_ + gap);
            samples_[place - 1] = entering;
        } else {
            std::copy_backward(samples_ + place, samples_ + gap, samples_ + gap + 1);
            samples_[place] = entering;
        }
    }

  private:
    // Where the first sample stands that is not below `value`. By halves and without branches, which could not be
    // foreseen.
    size_t CountBelow(double value) const {
        if (std::isnan(value)) return 0;
        const auto is_below = [value](double sample) { return !(sample >= value); };
        const double* first = samples_;
        for (size_t length = size_; length > 1;) {
            const size_t half = length / 2;
            first += is_below(first[half - 1]) ? half : 0;
            length -= half;
        }
        return static_cast<size_t>(first - samples_) + (is_below(*first) ? 1 : 0);
    }

    double* samples_;
    size_t size_;
};

}  // namespace

int32_t MedianFilter(double* x, int32_t n, int32_t left, int32_t right) {
    if (left < 0) return kBadRank;
    if (right < 0) right = left;
    if (n > 0 && n <= right) return kBadDimension;
    if (n < 1 || (left == 0 && right == 0)) return kOk;

    const int64_t width = int64_t{left} + right + 1;
    if (width > INT32_MAX) return kOutOfMemory;
    // Where no window holds more samples than zeros, none needs to be made: a wide one may be beyond all memory.
    if (width > 2 * int64_t{n}) {
        std::fill_n(x, n, 0.0);
        return kOk;
    }
    Scratch<double> samples(static_cast<size_t>(width));
    // What the output has overwritten: the sample at i stands at i modulo `left`.
    Scratch<double> history(Count(left), Scratch<double>::kZeroed);
    if (!samples || !history) return kOutOfMemory;
    std::fill_n(samples.data(), left, 0.0);
    std::copy_n(x, right + 1, samples.data() + left);
    if (const int32_t status = SortDoubles(samples.data(), static_cast<int32_t>(width), 0, nullptr)) return status;

    SortedWindow window(samples.data(), static_cast<size_t>(width));
    size_t oldest = 0;
    for (int32_t i = 0;; ++i) {
        double leaving = x[i];
        x[i] = window.Median();
        if (i + 1 == n) return kOk;
        if (left > 0) {
            std::swap(leaving, history[oldest]);
            oldest = oldest + 1 < Count(left) ? oldest + 1 : 0;
        }
        window.Replace(leaving, right < n - 1 - i ? x[i + 1 + right] : 0.0);
    }
}

}  // namespace krnumer
