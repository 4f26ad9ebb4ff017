// What holds of every window: its weights against the reference, its symmetry, its complex twin, its answer to nothing.
#include <gtest/gtest.h>

#include <cstddef>
#include <fstream>
#include <map>
#include <sstream>
#include <string>
#include <vector>

#include "frame/status.h"
#include "support/numbers.h"
#include "window/kernels.h"

namespace krnumer {
namespace {

const int32_t kLengths[] = {1, 2, 3, 4, 5, 6, 7, 8, 15, 16, 17, 31, 32, 33, 34, 35, 64, 97, 100, 257, 500};

// length -> weights, for each window
using Reference = std::map<std::string, std::map<int32_t, std::vector<double>>>;

Reference ReadReference() {
    Reference reference;
    std::ifstream file(KRNUMER_REFERENCE "/windows.csv");
    std::string line, name, cell;
    std::getline(file, line);
    while (std::getline(file, line)) {
        std::istringstream cells(line);
        std::getline(cells, name, ',');
        std::getline(cells, cell, ',');
        std::vector<double>& weights = reference[name][std::stoi(cell)];
        while (std::getline(cells, cell, ',')) weights.push_back(std::stod(cell));
    }
    return reference;
}

// How far weights may be from the truth. The Dolph-Chebyshev spectrum is steep in its cosines, which come by a
// recurrence, and cancels when it is transformed.
double Tolerance(const std::string& name) {
    return name.starts_with("dolph-chebyshev") ? 1e-12 : 5e-15;
}

TEST(AllWindows, MatchTheirDefinitions) {
    const Reference reference = ReadReference();
    const std::vector<Kernel> kernels = AllKernels();
    ASSERT_EQ(reference.size(), kernels.size());
    for (const Kernel& kernel : kernels) {
        SCOPED_TRACE(kernel.name);
        ASSERT_TRUE(reference.contains(kernel.name));
        for (const auto& [n, expected] : reference.at(kernel.name)) {
            ASSERT_EQ(expected.size(), static_cast<std::size_t>(n));
            EXPECT_THAT(Weights(kernel.real, n), AllNear(expected, 0.0, Tolerance(kernel.name))) << "length " << n;
        }
    }
}

TEST(AllWindows, PeriodicOnesMirrorAboutHalfTheirLength) {
    for (const Kernel& kernel : PeriodicKernels()) {
        for (const int32_t n : kLengths) {
            const std::vector<double> w = Weights(kernel.real, n);
            for (std::size_t i = 1; i < w.size(); ++i)
                ASSERT_TRUE(SameBits(w[i], w[w.size() - i])) << kernel.name << ", " << i << " of " << n;
        }
    }
}

TEST(AllWindows, MultiplySamplesByTheirWeights) {
    for (const Kernel& kernel : AllKernels()) {
        for (const int32_t n : kLengths) {
            if (n == 1) continue;
            const std::vector<double> w = Weights(kernel.real, n), samples = Samples(n, 1);
            std::vector<double> x = samples;
            ASSERT_EQ(kernel.real(x.data(), n), 0);
            for (std::size_t i = 0; i < x.size(); ++i)
                ASSERT_TRUE(x[i] == samples[i] * w[i]) << kernel.name << ", " << i << " of " << n;
        }
    }
}

TEST(AllWindows, WeighBothPartsOfComplexSamplesLikeRealOnes) {
    for (const Kernel& kernel : AllKernels()) {
        const bool taper = kernel.name.starts_with("taper");  // whose angles are reckoned in two ways
        for (const int32_t n : kLengths) {
            std::vector<double> re = Samples(n, 2), im = Samples(n, 3);
            std::vector<Complex> z;
            for (std::size_t i = 0; i < re.size(); ++i) z.push_back({re[i], im[i]});
            const int32_t status = kernel.complex(z.data(), n);
            ASSERT_EQ(kernel.real(re.data(), n), status);
            ASSERT_EQ(kernel.real(im.data(), n), status);
            for (std::size_t i = 0; i < re.size(); ++i) {
                const Complex expected{re[i], im[i]};
                ASSERT_TRUE(taper ? IsNear(z[i], expected, 1e-13, 0.0) : SameBits(z[i], expected))
                    << kernel.name << ", " << i << " of " << n;
            }
        }
    }
}

TEST(AllWindows, RefuseNoSamples) {
    for (const Kernel& kernel : AllKernels()) {
        const int32_t status = kernel.name.starts_with("exponential") ? kFewerThanTwo : kEmptyInput;
        for (const int32_t n : {0, -1, INT32_MIN}) {
            EXPECT_EQ(kernel.real(nullptr, n), status) << kernel.name;
            EXPECT_EQ(kernel.complex(nullptr, n), status) << kernel.name;
        }
    }
}

TEST(AllWindows, LeaveOneSampleUnlessTheyAreTriangleKaiserOrExponential) {
    for (const Kernel& kernel : AllKernels()) {
        double x = 0.7;
        if (kernel.name.starts_with("exponential")) {
            EXPECT_EQ(kernel.real(&x, 1), kFewerThanTwo);
            continue;
        }
        EXPECT_EQ(kernel.real(&x, 1), 0) << kernel.name;
        if (kernel.name == "triangle")
            EXPECT_TRUE(SameBits(x, 0.0));
        else if (kernel.name.starts_with("kaiser"))
            EXPECT_LT(x, 0.7);
        else
            EXPECT_TRUE(SameBits(x, 0.7)) << kernel.name;
    }
}

}  // namespace
}  // namespace krnumer
