#include "sigop/signals.h"

#include <cstdlib>
#include <fstream>
#include <sstream>
#include <stdexcept>

namespace krnumer {

Golden::Golden(const std::string& file) {
    std::ifstream lines(std::string(KRNUMER_REFERENCE "/") + file + ".txt");
    if (!lines) throw std::runtime_error("no reference file " + file);
    for (std::string line, name, word; std::getline(lines, line);) {
        if (line.starts_with('#')) continue;
        std::istringstream words(line);
        words >> name;
        std::vector<double>& numbers = signals_[name];
        while (words >> word) numbers.push_back(std::strtod(word.c_str(), nullptr));
    }
}

std::vector<Complex> Golden::Complexes(const std::string& name) const {
    const std::vector<double>& parts = Reals(name);
    std::vector<Complex> values;
    for (size_t i = 0; i + 1 < parts.size(); i += 2) values.push_back({parts[i], parts[i + 1]});
    return values;
}

std::vector<int32_t> Golden::Integers(const std::string& name) const {
    const std::vector<double>& numbers = Reals(name);
    return {numbers.begin(), numbers.end()};
}

std::vector<std::string> Golden::Cases(const std::string& prefix) const {
    std::vector<std::string> cases;
    for (const auto& [name, numbers] : signals_) {
        const std::string stem = name.substr(0, name.find('.'));
        if (stem.starts_with(prefix) && (cases.empty() || cases.back() != stem)) cases.push_back(stem);
    }
    if (cases.empty()) throw std::out_of_range("no reference for " + prefix);
    return cases;
}

}  // namespace krnumer
