// How the samples are distributed: moments, modes, histograms.
#include <array>
#include <cmath>

#include "sections.h"

namespace {

// The share of samples in bands that matter to a reader, by a histogram with intervals of its own.
Table Bands(const Array<double>& x) {
    constexpr std::array<const char*, 4> kNames = {"below -1 mV", "-1 mV to 0", "0 to 1 mV", "above 1 mV"};
    constexpr std::array<double, 5> kEdges = {-HUGE_VAL, -1.0, 0.0, 1.0, HUGE_VAL};
    Records<KrInterval> intervals(kNames.size());
    for (std::size_t i = 0; i < kNames.size(); ++i) {
        intervals.values()[i] = {.lower = kEdges[i], .upper = kEdges[i + 1], .inclusion = 0};
    }
    Array<int32_t> histogram;
    KrOutOfRange missed;
    int32_t err = 0;
    GenHistH(x.handle(), intervals.handle(), histogram.handle(), &missed, &err);
    Check(err, "GenHistH");

    Table table{"Where the samples lie", {"band", "samples", "share"}, {}};
    for (std::size_t i = 0; i < kNames.size(); ++i) {
        const double share = static_cast<double>(histogram[i]) / static_cast<double>(x.size());
        table.rows.push_back({kNames[i], std::to_string(histogram[i]), Number(100.0 * share, 1) + " %"});
    }
    return table;
}

}  // namespace

double Statistic(int32_t (*statistic)(KrHandle, double*, int32_t*), const char* name, const Array<double>& x) {
    double value = 0.0;
    int32_t err = 0;
    statistic(x.handle(), &value, &err);
    Check(err, name);
    return value;
}

double Moment(const Array<double>& x, int32_t order) {
    double value = 0.0;
    int32_t err = 0;
    Moment_head(x.handle(), &order, &value, &err);
    Check(err, "Moment_head");
    return value;
}

Section StatisticsSection(const Recording& ecg) {
    const Array<double>& x = ecg.millivolt;
    const double mean = Statistic(Mean_head, "Mean_head", x);
    const double median = Statistic(Median_head, "Median_head", x);
    const double deviation = std::sqrt(Moment(x, 2));

    constexpr int32_t kBins = 100;
    Array<double> modes;
    Check(ModeH(x.handle(), kBins, modes.handle()), "ModeH");

    Array<int32_t> counts;
    Array<double> centers;
    int32_t err = 0;
    histgran_head(x.handle(), &kBins, counts.handle(), centers.handle(), &err);
    Check(err, "histgran_head");

    Plot histogram{
        .title = "Histogram of " + std::to_string(kBins) + " bins",
        .x_label = "lead MLII in mV",
        .y_label = "samples",
        .series = {Columns("samples", centers.values(), counts.values()), Mark("mean", mean), Mark("median", median)}};
    for (const double mode : modes.values()) histogram.series.push_back(Mark("mode", mode));

    return {.title = "Statistics",
            .text =
                "The beats are short: most samples are baseline. The tail towards positive values pulls the mean above "
                "the median, and the median above the mode.",
            .values = {{"mean", mean, "mV"},
                       {"median", median, "mV"},
                       {"mode of the histogram", modes.size() > 0 ? modes[0] : NAN, "mV"},
                       {"root mean square", Statistic(RMS_head, "RMS_head", x), "mV"},
                       {"standard deviation", deviation, "mV"},
                       {"skewness", Moment(x, 3) / std::pow(deviation, 3), ""},
                       {"excess kurtosis", Moment(x, 4) / std::pow(deviation, 4) - 3.0, ""}},
            .tables = {Bands(x)},
            .plots = {histogram}};
}
