// The transformation that a QR iteration accumulates, brought up to date by several sweeps at a time.
#pragma once

#include <algorithm>
#include <cstddef>

#include "frame/scratch.h"

namespace krnumer {

// Sweeps that the columns of the transformation, kept as rows of n, still wait for. The iteration does without the
// transformation. So several sweeps go through it together, a strip of columns at a time, and what one has touched is
// still in the cache for the next.
//
// A Sweep consists of Links, at most n of them, and has ApplyTo(columns, stride, width).
template <class T, class Sweep>
class DelayedSweeps {
  public:
    using Link = typename Sweep::Link;

    // Without columns nothing is delayed, or applied. False when there is no memory.
    [[nodiscard]] bool Start(T* columns, std::ptrdiff_t n) {
        columns_ = columns;
        n_ = n;
        return links_.Allocate(static_cast<std::size_t>(columns != nullptr ? kMost * n : n));
    }

    // Room for the links of the next sweep.
    Link* NextLinks() { return links_.data() + count_ * n_; }

    void Add(const Sweep& sweep) {
        if (columns_ == nullptr) return;
        sweeps_[count_++] = sweep;
        if (count_ == kMost) Apply();
    }

    void Apply() {
        for (std::ptrdiff_t column = 0; count_ > 0 && column < n_; column += kStrip)
            for (std::ptrdiff_t i = 0; i < count_; ++i)
                sweeps_[i].ApplyTo(columns_ + column, n_, std::min(kStrip, n_ - column));
        count_ = 0;
    }

  private:
    static constexpr std::ptrdiff_t kMost = 8;
    static constexpr std::ptrdiff_t kStrip = 256 / sizeof(T);

    T* columns_ = nullptr;
    std::ptrdiff_t n_ = 0;
    Scratch<Link> links_;
    Sweep sweeps_[kMost];
    std::ptrdiff_t count_ = 0;
};

}  // namespace krnumer
