// The blocks of a digital down-converter. They have no failure of their own: what cannot be done is left undone.

#include <algorithm>

#include "frame/entry.h"
#include "krnumer/spectrum.h"
#include "transform/modulator.h"
#include "transform/moving_average.h"

using namespace krnumer;

namespace {

template <class T>
int32_t Cascade(KrHandle x, int32_t stages, int32_t window, KrHandle sums, KrHandle history, int32_t* index,
                int32_t reset) {
    ByValue call;
    InOut<T> samples(call, x);
    InOut<T> stage_sums(call, sums);
    InOutMatrix<T> rings(call, history);
    if (window <= 1 && reset == 0) return call.Leave(kOk);
    if (stages <= 0) return call.Leave(kOk);

    const bool goes_on = reset == 0 && stage_sums.size() == stages && rings.rows() == stages &&
                         rings.columns() == window && *index >= 0 && *index <= window;
    if (!goes_on) {
        *index = 0;
        if (stage_sums.Resize(stages) || rings.Resize(stages, std::max(window, 0))) {
            stage_sums.Empty();
            rings.Empty();
            return call.Leave(kOk);
        }
    }
    return call.Run([&] {
        if (!goes_on) {
            std::fill_n(stage_sums.data(), stage_sums.count(), T{});
            std::fill_n(rings.data(), rings.count(), T{});
        }
        CascadedMovingSums(samples.data(), samples.size(), stages, window, stage_sums.data(), rings.data(), index);
        return kOk;
    });
}

template <class T, class Scalar>
int32_t Decimate(KrHandle x, int32_t m, Scalar* sum, int32_t* count, int32_t reset, int32_t* out_count) {
    ByValue call;
    InOut<T> samples(call, x);
    const bool misplaced = m >= 2 && (*count < 0 || *count >= m);  // the block was begun with another width
    if (reset != 0 || misplaced) {
        *sum = Scalar{};
        *count = 0;
    }
    if (m < 2) {
        *out_count = samples.size();
        return call.Leave(kOk);
    }
    return call.Run([&] {
        T open;
        std::memcpy(&open, sum, sizeof open);
        *out_count = DecimatedMovingSums(samples.data(), samples.size(), m, &open, count);
        std::memcpy(sum, &open, sizeof open);
        return kOk;
    });
}

}  // namespace

int32_t ReCascadedMovingAverageH(KrHandle x, int32_t stages, int32_t window, KrHandle sums, KrHandle history,
                                 int32_t* index, int32_t reset) {
    return Cascade<double>(x, stages, window, sums, history, index, reset);
}
int32_t CxCascadedMovingAverageH(KrHandle x, int32_t stages, int32_t window, KrHandle sums, KrHandle history,
                                 int32_t* index, int32_t reset) {
    return Cascade<Complex>(x, stages, window, sums, history, index, reset);
}

int32_t ReDecimatedMovingAverageH(KrHandle x, int32_t m, double* sum, int32_t* count, int32_t reset,
                                  int32_t* outCount) {
    return Decimate<double>(x, m, sum, count, reset, outCount);
}
int32_t CxDecimatedMovingAverageH(KrHandle x, int32_t m, KrComplex* sum, int32_t* count, int32_t reset,
                                  int32_t* outCount) {
    return Decimate<Complex>(x, m, sum, count, reset, outCount);
}

int32_t ReComplexModulatorH(KrHandle x, double f, double fs, double* phase, KrHandle y) {
    ByValue call;
    In<double> samples(call, x);
    Out<Complex> modulated(call, y);
    const int32_t n = samples.size();
    if (n < 1) return call.Leave(kOk);
    if (modulated.Resize(n)) {
        modulated.Empty();
        return call.Leave(kOk);
    }
    return call.Run([&] {
        Modulate(samples.data(), n, f / fs, phase, modulated.data());
        return kOk;
    });
}

int32_t CxComplexModulatorH(KrHandle x, double f, double fs, double* phase) {
    ByValue call;
    InOut<Complex> samples(call, x);
    return call.Run([&] {
        Modulate(samples.data(), samples.size(), f / fs, phase, samples.data());
        return kOk;
    });
}
