// The adversary of M. D. McIlroy, A killer adversary for quicksort, Software Pract. Exper. 29, 341 (1999): it answers
// the comparisons of a sort so that its pivots are always as small as can be, and thereby finds the input that is the
// worst for exactly this sort.
#pragma once

#include <cstdint>
#include <numeric>
#include <vector>

namespace krnumer {

class QuicksortKiller {
  public:
    // `sort` is called as sort(first, last, before) on int32_t.
    template <class Sort>
    QuicksortKiller(int32_t n, Sort sort) : values_(static_cast<std::size_t>(n), kGas) {
        std::vector<int32_t> items(values_.size());
        std::iota(items.begin(), items.end(), 0);
        sort(items.data(), items.data() + n, [this](int32_t a, int32_t b) { return Before(a, b); });
        for (double& value : values_) {
            if (value == kGas) value = solid_++;
        }
    }

    const std::vector<double>& values() const { return values_; }
    int64_t comparisons() const { return comparisons_; }

  private:
    static constexpr double kGas = 1e300;  // not fixed yet, and greater than all that is

    bool Before(int32_t a, int32_t b) {
        ++comparisons_;
        double& left = values_[static_cast<std::size_t>(a)];
        double& right = values_[static_cast<std::size_t>(b)];
        if (left == kGas && right == kGas) (a == candidate_ ? left : right) = solid_++;
        if (left == kGas) {
            candidate_ = a;
        } else if (right == kGas) {
            candidate_ = b;
        }
        return left < right;
    }

    std::vector<double> values_;
    double solid_ = 0.0;
    int32_t candidate_ = -1;
    int64_t comparisons_ = 0;
};

}  // namespace krnumer
