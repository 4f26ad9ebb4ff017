// Trend and yearly cycle by general linear least squares, and what they leave.
#include <array>
#include <cmath>
#include <numbers>
#include <numeric>

#include "sections.h"

namespace {

using Basis = std::array<double, SeasonalFit::kCoefficients>;

Basis BasisAt(double year) {
    const double u = year - SeasonalFit::kMiddle;
    Basis basis;
    double power = 1.0;
    for (std::size_t p = 0; p < SeasonalFit::kPowers; ++p, power *= u) basis[p] = power;
    for (std::size_t h = 0; h < SeasonalFit::kHarmonics; ++h) {
        const double angle = 2.0 * std::numbers::pi * static_cast<double>(h + 1) * u;
        basis[SeasonalFit::kPowers + 2 * h] = std::cos(angle);
        basis[SeasonalFit::kPowers + 2 * h + 1] = std::sin(angle);
    }
    return basis;
}

double Sum(const Basis& basis, const Array<double>& coef, std::size_t from, std::size_t to) {
    double sum = 0.0;
    for (std::size_t i = from; i < to; ++i) sum += basis[i] * coef[i];
    return sum;
}

// One year, in hundredths.
constexpr std::size_t kPlaces = 101;

Plot CyclePlot(const SeasonalFit& fit, double t) {
    std::vector<double> x(kPlaces), cycle(kPlaces), lower(kPlaces), upper(kPlaces);
    for (std::size_t i = 0; i < kPlaces; ++i) {
        const double phase = static_cast<double>(i) / (kPlaces - 1);
        const double half = t * fit.CycleError(phase);
        x[i] = 12.0 * phase;
        cycle[i] = fit.Cycle(phase);
        lower[i] = cycle[i] - half;
        upper[i] = cycle[i] + half;
    }
    return {.title = "A year",
            .x_label = "months from the new year",
            .y_label = "off the trend in ppm",
            .series = {Line("cycle", x, cycle), Band("95 % band", x, lower, upper)}};
}

Table CoefficientTable(const SeasonalFit& fit) {
    constexpr std::array<const char*, SeasonalFit::kCoefficients> kNames = {
        "constant",         "per year",         "per year squared",  "per year cubed",
        "cos, once a year", "sin, once a year", "cos, twice a year", "sin, twice a year"};
    Table table{"Coefficients, time in years from the middle of 1978",
                {"term", "ppm", "error, independent", "error, correlated"},
                {}};
    for (std::size_t i = 0; i < kNames.size(); ++i) {
        const double error = fit.StandardError(i);
        table.rows.push_back({kNames[i], Number(fit.coef[i], 6), Number(error, 6), Number(fit.Widening(i) * error, 6)});
    }
    return table;
}

}  // namespace

SeasonalFit::SeasonalFit(const Record& record) : residuals(record.ppm) {
    Matrix observations(record.size(), kCoefficients);
    for (std::size_t i = 0; i < record.size(); ++i) {
        const Basis basis = BasisAt(record.years[i]);
        std::ranges::copy(basis, observations.Row(i).begin());
    }
    constexpr int32_t kQR = 1, kWithCovariance = 1;
    const Array<double> equal_weights;
    double mse = 0.0;
    Check(GenLSFit80_head(observations.handle(), record.ppm.handle(), equal_weights.handle(), kQR, kWithCovariance,
                          coef.handle(), values.handle(), covariance.handle(), &mse),
          "GenLSFit80_head");

    for (std::size_t i = 0; i < residuals.size(); ++i) residuals[i] -= values[i];
    const auto freedom = static_cast<int32_t>(record.size() - kCoefficients);
    double squares = 0.0;
    Check(GoodnessOfFit_head(record.ppm.handle(), values.handle(), equal_weights.handle(), freedom, &squares, &r_square,
                             &deviation),
          "GoodnessOfFit_head");
    correlation = NeighbourCorrelation(residuals.values());
}

double SeasonalFit::Trend(double year) const {
    return Sum(BasisAt(year), coef, 0, kPowers);
}

double SeasonalFit::Cycle(double year) const {
    return Sum(BasisAt(year), coef, kPowers, kCoefficients);
}

double SeasonalFit::StandardError(std::size_t i) const {
    return deviation * std::sqrt(covariance.Row(i)[i]);
}

double SeasonalFit::Widening(std::size_t i) const {
    constexpr double kSamplesPerYear = 12.0;
    const double cycles_per_year = i < kPowers ? 0.0 : static_cast<double>((i - kPowers) / 2 + 1);
    return ::Widening(correlation, cycles_per_year / kSamplesPerYear);
}

double SeasonalFit::CycleError(double year) const {
    const Basis basis = BasisAt(year);
    double variance = 0.0;
    for (std::size_t i = kPowers; i < kCoefficients; ++i) {
        for (std::size_t j = kPowers; j < kCoefficients; ++j) {
            variance += basis[i] * Widening(i) * covariance.Row(i)[j] * Widening(j) * basis[j];
        }
    }
    return deviation * std::sqrt(variance);
}

Array<double> SeasonalFit::WithoutCycle(const Record& record) const {
    Array<double> rest(record.ppm);
    for (std::size_t i = 0; i < rest.size(); ++i) rest[i] -= Cycle(record.years[i]);
    return rest;
}

double NeighbourCorrelation(std::span<const double> x) {
    const double products = std::inner_product(x.begin() + 1, x.end(), x.begin(), 0.0);
    return products / std::inner_product(x.begin(), x.end(), x.begin(), 0.0);
}

double Widening(double correlation, double cycles_per_sample) {
    const double r = correlation;
    return std::sqrt((1.0 - r * r) / (1.0 - 2.0 * r * std::cos(2.0 * std::numbers::pi * cycles_per_sample) + r * r));
}

double StudentT(double confidence, std::size_t degrees_of_freedom) {
    const double probability = 0.5 * (1.0 + confidence);
    const auto freedom = static_cast<int32_t>(degrees_of_freedom);
    double t = 0.0;
    int32_t err = 0;
    InvTdist_head(&probability, &freedom, &t, &err);
    Check(err, "InvTdist_head");
    return t;
}

Section RecordSection(const Record& record, const SeasonalFit& fit) {
    constexpr double kFrom = 1990.0;
    const double t = StudentT(0.95, record.size() - SeasonalFit::kCoefficients);

    std::vector<double> trend;
    std::vector<double> late_years, late_ppm, late_fit;
    double highest = 0.0, lowest = 0.0;
    for (std::size_t i = 0; i < record.size(); ++i) {
        const double year = record.years[i];
        trend.push_back(fit.Trend(year));
        if (year < kFrom) continue;
        late_years.push_back(year);
        late_ppm.push_back(record.ppm[i]);
        late_fit.push_back(fit.values[i]);
    }
    for (std::size_t i = 0; i < kPlaces; ++i) {
        const double cycle = fit.Cycle(static_cast<double>(i) / (kPlaces - 1));
        highest = std::max(highest, cycle);
        lowest = std::min(lowest, cycle);
    }
    return {
        .title = "Trend and yearly cycle",
        .text =
            "A cubic in time and two harmonics of the year, eight columns of one matrix, by QR with the covariance "
            "of the coefficients. Plants bind carbon in the northern summer: the cycle falls from May to September. "
            "Standard errors from the covariance take the months for independent, which they are not; the last "
            "column widens them by what neighbouring residuals say.",
        .values = {{"months", static_cast<double>(record.size()), ""},
                   {"rate in 1978", fit.coef[1], "ppm a year"},
                   {"swing of the cycle", highest - lowest, "ppm"},
                   {"residual deviation", fit.deviation, "ppm"},
                   {"explained share", fit.r_square, ""}},
        .tables = {CoefficientTable(fit)},
        .plots = {
            {.title = "The record",
             .x_label = "year",
             .y_label = "carbon dioxide in ppm",
             .series = {Line("monthly means", record.years.values(), record.ppm.values()),
                        Line("trend", record.years.values(), trend)}},
            {.title = "Its last eight years",
             .x_label = "year",
             .y_label = "carbon dioxide in ppm",
             .series = {Points("monthly means", late_years, late_ppm), Line("trend and cycle", late_years, late_fit)}},
            CyclePlot(fit, t)}};
}

Section ResidualSection(const Record& record, const SeasonalFit& fit) {
    constexpr int32_t kBins = 24;
    Array<int32_t> counts;
    Array<double> centers;
    int32_t err = 0;
    histgran_head(fit.residuals.handle(), &kBins, counts.handle(), centers.handle(), &err);
    Check(err, "histgran_head");

    return {.title = "What trend and cycle leave",
            .text =
                "Slow waves of a few years, which go with El Niño and with eruptions, and a yearly ripple: the cycle "
                "has grown over the decades, and the fit has one for all of them. Neighbouring months are far from "
                "independent.",
            .values = {{"residual deviation", fit.deviation, "ppm"},
                       {"correlation of neighbours", fit.correlation, ""},
                       {"factor on errors of the trend", fit.Widening(0), ""}},
            .tables = {},
            .plots = {{.title = "Residuals",
                       .x_label = "year",
                       .y_label = "record minus fit in ppm",
                       .series = {Line("residuals", record.years.values(), fit.residuals.values())}},
                      {.title = "How they are distributed",
                       .x_label = "record minus fit in ppm",
                       .y_label = "months",
                       .series = {Columns("months", centers.values(), counts.values())}}}};
}
