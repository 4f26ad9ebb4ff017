// Filters at work on the recording, and the designs they come from.
#include <algorithm>
#include <cmath>

#include "sections.h"

namespace {

enum FilterType : int32_t { kLowpass, kHighpass, kBandpass, kBandstop };

// A recursive filter in sections, as the designs deliver it.
struct Cascade {
    Array<double> a, b;
    int32_t structure = 0;  // 0: sections of order 2; 1: of order 4

    std::size_t SectionOrder() const { return structure == 0 ? 2 : 4; }
};

Cascade ButterworthBandpass(double rate, double from, double to, int32_t order) {
    Cascade filter;
    filter.structure = 1;
    constexpr int32_t kType = kBandpass;
    int32_t err = 0;
    BWCoefs(&rate, &from, &to, &order, &kType, filter.a.handle(), filter.b.handle(), &err);
    Check(err, "BWCoefs");
    return filter;
}

void Run(const Cascade& filter, Array<double>& x) {
    Array<double> state;
    constexpr uint8_t kFromRest = 0;
    int32_t err = 0;
    IIR_Filter2(x.handle(), &filter.structure, filter.a.handle(), filter.b.handle(), state.handle(), &kFromRest, &err);
    Check(err, "IIR_Filter2");
}

// Forward and backward, section by section: twice the attenuation, and nothing is delayed.
void RunBothWays(const Cascade& filter, Array<double>& x) {
    const std::size_t m = filter.SectionOrder();
    for (std::size_t section = 0; section * m < filter.a.size(); ++section) {
        Array<double> a(m + 1, 1.0), b(filter.b.values().subspan(section * (m + 1), m + 1));
        std::ranges::copy(filter.a.values().subspan(section * m, m), a.values().begin() + 1);
        Array<double> forward_x, backward_x, forward_y, backward_y;
        constexpr int32_t kFromRest = 0;
        Check(zeroPhaseFiltH(x.handle(), a.handle(), b.handle(), forward_x.handle(), backward_x.handle(),
                             forward_y.handle(), backward_y.handle(), kFromRest),
              "zeroPhaseFiltH");
    }
}

constexpr std::size_t kResponse = 7200;  // samples, by which every response has died away

// Magnitude up to a frequency, from the impulse response.
Series Magnitude(const char* name, const Array<double>& response, double rate, double highest) {
    constexpr double kFloor = -90.0;  // dB
    void* slot = nullptr;             // given back at the end of the process
    Array<KrComplex> spectrum;
    Check(ReQMFFTH(response.handle(), spectrum.handle(), &slot), "ReQMFFTH");
    const double line = rate / kResponse;
    std::vector<double> decibels;
    for (std::size_t k = 0; static_cast<double>(k) * line <= highest; ++k)
        decibels.push_back(std::max(20.0 * std::log10(std::hypot(spectrum[k].re, spectrum[k].im)), kFloor));
    return Line(name, decibels, line);
}

// The answer of a filter to a single 1 in the middle, so that it may look ahead.
template <class Filter>
Array<double> Response(const Filter& filter) {
    Array<double> impulse(kResponse, 0.0);
    impulse[kResponse / 2] = 1.0;
    filter(impulse);
    return impulse;
}

// Without feedback the coefficients are the response.
Array<double> PaddedTaps(const Array<double>& taps) {
    Array<double> response(kResponse, 0.0);
    std::ranges::copy(taps.values(), response.values().begin());
    return response;
}

constexpr double kCutoff = 40.0;  // Hz, of all low-passes

Plot RecursivePlot(double rate) {
    constexpr int32_t kOrder = 5, kType = kLowpass;
    constexpr double kRipple = 1.0, kAttenuation = 60.0, kStop = 65.0, kHighest = 120.0, kUnused = 0.0;
    Plot plot{.title = "Recursive low-passes of order 5 at 40 Hz",
              .x_label = "frequency in Hz",
              .y_label = "dB",
              .series = {}};
    Cascade filter;
    int32_t err = 0;
    const auto add = [&](const char* function, const char* name) {
        Check(err, function);
        plot.series.push_back(Magnitude(name, Response([&](Array<double>& x) { Run(filter, x); }), rate, kHighest));
    };
    BWCoefs(&rate, &kCutoff, &kUnused, &kOrder, &kType, filter.a.handle(), filter.b.handle(), &err);
    add("BWCoefs", "Butterworth");
    BesselCoefs(&rate, &kCutoff, &kUnused, &kOrder, &kType, filter.a.handle(), filter.b.handle(), &err);
    add("BesselCoefs", "Bessel");
    ChebyshevCoefs(&rate, &kCutoff, &kUnused, &kRipple, &kOrder, &kType, filter.a.handle(), filter.b.handle(), &err);
    add("ChebyshevCoefs", "Chebyshev, 1 dB");
    InvChebyshevCoefs(&rate, &kStop, &kUnused, &kAttenuation, &kOrder, &kType, filter.a.handle(), filter.b.handle(),
                      &err);
    add("InvChebyshevCoefs", "inverse Chebyshev,\n60 dB from 65 Hz");
    EllipticCoefs(&rate, &kCutoff, &kUnused, &kRipple, &kAttenuation, &kOrder, &kType, filter.a.handle(),
                  filter.b.handle(), &err);
    add("EllipticCoefs", "elliptic, 1 dB, 60 dB");
    return plot;
}

// Two low-passes of the same length; `ripple` receives the error of the equiripple one.
Plot TapsPlot(double rate, double* ripple) {
    constexpr int32_t kTaps = 101, kType = kLowpass, kHamming = 2, kMultiband = 0, kDefaultLimit = 0;
    constexpr double kUnused = 0.0, kEdge = 6.0, kHighest = 120.0;  // Hz on either side of the cut-off
    Array<double> windowed, equiripple;
    int32_t err = 0;
    FIRCoefs(&rate, &kCutoff, &kUnused, &kTaps, windowed.handle(), &kType, &err);
    Check(err, "FIRCoefs");
    Check(SymmWinH(windowed.handle(), kHamming, 0.0), "SymmWinH");
    Records<KrFirBand> bands(2);
    bands.values()[0] = {.desired = 1.0, .lowEdge = 0.0, .highEdge = kCutoff - kEdge, .weight = 1.0};
    bands.values()[1] = {.desired = 0.0, .lowEdge = kCutoff + kEdge, .highEdge = 0.5 * rate, .weight = 1.0};
    Parks(&kTaps, &rate, bands.handle(), &kMultiband, equiripple.handle(), ripple, &kDefaultLimit, &err);
    Check(err, "Parks");
    return {.title = "Low-passes of 101 taps at 40 Hz",
            .x_label = "frequency in Hz",
            .y_label = "dB",
            .series = {Magnitude("Hamming window", PaddedTaps(windowed), rate, kHighest),
                       Magnitude("equiripple", PaddedTaps(equiripple), rate, kHighest)}};
}

constexpr double kBeatsFrom = 5.0, kBeatsTo = 20.0;  // Hz, where beats are and other waves of the heart are not

Cascade BeatFilter(double rate) {
    constexpr int32_t kOrder = 2;
    return ButterworthBandpass(rate, kBeatsFrom, kBeatsTo, kOrder);
}

Plot BandpassPlot(double rate, const Cascade& wide) {
    constexpr double kHighest = 60.0;
    const Cascade narrow = BeatFilter(rate);
    return {.title = "Butterworth band-passes",
            .x_label = "frequency in Hz",
            .y_label = "dB",
            .series = {
                Magnitude("0.5 to 40 Hz, order 4", Response([&](Array<double>& x) { Run(wide, x); }), rate, kHighest),
                Magnitude("5 to 20 Hz, order 2", Response([&](Array<double>& x) { Run(narrow, x); }), rate, kHighest),
                Magnitude("the same, both ways", Response([&](Array<double>& x) { RunBothWays(narrow, x); }), rate,
                          kHighest)}};
}

double RootMeanSquare(const Array<double>& x) {
    return Statistic(RMS_head, "RMS_head", x);
}

}  // namespace

Array<double> WithoutBaseline(const Recording& ecg) {
    // Longer than any beat is wide, so that the median does not see the beats.
    const auto rank = static_cast<int32_t>(0.3 * ecg.rate);
    Array<double> baseline(ecg.millivolt), rest(ecg.millivolt);
    int32_t err = 0;
    MedianFilterCIN(baseline.handle(), &rank, &err);
    Check(err, "MedianFilterCIN");
    for (std::size_t i = 0; i < rest.size(); ++i) rest[i] -= baseline[i];
    return rest;
}

Array<double> BeatsAlone(const Recording& ecg) {
    Array<double> beats = WithoutBaseline(ecg);
    RunBothWays(BeatFilter(ecg.rate), beats);
    return beats;
}

Section FilterSection(const Recording& ecg) {
    constexpr double kLow = 0.5;  // Hz
    constexpr int32_t kOrder = 4;
    const double step = 1.0 / ecg.rate;
    const Cascade bandpass = ButterworthBandpass(ecg.rate, kLow, kCutoff, kOrder);
    Array<double> passed(ecg.millivolt);
    Run(bandpass, passed);

    const Array<double> level = WithoutBaseline(ecg);
    Array<double> baseline(ecg.millivolt);
    for (std::size_t i = 0; i < baseline.size(); ++i) baseline[i] -= level[i];

    // Muscle noise, between the beats and under them.
    constexpr int32_t kDegree = 4, kFrame = 17;
    constexpr double kNoisy = 28.7, kCalm = 29.9, kBeat = 29.2;
    const Array<double> equal_weights;
    Array<double> smooth, noise(ecg.Between(kNoisy, kCalm));
    Check(SavitzkyGolayFiltH(level.handle(), kDegree, kFrame, equal_weights.handle(), smooth.handle()),
          "SavitzkyGolayFiltH");
    const std::size_t first = ecg.SampleAt(kNoisy);
    for (std::size_t i = 0; i < noise.size(); ++i) noise[i] = level[first + i] - smooth[first + i];

    const auto height = [&](const Array<double>& x) {
        return *std::ranges::max_element(x.values().subspan(ecg.SampleAt(kBeat - 0.1), ecg.SampleAt(0.2)));
    };

    const auto part = [&](const Array<double>& x, double from, double to) {
        return x.values().subspan(ecg.SampleAt(from), ecg.SampleAt(to) - ecg.SampleAt(from));
    };
    constexpr double kFrom = 4.0, kTo = 14.0, kClose = 10.0, kCloseEnd = 12.5;
    double ripple = 0.0;
    const Plot taps = TapsPlot(ecg.rate, &ripple);
    return {.title = "Filters",
            .text =
                "The running median of 0.6 s follows the breath and not the beats; taken off, it leaves them on level "
                "ground, with their shape. A Butterworth band-pass does so too, but bends the shape and comes late. "
                "Polynomials of degree 4 through 17 samples at a time take much of the muscle noise off and a little "
                "of the beats.",
            .values = {{"baseline, root mean square", RootMeanSquare(baseline), "mV"},
                       {"muscle noise taken off", 1000.0 * RootMeanSquare(noise), "µV"},
                       {"height of a beat kept", 100.0 * height(smooth) / height(level), "%"},
                       {"equiripple error", 1000.0 * ripple, "10⁻³"}},
            .tables = {},
            .plots = {{.title = "The baseline that a median finds",
                       .x_label = "time in s",
                       .y_label = "mV",
                       .series = {Line("recording", part(ecg.millivolt, kFrom, kTo), step, kFrom),
                                  Line("median of 0.6 s", part(baseline, kFrom, kTo), step, kFrom)}},
                      {.title = "On level ground",
                       .x_label = "time in s",
                       .y_label = "mV",
                       .series = {Line("less the median", part(level, kClose, kCloseEnd), step, kClose),
                                  Line("band-pass, 0.5 to 40 Hz", part(passed, kClose, kCloseEnd), step, kClose)}},
                      {.title = "Muscle noise and the polynomials through it",
                       .x_label = "time in s",
                       .y_label = "mV",
                       .series = {Line("less the median", part(level, kNoisy, kCalm), step, kNoisy),
                                  Line("Savitzky-Golay", part(smooth, kNoisy, kCalm), step, kNoisy)}},
                      BandpassPlot(ecg.rate, bandpass),
                      RecursivePlot(ecg.rate),
                      taps}};
}
