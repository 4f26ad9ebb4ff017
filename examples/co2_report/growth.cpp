// Exponential growth above the level before industry: robust fits of a spoilt record, and bands.
#include <cmath>
#include <numbers>

#include "sections.h"

namespace {

constexpr double kBeforeIndustry = 280.0;  // ppm

// What people have added: a exp(b u), u in years from SeasonalFit::kMiddle.
struct Added {
    Array<double> u, ppm;
};

Added AddedTo(const Record& record, const SeasonalFit& fit) {
    Added added{Array<double>(record.years), fit.WithoutCycle(record)};
    for (double& u : added.u.values()) u -= SeasonalFit::kMiddle;
    for (double& ppm : added.ppm.values()) ppm -= kBeforeIndustry;
    return added;
}

// The record as a tired copyist leaves it: in every tenth month the last two digits before the point are exchanged.
constexpr std::size_t kFirstBlunder = 4, kBlunderStep = 10;

Record Spoil(const Record& record) {
    Record spoilt(record);
    for (std::size_t i = kFirstBlunder; i < spoilt.size(); i += kBlunderStep) {
        const auto whole = static_cast<int>(spoilt.ppm[i]);
        const int ones = whole % 10, tens = whole / 10 % 10;
        spoilt.ppm[i] += 9 * (ones - tens);
    }
    return spoilt;
}

struct Growth {
    double a = 0.0, b = 0.0;
    int32_t steps = 100;

    double At(double u) const { return a * std::exp(b * u); }
};

constexpr int32_t kIterated = 1;
constexpr double kDefaultTolerance = -1.0;

Growth LeastSquares(const Added& added) {
    Growth growth;
    const Array<double> none;
    Check(ExpFitCoef80_head(added.ppm.handle(), added.u.handle(), none.handle(), kIterated, kDefaultTolerance,
                            none.handle(), &growth.a, &growth.b, &growth.steps, kDefaultTolerance),
          "ExpFitCoef80_head");
    return growth;
}

using RobustFit = decltype(BiExpFit_head);

Growth Robust(RobustFit* fit, const char* name, const Added& added) {
    constexpr int32_t kCoefficientsOnly = 1;
    Growth growth;
    const Array<double> none;
    double residue = 0.0;
    Check(fit(added.ppm.handle(), added.u.handle(), none.handle(), kDefaultTolerance, none.handle(), kIterated,
              &growth.a, &growth.b, &residue, &growth.steps, kDefaultTolerance, kCoefficientsOnly),
          name);
    return growth;
}

std::vector<double> Curve(const Growth& growth, const Added& added) {
    std::vector<double> values;
    for (const double u : added.u.values()) values.push_back(growth.At(u));
    return values;
}

}  // namespace

Section BlunderSection(const Record& record, const SeasonalFit& fit) {
    const Added clean = AddedTo(record, fit);
    const Added spoilt = AddedTo(Spoil(record), fit);
    const Growth reference = LeastSquares(clean);
    struct Row {
        const char* name;
        Growth growth;
    };
    const Row rows[] = {{"least squares, record as it is", reference},
                        {"least squares, spoilt", LeastSquares(spoilt)},
                        {"bisquare weights, spoilt", Robust(BiExpFit_head, "BiExpFit_head", spoilt)},
                        {"least absolute residuals, spoilt", Robust(LARExpFit_head, "LARExpFit_head", spoilt)}};
    Table table{"Growth above " + Number(kBeforeIndustry, 0) + " ppm",
                {"fit", "ppm in mid 1978", "% a year", "doubles in years", "steps"},
                {}};
    std::vector<double> years, blunders;
    for (std::size_t i = kFirstBlunder; i < spoilt.ppm.size(); i += kBlunderStep) {
        years.push_back(record.years[i]);
        blunders.push_back(spoilt.ppm[i]);
    }
    Plot plot{.title = "The spoilt months and the fits",
              .x_label = "year",
              .y_label = "above " + Number(kBeforeIndustry, 0) + " ppm, without the cycle",
              .series = {Points("spoilt months", years, blunders)}};
    for (const auto& [name, growth] : rows) {
        table.rows.push_back({name, Number(growth.a, 3), Number(100.0 * growth.b, 4),
                              Number(std::numbers::ln2 / growth.b, 2), std::to_string(growth.steps)});
        plot.series.push_back(Line(name, record.years.values(), Curve(growth, clean)));
    }
    return {.title = "Exponential growth, with blunders",
            .text =
                "Without the cycle, what has been added since industry began grows nearly as an exponential. In every "
                "tenth month the last two digits before the point have been exchanged, as a tired copyist might: the "
                "fit by least squares follows the blunders, the robust ones hardly notice them.",
            .values = {},
            .tables = {table},
            .plots = {plot}};
}

Section BandSection(const Record& record, const SeasonalFit& fit) {
    constexpr double kConfidence = 0.95;
    const Added added = AddedTo(record, fit);
    const Growth growth = LeastSquares(added);
    const Array<double> none;
    Array<double> upper, lower, upper_coef, lower_coef, above, below;
    double a_half = 0.0, b_half = 0.0;
    Check(ConfBndExp_head(added.ppm.handle(), added.u.handle(), none.handle(), growth.a, growth.b, kConfidence,
                          upper.handle(), lower.handle(), upper_coef.handle(), lower_coef.handle(), &a_half, &b_half),
          "ConfBndExp_head");
    Check(PredBndExp_head(added.ppm.handle(), added.u.handle(), none.handle(), growth.a, growth.b, kConfidence,
                          above.handle(), below.handle()),
          "PredBndExp_head");

    // Seen from the curve, for beside 80 ppm the bands would be thin lines.
    const std::vector<double> curve = Curve(growth, added);
    std::vector<double> residuals(curve.size());
    std::size_t outside = 0;
    for (std::size_t i = 0; i < curve.size(); ++i) {
        outside += added.ppm[i] > above[i] || added.ppm[i] < below[i];
        residuals[i] = added.ppm[i] - curve[i];
        for (Array<double>* bound : {&upper, &lower, &above, &below}) (*bound)[i] -= curve[i];
    }
    const double correlation = NeighbourCorrelation(residuals);
    const auto years = record.years.values();
    return {.title = "How sure is the growth?",
            .text =
                "The curve by least squares with 95 % bands: the narrow one for the curve, the wide one for a single "
                "month. The narrow one takes the months for independent; the slow waves that leave it show that they "
                "are not, and that an exponential is not the last word.",
            .values = {{"growth", 100.0 * growth.b, "% a year"},
                       {"half-width, independent", 100.0 * b_half, "% a year"},
                       {"half-width, correlated", 100.0 * b_half * Widening(correlation, 0.0), "% a year"},
                       {"months outside the wide band",
                        100.0 * static_cast<double>(outside) / static_cast<double>(curve.size()), "%"}},
            .tables = {},
            .plots = {{.title = "The record, seen from the curve",
                       .x_label = "year",
                       .y_label = "off the curve in ppm",
                       .series = {Band("band of a month", years, below.values(), above.values()),
                                  Band("band of the curve", years, lower.values(), upper.values()),
                                  Points("months", years, residuals)}}}};
}
