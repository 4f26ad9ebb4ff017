// Every window of the family behind one face, for what holds of all of them.
#pragma once

#include <cstdint>
#include <functional>
#include <string>
#include <utility>
#include <vector>

#include "frame/complex.h"

namespace krnumer {

struct Kernel {
    template <class Run>
    Kernel(std::string name_, Run run) : name(std::move(name_)), real(run), complex(run) {}

    std::string name;  // with its parameter, as in the reference data
    std::function<int32_t(double*, int32_t)> real;
    std::function<int32_t(Complex*, int32_t)> complex;
};

inline void PrintTo(const Kernel& kernel, std::ostream* out) {
    *out << kernel.name;
}

// Periodic windows, w[i] = w[n-i], then those that are not.
const std::vector<Kernel>& PeriodicKernels();
const std::vector<Kernel>& OtherKernels();
std::vector<Kernel> AllKernels();

// The weights that a kernel gives: what becomes of ones. Fails the test unless the kernel succeeds.
std::vector<double> Weights(const std::function<int32_t(double*, int32_t)>& kernel, int32_t n);

// Samples without pattern between -1 and 1.
std::vector<double> Samples(int32_t n, uint32_t seed);

}  // namespace krnumer
