// What a filter does to a frequency, and whether it is stable, by its coefficients.
#pragma once

#include <cmath>
#include <complex>
#include <cstddef>
#include <cstdint>
#include <vector>

#include "frame/complex.h"
#include "frame/numeric.h"

namespace krnumer {

// b[0] + b[1] / z + ... at the frequency, in cycles per sample.
inline std::complex<double> AtFrequency(const double* b, std::size_t count, double frequency) {
    std::complex<double> sum = 0.0;
    for (std::size_t i = 0; i < count; ++i)
        sum += std::polar(1.0, -2.0 * kPi * frequency * static_cast<double>(i)) * b[i];
    return sum;
}

// Response of a cascade, whose section order m follows from the lengths: a has m entries per section, b one more.
inline Complex CascadeResponse(const std::vector<double>& a, const std::vector<double>& b, double frequency) {
    const std::size_t sections = b.size() - a.size();
    const std::size_t m = a.size() / sections;
    std::complex<double> product = 1.0;
    for (std::size_t k = 0; k < sections; ++k) {
        std::vector<double> denominator{1.0};
        denominator.insert(denominator.end(), &a[k * m], &a[k * m] + m);
        product *= AtFrequency(&b[k * (m + 1)], m + 1, frequency) / AtFrequency(denominator.data(), m + 1, frequency);
    }
    return {product.real(), product.imag()};
}

// Whether 1 + a[0] / z + ... + a[m-1] / z^m has all its zeros inside the unit circle.
inline bool IsStableSection(const double* a, int32_t m) {
    std::vector<long double> polynomial{1.0L};
    polynomial.insert(polynomial.end(), a, a + m);
    while (polynomial.size() > 1) {
        const long double reflection = polynomial.back();
        if (!(std::fabs(reflection) < 1.0L)) return false;
        std::vector<long double> lower(polynomial.size() - 1);
        for (std::size_t i = 0; i < lower.size(); ++i)
            lower[i] =
                (polynomial[i] - reflection * polynomial[polynomial.size() - 1 - i]) / (1.0L - reflection * reflection);
        polynomial = lower;
    }
    return true;
}

}  // namespace krnumer
