// Regression problems of NIST with certified coefficients.
#pragma once

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <fstream>
#include <sstream>
#include <string>
#include <vector>

namespace krnumer {

struct Certified {
    std::vector<double> coef, deviations;
    double rss = 0.0;
    std::vector<double> y;
    std::vector<std::vector<double>> x;  // one column after the other
};

inline Certified LoadCertified(const std::string& name) {
    std::ifstream in(std::string(KRNUMER_REFERENCE) + "/nist/" + name + ".csv");
    Certified set;
    for (std::string line; std::getline(in, line);) {
        if (line.empty() || line[0] == '#') continue;
        std::istringstream cells(line);
        std::vector<std::string> words;
        for (std::string word; std::getline(cells, word, ',');) words.push_back(word);
        if (words[0] == "coef" || words[0] == "sd") {
            auto& values = words[0] == "coef" ? set.coef : set.deviations;
            for (size_t i = 1; i < words.size(); ++i) values.push_back(std::stod(words[i]));
        } else if (words[0] == "rss") {
            set.rss = std::stod(words[1]);
        } else {
            set.y.push_back(std::stod(words[0]));
            set.x.resize(words.size() - 1);
            for (size_t i = 1; i < words.size(); ++i) set.x[i - 1].push_back(std::stod(words[i]));
        }
    }
    EXPECT_FALSE(set.y.empty()) << name;
    return set;
}

// Correct digits of the worst coefficient, at most 15.
inline double CorrectDigits(const std::vector<double>& coef, const std::vector<double>& certified) {
    double digits = 15.0;
    for (size_t i = 0; i < certified.size(); ++i) {
        const double error = certified[i] == 0.0 ? std::fabs(coef.at(i)) : std::fabs(coef.at(i) / certified[i] - 1.0);
        digits = std::min(digits, error == 0.0 ? 15.0 : -std::log10(error));
    }
    return digits;
}

}  // namespace krnumer
