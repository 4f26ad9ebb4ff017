#include "krnumer/peak.h"

#include <cmath>

#include "sweep/sweep.h"

namespace {

// One call with a detector. A block before it, if there is one, has no peaks, so that it sizes nothing.
int32_t Detect(sweep::Scene& scene, int32_t flags) {
    std::vector<double> samples;
    for (int i = 0; i < 40; ++i) samples.push_back(std::sin(0.5 * i));
    KrPeakRecord record{};
    record.input = scene.Doubles(samples);
    record.threshold = 0.5;
    record.width = 5;
    record.locations = scene.OutDoubles();
    record.amplitudes = scene.OutDoubles();
    record.second_derivatives = scene.OutDoubles();
    KrPeakState state;
    KrHandle work = nullptr;
    if ((flags & KRN_FIRST_BLOCK) == 0) {
        sweep::Scene before;
        KrPeakRecord former = record;
        former.input = before.Doubles({0, 0, 0, 0, 0, 0});
        former.locations = before.OutDoubles();
        former.amplitudes = before.OutDoubles();
        former.second_derivatives = before.OutDoubles();
        former.flags = KRN_FIRST_BLOCK;
        int32_t err;
        PeakD(&former, &state, &work, &err);
    }
    record.flags = flags;
    const int32_t status = scene.Call(PeakD, &record, &state, &work, scene.err());
    DropBlock(work);
    return status;
}

}  // namespace

SWEEP(PeakD) {
    return Detect(scene, KRN_FIRST_BLOCK | KRN_LAST_BLOCK);
}

SWEEP_MORE(PeakD, first) {
    return Detect(scene, KRN_FIRST_BLOCK);
}

SWEEP_MORE(PeakD, last) {
    return Detect(scene, KRN_LAST_BLOCK);
}

SWEEP(PeakDetector) {
    const KrHandle x = scene.Doubles({0, 1, 1, 0, 0, 1, 1, 1, 0});
    const double threshold = 1;
    const int32_t width = 2;
    const KrHandle indices = scene.OutIntegers();
    int32_t* count = scene.Integer(-7);
    return scene.Call(PeakDetector, x, &threshold, &width, indices, count, scene.err());
}
