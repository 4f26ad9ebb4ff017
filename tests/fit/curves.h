// Data with fits and bands made elsewhere, and the steps of their loops: see reference/fit/make_curves.py and
// make_loops.py.
#pragma once

#include <gtest/gtest.h>

#include <cstdint>
#include <fstream>
#include <map>
#include <sstream>
#include <string>
#include <vector>

namespace krnumer {

// The row of a name.
inline const std::vector<double>& Reference(const std::string& name) {
    static const auto rows = [] {
        std::map<std::string, std::vector<double>> all;
        std::ifstream in(std::string(KRNUMER_REFERENCE) + "/curves.csv");
        for (std::string line; std::getline(in, line);) {
            std::istringstream cells(line);
            std::string word;
            std::getline(cells, word, ',');
            std::vector<double>& values = all[word];
            while (std::getline(cells, word, ',')) values.push_back(std::stod(word));
        }
        return all;
    }();
    const auto row = rows.find(name);
    if (row == rows.end()) throw std::out_of_range(name);
    return row->second;
}

// One run of an iterated fit to the data of a row.
struct Loop {
    double tol;
    int32_t budget;
    std::vector<double> coef;
    double error;  // mean square, or mean absolute
    int32_t steps;
};

// All runs of a fit, named after its way, its model and ".weighted".
inline std::vector<Loop> Loops(const std::string& name) {
    std::vector<Loop> loops;
    std::ifstream in(std::string(KRNUMER_REFERENCE) + "/loops.csv");
    for (std::string line; std::getline(in, line);) {
        std::istringstream cells(line);
        std::string word;
        std::getline(cells, word, ',');
        if (word != name) continue;
        std::vector<double> values;
        while (std::getline(cells, word, ',')) values.push_back(std::stod(word));
        loops.push_back({values.at(0),
                         static_cast<int32_t>(values.at(1)),
                         {values.begin() + 2, values.end() - 2},
                         *(values.end() - 2),
                         static_cast<int32_t>(values.back())});
    }
    EXPECT_FALSE(loops.empty()) << name;
    return loops;
}

}  // namespace krnumer
