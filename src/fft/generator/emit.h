// Programs as C++.
#pragma once

#include <string>

#include "fft/generator/program.h"

namespace krnumer::generator {

// The sizes that have a butterfly.
inline constexpr int kRadices[] = {2, 3, 4, 5, 7, 8, 9, 10, 11, 13, 14, 16, 17, 18, 19, 29, 31, 32, 37, 41, 43};

// One butterfly: its program and what it delivers.
struct Butterfly {
    Program program;
    Spectrum spectrum;

    explicit Butterfly(int points);

    // Operations on real samples, and on complex ones. Those run the program on real and imaginary parts and join the
    // halves of each conjugate pair by four additions; size 32 goes its own way.
    OperationCount RealCount() const { return program.Count(); }
    OperationCount ComplexCount() const;
};

// Name of the file that holds a butterfly.
std::string FileName(int points);

// Its contents.
std::string FileText(int points);

}  // namespace krnumer::generator
