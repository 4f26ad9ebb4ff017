// Comparison with golden data: <name>.csv in tests/reference/special, lines of region, arguments, true value.
#pragma once

#include <functional>
#include <string>
#include <vector>

namespace krnumer {

// What a region is held to: |computed - true| <= relative |true| + absolute.
struct Bound {
    std::string region;
    double relative;
    double absolute = 0.0;
};

// Every line of the file by the bound of its region. Every region of the file has a bound and every bound a region.
void ExpectGolden(const std::string& name, const std::function<double(const double*)>& function,
                  const std::vector<Bound>& bounds);

}  // namespace krnumer
