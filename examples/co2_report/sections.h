// The chapters of the analysis, and what they hand on.
#pragma once

#include <cstddef>
#include <vector>

#include "array.h"
#include "report.h"

// Monthly means.
struct Record {
    Array<double> years;  // with decimals
    Array<double> ppm;    // parts per million

    std::size_t size() const { return ppm.size(); }
};

// A cubic in time and a yearly cycle of two harmonics, by least squares.
struct SeasonalFit {
    static constexpr double kMiddle = 1978.5;  // where time is 0
    static constexpr std::size_t kPowers = 4;
    static constexpr std::size_t kHarmonics = 2;
    static constexpr std::size_t kCoefficients = kPowers + 2 * kHarmonics;

    explicit SeasonalFit(const Record& record);

    double Trend(double year) const;
    double Cycle(double year) const;
    // Standard error of a coefficient, the months taken for independent.
    double StandardError(std::size_t i) const;
    // Factor on that error, because they are not.
    double Widening(std::size_t i) const;
    double CycleError(double year) const;  // widened

    Array<double> WithoutCycle(const Record& record) const;

    Array<double> coef, values, residuals;
    Matrix covariance;  // for observations of variance 1
    double deviation = 0.0, r_square = 0.0;
    double correlation = 0.0;  // of neighbouring residuals
};

double NeighbourCorrelation(std::span<const double> x);

// How much wider standard errors are at a frequency when the noise is an autoregression of first order: the root of its
// spectrum, over that of white noise of the same variance.
double Widening(double correlation, double cycles_per_sample);

// Quantile of Student's t for a two-sided interval.
double StudentT(double confidence, std::size_t degrees_of_freedom);

Section RecordSection(const Record& record, const SeasonalFit& fit);
Section ResidualSection(const Record& record, const SeasonalFit& fit);
Section BlunderSection(const Record& record, const SeasonalFit& fit);
Section BandSection(const Record& record, const SeasonalFit& fit);
