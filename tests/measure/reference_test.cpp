// All measurements of many kinds of signals against their definitions, evaluated elsewhere.

#include <fstream>
#include <map>
#include <sstream>
#include <string>

#include "measure/measuring.h"

namespace krnumer {
namespace {

std::ifstream OpenReference(const std::string& name) {
    std::ifstream file(KRNUMER_REFERENCE "/" + name);
    EXPECT_TRUE(file) << name;
    return file;
}

std::map<std::string, Samples> ReadSignals() {
    std::map<std::string, Samples> signals;
    std::ifstream file = OpenReference("signals.txt");
    for (std::string line, name; std::getline(file, line);) {
        std::istringstream words(line);
        words >> name;
        for (double sample; words >> sample;) signals[name].push_back(sample);
    }
    return signals;
}

struct Expected {
    std::string name;
    Block block;
    int32_t kind;
    int32_t status;
    double value;
};

std::vector<Expected> ReadExpected() {
    const auto signals = ReadSignals();
    std::vector<Expected> all;
    std::ifstream file = OpenReference("expected.txt");
    for (std::string line; std::getline(file, line);) {
        std::istringstream words(line);
        Expected e;
        double low, mid, high;
        int16_t units;
        int32_t method, bins;
        words >> e.name >> e.block.t0 >> e.block.dt >> low >> mid >> high >> units >> method >> bins >>
            e.block.occurrence >> e.kind >> e.status >> e.value;
        EXPECT_TRUE(words) << line;
        e.block.levels = {high, mid, low, units};
        e.block.method = {method, bins};
        e.block.samples = signals.at(e.name);
        all.push_back(e);
    }
    EXPECT_GT(all.size(), 1000u);
    return all;
}

void ExpectAgreement(const Expected& e, const Outcome& outcome) {
    SCOPED_TRACE(testing::Message() << e.name << ", measurement " << e.kind << ", occurrence " << e.block.occurrence
                                    << ", method " << int32_t{e.block.method.method});
    EXPECT_EQ(outcome.status, e.status);
    // times on a late axis are as exact as the axis
    EXPECT_THAT(outcome.value, Near(e.value, 1e-11, 1e-13 * (1.0 + std::fabs(e.block.t0))));
}

TEST(Measurements, AgreeWithTheirDefinitions) {
    for (const Expected& e : ReadExpected()) ExpectAgreement(e, Fetch(e.kind, e.block));
}

// In one context, forwards and backwards: whatever was computed before must not matter.
TEST(Measurements, AgreeInAnyOrder) {
    std::vector<Expected> all = ReadExpected();
    const NewContext context;
    const auto fetch_all = [&] {
        const Block* last = nullptr;
        for (const Expected& e : all) {
            if (last != nullptr && last->samples != e.block.samples) measurements_clear(context.id());
            last = &e.block;
            ExpectAgreement(e, Fetch(context.id(), e.kind, e.block));
        }
    };
    fetch_all();
    measurements_clear(context.id());
    std::reverse(all.begin(), all.end());
    fetch_all();
}

}  // namespace
}  // namespace krnumer
