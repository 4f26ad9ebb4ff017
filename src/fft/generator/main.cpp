// Writes the butterflies into the folder that it is given.
#include <cstdio>
#include <fstream>

#include "fft/generator/emit.h"

int main(int count, char** arguments) {
    if (count != 2) {
        std::fprintf(stderr, "usage: %s <folder>\n", arguments[0]);
        return 1;
    }
    for (int points : krnumer::generator::kRadices) {
        std::ofstream file(std::string(arguments[1]) + "/" + krnumer::generator::FileName(points), std::ios::binary);
        file << krnumer::generator::FileText(points);
        if (!file) return 1;
    }
    return 0;
}
