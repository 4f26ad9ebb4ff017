#include "krnumer/stat.h"

#include "sweep/sweep.h"

SWEEP(Mean_head) {
    const KrHandle x = scene.Doubles({1, 2, 4});
    double* mean = scene.Number();
    return scene.Call(Mean_head, x, mean, scene.err());
}

SWEEP(Median_head) {
    const KrHandle x = scene.Doubles({4, 1, 2, 8});
    double* median = scene.Number();
    return scene.Call(Median_head, x, median, scene.err());
}

SWEEP(ModeH) {
    const KrHandle x = scene.Doubles({1, 2, 2, 3, 3});
    const KrHandle modes = scene.OutDoubles(sweep::OnFailure::kOther);
    return scene.Call(ModeH, x, 0, modes);
}

SWEEP_MORE(ModeH, binned) {
    const KrHandle x = scene.Doubles({1, 2, 2, 3, 3});
    const KrHandle modes = scene.OutDoubles(sweep::OnFailure::kOther);
    return scene.Call(ModeH, x, 3, modes);
}

SWEEP(Moment_head) {
    const KrHandle x = scene.Doubles({1, 2, 4});
    const int32_t order = 3;
    double* moment = scene.Number();
    return scene.Call(Moment_head, x, &order, moment, scene.err());
}

SWEEP(MSE_head) {
    const KrHandle x = scene.Doubles({1, 2, 4});
    const KrHandle y = scene.Doubles({1, 3});
    double* mse = scene.Number();
    return scene.Call(MSE_head, x, y, mse, scene.err());
}

SWEEP(RMS_head) {
    const KrHandle x = scene.Doubles({1, 2, 4});
    double* rms = scene.Number();
    return scene.Call(RMS_head, x, rms, scene.err());
}

SWEEP(GenHistH) {
    const KrHandle x = scene.Doubles({-1, 0.5, 1, 2});
    const KrHandle bins = scene.Records<KrInterval>({{0, 1, 0}, {1, 2, 0}});
    const KrHandle histogram = scene.OutIntegers(sweep::OnFailure::kOther);
    KrOutOfRange counters{-1, -1, -1};
    return scene.Call(GenHistH, x, bins, histogram, &counters, scene.err());
}

SWEEP(histgran_head) {
    const KrHandle x = scene.Doubles({1, 2, 2.5, 3});
    const int32_t bins = 2;
    const KrHandle histogram = scene.OutIntegers();
    const KrHandle centers = scene.OutDoubles();
    return scene.Call(histgran_head, x, &bins, histogram, centers, scene.err());
}
