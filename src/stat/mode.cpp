#include "stat/mode.h"

#include <cmath>

#include "frame/numeric.h"
#include "frame/status.h"
#include "stat/histogram.h"
#include "stat/order.h"

namespace krnumer {

namespace {

// True for a NaN or an infinite `value` too, whose tolerance no spread exceeds.
bool NoSpread(double value, double other) {
    return !(std::fabs(value - other) > std::fabs(value) * kEpsilon);
}

// The values of highest frequency among those offered so far, kept at the head of an array that is still being read:
// there are never more of them than offers.
class Leaders {
  public:
    explicit Leaders(double* values) : values_(values) {}

    void Offer(double value, int32_t frequency) {
        if (frequency < highest_) return;
        if (frequency > highest_) {
            highest_ = frequency;
            count_ = 0;
        }
        values_[count_++] = value;
    }

    int32_t count() const { return count_; }

  private:
    double* values_;
    int32_t highest_ = 2;  // what occurs once is no mode
    int32_t count_ = 0;
};

int32_t ModesOfValues(const double* x, int32_t n, Scratch<double>* modes, int32_t* count) {
    if (!modes->Allocate(Count(n))) return kOutOfMemory;
    double* sorted = modes->data();
    if (const int32_t status = SortDoubles(x, n, 0, sorted); status != kOk) return status;
    if (NoSpread(sorted[0], sorted[n - 1])) {
        *count = 1;
        return kOk;
    }

    Leaders leaders(sorted);
    for (int32_t i = 0, next = 0; i < n; i = next) {
        const double value = sorted[i];
        const double tolerance = std::fabs(value) * kEpsilon;
        next = i + 1;
        while (next < n && std::fabs(value - sorted[next]) <= tolerance) ++next;
        leaders.Offer(value, next - i);
    }
    *count = leaders.count();
    return kOk;
}

int32_t ModesOfBins(const double* x, int32_t n, int32_t intervals, Scratch<double>* modes, int32_t* count) {
    double max = 0.0;
    double min = 0.0;
    int32_t max_index = 0;
    int32_t min_index = 0;
    if (const int32_t status = MinMaxIgnoreNaN(x, n, &max, &max_index, &min, &min_index); status != kOk) return status;
    if (NoSpread(max, min)) {
        if (!modes->Allocate(1)) return kOutOfMemory;
        (*modes)[0] = max;
        *count = 1;
        return kOk;
    }

    Scratch<int32_t> counts(Count(intervals));
    if (!counts || !modes->Allocate(Count(intervals))) return kOutOfMemory;
    double* centers = modes->data();
    if (const int32_t status = EqualWidthHistogram(x, n, min, max, counts.data(), centers, intervals); status != kOk) {
        return status;
    }
    Leaders leaders(centers);
    for (int32_t k = 0; k < intervals; ++k) leaders.Offer(centers[k], counts[Count(k)]);
    *count = leaders.count();
    return kOk;
}

}  // namespace

int32_t Mode(const double* x, int32_t n, int32_t intervals, Scratch<double>* modes, int32_t* count) {
    *modes = Scratch<double>();
    *count = 0;
    if (n < 1) return kEmptyInput;
    if (n == 1) return kOk;
    const int32_t status =
        intervals < 1 ? ModesOfValues(x, n, modes, count) : ModesOfBins(x, n, intervals, modes, count);
    if (*count == 0) *modes = Scratch<double>();
    return status;
}

}  // namespace krnumer
