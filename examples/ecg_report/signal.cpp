#include "sections.h"

Section SignalSection(const Recording& ecg) {
    constexpr double kFrom = 10.0, kTo = 16.0;
    return {.title = "The recording",
            .text =
                "An ambulatory recording as it comes: beats of differing shape, a baseline that wanders with the "
                "breath, a loose electrode around 43 s, muscle noise.",
            .values = {{"samples", static_cast<double>(ecg.millivolt.size()), ""},
                       {"samples per second", ecg.rate, "Hz"},
                       {"duration", ecg.seconds(), "s"}},
            .tables = {},
            .plots = {{.title = "The whole minute",
                       .x_label = "time in s",
                       .y_label = "lead MLII in mV",
                       .series = {Line("recording", ecg.millivolt.values(), 1.0 / ecg.rate)}},
                      {.title = "Six seconds of it",
                       .x_label = "time in s",
                       .y_label = "lead MLII in mV",
                       .series = {Line("recording", ecg.Between(kFrom, kTo), 1.0 / ecg.rate, kFrom)}}}};
}
