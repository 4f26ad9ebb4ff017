// The beats, one by one: where they are, how regular, and what they look like on average.
#include <algorithm>
#include <cmath>

#include "sections.h"

namespace {

// Times of the beats in s. The samples come in blocks, as from a monitor.
std::vector<double> FindBeats(const Recording& ecg) {
    constexpr double kBlock = 5.0, kWindow = 0.08, kRefractory = 0.2;  // s
    constexpr double kThreshold = 0.25;                                // mV
    const Array<double> trace = BeatsAlone(ecg);
    const std::size_t block = ecg.SampleAt(kBlock);
    Array<double> places, heights, curvatures;
    KrPeakState state{};
    KrHandle work = nullptr;
    std::vector<double> beats;
    double last_height = 0.0;
    for (std::size_t from = 0; from < trace.size(); from += block) {
        const bool last = from + 2 * block > trace.size();
        const Array<double> samples(trace.values().subspan(from, last ? trace.size() - from : block));
        KrPeakRecord record{.input = samples.handle(),
                            .threshold = kThreshold,
                            .width = static_cast<int32_t>(kWindow * ecg.rate),
                            .polarity = KRN_PEAKS,
                            .locations = places.handle(),
                            .amplitudes = heights.handle(),
                            .second_derivatives = curvatures.handle(),
                            .count = 0,
                            .flags = (from == 0 ? KRN_FIRST_BLOCK : 0) | (last ? KRN_LAST_BLOCK : 0)};
        int32_t err = 0;
        PeakD(&record, &state, &work, &err);
        Check(err, "PeakD");
        for (std::size_t i = 0; i < places.size(); ++i) {
            const double time = places[i] / ecg.rate;
            if (!beats.empty() && time - beats.back() < kRefractory) {  // no heart beats again so soon
                if (heights[i] <= last_height) continue;
                beats.pop_back();
            }
            beats.push_back(time);
            last_height = heights[i];
        }
        if (last) break;
    }
    return beats;
}

// Intervals in ms from beat to beat. Those in step are within a fifth of the median of the eleven around them: early
// beats, lost ones and artefacts are not what the rhythm is judged by.
struct Rhythm {
    explicit Rhythm(std::span<const double> beats) {
        constexpr std::size_t kAround = 5;
        constexpr double kOutOfStep = 0.2;
        for (std::size_t i = 1; i < beats.size(); ++i) {
            times.push_back(beats[i]);
            intervals.push_back(1000.0 * (beats[i] - beats[i - 1]));
        }
        for (std::size_t i = 0; i < intervals.size(); ++i) {
            const std::size_t from = i < kAround ? 0 : i - kAround;
            const std::size_t to = std::min(i + kAround + 1, intervals.size());
            const Array<double> around(std::span<const double>(intervals).subspan(from, to - from));
            const double median = Statistic(Median_head, "Median_head", around);
            in_step.push_back(std::fabs(intervals[i] - median) < kOutOfStep * median);
        }
    }

    std::vector<double> times, intervals;
    std::vector<bool> in_step;
};

struct Variability {
    double mean, deviation;             // of the intervals in step, ms
    double successive;                  // root mean square of the differences of neighbours, ms
    double beyond_50;                   // share of these differences above 50 ms
    std::vector<double> before, after;  // neighbours, ms
};

Variability Measure(const Rhythm& rhythm) {
    std::vector<double> steady;
    Variability result{};
    std::vector<double> differences;
    for (std::size_t i = 0; i < rhythm.intervals.size(); ++i) {
        if (!rhythm.in_step[i]) continue;
        steady.push_back(rhythm.intervals[i]);
        if (i == 0 || !rhythm.in_step[i - 1]) continue;
        result.before.push_back(rhythm.intervals[i - 1]);
        result.after.push_back(rhythm.intervals[i]);
        differences.push_back(rhythm.intervals[i] - rhythm.intervals[i - 1]);
    }
    const Array<double> x(steady);
    result.mean = Statistic(Mean_head, "Mean_head", x);
    result.deviation = std::sqrt(Moment(x, 2));
    result.successive = Statistic(RMS_head, "RMS_head", Array<double>(differences));
    const auto large = std::ranges::count_if(differences, [](double ms) { return std::fabs(ms) > 50.0; });
    result.beyond_50 = static_cast<double>(large) / static_cast<double>(differences.size());
    return result;
}

// The beats in step laid over one another: their mean, and a deviation to either side.
Plot AverageBeat(const Recording& ecg, const Array<double>& level, const Rhythm& rhythm) {
    constexpr double kBefore = 0.25, kBehind = 0.35;  // s
    const std::size_t before = ecg.SampleAt(kBefore), size = before + ecg.SampleAt(kBehind);
    std::vector<double> sum(size), squares(size), x(size), lower(size), upper(size);
    double count = 0.0;
    for (std::size_t i = 0; i < rhythm.times.size(); ++i) {
        const std::size_t middle = ecg.SampleAt(rhythm.times[i]);
        if (!rhythm.in_step[i] || middle < before || middle - before + size > level.size()) continue;
        for (std::size_t k = 0; k < size; ++k) {
            const double sample = level[middle - before + k];
            sum[k] += sample;
            squares[k] += sample * sample;
        }
        count += 1.0;
    }
    for (std::size_t k = 0; k < size; ++k) {
        x[k] = (static_cast<double>(k) - static_cast<double>(before)) / ecg.rate;
        const double mean = sum[k] / count;
        const double deviation = std::sqrt(std::max(squares[k] / count - mean * mean, 0.0));
        sum[k] = mean;
        lower[k] = mean - deviation;
        upper[k] = mean + deviation;
    }
    return {.title = "The average beat",
            .x_label = "time from the beat in s",
            .y_label = "mV, less the median",
            .series = {Line("mean", x, sum), Band("one deviation", x, lower, upper)}};
}

}  // namespace

Section BeatSection(const Recording& ecg) {
    const std::vector<double> beats = FindBeats(ecg);
    const Rhythm rhythm(beats);
    const Variability variability = Measure(rhythm);
    const Array<double> level = WithoutBaseline(ecg);

    constexpr double kFrom = 15.0, kTo = 30.0;
    constexpr double kAround = 0.04;  // s, in which the top of a beat lies
    std::vector<double> tops, heights;
    for (const double beat : beats) {
        if (beat < kFrom || beat >= kTo) continue;
        const auto around = level.values().subspan(ecg.SampleAt(beat - kAround), ecg.SampleAt(2.0 * kAround));
        const auto top = std::ranges::max_element(around);
        tops.push_back(static_cast<double>(&*top - level.values().data()) / ecg.rate);
        heights.push_back(*top);
    }
    std::vector<double> steady_times, steady, odd_times, odd;
    for (std::size_t i = 0; i < rhythm.intervals.size(); ++i) {
        (rhythm.in_step[i] ? steady_times : odd_times).push_back(rhythm.times[i]);
        (rhythm.in_step[i] ? steady : odd).push_back(60000.0 / rhythm.intervals[i]);
    }
    return {
        .title = "Beats",
        .text =
            "Filtered from 5 to 20 Hz without delay, a beat is a single hill, and the parabolas of PeakD find its "
            "top between the samples. Some beats come early and broad, from the chambers themselves, and while the "
            "electrode is loose none is seen: such intervals stand apart, and the figures leave them out.",
        .values = {{"beats", static_cast<double>(beats.size()), ""},
                   {"heart rate", 60000.0 / variability.mean, "per minute"},
                   {"mean interval", variability.mean, "ms"},
                   {"deviation of intervals", variability.deviation, "ms"},
                   {"successive differences", variability.successive, "ms"},
                   {"differences above 50 ms", 100.0 * variability.beyond_50, "%"},
                   {"intervals out of step", static_cast<double>(odd.size()), ""}},
        .tables = {},
        .plots = {{.title = "Fifteen seconds with their beats",
                   .x_label = "time in s",
                   .y_label = "mV, less the median",
                   .series = {Line("recording",
                                   level.values().subspan(ecg.SampleAt(kFrom), ecg.SampleAt(kTo) - ecg.SampleAt(kFrom)),
                                   1.0 / ecg.rate, kFrom),
                              Points("beats", tops, heights)}},
                  {.title = "Heart rate from beat to beat",
                   .x_label = "time in s",
                   .y_label = "per minute",
                   .series = {Points("in step", steady_times, steady), Points("out of step", odd_times, odd)}},
                  {.title = "An interval and the next",
                   .x_label = "interval in ms",
                   .y_label = "next interval in ms",
                   .series = {Points("both in step", variability.before, variability.after)}},
                  AverageBeat(ecg, level, rhythm)}};
}
