#include "special/golden.h"

#include <gtest/gtest.h>

#include <cmath>
#include <fstream>
#include <map>
#include <sstream>

#include "frame/numeric.h"
#include "support/numbers.h"

namespace krnumer {
namespace {

struct Worst {
    double excess = -1.0;  // error over bound
    std::vector<double> arguments;
    double computed = 0.0, expected = 0.0;
};

struct Line {
    std::string region;
    std::vector<double> numbers;  // arguments, true value
};

std::vector<Line> ReadGolden(const std::string& name) {
    std::vector<Line> lines;
    std::ifstream file(std::string(KRNUMER_REFERENCE "/") + name + ".csv");
    for (std::string text; std::getline(file, text);) {
        Line line;
        std::istringstream fields(text);
        std::string field;
        const bool quoted = text.front() == '"';  // a region with a comma in its name
        if (quoted) fields.get();
        std::getline(fields, line.region, quoted ? '"' : ',');
        if (quoted) fields.get();
        while (std::getline(fields, field, ',')) line.numbers.push_back(std::strtod(field.c_str(), nullptr));
        lines.push_back(line);
    }
    return lines;
}

}  // namespace

void ExpectGolden(const std::string& name, const std::function<double(const double*)>& function,
                  const std::vector<Bound>& bounds) {
    std::map<std::string, Bound> by_region;
    for (const Bound& bound : bounds) by_region[bound.region] = bound;

    std::map<std::string, Worst> found;
    for (const Line& line : ReadGolden(name)) {
        ASSERT_TRUE(by_region.contains(line.region)) << name << " has no bound for the region " << line.region;
        ASSERT_GE(line.numbers.size(), 2u);
        const Bound& bound = by_region[line.region];
        const double expected = line.numbers.back();
        const double computed = function(line.numbers.data());
        const double allowed = bound.relative * std::abs(expected) + bound.absolute;
        double excess = computed == expected ? 0.0 : std::abs(computed - expected) / allowed;
        if (std::isnan(excess)) excess = kInfinity;
        Worst& worst = found[line.region];
        if (excess > worst.excess) worst = {excess, {line.numbers.begin(), line.numbers.end() - 1}, computed, expected};
    }
    for (const Bound& bound : bounds) {
        ASSERT_TRUE(found.contains(bound.region)) << name << " has no data for the region " << bound.region;
        const Worst& worst = found[bound.region];
        EXPECT_LE(worst.excess, 1.0) << name << ", " << bound.region << ": " << Show(worst.computed) << " instead of "
                                     << Show(worst.expected) << " at " << testing::PrintToString(worst.arguments);
    }
}

}  // namespace krnumer
