// Windows: their shapes, their constants, and one at work on the recording.
#include <array>

#include "sections.h"

namespace {

struct Window {
    const char* name;
    int32_t type;
    double parameter;
    bool shown;  // its shape is plotted
};

constexpr std::array kWindows = {
    Window{"rectangle", 0, 0.0, false},
    Window{"Hann", 1, 0.0, true},
    Window{"Hamming", 2, 0.0, false},
    Window{"Blackman", 5, 0.0, false},
    Window{"Blackman-Harris", 7, 0.0, true},
    Window{"flat top", 6, 0.0, true},
    Window{"triangle", 30, 0.0, false},
    Window{"Welch", 34, 0.0, false},
    Window{"Kaiser, beta 6", 60, 6.0, true},
    Window{"Dolph-Chebyshev, 60 dB", 61, 1000.0, true},
    Window{"Gaussian, sigma 0.2", 62, 0.2, true},
};

}  // namespace

Section WindowsSection(const Recording& ecg) {
    constexpr std::size_t kLength = 512;
    Table constants{"Constants, and the same measured from the weights of " + std::to_string(kLength) + " samples",
                    {"window", "noise bandwidth in bins", "coherent gain", "bandwidth measured", "gain measured"},
                    {}};
    Plot shapes{.title = "Shapes", .x_label = "sample", .y_label = "weight", .series = {}};
    for (const Window& window : kWindows) {
        // A window of ones is the window itself; of unit gain, it has to be multiplied by its gain again.
        Array<double> weights(kLength, 1.0);
        KrWindowConstants stated, measured;
        Check(ScaledWinH(weights.handle(), window.type, window.parameter, &stated), "ScaledWinH");
        for (double& weight : weights.values()) weight *= stated.coherentGain;
        Check(NumWinConstH(weights.handle(), &measured), "NumWinConstH");
        constants.rows.push_back({window.name, Number(stated.enbw, 4), Number(stated.coherentGain, 4),
                                  Number(measured.enbw, 4), Number(measured.coherentGain, 4)});
        if (window.shown) shapes.series.push_back(Line(window.name, weights.values()));
    }

    constexpr double kFrom = 10.0, kTo = 16.0;
    Array<double> part(ecg.Between(kFrom, kTo));
    const double mean = Statistic(Mean_head, "Mean_head", part);
    for (double& sample : part.values()) sample -= mean;
    Array<double> windowed(part);
    constexpr int32_t kHann = 1, kScaled = 0;
    Check(AllCosWinH(windowed.handle(), kHann, kScaled), "AllCosWinH");

    return {.title = "Windows",
            .text =
                "A stretch of a recording starts and ends anywhere, and a spectrum takes the jump between its ends for "
                "signal. A window lets both ends fade to zero; what that costs in bandwidth and in gain is in its "
                "constants.",
            .values = {},
            .tables = {constants},
            .plots = {shapes,
                      {.title = "Six seconds under a Hann window",
                       .x_label = "time in s",
                       .y_label = "mV, without mean",
                       .series = {Line("as recorded", part.values(), 1.0 / ecg.rate, kFrom),
                                  Line("windowed", windowed.values(), 1.0 / ecg.rate, kFrom)}}}};
}
