#include "sigop/trigger.h"

#include <cmath>

#include "frame/numeric.h"

namespace krnumer {
namespace {

constexpr int32_t kRising = 1;
constexpr int32_t kFalling = 0;

// The slots of `found`, filled over all channels.
class Slots {
  public:
    explicit Slots(int32_t* found) : found_(found) {}

    void Add(int32_t index) {
        if (taken_ < kMostTriggersFound) found_[taken_++] = index;
    }

  private:
    int32_t* found_;
    int32_t taken_ = 0;
};

}  // namespace

void FindTriggers(const double* x, int32_t channels, int32_t n, const Triggers& triggers, const TriggerHits& hits) {
    Slots slots(hits.found);
    for (int32_t r = 0; r < channels; ++r, x += Count(n)) {
        const double level = triggers.levels[r];
        const double hysteresis = std::fabs(triggers.hysteresis[r]);
        const double low = level - hysteresis;
        const double high = level + hysteresis;
        const double previous = triggers.previous[r];
        const int32_t slope = triggers.slopes[r];
        bool armed = (slope == kRising && previous < low) || (slope == kFalling && previous > high);
        int32_t count = 0;
        for (int32_t s = 0; s < n && count < triggers.most; ++s) {
            if (!armed) {
                armed = slope == kRising ? x[s] < low : x[s] > high;
            } else if ((slope == kRising && x[s] >= level) || (slope == kFalling && x[s] <= level)) {
                slots.Add(s);
                ++count;
                armed = false;
            }
        }
        if (count == 0 && triggers.most > 0) slots.Add(0);
        hits.counts[r] = count;
        hits.flags[r] = count > 0 ? 1 : 0;
        hits.last[r] = n > 0 ? x[n - 1] : previous;
    }
}

}  // namespace krnumer
