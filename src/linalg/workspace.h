// Work space of a decomposition: one block of memory, handed out piece by piece.
#pragma once

#include <cstddef>
#include <utility>

#include "frame/scratch.h"

namespace krnumer {

template <class T>
class Workspace {
  public:
    Workspace(std::ptrdiff_t elements, std::ptrdiff_t doubles)
        : block_(static_cast<std::size_t>(kParts * elements + doubles)), next_(block_.data()) {}

    explicit operator bool() const { return static_cast<bool>(block_); }

    double* Doubles(std::ptrdiff_t count) { return std::exchange(next_, next_ + count); }
    T* Elements(std::ptrdiff_t count) { return reinterpret_cast<T*>(Doubles(kParts * count)); }
    // An index takes the room of a double.
    std::ptrdiff_t* Indices(std::ptrdiff_t count) {
        static_assert(sizeof(std::ptrdiff_t) <= sizeof(double));
        return reinterpret_cast<std::ptrdiff_t*>(Doubles(count));
    }

  private:
    static constexpr std::ptrdiff_t kParts = sizeof(T) / sizeof(double);

    Scratch<double> block_;
    double* next_;
};

}  // namespace krnumer
