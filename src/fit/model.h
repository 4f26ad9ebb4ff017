// The curves that are fitted to data: their values, and their derivatives by the coefficients.
//
// A model has kCoefficients, Value(coef, x) and Gradient(coef, x, gradient), the latter in the order of coefficients.
#pragma once

#include <cmath>
#include <cstdint>

#include "stat/moments.h"

namespace krnumer {

// n points with their weights, which count by magnitude; no weights where w is null.
struct FitData {
    const double* x;
    const double* y;
    const double* w;
    int32_t n;
};

inline double WeightOf(const FitData& data, int32_t i) {
    return data.w != nullptr ? std::fabs(data.w[i]) : 1.0;
}

// slope x + intercept
struct LineModel {
    static constexpr int32_t kCoefficients = 2;
    static double Value(const double* coef, double x) { return coef[0] * x + coef[1]; }
    static void Gradient(const double*, double x, double* gradient) {
        gradient[0] = x;
        gradient[1] = 1.0;
    }
};

// a shape(b, x), with a shape whose logarithm is b times a function of x, here called its abscissa.
template <class Curve>
struct AmplitudeModel {
    static constexpr int32_t kCoefficients = 2;
    static double Value(const double* coef, double x) { return coef[0] * Curve::Shape(coef[1], x); }
    static void Gradient(const double* coef, double x, double* gradient) {
        gradient[0] = Curve::Shape(coef[1], x);
        gradient[1] = coef[0] * gradient[0] * Curve::Abscissa(x);
    }
};

// a exp(b x)
struct ExponentialModel : AmplitudeModel<ExponentialModel> {
    static double Abscissa(double x) { return x; }
    static double Shape(double b, double x) { return std::exp(b * x); }
};

// a x^b
struct PowerModel : AmplitudeModel<PowerModel> {
    static double Abscissa(double x) { return std::log(x); }
    static double Shape(double b, double x) { return std::pow(x, b); }
};

// The base whose logarithm is natural. Callers write e with these digits; with more it is a base like any other.
inline constexpr double kNaturalBase = 2.71828;

inline double LogOfBase(double v, double base, double ln_base) {
    if (base == kNaturalBase) return std::log(v);
    return base == 10.0 ? std::log10(v) : std::log(v) / ln_base;
}

inline double PowerOfBase(double base, double v) {
    return base == kNaturalBase ? std::exp(v) : std::pow(base, v);
}

// a log(b x) to a base
struct LogModel {
    static constexpr int32_t kCoefficients = 2;
    explicit LogModel(double base_in) : base(base_in), ln_base(std::log(base_in)) {}
    double Value(const double* coef, double x) const { return coef[0] * LogOfBase(coef[1] * x, base, ln_base); }
    void Gradient(const double* coef, double x, double* gradient) const {
        gradient[0] = LogOfBase(coef[1] * x, base, ln_base);
        gradient[1] = base == kNaturalBase ? coef[0] / coef[1] : coef[0] / (coef[1] * ln_base);
    }

    double base;
    double ln_base;
};

// a exp(-z^2 / 2), z = (x - mu) / sigma
struct GaussianModel {
    static constexpr int32_t kCoefficients = 3;
    static double Standardised(const double* coef, double x) { return (x - coef[1]) / coef[2]; }
    static double Value(const double* coef, double x) {
        const double z = Standardised(coef, x);
        return coef[0] * std::exp(-0.5 * z * z);
    }
    static void Gradient(const double* coef, double x, double* gradient) {
        const double z = Standardised(coef, x);
        gradient[0] = std::exp(-0.5 * z * z);
        gradient[1] = coef[0] * gradient[0] * z / coef[2];
        gradient[2] = coef[0] * gradient[0] * z * z / coef[2];
    }
};

template <class Model>
void EvaluateModel(const Model& model, const double* coef, const double* x, int32_t n, double* values) {
    for (int32_t i = 0; i < n; ++i) values[i] = model.Value(coef, x[i]);
}

// The fitted values, which may take the place of the ordinates, and their mean square error. Of a squared difference
// that rounding has made negative the magnitude counts once it is weighted.
template <class Model>
void BestFit(const Model& model, const FitData& data, const double* coef, double* best_fit, double* mse) {
    double sum = 0.0;
    for (int32_t i = 0; i < data.n; ++i) {
        const double value = model.Value(coef, data.x[i]);
        const double squared = SquaredDifference(data.y[i], value);
        sum += data.w != nullptr ? std::fabs(squared * data.w[i]) : squared;
        best_fit[i] = value;
    }
    *mse = sum / data.n;
}

}  // namespace krnumer
