// A pulse train of known properties, and every measurement of a waveform on it.
#include <cmath>
#include <numbers>

#include "sections.h"

namespace {

// A clock that rings: a square wave through a resonance, with noise.
struct PulseTrain {
    static constexpr double kStep = 1e-6;      // s
    static constexpr double kFrequency = 1e3;  // Hz
    static constexpr double kDuty = 0.4;
    static constexpr double kLow = 0.2, kHigh = 3.3;  // V
    static constexpr double kNoise = 0.005;           // V
    static constexpr double kResonance = 20e3;        // Hz
    static constexpr double kDamping = 0.45;
    static constexpr int32_t kSamples = 4000;

    PulseTrain();

    // Of the step response of the resonance.
    static double Overshoot() {
        return 100.0 * std::exp(-std::numbers::pi * kDamping / std::sqrt(1.0 - kDamping * kDamping));
    }
    // Between 10 % and 90 % of the step response, by bisection.
    static double RiseTime();

    Array<double> volt;
};

PulseTrain::PulseTrain() {
    const double amplitude = 0.5 * (kHigh - kLow), cycles = kFrequency * kStep, duty = 100.0 * kDuty;
    double phase = 300.0;  // in the low state
    int32_t err = 0;
    SquareWaveCIN(volt.handle(), &kSamples, &amplitude, &cycles, &phase, &duty, &err);
    Check(err, "SquareWaveCIN");

    // The resonance by the bilinear transform.
    const double k = std::tan(std::numbers::pi * kResonance * kStep);
    const double scale = 1.0 / (1.0 + 2.0 * kDamping * k + k * k);
    Array<double> a(3), b(3, k * k * scale);
    a[0] = 1.0;
    a[1] = 2.0 * (k * k - 1.0) * scale;
    a[2] = (1.0 - 2.0 * kDamping * k + k * k) * scale;
    b[1] *= 2.0;
    // It has been in the low state for long.
    Array<double> inputs(2, -amplitude), outputs(2, -amplitude);
    constexpr uint8_t kGoOn = 1;
    IIR_Filter(volt.handle(), a.handle(), b.handle(), inputs.handle(), outputs.handle(), &kGoOn, &err);
    Check(err, "IIR_Filter");

    constexpr int32_t kSeed = 11;
    Array<double> noise;
    KrRandomState random{};
    KrGaussSpare spare{};
    Gauss(noise.handle(), &kSamples, &kNoise, &kSeed, &err, &random, &spare);
    Check(err, "Gauss");
    for (std::size_t i = 0; i < volt.size(); ++i) volt[i] += 0.5 * (kHigh + kLow) + noise[i];
}

double PulseTrain::RiseTime() {
    const double omega = 2.0 * std::numbers::pi * kResonance, root = std::sqrt(1.0 - kDamping * kDamping);
    const auto response = [&](double t) {
        return 1.0 - std::exp(-kDamping * omega * t) *
                         (std::cos(root * omega * t) + kDamping / root * std::sin(root * omega * t));
    };
    const auto reaches = [&](double level) {
        double before = 0.0, behind = std::numbers::pi / (root * omega);  // the first maximum
        for (int i = 0; i < 60; ++i) {
            const double middle = 0.5 * (before + behind);
            (response(middle) < level ? before : behind) = middle;
        }
        return before;
    };
    return reaches(0.9) - reaches(0.1);
}

struct Measured {
    double value;
    KrMarkers markers;
};

// One context for all, so that levels and crossings are found once.
class Meter {
  public:
    explicit Meter(const PulseTrain& train) : train_(train) { Check(measurements_create(&id_), "measurements_create"); }
    Meter(const Meter&) = delete;
    Meter& operator=(const Meter&) = delete;
    ~Meter() { measurements_destroy(static_cast<int32_t>(id_)); }

    Measured operator()(int32_t kind, int32_t occurrence = 1) const {
        static constexpr KrLevels kLevels{.high = 90.0, .mid = 50.0, .low = 10.0, .units = KRN_LEVELS_PERCENT};
        static constexpr KrStateMethod kStates{.method = KRN_STATES_BY_HISTOGRAM, .bins = 256};
        Measured measured{};
        Check(
            measurements_fetch(static_cast<int32_t>(id_), kind, &kLevels, &kStates, occurrence, 0.0, PulseTrain::kStep,
                               train_.volt.values().data(), train_.volt.count(), &measured.value, &measured.markers),
            "measurements_fetch");
        return measured;
    }

  private:
    const PulseTrain& train_;
    uint32_t id_ = 0;
};

struct Kind {
    int32_t selector;
    const char* name;
    double scale;  // from V and s to the unit
    const char* unit;
    double expected = NAN;  // in the unit, where the train tells
};

std::vector<Kind> Kinds() {
    constexpr double kMilli = 1e3, kMicro = 1e6;
    constexpr double kPeriod = kMicro / PulseTrain::kFrequency;
    constexpr double kAmplitude = PulseTrain::kHigh - PulseTrain::kLow;
    constexpr double kMean = PulseTrain::kLow + PulseTrain::kDuty * kAmplitude;
    const double overshoot = PulseTrain::Overshoot(), rise = kMicro * PulseTrain::RiseTime();
    const double beyond = 0.01 * overshoot * kAmplitude, slew = 0.8 * kAmplitude / rise;
    return {{KRN_SMALLEST, "smallest sample", 1.0, "V", PulseTrain::kLow - beyond},
            {KRN_LARGEST, "largest sample", 1.0, "V", PulseTrain::kHigh + beyond},
            {KRN_RANGE, "range", 1.0, "V", kAmplitude + 2.0 * beyond},
            {KRN_LOW_STATE, "low state", 1.0, "V", PulseTrain::kLow},
            {KRN_HIGH_STATE, "high state", 1.0, "V", PulseTrain::kHigh},
            {KRN_AMPLITUDE, "amplitude", 1.0, "V", kAmplitude},
            {KRN_TOP, "top", 1.0, "V", PulseTrain::kHigh},
            {KRN_BASE, "base", 1.0, "V", PulseTrain::kLow},
            {KRN_TOP_TO_BASE, "top to base", 1.0, "V", kAmplitude},
            {KRN_LOW_REFERENCE, "low reference, 10 %", 1.0, "V", PulseTrain::kLow + 0.1 * kAmplitude},
            {KRN_MID_REFERENCE, "mid reference, 50 %", 1.0, "V", PulseTrain::kLow + 0.5 * kAmplitude},
            {KRN_HIGH_REFERENCE, "high reference, 90 %", 1.0, "V", PulseTrain::kLow + 0.9 * kAmplitude},
            {KRN_BAND, "band about the middle", 1.0, "V", 0.4 * kAmplitude},
            {KRN_RMS, "root mean square", 1.0, "V"},
            {KRN_MEAN, "mean", 1.0, "V"},
            {KRN_PERIOD, "period", kMicro, "µs", kPeriod},
            {KRN_FREQUENCY, "frequency", 1.0, "Hz", PulseTrain::kFrequency},
            {KRN_CYCLE_RMS, "root mean square of a cycle", 1.0, "V"},
            {KRN_CYCLE_MEAN, "mean of a cycle", 1.0, "V", kMean},
            {KRN_FALL_TIME, "fall time", kMicro, "µs", rise},
            {KRN_RISE_TIME, "rise time", kMicro, "µs", rise},
            {KRN_POSITIVE_WIDTH, "positive width", kMicro, "µs", PulseTrain::kDuty * kPeriod},
            {KRN_NEGATIVE_WIDTH, "negative width", kMicro, "µs", (1.0 - PulseTrain::kDuty) * kPeriod},
            {KRN_DUTY_HIGH, "high part of the cycle", 100.0, "%", 100.0 * PulseTrain::kDuty},
            {KRN_DUTY_LOW, "low part of the cycle", 100.0, "%", 100.0 * (1.0 - PulseTrain::kDuty)},
            {KRN_UNDERSHOOT, "undershoot of edge 2", 1.0, "%", overshoot},
            {KRN_OVERSHOOT, "overshoot of edge 2", 1.0, "%", 0.0},
            {KRN_NEXT_OVERSHOOT, "overshoot of edge 3", 1.0, "%", overshoot},
            {KRN_NEXT_UNDERSHOOT, "undershoot of edge 3", 1.0, "%", 0.0},
            {KRN_POSITIVE_CENTER, "centre of the positive pulse", kMilli, "ms"},
            {KRN_NEGATIVE_CENTER, "centre of the negative pulse", kMilli, "ms"},
            {KRN_RISING_SLEW, "slew rate, rising", 1.0 / kMicro, "V/µs", slew},
            {KRN_FALLING_SLEW, "slew rate, falling", 1.0 / kMicro, "V/µs", slew}};
}

Table MeasurementTable(const Meter& meter) {
    Table table{"Every measurement, of the first cycle", {"measurement", "measured", "as made", "unit"}, {}};
    for (const Kind& kind : Kinds()) {
        const double value = kind.scale * meter(kind.selector).value;
        table.rows.push_back(
            {kind.name, Number(value, 3), std::isnan(kind.expected) ? "" : Number(kind.expected, 3), kind.unit});
    }
    return table;
}

// The levels and crossings of the whole train.
Plot TrainPlot(const PulseTrain& train, const Meter& meter) {
    constexpr double kMilli = 1e3;
    constexpr int32_t kCycles = 3;
    std::vector<double> times, levels, centers, middles;
    for (int32_t k = 1; k <= kCycles; ++k) {
        const Measured width = meter(KRN_POSITIVE_WIDTH, k);
        for (const double time : {width.markers.left, width.markers.right}) {
            times.push_back(kMilli * time);
            levels.push_back(width.markers.values[0]);
        }
        centers.push_back(kMilli * meter(KRN_POSITIVE_CENTER, k).value);
        middles.push_back(width.markers.values[0]);
    }
    return {.title = "The train, its states and its crossings",
            .x_label = "time in ms",
            .y_label = "V",
            .series = {Line("pulses", train.volt.values(), kMilli * PulseTrain::kStep),
                       Level("high state", meter(KRN_HIGH_STATE).value),
                       Level("mid reference", meter(KRN_MID_REFERENCE).value),
                       Level("low state", meter(KRN_LOW_STATE).value), Points("crossings", times, levels),
                       Points("centres", centers, middles)}};
}

// The second rising edge, edge 3, from close by.
Plot EdgePlot(const PulseTrain& train, const Meter& meter) {
    constexpr double kMicro = 1e6, kBefore = 40e-6, kBehind = 160e-6;  // s
    const Measured rise = meter(KRN_RISE_TIME, 2), overshoot = meter(KRN_NEXT_OVERSHOOT, 1);
    const auto first = static_cast<std::size_t>((rise.markers.left - kBefore) / PulseTrain::kStep);
    const auto count = static_cast<std::size_t>((kBefore + kBehind) / PulseTrain::kStep);
    const double from = kMicro * PulseTrain::kStep * static_cast<double>(first);
    const double ends[] = {kMicro * rise.markers.left, kMicro * rise.markers.right};
    const double top_time[] = {kMicro * overshoot.markers.values[0]}, top[] = {overshoot.markers.values[1]};
    return {.title = "A rising edge from close by",
            .x_label = "time in µs",
            .y_label = "V",
            .series = {Line("pulses", train.volt.values().subspan(first, count), kMicro * PulseTrain::kStep, from),
                       Level("high state", meter(KRN_HIGH_STATE).value),
                       Level("high reference", meter(KRN_HIGH_REFERENCE).value),
                       Level("low reference", meter(KRN_LOW_REFERENCE).value),
                       Level("low state", meter(KRN_LOW_STATE).value),
                       Points("begin and end of the rise", ends, std::span(rise.markers.values).first(2)),
                       Points("overshoot", top_time, top)}};
}

}  // namespace

Section MeasurementSection(const Recording&) {
    const PulseTrain train;
    const Meter meter(train);
    return {.title = "Measurements of a pulse train",
            .text =
                "A clock of 1 kHz that is high for 40 % of its period, from 0.2 V to 3.3 V, behind a resonance of 20 "
                "kHz with a damping of 0.45 and with 5 mV of noise: what can be measured is known beforehand. One "
                "context answers all questions and finds levels, crossings and edges once.",
            .values = {},
            .tables = {MeasurementTable(meter)},
            .plots = {TrainPlot(train, meter), EdgePlot(train, meter)}};
}
