// Data with fits and bands made elsewhere: see reference/fit/make_curves.py.
#pragma once

#include <gtest/gtest.h>

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

}  // namespace krnumer
