// What frequencies the recording is made of: spectra with and without a window, and a closer look at the slow end.
#include <algorithm>
#include <cmath>
#include <numbers>

#include "sections.h"

namespace {

constexpr double kQuiet = 40.0;  // s, before the electrode comes loose
constexpr int32_t kNone = 0, kHann = 1;

double Modulus(KrComplex z) {
    return std::hypot(z.re, z.im);
}

// A part without its mean, under a window of unit gain: a line of the spectrum keeps its height.
Array<double> Windowed(const Recording& ecg, double from, double to, int32_t window) {
    Array<double> x(ecg.Between(from, to));
    const double mean = Statistic(Mean_head, "Mean_head", x);
    for (double& sample : x.values()) sample -= mean;
    KrWindowConstants constants;
    Check(ScaledWinH(x.handle(), window, 0.0, &constants), "ScaledWinH");
    return x;
}

// Amplitudes in mV of the lines up to half the sampling rate.
std::vector<double> Amplitudes(const Array<double>& x) {
    static void* slot = nullptr;  // keeps the tables for the next call; given back at the end of the process
    Array<KrComplex> spectrum;
    Check(ReQMFFTH(x.handle(), spectrum.handle(), &slot), "ReQMFFTH");
    std::vector<double> amplitudes;
    for (std::size_t k = 0; k <= x.size() / 2; ++k)
        amplitudes.push_back(2.0 * Modulus(spectrum[k]) / static_cast<double>(x.size()));
    return amplitudes;
}

// The quiet part in pieces that overlap by half: root of the mean square of their amplitudes, in dB over 1 mV.
std::vector<double> Averaged(const Recording& ecg, double piece, int32_t window) {
    std::vector<double> decibels;
    double count = 0.0;
    for (double from = 0.0; from + piece <= kQuiet; from += 0.5 * piece, count += 1.0) {
        const std::vector<double> amplitudes = Amplitudes(Windowed(ecg, from, from + piece, window));
        decibels.resize(amplitudes.size());
        for (std::size_t k = 0; k < amplitudes.size(); ++k) decibels[k] += amplitudes[k] * amplitudes[k];
    }
    for (double& value : decibels) value = 10.0 * std::log10(value / count);
    decibels.erase(decibels.begin());  // without a mean there is no line at 0
    return decibels;
}

// Amplitudes in mV at frequencies of any distance, on an arc of the unit circle.
std::vector<double> Zoomed(const Array<double>& x, double rate, double from, double step, int32_t count) {
    const auto on_circle = [rate](double frequency) {
        const double angle = 2.0 * std::numbers::pi * frequency / rate;
        return KrComplex{std::cos(angle), std::sin(angle)};
    };
    const KrComplex start = on_circle(from), ratio = on_circle(-step);
    constexpr int32_t kFast = 1;
    Array<KrComplex> spectrum;
    Check(ChirpZT_head(x.handle(), &start, &ratio, count, kFast, spectrum.handle()), "ChirpZT_head");
    std::vector<double> amplitudes;
    for (const KrComplex value : spectrum.values())
        amplitudes.push_back(2.0 * Modulus(value) / static_cast<double>(x.size()));
    return amplitudes;
}

}  // namespace

Section SpectrumSection(const Recording& ecg) {
    constexpr double kPiece = 4.0;                   // s
    constexpr double kMains = 60.0, kFloor = 150.0;  // Hz
    const std::vector<double> plain = Averaged(ecg, kPiece, kNone), hann = Averaged(ecg, kPiece, kHann);
    const double line = 1.0 / kPiece;
    const auto at = [line](const std::vector<double>& decibels, double frequency) {
        return decibels[static_cast<std::size_t>(frequency / line) - 1];
    };

    constexpr double kFrom = 0.5, kStep = 0.005, kTo = 4.5;  // Hz
    const auto count = static_cast<int32_t>((kTo - kFrom) / kStep + 1.5);
    const Array<double> whole = Windowed(ecg, 0.0, kQuiet, kHann);
    const std::vector<double> zoomed = Zoomed(whole, ecg.rate, kFrom, kStep, count);
    const auto highest = std::ranges::max_element(zoomed);
    const double beat = kFrom + kStep * static_cast<double>(highest - zoomed.begin());
    const std::vector<double> amplitudes = Amplitudes(whole);
    std::vector<double> places, heights;
    for (double frequency = kFrom; frequency <= kTo; frequency += 1.0 / kQuiet) {
        places.push_back(frequency);
        heights.push_back(1000.0 * amplitudes[static_cast<std::size_t>(frequency * kQuiet + 0.5)]);
    }
    std::vector<double> microvolt(zoomed);
    for (double& amplitude : microvolt) amplitude *= 1000.0;

    return {.title = "Spectrum",
            .text =
                "Pieces of four seconds, transformed as they were cut out and under a Hann window. What jumps between "
                "the ends of a piece smears over all frequencies and covers what is small; under the window the "
                "recording falls off as it was filtered when it was taken, and the mains hum at 60 Hz and at "
                "120 Hz. The chirp-Z transform looks between the lines of a long transform: the highest hill is the "
                "heart rate.",
            .values = {{"mains", 1000.0 * std::pow(10.0, at(hann, kMains) / 20.0), "µV"},
                       {"at 150 Hz, as cut out", at(plain, kFloor), "dB over 1 mV"},
                       {"at 150 Hz, Hann window", at(hann, kFloor), "dB over 1 mV"},
                       {"highest hill", beat, "Hz"},
                       {"as a heart rate", 60.0 * beat, "per minute"}},
            .tables = {},
            .plots = {{.title = "Amplitudes, averaged over pieces of 4 s",
                       .x_label = "frequency in Hz",
                       .y_label = "dB over 1 mV",
                       .series = {Line("as cut out", plain, line, line), Line("Hann window", hann, line, line)}},
                      {.title = "Between the lines of 40 s",
                       .x_label = "frequency in Hz",
                       .y_label = "amplitude in µV",
                       .series = {Line("chirp-Z transform", microvolt, kStep, kFrom),
                                  Points("lines of the transform", places, heights)}}}};
}
