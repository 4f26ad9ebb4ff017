// Random samples and their exact spectra.
#pragma once

#include <complex>
#include <cstdint>
#include <random>
#include <vector>

#include "fft/long_dft.h"
#include "frame/complex.h"

namespace krnumer {

inline std::vector<Complex> RandomComplex(int32_t n, uint64_t seed = 1) {
    std::mt19937_64 engine(seed + static_cast<uint64_t>(n) * 1000);
    std::normal_distribution<double> normal;
    std::vector<Complex> x(static_cast<size_t>(n));
    for (Complex& z : x) z = {normal(engine), normal(engine)};
    return x;
}

inline std::vector<double> RandomReal(int32_t n, uint64_t seed = 1) {
    std::vector<double> x;
    for (Complex z : RandomComplex(n, seed)) x.push_back(z.re);
    return x;
}

inline std::vector<LongComplex> Widened(const std::vector<Complex>& x) {
    std::vector<LongComplex> z;
    for (Complex value : x) z.emplace_back(value.re, value.im);
    return z;
}

inline std::vector<LongComplex> ReferenceOf(const std::vector<Complex>& x) {
    return LongDft(Widened(x));
}

inline std::vector<LongComplex> ReferenceOf(const std::vector<double>& x) {
    return LongDft({x.begin(), x.end()});
}

// Root of the mean squared error over the root of the mean square.
inline double RelativeError(const std::vector<Complex>& actual, const std::vector<LongComplex>& expected) {
    long double error = 0, size = 0;
    for (size_t k = 0; k < expected.size(); ++k) {
        error += std::norm(expected[k] - LongComplex(actual[k].re, actual[k].im));
        size += std::norm(expected[k]);
    }
    return static_cast<double>(std::sqrt(error / size));
}

inline double RelativeError(const std::vector<Complex>& actual, const std::vector<Complex>& expected) {
    return RelativeError(actual, Widened(expected));
}

}  // namespace krnumer
