#include "sweep/fuzz.h"

#include <gtest/gtest.h>

#include <fstream>
#include <vector>

namespace sweep {
namespace {

// What the fuzzer kept because it reached code that nothing before it had reached, one input a line in hexadecimal.
TEST(Fuzz, FindsNothingInItsCorpus) {
    std::ifstream corpus(KRNUMER_REFERENCE "/corpus.txt");
    int inputs = 0;
    for (std::string line; corpus >> line; ++inputs) {
        std::vector<uint8_t> input;
        for (size_t i = 0; i + 1 < line.size(); i += 2)
            input.push_back(static_cast<uint8_t>(std::stoi(line.substr(i, 2), nullptr, 16)));
        EXPECT_EQ(Fuzz(input), "") << FuzzedScene(input) << ": " << line;
    }
    EXPECT_GT(inputs, 0);
}

}  // namespace
}  // namespace sweep
