// The rhythm of the recording: its power spectrum, its likeness to itself later on, and the trace at another rate.
#include <algorithm>
#include <cmath>

#include "sections.h"

namespace {

constexpr double kQuiet = 40.0;  // s, before the electrode comes loose

// The quiet part less its baseline, the mean of the half second around each sample.
Array<double> Deviations(const Recording& ecg) {
    constexpr int32_t kWindow = 181, kStages = 1, kReset = 1;
    Array<double> x(ecg.Between(0.0, kQuiet)), sums(x), running;
    Matrix history;
    int32_t index = 0;
    Check(ReCascadedMovingAverageH(sums.handle(), kStages, kWindow, running.handle(), history.handle(), &index, kReset),
          "ReCascadedMovingAverageH");
    Array<double> deviations(x.size() - (kWindow - 1));
    for (std::size_t i = 0; i < deviations.size(); ++i)
        deviations[i] = x[i + kWindow / 2] - sums[i + kWindow - 1] / kWindow;
    return deviations;
}

Array<double> Power(const Recording& ecg) {
    constexpr int32_t kHann = 1, kScaled = 1;
    Array<double> x = Deviations(ecg);
    Check(AllCosWinH(x.handle(), kHann, kScaled), "AllCosWinH");
    void* slot = nullptr;  // given back at the end of the process
    Check(SpectrumH(x.handle(), &slot), "SpectrumH");
    return x;
}

// From lag 0, where it is 1, to `longest` seconds.
std::vector<double> Likeness(const Recording& ecg, double longest) {
    constexpr int32_t kBiased = 2;
    Array<double> x = Deviations(ecg);
    const std::size_t middle = x.size() - 1;
    int32_t err = 0;
    AutoCorrelation80(x.handle(), kBiased, &err);
    Check(err, "AutoCorrelation80");
    std::vector<double> likeness;
    for (std::size_t k = 0; k <= ecg.SampleAt(longest); ++k) likeness.push_back(x[middle + k] / x[middle]);
    return likeness;
}

// By up / down, in blocks of a second, as if the samples were just arriving.
std::vector<double> Resampled(const Recording& ecg, int32_t up, int32_t down) {
    const int32_t taps = 20 * std::max(up, down) + 1;
    const double fast = ecg.rate * up, cutoff = 0.5 * fast / std::max(up, down), unused = 0.0;
    constexpr int32_t kLowpass = 0, kHann = 1;
    Array<double> filter, history, y;
    int32_t err = 0;
    FIRCoefs(&fast, &cutoff, &unused, &taps, filter.handle(), &kLowpass, &err);
    Check(err, "FIRCoefs");
    Check(SymmWinH(filter.handle(), kHann, 0.0), "SymmWinH");

    std::vector<double> resampled;
    int32_t start = 0, kept = 0, reset = 1;
    for (double second = 0.0; second < ecg.seconds(); second += 1.0, reset = 0) {
        const Array<double> block(ecg.Between(second, std::min(second + 1.0, ecg.seconds())));
        Check(RationalResample_H(block.handle(), up, down, reset, &start, filter.handle(), history.handle(), &kept,
                                 y.handle()),
              "RationalResample_H");
        resampled.insert(resampled.end(), y.values().begin(), y.values().end());
    }
    return resampled;
}

}  // namespace

Section RhythmSection(const Recording& ecg) {
    constexpr double kHighest = 40.0, kLongest = 2.0, kShortestBeat = 0.3;
    const double step = 1.0 / ecg.rate;

    const Array<double> power = Power(ecg);
    std::vector<double> level;
    const double line = ecg.rate / static_cast<double>(power.size());
    for (std::size_t k = 0; static_cast<double>(k) * line <= kHighest; ++k)
        level.push_back(10.0 * std::log10(2.0 * power[k]));

    const std::vector<double> likeness = Likeness(ecg, kLongest);
    const auto beat =
        std::max_element(likeness.begin() + static_cast<std::ptrdiff_t>(ecg.SampleAt(kShortestBeat)), likeness.end());
    const double interval = static_cast<double>(beat - likeness.begin()) * step;

    constexpr int32_t kUp = 25, kDown = 36;
    constexpr double kFrom = 10.8, kTo = 11.4;
    const std::vector<double> resampled = Resampled(ecg, kUp, kDown);
    const double rate = ecg.rate * kUp / kDown;
    const auto first = static_cast<std::size_t>(std::ceil(kFrom * rate));
    const auto last = static_cast<std::size_t>(kTo * rate);
    Series points = Line("at 250 Hz", std::span(resampled).subspan(first, last - first), 1.0 / rate,
                         static_cast<double>(first) / rate);
    points.kind = "points";

    return {.title = "Rhythm",
            .text =
                "The beats are the lines of the spectrum below 10 Hz and the hills of the autocorrelation; the highest "
                "hill behind lag 0 tells the time from beat to beat. The same samples at 250 Hz, filtered and thinned "
                "in blocks of a second, lie on the trace.",
            .values = {{"from beat to beat", interval, "s"},
                       {"beats", 60.0 / interval, "per minute"},
                       {"samples at 250 Hz", static_cast<double>(resampled.size()), ""}},
            .tables = {},
            .plots = {{.title = "Power spectrum of 40 s",
                       .x_label = "frequency in Hz",
                       .y_label = "dB over 1 mV²",
                       .series = {Line("Hann window", level, line)}},
                      {.title = "Autocorrelation",
                       .x_label = "lag in s",
                       .y_label = "",
                       .series = {Line("first 40 s", likeness, step), Mark("from beat to beat", interval)}},
                      {.title = "A beat at two rates",
                       .x_label = "time in s",
                       .y_label = "lead MLII in mV",
                       .series = {Line("at 360 Hz", ecg.Between(kFrom, kTo), step, kFrom), points}}}};
}
