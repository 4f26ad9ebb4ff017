// Data for tests of transforms.
#pragma once

#include <complex>
#include <cstdint>
#include <fstream>
#include <random>
#include <sstream>
#include <string>
#include <vector>

#include "frame/complex.h"

namespace krnumer {

// What SciPy made of random data.
struct Transformed {
    std::string kind;
    int32_t rows, columns;
    std::vector<double> input, output;
};

inline std::vector<Transformed> Reference(const std::string& kind) {
    std::ifstream in(KRNUMER_REFERENCE "/transform.csv");
    std::vector<Transformed> all;
    for (std::string line; std::getline(in, line);) {
        std::istringstream cells(line);
        std::vector<std::string> words;
        for (std::string word; std::getline(cells, word, ',');) words.push_back(word);
        if (words.at(0) != kind) continue;
        Transformed one{kind, std::stoi(words.at(1)), std::stoi(words.at(2)), {}, {}};
        const size_t count = (words.size() - 3) / 2;
        for (size_t i = 0; i < count; ++i) {
            one.input.push_back(std::stod(words.at(3 + i)));
            one.output.push_back(std::stod(words.at(3 + count + i)));
        }
        all.push_back(std::move(one));
    }
    return all;
}

inline std::vector<double> RandomReals(int32_t n, uint32_t seed = 1) {
    std::mt19937 random(seed);
    std::normal_distribution<> normal;
    std::vector<double> x(static_cast<size_t>(n));
    for (double& value : x) value = normal(random);
    return x;
}

inline std::vector<Complex> RandomComplexes(int32_t n, uint32_t seed = 1) {
    const std::vector<double> parts = RandomReals(2 * n, seed);
    std::vector<Complex> x;
    for (size_t i = 0; i < parts.size(); i += 2) x.push_back({parts[i], parts[i + 1]});
    return x;
}

// Discrete Fourier transform by its definition, in extended precision.
inline std::vector<std::complex<long double>> Fourier(const std::vector<Complex>& x) {
    const size_t n = x.size();
    const long double turn = -2.0L * 3.141592653589793238462643383279502884L / static_cast<long double>(n);
    std::vector<std::complex<long double>> spectrum(n);
    for (size_t k = 0; k < n; ++k)
        for (size_t j = 0; j < n; ++j)
            spectrum[k] += std::complex<long double>(x[j].re, x[j].im) *
                           std::polar(1.0L, turn * static_cast<long double>(j * k % n));
    return spectrum;
}

}  // namespace krnumer
