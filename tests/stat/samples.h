// Data sets of the statistics tests: golden ones from files, and random ones of many kinds.
#pragma once

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <fstream>
#include <map>
#include <random>
#include <sstream>
#include <stdexcept>
#include <string>
#include <vector>

#include "frame/numeric.h"

namespace krnumer {

inline int32_t Size(const std::vector<double>& samples) {
    return static_cast<int32_t>(samples.size());
}

inline std::ifstream OpenReference(const std::string& name) {
    std::ifstream file(std::string(KRNUMER_REFERENCE) + "/" + name);
    if (!file) throw std::runtime_error("no reference file " + name);
    return file;
}

// The data sets of samples.txt by name.
inline const std::map<std::string, std::vector<double>>& GoldenSamples() {
    static const auto sets = [] {
        std::map<std::string, std::vector<double>> read;
        std::ifstream file = OpenReference("samples.txt");
        for (std::string line, name, word; std::getline(file, line);) {
            std::istringstream words(line);
            words >> name;
            while (words >> word) read[name].push_back(std::stod(word));
        }
        return read;
    }();
    return sets;
}

struct GoldenResult {
    std::string set;
    std::string parameter;
    std::vector<double> values;
};

// All results of expected.txt for one statistic.
inline std::vector<GoldenResult> GoldenResults(const std::string& statistic) {
    std::vector<GoldenResult> results;
    std::ifstream file = OpenReference("expected.txt");
    for (std::string line, kind; std::getline(file, line);) {
        std::istringstream words(line);
        GoldenResult result;
        words >> result.set >> kind >> result.parameter;
        if (kind != statistic) continue;
        for (double value; words >> value;) result.values.push_back(value);
        results.push_back(result);
    }
    if (results.empty()) throw std::runtime_error("no reference for " + statistic);
    return results;
}

// A univariate set of the NIST reference data with its certified values.
struct CertifiedSet {
    std::vector<double> samples;
    double mean = 0.0;
    double standard_deviation = 0.0;
};

inline CertifiedSet ReadCertifiedSet(const std::string& name) {
    CertifiedSet set;
    std::ifstream file = OpenReference("nist/" + name + ".txt");
    for (std::string line, hash, key; std::getline(file, line);) {
        std::istringstream words(line);
        if (line[0] == '#') {
            words >> hash >> key;
            if (key == "mean") words >> set.mean;
            if (key == "sd") words >> set.standard_deviation;
        } else {
            set.samples.push_back(std::stod(line));
        }
    }
    return set;
}

enum class Kind {
    kUniform,
    kFewValues,
    kAscending,
    kDescending,
    kConstant,
    kOrganPipe,
    kSawtooth,
    kNaNLaden,
    kExtreme
};

inline constexpr Kind kAllKinds[] = {Kind::kUniform,    Kind::kFewValues, Kind::kAscending,
                                     Kind::kDescending, Kind::kConstant,  Kind::kOrganPipe,
                                     Kind::kSawtooth,   Kind::kNaNLaden,  Kind::kExtreme};

inline std::vector<double> RandomSamples(Kind kind, int32_t n, std::mt19937_64& random) {
    std::uniform_real_distribution<double> uniform(-1.0, 1.0);
    std::vector<double> samples;
    for (int32_t i = 0; i < n; ++i) {
        switch (kind) {
            case Kind::kUniform:
                samples.push_back(uniform(random));
                break;
            case Kind::kFewValues:
                samples.push_back(static_cast<double>(random() % 7));
                break;
            case Kind::kAscending:
                samples.push_back(i);
                break;
            case Kind::kDescending:
                samples.push_back(-i);
                break;
            case Kind::kConstant:
                samples.push_back(2.5);
                break;
            case Kind::kOrganPipe:
                samples.push_back(std::min(i, n - i));
                break;
            case Kind::kSawtooth:
                samples.push_back(i % 13);
                break;
            case Kind::kNaNLaden:
                samples.push_back(random() % 3 == 0 ? -kQuietNaN : uniform(random));
                break;
            case Kind::kExtreme: {
                constexpr double kValues[] = {-kInfinity, -1.7976931348623157e308, -0.0,     0.0,
                                              4.94e-324,  1.7976931348623157e308,  kInfinity};
                samples.push_back(kValues[random() % 7]);
                break;
            }
        }
    }
    return samples;
}

}  // namespace krnumer
