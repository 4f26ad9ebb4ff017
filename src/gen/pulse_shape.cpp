#include "gen/pulse_shape.h"

#include <cmath>

#include "frame/numeric.h"
#include "frame/status.h"
#include "gen/sines.h"

namespace krnumer {

namespace {

constexpr double kE = 2.718281828459045;
constexpr double kLn10 = 2.302585092994046;

template <class Shape>
int32_t SampleShape(const double* time, double* y, int32_t n, double delay, double dt, Shape shape) {
    if (time != nullptr) {
        for (int32_t i = 0; i < n; ++i) y[i] = shape(time[i]);
    } else {
        for (int32_t i = 0; i < n; ++i) y[i] = shape(i * dt - delay);
    }
    return kOk;
}

}  // namespace

int32_t AperiodicTriangle(const double* time, double* y, int32_t n, double amplitude, double delay, double dt,
                          double width, double skew) {
    if (n < 1) return kEmptyInput;
    if (width <= 0.0) return kNotPositive;
    if (dt <= 0.0) return kBadSamplingInterval;
    if (skew < 0.0 || skew > 1.0) return kBadProbability;
    const double shift = time != nullptr ? width / 2.0 : 0.0;
    const auto sample = [=](auto shape) {
        return SampleShape(time, y, n, delay, dt, [=](double t) { return shape(t + shift); });
    };
    if (skew == 0.0) {
        const double fall = amplitude / width;
        return sample([=](double t) { return t >= 0.0 && t <= width ? (width - t) * fall : 0.0; });
    }
    if (skew == 1.0) {
        const double rise = amplitude / width;
        return sample([=](double t) { return t >= 0.0 && t <= width ? rise * t : 0.0; });
    }
    const double peak = width * skew;
    const double rise = amplitude / peak;
    const double fall = amplitude / (width - peak);
    return sample([=](double t) {
        if (t >= 0.0 && t <= peak) return rise * t;
        return t > peak && t <= width ? (width - t) * fall : 0.0;
    });
}

int32_t GaussianMonopulse(const double* time, double* y, int32_t n, double dt, double delay, double fc,
                          double amplitude) {
    if (fc <= 0.0) return kNotPositive;
    if (n < 1) return kEmptyInput;
    if (dt <= 0.0) return kBadSamplingInterval;
    const double scale = 2.0 * std::sqrt(kE) * amplitude;
    return SampleShape(time, y, n, delay, dt, [=](double t) {
        const double u = kPi * fc * t;
        return scale * u * std::exp(-2.0 * (u * u));
    });
}

int32_t GaussianPulse(const double* time, double* y, int32_t n, double amplitude, double delay, double dt, double fc,
                      double bandwidth, double attenuation) {
    if (fc <= 0.0 || bandwidth <= 0.0 || attenuation <= 0.0) return kNotPositive;
    if (n < 1) return kEmptyInput;
    if (dt <= 0.0) return kBadSamplingInterval;
    const double decay = -5.0 * (bandwidth * bandwidth) / kLn10 / attenuation;
    SampleAngles(
        y, n, Cosines, [=](int32_t i) { return 2.0 * (kPi * fc * (time != nullptr ? time[i] : i * dt - delay)); },
        [=](double angle, double cosine) {
            const double u = 0.5 * angle;
            return std::exp(decay * (u * u)) * cosine * amplitude;
        });
    return kOk;
}

int32_t PeriodicSinc(const double* time, double* y, int32_t n, double amplitude, int32_t order, double dt,
                     double delay) {
    if (order < 1) return kNotPositive;
    if (n < 1) return kEmptyInput;
    if (dt <= 0.0) return kBadSamplingInterval;
    return SampleShape(time, y, n, delay, dt, [=](double t) {
        const double u = t / 2.0;
        const double sine = std::sin(u);
        const double kernel = std::fabs(sine) > kEpsilon ? std::sin(order * u) / (order * sine) : 1.0;
        return amplitude * kernel;
    });
}

}  // namespace krnumer
