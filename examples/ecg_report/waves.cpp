// Test waves beside the recording: a disturbance of known size, a beat played as a wave, and the shapes on offer.
#include <algorithm>
#include <cmath>

#include "sections.h"

namespace {

constexpr double kPart = 2.0;  // s of the recording that a plot shows

// Mains hum in two blocks that join without a seam: the phase goes from call to call.
std::vector<double> Hum(int32_t n, double amplitude, double frequency) {
    std::vector<double> samples;
    double phase = 0.0;
    for (const int32_t block : {n / 3, n - n / 3}) {
        Array<double> x;
        int32_t err = 0;
        SineWaveCIN(x.handle(), &block, &amplitude, &frequency, &phase, &err);
        Check(err, "SineWaveCIN");
        samples.insert(samples.end(), x.values().begin(), x.values().end());
    }
    return samples;
}

// One recorded beat as a table whose ends meet: a ramp from its first to its last sample is taken off.
Array<double> BeatTable(const Recording& ecg, double from, double to) {
    Array<double> beat(ecg.Between(from, to));
    const int32_t n = beat.count();
    const double first = beat[0], last = beat[beat.size() - 1];
    Array<double> ramp;
    int32_t err = 0;
    RampPtrn(ramp.handle(), &n, &first, &last, &err);
    Check(err, "RampPtrn");
    for (std::size_t i = 0; i < beat.size(); ++i) beat[i] -= ramp[i];
    return beat;
}

Array<double> PlayBeat(const Array<double>& table, int32_t n, double beats_per_minute, double rate) {
    const double amplitude = 1.0, frequency = beats_per_minute / 60.0 / rate;
    const int32_t linear_interpolation = 1;
    double phase = 0.0;
    Array<double> x;
    int32_t err = 0;
    ArbitraryWaveCIN(x.handle(), &n, &amplitude, &frequency, &phase, table.handle(), &linear_interpolation, &err);
    Check(err, "ArbitraryWaveCIN");
    return x;
}

// The generators over the same 400 samples, one above the other.
Plot Gallery() {
    const int32_t n = 400;
    const double amplitude = 1.0, frequency = 0.01, duty = 25.0, slow = 0.0, fast = 0.06;
    double phase = 0.0;
    int32_t err = 0;
    Plot plot{.title = "Waves and pulses on offer", .x_label = "sample", .y_label = "", .series = {}};
    const auto add = [&](const char* function, const std::string& name, int32_t status, const Array<double>& x) {
        Check(status, function);
        std::vector<double> shifted(x.values().begin(), x.values().end());
        for (double& sample : shifted) sample -= 2.5 * static_cast<double>(plot.series.size());
        plot.series.push_back(Line(name, shifted));
    };

    Array<double> square, sawtooth, triangle, chirp, pulse, monopulse, sinc;
    SquareWaveCIN(square.handle(), &n, &amplitude, &frequency, &phase, &duty, &err);
    add("SquareWaveCIN", "square, 25 %", err, square);
    phase = 0.0;
    SawtoothWaveCIN(sawtooth.handle(), &n, &amplitude, &frequency, &phase, &err);
    add("SawtoothWaveCIN", "sawtooth", err, sawtooth);
    phase = 0.0;
    TriangleWaveCIN(triangle.handle(), &n, &amplitude, &frequency, &phase, &err);
    add("TriangleWaveCIN", "triangle", err, triangle);
    ChirpCIN(chirp.handle(), &n, &amplitude, &slow, &fast, &err);
    add("ChirpCIN", "chirp", err, chirp);
    add("GaussPulseH", "Gaussian pulse", GaussPulseH(pulse.handle(), n, amplitude, 200.0, 1.0, 0.04, 0.5, 6.0), pulse);
    add("GaussMonopulseH", "Gaussian monopulse", GaussMonopulseH(monopulse.handle(), n, 1.0, 200.0, 0.02, amplitude),
        monopulse);
    add("PeriodicSincH", "periodic sinc", PeriodicSincH(sinc.handle(), n, amplitude, 9, 0.05, 10.0), sinc);
    return plot;
}

}  // namespace

Section WavesSection(const Recording& ecg) {
    constexpr double kFrom = 10.0, kAmplitude = 0.1, kMains = 60.0;
    const Array<double> clean(ecg.Between(kFrom, kFrom + kPart));
    const std::vector<double> hum = Hum(clean.count(), kAmplitude, kMains / ecg.rate);
    Array<double> disturbed(clean);
    for (std::size_t i = 0; i < hum.size(); ++i) disturbed[i] += hum[i];
    double error = 0.0;
    int32_t err = 0;
    MSE_head(clean.handle(), disturbed.handle(), &error, &err);
    Check(err, "MSE_head");

    const double step = 1.0 / ecg.rate, rate = 75.0;
    const Array<double> beat = BeatTable(ecg, 10.88, 11.44);
    const Array<double> played = PlayBeat(beat, static_cast<int32_t>(6.0 * ecg.rate), rate, ecg.rate);

    return {
        .title = "Test waves",
        .text =
            "A hum of the mains is added to the recording, and its mean square comes back as the mean square error: "
            "half the square of the amplitude. One recorded beat becomes the table of a wave and is played at "
            "another rate.",
        .values = {{"amplitude of the hum", kAmplitude, "mV"},
                   {"mean square error", error, "mV²"},
                   {"half the amplitude squared", kAmplitude * kAmplitude / 2.0, "mV²"},
                   {"rate of the played beat", rate, "per minute"}},
        .tables = {},
        .plots = {{.title = "A hum of 60 Hz on two seconds of the recording",
                   .x_label = "time in s",
                   .y_label = "mV",
                   .series = {Line("with hum", disturbed.values(), step, kFrom),
                              Line("recording", clean.values(), step, kFrom)}},
                  {.title = "One beat, played 75 times a minute",
                   .x_label = "time in s",
                   .y_label = "mV",
                   .series = {Line("wave from the table", played.values(), step)}},
                  Gallery()}};
}
